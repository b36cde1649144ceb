#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "frame/Object.h"
#include "frame/Variant.h"
#include "frame/host.h"

namespace tessel::fileservices {

/// The counter by which long work lets the message loop run, and a growing list of texts. One for each host, shared by all its
/// controls: `host.Module<Collect>()`.
class Collect final : public frame::Object {
  public:
    explicit Collect(frame::Host& host) : host_(host) {}

    /// With a limit: sets it, and the count to 0. Without: counts one call, and at each one that reaches the limit the message loop
    /// has a turn, in which input and timers come in. Set the limit before a loop, then call without one for each item.
    void CollectYield(const std::optional<frame::Variant>& limit = {});
    void CollectAdd(const std::string& text);

    /// What was added, in its order.
    const std::vector<std::string>& Collected() const { return collected_; }

    std::string Path() const override { return "Collect"; }
    const frame::ClassTable& Table() const override;

  private:
    frame::Host& host_;
    std::int32_t count_ = 0, limit_ = 0;
    std::vector<std::string> collected_;
};

}  // namespace tessel::fileservices
