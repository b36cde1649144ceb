#include "frame/child/ListHeaders.h"

#include <gtest/gtest.h>

#include <string>

#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"
#include "tests/frame/child/ListOwner.h"

namespace tessel::child {
namespace {

using frame::ObjectRef;
using frame::Variant;
using test::ErrorOf;
using test::ListOwner;
namespace errors = frame::errors;

class ListHeadersTest : public testing::Test {
  protected:
    ListHeadersTest() : owner(&host.Create<ListOwner>("FileView1")) {}

    ListView& List() { return owner->list; }
    ColumnHeaders& Headers() { return List().ColumnHeaders; }
    ColumnHeader& Add(const char* text, float width = 1000) { return Headers().Add({}, {}, text, width); }
    /// The texts by index; then by their places in view.
    std::string Texts() {
        std::string texts;
        for (int index = 1; index <= Headers().Count(); ++index) texts += (index > 1 ? " " : "") + Headers().Item(index).Text();
        return texts;
    }
    std::string TextsInView() {
        std::string texts;
        for (int place = 1; place <= Headers().Count(); ++place) {
            EXPECT_EQ(Headers().InView(place).Position(), place);
            texts += (place > 1 ? " " : "") + Headers().InView(place).Text();
        }
        return texts;
    }
    void AddImage(const char* key) { owner->Image16.ListImages.Add({}, key, std::make_shared<frame::Picture>(240.0f, 240.0f, "")); }

