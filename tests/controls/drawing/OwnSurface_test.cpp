#include <cstdint>
#include <functional>

#include "tests/controls/drawing/DrawingTestHelp.h"

/// The surface that a control itself is, as the pixels that are read back from it.
namespace tessel::test::drawing {
namespace {

using Place = std::pair<float, float>;

/// A white surface of 12 by 8 pixels, in pixels.
class OwnSurfaceTest : public testing::Test {
  protected:
    static constexpr int columns = 12, rows = 8;

    OwnSurfaceTest() {
        surface.SetScaleMode(ScaleModeConstants::Pixels);
        surface.SetBackColor(white);
    }

    OLE_COLOR At(int x, int y) const { return PixelOf(surface, static_cast<float>(x), static_cast<float>(y)); }
    std::string Rows(int width = columns, int height = rows) const { return RowsOf(surface, width, height); }
    std::string Touched() const { return TouchedIn(surface, columns, rows); }
    std::vector<std::int32_t> Pixels() const {
        std::vector<std::int32_t> pixels;
        for (int y = 0; y < rows; ++y)
            for (int x = 0; x < columns; ++x) pixels.push_back(surface.Point(static_cast<float>(x), static_cast<float>(y)));
        return pixels;
    }
    Place Position() const { return {surface.CurrentX(), surface.CurrentY()}; }
    SiteUnderTest& Site() { return *host.SiteOf(easel); }

