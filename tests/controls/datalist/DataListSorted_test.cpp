#include <gtest/gtest.h>

#include <ostream>
#include <string>

#include "tests/controls/datalist/DataListTestHelp.h"

/// The sorted and the unsorted list, the moving of items between them, and what is to be seen of them.
namespace tessel::controls {
namespace {

using namespace datalisttest;

/// Pear=1 | Apple=2 | Fig=3, with nothing chosen.
class DataListSorted : public testing::Test {
  protected:
    DataListSorted() {
        stage.Add("Pear", 1);
        stage.Add("Apple", 2);
        stage.Add("Fig", 3);
        stage.Reset();
    }
    Stage stage;
};

TEST_F(DataListSorted, SettingSortedMovesTheItemsIntoTheSortedList) {
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.Get("Sorted"), Variant(true));
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "Apple=2 | Fig=3 | Pear=1");
    EXPECT_EQ(stage.Get("ListCount"), Variant(3));
}

TEST_F(DataListSorted, UnsettingSortedMovesThemBackInTheOrderInWhichTheyStand) {
    stage.Put("Sorted", true);
    stage.Put("Sorted", false);
    EXPECT_EQ(stage.ItemsOf(0), "Apple=2 | Fig=3 | Pear=1");
    EXPECT_EQ(stage.ItemsOf(1), "");
    stage.Add("Banana", 4);
    EXPECT_EQ(stage.ItemsOf(0), "Apple=2 | Fig=3 | Pear=1 | Banana=4");
}

TEST_F(DataListSorted, ItIsReportedOnceAndRaisesNothingAndTurnsNoLoop) {
    stage.Choose(1);
    stage.Reset();
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.Happened(), "changed Sorted");
}

TEST_F(DataListSorted, NewItemsTakeTheirPlaceInTheSortedListWithTheirValues) {
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.Add("Banana", 4), "");
    EXPECT_EQ(stage.Add("Zucchini", 5), "");
    EXPECT_EQ(stage.Add("Aloe", 6), "");
    EXPECT_EQ(stage.ItemsOf(1), "Aloe=6 | Apple=2 | Banana=4 | Fig=3 | Pear=1 | Zucchini=5");
    EXPECT_EQ(stage.ItemsOf(0), "");
}

TEST_F(DataListSorted, CaseDoesNotCountInTheOrder) {
    stage.Put("Sorted", true);
    stage.Add("banana", 4);
    stage.Add("GRAPE", 5);
    EXPECT_EQ(stage.ItemsOf(1), "Apple=2 | banana=4 | Fig=3 | GRAPE=5 | Pear=1");
}

TEST_F(DataListSorted, TheChoiceIsKeptByItsValueAndTheLabelStaysInStep) {
    stage.Choose(0);
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ListIndex(1), 2);
    EXPECT_EQ(stage.Value(), 1);
    EXPECT_EQ(stage.Text(), "Pear");
    EXPECT_EQ(stage.LabelText(), "Pear");
    stage.Put("Sorted", false);
    EXPECT_EQ(stage.Value(), 1);
    EXPECT_EQ(stage.Text(), "Pear");
}

TEST_F(DataListSorted, WithNothingChosenNothingIsChosenAfterwards) {
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ListIndex(1), -1);
    EXPECT_EQ(stage.ListIndex(0), -1);
}

TEST_F(DataListSorted, OfSeveralItemsOfTheChosenValueTheFirstOneIsChosenAfterwards) {
    stage.Add("Aloe", 1);
    stage.Choose(0);
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(1), "Aloe=1 | Apple=2 | Fig=3 | Pear=1");
    EXPECT_EQ(stage.Text(), "Aloe");
    EXPECT_EQ(stage.LabelText(), "Aloe");
}

