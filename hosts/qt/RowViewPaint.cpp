#include <QPainter>
#include <QStyleOptionFocusRect>

#include "frame/ChildControl.h"
#include "frame/child/ImageList.h"
#include "hosts/qt/LabelPeer.h"
#include "hosts/qt/RowView.h"

/// What list and tree paint alike.
namespace tessel::qt {

bool RowView::IsDark(const QColor& color) {
    constexpr int middle = 128;
    return color.lightness() < middle;
}

QColor RowView::Mixed(const QColor& first, const QColor& second, float share) {
    const auto part = [share](float a, float b) { return a + (b - a) * share; };
    return QColor::fromRgbF(part(first.redF(), second.redF()), part(first.greenF(), second.greenF()),
                            part(first.blueF(), second.blueF()));
}

void RowView::DirectBy(QPainter& painter, const QString& text) {
    painter.setLayoutDirection(text.isRightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
}

QString RowView::OneLine(QString text) {
    // A name may have line breaks: they are seen, and take no line.
    constexpr QChar shownBreak(0x21B5);
    for (QChar& unit : text)
        if (unit == '\n' || unit == '\r' || unit == QChar::LineSeparator || unit == QChar::ParagraphSeparator) unit = shownBreak;
    return text;
}

RowView::Colors RowView::ColorsNow() const {
    constexpr float halfway = 0.5f, gridShare = 0.14f, faintShare = 0.16f, idleShare = 0.72f;
    const frame::SystemColors& system = Child()->Host().Colors();
    // What the palette stands for is that of this widget. The text of a disabled one is made paler below.
    Colors colors;
    colors.back = look_.back == frame::colors::windowBackground ? palette().color(QPalette::Base) : ToQt(look_.back, system);
    const QPalette::ColorGroup group = isEnabled() ? palette().currentColorGroup() : QPalette::Active;
    colors.text = look_.fore == frame::colors::windowText ? palette().color(group, QPalette::Text) : ToQt(look_.fore, system);
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

void RowView::paintEvent(QPaintEvent* event) {
    QPainter painter(viewport());
    if (!Child()) return painter.fillRect(event->rect(), palette().base());
    if (iconScale_ != devicePixelRatioF()) icons_.clear();
    iconScale_ = devicePixelRatioF();
    const Colors colors = ColorsNow();
    painter.setFont(font());
    painter.fillRect(event->rect(), colors.back);
    PaintBehind(painter);
    const QRect exposed = ToViewport(event->rect().translated(Scrolled())).translated(Scrolled());
    for (const child::RowRange range : layout_.Touched(exposed))
        for (Position row = range.first; row < range.first + range.count && row < rows_.HeldRows(); ++row)
            PaintRow(painter, row, colors);
    PaintAbove(painter, exposed, colors);
}

void RowView::PaintMark(QPainter& painter, QRect contents, bool isMarked, bool isHot, const Colors& colors) const {
    constexpr float paler = 0.12f;
    if (isMarked)
        painter.fillRect(ToViewport(contents), isHot ? Mixed(colors.mark, colors.back, paler) : colors.mark);
    else if (isHot)
        painter.fillRect(ToViewport(contents), colors.faintMark);
}

void RowView::PaintIcon(QPainter& painter, QRect contents, const frame::Variant& key, IconLook how, const Colors& colors) {
    child::ImageList* const images = Images();
    if (!images || contents.isEmpty()) return;
    const child::ListImage* image = images->Images().Find(key);
    if (!image || !image->ShownPicture()) return;
    auto& [held, pixels] = icons_[image->ShownPicture().get()];
    if (!held) {
        held = image->ShownPicture();
        pixels = IconOf(images, key, iconScale_);
    }
    if (pixels.isNull()) return;
    constexpr double ghost = 0.45, breath = 0.4;
    const QRect at = ToViewport(contents);
    painter.setOpacity(how.pale || !isEnabled() ? ghost : 1);
    painter.drawPixmap(at, pixels);
    if (how.tinted) {  // a breath of the mark over the icon
        QPixmap tint = pixels;
        QPainter tinting(&tint);
        tinting.setCompositionMode(QPainter::CompositionMode_SourceIn);
        tinting.fillRect(QRect(QPoint(), contents.size()), colors.mark);
        tinting.end();
        painter.setOpacity(painter.opacity() * breath);
        painter.drawPixmap(at, tint);
    }
    painter.setOpacity(1);
}

void RowView::PaintLine(QPainter& painter, QRect viewport, const QString& text, Qt::Alignment alignment) const {
    DirectBy(painter, text);
    painter.drawText(
        viewport, static_cast<int>(QStyle::visualAlignment(layoutDirection(), alignment | Qt::AlignVCenter)) | Qt::TextSingleLine,
        painter.fontMetrics().elidedText(text, Qt::ElideRight, viewport.width()));
}

void RowView::PaintFocus(QPainter& painter, QRect viewport, const QColor& back) const {
    QStyleOptionFocusRect option;
    option.initFrom(this);
    option.rect = viewport;
    option.backgroundColor = back;
    option.state |= QStyle::State_KeyboardFocusChange | QStyle::State_HasFocus;
    style()->drawPrimitive(QStyle::PE_FrameFocusRect, &option, &painter, this);
}

}  // namespace tessel::qt
