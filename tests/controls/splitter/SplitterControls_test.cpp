#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/HostUnderTest.h"
#include "tests/controls/splitter/SplitterTestHelp.h"

/// The controls on the two sides: how they are found by name, and how they give and take room.
namespace tessel::controls {
namespace {

using frame::Variant;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::IsEmpty;
using namespace splittertest;

/// A horizontal bar at 1000, that is dragged down by 100 unless a test says otherwise.
class SplitterFind : public testing::Test {
  protected:
    SplitterFind() { stage.LayHorizontal(1000); }
    frame::Control& bar() { return stage.Bar(); }

    /// What a list above the bar sets in one step of 100.
    std::vector<std::string> MovedBy(const std::string& list) {
        bar().Put("ControlsTopLeft", list);
        stage.LayHorizontal(1000);
        DragBy(bar(), 0, 100);
        std::vector<std::string> moved = stage.Moves();
        std::erase(moved, "Splitter1.Top=1100");
        std::erase(moved, "AfterMove(0, 100)");
        return moved;
    }

    Stage stage;
};

TEST_F(SplitterFind, AControlIsFoundByItsName) {
    stage.Add("Text1");
    stage.Add("Text2");
    EXPECT_THAT(MovedBy("Text2"), ElementsAre("Text2.Height=900"));
}

TEST_F(SplitterFind, EntriesArePartedByCommasAndMovedInTheirOrder) {
    stage.Add("Text1");
    stage.Add("Text2");
    stage.Add("Text3");
    EXPECT_THAT(MovedBy("Text3,Text1,Text2"), ElementsAre("Text3.Height=900", "Text1.Height=900", "Text2.Height=900"));
}

TEST_F(SplitterFind, BlanksAroundEntriesAreIgnored) {
    stage.Add("Text1");
    stage.Add("Text2");
    stage.AddMember("Text3", 2);
    EXPECT_THAT(MovedBy("  Text2 , Text1  ,  Text3(2)  "),
                ElementsAre("Text2.Height=900", "Text1.Height=900", "Text3(2).Height=900"));
}

TEST_F(SplitterFind, BlanksInsideANameBelongToIt) {
    stage.Add("Text1");
    stage.Add("My Text");
    EXPECT_THAT(MovedBy("Te xt1, My Text"), ElementsAre("My Text.Height=900"));
}

TEST_F(SplitterFind, NamesAreComparedWithoutRegardToCase) {
    stage.Add("Text1");
    stage.Add("\u00C4pfel");
    EXPECT_THAT(MovedBy("tEXT1,\u00E4PFEL"), ElementsAre("Text1.Height=900", "\u00C4pfel.Height=900"));
}

TEST_F(SplitterFind, ANameAloneFindsTheFirstControlOfThatName) {
    stage.AddMember("Text1", 5);
    stage.AddMember("Text1", 0);
    EXPECT_THAT(MovedBy("Text1"), ElementsAre("Text1(5).Height=900"));
}

TEST_F(SplitterFind, ANameWithAnIndexFindsThatMember) {
    stage.AddMember("Text1", 0);
    stage.AddMember("Text1", 1);
    stage.AddMember("Text1", 2);
    EXPECT_THAT(MovedBy("text1(2)"), ElementsAre("Text1(2).Height=900"));
    EXPECT_THAT(MovedBy("Text1(0)"), ElementsAre("Text1(0).Height=900"));
}

TEST_F(SplitterFind, AnIndexOfSeveralDigitsIsReadWhole) {
    stage.AddMember("Text1", 1);
    stage.AddMember("Text1", 12);
    stage.AddMember("Text1", 123);
    EXPECT_THAT(MovedBy("Text1(123), Text1(12)"), ElementsAre("Text1(123).Height=900", "Text1(12).Height=900"));
}

TEST_F(SplitterFind, AnIndexMayHaveBlanksAroundIt) {
    stage.AddMember("Text1", 1);
    stage.AddMember("Text1", 2);
    EXPECT_THAT(MovedBy("Text1( 2 )"), ElementsAre("Text1(2).Height=900"));
}

TEST_F(SplitterFind, ABlankBeforeTheParenthesisBelongsToTheName) {
    stage.AddMember("Text1", 2);
    EXPECT_THAT(MovedBy("Text1 (2)"), IsEmpty());
}

TEST_F(SplitterFind, AnIndexBelowZeroFindsTheFirstOfTheName) {
    stage.AddMember("Text1", 3);
    stage.AddMember("Text1", 1);
    EXPECT_THAT(MovedBy("Text1(-2)"), ElementsAre("Text1(3).Height=900"));
}

TEST_F(SplitterFind, AnIndexThatNoMemberHasFindsNothing) {
    stage.AddMember("Text1", 0);
    stage.AddMember("Text1", 1);
    EXPECT_THAT(MovedBy("Text1(7)"), IsEmpty());
}

TEST_F(SplitterFind, AControlWithoutAnIndexIsPassedOverWhenOneIsAsked) {
    stage.Add("Text1");
    stage.AddMember("Text1", 2);
    EXPECT_THAT(MovedBy("Text1(2)"), ElementsAre("Text1(2).Height=900"));
}

TEST_F(SplitterFind, AMisspeltNameIsSkippedWithoutAWord) {
    stage.Add("Text1");
    EXPECT_THAT(MovedBy("Txet1,Text,Text11,Text1"), ElementsAre("Text1.Height=900"));
    EXPECT_THAT(stage.others.log.Of("msgbox"), IsEmpty());
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST_F(SplitterFind, EmptyListsAndEmptyEntriesDoNothing) {
    stage.Add("Text1");
    for (const std::string list : {"", " ", ",", ",,,", " , "}) EXPECT_THAT(MovedBy(list), IsEmpty()) << '"' << list << '"';
    EXPECT_THAT(MovedBy(",Text1,"), ElementsAre("Text1.Height=900"));
    EXPECT_EQ(stage.Deeds("AfterMove").size(), 1u);
}

TEST_F(SplitterFind, ASiblingWithoutANameIsPassedOver) {
    stage.AddBare("Nameless", {{"Height", 500.0f}, {"Top", 0.0f}});
    stage.Add("Text1");
    stage.AddBare("Nameless", {});
    stage.Add("Text2");
    EXPECT_THAT(MovedBy("Text1,Text2"), ElementsAre("Text1.Height=900", "Text2.Height=900"));
}

TEST_F(SplitterFind, ANamelessSiblingBehindAMemberOfAnotherIndexIsPassedOver) {
    stage.AddMember("Text1", 1);
    stage.AddBare("Nameless", {{"Index", 2}, {"Height", 500.0f}});
    stage.AddMember("Text1", 2);
    EXPECT_THAT(MovedBy("Text1(2)"), ElementsAre("Text1(2).Height=900"));
}

TEST_F(SplitterFind, ASiblingThatCannotBeHadIsPassedOver) {
    stage.standing.push_back(nullptr);
    stage.Add("Text1");
    EXPECT_THAT(MovedBy("Text1"), ElementsAre("Text1.Height=900"));
}

TEST_F(SplitterFind, WithoutACountNothingIsFound) {
    stage.Add("Text1");
    stage.countFails = true;
    EXPECT_THAT(MovedBy("Text1"), IsEmpty());
    EXPECT_EQ(stage.Deeds("AfterMove").size(), 1u);
}

TEST_F(SplitterFind, EachEntryIsSearchedForAgainAtEachStep) {
    auto& first = stage.Add("Text1");
    auto& second = stage.Add("Text2");
    bar().Put("ControlsTopLeft", "Text1");
    stage.LayHorizontal(1000);
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 60);
    first.SetMember("Name", "Other");
    second.SetMember("Name", "Text1");
    MoveTo(bar(), 50, 60);
    EXPECT_EQ(first.Number("Height"), 810);
    EXPECT_EQ(second.Number("Height"), 810);
}

TEST_F(SplitterFind, AControlThatComesDuringADragFollowsFromThen) {
    bar().Put("ControlsTopLeft", "Text1");
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 60);
    auto& late = stage.Add("Text1");
    MoveTo(bar(), 50, 60);
    EXPECT_EQ(late.Number("Height"), 810);
}

TEST_F(SplitterFind, IdentIs42DuringTheSearchAnd0Afterwards) {
    auto& text = stage.Add("Text1");
    std::vector<std::string> searching, moving;
    text.onGet = [&](const std::string& name) { (name == "Name" ? searching : moving).push_back(bar().Get("Ident").ToText()); };
    bar().Put("Ident", 7);
    MovedBy("Text1,Text2");
    EXPECT_THAT(searching, testing::AllOf(testing::SizeIs(2), testing::Each("42")));
    EXPECT_THAT(moving, testing::AllOf(testing::Not(IsEmpty()), testing::Each("0")));
    EXPECT_EQ(bar().Get("Ident"), Variant(0));
}

TEST_F(SplitterFind, IdentIs0AfterASearchThatFoundNothing) {
    bar().Put("Ident", 7);
    MovedBy("Text9");
    EXPECT_EQ(bar().Get("Ident"), Variant(0));
    bar().Put("Ident", 7);
    stage.countFails = true;
    MovedBy("Text9");
    EXPECT_EQ(bar().Get("Ident"), Variant(0));
}

TEST_F(SplitterFind, IdentServesTheSearchAtDesignTimeToo) {
    auto& text = stage.Add("Text1");
    stage.designTime = true;
    std::string seen;
    text.onGet = [&](const std::string& name) {
        if (name == "Name") seen = bar().Get("Ident").ToText();
    };
    MovedBy("Text1");
    EXPECT_EQ(seen, "42");
    EXPECT_EQ(bar().Get("Ident"), Variant(0));
}

// Giving and taking room.

class SplitterMove : public testing::Test {
  protected:
    frame::Control& bar() { return stage.Bar(); }
    void Name(const std::string& topLeft, const std::string& bottomRight) {
        bar().Put("ControlsTopLeft", topLeft);
        bar().Put("ControlsBottomRight", bottomRight);
    }

