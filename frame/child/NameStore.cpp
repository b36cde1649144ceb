#include "frame/child/NameStore.h"

#include <algorithm>

namespace tessel::child {

NameStore::Place NameStore::Add(RowId row, std::string_view text, std::string_view key) {
    constexpr std::size_t longest = std::size_t{1} << 30;
    text = text.substr(0, longest);
    key = key.substr(0, longest);
    const bool textIsTail = key.ends_with(text);
    const std::size_t bytes = BlockSize(key.size() + (textIsTail ? 0 : text.size()));
    if (bytes > free_) {
        pages_.emplace_back(new char[std::max(bytes, pageBytes)]);
        free_ = pageBytes;
    }
    const std::size_t start = pageBytes - free_;
    Head head{.row = row, .keySize = static_cast<std::uint32_t>(key.size())};
    head.textSize = static_cast<std::uint32_t>(text.size()) & 0x7FFFFFFFu;
    head.textIsTail = textIsTail ? 1 : 0;
    char* const block = pages_.back().get() + start;
    std::memcpy(block, &head, sizeof head);
    char* const end = std::copy(key.begin(), key.end(), block + sizeof head);
    if (!textIsTail) std::copy(text.begin(), text.end(), end);
    free_ -= std::min(bytes, free_);
    size_ += bytes;
    return static_cast<Place>((pages_.size() - 1) * pageUnits + start / unitBytes);
}

}  // namespace tessel::child
