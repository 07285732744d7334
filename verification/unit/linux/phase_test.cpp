#include "linux/phase.h"

#include <gtest/gtest.h>
#include <poll.h>

namespace wp {
namespace {

/// A phase on a machine without the interface it asks for, so that each fact ends with an error soon.
class PhaseTest : public testing::Test {
  protected:
    PhaseTest() { sources_.interfaceName = "no-such-wifi"; }
    ~PhaseTest() override { stop_->raise(); }

    std::shared_ptr<Phase> begun(const PhaseTopic& topic) {
        auto phase = std::make_shared<Phase>(topic, sources_, workers_, stop_, [this] { ++progress_; });
        phase->begin();
        return phase;
    }

    /// Takes over what was gathered until the facts of the test are there; false where that does not come to be.
    bool becomesReady(const Phase& phase, int test) {
        while (!phase.isReady(*findTest(test))) {
            pollfd gathered{inbox_.descriptor(), POLLIN, 0};
            if (poll(&gathered, 1, 10'000) <= 0) return false;
            inbox_.run();
        }
        return true;
    }

    Sources sources_;
    Inbox inbox_;
    std::shared_ptr<StopSignal> stop_ = std::make_shared<StopSignal>();
    int progress_ = 0;
    Workers workers_{inbox_};
};

TEST_F(PhaseTest, OfTheJoinedNetworkIsAboutTheDeviceToo) {
    const auto phase = begun({Subject::network, std::nullopt, {}});
    for (const int test : {14, 18, 22, 29, 3, 34}) EXPECT_TRUE(becomesReady(*phase, test)) << test;
    EXPECT_GT(progress_, 0);
}

TEST_F(PhaseTest, OfTheDeviceAloneIsAboutNoNetwork) {
    const auto phase = begun({Subject::device, std::nullopt, {}});
    for (const int test : {14, 18, 22, 29}) EXPECT_TRUE(becomesReady(*phase, test)) << test;
    for (const int test : {3, 24, 30, 35}) EXPECT_FALSE(phase->isReady(*findTest(test))) << test;
}

TEST_F(PhaseTest, OfANamedNetworkIsNotAboutTheDevice) {
    const auto phase = begun({Subject::network, nameFromText("Office"), {}});
    for (const int test : {24, 28, 34}) EXPECT_TRUE(becomesReady(*phase, test)) << test;
    for (const int test : {18, 22}) EXPECT_FALSE(phase->isReady(*findTest(test))) << test;
}

}  // namespace
}  // namespace wp
