#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <random>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "frame/child/ListView.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"
#include "tests/frame/child/ListOwner.h"

namespace tessel::child {
namespace {

using frame::ControlError;
using frame::ObjectRef;
using frame::Variant;
using test::ErrorOf;
using test::ListOwner;
namespace errors = frame::errors;

constexpr std::int16_t shiftKey = 1, ctrlKey = 2;

class ListInputTest : public testing::Test {
  protected:
    ListInputTest() : owner(&host.Create<ListOwner>("FileView1")) {}

    ListView& List() { return owner->list; }
    ListRows& Rows() { return List().Rows(); }
    ListItemRef Item(int index) { return List().ListItems.Item(index); }
    void Add(std::initializer_list<const char*> texts) {
        for (const char* text : texts) List().ListItems.Add(text);
    }
    /// The texts in their order; "*" marks a selected row, "<" the focus row.
    std::string Texts() {
        std::string texts;
        const auto focus = List().FocusRow();
        for (int index = 1; index <= List().ListItems.Count(); ++index) {
            const RowId row = List().ListItems.At(index);
            texts += (index > 1 ? " " : "") + Item(index)->Text() + (Rows().Selected(row) ? "*" : "") + (focus == row ? "<" : "");
        }
        return texts;
    }
    std::vector<Variant> Fire(const char* event, std::vector<Variant> arguments) {
        List().Table().FindInput(event)->call(List(), arguments);
        return arguments;
    }
    std::string Error() {
        std::string text;
        for (const auto& report : std::exchange(host.errors.reports, {}))
            text += report.where + " " + frame::Decimal(report.error.Number());
        return text;
    }

    headless::HeadlessHost host;
    ListOwner* owner;
};

using ListSelectionTest = ListInputTest;
using ListEditTest = ListInputTest;
using ListScrollTest = ListInputTest;
using ListDragTest = ListInputTest;
using ListIconsTest = ListInputTest;
using ListFindTest = ListInputTest;
using ListLookTest = ListInputTest;

TEST_F(ListSelectionTest, AClickWithoutMultiSelectSelectsTheRowAloneWhateverIsHeld) {
    Add({"a", "b", "c"});
    for (const std::int16_t shift : {0, 1, 2, 3, 4}) {
        List().ItemClickInput(1, 0);
        List().ItemClickInput(3, shift);
        EXPECT_EQ(Texts(), "a b c*<") << shift;
    }
}

TEST_F(ListSelectionTest, CtrlTurnsARowRoundAndShiftSelectsFromTheLastSuchRow) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c", "d", "e"});
    List().ItemClickInput(2, 0);
    List().ItemClickInput(4, shiftKey);
    EXPECT_EQ(Texts(), "a b* c* d*< e");
    List().ItemClickInput(1, shiftKey);
    EXPECT_EQ(Texts(), "a*< b* c d e");
    List().ItemClickInput(4, ctrlKey);
    EXPECT_EQ(Texts(), "a* b* c d*< e");
    List().ItemClickInput(5, shiftKey | ctrlKey);
    EXPECT_EQ(Texts(), "a* b* c d* e*<");
    EXPECT_EQ(List().SelectedItem()->Text(), "e");
    List().ItemClickInput(5, ctrlKey);
    EXPECT_EQ(Texts(), "a* b* c d* e<");
    EXPECT_EQ(List().SelectedItem()->Text(), "e");
    List().ItemClickInput(3);
    EXPECT_EQ(Texts(), "a b c*< d e");
}

TEST_F(ListSelectionTest, ItemClickComesAfterTheSelectionAndTheKeyboardRaisesNone) {
    Add({"a", "b"});
    List().ItemClickInput(2, 0);
    EXPECT_EQ(owner->Heard(), "ItemClick b 2");
    List().SelectInput(1, ListSelectConstants::Only);
    EXPECT_EQ(owner->Heard(), "");
    EXPECT_EQ(Texts(), "a*< b");
}

TEST_F(ListSelectionTest, AllAndNoneLeaveTheFocusWhereItIs) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c"});
    List().ItemClickInput(2);
    List().SelectAllInput();
    EXPECT_EQ(Texts(), "a* b*< c*");
    EXPECT_EQ(Rows().SelectedCount(), 3u);
    List().SelectNoneInput();
    EXPECT_EQ(Texts(), "a b< c");
    EXPECT_EQ(Rows().SelectedCount(), 0u);
    List().SetMultiSelect(false);
    List().SelectAllInput();
    EXPECT_EQ(Texts(), "a b< c");
}

TEST_F(ListSelectionTest, TheFocusMovesByItselfAndTheSelectedItemStays) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c"});
    List().ItemClickInput(1);
    List().FocusInput(3);
    EXPECT_EQ(Texts(), "a* b c<");
    EXPECT_EQ(List().SelectedItem()->Text(), "a");
    List().SelectInput(3, ListSelectConstants::Toggle);
    EXPECT_EQ(Texts(), "a* b c*<");
    EXPECT_EQ(List().SelectedItem()->Text(), "c");
}

