#include <algorithm>
#include <utility>

#include "frame/Text.h"
#include "frame/child/ListRows.h"

/// How the rows of a list settle.
namespace tessel::child {

/// A row that has to find its place anew.
struct ListRows::Moving {
    RowId row = 0;
    Position from = 0;
    RowKey key;
    Position to = 0;  // among the rows that stay
};

void ListRows::SetSorted(bool value) {
    const bool isNew = !std::exchange(sorted_, value) && value;
    isNew ? SettleAnew() : Settle();
    changed_();
}

void ListRows::SetSortKey(int value) {
    const bool isNew = std::exchange(sortKey_, value) != value;
    isNew ? SettleAnew() : Settle();
    changed_();
}

void ListRows::SetSortOrder(ListSortOrderConstants value) {
    const bool isNew = std::exchange(sortOrder_, value) != value;
    isNew ? SettleAnew() : Settle();
    changed_();
}

void ListRows::SettleAnew() {
    allUnsettled_ = true;
    Settle();
}

void ListRows::Settle() {
    if (!sorted_ || (unsettled_.empty() && !allUnsettled_)) return;
    constexpr std::size_t worthSortingAll = 8;
    const bool isSortingAll = allUnsettled_ || unsettled_.size() * worthSortingAll > Count();
    allUnsettled_ = true;  // until it is done: where a source fails, the next settling begins anew
    if (isSortingAll)
        SortAll();
    else
        MoveUnsettled();
    allUnsettled_ = false;
}

void ListRows::SortAll() {
    const std::vector<RowId> before = order_.All();
    std::vector<RowId> after = before;
    RowSort(texts_, sortKey_).Sort(after, Ascending());

    for (const RowId row : std::exchange(unsettled_, {}))
        if (row < rows_.Size()) rows_[row].flags &= static_cast<std::uint8_t>(~unsettled);
    if (after == before) return;
    order_.Assign(after);
    if (followed_) journal_.Reordered(Count());
}

void ListRows::MoveUnsettled() {
    std::vector<Moving> moving = TakeUnsettled();
    // All places are found before the first row moves: a source that fails leaves the order whole.
    std::vector<Position> gaps(moving.size());  // where, among the rows that stay, a moving one is passed over
    for (std::size_t i = 0; i < moving.size(); ++i) gaps[i] = moving[i].from - static_cast<Position>(i);
    const auto staying = [&](Position at) {
        const auto passed = std::upper_bound(gaps.begin(), gaps.end(), at) - gaps.begin();
        return order_.At(at + static_cast<Position>(passed));
    };
    const Position count = Count() - static_cast<Position>(moving.size());
    for (std::size_t i = 0; i < moving.size(); ++i) moving[i].to = PlaceOf(moving[i].key, count, gaps[i], staying);

    std::vector<Moving> leaving = moving;
    std::stable_sort(moving.begin(), moving.end(), [&](const Moving& a, const Moving& b) {
        const int order = frame::CompareNoCase(a.key.text, b.key.text);
        return Ascending() ? order < 0 : order > 0;
    });
    for (std::size_t i = 0; i < moving.size(); ++i) moving[i].to += static_cast<Position>(i);
    const bool standsStill = std::all_of(moving.begin(), moving.end(), [](const Moving& row) { return row.from == row.to; });
    if (standsStill) return;

    std::for_each(leaving.rbegin(), leaving.rend(), [this](const Moving& row) {
        order_.Remove(row.from);
        if (followed_) journal_.Removed(row.from);
    });
    for (const Moving& row : moving) {
        order_.Insert(row.to, row.row);
        if (followed_) journal_.Inserted(row.to);
    }
}

std::vector<ListRows::Moving> ListRows::TakeUnsettled() {
    std::vector<Moving> moving;
    for (const RowId row : unsettled_) {
        if (row >= rows_.Size() || !Has(row, unsettled)) continue;
        rows_[row].flags &= static_cast<std::uint8_t>(~unsettled);
        moving.push_back({row, PositionOf(row), RowSort(texts_, sortKey_).KeyOf(row), 0});
    }
    unsettled_.clear();
    std::sort(moving.begin(), moving.end(), [](const Moving& a, const Moving& b) { return a.from < b.from; });
    return moving;
}

ListRows::Position ListRows::PlaceOfNew(const RowKey& key) const {
    return PlaceOf(key, Count(), Count(), [&](Position at) { return order_.At(at); });
}

/// Where a row with this key belongs among `count` sorted rows, when without a reason it would stay before the one at `stay`.
/// Both ends are tried first: rows often come in order.
template <class RowAt>
ListRows::Position ListRows::PlaceOf(const RowKey& key, Position count, Position stay, RowAt&& rowAt) const {
    const RowSort sort(texts_, sortKey_);
    const auto standsBefore = [&](Position at) {
        const int order = sort.Compare(rowAt(at), key);
        if (order == 0) return at < stay;
        return Ascending() ? order < 0 : order > 0;
    };
    if (count == 0 || !standsBefore(0)) return 0;
    if (standsBefore(count - 1)) return count;
    Position first = 1, last = count - 1;
    while (first < last) {
        const Position middle = first + (last - first) / 2;
        if (standsBefore(middle))
            first = middle + 1;
        else
            last = middle;
    }
    return first;
}

}  // namespace tessel::child
