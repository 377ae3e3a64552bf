#include "FemNotifier.h"

#include <algorithm>
#include <iterator>

CFemNotifier::~CFemNotifier() {
    // Listeners may outlive the notifier; they must not reach back into it.
    for (CFemListener* l : m_listeners)
        if (l)
            std::erase_if(l->m_notifiers, [this](const CFemListener::Subscription& s) {
                return s.notifier == this;
            });
}

void CFemNotifier::NotifyListeners(ENotifyMessage message) {
    if (m_listeners.empty())
        return;
    // Those present now are told: one that leaves meanwhile is not, one that starts
    // listening meanwhile hears the next message.
    const Listeners::iterator last = std::prev(m_listeners.end());
    ++m_notifying;
    for (Listeners::iterator it = m_listeners.begin();; ++it) {
        if (*it)
            (*it)->Notify(this, message);
        if (it == last)
            break;
    }
    if (--m_notifying == 0 && m_emptied) {
        m_listeners.remove(nullptr);
        m_emptied = false;
    }
}

void CFemNotifier::Remove(Listeners::iterator at) {
    if (m_notifying > 0) {
        *at = nullptr;
        m_emptied = true;
    } else {
        m_listeners.erase(at);
    }
}

CFemListener::~CFemListener() {
    for (const Subscription& s : m_notifiers)
        s.notifier->Remove(s.at);
}

void CFemListener::Listen(CFemNotifier* notifier) {
    if (!notifier || std::any_of(m_notifiers.begin(), m_notifiers.end(),
                                 [&](const Subscription& s) { return s.notifier == notifier; }))
        return;
    notifier->m_listeners.push_back(this);
    m_notifiers.push_back({notifier, std::prev(notifier->m_listeners.end())});
}

void CFemListener::StopListening(CFemNotifier* notifier) {
    auto it = std::find_if(m_notifiers.begin(), m_notifiers.end(),
                           [&](const Subscription& s) { return s.notifier == notifier; });
    if (it == m_notifiers.end())
        return;
    it->notifier->Remove(it->at);
    m_notifiers.erase(it);
}

void CFemListener::Notify(CFemNotifier*, ENotifyMessage) {}