    Stage stage;
    Thing& above = stage.Add("Above");  // 1000 by 800 at 100, 200, as all
    Thing& below = stage.Add("Below");
};

std::string PlaceOf(const Thing& thing) {
    const auto number = [&](std::string_view name) { return Variant(thing.Number(name)).ToText(); };
    return number("Left") + "," + number("Top") + " " + number("Width") + "x" + number("Height");
}

TEST_F(SplitterMove, DownwardsTheUpperGrowsAndTheLowerShrinksAndShifts) {
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 150);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x950");
    EXPECT_EQ(PlaceOf(below), "100,350 1000x650");
}

TEST_F(SplitterMove, UpwardsTheUpperShrinksAndTheLowerGrowsAndShifts) {
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, -150);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x650");
    EXPECT_EQ(PlaceOf(below), "100,50 1000x950");
}

TEST_F(SplitterMove, ToTheRightTheLeftOneGrowsAndTheRightOneShrinksAndShifts) {
    Name("Above", "Below");
    stage.LayVertical(1000);
    DragBy(bar(), 150, 0);
    EXPECT_EQ(PlaceOf(above), "100,200 1150x800");
    EXPECT_EQ(PlaceOf(below), "250,200 850x800");
}

TEST_F(SplitterMove, ToTheLeftTheLeftOneShrinksAndTheRightOneGrowsAndShifts) {
    Name("Above", "Below");
    stage.LayVertical(1000);
    DragBy(bar(), -150, 0);
    EXPECT_EQ(PlaceOf(above), "100,200 850x800");
    EXPECT_EQ(PlaceOf(below), "-50,200 1150x800");
}

