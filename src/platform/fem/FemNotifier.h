// Change notification between nodes that do not own each other.
#pragma once

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
    std::vector<CFemListener*> m_listeners;
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
    std::vector<CFemNotifier*> m_notifiers;
};
