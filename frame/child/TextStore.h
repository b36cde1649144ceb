#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string_view>
#include <vector>

namespace tessel::child {

/// Texts side by side in large pages, each found by a number of 32 bits: 4 bytes and its characters, up to 3 bytes more. What is in
/// the store stays in its place until all is cleared: a user whose texts go copies those in use into a new store once `Size` has
/// outgrown them.
class TextStore {
  public:
    using Place = std::uint32_t;

    /// What is beyond a gigabyte is cut off. `text` may stand in the store.
    Place Add(std::string_view text);
    std::string_view Read(Place place) const {
        const char* block = pages_[place / pageUnits].get() + place % pageUnits * unitBytes;
        std::uint32_t size = 0;
        std::memcpy(&size, block, sizeof size);
        return {block + sizeof size, size};
    }
    /// The bytes that all texts take, and that a text takes.
    std::size_t Size() const { return size_; }
    static std::size_t SizeOf(std::string_view text) {
        return (sizeof(std::uint32_t) + text.size() + unitBytes - 1) / unitBytes * unitBytes;
    }

  private:
    static constexpr std::size_t unitBytes = 4, pageUnits = 4096, pageBytes = pageUnits * unitBytes;

    std::vector<std::unique_ptr<char[]>> pages_;  // of `pageBytes`; one that is too large for them has a page of its own
    std::size_t free_ = 0;                        // bytes at the end of the last page
    std::size_t size_ = 0;
};

}  // namespace tessel::child
