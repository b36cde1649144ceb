#include "frame/child/KeyIndex.h"

#include <algorithm>
#include <utility>

namespace tessel::child {

void KeyIndex::Add(RowId row, std::uint32_t hash) {
    if ((count_ + 1) * 5 > slots_.size() * 4) Widen();
    Put({hash, row});
    ++count_;
}

void KeyIndex::Remove(RowId row, std::uint32_t hash) {
    std::size_t gap = Home(hash);
    while (slots_[gap].row != row) gap = Behind(gap);
    // Who stands behind the gap and came by it moves up.
    for (std::size_t at = Behind(gap); slots_[at].row != none; at = Behind(at)) {
        const std::size_t mask = slots_.size() - 1;
        const std::size_t fromHome = (at - Home(slots_[at].hash)) & mask;
        if (fromHome < ((at - gap) & mask)) continue;
        slots_[gap] = slots_[at];
        gap = at;
    }
    slots_[gap] = Slot();
    --count_;
}

void KeyIndex::Put(Slot slot) {
    std::size_t at = Home(slot.hash);
    while (slots_[at].row != none) at = Behind(at);
    slots_[at] = slot;
}

void KeyIndex::Widen() {
    constexpr std::size_t fewest = 16;
    for (const Slot& slot : std::exchange(slots_, std::vector<Slot>(std::max(fewest, slots_.size() * 2))))
        if (slot.row != none) Put(slot);
}

}  // namespace tessel::child
