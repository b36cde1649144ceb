#include "controls/link/Link.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <limits>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "tests/HostUnderTest.h"
#include "tests/controls/link/LinkTestHelp.h"

namespace tessel::controls {
namespace {

using frame::ControlError;
using frame::Font;
using frame::MemoryBag;
using frame::OLE_COLOR;
using frame::Variant;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace linktest;

constexpr float notANumber = std::numeric_limits<float>::quiet_NaN();
constexpr float infinite = std::numeric_limits<float>::infinity();

/// A link that was placed new on a form at run time.
class PlacedLink : public testing::Test {
  protected:
    HostUnderTest host;
    Link& link = NewLink(host);
};

// Creation and load.

TEST_F(PlacedLink, NewLinkHasItsDefaults) {
    EXPECT_EQ(link.HighlightColor(), red);
    EXPECT_EQ(link.UsedColor(), purple);
    EXPECT_EQ(link.ForeColor(), blue);
    EXPECT_EQ(link.LinkTo(), "");
    EXPECT_EQ(link.BorderSize(), 30.0f);
    EXPECT_FALSE(link.SuppressMessages());
    EXPECT_EQ(link.ClickAction(), ClickActionConstants::Open_Link);
    EXPECT_EQ(link.Caption(), "Label1");
    EXPECT_EQ(link.BackColor(), OLE_COLOR(0x8000000F));
    EXPECT_TRUE(link.Enabled());
    EXPECT_FALSE(link.AutoSize());
    EXPECT_FALSE(link.WordWrap());
    EXPECT_EQ(link.BorderStyle(), child::LabelBorderConstants::None);
    EXPECT_EQ(link.Alignment(), child::AlignmentConstants::LeftJustify);
    EXPECT_EQ(link.Appearance(), child::AppearanceConstants::ThreeD);
}

TEST_F(PlacedLink, NewLinkShowsItsTextInBlueAtTheTopLeftCorner) {
    EXPECT_EQ(link.Label1.ForeColor(), blue);
    EXPECT_EQ(link.Label1.Left(), 0);
    EXPECT_EQ(link.Label1.Top(), 0);
}

TEST(Link, NewLinkReportsNoChange) {
    HostUnderTest host;
    NewLink(host);
    EXPECT_THAT(Changes(host), IsEmpty());
}

TEST(Link, NewLinkKeepsTheFontOfItsLabel) {
    HostUnderTest host;
    const auto ambient = std::make_shared<Font>("Courier", 20);
    auto& link = host.Create<Link>("Link1", {.ambientFont = ambient});
    EXPECT_NE(link.Font()->Name(), "Courier");
}

TEST(Link, LoadFromAnEmptyBagTakesTheAmbientFont) {
    HostUnderTest host;
    const MemoryBag nothing;
    auto& link = host.Create<Link>("Link1", {.saved = &nothing, .ambientFont = std::make_shared<Font>("Courier", 20)});
    EXPECT_EQ(link.Font()->Name(), "Courier");
    EXPECT_EQ(link.Font()->Size(), 20);
    EXPECT_THAT(host.Save(link).Kept(), IsEmpty());
}

TEST(Link, LoadWithoutAFontObjectStillLeavesAUsableFont) {
    HostUnderTest host;
    const MemoryBag saved({{"Font", frame::ObjectRef()}, {"AutoSize", true}});
    auto& link = LoadedLink(host, saved);
    link.SetCaption("Home");
    ASSERT_NE(link.Font(), nullptr);
    EXPECT_EQ(link.Surface().Width(), 4 * 90);
}

TEST(Link, LoadShowsForeColorOnTheText) {
    HostUnderTest host;
    const MemoryBag saved({{"Forecolor", OLE_COLOR(0x112233)}});
    auto& link = LoadedLink(host, saved);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x112233));
}

TEST(Link, LoadOfAnotherAppearanceStillShowsForeColor) {
    HostUnderTest host;
    const MemoryBag saved({{"Appearance", std::int16_t{0}}});
    auto& link = LoadedLink(host, saved);
    EXPECT_EQ(link.Appearance(), child::AppearanceConstants::Flat);
    EXPECT_EQ(link.Label1.ForeColor(), blue);
}

TEST(Link, LoadedLinkIsUnused) {
    HostUnderTest host;
    auto& first = NewLink(host);
    PressInside(first);
    const MemoryBag saved = host.Save(first);
    EXPECT_THAT(saved.Kept(), IsEmpty());
    auto& second = host.Create<Link>("Link2", {.saved = &saved, .width = width, .height = height});
    EXPECT_FALSE(IsUsed(second));
}

TEST(Link, SettersAreAllowedAtDesignTimeAndAtRunTime) {
    for (const bool designTime : {true, false}) {
        HostUnderTest host;
        auto& link = host.Create<Link>("Link1", {.designTime = designTime});
        EXPECT_NO_THROW(link.SetLinkTo("a.txt"));
        EXPECT_NO_THROW(link.SetBorderSize(-1e30f));
        EXPECT_NO_THROW(link.SetClickAction(static_cast<ClickActionConstants>(-77)));
        EXPECT_NO_THROW(link.SetAlignment(static_cast<child::AlignmentConstants>(99)));
        EXPECT_EQ(link.LinkTo(), "a.txt");
        EXPECT_EQ(link.BorderSize(), -1e30f);
        EXPECT_EQ(link.ClickAction(), static_cast<ClickActionConstants>(-77));
        EXPECT_EQ(link.Alignment(), static_cast<child::AlignmentConstants>(99));
    }
}

TEST_F(PlacedLink, TextPropertiesAreThoseOfTheLabel) {
    link.SetBackColor(0x0A0B0C);
    link.SetEnabled(false);
    link.SetBorderStyle(child::LabelBorderConstants::FixedSingle);
    link.SetAlignment(child::AlignmentConstants::Center);
    link.SetAppearance(child::AppearanceConstants::Flat);
    link.SetAutoSize(true);
    link.SetCaption("Home");
    link.SetWordWrap(true);
    EXPECT_EQ(link.Label1.BackColor(), OLE_COLOR(0x0A0B0C));
    EXPECT_FALSE(link.Label1.Enabled());
    EXPECT_EQ(link.Label1.BorderStyle(), child::LabelBorderConstants::FixedSingle);
    EXPECT_EQ(link.Label1.Alignment(), child::AlignmentConstants::Center);
    EXPECT_EQ(link.Label1.Appearance(), child::AppearanceConstants::Flat);
    EXPECT_TRUE(link.Label1.AutoSize());
    EXPECT_EQ(link.Label1.Caption(), "Home");
    EXPECT_TRUE(link.Label1.WordWrap());
    link.Label1.SetBackColor(0x0D0E0F);
    EXPECT_EQ(link.BackColor(), OLE_COLOR(0x0D0E0F));
}

