#include "frame/child/Timer.h"

#include "frame/ClassTable.h"

namespace tessel::child {

void Timer::SetInterval(std::int32_t value) {
    if (value < 0) throw frame::ControlError(frame::errors::invalidValue);
    if (value == interval_) return;
    interval_ = value;
    Follow();
}

void Timer::SetEnabled(bool value) {
    if (value == Enabled()) return;
    ChildControl::SetEnabled(value);
    Follow();
}

void Timer::Follow() {
    if (Enabled() && interval_ > 0)
        Host().Clock().Start(*this, interval_);
    else
        Host().Clock().Stop(*this);
}

void Timer::TimerInput() {
    Enter("Timer", [&] { Elapsed(); });
}

namespace {

constexpr std::array members = {
    frame::property<&Timer::Name>("Name", "The name of the child."),
    frame::property<&Timer::Interval, &Timer::SetInterval>("Interval", "Milliseconds between two events; 0 for none."),
    frame::property<&Timer::Enabled, &Timer::SetEnabled>("Enabled", "Whether the timer runs."),
};
constexpr std::array inputs = {frame::input<&Timer::TimerInput>("Timer")};
constexpr frame::ClassTable table{.name = "Timer", .members = members, .inputs = inputs};

}  // namespace

const frame::ClassTable& Timer::Table() const { return table; }

}  // namespace tessel::child
