#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <ostream>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "frame/host.h"
#include "tests/HostUnderTest.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

/// Handlers that destroy the bar, move it, change its lists, drag it on or fail.
namespace tessel::controls {
namespace {

using frame::ControlError;
using frame::OLE_COLOR;
using frame::Variant;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using namespace splittertest;

/// A horizontal bar at 1000 between two controls, held at 50, 50.
class SplitterHandlers : public testing::Test {
  protected:
    SplitterHandlers() {
        bar().Put("ControlsTopLeft", "Above");
        bar().Put("ControlsBottomRight", "Below");
        stage.LayHorizontal(1000);
    }
    frame::Control& bar() { return stage.Bar(); }
    void On(const std::string& event, std::function<void()> act) {
        stage.on[event] = [act = std::move(act)](frame::EventArguments) { act(); };
    }
    float Top() { return stage.Site().Top(); }

    Stage stage;
    Thing& above = stage.Add("Above");
    Thing& below = stage.Add("Below");
};

// Changes in MouseMove count for the step that follows.

TEST_F(SplitterHandlers, ListsChangedInMouseMoveAreThoseOfTheStep) {
    Press(bar(), 50, 50);
    On("MouseMove", [&] {
        bar().Put("ControlsTopLeft", "Below");
        bar().Put("ControlsBottomRight", "");
    });
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(above.Number("Height"), 800);
    EXPECT_EQ(below.Number("Height"), 900);
    EXPECT_EQ(below.Number("Top"), 200);
}

TEST_F(SplitterHandlers, LimitsChangedInMouseMoveHoldForTheStep) {
    Press(bar(), 50, 50);
    On("MouseMove", [&] { bar().Put("MinTopLeft", 1050); });
    MoveTo(bar(), 50, 0);
    EXPECT_EQ(Top(), 1050);
}

TEST_F(SplitterHandlers, ABarMovedInMouseMoveGoesOnFromThere) {
    Press(bar(), 50, 50);
    On("MouseMove", [&] { stage.Site().SetPlace(0, 2000); });
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 2100);
    EXPECT_THAT(stage.Deeds("AfterMove"), ElementsAre("AfterMove(0, 100)"));
}

TEST_F(SplitterHandlers, AnOrientationChangedInMouseMoveIsThatOfTheStep) {
    Press(bar(), 50, 50);
    On("MouseMove", [&] {
        bar().Put("Orientation", vertical);
        stage.on.clear();
    });
    MoveTo(bar(), 70, 150);
    EXPECT_EQ(stage.Site().Left(), 3020);
    EXPECT_EQ(stage.Site().Top(), 0);
    EXPECT_EQ(above.Number("Width"), 1020);
    EXPECT_EQ(above.Number("Height"), 800);
}

TEST_F(SplitterHandlers, AReleaseInMouseMoveEndsTheDragBeforeTheStep) {
    Press(bar(), 50, 50);
    On("MouseMove", [&] { Release(bar()); });
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1000);
    EXPECT_THAT(stage.Deeds("AfterMove"), IsEmpty());
}

TEST_F(SplitterHandlers, APressInMouseMoveBeginsTheDragWithTheStep) {
    On("MouseMove", [&] { Press(bar(), 50, 50); });
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1100);
}

TEST_F(SplitterHandlers, AReleaseInMouseDownIsUndoneByThePress) {
    On("MouseDown", [&] { Release(bar()); });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1100);
}

TEST_F(SplitterHandlers, APressInMouseUpIsUndoneByTheRelease) {
    Press(bar(), 50, 50);
    On("MouseUp", [&] { Press(bar(), 50, 50); });
    Release(bar());
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1000);
}

// AfterMove.

TEST_F(SplitterHandlers, AfterMoveFindsEverythingInItsNewPlace) {
    std::string seen;
    On("AfterMove", [&] {
        seen = Variant(Top()).ToText() + " " + Variant(above.Number("Height")).ToText() + " " +
               Variant(below.Number("Height")).ToText() + " " + Variant(below.Number("Top")).ToText();
    });
    DragBy(bar(), 0, 100);
    EXPECT_EQ(seen, "1100 900 700 300");
}

