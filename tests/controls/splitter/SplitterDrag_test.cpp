#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "tests/HostUnderTest.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

/// The bar under the pointer, and the limits that hold it. The form of a stage is 6000 wide and 4000 high.
namespace tessel::controls {
namespace {

using frame::Variant;
using frame::VarType;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace splittertest;

class SplitterDrag : public testing::Test {
  protected:
    frame::Control& bar() { return stage.Bar(); }
    float Left() { return stage.Site().Left(); }
    float Top() { return stage.Site().Top(); }
    std::vector<std::string> AfterMoves() const { return stage.Deeds("AfterMove"); }

    Stage stage;
};

TEST_F(SplitterDrag, AHorizontalBarFollowsThePointerUpAndDown) {
    stage.LayHorizontal(1000);
    Press(bar(), 500, 60);
    MoveTo(bar(), 500, 160);
    EXPECT_EQ(Top(), 1100);
    EXPECT_EQ(Left(), 0);
    MoveTo(bar(), 500, 10);
    EXPECT_EQ(Top(), 1050);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(0, 100)", "AfterMove(0, -50)"));
}

TEST_F(SplitterDrag, AVerticalBarFollowsThePointerLeftAndRight) {
    stage.LayVertical(2000);
    Press(bar(), 60, 500);
    MoveTo(bar(), 260, 500);
    EXPECT_EQ(Left(), 2200);
    EXPECT_EQ(Top(), 0);
    MoveTo(bar(), 50, 500);
    EXPECT_EQ(Left(), 2190);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(200, 0)", "AfterMove(-10, 0)"));
}

TEST_F(SplitterDrag, TheOtherCoordinateOfThePointerCountsForNothing) {
    stage.LayHorizontal(1000);
    Press(bar(), 500, 60);
    MoveTo(bar(), 900, 60);
    EXPECT_EQ(Left(), 0);
    EXPECT_EQ(Top(), 1000);
    Release(bar());
    stage.LayVertical(2000);
    Press(bar(), 60, 500);
    MoveTo(bar(), 60, 900);
    EXPECT_EQ(Left(), 2000);
    EXPECT_EQ(Top(), 0);
    EXPECT_THAT(AfterMoves(), IsEmpty());
}

TEST_F(SplitterDrag, TheSizeOfTheBarStays) {
    stage.LayHorizontal(1000);
    DragBy(bar(), 30, 70);
    EXPECT_EQ(stage.Site().Width(), 6000);
    EXPECT_EQ(stage.Site().Height(), thick);
}

TEST_F(SplitterDrag, AnyButtonStartsADrag) {
    for (const std::int16_t button : {std::int16_t{1}, std::int16_t{2}, std::int16_t{4}, std::int16_t{0}, std::int16_t{3}}) {
        stage.LayHorizontal(1000);
        Press(bar(), 50, 50, button);
        MoveTo(bar(), 50, 150);
        Release(bar());
        EXPECT_EQ(Top(), 1100) << button;
    }
}

TEST_F(SplitterDrag, APressInTheStripStartsADragToo) {
    stage.LayHorizontal(1000);
    Press(bar(), 0, 5);
    MoveTo(bar(), 0, 105);
    EXPECT_EQ(Top(), 1100);
}

TEST_F(SplitterDrag, NothingMovesWithoutAPress) {
    stage.LayHorizontal(1000);
    MoveTo(bar(), 500, 60);
    MoveTo(bar(), 500, 500);
    EXPECT_EQ(Top(), 1000);
    EXPECT_THAT(AfterMoves(), IsEmpty());
}

TEST_F(SplitterDrag, NothingMovesAfterTheRelease) {
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    MoveTo(bar(), 50, 500);
    EXPECT_EQ(Top(), 1100);
    EXPECT_EQ(AfterMoves().size(), 1u);
}

TEST_F(SplitterDrag, ASecondPressTakesItsOwnPlace) {
    stage.LayHorizontal(1000);
    Press(bar(), 500, 60);
    Press(bar(), 500, 20);
    MoveTo(bar(), 500, 30);
    EXPECT_EQ(Top(), 1010);
}

TEST_F(SplitterDrag, AReleaseOfAnyButtonEndsTheDrag) {
    stage.LayHorizontal(1000);
    Press(bar(), 50, 50, 1);
    Press(bar(), 50, 50, 2);
    Mouse(bar(), "MouseUp", 50, 50, 2);
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1000);
}

TEST_F(SplitterDrag, AMoveThatChangesNothingRaisesNoAfterMove) {
    stage.LayHorizontal(1000);
    Press(bar(), 500, 60);
    MoveTo(bar(), 500, 60);
    MoveTo(bar(), 900, 60);
    EXPECT_THAT(stage.Moves(), IsEmpty());
}

// Limits.

TEST_F(SplitterDrag, WithoutLimitsTheBarStaysWhollyWithinTheForm) {
    stage.LayHorizontal(1000);
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 50 + 99'999);
    EXPECT_EQ(Top(), 3880);  // 4000 - 120
    MoveTo(bar(), 50, 50 - 99'999);
    EXPECT_EQ(Top(), 0);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(0, 2880)", "AfterMove(0, -3880)"));
}

TEST_F(SplitterDrag, WithoutLimitsAVerticalBarStaysWhollyWithinTheForm) {
    stage.LayVertical(1000);
    Press(bar(), 50, 50);
    MoveTo(bar(), 99'999, 50);
    EXPECT_EQ(Left(), 5880);  // 6000 - 120
    MoveTo(bar(), -99'999, 50);
    EXPECT_EQ(Left(), 0);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(4880, 0)", "AfterMove(-5880, 0)"));
}

TEST_F(SplitterDrag, MinTopLeftStopsTheBarAndCutsTheDistance) {
    bar().Put("MinTopLeft", 700);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, -500);
    EXPECT_EQ(Top(), 700);
    stage.LayVertical(1000);
    DragBy(bar(), -500, 0);
    EXPECT_EQ(Left(), 700);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(-300, 0)"));
}

TEST_F(SplitterDrag, MinBottomRightIsTheLeastRoomBehindTheBar) {
    bar().Put("MinBottomRight", 900);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 3000);
    EXPECT_EQ(Top(), 2980);  // 4000 - 900 - 120
    stage.LayVertical(1000);
    DragBy(bar(), 5000, 0);
    EXPECT_EQ(Left(), 4980);  // 6000 - 900 - 120
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(3980, 0)"));
}

TEST_F(SplitterDrag, TheLimitsThemselvesAreReached) {
    bar().Put("MinTopLeft", 700);
    bar().Put("MinBottomRight", 900);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, -300);
    EXPECT_EQ(Top(), 700);
    DragBy(bar(), 0, 2280);
    EXPECT_EQ(Top(), 2980);
}

TEST_F(SplitterDrag, WhenBothLimitsExceedTheFormTheBottomRightOneWins) {
    bar().Put("MinTopLeft", 3000);
    bar().Put("MinBottomRight", 2000);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 10);
    EXPECT_EQ(Top(), 1880);  // 4000 - 2000 - 120, above the 3000 of MinTopLeft
    bar().Put("MinTopLeft", 5000);
    stage.LayVertical(1000);
    DragBy(bar(), 10, 0);
    EXPECT_EQ(Left(), 3880);  // 6000 - 2000 - 120
}