TEST_F(SplitterMove, TheControlsMoveByWhatTheLimitLeavesOfTheDistance) {
    Name("Above", "Below");
    bar().Put("MinTopLeft", 900);
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, -500);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x700");
    EXPECT_EQ(PlaceOf(below), "100,100 1000x900");
}

TEST_F(SplitterMove, ASizeBelowZeroIsSetAsZeroAndTheShiftHappensAllTheSame) {
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 900);
    EXPECT_EQ(PlaceOf(below), "100,1100 1000x0");
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(below), "100,1200 1000x0");
    EXPECT_EQ(PlaceOf(above), "100,200 1000x1800");
}

TEST_F(SplitterMove, ASizeOfJustZeroIsSetAsZero) {
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 800);
    EXPECT_EQ(PlaceOf(below), "100,1000 1000x0");
    EXPECT_EQ(below.Get("Height"), Variant(0));
}

TEST_F(SplitterMove, TheUpperControlIsSqueezedToZeroAndStaysInItsPlace) {
    Name("Above", "");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, -900);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x0");
}

TEST_F(SplitterMove, WidthsBelowZeroAreSetAsZeroOnBothSides) {
    Name("Above", "Below");
    stage.LayVertical(2000);
    DragBy(bar(), -1500, 0);
    EXPECT_EQ(PlaceOf(above), "100,200 0x800");
    EXPECT_EQ(PlaceOf(below), "-1400,200 2500x800");
    DragBy(bar(), 3000, 0);
    EXPECT_EQ(PlaceOf(above), "100,200 3000x800");
    EXPECT_EQ(PlaceOf(below), "1600,200 0x800");
}

