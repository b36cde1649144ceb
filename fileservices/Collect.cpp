#include "fileservices/Collect.h"

#include <array>

#include "frame/ClassTable.h"

namespace tessel::fileservices {

void Collect::CollectYield(const std::optional<frame::Variant>& limit) {
    if (limit) {
        limit_ = limit->ToLong();
        count_ = 0;
        return;
    }
    if (count_ < limit_) ++count_;
    if (count_ < limit_) return;
    host_.Turn();
    count_ = 0;
}

void Collect::CollectAdd(const std::string& text) { collected_.push_back(text); }

namespace {

constexpr std::array members = {
    frame::method<&Collect::CollectYield>("CollectYield", "Counts a call, and lets the message loop run at the limit.", {"Limit"}),
    frame::method<&Collect::CollectAdd>("CollectAdd", "Adds a text to the list.", {"Text"}),
};
constexpr frame::ClassTable table{.name = "Collect", .members = members};

}  // namespace

const frame::ClassTable& Collect::Table() const { return table; }

}  // namespace tessel::fileservices
