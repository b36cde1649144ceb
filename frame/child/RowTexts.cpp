#include "frame/child/RowTexts.h"

#include <algorithm>
#include <utility>

#include "frame/Text.h"

namespace tessel::child {

void RowTexts::Begin(RowId row, ColumnZero columnZero) {
    flags_.MakeRoom(row);
    flags_[row] = columnZero == ColumnZero::FromSource ? fromSource : 0;
}

void RowTexts::End(RowId row) {
    if (flags_[row] & hasOwn) own_.erase(row);
    flags_[row] = 0;
}

void RowTexts::Clear() {
    flags_.Clear();
    own_.clear();
}

std::string RowTexts::Text(RowId row, int column) const {
    if (const std::string* own = Own(row, column)) return *own;
    return IsMade(row, column) ? source_->Text(row, column) : std::string();
}

void RowTexts::AppendText(RowId row, int column, std::string& out) const {
    if (const std::string* own = Own(row, column))
        out += *own;
    else if (IsMade(row, column))
        source_->AppendText(row, column, out);
}

std::optional<std::uint64_t> RowTexts::SortNumber(RowId row, int column) const {
    if (const std::string* own = Own(row, column)) return own->empty() ? std::optional<std::uint64_t>(0) : std::nullopt;
    return IsMade(row, column) ? source_->SortNumber(row, column) : 0;
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

const std::string* RowTexts::Own(RowId row, int column) const {
    if (!(flags_[row] & hasOwn)) return nullptr;
    for (const OwnText& own : own_.find(row)->second)
        if (own.column == column) return &own.text;
    return nullptr;
}

}  // namespace tessel::child