TEST_F(PlacedLink, FontIsKeptAsTheSameObject) {
    const auto font = std::make_shared<Font>("Courier", 20);
    link.SetFont(font);
    EXPECT_EQ(link.Font(), font);
    EXPECT_EQ(link.Label1.Font(), font);
    font->SetBold(true);
    EXPECT_TRUE(link.Font()->Bold());
}

TEST_F(PlacedLink, SaveReadsTheLabelAtThatMoment) {
    link.Label1.SetCaption("Changed behind the link");
    const MemoryBag saved = host.Save(link);
    ASSERT_EQ(saved.Kept().size(), 1u);
    EXPECT_EQ(saved.Kept()[0].first, "Caption");
    EXPECT_EQ(saved.Kept()[0].second, Variant("Changed behind the link"));
}

TEST_F(PlacedLink, HoverColourNeverReachesTheBag) {
    MoveInside(link);
    ASSERT_EQ(link.Label1.ForeColor(), red);
    EXPECT_THAT(host.Save(link).Kept(), IsEmpty());
    PressInside(link);
    MoveIntoStrip(link);
    ASSERT_EQ(link.Label1.ForeColor(), purple);
    EXPECT_THAT(host.Save(link).Kept(), IsEmpty());
}

// Colours.

TEST_F(PlacedLink, NewForeColorShowsAtOnceWhateverTheHoverState) {
    link.SetForeColor(0x111111);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x111111));
    MoveInside(link);
    link.SetForeColor(0x222222);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x222222));
    PressInside(link);
    MoveIntoStrip(link);
    link.SetForeColor(0x333333);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x333333));
}

TEST_F(PlacedLink, ForeColorIsReportedInTheSpellingOfTheBag) {
    link.SetForeColor(0x111111);
    EXPECT_THAT(Changes(host), ElementsAre("Forecolor"));
}

TEST_F(PlacedLink, HoveringLeavesForeColorAsItIs) {
    MoveInside(link);
    EXPECT_EQ(link.ForeColor(), blue);
    EXPECT_THAT(Changes(host), IsEmpty());
}

TEST_F(PlacedLink, NewHighlightColorShowsAtTheNextHover) {
    MoveInside(link);
    link.SetHighlightColor(0x00FF00);
    EXPECT_EQ(link.Label1.ForeColor(), red);
    MoveInside(link);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x00FF00));
}

TEST_F(PlacedLink, NewUsedColorShowsAtTheNextMove) {
    PressInside(link);
    MoveIntoStrip(link);
    link.SetUsedColor(0x00FF00);
    EXPECT_EQ(link.Label1.ForeColor(), purple);
    MoveIntoStrip(link);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x00FF00));
}

TEST_F(PlacedLink, NewBorderSizeLinkToClickActionAndSuppressMessagesLeaveTheColour) {
    MoveInside(link);
    link.SetBorderSize(5000);
    link.SetLinkTo("a.txt");
    link.SetClickAction(ClickActionConstants::Do_nothing);
    link.SetSuppressMessages(true);
    link.SetBackColor(0xFFFFFF);
    link.SetCaption("Home");
    EXPECT_EQ(Shown(link), "hovered");
}

TEST_F(PlacedLink, AppearanceShowsForeColorAgain) {
    PressInside(link);
    MoveIntoStrip(link);
    link.SetAppearance(child::AppearanceConstants::Flat);
    EXPECT_EQ(link.Label1.ForeColor(), blue);
    MoveInside(link);
    link.SetAppearance(child::AppearanceConstants::Flat);
    EXPECT_EQ(link.Label1.ForeColor(), blue);
}

// The order inside a setter, as the host sees it when it is told.

TEST(Link, ForeColorIsStoredThenReportedThenShown) {
    WatchedHost host;
    auto& link = host.TheLink();
    MoveInside(link);
    std::vector<std::string> reported;
    host.onPropertyChanged = [&](std::string_view key) {
        reported.emplace_back(key);
        EXPECT_EQ(link.ForeColor(), OLE_COLOR(0x111111));
        EXPECT_EQ(link.Label1.ForeColor(), red);
    };
    link.SetForeColor(0x111111);
    EXPECT_THAT(reported, ElementsAre("Forecolor"));
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x111111));
}

TEST(Link, AppearanceIsStoredThenReportedThenTheTextTakesForeColor) {
    WatchedHost host;
    auto& link = host.TheLink();
    bool told = false;
    host.onPropertyChanged = [&](std::string_view key) {
        told = true;
        EXPECT_EQ(key, "Appearance");
        EXPECT_EQ(link.Appearance(), child::AppearanceConstants::Flat);
        EXPECT_EQ(link.Label1.ForeColor(), frame::colors::windowText);  // as the label resets it
    };
    link.SetAppearance(child::AppearanceConstants::Flat);
    EXPECT_TRUE(told);
    EXPECT_EQ(link.Label1.ForeColor(), blue);
}

TEST(Link, EachPropertyHasItsNewValueWhenItIsReported) {
    WatchedHost host;
    auto& link = host.TheLink();
    const auto font = std::make_shared<Font>("Courier", 20);
    const std::vector<std::pair<std::string, Variant>> values = {
        {"BackColor", OLE_COLOR(1)}, {"Enabled", false},         {"Font", font},
        {"BorderStyle", 1},          {"Alignment", 1},           {"Appearance", 0},
        {"AutoSize", true},          {"Caption", "Home"},        {"WordWrap", true},
        {"HighlightColor", 2},       {"UsedColor", 3},           {"LinkTo", "a.txt"},
        {"BorderSize", 4.5f},        {"SuppressMessages", true}, {"ClickAction", 2}};
    for (const auto& [name, value] : values) {
        int calls = 0;
        host.onPropertyChanged = [&, expectedKey = name, expected = value](std::string_view key) {
            ++calls;
            EXPECT_EQ(key, expectedKey);
            EXPECT_EQ(link.Get(expectedKey), expected) << expectedKey;
        };
        link.Put(name, value);
        EXPECT_EQ(calls, 1) << name;
    }
}