TEST_F(SplitterHandlers, ABarMovedBackInAfterMoveGoesOnFromThere) {
    On("AfterMove", [&] { stage.Site().SetPlace(0, 1000); });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1000);
    MoveTo(bar(), 50, 80);
    EXPECT_THAT(stage.Deeds("AfterMove"), ElementsAre("AfterMove(0, 100)", "AfterMove(0, 30)"));
    EXPECT_EQ(above.Number("Height"), 930);
}

TEST_F(SplitterHandlers, ListsChangedInAfterMoveCountFromTheNextStep) {
    On("AfterMove", [&] { bar().Put("ControlsTopLeft", ""); });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 60);
    MoveTo(bar(), 50, 60);
    EXPECT_EQ(above.Number("Height"), 810);
    EXPECT_EQ(below.Number("Height"), 780);
}

TEST_F(SplitterHandlers, ANewOrientationInAfterMovePutsTheBarInTheMiddle) {
    On("AfterMove", [&] { bar().Put("Orientation", vertical); });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 60);
    EXPECT_EQ(stage.Site().Left(), 3000);
    EXPECT_EQ(stage.Site().Top(), 0);
    stage.on.clear();
    MoveTo(bar(), 60, 60);
    EXPECT_EQ(stage.Site().Left(), 3010);
}

TEST_F(SplitterHandlers, AReleaseInAfterMoveEndsTheDrag) {
    On("AfterMove", [&] { Release(bar()); });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 60);
    MoveTo(bar(), 50, 90);
    EXPECT_EQ(Top(), 1010);
}

TEST_F(SplitterHandlers, AHandlerThatMovesTheMouseInAfterMoveEndsWithEachStepTold) {
    int turns = 0;
    On("AfterMove", [&] {
        if (++turns < 40) MoveTo(bar(), 50, 51);
    });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 51);
    EXPECT_EQ(stage.Deeds("AfterMove").size(), static_cast<std::size_t>(turns));
    EXPECT_EQ(Top(), 1000 + static_cast<float>(turns));
    EXPECT_EQ(above.Number("Height"), 800 + static_cast<float>(turns));
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

// The drag step runs in resume-next mode to its end.
TEST_F(SplitterHandlers, AnErrorInAfterMoveIsSkippedAndTheDragGoesOn) {
    On("AfterMove", [] { throw ControlError(1234); });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 150);
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
    MoveTo(bar(), 50, 60);
    EXPECT_EQ(Top(), 1110);
    EXPECT_EQ(above.Number("Height"), 910);
}

// Errors of the handlers of the surface's events leave the bar, which does not react.

TEST_F(SplitterHandlers, AnErrorInMouseMoveIsReportedAndNothingMovesOrDraws) {
    Press(bar(), 50, 50);
    Release(bar());
    On("MouseMove", [] { throw ControlError(1234, "The handler's own words"); });
    MoveTo(bar(), 50, 50);
    EXPECT_THAT(Drawn(stage.canvas), IsEmpty());
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1000);
    ASSERT_EQ(stage.others.errors.reports.size(), 2u);
    EXPECT_EQ(stage.others.errors.reports[0].error.Number(), 1234);
    EXPECT_EQ(stage.others.errors.reports[0].error.Description(), "The handler's own words");
    EXPECT_EQ(stage.others.errors.reports[0].where, "Splitter1.MouseMove");
    stage.on.clear();
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1100);
}

TEST_F(SplitterHandlers, AnErrorInMouseDownLeavesTheBarWithoutADrag) {
    On("MouseDown", [] { throw ControlError(1234); });
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1000);
    EXPECT_EQ(stage.others.errors.reports.size(), 1u);
}

TEST_F(SplitterHandlers, AnErrorInMouseUpLeavesTheDragGoing) {
    On("MouseUp", [] { throw ControlError(1234); });
    Press(bar(), 50, 50);
    Release(bar());
    MoveTo(bar(), 50, 150);
    EXPECT_EQ(Top(), 1100);
    EXPECT_EQ(stage.others.errors.reports.size(), 1u);
}