TEST_F(SplitterDrag, MinBottomRightMayPushTheBarOutOfTheForm) {
    bar().Put("MinBottomRight", 5000);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 10);
    EXPECT_EQ(Top(), -1120);  // 4000 - 5000 - 120
}

TEST_F(SplitterDrag, NegativeLimitsLetTheBarOut) {
    bar().Put("MinTopLeft", -500);
    bar().Put("MinBottomRight", -300);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, -9000);
    EXPECT_EQ(Top(), -500);
    DragBy(bar(), 0, 9000);
    EXPECT_EQ(Top(), 4180);  // 4000 + 300 - 120
}

TEST_F(SplitterDrag, TheThicknessIsTheBarsOwn) {
    stage.Lay(horizontal, 0, 1000, 6000, 500);
    DragBy(bar(), 0, 9000);
    EXPECT_EQ(Top(), 3500);
    stage.Lay(vertical, 1000, 0, 700, 4000);
    DragBy(bar(), 9000, 0);
    EXPECT_EQ(Left(), 5300);
}

TEST_F(SplitterDrag, AMoveThatALimitReducesToNothingRaisesNoAfterMove) {
    bar().Put("MinTopLeft", 1000);
    stage.LayHorizontal(1000);
    stage.Add("Text1");
    bar().Put("ControlsTopLeft", "Text1");
    stage.Forget();
    DragBy(bar(), 0, -200);
    EXPECT_THAT(stage.Moves(), IsEmpty());
    stage.LayHorizontal(3880);
    DragBy(bar(), 0, 200);
    EXPECT_THAT(stage.Moves(), IsEmpty());
}

