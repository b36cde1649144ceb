#include "frame/Picture.h"

#include <gtest/gtest.h>

#include <limits>

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

PictureRef Counted(int& drawings) {
    return std::make_shared<Picture>(150.0f, 300.0f, [&drawings](double scale) {
        ++drawings;
        return PlaneOf(scale, static_cast<int>(10 * scale), static_cast<int>(20 * scale), 0xFF0000FF);
    });
}

TEST(Picture, ThatIsDrawnIsDrawnWhenAScaleIsFirstWanted) {
    int drawings = 0;
    const PictureRef picture = Counted(drawings);
    EXPECT_EQ(picture->Width(), 150);
    EXPECT_EQ(picture->Height(), 300);
    EXPECT_EQ(drawings, 0);
    const PixelPlane* once = picture->Plane(1);
    ASSERT_NE(once, nullptr);
    EXPECT_EQ(once->width, 10);
    EXPECT_EQ(picture->Plane(2)->width, 20);
    EXPECT_EQ(picture->Plane(1), once) << "a plane stays where it is";
    EXPECT_EQ(drawings, 2);
}

TEST(Picture, ThatIsDrawnHasScalesInQuartersFromOneToEight) {
    int drawings = 0;
    const PictureRef picture = Counted(drawings);
    EXPECT_EQ(picture->Plane(1.1)->scale, 1.25);
    EXPECT_EQ(picture->Plane(1.25)->scale, 1.25);
    for (const double small : {0.5, 0.0, -3.0, std::numeric_limits<double>::quiet_NaN()})
        EXPECT_EQ(picture->Plane(small)->scale, 1);
    for (const double large : {8.0, 9.0, 1e300, std::numeric_limits<double>::infinity()})
        EXPECT_EQ(picture->Plane(large)->scale, 8);
    EXPECT_EQ(drawings, 3);
}

TEST(Picture, ThatIsDrawnEqualsItselfAlone) {
    int drawings = 0;
    const PictureRef one = Counted(drawings), other = Counted(drawings);
    EXPECT_TRUE(one->EqualsObject(*one));
    EXPECT_FALSE(one->EqualsObject(*other));
    EXPECT_FALSE(one->EqualsObject(Picture(150, 300, "")));
    EXPECT_FALSE(Picture(150, 300, "").EqualsObject(*one));
    EXPECT_EQ(drawings, 0);
}

TEST(Picture, ThatIsDrawnAndMappedIsMappedWhenItIsDrawn) {
    int drawings = 0;
    const PictureRef mapped = MapPixels(Counted(drawings), [](std::uint32_t) { return 0xFF123456u; });
    EXPECT_EQ(drawings, 0);
    EXPECT_EQ(mapped->Width(), 150);
    EXPECT_EQ(mapped->Plane(1)->pixels.front(), 0xFF123456u);
}

}  // namespace
}  // namespace tessel::frame
