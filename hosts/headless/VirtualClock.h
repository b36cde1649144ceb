#pragma once

#include <cstdint>
#include <vector>

#include "frame/host.h"

namespace tessel::headless {

/// Time that stands still until it is moved: timers fire in the order in which they are due.
class VirtualClock final : public frame::Clock {
  public:
    frame::Date Now() override;
    void SetNow(frame::Date now);
    void Start(frame::TimerClient& client, int interval) override;
    void Stop(frame::TimerClient& client) override;

    /// Moves the time by so many milliseconds and fires what falls due on the way. A timer that is started meanwhile counts
    /// from the moment at which it was started.
    void Advance(std::int64_t milliseconds);

  private:
    struct Running {
        frame::TimerClient* client;
        std::int64_t interval;
        std::int64_t due;
        std::uint64_t order;  // of two that are due at once, the one started first
    };

    std::vector<Running> running_;
    std::int64_t time_ = 0;
    std::uint64_t started_ = 0;
    double start_ = 0;  // the date, in days, at time 0
};

}  // namespace tessel::headless
