#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <ostream>
#include <random>
#include <string>
#include <unordered_set>
#include <utility>
#include <vector>

#include "hosts/headless/MemoryRecordset.h"
#include "tests/controls/datalist/DataListTestHelp.h"

/// Filling the list from a source of records.
namespace tessel::controls {
namespace {

using headless::MemoryRecordset;
using test::ErrorOf;
using testing::ElementsAre;
using namespace datalisttest;

constexpr int sourceError = 1234;
constexpr const char* sourceWords = "The source is out of order.";

/// A list that holds Old=40, chosen, before it is filled with Pear=1, Apple=2, Fig=3.
class DataListPopulate : public testing::Test {
  protected:
    DataListPopulate() {
        stage.Put("DefaultValue", 77);
        stage.Put("DefaultText", "None");
        stage.Add("Old", 40);
        stage.Choose(0);
        stage.Reset();
    }
    Stage stage;
    Records records{Fruits()};
};

TEST_F(DataListPopulate, TheRowsTakeThePlaceOfWhatWasThereAndTheResultIsEmpty) {
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.ItemsOf(1), "");
    EXPECT_EQ(stage.Get("ListCount"), Variant(3));
}

TEST_F(DataListPopulate, WithoutADefaultNothingIsChosenAndTheDefaultPairIsRead) {
    stage.Populate(records);
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_EQ(stage.Value(), 77);
    EXPECT_EQ(stage.Text(), "None");
}

TEST_F(DataListPopulate, ItRaisesAndReportsNothingAndTurnsTheLoopOnceAtItsEnd) {
    std::size_t rowsAtTheTurn = 0;
    bool endAtTheTurn = false;
    stage.AtYield([&] {
        rowsAtTheTurn = static_cast<std::size_t>(stage.Get("ListCount").ToLong());
        endAtTheTurn = records.position == records.rows.size();
    });
    stage.PopulateWith(records, "Any", 8);
    EXPECT_EQ(stage.Happened(), "yield");
    EXPECT_EQ(rowsAtTheTurn, 4u);
    EXPECT_TRUE(endAtTheTurn);
}

TEST_F(DataListPopulate, TheSourceIsReadFromItsFirstRowAndLeftAtItsEnd) {
    records.position = 2;
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(records.position, 3u);
    EXPECT_EQ(records.Times("MoveFirst"), 1);
    EXPECT_EQ(records.Times("MoveNext"), 3);
}

TEST_F(DataListPopulate, FilledAgainItHoldsTheRowsOnce) {
    stage.Populate(records);
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
}

TEST_F(DataListPopulate, ASourceAtItsEndFromTheBeginningGivesAnEmptyList) {
    records.rows.clear();
    records.refusesToBeEmpty = false;
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(records.Times("MoveNext"), 0);
    EXPECT_EQ(stage.Happened(), "yield");
}

TEST_F(DataListPopulate, ColumnsAreGivenByNameInAnyCase) {
    EXPECT_EQ(stage.Populate(records, "NAME", "id"), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
    for (const Variant& column : records.askedColumns) EXPECT_TRUE(column == Variant("NAME") || column == Variant("id"));
}

TEST_F(DataListPopulate, ColumnsAreGivenByNumber) {
    EXPECT_EQ(stage.Populate(records, std::int16_t{0}, 1), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
    for (const Variant& column : records.askedColumns) EXPECT_TRUE(column.IsNumber()) << column.ToText();
}

TEST_F(DataListPopulate, OneColumnMayServeForBoth) {
    EXPECT_EQ(stage.Populate(records, 1, "Id"), "");
    EXPECT_EQ(stage.ItemsOf(0), "1=1 | 2=2 | 3=3");
}

TEST_F(DataListPopulate, ItWorksAtDesignTimeToo) {
    Stage designed(Stage::Options{.designTime = true});
    EXPECT_EQ(designed.Populate(records), "");
    EXPECT_EQ(designed.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
}

TEST_F(DataListPopulate, InASortedListTheRowsStandInOrder) {
    stage.Put("Sorted", true);
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "Apple=2 | Fig=3 | Pear=1");
}

TEST_F(DataListPopulate, WhatIsInTheOtherListIsClearedToo) {
    Call(stage.List(1), "AddItem", {"Left over"});
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(1), "");
}

TEST_F(DataListPopulate, TheLabelIsLeftAloneWithoutADefault) {
    stage.Populate(records);
    EXPECT_EQ(stage.LabelText(), "Old");
}

// Failures before the list is touched.

struct FailingStep {
    const char* name;
    const char* step;
    const char* prefix;
};
void PrintTo(const FailingStep& step, std::ostream* out) { *out << step.name; }

class DataListPopulateFails : public testing::TestWithParam<FailingStep> {};

TEST_P(DataListPopulateFails, WithTheSourcesOwnWordsAndTheListStaysAsItWas) {
    Stage stage;
    Records records(Fruits());
    stage.Put("DefaultValue", 77);
    stage.Put("DefaultText", "None");
    stage.Put("Style", countAndText);
    stage.Add("Old", 40);
    stage.Choose(0);
    const std::string before = stage.State();
    stage.Reset();
    records.FailAt(GetParam().step, sourceError, sourceWords);
    EXPECT_EQ(stage.PopulateWith(records, "Any", 8), std::string(GetParam().prefix) + sourceWords);
    EXPECT_EQ(stage.State(), before);
    EXPECT_EQ(stage.Happened(), "");
    EXPECT_EQ(records.Times("EOF"), 0);
    EXPECT_EQ(records.Times("MoveNext"), 0);
    // The counter goes on, clicks are raised, and the next attempt succeeds.
    stage.Add("New", 41);
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Old=40 |    2 - New=41");
    stage.Reset();
    stage.Choose(1);
    EXPECT_EQ(stage.Happened(), "Click");
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Pear=1 |    2 - Apple=2 |    3 - Fig=3");
}

INSTANTIATE_TEST_SUITE_P(Steps, DataListPopulateFails,
                         testing::Values(FailingStep{"MoveFirst", "MoveFirst", ""},
                                         FailingStep{"TextField", "Fields(Name)", "TextColumn=Name - "},
                                         FailingStep{"TextName", "Name(Name)", "TextColumn=Name - "},
                                         FailingStep{"ValueField", "Fields(Id)", "ValueColumn=Id - "},
                                         FailingStep{"ValueName", "Name(Id)", "ValueColumn=Id - "}),
                         [](const auto& row) { return std::string(row.param.name); });

TEST_F(DataListPopulate, AnEmptySourceThatRefusesToMoveGivesItsWords) {
    records.rows.clear();
    const std::string before = stage.State();
    EXPECT_EQ(stage.Populate(records), Records::noRecord);
    EXPECT_EQ(stage.State(), before);
    EXPECT_THAT(records.steps, ElementsAre("MoveFirst"));
}

TEST_F(DataListPopulate, AWrongTextColumnIsNamedAsItWasGiven) {
    const std::string before = stage.State();
    EXPECT_EQ(stage.Populate(records, "Nmae", "Id"), std::string("TextColumn=Nmae - ") + Records::noColumn);
    EXPECT_EQ(stage.Populate(records, 9, "Id"), std::string("TextColumn=9 - ") + Records::noColumn);
    EXPECT_EQ(stage.State(), before);
}

TEST_F(DataListPopulate, AWrongValueColumnIsNamedAsItWasGiven) {
    const std::string before = stage.State();
    EXPECT_EQ(stage.Populate(records, "Name", "Idd"), std::string("ValueColumn=Idd - ") + Records::noColumn);
    EXPECT_EQ(stage.Populate(records, "Name", -1), std::string("ValueColumn=-1 - ") + Records::noColumn);
    EXPECT_EQ(stage.State(), before);
}

TEST_F(DataListPopulate, OfTwoWrongColumnsThatOfTheTextIsNamed) {
    EXPECT_EQ(stage.Populate(records, "X", "Y"), std::string("TextColumn=X - ") + Records::noColumn);
}

TEST_F(DataListPopulate, WithoutASourceTheListStaysAsItWas) {
    const std::string before = stage.State();
    EXPECT_NE(Call(stage.Control(), "Populate", {frame::ObjectRef(), "Name", "Id"}).ToText(), "");
    EXPECT_EQ(stage.State(), before);
}

TEST_F(DataListPopulate, ASourceThatHasGoneLeavesTheListAsItWas) {
    auto other = std::make_unique<Records>(Fruits());
    std::vector<Variant> arguments = {frame::ObjectRef(*other), "Name", "Id"};
    other.reset();
    const std::string before = stage.State();
    EXPECT_NE(stage.Control().Call("Populate", arguments).ToText(), "");
    EXPECT_EQ(stage.State(), before);
}

// The default pair.

TEST_F(DataListPopulate, AGivenDefaultPairIsTheFirstItemAndChosen) {
    EXPECT_EQ(stage.PopulateWith(records, "Any", 8), "");
    EXPECT_EQ(stage.ItemsOf(0), "Any=8 | Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.ListIndex(), 0);
    EXPECT_EQ(stage.Value(), 8);
    EXPECT_EQ(stage.Text(), "Any");
    EXPECT_EQ(stage.Get("DefaultText"), Variant("Any"));
    EXPECT_EQ(stage.Get("DefaultValue"), Variant(8));
}

TEST_F(DataListPopulate, ChoosingTheDefaultPairKeepsTheLabelInStepAndRaisesNoClick) {
    stage.PopulateWith(records, "Any", 8);
    EXPECT_EQ(stage.LabelText(), "Any");
    EXPECT_EQ(stage.Happened(), "yield");
}

TEST_F(DataListPopulate, ADefaultTextAloneGoesWithTheDefaultValueOfTheControl) {
    EXPECT_EQ(stage.PopulateWith(records, "Any"), "");
    EXPECT_EQ(stage.ItemsOf(0), "Any=77 | Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.ListIndex(), 0);
    EXPECT_EQ(stage.Get("DefaultText"), Variant("Any"));
    EXPECT_EQ(stage.Get("DefaultValue"), Variant(77));
}

TEST_F(DataListPopulate, ADefaultValueAloneIsIgnored) {
    EXPECT_EQ(stage.PopulateWith(records, Variant::Missing(), 8), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_EQ(stage.Get("DefaultText"), Variant("None"));
    EXPECT_EQ(stage.Get("DefaultValue"), Variant(77));
}

TEST_F(DataListPopulate, ABlankDefaultTextIsStoredButIsNoItem) {
    EXPECT_EQ(stage.PopulateWith(records, "", 8), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.ListIndex(), -1);
    EXPECT_EQ(stage.Value(), 8);
    EXPECT_EQ(stage.Text(), "");
}

TEST_F(DataListPopulate, TheBoundsOf16BitsAreValuesOfADefaultPair) {
    for (const std::int32_t value : {32'767, -32'768, 0}) {
        stage.PopulateWith(records, "Any", value);
        EXPECT_EQ(GetAt(stage.List(0), "ItemData", 0), Variant(value));
        EXPECT_EQ(stage.Value(), value);
    }
}

TEST_F(DataListPopulate, ADefaultValueBeyond16BitsAddsTheDefaultItemWithTheOldValue) {
    for (const std::int32_t value : {32'768, 40'000, -32'769, 2147483647}) {
        Stage fresh;
        fresh.Put("DefaultValue", 7);
        EXPECT_EQ(fresh.PopulateWith(records, "Any", value), "");
        EXPECT_EQ(fresh.ItemsOf(0), "Any=7 | Pear=1 | Apple=2 | Fig=3") << value;
        EXPECT_EQ(fresh.ListIndex(), 0);
        EXPECT_EQ(fresh.Get("DefaultText"), Variant("Any"));
    }
}

// The value is taken to 16 bits only to be stored: what fails leaves the property as it is, and the item takes it whole.
TEST_F(DataListPopulate, ADefaultTextAloneGoesWithADefaultValueBeyond16BitsWhole) {
    for (const std::int32_t value : {32'768, 40'000, -40'000}) {
        stage.Put("DefaultValue", value);
        EXPECT_EQ(stage.PopulateWith(records, "Any"), "");
        EXPECT_EQ(stage.ItemsOf(0), "Any=" + std::to_string(value) + " | Pear=1 | Apple=2 | Fig=3");
        EXPECT_EQ(stage.ListIndex(), 0);
        EXPECT_EQ(stage.Value(), value);
        EXPECT_EQ(stage.Get("DefaultText"), Variant("Any"));
        EXPECT_EQ(stage.Get("DefaultValue"), Variant(value));
    }
}

TEST_F(DataListPopulate, ADefaultValueThatIsNoNumberAddsTheDefaultItemWithTheOldValue) {
    EXPECT_EQ(stage.PopulateWith(records, "Any", "no number"), "");
    EXPECT_EQ(stage.ItemsOf(0), "Any=77 | Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.ListIndex(), 0);
}

TEST_F(DataListPopulate, ADefaultPairIsConvertedAsVariantsAre) {
    EXPECT_EQ(stage.PopulateWith(records, 12, "34"), "");
    EXPECT_EQ(stage.ItemsOf(0), "12=34 | Pear=1 | Apple=2 | Fig=3");
    EXPECT_EQ(stage.Get("DefaultText"), Variant("12"));
    EXPECT_EQ(stage.Get("DefaultValue"), Variant(34));
}

TEST_F(DataListPopulate, ADefaultPairHasAPrefixToo) {
    stage.Put("Style", idAndText);
    stage.PopulateWith(records, "Any", 8);
    EXPECT_EQ(stage.ItemsOf(0), "   8 - Any=8 |    1 - Pear=1 |    2 - Apple=2 |    3 - Fig=3");
    EXPECT_EQ(stage.Text(), "   8 - Any");
    EXPECT_EQ(stage.LabelText(), "   8 - Any");
    stage.Put("Style", countAndText);
    stage.PopulateWith(records, "Any", 8);
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Any=8 |    2 - Pear=1 |    3 - Apple=2 |    4 - Fig=3");
}

TEST_F(DataListPopulate, ADefaultPairInASortedListStaysChosenWhileRowsComeBeforeIt) {
    stage.Put("Sorted", true);
    stage.PopulateWith(records, "Kiwi", 8);
    EXPECT_EQ(stage.ItemsOf(1), "Apple=2 | Fig=3 | Kiwi=8 | Pear=1");
    EXPECT_EQ(stage.Value(), 8);
    EXPECT_EQ(stage.Text(), "Kiwi");
    EXPECT_EQ(stage.LabelText(), "Kiwi");
}

// Rows that are refused or fail.

TEST_F(DataListPopulate, RowsWithABlankTextAreDroppedInSilence) {
    records.rows = {{"Pear", 1}, {"", 2}, {Variant(), 3}, {"Fig", 4}};
    stage.Put("Style", countAndText);
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Pear=1 |    2 - Fig=4");
    EXPECT_EQ(records.position, 4u);
}

TEST_F(DataListPopulate, WithUniqueValuesRowsOfARepeatedValueAreDroppedInSilence) {
    records.rows = {{"Pear", 1}, {"Plum", 1}, {"Fig", 4}, {"Date", 4}, {"Lime", 5}};
    stage.Put("Style", countAndText);
    stage.Put("OnlyUniqueValues", true);
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Pear=1 |    2 - Fig=4 |    3 - Lime=5");
}

TEST_F(DataListPopulate, WithUniqueValuesARowWithTheValueOfTheDefaultPairIsDropped) {
    stage.Put("OnlyUniqueValues", true);
    EXPECT_EQ(stage.PopulateWith(records, "Any", 2), "");
    EXPECT_EQ(stage.ItemsOf(0), "Any=2 | Pear=1 | Fig=3");
}

TEST_F(DataListPopulate, UniqueValuesDoNotMindWhatTheListHeldBefore) {
    stage.Put("OnlyUniqueValues", true);
    stage.Populate(records);
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
}

TEST_F(DataListPopulate, ValuesOfRowsHave32Bits) {
    records.rows = {{"Pear", 100'000}, {"Fig", -100'000}};
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(0), "Pear=100000 | Fig=-100000");
}

TEST_F(DataListPopulate, ARowWhoseValueDoesNotConvertIsAddedWithTheValue0) {
    records.rows = {{"Pear", "no number"}, {"Apple", 3e9}, {"Fig", "3"}, {4, 4.5}};
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=0 | Apple=0 | Fig=3 | 4=4");
}

TEST_F(DataListPopulate, ARowOfWhichAStepFailsIsDroppedInSilence) {
    for (const auto* failing : {"Fields(Name)", "Value(Name)", "Fields(Id)"}) {
        records.onStep = [&](const std::string& step) {
            if (step == failing && records.position == 1) throw frame::ControlError(sourceError, sourceWords);
        };
        EXPECT_EQ(stage.Populate(records), "");
        EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Fig=3") << failing;
        EXPECT_EQ(records.position, 3u);
    }
}

TEST_F(DataListPopulate, AfterAStepToTheNextRowThatFailsTheRowComesAgain) {
    records.FailAt("MoveNext", 2, sourceError, sourceWords);
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Apple=2 | Fig=3");
}

TEST_F(DataListPopulate, ATestForTheEndThatFailsGoesOnWithTheRow) {
    records.FailAt("EOF", 2, sourceError, sourceWords);
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2 | Fig=3");
}

// The busy flag.

TEST_F(DataListPopulate, AChoiceThatComesInAtTheTurnRaisesNoClickButTakesTheLabelAlong) {
    std::string label;
    stage.AtYield([&] {
        stage.Choose(1);
        label = stage.LabelText();
    });
    stage.Populate(records);
    EXPECT_EQ(label, "Apple");
    EXPECT_EQ(stage.Happened(), "yield");
    EXPECT_EQ(stage.Value(), 2);
    stage.Choose(2);
    EXPECT_EQ(stage.Happened(), "Click");
}

TEST_F(DataListPopulate, AClickThatComesInAtTheTurnIsHeldBackButOtherInputIsForwarded) {
    stage.AtYield([&] {
        Fire(stage.List(0), "Click");
        Fire(stage.List(0), "DblClick");
        Fire(stage.List(0), "KeyDown", {std::int16_t{65}, std::int16_t{0}});
    });
    stage.Populate(records);
    EXPECT_EQ(stage.Happened(), "yield DblClick KeyDown(65, 0)");
}

TEST_F(DataListPopulate, AChoiceMadeWhileTheSourceIsReadRaisesNoClick) {
    records.onStep = [&](const std::string& step) {
        if (step == "MoveNext") stage.Choose(0);
    };
    stage.Populate(records);
    EXPECT_EQ(stage.Happened(), "yield");
    EXPECT_EQ(stage.LabelText(), "Pear");
}

// What comes in while the list is filled.

TEST_F(DataListPopulate, FilledAnewAtTheTurnItHoldsTheInnerRows) {
    Records inner({{"Lime", 9}});
    std::string innerResult = "none";
    stage.AtYield([&] { innerResult = stage.PopulateWith(inner, "All", 6); });
    EXPECT_EQ(stage.Populate(records), "");
    EXPECT_EQ(innerResult, "");
    EXPECT_EQ(stage.ItemsOf(0), "All=6 | Lime=9");
    EXPECT_EQ(stage.Value(), 6);
    EXPECT_EQ(stage.Happened(), "yield yield");
}

TEST_F(DataListPopulate, AnItemAddedAtTheTurnStandsBehindTheRows) {
    stage.Put("Style", countAndText);
    stage.AtYield([&] { stage.Add("Late", 50); });
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(0), "   1 - Pear=1 |    2 - Apple=2 |    3 - Fig=3 |    4 - Late=50");
}

TEST_F(DataListPopulate, WhatIsAddedAtTheTurnEndsTheHoldingBackOfClicks) {
    stage.AtYield([&] {
        stage.Add("Late", 50);
        stage.Choose(1);
    });
    stage.Reset();
    stage.Populate(records);
    EXPECT_EQ(stage.Happened(), "yield yield Click");
}

TEST_F(DataListPopulate, ClearedAtTheTurnItIsEmpty) {
    stage.AtYield([&] { stage.Clear(); });
    EXPECT_EQ(stage.PopulateWith(records, "Any", 8), "");
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.Value(), 8);
    EXPECT_EQ(stage.Text(), "Any");
    EXPECT_EQ(stage.LabelText(), "");
}

TEST_F(DataListPopulate, ClearedWhileTheSourceIsReadItHoldsTheRowsThatComeAfter) {
    int moves = 0;
    records.onStep = [&](const std::string& step) {
        if (step == "MoveNext" && ++moves == 2) stage.Clear();
    };
    EXPECT_EQ(stage.PopulateWith(records, "Any", 8), "");
    EXPECT_EQ(stage.ItemsOf(0), "Fig=3");
    EXPECT_EQ(stage.ListIndex(), -1);
}

TEST_F(DataListPopulate, AnotherOrderAtTheTurnMovesTheRows) {
    stage.AtYield([&] { stage.Put("Sorted", true); });
    stage.Populate(records);
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "Apple=2 | Fig=3 | Pear=1");
}

TEST_F(DataListPopulate, DestroyedAtTheTurnItStillGivesItsResult) {
    stage.AtYield([&] { stage.Destroy(); });
    EXPECT_EQ(stage.PopulateWith(records, "Any", 8), "");
    EXPECT_FALSE(stage.Lives());
    EXPECT_EQ(stage.Happened(), "yield");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(DataListPopulate, DestroyedAtTheTurnOfAnAddedItemItStillGivesItsResult) {
    stage.AtYield([&] { stage.Destroy(); });
    EXPECT_EQ(stage.Add("", 8), "Blank text item not allowed.");
    EXPECT_FALSE(stage.Lives());
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(DataListPopulate, AChoiceThatComesInWhileAnItemIsAddedRaisesNoClickButTakesTheLabelAlong) {
    stage.AtYield([&] { stage.Choose(1); });
    EXPECT_EQ(stage.Add("New", 41), "");
    EXPECT_EQ(stage.Happened(), "yield");
    EXPECT_EQ(stage.LabelText(), "New");
    stage.Choose(0);
    EXPECT_EQ(stage.Happened(), "Click");
}

TEST_F(DataListPopulate, ItemsAddedInsideAnAddedItemsTurnStandInTheOrderOfTheirCalls) {
    stage.AtYield([&] { stage.Add("Inner", 42); });
    EXPECT_EQ(stage.Add("Outer", 41), "");
    EXPECT_EQ(stage.ItemsOf(0), "Old=40 | Outer=41 | Inner=42");
}

// Many rows.

using Pairs = std::vector<std::pair<std::string, std::int32_t>>;

/// 100,000 rows with some 60,000 different values from -30,000 on, in no order. Each 100th text is blank.
Pairs ManyPairs() {
    constexpr std::uint32_t rows = 100'000, values = 60'000, blankEach = 100;
    Pairs pairs;
    pairs.reserve(rows);
    std::mt19937 random(20);
    for (std::uint32_t row = 0; row < rows; ++row) {
        const auto drawn = static_cast<std::uint32_t>(random());
        pairs.emplace_back(row % blankEach == 0 ? std::string() : std::to_string(drawn),
                           static_cast<std::int32_t>(drawn % values) - 30'000);
    }
    return pairs;
}

/// What a list takes of them, one after the other: no blank text, the first of each value, under a number that stays at 32767.
Pairs Taken(const Pairs& offered, bool numbered) {
    constexpr int lastNumber = 32'767;
    Pairs taken;
    std::unordered_set<std::int32_t> present;
    int number = 0;
    for (const auto& [text, value] : offered) {
        if (text.empty() || !present.insert(value).second) continue;
        number = std::min(number + 1, lastNumber);
        const std::string padded = "     " + std::to_string(number);
        taken.emplace_back(numbered ? padded.substr(padded.size() - 4) + " - " + text : text, value);
    }
    return taken;
}

/// Fills a list from the pairs and compares all of its items.
void ExpectItems(Stage& stage, int list, const Pairs& offered, const Pairs& expected) {
    std::vector<MemoryRecordset::Row> rows;
    rows.reserve(offered.size());
    for (const auto& [text, value] : offered) {
        MemoryRecordset::Row& row = rows.emplace_back();
        row.reserve(2);
        row.emplace_back(text);
        row.emplace_back(value);
    }
    MemoryRecordset records("RS1", {"Name", "Id"}, std::move(rows));
    EXPECT_EQ(Call(stage.Control(), "Populate", {frame::ObjectRef(records), "Name", "Id"}), Variant(""));
    EXPECT_TRUE(records.AtEnd());
    frame::Object& items = stage.List(list);
    ASSERT_EQ(items.Get("ListCount"), Variant(static_cast<std::int32_t>(expected.size())));
    const frame::Member *text = items.Table().Find("List"), *value = items.Table().Find("ItemData");
    for (std::size_t i = 0; i < expected.size(); ++i) {
        Variant at[] = {static_cast<std::int32_t>(i)};
        const frame::Arguments index(at);
        const std::pair item(text->get(items, index).ToText(), value->get(items, index).ToLong());
        if (item != expected[i]) FAIL() << i << ": " << item.first << "=" << item.second << " and not " << expected[i].first;
    }
}

TEST(DataListOfManyRows, WithUniqueValuesTheFirstRowOfEachValueIsTakenBeyondTheLastNumberToo) {
    constexpr std::size_t lastNumber = 32'767;
    Stage stage;
    stage.Put("OnlyUniqueValues", true);
    stage.Put("Style", countAndText);
    const Pairs offered = ManyPairs(), expected = Taken(offered, true);
    ASSERT_GT(expected.size(), lastNumber);
    ExpectItems(stage, 0, offered, expected);
    const auto& [text, value] = expected.back();
    EXPECT_EQ(stage.Add("Another", value), "Item with value " + std::to_string(value) + " already exists.");
    stage.Put("Value", value);
    EXPECT_EQ(stage.Text(), text);
}

TEST(DataListOfManyRows, WithUniqueValuesASortedListTakesTheSameRowsInTheirOrder) {
    Stage stage;
    stage.Put("OnlyUniqueValues", true);
    stage.Put("Sorted", true);
    const Pairs offered = ManyPairs();
    Pairs expected = Taken(offered, false);
    std::sort(expected.begin(), expected.end());
    ExpectItems(stage, 1, offered, expected);
}

}  // namespace
}  // namespace tessel::controls