TEST(Link, ControlHasItsNewSizeWhenACaptionIsReported) {
    WatchedHost host;
    auto& link = host.TheLink();
    link.SetAutoSize(true);
    bool told = false;
    host.onPropertyChanged = [&](std::string_view) {
        told = true;
        EXPECT_EQ(link.Surface().Width(), link.Label1.Width());
    };
    link.SetCaption("A longer caption than before");
    EXPECT_TRUE(told);
}

// Size.

TEST_F(PlacedLink, LabelFillsTheControl) {
    EXPECT_EQ(link.Label1.Width(), width);
    EXPECT_EQ(link.Label1.Height(), height);
}

TEST(Link, LabelFillsAControlThatGotNoSizeOfTheHost) {
    HostUnderTest host;
    const MemoryBag nothing;
    for (const auto* saved : {static_cast<const MemoryBag*>(nullptr), &nothing}) {
        auto& link = host.Create<Link>("Link1", {.saved = saved});
        EXPECT_GT(link.Surface().Width(), 0);
        EXPECT_EQ(link.Label1.Width(), link.Surface().ScaleWidth());
        EXPECT_EQ(link.Label1.Height(), link.Surface().ScaleHeight());
        host.Destroy(link);
    }
}

TEST(Link, ResizeLaysTheLabelOut) {
    for (const bool designTime : {true, false}) {
        HostUnderTest host;
        auto& link = host.Create<Link>("Link1", {.designTime = designTime, .width = width, .height = height});
        link.Label1.Move(70, 80, 90, 100);
        host.SiteOf(link)->SetSize(3000, 900);
        EXPECT_EQ(link.Label1.Left(), 0);
        EXPECT_EQ(link.Label1.Top(), 0);
        EXPECT_EQ(link.Label1.Width(), 3000);
        EXPECT_EQ(link.Label1.Height(), 900);
    }
}

TEST_F(PlacedLink, ResizeToNothingLeavesAnEmptyLabel) {
    host.SiteOf(link)->SetSize(0, 0);
    EXPECT_EQ(link.Label1.Width(), 0);
    EXPECT_EQ(link.Label1.Height(), 0);
    MoveTo(link, 0, 0);
    EXPECT_EQ(Shown(link), "unused");
}

TEST_F(PlacedLink, CaptionThatGrowsAnAutoSizeLabelGrowsTheControl) {
    link.SetAutoSize(true);
    EXPECT_EQ(link.Surface().Width(), 6 * 90);
    EXPECT_EQ(link.Surface().Height(), 195);
    link.SetCaption("A longer caption");
    EXPECT_EQ(link.Label1.Width(), 16 * 90);
    EXPECT_EQ(link.Surface().Width(), 16 * 90);
    EXPECT_EQ(link.Surface().Height(), 195);
    link.SetCaption("");
    EXPECT_EQ(link.Surface().Width(), 0);
}

TEST_F(PlacedLink, GrowingDoesNotLayTheLabelOutAgain) {
    link.SetAutoSize(true);
    link.Label1.SetLeft(50);
    link.Label1.SetTop(40);
    link.SetCaption("A longer caption");
    EXPECT_EQ(link.Surface().Width(), 16 * 90);
    EXPECT_EQ(link.Label1.Left(), 50);
    EXPECT_EQ(link.Label1.Top(), 40);
}

TEST_F(PlacedLink, ControlFollowsALabelThatDoesNotSizeItselfToo) {
    link.Label1.Move(50, 40, 700, 300);
    link.SetCaption("Home");
    EXPECT_EQ(link.Surface().Width(), 700);
    EXPECT_EQ(link.Surface().Height(), 300);
    EXPECT_EQ(link.Label1.Left(), 50);
    EXPECT_EQ(link.Label1.Top(), 40);
    EXPECT_EQ(link.Label1.Width(), 700);
}

TEST_F(PlacedLink, ResizeWorksAgainAfterTheControlHasFollowedItsLabel) {
    link.Label1.Move(50, 40, 700, 300);
    link.SetCaption("Home");
    host.SiteOf(link)->SetSize(3000, 900);
    EXPECT_EQ(link.Label1.Left(), 0);
    EXPECT_EQ(link.Label1.Top(), 0);
    EXPECT_EQ(link.Label1.Width(), 3000);
    EXPECT_EQ(link.Label1.Height(), 900);
}

TEST_F(PlacedLink, HostCannotStretchALinkThatSizesItself) {
    link.SetAutoSize(true);
    host.SiteOf(link)->SetSize(3000, 900);
    EXPECT_EQ(link.Label1.Width(), 6 * 90);
    EXPECT_EQ(link.Surface().Width(), 6 * 90);
    EXPECT_EQ(link.Surface().Height(), 195);
}

TEST(Link, LoadedAutoSizeLinkHasTheSizeOfItsText) {
    HostUnderTest host;
    const MemoryBag saved({{"AutoSize", true}, {"Caption", "Home page"}});
    auto& link = host.Create<Link>("Link1", {.saved = &saved});
    EXPECT_EQ(link.Label1.Width(), 9 * 90);
    EXPECT_EQ(link.Surface().Width(), 9 * 90);
    EXPECT_EQ(link.Surface().Height(), 195);
}

TEST(Link, AnotherFontResizesAnAutoSizeLink) {
    WatchedHost host;
    auto& link = host.TheLink();
    link.SetAutoSize(true);
    link.SetFont(std::make_shared<Font>("Courier", 20));
    EXPECT_EQ(link.Surface().Width(), 6 * 20 * 10);
    EXPECT_EQ(link.Surface().Height(), 20 * 20);
}

