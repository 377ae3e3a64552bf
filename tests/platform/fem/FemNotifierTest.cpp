#include "fem/FemNotifier.h"
#include "fem/UnitUtil.h"

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace {

// A listener that logs what it hears and may act on the notifier while it is told.
class Recorder : public CFemListener {
public:
    Recorder(std::string name, std::vector<std::string>& log) : m_name(std::move(name)), m_log(log) {}
    void Notify(CFemNotifier* n, ENotifyMessage message) override {
        m_log.push_back(m_name + ":" + std::to_string(message));
        if (onNotify)
            onNotify(n, message);
    }
    std::function<void(CFemNotifier*, ENotifyMessage)> onNotify;

private:
    std::string m_name;
    std::vector<std::string>& m_log;
};

TEST(Notifier, ListenersJoiningOrLeavingWhileTheyAreToldAreHandledInOrder) {
    std::vector<std::string> log;
    CFemNotifier notifier;
    Recorder a("a", log), c("c", log), d("d", log);
    auto b = std::make_unique<Recorder>("b", log);
    auto late = std::make_unique<Recorder>("late", log);
    a.Listen(&notifier);
    b->Listen(&notifier);
    c.Listen(&notifier);
    d.Listen(&notifier);
    a.Listen(&notifier);  // once only

    // a removes b (destroyed) and stops c; a newcomer waits for the next message.
    a.onNotify = [&](CFemNotifier* n, ENotifyMessage m) {
        if (m != 1)
            return;
        b.reset();
        c.StopListening(n);
        late->Listen(n);
    };
    notifier.NotifyListeners(1);
    EXPECT_EQ(log, (std::vector<std::string>{"a:1", "d:1"}));

    log.clear();
    notifier.NotifyListeners(2);
    EXPECT_EQ(log, (std::vector<std::string>{"a:2", "d:2", "late:2"}));

    // A message sent from inside a message, after which the next listener goes.
    log.clear();
    d.onNotify = [&](CFemNotifier* n, ENotifyMessage m) {
        if (m != 3)
            return;
        n->NotifyListeners(4);
        late.reset();
    };
    notifier.NotifyListeners(3);
    EXPECT_EQ(log, (std::vector<std::string>{"a:3", "d:3", "a:4", "d:4", "late:4"}));
    log.clear();
    notifier.NotifyListeners(5);
    EXPECT_EQ(log, (std::vector<std::string>{"a:5", "d:5"}));
}

TEST(Notifier, ListenersOutliveTheirNotifiers) {
    std::vector<std::string> log;
    Recorder r("r", log);
    auto first = std::make_unique<CFemNotifier>();
    CFemNotifier second;
    r.Listen(first.get());
    r.Listen(&second);
    first.reset();
    second.NotifyListeners(1);
    r.StopListening(&second);
    second.NotifyListeners(2);
    EXPECT_EQ(log, (std::vector<std::string>{"r:1"}));
}

TEST(Units, ConvertWithinAQuantityOnly) {
    const QuantityInfo* velocity = CUnitUtil::FindQuantity(100128);
    const QuantityInfo* coordinate = CUnitUtil::FindQuantity(100183);
    ASSERT_TRUE(velocity && coordinate);
    const int ms = velocity->units.at(0).id;
    const int mms = velocity->units.at(1).id;
    const int km = coordinate->units.at(1).id;
    EXPECT_DOUBLE_EQ(CZoUnitConverter(ms, mms).Convert(0.0025), 2.5);
    EXPECT_DOUBLE_EQ(CZoUnitConverter(mms, ms).Convert(2.5), 0.0025);
    // Units of different quantities, or unknown ones, leave the value as it is.
    EXPECT_EQ(CZoUnitConverter(km, ms).Convert(3.0), 3.0);
    EXPECT_EQ(CZoUnitConverter(ms, 0).Convert(3.0), 3.0);
}

}  // namespace
