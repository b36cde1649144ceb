#include "frame/child/RowIndex.h"

#include <algorithm>
#include <utility>

#include "frame/Text.h"

namespace tessel::child {

std::uint32_t HashIndex::HashOf(std::string_view text) {
    const std::uint64_t hash = frame::HashNoCase()(text);
    return static_cast<std::uint32_t>(hash ^ hash >> 32);
}

void HashIndex::Add(RowId row, std::uint32_t hash) {
    constexpr std::size_t rowsPerBucket = 2;
    if (count_ >= heads_.size() * rowsPerBucket) Widen();
    entries_.MakeRoom(row);
    entries_[row].hash = hash;
    Link(row);
    ++count_;
}

void HashIndex::Remove(RowId row) {
    RowId* link = &heads_[Bucket(entries_[row].hash)];
    while (*link != row) link = &entries_[*link].next;
    *link = entries_[row].next;
    --count_;
}

void HashIndex::Link(RowId row) {
    RowId& head = heads_[Bucket(entries_[row].hash)];
    entries_[row].next = std::exchange(head, row);
}

void HashIndex::Widen() {
    constexpr std::size_t fewest = 32;
    const std::vector<RowId> before = std::exchange(heads_, std::vector<RowId>(std::max(fewest, heads_.size() * 2), none));
    for (RowId head : before)
        while (head != none) {
            const RowId next = entries_[head].next;
            Link(head);
            head = next;
        }
}

}  // namespace tessel::child
