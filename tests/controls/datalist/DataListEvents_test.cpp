#include <gtest/gtest.h>

#include <cstdint>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "tests/controls/datalist/DataListTestHelp.h"

/// The forwarded events, and what an application may do inside them: everything.
namespace tessel::controls {
namespace {

using test::ErrorOf;
using namespace datalisttest;

constexpr std::int16_t letterA = 65, shiftKey = 1;
constexpr int applicationError = 1234;

/// Red=5 | Blue=7 | Green=9, with nothing chosen.
class DataListEvents : public testing::Test {
  protected:
    DataListEvents() {
        stage.Add("Red", 5);
        stage.Add("Blue", 7);
        stage.Add("Green", 9);
        stage.Reset();
    }
    Stage stage;
};

// Forwarding.

TEST_F(DataListEvents, InputOfTheActiveListIsForwardedWithItsArguments) {
    for (const int active : {0, 1}) {
        if (active == 1) stage.Put("Sorted", true);
        stage.Reset();
        frame::Object& list = stage.List(active);
        Fire(list, "Click");
        Fire(list, "DblClick");
        Fire(list, "KeyDown", {letterA, shiftKey});
        Fire(list, "KeyPress", {letterA});
        Fire(list, "KeyUp", {letterA, shiftKey});
        EXPECT_EQ(stage.Happened(), "Click DblClick KeyDown(65, 1) KeyPress(65) KeyUp(65, 1)") << active;
    }
}

TEST_F(DataListEvents, ArgumentsThatAHandlerChangesAreNotReadBack) {
    stage.onEvent = [](frame::EventArguments arguments) {
        for (const frame::EventArgument& argument : arguments) argument.Set(Variant(0));
    };
    const std::vector<Variant> both = {letterA, shiftKey}, one = {letterA};
    EXPECT_EQ(Fire(stage.List(0), "KeyDown", both), both);
    EXPECT_EQ(Fire(stage.List(0), "KeyUp", both), both);
    EXPECT_EQ(Fire(stage.List(0), "KeyPress", one), one);
}

TEST_F(DataListEvents, MouseEventsAreNeverRaised) {
    const std::vector<Variant> arguments = {std::int16_t{1}, std::int16_t{0}, 100.0f, 50.0f};
    int fired = 0;
    for (frame::Object* child : {&stage.List(0), &stage.List(1), &stage.Label()}) {
        for (const auto* name : {"MouseDown", "MouseMove", "MouseUp"}) {
            if (!child->Table().FindInput(name)) continue;
            Fire(*child, name, arguments);
            ++fired;
        }
    }
    EXPECT_GT(fired, 0);  // the label reports them at least
    EXPECT_EQ(stage.Happened(), "");
}

TEST_F(DataListEvents, InputOfTheLabelIsNotForwarded) {
    for (const auto* name : {"Click", "DblClick"})
        if (stage.Label().Table().FindInput(name)) Fire(stage.Label(), name);
    EXPECT_EQ(stage.Happened(), "");
}

TEST_F(DataListEvents, AChoiceRaisesClickOnceAndTakesTheLabelAlong) {
    stage.Choose(1);
    EXPECT_EQ(stage.Happened(), "Click");
    EXPECT_EQ(stage.LabelText(), "Blue");
    stage.Choose(2);
    EXPECT_EQ(stage.Happened(), "Click");
    EXPECT_EQ(stage.LabelText(), "Green");
}

TEST_F(DataListEvents, InsideClickTheChoiceIsNewAndTheLabelStillOld) {
    stage.Choose(0);
    std::string seen;
    stage.AtEvent([&] { seen = stage.Text() + " " + std::to_string(stage.Value()) + " " + stage.LabelText(); });
    stage.Choose(1);
    EXPECT_EQ(seen, "Blue 7 Red");
    EXPECT_EQ(stage.LabelText(), "Blue");
}

TEST_F(DataListEvents, InsideClickOfASetValueTheLabelIsStillOld) {
    stage.Choose(0);
    std::string seen;
    stage.AtEvent([&] { seen = stage.Text() + " " + stage.LabelText(); });
    stage.Put("Value", 7);
    EXPECT_EQ(seen, "Blue Red");
    EXPECT_EQ(stage.LabelText(), "Blue");
}

TEST_F(DataListEvents, InsideClickOfASetTextTheLabelIsAlreadyNewAndTheTextNotYetStored) {
    stage.Choose(0);
    std::string seen, reported;
    stage.AtEvent([&] {
        seen = stage.Text() + " " + stage.LabelText() + " " + stage.Saved("Text").ToText();
        reported = stage.Happened();
    });
    stage.Reset();
    stage.Put("Text", "BLUE");
    EXPECT_EQ(seen, "Blue Blue ");
    EXPECT_EQ(reported, "Click");
    EXPECT_EQ(stage.Happened(), "changed Text");
    EXPECT_EQ(stage.Saved("Text"), Variant("BLUE"));
}

TEST_F(DataListEvents, AnErrorOfAHandlerOfTheUsersInputReachesTheHost) {
    stage.onEvent = [](frame::EventArguments) { throw frame::ControlError(applicationError); };
    Fire(stage.List(0), "KeyPress", {letterA});
    ASSERT_EQ(stage.host.errors.reports.size(), 1u);
    EXPECT_EQ(stage.host.errors.reports[0].error.Number(), applicationError);
}

// The setter of Text goes no further than its failing statement.

TEST_F(DataListEvents, AnErrorOfAHandlerWhileTextIsSetReachesTheSetterAndTheTextIsNotStored) {
    stage.Put("Text", "red");
    stage.Reset();
    stage.AtEvent([] { throw frame::ControlError(applicationError); });
    EXPECT_EQ(ErrorOf([&] { stage.Put("Text", "BLUE"); }), applicationError);
    EXPECT_EQ(stage.Happened(), "Click");
    EXPECT_EQ(stage.Saved("Text"), Variant("red"));
    EXPECT_EQ(stage.ListIndex(), 1);
    EXPECT_EQ(stage.LabelText(), "Blue");
    EXPECT_TRUE(stage.host.errors.reports.empty());
    stage.Put("Text", "BLUE");
    EXPECT_EQ(stage.Happened(), "Click changed Text");
    EXPECT_EQ(stage.Saved("Text"), Variant("BLUE"));
}

TEST_F(DataListEvents, AnErrorOfAHandlerWhileAnUnknownTextChoosesTheDefaultLeavesTheTextUnstoredToo) {
    stage.Put("Text", "red");
    stage.Put("DefaultValue", 9);
    stage.Reset();
    stage.AtEvent([] { throw frame::ControlError(applicationError); });
    EXPECT_EQ(ErrorOf([&] { stage.Put("Text", "Mauve"); }), applicationError);
    EXPECT_EQ(stage.Happened(), "Click");
    EXPECT_EQ(stage.Saved("Text"), Variant("red"));
    EXPECT_EQ(stage.ListIndex(), 2);
    EXPECT_EQ(stage.LabelText(), "Red");  // it follows behind the event
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

// Handlers that change the control, or fail.

/// Where the error of a handler goes.
enum class Fate { Reported, Thrown, Skipped };

struct Input {
    const char* name;
    void (*send)(Stage&);
    Fate errorIs = Fate::Reported;  // the user's input has no caller to take it
};
void PrintTo(const Input& input, std::ostream* out) { *out << input.name; }

class DataListHandlers : public testing::TestWithParam<Input> {
  protected:
    DataListHandlers() {
        stage.Add("Red", 5);
        stage.Add("Blue", 7);
        stage.Add("Green", 9);
        stage.Choose(0);
        stage.Reset();
    }
    void Send() { GetParam().send(stage); }
    Stage stage;
};

INSTANTIATE_TEST_SUITE_P(Events, DataListHandlers,
                         testing::Values(Input{"Click", [](Stage& stage) { Fire(stage.List(0), "Click"); }},
                                         Input{"UserChoice", [](Stage& stage) { Fire(stage.List(0), "Click", {1}); }},
                                         Input{"Choice", [](Stage& stage) { stage.Choose(1); }, Fate::Thrown},
                                         Input{"SetValue", [](Stage& stage) { stage.Put("Value", 7); }, Fate::Skipped},
                                         Input{"SetText", [](Stage& stage) { stage.Put("Text", "blue"); }, Fate::Thrown},
                                         Input{"DblClick", [](Stage& stage) { Fire(stage.List(0), "DblClick"); }},
                                         Input{"KeyDown",
                                               [](Stage& stage) {
                                                   Fire(stage.List(0), "KeyDown", {letterA, shiftKey});
                                               }},
                                         Input{"KeyPress", [](Stage& stage) { Fire(stage.List(0), "KeyPress", {letterA}); }},
                                         Input{"KeyUp",
                                               [](Stage& stage) {
                                                   Fire(stage.List(0), "KeyUp", {letterA, shiftKey});
                                               }}),
                         [](const auto& row) { return std::string(row.param.name); });

TEST_P(DataListHandlers, AHandlerMayDestroyTheControl) {
    stage.AtEvent([&] { stage.Destroy(); });
    Send();
    EXPECT_FALSE(stage.Lives());
    EXPECT_TRUE(stage.host.errors.reports.empty());
    EXPECT_EQ(stage.host.OnForm().Count(), 0);
}

TEST_P(DataListHandlers, ADestroyedControlRaisesNothingMore) {
    std::string raised;
    stage.AtEvent([&] {
        frame::Control& gone = stage.Control();
        frame::Object& list = stage.List(0);
        stage.Destroy();
        stage.Reset();
        for (const auto* event : {"Click", "DblClick"}) Fire(list, event);
        list.Put("ListIndex", 2);
        gone.Put("DefaultText", "None");
        raised = stage.Happened();
    });
    Send();
    EXPECT_EQ(raised, "");
    EXPECT_EQ(stage.Happened(), "");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_P(DataListHandlers, AnErrorOfAHandlerIsReportedOnceOrGoesToTheCallerAndTheListGoesOnWorking) {
    const Fate fate = GetParam().errorIs;
    stage.AtEvent([] { throw frame::ControlError(applicationError, "The handler's own words"); });
    EXPECT_EQ(ErrorOf([&] { Send(); }), fate == Fate::Thrown ? applicationError : 0);
    EXPECT_FALSE(stage.onEvent);  // it has run
    const auto& reports = stage.host.errors.reports;
    ASSERT_EQ(reports.size(), fate == Fate::Reported ? 1u : 0u);
    if (fate == Fate::Reported) {
        EXPECT_EQ(reports[0].error.Number(), applicationError);
        EXPECT_EQ(reports[0].error.Description(), "The handler's own words");
    }
    EXPECT_EQ(ErrorOf([&] { Send(); }), 0);
    stage.Reset();
    Fire(stage.List(0), "Click", {2});
    Fire(stage.List(0), "KeyPress", {letterA});
    EXPECT_EQ(stage.Happened(), "Click KeyPress(65)");
    EXPECT_EQ(stage.Value(), 9);
    EXPECT_EQ(stage.LabelText(), "Green");
    EXPECT_EQ(stage.Add("Grey", 11), "");
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Blue=7 | Green=9 | Grey=11");
    EXPECT_EQ(reports.size(), fate == Fate::Reported ? 1u : 0u);
}

TEST_P(DataListHandlers, AHandlerMayClearTheList) {
    stage.AtEvent([&] { stage.Clear(); });
    EXPECT_EQ(ErrorOf([&] { Send(); }), 0);
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.LabelText(), "");
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_P(DataListHandlers, AHandlerMayFillTheListAnew) {
    Records records(Fruits());
    std::string result = "none";
    stage.AtEvent([&] { result = stage.PopulateWith(records, "Any", 8); });
    EXPECT_EQ(ErrorOf([&] { Send(); }), 0);
    EXPECT_EQ(result, "");
    EXPECT_EQ(stage.ItemsOf(0), "Any=8 | Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.ListIndex(), 0);
    EXPECT_EQ(stage.Text(), "Any");
    EXPECT_TRUE(stage.host.errors.reports.empty());
    stage.Reset();
    stage.Choose(2);
    EXPECT_EQ(stage.Happened(), "Click");
    EXPECT_EQ(stage.LabelText(), "Apple");
}

TEST_P(DataListHandlers, AHandlerMayChangeTheOrder) {
    stage.AtEvent([&] { stage.Put("Sorted", true); });
    EXPECT_EQ(ErrorOf([&] { Send(); }), 0);
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "Blue=7 | Green=9 | Red=5");
    EXPECT_EQ(stage.Visible(), "list 1");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_P(DataListHandlers, AHandlerMayRemoveTheChosenItem) {
    stage.AtEvent([&] { stage.Remove(stage.Value()); });
    EXPECT_EQ(ErrorOf([&] { Send(); }), 0);
    EXPECT_EQ(stage.Get("ListCount"), Variant(2));
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_P(DataListHandlers, AHandlerMayAddAnItem) {
    stage.AtEvent([&] { stage.Add("Grey", 11); });
    EXPECT_EQ(ErrorOf([&] { Send(); }), 0);
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Blue=7 | Green=9 | Grey=11");
}

TEST_P(DataListHandlers, AHandlerMaySetEveryProperty) {
    const std::vector<std::pair<std::string, Variant>> values = {{"Locked", true},
                                                                 {"LockedAlways", true},
                                                                 {"DefaultValue", 9},
                                                                 {"DefaultText", "None"},
                                                                 {"Style", idAndText},
                                                                 {"Enabled", false},
                                                                 {"Appearance", 1},
                                                                 {"BackColor", frame::OLE_COLOR(0x123456)},
                                                                 {"OnlyUniqueValues", true},
                                                                 {"ListCount", 1},
                                                                 {"ForeColor", frame::OLE_COLOR(0x654321)}};
    stage.AtEvent([&] {
        for (const auto& [name, value] : values) stage.Put(name, value);
    });
    EXPECT_EQ(ErrorOf([&] { Send(); }), 0);
    for (const auto& [name, value] : values) {
        if (name == "ListCount") continue;
        EXPECT_EQ(stage.Get(name), value) << name;
    }
    EXPECT_EQ(stage.Visible(), "list 0");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(DataListEvents, AHandlerThatChoosesAnotherItemRaisesClickAgainAndTheLabelFollowsTheLastChoice) {
    stage.AtEvent([&] { stage.Choose(2); });
    stage.Choose(0);
    EXPECT_EQ(stage.Happened(), "Click Click");
    EXPECT_EQ(stage.Value(), 9);
    EXPECT_EQ(stage.LabelText(), "Green");
}

TEST_F(DataListEvents, AHandlerThatSendsItsOwnEventAgainEnds) {
    constexpr int depth = 50;
    int level = 0;
    stage.onEvent = [&](frame::EventArguments) {
        if (++level < depth) Fire(stage.List(0), "KeyPress", {letterA});
    };
    Fire(stage.List(0), "KeyPress", {letterA});
    EXPECT_EQ(level, depth);
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(DataListEvents, WhatIsAddedInsideClickEndsWithClicksRaisedAgain) {
    stage.AtEvent([&] { stage.Add("Grey", 11); });
    stage.Choose(0);
    stage.Reset();
    stage.Choose(1);
    EXPECT_EQ(stage.Happened(), "Click");
}

TEST_F(DataListEvents, AHandlerThatClearsWhileTextIsSetLeavesTheTextStoredAndReported) {
    stage.AtEvent([&] { stage.Clear(); });
    EXPECT_EQ(ErrorOf([&] { stage.Put("Text", "blue"); }), 0);
    EXPECT_EQ(stage.Happened(), "Click changed Text");
    EXPECT_EQ(stage.Saved("Text"), Variant("blue"));
}

}  // namespace
}  // namespace tessel::controls