TEST_F(DataListSorted, ClicksAreRaisedAgainAfterwards) {
    stage.Put("Sorted", true);
    stage.Reset();
    stage.Choose(0, 1);
    EXPECT_EQ(stage.Happened(), "Click");
    EXPECT_EQ(stage.LabelText(), "Apple");
}

// Kept so that programs which set it twice act the same: the list that the items are to move to is cleared first.
TEST_F(DataListSorted, SettingItToWhatItIsEmptiesTheList) {
    stage.Put("Sorted", true);
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "");
    stage.Add("Lime", 9);
    EXPECT_EQ(stage.ItemsOf(1), "Lime=9");
}

TEST_F(DataListSorted, UnsettingItWhereItIsNotSetEmptiesTheList) {
    stage.Put("Sorted", false);
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "");
}

TEST(DataListMoving, WithIdAndTextThePrefixComesTwice) {
    Stage stage;
    stage.Put("Style", idAndText);
    stage.Add("Red", 7);
    stage.Add("Blue", 5);
    stage.Choose(0);
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(1), "   5 -    5 - Blue=5 |    7 -    7 - Red=7");
    EXPECT_EQ(stage.Value(), 7);
    EXPECT_EQ(stage.Text(), "   7 -    7 - Red");
    EXPECT_EQ(stage.LabelText(), "   7 -    7 - Red");
}

TEST(DataListMoving, WithCountAndTextThePrefixComesTwiceAndTheCounterRises) {
    Stage stage;
    stage.Put("Style", countAndText);
    stage.Add("Red", 50);
    stage.Add("Blue", 70);
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(1), "   3 -    1 - Red=50 |    4 -    2 - Blue=70");
    stage.Put("Sorted", false);
    EXPECT_EQ(stage.ItemsOf(0), "   5 -    3 -    1 - Red=50 |    6 -    4 -    2 - Blue=70");
    stage.Add("Green", 90);
    EXPECT_EQ(GetAt(stage.List(0), "List", 2), Variant("   7 - Green"));
}

TEST(DataListMoving, TheStyleOfTheMomentMakesThePrefix) {
    Stage stage;
    stage.Add("Red", 7);
    stage.Put("Style", idAndText);
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(1), "   7 - Red=7");
    stage.Put("Style", textOnly);
    stage.Put("Sorted", false);
    EXPECT_EQ(stage.ItemsOf(0), "   7 - Red=7");
}

TEST(DataListMoving, WithUniqueValuesItemsOfARepeatedValueStayBehindAndAreGone) {
    Stage stage;
    stage.Add("Red", 5);
    stage.Add("Crimson", 5);
    stage.Add("Blue", 7);
    stage.Put("OnlyUniqueValues", true);
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(0), "");
    EXPECT_EQ(stage.ItemsOf(1), "Blue=7 | Red=5");
}

TEST(DataListMoving, WhatWasInTheOtherListIsCleared) {
    Stage stage;
    stage.Add("Red", 5);
    Call(stage.List(1), "AddItem", {"Left over"});
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.ItemsOf(1), "Red=5");
}

TEST(DataListMoving, RemovingAndFindingGoByTheSortedList) {
    Stage stage;
    stage.Put("Sorted", true);
    stage.Add("Pear", 1);
    stage.Add("Apple", 2);
    stage.Put("Value", 1);
    EXPECT_EQ(stage.ListIndex(1), 1);
    stage.Put("Text", "APPLE");
    EXPECT_EQ(stage.ListIndex(1), 0);
    EXPECT_EQ(stage.Remove(2), Variant(true));
    EXPECT_EQ(stage.ItemsOf(1), "Pear=1");
    stage.Clear();
    EXPECT_EQ(stage.ItemsOf(1), "");
}

TEST(DataListMoving, WithUniqueValuesTheSortedListIsSearchedForTheValue) {
    Stage stage;
    stage.Put("Sorted", true);
    stage.Put("OnlyUniqueValues", true);
    stage.Add("Red", 5);
    EXPECT_EQ(stage.Add("Crimson", 5), "Item with value 5 already exists.");
    EXPECT_EQ(stage.ItemsOf(1), "Red=5");
}

