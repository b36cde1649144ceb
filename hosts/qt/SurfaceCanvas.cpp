#include "hosts/qt/SurfaceCanvas.h"

#include <QGuiApplication>
#include <QPainter>
#include <QPalette>
#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

#include "hosts/qt/Convert.h"
#include "hosts/qt/TextLayout.h"

namespace tessel::qt {

namespace draw = frame::draw;
using frame::OLE_COLOR;

namespace {

constexpr double endless = 1 << 20;

int Scaled(int pixels, double scale) { return static_cast<int>(std::ceil(pixels * scale)); }

std::size_t BytesOf(const frame::Picture& picture) {
    const frame::PixelPlane* largest = picture.Plane(std::numeric_limits<double>::infinity());
    return largest ? largest->pixels.size() * sizeof(std::uint32_t) : 0;
}

/// Red and blue change places. The rasters here are drawn on in such colours, and so their pixels are as a screen has them, which
/// it copies; in the order of the raster it would convert each of them whenever it shows them.
OLE_COLOR Turned(OLE_COLOR color) { return (color.value & 0xFF00FF00u) | (color.value & 0xFF) << 16 | (color.value >> 16 & 0xFF); }

/// The pixels of a raster, to be painted on: nothing is copied.
QImage Shared(child::Raster& raster) {
    return {reinterpret_cast<uchar*>(raster.Pixels().data()), raster.Width(), raster.Height(), QImage::Format_RGB32};
}
QImage Shared(const child::Raster& raster) {
    return {reinterpret_cast<const uchar*>(raster.Pixels().data()), raster.Width(), raster.Height(), QImage::Format_RGB32};
}

frame::PixelPlane PlaneAt(double scale, const child::Raster& raster) {
    frame::PixelPlane plane{scale, raster.Width(), raster.Height(), {}};
    plane.pixels.reserve(raster.Pixels().size());
    for (const std::uint32_t pixel : raster.Pixels()) plane.pixels.push_back(Turned(pixel).value);
    return plane;
}

/// How a stroke is drawn in the pixels of a screen, so that each of its pixels at scale 1 becomes the square of pixels that
/// stands for it.
struct Grid {
    Grid(const frame::Pen& given, const frame::Scale& unitsGiven, double screenScale)
        : units(unitsGiven),
          screen(screenScale),
          pen{std::max(1, static_cast<int>(std::lround(given.width * screen))), given.style, given.mode},
          scale{units.originX, units.originY, units.factorX * static_cast<float>(screen),
                units.factorY * static_cast<float>(screen)},
          isThin(given.width == 1) {
        // A broken style is for thin pens alone.
        if (isThin && given.style >= draw::dash && given.style <= draw::dashDotDot) pen.width = 1;
        const double before = given.width / 2 * screen;  // of the brush, left of and above its pixel
        shift = isThin && pen.width == 1 ? 0 : pen.width / 2 - static_cast<int>(std::lround(before));
    }
    float X(float unit) const { return static_cast<float>(frame::PixelAt(scale.X(unit)) + shift); }
    float Y(float unit) const { return static_cast<float>(frame::PixelAt(scale.Y(unit)) + shift); }

    draw::Circle Fitted(draw::Circle circle) const {
        circle.x = X(circle.x);
        circle.y = Y(circle.y);
        circle.radius *= std::abs(scale.factorX);
        return circle;
    }
    /// A thin line ends before its last pixel at scale 1; what is left may be one dot.
    std::variant<draw::Line, draw::PSet> Fitted(draw::Line line) const {
        if (line.box == draw::Box::Filled && pen.style == draw::transparent) return Inside(line);
        line = {X(line.x1), Y(line.y1), X(line.x2), Y(line.y2), line.color, line.box};
        const float across = line.x2 - line.x1, down = line.y2 - line.y1;
        const float length = std::max(std::abs(across), std::abs(down));
        if (line.box != draw::Box::None || !isThin || pen.width == 1 || length == 0) return line;
        const float rest = std::max(0.0f, 1 - static_cast<float>(pen.width) / length);
        line.x2 = line.x1 + std::round(across * rest);
        line.y2 = line.y1 + std::round(down * rest);
        if (line.x1 == line.x2 && line.y1 == line.y2) return draw::PSet{line.x1, line.y1, line.color};
        return line;
    }

