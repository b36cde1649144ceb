#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "tests/ErrorOf.h"
#include "tests/controls/fileview/FileViewTestHelp.h"

/// The items and images under the cursor.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::Variant;
using test::ErrorOf;
using testing::ElementsAre;
using testing::IsEmpty;

class FileViewItems : public testing::Test {
  protected:
    FileViewItems() {
        stage.File("C:\\x\\a.txt", 1500);
        stage.File("C:\\x\\b.txt", 2);
        stage.File("C:\\x\\sub\\c.txt", 3);
        stage.ShowPath("C:\\x");
        stage.Changes();
    }
    Stage stage;
    FileView& view = stage.View();
};

TEST_F(FileViewItems, TheCursorReadsTheCurrentItem) {
    view.SetItemIndex(2);
    EXPECT_EQ(view.ItemDisplayName(), "a.txt");
    EXPECT_EQ(view.ItemName(), "a.txt");
    EXPECT_EQ(view.ItemPath(), "C:\\x\\a.txt");
    EXPECT_EQ(view.ItemSize(), 1500);
    EXPECT_EQ(view.ItemType(), "TXT File");
    EXPECT_EQ(view.ItemIcon(), "txt");
    EXPECT_EQ(view.ItemSmallIcon(), "txt");
    EXPECT_EQ(view.ItemTag(), "");
    EXPECT_FALSE(view.ItemSelected());
    view.SetItemIndex(1);
    EXPECT_EQ(view.ItemSize(), 1);
    EXPECT_EQ(view.ItemIcon(), "File Folder");
}

TEST_F(FileViewItems, AnIndexOutsideIsPassedOver) {
    view.SetItemIndex(2);
    stage.Changes();
    for (const std::int32_t index : {0, -1, 4, 1000}) {
        view.SetItemIndex(index);
        EXPECT_EQ(view.ItemIndex(), 2);
    }
    EXPECT_THAT(stage.Changes(), IsEmpty());
    view.SetItemIndex(3);
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemIndex"));
}

TEST_F(FileViewItems, WithoutACurrentItemGettersAreEmptyAndSettersDoNothing) {
    stage.Folder("C:\\none");
    stage.ShowPath("C:\\none");
    stage.Changes();
    EXPECT_EQ(view.ItemIndex(), 0);
    EXPECT_EQ(view.ItemDisplayName(), "");
    EXPECT_EQ(view.ItemName(), "");
    EXPECT_EQ(view.ItemPath(), "");
    EXPECT_EQ(view.ItemSize(), 0);
    EXPECT_EQ(view.ItemType(), "");
    EXPECT_EQ(view.ItemIcon(), "");
    EXPECT_EQ(view.ItemSmallIcon(), "");
    EXPECT_EQ(view.ItemTag(), "");
    EXPECT_FALSE(view.ItemSelected());
    EXPECT_EQ(view.SelectedItem(), 0);
    view.SetItemDisplayName("x");
    view.SetItemName("x");
    view.SetItemIcon("txt");
    view.SetItemSmallIcon("txt");
    view.SetItemSelected(true);
    view.SetItemTag("x");
    view.SetSelectedItem(1);
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FileViewItems, TheLabelChangesAndTheNameStays) {
    view.SetItemIndex(2);
    view.SetItemDisplayName("nicer");
    EXPECT_EQ(view.ItemDisplayName(), "nicer");
    EXPECT_EQ(view.ItemName(), "a.txt");
    EXPECT_EQ(view.ItemPath(), "C:\\x\\a.txt");
    EXPECT_EQ(SubItem(view, 2, 12), "a.txt");
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemIndex", "ItemDisplayName"));
}

TEST_F(FileViewItems, SettingTheNameRenames) {
    view.SetItemIndex(2);
    view.SetItemName("  new.txt ");
    EXPECT_TRUE(stage.Disk().FileExists("C:\\x\\new.txt"));
    EXPECT_FALSE(stage.Disk().FileExists("C:\\x\\a.txt"));
    EXPECT_EQ(view.ItemDisplayName(), "  new.txt ");
    EXPECT_EQ(view.ItemName(), "new.txt");
    EXPECT_EQ(SubItem(view, 2, 12), "a.txt");
}

