#pragma once

#include <QFont>
#include <QRectF>
#include <QSizeF>
#include <QString>
#include <optional>

class QPainter;

/// Plain text as labels show it: measured and painted by the same rules.
namespace tessel::qt {

/// The size in pixels. Lines part at line feeds, and at blanks where `wrapWidth` (in pixels) is given. An empty text is a line
/// high.
QSizeF TextSizeOf(const QFont& font, const QString& text, std::optional<double> wrapWidth);

/// Paints from the top of a rectangle, in the painter's font and pen; `alignment` is that of each line, left meaning left.
void PaintText(QPainter& painter, const QRectF& place, const QString& text, Qt::Alignment alignment, bool wrap);

}  // namespace tessel::qt
