#include "frame/child/Raster.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace tessel::child {

using frame::OLE_COLOR;
using frame::Pen;
using frame::PixelAt;
using frame::Scale;
namespace draw = frame::draw;

namespace {

constexpr std::uint32_t white = 0xFFFFFF;
constexpr std::uint32_t opaque = 0xFF000000u;
constexpr int nop = 11;
constexpr int whiteness = 16;
constexpr int maximumPenWidth = 32'767;
/// In pixels. Larger circles are drawn with this radius, so that no coordinate overflows.
constexpr double maximumRadius = 16'777'216;

/// A colour as a pixel.
std::uint32_t PixelOf(OLE_COLOR color) { return frame::OleTranslateColor(color, frame::ClassicColors()).value | opaque; }

int WidthOf(const Pen& pen) { return std::clamp(pen.width, 1, maximumPenWidth); }

raster::Dashes DashesOf(const Pen& pen) { return raster::Dashes(WidthOf(pen) == 1 ? pen.style : draw::solid); }

raster::Point PointAt(const Scale& scale, float x, float y) { return {PixelAt(scale.X(x)), PixelAt(scale.Y(y))}; }

/// The pixel before the last one of a straight line.
raster::Point StepBack(raster::Point last, raster::Point first) {
    const auto back = [](int at, int to) { return at == to ? at : at + (to > at ? 1 : -1); };
    return {back(last.x, first.x), back(last.y, first.y)};
}

std::optional<raster::Ellipse> EllipseOf(const draw::Circle& circle, const Scale& scale) {
    const double longer = static_cast<double>(circle.radius) * std::abs(scale.factorX);
    if (!(longer >= 0)) return {};
    const double radius = std::min(longer, maximumRadius);
    const double aspect = circle.aspect && *circle.aspect >= 0 ? *circle.aspect : 1;
    return raster::Ellipse{PointAt(scale, circle.x, circle.y), static_cast<int>(std::round(aspect > 1 ? radius / aspect : radius)),
                           static_cast<int>(std::round(aspect > 1 ? radius : radius * aspect))};
}

/// The part of `begin` to `end` that stays within 0 to `limit` when it is moved by `offset`, and is within 0 to `sourceLimit`.
struct Range {
    std::int64_t begin, end;
};
Range Visible(int begin, int end, int sourceLimit, std::int64_t offset, int limit) {
    return {std::max<std::int64_t>({begin, 0, -offset}), std::min<std::int64_t>({end, sourceLimit, limit - offset})};
}

}  // namespace

Raster::Raster(int width, int height, OLE_COLOR background) { Resize(width, height, background); }

void Raster::Resize(int width, int height, OLE_COLOR background) {
    width = std::clamp(width, 0, maximumSide);
    height = std::clamp(height, 0, width > 0 ? std::min(maximumSide, maximumPixels / width) : maximumSide);
    if (width == columns && height == rows) return;

    const std::vector<std::uint32_t> before = std::exchange(
        pixels,
        std::vector<std::uint32_t>(static_cast<std::size_t>(width) * static_cast<std::size_t>(height), PixelOf(background)));
    const int columnsBefore = std::exchange(columns, width), rowsBefore = std::exchange(rows, height);
    DrawPicture(behind.get(), {});
    for (int y = 0; y < std::min(rows, rowsBefore); ++y) {
        const auto from = before.begin() + static_cast<std::ptrdiff_t>(y) * columnsBefore;
        std::copy_n(from, std::min(columns, columnsBefore), pixels.begin() + static_cast<std::ptrdiff_t>(IndexOf(0, y)));
    }
}

std::optional<OLE_COLOR> Raster::Pixel(int x, int y) const {
    if (!Contains(x, y)) return {};
    return OLE_COLOR(pixels[IndexOf(x, y)] & white);
}

void Raster::SetPixel(int x, int y, OLE_COLOR color) {
    if (Contains(x, y)) pixels[IndexOf(x, y)] = PixelOf(color);
}

std::vector<frame::PixelPlane> Raster::Planes() const { return {frame::PixelPlane{1, columns, rows, pixels}}; }

void Raster::Draw(const frame::DrawOp& op, const Pen& pen, const Scale& scale, OLE_COLOR background, OLE_COLOR) {
    if (std::holds_alternative<draw::Cls>(op)) Clear(background);
    if (const auto* line = std::get_if<draw::Line>(&op)) DrawLine(*line, pen, scale);
    if (const auto* circle = std::get_if<draw::Circle>(&op)) DrawCircle(*circle, pen, scale);
    if (const auto* dot = std::get_if<draw::PSet>(&op)) DrawDot(*dot, pen, scale);
    if (const auto* picture = std::get_if<draw::PaintPicture>(&op))
        DrawPicture(picture->picture.get(), PointAt(scale, picture->x, picture->y));
}

void Raster::Wipe(OLE_COLOR background, const frame::PictureRef& picture) {
    behind = picture;
    Clear(background);
}

void Raster::Blit(int x, int y, const Raster& source, const raster::Area& part, std::optional<OLE_COLOR> mask) {
    if (&source == this) return Blit(x, y, Raster(source), part, mask);
    const std::int64_t right = static_cast<std::int64_t>(x) - part.left;
    const std::int64_t down = static_cast<std::int64_t>(y) - part.top;
    const Range across = Visible(part.left, part.right, source.columns, right, columns);
    const Range along = Visible(part.top, part.bottom, source.rows, down, rows);
    for (std::int64_t row = along.begin; row < along.end; ++row) {
        for (std::int64_t column = across.begin; column < across.end; ++column) {
            const std::uint32_t pixel = source.pixels[source.IndexOf(static_cast<int>(column), static_cast<int>(row))];
            if (mask && pixel == PixelOf(*mask)) continue;
            pixels[IndexOf(static_cast<int>(column + right), static_cast<int>(row + down))] = pixel;
        }
    }
}

