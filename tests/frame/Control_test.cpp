#include "frame/Control.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "frame/Numbers.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {

// Not in the unnamed namespace: the rows of a table name it in templates that have linkage.
namespace control_test {

/// Saves in another order than it loads, and with other defaults.
class OddControl final : public Control {
  public:
    using Control::Control;
    TextSize DesignSize() const override { return {100, 100}; }
    const ClassTable& Table() const override;

    struct Own {
        std::int32_t First = 0, Second = 0, Third = 0;
        OLE_COLOR Tint;
    };
    Own own;
};

inline const ClassTable& OddControl::Table() const {
    static constexpr std::array kept = {
        key<&OddControl::own, &Own::First>("First", ValueDefault(VarType::Integer, 1), ValueDefault(VarType::Integer, 10)),
        key<&OddControl::own, &Own::Second>("Second", VarType::Integer, 2),
        key<&OddControl::own, &Own::Third>("Third", VarType::Integer, 3),
        key<&OddControl::own, &Own::Tint>("Tint", ValueDefault(VarType::Long, 192), ValueDefault(VarType::Long, 0x8000000F)),
    };
    static constexpr std::string_view order[] = {"Third", "Tint", "First", "Second"};
    static constexpr ClassTable table{.name = "OddControl", .members = {}, .bag = kept, .savedOrder = order};
    return table;
}

}  // namespace control_test

namespace {

using control_test::OddControl;
using headless::HeadlessHost;
using headless::HeadlessSite;
using headless::Placing;
using test::BagOf;
using test::ErrorOf;
using test::Mood;
using test::TestControl;
using testing::ElementsAre;

/// A bag that tells in which order it was read.
class WatchedBag final : public PropertyBag {
  public:
    Variant ReadProperty(std::string_view name, const Variant& otherwise) const override {
        reads.emplace_back(name);
        defaults.push_back(otherwise);
        return otherwise;
    }
    void WriteProperty(std::string_view, const Variant&, const Variant&) override {}

    mutable std::vector<std::string> reads;
    mutable std::vector<Variant> defaults;
};

std::vector<std::string> WrittenKeys(const MemoryBag& bag) {
    std::vector<std::string> keys;
    for (const MemoryBag::Write& write : bag.Written()) keys.push_back(write.key);
    return keys;
}

std::string Changes(const headless::Log& log) {
    std::string keys;
    for (const auto& entry : log.Of("changed")) keys += (keys.empty() ? "" : " ") + entry[2].ToText();
    return keys;
}

/// All that a bag holds of a control, as text.
std::string StateOf(const TestControl& control) {
    MemoryBag bag;
    control.WriteProperties(bag);
    std::string state;
    for (const MemoryBag::Write& write : bag.Written())
        if (write.value.Type() != VarType::Object) state += write.key + "=" + write.value.ToText() + " ";
    const auto& face = control.Face();
    return state + (face ? face->Name() + " " + NumberText(face->Size()) : "no font");
}

struct Controls : testing::Test {
    TestControl& Make(const Placing& placing = {}) { return host.Create<TestControl>("Test1", placing); }
    TestControl& Load(const PropertyBag& bag) { return host.Create<TestControl>("Loaded1", {.saved = &bag}); }

