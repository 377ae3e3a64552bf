#include "FemNotifier.h"

#include <algorithm>

CFemNotifier::~CFemNotifier() {
    // Listeners may outlive the notifier; they must not reach back into it.
    for (CFemListener* l : m_listeners)
        std::erase(l->m_notifiers, this);
}

void CFemNotifier::NotifyListeners(ENotifyMessage message) {
    // A listener may start or stop listening while it is told; tell those present now.
    const std::vector<CFemListener*> listeners = m_listeners;
    for (CFemListener* l : listeners)
        if (std::find(m_listeners.begin(), m_listeners.end(), l) != m_listeners.end())
            l->Notify(this, message);
}

CFemListener::~CFemListener() {
    for (CFemNotifier* n : m_notifiers)
        std::erase(n->m_listeners, this);
}

void CFemListener::Listen(CFemNotifier* notifier) {
    if (!notifier || std::find(m_notifiers.begin(), m_notifiers.end(), notifier) != m_notifiers.end())
        return;
    m_notifiers.push_back(notifier);
    notifier->m_listeners.push_back(this);
}

void CFemListener::StopListening(CFemNotifier* notifier) {
    std::erase(m_notifiers, notifier);
    if (notifier)
        std::erase(notifier->m_listeners, this);
}

void CFemListener::Notify(CFemNotifier*, ENotifyMessage) {}