TEST_F(ListSelectionTest, ARangeBeginsAtTheRowThatTheProgramSelected) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c", "d"});
    Item(2)->SetSelected(true);
    List().SelectInput(4, ListSelectConstants::Range);
    EXPECT_EQ(Texts(), "a b* c* d*<");
    List().ListItems.Remove(2);
    List().SelectInput(1, ListSelectConstants::Range);
    EXPECT_EQ(Texts(), "a*< c d");
}

TEST_F(ListSelectionTest, ARubberBandReportsRangesAndWhatLiesOutsideIsPassedOver) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c", "d"});
    List().FocusInput(2);
    const RowRange selected[] = {{0, 2}, {3, 99}}, deselected[] = {{0, 1}, {77, 5}};
    List().SelectionInput(selected, deselected);
    EXPECT_EQ(Texts(), "a b*< c d*");
    EXPECT_EQ(List().SelectedItem()->Text(), "b");
    EXPECT_EQ(Rows().SelectedCount(), 2u);
}

TEST_F(ListSelectionTest, SelectionAndFocusStayWithTheirRowsWhenTheOrderChanges) {
    List().SetMultiSelect(true);
    Add({"c", "b", "a"});
    List().ItemClickInput(1, 0);
    List().ItemClickInput(3, ctrlKey);
    List().SetSorted(true);
    EXPECT_EQ(Texts(), "a*< b c*");
    Add({"aa"});
    EXPECT_EQ(Texts(), "a*< aa b c*");
}

TEST_F(ListSelectionTest, AnyOrderOfSelectingEndsAsOnAPlainSet) {
    List().SetMultiSelect(true);
    constexpr int count = 300;
    for (int row = 0; row < count; ++row) List().ListItems.Add(frame::Decimal(row));
    std::mt19937 numbers(7);
    const auto below = [&](int end) { return std::uniform_int_distribution(0, end - 1)(numbers); };
    std::set<int> selected;
    int anchor = 1;
    const auto addRange = [&](int to) {
        for (int index = std::min(anchor, to); index <= std::max(anchor, to); ++index) selected.insert(index);
    };
    List().ItemClickInput(1);
    selected = {1};
    for (int step = 0; step < 2'000; ++step) {
        const int index = 1 + below(count);
        switch (below(6)) {
            case 0:
                List().SelectInput(index, ListSelectConstants::Only);
                selected = {index};
                anchor = index;
                break;
            case 1:
                List().SelectInput(index, ListSelectConstants::Toggle);
                if (!selected.erase(index)) selected.insert(index);
                anchor = index;
                break;
            case 2:
                List().SelectInput(index, ListSelectConstants::Range);
                selected.clear();
                addRange(index);
                break;
            case 3:
                List().SelectInput(index, ListSelectConstants::AddRange);
                addRange(index);
                break;
            case 4:
                List().SelectNoneInput();
                selected.clear();
                break;
            default:
                Item(index)->SetSelected(true);
                selected.insert(index);
                anchor = index;
        }
        ASSERT_EQ(Rows().SelectedCount(), selected.size()) << "step " << step;
        for (int at = 1; at <= count; ++at) ASSERT_EQ(Item(at)->Selected(), selected.contains(at)) << "step " << step;
    }
}

TEST_F(ListSelectionTest, AHandlerOfTheClickMayTakeTheRowAway) {
    Add({"a", "b"});
    owner->atItemClick = [&] { List().ListItems.Clear(); };
    List().ItemClickInput(2);
    EXPECT_EQ(owner->Heard(), "ItemClick b 2");
    EXPECT_EQ(List().SelectedItem(), nullptr);
    EXPECT_EQ(List().FocusRow(), std::nullopt);
}

TEST_F(ListSelectionTest, AHandlerOfTheClickMayDestroyTheControl) {
    ListOwner& other = host.Create<ListOwner>("FileView2");
    other.list.ListItems.Add("a");
    bool destroyed = false;
    other.atItemClick = [&] {
        host.Destroy(other);
        destroyed = true;
    };
    other.list.ItemClickInput(1);
    EXPECT_TRUE(destroyed);
    EXPECT_EQ(Error(), "");
}

/// A screen that shows three rows in two columns, and writes down what it is asked for.
class Grid final : public ListViewPeer, public ListScreen {
  public:
    explicit Grid(ListView& list) : list_(list) {}

    void Update() override {
        list_.Rows().TakeChanges();
        ++updates;
        rows = list_.Rows().Count();
    }
    ListScreen* Screen() override { return shown ? this : nullptr; }
    void EditBegan(RowId row) override { asked += "EditBegan " + list_.Rows().Text(row, 0) + ";"; }

    std::optional<Position> RowAt(float x, float y) override {
        const Position column = x < 1000 ? 0 : 1;
        return y < 0 ? std::nullopt : std::optional(column * 3 + static_cast<Position>(y / 100) + first);
    }
    Position FirstVisible() override { return first; }
    RowPlace PlaceOf(Position row) override { return {static_cast<float>(row % 3) * 100, 100}; }
    void ScrollTo(Position row) override { first = row; }
    void MakeVisible(Position row) override { asked += "MakeVisible " + frame::Decimal(row) + ";"; }

    std::string asked;
    Position first = 0;
    Position rows = 0;  // that it knew of at its last update
    int updates = 0;
    bool shown = true;

  private:
    ListView& list_;
};

