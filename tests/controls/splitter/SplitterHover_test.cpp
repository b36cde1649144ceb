#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "tests/HostUnderTest.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

/// The highlight under the mouse, the flags behind it, and the events of the bar's own surface.
namespace tessel::controls {
namespace {

using frame::OLE_COLOR;
using frame::Variant;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace splittertest;

// The active area.

/// A bar without a border, 3000 wide and 1050 high: it draws one fill, so that the number of fills is the number of drawings.
class SplitterHover : public testing::Test {
  protected:
    SplitterHover() {
        stage.Lay(horizontal, 0, 1000, 3000, 1050);
        bar().Put("Appearance", none);
        stage.Forget();
    }
    frame::Control& bar() { return stage.Bar(); }
    /// The fills of what was drawn since the last call: "on" in the highlight colour, "off" in the background's.
    std::vector<std::string> Fills() {
        std::vector<std::string> fills;
        for (const auto& line : Drawn(stage.canvas)) fills.push_back(line.ends_with(" C0C000") ? "on" : "off");
        stage.canvas.operations.clear();
        return fills;
    }
    bool HighlightsAt(float x, float y) {
        MoveTo(bar(), 0, 0);
        Fills();
        MoveTo(bar(), x, y);
        return !Fills().empty();
    }

    Stage stage;
};

TEST_F(SplitterHover, APointInTheActiveAreaHighlightsTheBar) {
    MoveTo(bar(), 1500, 500);
    EXPECT_THAT(Fills(), ElementsAre("on"));
}

TEST_F(SplitterHover, TheLimitsOfTheActiveAreaAreInside) {
    for (const auto& [x, y] : {std::pair{30.0f, 500.0f},
                               {2970.0f, 500.0f},
                               {1500.0f, 30.0f},
                               {1500.0f, 1020.0f},
                               {30.0f, 30.0f},
                               {2970.0f, 1020.0f},
                               {30.0f, 1020.0f},
                               {2970.0f, 30.0f}})
        EXPECT_TRUE(HighlightsAt(x, y)) << x << ", " << y;
}

TEST_F(SplitterHover, TheStripAlongEachEdgeIsOutside) {
    for (const auto& [x, y] : {std::pair{29.5f, 500.0f},
                               {2970.5f, 500.0f},
                               {1500.0f, 29.5f},
                               {1500.0f, 1020.5f},
                               {0.0f, 0.0f},
                               {3000.0f, 1050.0f},
                               {-10.0f, 500.0f},
                               {1500.0f, -10.0f},
                               {4000.0f, 500.0f},
                               {1500.0f, 2000.0f}})
        EXPECT_FALSE(HighlightsAt(x, y)) << x << ", " << y;
}

TEST_F(SplitterHover, MovingOnInsideDrawsNothingMore) {
    MoveTo(bar(), 1500, 500);
    Fills();
    MoveTo(bar(), 1501, 500);
    MoveTo(bar(), 2000, 700);
    EXPECT_THAT(Fills(), IsEmpty());
}

TEST_F(SplitterHover, TheStripTakesTheHighlightAway) {
    MoveTo(bar(), 1500, 500);
    MoveTo(bar(), 10, 500);
    EXPECT_THAT(Fills(), ElementsAre("on", "off"));
}

TEST_F(SplitterHover, MovingOnInTheStripDrawsNothing) {
    MoveTo(bar(), 10, 500);
    MoveTo(bar(), 20, 500);
    EXPECT_THAT(Fills(), IsEmpty());
}

TEST_F(SplitterHover, ABarOf120IsHighlightedFrom30Inside) {
    stage.Lay(horizontal, 0, 1000, 6000, thick);
    EXPECT_TRUE(HighlightsAt(1000, 30));
    EXPECT_TRUE(HighlightsAt(1000, 90));
    EXPECT_FALSE(HighlightsAt(1000, 29));
    EXPECT_FALSE(HighlightsAt(1000, 91));
}

TEST_F(SplitterHover, ABarOf60HasALineForItsActiveArea) {
    stage.Lay(vertical, 1000, 0, 60, 4000);
    EXPECT_TRUE(HighlightsAt(30, 2000));
    EXPECT_FALSE(HighlightsAt(29, 2000));
    EXPECT_FALSE(HighlightsAt(31, 2000));
}

TEST_F(SplitterHover, AThinnerBarHasNoActiveArea) {
    stage.Lay(horizontal, 0, 1000, 6000, 45);
    for (float y = 0; y <= 45; y += 5) EXPECT_FALSE(HighlightsAt(3000, y)) << y;
}

TEST_F(SplitterHover, TheActiveAreaFollowsTheSize) {
    EXPECT_FALSE(HighlightsAt(3500, 500));
    stage.Site().SetSize(4000, 1050);
    EXPECT_TRUE(HighlightsAt(3500, 500));
}

// States.

TEST_F(SplitterHover, APressByItselfNeitherDrawsNorHighlights) {
    Press(bar(), 1500, 500);
    EXPECT_THAT(Fills(), IsEmpty());
    EXPECT_FALSE(ShowsHighlight(bar()));
}

TEST_F(SplitterHover, TheFirstMoveOfADragHighlightsWithoutDrawing) {
    Press(bar(), 1500, 500);
    MoveTo(bar(), 1500, 500);
    EXPECT_THAT(Fills(), IsEmpty());
    EXPECT_TRUE(ShowsHighlight(bar()));
}

TEST_F(SplitterHover, ADragHighlightsInTheStripToo) {
    Press(bar(), 10, 10);
    MoveTo(bar(), 10, 10);
    EXPECT_THAT(Fills(), IsEmpty());
    EXPECT_TRUE(ShowsHighlight(bar()));
}

TEST_F(SplitterHover, NoMoveOfADragDraws) {
    MoveTo(bar(), 1500, 500);
    Fills();
    Press(bar(), 1500, 500);
    MoveTo(bar(), 0, 0);
    MoveTo(bar(), 1500, 520);
    EXPECT_THAT(Fills(), IsEmpty());
}

TEST_F(SplitterHover, AReleaseDrawsNothingAndTheNextPaintShowsNoHighlight) {
    Press(bar(), 1500, 500);
    MoveTo(bar(), 1500, 500);
    Release(bar());
    EXPECT_THAT(Fills(), IsEmpty());
    EXPECT_FALSE(ShowsHighlight(bar()));
}

TEST_F(SplitterHover, AfterAReleaseAMoveInsideHighlightsAndDrawsAgain) {
    MoveTo(bar(), 1500, 500);
    Press(bar(), 1500, 500);
    Release(bar());
    Fills();
    MoveTo(bar(), 1500, 500);
    EXPECT_THAT(Fills(), ElementsAre("on"));
}

TEST_F(SplitterHover, AfterAReleaseAMoveInTheStripDrawsNothingSinceTheFlagIsClear) {
    MoveTo(bar(), 1500, 500);
    Press(bar(), 1500, 500);
    Release(bar());
    Fills();
    MoveTo(bar(), 10, 500);
    EXPECT_THAT(Fills(), IsEmpty());
}

TEST_F(SplitterHover, AReleaseWithoutAPressClearsTheHighlightToo) {
    MoveTo(bar(), 1500, 500);
    Fills();
    Release(bar());
    EXPECT_THAT(Fills(), IsEmpty());
    EXPECT_FALSE(ShowsHighlight(bar()));
}

TEST_F(SplitterHover, AHoveredBarKeepsItsHighlightThroughAPress) {
    MoveTo(bar(), 1500, 500);
    Press(bar(), 1500, 500);
    EXPECT_TRUE(ShowsHighlight(bar()));
}

TEST_F(SplitterHover, WithoutAPressAMoveWithAButtonDownIsNoDrag) {
    Mouse(bar(), "MouseMove", 1500, 900, 1);
    EXPECT_EQ(stage.Site().Top(), 1000);
    EXPECT_THAT(Fills(), ElementsAre("on"));
}

// Events: first the event, then the reaction.

TEST_F(SplitterHover, MouseMoveIsRaisedBeforeTheHighlight) {
    std::size_t drawn = 1;
    stage.on["MouseMove"] = [&](auto) { drawn = stage.canvas.operations.size(); };
    MoveTo(bar(), 1500, 500);
    EXPECT_EQ(drawn, 0u);
    EXPECT_THAT(Fills(), ElementsAre("on"));
}

TEST_F(SplitterHover, MouseMoveIsRaisedBeforeTheDragStep) {
    float top = 0;
    Press(bar(), 1500, 500);
    stage.on["MouseMove"] = [&](auto) { top = stage.Site().Top(); };
    MoveTo(bar(), 1500, 600);
    EXPECT_EQ(top, 1000);
    EXPECT_EQ(stage.Site().Top(), 1100);
}

TEST_F(SplitterHover, MouseDownIsRaisedBeforeTheDragBegins) {
    stage.on["MouseDown"] = [&](auto) { MoveTo(bar(), 1500, 900); };
    Press(bar(), 1500, 500);
    EXPECT_EQ(stage.Site().Top(), 1000);
    EXPECT_THAT(Fills(), ElementsAre("on"));
    MoveTo(bar(), 1500, 600);
    EXPECT_EQ(stage.Site().Top(), 1100);
}

TEST_F(SplitterHover, MouseUpIsRaisedBeforeTheDragEnds) {
    Press(bar(), 1500, 500);
    stage.on["MouseUp"] = [&](auto) { MoveTo(bar(), 1500, 600); };
    Release(bar());
    EXPECT_EQ(stage.Site().Top(), 1100);
    MoveTo(bar(), 1500, 700);
    EXPECT_EQ(stage.Site().Top(), 1100);
}

TEST_F(SplitterHover, TheHighlightTakesTheColourThatTheHandlerSets) {
    stage.on["MouseMove"] = [&](auto) { bar().Put("HighlightColor", OLE_COLOR(0x123456)); };
    MoveTo(bar(), 1500, 500);
    EXPECT_THAT(Drawn(stage.canvas), ElementsAre("fill 0,0-199,69 123456"));
}

TEST_F(SplitterHover, WhatAHandlerDoesToTheArgumentsIsNotReadBack) {
    const auto elsewhere = [](frame::EventArguments arguments) {
        for (const auto& argument : arguments) argument.Set(7);
    };
    stage.on["MouseDown"] = stage.on["MouseMove"] = elsewhere;
    MoveTo(bar(), 1500, 500);
    EXPECT_THAT(Fills(), ElementsAre("on"));
    Press(bar(), 1500, 500);
    MoveTo(bar(), 1500, 600);
    EXPECT_EQ(stage.Site().Top(), 1100);
}

TEST_F(SplitterHover, ArgumentsOfAllEventsCanBeSet) {
    std::vector<std::string> after;
    for (const auto* name : {"KeyDown", "KeyPress", "KeyUp", "MouseDown", "MouseMove", "MouseUp"})
        stage.on[name] = [&after](frame::EventArguments arguments) {
            std::string line;
            for (const auto& argument : arguments) {
                argument.Set(argument.Get().ToSingle() + 1);
                line += (line.empty() ? "" : " ") + argument.Get().ToText();
            }
            after.push_back(line);
        };
    Fire(bar(), "KeyDown", {std::int16_t{65}, std::int16_t{1}});
    Fire(bar(), "KeyPress", {std::int16_t{97}});
    Fire(bar(), "KeyUp", {std::int16_t{65}, std::int16_t{0}});
    Mouse(bar(), "MouseDown", 10.5f, 20.5f);
    Mouse(bar(), "MouseMove", 11.5f, 21.5f);
    Mouse(bar(), "MouseUp", 12.5f, 22.5f);
    EXPECT_THAT(after, ElementsAre("66 2", "98", "66 1", "2 1 11.5 21.5", "2 1 12.5 22.5", "2 1 13.5 23.5"));
}

TEST(SplitterEvents, EachInputRaisesItsEventWithItsArguments) {
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.width = 3000, .height = 1050});
    Fire(bar, "Click");
    Fire(bar, "DblClick");
    Fire(bar, "KeyDown", {std::int16_t{65}, std::int16_t{1}});
    Fire(bar, "KeyPress", {std::int16_t{97}});
    Fire(bar, "KeyUp", {std::int16_t{65}, std::int16_t{2}});
    Fire(bar, "MouseDown", {std::int16_t{2}, std::int16_t{4}, 10.5f, 20.5f});
    Fire(bar, "MouseMove", {std::int16_t{1}, std::int16_t{3}, 11.5f, 20.5f});
    Fire(bar, "MouseUp", {std::int16_t{2}, std::int16_t{0}, 12.5f, -20.5f});
    std::vector<std::string> lines;
    for (const auto& entry : host.log.Of("event")) {
        std::string line = entry.at(2).ToText();
        for (const auto& value : entry.at(3).ToArray().items)
            line += " " + value.ToText() + ":" + std::string(VarTypeName(value.Type()));
        if (entry.at(2) == Variant("AfterMove")) continue;
        lines.push_back(line);
    }
    EXPECT_THAT(lines, ElementsAre("Click", "DblClick", "KeyDown 65:Integer 1:Integer", "KeyPress 97:Integer",
                                   "KeyUp 65:Integer 2:Integer", "MouseDown 2:Integer 4:Integer 10.5:Single 20.5:Single",
                                   "MouseMove 1:Integer 3:Integer 11.5:Single 20.5:Single",
                                   "MouseUp 2:Integer 0:Integer 12.5:Single -20.5:Single"));
}

