#include "frame/Event.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "frame/Font.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

using test::ErrorOf;
using test::Happened;
using test::Quiet;
using test::TestControl;

TEST(EventArgument, IsTheStorageOfTheOneWhoRaised) {
    std::int16_t number = 3;
    const EventArgument argument(number);
    EXPECT_EQ(argument.Get().Type(), VarType::Integer);
    EXPECT_EQ(argument.Get().ToLong(), 3);
    number = 4;
    EXPECT_EQ(argument.Get().ToLong(), 4);
    argument.Set(5);
    EXPECT_EQ(number, 5);
    argument.As<std::int16_t>() = 6;
    EXPECT_EQ(number, 6);
}

TEST(EventArgument, OfOneStorageShowEachOthersChanges) {
    std::string text = "a";
    const EventArgument one(text), other(text);
    one.Set("b");
    EXPECT_EQ(other.Get().ToText(), "b");
}

TEST(EventArgument, ConvertsWhatIsSetToTheTypeOfItsStorage) {
    std::int16_t number = 0;
    bool flag = false;
    std::string text;
    float fraction = 0;
    EventArgument(number).Set("2.5");
    EventArgument(flag).Set(-1);
    EventArgument(text).Set(12.5);
    EventArgument(fraction).Set("0.25");
    EXPECT_EQ(number, 2);
    EXPECT_TRUE(flag);
    EXPECT_EQ(text, "12.5");
    EXPECT_EQ(fraction, 0.25f);
}

