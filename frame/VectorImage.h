#pragma once

#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

#include "frame/Picture.h"

/// Pictures that are drawn from shapes, sharp at every scale.
namespace tessel::frame {

/// One shape of a drawing, in the drawing's own units; later shapes cover earlier ones.
///
/// The outline is a text of commands, each a letter with its numbers, parted by blanks: `M x y` begins a line there, `L x y` and
/// `C x1 y1 x2 y2 x y` go on straight and as a cubic curve, `Z` closes the line; `E x y rx ry` is a whole ellipse about a centre,
/// `R x y width height r` a box with rounded corners. Lines that overlap are one area, unless they turn against each other.
struct VectorShape {
    std::string_view outline;
    std::uint32_t color = 0;  ///< 0xAABBGGRR; its alpha lets through what lies below
    float stroke = 0;         ///< draws the line itself this wide, with round ends and corners; 0 fills what is within
};

/// The 0xAABBGGRR of a colour written as 0xRRGGBB, with an opacity from 0 to 1.
constexpr std::uint32_t Paint(std::uint32_t redGreenBlue, double opacity = 1) {
    const auto alpha = static_cast<std::uint32_t>(opacity * 255 + 0.5);
    return alpha << 24 | (redGreenBlue & 0xFF) << 16 | (redGreenBlue & 0xFF00) | (redGreenBlue >> 16 & 0xFF);
}

/// The pixels of a square drawing of `side` units at a scale: a unit is `scale` pixels. What lies outside is cut off. Nothing for a
/// side that does not give 1 to 4096 pixels. An outline that cannot be read ends where it cannot.
PixelPlane Rasterise(std::span<const VectorShape> shapes, int side, double scale);

/// A square picture of `side` pixels at scale 1, which is drawn at each scale when it is first wanted there. The outlines of the
/// shapes must stay.
PictureRef DrawnPicture(std::vector<VectorShape> shapes, int side);

}  // namespace tessel::frame
