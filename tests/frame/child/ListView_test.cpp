#include "frame/child/ListView.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <map>
#include <memory>
#include <random>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "frame/ResumeNext.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"
#include "tests/frame/child/ListOwner.h"

namespace tessel::child {
namespace {

using frame::ObjectRef;
using frame::Variant;
using test::ErrorOf;
using test::ListOwner;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
namespace errors = frame::errors;

class Keys final : public KeySet {
  public:
    Keys(std::set<std::string, std::less<>> keys) : keys_(std::move(keys)) {}
    bool Has(std::string_view key) const override { return keys_.contains(key); }
    std::int32_t Count() const override { return static_cast<std::int32_t>(keys_.size()); }
    std::uint32_t Revision() const override { return 0; }

  private:
    std::set<std::string, std::less<>> keys_;
};

/// Captured rows, whose sub-item n reads "<name>/n"; counts how often it is asked.
class Records final : public RowSource {
  public:
    std::string Text(RowId row, int column) const override {
        if (fails || failsAfter == 0) throw frame::ControlError(errors::internal);
        if (failsAfter > 0) --failsAfter;
        ++asked;
        const std::string& name = names.at(row);
        return column == 0 ? name : name + "/" + frame::Decimal(column);
    }
    std::map<RowId, std::string> names;
    mutable int asked = 0;
    bool fails = false;
    mutable int failsAfter = -1;  // so many texts; below 0 never
};

/// Follows a list as a screen does, and keeps its texts.
class Screen final : public frame::Peer {
  public:
    explicit Screen(ListView& list) : list_(list) {}
    void Update() override {
        const std::vector<RowChange> changes = list_.Rows().TakeChanges();
        for (const RowChange& change : changes) Apply(change);
        for (std::size_t row = 0; row < texts.size(); ++row)
            if (texts[row] == toRead) texts[row] = list_.ListItems.Item(static_cast<std::int32_t>(row + 1))->Text();
        seen.push_back(changes);
    }
    std::vector<std::string> texts;
    std::vector<std::vector<RowChange>> seen;

  private:
    static constexpr const char* toRead = "(to be read)";

    void Apply(const RowChange& change) {
        const auto first = texts.begin() + change.first;
        switch (change.kind) {
            case RowChange::Kind::Inserted:
                texts.insert(first, change.count, toRead);
                break;
            case RowChange::Kind::Removed:
                texts.erase(first, first + change.count);
                break;
            case RowChange::Kind::Changed:
                std::fill(first, first + change.count, toRead);
                break;
            case RowChange::Kind::Reordered:
                EXPECT_EQ(change.count, texts.size());
                std::fill(texts.begin(), texts.end(), toRead);
                break;
            case RowChange::Kind::Reset:
                texts.assign(list_.Rows().Count(), toRead);
                break;
        }
    }

    ListView& list_;
};

class ListViewTest : public testing::Test {
  protected:
    ListViewTest() : owner(&host.Create<ListOwner>("FileView1")) {}

    ListView& List() { return owner->list; }
    ListRows& Rows() { return List().Rows(); }
    ListItemRef Item(int index) { return List().ListItems.Item(index); }
    void Add(std::initializer_list<const char*> texts) {
        for (const char* text : texts) List().ListItems.Add(text);
    }
    /// Adds a row from the source, with sub-items.
    RowId Capture(const std::string& name) {
        records.names[Rows().NextId()] = name;
        const RowId row = Rows().AddFromSource();
        Rows().Fill(row);
        return row;
    }
    /// The texts in their order; "*" marks a selected row.
    std::string Texts() {
        std::string texts;
        for (int index = 1; index <= List().ListItems.Count(); ++index)
            texts += (index > 1 ? " " : "") + Item(index)->Text() + (Item(index)->Selected() ? "*" : "");
        return texts;
    }
    Screen& Show() {
        auto screen = std::make_unique<Screen>(List());
        Screen& shown = *screen;
        List().AttachPeer(std::move(screen));
        host.Frame().Flush();
        shown.seen.clear();
        return shown;
    }