TEST(EventArgument, LeavesTheStorageAsItWasWhenAValueDoesNotConvert) {
    std::int16_t number = 7;
    const EventArgument argument(number);
    EXPECT_EQ(ErrorOf([&] { argument.Set("seven"); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { argument.Set(100'000); }), errors::overflow);
    EXPECT_EQ(number, 7);
}

TEST(EventArgument, IsReachedOnlyWithTheTypeOfItsStorage) {
    std::int16_t number = 7;
    const EventArgument argument(number);
    EXPECT_EQ(ErrorOf([&] { argument.As<std::int32_t>() = 1; }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { argument.As<test::Mood>(); }), errors::typeMismatch);
    EXPECT_EQ(number, 7);
}

TEST(EventArgument, TakesAVariantAsItIs) {
    Variant value = 1;
    const EventArgument argument(value);
    argument.Set("text");
    EXPECT_TRUE(value.IsString());
}

TEST(Event, TellsNamesAndTypesOfItsArguments) {
    ASSERT_EQ(Happened.parameters.count, 3u);
    EXPECT_EQ(Happened.parameters.list[1].name, "Count");
    EXPECT_EQ(Happened.parameters.list[1].type.type, VarType::Long);
    EXPECT_TRUE(Happened.parameters.list[1].byReference);
    EXPECT_EQ(Quiet.parameters.count, 0u);
}

TEST(Event, KeepsAllButItsNumberUnderAnother) {
    constexpr auto numbered = stock::MouseDown.Numbered(4);
    EXPECT_EQ(numbered.number, 4);
    EXPECT_EQ(numbered.name, "MouseDown");
    EXPECT_EQ(numbered.parameters.count, 4u);
    EXPECT_EQ(stock::MouseDown.number, dispatch::mouseDown);
}

// Handlers

void Raise(Handlers& handlers, bool& cancel, std::int32_t& count, std::string& text) {
    const EventArgument arguments[] = {EventArgument(cancel), EventArgument(count), EventArgument(text)};
    handlers.Raise(Happened, arguments);
}

TEST(Handlers, WantOnlyTheEventsThatTheyHandle) {
    Handlers handlers;
    EXPECT_FALSE(handlers.Wants(Quiet));
    handlers.On(Quiet, [] {});
    EXPECT_TRUE(handlers.Wants(Quiet));
    EXPECT_FALSE(handlers.Wants(Happened));
    handlers.Remove(Quiet);
    EXPECT_FALSE(handlers.Wants(Quiet));
}

TEST(Handlers, GetTheArgumentsByReference) {
    Handlers handlers;
    handlers.On(Happened, [](bool& cancel, std::int32_t& count, std::string& text) {
        cancel = !cancel;
        count += 1;
        text += "!";
    });
    bool cancel = false;
    std::int32_t count = 1;
    std::string text = "a";
    Raise(handlers, cancel, count, text);
    EXPECT_TRUE(cancel);
    EXPECT_EQ(count, 2);
    EXPECT_EQ(text, "a!");
}

TEST(Handlers, AreReplacedByTheNextOneForTheSameEvent) {
    Handlers handlers;
    std::string heard;
    handlers.On(Quiet, [&] { heard += "a"; });
    handlers.On(Quiet, [&] { heard += "b"; });
    handlers.Raise(Quiet, {});
    EXPECT_EQ(heard, "b");
}

TEST(Handlers, DoNothingForAnEventThatNobodyHandles) {
    Handlers handlers;
    handlers.Raise(Quiet, {});
    EXPECT_FALSE(handlers.Wants(Quiet));
}

TEST(Handlers, MayReplaceAndRemoveThemselvesWhileTheyRun) {
    Handlers handlers;
    std::string heard;
    const std::string mark = "a long text that is held by the handler itself";
    handlers.On(Quiet, [&handlers, &heard, mark] {
        handlers.On(Quiet, [&heard] { heard += " then"; });
        handlers.Remove(Quiet);
        heard += mark;
    });
    handlers.Raise(Quiet, {});
    EXPECT_EQ(heard, mark);
    EXPECT_FALSE(handlers.Wants(Quiet));
}

TEST(Handlers, KeepTheirOwnStateFromOneRaiseToTheNext) {
    Handlers handlers;
    std::string heard;
    handlers.On(Quiet, [&heard, count = 0]() mutable { heard += std::to_string(++count); });
    handlers.Raise(Quiet, {});
    handlers.Raise(Quiet, {});
    EXPECT_EQ(heard, "12");
}

TEST(Handlers, LetTheirErrorsPassToTheOneWhoRaised) {
    Handlers handlers;
    handlers.On(Quiet, [] { throw ControlError(errors::diskFull); });
    EXPECT_EQ(ErrorOf([&] { handlers.Raise(Quiet, {}); }), errors::diskFull);
}

// Slots

class Listener {
  public:
    void Take(std::int16_t& number, float fraction) {
        number = static_cast<std::int16_t>(number + 1);
        heard += fraction;
    }
    void Other(std::int16_t&, float) { heard = -1; }

    float heard = 0;
};

TEST(Slot, IsSilentUntilItIsConnected) {
    const Slot<std::int16_t&, float> slot;
    std::int16_t number = 1;
    EXPECT_FALSE(slot);
    slot(number, 2);
    EXPECT_EQ(number, 1);
}

TEST(Slot, CallsItsFunctionWithTheArgumentsAsTheyAre) {
    Slot<std::int16_t&, float> slot;
    Listener listener;
    slot.To<&Listener::Take>(listener);
    EXPECT_TRUE(slot);
    std::int16_t number = 1;
    slot(number, 2.5f);
    EXPECT_EQ(number, 2);
    EXPECT_EQ(listener.heard, 2.5f);
}

TEST(Slot, GoesToTheFunctionThatWasNamedLast) {
    Slot<std::int16_t&, float> slot;
    Listener first, second;
    slot.To<&Listener::Take>(first);
    slot.To<&Listener::Other>(second);
    std::int16_t number = 1;
    slot(number, 2);
    EXPECT_EQ(first.heard, 0);
    EXPECT_EQ(second.heard, -1);
}

// Raised by a control

struct Events : testing::Test {
    headless::HeadlessHost host;
    test::WatchedSite site{host, "Test1"};
    TestControl& control = site.Make<TestControl>();
};

TEST_F(Events, WhatAHandlerSetsIsThereWhenTheRaiseReturns) {
    site.handlers.On(Happened, [](bool& cancel, std::int32_t& count, std::string& text) {
        cancel = true;
        count = 9;
        text = "set";
    });
    EXPECT_EQ(control.Ask(false, 1, "given"), "True 9 set");
}

TEST_F(Events, AForwardedEventDoesNotReadItsArgumentsBack) {
    int heard = 0;
    site.handlers.On(Happened, [&](bool& cancel, std::int32_t& count, std::string& text) {
        heard = count;
        cancel = true;
        count = 9;
        text = "set";
    });
    EXPECT_EQ(control.Forward(false, 1, "given"), "False 1 given");
    EXPECT_EQ(heard, 1);
}

TEST_F(Events, AnErrorOfAHandlerPassesToADirectCaller) {
    site.handlers.On(Quiet, [] { throw ControlError(errors::diskFull); });
    EXPECT_EQ(ErrorOf([&] { control.Tell(); }), errors::diskFull);
    EXPECT_TRUE(host.errors.reports.empty());
}

TEST_F(Events, AnEventThatNobodyWantsLeavesTheArgumentsAlone) {
    EXPECT_EQ(control.Ask(false, 1, "given"), "False 1 given");
    control.Tell();
}

TEST_F(Events, AreHeardNoMoreWhenTheSiteHasLetGo) {
    int heard = 0;
    site.handlers.On(Quiet, [&] { ++heard; });
    control.Tell();
    site.Detach();
    control.Tell();
    EXPECT_EQ(heard, 1);
}

TEST_F(Events, MayBeRaisedAgainByTheirOwnHandler) {
    int depth = 0;
    site.handlers.On(Quiet, [&] {
        if (++depth < 5) control.Tell();
    });
    control.Tell();
    EXPECT_EQ(depth, 5);
}

TEST_F(Events, OfAClassAreFoundByNameAndByNumber) {
    const ClassTable& table = control.Table();
    EXPECT_EQ(table.FindEvent("HAPPENED"), &Happened);
    EXPECT_EQ(table.FindEvent(dispatch::click), &stock::Click);
    EXPECT_EQ(table.FindEvent("KeyDown"), nullptr);
    EXPECT_EQ(table.FindEvent(99), nullptr);
}

}  // namespace
}  // namespace tessel::frame
