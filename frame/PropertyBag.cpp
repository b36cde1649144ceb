#include "frame/PropertyBag.h"

#include <algorithm>

namespace tessel::frame {

Variant MemoryBag::ReadProperty(std::string_view key, const Variant& otherwise) const {
    const auto found = std::find_if(contents_.begin(), contents_.end(), [&](const auto& entry) { return entry.first == key; });
    return found != contents_.end() ? found->second : otherwise;
}

void MemoryBag::WriteProperty(std::string_view key, const Variant& value, const Variant& otherwise) {
    written_.push_back({std::string(key), value, otherwise});
    std::erase_if(contents_, [&](const auto& entry) { return entry.first == key; });
    if (!(value == otherwise)) contents_.emplace_back(key, value);
}

void MemoryBag::Set(std::string_view key, Variant value) {
    std::erase_if(contents_, [&](const auto& entry) { return entry.first == key; });
    contents_.emplace_back(key, std::move(value));
}

}  // namespace tessel::frame