TEST(Link, AFontThatChangesItsSizeResizesAnAutoSizeLink) {
    WatchedHost host;
    auto& link = host.TheLink();
    link.SetAutoSize(true);
    link.Label1.SetLeft(50);
    link.Font()->SetSize(20);
    EXPECT_EQ(link.Label1.Width(), 6 * 20 * 10);
    EXPECT_EQ(link.Surface().Width(), 6 * 20 * 10);
    EXPECT_EQ(link.Surface().Height(), 20 * 20);
    EXPECT_EQ(link.Label1.Left(), 50);
}

// Tool tip.

TEST(Link, ShowAtRunTimeCopiesTheToolTip) {
    HostUnderTest host;
    auto& link = host.Create<Link>("Link1", {.extender = {{"ToolTipText", "Opens the page"}}});
    EXPECT_EQ(link.Label1.ToolTipText(), "Opens the page");
}

TEST(Link, ShowAtDesignTimeLeavesTheToolTip) {
    HostUnderTest host;
    auto& link = host.Create<Link>("Link1", {.designTime = true, .extender = {{"ToolTipText", "Opens the page"}}});
    EXPECT_EQ(link.Label1.ToolTipText(), "");
}

TEST(Link, UserModeIsAskedAtEachShow) {
    HostUnderTest host;
    auto& link = host.Create<Link>("Link1", {.designTime = true, .extender = {{"ToolTipText", "Opens the page"}}});
    auto& site = *host.SiteOf(link);
    site.SetUserMode(true);
    site.SetVisible(false);
    site.SetVisible(true);
    EXPECT_EQ(link.Label1.ToolTipText(), "Opens the page");
}

TEST(Link, RefreshCopiesTheToolTipAtDesignTimeToo) {
    for (const bool designTime : {true, false}) {
        HostUnderTest host;
        auto& link = host.Create<Link>("Link1", {.designTime = designTime});
        host.SiteOf(link)->Extender().Put("ToolTipText", "Opens the page");
        link.Refresh();
        EXPECT_EQ(link.Label1.ToolTipText(), "Opens the page");
        EXPECT_THAT(Changes(host), IsEmpty());
    }
}

TEST(Link, RefreshRepaintsTheLabelAndKeepsItsColour) {
    WatchedHost host;
    auto& link = host.TheLink();
    MoveInside(link);
    host.Flush();
    host.repaints = 0;
    link.Refresh();
    host.Flush();
    EXPECT_EQ(host.repaints, 1);
    EXPECT_EQ(Shown(link), "hovered");
}

// Active area.

TEST_F(PlacedLink, PointOnALimitIsInside) {
    EXPECT_TRUE(Highlights(link, 30, 300));
    EXPECT_TRUE(Highlights(link, 1970, 300));
    EXPECT_TRUE(Highlights(link, 1000, 30));
    EXPECT_TRUE(Highlights(link, 1000, 570));
    EXPECT_TRUE(Highlights(link, 30, 30));
    EXPECT_TRUE(Highlights(link, 1970, 570));
}

TEST_F(PlacedLink, PointJustPastALimitIsOutside) {
    EXPECT_FALSE(Highlights(link, std::nextafter(30.0f, 0.0f), 300));
    EXPECT_FALSE(Highlights(link, std::nextafter(1970.0f, infinite), 300));
    EXPECT_FALSE(Highlights(link, 1000, std::nextafter(30.0f, 0.0f)));
    EXPECT_FALSE(Highlights(link, 1000, std::nextafter(570.0f, infinite)));
}

TEST_F(PlacedLink, PointFarOffTheLabelIsOutside) {
    EXPECT_FALSE(Highlights(link, -5000, 300));
    EXPECT_FALSE(Highlights(link, 5000, 300));
    EXPECT_FALSE(Highlights(link, 1000, -infinite));
    EXPECT_FALSE(Highlights(link, 1000, infinite));
}

TEST_F(PlacedLink, LimitsAreThoseOfTheLabelAsItIs) {
    link.Label1.SetWidth(500);
    EXPECT_TRUE(Highlights(link, 470, 300));
    EXPECT_FALSE(Highlights(link, 471, 300));
}

TEST_F(PlacedLink, LimitsAreComputedInWideFloats) {
    link.SetBorderSize(0.1f);
    // In 32-bit floats 2000 - 0.1 would round up to the point itself.
    ASSERT_EQ(2000.0f - 0.1f, 1999.9f);
    EXPECT_FALSE(Highlights(link, 1999.9f, 300));
    EXPECT_TRUE(Highlights(link, std::nextafter(1999.9f, 0.0f), 300));
    EXPECT_TRUE(Highlights(link, 0.1f, 300));
}

TEST_F(PlacedLink, WithoutAStripNoPointOverTheLabelIsOutside) {
    link.SetBorderSize(0);
    MoveInside(link);
    for (const float x : {0.0f, 1.0f, 1000.0f, 1999.0f, 2000.0f})
        for (const float y : {0.0f, 1.0f, 300.0f, 599.0f, 600.0f}) {
            MoveTo(link, x, y);
            EXPECT_EQ(Shown(link), "hovered") << x << ", " << y;
        }
    EXPECT_FALSE(Highlights(link, -1, 300));
}

TEST_F(PlacedLink, StripAboveHalfTheLabelLeavesNoPointInside) {
    link.SetLinkTo("a.txt");
    link.SetBorderSize(301);
    for (float x = 0; x <= width; x += 100)
        for (float y = 0; y <= height; y += 50) {
            EXPECT_FALSE(Highlights(link, x, y)) << x << ", " << y;
            PressAt(link, x, y);
        }
    EXPECT_FALSE(IsUsed(link));
    EXPECT_EQ(Requests(host).size(), 21u * 13u);
}

TEST_F(PlacedLink, StripOfHalfTheHeightLeavesOneLineInside) {
    link.SetBorderSize(300);
    EXPECT_TRUE(Highlights(link, 1000, 300));
    EXPECT_FALSE(Highlights(link, 1000, 299));
    EXPECT_FALSE(Highlights(link, 1000, 301));
}

TEST_F(PlacedLink, NegativeBorderSizeReachesBeyondTheLabel) {
    link.SetBorderSize(-30);
    EXPECT_TRUE(Highlights(link, 0, 0));
    EXPECT_TRUE(Highlights(link, -30, 630));
    EXPECT_FALSE(Highlights(link, -31, 300));
    EXPECT_FALSE(Highlights(link, 2031, 300));
}

