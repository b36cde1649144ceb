#include "hosts/headless/MemoryRecordset.h"

#include <gtest/gtest.h>

#include <array>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "controls/datalist/DataList.h"
#include "frame/ClassTable.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"

namespace tessel::headless {
namespace {

using frame::Variant;
using test::ErrorOf;

MemoryRecordset Colours() { return {"RS1", {"Name", "Id"}, {{"Red", 1}, {"Green", 2}, {"", 3}, {"Blue", 4}}}; }

TEST(MemoryRecordset, WalksItsRows) {
    MemoryRecordset records = Colours();
    std::string names;
    for (records.MoveFirst(); !records.AtEnd(); records.MoveNext()) names += records.FieldValue(0).ToText() + ",";
    EXPECT_EQ(names, "Red,Green,,Blue,");
    EXPECT_EQ(ErrorOf([&] { records.MoveNext(); }), frame::errors::noCurrentRow);
    EXPECT_EQ(ErrorOf([&] { records.FieldValue(0); }), frame::errors::noCurrentRow);
}

TEST(MemoryRecordset, AnEmptyOneHasNoFirstRow) {
    MemoryRecordset records("RS1", {"Name"}, {});
    EXPECT_TRUE(records.AtEnd());
    EXPECT_EQ(ErrorOf([&] { records.MoveFirst(); }), 3021);
    EXPECT_EQ(records.Fields("name")->Name(), "Name");
}

TEST(MemoryRecordset, FieldsAreFoundByNameInAnyCaseAndByNumber) {
    MemoryRecordset records = Colours();
    EXPECT_EQ(records.Fields("ID")->Value().ToLong(), 1);
    EXPECT_EQ(records.Fields(0)->Value().ToText(), "Red");
    EXPECT_EQ(ErrorOf([&] { records.Fields("nothing"); }), frame::errors::noSuchField);
    EXPECT_EQ(ErrorOf([&] { records.Fields(2); }), frame::errors::noSuchField);
    EXPECT_EQ(ErrorOf([&] { records.Fields(-1); }), frame::errors::noSuchField);
}

TEST(MemoryRecordset, AFieldReadsTheRowOnWhichTheRecordsetStands) {
    MemoryRecordset records = Colours();
    const auto field = records.Fields("Name");
    records.MoveNext();
    EXPECT_EQ(field->Value().ToText(), "Green");
}

TEST(MemoryRecordset, IsReachedByNames) {
    MemoryRecordset records = Colours();
    records.Call("MoveFirst");
    records.Call("MoveNext");
    Variant column[] = {"name"};
    const frame::ObjectRef field = records.Get("Fields", column).ToObject();
    EXPECT_EQ(field->Get("Value").ToText(), "Green");
    EXPECT_EQ(field->Get("Name").ToText(), "Name");
    EXPECT_FALSE(records.Get("EOF").ToBoolean());
}

TEST(MemoryRecordset, ARowOfAnotherWidthIsRefused) {
    EXPECT_EQ(ErrorOf([] { MemoryRecordset("RS1", {"a", "b"}, {{1}}); }), frame::errors::invalidCall);
}

// Filling a list.

class Populating : public testing::Test {
  protected:
    std::string Items() const {
        std::string items;
        const child::ComboList& list = control.listItems[control.Sorted() ? 1 : 0];
        for (std::int32_t i = 0; i < list.ListCount(); ++i)
            items += (i ? ", " : "") + list.List(i) + "=" + frame::Decimal(list.ItemData(i));
        return items;
    }
    std::string Fill(frame::Object& records, const Variant& text = "Name", const Variant& value = "Id") {
        return control.Populate(frame::ObjectRef(records), text, value);
    }

    HeadlessHost host;
    controls::DataList& control = host.Create<controls::DataList>("DataList1");
};

TEST_F(Populating, TakesTheRowsAndDropsBlankTexts) {
    MemoryRecordset records = Colours();
    EXPECT_EQ(Fill(records), "");
    EXPECT_EQ(Items(), "Red=1, Green=2, Blue=4");
    EXPECT_TRUE(records.AtEnd());
}

TEST_F(Populating, AnEmptyOneAndAWrongColumnLeaveTheListAsItWas) {
    control.AddItem("old", 9);
    MemoryRecordset empty("RS1", {"Name", "Id"}, {}), records = Colours();
    EXPECT_EQ(Fill(empty), frame::ErrorText(3021));
    EXPECT_EQ(Fill(records, "Nome"), "TextColumn=Nome - " + frame::ErrorText(frame::errors::noSuchField));
    EXPECT_EQ(Fill(records, 0, 7), "ValueColumn=7 - " + frame::ErrorText(frame::errors::noSuchField));
    EXPECT_EQ(control.Populate({}, 0, 1), frame::ErrorText(frame::errors::objectGone));
    EXPECT_EQ(Items(), "old=9");
}

/// What an application may have: an object with the members of a recordset, which fails where it is told to.
class Foreign final : public frame::Object {
  public:
    explicit Foreign(int count) : count_(count) {}

    void MoveFirst() { at_ = 0; }
    void MoveNext() {
        if (at_ == failsAfter || failingMoves.count(++moves_)) throw frame::ControlError(3146, "the line is cut");
        ++at_;
    }
    bool End() {
        if (failingTests.count(++tests_)) throw frame::ControlError(3146, "nobody knows");
        return at_ >= count_;
    }
    frame::ObjectRef Fields(const Variant& index) { return frame::ObjectRef(index.ToText() == "n" ? number_ : text_); }

