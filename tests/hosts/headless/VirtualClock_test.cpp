#include "hosts/headless/VirtualClock.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "frame/Dates.h"

namespace tessel::headless {
namespace {

/// A client that writes its name and what else it is told to do.
class Ticker final : public frame::TimerClient {
  public:
    Ticker(std::string& trace, std::string name) : trace_(trace), name_(std::move(name)) {}
    void Tick() override {
        trace_ += name_;
        if (onTick) onTick();
    }

    std::function<void()> onTick;

  private:
    std::string& trace_;
    std::string name_;
};

struct Clocks : testing::Test {
    VirtualClock clock;
    std::string trace;
    Ticker a{trace, "a"}, b{trace, "b"}, c{trace, "c"};
};

TEST_F(Clocks, StandStillUntilTheyAreMoved) {
    clock.SetNow({36'000});
    clock.Start(a, 1);
    EXPECT_EQ(clock.Now().days, 36'000);
    EXPECT_EQ(trace, "");
}

TEST_F(Clocks, ShowTheTimeThatWasSetAndWhatHasPassedSince) {
    clock.Advance(5'000);
    clock.SetNow({36'000});
    EXPECT_EQ(frame::SortableDateText(clock.Now()), "1998-07-24 00:00:00");
    clock.Advance(90'061'000);
    EXPECT_EQ(frame::SortableDateText(clock.Now()), "1998-07-25 01:01:01");
}

TEST_F(Clocks, FireATimerEachTimeItsIntervalHasPassed) {
    clock.Start(a, 100);
    clock.Advance(99);
    EXPECT_EQ(trace, "");
    clock.Advance(1);
    EXPECT_EQ(trace, "a");
    clock.Advance(250);
    EXPECT_EQ(trace, "aaa");
    clock.Advance(50);
    EXPECT_EQ(trace, "aaaa");
}

TEST_F(Clocks, FireTimersInTheOrderInWhichTheyAreDue) {
    clock.Start(a, 100);
    clock.Start(b, 70);
    clock.Start(c, 30);
    clock.Advance(100);
    EXPECT_EQ(trace, "ccbca");
}

TEST_F(Clocks, FireOfTwoThatAreDueAtOnceTheOneStartedFirst) {
    clock.Start(b, 50);
    clock.Start(a, 50);
    clock.Start(c, 100);
    clock.Advance(100);
    EXPECT_EQ(trace, "babac");
}

TEST_F(Clocks, ShowTheMomentAtWhichATimerIsDueWhileItRuns) {
    clock.SetNow({1});
    double seen = 0;
    a.onTick = [&] { seen = clock.Now().days; };
    clock.Start(a, 21'600'000);
    clock.Advance(30'000'000);
    EXPECT_EQ(seen, 1.25);
}

TEST_F(Clocks, CountASecondStartAnew) {
    clock.Start(a, 100);
    clock.Advance(60);
    clock.Start(a, 100);
    clock.Advance(60);
    EXPECT_EQ(trace, "");
    clock.Advance(40);
    EXPECT_EQ(trace, "a");
    clock.Start(a, 10);
    clock.Advance(25);
    EXPECT_EQ(trace, "aaa");
}

TEST_F(Clocks, FireAStoppedTimerNoMore) {
    clock.Start(a, 10);
    clock.Start(b, 10);
    clock.Stop(a);
    clock.Stop(c);
    clock.Advance(20);
    EXPECT_EQ(trace, "bb");
}

TEST_F(Clocks, LetATimerStopItselfAndOthersWhileItRuns) {
    a.onTick = [&] {
        clock.Stop(a);
        clock.Stop(b);
    };
    clock.Start(a, 10);
    clock.Start(b, 10);
    clock.Start(c, 10);
    clock.Advance(20);
    EXPECT_EQ(trace, "acc");
}

TEST_F(Clocks, CountATimerThatIsStartedMeanwhileFromThatMoment) {
    a.onTick = [&] { clock.Start(b, 30); };
    clock.Start(a, 50);
    clock.Advance(79);
    EXPECT_EQ(trace, "a");
    clock.Advance(1);
    EXPECT_EQ(trace, "ab");
}

TEST_F(Clocks, LetATimerGiveItselfAnotherInterval) {
    a.onTick = [&] { clock.Start(a, 20); };
    clock.Start(a, 50);
    clock.Advance(90);
    EXPECT_EQ(trace, "aaa");
}

TEST_F(Clocks, GoOnFromWhereATimerHasMovedThem) {
    a.onTick = [&] {
        clock.Stop(a);
        clock.Advance(100);
    };
    clock.Start(a, 10);
    clock.Start(b, 40);
    clock.SetNow({0});
    clock.Advance(50);
    EXPECT_EQ(trace, "abb");
    EXPECT_NEAR(clock.Now().days * 86'400'000, 110, 0.01);
}

}  // namespace
}  // namespace tessel::headless
