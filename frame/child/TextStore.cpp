#include "frame/child/TextStore.h"

#include <algorithm>

namespace tessel::child {

TextStore::Place TextStore::Add(std::string_view text) {
    constexpr std::size_t longest = std::size_t{1} << 30;
    text = text.substr(0, longest);
    const std::size_t bytes = SizeOf(text);
    if (bytes > free_) {
        pages_.emplace_back(new char[std::max(bytes, pageBytes)]);
        free_ = pageBytes;
    }
    const std::size_t start = pageBytes - free_;
    const auto size = static_cast<std::uint32_t>(text.size());
    char* const block = pages_.back().get() + start;
    std::memcpy(block, &size, sizeof size);
    std::copy(text.begin(), text.end(), block + sizeof size);
    free_ -= std::min(bytes, free_);
    size_ += bytes;
    return static_cast<Place>((pages_.size() - 1) * pageUnits + start / unitBytes);
}

}  // namespace tessel::child
