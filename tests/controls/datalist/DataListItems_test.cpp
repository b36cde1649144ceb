#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "tests/controls/datalist/DataListTestHelp.h"

/// Adding, removing and clearing items, and reading and setting the choice by value and by text.
namespace tessel::controls {
namespace {

using frame::VarType;
using test::ErrorOf;
using namespace datalisttest;

constexpr const char* blankRefused = "Blank text item not allowed.";

/// Red=5 | Blue=7 | Green=9, with nothing chosen.
class DataListItems : public testing::Test {
  protected:
    DataListItems() {
        stage.Add("Red", 5);
        stage.Add("Blue", 7);
        stage.Add("Green", 9);
        stage.Reset();
    }
    Stage stage;
};

// Adding.

TEST(DataListAdding, AnItemIsAddedAtTheEndOfTheFirstListWithItsValue) {
    Stage stage;
    EXPECT_EQ(Call(stage.Control(), "AddItem", {"Red", 5}), Variant(""));
    EXPECT_EQ(stage.Add("Blue", 7), "");
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Blue=7");
    EXPECT_EQ(stage.ItemsOf(1), "");
    EXPECT_EQ(stage.Get("ListCount"), Variant(2));
}

TEST(DataListAdding, AddingChoosesNothingAndRaisesNothingAndTurnsTheLoopOnce) {
    Stage stage;
    stage.Add("Red", 5);
    EXPECT_EQ(stage.Happened(), "yield");
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_EQ(stage.LabelText(), "");
}

TEST(DataListAdding, ABlankTextIsRefusedAndTheCounterDoesNotMove) {
    Stage stage;
    stage.Put("Style", countAndText);
    EXPECT_EQ(stage.Add("", 5), blankRefused);
    EXPECT_EQ(stage.Add(Variant(), 5), blankRefused);
    EXPECT_EQ(stage.ItemsOf(0), "");
    stage.Add("Red", 5);
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Red=5");
}

TEST(DataListAdding, ARefusedItemTurnsTheLoopToo) {
    Stage stage;
    stage.Add("", 5);
    EXPECT_EQ(stage.Happened(), "yield");
}

TEST(DataListAdding, ATextOfBlanksAloneIsNotBlank) {
    Stage stage;
    EXPECT_EQ(stage.Add(" ", 5), "");
    EXPECT_EQ(stage.ItemsOf(0), " =5");
}

TEST(DataListAdding, ValuesMayRepeatUnlessTheyMustBeUnique) {
    Stage stage;
    stage.Add("Red", 5);
    EXPECT_EQ(stage.Add("Crimson", 5), "");
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Crimson=5");
}

TEST(DataListAdding, WithUniqueValuesASecondItemOfAValueIsRefusedWithTheValueInTheMessage) {
    Stage stage;
    stage.Put("OnlyUniqueValues", true);
    stage.Put("Style", countAndText);
    EXPECT_EQ(stage.Add("Red", 5), "");
    EXPECT_EQ(stage.Add("Blue", -12), "");
    EXPECT_EQ(stage.Add("Crimson", 5), "Item with value 5 already exists.");
    EXPECT_EQ(stage.Add("Navy", -12), "Item with value -12 already exists.");
    EXPECT_EQ(stage.Add("Red", 100'000), "");
    EXPECT_EQ(stage.Add("Rose", 100'000), "Item with value 100000 already exists.");
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Red=5 |    2 - Blue=-12 |    3 - Red=100000");
}

TEST(DataListAdding, ABlankTextIsNamedBeforeAValueThatIsThere) {
    Stage stage;
    stage.Put("OnlyUniqueValues", true);
    stage.Add("Red", 5);
    EXPECT_EQ(stage.Add("", 5), blankRefused);
}

TEST(DataListAdding, UniqueValuesDoNotTouchWhatIsThere) {
    Stage stage;
    stage.Add("Red", 5);
    stage.Add("Crimson", 5);
    stage.Put("OnlyUniqueValues", true);
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Crimson=5");
    EXPECT_EQ(stage.Add("Rose", 5), "Item with value 5 already exists.");
}

TEST(DataListAdding, ARemovedValueIsFreeAgain) {
    Stage stage;
    stage.Put("OnlyUniqueValues", true);
    stage.Add("Red", 5);
    stage.Remove(5);
    EXPECT_EQ(stage.Add("Crimson", 5), "");
    EXPECT_EQ(stage.ItemsOf(0), "Crimson=5");
}

struct Shown {
    std::int32_t value;
    const char* prefix;
};

class DataListPrefix : public testing::TestWithParam<Shown> {};

TEST_P(DataListPrefix, IdAndTextShowsTheLastFourCharactersOfTheValueAfterFiveBlanks) {
    Stage stage;
    stage.Put("Style", idAndText);
    EXPECT_EQ(stage.Add("Red", GetParam().value), "");
    EXPECT_EQ(GetAt(stage.List(0), "List", 0), Variant(std::string(GetParam().prefix) + " - Red"));
    EXPECT_EQ(GetAt(stage.List(0), "ItemData", 0), Variant(GetParam().value));
}

INSTANTIATE_TEST_SUITE_P(Values, DataListPrefix,
                         testing::Values(Shown{0, "   0"}, Shown{5, "   5"}, Shown{12, "  12"}, Shown{123, " 123"},
                                         Shown{1234, "1234"}, Shown{12345, "2345"}, Shown{123456, "3456"}, Shown{10000, "0000"},
                                         Shown{-1, "  -1"}, Shown{-12, " -12"}, Shown{-123, "-123"}, Shown{-1234, "1234"},
                                         Shown{-12345, "2345"}, Shown{2147483647, "3647"},
                                         Shown{std::numeric_limits<std::int32_t>::min(), "3648"}));

TEST(DataListAdding, TheTextOfAValueStandsInThePrefixAsItWasGiven) {
    Stage stage;
    stage.Put("Style", idAndText);
    stage.Add("Red", "007");
    stage.Add("Blue", 2.5);
    EXPECT_EQ(stage.ItemsOf(0), " 007 - Red=7 |  2.5 - Blue=2");
}

TEST(DataListAdding, CountAndTextNumbersTheItemsAndKeepsTheirValues) {
    Stage stage;
    stage.Put("Style", countAndText);
    stage.Add("Red", 50);
    stage.Add("Blue", -7);
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Red=50 |    2 - Blue=-7");
}

TEST(DataListAdding, TheCounterCountsItemsOfEveryStyle) {
    Stage stage;
    stage.Add("Red", 5);
    stage.Put("Style", idAndText);
    stage.Add("Blue", 7);
    stage.Put("Style", countAndText);
    stage.Add("Green", 9);
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 |    7 - Blue=7 |    3 - Green=9");
}

TEST(DataListAdding, AnUnnamedStyleShowsTheTextAlone) {
    for (const std::int16_t style : {std::int16_t{3}, std::int16_t{-1}, std::int16_t{32'767}}) {
        Stage stage;
        stage.Put("Style", style);
        stage.Add("Red", 5);
        EXPECT_EQ(stage.Get("Style"), Variant(style));
        EXPECT_EQ(stage.ItemsOf(0), "Red=5");
    }
}

TEST_F(DataListItems, ANewStyleAppliesToLaterItemsAlone) {
    stage.Put("Style", idAndText);
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Blue=7 | Green=9");
    stage.Add("Grey", 11);
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Blue=7 | Green=9 |   11 - Grey=11");
}

TEST(DataListAdding, TextsAndValuesAreConvertedAsVariantsAre) {
    Stage stage;
    EXPECT_EQ(stage.Add(12, "34"), "");
    EXPECT_EQ(stage.Add("Half", 2.5), "");
    EXPECT_EQ(stage.Add("More", 3.5), "");
    EXPECT_EQ(stage.Add("Yes", true), "");
    EXPECT_EQ(stage.Add("Nothing", Variant()), "");
    EXPECT_EQ(stage.ItemsOf(0), "12=34 | Half=2 | More=4 | Yes=-1 | Nothing=0");
}

TEST(DataListAdding, AnItemWhoseValueDoesNotConvertIsAddedWithTheValue0) {
    Stage stage;
    EXPECT_EQ(stage.Add("Red", "no number"), "");
    EXPECT_EQ(stage.Add("Blue", 3e9), "");
    EXPECT_EQ(stage.ItemsOf(0), "Red=0 | Blue=0");
}

TEST(DataListAdding, ItemsAreAddedAtDesignTimeToo) {
    Stage stage(Stage::Options{.designTime = true});
    EXPECT_EQ(stage.Add("Red", 5), "");
    EXPECT_EQ(stage.ItemsOf(0), "List1=0 | Red=5");
}

// The counter.

TEST(DataListCounter, ClearAndRemovalLeaveItAndPopulateStartsItAgain) {
    Stage stage;
    stage.Put("Style", countAndText);
    stage.Add("Red", 5);
    stage.Add("Blue", 7);
    stage.Clear();
    stage.Add("Green", 9);
    EXPECT_EQ(stage.ItemsOf(0), "   3 - Green=9");
    stage.Remove(9);
    stage.Add("Grey", 11);
    EXPECT_EQ(stage.ItemsOf(0), "   4 - Grey=11");
    Records records(Fruits());
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Pear=1 |    2 - Apple=2 |    3 - Fig=3");
    stage.Add("Red", 5);
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Pear=1 |    2 - Apple=2 |    3 - Fig=3 |    4 - Red=5");
}

TEST(DataListCounter, At32767ItStaysAndItemsAreAddedAllTheSame) {
    constexpr int rows = 32'769;
    std::vector<Records::Row> many;
    for (int i = 0; i < rows; ++i) many.push_back({"r", i});
    Records records(std::move(many));
    Stage stage;
    stage.Put("Style", countAndText);
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(GetAt(stage.List(0), "List", 0), Variant("   1 - r"));
    EXPECT_EQ(GetAt(stage.List(0), "List", 9'998), Variant("9999 - r"));
    EXPECT_EQ(GetAt(stage.List(0), "List", 9'999), Variant("0000 - r"));
    EXPECT_EQ(GetAt(stage.List(0), "List", 32'765), Variant("2766 - r"));
    EXPECT_EQ(GetAt(stage.List(0), "List", 32'766), Variant("2767 - r"));
    EXPECT_EQ(GetAt(stage.List(0), "List", 32'767), Variant("2767 - r"));
    EXPECT_EQ(GetAt(stage.List(0), "ItemData", 32'766), Variant(32'766));
    EXPECT_EQ(ErrorOf([&] { stage.Get("ListCount"); }), frame::errors::overflow);
    stage.Clear();
    EXPECT_EQ(stage.Add("Red", 5), "");
    EXPECT_EQ(stage.Add("Blue", 7), "");
    EXPECT_EQ(stage.ItemsOf(0), "2767 - Red=5 | 2767 - Blue=7");
}

// Removing and clearing.

TEST_F(DataListItems, RemovingTellsWhetherTheValueWasThere) {
    const Variant removed = stage.Remove(7);
    EXPECT_EQ(removed.Type(), VarType::Boolean);
    EXPECT_EQ(removed, Variant(true));
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Green=9");
    const Variant again = stage.Remove(7);
    EXPECT_EQ(again.Type(), VarType::Boolean);
    EXPECT_EQ(again, Variant(false));
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Green=9");
    EXPECT_EQ(stage.Happened(), "");
}

TEST_F(DataListItems, RemovingTakesTheFirstItemOfTheValueAlone) {
    stage.Add("Crimson", 5);
    stage.Remove(5);
    EXPECT_EQ(stage.ItemsOf(0), "Blue=7 | Green=9 | Crimson=5");
}

TEST_F(DataListItems, RemovingTheChosenItemLeavesNothingChosen) {
    stage.Put("DefaultValue", 1);
    stage.Put("DefaultText", "None");
    stage.Choose(1);
    stage.Remove(7);
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_EQ(stage.Value(), 1);
    EXPECT_EQ(stage.Text(), "None");
}

TEST_F(DataListItems, RemovingAnotherItemKeepsTheChoice) {
    stage.Choose(1);
    stage.Remove(5);
    EXPECT_EQ(stage.Value(), 7);
    EXPECT_EQ(stage.Text(), "Blue");
    EXPECT_EQ(stage.ListIndex(), 0);
}

TEST_F(DataListItems, ClearEmptiesBothListsAndTheLabelAndGivesNothing) {
    Call(stage.List(1), "AddItem", {"Left over"});
    stage.Choose(0);
    stage.Reset();
    EXPECT_TRUE(stage.Clear().IsEmpty());
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "");
    EXPECT_EQ(stage.LabelText(), "");
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_EQ(stage.Get("ListCount"), Variant(0));
    EXPECT_EQ(stage.Happened(), "");
}

TEST_F(DataListItems, ClearKeepsTheDefaultPair) {
    stage.Put("DefaultValue", 1);
    stage.Put("DefaultText", "None");
    stage.Clear();
    EXPECT_EQ(stage.Value(), 1);
    EXPECT_EQ(stage.Text(), "None");
}

// Reading the choice.

TEST_F(DataListItems, WithNothingChosenTheDefaultPairIsReadThoughItIsNotInTheList) {
    stage.Put("DefaultValue", 77);
    stage.Put("DefaultText", "None");
    EXPECT_EQ(stage.Value(), 77);
    EXPECT_EQ(stage.Text(), "None");
}

TEST_F(DataListItems, TheChosenItemIsRead) {
    stage.Put("DefaultValue", 77);
    stage.Put("DefaultText", "None");
    stage.Choose(1);
    EXPECT_EQ(stage.Get("Value"), Variant(7));
    EXPECT_EQ(stage.Get("Text"), Variant("Blue"));
}

TEST_F(DataListItems, ListCountReadsTheItemsWhateverWasSet) {
    stage.Put("ListCount", 100);
    EXPECT_EQ(stage.Get("ListCount"), Variant(3));
    EXPECT_EQ(stage.ItemsOf(0), "Red=5 | Blue=7 | Green=9");
    EXPECT_EQ(stage.Saved("ListCount"), Variant(100));
}

// Setting Value.

TEST_F(DataListItems, SettingValueChoosesItsItemRaisesClickAndTakesTheTextToTheLabel) {
    stage.Put("Value", 7);
    EXPECT_EQ(stage.ListIndex(), 1);
    EXPECT_EQ(stage.LabelText(), "Blue");
    const std::string happened = stage.Happened();
    EXPECT_TRUE(happened == "Click changed Value" || happened == "changed Value Click") << happened;
}

TEST_F(DataListItems, SettingValueChoosesTheFirstItemThatHasIt) {
    stage.Add("Azure", 7);
    stage.Put("Value", 7);
    EXPECT_EQ(stage.ListIndex(), 1);
}

TEST_F(DataListItems, SettingAnUnknownValueChoosesTheDefaultWhereItIsInTheList) {
    stage.Put("DefaultValue", 9);
    stage.Put("Value", 1000);
    EXPECT_EQ(stage.ListIndex(), 2);
    EXPECT_EQ(stage.Value(), 9);
    EXPECT_EQ(stage.LabelText(), "Green");
}

TEST_F(DataListItems, SettingAnUnknownValueWithoutADefaultItemKeepsTheChoice) {
    stage.Put("DefaultValue", 77);
    stage.Choose(1);
    stage.Reset();
    stage.Put("Value", 1000);
    EXPECT_EQ(stage.ListIndex(), 1);
    EXPECT_EQ(stage.LabelText(), "Blue");
    EXPECT_EQ(stage.Happened(), "changed Value");
}

TEST_F(DataListItems, ValuesOf32BitsAreFound) {
    for (const std::int32_t value : {std::numeric_limits<std::int32_t>::min(), -40'000, 40'000, 2147483647}) {
        stage.Add("Far", value);
        stage.Put("Value", value);
        EXPECT_EQ(stage.Value(), value);
    }
}

TEST_F(DataListItems, AValueIsConvertedByTheRulesOfVariants) {
    stage.Put("Value", "7");
    EXPECT_EQ(stage.Text(), "Blue");
    stage.Put("Value", 8.6);
    EXPECT_EQ(stage.Text(), "Green");
}

TEST_F(DataListItems, AnErrorOfAHandlerDoesNotStopTheSettingOfValue) {
    stage.onEvent = [](frame::EventArguments) { throw frame::ControlError(1234); };
    EXPECT_EQ(ErrorOf([&] { stage.Put("Value", 7); }), 0);
    EXPECT_EQ(stage.Value(), 7);
    EXPECT_EQ(stage.LabelText(), "Blue");
}

// Setting Text.

TEST_F(DataListItems, SettingTextChoosesItsItemInAnyCaseAndStoresTheTextAsGiven) {
    stage.Put("Text", "bLUE");
    EXPECT_EQ(stage.Happened(), "Click changed Text");
    EXPECT_EQ(stage.ListIndex(), 1);
    EXPECT_EQ(stage.Value(), 7);
    EXPECT_EQ(stage.Text(), "Blue");
    EXPECT_EQ(stage.LabelText(), "Blue");
    EXPECT_EQ(stage.Saved("Text"), Variant("bLUE"));
}

TEST_F(DataListItems, TextsBeyondAsciiIgnoreCaseToo) {
    stage.Add("\u00C4rger \u0416", 20);
    stage.Put("Text", "\u00E4RGER \u0436");
    EXPECT_EQ(stage.Value(), 20);
}

TEST_F(DataListItems, APartOfATextIsNoMatch) {
    stage.Put("Text", "Blu");
    EXPECT_EQ(stage.ListIndex(), -1);
    stage.Put("Text", "Blue ");
    EXPECT_EQ(stage.ListIndex(), -1);
}

TEST_F(DataListItems, TheFirstItemOfATextIsChosen) {
    stage.Add("BLUE", 70);
    stage.Put("Text", "BLUE");
    EXPECT_EQ(stage.Value(), 7);
}

TEST_F(DataListItems, SettingAnUnknownTextChoosesTheDefaultAndStoresTheText) {
    stage.Put("DefaultValue", 9);
    stage.Put("DefaultText", "None");
    stage.Reset();
    stage.Put("Text", "Mauve");
    EXPECT_EQ(stage.Happened(), "Click changed Text");
    EXPECT_EQ(stage.ListIndex(), 2);
    EXPECT_EQ(stage.Text(), "Green");
    EXPECT_EQ(stage.LabelText(), "Green");
    EXPECT_EQ(stage.Saved("Text"), Variant("Mauve"));
}

TEST_F(DataListItems, SettingAnUnknownTextWithoutADefaultItemKeepsTheChoice) {
    stage.Put("DefaultValue", 77);
    stage.Choose(1);
    stage.Reset();
    stage.Put("Text", "Mauve");
    EXPECT_EQ(stage.Happened(), "changed Text");
    EXPECT_EQ(stage.Text(), "Blue");
    EXPECT_EQ(stage.LabelText(), "Blue");
    EXPECT_EQ(stage.Saved("Text"), Variant("Mauve"));
}

TEST(DataListTexts, WithAPrefixTheTextMustHoldIt) {
    Stage stage;
    stage.Put("Style", idAndText);
    stage.Put("DefaultValue", 77);
    stage.Add("Red", 5);
    stage.Put("Text", "Red");
    EXPECT_EQ(stage.ListIndex(), -1);
    stage.Put("Text", "   5 - RED");
    EXPECT_EQ(stage.ListIndex(), 0);
    EXPECT_EQ(stage.Text(), "   5 - Red");
    EXPECT_EQ(stage.LabelText(), "   5 - Red");
}

TEST(DataListTexts, TextIsSetAtDesignTimeToo) {
    Stage stage(Stage::Options{.designTime = true});
    stage.Add("Red", 5);
    stage.Reset();
    EXPECT_EQ(ErrorOf([&] { stage.Put("Text", "red"); }), 0);
    EXPECT_EQ(stage.Value(), 5);
    EXPECT_EQ(stage.Saved("Text"), Variant("red"));
}

// Properties that store and do no more, and those that are handed on.

TEST_F(DataListItems, SettersThatOnlyStoreLeaveItemsChoiceAndSightAlone) {
    stage.Choose(1);
    const std::string items = stage.ItemsOf(0), visible = stage.Visible();
    const std::vector<std::pair<std::string, Variant>> values = {
        {"Locked", true},     {"LockedAlways", true},     {"DefaultValue", 9}, {"DefaultText", "None"},
        {"Style", idAndText}, {"OnlyUniqueValues", true}, {"ListCount", 1}};
    for (const auto& [name, value] : values) {
        stage.Reset();
        stage.Put(name, value);
        EXPECT_EQ(stage.Happened(), "changed " + name);
        EXPECT_EQ(stage.ItemsOf(0), items) << name;
        EXPECT_EQ(stage.ListIndex(), 1) << name;
        EXPECT_EQ(stage.LabelText(), "Blue") << name;
        EXPECT_EQ(stage.Visible(), visible) << name;
        if (name == "ListCount") continue;
        EXPECT_EQ(stage.Get(name), value) << name;
    }
}

TEST(DataListLooks, ColoursAndEnabledGoToBothListsAndNotToTheLabel) {
    Stage stage;
    const std::vector<std::pair<std::string, Variant>> values = {
        {"BackColor", frame::OLE_COLOR(0xABCDEF)}, {"ForeColor", frame::OLE_COLOR(0x123456)}, {"Enabled", false}};
    for (const auto& [name, value] : values) {
        const Variant label = stage.Label().Get(name);
        stage.Put(name, value);
        EXPECT_EQ(stage.Get(name), value) << name;
        EXPECT_EQ(stage.List(0).Get(name), value) << name;
        EXPECT_EQ(stage.List(1).Get(name), value) << name;
        EXPECT_EQ(stage.Label().Get(name), label) << name;
        EXPECT_FALSE(label == value) << name;
    }
}

TEST(DataListLooks, FontAndAppearanceGoToBothListsAndToTheLabel) {
    Stage stage;
    const auto font = std::make_shared<frame::Font>("Courier", 20);
    stage.Put("Font", font);
    for (const std::int16_t appearance : {std::int16_t{1}, std::int16_t{0}}) {
        stage.Put("Appearance", appearance);
        EXPECT_EQ(stage.Get("Appearance"), Variant(appearance));
        for (frame::Object* child : {&stage.List(0), &stage.List(1), &stage.Label()}) {
            EXPECT_EQ(child->Get("Font"), Variant(font)) << child->Path();
            EXPECT_EQ(child->Get("Appearance"), Variant(appearance)) << child->Path();
        }
    }
}

TEST(DataListLooks, FontReadsTheSameObjectAndAChangeOfItIsSeenByTheChildren) {
    Stage stage;
    const auto font = std::make_shared<frame::Font>("Courier", 20);
    stage.Put("Font", font);
    EXPECT_EQ(stage.Get("Font").ToObject().Get(), font.get());
    font->SetBold(true);
    for (frame::Object* child : {&stage.List(0), &stage.List(1), &stage.Label()})
        EXPECT_EQ(child->Get("Font").ToObject()->Get("Bold"), Variant(true)) << child->Path();
}

TEST(DataListLooks, WhatIsSetOnAChildIsNotReadBack) {
    Stage stage;
    stage.List(0).Put("BackColor", frame::OLE_COLOR(0x010203));
    stage.List(0).Put("Enabled", false);
    EXPECT_EQ(stage.Get("BackColor"), Variant(frame::OLE_COLOR(0x80000005u)));
    EXPECT_EQ(stage.Get("Enabled"), Variant(true));
}

}  // namespace
}  // namespace tessel::controls
