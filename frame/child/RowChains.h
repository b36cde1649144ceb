#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "frame/child/RowPages.h"

namespace tessel::child {

/// Finds the first of the rows that share a key. Rows of one key form a chain whose first member is the one that stands before all
/// others in its list; finding it takes the same time however many there are. About 14 bytes a row, and 8 more where rows share
/// keys.
///
/// The index knows no keys: it is given their hashes, and `same(row)` tells whether a row of that hash has the key.
class RowChains {
  public:
    static constexpr RowId none = 0x7FFFFFFFu;

    template <class Same>
    RowId First(std::uint32_t hash, Same&& same) const {
        const std::size_t at = Find(hash, same);
        return at != absent ? slots_[at].Head() : none;
    }

    /// Where a new row stands among those of its key.
    enum class Place : std::uint8_t { Front, Inside, Back };
    /// `row` is not in the index. `placeAmong(first, last)` is asked where its key has rows already; the last one is the last in
    /// order as long as no row has come to stand inside.
    template <class Same, class PlaceAmong>
    void Add(RowId row, std::uint32_t hash, Same&& same, PlaceAmong&& placeAmong) {
        const std::size_t at = Find(hash, same);
        if (at == absent) return Begin(row, hash);
        const RowId head = slots_[at].Head(), tail = LinksOf(head).previous;
        const Place place = placeAmong(head, tail);
        SetLinks(row, {head, tail});
        Join(tail, row);
        Join(row, head);
        if (place == Place::Front) slots_[at].SetHead(row);
        if (place == Place::Inside) slots_[at].first |= unordered;
    }

    /// `row` is in the index, under this hash. `sort(rows)` puts rows into the order of their list; it is asked where the first of
    /// a chain goes that is in no order.
    template <class Same, class Sort>
    void Remove(RowId row, std::uint32_t hash, Same&& same, Sort&& sort) {
        const std::size_t at = Find(hash, same);
        const Links links = LinksOf(row);
        if (links.next == row) return Vacate(at);
        Join(links.previous, links.next);
        SetLinks(row, {row, row});
        if (slots_[at].Head() != row) return;
        if (slots_[at].first & unordered) {
            std::vector<RowId> rows = RowsFrom(links.next);
            sort(rows);
            for (std::size_t i = 0; i < rows.size(); ++i) Join(rows[i], rows[i + 1 < rows.size() ? i + 1 : 0]);
            slots_[at].first = rows.front();
        } else {
            slots_[at].first = links.next;
        }
    }

  private:
    static constexpr std::uint32_t unordered = 0x80000000u, vacant = 0xFFFFFFFFu;
    static constexpr std::size_t absent = static_cast<std::size_t>(-1);

    /// The hash of a key and the first of its rows.
    struct Slot {
        std::uint32_t hash = 0, first = vacant;
        bool IsVacant() const { return first == vacant; }
        RowId Head() const { return first & ~unordered; }
        void SetHead(RowId row) { first = row | (first & unordered); }
    };
    /// The neighbours of a row in its chain, which is a ring.
    struct Links {
        RowId next, previous;
    };
    static constexpr std::size_t pageSize = 256;
    using Page = std::array<Links, pageSize>;

    /// A row whose key no other row has needs none.
    Links LinksOf(RowId row) const {
        const std::size_t page = row / pageSize;
        return page < links_.size() && links_[page] ? (*links_[page])[row % pageSize] : Links{row, row};
    }
    Links& MadeLinks(RowId row);
    void SetLinks(RowId row, Links links) { MadeLinks(row) = links; }
    void Join(RowId row, RowId next) {
        MadeLinks(row).next = next;
        MadeLinks(next).previous = row;
    }

    std::size_t Home(std::uint32_t hash) const { return static_cast<std::size_t>((std::uint64_t{hash} * slots_.size()) >> 32); }
    std::size_t Behind(std::size_t at) const { return at + 1 < slots_.size() ? at + 1 : 0; }
    template <class Same>
    std::size_t Find(std::uint32_t hash, Same&& same) const {
        if (slots_.empty()) return absent;
        for (std::size_t at = Home(hash); !slots_[at].IsVacant(); at = Behind(at))
            if (slots_[at].hash == hash && same(slots_[at].Head())) return at;
        return absent;
    }
    void Begin(RowId row, std::uint32_t hash);
    void Put(const Slot& slot);
    void Vacate(std::size_t at);
    void Widen();
    std::vector<RowId> RowsFrom(RowId row) const;

    std::vector<Slot> slots_;  // one a chain; one that is taken is met by going on, without a gap
    std::size_t count_ = 0;    // of chains
    std::vector<std::unique_ptr<Page>> links_;
};

}  // namespace tessel::child
