#include "frame/child/RowChains.h"

#include <algorithm>
#include <utility>

namespace tessel::child {

void RowChains::Begin(RowId row, std::uint32_t hash) {
    if ((count_ + 1) * 5 > slots_.size() * 4) Widen();
    entries_[row] = {hash, row, row};
    Put(row);
    ++count_;
}

void RowChains::Put(std::uint32_t slot) {
    std::size_t at = Home(entries_[HeadOf(slot)].hash);
    while (slots_[at] != vacant) at = Behind(at);
    slots_[at] = slot;
}

void RowChains::Vacate(std::size_t at) {
    const auto distance = [&](std::size_t from, std::size_t to) { return to >= from ? to - from : to + slots_.size() - from; };
    std::size_t gap = at;
    // Who stands behind the gap and came by it moves up.
    for (at = Behind(at); slots_[at] != vacant; at = Behind(at)) {
        const std::size_t home = Home(entries_[HeadOf(slots_[at])].hash);
        if (distance(home, at) < distance(gap, at)) continue;
        slots_[gap] = slots_[at];
        gap = at;
    }
    slots_[gap] = vacant;
    --count_;
}

void RowChains::Widen() {
    constexpr std::size_t fewest = 16;
    const std::size_t wider = std::max(fewest, slots_.size() + slots_.size() / 2);
    for (const std::uint32_t slot : std::exchange(slots_, std::vector<std::uint32_t>(wider, vacant)))
        if (slot != vacant) Put(slot);
}

std::vector<RowId> RowChains::RowsFrom(RowId row) const {
    std::vector<RowId> rows;
    RowId at = row;
    do {
        rows.push_back(at);
        at = entries_[at].next;
    } while (at != row);
    return rows;
}

void RowChains::Link(const std::vector<RowId>& rows) {
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const RowId next = rows[i + 1 < rows.size() ? i + 1 : 0];
        entries_[rows[i]].next = next;
        entries_[next].previous = rows[i];
    }
}

}  // namespace tessel::child
