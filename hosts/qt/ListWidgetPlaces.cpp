#include <QStyle>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/ListWidget.h"

/// Where the parts of a list stand, the edit of a label among them.
namespace tessel::qt {

QRect ListWidget::ToViewport(QRect contents) const {
    return QStyle::visualRect(layoutDirection(), QRect(QPoint(), layout_.window), contents.translated(-Scrolled()));
}

QPoint ListWidget::ToContents(QPoint viewport) const {
    return QStyle::visualPos(layoutDirection(), QRect(QPoint(), layout_.window), viewport) + Scrolled();
}

QPointF ListWidget::InsideOffset() const { return viewport()->geometry().topLeft() - contentsRect().topLeft(); }

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
        const int wrap = look_.wrap ? Qt::TextWrapAnywhere | Qt::TextWordWrap : Qt::TextSingleLine;
        QRect used = metrics.boundingRect(room, Qt::AlignHCenter | Qt::AlignTop | wrap, text);
        used.setHeight(std::min(used.height(), (look_.wrap ? 2 : 1) * metrics.lineSpacing()));
        label.text = QRect(room.left(), room.top(), room.width(), used.height());
        label.mark = used.adjusted(-edge / 2, -1, edge / 2, 1).intersected(cell.adjusted(1, 0, -1, 0));
        return label;
    }
    const QRect cell = IsReport() ? ColumnCell(row, 0) : layout_.CellOf(row);
    if (cell.isEmpty()) return label;
    label.icon = QRect(QPoint(cell.left() + edge, cell.top() + (cell.height() - image.height()) / 2), image);
    const int start = image.width() > 0 ? label.icon.right() + 1 + edge : cell.left() + edge;
    label.text = QRect(start, cell.top(), std::max(0, cell.right() + 1 - edge - start), cell.height());
    const int width = std::min(label.text.width(), metrics.horizontalAdvance(text) + 1);
    label.mark = QRect(start - edge / 2, cell.top(), width + edge, cell.height()).intersected(cell);
    if (IsReport() && look_.fullRow)
        label.mark = QRect(0, cell.top(), list_->ColumnHeaders.Count() > 0 ? header_.length() : cell.width(), cell.height());
    return label;
}

std::optional<ListWidget::Position> ListWidget::HitRow(QPoint at) const {
    if (!list_) return std::nullopt;
    const QPoint point = ToContents(at);
    const auto row = layout_.At(point);
    if (!row) return std::nullopt;
    const Label label = LabelOf(*row, LabelText(*row));
    if (label.mark.contains(point) || label.icon.contains(point)) return row;
    // The strips before the icon and between icon and text are the row's too.
    const QRect between = IsLargeIcons() ? QRect(label.icon.topLeft(), QPoint(label.icon.right(), label.mark.top()))
                                         : label.icon.adjusted(-edge, 0, edge, 0).united(label.mark);
    return between.contains(point) ? row : std::nullopt;
}

std::optional<ListWidget::Position> ListWidget::RowAtInside(QPointF point) const {
    const QPoint at = (point - InsideOffset()).toPoint();
    return viewport()->rect().contains(at) ? HitRow(at) : std::nullopt;
}

QRectF ListWidget::PlaceInside(Position row) const { return QRectF(ToViewport(layout_.CellOf(row))).translated(InsideOffset()); }

QRect ListWidget::visualRect(const QModelIndex& index) const {
    if (!index.isValid() || !list_) return {};
    const auto row = static_cast<Position>(index.row());
    return ToViewport(IsReport() ? ColumnCell(row, index.column()) : layout_.CellOf(row));
}

void ListWidget::scrollTo(const QModelIndex& index, ScrollHint) {
    if (index.isValid()) MakeVisible(static_cast<Position>(index.row()));
}

QModelIndex ListWidget::indexAt(const QPoint& point) const {
    const auto row = layout_.At(ToContents(point));
    if (!row) return {};
    const int column = IsReport() ? header_.logicalIndexAt(point.x()) : 0;
    return model_.index(static_cast<int>(*row), column);
}

QModelIndex ListWidget::moveCursor(CursorAction, Qt::KeyboardModifiers) { return currentIndex(); }

// The label edit.

void ListWidget::BeginEdit(child::RowId row) {
    if (!list_) return;
    EndEditor();
    const Position position = list_->Rows().PositionOf(row);
    MakeVisible(position);
    edited_ = list_->Rows().Ref(row);
    editor_ = new LabelEditor(model_.Text(static_cast<int>(position), 0), viewport());
    editor_->setFont(font());
    connect(editor_, &LabelEditor::accepted, this, [this](const QString& text) {
        if (list_) list_->EndEditInput(FromQt(text));
    });
    connect(editor_, &LabelEditor::givenUp, this, [this] {
        if (list_) list_->GiveUpEditInput();
    });
    connect(editor_, &QLineEdit::textEdited, this, [this] { PlaceEditor(); });
    if (IsLargeIcons()) editor_->setAlignment(Qt::AlignHCenter);
    PlaceEditor();
    editor_->show();
    editor_->setFocus(Qt::OtherFocusReason);
}

void ListWidget::PlaceEditor() {
    if (!list_ || !list_->Rows().Lives(edited_)) return;
    const Position row = list_->Rows().PositionOf(edited_.row);
    const QFontMetrics metrics = fontMetrics();
    const Label label = LabelOf(row, editor_->text());
    constexpr int frame = 4, spare = 12;
    const int wanted = metrics.horizontalAdvance(editor_->text()) + 2 * frame + spare;
    const int least = IsReport() ? std::min(wanted, 10 * metrics.averageCharWidth()) : layout_.cell.width() / 2;
    const int height = std::max(metrics.height() + frame, IsLargeIcons() ? 0 : layout_.cell.height());
    QRect place;
    if (IsLargeIcons()) {
        const int width = std::clamp(wanted, least, std::max(least, 2 * layout_.cell.width()));
        place = QRect(label.text.center().x() - width / 2, label.text.top() - 2, width, height);
    } else {
        const int left = label.text.left() - frame;
        const int room = layout_.window.width() + Scrolled().x() - left - 2;
        place = QRect(left, label.text.top() - (height - label.text.height()) / 2, std::clamp(wanted, least, std::max(least, room)),
                      height);
    }
    editor_->setGeometry(ToViewport(place));
}

void ListWidget::EndEditor() {
    if (!editor_) return;
    LabelEditor* const leaving = editor_;
    editor_ = nullptr;
    disconnect(leaving, nullptr, this, nullptr);
    const bool hadFocus = leaving->hasFocus();
    leaving->hide();
    leaving->deleteLater();  // its key may be on the stack
    if (hadFocus) setFocus(Qt::OtherFocusReason);
}

}  // namespace tessel::qt