    headless::HeadlessHost host;
    ListOwner* owner;
};

TEST_F(ListHeadersTest, AddTakesWhatIsGivenAndDefaultsOtherwise) {
    const ColumnHeader& plain = Headers().Add();
    EXPECT_EQ(plain.Text(), "");
    EXPECT_EQ(plain.Width(), 1440);
    EXPECT_EQ(plain.Alignment(), AlignmentConstants::LeftJustify);
    EXPECT_TRUE(plain.Icon().IsEmpty());
    EXPECT_TRUE(plain.Tag().IsEmpty());
    EXPECT_EQ(plain.Tag().ToText(), "");
    const ColumnHeader& size = Headers().Add(1, "Folder", "Size", 0.0f, AlignmentConstants::RightJustify);
    EXPECT_EQ(size.Index(), 1);
    EXPECT_EQ(plain.Index(), 2);
    EXPECT_EQ(plain.SubItemIndex(), 1);
    EXPECT_EQ(Headers().Item("folder").Text(), "Size");
    EXPECT_EQ(size.Width(), 0);
    EXPECT_EQ(size.Alignment(), AlignmentConstants::RightJustify);
}

TEST_F(ListHeadersTest, WrongIndexesAndKeysAreTheErrorsOfACollection) {
    Headers().Add({}, "a");
    EXPECT_EQ(ErrorOf([&] { Headers().Add({}, "A"); }), errors::keyNotUnique);
    EXPECT_EQ(ErrorOf([&] { Headers().Add(3); }), errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { Headers().Add(0); }), errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { Headers().Item(2); }), errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { Headers().Item("b"); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { Headers().Item(""); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { Headers().Remove("b"); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { Headers().InView(0); }), errors::indexOutOfBounds);
    EXPECT_EQ(Headers().Count(), 1);
    ColumnHeader& other = Headers().Add();
    EXPECT_EQ(ErrorOf([&] { other.SetKey("A"); }), errors::keyNotUnique);
    Headers().Item(1).SetKey("A");
    other.SetKey("a2");
    EXPECT_EQ(Headers().Item("A2").Index(), 2);
}

TEST_F(ListHeadersTest, RemoveAndClearEndHeaders) {
    for (const char* text : {"a", "b", "c"}) Add(text);
    const ObjectRef second(Headers().Item(2)), third(Headers().Item(3));
    Headers().Remove(2);
    EXPECT_EQ(Texts(), "a c");
    EXPECT_EQ(TextsInView(), "a c");
    EXPECT_EQ(second.Get(), nullptr);
    Headers().Clear();
    EXPECT_EQ(Headers().Count(), 0);
    EXPECT_EQ(third.Get(), nullptr);
}

TEST_F(ListHeadersTest, PositionMovesAColumnInViewAndLeavesItsIndex) {
    for (const char* text : {"a", "b", "c", "d"}) Add(text);
    Headers().Item(1).SetPosition(3);
    EXPECT_EQ(TextsInView(), "b c a d");
    EXPECT_EQ(Texts(), "a b c d");
    Headers().Item(4).SetPosition(1);
    EXPECT_EQ(TextsInView(), "d b c a");
    Headers().Item(4).SetPosition(99);
    EXPECT_EQ(TextsInView(), "b c a d");
    EXPECT_EQ(ErrorOf([&] { Headers().Item(1).SetPosition(0); }), errors::invalidValue);
    EXPECT_EQ(Headers().Item(1).SubItemIndex(), 0);
}

TEST_F(ListHeadersTest, LeftSumsTheColumnsBeforeItInView) {
    Add("a", 1000);
    Add("hidden", 0);
    Add("c", 500);
    Add("d", 200);
    EXPECT_EQ(Headers().Item(3).Left(), 1000);
    Headers().Item(4).SetPosition(1);
    EXPECT_EQ(Headers().Item(3).Left(), 1200);
    Headers().Item(1).SetWidth(-5);
    EXPECT_EQ(Headers().Item(1).Width(), 0);
    EXPECT_EQ(Headers().Item(3).Left(), 200);
}

TEST_F(ListHeadersTest, AnIconComesFromTheHeaderImagesAndIsClearedByZero) {
    AddImage("SortDown");
    ColumnHeader& header = Add("a");
    EXPECT_EQ(header.SetIcon("SortDown").Number(), errors::elementNotFound);
    List().SetColumnHeaderIcons(&owner->Image16);
    EXPECT_FALSE(header.SetIcon("SortDown").Failed());
    EXPECT_EQ(header.SetIcon("SortUp").Number(), errors::elementNotFound);
    EXPECT_EQ(header.SetIcon(2).Number(), errors::indexOutOfBounds);
    EXPECT_EQ(header.Icon(), Variant("SortDown"));
    EXPECT_FALSE(header.SetIcon(0).Failed());
    EXPECT_TRUE(header.Icon().IsEmpty());
    EXPECT_FALSE(header.SetIcon(1).Failed());
    EXPECT_EQ(header.Icon(), Variant(1));
    EXPECT_EQ(ErrorOf([&] { Headers().Add({}, {}, "b", {}, {}, Variant("SortUp")); }), errors::elementNotFound);
    EXPECT_EQ(Texts(), "a b");
}

TEST_F(ListHeadersTest, AnIconOutlastsTheBindingOfItsImages) {
    AddImage("SortDown");
    List().SetColumnHeaderIcons(&owner->Image16);
    ColumnHeader& header = Add("a");
    header.SetIcon("SortDown").Check();
    List().SetColumnHeaderIcons(nullptr);
    EXPECT_EQ(header.Icon(), Variant("SortDown"));
    List().SetColumnHeaderIcons(&owner->Image16);
    EXPECT_EQ(header.Icon(), Variant("SortDown"));
}

TEST_F(ListHeadersTest, AClickIsHeardWithTheHeadersNumber) {
    Add("a");
    Add("b");
    List().ColumnClickInput(2);
    EXPECT_EQ(owner->Heard(), "ColumnClick 2");
    List().ColumnClickInput(3);
    EXPECT_EQ(owner->Heard(), "");
    ASSERT_EQ(host.errors.reports.size(), 1u);
    EXPECT_EQ(host.errors.reports[0].error.Number(), errors::indexOutOfBounds);
}

TEST_F(ListHeadersTest, TheUserSizesOnlyWhatIsSeenAndNeverToNothing) {
    Add("a", 1000);
    Add("hidden", 0);
    List().ColumnWidthInput(1, 333.5f);
    EXPECT_EQ(Headers().Item(1).Width(), 333.5f);
    List().ColumnWidthInput(1, -20);
    EXPECT_EQ(Headers().Item(1).Width(), 15);
    List().ColumnWidthInput(2, 500);
    EXPECT_EQ(Headers().Item(2).Width(), 0);
}

TEST_F(ListHeadersTest, TheUserMovesColumnsOnlyWhereItIsAllowed) {
    for (const char* text : {"a", "b", "c"}) Add(text);
    List().ColumnMoveInput(1, 3);
    EXPECT_EQ(TextsInView(), "a b c");
    List().SetAllowColumnReorder(true);
    List().ColumnMoveInput(1, 3);
    EXPECT_EQ(TextsInView(), "b c a");
}

TEST_F(ListHeadersTest, EachChangeHasAnotherRevision) {
    ColumnHeader& header = Add("a");
    std::uint32_t last = Headers().Revision();
    const auto isNew = [&] { return std::exchange(last, Headers().Revision()) != last; };
    header.SetText("b");
    EXPECT_TRUE(isNew());
    header.SetText("b");
    EXPECT_FALSE(isNew());
    header.SetWidth(10);
    EXPECT_TRUE(isNew());
    header.SetAlignment(AlignmentConstants::Center);
    EXPECT_TRUE(isNew());
    Add("c");
    EXPECT_TRUE(isNew());
    header.SetPosition(2);
    EXPECT_TRUE(isNew());
}

TEST_F(ListHeadersTest, EverythingIsReachedByName) {
    frame::Object& list = *owner->Inner("ListFiles");
    const ObjectRef headers = list.Inner("ColumnHeaders");
    Variant added[] = {Variant::Missing(), "RealName", "Name", 2540, 1};
    const ObjectRef header = headers->Call("Add", added).ToObject();
    EXPECT_EQ(header->Path(), "FileView1.ListFiles.ColumnHeaders(1)");
    EXPECT_EQ(header->Get("Width"), Variant(2540));
    EXPECT_EQ(header->Get("Alignment"), Variant(1));
    Variant key[] = {"realname"};
    EXPECT_EQ(headers->Get("Item", key), Variant(header));
    header->Put("Tag", "13");
    EXPECT_EQ(header->Get("Tag"), Variant("13"));
    EXPECT_EQ(ErrorOf([&] { header->Put("Icon", "SortUp"); }), errors::elementNotFound);
    header->Put("Icon", 0);
    EXPECT_EQ(headers->Get("Count"), Variant(1));
    headers->Call("Remove", key);
    EXPECT_EQ(ErrorOf([&] { header->Get("Text"); }), errors::objectGone);
}

}  // namespace
}  // namespace tessel::child
