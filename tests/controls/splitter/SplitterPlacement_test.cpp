#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/HostUnderTest.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

/// Where a new bar goes, and when.
namespace tessel::controls {
namespace {

using frame::Variant;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace splittertest;

std::string PlaceText(float left, float top, float width, float height) {
    const auto text = [](float value) { return Variant(value).ToText(); };
    return text(left) + "," + text(top) + " " + text(width) + "x" + text(height);
}
std::string PlaceOf(Stage& stage) {
    const auto& site = stage.Site();
    return PlaceText(site.Left(), site.Top(), site.Width(), site.Height());
}
template <class Site>
std::string PlaceOf(const Site& site) {
    return PlaceText(site.Left(), site.Top(), site.Width(), site.Height());
}

const Casting newAtDesignTime = {.designTime = true};

// On the host.

TEST(SplitterPlacement, ANewBarLiesAcrossTheMiddleOfItsFormAtDesignTime) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true, .width = 500, .height = 500});
    EXPECT_EQ(PlaceOf(*host.SiteOf(bar)), PlaceText(0, Inner(host, "ScaleHeight") / 2, Inner(host, "ScaleWidth"), thick));
    EXPECT_EQ(bar.Get("MousePointer"), Variant(7));
    EXPECT_EQ(bar.Get("Orientation"), Variant(horizontal));
}

TEST(SplitterPlacement, ABarTurnedUprightStandsInTheMiddleOfItsForm) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true});
    bar.Put("Orientation", vertical);
    EXPECT_EQ(PlaceOf(*host.SiteOf(bar)), PlaceText(Inner(host, "ScaleWidth") / 2, 0, thick, Inner(host, "ScaleHeight")));
    EXPECT_EQ(bar.Get("MousePointer"), Variant(9));
}

TEST(SplitterPlacement, ABarTurnedAtRunTimeGoesToTheMiddleOfItsFormWithoutAfterMove) {
    HostUnderTest host;
    auto& other = *host.SiteOf(host.Create(SplitterClass(), "Splitter2", {.width = 500, .height = 300}));
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.width = 500, .height = 300});
    bar.Put("ControlsTopLeft", "Splitter2");
    bar.Put("ControlsBottomRight", "Splitter2");
    other.SetPlace(40, 50);
    host.log.Clear();
    const float formWidth = Inner(host, "ScaleWidth"), formHeight = Inner(host, "ScaleHeight");
    bar.Put("Orientation", vertical);
    EXPECT_EQ(PlaceOf(*host.SiteOf(bar)), PlaceText(formWidth / 2, 0, thick, formHeight));
    EXPECT_EQ(bar.Get("MousePointer"), Variant(9));
    bar.Put("Orientation", horizontal);
    EXPECT_EQ(PlaceOf(*host.SiteOf(bar)), PlaceText(0, formHeight / 2, formWidth, thick));
    EXPECT_EQ(bar.Get("MousePointer"), Variant(7));
    EXPECT_EQ(PlaceOf(other), PlaceText(40, 50, 500, 300));
    EXPECT_EQ(host.log.EventNames(), "");
    DragBy(bar, 0, 100);
    EXPECT_EQ(host.log.EventNames("Splitter1"), "MouseDown MouseMove AfterMove MouseUp");
    EXPECT_EQ(PlaceOf(other), PlaceText(40, 150, 500, 300));
}

TEST(SplitterPlacement, ANewBarAtRunTimeStaysWhereItIs) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.width = 500, .height = 300});
    EXPECT_EQ(PlaceOf(*host.SiteOf(bar)), PlaceText(0, 0, 500, 300));
    EXPECT_EQ(bar.Get("MousePointer"), Variant(0));
}

TEST(SplitterPlacement, ALoadedBarStaysWhereItWasSaved) {
    for (const bool designTime : {true, false}) {
        HostUnderTest host;
        const frame::MemoryBag nothing;
        auto& bar =
            host.Create(SplitterClass(), "Splitter1", {.designTime = designTime, .saved = &nothing, .width = 500, .height = 300});
        EXPECT_EQ(PlaceOf(*host.SiteOf(bar)), PlaceText(0, 0, 500, 300));
        EXPECT_EQ(bar.Get("MousePointer"), Variant(0));
    }
}

TEST(SplitterPlacement, ABarIsPlacedOnce) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true});
    auto& site = *host.SiteOf(bar);
    site.SetPlace(300, 400);
    site.SetSize(1000, 200);
    site.SetVisible(false);
    site.SetVisible(true);
    EXPECT_EQ(PlaceOf(site), PlaceText(300, 400, 1000, 200));
}

