#pragma once

#include <span>

#include "frame/Font.h"
#include "frame/Picture.h"
#include "frame/child/DragChild.h"
#include "frame/child/ImageList.h"
#include "frame/child/ListConstants.h"
#include "frame/child/ListHeaders.h"
#include "frame/child/ListItem.h"
#include "frame/child/ListRows.h"
#include "frame/child/ListViewPeer.h"

namespace tessel::child {

/// A list of rows with a text, sub-items and icons, sorted by any of its columns, made for 100,000 rows. Code that handles many
/// rows uses `Rows()`; `ListItems` and `ListItem` are the same rows for late-bound callers and for those who keep a row across
/// an event.
///
/// Selection: any number of rows with `MultiSelect`, else one. Two rows stand out: the selected item, which was selected last,
/// and the focus row, from which the keyboard goes on; they part only while the user moves the focus by itself.
///
/// Without a screen a fixed rule answers for it: in report view a header 300 twips high unless it is hidden, and in every view rows
/// of 255, one below the other, found by their height alone.
///
/// What a peer must do:
/// - In each `Update` read `Rows().TakeChanges()`, which starts with the whole list, and compare everything else with what it
///   shows: selection and ghosts come as changed rows, headers have a `Revision`, so have image lists. A row's image is
///   `Icons()->ListImages.Find(Rows().Icon(row, size))`; null shows none. It draws `ShownPicture` at the list's image size.
/// - It keeps no texts. `Rows()` may be read at any time; a position that it holds is good until the next `Update`.
/// - Before it turns what the user does into an input it lets the host settle (`Host::Flush`), so that indexes mean the same.
/// - It derives from `ListViewPeer` to answer for the screen and to open the label edit; one that does not is a plain follower.
/// - Mouse and keys first, then what the list does by itself: `MouseDownInput`, the selection, `ClickInput` at the release.
///   A press on a row selects by `ItemClickInput` with the shift keys; on a row that is selected already it waits for the release,
///   so that a drag takes the whole selection. The right button selects nothing by itself. A press beside the rows is
///   `SelectNoneInput`. Keys move by `SelectInput` and `FocusInput`; type-ahead asks `FindItem` for a partial
///   text. A rubber band reports by `SelectionInput`.
/// - Columns of width 0 are not seen and have no grip. Headers report by `ColumnClickInput`, `ColumnWidthInput` and, where
///   `AllowColumnReorder` lets them, `ColumnMoveInput`. A peer shows columns in the order of `ColumnHeaders.InView`.
/// - With `LabelEdit` automatic a click on the label of the selected row that becomes no double click is `EditInput`. An open edit
///   belongs to the row `EditedRow`, wherever it moves: accepting it is `EndEditInput`, Escape `GiveUpEditInput`. Keys typed into
///   it, and their releases, are not reported as keys of the list.
/// - It drags by what `DragChild` says.
class ListView final : public DragChild {
  public:
    static constexpr float headerHeightTwips = 300;
    static constexpr float rowHeightTwips = 255;

    ListView(frame::Control& owner, std::string name);

    ListRows& Rows() { return rows_; }
    const ListRows& Rows() const { return rows_; }
    child::ListItems& Items() { return ListItems; }
    child::ColumnHeaders& Headers() { return ColumnHeaders; }

    bool Sorted() const { return rows_.Sorted(); }
    void SetSorted(bool value) { rows_.SetSorted(value); }
    /// 0 sorts by the text, 1 and above by a sub-item. Error 380 below 0.
    std::int32_t SortKey() const { return rows_.SortKey(); }
    void SetSortKey(std::int32_t value);
    ListSortOrderConstants SortOrder() const { return rows_.SortOrder(); }
    void SetSortOrder(ListSortOrderConstants value) { rows_.SetSortOrder(value); }

