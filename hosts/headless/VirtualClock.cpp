#include "hosts/headless/VirtualClock.h"

#include <algorithm>
#include <tuple>

#include "frame/Dates.h"

namespace tessel::headless {

namespace {
constexpr double millisecondsPerDay = 86'400'000;
}

frame::Date VirtualClock::Now() { return {start_ + static_cast<double>(time_) / millisecondsPerDay}; }

void VirtualClock::SetNow(frame::Date now) { start_ = now.days - static_cast<double>(time_) / millisecondsPerDay; }

void VirtualClock::Start(frame::TimerClient& client, int interval) {
    Stop(client);
    running_.push_back({&client, interval, time_ + interval, ++started_});
}

void VirtualClock::Stop(frame::TimerClient& client) {
    std::erase_if(running_, [&](const Running& timer) { return timer.client == &client; });
}

void VirtualClock::Advance(std::int64_t milliseconds) {
    const std::int64_t end = time_ + milliseconds;
    while (true) {
        const auto next = std::min_element(running_.begin(), running_.end(), [](const Running& a, const Running& b) {
            return std::tie(a.due, a.order) < std::tie(b.due, b.order);
        });
        if (next == running_.end() || next->due > end) break;
        time_ = std::max(time_, next->due);
        next->due += next->interval;
        next->client->Tick();
    }
    time_ = std::max(time_, end);
}

}  // namespace tessel::headless
