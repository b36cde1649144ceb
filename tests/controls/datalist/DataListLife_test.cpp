#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "tests/controls/datalist/DataListTestHelp.h"

/// The life of the control: how it begins, its size, its picture in a form designer, its tool tip.
namespace tessel::controls {
namespace {

using test::ErrorOf;
using namespace datalisttest;

// Beginning.

TEST(DataListLife, ItBeginsEmptyWithTheFirstListToBeSeen) {
    Stage stage;
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "");
    EXPECT_EQ(stage.LabelText(), "");
    EXPECT_EQ(stage.Visible(), "list 0");
    EXPECT_EQ(stage.ListIndex(0), -1);
    EXPECT_EQ(stage.ListIndex(1), -1);
}

TEST(DataListLife, ItsChildrenStandInItsCorner) {
    Stage stage;
    for (frame::Object* child : {&stage.List(0), &stage.List(1), &stage.Label()}) {
        EXPECT_EQ(child->Get("Left"), Variant(0)) << child->Path();
        EXPECT_EQ(child->Get("Top"), Variant(0)) << child->Path();
    }
}

TEST(DataListLife, ItComesIntoTheWorldWithoutEventsReportsOrTurns) {
    test::HostUnderTest host;
    host.Create(DataListClass(), "List2", {.width = width, .height = height});
    EXPECT_EQ(host.log.EventNames(), "");
    EXPECT_TRUE(host.log.Of("changed").empty());
    EXPECT_TRUE(host.log.Of("yield").empty());
    EXPECT_TRUE(host.errors.reports.empty());
}

TEST(DataListLife, ALoadGivesColoursFontAndAppearanceToBothListsAndToTheLabel) {
    const auto font = std::make_shared<frame::Font>("Courier", 20);
    const std::vector<std::pair<std::string, Variant>> values = {{"BackColor", frame::OLE_COLOR(0xABCDEF)},
                                                                 {"ForeColor", frame::OLE_COLOR(0x123456)},
                                                                 {"Enabled", false},
                                                                 {"Font", font},
                                                                 {"Appearance", std::int16_t{1}}};
    const frame::MemoryBag saved(frame::MemoryBag::Contents(values.begin(), values.end()));
    Stage stage(Stage::Options{.saved = &saved});
    for (frame::Object* child : {&stage.List(0), &stage.List(1), &stage.Label()})
        for (const auto& [name, value] : values) EXPECT_EQ(child->Get(name), value) << child->Path() << "." << name;
}

TEST(DataListLife, ALoadFromAnEmptyBagGivesTheDefaultsToTheChildren) {
    Loaded loaded{};
    Stage& stage = loaded.stage;
    for (frame::Object* child : {&stage.List(0), &stage.List(1), &stage.Label()}) {
        EXPECT_EQ(child->Get("BackColor"), Variant(frame::OLE_COLOR(0x80000005u))) << child->Path();
        EXPECT_EQ(child->Get("Enabled"), Variant(true)) << child->Path();
        EXPECT_EQ(child->Get("Appearance"), Variant(0)) << child->Path();
        EXPECT_EQ(child->Get("Font"), stage.Get("Font")) << child->Path();
    }
}

TEST(DataListLife, TwoControlsShareNothing) {
    Stage first;
    frame::Control& second = first.host.Create(DataListClass(), "List2");
    first.Add("Red", 5);
    first.Put("DefaultValue", 3);
    EXPECT_EQ(second.Get("ListCount"), Variant(0));
    EXPECT_EQ(second.Get("DefaultValue"), Variant(0));
}

// Size.

TEST(DataListSize, TheListGivesTheHeight) {
    Stage stage;
    const float given = stage.List(0).Get("Height").ToSingle();
    EXPECT_GT(given, 0);
    EXPECT_EQ(stage.TheSite().Height(), given);
    EXPECT_EQ(stage.Label().Get("Height"), Variant(given));
    for (const float tried : {given + 300, given - 90}) {
        stage.TheSite().SetSize(width, tried);
        EXPECT_EQ(stage.TheSite().Height(), given) << tried;
        EXPECT_EQ(stage.List(0).Get("Height"), Variant(given)) << tried;
        EXPECT_EQ(stage.Label().Get("Height"), Variant(given)) << tried;
    }
}

TEST(DataListSize, AllThreeChildrenAreAsWideAsTheControl) {
    Stage stage;
    for (const float tried : {width, 3'000.0f, 750.0f}) {
        stage.TheSite().SetSize(tried, height);
        EXPECT_EQ(stage.TheSite().Width(), tried);
        for (frame::Object* child : {&stage.List(0), &stage.List(1), &stage.Label()})
            EXPECT_EQ(child->Get("Width"), Variant(tried)) << child->Path();
    }
}

// In a form designer.

TEST(DataListDesign, ItShowsItsName) {
    Stage stage(Stage::Options{.designTime = true});
    EXPECT_EQ(stage.ItemsOf(0), "List1=0");
    EXPECT_EQ(stage.ListIndex(), 0);
    EXPECT_EQ(stage.Text(), "List1");
    EXPECT_EQ(stage.LabelText(), "List1");
    EXPECT_EQ(stage.Visible(), "list 0");
}

TEST(DataListDesign, TheChosenNameIsTheItemThatIsRead) {
    Stage stage(Stage::Options{.designTime = true});
    stage.Put("DefaultValue", 77);
    stage.Put("DefaultText", "None");
    EXPECT_EQ(stage.Value(), 0);
    EXPECT_EQ(stage.Text(), "List1");
    EXPECT_EQ(stage.Saved("Value"), Variant(0));
    EXPECT_EQ(stage.Saved("Text"), Variant(""));
}

TEST(DataListDesign, BeforeItIsShownItShowsNoName) {
    Stage stage(Stage::Options{.designTime = true, .show = false});
    EXPECT_EQ(stage.ItemsOf(0), "");
}

TEST(DataListDesign, EachShowMakesThePictureAnew) {
    Stage stage(Stage::Options{.designTime = true});
    stage.Add("Red", 5);
    auto& site = *stage.host.SiteOf(stage.Control());
    site.SetVisible(false);
    EXPECT_EQ(stage.ItemsOf(0), "List1=0 | Red=5");
    site.SetVisible(true);
    EXPECT_EQ(stage.ItemsOf(0), "List1=0");
}

TEST(DataListDesign, ShowAtRunTimeLeavesTheItems) {
    Stage stage;
    stage.Add("Red", 5);
    stage.Choose(0);
    auto& site = *stage.host.SiteOf(stage.Control());
    site.SetVisible(false);
    site.SetVisible(true);
    EXPECT_EQ(stage.ItemsOf(0), "Red=5");
    EXPECT_EQ(stage.ListIndex(), 0);
}

TEST(DataListDesign, ItFollowsANewName) {
    Stage stage(Stage::Options{.designTime = true});
    stage.host.SiteOf(stage.Control())->SetDisplayName("Colours");
    stage.TheSite().AmbientChanged("DisplayName");
    EXPECT_EQ(stage.ItemsOf(0), "Colours=0");
    EXPECT_EQ(stage.ListIndex(), 0);
    EXPECT_EQ(stage.LabelText(), "Colours");
}

TEST(DataListDesign, AnyChangeOfAnAmbientPropertyMakesThePictureAnew) {
    for (const auto* name : {"Font", "UserMode", "DisplayName", "Whatever", ""}) {
        Stage stage(Stage::Options{.designTime = true});
        stage.Add("Red", 5);
        stage.Choose(1);
        stage.TheSite().AmbientChanged(name);
        EXPECT_EQ(stage.ItemsOf(0), "List1=0") << name;
        EXPECT_EQ(stage.ListIndex(), 0) << name;
    }
}

TEST(DataListDesign, TheSortedListIsNotPartOfThePicture) {
    Stage stage(Stage::Options{.designTime = true});
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(1), "List1=0");
    stage.TheSite().AmbientChanged("DisplayName");
    EXPECT_EQ(stage.ItemsOf(0), "List1=0");
    EXPECT_EQ(stage.ItemsOf(1), "List1=0");
}

TEST(DataListDesign, ThePictureDoesNotCountAsAnItemThatWasAdded) {
    Stage stage(Stage::Options{.designTime = true});
    stage.Put("Style", countAndText);
    stage.TheSite().AmbientChanged("DisplayName");
    EXPECT_EQ(stage.ItemsOf(0), "List1=0");
    stage.Add("Red", 5);
    EXPECT_EQ(stage.ItemsOf(0), "List1=0 |    1 - Red=5");
}

TEST(DataListDesign, AtRunTimeThereIsNoPicture) {
    Stage stage;
    stage.Add("Red", 5);
    stage.Choose(0);
    stage.TheSite().AmbientChanged("DisplayName");
    EXPECT_EQ(stage.ItemsOf(0), "Red=5");
    EXPECT_EQ(stage.ListIndex(), 0);
}

TEST(DataListDesign, UserModeIsAskedAtEachChange) {
    Stage stage(Stage::Options{.designTime = true});
    stage.host.SiteOf(stage.Control())->SetUserMode(true);
    stage.Clear();
    stage.TheSite().AmbientChanged("Font");
    EXPECT_EQ(stage.ItemsOf(0), "");
}

TEST(DataListDesign, ADesignThatIsLockedShowsItsNameOnTheLabel) {
    const frame::MemoryBag saved(frame::MemoryBag::Contents{{"Locked", Variant(true)}});
    Stage stage(Stage::Options{.designTime = true, .saved = &saved});
    EXPECT_EQ(stage.Visible(), "label");
    EXPECT_EQ(stage.LabelText(), "List1");
}

// Tool tip.

TEST(DataListToolTip, ShowAtRunTimeCopiesItToAllThreeChildren) {
    Stage stage(Stage::Options{.toolTip = "Choose one"});
    EXPECT_EQ(ToolTips(stage), "Choose one | Choose one | Choose one");
}

TEST(DataListToolTip, ShowAtDesignTimeCopiesNone) {
    Stage stage(Stage::Options{.designTime = true, .toolTip = "Choose one"});
    EXPECT_EQ(ToolTips(stage), " |  | ");
}

TEST(DataListToolTip, RefreshCopiesItAtDesignTimeAndAtRunTime) {
    for (const bool designTime : {true, false}) {
        Stage stage(Stage::Options{.designTime = designTime});
        stage.host.SiteOf(stage.Control())->Extender().Put("ToolTipText", "Choose one");
        stage.Reset();
        EXPECT_TRUE(Call(stage.Control(), "Refresh").IsEmpty());
        EXPECT_EQ(ToolTips(stage), "Choose one | Choose one | Choose one");
        EXPECT_EQ(stage.Happened(), "");
    }
}

TEST(DataListToolTip, RefreshChangesNothingElse) {
    Stage stage;
    stage.Add("Red", 5);
    stage.Choose(0);
    stage.Put("Locked", true);
    const std::string before = stage.State();
    Call(stage.Control(), "Refresh");
    EXPECT_EQ(stage.State(), before);
    EXPECT_EQ(stage.Visible(), "list 0");
}

TEST(DataListToolTip, ACopiedOneIsSaved) {
    Stage stage(Stage::Options{.toolTip = "Choose one"});
    EXPECT_EQ(stage.Saved("ToolTipText"), Variant("Choose one"));
}

}  // namespace
}  // namespace tessel::controls