// A load leaves the active list as it is.

TEST(DataListLoadedSorted, TheFirstListStaysActiveUntilSortedIsSet) {
    Loaded loaded{{"Sorted", true}};
    Stage& stage = loaded.stage;
    EXPECT_EQ(stage.Get("Sorted"), Variant(true));
    EXPECT_EQ(stage.Visible(), "list 0");
    stage.Add("Pear", 1);
    stage.Add("Apple", 2);
    EXPECT_EQ(stage.ItemsOf(0), "Pear=1 | Apple=2");
    stage.Put("Sorted", true);
    EXPECT_EQ(stage.Visible(), "list 1");
    EXPECT_EQ(stage.ItemsOf(1), "Apple=2 | Pear=1");
}

// What is to be seen.

struct Locking {
    bool always, locked, sorted;
    const char* visible;
};
void PrintTo(const Locking& row, std::ostream* out) {
    *out << (row.always ? "always " : "") << (row.locked ? "locked " : "") << (row.sorted ? "sorted" : "");
}

class DataListLocking : public testing::TestWithParam<Locking> {};

TEST_P(DataListLocking, ALoadShowsTheLabelOrTheFirstList) {
    const Locking& row = GetParam();
    Loaded loaded{{"LockedAlways", row.always}, {"Locked", row.locked}, {"Sorted", row.sorted}};
    EXPECT_EQ(loaded.stage.Visible(), row.always || row.locked ? "label" : "list 0");
}

TEST_P(DataListLocking, SettingSortedShowsTheLabelOrTheActiveList) {
    const Locking& row = GetParam();
    Stage stage;
    stage.Put("LockedAlways", row.always);
    stage.Put("Locked", row.locked);
    EXPECT_EQ(stage.Visible(), "list 0");
    stage.Put("Sorted", row.sorted);
    EXPECT_EQ(stage.Visible(), row.visible);
}

INSTANTIATE_TEST_SUITE_P(Table, DataListLocking,
                         testing::Values(Locking{true, false, false, "label"}, Locking{true, false, true, "label"},
                                         Locking{true, true, false, "label"}, Locking{true, true, true, "label"},
                                         Locking{false, true, false, "label"}, Locking{false, true, true, "label"},
                                         Locking{false, false, false, "list 0"}, Locking{false, false, true, "list 1"}));

TEST(DataListLocked, UnlockingShowsNothingUntilSortedIsSet) {
    Loaded loaded{{"Locked", true}};
    Stage& stage = loaded.stage;
    stage.Put("Locked", false);
    EXPECT_EQ(stage.Visible(), "label");
    stage.Put("Sorted", false);
    EXPECT_EQ(stage.Visible(), "list 0");
}

TEST(DataListLocked, WhatTheProgramChoosesIsShownAsALabel) {
    Loaded loaded{{"Locked", true}};
    Stage& stage = loaded.stage;
    EXPECT_EQ(stage.LabelText(), "");
    stage.Add("Red", 5);
    stage.Add("Blue", 7);
    stage.Put("Value", 7);
    EXPECT_EQ(stage.LabelText(), "Blue");
    stage.Put("Text", "red");
    EXPECT_EQ(stage.LabelText(), "Red");
    EXPECT_EQ(stage.Value(), 5);
    EXPECT_EQ(stage.Visible(), "label");
    stage.Clear();
    EXPECT_EQ(stage.LabelText(), "");
}

TEST(DataListLocked, ASavedLockShowsInTheNextControlThatIsLoaded) {
    Stage stage;
    stage.Put("LockedAlways", true);
    const frame::MemoryBag saved = stage.Save();
    Stage second(Stage::Options{.saved = &saved});
    EXPECT_EQ(second.Visible(), "label");
}

}  // namespace
}  // namespace tessel::controls
