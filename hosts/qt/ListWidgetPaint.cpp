#include <QPainter>
#include <QStyleOptionFocusRect>
#include <QTextLayout>
#include <algorithm>
#include <cmath>

#include "hosts/qt/Convert.h"
#include "hosts/qt/LabelPeer.h"
#include "hosts/qt/ListWidget.h"

/// How a list looks.
namespace tessel::qt {

namespace {

QColor Mixed(const QColor& first, const QColor& second, float share) {
    const auto part = [share](float a, float b) { return a + (b - a) * share; };
    return QColor::fromRgbF(part(first.redF(), second.redF()), part(first.greenF(), second.greenF()),
                            part(first.blueF(), second.blueF()));
}

bool IsDark(const QColor& color) {
    constexpr int middle = 128;
    return color.lightness() < middle;
}

/// Each text runs in its own direction, so that a name reads the same in a view from right to left.
void DirectBy(QPainter& painter, const QString& text) {
    painter.setLayoutDirection(text.isRightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
}

/// Paints a label in up to two centred lines, the last one shortened.
void PaintLines(QPainter& painter, const QRect& place, const QString& text, bool wrap) {
    const QFontMetrics metrics = painter.fontMetrics();
    QTextLayout layout(text, painter.font());
    QTextOption option(Qt::AlignHCenter);
    option.setWrapMode(wrap ? QTextOption::WrapAtWordBoundaryOrAnywhere : QTextOption::NoWrap);
    DirectBy(painter, text);
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

QString ListWidget::OneLine(QString text) {
    // A name may have line breaks: they are seen, and take no line.
    constexpr QChar shownBreak(0x21B5);
    for (QChar& unit : text)
        if (unit == '\n' || unit == '\r' || unit == QChar::LineSeparator || unit == QChar::ParagraphSeparator) unit = shownBreak;
    return text;
}

ListWidget::Colors ListWidget::ColorsNow() const {
    constexpr float halfway = 0.5f, gridShare = 0.14f, faintShare = 0.16f, idleShare = 0.72f;
    const frame::SystemColors& system = list_->Host().Colors();
    const auto colorOf = [&](frame::OLE_COLOR color, QPalette::ColorRole role) {
        // What the palette stands for is that of this widget.
        const bool isOwn = color == (role == QPalette::Base ? frame::colors::windowBackground : frame::colors::windowText);
        return isOwn ? palette().color(role) : ToQt(color, system);
    };
    Colors colors;
    colors.back = colorOf(look_.back, QPalette::Base);
    colors.text = colorOf(look_.fore, QPalette::Text);
    if (look_.back.IsSystem() && IsDark(colors.back)) colors.text = Readable(colors.text, colors.back);
    if (!isEnabled()) colors.text = Mixed(colors.text, colors.back, halfway);
    colors.pale = Mixed(colors.text, colors.back, halfway);
    const QColor highlight = palette().color(QPalette::Active, QPalette::Highlight);
    const bool isActive = hasFocus() || (editor_ && editor_->hasFocus());
    colors.mark = isActive ? highlight : Mixed(Mixed(highlight, colors.text, 0.25f), colors.back, idleShare);
    colors.markedText = isActive ? palette().color(QPalette::Active, QPalette::HighlightedText) : colors.text;
    colors.faintMark = Mixed(highlight, colors.back, 1 - faintShare);
    colors.grid = Mixed(colors.text, colors.back, 1 - gridShare);
    return colors;
}

void ListWidget::paintEvent(QPaintEvent* event) {
    QPainter painter(viewport());
    if (!list_) return painter.fillRect(event->rect(), palette().base());
    if (iconScale_ != devicePixelRatioF()) icons_.clear();
    iconScale_ = devicePixelRatioF();
    const Colors colors = ColorsNow();
    painter.setFont(font());
    painter.fillRect(event->rect(), colors.back);
    PaintBackground(painter);
    const QRect exposed = ToViewport(event->rect().translated(Scrolled())).translated(Scrolled());
    for (const child::RowRange range : layout_.Touched(exposed))
        for (Position row = range.first; row < range.first + range.count && row < list_->Rows().Count(); ++row)
            PaintRow(painter, row, colors);
    if (look_.grid && IsReport()) PaintGrid(painter, exposed, colors);
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

void ListWidget::PaintBackground(QPainter& painter) const {
    using Alignment = child::ListPictureAlignmentConstants;
    if (!look_.picture) return;
    const QImage image = ToQt(*look_.picture, devicePixelRatioF());
    if (image.isNull()) return;
    const QSize size(Pixels(look_.picture->Width()), Pixels(look_.picture->Height()));
    if (size.isEmpty()) return;
    const QRect room = viewport()->rect();
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    if (look_.alignment == Alignment::Tile) {
        for (int y = 0; y < room.height(); y += size.height())
            for (int x = 0; x < room.width(); x += size.width()) painter.drawImage(QRect(QPoint(x, y), size), image);
        return;
    }
    const auto is = [&](Alignment one, Alignment other) { return look_.alignment == one || look_.alignment == other; };
    QRect place(QPoint(), size);
    if (look_.alignment == Alignment::Center) place.moveCenter(room.center());
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
    const bool hidesMark = look_.hideSelection && !hasFocus() && !editor_;
    const bool isMarked = rows.Selected(id) && !hidesMark, isHot = hot_ == row && look_.hot;
    const QRect mark = ToViewport(label.mark);
    if (isMarked)
        painter.fillRect(mark, isHot ? Mixed(colors.mark, colors.back, 0.12f) : colors.mark);
    else if (isHot)
        painter.fillRect(mark, colors.faintMark);
    QColor ink = isMarked ? colors.markedText : colors.text;
    if (rows.Ghosted(id)) ink = isMarked ? Mixed(colors.markedText, colors.mark, 0.3f) : colors.pale;
    if (!label.mark.isEmpty()) {
        PaintIcon(painter, row, label.icon, isMarked && !(IsReport() && look_.fullRow), colors);
        painter.setPen(ink);
        const QRect place = ToViewport(label.text);
        if (IsLargeIcons()) {
            PaintLines(painter, place, text, look_.wrap);
        } else {
            const Qt::Alignment alignment =
                IsReport() && list_->ColumnHeaders.Count() > 0 ? ToQt(list_->ColumnHeaders.Item(1).Alignment()) : Qt::AlignLeft;
            DirectBy(painter, text);
            painter.drawText(
                place,
                static_cast<int>(QStyle::visualAlignment(layoutDirection(), alignment | Qt::AlignVCenter)) | Qt::TextSingleLine,
                painter.fontMetrics().elidedText(text, Qt::ElideRight, place.width()));
        }
    }
    if (IsReport()) PaintSubItems(painter, row, look_.fullRow ? ink : rows.Ghosted(id) ? colors.pale : colors.text);
    if (!isFocus || !hasFocus() || mark.isEmpty()) return;
    QStyleOptionFocusRect option;
    option.initFrom(this);
    option.rect = mark;
    option.backgroundColor = isMarked ? colors.mark : colors.back;
    option.state |= QStyle::State_KeyboardFocusChange | QStyle::State_HasFocus;
    style()->drawPrimitive(QStyle::PE_FrameFocusRect, &option, &painter, this);
}

void ListWidget::PaintSubItems(QPainter& painter, Position row, const QColor& text) const {
    const QFontMetrics metrics = painter.fontMetrics();
    painter.setPen(text);
    for (int column = 1; column < list_->ColumnHeaders.Count() && column < header_.count(); ++column) {
        if (header_.isSectionHidden(column)) continue;
        const QRect cell = ToViewport(ColumnCell(row, column));
        if (!cell.intersects(viewport()->rect())) continue;
        const QRect place = cell.adjusted(edge, 0, -edge, 0);
        const QString words = OneLine(model_.Text(static_cast<int>(row), column));
        if (words.isEmpty() || place.width() <= 0) continue;
        const Qt::Alignment alignment = ToQt(list_->ColumnHeaders.Item(column + 1).Alignment()) | Qt::AlignVCenter;
        DirectBy(painter, words);
        painter.drawText(place, static_cast<int>(QStyle::visualAlignment(layoutDirection(), alignment)) | Qt::TextSingleLine,
                         metrics.elidedText(words, Qt::ElideRight, place.width()));
    }
}

void ListWidget::PaintIcon(QPainter& painter, Position row, QRect place, bool marked, const Colors& colors) {
    child::ImageList* const images = Images();
    if (!images || place.isEmpty()) return;
    const child::RowId id = list_->Rows().At(row);
    const frame::Variant key = list_->Rows().Icon(id, IsLargeIcons() ? child::IconSize::Large : child::IconSize::Small);
    const child::ListImage* image = images->Images().Find(key);
    if (!image || !image->ShownPicture()) return;
    auto& [held, pixels] = icons_[image->ShownPicture().get()];
    if (!held) {
        held = image->ShownPicture();
        pixels = IconOf(images, key, iconScale_);
    }
    if (pixels.isNull()) return;
    constexpr double ghost = 0.45;
    const QRect at = ToViewport(place);
    painter.setOpacity(list_->Rows().Ghosted(id) || !isEnabled() ? ghost : 1);
    painter.drawPixmap(at, pixels);
    if (marked) {  // a breath of the mark over the icon
        QPixmap tint = pixels;
        QPainter tinting(&tint);
        tinting.setCompositionMode(QPainter::CompositionMode_SourceIn);
        tinting.fillRect(QRect(QPoint(), place.size()), colors.mark);
        tinting.end();
        painter.setOpacity(painter.opacity() * 0.4);
        painter.drawPixmap(at, tint);
    }
    painter.setOpacity(1);
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
    const auto row = list_ ? layout_.At(ToContents(at)) : std::nullopt;
    if (!row) return {};
    const int column = IsReport() && list_->ColumnHeaders.Count() > 0 ? header_.logicalIndexAt(at.x()) : 0;
    if (column < 0) return {};
    const QString text = OneLine(model_.Text(static_cast<int>(*row), column));
    const int width = fontMetrics().horizontalAdvance(text);
    if (column > 0) return width > header_.sectionSize(column) - 2 * edge ? text : QString();
    const QSize room = LabelOf(*row, text).text.size();
    const int lines = IsLargeIcons() && look_.wrap ? 2 : 1;
    return width > room.width() * lines ? text : QString();
}

}  // namespace tessel::qt