class ListScreenTest : public ListInputTest {
  protected:
    ListScreenTest() {
        auto peer = std::make_unique<Grid>(List());
        grid = peer.get();
        List().AttachPeer(std::move(peer));
        Add({"a", "b", "c", "d", "e", "f"});
    }
    Grid* grid;
};

TEST_F(ListScreenTest, AnswersForPointsAndPlaces) {
    EXPECT_EQ(List().HitTest(1500, 150)->Text(), "e");
    EXPECT_EQ(List().HitTest(1500, 350), nullptr);  // behind the last row
    EXPECT_EQ(List().HitTest(0, -1), nullptr);
    EXPECT_EQ(Item(5)->Top(), 100);
    EXPECT_EQ(Item(5)->Height(), 100);
    EXPECT_EQ(grid->rows, 6u);
}

TEST_F(ListScreenTest, ScrollsAndTellsWhatIsFirst) {
    List().SetTopIndex(4);
    EXPECT_EQ(grid->first, 3u);
    EXPECT_EQ(List().GetFirstVisible()->Text(), "d");
    grid->first = 1;
    EXPECT_EQ(List().TopIndex(), 2);
    Item(6)->EnsureVisible();
    EXPECT_EQ(grid->asked, "MakeVisible 5;");
    List().ListItems.Clear();
    EXPECT_EQ(List().TopIndex(), 0);
    EXPECT_EQ(List().GetFirstVisible(), nullptr);
}

TEST_F(ListScreenTest, IsToldOfEveryChangeBeforeItIsAsked) {
    Add({"g"});
    List().HitTest(0, 0);
    EXPECT_EQ(grid->rows, 7u);
}

TEST_F(ListScreenTest, WithoutAnAnswerTheFixedRuleStandsIn) {
    grid->shown = false;
    EXPECT_EQ(List().HitTest(1500, 300)->Text(), "a");
    List().SetTopIndex(2);
    EXPECT_EQ(List().GetFirstVisible()->Text(), "b");
}

TEST_F(ListScreenTest, HearsOfAnEditAtOnce) {
    owner->atEditBegin = [&](bool&) { EXPECT_EQ(grid->asked, ""); };
    Item(2)->SetSelected(true);
    List().StartLabelEdit();
    EXPECT_EQ(grid->asked, "EditBegan b;");
}

TEST_F(ListScreenTest, SeesTheEndOfAnEditWhoseRowHasGone) {
    Item(2)->SetSelected(true);
    List().StartLabelEdit();
    const int before = grid->updates;
    List().ListItems.Remove(2);
    host.Frame().Flush();
    EXPECT_GT(grid->updates, before);
    EXPECT_EQ(List().EditedRow(), std::nullopt);
}

TEST_F(ListEditTest, StartLabelEditAsksFirstAndThenIsOpen) {
    Add({"a", "b"});
    Item(2)->SetSelected(true);
    owner->atEditBegin = [&](bool&) { EXPECT_FALSE(List().Editing()); };
    List().StartLabelEdit();
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit");
    EXPECT_TRUE(List().Editing());
    EXPECT_EQ(List().EditedRow(), Rows().At(1));
    List().StartLabelEdit();
    EXPECT_EQ(owner->Heard(), "");
}

TEST_F(ListEditTest, ACancelledEditIsNotOpen) {
    Add({"a"});
    Item(1)->SetSelected(true);
    owner->atEditBegin = [](bool& cancel) { cancel = true; };
    List().StartLabelEdit();
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit");
    EXPECT_FALSE(List().Editing());
}

TEST_F(ListEditTest, WithoutASelectedItemNothingHappens) {
    Add({"a"});
    List().StartLabelEdit();
    List().EndEditInput("x");
    List().GiveUpEditInput();
    EXPECT_EQ(owner->Heard(), "");
    EXPECT_FALSE(List().Editing());
}

TEST_F(ListEditTest, AnAcceptedTextBecomesTheLabelAfterTheEvent) {
    Add({"a"});
    Item(1)->SetSelected(true);
    List().StartLabelEdit();
    owner->atEditEnd = [&](bool&, std::string&) {
        EXPECT_EQ(Item(1)->Text(), "a");
        EXPECT_FALSE(List().Editing());
    };
    List().EndEditInput("new");
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | AfterLabelEdit new");
    EXPECT_EQ(Item(1)->Text(), "new");
    EXPECT_EQ(List().FindItem("new")->Index(), 1);
    List().EndEditInput("again");
    EXPECT_EQ(owner->Heard(), "");
}

TEST_F(ListEditTest, TheEventMayChangeTheTextOrRefuseIt) {
    Add({"a"});
    Item(1)->SetSelected(true);
    owner->atEditEnd = [](bool&, std::string& text) { text += "!"; };
    List().StartLabelEdit();
    List().EndEditInput("new");
    EXPECT_EQ(Item(1)->Text(), "new!");
    owner->atEditEnd = [](bool& cancel, std::string&) { cancel = true; };
    List().StartLabelEdit();
    List().EndEditInput("other");
    EXPECT_EQ(Item(1)->Text(), "new!");
    EXPECT_FALSE(List().Editing());
}

