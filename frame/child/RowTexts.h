#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "frame/child/RowOrder.h"

namespace tessel::child {

/// Makes the texts of rows from what a control captured when it added them. Column 0 is the row's text, 1 and above are its
/// sub-items. For the life of a row it gives the same text each time, and it does not touch the list.
class RowSource {
  public:
    virtual ~RowSource() = default;
    virtual std::string Text(RowId row, int column) const = 0;
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
    /// False when it reads so already.
    bool SetText(RowId row, int column, std::string_view text);

  private:
    struct OwnText {
        int column = 0;
        std::string text;
    };
    static constexpr std::uint8_t fromSource = 1, filled = 2, hasOwn = 4;

    const RowSource* source_ = nullptr;
    std::vector<std::uint8_t> flags_;  // by row
    std::unordered_map<RowId, std::vector<OwnText>> own_;
};

/// Finds rows by a text without regard to case. Holds hashes only: what it names has to be compared.
class TextIndex {
  public:
    void Add(RowId row, std::string_view text);
    /// `text` is what the row was added with. False when it was not added so: the index is then of no use any more.
    bool Remove(RowId row, std::string_view text);
    /// Calls `each` with every row that may have the text, in no particular order.
    template <class F>
    void Candidates(std::string_view text, F&& each) const {
        const auto [first, last] = rows_.equal_range(Hash(text));
        for (auto at = first; at != last; ++at) each(at->second);
    }

  private:
    static std::size_t Hash(std::string_view text);

    std::unordered_multimap<std::size_t, RowId> rows_;
};

}  // namespace tessel::child
