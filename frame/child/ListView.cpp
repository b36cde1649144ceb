#include "frame/child/ListView.h"

#include <algorithm>
#include <cmath>

#include "frame/ClassTable.h"

namespace tessel::child {

using frame::ControlError;
namespace errors = frame::errors;

void ListView::SetSortKey(std::int32_t value) {
    if (value < 0) throw ControlError(errors::invalidValue);
    rows_.SetSortKey(value);
}

ListItemRef ListView::SelectedItem() const { return rows_.Lives(selectedItem_) ? ItemOf(selectedItem_.row) : nullptr; }

void ListView::SetSelectedItem(const ListItemRef& value) {
    if (!value) {
        selectedItem_ = {};
        return;
    }
    if (!value->IsOf(*this)) throw ControlError(errors::elementNotFound);
    if (!rows_.Lives(value->Ref())) frame::ThrowObjectGone();
    Select(value->Ref().row, true);
}

void ListView::Select(RowId row, bool value) {
    if (value && !multiSelect_ && !(rows_.Selected(row) && rows_.SelectedCount() == 1)) rows_.ClearSelection();
    rows_.SetSelected(row, value);
    if (value) selectedItem_ = rows_.Ref(row);
}

ListItemRef ListView::FindItem(const std::string& text) const {
    const auto found = rows_.Find(text);
    return found ? ItemOf(*found) : nullptr;
}

ListItemRef ListView::HitTest(float /*x*/, float y) const {
    const float rows = std::floor((y - HeaderHeight()) / rowHeightTwips);
    if (!(rows >= 0 && rows < static_cast<float>(rows_.Count()))) return nullptr;
    const auto position = TopPosition() + static_cast<ListRows::Position>(rows);
    return position < rows_.Count() ? ItemOf(rows_.At(position)) : nullptr;
}

ListItemRef ListView::GetFirstVisible() const { return rows_.Count() > 0 ? ItemOf(rows_.At(TopPosition())) : nullptr; }

std::int32_t ListView::TopIndex() const { return rows_.Count() > 0 ? static_cast<std::int32_t>(TopPosition()) + 1 : 0; }

void ListView::SetTopIndex(std::int32_t value) {
    ListItems.At(value);
    Store(top_, static_cast<ListRows::Position>(value - 1));
}

float ListView::RowTop(ListRows::Position position) const {
    return HeaderHeight() + rowHeightTwips * (static_cast<float>(position) - static_cast<float>(TopPosition()));
}

ListItemRef ListView::ItemOf(RowId row) const {
    return std::make_shared<ListItem>(const_cast<ListView&>(*this), rows_.Ref(row));  // NOLINT: who may read a row may change it
}

void ListView::ItemClickInput(std::int32_t index) {
    Enter("ItemClick", [&] {
        const RowId row = ListItems.At(index);
        rows_.ClearSelection();
        Select(row, true);
        ItemClick(index);
    });
}

void ListView::RowsChanged() {
    if (!Peer()) rows_.Unfollow();
    Changed();
}

float ListView::HeaderHeight() const { return view_ == ListViewConstants::Report && !hideColumnHeaders_ ? headerHeightTwips : 0; }

ListRows::Position ListView::TopPosition() const { return rows_.Count() > 0 ? std::min(top_, rows_.Count() - 1) : 0; }

namespace {

constexpr auto members = Join(
    frame::childMembers,
    std::array{
        frame::property<&ListView::Items>("ListItems", "The rows."),
        frame::property<&ListView::Sorted, &ListView::SetSorted>("Sorted", "Whether the rows are sorted."),
        frame::property<&ListView::SortKey, &ListView::SetSortKey>("SortKey",
                                                                   "The column that sorts: 0 the text, above it a sub-item."),
        frame::property<&ListView::SortOrder, &ListView::SetSortOrder>("SortOrder", "Ascending or descending."),
        frame::property<&ListView::View, &ListView::SetView>("View", "Icons, small icons, a list or a report."),
        frame::property<&ListView::HideColumnHeaders, &ListView::SetHideColumnHeaders>("HideColumnHeaders",
                                                                                       "Whether a report has no headers."),
        frame::property<&ListView::MultiSelect, &ListView::SetMultiSelect>("MultiSelect", "Whether several rows may be selected."),
        frame::property<&ListView::SelectedItem, &ListView::SetSelectedItem>("SelectedItem", "The row that was selected last."),
        frame::property<&ListView::TopIndex, &ListView::SetTopIndex>("TopIndex", "The index of the first row in view."),
        frame::method<&ListView::FindItem>("FindItem", "The first row with a text.", {"Text"}),
        frame::method<&ListView::HitTest>("HitTest", "The row at a point.", {"X", "Y"}),
        frame::method<&ListView::GetFirstVisible>("GetFirstVisible", "The first row in view."),
    });
constexpr auto inputs = frame::Join(keyInputs, std::array{frame::input<&ListView::ItemClickInput>("ItemClick", {"Index"})});
constexpr frame::ClassTable table{.name = "ListView", .members = members, .inputs = inputs};

}  // namespace

const frame::ClassTable& ListView::Table() const { return table; }

}  // namespace tessel::child