// A control that was squeezed to nothing has forgotten its size: it grows from zero.
TEST_F(SplitterMove, ASqueezedControlGrowsFromZeroOnTheWayBack) {
    Name("", "Below");
    stage.LayHorizontal(1000);
    Press(bar(), 50, 50);
    MoveTo(bar(), 50, 1050);
    MoveTo(bar(), 50, -950);
    EXPECT_EQ(PlaceOf(below), "100,200 1000x1000");
}

TEST_F(SplitterMove, AControlNamedTwiceMovesTwice) {
    Name("Above,Above", "Below,below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x1000");
    EXPECT_EQ(PlaceOf(below), "100,400 1000x600");
}

TEST_F(SplitterMove, AControlInBothListsKeepsItsSizeAndShifts) {
    Name("Above", "Above");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(above), "100,300 1000x800");
}

TEST_F(SplitterMove, SizesBetweenPixelsAreKept) {
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 0.25f);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x800.25");
    EXPECT_EQ(PlaceOf(below), "100,200.25 1000x799.75");
}

TEST_F(SplitterMove, NumbersOfOtherTypesAreReckonedWith) {
    above.SetMember("Height", 800);
    below.SetMember("Height", std::int16_t{700});
    below.SetMember("Top", 900.0);
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(above.Number("Height"), 900);
    EXPECT_EQ(below.Number("Height"), 600);
    EXPECT_EQ(below.Number("Top"), 1000);
}

TEST_F(SplitterMove, TheHeightIsSetBeforeTheTopAndTheUpperListBeforeTheLower) {
    stage.Add("Above2");
    stage.Add("Below2");
    Name("Above2,Above", "Below,Below2");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_THAT(stage.Moves(), ElementsAre("Splitter1.Top=1100", "Above2.Height=900", "Above.Height=900", "Below.Height=700",
                                           "Below.Top=300", "Below2.Height=700", "Below2.Top=300", "AfterMove(0, 100)"));
}

TEST_F(SplitterMove, AHeightThatCannotBeSetLeavesTheRestGoing) {
    stage.Add("Text3");
    above.unsettable = below.unsettable = {"Height"};
    Name("Above", "Below,Text3");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x800");
    EXPECT_EQ(PlaceOf(below), "100,300 1000x800");
    EXPECT_THAT(stage.Moves(),
                ElementsAre("Splitter1.Top=1100", "Below.Top=300", "Text3.Height=700", "Text3.Top=300", "AfterMove(0, 100)"));
    EXPECT_THAT(stage.others.errors.reports, IsEmpty());
}

