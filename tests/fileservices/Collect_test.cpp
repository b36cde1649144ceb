#include "fileservices/Collect.h"

#include <gtest/gtest.h>

#include <limits>

#include "hosts/headless/HeadlessHost.h"

namespace tessel::fileservices {
namespace {

using frame::Variant;

class CollectTest : public testing::Test {
  protected:
    /// The calls, from 1, at which the message loop had a turn.
    std::vector<int> TurnsAt(int calls) {
        std::vector<int> turns;
        for (int call = 1; call <= calls; ++call) {
            host.log.Clear();
            collect.CollectYield();
            for (std::size_t i = 0; i < host.log.Of("yield").size(); ++i) turns.push_back(call);
        }
        return turns;
    }

    headless::HeadlessHost host;
    Collect& collect = host.Frame().Module<Collect>();
};

TEST_F(CollectTest, WithLimitThreeTheMessageLoopRunsOnTheThirdSixthAndNinthCall) {
    collect.CollectYield(3);
    EXPECT_TRUE(host.log.Entries().empty());
    EXPECT_EQ(TurnsAt(10), (std::vector{3, 6, 9}));
}

TEST_F(CollectTest, ANewLimitStartsTheCountAnew) {
    collect.CollectYield(3);
    EXPECT_EQ(TurnsAt(2), std::vector<int>{});
    collect.CollectYield(3);
    EXPECT_EQ(TurnsAt(3), std::vector{3});
}

TEST_F(CollectTest, WithoutALimitEveryCallLetsTheMessageLoopRun) {
    EXPECT_EQ(TurnsAt(2), (std::vector{1, 2}));
    collect.CollectYield(std::numeric_limits<std::int32_t>::min());
    EXPECT_EQ(TurnsAt(2), (std::vector{1, 2}));
}

TEST_F(CollectTest, TheLimitIsTakenByNameAndAnyValueCounts) {
    Variant limit[] = {2}, missing[] = {Variant::Missing()}, null[] = {Variant()};
    collect.Call("CollectYield", limit);
    collect.Call("CollectYield");
    EXPECT_TRUE(host.log.Of("yield").empty());
    collect.Call("CollectYield", missing);
    EXPECT_EQ(host.log.Of("yield").size(), 1u);
    collect.Call("CollectYield", limit);
    collect.Call("CollectYield", null);
    EXPECT_EQ(TurnsAt(1), std::vector{1});
}

TEST_F(CollectTest, AllControlsOfAHostShareTheCounterAndNoOtherHostDoes) {
    headless::HeadlessHost other;
    collect.CollectYield(2);
    other.Frame().Module<Collect>().CollectYield(2);
    host.Frame().Module<Collect>().CollectYield();
    other.Frame().Module<Collect>().CollectYield();
    EXPECT_TRUE(other.log.Of("yield").empty());
    EXPECT_EQ(TurnsAt(1), std::vector{1});
}

TEST_F(CollectTest, KeepsEveryTextThatIsAdded) {
    std::vector<std::string> texts;
    for (int i = 0; i < 1000; ++i) texts.push_back(std::to_string(i));
    for (const std::string& text : texts) {
        Variant argument[] = {text};
        collect.Call("CollectAdd", argument);
    }
    EXPECT_EQ(collect.Collected(), texts);
}

}  // namespace
}  // namespace tessel::fileservices
