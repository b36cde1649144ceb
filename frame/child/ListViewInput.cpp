#include <algorithm>

#include "frame/Surface.h"
#include "frame/child/ListView.h"

/// What the user does with a list.
namespace tessel::child {

namespace {

constexpr std::int16_t shiftKey = 1, ctrlKey = 2;

ListSelectConstants SelectedWith(std::int16_t shift) {
    const bool extends = (shift & shiftKey) != 0, keeps = (shift & ctrlKey) != 0;
    if (extends) return keeps ? ListSelectConstants::AddRange : ListSelectConstants::Range;
    return keeps ? ListSelectConstants::Toggle : ListSelectConstants::Only;
}

}  // namespace

void ListView::ItemClickInput(std::int32_t index, std::optional<std::int16_t> shift) {
    Enter("ItemClick", [&] {
        SelectBy(ListItems.At(index), SelectedWith(shift.value_or(0)));
        ItemClick(index);
    });
}

void ListView::SelectInput(std::int32_t index, ListSelectConstants how) {
    Enter("Select", [&] { SelectBy(ListItems.At(index), how); });
}

void ListView::SelectAllInput() {
    Enter("SelectAll", [&] {
        if (multiSelect_) rows_.SetSelected(RowRange{0, rows_.Count()}, true);
    });
}

void ListView::SelectNoneInput() {
    Enter("SelectNone", [&] { rows_.ClearSelection(); });
}

void ListView::FocusInput(std::int32_t index) {
    Enter("Focus", [&] { TakeFocus(ListItems.At(index)); });
}

void ListView::SelectionInput(std::span<const RowRange> select, std::span<const RowRange> deselect) {
    const auto inside = [&](RowRange range) {
        range.first = std::min(range.first, rows_.Count());
        range.count = std::min(range.count, rows_.Count() - range.first);
        return range;
    };
    Enter("Selection", [&] {
        for (const RowRange range : select) rows_.SetSelected(inside(range), true);
        for (const RowRange range : deselect) rows_.SetSelected(inside(range), false);
        const auto focus = FocusRow();
        if (focus && rows_.Selected(*focus)) selectedItem_ = rows_.Ref(*focus);
    });
}

void ListView::ColumnClickInput(std::int32_t index) {
    Enter("ColumnClick", [&] {
        ColumnHeaders.Item(index);
        ColumnClick(index);
    });
}

void ListView::ColumnWidthInput(std::int32_t index, float width) {
    Enter("ColumnWidth", [&] {
        ColumnHeader& header = ColumnHeaders.Item(index);
        if (header.Width() > 0) header.SetWidth(width > frame::twipsPerPixel ? width : frame::twipsPerPixel);
    });
}

void ListView::ColumnMoveInput(std::int32_t index, std::int32_t position) {
    Enter("ColumnMove", [&] {
        if (allowColumnReorder_) ColumnHeaders.Item(index).SetPosition(position);
    });
}

void ListView::ScrollInput(std::int32_t index) {
    Enter("Scroll", [&] {
        ListItems.At(index);
        Store(top_, static_cast<Position>(index - 1));
    });
}

void ListView::EditInput(std::int32_t index) {
    Enter("Edit", [&] {
        const RowId row = ListItems.At(index);
        if (labelEdit_ != ListLabelEditConstants::Automatic) return;
        Select(row, true);
        StartLabelEdit();
    });
}

void ListView::EndEditInput(const std::string& text) {
    Enter("EndEdit", [&] {
        bool cancel = false;
        std::string newString = text;
        if (Editing()) CloseEdit(edited_, cancel, newString);
    });
}

void ListView::GiveUpEditInput() {
    Enter("GiveUpEdit", [&] { GiveUpEdit(); });
}

void ListView::LabelEditInput(std::string& newString) {
    Enter("LabelEdit", [&] {
        const RowRef row = selectedItem_;
        std::string typed = newString;
        if (rows_.Lives(row)) newString = rows_.Text(row.row, 0);
        bool cancel = false;
        if (!OpenEdit(row, cancel)) return;
        CloseEdit(row, cancel, typed);
        if (!cancel) newString = typed;
    });
}

void ListView::BeforeLabelEditInput(bool& cancel) {
    Enter("BeforeLabelEdit", [&] { OpenEdit(selectedItem_, cancel); });
}

void ListView::AfterLabelEditInput(bool& cancel, std::string& newString) {
    Enter("AfterLabelEdit", [&] { CloseEdit(Editing() ? edited_ : selectedItem_, cancel, newString); });
}

void ListView::SelectOnly(RowId row) {
    const bool isOne = rows_.SelectedCount() == 1;
    if (isOne && rows_.Selected(row)) return;
    if (isOne && rows_.Lives(selectedItem_) && rows_.Selected(selectedItem_.row))
        rows_.SetSelected(selectedItem_.row, false);
    else
        rows_.ClearSelection();
    rows_.SetSelected(row, true);
}

void ListView::SelectBy(RowId row, ListSelectConstants how) {
    const bool isRange = multiSelect_ && (how == ListSelectConstants::Range || how == ListSelectConstants::AddRange);
    if (isRange) {
        const Position to = rows_.PositionOf(row);
        const Position from = rows_.Lives(anchor_) ? rows_.PositionOf(anchor_.row) : to;
        if (how == ListSelectConstants::Range) rows_.ClearSelection();
        rows_.SetSelected(RowRange{std::min(from, to), std::max(from, to) - std::min(from, to) + 1}, true);
    } else if (multiSelect_ && how == ListSelectConstants::Toggle) {
        rows_.SetSelected(row, !rows_.Selected(row));
    } else {
        SelectOnly(row);
    }
    TakeFocus(row);
    if (rows_.Selected(row)) selectedItem_ = focus_;
    if (!isRange || !rows_.Lives(anchor_)) anchor_ = focus_;
}

void ListView::TakeFocus(RowId row) { Store(focus_, rows_.Ref(row)); }

bool ListView::OpenEdit(RowRef row, bool& cancel) {
    struct Opening {
        ~Opening() { mark = {}; }
        RowRef& mark;
    };
    GiveUpEdit();
    {
        const Opening opening{opening_ = row};
        BeforeLabelEdit(cancel);
    }
    if (cancel) return false;
    if (!rows_.Lives(row)) return row == RowRef{};
    Store(edited_, row);
    if (auto* peer = dynamic_cast<ListViewPeer*>(Peer())) {
        Host().Flush();
        peer->EditBegan(row.row);
    }
    return true;
}

void ListView::CloseEdit(RowRef row, bool& cancel, std::string& newString) {
    Store(edited_, RowRef{});
    AfterLabelEdit(cancel, newString);
    if (!cancel && rows_.Lives(row)) rows_.SetText(row.row, 0, newString);
}

void ListView::GiveUpEdit() {
    const bool wasOpen = Editing();
    Store(edited_, RowRef{});
    if (wasOpen) LabelEditGivenUp();
}

}  // namespace tessel::child
