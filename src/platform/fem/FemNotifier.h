// Change notification between nodes that do not own each other.
#pragma once

#include <list>
#include <vector>

using ENotifyMessage = int;

class CFemListener;

class CFemNotifier {
public:
    CFemNotifier() = default;
    virtual ~CFemNotifier();
    CFemNotifier(const CFemNotifier&) = delete;
    CFemNotifier& operator=(const CFemNotifier&) = delete;

    // Calls Notify on every listener, in the order they started listening.
    void NotifyListeners(ENotifyMessage message);

private:
    friend class CFemListener;
    // One entry per listener, so that leaving costs the same however many listen (one per
    // boundary or source); an entry left while listeners are told is emptied, not erased.
    using Listeners = std::list<CFemListener*>;
    void Remove(Listeners::iterator at);

    Listeners m_listeners;
    int m_notifying = 0;
    bool m_emptied = false;
};

class CFemListener {
public:
    CFemListener() = default;
    virtual ~CFemListener();
    CFemListener(const CFemListener&) = delete;
    CFemListener& operator=(const CFemListener&) = delete;

    void Listen(CFemNotifier* notifier);
    void StopListening(CFemNotifier* notifier);
    virtual void Notify(CFemNotifier* notifier, ENotifyMessage message);

private:
    friend class CFemNotifier;
    struct Subscription {
        CFemNotifier* notifier;
        CFemNotifier::Listeners::iterator at;
    };
    std::vector<Subscription> m_notifiers;
};