TEST_F(FileViewItems, SettingTheNameToTheSameInAnotherCaseChangesTheLabelOnly) {
    view.SetItemIndex(2);
    view.SetItemName("A.TXT");
    EXPECT_EQ(view.ItemName(), "a.txt");
    EXPECT_EQ(view.ItemDisplayName(), "A.TXT");
}

TEST_F(FileViewItems, SettingTheNameWithAnotherExtensionAsksFirst) {
    view.SetItemIndex(2);
    stage.host.dialogs.answers = {frame::msgbox::answerNo};
    view.SetItemName("a.doc");
    EXPECT_TRUE(stage.Disk().FileExists("C:\\x\\a.txt"));
    EXPECT_EQ(view.ItemName(), "a.txt");
    stage.host.dialogs.answers = {frame::msgbox::answerYes};
    view.SetItemName("a.doc");
    EXPECT_TRUE(stage.Disk().FileExists("C:\\x\\a.doc"));
}

TEST_F(FileViewItems, ARefusedRenamingPassesItsError) {
    view.SetItemIndex(2);
    EXPECT_EQ(ErrorOf([&] { view.SetItemName("b.txt"); }), frame::errors::fileExists);
    EXPECT_EQ(view.ItemName(), "a.txt");
}

TEST_F(FileViewItems, AFolderIsRenamedToo) {
    view.SetItemName("other");
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\other"));
    EXPECT_EQ(view.ItemName(), "other");
}

TEST_F(FileViewItems, ARenamedFolderKeepsTheCountThatTheListingFound) {
    constexpr int many = 100;
    for (int number = 0; number < many; ++number) stage.File("C:\\y\\f" + std::to_string(1000 + number) + "\\one");
    stage.ShowPath("C:\\y");
    view.SetItemIndex(many);
    view.SetItemName("zzz");
    EXPECT_EQ(SubItem(view, many, 7), "000000000001");
}

TEST_F(FileViewItems, AnIconThatTheListLacksIsPassedOver) {
    view.SetItemIndex(2);
    view.SetItemIcon("FOLDERUNAVAILABLE");
    EXPECT_EQ(frame::FoldCase(view.ItemIcon()), "folderunavailable");
    view.SetItemIcon("no such key");
    EXPECT_EQ(frame::FoldCase(view.ItemIcon()), "folderunavailable");
    view.SetItemSmallIcon("SortUp");
    view.SetItemSmallIcon("no such key");
    EXPECT_EQ(view.ItemSmallIcon(), "SortUp");
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemIndex", "ItemIcon", "ItemIcon", "ItemSmallIcon", "ItemSmallIcon"));
}

TEST_F(FileViewItems, SelectionAndTagBelongToTheRow) {
    view.SetItemIndex(3);
    view.SetItemSelected(true);
    view.SetItemTag("mine");
    EXPECT_EQ(view.SelectedItem(), 3);
    view.SetItemIndex(2);
    EXPECT_FALSE(view.ItemSelected());
    EXPECT_EQ(view.ItemTag(), "");
    view.ItemRemove(Variant(1));
    EXPECT_TRUE(view.ItemSelected());
    EXPECT_EQ(view.ItemTag(), "mine");
    EXPECT_EQ(view.SelectedItem(), 2);
}

TEST_F(FileViewItems, BoldChangesNothingButItself) {
    const std::string before = Row(view, 1);
    view.SetItemBold(true);
    EXPECT_TRUE(view.ItemBold());
    EXPECT_EQ(Row(view, 1), before);
}

TEST_F(FileViewItems, SettingSelectedItemTestsTheNewValueAndSelectsTheStoredOne) {
    EXPECT_EQ(ErrorOf([&] { view.SetSelectedItem(2); }), frame::errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { view.SetSelectedItem(0); }), 0);
    EXPECT_EQ(ErrorOf([&] { view.SetSelectedItem(4); }), 0);
    EXPECT_EQ(view.SelectedItem(), 0);
    const frame::MemoryBag bag(frame::MemoryBag::Contents{{"SelectedItem", Variant(3)}, {"Path", Variant("C:\\x")}});
    test::HostUnderTest host;
    for (const char* name : {"a", "b", "c"}) host.files.SetFile(std::string("C:\\x\\") + name, {}).Check();
    FileView& loaded = host.Create<FileView>("FileView1", {.saved = &bag});
    loaded.SetSelectedItem(1);
    EXPECT_EQ(loaded.SelectedItem(), 3);
}

