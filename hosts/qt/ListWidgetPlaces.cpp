#include <algorithm>

#include "hosts/qt/ListWidget.h"

/// Where the parts of a list stand, the edit of a label among them.
namespace tessel::qt {

QRect ListWidget::ColumnCell(Position row, int column) const {
    const QRect cell = layout_.CellOf(row);
    if (!list_ || list_->ColumnHeaders.Count() == 0) return cell;
    if (header_.isSectionHidden(column)) return {};
    return {header_.sectionPosition(column), cell.top(), header_.sectionSize(column), cell.height()};
}

ListWidget::Label ListWidget::LabelOf(Position row, const QString& text) const {
    const QFontMetrics metrics = fontMetrics();
    const QSize image = ImageSize();
    Label label;
    if (IsLargeIcons()) {
        const QRect cell = layout_.CellOf(row);
        label.icon = QRect(QPoint(cell.center().x() - image.width() / 2, cell.top() + edge), image);
        const QRect room(cell.left() + edge, cell.top() + 2 * edge + image.height(), cell.width() - 2 * edge,
                         cell.bottom() - cell.top() - 3 * edge - image.height());
        const int wrap = view_.wrap ? Qt::TextWrapAnywhere | Qt::TextWordWrap : Qt::TextSingleLine;
        QRect used = metrics.boundingRect(room, Qt::AlignHCenter | Qt::AlignTop | wrap, text);
        used.setHeight(std::min(used.height(), (view_.wrap ? 2 : 1) * metrics.lineSpacing()));
        label.text = QRect(room.left(), room.top(), room.width(), used.height());
        label.mark = used.adjusted(-edge / 2, -1, edge / 2, 1).intersected(cell.adjusted(1, 0, -1, 0));
        label.reach = QRect(label.icon.topLeft(), QPoint(label.icon.right(), label.mark.top()));
        return label;
    }
    const QRect cell = IsReport() ? ColumnCell(row, 0) : layout_.CellOf(row);
    label = LineLabel(cell, metrics.horizontalAdvance(text));
    if (cell.isEmpty()) return label;
    if (IsReport() && look_.fullRow)
        label.mark = QRect(0, cell.top(), list_->ColumnHeaders.Count() > 0 ? header_.length() : cell.width(), cell.height());
    return label;
}

QRect ListWidget::visualRect(const QModelIndex& index) const {
    if (!index.isValid() || !list_) return {};
    const auto row = static_cast<Position>(index.row());
    return ToViewport(IsReport() ? ColumnCell(row, index.column()) : layout_.CellOf(row));
}

QModelIndex ListWidget::indexAt(const QPoint& point) const {
    const auto row = layout_.At(ToContents(point));
    if (!row) return {};
    const int column = IsReport() ? header_.logicalIndexAt(point.x()) : 0;
    return model_.index(static_cast<int>(*row), column);
}

// The label edit.

void ListWidget::BeginEdit(child::RowId row) {
    if (!list_) return;
    RowView::BeginEdit(list_->Rows().PositionOf(row));
    if (IsLargeIcons()) editor_->setAlignment(Qt::AlignHCenter);
}

QRect ListWidget::EditorPlace(Position row) const {
    if (IsReport()) return RowView::EditorPlace(row);
    const int least = layout_.cell.width() / 2;
    if (!IsLargeIcons()) return LineEditorPlace(row, least);
    constexpr int frame = 4;
    const Label label = LabelOf(row, editor_->text());
    const int width = std::clamp(WantedEditorWidth(), least, std::max(least, 2 * layout_.cell.width()));
    return {label.text.center().x() - width / 2, label.text.top() - 2, width, fontMetrics().height() + frame};
}

}  // namespace tessel::qt
