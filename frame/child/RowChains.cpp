#include "frame/child/RowChains.h"

#include <algorithm>
#include <utility>

namespace tessel::child {

RowChains::Links& RowChains::MadeLinks(RowId row) {
    const std::size_t number = row / pageSize;
    if (number >= links_.size()) links_.resize(number + 1);
    auto& page = links_[number];
    if (!page) {
        page = std::make_unique<Page>();
        auto id = static_cast<RowId>(number * pageSize);
        for (Links& links : *page) {
            links = {id, id};
            ++id;
        }
    }
    return (*page)[row % pageSize];
}

void RowChains::Begin(RowId row, std::uint32_t hash) {
    if ((count_ + 1) * 5 > slots_.size() * 4) Widen();
    Put({hash, row});
    ++count_;
}

void RowChains::Put(const Slot& slot) {
    std::size_t at = Home(slot.hash);
    while (!slots_[at].IsVacant()) at = Behind(at);
    slots_[at] = slot;
}

void RowChains::Vacate(std::size_t at) {
    const auto distance = [&](std::size_t from, std::size_t to) { return to >= from ? to - from : to + slots_.size() - from; };
    std::size_t gap = at;
    // Who stands behind the gap and came by it moves up.
    for (at = Behind(at); !slots_[at].IsVacant(); at = Behind(at)) {
        if (distance(Home(slots_[at].hash), at) < distance(gap, at)) continue;
        slots_[gap] = slots_[at];
        gap = at;
    }
    slots_[gap] = {};
    --count_;
}

void RowChains::Widen() {
    constexpr std::size_t fewest = 16;
    const std::size_t wider = std::max(fewest, slots_.size() + slots_.size() / 2);
    for (const Slot& slot : std::exchange(slots_, std::vector<Slot>(wider)))
        if (!slot.IsVacant()) Put(slot);
}

std::vector<RowId> RowChains::RowsFrom(RowId row) const {
    std::vector<RowId> rows;
    RowId at = row;
    do {
        rows.push_back(at);
        at = LinksOf(at).next;
    } while (at != row);
    return rows;
}

}  // namespace tessel::child