TEST(SplitterEvents, ClicksAndKeysDoNoMoreThanRaiseTheirEvents) {
    Stage stage;
    stage.Add("Text1");
    stage.Bar().Put("ControlsTopLeft", "Text1");
    stage.LayHorizontal(1000);
    Fire(stage.Bar(), "Click");
    Fire(stage.Bar(), "DblClick");
    for (const std::int16_t key : {std::int16_t{38}, std::int16_t{40}, std::int16_t{27}, std::int16_t{13}}) {
        Fire(stage.Bar(), "KeyDown", {key, std::int16_t{0}});
        Fire(stage.Bar(), "KeyPress", {key});
        Fire(stage.Bar(), "KeyUp", {key, std::int16_t{0}});
    }
    EXPECT_EQ(stage.deeds.size(), 14u);
    for (const auto& deed : stage.deeds) EXPECT_TRUE(deed.starts_with("Key") || deed.find("Click(") != std::string::npos) << deed;
    EXPECT_THAT(Drawn(stage.canvas), IsEmpty());
}

TEST(SplitterEvents, AClickDuringADragDoesNotEndIt) {
    Stage stage;
    stage.LayHorizontal(1000);
    Press(stage.Bar(), 50, 50);
    Fire(stage.Bar(), "Click");
    Fire(stage.Bar(), "DblClick");
    MoveTo(stage.Bar(), 50, 150);
    EXPECT_EQ(stage.Site().Top(), 1100);
}

TEST(SplitterEvents, OnBothHostsTheHighlightIsDrawnOnTheBarsOwnSurface) {
    frame::RecordingCanvas canvas;
    HostUnderTest host;
    auto& bar = host.Create(SplitterClass(), "Splitter1", {.width = 3000, .height = 1050});
    bar.Put("Appearance", none);
    bar.Surface().AddCanvas(canvas);
    MoveTo(bar, 1500, 500);
    MoveTo(bar, 1500, 10);
    EXPECT_THAT(Drawn(canvas), ElementsAre("fill 0,0-199,69 C0C000", "fill 0,0-199,69 8000000F"));
}

}  // namespace
}  // namespace tessel::controls
