#include "frame/VectorImage.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <numbers>
#include <string>

namespace tessel::frame {
namespace {

constexpr std::uint32_t red = Paint(0xFF0000), blue = Paint(0x0000FF);

std::uint32_t At(const PixelPlane& plane, int x, int y) { return plane.pixels.at(static_cast<std::size_t>(y * plane.width + x)); }
std::uint32_t Alpha(std::uint32_t pixel) { return pixel >> 24; }

/// The area of all shapes together, in pixels.
double Area(const PixelPlane& plane) {
    double sum = 0;
    for (const std::uint32_t pixel : plane.pixels) sum += Alpha(pixel) / 255.0;
    return sum;
}
PixelPlane Drawn(std::vector<VectorShape> shapes, int side = 16, double scale = 1) { return Rasterise(shapes, side, scale); }

TEST(VectorImage, ColoursAreWrittenRedFirstAndKeptRedLow) {
    EXPECT_EQ(Paint(0x123456), 0xFF563412u);
    EXPECT_EQ(Paint(0x123456, 0.5), 0x80563412u);
    EXPECT_EQ(Paint(0x123456, 0), 0x00563412u);
}

TEST(VectorImage, ABoxOnWholePixelsHasSharpEdges) {
    const PixelPlane plane = Drawn({{"M 2 3 L 6 3 L 6 8 L 2 8 Z", red}});
    for (int y = 0; y < 16; ++y) {
        for (int x = 0; x < 16; ++x) {
            const bool inside = x >= 2 && x < 6 && y >= 3 && y < 8;
            EXPECT_EQ(At(plane, x, y), inside ? red : 0u) << x << ' ' << y;
        }
    }
}

TEST(VectorImage, AHalfCoveredPixelIsHalfOpaqueInTheFullColour) {
    const PixelPlane plane = Drawn({{"M 2 2 L 4.5 2 L 4.5 4 L 2 4 Z", red}, {"M 8 2 L 10 2 L 10 3.5 L 8 3.5 Z", blue}});
    EXPECT_EQ(At(plane, 4, 2), (red & 0xFFFFFF) | 0x80000000u);
    EXPECT_EQ(At(plane, 8, 3), (blue & 0xFFFFFF) | 0x80000000u);
}

TEST(VectorImage, EllipsesRoundedBoxesAndStrokesHaveTheirArea) {
    constexpr double pi = std::numbers::pi;
    EXPECT_NEAR(Area(Drawn({{"E 8 8 6 4", red}}, 16, 4)), pi * 6 * 4 * 16, pi * 6 * 4 * 16 * 0.01);
    EXPECT_NEAR(Area(Drawn({{"R 2 3 10 8 2", red}}, 16, 4)), (80 - (4 - pi) * 4) * 16, 10);
    EXPECT_NEAR(Area(Drawn({{"M 4 8 L 12 8", red, 2}}, 16, 4)), (16 + pi) * 16, 4) << "with round ends";
}

TEST(VectorImage, ACurveGoesThroughWhereItMust) {
    // A quarter of a circle about (2, 2), as four points give it.
    const PixelPlane plane = Drawn({{"M 14 2 C 14 8.627 8.627 14 2 14 L 2 2 Z", red}}, 16, 4);
    EXPECT_NEAR(Area(plane), std::numbers::pi * 36 * 16, 10);
}

TEST(VectorImage, OverlappingPartsOfAShapeAreOneAreaAndATurnedOneIsAHole) {
    const PixelPlane united = Drawn({{"M 2 2 L 8 2 L 8 8 L 2 8 Z M 4 4 L 10 4 L 10 10 L 4 10 Z", Paint(0xFF0000, 0.5)}});
    EXPECT_EQ(At(united, 5, 5), At(united, 2, 2)) << "not twice as opaque";
    EXPECT_EQ(At(united, 9, 9), At(united, 2, 2));
    const PixelPlane hole = Drawn({{"M 2 2 L 10 2 L 10 10 L 2 10 Z M 4 4 L 4 8 L 8 8 L 8 4 Z", red}});
    EXPECT_EQ(At(hole, 5, 5), 0u);
    EXPECT_EQ(At(hole, 3, 3), red);
}

TEST(VectorImage, LaterShapesCoverEarlierOnesAsFarAsTheyAreOpaque) {
    const PixelPlane covered = Drawn({{"R 0 0 16 16 0", red}, {"R 0 0 8 16 0", blue}, {"R 8 0 8 16 0", Paint(0xFFFFFF, 0.5)}});
    EXPECT_EQ(At(covered, 2, 2), blue);
    EXPECT_EQ(At(covered, 12, 2), Paint(0xFF8080));
}

TEST(VectorImage, AScaleMakesTheSameDrawingLarger) {
    const std::vector<VectorShape> shapes = {{"E 8 8 6 6", red}, {"M 3 3 L 13 12", blue, 1.5}};
    const PixelPlane once = Drawn(shapes), twice = Drawn(shapes, 16, 2);
    EXPECT_EQ(twice.width, 32);
    EXPECT_EQ(twice.height, 32);
    EXPECT_NEAR(Area(twice), 4 * Area(once), 8);
}

TEST(VectorImage, WhatLiesOutsideIsCutOff) {
    const PixelPlane plane = Drawn({{"R -100 -100 300 300 5", red}, {"M -1e30 4 L 1e30 4", blue, 1}});
    EXPECT_NEAR(Area(plane), 256, 0.01);
    EXPECT_EQ(At(plane, 0, 10), red);
}

TEST(VectorImage, AnOutlineThatCannotBeReadEndsWhereItCannot) {
    const std::string box = "M 2 2 L 6 2 L 6 6 L 2 6 Z";
    for (const char* rest : {" X 1", " L", " L 1", " C 1 2 3", " E nan 1 1 1", " R inf 0 0 0 0", " L x y", " L 1,2", " 7"})
        EXPECT_EQ(Area(Drawn({{box + rest, red}})), 16) << rest;
    EXPECT_EQ(Area(Drawn({{"", red}, {"Z", red}, {"L 5 5", red}, {"E 1 1 0 0", red}, {"M 1 1 L 1 1", red}})), 0);
}

TEST(VectorImage, OnlySensibleSizesHavePixels) {
    EXPECT_TRUE(Drawn({}, 0).pixels.empty());
    EXPECT_TRUE(Drawn({}, -1).pixels.empty());
    EXPECT_TRUE(Drawn({}, 16, 1e9).pixels.empty());
    EXPECT_TRUE(Drawn({}, 16, -1).pixels.empty());
    EXPECT_EQ(Drawn({}, 16, 0.01).pixels.size(), 1u);
}

TEST(VectorImage, ADrawnPictureIsDrawnOnceAtEachScaleThatIsAskedFor) {
    const PictureRef picture = DrawnPicture({{"E 8 8 6 6", red}}, 16);
    EXPECT_EQ(picture->Width(), 240);
    EXPECT_EQ(picture->Height(), 240);
    const PixelPlane* plane = picture->Plane(2);
    ASSERT_NE(plane, nullptr);
    EXPECT_EQ(plane->width, 32);
    EXPECT_EQ(picture->Plane(1)->width, 16);
    EXPECT_EQ(picture->Plane(1.5)->width, 24);
    EXPECT_EQ(picture->Plane(2), plane);
}

}  // namespace
}  // namespace tessel::frame