    /// A filled box without an outline, around the squares of the pixels that an outline of width 1 encloses.
    draw::Line Inside(const draw::Line& box) const {
        const auto [left, right] = std::minmax({frame::PixelAt(units.X(box.x1)), frame::PixelAt(units.X(box.x2))});
        const auto [top, bottom] = std::minmax({frame::PixelAt(units.Y(box.y1)), frame::PixelAt(units.Y(box.y2))});
        constexpr int thinnest = 2;  // between the outer pixels
        if (right - left < thinnest || bottom - top < thinnest) return {0, 0, 0, 0, box.color, draw::Box::None};
        const auto begin = [&](int pixel) { return std::floor(static_cast<float>((pixel + 1) * screen)) - 1; };
        const auto end = [&](int pixel) { return std::floor(static_cast<float>(pixel * screen)); };
        return {begin(left), begin(top), end(right), end(bottom), box.color, box.box};
    }

    frame::Scale units;
    double screen;
    frame::Pen pen;
    frame::Scale scale;
    bool isThin;
    int shift = 0;
};

/// The rectangle around two points in pixels at scale 1, with what a pen adds.
QRectF Around(const frame::Scale& scale, float x1, float y1, float x2, float y2, int margin) {
    const QRectF between(QPointF(scale.X(x1), scale.Y(y1)), QPointF(scale.X(x2), scale.Y(y2)));
    return between.normalized().adjusted(-margin, -margin, margin, margin);
}

}  // namespace

void SurfaceCanvas::ShowOn(QWidget* widget, QPoint corner) {
    if (shown_ == widget && corner_ == corner) return;
    shown_ = widget;
    corner_ = corner;
    if (sizedByWidget_) TakeSize(SizeOfWidget());
    DamageAll();
}

void SurfaceCanvas::Draw(const frame::DrawOp& op, const frame::Pen& pen, const frame::Scale& scale, OLE_COLOR background,
                         OLE_COLOR) {
    if (frame::IsPenChange(op)) return;  // each operation brings its pen
    if (std::holds_alternative<draw::Cls>(op)) return Wipe(background, behind_);
    if (sizedByWidget_) TakeSize(SizeOfWidget());
    Stroke stroke{op, pen, scale, surface_.ForeColor(), {}};
    std::size_t bytes = 0;
    if (const auto* print = std::get_if<draw::Print>(&op)) {
        stroke.font = ToQt(*surface_.Font());
        bytes = print->text.size();
    } else if (const auto* paint = std::get_if<draw::PaintPicture>(&op)) {
        // The same picture many times is held once.
        if (paint->picture.get() != lastPicture_) bytes = BytesOf(*paint->picture);
        lastPicture_ = paint->picture.get();
    }
    Damage(BoundsOf(stroke));
    Keep(std::move(stroke), bytes);
}

void SurfaceCanvas::Wipe(OLE_COLOR, const frame::PictureRef& picture) {
    if (sizedByWidget_) TakeSize(SizeOfWidget());
    behind_ = picture;
    sizeAtFirst_ = size_;
    steps_.clear();
    kept_ = 0;
    lastPicture_ = nullptr;
    cut_ = false;
    for (Plane& plane : planes_) plane.begun = false;
    DamageAll();
}

void SurfaceCanvas::Resize(int width, int height, OLE_COLOR) { TakeSize(sizedByWidget_ ? SizeOfWidget() : Size{width, height}); }

/// Less a border of the corner's size on each side.
SurfaceCanvas::Size SurfaceCanvas::SizeOfWidget() const {
    if (!shown_) return size_;
    return {std::max(0, shown_->width() - 2 * corner_.x()), std::max(0, shown_->height() - 2 * corner_.y())};
}

void SurfaceCanvas::TakeSize(Size size) {
    if (size_ == size) return;
    size_ = size;
    if (steps_.empty() && !cut_) {
        sizeAtFirst_ = size_;
        for (Plane& plane : planes_) plane.begun = false;
    } else {
        Keep(size_, 0);
    }
    DamageAll();
}

void SurfaceCanvas::Keep(Step step, std::size_t bytes) {
    steps_.push_back(std::move(step));
    kept_ += sizeof(Step) + bytes;
    if (kept_ <= maximumKept) return;
    PlaneOf(ScreenScale());
    for (Plane& plane : planes_) {
        if (plane.begun) CatchUp(plane);
        plane.done = 0;
    }
    std::erase_if(planes_, [](const Plane& plane) { return !plane.begun; });
    steps_.clear();
    kept_ = 0;
    lastPicture_ = nullptr;
    cut_ = true;
}

std::optional<OLE_COLOR> SurfaceCanvas::Pixel(int x, int y) const {
    const std::optional<OLE_COLOR> pixel = PlaneOf(1).raster.Pixel(x, y);
    return pixel ? Turned(*pixel) : pixel;
}

std::vector<frame::PixelPlane> SurfaceCanvas::Planes() const {
    std::vector<frame::PixelPlane> planes = {PlaneAt(1, PlaneOf(1).raster)};
    if (const double scale = ScreenScale(); scale != 1) planes.push_back(PlaneAt(scale, PlaneOf(scale).raster));
    return planes;
}

QImage SurfaceCanvas::Image() const {
    damaged_ = {};
    if (steps_.empty() && !cut_) return {};
    const Plane& plane = PlaneOf(ScreenScale());
    if (plane.raster.Width() == 0 || plane.raster.Height() == 0) return {};
    QImage image = Shared(plane.raster);
    image.setDevicePixelRatio(plane.scale);
    return image;
}

double SurfaceCanvas::ScreenScale() const { return shown_ ? shown_->devicePixelRatioF() : qGuiApp->devicePixelRatio(); }

OLE_COLOR SurfaceCanvas::Rgb(OLE_COLOR color) const { return OleTranslateColor(color, surface_.Colors()); }

/// The whole drawing at a scale. Planes of a scale that neither the screen nor a reader has are dropped.
SurfaceCanvas::Plane& SurfaceCanvas::PlaneOf(double scale) const {
    if (const qint64 palette = QGuiApplication::palette().cacheKey(); palette_ != palette) {
        palette_ = palette;
        for (Plane& plane : planes_) plane.begun = plane.begun && cut_;
    }
    auto found = std::find_if(planes_.begin(), planes_.end(), [&](const Plane& plane) { return plane.scale == scale; });
    if (found == planes_.end()) {
        found = planes_.emplace(planes_.end());
        found->scale = scale;
    }
    if (!found->begun) {
        const auto sharpest = std::max_element(planes_.begin(), planes_.end(), [](const Plane& a, const Plane& b) {
            return a.begun != b.begun ? b.begun : a.scale < b.scale;
        });
        if (cut_ && sharpest->begun) {
            CatchUp(*sharpest);
            BeginFrom(*found, *sharpest);
        } else {
            Begin(*found);
        }
    }
    CatchUp(*found);
    const double screen = ScreenScale();
    std::erase_if(planes_, [&](const Plane& plane) { return plane.scale != scale && plane.scale != 1 && plane.scale != screen; });
    return *std::find_if(planes_.begin(), planes_.end(), [&](const Plane& plane) { return plane.scale == scale; });
}

void SurfaceCanvas::Begin(Plane& plane) const {
    const OLE_COLOR background = Turned(Rgb(surface_.BackColor()));
    plane.raster.Resize(Scaled(sizeAtFirst_.width, plane.scale), Scaled(sizeAtFirst_.height, plane.scale), background);
    plane.raster.Wipe(background, nullptr);
    if (behind_) Paint(plane, *behind_, {});
    plane.done = 0;
    plane.begun = true;
}

void SurfaceCanvas::BeginFrom(Plane& plane, const Plane& other) const {
    plane.raster =
        child::Raster(Scaled(size_.width, plane.scale), Scaled(size_.height, plane.scale), Turned(Rgb(surface_.BackColor())));
    plane.done = steps_.size();
    plane.begun = true;
    if (size_.width <= 0 || size_.height <= 0) return;
    QImage image = Shared(plane.raster);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    painter.scale(plane.scale / other.scale, plane.scale / other.scale);
    painter.drawImage(QPoint(), Shared(other.raster));
}

void SurfaceCanvas::CatchUp(Plane& plane) const {
    for (; plane.done < steps_.size(); ++plane.done) std::visit([&](const auto& step) { Do(plane, step); }, steps_[plane.done]);
}

void SurfaceCanvas::Do(Plane& plane, const Stroke& stroke) const {
    const Grid grid(stroke.pen, stroke.scale, plane.scale);
    const auto raster = [&](auto op) {
        op.color = Turned(Rgb(op.color));
        plane.raster.Draw(op, grid.pen, {}, {}, {});
    };
    if (const auto* line = std::get_if<draw::Line>(&stroke.op))
        std::visit(raster, grid.Fitted(*line));
    else if (const auto* circle = std::get_if<draw::Circle>(&stroke.op))
        raster(grid.Fitted(*circle));
    else if (const auto* dot = std::get_if<draw::PSet>(&stroke.op))
        raster(draw::PSet{grid.X(dot->x), grid.Y(dot->y), dot->color});
    else if (const auto* print = std::get_if<draw::Print>(&stroke.op))
        Print(plane, stroke, *print);
    else if (const auto* paint = std::get_if<draw::PaintPicture>(&stroke.op))
        Paint(plane, *paint->picture, QPointF(frame::PixelAt(grid.scale.X(paint->x)), frame::PixelAt(grid.scale.Y(paint->y))));
}

void SurfaceCanvas::Do(Plane& plane, const Size& size) const {
    const int width = Scaled(size.width, plane.scale), height = Scaled(size.height, plane.scale);
    const child::Raster before = std::exchange(plane.raster, child::Raster(width, height, Turned(Rgb(surface_.BackColor()))));
    if (behind_) Paint(plane, *behind_, {});
    plane.raster.Blit(0, 0, before, {0, 0, before.Width(), before.Height()});
}

void SurfaceCanvas::Paint(Plane& plane, const frame::Picture& picture, QPointF place) const {
    const frame::PixelPlane* pixels = picture.Plane(plane.scale);
    if (!pixels || pixels->width <= 0 || pixels->height <= 0 || plane.raster.Pixels().empty()) return;
    const QImage source(reinterpret_cast<const uchar*>(pixels->pixels.data()), pixels->width, pixels->height,
                        QImage::Format_RGBA8888);
    QImage image = Shared(plane.raster);
    QPainter painter(&image);
    if (pixels->scale == plane.scale) {
        painter.drawImage(place, source);
        return;
    }
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    const double grown = plane.scale / pixels->scale;
    painter.drawImage(QRectF(place, QSizeF(source.size()) * grown), source, QRectF(source.rect()));
}

void SurfaceCanvas::Print(Plane& plane, const Stroke& stroke, const draw::Print& print) const {
    if (plane.raster.Pixels().empty()) return;
    QImage image = Shared(plane.raster);
    QPainter painter(&image);
    painter.scale(plane.scale, plane.scale);
    painter.translate(stroke.scale.X(print.x), stroke.scale.Y(print.y));
    painter.setFont(stroke.font);
    painter.setPen(ToQt(stroke.foreground, surface_.Colors()));
    PaintText(painter, QRectF(0, 0, endless, endless), ToQt(print.text), Qt::AlignLeft, false);
}

/// What a stroke may touch, in pixels at scale 1.
QRectF SurfaceCanvas::BoundsOf(const Stroke& stroke) const {
    const int margin = stroke.pen.width / 2 + 2;
    if (const auto* line = std::get_if<draw::Line>(&stroke.op))
        return Around(stroke.scale, line->x1, line->y1, line->x2, line->y2, margin);
    if (const auto* dot = std::get_if<draw::PSet>(&stroke.op)) return Around(stroke.scale, dot->x, dot->y, dot->x, dot->y, margin);
    if (const auto* circle = std::get_if<draw::Circle>(&stroke.op)) {
        const double radius = std::abs(circle->radius * stroke.scale.factorX) + margin;
        return {stroke.scale.X(circle->x) - radius, stroke.scale.Y(circle->y) - radius, 2 * radius, 2 * radius};
    }
    if (const auto* paint = std::get_if<draw::PaintPicture>(&stroke.op))
        return {stroke.scale.X(paint->x) - 1, stroke.scale.Y(paint->y) - 1, PixelsExactly(paint->picture->Width()) + 2,
                PixelsExactly(paint->picture->Height()) + 2};
    if (const auto* print = std::get_if<draw::Print>(&stroke.op)) {
        // Not measured: no line is higher than twice its letters, and signs reach a little to the left.
        const double letters = stroke.font.pointSizeF() * 2;
        const auto lines = static_cast<double>(1 + std::count(print->text.begin(), print->text.end(), '\n'));
        return {stroke.scale.X(print->x) - letters, stroke.scale.Y(print->y) - letters,
                static_cast<double>(size_.width) * 2 + letters, lines * 2 * letters + 2 * letters};
    }
    return {0, 0, static_cast<double>(size_.width), static_cast<double>(size_.height)};
}

void SurfaceCanvas::Damage(const QRectF& bounds) {
    if (!shown_) return;
    const QRectF whole(0, 0, size_.width, size_.height);
    // A coordinate that is no number may be anywhere.
    const bool known = std::isfinite(bounds.x() + bounds.y() + bounds.width() + bounds.height());
    const QRect place = (known ? bounds & whole : whole).toAlignedRect().translated(corner_);
    if (place.isEmpty() || damaged_.contains(place)) return;
    damaged_ |= place;
    shown_->update(damaged_);
}

void SurfaceCanvas::DamageAll() {
    damaged_ = QRect(corner_, QSize(size_.width, size_.height));
    if (shown_) shown_->update();
}

}  // namespace tessel::qt