TEST_F(ListEditTest, AnErrorOfTheEventKeepsTheOldLabelAndIsReported) {
    Add({"a"});
    Item(1)->SetSelected(true);
    owner->atEditEnd = [](bool&, std::string&) { throw ControlError(errors::fileExists); };
    List().StartLabelEdit();
    List().EndEditInput("b");
    EXPECT_EQ(Error(), "FileView1.ListFiles.EndEdit 58");
    EXPECT_EQ(Item(1)->Text(), "a");
    EXPECT_FALSE(List().Editing());
    EXPECT_EQ(Fire("LabelEdit", {"b"})[0], Variant("a"));
}

TEST_F(ListEditTest, AnEditGivenUpRaisesNoAfterLabelEdit) {
    Add({"a"});
    Item(1)->SetSelected(true);
    List().StartLabelEdit();
    List().GiveUpEditInput();
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | LabelEditGivenUp");
    EXPECT_FALSE(List().Editing());
    EXPECT_EQ(Item(1)->Text(), "a");
}

TEST_F(ListEditTest, AnEditOfAnotherRowGivesUpTheFirst) {
    Add({"a", "b"});
    Item(1)->SetSelected(true);
    List().StartLabelEdit();
    Item(2)->SetSelected(true);
    List().StartLabelEdit();
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | LabelEditGivenUp | BeforeLabelEdit");
    List().EndEditInput("x");
    EXPECT_EQ(Texts(), "a x*<");
}

TEST_F(ListEditTest, AnEditFollowsItsRowThroughASort) {
    Add({"b", "a"});
    Item(1)->SetSelected(true);
    List().StartLabelEdit();
    List().SetSorted(true);
    List().EndEditInput("c");
    EXPECT_EQ(Texts(), "a c*<");
}

TEST_F(ListEditTest, AnEditEndsWithItsRow) {
    Add({"a", "b"});
    Item(1)->SetSelected(true);
    List().StartLabelEdit();
    List().ListItems.Remove(1);
    EXPECT_FALSE(List().Editing());
    owner->Heard();
    List().EndEditInput("x");
    EXPECT_EQ(owner->Heard(), "");
    EXPECT_EQ(Texts(), "b");
}

TEST_F(ListEditTest, AHandlerMayTakeTheRowAwayBeforeAndAfter) {
    Add({"a", "b"});
    Item(1)->SetSelected(true);
    owner->atEditBegin = [&](bool&) { List().ListItems.Remove(1); };
    List().StartLabelEdit();
    EXPECT_FALSE(List().Editing());
    Item(1)->SetSelected(true);
    EXPECT_EQ(Fire("LabelEdit", {"x"})[0], Variant("b"));
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | BeforeLabelEdit");
    Add({"c"});
    Item(1)->SetSelected(true);
    owner->atEditBegin = nullptr;
    owner->atEditEnd = [&](bool&, std::string&) { List().ListItems.Clear(); };
    Fire("LabelEdit", {"x"});
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | AfterLabelEdit x");
    EXPECT_EQ(Error(), "");
    EXPECT_EQ(Texts(), "");
}

TEST_F(ListEditTest, AHandlerThatStartsTheSameEditIsNotAskedAgain) {
    Add({"a"});
    Item(1)->SetSelected(true);
    owner->atEditBegin = [&](bool&) { List().StartLabelEdit(); };
    List().StartLabelEdit();
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit");
    EXPECT_TRUE(List().Editing());
}

TEST_F(ListEditTest, AHandlerMayDestroyTheControl) {
    for (const bool before : {true, false}) {
        ListOwner& other = host.Create<ListOwner>("FileView2");
        other.list.ListItems.Add("a");
        other.list.ListItems.Item(1)->SetSelected(true);
        if (before)
            other.atEditBegin = [&](bool&) { host.Destroy(other); };
        else
            other.atEditEnd = [&](bool&, std::string&) { host.Destroy(other); };
        std::string text = "x";
        other.list.LabelEditInput(text);
        host.Frame().Settle();
        EXPECT_EQ(host.FindSite("FileView2"), nullptr);
        EXPECT_EQ(Error(), "");
    }
}

TEST_F(ListEditTest, AWholeEditTellsByItsTextWhetherTheLabelWasKept) {
    Add({"old"});
    Item(1)->SetSelected(true);
    EXPECT_EQ(Fire("LabelEdit", {"new"})[0], Variant("new"));
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit | AfterLabelEdit new");
    owner->atEditEnd = [](bool& cancel, std::string&) { cancel = true; };
    EXPECT_EQ(Fire("LabelEdit", {"other"})[0], Variant("new"));
    owner->Heard();
    owner->atEditBegin = [](bool& cancel) { cancel = true; };
    EXPECT_EQ(Fire("LabelEdit", {"other"})[0], Variant("new"));
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit");
}

