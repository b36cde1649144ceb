#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "frame/child/RowPages.h"

namespace tessel::child {

/// Finds the first of the rows that share a key. Rows of one key form a chain whose first member is the one that stands before all
/// others in its list; finding it takes the same time however many there are. About 18 bytes a row.
///
/// The index knows no keys: it is given their hashes, and `same(row)` tells whether a row of that hash has the key.
class RowChains {
  public:
    static constexpr RowId none = 0x7FFFFFFFu;

    template <class Same>
    RowId First(std::uint32_t hash, Same&& same) const {
        const std::size_t at = Find(hash, same);
        return at != absent ? HeadOf(slots_[at]) : none;
    }

    /// Where a new row stands among those of its key.
    enum class Place : std::uint8_t { Front, Inside, Back };
    /// `row` is not in the index. `placeAmong(first, last)` is asked where its key has rows already; the last one is the last in
    /// order as long as no row has come to stand inside.
    template <class Same, class PlaceAmong>
    void Add(RowId row, std::uint32_t hash, Same&& same, PlaceAmong&& placeAmong) {
        entries_.MakeRoom(row);
        const std::size_t at = Find(hash, same);
        if (at == absent) return Begin(row, hash);
        const RowId head = HeadOf(slots_[at]), tail = entries_[head].previous;
        const Place place = placeAmong(head, tail);
        entries_[row] = {hash, head, tail};
        entries_[tail].next = entries_[head].previous = row;
        if (place == Place::Front) slots_[at] = row | (slots_[at] & unordered);
        if (place == Place::Inside) slots_[at] |= unordered;
    }

    /// `row` is in the index. `sort(rows)` puts rows into the order of their list; it is asked where the first of a chain goes that
    /// is in no order.
    template <class Same, class Sort>
    void Remove(RowId row, Same&& same, Sort&& sort) {
        const std::size_t at = Find(entries_[row].hash, same);
        const Entry entry = entries_[row];
        if (entry.next == row) return Vacate(at);
        entries_[entry.previous].next = entry.next;
        entries_[entry.next].previous = entry.previous;
        if (HeadOf(slots_[at]) != row) return;
        if (slots_[at] & unordered) {
            std::vector<RowId> rows = RowsFrom(entry.next);
            sort(rows);
            Link(rows);
            slots_[at] = rows.front();
        } else {
            slots_[at] = entry.next;
        }
    }

    void Clear() { *this = RowChains(); }

  private:
    /// Its neighbours in its chain, which is a ring.
    struct Entry {
        std::uint32_t hash = 0;
        RowId next = none, previous = none;
    };
    static constexpr std::uint32_t unordered = 0x80000000u, vacant = 0xFFFFFFFFu;
    static constexpr std::size_t absent = static_cast<std::size_t>(-1);

    static RowId HeadOf(std::uint32_t slot) { return slot & ~unordered; }
    std::size_t Home(std::uint32_t hash) const { return static_cast<std::size_t>((std::uint64_t{hash} * slots_.size()) >> 32); }
    std::size_t Behind(std::size_t at) const { return at + 1 < slots_.size() ? at + 1 : 0; }
    template <class Same>
    std::size_t Find(std::uint32_t hash, Same&& same) const {
        if (slots_.empty()) return absent;
        for (std::size_t at = Home(hash); slots_[at] != vacant; at = Behind(at)) {
            const RowId head = HeadOf(slots_[at]);
            if (entries_[head].hash == hash && same(head)) return at;
        }
        return absent;
    }
    void Begin(RowId row, std::uint32_t hash);
    void Put(std::uint32_t slot);
    void Vacate(std::size_t at);
    void Widen();
    std::vector<RowId> RowsFrom(RowId row) const;
    void Link(const std::vector<RowId>& rows);

    RowPages<Entry> entries_;
    std::vector<std::uint32_t> slots_;  // the first row of each chain; one that is taken is met by going on, without a gap
    std::size_t count_ = 0;             // of chains
};

}  // namespace tessel::child