    HeadlessHost host;
};

// Life

TEST_F(Controls, PlacedNewHearsInitializeInitPropertiesResizeShow) {
    EXPECT_EQ(Make().trace, "Initialize InitProperties Resize Show");
}

TEST_F(Controls, LoadedHearsReadPropertiesInstead) { EXPECT_EQ(Load(MemoryBag()).trace, "Initialize ReadProperties Resize Show"); }

TEST_F(Controls, HearsWhatTheHostDoesLaterEachTime) {
    TestControl& control = Make();
    control.trace.clear();
    HeadlessSite& site = *host.SiteOf(control);
    site.Hide();
    site.Show();
    site.Paint();
    site.AmbientChanged("Font");
    MemoryBag bag;
    site.Save(bag);
    EXPECT_EQ(control.trace, "Hide Show Paint AmbientChanged:Font WriteProperties");
}

TEST_F(Controls, HasItsDesignSizeUntilTheHostGivesAnother) {
    EXPECT_EQ(Make().Surface().Width(), 1200);
    EXPECT_EQ(Make({.width = 900.0f}).Surface().Width(), 900);
    EXPECT_EQ(Make({.width = 900.0f}).Surface().Height(), 600);
}

TEST_F(Controls, AsksForDesignTimeAfreshEachTime) {
    TestControl& control = Make();
    EXPECT_TRUE(control.UserMode());
    host.SiteOf(control)->SetUserMode(false);
    EXPECT_FALSE(control.UserMode());
}

TEST_F(Controls, IsKnownByItsPlaceAndReachesItsChildByName) {
    TestControl& control = Make();
    EXPECT_EQ(control.Path(), "Test1");
    EXPECT_EQ(control.Child1.Path(), "Test1.Child1");
    EXPECT_EQ(control.Inner("child1").Get(), &control.Child1);
    EXPECT_EQ(&control.Child1.Owner(), &control);
    ASSERT_EQ(control.Children().size(), 1u);
    EXPECT_EQ(control.Children()[0], &control.Child1);
    EXPECT_TRUE(control.Inner("Child2").IsNothing());
}

TEST_F(Controls, KnowsAChildOnlyForTheChildsLife) {
    TestControl& control = Make();
    auto added = std::make_unique<test::TestChild>(control, "picHandle(0)");
    EXPECT_EQ(control.Inner("PICHANDLE(0)").Get(), added.get());
    added.reset();
    EXPECT_EQ(control.Children().size(), 1u);
    EXPECT_TRUE(control.Inner("picHandle(0)").IsNothing());
}

// New and loaded

TEST_F(Controls, PlacedNewGetsEveryOwnFieldsDefault) {
    const TestControl& control = Make();
    EXPECT_EQ(control.Number(), 30);
    EXPECT_EQ(control.Tint(), OLE_COLOR(0x8000000Fu));
    EXPECT_EQ(control.Title(), "untitled");
    EXPECT_EQ(control.Amount(), 2);
    EXPECT_EQ(control.Temper(), Mood::Merry);
    EXPECT_EQ(control.Level(), 5);
    EXPECT_EQ(control.Image(), nullptr);
}

TEST_F(Controls, PlacedNewLeavesTheChildrenAsTheyWereDesigned) {
    auto made = std::make_unique<TestControl>(host.Frame());
    made->Child1.SetText("designed otherwise");
    made->InitProperties();
    EXPECT_EQ(made->Text(), "designed otherwise");
    EXPECT_EQ(made->Number(), 30);
}

TEST_F(Controls, LoadsStraightIntoFieldsAndChildrenAndReportsNothing) {
    const MemoryBag bag = BagOf({{"Number", 4}, {"Level", 8}, {"Serial", 9}, {"Text", "from the bag"}});
    const TestControl& control = Load(bag);
    EXPECT_EQ(control.Number(), 4);
    EXPECT_EQ(control.Level(), 8);
    EXPECT_EQ(control.Serial(), 9);
    EXPECT_EQ(control.Text(), "from the bag");
    EXPECT_EQ(Changes(host.log), "");
}

TEST_F(Controls, LoadsRunTimeAndReadOnlyPropertiesAtDesignTimeToo) {
    const MemoryBag bag = BagOf({{"Level", 8}, {"Serial", 9}});
    const auto& control = host.Create<TestControl>("Test1", {.designTime = true, .saved = &bag});
    EXPECT_EQ(control.Level(), 8);
    EXPECT_EQ(control.Serial(), 9);
}

TEST_F(Controls, LoadedFromAnEmptyBagIsLikeOnePlacedNew) { EXPECT_EQ(StateOf(Load(MemoryBag())), StateOf(Make())); }

TEST_F(Controls, ReadsEachKeyOnceInTheFixedOrderWithItsDefault) {
    const WatchedBag bag;
    Load(bag);
    EXPECT_THAT(bag.reads, ElementsAre("Number", "Tint", "Title", "Amount", "Temper", "Face", "Image", "Text", "Level", "Serial"));
    EXPECT_EQ(bag.defaults[0].Type(), VarType::Integer);
    EXPECT_EQ(bag.defaults[0].ToLong(), 30);
    EXPECT_TRUE(bag.defaults[1].IsColor());
    EXPECT_EQ(bag.defaults[2].ToText(), "untitled");
    EXPECT_EQ(bag.defaults[3].Type(), VarType::Integer);  // the key's type, not the field's
    EXPECT_TRUE(bag.defaults[6].ToObject().IsNothing());
}

TEST_F(Controls, ConvertsABagValueOfAnotherType) {
    const MemoryBag bag =
        BagOf({{"Number", "12.5"}, {"Tint", 255.0}, {"Title", 7}, {"Amount", "0.25"}, {"Temper", true}, {"Level", 3.5}});
    const TestControl& control = Load(bag);
    EXPECT_EQ(control.Number(), 12);
    EXPECT_EQ(control.Tint(), OLE_COLOR(255));
    EXPECT_EQ(control.Title(), "7");
    EXPECT_EQ(control.Amount(), 0.25f);
    EXPECT_EQ(static_cast<int>(control.Temper()), -1);
    EXPECT_EQ(control.Level(), 4);
}

TEST_F(Controls, FailsToLoadWithTheErrorOfTheConversion) {
    EXPECT_EQ(ErrorOf([&] { Load(BagOf({{"Number", "many"}})); }), errors::typeMismatch);
    EXPECT_EQ(ErrorOf([&] { Load(BagOf({{"Number", 40'000}})); }), errors::overflow);
    EXPECT_EQ(ErrorOf([&] { Load(BagOf({{"Face", "Arial"}})); }), errors::objectRequired);
    EXPECT_EQ(ErrorOf([&] { Load(BagOf({{"Face", std::make_shared<Picture>()}})); }), errors::typeMismatch);
    EXPECT_EQ(host.FindSite("Loaded1"), nullptr);
}

TEST_F(Controls, LeavesAFailedLoadWhereItStands) {
    TestControl control(host.Frame());
    EXPECT_EQ(ErrorOf([&] {
                  control.ReadProperties(BagOf({{"Tint", 1}, {"Title", "read"}, {"Amount", "x"}, {"Level", 8}}));
              }),
              errors::typeMismatch);
    EXPECT_EQ(control.Title(), "read");
    EXPECT_EQ(control.Tint(), OLE_COLOR(1));
    EXPECT_EQ(control.Level(), 0);
}

// Saving

TEST_F(Controls, PlacedNewAndSavedAtOnceHandsOverTheDefaultForEachKey) {
    const MemoryBag bag = host.Save(Make());
    EXPECT_EQ(bag.Written().size(), 10u);
    for (const MemoryBag::Write& write : bag.Written()) EXPECT_TRUE(write.value == write.otherwise) << write.key;
    EXPECT_TRUE(bag.Kept().empty());
}

TEST_F(Controls, ComesBackFromWhatTheHostKept) {
    TestControl& control = Make();
    control.SetNumber(-4);
    control.SetTint(0x80000012u);
    control.SetTitle("");
    control.SetAmount(0.125f);
    control.SetTemper(Mood::Calm);
    control.SetFace(std::make_shared<Font>("Arial", 14));
    control.SetText("changed");
    control.SetLevel(100'000);
    control.own.Serial = 3;
    control.SetImage(std::make_shared<Picture>(30.0f, 60.0f, "a.bmp"));
    const TestControl& loaded = Load(host.Save(control));
    EXPECT_EQ(StateOf(loaded), StateOf(control));
    EXPECT_EQ(loaded.Image(), control.Image());
    EXPECT_EQ(loaded.Number(), -4);
    EXPECT_EQ(loaded.Title(), "");
}

TEST_F(Controls, WritesTheFieldsTypeAndReadsAChildAtThatMoment) {
    TestControl& control = Make();
    control.Child1.SetText("set in the child");
    const MemoryBag bag = host.Save(control);
    EXPECT_EQ(bag.Written()[3].key, "Amount");
    EXPECT_EQ(bag.Written()[3].value.Type(), VarType::Single);
    EXPECT_EQ(bag.ReadProperty("Text", "").ToText(), "set in the child");
}

TEST_F(Controls, SavesInItsOwnOrderWhereThatIsNotTheOrderOfLoading) {
    auto& control = host.Create<OddControl>("Odd1");
    EXPECT_THAT(WrittenKeys(host.Save(control)), ElementsAre("Third", "Tint", "First", "Second"));
    const WatchedBag bag;
    control.ReadProperties(bag);
    EXPECT_THAT(bag.reads, ElementsAre("First", "Second", "Third", "Tint"));
}

TEST_F(Controls, SavesWithTheDefaultOfSavingAndLoadsWithThatOfLoading) {
    auto& control = host.Create<OddControl>("Odd1");
    EXPECT_EQ(control.own.First, 1);
    EXPECT_EQ(host.Save(control).ReadProperty("First", 0).ToLong(), 1);
    control.own.First = 10;
    const MemoryBag bag = host.Save(control);
    EXPECT_EQ(bag.ReadProperty("First", 0).ToLong(), 0);
    EXPECT_EQ(host.Create<OddControl>("Odd2", {.saved = &bag}).own.First, 1);
}

TEST_F(Controls, TakesASystemColorAsTheDefaultOfSavingToo) {
    auto& control = host.Create<OddControl>("Odd1");
    EXPECT_EQ(control.own.Tint, OLE_COLOR(192));
    EXPECT_EQ(host.Save(control).ReadProperty("Tint", 0).ToLong(), 192);
    control.own.Tint = 0x8000000Fu;
    EXPECT_EQ(host.Save(control).ReadProperty("Tint", 0).ToLong(), 0);
}

// Fonts

TEST_F(Controls, TakesACopyOfTheAmbientFontAtEachRead) {
    const auto ambient = std::make_shared<Font>("Arial", 14);
    TestControl& control = Make({.ambientFont = ambient});
    const FontRef first = control.AmbientFont(), second = control.AmbientFont();
    EXPECT_NE(first, second);
    EXPECT_NE(first, ambient);
    EXPECT_TRUE(first->EqualsObject(*ambient));
    first->SetSize(72);
    EXPECT_EQ(control.AmbientFont()->Size(), 14);
}

TEST_F(Controls, LoadedFromAnEmptyBagTakesTheAmbientFont) {
    const MemoryBag empty;
    const auto ambient = std::make_shared<Font>("Arial", 14);
    const auto& control = host.Create<TestControl>("Test1", {.saved = &empty, .ambientFont = ambient});
    ASSERT_NE(control.Face(), nullptr);
    EXPECT_TRUE(control.Face()->EqualsObject(*ambient));
    EXPECT_NE(control.Face(), ambient);
    EXPECT_TRUE(host.Save(const_cast<TestControl&>(control)).Kept().empty());
}

TEST_F(Controls, KeepsAFontInTheBagOnlyWhereItsMembersAreNotTheAmbientOnes) {
    TestControl& control = Make({.ambientFont = std::make_shared<Font>("Arial", 14)});
    control.SetFace(std::make_shared<Font>("Arial", 14));
    EXPECT_TRUE(host.Save(control).Kept().empty());
    control.Face()->SetItalic(true);
    EXPECT_EQ(host.Save(control).Kept().size(), 1u);
    host.SiteOf(control)->SetAmbientFont(control.Face()->Copy());
    EXPECT_TRUE(host.Save(control).Kept().empty());
}

TEST_F(Controls, SharesTheFontThatItWasGiven) {
    TestControl& control = Make();
    const auto font = std::make_shared<Font>("Arial", 14);
    control.Put("Face", font);
    EXPECT_EQ(control.Get("Face").ToObject().Get(), font.get());
}

// Setters and refusals

TEST_F(Controls, ReportsEachSetByItsKey) {
    TestControl& control = Make();
    control.SetNumber(1);
    control.Put("text", "x");
    control.SetNumber(1);
    EXPECT_EQ(Changes(host.log), "Number Text Number");
}

TEST_F(Controls, RefusesARunTimePropertyAtDesignTimeOnly) {
    TestControl& control = Make({.designTime = true});
    EXPECT_EQ(ErrorOf([&] { control.SetLevel(8); }), errors::notPermitted);
    EXPECT_EQ(ErrorOf([&] { control.Put("Level", 8); }), errors::notPermitted);
    EXPECT_EQ(control.Level(), 5);
    EXPECT_EQ(Changes(host.log), "");
    host.SiteOf(control)->SetUserMode(true);
    control.Put("Level", 8);
    EXPECT_EQ(control.Level(), 8);
    EXPECT_EQ(Changes(host.log), "Level");
}

TEST_F(Controls, RefusesAReadOnlyPropertyAtDesignTimeAndOtherwiseAtRunTime) {
    TestControl& control = Make({.designTime = true});
    EXPECT_EQ(ErrorOf([&] { control.Put("Serial", 8); }), errors::notPermitted);
    host.SiteOf(control)->SetUserMode(true);
    EXPECT_EQ(ErrorOf([&] { control.Put("Serial", 8); }), errors::notAtRunTime);
}

TEST_F(Controls, LeavesValueAndBagOfAReadOnlyPropertyAlone) {
    for (const bool designTime : {true, false}) {
        TestControl& control = Make({.designTime = designTime});
        control.own.Serial = 3;
        EXPECT_NE(ErrorOf([&] { control.Put("Serial", 8); }), 0);
        EXPECT_EQ(control.Get("Serial").ToLong(), 3);
        EXPECT_EQ(host.Save(control).ReadProperty("Serial", 0).ToLong(), 3);
    }
    EXPECT_EQ(Changes(host.log), "");
}

TEST_F(Controls, RefusesBeforeItLooksAtTheValue) {
    TestControl& control = Make({.designTime = true});
    EXPECT_EQ(ErrorOf([&] { control.Put("Serial", "no number"); }), errors::notPermitted);
}

TEST_F(Controls, RefusesByNumberWithTheStandardWords) {
    TestControl& control = Make({.designTime = true});
    try {
        control.SetLevel(1);
        FAIL();
    } catch (const ControlError& error) {
        EXPECT_EQ(error.Description(), ErrorText(errors::notPermitted));
    }
}

TEST_F(Controls, NeverRefusesToBeRead) {
    TestControl& control = Make({.designTime = true});
    EXPECT_EQ(control.Get("Level").ToLong(), 5);
    EXPECT_EQ(control.Get("Serial").ToLong(), 0);
    EXPECT_EQ(control.Get("Total").ToLong(), 7);
}

TEST_F(Controls, HasNoSetterForWhatIsOnlyComputed) {
    for (const bool designTime : {true, false})
        EXPECT_EQ(ErrorOf([&] { Make({.designTime = designTime}).Put("Total", 1); }), errors::notAtRunTime);
}

// Let go

TEST_F(Controls, ThatTheHostHasLetGoAsksAndTellsNothing) {
    TestControl& control = Make({.extender = {{"ToolTipText", "tip"}}});
    EXPECT_EQ(control.ToolTip(), "tip");
    host.SiteOf(control)->Detach();
    control.SetNumber(9);
    control.Tell();
    EXPECT_EQ(control.Number(), 9);
    EXPECT_EQ(control.Site(), nullptr);
    EXPECT_FALSE(control.UserMode());
    EXPECT_EQ(ErrorOf([&] { control.ToolTip(); }), errors::objectGone);
    EXPECT_TRUE(control.AmbientFont()->EqualsObject(Font()));
    EXPECT_EQ(control.Path(), "TestControl");
    EXPECT_EQ(control.Surface().Width(), 0);
    control.Surface().SetWidth(500);
    EXPECT_EQ(control.Surface().Width(), 0);
    EXPECT_EQ(Changes(host.log), "");
    EXPECT_EQ(host.log.EventNames(), "");
}

// Children

TEST_F(Controls, AChildIsMovedAsAWholeOrByOneEdge) {
    test::TestChild& child = Make().Child1;
    child.Move(10, 20, 300, 400);
    child.SetLeft(15);
    child.Put("Height", 50);
    EXPECT_EQ(child.Left(), 15);
    EXPECT_EQ(child.Top(), 20);
    EXPECT_EQ(child.Width(), 300);
    EXPECT_EQ(child.Height(), 50);
    EXPECT_EQ(child.moves, 3);
}

TEST_F(Controls, AMoveOfAChildToItsOwnPlaceIsNone) {
    test::TestChild& child = Make().Child1;
    child.Move(10, 20, 300, 400);
    child.Move(10, 20, 300, 400);
    child.SetWidth(300);
    EXPECT_EQ(child.moves, 1);
}

TEST_F(Controls, AChildHasNoNegativeSize) {
    test::TestChild& child = Make().Child1;
    child.Move(-10, -20, -300, -400);
    EXPECT_EQ(child.Left(), -10);
    EXPECT_EQ(child.Width(), 0);
    EXPECT_EQ(child.Height(), 0);
    child.SetWidth(-1);
    EXPECT_EQ(child.Width(), 0);
}

TEST_F(Controls, AChildIsReadAndSetByName) {
    test::TestChild& child = Make().Child1;
    child.Put("visible", false);
    child.Put("Enabled", 0);
    child.Put("ToolTipText", 5);
    child.Put("Text", "x");
    EXPECT_FALSE(child.Visible());
    EXPECT_FALSE(child.Enabled());
    EXPECT_EQ(child.ToolTipText(), "5");
    EXPECT_EQ(child.Text(), "x");
    EXPECT_EQ(child.Get("Name").ToText(), "Child1");
    EXPECT_EQ(ErrorOf([&] { child.Put("Name", "Other"); }), errors::notAtRunTime);
    child.Call("Refresh");
}

}  // namespace
}  // namespace tessel::frame
