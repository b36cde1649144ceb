#include "frame/child/RowTexts.h"

#include <algorithm>

#include "frame/Text.h"

namespace tessel::child {

void RowTexts::Begin(RowId row, ColumnZero columnZero) {
    if (row >= flags_.size()) flags_.resize(std::size_t{row} + 1);
    flags_[row] = columnZero == ColumnZero::FromSource ? fromSource : 0;
}

void RowTexts::End(RowId row) {
    if (flags_[row] & hasOwn) own_.erase(row);
    flags_[row] = 0;
}

void RowTexts::Clear() {
    flags_.clear();
    own_.clear();
}

std::string RowTexts::Text(RowId row, int column) const {
    const std::uint8_t flags = flags_[row];
    if (flags & hasOwn) {
        for (const OwnText& own : own_.find(row)->second)
            if (own.column == column) return own.text;
    }
    const bool made = (flags & (column == 0 ? fromSource : filled)) != 0;
    return made && source_ ? source_->Text(row, column) : std::string();
}

bool RowTexts::SetText(RowId row, int column, std::string_view text) {
    if (Text(row, column) == text) return false;
    auto& texts = own_[row];
    flags_[row] |= hasOwn;
    const auto found = std::find_if(texts.begin(), texts.end(), [&](const OwnText& own) { return own.column == column; });
    if (found != texts.end())
        found->text = text;
    else
        texts.push_back({column, std::string(text)});
    return true;
}

void TextIndex::Add(RowId row, std::string_view text) { rows_.emplace(Hash(text), row); }

bool TextIndex::Remove(RowId row, std::string_view text) {
    const auto [first, last] = rows_.equal_range(Hash(text));
    const auto found = std::find_if(first, last, [&](const auto& entry) { return entry.second == row; });
    if (found == last) return false;
    rows_.erase(found);
    return true;
}

std::size_t TextIndex::Hash(std::string_view text) { return frame::HashNoCase()(text); }

}  // namespace tessel::child