    HostUnderTest host;
    Easel& easel = host.Create<Easel>("Easel1", {.width = columns * 15, .height = rows * 15});
    frame::OwnSurface& surface = easel.Surface();
};

// Operations.

TEST_F(OwnSurfaceTest, ALineOfWidthOneTouchesItsPixelsWithoutTheLast) {
    surface.Line(0, 0, 5, 0, red);
    EXPECT_EQ(Touched(), "0,0 1,0 2,0 3,0 4,0");
    EXPECT_EQ(At(4, 0), red);
    EXPECT_EQ(Position(), Place(5, 0));
    surface.Cls();
    surface.Line(2, 6, 2, 3, blue);
    EXPECT_EQ(Touched(), "2,4 2,5 2,6") << "upwards too it leaves out its last pixel";
}

TEST_F(OwnSurfaceTest, ABoxIsItsOutlineWithBothCorners) {
    surface.Line(1, 1, 5, 4, red, draw::Box::Outline);
    EXPECT_EQ(Rows(),
              "............\n"
              ".rrrrr......\n"
              ".r...r......\n"
              ".r...r......\n"
              ".rrrrr......\n"
              "............\n"
              "............\n"
              "............\n");
    EXPECT_EQ(Position(), Place(5, 4));
}

TEST_F(OwnSurfaceTest, AFilledBoxHasBothCornersFromAnyCorner) {
    const std::string filled =
        "............\n"
        "............\n"
        ".bbbbb......\n"
        ".bbbbb......\n"
        ".bbbbb......\n"
        "............\n"
        "............\n"
        "............\n";
    surface.Line(5, 4, 1, 2, blue, draw::Box::Filled);
    EXPECT_EQ(Rows(), filled);
    surface.Cls();
    surface.Line(1, 4, 5, 2, blue, draw::Box::Filled);
    EXPECT_EQ(Rows(), filled);
}

TEST_F(OwnSurfaceTest, ABoxBeyondTheEdgesFillsAllOfTheSurface) {
    surface.Line(-5, -5, 500, 500, green, draw::Box::Filled);
    for (const std::int32_t pixel : Pixels()) EXPECT_EQ(pixel, static_cast<std::int32_t>(green.value));
}

TEST_F(OwnSurfaceTest, ACircleIsRoundAndEndsAtItsCentre) {
    surface.Circle(4, 3, 3, red);
    EXPECT_EQ(Rows(),
              "...rrr......\n"
              "..r...r.....\n"
              ".r.....r....\n"
              ".r.....r....\n"
              ".r.....r....\n"
              "..r...r.....\n"
              "...rrr......\n"
              "............\n");
    EXPECT_EQ(Position(), Place(4, 3));
}

TEST_F(OwnSurfaceTest, ADotIsOnePixelAndIsReadBack) {
    surface.PSet(3, 2, 0x123456);
    EXPECT_EQ(Touched(), "3,2");
    EXPECT_EQ(surface.Point(3, 2), 0x123456);
    EXPECT_EQ(Position(), Place(3, 2));
}

TEST_F(OwnSurfaceTest, AWidePenReachesHalfItsWidthAround) {
    surface.SetDrawWidth(3);
    surface.Line(2, 3, 6, 3, red);
    EXPECT_EQ(Rows(),
              "............\n"
              "............\n"
              ".rrrrrrr....\n"
              ".rrrrrrr....\n"
              ".rrrrrrr....\n"
              "............\n"
              "............\n"
              "............\n");
    surface.Cls();
    surface.PSet(4, 4, blue);
    EXPECT_EQ(Touched(), "3,3 4,3 5,3 3,4 4,4 5,4 3,5 4,5 5,5");
}

TEST_F(OwnSurfaceTest, APaintedPictureIsCopiedWhateverTheMode) {
    surface.SetDrawMode(draw::xorPen);
    surface.PaintPicture(Block(3, 2, blue), 2, 1);
    EXPECT_EQ(Touched(), "2,1 3,1 4,1 2,2 3,2 4,2");
    EXPECT_EQ(At(2, 1), blue);
    EXPECT_EQ(At(4, 2), blue);
}

TEST_F(OwnSurfaceTest, WithoutAColorTheForeColorDraws) {
    surface.SetForeColor(blue);
    surface.Line(0, 0, 2, 0);
    surface.PSet(5, 5);
    EXPECT_EQ(Touched(), "0,0 1,0 5,5");
    EXPECT_EQ(At(5, 5), blue);
}

TEST_F(OwnSurfaceTest, XorTwiceLeavesEveryPixelAsItWas) {
    surface.Line(0, 0, 7, 5, red, draw::Box::Filled);
    surface.Circle(6, 4, 3, blue);
    const std::vector<std::int32_t> pixels = Pixels();
    const frame::PictureRef image = surface.Image();
    const auto shapes = std::vector<std::function<void()>>{
        [&] { surface.Line(0, 7, 11, 0, 0xC0C0C0); },
        [&] { surface.Line(11, 3, 0, 3, 0x123456); },
        [&] { surface.Line(2, 1, 9, 6, 0x808080, draw::Box::Outline); },
        [&] { surface.Line(3, 2, 30, 5, 0x00FFFF, draw::Box::Filled); },
        [&] { surface.Circle(5, 4, 3, green); },
        [&] { surface.Circle(5, 4, 4, green, 0.5f, 4.0f, 0.5f); },
        [&] { surface.PSet(11, 7, white); },
    };
    surface.SetDrawMode(draw::xorPen);
    for (const std::int16_t width : {1, 2, 5}) {
        surface.SetDrawWidth(width);
        for (std::size_t i = 0; i < shapes.size(); ++i) {
            shapes[i]();
            EXPECT_NE(Pixels(), pixels) << i << " shows, with a pen of " << width;
            shapes[i]();
            EXPECT_EQ(Pixels(), pixels) << i << ", with a pen of " << width;
            EXPECT_TRUE(surface.Image()->EqualsObject(*image)) << i << ", with a pen of " << width;
        }
    }
}

// What is read back.

TEST_F(OwnSurfaceTest, OutsideTheInsideThereIsNoPixel) {
    EXPECT_EQ(At(columns - 1, rows - 1), white);
    EXPECT_EQ(surface.Point(columns, 0), -1);
    EXPECT_EQ(surface.Point(0, rows), -1);
    EXPECT_EQ(surface.Point(-1, 0), -1);
    EXPECT_EQ(surface.Point(0, -1), -1);
    surface.Line(-50, -50, 500, 500, red, draw::Box::Filled);
    EXPECT_EQ(surface.Point(columns, 0), -1) << "drawing there leaves nothing";
    EXPECT_EQ(surface.Point(0, rows), -1);
}

TEST_F(OwnSurfaceTest, ABorderMakesTheInsideSmallerByTwoPixelsOnEachSide) {
    surface.SetBorderStyle(1);
    EXPECT_EQ(surface.ScaleWidth(), columns - 4);
    EXPECT_EQ(At(columns - 5, rows - 5), white);
    EXPECT_EQ(surface.Point(columns - 4, 0), -1);
    EXPECT_EQ(surface.Point(0, rows - 4), -1);
    surface.SetBorderStyle(0);
    EXPECT_EQ(At(columns - 1, rows - 1), white);
}

TEST_F(OwnSurfaceTest, UntilSomethingIsDrawnItHasItsBackground) {
    EXPECT_EQ(Touched(), "");
    frame::OwnSurface& fresh = host.Create<Easel>("Easel2", {.width = 90, .height = 60}).Surface();
    const auto face = static_cast<std::int32_t>(OleTranslateColor(frame::colors::buttonFace, fresh.Colors()).value);
    EXPECT_EQ(fresh.Point(0, 0), face) << "that of a new surface";
    EXPECT_EQ(fresh.Point(89, 59), face);
    EXPECT_EQ(fresh.Point(90, 0), -1);
    const frame::PictureRef image = fresh.Image();
    const frame::PixelPlane* plane = image->Plane(1);
    ASSERT_TRUE(plane);
    EXPECT_EQ(plane->width, 6);
    EXPECT_EQ(plane->height, 4);
    EXPECT_EQ(plane->pixels, std::vector<std::uint32_t>(24, 0xFF000000u | static_cast<std::uint32_t>(face)));
}

TEST_F(OwnSurfaceTest, TheImageHasThePixelsInItsPlaneOfScaleOne) {
    surface.Line(1, 0, 3, 1, red, draw::Box::Filled);
    surface.PSet(11, 7, 0x123456);
    const std::vector<std::int32_t> shown = Pixels();
    const frame::PictureRef image = surface.Image();
    surface.Cls();
    EXPECT_EQ(image->Width(), columns * 15);
    EXPECT_EQ(image->Height(), rows * 15);
    const frame::PixelPlane* plane = image->Plane(1);
    ASSERT_TRUE(plane);
    EXPECT_EQ(plane->scale, 1);
    ASSERT_EQ(plane->width, columns);
    ASSERT_EQ(plane->height, rows);
    std::vector<std::int32_t> pixels;
    for (const std::uint32_t pixel : plane->pixels) {
        EXPECT_EQ(pixel >> 24, 0xFFu) << "each is opaque";
        pixels.push_back(static_cast<std::int32_t>(pixel & 0xFFFFFF));
    }
    EXPECT_EQ(pixels, shown) << "what showed when it was taken";
    surface.PaintPicture(image, 0, 4);
    EXPECT_EQ(Touched(), "1,4 2,4 3,4 1,5 2,5 3,5");
}

TEST_F(OwnSurfaceTest, ASurfaceAndThePictureBoxOnItAreDrawnApart) {
    child::PictureBox& box = easel.Picture1;
    box.SetBorderStyle(0);
    box.Move(0, 0, 180, 120);
    box.SetScaleMode(ScaleModeConstants::Pixels);
    box.SetBackColor(green);
    EXPECT_EQ(Touched(), "");
    surface.Line(0, 0, 11, 7, red, draw::Box::Filled);
    EXPECT_EQ(box.Point(3, 3), static_cast<std::int32_t>(green.value));
    box.PSet(3, 3, blue);
    EXPECT_EQ(At(3, 3), red);
}

// What wipes and what does not.

TEST_F(OwnSurfaceTest, ClearingGivesTheBackgroundAndGoesToTheOrigin) {
    surface.Line(0, 0, 11, 7, red, draw::Box::Filled);
    surface.Cls();
    EXPECT_EQ(Touched(), "");
    EXPECT_EQ(Position(), Place(0, 0));
}

TEST_F(OwnSurfaceTest, ANewBackgroundWipesTheDrawing) {
    surface.PSet(3, 3, red);
    surface.SetBackColor(blue);
    for (const std::int32_t pixel : Pixels()) EXPECT_EQ(pixel, static_cast<std::int32_t>(blue.value));
    surface.PSet(3, 3, red);
    surface.SetBackColor(blue);
    EXPECT_EQ(At(3, 3), red) << "the same background is no new one";
}

TEST_F(OwnSurfaceTest, ANewPictureWipesTheDrawingAndClearingShowsItAgain) {
    surface.PSet(3, 3, red);
    surface.SetPicture(Block(2, 1, green));
    EXPECT_EQ(Touched(), "0,0 1,0");
    EXPECT_EQ(At(0, 0), green);
    surface.Line(0, 0, 11, 7, red, draw::Box::Filled);
    EXPECT_EQ(At(0, 0), red);
    surface.Cls();
    EXPECT_EQ(Touched(), "0,0 1,0");
    surface.PSet(3, 3, red);
    surface.SetPicture(nullptr);
    EXPECT_EQ(Touched(), "");
}

TEST_F(OwnSurfaceTest, ThePictureOfItsImageIsWhatItShowed) {
    surface.Line(1, 1, 4, 2, blue, draw::Box::Filled);
    const std::string before = Rows();
    surface.SetPicture(surface.Image());
    EXPECT_EQ(Rows(), before);
    surface.PSet(1, 1, red);
    surface.Cls();
    EXPECT_EQ(Rows(), before);
}

TEST_F(OwnSurfaceTest, WhatIsDrawnStaysWhenTheControlGrows) {
    surface.Line(0, 0, 11, 7, red, draw::Box::Outline);
    Site().SetSize(240, 150);
    const std::string grown =
        "rrrrrrrrrrrr....-\n"
        "r..........r....-\n"
        "r..........r....-\n"
        "r..........r....-\n"
        "r..........r....-\n"
        "r..........r....-\n"
        "r..........r....-\n"
        "rrrrrrrrrrrr....-\n"
        "................-\n"
        "................-\n"
        "-----------------\n";
    EXPECT_EQ(Rows(17, 11), grown);
    surface.SetWidth(300);
    EXPECT_EQ(At(11, 7), red);
    EXPECT_EQ(At(19, 9), white);
    surface.PSet(19, 9, blue);
    EXPECT_EQ(At(19, 9), blue);
    EXPECT_EQ(surface.Point(20, 0), -1);
    EXPECT_EQ(surface.Image()->Width(), 300);
}

TEST_F(OwnSurfaceTest, WhatIsDrawnStaysInWhatIsLeftOfASmallerControl) {
    surface.Line(0, 0, 11, 0, red);
    Site().SetSize(90, 60);
    EXPECT_EQ(Rows(7, 5),
              "rrrrrr-\n"
              "......-\n"
              "......-\n"
              "......-\n"
              "-------\n");
}

TEST_F(OwnSurfaceTest, RepaintingHidingAndAnotherLookKeepWhatIsDrawn) {
    surface.Line(1, 1, 4, 2, blue, draw::Box::Filled);
    const std::string before = Rows();
    surface.Refresh();
    host.Frame().Flush();
    EXPECT_EQ(Rows(), before);
    Site().SetVisible(false);
    host.Frame().Flush();
    Site().SetVisible(true);
    Site().SetPlace(150, 75);
    EXPECT_EQ(Rows(), before);
    surface.SetEnabled(false);
    surface.SetAppearance(0);
    surface.SetForeColor(red);
    surface.SetFont(std::make_shared<frame::Font>("Serif", 20.0));
    surface.SetDrawWidth(9);
    surface.SetDrawMode(draw::xorPen);
    EXPECT_EQ(Rows(), before);
}

TEST_F(OwnSurfaceTest, ManyOperationsWithoutClearingAreAllThere) {
    surface.SetDrawMode(draw::xorPen);
    constexpr int passes = 50'001;  // more than is kept as operations
    for (int pass = 0; pass < passes; ++pass) surface.PSet(static_cast<float>(pass % 2), 0, white);
    EXPECT_EQ(At(0, 0), black) << "an odd number of times";
    EXPECT_EQ(At(1, 0), white) << "an even number of times";
    surface.SetDrawMode(draw::copyPen);
    surface.PSet(2, 0, red);
    EXPECT_EQ(Touched(), "0,0 2,0");
}

// Scales.

TEST_F(OwnSurfaceTest, AllScalesAgreeOnWhereAPointIs) {
    // The middle of the pixel 4, 3.
    const struct {
        ScaleModeConstants mode;
        float x, y;
    } middles[] = {
        {ScaleModeConstants::Twips, 67.5f, 52.5f},
        {ScaleModeConstants::Points, 3.375f, 2.625f},
        {ScaleModeConstants::Pixels, 4.5f, 3.5f},
        {ScaleModeConstants::Characters, 0.5625f, 0.21875f},
        {ScaleModeConstants::Inches, 0.046875f, 0.0364583f},
        {ScaleModeConstants::Millimetres, 1.190625f, 0.9260417f},
        {ScaleModeConstants::Centimetres, 0.1190625f, 0.09260417f},
    };
    for (const auto& [drawn, x, y] : middles) {
        surface.Cls();
        surface.SetScaleMode(drawn);
        surface.PSet(x, y, red);
        for (const auto& [read, readX, readY] : middles) {
            surface.SetScaleMode(read);
            EXPECT_EQ(surface.Point(readX, readY), static_cast<std::int32_t>(red.value))
                << static_cast<int>(drawn) << " " << static_cast<int>(read);
        }
        surface.SetScaleMode(ScaleModeConstants::Pixels);
        EXPECT_EQ(Touched(), "4,3") << static_cast<int>(drawn);
    }
}

TEST_F(OwnSurfaceTest, APixelIsFifteenTwipsWide) {
    surface.PSet(4, 3, red);
    surface.SetScaleMode(ScaleModeConstants::Twips);
    EXPECT_EQ(At(60, 45), red);
    EXPECT_EQ(At(74, 59), red);
    EXPECT_EQ(At(59, 45), white);
    EXPECT_EQ(At(75, 45), white);
    EXPECT_EQ(At(60, 44), white);
    EXPECT_EQ(At(60, 60), white);
    EXPECT_EQ(At(179, 119), white);
    EXPECT_EQ(surface.Point(180, 0), -1);
    EXPECT_EQ(surface.Point(0, 120), -1);
}

TEST_F(OwnSurfaceTest, LinesAndCirclesInTwipsAreThoseInPixels) {
    surface.Line(0, 0, 5, 0, red);
    surface.Line(1, 2, 5, 4, blue, draw::Box::Filled);
    surface.Circle(8, 4, 3, green);
    const std::string inPixels = Rows();
    surface.Cls();
    surface.SetScaleMode(ScaleModeConstants::Twips);
    surface.Line(0, 0, 75, 0, red);
    surface.Line(15, 30, 75, 60, blue, draw::Box::Filled);
    surface.Circle(120, 60, 45, green);
    surface.SetScaleMode(ScaleModeConstants::Pixels);
    EXPECT_EQ(Rows(), inPixels);
    EXPECT_EQ(inPixels.substr(0, 6), "rrrrr.");
}

TEST_F(OwnSurfaceTest, AUsersScaleHasItsOwnOriginAndSize) {
    surface.SetScaleLeft(-1);
    surface.SetScaleTop(10);
    surface.SetScaleWidth(6);
    surface.SetScaleHeight(4);
    surface.PSet(1, 11.5f, red);
    EXPECT_EQ(surface.Point(1.25f, 11.75f), static_cast<std::int32_t>(red.value));
    EXPECT_EQ(surface.Point(-1.5f, 11), -1);
    EXPECT_EQ(surface.Point(5, 11), -1) << "the right edge";
    surface.SetScaleMode(ScaleModeConstants::Pixels);
    EXPECT_EQ(Touched(), "4,3");
}

}  // namespace
}  // namespace tessel::test::drawing
