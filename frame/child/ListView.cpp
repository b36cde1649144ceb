#include "frame/child/ListView.h"

#include <algorithm>
#include <cmath>

#include "frame/ClassTable.h"
#include "frame/Surface.h"

namespace tessel::child {

using frame::ControlError;
namespace errors = frame::errors;

ListView::ListView(frame::Control& owner, std::string name) : DragChild(owner, std::move(name)) {
    font_.Set(std::make_shared<frame::Font>());
}

void ListView::SetSortKey(std::int32_t value) {
    if (value < 0) throw ControlError(errors::invalidValue);
    rows_.SetSortKey(value);
}

void ListView::SetIcons(ImageList* value) {
    icons_.Set(value);
    ImagesChanged();
}

void ListView::SetSmallIcons(ImageList* value) {
    smallIcons_.Set(value);
    ImagesChanged();
}

void ListView::SetColumnHeaderIcons(ImageList* value) {
    columnHeaderIcons_.Set(value);
    ImagesChanged();
}

void ListView::SetFont(const frame::FontRef& value) {
    font_.Set(value ? value : std::make_shared<frame::Font>());
    Changed();
}

ListItemRef ListView::SelectedItem() const { return rows_.Lives(selectedItem_) ? ItemOf(selectedItem_.row) : nullptr; }

void ListView::SetSelectedItem(const ListItemRef& value) {
    if (!value) {
        selectedItem_ = {};
        Changed();
        return;
    }
    if (!value->IsOf(*this)) throw ControlError(errors::elementNotFound);
    if (!rows_.Lives(value->Ref())) frame::ThrowObjectGone();
    Select(value->Ref().row, true);
}

void ListView::Select(RowId row, bool value) {
    if (value && !multiSelect_)
        SelectOnly(row);
    else
        rows_.SetSelected(row, value);
    if (!value) return;
    TakeFocus(row);
    selectedItem_ = anchor_ = focus_;
}

std::optional<RowId> ListView::FocusRow() const {
    if (rows_.Lives(focus_)) return focus_.row;
    return rows_.Lives(selectedItem_) ? std::optional(selectedItem_.row) : std::nullopt;
}

ListItemRef ListView::FindItem(const std::string& text, std::optional<ListFindWhereConstants> where,
                               std::optional<std::int32_t> start, std::optional<ListFindHowConstants> how) const {
    const auto place = where.value_or(ListFindWhereConstants::Text);
    const auto manner = how.value_or(ListFindHowConstants::Whole);
    if (start) ListItems.At(*start);
    const bool isIndexed = place == ListFindWhereConstants::Text && manner == ListFindHowConstants::Whole;
    if (isIndexed && start.value_or(1) == 1) {
        const auto found = rows_.Find(text);
        return found ? ItemOf(*found) : nullptr;
    }
    for (auto position = static_cast<Position>(start.value_or(1) - 1); position < rows_.Count(); ++position) {
        const RowId row = rows_.At(position);
        if (Matches(row, text, place, manner)) return ItemOf(row);
    }
    return nullptr;
}

ListItemRef ListView::HitTest(float x, float y) const {
    std::optional<Position> position;
    if (ListScreen* screen = Screen()) {
        position = screen->RowAt(x, y);
    } else {
        const float rows = std::floor((y - HeaderHeight()) / rowHeightTwips);
        if (rows >= 0 && rows < static_cast<float>(rows_.Count())) position = TopPosition() + static_cast<Position>(rows);
    }
    return position && *position < rows_.Count() ? ItemOf(rows_.At(*position)) : nullptr;
}

ListItemRef ListView::GetFirstVisible() const { return rows_.Count() > 0 ? ItemOf(rows_.At(TopPosition())) : nullptr; }

std::int32_t ListView::TopIndex() const { return rows_.Count() > 0 ? static_cast<std::int32_t>(TopPosition()) + 1 : 0; }

void ListView::SetTopIndex(std::int32_t value) {
    ListItems.At(value);
    const auto position = static_cast<Position>(value - 1);
    if (ListScreen* screen = Screen()) screen->ScrollTo(position);
    Store(top_, position);
}

float ListView::RowTop(Position position) const {
    if (ListScreen* screen = Screen()) return screen->PlaceOf(position).top;
    return HeaderHeight() + rowHeightTwips * (static_cast<float>(position) - static_cast<float>(TopPosition()));
}

float ListView::RowHeight(Position position) const {
    ListScreen* screen = Screen();
    return screen ? screen->PlaceOf(position).height : rowHeightTwips;
}

void ListView::EnsureVisible(Position position) {
    if (ListScreen* screen = Screen())
        screen->MakeVisible(position);
    else
        ShowFixed(position);
}

ListItemRef ListView::ItemOf(RowId row) const {
    return std::make_shared<ListItem>(const_cast<ListView&>(*this), rows_.Ref(row));  // NOLINT: who may read a row may change it
}

void ListView::StartLabelEdit() {
    if (!rows_.Lives(selectedItem_) || edited_ == selectedItem_ || opening_ == selectedItem_) return;
    bool cancel = false;
    OpenEdit(selectedItem_, cancel);
}

std::optional<RowId> ListView::EditedRow() const { return rows_.Lives(edited_) ? std::optional(edited_.row) : std::nullopt; }

void ListView::RowsChanged() {
    if (rows_.Count() == 0) top_ = 0;
    if (!Peer()) rows_.Unfollow();
    Changed();
}

void ListView::ImagesChanged() {
    const auto keysOf = [](const ImageListHolder& holder) { return holder.Get() ? &holder.Get()->Keys() : nullptr; };
    rows_.BindIcons(IconSize::Large, keysOf(icons_));
    rows_.BindIcons(IconSize::Small, keysOf(smallIcons_));
    Changed();
}

ListScreen* ListView::Screen() const {
    auto* peer = dynamic_cast<ListViewPeer*>(Peer());
    if (!peer) return nullptr;
    Host().Flush();
    return peer->Screen();
}

float ListView::HeaderHeight() const { return view_ == ListViewConstants::Report && !hideColumnHeaders_ ? headerHeightTwips : 0; }

ListView::Position ListView::TopPosition() const {
    if (rows_.Count() == 0) return 0;
    ListScreen* screen = Screen();
    return std::min(screen ? screen->FirstVisible() : top_, rows_.Count() - 1);
}

void ListView::ShowFixed(Position position) {
    const float border = borderStyle_ != ListBorderConstants::None ? 2 * frame::borderTwips : 0;
    const float rows = std::floor((Height() - border - HeaderHeight()) / rowHeightTwips);
    const auto shown = static_cast<Position>(std::clamp(rows, 1.0f, static_cast<float>(rows_.Count())));
    const Position top = TopPosition();
    if (position < top)
        Store(top_, position);
    else if (position - top >= shown)
        Store(top_, position - shown + 1);
}

bool ListView::Matches(RowId row, const std::string& text, ListFindWhereConstants where, ListFindHowConstants how) const {
    const auto matches = [&](const std::string& candidate) {
        return how == ListFindHowConstants::Partial ? frame::StartsWithNoCase(candidate, text)
                                                    : frame::EqualsNoCase(candidate, text);
    };
    if (where == ListFindWhereConstants::Tag) {
        const frame::Variant tag = rows_.Tag(row);
        return (tag.IsString() || tag.IsNumber()) && matches(tag.ToText());
    }
    if (where != ListFindWhereConstants::SubItem) return matches(rows_.Text(row, 0));
    for (int column = 1; column < ColumnHeaders.Count(); ++column)
        if (matches(rows_.Text(row, column))) return true;
    return false;
}

namespace {

constexpr auto lookMembers = std::array{
    frame::property<&ListView::BackColor, &ListView::SetBackColor>("BackColor", "The colour behind the rows."),
    frame::property<&ListView::ForeColor, &ListView::SetForeColor>("ForeColor", "The colour of the texts."),
    frame::property<&ListView::Font, &ListView::SetFont>("Font", "The font of the texts."),
    frame::property<&ListView::BorderStyle, &ListView::SetBorderStyle>("BorderStyle", "Whether the list has a border."),
    frame::property<&ListView::Appearance, &ListView::SetAppearance>("Appearance", "Flat or raised."),
    frame::property<&ListView::MousePointer, &ListView::SetMousePointer>("MousePointer", "The pointer's shape over the list."),
    frame::property<&ListView::MouseIcon, &ListView::SetMouseIcon>("MouseIcon", "A pointer of the program's own."),
    frame::property<&ListView::Picture, &ListView::SetPicture>("Picture", "The picture behind the rows."),
    frame::property<&ListView::PictureAlignment, &ListView::SetPictureAlignment>("PictureAlignment", "Where the picture stands."),
    frame::property<&ListView::LabelWrap, &ListView::SetLabelWrap>("LabelWrap", "Whether labels of icons take several lines."),
    frame::property<&ListView::HideColumnHeaders, &ListView::SetHideColumnHeaders>("HideColumnHeaders",
                                                                                   "Whether a report has no headers."),
    frame::property<&ListView::HideSelection, &ListView::SetHideSelection>("HideSelection",
                                                                           "Whether the selection shows only with the focus."),
    frame::property<&ListView::FlatScrollBar, &ListView::SetFlatScrollBar>("FlatScrollBar", "Whether scroll bars look flat."),
    frame::property<&ListView::FullRowSelect, &ListView::SetFullRowSelect>("FullRowSelect",
                                                                           "Whether a selected row is marked in all its columns."),
    frame::property<&ListView::GridLines, &ListView::SetGridLines>("GridLines", "Whether lines part rows and columns."),
    frame::property<&ListView::HotTracking, &ListView::SetHotTracking>("HotTracking",
                                                                       "Whether the row under the pointer is highlighted."),
};

constexpr auto ownMembers = std::array{
    frame::property<&ListView::Items>("ListItems", "The rows."),
    frame::property<&ListView::Headers>("ColumnHeaders", "The headers of the columns."),
    frame::property<&ListView::Icons, &ListView::SetIcons>("Icons", "The images of the large icons."),
    frame::property<&ListView::SmallIcons, &ListView::SetSmallIcons>("SmallIcons", "The images of the small icons."),
    frame::property<&ListView::ColumnHeaderIcons, &ListView::SetColumnHeaderIcons>("ColumnHeaderIcons",
                                                                                   "The images of the column headers."),
    frame::property<&ListView::Sorted, &ListView::SetSorted>("Sorted", "Whether the rows are sorted."),
    frame::property<&ListView::SortKey, &ListView::SetSortKey>("SortKey",
                                                               "The column that sorts: 0 the text, above it a sub-item."),
    frame::property<&ListView::SortOrder, &ListView::SetSortOrder>("SortOrder", "Ascending or descending."),
    frame::property<&ListView::View, &ListView::SetView>("View", "Icons, small icons, a list or a report."),
    frame::property<&ListView::Arrange, &ListView::SetArrange>("Arrange", "How icons fall into place."),
    frame::property<&ListView::LabelEdit, &ListView::SetLabelEdit>("LabelEdit", "Whether a click on a label may edit it."),
    frame::property<&ListView::MultiSelect, &ListView::SetMultiSelect>("MultiSelect", "Whether several rows may be selected."),
    frame::property<&ListView::AllowColumnReorder, &ListView::SetAllowColumnReorder>("AllowColumnReorder",
                                                                                     "Whether the user may move columns."),
    frame::property<&ListView::HoverSelection, &ListView::SetHoverSelection>("HoverSelection",
                                                                             "Whether resting on a row selects it."),
    frame::property<&ListView::SelectedItem, &ListView::SetSelectedItem>("SelectedItem", "The row that was selected last."),
    frame::property<&ListView::TopIndex, &ListView::SetTopIndex>("TopIndex", "The index of the first row in view."),
    frame::property<&ListView::Editing>("Editing", "Whether a label edit is open."),
    frame::method<&ListView::FindItem>("FindItem", "The first row with a text, or with a sub-item or tag of that text.",
                                       {"Text", "Where", "Index", "Match"}),
    frame::method<&ListView::HitTest>("HitTest", "The row at a point.", {"X", "Y"}),
    frame::method<&ListView::GetFirstVisible>("GetFirstVisible", "The first row in view."),
    frame::method<&ListView::StartLabelEdit>("StartLabelEdit", "Lets the user edit the selected row's text."),
    frame::method<&ListView::SetFocus>("SetFocus", "Gives the list the focus."),
};

constexpr auto members = Join(Join(frame::childMembers, dragMembers), frame::Join(ownMembers, lookMembers));

constexpr auto inputs =
    frame::Join(dragInputs, std::array{
                                frame::input<&ListView::ItemClickInput>("ItemClick", {"Index", "Shift"}),
                                frame::input<&ListView::SelectInput>("Select", {"Index", "How"}),
                                frame::input<&ListView::SelectAllInput>("SelectAll"),
                                frame::input<&ListView::SelectNoneInput>("SelectNone"),
                                frame::input<&ListView::FocusInput>("Focus", {"Index"}),
                                frame::input<&ListView::ColumnClickInput>("ColumnClick", {"Index"}),
                                frame::input<&ListView::ColumnWidthInput>("ColumnWidth", {"Index", "Width"}),
                                frame::input<&ListView::ColumnMoveInput>("ColumnMove", {"Index", "Position"}),
                                frame::input<&ListView::ScrollInput>("Scroll", {"Index"}),
                                frame::input<&ListView::EditInput>("Edit", {"Index"}),
                                frame::input<&ListView::EndEditInput>("EndEdit", {"NewString"}),
                                frame::input<&ListView::GiveUpEditInput>("GiveUpEdit"),
                                frame::input<&ListView::LabelEditInput>("LabelEdit", {"NewString"}),
                                frame::input<&ListView::BeforeLabelEditInput>("BeforeLabelEdit", {"Cancel"}),
                                frame::input<&ListView::AfterLabelEditInput>("AfterLabelEdit", {"Cancel", "NewString"}),
                            });
constexpr frame::ClassTable table{.name = "ListView", .members = members, .inputs = inputs};

}  // namespace

const frame::ClassTable& ListView::Table() const { return table; }

}  // namespace tessel::child