    // The image lists of the large icons, the small icons and the headers; null for none. An icon that names an image which has
    // gone shows nothing, and shows again when it comes back.
    ImageList* Icons() const { return icons_.Get(); }
    void SetIcons(ImageList* value);
    ImageList* SmallIcons() const { return smallIcons_.Get(); }
    void SetSmallIcons(ImageList* value);
    ImageList* ColumnHeaderIcons() const { return columnHeaderIcons_.Get(); }
    void SetColumnHeaderIcons(ImageList* value);

    ListViewConstants View() const { return view_; }
    void SetView(ListViewConstants value) { Store(view_, value); }
    /// How icons fall into place in the two icon views.
    ListArrangeConstants Arrange() const { return arrange_; }
    void SetArrange(ListArrangeConstants value) { Store(arrange_, value); }
    /// Whether the user may edit labels by clicking them; `StartLabelEdit` does either way.
    ListLabelEditConstants LabelEdit() const { return labelEdit_; }
    void SetLabelEdit(ListLabelEditConstants value) { Store(labelEdit_, value); }
    /// Whether labels in the large icon view go on in the next line.
    bool LabelWrap() const { return labelWrap_; }
    void SetLabelWrap(bool value) { Store(labelWrap_, value); }
    bool HideColumnHeaders() const { return hideColumnHeaders_; }
    void SetHideColumnHeaders(bool value) { Store(hideColumnHeaders_, value); }
    /// Whether the selection is not shown while the list has not the focus.
    bool HideSelection() const { return hideSelection_; }
    void SetHideSelection(bool value) { Store(hideSelection_, value); }
    /// Whether several rows may be selected. Turning it off leaves the selection as it is until a row is selected.
    bool MultiSelect() const { return multiSelect_; }
    void SetMultiSelect(bool value) { Store(multiSelect_, value); }
    /// Whether the user may move columns.
    bool AllowColumnReorder() const { return allowColumnReorder_; }
    void SetAllowColumnReorder(bool value) { Store(allowColumnReorder_, value); }
    bool FlatScrollBar() const { return flatScrollBar_; }
    void SetFlatScrollBar(bool value) { Store(flatScrollBar_, value); }
    bool FullRowSelect() const { return fullRowSelect_; }
    void SetFullRowSelect(bool value) { Store(fullRowSelect_, value); }
    bool GridLines() const { return gridLines_; }
    void SetGridLines(bool value) { Store(gridLines_, value); }
    /// Whether the row under the pointer is highlighted.
    bool HotTracking() const { return hotTracking_; }
    void SetHotTracking(bool value) { Store(hotTracking_, value); }
    /// Whether the row on which the pointer rests is selected.
    bool HoverSelection() const { return hoverSelection_; }
    void SetHoverSelection(bool value) { Store(hoverSelection_, value); }

    frame::OLE_COLOR BackColor() const { return backColor_; }
    void SetBackColor(frame::OLE_COLOR value) { Store(backColor_, value); }
    frame::OLE_COLOR ForeColor() const { return foreColor_; }
    void SetForeColor(frame::OLE_COLOR value) { Store(foreColor_, value); }
    /// Never null: a set to null gives a font of the default name and size.
    const frame::FontRef& Font() const { return font_.Get(); }
    void SetFont(const frame::FontRef& value);
    ListBorderConstants BorderStyle() const { return borderStyle_; }
    void SetBorderStyle(ListBorderConstants value) { Store(borderStyle_, value); }
    AppearanceConstants Appearance() const { return appearance_; }
    void SetAppearance(AppearanceConstants value) { Store(appearance_, value); }
    std::int16_t MousePointer() const { return mousePointer_; }
    void SetMousePointer(std::int16_t value) { Store(mousePointer_, value); }
    const frame::PictureRef& MouseIcon() const { return mouseIcon_; }
    void SetMouseIcon(const frame::PictureRef& value) { Store(mouseIcon_, value); }
    /// The picture behind the rows, and where it stands.
    const frame::PictureRef& Picture() const { return picture_; }
    void SetPicture(const frame::PictureRef& value) { Store(picture_, value); }
    ListPictureAlignmentConstants PictureAlignment() const { return pictureAlignment_; }
    void SetPictureAlignment(ListPictureAlignmentConstants value) { Store(pictureAlignment_, value); }