TEST_F(ListEditTest, TheTwoHalvesCanBeFiredAlone) {
    Add({"a"});
    Item(1)->SetSelected(true);
    EXPECT_EQ(Fire("BeforeLabelEdit", {false})[0], Variant(false));
    EXPECT_TRUE(List().Editing());
    owner->atEditEnd = [](bool& cancel, std::string& text) {
        cancel = text == "no";
        text += ".txt";
    };
    const auto refused = Fire("AfterLabelEdit", {false, "no"});
    EXPECT_EQ(refused[0], Variant(true));
    EXPECT_FALSE(List().Editing());
    EXPECT_EQ(Item(1)->Text(), "a");
    const auto kept = Fire("AfterLabelEdit", {false, "b"});
    EXPECT_EQ(kept[0], Variant(false));
    EXPECT_EQ(kept[1], Variant("b.txt"));
    EXPECT_EQ(Item(1)->Text(), "b.txt");
}

TEST_F(ListEditTest, TheUserOpensAnEditOnlyInAutomaticMode) {
    Add({"a", "b"});
    List().SetLabelEdit(ListLabelEditConstants::Manual);
    List().EditInput(2);
    EXPECT_EQ(owner->Heard(), "");
    EXPECT_EQ(List().SelectedItem(), nullptr);
    List().SetLabelEdit(ListLabelEditConstants::Automatic);
    List().EditInput(2);
    EXPECT_EQ(owner->Heard(), "BeforeLabelEdit");
    EXPECT_EQ(List().SelectedItem()->Text(), "b");
    EXPECT_TRUE(List().Editing());
}

TEST_F(ListScrollTest, EnsureVisibleScrollsJustSoFarByTheFixedRule) {
    for (int row = 1; row <= 20; ++row) List().ListItems.Add(frame::Decimal(row));
    List().Move(0, 0, 3000, 300 + 5 * 255 + 60 + 10);
    Item(5)->EnsureVisible();
    EXPECT_EQ(List().TopIndex(), 1);
    Item(6)->EnsureVisible();
    EXPECT_EQ(List().TopIndex(), 2);
    Item(20)->EnsureVisible();
    EXPECT_EQ(List().TopIndex(), 16);
    Item(18)->EnsureVisible();
    EXPECT_EQ(List().TopIndex(), 16);
    Item(3)->EnsureVisible();
    EXPECT_EQ(List().TopIndex(), 3);
    List().SetHeight(0);
    Item(9)->EnsureVisible();
    EXPECT_EQ(List().TopIndex(), 9);
}

TEST_F(ListScrollTest, TheUserScrolls) {
    Add({"a", "b", "c"});
    List().ScrollInput(3);
    EXPECT_EQ(List().TopIndex(), 3);
    List().ScrollInput(4);
    EXPECT_EQ(Error(), "FileView1.ListFiles.Scroll 35600");
    EXPECT_EQ(List().TopIndex(), 3);
}

TEST_F(ListScrollTest, AClearedListBeginsAtItsTop) {
    Add({"a", "b", "c"});
    List().SetTopIndex(3);
    List().ListItems.Clear();
    Add({"d", "e", "f"});
    EXPECT_EQ(List().TopIndex(), 1);
}

TEST_F(ListIconsTest, RowsNameImagesOfTheListsThatAreBound) {
    const auto picture = std::make_shared<frame::Picture>(240.0f, 240.0f, "");
    owner->Image16.ListImages.Add({}, "txt", picture);
    Add({"a"});
    EXPECT_EQ(Item(1)->SetSmallIcon("txt").Number(), errors::elementNotFound);
    List().SetSmallIcons(&owner->Image16);
    List().SetIcons(&owner->Image32);
    EXPECT_FALSE(Item(1)->SetSmallIcon("TXT").Failed());
    EXPECT_EQ(Item(1)->SmallIcon(), Variant("TXT"));
    EXPECT_EQ(Item(1)->SetIcon("txt").Number(), errors::elementNotFound);
    const RowId row = Rows().At(0);
    EXPECT_EQ(List().SmallIcons()->ListImages.Find(Rows().Icon(row, IconSize::Small))->Picture(), picture);
    EXPECT_EQ(List().Icons()->ListImages.Find(Rows().Icon(row, IconSize::Large)), nullptr);
    EXPECT_FALSE(Item(1)->SetSmallIcon(1).Failed());
    EXPECT_EQ(Item(1)->SetSmallIcon(2).Number(), errors::indexOutOfBounds);
}

TEST_F(ListIconsTest, AnImageThatIsAddedLaterIsFoundAndOneThatGoesShowsNothing) {
    List().SetSmallIcons(&owner->Image16);
    Add({"a"});
    EXPECT_EQ(Item(1)->SetSmallIcon("txt").Number(), errors::elementNotFound);
    owner->Image16.ListImages.Add({}, "txt", std::make_shared<frame::Picture>());
    EXPECT_FALSE(Item(1)->SetSmallIcon("txt").Failed());
    owner->Image16.ListImages.Remove("txt");
    EXPECT_EQ(Item(1)->SmallIcon(), Variant("txt"));
    EXPECT_EQ(owner->Image16.ListImages.Find(Item(1)->SmallIcon()), nullptr);
    Add({"b"});
    EXPECT_EQ(Item(2)->SetSmallIcon("txt").Number(), errors::elementNotFound);
    owner->Image16.ListImages.Add({}, "doc", std::make_shared<frame::Picture>()).SetKey("txt");
    EXPECT_FALSE(Item(2)->SetSmallIcon("txt").Failed());
    List().ListItems.Clear();
    Add({"c"});
    EXPECT_FALSE(Item(1)->SetSmallIcon("txt").Failed());
    EXPECT_EQ(Item(1)->SmallIcon(), Variant("txt"));
}

