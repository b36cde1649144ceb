#include "tests/controls/drawing/DrawingTestHelp.h"

namespace tessel::test::drawing {
namespace {

TEST_F(DrawingTest, ANewBackgroundWipesTheDrawingWithoutAnOperation) {
    box.PSet(3, 3, red);
    Recorded();
    host.log.Clear();
    box.SetBackColor(blue);
    EXPECT_EQ(At(3, 3), blue);
    EXPECT_EQ(Recorded(), Operations{});
    EXPECT_TRUE(host.log.Of("draw").empty());
    box.PSet(3, 3, red);
    box.SetBackColor(blue);
    EXPECT_EQ(At(3, 3), red) << "the same background is no new one";
}

TEST_F(DrawingTest, ANewPictureWipesTheDrawingWithoutAnOperation) {
    box.PSet(3, 3, red);
    Recorded();
    host.log.Clear();
    box.SetPicture(Block(4, 2, green));
    EXPECT_EQ(Touched(), "0,0 1,0 2,0 3,0 0,1 1,1 2,1 3,1");
    EXPECT_EQ(At(0, 0), green);
    EXPECT_EQ(Recorded(), Operations{});
    EXPECT_TRUE(host.log.Of("draw").empty());
}

TEST_F(DrawingTest, ClearingShowsThePictureAgain) {
    box.SetPicture(Block(2, 1, green));
    box.Line(0, 0, 11, 7, red, draw::Box::Filled);
    box.Cls();
    EXPECT_EQ(Touched(), "0,0 1,0");
    box.SetPicture(nullptr);
    EXPECT_TRUE(IsBlank());
}

TEST_F(DrawingTest, ThePictureOfAnImageIsWhatTheBoxShowed) {
    box.Line(1, 1, 4, 2, blue, draw::Box::Filled);
    const std::string before = Rows();
    box.SetPicture(box.Image());
    EXPECT_EQ(Rows(), before);
    box.PSet(1, 1, red);
    box.Cls();
    EXPECT_EQ(Rows(), before);
}

TEST_F(DrawingTest, AnotherSizeKeepsWhatIsDrawn) {
    box.Line(0, 0, 5, 0, red);
    box.Move(0, 0, 300, 150);
    EXPECT_EQ(Touched(), "0,0 1,0 2,0 3,0 4,0");
    EXPECT_EQ(At(19, 9), white);
    box.Line(15, 0, 20, 0, blue);
    EXPECT_EQ(At(19, 0), blue);
    box.Move(0, 0, 45, 30);
    EXPECT_EQ(Touched(), "0,0 1,0 2,0");
    box.Move(0, 0, 300, 150);
    EXPECT_EQ(Touched(), "0,0 1,0 2,0") << "what was cut off has gone";
}

TEST_F(DrawingTest, ALargerBoxShowsMoreOfItsPicture) {
    box.SetPicture(Block(14, 1, green));
    box.PSet(0, 0, red);
    box.Move(0, 0, 240, 120);
    EXPECT_EQ(Rows().substr(0, 17), "rggggggggggggg..\n");
}

TEST_F(DrawingTest, HidingMovingAndDisablingKeepWhatIsDrawn) {
    box.Line(1, 1, 4, 2, blue, draw::Box::Filled);
    const std::string before = Rows();
    box.SetVisible(false);
    host.Frame().Flush();
    box.SetVisible(true);
    box.Move(30, 45, 180, 120);
    box.SetEnabled(false);
    box.Refresh();
    host.Frame().Flush();
    EXPECT_EQ(Rows(), before);
}

TEST_F(DrawingTest, AnotherForeColorFontOrPenKeepsWhatIsDrawn) {
    box.Line(1, 1, 4, 2, blue, draw::Box::Filled);
    const std::string before = Rows();
    box.SetForeColor(red);
    box.SetFont(std::make_shared<frame::Font>("Serif", 20.0));
    box.SetDrawWidth(9);
    box.SetDrawMode(draw::xorPen);
    box.SetScaleMode(ScaleModeConstants::Inches);
    box.SetScaleMode(ScaleModeConstants::Pixels);
    EXPECT_EQ(Rows(), before);
}

TEST_F(DrawingTest, ManyOperationsWithoutClearingAreAllThere) {
    box.SetDrawMode(draw::xorPen);
    constexpr int passes = 50'001;  // more than is kept as operations
    for (int pass = 0; pass < passes; ++pass) box.PSet(static_cast<float>(pass % 2), 0, white);
    EXPECT_EQ(At(0, 0), black) << "an odd number of times";
    EXPECT_EQ(At(1, 0), white) << "an even number of times";
    box.SetDrawMode(draw::copyPen);
    box.PSet(2, 0, red);
    EXPECT_EQ(Rows().substr(0, 4), "k.r.");
}

TEST_F(DrawingTest, APictureThatWasPaintedManyTimesIsThere) {
    for (int pass = 0; pass < 40; ++pass) box.PaintPicture(Block(400, 400, pass % 2 == 0 ? red : green), 0, 0);
    EXPECT_EQ(At(11, 7), green);
    box.Cls();
    EXPECT_TRUE(IsBlank());
}

TEST_F(DrawingTest, ABoxThatWasReadBeforeItGrewIsReadAllOver) {
    EXPECT_EQ(box.Point(12, 0), -1);
    box.Move(0, 0, 195, 120);
    EXPECT_EQ(At(12, 7), white);
}

}  // namespace
}  // namespace tessel::test::drawing
