#include <QPainter>
#include <QTextLayout>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/ListWidget.h"

/// How a list looks.
namespace tessel::qt {

namespace {

/// Paints a label in up to two centred lines, the last one shortened.
void PaintLines(QPainter& painter, const QRect& place, const QString& text, bool wrap) {
    const QFontMetrics metrics = painter.fontMetrics();
    QTextLayout layout(text, painter.font());
    QTextOption option(Qt::AlignHCenter);
    option.setWrapMode(wrap ? QTextOption::WrapAtWordBoundaryOrAnywhere : QTextOption::NoWrap);
    option.setTextDirection(painter.layoutDirection());
    layout.setTextOption(option);
    layout.beginLayout();
    const int most = wrap ? 2 : 1;
    int y = place.top();
    for (int line = 1; line <= most; ++line, y += metrics.lineSpacing()) {
        QTextLine shown = layout.createLine();
        if (!shown.isValid()) break;
        shown.setLineWidth(place.width());
        const bool isCut =
            line == most && (shown.textStart() + shown.textLength() < text.size() || shown.naturalTextWidth() > place.width());
        QString words = isCut ? metrics.elidedText(text.mid(shown.textStart()), Qt::ElideRight, place.width())
                              : text.mid(shown.textStart(), shown.textLength()).trimmed();
        painter.drawText(QRect(place.left(), y, place.width(), metrics.lineSpacing()),
                         Qt::AlignHCenter | Qt::AlignTop | Qt::TextSingleLine, words);
    }
    layout.endLayout();
}

}  // namespace

void ListWidget::PaintAbove(QPainter& painter, const QRect& exposed, const Colors& colors) const {
    if (view_.grid && IsReport()) PaintGrid(painter, exposed, colors);
    if (band_) {
        const QRect band = ToViewport(*band_);
        QColor fill = palette().color(QPalette::Highlight);
        painter.setPen(fill);
        constexpr int faint = 48;
        fill.setAlpha(faint);
        painter.setBrush(fill);
        painter.drawRect(band.adjusted(0, 0, -1, -1));
    }
}

void ListWidget::PaintBehind(QPainter& painter) const {
    using Alignment = child::ListPictureAlignmentConstants;
    if (!view_.picture) return;
    const QImage image = ToQt(*view_.picture, devicePixelRatioF());
    if (image.isNull()) return;
    const QSize size(Pixels(view_.picture->Width()), Pixels(view_.picture->Height()));
    if (size.isEmpty()) return;
    const QRect room = viewport()->rect();
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    if (view_.alignment == Alignment::Tile) {
        for (int y = 0; y < room.height(); y += size.height())
            for (int x = 0; x < room.width(); x += size.width()) painter.drawImage(QRect(QPoint(x, y), size), image);
        return;
    }
    const auto is = [&](Alignment one, Alignment other) { return view_.alignment == one || view_.alignment == other; };
    QRect place(QPoint(), size);
    if (view_.alignment == Alignment::Center) place.moveCenter(room.center());
    if (is(Alignment::TopRight, Alignment::BottomRight)) place.moveRight(room.right());
    if (is(Alignment::BottomLeft, Alignment::BottomRight)) place.moveBottom(room.bottom());
    painter.drawImage(place, image);
}

void ListWidget::PaintRow(QPainter& painter, Position row, const Colors& colors) {
    const child::ListRows& rows = list_->Rows();
    const child::RowId id = rows.At(row);
    const QString text = LabelText(row);
    const Label label = LabelOf(row, text);
    const bool isFocus = currentIndex().row() == static_cast<int>(row);
    const bool isMarked = rows.Selected(id) && ShowsMark(), isHot = hot_ == row && look_.hot;
    const QRect mark = ToViewport(label.mark);
    PaintMark(painter, label.mark, isMarked, isHot, colors);
    QColor ink = isMarked ? colors.markedText : colors.text;
    if (rows.Ghosted(id)) ink = isMarked ? Mixed(colors.markedText, colors.mark, 0.3f) : colors.pale;
    if (!label.mark.isEmpty()) {
        PaintIcon(painter, label.icon, rows.Icon(id, IsLargeIcons() ? child::IconSize::Large : child::IconSize::Small),
                  {.pale = rows.Ghosted(id), .tinted = isMarked && !(IsReport() && look_.fullRow)}, colors);
        painter.setPen(ink);
        const QRect place = ToViewport(label.text);
        if (IsLargeIcons()) {
            DirectBy(painter, text);
            PaintLines(painter, place, text, view_.wrap);
        } else {
            PaintLine(
                painter, place, text,
                IsReport() && list_->ColumnHeaders.Count() > 0 ? ToQt(list_->ColumnHeaders.Item(1).Alignment()) : Qt::AlignLeft);
        }
    }
    if (IsReport()) PaintSubItems(painter, row, look_.fullRow ? ink : rows.Ghosted(id) ? colors.pale : colors.text);
    if (isFocus && hasFocus() && !mark.isEmpty()) PaintFocus(painter, mark, isMarked ? colors.mark : colors.back);
}

void ListWidget::PaintSubItems(QPainter& painter, Position row, const QColor& text) const {
    painter.setPen(text);
    for (int column = 1; column < list_->ColumnHeaders.Count() && column < header_.count(); ++column) {
        if (header_.isSectionHidden(column)) continue;
        const QRect cell = ToViewport(ColumnCell(row, column));
        if (!cell.intersects(viewport()->rect())) continue;
        const QRect place = cell.adjusted(edge, 0, -edge, 0);
        const QString words = OneLine(model_.Text(static_cast<int>(row), column));
        if (words.isEmpty() || place.width() <= 0) continue;
        PaintLine(painter, place, words, ToQt(list_->ColumnHeaders.Item(column + 1).Alignment()));
    }
}

void ListWidget::PaintGrid(QPainter& painter, const QRect& exposed, const Colors& colors) const {
    const QRect room = viewport()->rect();
    const int height = layout_.cell.height();
    for (int y = (exposed.top() / height + 1) * height - 1; y <= exposed.bottom(); y += height) {
        const int at = ToViewport(QRect(0, y, 1, 1)).top();
        painter.fillRect(room.left(), at, room.width(), 1, colors.grid);
    }
    for (int column = 0; column < list_->ColumnHeaders.Count() && column < header_.count(); ++column) {
        if (header_.isSectionHidden(column)) continue;
        const int end = header_.sectionPosition(column) + header_.sectionSize(column) - 1;
        const int at = ToViewport(QRect(end, 0, 1, 1)).left();
        painter.fillRect(at, room.top(), 1, room.height(), colors.grid);
    }
}

QString ListWidget::FullTextAt(QPoint at) const {
    const auto row = layout_.At(ToContents(at));
    if (!row) return {};
    const int column = IsReport() && list_->ColumnHeaders.Count() > 0 ? header_.logicalIndexAt(at.x()) : 0;
    if (column < 0) return {};
    const QString text = OneLine(model_.Text(static_cast<int>(*row), column));
    const int width = fontMetrics().horizontalAdvance(text);
    if (column > 0) return width > header_.sectionSize(column) - 2 * edge ? text : QString();
    const QSize room = LabelOf(*row, text).text.size();
    const int lines = IsLargeIcons() && view_.wrap ? 2 : 1;
    return width > room.width() * lines ? text : QString();
}

}  // namespace tessel::qt