TEST(SplitterPlacement, ABarIsPlacedWhenItIsFirstShownNotWhenItIsMade) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true, .width = 500, .height = 300, .show = false});
    auto& site = *host.SiteOf(bar);
    EXPECT_EQ(PlaceOf(site), PlaceText(0, 0, 500, 300));
    site.SetVisible(true);
    EXPECT_EQ(PlaceOf(site), PlaceText(0, Inner(host, "ScaleHeight") / 2, Inner(host, "ScaleWidth"), thick));
}

TEST(SplitterPlacement, APlacedBarIsKeptByItsBagWithItsPointer) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.designTime = true});
    const frame::MemoryBag saved = host.Save(bar);
    ASSERT_EQ(saved.Kept().size(), 1u);
    EXPECT_EQ(saved.Kept().front().first, "MousePointer");
    EXPECT_EQ(saved.Kept().front().second, Variant(7));
}

// On the stage.

TEST(SplitterPlacement, PlacementSetsThePlaceThroughTheExtender) {
    Stage stage(newAtDesignTime);
    EXPECT_EQ(PlaceOf(stage), "0,2000 6000x120");
    EXPECT_THAT(stage.Deeds("Splitter1."), testing::IsSupersetOf({"Splitter1.Left=0", "Splitter1.Top=2000"}));
}

TEST(SplitterPlacement, UserModeIsAskedAfreshAtEachShow) {
    Stage stage({.width = 500, .height = 300});
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,0 500x300");
    stage.designTime = true;
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,2000 6000x120");
}

TEST(SplitterPlacement, ShowAtRunTimeDoesNotUseThePlacingUp) {
    Stage stage({.width = 500, .height = 300, .show = false});
    for (int i = 0; i < 3; ++i) stage.Site().Show();
    EXPECT_THAT(stage.deeds, IsEmpty());
    stage.designTime = true;
    stage.Site().Show();
    stage.Site().SetPlace(7, 7);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "7,7 6000x120");
}

TEST(SplitterPlacement, PlacementRaisesNoEventAndMovesNoControl) {
    Stage stage({.designTime = true, .show = false});
    auto& text = stage.Add("Text1");
    stage.Bar().Put("ControlsTopLeft", "Text1");
    stage.Bar().Put("ControlsBottomRight", "Text1");
    stage.Site().Show();
    EXPECT_EQ(text.Number("Height"), 800);
    EXPECT_THAT(stage.Deeds("Text1"), IsEmpty());
    EXPECT_THAT(stage.Deeds("AfterMove"), IsEmpty());
    EXPECT_THAT(Drawn(stage.canvas), IsEmpty());
}

TEST(SplitterPlacement, LimitsDoNotHoldForPlacement) {
    Stage stage({.designTime = true, .show = false});
    stage.Bar().Put("MinTopLeft", 3000);
    stage.Bar().Put("MinBottomRight", 3000);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,2000 6000x120");
}

TEST(SplitterPlacement, HalfOfAnOddSizeKeepsItsFraction) {
    Stage stage({.designTime = true, .show = false});
    stage.form.SetMember("ScaleHeight", 4001.0f);
    stage.form.SetMember("ScaleWidth", 6001.0f);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,2000.5 6001x120");
    stage.Bar().Put("Orientation", vertical);
    EXPECT_EQ(PlaceOf(stage), "3000.5,0 120x4001");
}

// The form object.

headless::HostObject::Members FormMembers(const std::string& name, float width, float height) {
    return {{"Name", name}, {"ScaleWidth", width}, {"ScaleHeight", height}};
}

TEST(SplitterPlacement, TheParentIsTheFormWhenItHasAName) {
    Stage stage({.designTime = true, .show = false});
    stage.AddBare("Other", FormMembers("Other", 500, 500));
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,2000 6000x120");
}

TEST(SplitterPlacement, WithoutANameOfTheParentTheFirstOfItsControlsIsTheForm) {
    Stage stage({.designTime = true, .show = false});
    stage.form.SetMember("Name", "");
    stage.AddBare("Page", FormMembers("Page", 900, 700));
    stage.AddBare("Other", FormMembers("Other", 500, 500));
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,350 900x120");
}

TEST(SplitterPlacement, WithoutAParentTheFirstOfTheControlsIsTheForm) {
    Stage stage({.designTime = true, .show = false});
    stage.parent = nullptr;
    stage.AddBare("Page", FormMembers("Page", 900, 700));
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,350 900x120");
}