TEST_F(ListIconsTest, ManyKeysAreKeptApart) {
    List().SetSmallIcons(&owner->Image16);
    constexpr int count = 200;
    for (int key = 0; key < count; ++key) {
        owner->Image16.ListImages.Add({}, frame::Decimal(key), std::make_shared<frame::Picture>());
        List().ListItems.Add("row");
    }
    for (const int step : {1, 7, 16}) {
        const auto keyOf = [&](int row) { return frame::Decimal((row * step) % count); };
        for (int row = 0; row < count; ++row) EXPECT_FALSE(Item(row + 1)->SetSmallIcon(keyOf(row)).Failed());
        for (int row = 0; row < count; ++row) EXPECT_EQ(Item(row + 1)->SmallIcon(), Variant(keyOf(row)));
    }
}

TEST_F(ListIconsTest, AListLetsGoOfImagesAndOfImageListsThatGo) {
    List().SetSmallIcons(&owner->Image16);
    List().SetSmallIcons(nullptr);
    owner->Image16.ListImages.Add({}, "txt", std::make_shared<frame::Picture>());
    Add({"a"});
    EXPECT_EQ(Item(1)->SetSmallIcon("txt").Number(), errors::elementNotFound);
    ListOwner& other = host.Create<ListOwner>("FileView2");
    other.Image16.ListImages.Add({}, "txt", std::make_shared<frame::Picture>());
    List().SetSmallIcons(&other.Image16);
    EXPECT_FALSE(Item(1)->SetSmallIcon("txt").Failed());
    host.Destroy(other);
    EXPECT_EQ(List().SmallIcons(), nullptr);
    EXPECT_EQ(Item(1)->SetSmallIcon("txt").Number(), errors::elementNotFound);
}

TEST_F(ListIconsTest, APeerHearsOfAChangeOfTheImages) {
    auto peer = std::make_unique<Grid>(List());
    const Grid& grid = *peer;
    List().AttachPeer(std::move(peer));
    List().SetSmallIcons(&owner->Image16);
    host.Frame().Flush();
    const int before = grid.updates;
    owner->Image16.ListImages.Add({}, "txt", std::make_shared<frame::Picture>());
    owner->Image16.ListImages.Add({}, "doc", std::make_shared<frame::Picture>());
    host.Frame().Flush();
    EXPECT_EQ(grid.updates, before + 1);
}

TEST_F(ListIconsTest, ImageListsAreBoundByName) {
    frame::Object& list = List();
    list.Put("SmallIcons", ObjectRef(owner->Image16));
    EXPECT_EQ(list.Get("SmallIcons"), Variant(ObjectRef(owner->Image16)));
    EXPECT_EQ(ErrorOf([&] { list.Put("Icons", ObjectRef(List())); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { list.Put("Icons", 5); }), errors::objectRequired);
    list.Put("SmallIcons", ObjectRef());
    EXPECT_TRUE(list.Get("SmallIcons").ToObject().IsNothing());
}

TEST_F(ListFindTest, FindsByPartFromAnIndexOnAndInSubItemsAndTags) {
    for (const char* text : {"Name", "Size", "Type"}) List().ColumnHeaders.Add({}, {}, text);
    Add({"apple", "Apricot", "banana", "apple"});
    Item(2)->SetSubItems(2, "Fruit");
    Item(3)->SetTag("yellow");
    Item(4)->SetSubItems(3, "Fruit");  // no column shows it
    const auto find = [&](const char* text, ListFindWhereConstants where, std::optional<int> start, ListFindHowConstants how) {
        const auto found = List().FindItem(text, where, start, how);
        return found ? found->Index() : 0;
    };
    constexpr auto text = ListFindWhereConstants::Text, subItem = ListFindWhereConstants::SubItem,
                   tag = ListFindWhereConstants::Tag;
    constexpr auto whole = ListFindHowConstants::Whole, partial = ListFindHowConstants::Partial;
    EXPECT_EQ(find("apr", text, {}, partial), 2);
    EXPECT_EQ(find("apr", text, {}, whole), 0);
    EXPECT_EQ(find("ap", text, 3, partial), 4);
    EXPECT_EQ(find("APPLE", text, 2, whole), 4);
    EXPECT_EQ(find("fruit", subItem, {}, whole), 2);
    EXPECT_EQ(find("fruit", subItem, 3, whole), 0);
    EXPECT_EQ(find("FR", subItem, {}, partial), 2);
    EXPECT_EQ(find("yellow", tag, {}, whole), 3);
    EXPECT_EQ(find("y", tag, {}, partial), 3);
    EXPECT_EQ(ErrorOf([&] { List().FindItem("a", text, 5); }), errors::indexOutOfBounds);
    Variant arguments[] = {"ban", 0, Variant::Missing(), 1};
    EXPECT_EQ(List().Call("FindItem", arguments).ToObject()->Get("Index"), Variant(3));
}

TEST_F(ListFindTest, RowsHaveKeysThatAreUnique) {
    EXPECT_EQ(List().ListItems.Add("a", "k1"), 1);
    EXPECT_EQ(List().ListItems.Add("b", "k2", 1), 1);
    EXPECT_EQ(ErrorOf([&] { List().ListItems.Add("c", "K1"); }), errors::keyNotUnique);
    EXPECT_EQ(ErrorOf([&] { List().ListItems.Add("c", {}, 4); }), errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { List().ListItems.Add("c", {}, 0); }), errors::indexOutOfBounds);
    EXPECT_EQ(Texts(), "b a");
    EXPECT_EQ(List().ListItems.Item("K1")->Index(), 2);
    EXPECT_EQ(Item(1)->Key(), "k2");
    EXPECT_EQ(Item(1)->SetKey("k1").Number(), errors::keyNotUnique);
    EXPECT_FALSE(Item(1)->SetKey("K2").Failed());
    EXPECT_FALSE(Item(1)->SetKey("").Failed());
    EXPECT_EQ(ErrorOf([&] { List().ListItems.Item("k2"); }), errors::elementNotFound);
    List().ListItems.Remove("k1");
    EXPECT_EQ(List().ListItems.Add("d", "k1"), 2);
    List().ListItems.Clear();
    EXPECT_EQ(ErrorOf([&] { List().ListItems.Item("k1"); }), errors::elementNotFound);
    EXPECT_EQ(List().ListItems.Add("e", "k1"), 1);
}