    /// The row that was selected last, whether it still is or not; null when there is none or it has gone.
    ListItemRef SelectedItem() const;
    /// Selects a row of this list (error 35601 for one of another, 91 for one that has gone). Null: no row is the selected item,
    /// and the rows keep their state.
    void SetSelectedItem(const ListItemRef& value);
    void Select(RowId row, bool value);
    /// The row from which the keyboard goes on; the selected item where the user has not moved it away.
    std::optional<RowId> FocusRow() const;
    void SetFocus() { Host().Focus().Set(*this); }

    /// The first row, from an index on, whose text is this, without regard to case, or with `Partial` begins with it; null when
    /// there is none. `SubItem` looks at the sub-items that have a column, `Tag` at the row's tag. Error 35600 for a start outside
    /// 1 to the number of rows. Only a whole text from the first row on is found without looking at each row.
    ListItemRef FindItem(const std::string& text, std::optional<ListFindWhereConstants> where = {},
                         std::optional<std::int32_t> start = {}, std::optional<ListFindHowConstants> how = {}) const;
    /// The row at a point in twips of the list; null beside the rows.
    ListItemRef HitTest(float x, float y) const;
    /// The row at the top of what is in view; null for an empty list.
    ListItemRef GetFirstVisible() const;
    /// The index of that row; 0 for an empty list.
    std::int32_t TopIndex() const;
    /// Scrolls. Error 35600 for an index outside 1 to the number of rows.
    void SetTopIndex(std::int32_t value);
    /// The upper edge of a row in twips of the list; above the header's lower edge for one that is scrolled off.
    float RowTop(ListRows::Position position) const;
    float RowHeight(ListRows::Position position) const;
    /// Scrolls just so far that a row is in view.
    void EnsureVisible(ListRows::Position position);
    ListItemRef ItemOf(RowId row) const;

    /// Opens the edit of the selected item's label: `BeforeLabelEdit` comes first and may cancel it. Nothing happens without a
    /// selected item, or when its edit is open; an edit of another row is given up.
    void StartLabelEdit();
    /// Whether a label edit is open.
    bool Editing() const { return EditedRow().has_value(); }
    /// The row whose label edit is open.
    std::optional<RowId> EditedRow() const;

    // What a peer reports. Indexes count from 1; error 35600 outside.
    /// The user has clicked a row: it is selected by the shift keys (1 Shift, 2 Ctrl, 0 and any without these: it alone), then
    /// `ItemClick` comes.
    void ItemClickInput(std::int32_t index, std::optional<std::int16_t> shift = {});
    /// The user has selected a row otherwise, by the keyboard or by resting on it. Without `MultiSelect` always the row alone.
    void SelectInput(std::int32_t index, ListSelectConstants how);
    void SelectAllInput();
    void SelectNoneInput();
    /// The user has moved the focus and left the selection alone.
    void FocusInput(std::int32_t index);
    /// The user has selected and deselected ranges of rows, in this order. What lies outside the list is passed over.
    void SelectionInput(std::span<const RowRange> select, std::span<const RowRange> deselect);
    void ColumnClickInput(std::int32_t index);
    /// The user has dragged the edge of a header. A hidden column stays hidden, any other is at least a pixel wide.
    void ColumnWidthInput(std::int32_t index, float width);
    /// The user has dragged a header to a place in view. Passed over without `AllowColumnReorder`.
    void ColumnMoveInput(std::int32_t index, std::int32_t position);
    /// The user has scrolled: the row at this index is the first in view.
    void ScrollInput(std::int32_t index);
    /// The user has asked for the edit of a label by clicking it. Passed over when `LabelEdit` is manual.
    void EditInput(std::int32_t index);
    /// The user has accepted the text of the open edit: it is closed, `AfterLabelEdit` comes, and unless that cancels the row takes
    /// the text as the event leaves it.
    void EndEditInput(const std::string& text);
    /// The user has given the open edit up: `LabelEditGivenUp` comes and no `AfterLabelEdit`.
    void GiveUpEditInput();
    /// A whole edit of the selected item: `BeforeLabelEdit`, and unless that cancels `AfterLabelEdit`. `newString` is the row's
    /// label afterwards, so that it tells whether the text was kept.
    void LabelEditInput(std::string& newString);
    /// The two halves of it by themselves.
    void BeforeLabelEditInput(bool& cancel);
    void AfterLabelEditInput(bool& cancel, std::string& newString);

