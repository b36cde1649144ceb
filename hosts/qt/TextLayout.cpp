#include "hosts/qt/TextLayout.h"

#include <QFontMetricsF>
#include <QPainter>
#include <algorithm>

namespace tessel::qt {

namespace {

constexpr double endless = 1 << 20;

/// Ends of lines as the painter knows them.
QString WithLineFeeds(QString text) { return text.contains('\r') ? text.replace("\r\n", "\n") : text; }

int Flags(bool wrap) { return Qt::TextExpandTabs | (wrap ? Qt::TextWordWrap : 0); }

}  // namespace

QSizeF TextSizeOf(const QFont& font, const QString& text, std::optional<double> wrapWidth) {
    const QFontMetricsF metrics(font);
    const double width = wrapWidth ? std::clamp(*wrapWidth, 1.0, endless) : endless;
    const QSizeF size =
        metrics.boundingRect(QRectF(0, 0, width, endless), Flags(wrapWidth.has_value()), WithLineFeeds(text)).size();
    return {text.isEmpty() ? 0 : size.width(), std::max(size.height(), metrics.height())};
}

void PaintText(QPainter& painter, const QRectF& place, const QString& text, Qt::Alignment alignment, bool wrap) {
    // The direction is that of the text, whatever that of the widget: it decides where its signs stand.
    const int direction = text.isRightToLeft() ? Qt::TextForceRightToLeft : Qt::TextForceLeftToRight;
    painter.drawText(place, static_cast<int>(alignment | Qt::AlignAbsolute | Qt::AlignTop) | direction | Flags(wrap),
                     WithLineFeeds(text));
}

}  // namespace tessel::qt