TEST_F(SplitterMove, ATopThatCannotBeSetLeavesTheRestGoing) {
    stage.Add("Text3");
    below.unsettable = {"Top"};
    Name("", "Below,Text3");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_THAT(stage.Moves(),
                ElementsAre("Splitter1.Top=1100", "Below.Height=700", "Text3.Height=700", "Text3.Top=300", "AfterMove(0, 100)"));
}

TEST_F(SplitterMove, ATopThatCannotBeReadStays) {
    below.unreadable = {"Top"};
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(below.Number("Height"), 700);
    EXPECT_EQ(below.Number("Top"), 200);
    EXPECT_EQ(above.Number("Height"), 900);
}

TEST_F(SplitterMove, WidthsAndLeftsThatFailLeaveTheRestGoing) {
    above.unsettable = {"Width"};
    below.unsettable = {"Width"};
    stage.Add("Text3").unsettable = {"Left"};
    Name("Above", "Below,Text3");
    stage.LayVertical(1000);
    DragBy(bar(), 100, 0);
    EXPECT_THAT(stage.Moves(), ElementsAre("Splitter1.Left=1100", "Below.Left=200", "Text3.Width=900", "AfterMove(100, 0)"));
}

TEST_F(SplitterMove, AControlWithoutASizeOrAPlaceIsLeftAlone) {
    stage.AddBare("Timer1", {{"Name", "Timer1"}, {"Interval", 100}});
    Name("Timer1,Above", "Timer1,Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x900");
    EXPECT_EQ(PlaceOf(below), "100,300 1000x700");
    EXPECT_EQ(stage.Deeds("AfterMove").size(), 1u);
}

TEST_F(SplitterMove, AHeightThatIsNoNumberLeavesTheRestGoing) {
    below.SetMember("Height", "tall");
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(below.Get("Height"), Variant("tall"));
    EXPECT_EQ(below.Number("Top"), 300);
    EXPECT_EQ(above.Number("Height"), 900);
}

TEST_F(SplitterMove, AControlThatIsNotNamedStays) {
    Name("Above", "");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(below), "100,200 1000x800");
}

TEST_F(SplitterMove, AListOfAnArrayMovesTheMembersOfTheirIndex) {
    auto& zero = stage.AddMember("Text1", 0);
    auto& one = stage.AddMember("Text1", 1);
    auto& two = stage.AddMember("Text1", 2);
    Name("Text1(2)", "Text1(1)");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(zero), "100,200 1000x800");
    EXPECT_EQ(PlaceOf(one), "100,300 1000x700");
    EXPECT_EQ(PlaceOf(two), "100,200 1000x900");
}

TEST_F(SplitterMove, ManyStepsOfOneDragAddUp) {
    Name("Above", "Below");
    stage.LayHorizontal(1000);
    Press(bar(), 50, 50);
    for (int i = 0; i < 100; ++i) MoveTo(bar(), 50, 52);
    EXPECT_EQ(stage.Site().Top(), 1200);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x1000");
    EXPECT_EQ(PlaceOf(below), "100,400 1000x600");
    EXPECT_EQ(stage.Deeds("AfterMove").size(), 100u);
}

TEST_F(SplitterMove, AListMayBeLongAndFullOfNonsense) {
    std::string list;
    for (int i = 0; i < 2000; ++i) list += "no" + std::to_string(i) + "(,)x(99999999999999999999),((,";
    Name(list + "Above", list + "Below");
    stage.LayHorizontal(1000);
    DragBy(bar(), 0, 100);
    EXPECT_EQ(PlaceOf(above), "100,200 1000x900");
    EXPECT_EQ(PlaceOf(below), "100,300 1000x700");
}

// Several bars on one form.