TEST_F(ListFindTest, AnIndexIsPassedOverInASortedList) {
    List().SetSorted(true);
    Add({"b"});
    EXPECT_EQ(List().ListItems.Add("a", {}, 2), 1);
    EXPECT_EQ(Texts(), "a b");
}

TEST_F(ListDragTest, TheControlFillsTheDataAndSaysWhatIsAllowed) {
    const auto data = std::make_shared<frame::DragData>();
    std::int32_t effects = 0;
    List().OLEStartDragInput(data, effects);
    EXPECT_EQ(effects, 3);
    std::int16_t format = 1;
    List().OLESetDataInput(data, format);
    EXPECT_EQ(format, 15);
    EXPECT_TRUE(data->GetFormat(15));
    std::int32_t effect = 2;
    bool defaultCursors = true;
    List().OLEGiveFeedbackInput(effect, defaultCursors);
    EXPECT_FALSE(defaultCursors);
    List().OLECompleteDragInput(effect);
    EXPECT_EQ(owner->Heard(), "OLEStartDrag | OLESetData 1 | OLEGiveFeedback 2 | OLECompleteDrag 2");
}

TEST_F(ListDragTest, WhatIsDraggedOverAndDroppedIsAnsweredInTheEffect) {
    const auto data = std::make_shared<frame::DragData>();
    data->Files.Add("/a");
    const auto over = Fire("OLEDragOver", {data, 3, std::int16_t{1}, std::int16_t{2}, 10, 400, std::int16_t{2}});
    EXPECT_EQ(over[1], Variant(1));
    const auto dropped = Fire("OLEDragDrop", {data, 3, std::int16_t{1}, std::int16_t{0}, 10, 400});
    EXPECT_EQ(dropped[1], Variant(0));
    EXPECT_EQ(owner->Heard(), "OLEDragOver 1 2 400 2 | OLEDragDrop 1 10");
    EXPECT_EQ(ErrorOf([&] { Fire("OLEStartDrag", {ObjectRef(List()), 0}); }), errors::typeMismatch);
}

TEST_F(ListDragTest, OLEDragAndSetFocusAskTheHost) {
    List().Call("OLEDrag");
    List().Call("SetFocus");
    ASSERT_EQ(host.log.Of("drag").size(), 1u);
    EXPECT_EQ(host.log.Of("drag")[0][1], Variant("FileView1.ListFiles"));
    EXPECT_EQ(host.log.Of("focus").size(), 1u);
}

TEST_F(ListLookTest, EveryPropertyThatCanBeSetTakesAValueAndTellsThePeer) {
    auto peer = std::make_unique<Grid>(List());
    const Grid& grid = *peer;
    List().AttachPeer(std::move(peer));
    for (const char* name :
         {"Arrange", "LabelEdit", "PictureAlignment", "MousePointer", "OLEDragMode", "OLEDropMode", "SortOrder"}) {
        host.Frame().Flush();
        const int before = grid.updates;
        List().Put(name, 1);
        host.Frame().Flush();
        EXPECT_EQ(List().Get(name), Variant(1)) << name;
        EXPECT_EQ(grid.updates, before + 1) << name;
    }
    for (const char* name : {"HideColumnHeaders", "HideSelection", "MultiSelect", "AllowColumnReorder", "FlatScrollBar",
                             "FullRowSelect", "GridLines", "HotTracking", "HoverSelection"}) {
        EXPECT_EQ(List().Get(name), Variant(false)) << name;
        host.Frame().Flush();
        const int before = grid.updates;
        List().Put(name, true);
        host.Frame().Flush();
        EXPECT_EQ(List().Get(name), Variant(true)) << name;
        EXPECT_EQ(grid.updates, before + 1) << name;
    }
    for (const char* name : {"BorderStyle", "Appearance"}) {
        EXPECT_EQ(List().Get(name), Variant(1)) << name;
        List().Put(name, 0);
        EXPECT_EQ(List().Get(name), Variant(0)) << name;
    }
    for (const char* name : {"BackColor", "ForeColor"}) {
        List().Put(name, 0x123456);
        EXPECT_EQ(List().Get(name), Variant(0x123456)) << name;
    }
    for (const char* name : {"MouseIcon", "Picture"}) {
        EXPECT_TRUE(List().Get(name).ToObject().IsNothing()) << name;
        const auto picture = std::make_shared<frame::Picture>();
        List().Put(name, picture);
        EXPECT_EQ(List().Get(name), Variant(picture)) << name;
    }
    List().Put("LabelWrap", false);
    EXPECT_FALSE(List().LabelWrap());
}