TEST_F(PlacedLink, BorderSizeThatIsNoNumberExcludesNothing) {
    link.SetBorderSize(notANumber);
    EXPECT_TRUE(Highlights(link, 0, 0));
    EXPECT_TRUE(Highlights(link, -1e9f, 1e9f));
    PressAt(link, 0, 0);
    link.SetBorderSize(30);
    EXPECT_TRUE(IsUsed(link));
}

TEST_F(PlacedLink, InfiniteBorderSizeExcludesEverything) {
    link.SetBorderSize(infinite);
    EXPECT_FALSE(Highlights(link, 1000, 300));
    link.SetBorderSize(-infinite);
    EXPECT_TRUE(Highlights(link, -1e9f, 1e9f));
}

TEST_F(PlacedLink, PointThatIsNoNumberIsNotOutside) {
    EXPECT_TRUE(Highlights(link, notANumber, 300));
    EXPECT_TRUE(Highlights(link, notANumber, notANumber));
    EXPECT_FALSE(Highlights(link, notANumber, 10));
}

// Hover.

TEST_F(PlacedLink, MoveInTheActiveAreaHighlights) {
    EXPECT_EQ(Shown(link), "unused");
    MoveInside(link);
    EXPECT_EQ(link.Label1.ForeColor(), red);
}

TEST_F(PlacedLink, MoveIntoTheStripShowsAnUnusedLinkInForeColor) {
    MoveInside(link);
    MoveIntoStrip(link);
    EXPECT_EQ(link.Label1.ForeColor(), blue);
}

TEST_F(PlacedLink, MoveIntoTheStripShowsAUsedLinkInUsedColor) {
    PressInside(link);
    MoveIntoStrip(link);
    EXPECT_EQ(link.Label1.ForeColor(), purple);
    MoveInside(link);
    EXPECT_EQ(link.Label1.ForeColor(), red);
    MoveIntoStrip(link);
    EXPECT_EQ(link.Label1.ForeColor(), purple);
}

TEST_F(PlacedLink, MouseThatJumpsAcrossTheStripLeavesTheLinkHighlighted) {
    MoveInside(link);
    host.clock.Advance(60'000);
    EXPECT_EQ(Shown(link), "hovered");
}

TEST_F(PlacedLink, MoveIsRaisedBeforeTheColourChanges) {
    std::string shown;
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseMove,
                                                [&](std::int16_t&, std::int16_t&, float&, float&) { shown = Shown(link); });
    MoveInside(link);
    EXPECT_EQ(shown, "unused");
    EXPECT_EQ(Shown(link), "hovered");
}

TEST_F(PlacedLink, ColoursThatAHandlerSetsDuringTheMoveShowAtOnce) {
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseMove, [&](std::int16_t&, std::int16_t&, float&, float&) {
        link.SetHighlightColor(0x111111);
        link.SetForeColor(0x222222);
    });
    MoveInside(link);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x111111));
    MoveIntoStrip(link);
    EXPECT_EQ(link.Label1.ForeColor(), OLE_COLOR(0x222222));
}

TEST_F(PlacedLink, BorderSizeThatAHandlerSetsCountsForThatMove) {
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseMove,
                                                [&](std::int16_t&, std::int16_t&, float&, float&) { link.SetBorderSize(5000); });
    MoveInside(link);
    EXPECT_EQ(Shown(link), "unused");
}

TEST_F(PlacedLink, MoveOpensNothing) {
    link.SetLinkTo("a.txt");
    link.Label1.MouseMoveInput(leftButton, noShift, 1000, 300);
    EXPECT_THAT(Requests(host), IsEmpty());
    EXPECT_FALSE(IsUsed(link));
}

// The display states.

TEST_F(PlacedLink, SettingForeColorOrAppearanceLeavesTheHoveredStateUntilTheNextMove) {
    for (const bool byAppearance : {false, true}) {
        MoveInside(link);
        ASSERT_EQ(Shown(link), "hovered");
        if (byAppearance)
            link.SetAppearance(child::AppearanceConstants::Flat);
        else
            link.SetForeColor(0x111111);
        EXPECT_EQ(Shown(link), "unused");
        MoveInside(link);
        EXPECT_EQ(Shown(link), "hovered");
    }
}

TEST_F(PlacedLink, SettingForeColorOrAppearanceLeavesTheUsedStateUntilTheNextMove) {
    PressInside(link);
    for (const bool byAppearance : {false, true}) {
        MoveIntoStrip(link);
        ASSERT_EQ(Shown(link), "used");
        if (byAppearance)
            link.SetAppearance(child::AppearanceConstants::Flat);
        else
            link.SetForeColor(0x111111);
        EXPECT_EQ(Shown(link), "unused");
        MoveIntoStrip(link);
        EXPECT_EQ(Shown(link), "used");
    }
}

TEST_F(PlacedLink, UsedStateLastsForTheLifeOfTheLink) {
    PressInside(link);
    link.SetLinkTo("another.txt");
    link.SetCaption("Another");
    link.SetForeColor(0x111111);
    link.SetClickAction(ClickActionConstants::Do_nothing);
    link.Refresh();
    host.SiteOf(link)->SetVisible(false);
    host.SiteOf(link)->SetVisible(true);
    PressInStrip(link);
    EXPECT_TRUE(IsUsed(link));
}

// Press.

TEST_F(PlacedLink, PressOpensLinkTo) {
    link.SetLinkTo("C:\\My \"notes\".txt");
    PressInside(link);
    EXPECT_THAT(Requests(host), ElementsAre("open C:\\My \"notes\".txt"));
    EXPECT_THAT(Boxes(host), IsEmpty());
}

TEST_F(PlacedLink, PressPrintsLinkTo) {
    link.SetLinkTo("a.txt");
    link.SetClickAction(ClickActionConstants::Print_Link);
    PressInside(link);
    EXPECT_THAT(Requests(host), ElementsAre("print a.txt"));
}