    // Where the events go.
    frame::Slot<std::int32_t> ItemClick;    ///< with the row's index
    frame::Slot<std::int32_t> ColumnClick;  ///< with the header's
    frame::Slot<bool&> BeforeLabelEdit;
    frame::Slot<bool&, std::string&> AfterLabelEdit;
    frame::Slot<> LabelEditGivenUp;

    const frame::ClassTable& Table() const override;

    child::ListItems ListItems{*this};
    child::ColumnHeaders ColumnHeaders{*this};

  protected:
    void PeerAttached() override { rows_.Follow(); }

  private:
    using Position = ListRows::Position;

    void RowsChanged();
    void ImagesChanged();
    /// The screen, told of every change; null where the fixed rule stands in.
    ListScreen* Screen() const;
    float HeaderHeight() const;
    Position TopPosition() const;
    void ShowFixed(Position position);
    Position PositionAt(std::int32_t index) const { return rows_.PositionOf(ListItems.At(index)); }
    bool Matches(RowId row, const std::string& text, ListFindWhereConstants where, ListFindHowConstants how) const;

    void SelectOnly(RowId row);
    void SelectBy(RowId row, ListSelectConstants how);
    void TakeFocus(RowId row);

    /// False when the edit was refused, or its row has gone meanwhile. No row at all raises the event alone.
    bool OpenEdit(RowRef row, bool& cancel);
    void CloseEdit(RowRef row, bool& cancel, std::string& newString);
    void GiveUpEdit();

    ListRows rows_{[this] { RowsChanged(); }};
    ImageListHolder icons_{[this] { ImagesChanged(); }};
    ImageListHolder smallIcons_{[this] { ImagesChanged(); }};
    ImageListHolder columnHeaderIcons_{[this] { ImagesChanged(); }};
    frame::FontHolder font_{[this] { Changed(); }};
    frame::PictureRef mouseIcon_, picture_;
    RowRef selectedItem_;
    RowRef focus_;
    RowRef anchor_;  // where a range that the user selects begins
    RowRef edited_;
    RowRef opening_;    // while `BeforeLabelEdit` asks
    Position top_ = 0;  // by the fixed rule; may stand behind the end after rows have gone

    frame::OLE_COLOR backColor_ = frame::colors::windowBackground;
    frame::OLE_COLOR foreColor_ = frame::colors::windowText;
    ListViewConstants view_ = ListViewConstants::Report;
    ListArrangeConstants arrange_ = ListArrangeConstants::None;
    ListLabelEditConstants labelEdit_ = ListLabelEditConstants::Automatic;
    ListBorderConstants borderStyle_ = ListBorderConstants::FixedSingle;
    AppearanceConstants appearance_ = AppearanceConstants::ThreeD;
    ListPictureAlignmentConstants pictureAlignment_ = ListPictureAlignmentConstants::TopLeft;
    std::int16_t mousePointer_ = 0;
    bool labelWrap_ = true, hideColumnHeaders_ = false, hideSelection_ = false, multiSelect_ = false;
    bool allowColumnReorder_ = false, flatScrollBar_ = false, fullRowSelect_ = false, gridLines_ = false;
    bool hotTracking_ = false, hoverSelection_ = false;
};

}  // namespace tessel::child
