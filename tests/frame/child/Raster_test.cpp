#include "frame/child/Raster.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <functional>
#include <limits>
#include <memory>
#include <optional>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "frame/Picture.h"

namespace tessel::child {
namespace {

using frame::DrawOp;
using frame::OLE_COLOR;
using frame::Pen;
using frame::Scale;
namespace draw = frame::draw;
using draw::Box;

constexpr std::uint32_t ink = 0x123456;
constexpr std::uint32_t paper = 0xFFFFFF;

draw::Line LineOf(float x1, float y1, float x2, float y2, Box box = Box::None, OLE_COLOR color = ink) {
    return {x1, y1, x2, y2, color, box};
}
draw::Circle CircleOf(float x, float y, float radius, std::optional<float> aspect = {}) {
    return {x, y, radius, ink, {}, {}, aspect};
}
draw::Circle ArcOf(float x, float y, float radius, std::optional<float> start, std::optional<float> end) {
    return {x, y, radius, ink, start, end, {}};
}

/// '.' for the paper, '#' for the ink, '?' for any other colour.
std::string Rows(const Raster& raster) {
    std::string text;
    for (int y = 0; y < raster.Height(); ++y) {
        for (int x = 0; x < raster.Width(); ++x) {
            const std::uint32_t color = raster.Pixel(x, y)->value;
            text += color == paper ? '.' : color == ink ? '#' : '?';
        }
        text += '\n';
    }
    return text;
}

std::string Drawn(const DrawOp& op, int width, int height, const Pen& pen = {}, const Scale& scale = {}) {
    Raster raster(width, height, paper);
    raster.Draw(op, pen, scale, paper, ink);
    return Rows(raster);
}

/// The first row alone, for what is one row high.
std::string DrawnRow(const DrawOp& op, int width, const Pen& pen) {
    const std::string rows = Drawn(op, width, 1, pen);
    return rows.substr(0, rows.size() - 1);
}

int InkCount(const std::string& rows) { return static_cast<int>(std::count(rows.begin(), rows.end(), '#')); }

Raster Noise(int width, int height, std::mt19937& random) {
    Raster raster(width, height, paper);
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x) raster.SetPixel(x, y, static_cast<std::uint32_t>(random() & 0xFFFFFF));
    return raster;
}

int Between(std::mt19937& random, int low, int high) {
    return low + static_cast<int>(random() % static_cast<unsigned>(high - low + 1));
}
float Somewhere(std::mt19937& random, int low, int high) { return static_cast<float>(Between(random, low * 4, high * 4)) / 4; }

DrawOp RandomShape(std::mt19937& random, OLE_COLOR color) {
    const auto place = [&] { return Somewhere(random, -15, 60); };
    const auto maybe = [&](float value) { return random() % 2 ? std::optional(value) : std::nullopt; };
    switch (random() % 5) {
        case 0:
            return draw::PSet{place(), place(), color};
        case 1:
            return draw::Line{place(), place(), place(), place(), color, Box::None};
        case 2:
            return draw::Line{place(), place(), place(), place(), color, random() % 2 ? Box::Outline : Box::Filled};
        default:
            return draw::Circle{place(),
                                place(),
                                Somewhere(random, 0, 60),
                                color,
                                maybe(Somewhere(random, -7, 7)),
                                maybe(Somewhere(random, -7, 7)),
                                maybe(Somewhere(random, 0, 4))};
    }
}

/// Every pixel of a line in turn, by adding up the error; without any clipping.
void WalkLine(raster::Point from, raster::Point to, const std::function<void(raster::Point, int step)>& visit) {
    const int across = std::abs(to.x - from.x), down = std::abs(to.y - from.y);
    const int right = to.x < from.x ? -1 : 1, below = to.y < from.y ? -1 : 1;
    const bool flat = across >= down;
    const int length = std::max(across, down), rise = std::min(across, down);
    const int aside = flat ? below : right;
    raster::Point at = from;
    std::int64_t error = 0;
    for (int step = 0; step < length; ++step) {
        visit(at, step);
        (flat ? at.x : at.y) += flat ? right : below;
        error += 2 * static_cast<std::int64_t>(rise);
        if (error > length || (error == length && aside < 0)) {
            (flat ? at.y : at.x) += aside;
            error -= 2 * static_cast<std::int64_t>(length);
        }
    }
}

std::string WalkedLine(
    raster::Point from, raster::Point to, int width, int height,
    const std::function<bool(int)>& drawsAt = [](int) { return true; }) {
    Raster raster(width, height, paper);
    WalkLine(from, to, [&](raster::Point at, int step) {
        if (drawsAt(step)) raster.SetPixel(at.x, at.y, ink);
    });
    return Rows(raster);
}

DrawOp LineBetween(raster::Point from, raster::Point to) {
    return LineOf(static_cast<float>(from.x), static_cast<float>(from.y), static_cast<float>(to.x), static_cast<float>(to.y));
}

TEST(Raster, IsFilledWithItsBackground) {
    const Raster raster(3, 2, frame::colors::buttonFace);
    EXPECT_EQ(raster.Width(), 3);
    EXPECT_EQ(raster.Height(), 2);
    EXPECT_EQ(raster.Pixel(0, 0), OLE_COLOR(0xC0C0C0));
    EXPECT_EQ(raster.Pixel(2, 1), OLE_COLOR(0xC0C0C0));
}

TEST(Raster, HasNoPixelOutside) {
    Raster raster(3, 2, paper);
    for (const auto& [x, y] : {std::pair(-1, 0), {0, -1}, {3, 0}, {0, 2}, {INT32_MIN, INT32_MAX}}) {
        raster.SetPixel(x, y, ink);
        EXPECT_FALSE(raster.Pixel(x, y).has_value());
    }
    EXPECT_EQ(Rows(raster), "...\n...\n");
}

TEST(Raster, SetPixelStoresRgb) {
    Raster raster(2, 1, paper);
    raster.SetPixel(0, 0, 0x7F112233u);
    raster.SetPixel(1, 0, frame::colors::windowText);
    EXPECT_EQ(raster.Pixel(0, 0), OLE_COLOR(0x112233));
    EXPECT_EQ(raster.Pixel(1, 0), OLE_COLOR(0));
}

TEST(Raster, ResizeKeepsWhatIsInBothSizes) {
    Raster raster(3, 2, paper);
    raster.SetPixel(1, 1, ink);
    raster.SetPixel(2, 0, ink);
    raster.Resize(4, 3, paper);
    EXPECT_EQ(Rows(raster), "..#.\n.#..\n....\n");
    raster.Resize(2, 2, paper);
    EXPECT_EQ(Rows(raster), "..\n.#\n");
    raster.Resize(3, 1, ink);
    EXPECT_EQ(Rows(raster), "..#\n");
    raster.Resize(0, 5, ink);
    EXPECT_EQ(raster.Height(), 5);
    EXPECT_FALSE(raster.Pixel(0, 0).has_value());
}

TEST(Raster, HoldsNonsenseSizes) {
    const Raster negative(-5, INT32_MIN, paper);
    EXPECT_EQ(negative.Width(), 0);
    EXPECT_EQ(negative.Height(), 0);
    const Raster wide(INT32_MAX, 2, paper);
    EXPECT_EQ(wide.Width(), 16'384);
    EXPECT_EQ(wide.Height(), 2);
    const Raster high(1, INT32_MAX, paper);
    EXPECT_EQ(high.Height(), 16'384);
}

TEST(Raster, HoldsTheNumberOfPixels) {
    Raster raster(1, 1, ink);
    raster.Resize(INT32_MAX, INT32_MAX, paper);
    EXPECT_EQ(raster.Width(), 16'384);
    EXPECT_EQ(raster.Height(), 4'096);
    EXPECT_EQ(raster.Pixel(0, 0), OLE_COLOR(ink));
    EXPECT_EQ(raster.Pixel(16'383, 4'095), OLE_COLOR(paper));
}

TEST(Raster, ClsFillsWithTheBackgroundWhateverTheMode) {
    Raster raster(2, 2, ink);
    raster.Draw(draw::Cls{}, {1, draw::transparent, draw::xorPen}, {}, 0xFFFFFFu, 0);
    EXPECT_EQ(Rows(raster), "..\n..\n");
}

TEST(Raster, TextAndPenOperationsDrawNothing) {
    Raster raster(4, 4, paper);
    const std::vector<DrawOp> operations = {draw::Print{"Text", 0, 0}, draw::DrawWidth{3}, draw::DrawStyle{1}, draw::DrawMode{7}};
    for (const DrawOp& op : operations) raster.Draw(op, {}, {}, ink, ink);
    EXPECT_EQ(Rows(raster), "....\n....\n....\n....\n");
}

TEST(RasterLine, LeavesOutItsLastPoint) {
    EXPECT_EQ(Drawn(LineOf(0, 0, 5, 0), 7, 2), "#####..\n.......\n");
    EXPECT_EQ(Drawn(LineOf(5, 0, 0, 0), 7, 2), ".#####.\n.......\n");
    EXPECT_EQ(Drawn(LineOf(1, 0, 1, 2), 3, 4), ".#.\n.#.\n...\n...\n");
}

TEST(RasterLine, FromAPixelToItselfDrawsNothing) {
    for (const int width : {1, 2, 9}) EXPECT_EQ(Drawn(LineOf(1, 1, 1.5f, 1.9f), 3, 3, {width}), "...\n...\n...\n");
}

TEST(RasterLine, TakesTheUpperOrLeftPixelHalfway) {
    EXPECT_EQ(Drawn(LineOf(0, 0, 6, 3), 7, 4),
              "##.....\n"
              "..##...\n"
              "....##.\n"
              ".......\n");
    EXPECT_EQ(Drawn(LineOf(6, 3, 0, 0), 7, 4),
              ".#.....\n"
              "..##...\n"
              "....##.\n"
              "......#\n");
    EXPECT_EQ(Drawn(LineOf(0, 0, 1, 4), 3, 4),
              "#..\n"
              "#..\n"
              "#..\n"
              ".#.\n");
}

TEST(RasterLine, HasTheSamePixelsInEitherDirection) {
    std::mt19937 random(11);
    for (int round = 0; round < 500; ++round) {
        const raster::Point from{Between(random, 0, 39), Between(random, 0, 29)},
            to{Between(random, 0, 39), Between(random, 0, 29)};
        Raster there(40, 30, paper), back(40, 30, paper);
        there.Draw(LineBetween(from, to), {}, {}, paper, ink);
        there.SetPixel(to.x, to.y, ink);
        back.Draw(LineBetween(to, from), {}, {}, paper, ink);
        back.SetPixel(from.x, from.y, ink);
        ASSERT_EQ(Rows(there), Rows(back));
    }
}

TEST(RasterLine, ClippedHasThePixelsOfTheUnclippedLine) {
    std::mt19937 random(12);
    int visible = 0;
    for (int round = 0; round < 3000; ++round) {
        const int reach = round % 2 ? 60 : 3000;
        const raster::Point from{Between(random, -reach, reach), Between(random, -reach, reach)};
        const raster::Point to{Between(random, -reach, reach), Between(random, -reach, reach)};
        const std::string drawn = Drawn(LineBetween(from, to), 40, 30);
        ASSERT_EQ(drawn, WalkedLine(from, to, 40, 30)) << from.x << ' ' << from.y << ' ' << to.x << ' ' << to.y;
        visible += InkCount(drawn) > 0 ? 1 : 0;
    }
    EXPECT_GT(visible, 500);
}

TEST(RasterLine, BetweenTheFarthestPointsHasThePixelsOfTheUnclippedLine) {
    constexpr int far = 16'777'216;
    for (const auto& [from, to] :
         {std::pair(raster::Point{-far, -far + 7}, raster::Point{far, far}),
          std::pair(raster::Point{3, far}, raster::Point{20, -far}), std::pair(raster::Point{far, 19}, raster::Point{-far, 2})}) {
        const std::string drawn = Drawn(LineBetween(from, to), 40, 30);
        EXPECT_EQ(drawn, WalkedLine(from, to, 40, 30));
        EXPECT_GE(InkCount(drawn), 20);
    }
}

TEST(RasterLine, HoldsCoordinatesBeyondTheFarthest) {
    EXPECT_EQ(Drawn(LineOf(-1e30f, 1, 1e30f, 1), 4, 3), "....\n####\n....\n");
    EXPECT_EQ(Drawn(LineOf(2, -std::numeric_limits<float>::infinity(), 2, 2), 4, 3), "..#.\n..#.\n....\n");
    EXPECT_EQ(Drawn(LineOf(std::numeric_limits<float>::quiet_NaN(), 0, 2, 0), 4, 1), "##..\n");
}

TEST(RasterLine, ScalesItsCoordinates) {
    // 15 units a pixel, from -30: pixels 2 to 5.
    EXPECT_EQ(Drawn(LineOf(0, 15, 45, 15), 7, 3, {}, {-30, 0, 1 / 15.0f, 1 / 15.0f}), ".......\n..###..\n.......\n");
}

TEST(RasterLine, BrokenStylesHaveTheirPatterns) {
    EXPECT_EQ(DrawnRow(LineOf(0, 0, 50, 0), 50, {1, draw::dash}), "##################......##################......##");
    EXPECT_EQ(DrawnRow(LineOf(0, 0, 14, 0), 14, {1, draw::dot}), "###...###...##");
    EXPECT_EQ(DrawnRow(LineOf(0, 0, 30, 0), 30, {1, draw::dashDot}), "#########......###......######");
    EXPECT_EQ(DrawnRow(LineOf(0, 0, 28, 0), 28, {1, draw::dashDotDot}), "#########...###...###...####");
    EXPECT_EQ(DrawnRow(LineOf(9, 0, -1, 0), 10, {1, draw::dot}), ".###...###");
    EXPECT_EQ(DrawnRow(LineOf(0, 0, 8, 0), 8, {1, draw::insideSolid}), "########");
    EXPECT_EQ(DrawnRow(LineOf(0, 0, 8, 0), 8, {1, 99}), "########");
    EXPECT_EQ(DrawnRow(LineOf(0, 0, 8, 0), 8, {1, draw::transparent}), "........");
}

TEST(RasterLine, ClippingDoesNotMoveTheDashes) {
    EXPECT_EQ(DrawnRow(LineOf(-4, 0, 10, 0), 10, {1, draw::dot}), "..###...##");
    std::mt19937 random(13);
    for (int round = 0; round < 300; ++round) {
        const raster::Point from{Between(random, -90, 130), Between(random, -90, 120)};
        const raster::Point to{Between(random, -90, 130), Between(random, -90, 120)};
        const auto dotted = [](int step) { return step % 6 < 3; };
        ASSERT_EQ(Drawn(LineBetween(from, to), 40, 30, {1, draw::dot}), WalkedLine(from, to, 40, 30, dotted));
    }
}

TEST(RasterLine, OfAWidePenHasRoundEnds) {
    EXPECT_EQ(Drawn(LineOf(3, 3, 8, 3), 12, 7, {5}),
              "............\n"
              "..########..\n"
              ".##########.\n"
              ".##########.\n"
              ".##########.\n"
              "..########..\n"
              "............\n");
    EXPECT_EQ(Drawn(LineOf(2, 1, 2, 3), 5, 5, {2}),
              ".##..\n"
              ".##..\n"
              ".##..\n"
              ".##..\n"
              ".....\n");
}

TEST(RasterLine, OfAWidePenIsSolidInAnyBrokenStyle) {
    EXPECT_EQ(Drawn(LineOf(3, 3, 30, 9), 36, 12, {2, draw::dot}), Drawn(LineOf(3, 3, 30, 9), 36, 12, {2}));
    EXPECT_EQ(InkCount(Drawn(LineOf(3, 3, 30, 9), 36, 12, {2, draw::transparent})), 0);
}

TEST(RasterLine, OfAWidePenHasAllThatIsWithinHalfItsWidth) {
    std::mt19937 random(14);
    for (int round = 0; round < 150; ++round) {
        const raster::Point from{Between(random, -15, 45), Between(random, -15, 35)};
        const raster::Point to{Between(random, -15, 45), Between(random, -15, 35)};
        if (from == to) continue;
        const int width = Between(random, 2, 14);
        const int half = width % 2 == 0 ? 1 : 0;
        Raster expected(30, 20, paper);
        const auto stamp = [&](raster::Point at, int) {
            for (int y = 0; y < 20; ++y)
                for (int x = 0; x < 30; ++x) {
                    const int across = 2 * (x - at.x) + half, down = 2 * (y - at.y) + half;
                    if (across * across + down * down <= width * width) expected.SetPixel(x, y, ink);
                }
        };
        WalkLine(from, to, stamp);
        stamp(to, 0);
        ASSERT_EQ(Drawn(LineBetween(from, to), 30, 20, {width}), Rows(expected)) << width;
    }
}

TEST(RasterBox, IncludesBothCornersInAnyOrder) {
    const std::string outline = "####..\n#..#..\n####..\n......\n";
    const std::string filled = "####..\n####..\n####..\n......\n";
    for (const auto& corners : {std::array{0, 0, 3, 2}, {3, 2, 0, 0}, {3, 0, 0, 2}, {0, 2, 3, 0}}) {
        const auto [x1, y1, x2, y2] = std::array<float, 4>{static_cast<float>(corners[0]), static_cast<float>(corners[1]),
                                                           static_cast<float>(corners[2]), static_cast<float>(corners[3])};
        EXPECT_EQ(Drawn(LineOf(x1, y1, x2, y2, Box::Outline), 6, 4), outline);
        EXPECT_EQ(Drawn(LineOf(x1, y1, x2, y2, Box::Filled), 6, 4), filled);
    }
}

TEST(RasterBox, OfOneRowColumnOrPixelIsDrawnOnce) {
    for (const Box box : {Box::Outline, Box::Filled}) {
        for (const int mode : {draw::copyPen, draw::xorPen}) {
            const OLE_COLOR color = mode == draw::xorPen ? paper ^ ink : ink;
            const Pen pen{1, draw::solid, mode};
            EXPECT_EQ(Drawn(LineOf(1, 1, 3, 1, box, color), 5, 3, pen), ".....\n.###.\n.....\n");
            EXPECT_EQ(Drawn(LineOf(1, 2, 1, 0, box, color), 3, 3, pen), ".#.\n.#.\n.#.\n");
            EXPECT_EQ(Drawn(LineOf(1, 1, 1, 1, box, color), 3, 3, pen), "...\n.#.\n...\n");
            EXPECT_EQ(Drawn(LineOf(0, 0, 1, 1, box, color), 3, 3, pen), "##.\n##.\n...\n");
        }
    }
}

TEST(RasterBox, LargerThanThePlaneShowsItsInsideAlone) {
    EXPECT_EQ(Drawn(LineOf(-1e9f, -1e9f, 1e9f, 1e9f, Box::Outline), 3, 2), "...\n...\n");
    EXPECT_EQ(Drawn(LineOf(-1e9f, -1e9f, 1e9f, 1e9f, Box::Filled), 3, 2), "###\n###\n");
    EXPECT_EQ(Drawn(LineOf(-1e9f, 1, 1, 1e9f, Box::Outline), 3, 3), "...\n##.\n.#.\n");
}

TEST(RasterBox, WithAWidePenGrowsByHalfItsWidth) {
    EXPECT_EQ(Drawn(LineOf(2, 2, 7, 6, Box::Outline), 10, 9, {3}),
              "..........\n"
              ".########.\n"
              ".########.\n"
              ".########.\n"
              ".###..###.\n"
              ".########.\n"
              ".########.\n"
              ".########.\n"
              "..........\n");
    EXPECT_EQ(Drawn(LineOf(3, 3, 4, 4, Box::Filled), 8, 8, {5}),
              "........\n"
              "..####..\n"
              ".######.\n"
              ".######.\n"
              ".######.\n"
              ".######.\n"
              "..####..\n"
              "........\n");
}

TEST(RasterBox, DashesGoAroundClockwise) {
    EXPECT_EQ(Drawn(LineOf(4, 0, 0, 4, Box::Outline), 5, 5, {1, draw::dot}),
              "###..\n"
              ".....\n"
              "#...#\n"
              "#...#\n"
              "#...#\n");
}

TEST(RasterBox, TransparentStyleLeavesTheInside) {
    EXPECT_EQ(Drawn(LineOf(0, 0, 4, 3, Box::Outline), 5, 4, {1, draw::transparent}), ".....\n.....\n.....\n.....\n");
    for (const int width : {1, 7})
        EXPECT_EQ(Drawn(LineOf(0, 0, 4, 3, Box::Filled), 5, 4, {width, draw::transparent}), ".....\n.###.\n.###.\n.....\n");
}

TEST(RasterCircle, HasTheRoundPictures) {
    EXPECT_EQ(Drawn(CircleOf(1, 1, 0), 3, 3), "...\n.#.\n...\n");
    EXPECT_EQ(Drawn(CircleOf(1, 1, 1), 3, 3), ".#.\n#.#\n.#.\n");
    EXPECT_EQ(Drawn(CircleOf(3, 3, 3), 7, 7),
              "..###..\n"
              ".#...#.\n"
              "#.....#\n"
              "#.....#\n"
              "#.....#\n"
              ".#...#.\n"
              "..###..\n");
    EXPECT_EQ(Drawn(CircleOf(6, 6, 6), 13, 13),
              "....#####....\n"
              "...#.....#...\n"
              "..#.......#..\n"
              ".#.........#.\n"
              "#...........#\n"
              "#...........#\n"
              "#...........#\n"
              "#...........#\n"
              "#...........#\n"
              ".#.........#.\n"
              "..#.......#..\n"
              "...#.....#...\n"
              "....#####....\n");
}

TEST(RasterCircle, AspectIsHeightToWidthAndTheRadiusTheLongerHalf) {
    EXPECT_EQ(Drawn(CircleOf(10, 5, 10, 0.5f), 21, 11),
              "......#########......\n"
              "...###.........###...\n"
              "..#...............#..\n"
              ".#.................#.\n"
              "#...................#\n"
              "#...................#\n"
              "#...................#\n"
              ".#.................#.\n"
              "..#...............#..\n"
              "...###.........###...\n"
              "......#########......\n");
    EXPECT_EQ(Drawn(CircleOf(2, 4, 4, 2), 5, 9),
              "..#..\n"
              ".#.#.\n"
              "#...#\n"
              "#...#\n"
              "#...#\n"
              "#...#\n"
              "#...#\n"
              ".#.#.\n"
              "..#..\n");
    EXPECT_EQ(Drawn(CircleOf(3, 1, 2, 0), 7, 3), ".......\n.#####.\n.......\n");
    EXPECT_EQ(Drawn(CircleOf(1, 2, 1, std::numeric_limits<float>::infinity()), 3, 5), "...\n.#.\n.#.\n.#.\n...\n");
}

TEST(RasterCircle, IsTheSameTurnedAndMirrored) {
    for (int radius = 0; radius <= 120; ++radius) {
        const int side = 2 * radius + 1;
        Raster raster(side, side, paper);
        raster.Draw(CircleOf(static_cast<float>(radius), static_cast<float>(radius), static_cast<float>(radius)), {}, {}, paper, 0);
        for (int y = 0; y < side; ++y)
            for (int x = 0; x < side; ++x) {
                ASSERT_EQ(raster.Pixel(x, y), raster.Pixel(y, x)) << radius;
                ASSERT_EQ(raster.Pixel(x, y), raster.Pixel(side - 1 - x, y)) << radius;
            }
    }
}

TEST(RasterCircle, StaysWithinAPixelOfTheTrueCurve) {
    Raster raster(101, 101, paper);
    raster.Draw(CircleOf(50, 50, 47), {}, {}, paper, 0);
    for (int y = 0; y < 101; ++y)
        for (int x = 0; x < 101; ++x) {
            const double distance = std::abs(std::hypot(x - 50, y - 50) - 47);
            const bool drawn = raster.Pixel(x, y) == OLE_COLOR(ink);
            ASSERT_FALSE(drawn && distance > 0.75) << x << ' ' << y;
            ASSERT_FALSE(!drawn && distance < 0.2) << x << ' ' << y;
        }
}

TEST(RasterCircle, RadiusIsInHorizontalUnits) {
    EXPECT_EQ(Drawn(CircleOf(30, 6, 30), 7, 7, {}, {0, 0, 0.1f, 0.5f}), Drawn(CircleOf(3, 3, 3), 7, 7));
}

TEST(RasterCircle, ArcsGoCounterClockwiseFromTheRight) {
    constexpr float quarter = 1.5707963f;
    EXPECT_EQ(Drawn(ArcOf(3, 3, 3, 0, quarter), 7, 7),
              "...##..\n"
              ".....#.\n"
              "......#\n"
              "......#\n"
              ".......\n"
              ".......\n"
              ".......\n");
    EXPECT_EQ(Drawn(ArcOf(3, 3, 3, 3 * quarter, quarter), 7, 7),
              "...##..\n"
              ".....#.\n"
              "......#\n"
              "......#\n"
              "......#\n"
              ".....#.\n"
              "...##..\n");
}

TEST(RasterCircle, ArcAnglesWrap) {
    constexpr float turn = 6.2831853f;
    const std::string arc = Drawn(ArcOf(10, 10, 9, 1, 2.5f), 21, 21);
    EXPECT_EQ(Drawn(ArcOf(10, 10, 9, 1 + turn, 2.5f), 21, 21), arc);
    EXPECT_EQ(Drawn(ArcOf(10, 10, 9, 1, 2.5f - 2 * turn), 21, 21), arc);
    EXPECT_EQ(Drawn(ArcOf(10, 10, 9, 0, turn), 21, 21), Drawn(CircleOf(10, 10, 9), 21, 21));
    EXPECT_EQ(Drawn(ArcOf(10, 10, 9, {}, 2.5f), 21, 21), Drawn(ArcOf(10, 10, 9, 0, 2.5f), 21, 21));
    EXPECT_EQ(Drawn(ArcOf(10, 10, 9, 1, {}), 21, 21), Drawn(ArcOf(10, 10, 9, 1, turn), 21, 21));
    EXPECT_EQ(Drawn(ArcOf(10, 10, 9, std::numeric_limits<float>::quiet_NaN(), {}), 21, 21), Drawn(CircleOf(10, 10, 9), 21, 21));
}

TEST(RasterCircle, TheSmallestArcShowsAPixelOfTheCircle) {
    const std::string circle = Drawn(CircleOf(10, 10, 9), 21, 21);
    for (int tick = 0; tick < 200; ++tick) {
        const float start = static_cast<float>(std::fmod(tick, 6.28318530717958));
        for (const float sweep : {0.05f, 0.001f, 0.0f}) {
            const std::string arc = Drawn(ArcOf(10, 10, 9, start, start + sweep), 21, 21);
            ASSERT_GE(InkCount(arc), 1) << start;
            ASSERT_LE(InkCount(arc), 2) << start;
            for (std::size_t at = 0; at < arc.size(); ++at) ASSERT_FALSE(arc[at] == '#' && circle[at] != '#') << start;
        }
    }
    EXPECT_EQ(InkCount(Drawn({draw::Circle{10, 10, 8, ink, 1.0f, 1.05f, 0.0f}}, 21, 21)), 1);
}

TEST(RasterCircle, TwoArcsMakeTheWhole) {
    Raster raster(31, 31, paper);
    raster.Draw(ArcOf(15, 15, 14, 0.3f, 3), {}, {}, paper, 0);
    raster.Draw(ArcOf(15, 15, 14, 3, 0.3f), {}, {}, paper, 0);
    EXPECT_EQ(Rows(raster), Drawn(CircleOf(15, 15, 14), 31, 31));
}

TEST(RasterCircle, OfAWidePenIsARing) {
    EXPECT_EQ(Drawn(CircleOf(6, 6, 5), 13, 13, {3}),
              "...#######...\n"
              "..#########..\n"
              ".###########.\n"
              "#####...#####\n"
              "####.....####\n"
              "###.......###\n"
              "###.......###\n"
              "###.......###\n"
              "####.....####\n"
              "#####...#####\n"
              ".###########.\n"
              "..#########..\n"
              "...#######...\n");
}

TEST(RasterCircle, AShortArcOfAWidePenIsADot) {
    EXPECT_EQ(Drawn(ArcOf(0, 4, 5, 0, 0.05f), 9, 9, {5}), Drawn(draw::PSet{5, 4, ink}, 9, 9, {5}));
}

TEST(RasterCircle, BrokenStylesFollowTheCurve) {
    const std::string solid = Drawn(CircleOf(40, 40, 38), 81, 81);
    const std::string dotted = Drawn(CircleOf(40, 40, 38), 81, 81, {1, draw::dot});
    EXPECT_NEAR(InkCount(dotted), InkCount(solid) / 2.0, 12);
    // The first three steps from the right are drawn, counter-clockwise; the next three are not.
    EXPECT_EQ(dotted[82 * 40 + 78], '#');
    EXPECT_EQ(dotted[82 * 38 + 78], '#');
    EXPECT_EQ(dotted[82 * 36 + 78], '.');
    EXPECT_EQ(InkCount(Drawn(CircleOf(40, 40, 38), 81, 81, {1, draw::transparent})), 0);
}

TEST(RasterCircle, WithoutAUsableRadiusDrawsNothing) {
    for (const float radius : {-1.0f, -1e30f, std::numeric_limits<float>::quiet_NaN()})
        EXPECT_EQ(InkCount(Drawn(CircleOf(3, 3, radius), 7, 7, {3})), 0);
}

TEST(RasterCircle, AspectThatIsNoneCountsAsOne) {
    for (const float aspect : {-2.0f, std::numeric_limits<float>::quiet_NaN()})
        EXPECT_EQ(Drawn(CircleOf(3, 3, 3, aspect), 7, 7), Drawn(CircleOf(3, 3, 3), 7, 7));
}

TEST(RasterCircle, OfAHugeRadiusPassesThroughThePlane) {
    // So large that its edge is an upright line where it crosses the plane.
    EXPECT_EQ(Drawn(CircleOf(-16'000'000, 1, 16'000'002), 5, 3), "..#..\n..#..\n..#..\n");
    EXPECT_EQ(Drawn(CircleOf(1, 16'000'001, 16'000'000), 3, 3), "...\n###\n...\n");
    EXPECT_EQ(InkCount(Drawn(CircleOf(1, 1, std::numeric_limits<float>::infinity()), 3, 3)), 0);
}

TEST(RasterDot, IsOnePixelOrRound) {
    EXPECT_EQ(Drawn(draw::PSet{1.9f, 1.1f, ink}, 3, 3), "...\n.#.\n...\n");
    EXPECT_EQ(Drawn(draw::PSet{1, 1, ink}, 3, 3, {2}), "##.\n##.\n...\n");
    EXPECT_EQ(Drawn(draw::PSet{1, 1, ink}, 3, 3, {3}), "###\n###\n###\n");
    EXPECT_EQ(Drawn(draw::PSet{2, 2, ink}, 5, 5, {4}), ".##..\n####.\n####.\n.##..\n.....\n");
    EXPECT_EQ(Drawn(draw::PSet{2, 2, ink}, 5, 5, {5}), ".###.\n#####\n#####\n#####\n.###.\n");
    EXPECT_EQ(Drawn(draw::PSet{-2, 1, ink}, 3, 3, {5}), "#..\n#..\n#..\n");
    EXPECT_EQ(Drawn(draw::PSet{-3, 1, ink}, 3, 3, {5}), "...\n...\n...\n");
}

TEST(RasterPen, WidthIsHeld) {
    for (const int width : {0, -1, INT32_MIN}) EXPECT_EQ(Drawn(draw::PSet{1, 1, ink}, 3, 3, {width}), "...\n.#.\n...\n");
    for (const int width : {1'000'000'000, INT32_MAX}) EXPECT_EQ(Drawn(draw::PSet{1, 1, ink}, 3, 2, {width}), "###\n###\n");
    EXPECT_EQ(Drawn(draw::PSet{-16'384, 0, ink}, 1, 1, {1'000'000'000}), ".\n");
    EXPECT_EQ(Drawn(draw::PSet{-16'383, 0, ink}, 1, 1, {1'000'000'000}), "#\n");
}

TEST(RasterPen, ModesCombineTheColourWithThePixel) {
    const auto after = [](int mode, OLE_COLOR color) {
        Raster raster(1, 1, 0xF0C010u);
        raster.Draw(draw::PSet{0, 0, color}, {1, draw::solid, mode}, {}, paper, 0);
        return raster.Pixel(0, 0)->value;
    };
    EXPECT_EQ(after(draw::copyPen, 0x123456u), 0x123456u);
    EXPECT_EQ(after(draw::xorPen, 0x123456u), 0xF0C010u ^ 0x123456u);
    EXPECT_EQ(after(draw::invert, 0x123456u), 0x0F3FEFu);
    EXPECT_EQ(after(draw::blackness, 0x123456u), 0u);
    EXPECT_EQ(after(16, 0x123456u), 0xFFFFFFu);
    EXPECT_EQ(after(11, 0x123456u), 0xF0C010u);
    for (const int mode : {0, 2, 15, 17, -1, INT32_MIN, INT32_MAX}) EXPECT_EQ(after(mode, 0x123456u), 0x123456u);
    EXPECT_EQ(after(draw::copyPen, frame::colors::buttonFace), 0xC0C0C0u);
    EXPECT_EQ(after(draw::xorPen, 0x7F123456u), 0xF0C010u ^ 0x123456u);
}

TEST(RasterPen, XorAndInvertDrawnTwiceLeaveThePlaneAsItWas) {
    std::mt19937 random(21);
    for (int round = 0; round < 2000; ++round) {
        Raster raster = Noise(50, 40, random);
        const Raster original = raster;
        const DrawOp op = RandomShape(random, static_cast<std::uint32_t>(random() & 0xFFFFFF));
        const Pen pen{Between(random, 1, 9), Between(random, 0, 6), random() % 2 ? draw::xorPen : draw::invert};
        raster.Draw(op, pen, {}, paper, 0);
        raster.Draw(op, pen, {}, paper, 0);
        for (int y = 0; y < 40; ++y)
            for (int x = 0; x < 50; ++x) ASSERT_EQ(raster.Pixel(x, y), original.Pixel(x, y)) << round;
    }
}

TEST(RasterPen, XorChangesEachPixelThatCopyingChanges) {
    std::mt19937 random(22);
    int covered = 0;
    for (int round = 0; round < 2000; ++round) {
        const DrawOp op = RandomShape(random, ink);
        const Pen copying{Between(random, 1, 9), Between(random, 0, 6), draw::copyPen};
        const Pen combining{copying.width, copying.style, draw::xorPen};
        Raster copied(50, 40, 0u), combined(50, 40, 0u);
        copied.Draw(op, copying, {}, paper, 0);
        combined.Draw(op, combining, {}, paper, 0);
        const std::string rows = Rows(copied);
        ASSERT_EQ(Rows(combined), rows) << "a pixel was touched twice in round " << round;
        covered += InkCount(rows) > 0 ? 1 : 0;
    }
    EXPECT_GT(covered, 1000);
}

TEST(RasterPen, APlaneShowsWhatAWindowOnALargerOneShows) {
    std::mt19937 random(23);
    for (int round = 0; round < 1500; ++round) {
        const DrawOp op = RandomShape(random, ink);
        const Pen pen{random() % 2 ? 1 : Between(random, 2, 12), Between(random, 0, 6)};
        const int left = Between(random, 0, 90), top = Between(random, 0, 90);
        Raster large(220, 220, paper), window(30, 25, paper), cut(30, 25, 0u);
        large.Draw(op, pen, {-80, -80, 1, 1}, paper, 0);
        window.Draw(op, pen, {static_cast<float>(left - 80), static_cast<float>(top - 80), 1, 1}, paper, 0);
        cut.Blit(0, 0, large, {left, top, left + 30, top + 25});
        ASSERT_EQ(Rows(window), Rows(cut)) << round;
    }
}

TEST(RasterPen, NoValueCrashesOrHangs) {
    constexpr float infinity = std::numeric_limits<float>::infinity();
    const std::vector<float> numbers = {0,     0.5f,  -1,    7,        100,       -100,          16'777'216,
                                        1e9f,  -1e9f, 1e30f, -1e30f,   3.4e38f,   1e-40f,        -1e-40f,
                                        1e-5f, 6.3f,  -6.3f, infinity, -infinity, std::nanf(""), -0.0f};
    const std::vector<int> integers = {0, 1, 2, 5, 6, 7, 11, 13, 16, -1, 40, 1'000, 1'000'000'000, INT32_MIN, INT32_MAX};
    std::mt19937 random(24);
    const auto number = [&] { return numbers[random() % numbers.size()]; };
    const auto integer = [&] { return integers[random() % integers.size()]; };
    const auto maybe = [&] { return random() % 2 ? std::optional(number()) : std::nullopt; };
    Raster raster(40, 30, paper);
    for (int round = 0; round < 2500; ++round) {
        const OLE_COLOR color = static_cast<std::uint32_t>(random());
        const std::vector<DrawOp> operations = {
            draw::Line{number(), number(), number(), number(), color, static_cast<Box>(random() % 3)},
            draw::Circle{number(), number(), number(), color, maybe(), maybe(), maybe()}, draw::PSet{number(), number(), color},
            draw::PaintPicture{number(), number(), nullptr}};
        const Scale scale = round % 2 ? Scale{} : Scale{number(), number(), number(), number()};
        for (const DrawOp& op : operations) raster.Draw(op, {integer(), integer(), integer()}, scale, color, color);
    }
    for (int y = 0; y < 30; ++y)
        for (int x = 0; x < 40; ++x) ASSERT_EQ(raster.Pixel(x, y)->value & 0xFF000000u, 0u);
}

TEST(RasterPen, NothingIsDrawnOnAPlaneWithoutPixels) {
    std::mt19937 random(25);
    for (const auto& [width, height] : {std::pair(0, 0), {0, 9}, {9, 0}}) {
        Raster raster(width, height, paper);
        for (int round = 0; round < 200; ++round)
            raster.Draw(RandomShape(random, ink), {Between(random, 1, 9), Between(random, 0, 6)}, {}, paper, 0);
        raster.Draw(draw::Cls{}, {}, {}, paper, 0);
        EXPECT_EQ(InkCount(Rows(raster)), 0);
    }
}

TEST(RasterBlit, CopiesAPart) {
    Raster source(4, 3, paper), target(4, 3, paper);
    source.Draw(LineOf(1, 1, 3, 2, Box::Filled), {}, {}, paper, 0);
    target.Blit(0, 1, source, {1, 1, 3, 2});
    EXPECT_EQ(Rows(target), "....\n##..\n....\n");
    target.Blit(3, 2, source, {1, 1, 4, 3});
    EXPECT_EQ(Rows(target), "....\n##..\n...#\n");
}

TEST(RasterBlit, LeavesOutTheMaskColour) {
    Raster source(3, 1, 0xFF00FFu), target(3, 1, paper);
    source.SetPixel(1, 0, ink);
    target.Blit(0, 0, source, {0, 0, 3, 1}, 0xFF00FFu);
    EXPECT_EQ(Rows(target), ".#.\n");
    Raster faces(3, 1, frame::colors::buttonFace);
    faces.SetPixel(0, 0, ink);
    target.Blit(0, 0, faces, {0, 0, 3, 1}, frame::colors::buttonFace);
    EXPECT_EQ(Rows(target), "##.\n");
}

TEST(RasterBlit, HoldsNonsense) {
    Raster source(3, 3, ink), target(3, 3, paper);
    target.Blit(INT32_MAX, INT32_MIN, source, {INT32_MIN, INT32_MIN, INT32_MAX, INT32_MAX});
    target.Blit(0, 0, source, {3, 3, 0, 0});
    target.Blit(0, 0, source, {5, 5, 9, 9});
    target.Blit(-3, 0, source, {0, 0, 3, 3});
    EXPECT_EQ(InkCount(Rows(target)), 0);
    target.Blit(-1, -2, source, {-1, -1, 100, 100});
    EXPECT_EQ(Rows(target), "###\n###\n...\n");
}

TEST(RasterBlit, WithinOnePlaneReadsBeforeItWrites) {
    Raster raster(6, 1, paper);
    raster.Draw(LineOf(0, 0, 2, 0), {}, {}, paper, 0);
    raster.Blit(1, 0, raster, {0, 0, 4, 1});
    EXPECT_EQ(Rows(raster), "###...\n");
}

TEST(RasterPicture, IsCopiedToTheScaledPositionWhereItIsOpaque) {
    constexpr std::uint32_t opaque = 0xFF000000u, clear = 0x00FFFFFFu;
    const std::vector<frame::PixelPlane> planes = {{2, 6, 2, std::vector<std::uint32_t>(12, opaque | 0x123456)},
                                                   {1, 3, 1, {opaque | ink, clear, opaque | ink}}};
    const auto picture = std::make_shared<frame::Picture>(planes, "");
    const Scale scale{0, 0, 0.1f, 0.1f};

    Raster raster(5, 2, paper);
    raster.Draw(draw::PaintPicture{10, 0, nullptr}, {}, scale, paper, 0);
    EXPECT_EQ(Rows(raster), ".....\n.....\n");
    raster.Draw(draw::PaintPicture{10, 10, picture}, {1, draw::transparent, draw::xorPen}, scale, paper, 0);
    EXPECT_EQ(Rows(raster), ".....\n.#.#.\n");
    raster.Draw(draw::PaintPicture{30, -10, picture}, {}, scale, paper, 0);
    raster.Draw(draw::PaintPicture{-20, 0, picture}, {}, scale, paper, 0);
    EXPECT_EQ(Rows(raster), "#....\n.#.#.\n");
}

}  // namespace
}  // namespace tessel::child
