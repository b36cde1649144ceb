#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "frame/Text.h"
#include "frame/child/ListConstants.h"
#include "frame/child/RowIcons.h"
#include "frame/child/RowJournal.h"
#include "frame/child/RowOrder.h"
#include "frame/child/RowSort.h"
#include "frame/child/RowTexts.h"

namespace tessel::child {

/// A row that may have gone, in which case its number may already name another.
struct RowRef {
    RowId row = 0;
    std::uint32_t serial = 0;  ///< 0 names no row
    friend bool operator==(const RowRef&, const RowRef&) = default;
};

/// The rows from a position on.
struct RowRange {
    RowOrder::Position first = 0;
    RowOrder::Position count = 0;
};

/// The rows of a list: their order, texts and states, made for 100,000 of them. A row takes about 18 bytes besides the texts that
/// were set by themselves, 8 more once they are in another order, and 11 more once a row was looked for by its text. Positions
/// count from 0; a `RowId` must name a row that is in the list.
///
/// Sorting: by the texts of one column, without regard to case, rows with equal texts keep their order. The rows settle by the
/// texts then standing when one is added, when one of the three sort settings is set, and in `TakeChanges`; setting a text moves
/// nothing.
class ListRows {
  public:
    using Position = RowOrder::Position;

    /// `changed` is told after each change.
    explicit ListRows(std::function<void()> changed) : changed_(std::move(changed)) {}

    Position Count() const { return order_.Size(); }
    RowId At(Position position) const { return order_.At(position); }
    Position PositionOf(RowId row) const { return order_.PositionOf(row); }
    RowRef Ref(RowId row) const { return {row, rows_[row].serial}; }
    bool Lives(RowRef ref) const { return ref.serial != 0 && ref.row < rows_.Size() && rows_[ref.row].serial == ref.serial; }

    /// Adds a row with a text of its own and empty sub-items: where it sorts, in a list that is not sorted at a position from 0 to
    /// `Count`, behind all others where none is given.
    RowId Add(std::string_view text, std::optional<Position> position = {});
    /// The number that the next row will have: a control captures under it what its source makes texts of.
    RowId NextId() const { return free_.empty() ? numbers_ : free_.back(); }
    /// Adds a row whose text the source makes; its sub-items are empty until `Fill`.
    RowId AddFromSource();
    /// The source makes the sub-items of this row from now on.
    void Fill(RowId row);
    void Remove(RowId row);
    void Clear();

    /// The source must live as long as the rows that it serves. All rows read anew.
    void SetSource(const RowSource* source);
    std::string Text(RowId row, int column) const { return texts_.Text(row, column); }
    void SetText(RowId row, int column, std::string_view text);
    /// The first row in the order whose text is this, without regard to case.
    std::optional<RowId> Find(std::string_view text) const;

    /// The key of a row, unique in the list without regard to case; empty for none.
    std::string Key(RowId row) const;
    /// Error 35602 for a key that another row has.
    frame::Status SetKey(RowId row, std::string_view key);
    std::optional<RowId> FindKey(std::string_view key) const;

    bool Selected(RowId row) const { return Has(row, selected); }
    void SetSelected(RowId row, bool value);
    /// Selects or deselects the rows of a range that lies in the list.
    void SetSelected(RowRange range, bool value);
    std::uint32_t SelectedCount() const { return selectedCount_; }
    void ClearSelection();
    bool Ghosted(RowId row) const { return Has(row, ghosted); }
    void SetGhosted(RowId row, bool value) { SetFlag(row, ghosted, value); }
    frame::Variant Tag(RowId row) const;
    void SetTag(RowId row, frame::Variant value);

    void BindIcons(IconSize size, const KeySet* keys) { icons_.Bind(size, keys); }
    frame::Variant Icon(RowId row, IconSize size) const { return icons_.Value(IconOf(row, size)); }
    /// The errors of `RowIcons`: 35601 for a key that the image list lacks, 35600 for an index outside of it.
    frame::Status SetIcon(RowId row, IconSize size, const frame::Variant& value);
    frame::Status SetIconKey(RowId row, IconSize size, std::string_view key);

    bool Sorted() const { return sorted_; }
    void SetSorted(bool value);
    /// 0 sorts by the text, 1 and above by a sub-item.
    int SortKey() const { return sortKey_; }
    void SetSortKey(int value);
    ListSortOrderConstants SortOrder() const { return sortOrder_; }
    void SetSortOrder(ListSortOrderConstants value);

    /// From now on changes are kept for one who follows and begins with the whole list; `Unfollow` ends that.
    void Follow();
    void Unfollow();
    /// Settles the order and gives what has changed since the last call.
    std::vector<RowChange> TakeChanges();

  private:
    struct Row {
        std::uint32_t serial = 0;  // 0 for a row that has gone
        std::array<RowIcons::IconId, 2> icons{};
        std::uint8_t flags = 0;
    };
    struct Moving;
    using RowsByKey = std::unordered_map<std::string, RowId, frame::HashNoCase, frame::EqualNoCase>;
    static constexpr std::uint8_t selected = 1, ghosted = 2, unsettled = 4, tagged = 8, keyed = 16;

    bool Has(RowId row, std::uint8_t flag) const { return (rows_[row].flags & flag) != 0; }
    void SetFlag(RowId row, std::uint8_t flag, bool value);
    RowIcons::IconId IconOf(RowId row, IconSize size) const { return rows_[row].icons[static_cast<std::size_t>(size)]; }
    void StoreIcon(RowId row, IconSize size, RowIcons::IconId icon);
    RowId AddRow(std::string_view text, RowTexts::ColumnZero columnZero, std::optional<Position> position);
    void RowChanged(RowId row);
    void TextChanged(RowId row, int column);
    void DropIndex() { index_.reset(); }
    void DropKey(RowId row);

    bool Ascending() const { return sortOrder_ == ListSortOrderConstants::Ascending; }
    void Settle();
    void SettleAnew();
    void SortAll();
    void MoveUnsettled();
    std::vector<Moving> TakeUnsettled();
    Position PlaceOfNew(const RowKey& key) const;
    template <class RowAt>
    Position PlaceOf(const RowKey& key, Position count, Position stay, RowAt&& rowAt) const;

    std::function<void()> changed_;
    RowPages<Row> rows_;
    RowId numbers_ = 0;  // that were given to rows, of which `free_` are free again
    std::vector<RowId> free_;
    std::uint32_t lastSerial_ = 0;
    RowOrder order_;
    RowTexts texts_;
    mutable std::unique_ptr<TextIndex> index_;  // made when first asked
    RowIcons icons_;
    std::unordered_map<RowId, frame::Variant> tags_;
    RowsByKey ofKey_;
    std::unordered_map<RowId, std::string> keys_;
    std::uint32_t selectedCount_ = 0;

    bool sorted_ = false;
    int sortKey_ = 0;
    ListSortOrderConstants sortOrder_ = ListSortOrderConstants::Ascending;
    std::vector<RowId> unsettled_;  // rows whose key has changed; may name a row twice, or one that has gone
    bool allUnsettled_ = false;

    bool followed_ = false;
    RowJournal journal_;
};

}  // namespace tessel::child
