#include "tests/controls/drawing/DrawingTestHelp.h"

namespace tessel::test::drawing {
namespace {

using Place = std::pair<float, float>;

TEST_F(DrawingTest, TheCurrentPositionIsConvertedWithTheScale) {
    box.SetCurrentX(6);
    box.SetCurrentY(4);
    const struct {
        ScaleModeConstants mode;
        float x, y;
    } expected[] = {
        {ScaleModeConstants::Twips, 90, 60},
        {ScaleModeConstants::Points, 4.5f, 3},
        {ScaleModeConstants::Characters, 0.75f, 0.25f},
        {ScaleModeConstants::Inches, 0.0625f, 60.0f / 1440},
        {ScaleModeConstants::Millimetres, 1.5875f, 1.0583333f},
        {ScaleModeConstants::Centimetres, 0.15875f, 0.10583333f},
        {ScaleModeConstants::Pixels, 6, 4},
    };
    for (const auto& [mode, x, y] : expected) {
        box.SetScaleMode(mode);
        EXPECT_NEAR(box.CurrentX(), x, 1e-5) << static_cast<int>(mode);
        EXPECT_NEAR(box.CurrentY(), y, 1e-5) << static_cast<int>(mode);
    }
}

TEST_F(DrawingTest, TheInsideIsMeasuredInTheScale) {
    EXPECT_EQ(box.ScaleWidth(), 12);
    EXPECT_EQ(box.ScaleHeight(), 8);
    box.SetScaleMode(ScaleModeConstants::Twips);
    EXPECT_EQ(box.ScaleWidth(), 180);
    box.SetScaleMode(ScaleModeConstants::Points);
    EXPECT_EQ(box.ScaleWidth(), 9);
    EXPECT_EQ(box.ScaleHeight(), 6);
    EXPECT_EQ(box.Width(), 180) << "the box itself stays in twips";
}

TEST_F(DrawingTest, OperationsAreInTheScale) {
    box.SetScaleMode(ScaleModeConstants::Twips);
    box.Line(15, 30, 60, 30, red);
    EXPECT_EQ(At(15, 30), red);
    EXPECT_EQ(At(59, 44), red) << "the same pixel as 45, 30";
    EXPECT_EQ(At(60, 30), white) << "the end is not drawn";
    box.SetScaleMode(ScaleModeConstants::Pixels);
    EXPECT_EQ(Touched(), "1,2 2,2 3,2");
}

TEST_F(DrawingTest, AUsersScaleHasItsOwnOriginAndSize) {
    box.SetScaleLeft(-1);
    box.SetScaleTop(10);
    box.SetScaleWidth(6);
    box.SetScaleHeight(4);
    EXPECT_EQ(box.ScaleMode(), ScaleModeConstants::User);
    box.PSet(0, 11, red);
    box.Cls();
    EXPECT_EQ(Position(), Place(-1, 10));
    box.PSet(0, 11, red);
    box.SetScaleMode(ScaleModeConstants::Pixels);
    EXPECT_EQ(Touched(), "2,2");
}

TEST_F(DrawingTest, ThePensWidthIsInPixelsInAnyScale) {
    box.SetScaleMode(ScaleModeConstants::Twips);
    box.SetDrawWidth(3);
    box.PSet(75, 60, red);
    box.SetScaleMode(ScaleModeConstants::Pixels);
    EXPECT_EQ(At(4, 4), red);
    EXPECT_EQ(At(6, 4), red);
    EXPECT_EQ(At(7, 4), white);
}

TEST_F(DrawingTest, ABorderMakesTheInsideSmallerByTwoPixelsOnEachSide) {
    box.SetBorderStyle(1);
    EXPECT_EQ(box.ScaleWidth(), 8);
    EXPECT_EQ(box.ScaleHeight(), 4);
    box.Line(0, 0, 20, 0, red);
    EXPECT_EQ(Touched(), "0,0 1,0 2,0 3,0 4,0 5,0 6,0 7,0");
    EXPECT_EQ(box.Point(8, 0), -1);
}

}  // namespace
}  // namespace tessel::test::drawing