TEST_F(FileViewItems, RunTimePropertiesRefuseAtDesignTime) {
    Stage design({.designTime = true});
    EXPECT_EQ(ErrorOf([&] { design.View().SetItemIndex(1); }), frame::errors::notPermitted);
    EXPECT_EQ(ErrorOf([&] { design.View().SetItemIcon("txt"); }), frame::errors::notPermitted);
    EXPECT_EQ(ErrorOf([&] { design.View().SetSelectedItem(0); }), frame::errors::notPermitted);
    EXPECT_EQ(ErrorOf([&] { design.View().SetImageSmall(true); }), frame::errors::notPermitted);
}

TEST_F(FileViewItems, AClickMovesTheCursorBeforeTheApplicationHearsOfIt) {
    std::int32_t seen = 0;
    stage.handlers.On(fileview::ItemClick, [&](std::int32_t&) { seen = view.ItemIndex(); });
    view.ListFiles.ItemClickInput(3);
    EXPECT_EQ(view.ItemIndex(), 3);
    EXPECT_EQ(seen, 3);
    EXPECT_EQ(stage.Events(), "ItemClick(3)");
}

TEST_F(FileViewItems, MouseAndKeysOfTheListAreForwarded) {
    view.ListFiles.MouseDownInput(1, 2, 3, 4);
    view.ListFiles.MouseMoveInput(0, 0, 5, 6);
    view.ListFiles.MouseUpInput(1, 0, 3, 4);
    view.ListFiles.ClickInput();
    view.ListFiles.DblClickInput();
    view.ListFiles.KeyDownInput(65, 1);
    view.ListFiles.KeyPressInput(97);
    view.ListFiles.KeyUpInput(65, 1);
    EXPECT_EQ(
        stage.Events(),
        "MouseDown(1, 2, 3, 4) MouseMove(0, 0, 5, 6) MouseUp(1, 0, 3, 4) Click DblClick KeyDown(65, 1) KeyPress(97) KeyUp(65, 1)");
}

// Adding and removing.

TEST_F(FileViewItems, AnyFileOrFolderCanBeAdded) {
    stage.File("C:\\free\\z.txt", 9);
    stage.Folder("C:\\free\\dir");
    EXPECT_EQ(view.ItemAddNew("C:\\free\\z.txt"), 4);
    EXPECT_EQ(view.ItemAddNew("C:\\free\\dir"), 5);
    EXPECT_EQ(Rows(view), "sub | a.txt | b.txt | z.txt | dir");
    EXPECT_EQ(SubItem(view, 4, 6), "C:\\free");
    EXPECT_EQ(stage.Events(),
              "BeforeAddItem(False, C:\\free\\z.txt) AfterAddItem(4) BeforeAddItem(False, C:\\free\\dir) AfterAddItem(5)");
    stage.handlers.On(fileview::BeforeAddItem, [](bool& cancel, std::string&) { cancel = true; });
    EXPECT_EQ(view.ItemAddNew("C:\\free\\z.txt"), 0);
}

TEST_F(FileViewItems, TheIndexThatTheApplicationSetsIsTheResult) {
    stage.handlers.On(fileview::AfterAddItem, [](std::int32_t& index) { index = 77; });
    EXPECT_EQ(view.ItemAddNew("C:\\x\\a.txt"), 77);
}

TEST_F(FileViewItems, APathThatDoesNotExistGivesARowOfTheFolderHandledLast) {
    EXPECT_EQ(view.ItemAddNew("C:\\no\\such"), 4);
    EXPECT_EQ(Row(view, 4), Row(view, 1));
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False, C:\\no\\such) AfterAddItem(4)");
}

TEST(FileViewWithoutAFolderInHand, AddsNothingForAPathThatDoesNotExist) {
    Stage stage;
    EXPECT_EQ(stage.View().ItemAddNew("C:\\no\\such"), 0);
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False, C:\\no\\such)");
    EXPECT_EQ(stage.View().ItemCount(), 0);
}

