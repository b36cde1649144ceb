#pragma once

#include <cmath>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "frame/Color.h"
#include "frame/Picture.h"

/// Drawing as data: a surface hands each operation on as one of these plain structs, in the surface's own units,
/// to whatever records it, rasters it or paints it.
namespace tessel::frame {

namespace draw {

/// Pen modes of `DrawMode` that the library uses. Any other value draws as `copyPen`.
inline constexpr int blackness = 1;
inline constexpr int invert = 6;
inline constexpr int xorPen = 7;
inline constexpr int copyPen = 13;

/// Values of `DrawStyle`: solid, and the broken lines; `transparent` draws nothing.
inline constexpr int solid = 0, dash = 1, dot = 2, dashDot = 3, dashDotDot = 4, transparent = 5, insideSolid = 6;

enum class Box : std::uint8_t { None, Outline, Filled };

struct Cls {
    friend bool operator==(const Cls&, const Cls&) = default;
};
/// A line from (x1, y1) to (x2, y2), or the box between the two corners.
struct Line {
    float x1 = 0, y1 = 0, x2 = 0, y2 = 0;
    OLE_COLOR color;
    Box box = Box::None;
    friend bool operator==(const Line&, const Line&) = default;
};
/// A circle, an ellipse (`aspect` other than 1: height to width) or an arc (`start` to `end` in radians, counter-clockwise,
/// 0 to the right). The radius is the longer half axis.
struct Circle {
    float x = 0, y = 0, radius = 0;
    OLE_COLOR color;
    std::optional<float> start, end, aspect;
    friend bool operator==(const Circle&, const Circle&) = default;
};
struct PSet {
    float x = 0, y = 0;
    OLE_COLOR color;
    friend bool operator==(const PSet&, const PSet&) = default;
};
/// Text whose top left corner is at (x, y), in the surface's `ForeColor` and font.
struct Print {
    std::string text;
    float x = 0, y = 0;
    friend bool operator==(const Print&, const Print&) = default;
};
struct PaintPicture {
    float x = 0, y = 0;
    std::shared_ptr<Picture> picture;
    friend bool operator==(const PaintPicture&, const PaintPicture&) = default;
};
struct DrawWidth {
    int value = 1;
    friend bool operator==(const DrawWidth&, const DrawWidth&) = default;
};
struct DrawStyle {
    int value = 0;
    friend bool operator==(const DrawStyle&, const DrawStyle&) = default;
};
struct DrawMode {
    int value = copyPen;
    friend bool operator==(const DrawMode&, const DrawMode&) = default;
};

}  // namespace draw

using DrawOp = std::variant<draw::Cls, draw::Line, draw::Circle, draw::PSet, draw::Print, draw::PaintPicture, draw::DrawWidth,
                            draw::DrawStyle, draw::DrawMode>;

/// Whether an operation draws nothing: it tells of another pen.
inline bool IsPenChange(const DrawOp& op) {
    return std::holds_alternative<draw::DrawWidth>(op) || std::holds_alternative<draw::DrawStyle>(op) ||
           std::holds_alternative<draw::DrawMode>(op);
}

/// The pen with which an operation is drawn. The width is in pixels, whatever the surface's scale.
struct Pen {
    int width = 1;
    int style = draw::solid;
    int mode = draw::copyPen;
    friend bool operator==(const Pen&, const Pen&) = default;
};

/// How the units of a surface become pixels: pixel = (unit - origin) * factor.
struct Scale {
    float originX = 0, originY = 0;
    float factorX = 1, factorY = 1;

    float X(float unit) const { return (unit - originX) * factorX; }
    float Y(float unit) const { return (unit - originY) * factorY; }
    friend bool operator==(const Scale&, const Scale&) = default;
};

/// The pixel that a coordinate in pixels falls on: its whole part towards minus infinity, held within +-2^24 so that no
/// value read from a file, NaN and infinities included, can overflow what is computed from it.
inline int PixelAt(float pixels) {
    constexpr float limit = 16'777'216.0f;
    if (!(pixels > -limit)) return pixels <= -limit ? -static_cast<int>(limit) : 0;
    return pixels < limit ? static_cast<int>(std::floor(pixels)) : static_cast<int>(limit);
}

/// Where the operations of a surface go: a raster, a recorder, a screen.
class Canvas {
  public:
    virtual ~Canvas() = default;
    /// One operation in the surface's own units. `background` and `foreground` are the surface's colours, as RGB.
    virtual void Draw(const DrawOp& op, const Pen& pen, const Scale& scale, OLE_COLOR background, OLE_COLOR foreground) = 0;
    /// What was drawn has gone: the surface has another background (RGB), or another picture or none behind the drawing, which is
    /// what shows from now on, and where `Cls` clears.
    virtual void Wipe(OLE_COLOR /*background*/, const PictureRef& /*picture*/) {}
    /// The inside of the surface has this size, in pixels at scale 1. What is drawn stays, and beside it the background comes.
    virtual void Resize(int /*width*/, int /*height*/, OLE_COLOR /*background*/) {}

    /// Whether the canvas keeps the pixels of what was drawn, and answers what follows.
    virtual bool KeepsPixels() const { return false; }
    /// RGB of a pixel at scale 1; nothing outside.
    virtual std::optional<OLE_COLOR> Pixel(int /*x*/, int /*y*/) const { return {}; }
    /// What shows: a plane of scale 1, and one of the screen's scale where that is another.
    virtual std::vector<PixelPlane> Planes() const { return {}; }
};

/// Keeps the operations in their order, for tests and logs.
class RecordingCanvas final : public Canvas {
  public:
    void Draw(const DrawOp& op, const Pen&, const Scale&, OLE_COLOR, OLE_COLOR) override { operations.push_back(op); }

    std::vector<DrawOp> operations;
};

}  // namespace tessel::frame
