#include "frame/child/Timer.h"

#include <gtest/gtest.h>

#include "frame/ClassTable.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"

namespace tessel::child {
namespace {

using test::ErrorOf;

class Clockwork final : public frame::Control {
  public:
    explicit Clockwork(frame::Host& host) : Control(host) { Timer1.Elapsed.To<&Clockwork::Ticked>(*this); }
    frame::TextSize DesignSize() const override { return {1500, 1500}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Clockwork", .members = {}};
        return table;
    }

    int ticks = 0;
    std::function<void()> onTick;
    Timer Timer1{*this, "Timer1"};

  private:
    void Ticked() {
        ++ticks;
        if (onTick) onTick();
    }
};

class TimerTest : public testing::Test {
  protected:
    /// How often the timer comes in that time.
    int TicksIn(int milliseconds) {
        const int before = control.ticks;
        host.clock.Advance(milliseconds);
        return control.ticks - before;
    }

    headless::HeadlessHost host;
    Clockwork& control = host.Create<Clockwork>("Clockwork1");
    Timer& timer = control.Timer1;
};

TEST_F(TimerTest, StandsStillUntilItHasAnInterval) {
    EXPECT_EQ(TicksIn(100'000), 0);
    timer.SetInterval(100);
    EXPECT_EQ(TicksIn(99), 0);
    EXPECT_EQ(TicksIn(1), 1);
    EXPECT_EQ(TicksIn(1000), 10);
    timer.SetInterval(0);
    EXPECT_EQ(TicksIn(100'000), 0);
}

TEST_F(TimerTest, StandsStillWhileItIsDisabled) {
    timer.SetEnabled(false);
    timer.SetInterval(100);
    EXPECT_EQ(TicksIn(1000), 0);
    timer.SetEnabled(true);
    EXPECT_EQ(TicksIn(99), 0);
    EXPECT_EQ(TicksIn(1), 1);
}

TEST_F(TimerTest, NewIntervalCountsFromNowOnAndTheSameOneGoesOn) {
    timer.SetInterval(100);
    EXPECT_EQ(TicksIn(50), 0);
    timer.SetInterval(100);
    EXPECT_EQ(TicksIn(50), 1);
    EXPECT_EQ(TicksIn(50), 0);
    timer.SetInterval(60);
    EXPECT_EQ(TicksIn(59), 0);
    EXPECT_EQ(TicksIn(1), 1);
}

TEST_F(TimerTest, NegativeIntervalIsRefused) {
    timer.SetInterval(100);
    EXPECT_EQ(ErrorOf([&] { timer.SetInterval(-1); }), frame::errors::invalidValue);
    EXPECT_EQ(timer.Interval(), 100);
}

TEST_F(TimerTest, CanBeStoppedAndStartedByItsOwnEvent) {
    timer.SetInterval(100);
    control.onTick = [&] { timer.SetInterval(0); };
    EXPECT_EQ(TicksIn(1000), 1);
    control.onTick = [&] { timer.SetInterval(timer.Interval() + 100); };
    timer.SetInterval(100);
    EXPECT_EQ(TicksIn(300), 2);  // at 100 and at 300
}

TEST_F(TimerTest, GoesWithItsControlEvenFromItsOwnEvent) {
    timer.SetInterval(100);
    int ticks = 0;
    control.onTick = [&] {
        ++ticks;
        host.Destroy(control);
    };
    host.clock.Advance(1000);
    EXPECT_EQ(ticks, 1);
    EXPECT_TRUE(host.errors.reports.empty());
}

TEST_F(TimerTest, ErrorOfItsEventIsReportedAndItGoesOn) {
    timer.SetInterval(100);
    control.onTick = [] { throw frame::ControlError(frame::errors::typeMismatch); };
    EXPECT_EQ(TicksIn(200), 2);
    ASSERT_EQ(host.errors.reports.size(), 2u);
    EXPECT_EQ(host.errors.reports[0].where, "Clockwork1.Timer1.Timer");
}

TEST_F(TimerTest, IsReachedByName) {
    timer.Put("Interval", 250);
    EXPECT_EQ(timer.Get("Interval").ToLong(), 250);
    EXPECT_EQ(timer.Get("Enabled").ToBoolean(), true);
    timer.Table().FindInput("Timer")->call(timer, {});
    EXPECT_EQ(control.ticks, 1);
}

}  // namespace
}  // namespace tessel::child
