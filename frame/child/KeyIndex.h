#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "frame/child/RowPages.h"

namespace tessel::child {

/// Finds rows by the hash of a key that few others share, as unique keys do: what it names has to be compared. All stands in one
/// table, so that a search looks at one place in memory: 10 to 20 bytes a row.
class KeyIndex {
  public:
    /// `row` is not in the index.
    void Add(RowId row, std::uint32_t hash);
    /// `row` is in the index, under this hash.
    void Remove(RowId row, std::uint32_t hash);
    void Clear() { *this = KeyIndex(); }
    /// The first row of that hash for which `isIt` is true; `none` when there is none.
    template <class F>
    RowId Find(std::uint32_t hash, F&& isIt) const {
        if (slots_.empty()) return none;
        for (std::size_t at = Home(hash); slots_[at].row != none; at = Behind(at))
            if (slots_[at].hash == hash && isIt(slots_[at].row)) return slots_[at].row;
        return none;
    }
    static constexpr RowId none = 0xFFFFFFFFu;

  private:
    struct Slot {
        std::uint32_t hash = 0;
        RowId row = none;
    };

    std::size_t Home(std::uint32_t hash) const { return hash & (slots_.size() - 1); }
    std::size_t Behind(std::size_t at) const { return (at + 1) & (slots_.size() - 1); }
    void Put(Slot slot);
    void Widen();

    std::vector<Slot> slots_;  // their number is a power of two; one that is taken is met by going on, without a gap
    std::size_t count_ = 0;
};

}  // namespace tessel::child
