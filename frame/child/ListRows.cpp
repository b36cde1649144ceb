#include "frame/child/ListRows.h"

#include <algorithm>

#include "frame/Text.h"

namespace tessel::child {

using frame::Variant;

RowId ListRows::Add(std::string_view text, std::optional<Position> position) {
    const RowId row = AddRow(text, RowTexts::ColumnZero::Own, position);
    texts_.SetText(row, 0, text);
    return row;
}

RowId ListRows::AddFromSource() {
    const bool needsText = index_ || (sorted_ && sortKey_ == 0);
    texts_.Begin(NextId(), RowTexts::ColumnZero::FromSource);
    return AddRow(needsText ? Text(NextId(), 0) : std::string(), RowTexts::ColumnZero::FromSource, {});
}

RowId ListRows::AddRow(std::string_view text, RowTexts::ColumnZero columnZero, std::optional<Position> position) {
    Settle();
    const RowId row = NextId();
    if (sorted_) {
        RowKey key{std::string(), 0};
        if (sortKey_ == 0) key = {std::string(text), {}};
        if (sortKey_ == 0 && columnZero == RowTexts::ColumnZero::FromSource) key.number = texts_.SortNumber(row, 0);
        position = PlaceOfNew(key);
    }
    const Position place = position.value_or(Count());

    rows_.MakeRoom(row);
    texts_.Begin(row, columnZero);
    order_.Insert(place, row);
    if (free_.empty())
        ++numbers_;
    else
        free_.pop_back();
    rows_[row] = Row{};
    rows_[row].serial = ++lastSerial_;
    if (index_) index_->Add(row, text);
    if (followed_) journal_.Inserted(place);
    changed_();
    return row;
}

void ListRows::Fill(RowId row) {
    texts_.Fill(row);
    sortKey_ > 0 ? TextChanged(row, sortKey_) : RowChanged(row);
}

void ListRows::Remove(RowId row) {
    if (index_) index_->Remove(row);
    const Position position = PositionOf(row);
    order_.Remove(position);
    if (Has(row, selected)) --selectedCount_;
    if (Has(row, tagged)) tags_.erase(row);
    DropKey(row);
    texts_.End(row);
    rows_[row] = Row{};
    free_.push_back(row);
    if (followed_) journal_.Removed(position);
    changed_();
}

void ListRows::Clear() {
    DropIndex();
    order_.Clear();
    texts_.Clear();
    icons_.Clear();
    tags_.clear();
    ofKey_.clear();
    keys_.clear();
    rows_.Clear();
    numbers_ = 0;
    free_.clear();
    unsettled_.clear();
    allUnsettled_ = false;
    selectedCount_ = 0;
    if (followed_) journal_.Reset();
    changed_();
}

void ListRows::SetSource(const RowSource* source) {
    texts_.SetSource(source);
    DropIndex();
    allUnsettled_ = true;
    if (followed_) journal_.Reset();
    changed_();
}

void ListRows::SetText(RowId row, int column, std::string_view text) {
    if (!texts_.SetText(row, column, text)) return;
    if (column == 0 && index_) {
        index_->Remove(row);
        index_->Add(row, text);
    }
    TextChanged(row, column);
}

void ListRows::TextChanged(RowId row, int column) {
    if (sorted_ && column == sortKey_ && !Has(row, unsettled)) {
        unsettled_.push_back(row);
        rows_[row].flags |= unsettled;
    }
    RowChanged(row);
}

std::optional<RowId> ListRows::Find(std::string_view text) const {
    if (!index_) {
        auto index = std::make_unique<TextIndex>();
        for (const RowId row : order_.All()) index->Add(row, Text(row, 0));
        index_ = std::move(index);
    }
    std::optional<Position> first;
    index_->Candidates(text, [&](RowId row) {
        if (!frame::EqualsNoCase(Text(row, 0), text)) return;
        const Position position = PositionOf(row);
        if (!first || position < *first) first = position;
    });
    return first ? std::optional(At(*first)) : std::nullopt;
}

std::string ListRows::Key(RowId row) const { return Has(row, keyed) ? keys_.find(row)->second : std::string(); }

frame::Status ListRows::SetKey(RowId row, std::string_view key) {
    const auto other = FindKey(key);
    if (other && *other != row) return frame::errors::keyNotUnique;
    DropKey(row);
    if (key.empty()) return {};
    ofKey_.emplace(key, row);
    keys_.emplace(row, key);
    rows_[row].flags |= keyed;
    return {};
}

std::optional<RowId> ListRows::FindKey(std::string_view key) const {
    const auto found = ofKey_.find(key);
    return found != ofKey_.end() ? std::optional(found->second) : std::nullopt;
}

void ListRows::DropKey(RowId row) {
    if (!Has(row, keyed)) return;
    const auto known = keys_.find(row);
    ofKey_.erase(known->second);
    keys_.erase(known);
    rows_[row].flags &= static_cast<std::uint8_t>(~keyed);
}

void ListRows::SetSelected(RowId row, bool value) {
    if (Selected(row) == value) return;
    selectedCount_ += value ? 1 : -1;
    SetFlag(row, selected, value);
}

void ListRows::SetSelected(RowRange range, bool value) {
    bool isNew = false;
    for (Position position = range.first; position < range.first + range.count; ++position) {
        const RowId row = At(position);
        if (Selected(row) == value) continue;
        rows_[row].flags ^= selected;
        selectedCount_ += value ? 1 : -1;
        isNew = true;
    }
    if (!isNew) return;
    if (followed_) journal_.Changed(range.first, range.count);
    changed_();
}

void ListRows::ClearSelection() {
    constexpr std::uint32_t worthOneStep = 256;
    if (selectedCount_ > worthOneStep) return SetSelected(RowRange{0, Count()}, false);
    for (RowId row = 0; selectedCount_ > 0; ++row) SetSelected(row, false);
}

void ListRows::SetFlag(RowId row, std::uint8_t flag, bool value) {
    if (Has(row, flag) == value) return;
    rows_[row].flags ^= flag;
    RowChanged(row);
}

Variant ListRows::Tag(RowId row) const { return Has(row, tagged) ? tags_.find(row)->second : Variant(); }

void ListRows::SetTag(RowId row, Variant value) {
    tags_[row] = std::move(value);
    rows_[row].flags |= tagged;
}

frame::Status ListRows::SetIcon(RowId row, IconSize size, const Variant& value) {
    RowIcons::IconId icon = IconOf(row, size);
    const frame::Status status = icons_.Find(size, value, icon);
    StoreIcon(row, size, icon);
    return status;
}

frame::Status ListRows::SetIconKey(RowId row, IconSize size, std::string_view key) {
    RowIcons::IconId icon = IconOf(row, size);
    const frame::Status status = icons_.FindKey(size, key, icon);
    StoreIcon(row, size, icon);
    return status;
}

void ListRows::StoreIcon(RowId row, IconSize size, RowIcons::IconId icon) {
    RowIcons::IconId& stored = rows_[row].icons[static_cast<std::size_t>(size)];
    if (stored == icon) return;
    stored = icon;
    RowChanged(row);
}

void ListRows::RowChanged(RowId row) {
    if (followed_ && !journal_.IsReset()) journal_.Changed(PositionOf(row));
    changed_();
}

void ListRows::Follow() {
    followed_ = true;
    journal_.Reset();
}

void ListRows::Unfollow() {
    if (!followed_) return;
    followed_ = false;
    journal_.Take();
}

std::vector<RowChange> ListRows::TakeChanges() {
    Settle();
    return journal_.Take();
}

}  // namespace tessel::child
