#include "controls/scorecard/ScorePictures.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <set>
#include <string>
#include <vector>

namespace tessel::controls {
namespace {

bool IsOpaque(std::uint32_t pixel) { return pixel >> 24 >= 0x80; }

/// The brightness of a pixel: what somebody sees who tells no colours apart.
double Grey(std::uint32_t pixel) { return 0.299 * (pixel & 0xFF) + 0.587 * (pixel >> 8 & 0xFF) + 0.114 * (pixel >> 16 & 0xFF); }

double MeanGrey(const frame::PixelPlane& plane) {
    double sum = 0, count = 0;
    for (const std::uint32_t pixel : plane.pixels) {
        if (!IsOpaque(pixel)) continue;
        sum += Grey(pixel);
        ++count;
    }
    return sum / count;
}

/// The share of the pixels that differ clearly in brightness, or that only one of the pictures has, when both are made equally
/// bright as a whole: so that another colour alone is no difference.
double Difference(const frame::PixelPlane& one, const frame::PixelPlane& other) {
    constexpr double clearly = 48;
    const double offset = MeanGrey(one) - MeanGrey(other);
    double different = 0, all = 0;
    for (std::size_t i = 0; i < one.pixels.size(); ++i) {
        const bool inOne = IsOpaque(one.pixels[i]), inOther = IsOpaque(other.pixels[i]);
        if (!inOne && !inOther) continue;
        ++all;
        if (inOne != inOther || std::abs(Grey(one.pixels[i]) - Grey(other.pixels[i]) - offset) >= clearly) ++different;
    }
    return different / all;
}

class ScorePicturesTest : public testing::Test {
  protected:
    template <class F>
    void ForEach(F&& check) const {
        for (std::size_t family = 0; family < scoreFamilies.size(); ++family)
            for (int grade = 1; grade <= scoreGrades; ++grade)
                for (const int side : {smallSide, largeSide}) {
                    SCOPED_TRACE(std::string(scoreFamilies[family]) + std::to_string(grade) + " at " + std::to_string(side));
                    check(*pictures.Of(family, grade, side), side);
                }
    }
    ScorePictures pictures;
};

TEST_F(ScorePicturesTest, HaveTheirSizeAndASharpPlaneForEachScale) {
    ForEach([](const frame::Picture& picture, int side) {
        EXPECT_EQ(picture.Width(), static_cast<float>(side * 15));
        EXPECT_EQ(picture.Height(), static_cast<float>(side * 15));
        for (const double scale : {1.0, 2.0, 3.0}) {
            const frame::PixelPlane* plane = picture.Plane(scale);
            ASSERT_NE(plane, nullptr);
            EXPECT_EQ(plane->scale, scale);
            EXPECT_EQ(plane->width, side * scale);
            EXPECT_EQ(plane->height, side * scale);
        }
    });
}

TEST_F(ScorePicturesTest, FillTheirSquareAndAreClearAtTheCorners) {
    ForEach([](const frame::Picture& picture, int side) {
        const frame::PixelPlane& plane = *picture.Plane(1);
        int opaque = 0, left = side, right = 0, top = side, bottom = 0;
        for (int y = 0; y < side; ++y) {
            for (int x = 0; x < side; ++x) {
                if (plane.pixels[static_cast<std::size_t>(y * side + x)] >> 24 < 0x80) continue;
                ++opaque;
                left = std::min(left, x);
                right = std::max(right, x);
                top = std::min(top, y);
                bottom = std::max(bottom, y);
            }
        }
        EXPECT_GE(opaque, side * side / 4);
        EXPECT_GE(bottom - top + 1, side * 3 / 4);
        EXPECT_GE(right - left + 1, side / 2);
        EXPECT_LT(plane.pixels.front() >> 24, 0x80u);
        EXPECT_LT(plane.pixels.back() >> 24, 0x80u);
    });
}

TEST_F(ScorePicturesTest, AreFortyDifferentOnes) {
    std::set<std::vector<std::uint32_t>> seen;
    ForEach([&](const frame::Picture& picture, int) { seen.insert(picture.Plane(1)->pixels); });
    EXPECT_EQ(seen.size(), 40u);
}

TEST_F(ScorePicturesTest, GradesDifferInShapeNotInColourAlone) {
    constexpr double leastDifference = 0.05;
    for (const int side : {smallSide, largeSide}) {
        for (std::size_t family = 0; family < scoreFamilies.size(); ++family) {
            for (int one = 1; one <= scoreGrades; ++one) {
                for (int other = one + 1; other <= scoreGrades; ++other)
                    EXPECT_GT(Difference(*pictures.Of(family, one, side)->Plane(1), *pictures.Of(family, other, side)->Plane(1)),
                              leastDifference)
                        << scoreFamilies[family] << one << " and " << other << " at " << side;
            }
        }
    }
}

}  // namespace
}  // namespace tessel::controls