    headless::HeadlessHost host;
    Records records;
    ListOwner* owner;
};

using ListItemsTest = ListViewTest;
using ListSortTest = ListViewTest;
using ListSourceTest = ListViewTest;
using ListPeerTest = ListViewTest;

TEST_F(ListItemsTest, AddGivesTheIndexFromOne) {
    EXPECT_EQ(List().ListItems.Add("a"), 1);
    EXPECT_EQ(List().ListItems.Add("b"), 2);
    EXPECT_EQ(List().ListItems.Count(), 2);
    EXPECT_EQ(Texts(), "a b");
}

TEST_F(ListItemsTest, AnIndexOutsideIsError35600) {
    Add({"a"});
    for (const int index : {-1, 0, 2}) {
        EXPECT_EQ(ErrorOf([&] { Item(index); }), errors::indexOutOfBounds) << index;
        EXPECT_EQ(ErrorOf([&] { List().ListItems.Remove(index); }), errors::indexOutOfBounds) << index;
    }
    EXPECT_EQ(Texts(), "a");
}

TEST_F(ListItemsTest, RemoveClosesTheGapInTheIndexes) {
    Add({"a", "b", "c"});
    const ListItemRef last = Item(3);
    List().ListItems.Remove(2);
    EXPECT_EQ(Texts(), "a c");
    EXPECT_EQ(last->Index(), 2);
}

TEST_F(ListItemsTest, ARowThatHasGoneFailsWithError91EvenWhenItsPlaceIsTakenAgain) {
    Add({"a"});
    const ListItemRef gone = Item(1);
    List().ListItems.Remove(1);
    Add({"b"});
    EXPECT_EQ(ErrorOf([&] { gone->Text(); }), errors::objectGone);
    EXPECT_EQ(ErrorOf([&] { gone->SetSelected(true); }), errors::objectGone);
    EXPECT_EQ(ErrorOf([&] { gone->Height(); }), errors::objectGone);
    EXPECT_EQ(gone->Path(), "");
    EXPECT_EQ(Item(1)->Text(), "b");
}

TEST_F(ListItemsTest, ClearEndsEveryRow) {
    Add({"a", "b"});
    const ListItemRef gone = Item(1);
    List().ListItems.Clear();
    Add({"c"});
    EXPECT_EQ(ErrorOf([&] { gone->Text(); }), errors::objectGone);
    EXPECT_EQ(Texts(), "c");
}

TEST_F(ListItemsTest, AnItemOutlivesItsListAndThenFailsWithError91) {
    ListOwner& other = host.Create<ListOwner>("FileView2");
    other.list.ListItems.Add("a");
    const ListItemRef item = other.list.ListItems.Item(1);
    host.Destroy(other);
    EXPECT_EQ(ErrorOf([&] { item->Text(); }), errors::objectGone);
}

TEST_F(ListItemsTest, ItemsOfTheSameRowAreEqual) {
    Add({"a", "b"});
    EXPECT_EQ(ObjectRef(Item(1)), ObjectRef(Item(1)));
    EXPECT_FALSE(ObjectRef(Item(1)) == ObjectRef(Item(2)));
}

TEST_F(ListItemsTest, SubItemsCountFromOneAndStartEmpty) {
    Add({"a"});
    Item(1)->SetSubItems(12, "z");
    EXPECT_EQ(Item(1)->SubItems(12), "z");
    EXPECT_EQ(Item(1)->SubItems(1), "");
    for (const int index : {-1, 0, 32768}) EXPECT_EQ(ErrorOf([&] { Item(1)->SetSubItems(index, "x"); }), errors::invalidValue);
}

TEST_F(ListItemsTest, TagAndGhostedBelongToTheRow) {
    Add({"a", "b"});
    Item(1)->SetTag("t");
    Item(1)->SetGhosted(true);
    EXPECT_EQ(Item(1)->Tag(), Variant("t"));
    EXPECT_TRUE(Item(1)->Ghosted());
    EXPECT_TRUE(Item(2)->Tag().IsEmpty());
    EXPECT_FALSE(Item(2)->Ghosted());
    List().ListItems.Remove(1);
    Add({"c"});
    EXPECT_TRUE(Item(2)->Tag().IsEmpty());
    EXPECT_FALSE(Item(2)->Ghosted());
}

TEST_F(ListItemsTest, AnIconKeyThatTheImagesLackIsError35601AndChangesNothing) {
    const Keys large({"txt"});
    const Keys small({"txt", "exe"});
    Rows().BindIcons(IconSize::Large, &large);
    Rows().BindIcons(IconSize::Small, &small);
    Add({"a"});
    EXPECT_FALSE(Item(1)->SetIcon("txt").Failed());
    EXPECT_EQ(Item(1)->SetIcon("exe").Number(), errors::elementNotFound);
    EXPECT_FALSE(Item(1)->SetSmallIcon("exe").Failed());
    EXPECT_EQ(Item(1)->Icon(), Variant("txt"));
    EXPECT_EQ(Item(1)->SmallIcon(), Variant("exe"));
}

TEST_F(ListItemsTest, AnIconMayBeAnIndexAndIsTakenAwayByZeroAndByAnEmptyValue) {
    const Keys keys({"txt", "exe"});
    Rows().BindIcons(IconSize::Large, &keys);
    Add({"a"});
    EXPECT_FALSE(Item(1)->SetIcon(2).Failed());
    EXPECT_EQ(Item(1)->SetIcon(3).Number(), errors::indexOutOfBounds);
    EXPECT_EQ(Item(1)->SetIcon(-1).Number(), errors::indexOutOfBounds);
    EXPECT_EQ(Item(1)->Icon(), Variant(2));
    EXPECT_FALSE(Item(1)->SetIcon(0).Failed());
    EXPECT_TRUE(Item(1)->Icon().IsEmpty());
    EXPECT_FALSE(Item(1)->SetIcon("txt").Failed());
    EXPECT_FALSE(Item(1)->SetIcon(Variant()).Failed());
    EXPECT_TRUE(Item(1)->Icon().IsEmpty());
}

TEST_F(ListItemsTest, TheEmptyKeyIsLackingInEveryImageList) {
    const Keys keys({"txt"});
    Rows().BindIcons(IconSize::Large, &keys);
    Add({"a"});
    EXPECT_FALSE(Item(1)->SetIcon("txt").Failed());
    EXPECT_EQ(Item(1)->SetIcon("").Number(), errors::elementNotFound);
    EXPECT_EQ(Item(1)->Icon(), Variant("txt"));
}

TEST_F(ListItemsTest, WithoutImagesEveryKeyIsLacking) {
    Add({"a"});
    EXPECT_EQ(Item(1)->SetSmallIcon("txt").Number(), errors::elementNotFound);
}

TEST_F(ListItemsTest, ACacheMissIsSeenInResumeNextMode) {
    Add({"a"});
    frame::ResumeNext next;
    next([&] { return Item(1)->SetSmallIcon("txt"); });
    EXPECT_EQ(next.Number(), errors::elementNotFound);
}

TEST_F(ListItemsTest, EverythingIsReachedByName) {
    frame::Object& list = *owner->Inner("listfiles");
    frame::Object& items = *list.Get("ListItems").ToObject();
    Variant text[] = {"readme"};
    EXPECT_EQ(items.Call("Add", text), Variant(1));
    EXPECT_EQ(items.Get("Count"), Variant(1));
    Variant one[] = {1};
    const ObjectRef item = items.Get("item", one).ToObject();
    EXPECT_EQ(item->Path(), "FileView1.ListFiles.ListItems(1)");
    Variant ten[] = {10};
    item->Put("SubItems", "README", ten);
    EXPECT_EQ(item->Get("SubItems", ten), Variant("README"));
    EXPECT_EQ(item->Get("Index"), Variant(1));
    EXPECT_EQ(ErrorOf([&] { item->Put("SmallIcon", "txt"); }), errors::elementNotFound);
    list.Put("SelectedItem", item);
    EXPECT_EQ(list.Get("SelectedItem"), Variant(item));
    EXPECT_EQ(item->Get("Selected"), Variant(true));
    EXPECT_EQ(list.Get("SortOrder"), Variant(0));
    items.Call("Clear");
    EXPECT_TRUE(list.Get("SelectedItem").ToObject().IsNothing());
    EXPECT_EQ(ErrorOf([&] { item->Get("Text"); }), errors::objectGone);
}

TEST_F(ListViewTest, WithoutMultiSelectOneRowIsSelected) {
    Add({"a", "b", "c"});
    Item(1)->SetSelected(true);
    Item(3)->SetSelected(true);
    EXPECT_EQ(Texts(), "a b c*");
    EXPECT_EQ(List().SelectedItem()->Text(), "c");
}

TEST_F(ListViewTest, WithMultiSelectRowsAreSelectedByThemselves) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c"});
    Item(1)->SetSelected(true);
    Item(3)->SetSelected(true);
    EXPECT_EQ(Texts(), "a* b c*");
    Item(3)->SetSelected(false);
    EXPECT_EQ(Texts(), "a* b c");
    EXPECT_EQ(List().SelectedItem()->Text(), "c");
}

TEST_F(ListViewTest, SelectedItemIsNothingOnceItsRowHasGone) {
    Add({"a", "b"});
    EXPECT_EQ(List().SelectedItem(), nullptr);
    List().SetSelectedItem(Item(2));
    EXPECT_EQ(Texts(), "a b*");
    List().ListItems.Remove(2);
    EXPECT_EQ(List().SelectedItem(), nullptr);
    EXPECT_EQ(Rows().SelectedCount(), 0u);
}

TEST_F(ListViewTest, SelectedItemTakesNothingButRowsOfItsOwn) {
    ListView& otherList = host.Create<ListOwner>("FileView2").list;
    otherList.ListItems.Add("x");
    Add({"a", "b"});
    const ListItemRef gone = Item(2);
    List().ListItems.Remove(2);
    List().SetSelectedItem(Item(1));
    EXPECT_EQ(ErrorOf([&] { List().SetSelectedItem(otherList.ListItems.Item(1)); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { List().SetSelectedItem(gone); }), errors::objectGone);
    EXPECT_EQ(List().SelectedItem()->Text(), "a");
    List().SetSelectedItem(nullptr);
    EXPECT_EQ(List().SelectedItem(), nullptr);
    EXPECT_EQ(Texts(), "a*");
}

TEST_F(ListViewTest, AClickedRowIsTheOnlyOneSelectedBeforeTheEvent) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c"});
    Item(1)->SetSelected(true);
    List().ItemClickInput(2);
    EXPECT_EQ(owner->heard, "ItemClick b 2");
    EXPECT_EQ(Texts(), "a b* c");
}

TEST_F(ListViewTest, AClickBesideTheRowsIsReportedAndChangesNothing) {
    Add({"a"});
    List().ItemClickInput(2);
    ASSERT_EQ(host.errors.reports.size(), 1u);
    EXPECT_EQ(host.errors.reports[0].error.Number(), errors::indexOutOfBounds);
    EXPECT_EQ(host.errors.reports[0].where, "FileView1.ListFiles.ItemClick");
    EXPECT_EQ(owner->heard, "");
    EXPECT_EQ(Texts(), "a");
}

TEST_F(ListViewTest, InputsAreReachedByName) {
    const auto fire = [&](const char* name, std::vector<Variant> arguments) {
        List().Table().FindInput(name)->call(List(), arguments);
    };
    fire("MouseDown", {Variant(std::int16_t{2}), Variant(0), Variant(10), Variant(400)});
    EXPECT_EQ(std::exchange(owner->heard, ""), "MouseDown 2 400");
    fire("KeyDown", {Variant(113), Variant(1)});
    EXPECT_EQ(std::exchange(owner->heard, ""), "KeyDown 113 1");
    fire("DblClick", {});
    EXPECT_EQ(owner->heard, "DblClick");
}

TEST_F(ListViewTest, FindItemTakesTheFirstRowInTheOrderWithoutRegardToCase) {
    Add({"b", "A.TXT", "a.txt"});
    EXPECT_EQ(List().FindItem("a.Txt")->Index(), 2);
    List().ListItems.Remove(2);
    EXPECT_EQ(List().FindItem("a.Txt")->Text(), "a.txt");
    EXPECT_EQ(List().FindItem("a"), nullptr);
}

TEST_F(ListViewTest, FindItemFollowsEveryChangeAsALinearSearchDoes) {
    std::mt19937 numbers(3);
    const auto below = [&](int end) { return std::uniform_int_distribution(0, end - 1)(numbers); };
    const auto name = [&] { return std::string(1, "aAbBcCdDeE"[below(10)]) + frame::Decimal(below(5)); };
    for (int step = 0; step < 3'000; ++step) {
        const int count = List().ListItems.Count();
        const int kind = below(10);
        if (kind < 5 || count == 0)
            List().ListItems.Add(name());
        else if (kind < 7)
            List().ListItems.Remove(1 + below(count));
        else if (kind < 9)
            Item(1 + below(count))->SetText(name());
        else
            List().SetSorted(!List().Sorted());
        if (count > 40) List().ListItems.Clear();

        const std::string wanted = name();
        int expected = 0;
        for (int index = List().ListItems.Count(); index > 0; --index)
            if (frame::EqualsNoCase(Item(index)->Text(), wanted)) expected = index;
        const ListItemRef found = List().FindItem(wanted);
        ASSERT_EQ(found ? found->Index() : 0, expected) << "step " << step;
    }
}

TEST_F(ListViewTest, HitTestTakesTheRowByItsHeightBelowTheHeader) {
    Add({"a", "b"});
    EXPECT_EQ(List().HitTest(0, 299), nullptr);
    EXPECT_EQ(List().HitTest(0, 300)->Text(), "a");
    EXPECT_EQ(List().HitTest(99'999, 554)->Text(), "a");
    EXPECT_EQ(List().HitTest(0, 555)->Text(), "b");
    EXPECT_EQ(List().HitTest(0, 810), nullptr);
    for (const float y : {-1.0f, 1e30f, -1e30f, std::numeric_limits<float>::quiet_NaN()}) EXPECT_EQ(List().HitTest(0, y), nullptr);
}

TEST_F(ListViewTest, WithoutAHeaderTheRowsBeginAtTheTop) {
    Add({"a", "b"});
    List().SetHideColumnHeaders(true);
    EXPECT_EQ(List().HitTest(0, 0)->Text(), "a");
    List().SetHideColumnHeaders(false);
    List().SetView(ListViewConstants::List);
    EXPECT_EQ(List().HitTest(0, 255)->Text(), "b");
}

TEST_F(ListViewTest, TopIndexScrollsTheRows) {
    EXPECT_EQ(List().TopIndex(), 0);
    EXPECT_EQ(List().GetFirstVisible(), nullptr);
    Add({"a", "b", "c", "d"});
    EXPECT_EQ(List().TopIndex(), 1);
    List().SetTopIndex(3);
    EXPECT_EQ(List().GetFirstVisible()->Text(), "c");
    EXPECT_EQ(List().HitTest(0, 300)->Text(), "c");
    EXPECT_EQ(List().HitTest(0, 810), nullptr);
    EXPECT_EQ(Item(3)->Top(), 300);
    EXPECT_EQ(Item(4)->Top(), 555);
    EXPECT_EQ(Item(1)->Top(), 300 - 2 * 255);
    EXPECT_EQ(Item(1)->Height(), 255);
    EXPECT_EQ(ErrorOf([&] { List().SetTopIndex(5); }), errors::indexOutOfBounds);
    List().ListItems.Remove(4);
    List().ListItems.Remove(3);
    EXPECT_EQ(List().TopIndex(), 2);
}

TEST_F(ListSourceTest, TextsOnDemandReadAsTextsThatWereSet) {
    Rows().SetSource(&records);
    Capture("a.txt");
    Add({"eager"});
    EXPECT_EQ(records.asked, 0);
    EXPECT_EQ(Item(1)->Text(), "a.txt");
    EXPECT_EQ(Item(1)->SubItems(7), "a.txt/7");
    EXPECT_EQ(Item(2)->SubItems(7), "");
}

TEST_F(ListSourceTest, ARowHasNoSubItemsBeforeItIsFilled) {
    Rows().SetSource(&records);
    records.names[Rows().NextId()] = "a.txt";
    const RowId row = Rows().AddFromSource();
    EXPECT_EQ(Item(1)->Text(), "a.txt");
    EXPECT_EQ(Item(1)->SubItems(1), "");
    Rows().Fill(row);
    EXPECT_EQ(Item(1)->SubItems(1), "a.txt/1");
}

TEST_F(ListSourceTest, WhatTheHostSetsWinsAndGoesWithItsRow) {
    Rows().SetSource(&records);
    Capture("a.txt");
    Item(1)->SetText("shown");
    Item(1)->SetSubItems(10, "");
    EXPECT_EQ(Item(1)->Text(), "shown");
    EXPECT_EQ(Item(1)->SubItems(10), "");
    EXPECT_EQ(Item(1)->SubItems(9), "a.txt/9");
    EXPECT_EQ(List().FindItem("a.txt"), nullptr);
    List().ListItems.Remove(1);
    Capture("b.txt");
    EXPECT_EQ(Item(1)->Text(), "b.txt");
    EXPECT_EQ(Item(1)->SubItems(10), "b.txt/10");
}

TEST_F(ListSourceTest, ASourceThatFailsLeavesTheRowsWhole) {
    Rows().SetSource(&records);
    for (const char* name : {"d", "b", "c"}) Capture(name);
    List().SetSorted(true);
    records.fails = true;
    EXPECT_EQ(ErrorOf([&] { Capture("a"); }), errors::internal);
    EXPECT_EQ(ErrorOf([&] { List().SetSortOrder(ListSortOrderConstants::Descending); }), errors::internal);
    records.fails = false;
    EXPECT_EQ(Texts(), "b c d");
    Capture("a");
    EXPECT_EQ(Texts(), "d c b a");
}

TEST_F(ListSourceTest, ASearchThatASourceFailsLeavesTheRowsWhole) {
    Rows().SetSource(&records);
    for (const char* name : {"a", "b", "c"}) Capture(name);
    records.failsAfter = 2;
    EXPECT_EQ(ErrorOf([&] { List().FindItem("c"); }), errors::internal);
    records.failsAfter = -1;
    List().ListItems.Remove(3);
    List().ListItems.Remove(1);
    EXPECT_EQ(List().FindItem("b")->Index(), 1);
    EXPECT_EQ(List().FindItem("c"), nullptr);
}

TEST_F(ListSourceTest, ARowThatASourceKeptFromSettlingSettlesLater) {
    Rows().SetSource(&records);
    List().SetSorted(true);
    for (int row = 10; row < 40; ++row) Capture(frame::Decimal(row));
    Item(1)->SetText("99");
    records.fails = true;
    EXPECT_EQ(ErrorOf([&] { List().SetSorted(true); }), errors::internal);
    records.fails = false;
    EXPECT_EQ(Item(1)->Text(), "99");
    List().SetSorted(true);
    EXPECT_EQ(Item(30)->Text(), "99");
}

TEST_F(ListSortTest, UnsortedRowsStandAsTheyWereAdded) {
    Add({"b", "c", "a"});
    List().SetSortOrder(ListSortOrderConstants::Descending);
    List().SetSortKey(0);
    EXPECT_EQ(Texts(), "b c a");
}

TEST_F(ListSortTest, SortedPutsTheRowsInOrderWithoutRegardToCase) {
    Add({"b", "C", "a"});
    List().SetSorted(true);
    EXPECT_EQ(Texts(), "a b C");
    List().SetSortOrder(ListSortOrderConstants::Descending);
    EXPECT_EQ(Texts(), "C b a");
    List().SetSorted(false);
    EXPECT_EQ(Texts(), "C b a");
}

TEST_F(ListSortTest, AddFindsThePlaceBehindItsEquals) {
    List().SetSorted(true);
    EXPECT_EQ(List().ListItems.Add("b"), 1);
    EXPECT_EQ(List().ListItems.Add("a"), 1);
    EXPECT_EQ(List().ListItems.Add("c"), 3);
    EXPECT_EQ(List().ListItems.Add("B"), 3);
    EXPECT_EQ(List().ListItems.Add("A"), 2);
    EXPECT_EQ(Texts(), "a A b B c");
}

TEST_F(ListSortTest, EqualRowsKeepTheirOrderBothWays) {
    Add({"b", "A", "B", "a"});
    List().SetSorted(true);
    EXPECT_EQ(Texts(), "A a b B");
    List().SetSortOrder(ListSortOrderConstants::Descending);
    EXPECT_EQ(Texts(), "b B A a");
}

TEST_F(ListSortTest, SettingASubItemMovesNothingUntilTheNextAdd) {
    List().SetSortKey(12);
    List().SetSorted(true);
    Add({"b"});
    Item(1)->SetSubItems(12, "2");
    Add({"a"});
    EXPECT_EQ(Texts(), "a b");
    Item(1)->SetSubItems(12, "9");
    EXPECT_EQ(Texts(), "a b");
    Add({"new"});
    EXPECT_EQ(Texts(), "new b a");
}

TEST_F(ListSortTest, EachOfTheThreeSettingsSettlesEvenWhenItStays) {
    Add({"a", "b"});
    List().SetSorted(true);
    Item(1)->SetText("x");
    EXPECT_EQ(Texts(), "x b");
    List().SetSorted(true);
    EXPECT_EQ(Texts(), "b x");
    Item(1)->SetText("y");
    List().SetSortOrder(ListSortOrderConstants::Ascending);
    EXPECT_EQ(Texts(), "x y");
    Item(1)->SetText("z");
    List().SetSortKey(0);
    EXPECT_EQ(Texts(), "y z");
}

TEST_F(ListSortTest, ANewKeySortsByItsColumn) {
    Add({"a", "b", "c"});
    for (int index = 1; index <= 3; ++index) Item(index)->SetSubItems(1, frame::Decimal(4 - index));
    List().SetSorted(true);
    List().SetSortKey(1);
    EXPECT_EQ(Texts(), "c b a");
    EXPECT_EQ(ErrorOf([&] { List().SetSortKey(-1); }), errors::invalidValue);
    EXPECT_EQ(List().SortKey(), 1);
}

TEST_F(ListSortTest, ARowThatLeavesBeforeItSettlesIsForgotten) {
    List().SetSorted(true);
    for (int row = 0; row < 40; ++row) Add({"m"});
    Item(3)->SetText("z");
    List().ListItems.Remove(3);
    Add({"a"});
    Item(1)->SetText("q");
    Add({"b"});
    EXPECT_EQ(Item(1)->Text(), "b");
    EXPECT_EQ(Item(41)->Text(), "q");
}

TEST_F(ListSortTest, ASortedAddAsksForFewTexts) {
    Rows().SetSource(&records);
    List().SetSortKey(12);
    List().SetSorted(true);
    std::mt19937 numbers(5);
    constexpr int rows = 4'000;
    for (int row = 0; row < rows; ++row) {
        records.asked = 0;
        Capture(frame::Decimal(std::uniform_int_distribution(0, 1'000'000)(numbers)));
        EXPECT_LE(records.asked, 2 * (12 + 2) + 1);
    }
    std::string last;
    for (int index = 2; index <= rows; ++index) {  // the row added last stands first: its key was still empty
        const std::string key = Item(index)->SubItems(12);
        ASSERT_LE(frame::CompareNoCase(last, key), 0);
        last = key;
    }
}

/// The order that a list keeps, by the plain rule: all rows are sorted stably at each settling.
class PlainList {
  public:
    struct Row {
        std::string name, key;
    };
    void Settle() {
        if (!sorted) return;
        std::stable_sort(rows.begin(), rows.end(), [&](const Row& a, const Row& b) {
            const int order = frame::CompareNoCase(a.key, b.key);
            return descending ? order > 0 : order < 0;
        });
    }
    void Add(const std::string& name) {
        rows.push_back({name, ""});
        Settle();
    }
    std::vector<Row> rows;
    bool sorted = false, descending = false;
};

TEST_F(ListSortTest, SettlesAsAStableSortOfAllRowsDoes) {
    std::mt19937 numbers(11);
    const auto below = [&](int end) { return std::uniform_int_distribution(0, end - 1)(numbers); };
    PlainList plain;
    List().SetSortKey(1);
    const Screen& screen = Show();
    for (int step = 0; step < 6'000; ++step) {
        const int count = List().ListItems.Count();
        const int kind = below(100);
        if (kind < 30 || count == 0) {
            const std::string name = frame::Decimal(step);
            plain.Add(name);
            List().ListItems.Add(name);
        } else if (kind < 80) {
            const int index = below(count);
            const std::string key(1, "aAbBcCdDeEfF"[below(12)]);
            plain.rows[static_cast<std::size_t>(index)].key = key;
            Item(index + 1)->SetSubItems(1, key);
        } else if (kind < 95) {
            const int index = below(count);
            plain.rows.erase(plain.rows.begin() + index);
            List().ListItems.Remove(index + 1);
        } else if (kind < 98) {
            plain.sorted = below(4) != 0;
            plain.Settle();
            List().SetSorted(plain.sorted);
        } else {
            plain.descending = below(2) == 0;
            plain.Settle();
            List().SetSortOrder(plain.descending ? ListSortOrderConstants::Descending : ListSortOrderConstants::Ascending);
        }
        std::vector<std::string> names;
        for (const auto& row : plain.rows) names.push_back(row.name);
        for (std::size_t row = 0; row < names.size(); ++row)
            ASSERT_EQ(Item(static_cast<std::int32_t>(row + 1))->Text(), names[row]) << "step " << step;
        if (below(20) != 0) continue;
        plain.Settle();
        names.clear();
        for (const auto& row : plain.rows) names.push_back(row.name);
        host.Frame().Flush();
        ASSERT_EQ(screen.texts, names) << "step " << step;
    }
}

TEST_F(ListPeerTest, APeerBeginsWithTheWholeList) {
    Add({"a", "b"});
    EXPECT_THAT(Show().texts, ElementsAre("a", "b"));
}

TEST_F(ListPeerTest, AThousandAddsAreOneUpdateWithOneStep) {
    const Screen& screen = Show();
    Rows().SetSource(&records);
    host.Frame().Flush();
    const std::size_t before = screen.seen.size();
    for (int row = 0; row < 1'000; ++row) {
        const RowId id = Capture(frame::Decimal(row));
        Rows().SetGhosted(id, true);
    }
    host.Frame().Flush();
    ASSERT_THAT(screen.seen, SizeIs(before + 1));
    EXPECT_THAT(screen.seen.back(), ElementsAre(RowChange{RowChange::Kind::Inserted, 0, 1'000}));
    EXPECT_EQ(screen.texts.back(), "999");
}

TEST_F(ListPeerTest, ARowSettlesBeforeItIsShown) {
    const Screen& screen = Show();
    List().SetSorted(true);
    Add({"a", "b", "c", "d", "e", "f", "g", "h", "i", "j"});
    host.Frame().Flush();
    Item(2)->SetText("m");
    host.Frame().Flush();
    EXPECT_EQ(screen.texts.back(), "m");
    EXPECT_EQ(Texts(), "a c d e f g h i j m");
    EXPECT_THAT(screen.seen.back(), SizeIs(3));  // the row has changed, left and come back
}

TEST_F(ListPeerTest, ASortIsOneStepThatKeepsTheRows) {
    Add({"b", "a", "c"});
    const Screen& screen = Show();
    Item(1)->SetText("z");
    List().SetSorted(true);
    Item(1)->SetGhosted(true);
    List().SetSortOrder(ListSortOrderConstants::Descending);
    host.Frame().Flush();
    ASSERT_THAT(screen.seen, SizeIs(1));
    EXPECT_THAT(screen.seen.back(), ElementsAre(RowChange{RowChange::Kind::Reordered, 0, 3}));
    EXPECT_THAT(screen.texts, ElementsAre("z", "c", "a"));
}

TEST_F(ListPeerTest, AClickIsShownWhenItsInputEnds) {
    Add({"a", "b"});
    const Screen& screen = Show();
    List().ItemClickInput(2);
    ASSERT_THAT(screen.seen, SizeIs(1));
    EXPECT_THAT(screen.seen.back(), ElementsAre(RowChange{RowChange::Kind::Changed, 1, 1}));
}

TEST_F(ListPeerTest, WithoutAPeerNothingIsJournalled) {
    List().AttachPeer(nullptr);  // the headless host has one that logs edits
    Add({"a"});
    EXPECT_THAT(Rows().TakeChanges(), IsEmpty());
    Show();
    List().AttachPeer(nullptr);
    Add({"b", "c"});
    EXPECT_THAT(Rows().TakeChanges(), IsEmpty());
    EXPECT_THAT(Show().texts, ElementsAre("a", "b", "c"));
}

}  // namespace
}  // namespace tessel::child
