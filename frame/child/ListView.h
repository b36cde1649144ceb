#pragma once

#include "frame/child/ListItem.h"
#include "frame/child/ListRows.h"
#include "frame/child/PointerChild.h"

namespace tessel::child {

enum class ListViewConstants : std::int16_t { Icon = 0, SmallIcon = 1, List = 2, Report = 3 };

namespace names {
inline constexpr frame::Enumeration::Constant listView[] = {{"Icon", 0}, {"SmallIcon", 1}, {"List", 2}, {"Report", 3}};
inline constexpr frame::Enumeration::Constant listSortOrder[] = {{"Ascending", 0}, {"Descending", 1}};
}  // namespace names
inline constexpr frame::Enumeration listViewConstants{"ListViewConstants", names::listView};
inline constexpr frame::Enumeration listSortOrderConstants{"ListSortOrderConstants", names::listSortOrder};

/// A list of rows with a text, sub-items and icons, sorted by any of its columns, made for 100,000 rows. Code that handles many
/// rows uses `Rows()`; `ListItems` and `ListItem` are the same rows for late-bound callers and for those who keep a row across
/// an event.
///
/// A peer reads `Rows().TakeChanges()` in each `Update`.
class ListView final : public KeyChild {
  public:
    static constexpr float headerHeightTwips = 300;
    static constexpr float rowHeightTwips = 255;

    ListView(frame::Control& owner, std::string name) : KeyChild(owner, std::move(name)) {}

    ListRows& Rows() { return rows_; }
    const ListRows& Rows() const { return rows_; }
    child::ListItems& Items() { return ListItems; }

    bool Sorted() const { return rows_.Sorted(); }
    void SetSorted(bool value) { rows_.SetSorted(value); }
    /// 0 sorts by the text, 1 and above by a sub-item. Error 380 below 0.
    std::int32_t SortKey() const { return rows_.SortKey(); }
    void SetSortKey(std::int32_t value);
    ListSortOrderConstants SortOrder() const { return rows_.SortOrder(); }
    void SetSortOrder(ListSortOrderConstants value) { rows_.SetSortOrder(value); }

    ListViewConstants View() const { return view_; }
    void SetView(ListViewConstants value) { Store(view_, value); }
    bool HideColumnHeaders() const { return hideColumnHeaders_; }
    void SetHideColumnHeaders(bool value) { Store(hideColumnHeaders_, value); }
    /// Whether several rows may be selected. Turning it off leaves the selection as it is until a row is selected.
    bool MultiSelect() const { return multiSelect_; }
    void SetMultiSelect(bool value) { Store(multiSelect_, value); }

    /// The row that was selected last, whether it still is or not; null when there is none or it has gone.
    ListItemRef SelectedItem() const;
    /// Selects a row of this list (error 35601 for one of another, 91 for one that has gone). Null: no row is the selected item,
    /// and the rows keep their state.
    void SetSelectedItem(const ListItemRef& value);
    void Select(RowId row, bool value);

    /// The first row whose text is this, without regard to case; null when there is none.
    ListItemRef FindItem(const std::string& text) const;
    /// The row at a point in twips of the list, by its height alone; null beside the rows.
    ListItemRef HitTest(float x, float y) const;
    /// The row at the top of what is in view; null for an empty list.
    ListItemRef GetFirstVisible() const;
    /// The index of that row; 0 for an empty list.
    std::int32_t TopIndex() const;
    /// Scrolls. Error 35600 for an index outside 1 to the number of rows.
    void SetTopIndex(std::int32_t value);
    /// The upper edge of a row in twips of the list; above the header's lower edge for one that is scrolled off.
    float RowTop(ListRows::Position position) const;
    ListItemRef ItemOf(RowId row) const;

    // What a peer reports.
    /// The user has clicked the row at an index, which is now the only one selected.
    void ItemClickInput(std::int32_t index);

    /// Where the event goes, with the row's index.
    frame::Slot<std::int32_t> ItemClick;

    const frame::ClassTable& Table() const override;

    child::ListItems ListItems{*this};

  protected:
    void PeerAttached() override { rows_.Follow(); }

  private:
    void RowsChanged();
    float HeaderHeight() const;
    ListRows::Position TopPosition() const;

    ListRows rows_{[this] { RowsChanged(); }};
    RowRef selectedItem_;
    ListRows::Position top_ = 0;  // may stand behind the end after rows have gone
    ListViewConstants view_ = ListViewConstants::Report;
    bool hideColumnHeaders_ = false, multiSelect_ = false;
};

}  // namespace tessel::child

namespace tessel::frame {
template <>
inline constexpr const Enumeration* enumerationOf<child::ListViewConstants> = &child::listViewConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::ListSortOrderConstants> = &child::listSortOrderConstants;
}  // namespace tessel::frame