TEST_F(SplitterHandlers, AFailureThatIsNoNumberedErrorIsReportedToo) {
    On("Click", [] { throw std::runtime_error("The application's own"); });
    Fire(bar(), "Click");
    ASSERT_EQ(stage.others.errors.reports.size(), 1u);
    EXPECT_EQ(stage.others.errors.reports[0].error.Number(), frame::errors::internal);
}

// Controls that do things while they are moved.

TEST_F(SplitterHandlers, AControlThatDestroysTheBarWhileItIsMovedEndsTheStepQuietly) {
    above.onPut = [&](const std::string&) { stage.DestroyBar(); };
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 150);
    EXPECT_TRUE(stage.Destroyed());
    EXPECT_EQ(above.Number("Height"), 900);
    EXPECT_EQ(below.Number("Height"), 800);
    EXPECT_THAT(stage.Deeds("AfterMove"), IsEmpty());
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST_F(SplitterHandlers, AControlThatDestroysTheBarWhileItIsSearchedForEndsTheStepQuietly) {
    above.onGet = [&](const std::string& name) {
        if (name == "Name") stage.DestroyBar();
    };
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 150);
    EXPECT_TRUE(stage.Destroyed());
    EXPECT_THAT(stage.Deeds("AfterMove"), IsEmpty());
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST_F(SplitterHandlers, AControlThatTakesAllOthersOffTheFormLeavesTheStepGoing) {
    above.onPut = [&](const std::string&) { stage.standing.clear(); };
    DragBy(bar(), 0, 100);
    EXPECT_EQ(above.Number("Height"), 900);
    EXPECT_EQ(below.Number("Height"), 800);
    EXPECT_EQ(stage.Deeds("AfterMove").size(), 1u);
}

