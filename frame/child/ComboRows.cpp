#include "frame/child/ComboRows.h"

#include <algorithm>
#include <string>
#include <utility>

#include "frame/Text.h"
#include "frame/child/RowIndex.h"
#include "frame/child/RowSort.h"

namespace tessel::child {

namespace {

/// One number for each number: none are equal that were not.
std::uint32_t Mixed(std::uint32_t value) {
    value ^= value >> 16;
    value *= 0x85EBCA6Bu;
    value ^= value >> 13;
    value *= 0xC2B2AE35u;
    value ^= value >> 16;
    return value;
}

std::uint32_t HashOf(std::int32_t data) { return Mixed(static_cast<std::uint32_t>(data)); }
std::uint32_t HashOf(std::string_view text) { return Mixed(HashIndex::HashOf(text)); }

bool EveryRow(RowId) { return true; }

}  // namespace

RowId ComboRows::Add(std::string_view text, std::int32_t data) {
    RowId row = end_;
    if (free_.empty()) {
        rows_.MakeRoom(row);
        ++end_;
    } else {
        row = free_.back();
        free_.pop_back();
    }
    rows_[row] = {texts_.Add(text), data};
    textBytes_ += TextStore::SizeOf(text);
    if (IsSorted())
        pending_.push_back(row);
    else
        order_.Append(row);
    if (dataIndexed_) IndexData(row);
    if (textIndexed_) IndexText(row);
    return row;
}

void ComboRows::Remove(Position position) {
    const RowId row = RowAt(position);
    if (dataIndexed_) UnindexData(row);
    if (textIndexed_) {
        const auto same = [&](RowId other) { return frame::EqualsNoCase(TextOf(other), TextOf(row)); };
        byText_.Remove(row, HashOf(TextOf(row)), same, [&](std::vector<RowId>& rows) { SortByPosition(rows); });
    }
    order_.Remove(position);
    textBytes_ -= TextStore::SizeOf(TextOf(row));
    free_.push_back(row);
    KeepTextsSmall();
}

void ComboRows::Clear() { *this = ComboRows(ordering_); }

void ComboRows::SetData(Position position, std::int32_t data) {
    const RowId row = RowAt(position);
    if (rows_[row].data == data) return;
    if (dataIndexed_) UnindexData(row);
    rows_[row].data = data;
    if (dataIndexed_) IndexData(row);
}

RowId ComboRows::RowAt(Position position) const {
    Settle();
    return order_.At(position);
}

ComboRows::Position ComboRows::PositionOf(RowId row) const {
    Settle();
    return order_.PositionOf(row);
}

bool ComboRows::HasData(std::int32_t data) const { return FirstWithData(data) != RowChains::none; }

std::optional<ComboRows::Position> ComboRows::FindData(std::int32_t data) const {
    const RowId row = FirstWithData(data);
    if (row == RowChains::none) return std::nullopt;
    return PositionOf(row);
}

std::optional<ComboRows::Position> ComboRows::FindText(std::string_view text) const {
    WantTextIndex();
    const RowId row = byText_.First(HashOf(text), [&](RowId other) { return frame::EqualsNoCase(TextOf(other), text); });
    if (row == RowChains::none) return std::nullopt;
    return PositionOf(row);
}

std::optional<ComboRows::Position> ComboRows::FindStart(std::string_view start, Position from) const {
    Settle();
    const std::vector<RowId> rows = order_.All();
    const auto begins = [&](RowId row) { return frame::StartsWithNoCase(TextOf(row), start); };
    const auto middle = rows.begin() + std::min<std::ptrdiff_t>(from, static_cast<std::ptrdiff_t>(rows.size()));
    auto found = std::find_if(middle, rows.end(), begins);
    if (found == rows.end()) {
        found = std::find_if(rows.begin(), middle, begins);
        if (found == middle) return std::nullopt;
    }
    return static_cast<Position>(found - rows.begin());
}

// Order.

void ComboRows::Settle() const {
    constexpr std::size_t few = 16, share = 64;
    if (pending_.empty()) return;
    if (pending_.size() <= std::max(few, order_.Size() / share)) {
        SettleFew();
        pending_.clear();
    } else {
        SettleMany();
        pending_ = std::vector<RowId>();
    }
}

void ComboRows::SettleFew() const {
    for (const RowId row : pending_) order_.Insert(PlaceFor(row), row);
}

/// Behind the last row that is not greater.
ComboRows::Position ComboRows::PlaceFor(RowId row) const {
    const std::string_view text = TextOf(row);
    Position first = 0, end = order_.Size();
    while (first < end) {
        const Position middle = first + (end - first) / 2;
        if (frame::CompareNoCase(TextOf(order_.At(middle)), text) <= 0)
            first = middle + 1;
        else
            end = middle;
    }
    return first;
}

void ComboRows::SettleMany() const {
    struct Word {
        std::uint64_t start = 0;  // the first bytes of the key, the first one highest
        std::uint32_t at = 0, size = 0;
        RowId row = 0;
    };
    std::string keys;
    std::vector<Word> words;
    words.reserve(Size());
    const auto add = [&](RowId row) {
        const std::size_t at = keys.size();
        AppendOrdered(keys, TextOf(row));
        Word word{0, static_cast<std::uint32_t>(at), static_cast<std::uint32_t>(keys.size() - at), row};
        for (std::size_t i = 0; i < sizeof word.start; ++i)
            word.start = word.start << 8 | (i < word.size ? static_cast<unsigned char>(keys[at + i]) : 0u);
        words.push_back(word);
    };
    for (const RowId row : order_.All()) add(row);
    for (const RowId row : pending_) add(row);
    const auto keyOf = [&](const Word& word) { return std::string_view(keys).substr(word.at, word.size); };
    std::stable_sort(words.begin(), words.end(),
                     [&](const Word& a, const Word& b) { return a.start != b.start ? a.start < b.start : keyOf(a) < keyOf(b); });
    std::vector<RowId> rows;
    rows.reserve(words.size());
    for (const Word& word : words) rows.push_back(word.row);
    order_.Assign(rows);
}

void ComboRows::SortByPosition(std::vector<RowId>& rows) const {
    std::vector<std::pair<Position, RowId>> placed;
    placed.reserve(rows.size());
    for (const RowId row : rows) placed.emplace_back(PositionOf(row), row);
    std::sort(placed.begin(), placed.end());
    std::transform(placed.begin(), placed.end(), rows.begin(), [](const auto& entry) { return entry.second; });
}

// Finding.

void ComboRows::WantDataIndex() const {
    if (std::exchange(dataIndexed_, true)) return;
    Settle();
    const auto atEnd = [](RowId, RowId) { return RowChains::Place::Back; };
    for (const RowId row : order_.All()) byData_.Add(row, HashOf(rows_[row].data), EveryRow, atEnd);
}

void ComboRows::WantTextIndex() const {
    if (std::exchange(textIndexed_, true)) return;
    Settle();
    for (const RowId row : order_.All()) IndexText(row);
}

RowId ComboRows::FirstWithData(std::int32_t data) const {
    WantDataIndex();
    return byData_.First(HashOf(data), EveryRow);
}

void ComboRows::IndexData(RowId row) const {
    using Place = RowChains::Place;
    const bool isNew = IsSorted() ? !pending_.empty() && pending_.back() == row : true;
    byData_.Add(row, HashOf(rows_[row].data), EveryRow, [&](RowId first, RowId last) {
        if (!IsSorted() || !isNew) {
            if (order_.PositionOf(row) > order_.PositionOf(last)) return Place::Back;
            return order_.PositionOf(row) < order_.PositionOf(first) ? Place::Front : Place::Inside;
        }
        // It has no position yet, and comes behind its equals.
        if (frame::CompareNoCase(TextOf(row), TextOf(last)) >= 0) return Place::Back;
        return frame::CompareNoCase(TextOf(row), TextOf(first)) < 0 ? Place::Front : Place::Inside;
    });
}

void ComboRows::UnindexData(RowId row) {
    byData_.Remove(row, HashOf(rows_[row].data), EveryRow, [&](std::vector<RowId>& rows) { SortByPosition(rows); });
}

/// Rows of one text stand in the order in which they were added, in either list.
void ComboRows::IndexText(RowId row) const {
    const auto same = [&](RowId other) { return frame::EqualsNoCase(TextOf(other), TextOf(row)); };
    byText_.Add(row, HashOf(TextOf(row)), same, [](RowId, RowId) { return RowChains::Place::Back; });
}

void ComboRows::KeepTextsSmall() {
    constexpr std::size_t worthwhile = 65'536;
    if (texts_.Size() < worthwhile || texts_.Size() < 2 * textBytes_) return;
    TextStore fresh;
    for (const RowId row : order_.All()) rows_[row].text = fresh.Add(TextOf(row));
    texts_ = std::move(fresh);
}

}  // namespace tessel::child
