#include "tests/ErrorOf.h"
#include "tests/controls/drawing/DrawingTestHelp.h"

namespace tessel::test::drawing {
namespace {

using Place = std::pair<float, float>;

TEST_F(DrawingTest, ALineOfWidthOneTouchesItsPixelsWithoutTheLast) {
    box.Line(0, 0, 5, 0, red);
    EXPECT_EQ(Touched(), "0,0 1,0 2,0 3,0 4,0");
    EXPECT_EQ(At(4, 0), red);
    EXPECT_EQ(Recorded(), (Operations{draw::Line{0, 0, 5, 0, red, draw::Box::None}}));
    EXPECT_EQ(Position(), Place(5, 0));
}

TEST_F(DrawingTest, ASlopingLineHasOnePixelInEachColumn) {
    box.Line(0, 0, 6, 3, red);
    EXPECT_EQ(Touched(), "0,0 1,0 2,1 3,1 4,2 5,2");
    box.Cls();
    box.Line(2, 6, 2, 3, red);
    EXPECT_EQ(Touched(), "2,4 2,5 2,6") << "upwards too it leaves out its last pixel";
}

TEST_F(DrawingTest, ABoxIsItsOutlineWithBothCorners) {
    box.Line(1, 1, 5, 4, red, draw::Box::Outline);
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

TEST_F(DrawingTest, AFilledBoxIsItsOutlineAndItsInsideFromAnyCorner) {
    box.Line(5, 4, 1, 2, blue, draw::Box::Filled);
    EXPECT_EQ(Rows(),
              "............\n"
              "............\n"
              ".bbbbb......\n"
              ".bbbbb......\n"
              ".bbbbb......\n"
              "............\n"
              "............\n"
              "............\n");
}

TEST_F(DrawingTest, ABoxBeyondTheEdgesFillsAllOfTheSurface) {
    box.Line(-5, -5, 500, 500, green, draw::Box::Filled);
    for (const char pixel : Rows()) EXPECT_TRUE(pixel == 'g' || pixel == '\n');
}

TEST_F(DrawingTest, FlagsByNameMakeTheBoxesInAnyCase) {
    box.LineWithFlags(0, 0, 2, 1, red, "b");
    box.LineWithFlags(4, 0, 6, 2, blue, "BF");
    EXPECT_EQ(Touched(), "0,0 1,0 2,0 4,0 5,0 6,0 0,1 1,1 2,1 4,1 5,1 6,1 4,2 5,2 6,2");
    EXPECT_EQ(ErrorOf([&] { box.LineWithFlags(0, 0, 1, 1, red, "F"); }), frame::errors::invalidCall);
}

TEST_F(DrawingTest, ACircleIsRoundAndEndsAtItsCentre) {
    box.Circle(4, 3, 3, red);
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

TEST_F(DrawingTest, AnArcIsPartOfItsCircleAndAnAspectMakesAnEllipse) {
    constexpr float right = 0, up = 1.5707964f;
    box.Circle(4, 4, 3, red, right, up);
    EXPECT_EQ(At(7, 4), red) << "it begins to the right";
    EXPECT_EQ(At(4, 1), red) << "and ends at the top";
    EXPECT_EQ(At(1, 4), white);
    EXPECT_EQ(At(4, 7), white);

    box.Cls();
    box.Circle(5, 4, 4, blue, {}, {}, 0.5f);
    EXPECT_EQ(At(1, 4), blue);
    EXPECT_EQ(At(9, 4), blue);
    EXPECT_EQ(At(5, 2), blue) << "half as high as it is wide";
    EXPECT_EQ(At(5, 6), blue);
    EXPECT_EQ(At(5, 0), white);

    box.Cls();
    box.Circle(5, 4, 3, blue, {}, {}, 3.0f);
    EXPECT_EQ(At(5, 1), blue) << "the radius is the longer half axis";
    EXPECT_EQ(At(5, 7), blue);
    EXPECT_EQ(At(6, 4), blue);
    EXPECT_EQ(At(8, 4), white);
}

TEST_F(DrawingTest, APointIsOnePixelAndIsReadBack) {
    box.PSet(3, 2, 0x123456);
    EXPECT_EQ(Touched(), "3,2");
    EXPECT_EQ(box.Point(3, 2), 0x123456);
    EXPECT_EQ(Position(), Place(3, 2));
    EXPECT_EQ(box.Point(12, 0), -1);
    EXPECT_EQ(box.Point(0, 8), -1);
    EXPECT_EQ(box.Point(-1, 0), -1);
}

TEST_F(DrawingTest, AWidePenReachesHalfItsWidthAround) {
    box.SetDrawWidth(3);
    box.Line(2, 3, 6, 3, red);
    EXPECT_EQ(Rows(),
              "............\n"
              "............\n"
              ".rrrrrrr....\n"
              ".rrrrrrr....\n"
              ".rrrrrrr....\n"
              "............\n"
              "............\n"
              "............\n")
        << "the brush goes from the first pixel to the last";
    EXPECT_EQ(Recorded(), (Operations{draw::DrawWidth{3}, draw::Line{2, 3, 6, 3, red, draw::Box::None}}));
}

TEST_F(DrawingTest, ABrokenLineLeavesPixelsOutAndTheTransparentPenDrawsNone) {
    box.SetDrawStyle(draw::dot);
    box.Line(0, 0, 12, 0, red);
    EXPECT_EQ(Rows().substr(0, 13), "rrr...rrr...\n");
    box.SetDrawStyle(draw::transparent);
    box.Line(0, 1, 12, 1, red);
    box.Circle(5, 4, 2, red);
    EXPECT_EQ(Rows().substr(13, 13), "............\n");
    EXPECT_EQ(At(7, 4), white);
}

TEST_F(DrawingTest, XorCombinesTheColorWithThePixel) {
    box.SetDrawMode(draw::xorPen);
    box.PSet(1, 1, 0x0F0F0F);
    EXPECT_EQ(At(1, 1), OLE_COLOR(0xF0F0F0));
    box.SetDrawMode(draw::copyPen);
    box.PSet(1, 1, 0x0F0F0F);
    EXPECT_EQ(At(1, 1), OLE_COLOR(0x0F0F0F));
}

TEST_F(DrawingTest, XorTwiceLeavesEveryPixelAsItWas) {
    box.Line(0, 0, 7, 5, red, draw::Box::Filled);
    box.Circle(6, 4, 3, blue);
    const frame::PictureRef before = box.Image();
    const auto shapes = std::vector<std::function<void()>>{
        [&] { box.Line(0, 7, 11, 0, 0xC0C0C0); },
        [&] { box.Line(11, 3, 0, 3, 0x123456); },
        [&] { box.Line(2, 1, 9, 6, 0x808080, draw::Box::Outline); },
        [&] { box.Line(3, 2, 30, 5, 0x00FFFF, draw::Box::Filled); },
        [&] { box.Circle(5, 4, 3, green); },
        [&] { box.Circle(5, 4, 4, green, 0.5f, 4.0f, 0.5f); },
        [&] { box.PSet(11, 7, white); },
    };
    box.SetDrawMode(draw::xorPen);
    for (const std::int16_t width : {1, 2, 5}) {
        box.SetDrawWidth(width);
        for (std::size_t i = 0; i < shapes.size(); ++i) {
            shapes[i]();
            EXPECT_FALSE(box.Image()->EqualsObject(*before)) << i << " shows, with a pen of " << width;
            shapes[i]();
            EXPECT_TRUE(box.Image()->EqualsObject(*before)) << i << ", with a pen of " << width;
        }
    }
}

TEST_F(DrawingTest, WithoutAColorTheForeColorDraws) {
    box.SetForeColor(blue);
    box.Line(0, 0, 2, 0);
    box.PSet(5, 5);
    EXPECT_EQ(At(1, 0), blue);
    EXPECT_EQ(At(5, 5), blue);
}

TEST_F(DrawingTest, TextIsMeasuredInPixelsAndPrintingGoesToTheNextLine) {
    EXPECT_EQ(box.TextWidth("93%"), 18);
    EXPECT_EQ(box.TextHeight("93%"), 13);
    box.SetCurrentX(4);
    box.SetCurrentY(2);
    box.Print("93%");
    EXPECT_EQ(Recorded(), (Operations{draw::Print{"93%", 4, 2}}));
    EXPECT_EQ(Position(), Place(0, 15));
}

TEST_F(DrawingTest, ClearingGivesTheBackgroundAndGoesToTheOrigin) {
    box.Line(0, 0, 11, 7, red, draw::Box::Filled);
    box.Cls();
    EXPECT_TRUE(IsBlank());
    EXPECT_EQ(Position(), Place(0, 0));
    EXPECT_EQ(Recorded().back(), frame::DrawOp(draw::Cls{}));
}

TEST_F(DrawingTest, APaintedPictureIsCopiedWhateverTheMode) {
    box.SetDrawMode(draw::xorPen);
    box.PaintPicture(Block(3, 2, blue), 2, 1);
    EXPECT_EQ(Touched(), "2,1 3,1 4,1 2,2 3,2 4,2");
    EXPECT_EQ(At(2, 1), blue);
    EXPECT_EQ(ErrorOf([&] { box.PaintPicture(nullptr, 0, 0); }), frame::errors::invalidPicture);
}

TEST_F(DrawingTest, TheImageIsASnapshotOfAllPixels) {
    box.Line(0, 0, 3, 1, red, draw::Box::Filled);
    const frame::PictureRef image = box.Image();
    box.Cls();
    EXPECT_EQ(image->Width(), 180);
    EXPECT_EQ(image->Height(), 120);
    const frame::PixelPlane* plane = image->Plane(1);
    ASSERT_TRUE(plane);
    EXPECT_EQ(plane->pixels[1], 0xFF0000FFu);
    EXPECT_EQ(plane->pixels[5], 0xFFFFFFFFu);
    box.PaintPicture(image, 0, 4);
    EXPECT_EQ(At(1, 5), red);
    EXPECT_EQ(At(1, 1), white);
}

}  // namespace
}  // namespace tessel::test::drawing