TEST_F(SplitterHandlers, AControlThatChangesTheOrderDuringTheSearchDoesNoHarm) {
    above.onGet = [&](const std::string& name) {
        if (name == "Name" && stage.standing.size() > 1) stage.standing.pop_back();
    };
    DragBy(bar(), 0, 100);
    EXPECT_EQ(stage.Deeds("AfterMove").size(), 1u);
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST_F(SplitterHandlers, AFormThatDestroysTheBarWhenItIsAskedForItsSizeEndsTheStepQuietly) {
    Press(bar(), 50, 50);
    stage.form.onGet = [&](const std::string&) { stage.DestroyBar(); };
    MoveTo(bar(), 50, 150);
    EXPECT_TRUE(stage.Destroyed());
    EXPECT_EQ(below.Number("Top"), 200);
    EXPECT_THAT(stage.Deeds("AfterMove"), IsEmpty());
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

// Destroyed when a property is reported.

TEST_F(SplitterHandlers, ABarDestroyedWhenAPropertyIsReportedEndsItsSetterQuietly) {
    const std::vector<std::pair<std::string, Variant>> values = {{"Orientation", vertical},
                                                                 {"BackColor", OLE_COLOR(0x123456)},
                                                                 {"Appearance", sunken},
                                                                 {"MinTopLeft", 5},
                                                                 {"MousePointer", 2}};
    for (const auto& [name, value] : values) {
        Stage other;
        frame::Control& gone = other.Bar();
        other.onPropertyChanged = [&](std::string_view) { other.DestroyBar(); };
        // The entry keeps the bar until its setter has been seen to end.
        frame::Entry::Run(
            other.Frame(), [] { return std::string(); },
            [&, key = name, kept = value] {
                gone.Put(key, kept);
                EXPECT_EQ(gone.Get(key), kept);
            });
        EXPECT_TRUE(other.Destroyed());
        EXPECT_THAT(other.others.errors.reports, IsEmpty()) << name;
    }
}

// Each event of the surface, on both hosts.

struct Input {
    const char* name;
    void (*send)(frame::Control&);
};

void PrintTo(const Input& input, std::ostream* out) { *out << input.name; }

constexpr Input inputs[] = {{"Click", [](frame::Control& bar) { Fire(bar, "Click"); }},
                            {"DblClick", [](frame::Control& bar) { Fire(bar, "DblClick"); }},
                            {"KeyDown",
                             [](frame::Control& bar) {
                                 Fire(bar, "KeyDown", {std::int16_t{65}, std::int16_t{0}});
                             }},
                            {"KeyPress", [](frame::Control& bar) { Fire(bar, "KeyPress", {std::int16_t{97}}); }},
                            {"KeyUp",
                             [](frame::Control& bar) {
                                 Fire(bar, "KeyUp", {std::int16_t{65}, std::int16_t{0}});
                             }},
                            {"MouseDown", [](frame::Control& bar) { Press(bar, 50, 50); }},
                            {"MouseMove", [](frame::Control& bar) { MoveTo(bar, 50, 150); }},
                            {"MouseUp", [](frame::Control& bar) { Release(bar); }},
                            // While the bar is held, the move of the mouse raises it.
                            {"AfterMove", [](frame::Control& bar) { MoveTo(bar, 50, 150); }}};

/// A bar in the course of a drag, with another bar below it, under a handler of one of its events that runs once.
class SplitterUnderHandler : public testing::TestWithParam<Input> {
  protected:
    void Hear(frame::Handlers& handlers) {
        const frame::Event<Variant&, Variant&> afterMove("AfterMove", SplitterClass().table->FindEvent("AfterMove")->number);
        const auto hear = [&](const auto& event) {
            if (event.name != GetParam().name) return;
            handlers.On(event, [this](auto&...) {
                if (const auto act = std::exchange(handler, nullptr)) act();
            });
        };
        hear(frame::stock::Click);
        hear(frame::stock::DblClick);
        hear(frame::stock::KeyDown);
        hear(frame::stock::KeyPress);
        hear(frame::stock::KeyUp);
        hear(frame::stock::MouseDown);
        hear(frame::stock::MouseMove);
        hear(frame::stock::MouseUp);
        hear(afterMove);
    }
    frame::Control& Make() {
        auto& made = host.Create(SplitterClass(), "Splitter1");
        host.SiteOf(made)->SetPlace(0, 1000);
        host.SiteOf(made)->SetSize(6000, thick);
        made.Put("ControlsBottomRight", "Splitter2");
        Press(made, 50, 50);
        Hear(host.SiteOf(made)->ApplicationHandlers());
        return made;
    }
    frame::Control& MakeOther() {
        auto& made = host.Create(SplitterClass(), "Splitter2");
        host.SiteOf(made)->SetPlace(0, 2000);
        host.SiteOf(made)->SetSize(6000, 900);
        return made;
    }

    std::function<void()> handler;
    HostUnderTest host;
    frame::Control& other = MakeOther();
    frame::Control& bar = Make();
};

INSTANTIATE_TEST_SUITE_P(Events, SplitterUnderHandler, testing::ValuesIn(inputs),
                         [](const auto& row) { return std::string(row.param.name); });

TEST_P(SplitterUnderHandler, HandlerThatDestroysTheBarEndsQuietly) {
    host.log.Clear();
    handler = [&] { host.Destroy(bar); };
    GetParam().send(bar);
    EXPECT_EQ(host.FindSite("Splitter1"), nullptr);
    EXPECT_THAT(host.log.EventNames("Splitter1"), EndsWith(GetParam().name));
    const float shift = GetParam().name == std::string("AfterMove") ? 100 : 0;
    EXPECT_EQ(host.SiteOf(other)->Top(), 2000 + shift);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(SplitterUnderHandler, DestroyedBarRaisesAndMovesNothingMore) {
    handler = [&] {
        frame::Control& gone = bar;
        host.Destroy(gone);
        host.log.Clear();
        for (const Input& input : inputs) input.send(gone);
        gone.Put("Orientation", vertical);
        gone.Put("BackColor", OLE_COLOR(0x123456));
        gone.Put("Appearance", sunken);
        gone.Call("Refresh");
        gone.Paint();
        gone.Show();
    };
    GetParam().send(bar);
    EXPECT_EQ(host.log.EventNames(), "");
    EXPECT_THAT(host.log.Of("changed"), IsEmpty());
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(SplitterUnderHandler, HandlerThatDestroysTheOtherBarHolds) {
    handler = [&] { host.Destroy(other); };
    GetParam().send(bar);
    MoveTo(bar, 50, 60);
    EXPECT_NE(host.FindSite("Splitter1"), nullptr);
    EXPECT_EQ(host.FindSite("Splitter2"), nullptr);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

// The drag step runs in resume-next mode to its end, so that what fails in AfterMove is skipped.
TEST_P(SplitterUnderHandler, HandlerThatFailsIsReportedOnceOrSkippedInTheStepAndTheBarGoesOnWorking) {
    const std::string event = GetParam().name;
    const bool inTheStep = event == "AfterMove";
    auto& site = *host.SiteOf(bar);
    auto& otherSite = *host.SiteOf(other);
    handler = [] { throw ControlError(1234, "The handler's own words"); };
    GetParam().send(bar);
    EXPECT_FALSE(handler);  // it has run
    EXPECT_EQ(site.Top(), inTheStep ? 1100 : 1000);
    const auto& reports = host.errors.reports;
    ASSERT_EQ(reports.size(), inTheStep ? 0u : 1u);
    if (!inTheStep) {
        EXPECT_EQ(reports[0].error.Number(), 1234);
        EXPECT_EQ(reports[0].error.Description(), "The handler's own words");
        EXPECT_EQ(reports[0].where, "Splitter1." + event);
    }
    host.log.Clear();
    GetParam().send(bar);
    EXPECT_THAT(host.log.EventNames("Splitter1"), HasSubstr(event));
    const float top = site.Top(), otherTop = otherSite.Top();
    host.log.Clear();
    DragBy(bar, 0, 100);
    MoveTo(bar, 50, 500);
    EXPECT_EQ(host.log.EventNames("Splitter1"), "MouseDown MouseMove AfterMove MouseUp MouseMove");
    EXPECT_EQ(site.Top(), top + 100);
    EXPECT_EQ(otherSite.Top(), otherTop + 100);
    EXPECT_EQ(reports.size(), inTheStep ? 0u : 1u);
}

TEST_P(SplitterUnderHandler, HandlerMaySetEveryProperty) {
    const std::vector<std::pair<std::string, Variant>> values = {{"Orientation", vertical},
                                                                 {"MinTopLeft", 200},
                                                                 {"MinBottomRight", 300},
                                                                 {"BackColor", OLE_COLOR(1)},
                                                                 {"ForeColor", OLE_COLOR(2)},
                                                                 {"Enabled", false},
                                                                 {"ControlsTopLeft", "Splitter2(3)"},
                                                                 {"ControlsBottomRight", ""},
                                                                 {"MousePointer", 3},
                                                                 {"Appearance", serrated},
                                                                 {"HighlightColor", OLE_COLOR(3)}};
    handler = [&] {
        for (const auto& [name, value] : values) bar.Put(name, value);
    };
    GetParam().send(bar);
    for (const auto& [name, value] : values) EXPECT_EQ(bar.Get(name), value) << name;
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(SplitterUnderHandler, HandlerThatSendsAllInputsHolds) {
    handler = [&] {
        for (const Input& input : inputs) input.send(bar);
    };
    GetParam().send(bar);
    EXPECT_NE(host.FindSite("Splitter1"), nullptr);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(SplitterUnderHandler, HandlerMayHideResizeMoveAndSaveTheBar) {
    handler = [&] {
        auto& site = *host.SiteOf(bar);
        site.SetVisible(false);
        site.SetPlace(0, 3000);
        site.SetSize(0, 0);
        site.SetVisible(true);
        EXPECT_EQ(host.Save(bar).Written().size(), 13u);
    };
    GetParam().send(bar);
    EXPECT_EQ(host.SiteOf(bar)->Width(), 0);
    EXPECT_EQ(host.SiteOf(bar)->Height(), 0);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(SplitterUnderHandler, ABarOfTheSameNameMadeInTheHandlerIsUntouched) {
    frame::Control* second = nullptr;
    handler = [&] {
        host.Destroy(bar);
        second = &host.Create(SplitterClass(), "Splitter1", {.width = 3000, .height = thick});
        host.SiteOf(*second)->SetPlace(0, 4000);
    };
    GetParam().send(bar);
    ASSERT_NE(second, nullptr);
    EXPECT_EQ(host.SiteOf(*second)->Top(), 4000);
    MoveTo(*second, 50, 500);
    EXPECT_EQ(host.SiteOf(*second)->Top(), 4000);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

}  // namespace
}  // namespace tessel::controls