TEST(Link, PressOfAnyButtonRunsTheActionAndMarksTheLinkUsed) {
    for (const std::int16_t button : {leftButton, rightButton, middleButton}) {
        HostUnderTest host;
        auto& link = NewLink(host);
        link.SetLinkTo("a.txt");
        link.Label1.MouseDownInput(button, 7, 1000, 300);
        EXPECT_THAT(Requests(host), ElementsAre("open a.txt"));
        EXPECT_TRUE(IsUsed(link));
    }
}

TEST_F(PlacedLink, PressWithoutLinkToOpensOrPrintsTheCaption) {
    link.SetCaption("www.example.org");
    PressInside(link);
    link.SetClickAction(ClickActionConstants::Print_Link);
    PressInside(link);
    EXPECT_THAT(Requests(host), ElementsAre("open www.example.org", "print www.example.org"));
}

TEST_F(PlacedLink, PressPrefersLinkToToTheCaption) {
    link.SetCaption("caption");
    link.SetLinkTo(" ");  // not empty
    PressInside(link);
    EXPECT_THAT(Requests(host), ElementsAre("open  "));
}

TEST_F(PlacedLink, PressWithoutLinkToAndCaptionDoesNothing) {
    link.SetCaption("");
    host.shell.executeResults = {2};
    PressInside(link);
    link.SetClickAction(ClickActionConstants::Print_Link);
    PressInStrip(link);
    EXPECT_THAT(Requests(host), IsEmpty());
    EXPECT_THAT(Boxes(host), IsEmpty());
}

TEST_F(PlacedLink, PressThatDoesNothingStillMarksTheLinkUsed) {
    link.SetLinkTo("a.txt");
    link.SetClickAction(ClickActionConstants::Do_nothing);
    PressInside(link);
    EXPECT_THAT(Requests(host), IsEmpty());
    EXPECT_TRUE(IsUsed(link));
}

TEST(Link, UnnamedClickActionDoesNothing) {
    for (const int action : {3, -1, 257, 258, -32'768, 32'767}) {
        HostUnderTest host;
        auto& link = NewLink(host);
        link.SetLinkTo("a.txt");
        link.Put("ClickAction", action);
        EXPECT_EQ(link.Get("ClickAction"), Variant(action));
        PressInside(link);
        EXPECT_THAT(Requests(host), IsEmpty()) << action;
        EXPECT_TRUE(IsUsed(link)) << action;
    }
}

TEST_F(PlacedLink, PressInTheStripRunsTheActionWithoutMarkingItUsed) {
    link.SetLinkTo("a.txt");
    PressInStrip(link);
    EXPECT_THAT(Requests(host), ElementsAre("open a.txt"));
    EXPECT_FALSE(IsUsed(link));
}

TEST_F(PlacedLink, PressOnTheLimitMarksTheLinkUsed) {
    PressAt(link, 30, 570);
    EXPECT_TRUE(IsUsed(link));
}

TEST_F(PlacedLink, PressThatFailsStillMarksTheLinkUsed) {
    host.shell.executeResults = {2};
    PressInside(link);
    EXPECT_TRUE(IsUsed(link));
}

TEST(Link, PressRepaintsNothing) {
    WatchedHost host;
    auto& link = host.TheLink();
    PressInside(link);
    host.Flush();
    EXPECT_EQ(host.repaints, 0);
    EXPECT_EQ(link.Label1.ForeColor(), blue);
    MoveInside(link);
    EXPECT_EQ(host.repaints, 1);
    PressInside(link);
    EXPECT_EQ(link.Label1.ForeColor(), red);
    EXPECT_EQ(host.repaints, 1);
}

TEST_F(PlacedLink, PressIsRaisedBeforeTheActionRuns) {
    link.SetLinkTo("old.txt");
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseDown, [&](std::int16_t&, std::int16_t&, float&, float&) {
        EXPECT_THAT(Requests(host), IsEmpty());
        link.SetLinkTo("new.txt");
        link.SetClickAction(ClickActionConstants::Print_Link);
    });
    PressInside(link);
    EXPECT_THAT(Requests(host), ElementsAre("print new.txt"));
}

TEST_F(PlacedLink, HandlerOfThePressCanCallTheActionOff) {
    link.SetLinkTo("a.txt");
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseDown, [&](std::int16_t&, std::int16_t&, float&, float&) {
        link.SetClickAction(ClickActionConstants::Do_nothing);
    });
    PressInside(link);
    EXPECT_THAT(Requests(host), IsEmpty());
}

TEST_F(PlacedLink, BorderSizeThatAHandlerSetsCountsForThatPress) {
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseDown,
                                                [&](std::int16_t&, std::int16_t&, float&, float&) { link.SetBorderSize(5000); });
    PressInside(link);
    EXPECT_FALSE(IsUsed(link));
}

TEST_F(PlacedLink, ActionRunsBeforeMouseUpAndClick) {
    link.SetLinkTo("a.txt");
    PressInside(link);
    link.Label1.MouseUpInput(leftButton, noShift, 1000, 300);
    link.Label1.ClickInput();
    std::string order;
    for (const auto& entry : host.log.Entries())
        if (entry[0] == Variant("event") || entry[0] == Variant("execute"))
            order += (entry[0] == Variant("execute") ? "execute" : entry[2].ToText()) + " ";
    EXPECT_EQ(order, "MouseDown execute MouseUp Click ");
}