TEST(SplitterPlacement, WithoutAnyFormOnlyWhatNeedsNoneIsSet) {
    Stage stage({.designTime = true, .width = 500, .height = 300, .show = false});
    stage.parent = nullptr;
    stage.Site().SetPlace(40, 50);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,50 500x120");
    EXPECT_EQ(stage.Bar().Get("MousePointer"), Variant(7));
    stage.Site().SetPlace(40, 50);
    stage.Site().SetSize(500, 300);
    stage.Bar().Put("Orientation", vertical);
    EXPECT_EQ(PlaceOf(stage), "40,0 120x300");
    EXPECT_EQ(stage.Bar().Get("MousePointer"), Variant(9));
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST(SplitterPlacement, WhatCannotBeReadOfTheFormLeavesThatOneSettingAsItWas) {
    Stage stage({.designTime = true, .width = 500, .height = 300, .show = false});
    stage.form.unreadable = {"ScaleHeight"};
    stage.Site().SetPlace(40, 50);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "0,50 6000x120");
    EXPECT_EQ(stage.Bar().Get("MousePointer"), Variant(7));
}

TEST(SplitterPlacement, WhatCannotBeSetIsSkipped) {
    Stage stage({.designTime = true, .width = 500, .height = 300, .show = false});
    stage.unsettable = {"Left", "Top"};
    stage.Site().SetPlace(40, 50);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "40,50 6000x120");
    EXPECT_EQ(stage.Bar().Get("MousePointer"), Variant(7));
}

TEST(SplitterPlacement, APlacementThatFailedIsNotTriedAgain) {
    Stage stage({.designTime = true, .width = 500, .height = 300, .show = false});
    stage.unsettable = {"Left", "Top"};
    stage.Site().SetPlace(40, 50);
    stage.Site().Show();
    stage.unsettable.clear();
    stage.Site().SetSize(500, 300);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "40,50 500x300");
}

// Orientation.

TEST(SplitterPlacement, ANewOrientationAtRunTimePutsTheBarInTheMiddle) {
    Stage stage({.width = 500, .height = 300});
    auto& text = stage.Add("Text1");
    stage.Bar().Put("ControlsTopLeft", "Text1");
    stage.Bar().Put("ControlsBottomRight", "Text1");
    stage.Forget();
    stage.Bar().Put("Orientation", vertical);
    EXPECT_EQ(PlaceOf(stage), "3000,0 120x4000");
    EXPECT_EQ(stage.Bar().Get("MousePointer"), Variant(9));
    EXPECT_EQ(text.Number("Width"), 1000);
    EXPECT_THAT(stage.Deeds("Text1"), IsEmpty());
    EXPECT_THAT(stage.Deeds("AfterMove"), IsEmpty());
    stage.Bar().Put("Orientation", horizontal);
    EXPECT_EQ(PlaceOf(stage), "0,2000 6000x120");
    EXPECT_EQ(stage.Bar().Get("MousePointer"), Variant(7));
}

TEST(SplitterPlacement, TheSameOrientationPutsTheBarInTheMiddleToo) {
    Stage stage;
    stage.Site().SetPlace(10, 20);
    stage.Bar().Put("Orientation", horizontal);
    EXPECT_EQ(PlaceOf(stage), "0,2000 6000x120");
}

TEST(SplitterPlacement, TheOrientationIsStoredAndReportedBeforeTheBarMoves) {
    Stage stage({.width = 500, .height = 300});
    std::vector<std::string> seen;
    stage.onPropertyChanged = [&](std::string_view key) {
        if (key == "Orientation") seen.push_back(PlaceOf(stage) + " " + stage.Bar().Get("Orientation").ToText());
    };
    stage.Bar().Put("Orientation", vertical);
    EXPECT_THAT(seen, ElementsAre("0,0 500x300 1"));
}

TEST(SplitterPlacement, ALoadedOrientationPlacesNothing) {
    const frame::MemoryBag saved({{"Orientation", std::int16_t{1}}});
    for (const bool designTime : {true, false}) {
        Stage stage({.designTime = designTime, .saved = &saved, .width = 500, .height = 300});
        EXPECT_EQ(PlaceOf(stage), "0,0 500x300");
        EXPECT_EQ(stage.Bar().Get("MousePointer"), Variant(0));
        EXPECT_EQ(stage.Bar().Get("Orientation"), Variant(vertical));
    }
}

TEST(SplitterPlacement, TheOrientationSetBeforeTheFirstShowIsTheOneOfThePlacing) {
    Stage stage({.designTime = true, .show = false});
    stage.Bar().Put("Orientation", vertical);
    stage.Site().SetPlace(1, 2);
    stage.Site().SetSize(300, 300);
    stage.Site().Show();
    EXPECT_EQ(PlaceOf(stage), "3000,0 120x4000");
}

TEST(SplitterPlacement, ADragInProgressGoesOnFromTheMiddle) {
    Stage stage;
    stage.LayHorizontal(500);
    Press(stage.Bar(), 50, 50);
    stage.Bar().Put("Orientation", vertical);
    MoveTo(stage.Bar(), 60, 200);
    EXPECT_EQ(PlaceOf(stage), "3010,0 120x4000");
}

}  // namespace
}  // namespace tessel::controls
