#include "frame/child/RowJournal.h"

#include <algorithm>
#include <utility>

namespace tessel::child {

using Kind = RowChange::Kind;

void RowJournal::Inserted(std::uint32_t first, std::uint32_t count) {
    if (IsReset()) return;
    if (RowChange* last = Last(Kind::Inserted); last && first >= last->first && first - last->first <= last->count)
        last->count += count;
    else
        Add({Kind::Inserted, first, count});
}

void RowJournal::Removed(std::uint32_t first, std::uint32_t count) {
    if (IsReset()) return;
    const std::uint32_t end = first + count;
    if (RowChange* last = Last(Kind::Inserted); last && first >= last->first && end <= last->first + last->count) {
        last->count -= count;
        if (last->count == 0) changes_.pop_back();
    } else if (last = Last(Kind::Removed); last && first <= last->first && end >= last->first) {
        last->first = first;
        last->count += count;
    } else {
        Add({Kind::Removed, first, count});
    }
}

void RowJournal::Changed(std::uint32_t first, std::uint32_t count) {
    if (IsReset()) return;
    const std::uint32_t end = first + count;
    if (RowChange* last = Last(Kind::Inserted); last && first >= last->first && end <= last->first + last->count) return;
    if (Last(Kind::Reordered)) return;
    if (RowChange* last = Last(Kind::Changed); last && first <= last->first + last->count && end >= last->first) {
        const std::uint32_t lastEnd = std::max(end, last->first + last->count);
        last->first = std::min(first, last->first);
        last->count = lastEnd - last->first;
    } else {
        Add({Kind::Changed, first, count});
    }
}

void RowJournal::Reordered(std::uint32_t count) {
    if (IsReset() || Last(Kind::Reordered)) return;
    if (Last(Kind::Changed)) changes_.pop_back();
    Add({Kind::Reordered, 0, count});
}

void RowJournal::Reset() { changes_.assign(1, {Kind::Reset, 0, 0}); }

std::vector<RowChange> RowJournal::Take() { return std::exchange(changes_, {}); }

RowChange* RowJournal::Last(Kind kind) { return !changes_.empty() && changes_.back().kind == kind ? &changes_.back() : nullptr; }

void RowJournal::Add(RowChange change) {
    changes_.push_back(change);
    if (changes_.size() > limit) Shorten();
}

void RowJournal::Shorten() {
    const auto isChanged = [](const RowChange& change) { return change.kind == Kind::Changed; };
    if (!std::all_of(changes_.begin(), changes_.end(), isChanged)) return Reset();
    RowChange all = changes_.front();
    for (const RowChange& change : changes_) {
        const std::uint32_t end = std::max(all.first + all.count, change.first + change.count);
        all.first = std::min(all.first, change.first);
        all.count = end - all.first;
    }
    changes_.assign(1, all);
}

}  // namespace tessel::child
