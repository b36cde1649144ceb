#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "frame/ClassTable.h"
#include "frame/Control.h"
#include "frame/child/PictureBox.h"
#include "tests/HostUnderTest.h"

/// What the tests of drawing share: a control with a picture box.
namespace tessel::test::drawing {

namespace draw = frame::draw;
using frame::OLE_COLOR;
using frame::ScaleModeConstants;
using Operations = std::vector<frame::DrawOp>;

inline constexpr OLE_COLOR red = 0x0000FF, green = 0x00FF00, blue = 0xFF0000, white = 0xFFFFFF, black = 0x000000;

class Easel final : public frame::Control {
  public:
    using Control::Control;
    frame::TextSize DesignSize() const override { return {3000, 3000}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable easel{.name = "Easel", .members = {}};
        return easel;
    }

    child::PictureBox Picture1{*this, "Picture1"};
};

inline OLE_COLOR PixelOf(const frame::DrawingSurface& surface, float x, float y) {
    return OLE_COLOR(static_cast<std::uint32_t>(surface.Point(x, y)));
}
/// The pixels row by row: '.' white, 'r', 'g', 'b', 'k' the colours, '-' none, '?' another. The surface must be in pixels.
inline std::string RowsOf(const frame::DrawingSurface& surface, int width, int height) {
    constexpr std::uint32_t none = 0xFFFFFFFF;
    const auto letter = [](OLE_COLOR color) {
        if (color == white) return '.';
        if (color == red) return 'r';
        if (color == green) return 'g';
        if (color == blue) return 'b';
        if (color == OLE_COLOR(none)) return '-';
        return color == black ? 'k' : '?';
    };
    std::string text;
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) text += letter(PixelOf(surface, static_cast<float>(x), static_cast<float>(y)));
        text += '\n';
    }
    return text;
}
/// The pixels that are not white, as "x,y x,y".
inline std::string TouchedIn(const frame::DrawingSurface& surface, int width, int height) {
    std::string text;
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x)
            if (PixelOf(surface, static_cast<float>(x), static_cast<float>(y)) != white)
                text += (text.empty() ? "" : " ") + std::to_string(x) + "," + std::to_string(y);
    return text;
}

/// A white box of 12 by 8 pixels without a border, in pixels.
class DrawingTest : public testing::Test {
  protected:
    DrawingTest() {
        box.SetBorderStyle(0);
        box.Move(0, 0, 180, 120);
        box.SetScaleMode(ScaleModeConstants::Pixels);
        box.SetBackColor(white);
        box.AddCanvas(canvas_);
    }
    ~DrawingTest() override { box.RemoveCanvas(canvas_); }

    /// The operations since the last time.
    Operations Recorded() { return std::exchange(canvas_.operations, {}); }

    OLE_COLOR At(float x, float y) const { return PixelOf(box, x, y); }
    std::string Rows() const { return RowsOf(box, static_cast<int>(box.ScaleWidth()), static_cast<int>(box.ScaleHeight())); }
    std::string Touched() const { return TouchedIn(box, static_cast<int>(box.ScaleWidth()), static_cast<int>(box.ScaleHeight())); }
    bool IsBlank() const { return Touched().empty(); }
    std::pair<float, float> Position() const { return {box.CurrentX(), box.CurrentY()}; }

    HostUnderTest host;
    Easel& easel = host.Create<Easel>("Easel1");
    child::PictureBox& box = easel.Picture1;

  private:
    frame::RecordingCanvas canvas_;
};

/// A picture of one colour at scale 1.
inline frame::PictureRef Block(int width, int height, OLE_COLOR color) {
    constexpr std::uint32_t opaque = 0xFF000000u;
    const auto count = static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
    return std::make_shared<frame::Picture>(
        std::vector<frame::PixelPlane>{{1, width, height, std::vector<std::uint32_t>(count, opaque | color.value)}}, "");
}

}  // namespace tessel::test::drawing