class SplitterBars : public testing::Test {
  protected:
    frame::Control& Make(const std::string& name, int orientation, float left, float top, float width, float height) {
        auto& bar = host.Create(SplitterClass(), name);
        bar.Put("Orientation", orientation);
        host.SiteOf(bar)->SetPlace(left, top);
        host.SiteOf(bar)->SetSize(width, height);
        return bar;
    }
    std::string Place(const frame::Control& bar) {
        const auto& site = *host.SiteOf(bar);
        const auto text = [](float value) { return Variant(value).ToText(); };
        return text(site.Left()) + "," + text(site.Top()) + " " + text(site.Width()) + "x" + text(site.Height());
    }

    HostUnderTest host;
    frame::Control& lying = Make("Splitter1", horizontal, 0, 3000, 6000, thick);
    frame::Control& standing = Make("Splitter2", vertical, 2000, 3120, thick, 2000);
    frame::Control& upper = Make("Splitter3", vertical, 4000, 0, thick, 3000);
};

TEST_F(SplitterBars, ABarNamedInAListMovesAndSizesLikeAnyOtherControl) {
    lying.Put("ControlsTopLeft", "Splitter3");
    lying.Put("ControlsBottomRight", " splitter2 ");
    DragBy(lying, 0, 300);
    EXPECT_EQ(Place(lying), "0,3300 6000x120");
    EXPECT_EQ(Place(standing), "2000,3420 120x1700");
    EXPECT_EQ(Place(upper), "4000,0 120x3300");
}

TEST_F(SplitterBars, OnlyTheBarThatIsDraggedRaisesAfterMove) {
    lying.Put("ControlsBottomRight", "Splitter2");
    host.log.Clear();
    DragBy(lying, 0, 300);
    EXPECT_EQ(host.log.EventNames("Splitter1"), "MouseDown MouseMove AfterMove MouseUp");
    EXPECT_EQ(host.log.EventNames("Splitter2"), "");
}

TEST_F(SplitterBars, EachBarWorksAlone) {
    DragBy(lying, 0, 300);
    EXPECT_EQ(Place(standing), "2000,3120 120x2000");
    DragBy(standing, -500, 0);
    EXPECT_EQ(Place(standing), "1500,3120 120x2000");
    EXPECT_EQ(Place(lying), "0,3300 6000x120");
}

TEST_F(SplitterBars, BarsMayNameEachOther) {
    lying.Put("ControlsBottomRight", "Splitter2");
    standing.Put("ControlsTopLeft", "Splitter1");
    DragBy(lying, 0, 100);
    EXPECT_EQ(Place(standing), "2000,3220 120x1900");
    DragBy(standing, 400, 0);
    EXPECT_EQ(Place(standing), "2400,3220 120x1900");
    EXPECT_EQ(Place(lying), "0,3100 6400x120");
}

TEST_F(SplitterBars, ABarThatNamesItselfGrowsToo) {
    lying.Put("ControlsTopLeft", "Splitter1");
    DragBy(lying, 0, 100);
    EXPECT_EQ(Place(lying), "0,3100 6000x220");
}

TEST_F(SplitterBars, ADragOfOneIsNoDragOfAnother) {
    Press(lying, 50, 50);
    MoveTo(standing, 50, 50);
    MoveTo(standing, 500, 500);
    EXPECT_EQ(Place(standing), "2000,3120 120x2000");
    MoveTo(lying, 50, 60);
    EXPECT_EQ(Place(lying), "0,3010 6000x120");
}

TEST_F(SplitterBars, TheSearchOfOneBarLeavesTheIdentOfAnother) {
    standing.Put("Ident", 5);
    lying.Put("ControlsBottomRight", "Splitter2");
    DragBy(lying, 0, 100);
    EXPECT_EQ(standing.Get("Ident"), Variant(5));
    EXPECT_EQ(lying.Get("Ident"), Variant(0));
}

TEST_F(SplitterBars, ABarThatIsGoneIsSkipped) {
    lying.Put("ControlsBottomRight", "Splitter2,Splitter3");
    host.Destroy(standing);
    DragBy(lying, 0, 100);
    EXPECT_EQ(Place(upper), "4000,100 120x2900");
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

}  // namespace
}  // namespace tessel::controls
