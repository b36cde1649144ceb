#include "frame/Picture.h"

#include <gtest/gtest.h>

#include "frame/Font.h"
#include "frame/Variant.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

PixelPlane PlaneOf(double scale, int width, int height, std::uint32_t pixel) {
    return {scale, width, height, std::vector<std::uint32_t>(static_cast<std::size_t>(width * height), pixel)};
}

TEST(Picture, ThatIsEmptyHasNoSizeAndNoPlane) {
    const Picture picture;
    EXPECT_EQ(picture.Width(), 0);
    EXPECT_EQ(picture.Height(), 0);
    EXPECT_EQ(picture.Source(), "");
    EXPECT_EQ(picture.Plane(1), nullptr);
    EXPECT_EQ(Picture(std::vector<PixelPlane>(), "a.bmp").Width(), 0);
}

TEST(Picture, OfWhichOnlyTheSizeIsKnownHasNoPlane) {
    const Picture picture(150, 300, "a.bmp");
    EXPECT_EQ(picture.Width(), 150);
    EXPECT_EQ(picture.Height(), 300);
    EXPECT_EQ(picture.Source(), "a.bmp");
    EXPECT_EQ(picture.Plane(1), nullptr);
}

TEST(Picture, IsFifteenTwipsLargeForEachPixelAtScaleOne) {
    const Picture picture({PlaneOf(1, 10, 20, 0)}, "");
    EXPECT_EQ(picture.Width(), 150);
    EXPECT_EQ(picture.Height(), 300);
}

TEST(Picture, HasTheSameNaturalSizeAtAnyScale) {
    const Picture picture({PlaneOf(2, 20, 40, 0)}, "");
    EXPECT_EQ(picture.Width(), 150);
    EXPECT_EQ(picture.Height(), 300);
}

TEST(Picture, GivesThePlaneOfTheLeastScaleThatIsEnoughElseTheGreatest) {
    const Picture picture({PlaneOf(3, 3, 3, 3), PlaneOf(1, 1, 1, 1), PlaneOf(2, 2, 2, 2)}, "");
    const auto at = [&](double scale) { return picture.Plane(scale)->width; };
    EXPECT_EQ(at(0.5), 1);
    EXPECT_EQ(at(1), 1);
    EXPECT_EQ(at(1.25), 2);
    EXPECT_EQ(at(2), 2);
    EXPECT_EQ(at(3), 3);
    EXPECT_EQ(at(4), 3);
}

TEST(Picture, EqualsOneOfTheSameSizeSourceAndPixels) {
    const Picture picture({PlaneOf(1, 2, 2, 0xFF0000FF)}, "a.bmp");
    EXPECT_TRUE(picture.EqualsObject(picture));
    EXPECT_TRUE(picture.EqualsObject(Picture({PlaneOf(1, 2, 2, 0xFF0000FF)}, "a.bmp")));
    EXPECT_FALSE(picture.EqualsObject(Picture({PlaneOf(1, 2, 2, 0xFF0000FE)}, "a.bmp")));
    EXPECT_FALSE(picture.EqualsObject(Picture({PlaneOf(1, 2, 2, 0xFF0000FF)}, "b.bmp")));
    EXPECT_FALSE(picture.EqualsObject(Picture(30, 30, "a.bmp")));
    EXPECT_FALSE(picture.EqualsObject(Font()));
}

TEST(Picture, ShowsItsSizeByNameAndRefusesToBeSet) {
    Picture picture(150, 300, "");
    EXPECT_EQ(picture.Get("width").ToSingle(), 150);
    EXPECT_EQ(picture.Get("Height").ToSingle(), 300);
    EXPECT_EQ(test::ErrorOf([&] { picture.Put("Width", 1); }), errors::notAtRunTime);
    EXPECT_EQ(picture.Width(), 150);
}

}  // namespace
}  // namespace tessel::frame
