#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "frame/Color.h"
#include "frame/Drawing.h"
#include "frame/child/RasterRuns.h"

namespace tessel::child {

/// A plane of RGB pixels that keeps what is drawn on it: the surface of a picture box that no screen shows.
///
/// How it draws. An operation touches each pixel at most once, so that XOR and invert drawn twice leave the plane as it was.
/// - `Line`, pen width 1: from the first pixel up to but without the last. Wider: a round brush moved from the first pixel to the
///   last. A line that begins and ends on the same pixel draws nothing.
/// - Boxes include both corners. A filled box is its outline and its inside; a wide pen makes it larger by half its width.
/// - `Circle`: the radius is in the scale's horizontal units, rounded to whole pixels; a negative radius, or none that is a
///   number, draws nothing. An aspect that is negative or no number counts as 1. An arc shows at least one pixel.
/// - `PSet`: one pixel, with a wide pen a round dot, whatever the style.
/// - `Cls` fills with the background, and with the picture behind the drawing; `PaintPicture` copies; whatever the mode. Of a
///   picture the plane of scale 1 is taken; its pixels are drawn where they are at least half opaque.
/// - `Print` draws nothing: the raster has no font.
/// - The pen's width is held within 1 and 32,767 pixels. Broken styles count for width 1, wider pens draw them solid. The
///   transparent style leaves out the outline: of a filled box remains what an outline of width 1 encloses.
/// - Colours may be system colours; they are looked up in `ClassicColors`.
class Raster final : public frame::Canvas {
  public:
    static constexpr int maximumSide = 16'384;
    static constexpr int maximumPixels = 64 * 1024 * 1024;

    /// A plane filled with `background`. Sizes below 0 count as 0, and above `maximumSide` as that; a height that would give more
    /// than `maximumPixels` is made smaller.
    Raster(int width, int height, frame::OLE_COLOR background);

    /// The size is held as in the constructor. Pixels that are in both sizes stay; new ones are `background`, and the picture
    /// behind the drawing.
    void Resize(int width, int height, frame::OLE_COLOR background) override;
    int Width() const { return columns; }
    int Height() const { return rows; }

    /// RGB; nothing outside the plane.
    std::optional<frame::OLE_COLOR> Pixel(int x, int y) const override;
    /// All pixels as 0xFFBBGGRR, row by row. Who writes them leaves the high byte as it is.
    std::span<const std::uint32_t> Pixels() const { return pixels; }
    std::span<std::uint32_t> Pixels() { return pixels; }
    bool KeepsPixels() const override { return true; }
    std::vector<frame::PixelPlane> Planes() const override;
    /// Outside the plane nothing happens.
    void SetPixel(int x, int y, frame::OLE_COLOR color);

    void Draw(const frame::DrawOp& op, const frame::Pen& pen, const frame::Scale& scale, frame::OLE_COLOR background,
              frame::OLE_COLOR foreground) override;
    void Wipe(frame::OLE_COLOR background, const frame::PictureRef& picture) override;

    /// Copies the pixels in `part` of `source`, which may be this plane itself, so that the part's top left comes to (x, y).
    /// Pixels of the colour `mask` are left out, and so is what lies outside either plane.
    void Blit(int x, int y, const Raster& source, const raster::Area& part, std::optional<frame::OLE_COLOR> mask = {});

  private:
    /// What a pen mode and a colour do to a pixel: some bits stay, then some are flipped.
    struct Ink {
        std::uint32_t keep, flip;
    };
    static Ink InkOf(int mode, frame::OLE_COLOR color);

    void DrawLine(const frame::draw::Line& line, const frame::Pen& pen, const frame::Scale& scale);
    void DrawCircle(const frame::draw::Circle& circle, const frame::Pen& pen, const frame::Scale& scale);
    void DrawDot(const frame::draw::PSet& dot, const frame::Pen& pen, const frame::Scale& scale);
    void DrawPicture(const frame::Picture* picture, raster::Point at);
    void Clear(frame::OLE_COLOR background);

    raster::Area Whole() const { return {0, 0, columns, rows}; }
    /// The area whose runs can matter to the plane when they are drawn with a pen of this width.
    raster::Area Reach(int penWidth) const { return penWidth > 1 ? raster::Grown(Whole(), penWidth) : Whole(); }
    void Stroke(raster::Runs runs, int penWidth, Ink ink);
    std::size_t IndexOf(int x, int y) const;
    bool Contains(int x, int y) const { return x >= 0 && y >= 0 && x < columns && y < rows; }

    int columns = 0, rows = 0;
    std::vector<std::uint32_t> pixels;
    frame::PictureRef behind;
};

}  // namespace tessel::child