TEST_F(ListLookTest, AFontIsAlwaysThereAndItsChangesReachThePeer) {
    auto peer = std::make_unique<Grid>(List());
    const Grid& grid = *peer;
    List().AttachPeer(std::move(peer));
    const auto font = std::make_shared<frame::Font>("Sans", 12);
    List().SetFont(font);
    host.Frame().Flush();
    const int before = grid.updates;
    font->SetBold(true);
    host.Frame().Flush();
    EXPECT_EQ(grid.updates, before + 1);
    List().SetFont(nullptr);
    EXPECT_NE(List().Font(), nullptr);
}

TEST_F(ListLookTest, EveryMemberHasAHelpTextAndANameOfItsOwn) {
    List().ListItems.Add("a");
    List().ColumnHeaders.Add();
    owner->Image16.ListImages.Add({}, "a", std::make_shared<frame::Picture>());
    const ListItemRef item = Item(1);
    const std::vector<const frame::Object*> objects = {&List(),
                                                       item.get(),
                                                       &List().ListItems,
                                                       &List().ColumnHeaders,
                                                       &List().ColumnHeaders.Item(1),
                                                       &owner->Image16,
                                                       &owner->Image16.ListImages,
                                                       &owner->Image16.ListImages.Item(1)};
    for (const frame::Object* object : objects) {
        std::set<std::string> names, inputs;
        for (const frame::Member& member : object->Table().members) {
            EXPECT_FALSE(member.help.empty()) << object->Table().name << "." << member.name;
            EXPECT_TRUE(names.insert(frame::FoldCase(member.name)).second) << object->Table().name << "." << member.name;
            for (const frame::Parameter& parameter : member.parameters.All()) EXPECT_FALSE(parameter.name.empty()) << member.name;
        }
        for (const frame::Member& input : object->Table().inputs) {
            EXPECT_TRUE(inputs.insert(frame::FoldCase(input.name)).second) << input.name;
            for (const frame::Parameter& parameter : input.parameters.All()) EXPECT_FALSE(parameter.name.empty()) << input.name;
        }
        if (const auto shown = object->Table().defaultMember; !shown.empty()) {
            EXPECT_NE(object->Table().Find(shown), nullptr);
        }
    }
}

TEST_F(ListLookTest, InputsAreReachedByName) {
    List().SetMultiSelect(true);
    Add({"a", "b", "c"});
    List().ColumnHeaders.Add();
    Fire("ItemClick", {2});
    Fire("ItemClick", {3, std::int16_t{1}});
    EXPECT_EQ(Texts(), "a b* c*<");
    Fire("Select", {1, 0});
    Fire("Focus", {2});
    EXPECT_EQ(Texts(), "a* b< c");
    Fire("SelectAll", {});
    EXPECT_EQ(Texts(), "a* b*< c*");
    Fire("SelectNone", {});
    Fire("ColumnClick", {1});
    Fire("ColumnWidth", {1, 100});
    Fire("Edit", {3});
    Fire("EndEdit", {"d"});
    EXPECT_EQ(owner->Heard(), "ItemClick b 2 | ItemClick c 3 | ColumnClick 1 | BeforeLabelEdit | AfterLabelEdit d");
    EXPECT_EQ(Texts(), "a b d*<");
    EXPECT_EQ(List().ColumnHeaders.Item(1).Width(), 100);
    Fire("Scroll", {2});
    EXPECT_EQ(List().Get("TopIndex"), Variant(2));
    EXPECT_EQ(List().Get("Editing"), Variant(false));
    List().Call("StartLabelEdit");
    EXPECT_EQ(List().Get("Editing"), Variant(true));
    Fire("GiveUpEdit", {});
    EXPECT_EQ(List().Get("Editing"), Variant(false));
}

TEST_F(ListLookTest, RowsAreReachedByNameAndByKey) {
    const ObjectRef items = List().Inner("ListItems");
    Variant row[] = {"readme", "k"};
    items->Call("Add", row);
    Variant key[] = {"K"};
    const ObjectRef item = items->Call("Item", key).ToObject();
    EXPECT_EQ(item->Get("Key"), Variant("k"));
    EXPECT_EQ(item->Get("Top"), Variant(300));
    EXPECT_EQ(item->Get("Height"), Variant(255));
    item->Call("EnsureVisible");
    items->Call("Remove", key);
    EXPECT_EQ(items->Get("Count"), Variant(0));
}

}  // namespace
}  // namespace tessel::child
