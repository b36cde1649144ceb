#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string_view>
#include <vector>

#include "frame/child/RowPages.h"

namespace tessel::child {

/// Names of rows side by side in large pages: a row, its text and its key as one block, which a number of 32 bits finds. A name
/// takes 12 bytes and its characters, up to 3 bytes more; where the key ends with the text, as a path does with a name, the text is
/// not held a second time. What is in the store stays in its place until all is cleared: a user whose names change copies those in
/// use into a new store once `Size` has outgrown them.
class NameStore {
  public:
    /// Where a name stands, below `none`.
    using Place = std::uint32_t;
    static constexpr Place none = 0xFFFFFFFFu;

    struct Name {
        RowId row = 0;
        std::string_view text, key;
    };

    /// `text` and `key` may stand in the store. Of each, what is beyond a gigabyte is cut off.
    Place Add(RowId row, std::string_view text, std::string_view key);
    Name Read(Place place) const {
        const Head head = HeadOf(place);
        const char* key = Block(place) + sizeof head;
        const char* text = key + head.keySize - (head.textIsTail ? head.textSize : 0);
        return {head.row, {text, head.textSize}, {key, head.keySize}};
    }
    /// The bytes that all names take.
    std::size_t Size() const { return size_; }
    /// The bytes that this name takes.
    std::size_t SizeOf(Place place) const {
        const Head head = HeadOf(place);
        return BlockSize(head.keySize + (head.textIsTail ? 0 : head.textSize));
    }

  private:
    /// Before the characters: those of the key, then those of the text where they are not the key's last.
    struct Head {
        RowId row = 0;
        std::uint32_t keySize = 0;
        std::uint32_t textSize : 31 = 0;
        std::uint32_t textIsTail : 1 = 0;
    };
    static constexpr std::size_t unitBytes = 4, pageUnits = 4096, pageBytes = pageUnits * unitBytes;

    const char* Block(Place place) const { return pages_[place / pageUnits].get() + place % pageUnits * unitBytes; }
    Head HeadOf(Place place) const {
        Head head;
        std::memcpy(&head, Block(place), sizeof head);
        return head;
    }
    static std::size_t BlockSize(std::size_t characters) {
        return (sizeof(Head) + characters + unitBytes - 1) / unitBytes * unitBytes;
    }

    std::vector<std::unique_ptr<char[]>> pages_;  // of `pageBytes`; one that is too large for them has a page of its own
    std::size_t free_ = 0;                        // bytes at the end of the last page
    std::size_t size_ = 0;
};

}  // namespace tessel::child
