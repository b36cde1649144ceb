#pragma once

#include "frame/ChildControl.h"

namespace tessel::child {

/// Calls its control again and again: after each `Interval` milliseconds while it is enabled. It is never seen; it has no peer.
class Timer final : public frame::ChildControl, private frame::TimerClient {
  public:
    Timer(frame::Control& owner, std::string name) : ChildControl(owner, std::move(name)) {}
    ~Timer() override { Host().Clock().Stop(*this); }

    /// In milliseconds; 0 keeps the timer still. Error 380 below 0. A new interval counts from now on.
    std::int32_t Interval() const { return interval_; }
    void SetInterval(std::int32_t value);
    bool Enabled() const { return ChildControl::Enabled(); }
    void SetEnabled(bool value);

    /// What a host reports when the time has come, or a script in its place.
    void TimerInput();

    /// Where the event goes. An event that falls due while the control handles one comes after it.
    frame::Slot<> Elapsed;

    const frame::ClassTable& Table() const override;

  private:
    void Tick() override { TimerInput(); }
    void Follow();

    std::int32_t interval_ = 0;
};

}  // namespace tessel::child