    const frame::ClassTable& Table() const override {
        static constexpr std::array members = {frame::method<&Foreign::MoveFirst>("MoveFirst"),
                                               frame::method<&Foreign::MoveNext>("MoveNext"), frame::property<&Foreign::End>("EOF"),
                                               frame::property<&Foreign::Fields>("Fields")};
        static constexpr frame::ClassTable table{.name = "Foreign", .members = members};
        return table;
    }

    int failsAfter = -1;
    std::set<int> failingMoves, failingTests;  // which of them, from 1

  private:
    struct Cell final : frame::Object {
        Cell(const Foreign& holder, bool isNumber) : of(holder), number(isNumber) {}
        std::string Name() const { return number ? "n" : "t"; }
        Variant Value() const {
            if (number) return of.at_;
            return "row " + frame::Decimal(of.at_);
        }
        const frame::ClassTable& Table() const override {
            static constexpr std::array members = {frame::property<&Cell::Name>("Name"), frame::property<&Cell::Value>("Value")};
            static constexpr frame::ClassTable table{.name = "Cell", .members = members};
            return table;
        }
        const Foreign& of;
        bool number;
    };

    int count_, at_ = 0, moves_ = 0, tests_ = 0;
    Cell number_{*this, true}, text_{*this, false};
};

TEST_F(Populating, AnyObjectWithTheMembersWillDo) {
    Foreign records(3);
    EXPECT_EQ(Fill(records, "t", "n"), "");
    EXPECT_EQ(Items(), "row 0=0, row 1=1, row 2=2");
}

TEST_F(Populating, ASourceThatCannotGoOnEndsTheFillAndTellsWhy) {
    Foreign records(5);
    records.failsAfter = 2;
    EXPECT_EQ(Fill(records, "t", "n"), "the line is cut");
    EXPECT_EQ(Items(), "row 0=0, row 1=1, row 2=2, row 2=2");
}

TEST_F(Populating, FailuresWithSoundRowsBetweenThemDoNotEndTheFill) {
    Foreign records(4);
    records.failingMoves = {2, 4, 6};
    EXPECT_EQ(Fill(records, "t", "n"), "");
    EXPECT_EQ(Items(), "row 0=0, row 1=1, row 1=1, row 2=2, row 2=2, row 3=3, row 3=3");
    Foreign twice(4);
    twice.failingMoves = {2, 3};
    EXPECT_EQ(Fill(twice, "t", "n"), "the line is cut");
    EXPECT_EQ(Items(), "row 0=0, row 1=1, row 1=1");
}

TEST_F(Populating, ATestForTheEndThatFailsTwiceWithoutASoundRowBetweenEndsTheFill) {
    Foreign records(4);
    records.failingTests = {1, 3};
    EXPECT_EQ(Fill(records, "t", "n"), "");
    EXPECT_EQ(Items(), "row 0=0, row 1=1, row 2=2, row 3=3");
    Foreign twice(4);
    twice.failingTests = {2, 3};
    EXPECT_EQ(Fill(twice, "t", "n"), "nobody knows");
    EXPECT_EQ(Items(), "row 0=0, row 1=1");
    Foreign both(4);
    both.failingTests = {2};
    both.failingMoves = {2};
    EXPECT_EQ(Fill(both, "t", "n"), "the line is cut");
    EXPECT_EQ(Items(), "row 0=0, row 1=1");
}

TEST_F(Populating, RowsBeyondTheItemCounterAreAddedUnderItsLastNumber) {
    constexpr int rows = 32'770;
    Foreign records(rows);
    control.SetStyle(controls::DataListStyleConstants::Count_and_Text);
    EXPECT_EQ(Fill(records, "t", "n"), "");
    const child::ComboList& list = control.listItems[0];
    ASSERT_EQ(list.ListCount(), rows);
    EXPECT_EQ(list.List(0), "   1 - row 0");
    EXPECT_EQ(list.List(32'766), "2767 - row 32766");
    EXPECT_EQ(list.List(32'767), "2767 - row 32767");
    EXPECT_EQ(list.List(32'769), "2767 - row 32769");
    EXPECT_EQ(list.ItemData(32'769), 32'769);
    EXPECT_EQ(ErrorOf([&] { control.ListCount(); }), frame::errors::overflow);
    control.SetValue(32'769);
    EXPECT_EQ(control.Value(), 32'769);
}

TEST_F(Populating, ADefaultValueBeyond16BitsLeavesTheOneThatWasThere) {
    MemoryRecordset records = Colours();
    control.SetDefaultValue(7);
    EXPECT_EQ(control.Populate(frame::ObjectRef(records), "Name", "Id", Variant("none"), Variant(70'000)), "");
    EXPECT_EQ(Items(), "none=7, Red=1, Green=2, Blue=4");
    EXPECT_EQ(control.DefaultValue(), 7);
    EXPECT_EQ(control.Value(), 7);
    EXPECT_EQ(control.Text(), "none");
}

TEST_F(Populating, TheChosenDefaultStaysChosenInASortedList) {
    MemoryRecordset records = Colours();
    control.SetSorted(true);
    EXPECT_EQ(control.Populate(frame::ObjectRef(records), "Name", "Id", Variant("M"), Variant(7)), "");
    EXPECT_EQ(Items(), "Blue=4, Green=2, M=7, Red=1");
    EXPECT_EQ(control.Text(), "M");
    EXPECT_EQ(control.labItem.Caption(), "M");
}

}  // namespace
}  // namespace tessel::headless