TEST_F(FileViewItems, TheFolderHandledLastIsSharedByAllListsOfAHost) {
    test::HostUnderTest host;
    host.files.SetFolder("C:\\x\\sub", {}).Check();
    FileView& one = host.Create<FileView>("FileView1");
    FileView& two = host.Create<FileView>("FileView2");
    one.ItemAddNew("C:\\x\\sub");
    EXPECT_EQ(two.ItemAddNew("C:\\gone"), 1);
    EXPECT_EQ(Rows(two), "sub");
}

TEST_F(FileViewItems, RemovingTakesTheItemOffTheListOnly) {
    view.SetItemIndex(2);
    EXPECT_EQ(view.ItemRemove(), 0);
    EXPECT_EQ(Rows(view), "sub | b.txt");
    view.ItemRemove(Variant(1));
    EXPECT_EQ(Rows(view), "b.txt");
    EXPECT_TRUE(stage.Disk().FileExists("C:\\x\\a.txt"));
    EXPECT_EQ(ErrorOf([&] { view.ItemRemove(Variant(2)); }), frame::errors::indexOutOfBounds);
    EXPECT_EQ(ErrorOf([&] { view.ItemRemove(); }), frame::errors::indexOutOfBounds);
    EXPECT_EQ(stage.Events(), "");
}

TEST_F(FileViewItems, ClearingTakesAllItemsOffTheList) {
    EXPECT_EQ(view.ItemClear(), 0);
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(view.ItemIndex(), 1);
    EXPECT_EQ(view.ItemName(), "");
    EXPECT_EQ(stage.Events(), "");
    view.ItemAddNew("C:\\x\\b.txt");
    EXPECT_EQ(Rows(view), "b.txt");
}

// Images.

TEST_F(FileViewItems, ImagesAreThoseOfTheSizeChosen) {
    EXPECT_EQ(view.ImageCount(), 4);
    view.SetImageSmall(true);
    EXPECT_EQ(view.ImageCount(), 6);
    view.SetImageIndex(2);
    EXPECT_EQ(view.ImageKey(), "SortUp");
    view.SetImageSmall(false);
    EXPECT_EQ(view.ImageKey(), "FolderUnavailable");
    view.SetImageIndex(99);
    EXPECT_EQ(view.ImageIndex(), 99);
    EXPECT_EQ(view.ImageKey(), "");
    EXPECT_EQ(view.ImageTag(), "");
    stage.Changes();
    view.SetImageKey("x");
    view.SetImageTag("x");
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FileViewItems, KeyAndTagOfAnImageCanBeSet) {
    view.SetImageIndex(1);
    view.SetImageKey("mine");
    view.SetImageTag("tag");
    EXPECT_EQ(view.Image32.ListImages.Item(1).Key(), "mine");
    EXPECT_EQ(view.ImageTag(), "tag");
    EXPECT_EQ(ErrorOf([&] { view.SetImageKey("File Folder"); }), frame::errors::keyNotUnique);
}

TEST_F(FileViewItems, AnImageIsAddedAndRemoved) {
    const Variant picture = std::make_shared<frame::Picture>(480.0f, 480.0f, "");
    EXPECT_EQ(view.ImageAddNew(picture, "mine"), 5);
    EXPECT_EQ(view.ImageAddNew(picture, "MINE"), frame::errors::keyNotUnique);
    EXPECT_EQ(view.ImageAddNew(Variant("no picture"), "other"), frame::errors::objectRequired);
    EXPECT_EQ(view.ImageAddNew(picture, ""), 6);
    EXPECT_EQ(view.ImageRemove(Variant("mine")), Variant(0));
    EXPECT_EQ(view.ImageRemove(Variant("mine")), Variant(frame::errors::elementNotFound));
    EXPECT_EQ(view.ImageRemove(Variant(99)), Variant(frame::errors::indexOutOfBounds));
    EXPECT_EQ(view.ImageRemove(Variant(5)), Variant(0));
    EXPECT_EQ(view.ImageCount(), 4);
}

}  // namespace
}  // namespace tessel::controls