Raster::Ink Raster::InkOf(int mode, OLE_COLOR color) {
    switch (mode) {
        case draw::blackness:
            return {0, opaque};
        case draw::invert:
            return {opaque | white, white};
        case draw::xorPen:
            return {opaque | white, PixelOf(color) & white};
        case nop:
            return {opaque | white, 0};
        case whiteness:
            return {0, opaque | white};
        default:
            return {0, PixelOf(color)};
    }
}

void Raster::DrawLine(const draw::Line& line, const Pen& pen, const Scale& scale) {
    const raster::Point from = PointAt(scale, line.x1, line.y1);
    const raster::Point to = PointAt(scale, line.x2, line.y2);
    const bool outlined = pen.style != draw::transparent;
    const int width = outlined ? WidthOf(pen) : 1;
    const bool straight = line.box == draw::Box::None && (from.x == to.x || from.y == to.y);
    if (outlined && (straight || line.box == draw::Box::Filled) && DashesOf(pen).IsSolid()) {
        if (straight && from == to) return;
        const raster::Point last = straight && width == 1 ? StepBack(to, from) : to;
        return Stroke(raster::BrushedBoxRuns(from, last, width, Whole()), 1, InkOf(pen.mode, line.color));
    }
    const raster::Area reach = Reach(width);

    raster::Runs runs;
    if (line.box == draw::Box::None) {
        const auto lastPoint = width > 1 ? raster::LastPoint::Included : raster::LastPoint::Excluded;
        if (outlined && from != to) runs = raster::LineRuns(from, to, lastPoint, DashesOf(pen), reach);
    } else if (outlined) {
        runs = raster::BoxOutlineRuns(from, to, DashesOf(pen), reach);
    }
    if (line.box == draw::Box::Filled) {
        const raster::Runs inside = raster::BoxInsideRuns(from, to, reach);
        runs.insert(runs.end(), inside.begin(), inside.end());
    }
    Stroke(std::move(runs), width, InkOf(pen.mode, line.color));
}

void Raster::DrawCircle(const draw::Circle& circle, const Pen& pen, const Scale& scale) {
    const std::optional<raster::Ellipse> ellipse = EllipseOf(circle, scale);
    if (!ellipse || pen.style == draw::transparent) return;
    const int width = WidthOf(pen);
    const raster::Arc arc = raster::ArcBetween(circle.start, circle.end);
    Stroke(raster::EllipseRuns(*ellipse, arc, DashesOf(pen), Reach(width)), width, InkOf(pen.mode, circle.color));
}

void Raster::DrawDot(const draw::PSet& dot, const Pen& pen, const Scale& scale) {
    const raster::Point pixel = PointAt(scale, dot.x, dot.y);
    const raster::Area reach = Reach(WidthOf(pen));
    if (pixel.x < reach.left || pixel.x >= reach.right || pixel.y < reach.top || pixel.y >= reach.bottom) return;
    Stroke({{pixel.y, pixel.x, pixel.x}}, WidthOf(pen), InkOf(pen.mode, dot.color));
}

void Raster::Clear(OLE_COLOR background) {
    std::fill(pixels.begin(), pixels.end(), PixelOf(background));
    DrawPicture(behind.get(), {});
}

void Raster::DrawPicture(const frame::Picture* picture, raster::Point at) {
    const frame::PixelPlane* plane = picture ? picture->Plane(1) : nullptr;
    if (!plane) return;
    constexpr std::uint32_t halfOpaque = 0x80000000u;
    const Range across = Visible(0, plane->width, plane->width, at.x, columns);
    const Range along = Visible(0, plane->height, plane->height, at.y, rows);
    for (std::int64_t row = along.begin; row < along.end; ++row) {
        for (std::int64_t column = across.begin; column < across.end; ++column) {
            const std::uint32_t pixel = plane->pixels[static_cast<std::size_t>(row * plane->width + column)];
            if (pixel & halfOpaque) pixels[IndexOf(static_cast<int>(column + at.x), static_cast<int>(row + at.y))] = pixel | opaque;
        }
    }
}

void Raster::Stroke(raster::Runs runs, int penWidth, Ink ink) {
    if (penWidth > 1) runs = raster::Widened(std::move(runs), penWidth, Whole());
    for (const raster::Run& run : runs) {
        const std::size_t first = IndexOf(run.first, run.row);
        const std::size_t last = IndexOf(run.last, run.row);
        if (ink.keep == 0) {
            std::fill(pixels.begin() + static_cast<std::ptrdiff_t>(first), pixels.begin() + static_cast<std::ptrdiff_t>(last) + 1,
                      ink.flip);
            continue;
        }
        for (std::size_t at = first; at <= last; ++at) pixels[at] = (pixels[at] & ink.keep) ^ ink.flip;
    }
}

std::size_t Raster::IndexOf(int x, int y) const {
    return static_cast<std::size_t>(y) * static_cast<std::size_t>(columns) + static_cast<std::size_t>(x);
}

}  // namespace tessel::child