TEST_F(PlacedLink, FailureOfAPressIsShownAndNeverRaised) {
    link.SetLinkTo("a.txt");
    host.shell.executeResults = {31};
    PressInside(link);
    EXPECT_THAT(Boxes(host), ElementsAre("Error 31: No application associated with file 'a.txt'"));
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_F(PlacedLink, FailureOfAPressIsSilentWithMessagesSuppressed) {
    link.SetLinkTo("a.txt");
    link.SetSuppressMessages(true);
    host.shell.executeResults = {31};
    PressInside(link);
    EXPECT_THAT(Requests(host), ElementsAre("open a.txt"));
    EXPECT_THAT(Boxes(host), IsEmpty());
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

// Events.

TEST(Link, MouseUpClickAndDblClickAreForwardedAndDoNothingElse) {
    WatchedHost watched;
    auto& quiet = watched.TheLink();
    quiet.Label1.MouseUpInput(leftButton, noShift, 1000, 300);
    quiet.Label1.ClickInput();
    quiet.Label1.DblClickInput();
    EXPECT_THAT(watched.requests, IsEmpty());
    EXPECT_EQ(watched.repaints, 0);
    EXPECT_FALSE(IsUsed(quiet));

    HostUnderTest host;
    auto& link = NewLink(host);
    link.Label1.MouseUpInput(leftButton, noShift, 1000, 300);
    link.Label1.ClickInput();
    link.Label1.DblClickInput();
    EXPECT_EQ(host.log.EventNames("Link1"), "MouseUp Click DblClick");
}

TEST_F(PlacedLink, MouseEventsCarryTheArgumentsOfTheLabel) {
    link.Label1.MouseDownInput(2, 5, 12.5f, -7);
    EXPECT_EQ(LastArguments(host), "2 5 12.5 -7");
    link.Label1.MouseMoveInput(4, 1, 0, 600);
    EXPECT_EQ(LastArguments(host), "4 1 0 600");
    link.Label1.MouseUpInput(1, 2, 1999.5f, 3);
    EXPECT_EQ(LastArguments(host), "1 2 1999.5 3");
    link.Label1.ClickInput();
    EXPECT_EQ(LastArguments(host), "");
    EXPECT_EQ(host.log.EventNames("Link1"), "MouseDown MouseMove MouseUp Click");
}

TEST_F(PlacedLink, MoveDoesNotReadBackWhatAHandlerDidToTheArguments) {
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseMove,
                                                [&](std::int16_t& button, std::int16_t& shift, float& x, float& y) {
                                                    button = shift = 99;
                                                    x = y = 1;
                                                });
    MoveInside(link);
    EXPECT_EQ(Shown(link), "hovered");
}

TEST_F(PlacedLink, PressDoesNotReadBackWhatAHandlerDidToTheArguments) {
    host.SiteOf(link)->ApplicationHandlers().On(frame::stock::MouseDown,
                                                [&](std::int16_t&, std::int16_t&, float& x, float& y) { x = y = 1; });
    PressInside(link);
    EXPECT_TRUE(IsUsed(link));
}

TEST_F(PlacedLink, KeyEventsAreNeverRaised) {
    for (const std::int16_t button : {leftButton, rightButton}) {
        link.Label1.MouseDownInput(button, noShift, 1000, 300);
        link.Label1.MouseMoveInput(button, noShift, 1000, 300);
        link.Label1.MouseUpInput(button, noShift, 1000, 300);
        link.Label1.ClickInput();
        link.Label1.DblClickInput();
    }
    link.OpenLink("a.txt");
    link.Refresh();
    EXPECT_EQ(host.log.EventNames(), "MouseDown MouseMove MouseUp Click DblClick MouseDown MouseMove MouseUp Click DblClick");
}

TEST_F(PlacedLink, SettersAndMethodsRaiseNoEvent) {
    link.SetCaption("Home");
    link.SetForeColor(1);
    link.OpenLink("a.txt");
    link.PrintLink("a.txt");
    EXPECT_EQ(host.log.EventNames(), "");
}

// The shell.

struct Failure {
    int result;
    const char* whenOpened;
    const char* whenPrinted;
};

class LinkShell : public testing::TestWithParam<Failure> {};

TEST_P(LinkShell, OpenLinkShowsAndReturnsTheMessageOfTheResult) {
    HostUnderTest host;
    auto& link = NewLink(host);
    host.shell.executeResults = {GetParam().result};
    EXPECT_EQ(link.OpenLink("My file.txt"), GetParam().whenOpened);
    EXPECT_THAT(Requests(host), ElementsAre("open My file.txt"));
    EXPECT_THAT(Boxes(host),
                ElementsAre("Error " + std::to_string(GetParam().result) + ": " + GetParam().whenOpened + " 'My file.txt'"));
    EXPECT_EQ(host.log.Of("msgbox")[0][2], Variant(0));
}

TEST_P(LinkShell, PrintLinkShowsAndReturnsTheMessageOfTheResult) {
    HostUnderTest host;
    auto& link = NewLink(host);
    host.shell.executeResults = {GetParam().result};
    EXPECT_EQ(link.PrintLink("My file.txt"), GetParam().whenPrinted);
    EXPECT_THAT(Requests(host), ElementsAre("print My file.txt"));
    EXPECT_THAT(Boxes(host),
                ElementsAre("Error " + std::to_string(GetParam().result) + ": " + GetParam().whenPrinted + " 'My file.txt'"));
    EXPECT_EQ(host.log.Of("msgbox")[0][2], Variant(0));
}

TEST_P(LinkShell, PressShowsTheMessageOfTheResult) {
    HostUnderTest host;
    auto& link = NewLink(host);
    link.SetLinkTo("a.txt");
    host.shell.executeResults = {GetParam().result, GetParam().result};
    PressInside(link);
    link.SetClickAction(ClickActionConstants::Print_Link);
    PressInside(link);
    const std::string start = "Error " + std::to_string(GetParam().result) + ": ";
    EXPECT_THAT(Boxes(host), ElementsAre(start + GetParam().whenOpened + " 'a.txt'", start + GetParam().whenPrinted + " 'a.txt'"));
}

TEST_P(LinkShell, SuppressedMessageIsReturnedAllTheSame) {
    HostUnderTest host;
    auto& link = NewLink(host);
    link.SetSuppressMessages(true);
    host.shell.executeResults = {GetParam().result, GetParam().result};
    EXPECT_EQ(link.OpenLink("a.txt"), GetParam().whenOpened);
    EXPECT_EQ(link.PrintLink("a.txt"), GetParam().whenPrinted);
    EXPECT_THAT(Boxes(host), IsEmpty());
}

constexpr const char* noProgram = "No application associated with file";
constexpr const char* notFound = "Unable to find file";
constexpr const char* notViewed = "Unable to view file";
constexpr const char* notPrinted = "Unable to print file";

INSTANTIATE_TEST_SUITE_P(Results, LinkShell,
                         testing::Values(Failure{31, noProgram, noProgram}, Failure{2, notFound, notFound},
                                         Failure{3, notFound, notFound}, Failure{0, notViewed, notPrinted},
                                         Failure{1, notViewed, notPrinted}, Failure{4, notViewed, notPrinted},
                                         Failure{5, notViewed, notPrinted}, Failure{8, notViewed, notPrinted},
                                         Failure{26, notViewed, notPrinted}, Failure{30, notViewed, notPrinted},
                                         Failure{32, notViewed, notPrinted}, Failure{-1, notViewed, notPrinted}),
                         [](const auto& row) {
                             const int result = row.param.result;
                             return result < 0 ? "Minus" + std::to_string(-result) : "Result" + std::to_string(result);
                         });

TEST_F(PlacedLink, ResultsAboveThirtyTwoAreSuccess) {
    for (const int result : {33, 42, 1000, 2'147'483'647}) {
        host.shell.executeResults = {result, result};
        EXPECT_EQ(link.OpenLink("a.txt"), "") << result;
        EXPECT_EQ(link.PrintLink("a.txt"), "") << result;
    }
    EXPECT_THAT(Boxes(host), IsEmpty());
}

TEST_F(PlacedLink, MessageNamesTheTargetAsItIs) {
    host.shell.executeResults = {2};
    link.OpenLink("C:\\It's 'here'%s.txt");
    EXPECT_THAT(Boxes(host), ElementsAre("Error 2: Unable to find file 'C:\\It's 'here'%s.txt'"));
}

TEST_F(PlacedLink, OpenLinkAndPrintLinkTakeLinkToWithoutAnArgument) {
    link.SetLinkTo("a.txt");
    EXPECT_EQ(link.OpenLink(), "");
    EXPECT_EQ(link.PrintLink(), "");
    EXPECT_THAT(Requests(host), ElementsAre("open a.txt", "print a.txt"));
}

TEST_F(PlacedLink, OpenLinkAndPrintLinkPreferTheirArgument) {
    link.SetLinkTo("a.txt");
    link.OpenLink("b.txt");
    link.PrintLink("c.txt");
    EXPECT_THAT(Requests(host), ElementsAre("open b.txt", "print c.txt"));
    EXPECT_EQ(link.LinkTo(), "a.txt");
}

TEST_F(PlacedLink, OpenLinkDoesNotFallBackOnTheCaption) {
    link.SetCaption("www.example.org");
    EXPECT_EQ(link.OpenLink(), "");
    EXPECT_EQ(link.PrintLink(), "");
    EXPECT_THAT(Requests(host), IsEmpty());
    EXPECT_THAT(Boxes(host), IsEmpty());
}

TEST_F(PlacedLink, EmptyArgumentIsATargetAndOpensNothing) {
    link.SetLinkTo("a.txt");
    EXPECT_EQ(link.OpenLink(""), "");
    EXPECT_EQ(link.PrintLink(""), "");
    EXPECT_EQ(link.OpenLink(Variant()), "");
    EXPECT_THAT(Requests(host), IsEmpty());
}

TEST_F(PlacedLink, ArgumentThatIsANumberIsTakenAsText) {
    link.OpenLink(Variant(7));
    EXPECT_THAT(Requests(host), ElementsAre("open 7"));
}

TEST_F(PlacedLink, ArgumentWithoutATextFormIsATypeMismatch) {
    try {
        link.OpenLink(headless::ListOf(std::vector<std::string>{"a.txt"}));
        ADD_FAILURE() << "an array was opened";
    } catch (const ControlError& error) {
        EXPECT_EQ(error.Number(), frame::errors::typeMismatch);
    }
    EXPECT_THAT(Requests(host), IsEmpty());
}

TEST_F(PlacedLink, OpenLinkAndPrintLinkDoNotLookAtTheClickAction) {
    link.SetLinkTo("a.txt");
    for (const int action : {0, 1, 2, 9}) {
        host.log.Clear();
        link.Put("ClickAction", action);
        link.OpenLink();
        link.PrintLink();
        EXPECT_THAT(Requests(host), ElementsAre("open a.txt", "print a.txt")) << action;
    }
}

TEST_F(PlacedLink, OpenLinkAndPrintLinkDoNotMarkTheLinkUsed) {
    link.OpenLink("a.txt");
    link.PrintLink("a.txt");
    EXPECT_FALSE(IsUsed(link));
}

// While a box stands.

TEST(Link, InputWhileAMessageBoxStandsIsHandledAsEver) {
    WatchedHost host;
    auto& link = host.TheLink();
    link.SetLinkTo("first.txt");
    host.shellResult = 2;
    host.whileBoxStands = [&] {
        MoveInside(link);
        EXPECT_EQ(Shown(link), "hovered");
        link.SetLinkTo("second.txt");
        PressInside(link);
    };
    PressInStrip(link);
    EXPECT_THAT(host.requests, ElementsAre("open first.txt", "open second.txt"));
    EXPECT_THAT(host.boxes, ElementsAre("Error 2: Unable to find file 'first.txt'", "Error 2: Unable to find file 'second.txt'"));
    EXPECT_TRUE(IsUsed(link));
}

TEST(Link, MessageReturnedIsTheOneShownWhateverHappensMeanwhile) {
    WatchedHost host;
    auto& link = host.TheLink();
    link.SetLinkTo("first.txt");
    host.shellResult = 31;
    host.whileBoxStands = [&] {
        host.shellResult = 5;
        link.SetLinkTo("second.txt");
        EXPECT_EQ(link.PrintLink(), "Unable to print file");
    };
    EXPECT_EQ(link.OpenLink(), "No application associated with file");
}

TEST(Link, TargetOfAFailureIsTheOneThatWasTried) {
    WatchedHost host;
    auto& link = host.TheLink();
    link.SetLinkTo("first.txt");
    host.shellResult = 2;
    host.whileShellWorks = [&] { link.SetLinkTo("second.txt"); };
    link.OpenLink();
    EXPECT_THAT(host.boxes, ElementsAre("Error 2: Unable to find file 'first.txt'"));
}

TEST(Link, MessagesSuppressedWhileTheShellWorksAreNotShown) {
    WatchedHost host;
    auto& link = host.TheLink();
    host.shellResult = 2;
    host.whileShellWorks = [&] { link.SetSuppressMessages(true); };
    EXPECT_EQ(link.OpenLink("a.txt"), "Unable to find file");
    EXPECT_THAT(host.boxes, IsEmpty());
}

}  // namespace
}  // namespace tessel::controls
