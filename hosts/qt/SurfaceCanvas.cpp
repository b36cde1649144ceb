#include "hosts/qt/SurfaceCanvas.h"

#include <QPainter>
#include <cmath>

#include "hosts/qt/Convert.h"
#include "hosts/qt/TextLayout.h"

namespace tessel::qt {

namespace {

constexpr std::uint32_t opaque = 0xFF000000u;

bool IsPenChange(const frame::DrawOp& op) {
    return std::holds_alternative<frame::draw::DrawWidth>(op) || std::holds_alternative<frame::draw::DrawStyle>(op) ||
           std::holds_alternative<frame::draw::DrawMode>(op);
}

}  // namespace

void SurfaceCanvas::Draw(const frame::DrawOp& op, const frame::Pen& pen, const frame::Scale& scale, frame::OLE_COLOR background,
                         frame::OLE_COLOR foreground) {
    if (IsPenChange(op)) return;  // each operation brings its pen
    FitScreen(background);
    const auto ratio = static_cast<float>(ratio_);
    const frame::Scale sharp{scale.originX, scale.originY, scale.factorX * ratio, scale.factorY * ratio};
    if (const auto* print = std::get_if<frame::draw::Print>(&op))
        Print(*print, sharp, foreground);
    else if (const auto* picture = std::get_if<frame::draw::PaintPicture>(&op))
        Paint(*picture, sharp);
    else
        raster_.Draw(op, {static_cast<int>(std::lround(pen.width * ratio_)), pen.style, pen.mode}, sharp, background, foreground);
    shown_.update();
}

QImage SurfaceCanvas::Image() const {
    if (raster_.Width() == 0 || raster_.Height() == 0) return {};
    QImage image(raster_.Width(), raster_.Height(), QImage::Format_RGBX8888);
    auto pixel = raster_.Pixels().begin();
    for (int y = 0; y < image.height(); ++y) {
        auto* const line = reinterpret_cast<std::uint32_t*>(image.scanLine(y));
        for (int x = 0; x < image.width(); ++x) line[x] = *pixel++ | opaque;
    }
    image.setDevicePixelRatio(ratio_);
    return image;
}

void SurfaceCanvas::FitScreen(frame::OLE_COLOR background) {
    if (ratio_ != shown_.devicePixelRatioF()) {
        ratio_ = shown_.devicePixelRatioF();
        raster_ = child::Raster(0, 0, background);
    }
    const auto sharp = [this](int pixels) { return static_cast<int>(std::ceil(pixels * ratio_)); };
    if (raster_.Width() != sharp(shown_.width()) || raster_.Height() != sharp(shown_.height()))
        raster_.Resize(sharp(shown_.width()), sharp(shown_.height()), background);
}

template <class F>
void SurfaceCanvas::WithPainter(F&& paint) {
    QImage image = Image();
    if (image.isNull()) return;
    image.setDevicePixelRatio(1);
    {
        QPainter painter(&image);
        paint(painter);
    }
    for (int y = 0; y < image.height(); ++y) {
        const auto* const line = reinterpret_cast<const std::uint32_t*>(image.constScanLine(y));
        for (int x = 0; x < image.width(); ++x) raster_.SetPixel(x, y, line[x] & ~opaque);
    }
}

void SurfaceCanvas::Print(const frame::draw::Print& op, const frame::Scale& scale, frame::OLE_COLOR foreground) {
    WithPainter([&](QPainter& painter) {
        painter.translate(scale.X(op.x), scale.Y(op.y));
        painter.scale(ratio_, ratio_);
        painter.setFont(ToQt(*surface_.Font()));
        painter.setPen(QColor(frame::Red(foreground), frame::Green(foreground), frame::Blue(foreground)));
        PaintText(painter, QRectF(0, 0, shown_.width(), shown_.height()), ToQt(op.text), Qt::AlignLeft, false);
    });
}

void SurfaceCanvas::Paint(const frame::draw::PaintPicture& op, const frame::Scale& scale) {
    if (!op.picture || !op.picture->Plane(ratio_)) return;
    WithPainter([&](QPainter& painter) {
        const QRectF place(scale.X(op.x), scale.Y(op.y), Pixels(op.picture->Width()) * ratio_,
                           Pixels(op.picture->Height()) * ratio_);
        painter.setRenderHint(QPainter::SmoothPixmapTransform);
        const QImage image = ToQt(*op.picture, ratio_);
        painter.drawImage(place, image, QRectF(image.rect()));
    });
}

}  // namespace tessel::qt