TEST_F(SplitterDrag, ABarBeyondItsLimitComesBackAtTheFirstMove) {
    bar().Put("MinTopLeft", 700);
    stage.LayHorizontal(200);
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 50);
    EXPECT_EQ(Top(), 700);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(0, 500)"));
}

TEST_F(SplitterDrag, ALimitSetDuringADragHoldsFromTheNextMove) {
    stage.LayHorizontal(1000);
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 0);
    EXPECT_EQ(Top(), 950);
    bar().Put("MinTopLeft", 2000);
    MoveTo(bar(), 50, 50);
    EXPECT_EQ(Top(), 2000);
}

TEST_F(SplitterDrag, AFormOfSizeZeroGivesNoLowerLimit) {
    bar().Put("MinTopLeft", 700);
    bar().Put("MinBottomRight", 900);
    stage.form.SetMember("ScaleHeight", 0.0f);
    stage.form.SetMember("ScaleWidth", 0.0f);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 50'000);
    EXPECT_EQ(Top(), 51'000);
    DragBy(bar(), 0, -90'000);
    EXPECT_EQ(Top(), 700);
    stage.LayVertical(1000);
    DragBy(bar(), 50'000, 0);
    EXPECT_EQ(Left(), 51'000);
}

TEST_F(SplitterDrag, AFormOfNegativeSizeGivesNoLowerLimit) {
    stage.form.SetMember("ScaleHeight", -4000.0f);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 50'000);
    EXPECT_EQ(Top(), 51'000);
}

TEST_F(SplitterDrag, AFormWhoseSizeCannotBeReadGivesNoLowerLimit) {
    bar().Put("MinTopLeft", 700);
    stage.form.unreadable = {"ScaleWidth", "ScaleHeight"};
    stage.LayHorizontal(1000);
    stage.Site().SetSize(6000, thick);
    DragBy(bar(), 0, 50'000);
    EXPECT_EQ(Top(), 51'000);
    DragBy(bar(), 0, -90'000);
    EXPECT_EQ(Top(), 700);
    stage.LayVertical(1000);
    DragBy(bar(), 50'000, 0);
    EXPECT_EQ(Left(), 51'000);
}

TEST_F(SplitterDrag, WithoutAFormThereIsNoLowerLimit) {
    stage.parent = nullptr;
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 50'000);
    EXPECT_EQ(Top(), 51'000);
}

TEST_F(SplitterDrag, TheFormOfTheLimitIsTheParentEvenWithoutAName) {
    stage.form.SetMember("Name", "");
    stage.AddBare("Form2", {{"Name", "Form2"}, {"ScaleWidth", 500.0f}, {"ScaleHeight", 500.0f}});
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 50'000);
    EXPECT_EQ(Top(), 3880);
}

TEST_F(SplitterDrag, TheSizeOfTheFormIsReadAtEachStep) {
    stage.LayHorizontal(1000);
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 9000);
    stage.form.SetMember("ScaleHeight", 3000.0f);
    MoveTo(bar(), 50, 9000);
    EXPECT_EQ(Top(), 2880);
}

// 32-bit floats.

TEST_F(SplitterDrag, TheStepIsReckonedIn32BitFloats) {
    stage.LayHorizontal(1000.7f);
    Press(bar(), 50, 100.1f);
    Variant dx, dy;
    stage.on["AfterMove"] = [&](frame::EventArguments arguments) {
        dx = arguments[0].Get();
        dy = arguments[1].Get();
    };
    MoveTo(bar(), 50, 333.3f);
    const float delta = 333.3f - 100.1f;
    const float top = delta + 1000.7f;
    const float moved = top - 1000.7f;
    EXPECT_EQ(Top(), top);
    EXPECT_EQ(dx.Type(), VarType::Single);
    EXPECT_EQ(dy.Type(), VarType::Single);
    EXPECT_EQ(dx.ToSingle(), 0.0f);
    EXPECT_EQ(dy.ToSingle(), moved);
}

TEST_F(SplitterDrag, AStepTooSmallForAFloatIsNoChange) {
    stage.parent = nullptr;
    stage.LayHorizontal(16'777'216.0f);
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 51);
    EXPECT_THAT(AfterMoves(), IsEmpty());
    EXPECT_THAT(stage.Deeds("Splitter1.Top"), IsEmpty());
    MoveTo(bar(), 50, 52);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(0, 2)"));
}

TEST_F(SplitterDrag, PlacesBetweenPixelsAreKept) {
    stage.LayHorizontal(1000.25f);
    DragBy(bar(), 0, 0.5f);
    EXPECT_EQ(Top(), 1000.75f);
    EXPECT_THAT(AfterMoves(), ElementsAre("AfterMove(0, 0.5)"));
}

// Order and failures.

TEST_F(SplitterDrag, TheBarMovesFirstThenTheControlsThenAfterMove) {
    stage.LayHorizontal(1000);
    stage.Add("Text1");
    stage.Add("Text2");
    bar().Put("ControlsTopLeft", "Text1");
    bar().Put("ControlsBottomRight", "Text2");
    stage.Forget();
    DragBy(bar(), 0, 100);
    EXPECT_THAT(stage.deeds,
                ElementsAre("MouseDown(1, 0, 50, 50)", "MouseMove(1, 0, 50, 150)", "Splitter1.Top=1100", "Text1.Height=900",
                            "Text2.Height=700", "Text2.Top=300", "AfterMove(0, 100)", "MouseUp(1, 0, 0, 0)"));
}

TEST_F(SplitterDrag, AVerticalBarSetsItsLeftAndTheWidthsAndLeftsOfTheControls) {
    stage.LayVertical(1000);
    stage.Add("Text1");
    stage.Add("Text2");
    bar().Put("ControlsTopLeft", "Text1");
    bar().Put("ControlsBottomRight", "Text2");
    stage.Forget();
    DragBy(bar(), 100, 0);
    EXPECT_THAT(stage.Moves(),
                ElementsAre("Splitter1.Left=1100", "Text1.Width=1100", "Text2.Width=900", "Text2.Left=200", "AfterMove(100, 0)"));
}

TEST_F(SplitterDrag, ABarThatCannotBeMovedStillMovesTheControls) {
    stage.LayHorizontal(1000);
    stage.Add("Text1");
    bar().Put("ControlsTopLeft", "Text1");
    stage.Forget();
    stage.unsettable = {"Top"};
    DragBy(bar(), 0, 100);
    EXPECT_EQ(Top(), 1000);
    EXPECT_THAT(stage.Moves(), ElementsAre("Text1.Height=900", "AfterMove(0, 100)"));
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST_F(SplitterDrag, ADragReportsNoChangedProperty) {
    stage.LayHorizontal(1000);
    stage.Add("Text1");
    bar().Put("ControlsTopLeft", "Text1");
    stage.Forget();
    DragBy(bar(), 0, 100);
    EXPECT_THAT(stage.Deeds("changed"), IsEmpty());
}

TEST_F(SplitterDrag, ADragShowsNoMessageAndReportsNoError) {
    stage.LayHorizontal(1000);
    stage.countFails = true;
    stage.parent = nullptr;
    bar().Put("ControlsTopLeft", "Text1,Text2(x),(,)");
    stage.unsettable = {"Top"};
    DragBy(bar(), 0, 100);
    EXPECT_THAT(stage.others.log.Of("msgbox"), IsEmpty());
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST_F(SplitterDrag, DraggingWorksAtDesignTimeToo) {
    stage.designTime = true;
    stage.LayHorizontal(1000);
    stage.Add("Text1");
    bar().Put("ControlsTopLeft", "Text1");
    stage.Forget();
    DragBy(bar(), 0, 100);
    EXPECT_EQ(Top(), 1100);
    EXPECT_THAT(stage.Moves(), ElementsAre("Splitter1.Top=1100", "Text1.Height=900", "AfterMove(0, 100)"));
    EXPECT_EQ(bar().Get("Ident"), Variant(0));
}

TEST_F(SplitterDrag, AfterMoveGivesItsDistancesByReference) {
    stage.LayHorizontal(1000);
    std::string seen;
    stage.on["AfterMove"] = [&](frame::EventArguments arguments) {
        ASSERT_EQ(arguments.size(), 2u);
        arguments[0].Set("far");
        arguments[1].Set(true);
        seen = arguments[0].Get().ToText() + " " + arguments[1].Get().ToText();
        arguments[0].As<Variant>() = Variant();
    };
    DragBy(bar(), 0, 100);
    EXPECT_EQ(seen, "far True");
    EXPECT_EQ(Top(), 1100);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(Top(), 1200);
}

// On the host itself.

TEST(SplitterOnItsHost, ABarIsDraggedThroughItsExtenderAndToldOf) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1");
    bar.Put("Orientation", vertical);
    auto& site = *host.SiteOf(bar);
    site.SetPlace(2000.5f, 0);
    site.SetSize(thick, 3000);
    host.log.Clear();
    DragBy(bar, 300.25f, 40);
    EXPECT_EQ(site.Left(), 2300.75f);
    EXPECT_EQ(site.Top(), 0);
    EXPECT_EQ(host.log.EventNames("Splitter1"), "MouseDown MouseMove AfterMove MouseUp");
    const auto entry = host.log.Of("event").at(2);
    EXPECT_EQ(entry.at(3).ToArray().items.at(0), Variant(300.25f));
    EXPECT_EQ(entry.at(3).ToArray().items.at(1), Variant(0));
}

TEST(SplitterOnItsHost, ABarStaysWithinItsForm) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1");
    auto& site = *host.SiteOf(bar);
    site.SetPlace(0, 1000);
    site.SetSize(3000, thick);
    DragBy(bar, 0, 1e6f);
    EXPECT_EQ(site.Top(), Inner(host, "ScaleHeight") - thick);
    DragBy(bar, 0, -1e6f);
    EXPECT_EQ(site.Top(), 0);
}

TEST(SplitterOnItsHost, ALoadedBarKeepsItsLimits) {
    HostUnderTest host;
    const frame::MemoryBag saved({{"MinTopLeft", 600}, {"MinBottomRight", 800}});
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.saved = &saved, .width = 3000, .height = thick});
    auto& site = *host.SiteOf(bar);
    site.SetPlace(0, 1000);
    DragBy(bar, 0, -1e6f);
    EXPECT_EQ(site.Top(), 600);
    DragBy(bar, 0, 1e6f);
    EXPECT_EQ(site.Top(), Inner(host, "ScaleHeight") - 800 - thick);
}

TEST(SplitterOnItsHost, WhenBothLimitsExceedItsFormTheBottomRightOneWins) {
    for (const int orientation : {horizontal, vertical}) {
        HostUnderTest host;
        auto& bar = host.Create(SplitterClass(), "Splitter1");
        bar.Put("Orientation", orientation);
        const bool across = orientation == horizontal;
        const float form = Inner(host, across ? "ScaleHeight" : "ScaleWidth");
        bar.Put("MinTopLeft", form * 0.75f);
        bar.Put("MinBottomRight", form * 0.5f);
        auto& site = *host.SiteOf(bar);
        site.SetPlace(across ? 0 : 1000.0f, across ? 1000.0f : 0);
        host.log.Clear();
        for (const float distance : {10.0f, form, -form}) DragBy(bar, across ? 0 : distance, across ? distance : 0);
        EXPECT_EQ(across ? site.Top() : site.Left(), form - form * 0.5f - thick);
        EXPECT_EQ(across ? site.Left() : site.Top(), 0);
        EXPECT_EQ(host.log.EventNames("Splitter1"),
                  "MouseDown MouseMove AfterMove MouseUp MouseDown MouseMove MouseUp MouseDown MouseMove MouseUp");
    }
}

/// A bar at 1000 above another bar, which is 3000 wide and 900 high and stands at 2000.
class TwoBars {
  public:
    TwoBars() {
        bar.Put("ControlsTopLeft", "Splitter2");
        bar.Put("ControlsBottomRight", "Splitter2");
        site.SetPlace(0, 1000);
        site.SetSize(3000, thick);
        other.SetPlace(0, 2000);
        other.SetSize(3000, 900);
        host.log.Clear();
    }
    bool OtherIsUntouched() const {
        return other.Left() == 0 && other.Top() == 2000 && other.Width() == 3000 && other.Height() == 900;
    }

    HostUnderTest host;
    frame::Control& bar = host.Create(SplitterClass(), "Splitter1");
    test::SiteUnderTest& site = *host.SiteOf(bar);
    test::SiteUnderTest& other = *host.SiteOf(host.Create(SplitterClass(), "Splitter2"));
};

TEST(SplitterOnItsHost, AMoveThatItsLimitsReduceToNothingMovesNoControlAndRaisesNoAfterMove) {
    TwoBars bars;
    bars.bar.Put("MinTopLeft", 1000);
    bars.bar.Put("MinBottomRight", 800);
    const float lowest = Inner(bars.host, "ScaleHeight") - 800 - thick;
    const std::pair<float, float> moves[] = {{1000, -200}, {lowest, 200}};
    for (const auto& [top, distance] : moves) {
        bars.site.SetPlace(0, top);
        bars.host.log.Clear();
        DragBy(bars.bar, 0, distance);
        EXPECT_EQ(bars.site.Top(), top);
        EXPECT_TRUE(bars.OtherIsUntouched()) << top;
        EXPECT_EQ(bars.host.log.EventNames("Splitter1"), "MouseDown MouseMove MouseUp");
    }
}

TEST(SplitterOnItsHost, ListsWithoutANameLetTheBarMoveAlone) {
    for (const char* list : {"", ",", " , ,"}) {
        TwoBars bars;
        bars.bar.Put("ControlsTopLeft", list);
        bars.bar.Put("ControlsBottomRight", list);
        DragBy(bars.bar, 0, 100);
        EXPECT_EQ(bars.site.Top(), 1100);
        EXPECT_TRUE(bars.OtherIsUntouched()) << '"' << list << '"';
        EXPECT_EQ(bars.host.log.EventNames("Splitter1"), "MouseDown MouseMove AfterMove MouseUp");
        EXPECT_THAT(bars.host.errors.reports, IsEmpty());
    }
}

}  // namespace
}  // namespace tessel::controls
