#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "frame/child/RowIndex.h"
#include "frame/child/RowPages.h"

namespace tessel::child {

/// Makes the texts of rows from what a control captured when it added them. Column 0 is the row's text, 1 and above are its
/// sub-items. For the life of a row it gives the same text each time, and it does not touch the list.
class RowSource {
  public:
    virtual ~RowSource() = default;
    virtual std::string Text(RowId row, int column) const = 0;

    /// Appends the text: for a source that has it at hand, so that sorting makes no string of each.
    virtual void AppendText(RowId row, int column, std::string& out) const { out += Text(row, column); }

    /// A number that stands in for the text where rows are sorted by this column: such numbers order as the texts do without
    /// regard to case, and are equal just where the texts are. 0 stands for the empty text and for no other. Nothing for a row
    /// whose text has no such number: those rows, and in a full sort all rows, are then compared by their texts.
    virtual std::optional<std::uint64_t> SortNumber(RowId /*row*/, int /*column*/) const { return std::nullopt; }
};

/// The texts of the rows of a list. What was set by itself stands aside, in a store that has room only for rows with such texts,
/// and wins over what the source makes. A text that neither has is empty.
class RowTexts {
  public:
    void SetSource(const RowSource* source) { source_ = source; }

    /// A new row without any text of its own. With `columnZero` the source gives its text.
    enum class ColumnZero : std::uint8_t { Own, FromSource };
    void Begin(RowId row, ColumnZero columnZero);
    /// From now on the source gives the sub-items.
    void Fill(RowId row) { flags_[row] |= filled; }
    void End(RowId row);
    void Clear();

    std::string Text(RowId row, int column) const;
    void AppendText(RowId row, int column, std::string& out) const;
    /// The number that stands in for the text in a sort, where there is one; see `RowSource::SortNumber`.
    std::optional<std::uint64_t> SortNumber(RowId row, int column) const;
    /// False when it reads so already.
    bool SetText(RowId row, int column, std::string_view text);

  private:
    struct OwnText {
        int column = 0;
        std::string text;
    };
    static constexpr std::uint8_t fromSource = 1, filled = 2, hasOwn = 4;

    /// Null for a text that the row has not by itself.
    const std::string* Own(RowId row, int column) const;
    bool IsMade(RowId row, int column) const { return source_ && (flags_[row] & (column == 0 ? fromSource : filled)) != 0; }

    const RowSource* source_ = nullptr;
    RowPages<std::uint8_t> flags_;
    std::unordered_map<RowId, std::vector<OwnText>> own_;
};

/// Finds rows by a text without regard to case. Holds hashes only: what it names has to be compared. About 11 bytes a row.
class TextIndex {
  public:
    /// `row` is not in the index.
    void Add(RowId row, std::string_view text) { index_.Add(row, HashIndex::HashOf(text)); }
    /// `row` is in the index.
    void Remove(RowId row) { index_.Remove(row); }
    /// Calls `each` with every row that may have the text, in no particular order.
    template <class F>
    void Candidates(std::string_view text, F&& each) const {
        index_.Candidates(HashIndex::HashOf(text), each);
    }

  private:
    HashIndex index_;
};

}  // namespace tessel::child
