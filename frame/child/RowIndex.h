#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

#include "frame/child/RowPages.h"

namespace tessel::child {

/// Finds rows by a hash of something of theirs: what it names has to be compared. About 11 bytes a row.
class HashIndex {
  public:
    /// The hash of a text, equal for texts that are equal without regard to case.
    static std::uint32_t HashOf(std::string_view text);

    /// `row` is not in the index.
    void Add(RowId row, std::uint32_t hash);
    /// `row` is in the index.
    void Remove(RowId row);
    void Clear() { *this = HashIndex(); }
    /// Calls `each` with every row of that hash, in no particular order.
    template <class F>
    void Candidates(std::uint32_t hash, F&& each) const {
        if (heads_.empty()) return;
        for (RowId row = heads_[Bucket(hash)]; row != none; row = entries_[row].next)
            if (entries_[row].hash == hash) each(row);
    }

  private:
    static constexpr RowId none = 0xFFFFFFFFu;
    struct Entry {
        std::uint32_t hash = 0;
        RowId next = none;  // in the same bucket
    };

    std::size_t Bucket(std::uint32_t hash) const { return hash & (heads_.size() - 1); }
    void Link(RowId row);
    void Widen();

    RowPages<Entry> entries_;
    std::vector<RowId> heads_;  // the first row of each bucket; their number is a power of two
    std::size_t count_ = 0;
};

}  // namespace tessel::child
