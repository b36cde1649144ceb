#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/ErrorOf.h"
#include "tests/controls/folderview/FolderViewTestHelp.h"

/// The cursor over the nodes and what it reads and writes.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::Variant;
using test::ErrorOf;
using testing::ElementsAre;
using testing::IsEmpty;

class FolderViewItems : public testing::Test {
  protected:
    FolderViewItems() {
        for (const char* path : {"C:\\x\\a", "C:\\x\\b", "C:\\x\\c"}) stage.Folder(path);
        stage.ShowRoot("C:\\x");
    }
    /// Puts the cursor on a node, with nothing of that in the logs.
    void On(const std::string& key) {
        view.SetItemIndex(stage.IndexOf(key));
        stage.Clear();
    }
    Stage stage;
    FolderView& view = stage.View();
};

TEST_F(FolderViewItems, TheCursorGoesFromOneToTheNumberOfNodes) {
    EXPECT_EQ(view.ItemCount(), 4);
    for (const int index : {1, 4}) {
        view.SetItemIndex(index);
        EXPECT_EQ(view.ItemIndex(), index);
    }
}

TEST_F(FolderViewItems, ACursorOutOfRangeReadsBackZero) {
    for (const int index : {0, -1, 5, 1'000'000, -2'000'000'000}) {
        view.SetItemIndex(2);
        view.SetItemIndex(index);
        EXPECT_EQ(view.ItemIndex(), 0) << index;
    }
    EXPECT_EQ(stage.Changes().back(), "ItemIndex");
}

TEST_F(FolderViewItems, WithoutACursorAllGettersGiveEmptyValues) {
    stage.Select("C:\\x\\a");
    for (const int index : {0, 5}) {
        view.SetItemIndex(index);
        EXPECT_EQ(view.Get("ItemPath"), Variant(""));
        EXPECT_EQ(view.Get("ItemName"), Variant(""));
        EXPECT_EQ(view.Get("ItemDisplayName"), Variant(""));
        EXPECT_EQ(view.Get("ItemTag"), Variant(""));
        EXPECT_EQ(view.Get("ItemIcon"), Variant(""));
        EXPECT_EQ(view.Get("ItemSelected"), Variant(false));
        EXPECT_EQ(view.Get("ItemExpanded"), Variant(false));
    }
}

TEST_F(FolderViewItems, WithoutACursorSettersDoAndReportNothing) {
    view.SetItemIndex(0);
    stage.Clear();
    view.SetItemName("n");
    view.SetItemDisplayName("n");
    view.SetItemTag("n");
    view.SetItemIcon("no such image");
    view.SetItemSelected(true);
    view.SetItemExpanded(true);
    EXPECT_THAT(stage.Changes(), IsEmpty());
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(Labels(view), "x {a, b, c}");
    EXPECT_EQ(stage.Selected(), "");
}

TEST_F(FolderViewItems, ACursorThatTheNodesHaveLeftBehindGivesEmptyValues) {
    On("C:\\x\\c");
    for (const char* key : {"C:\\x\\a", "C:\\x\\b"}) stage.Tree().Nodes.Remove(Variant(key));
    EXPECT_EQ(view.ItemPath(), "");
    view.SetItemDisplayName("n");
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FolderViewItems, ThePathIsTheKeyOfTheNode) {
    On("C:\\x\\b");
    EXPECT_EQ(view.ItemPath(), "C:\\x\\b");
    stage.Node("C:\\x\\b")->SetKey("anything").Check();
    EXPECT_EQ(view.ItemPath(), "anything");
}

TEST_F(FolderViewItems, TheTagBelongsToTheNode) {
    On("C:\\x\\a");
    view.SetItemTag("mine");
    EXPECT_EQ(view.ItemTag(), "mine");
    EXPECT_EQ(stage.Node("C:\\x\\a")->Tag(), Variant("mine"));
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemTag"));
    On("C:\\x\\b");
    EXPECT_EQ(view.ItemTag(), "");
}

TEST_F(FolderViewItems, TheTagStaysThroughARefresh) {
    On("C:\\x\\a");
    view.SetItemTag("mine");
    view.Refresh();
    EXPECT_EQ(view.ItemTag(), "mine");
}

TEST_F(FolderViewItems, TheIconIsTheImageOfTheNode) {
    On("C:\\x\\a");
    EXPECT_EQ(view.ItemIcon(), "File Folder");
    view.SetItemIcon("My Folders");
    EXPECT_EQ(view.ItemIcon(), "My Folders");
    EXPECT_EQ(stage.Node("C:\\x\\a")->Image(), Variant("My Folders"));
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemIcon"));
}

TEST_F(FolderViewItems, AnIconThatIsNotAmongTheImagesIsAnError) {
    On("C:\\x\\a");
    EXPECT_EQ(ErrorOf([&] { view.SetItemIcon("no such image"); }), frame::errors::elementNotFound);
    EXPECT_EQ(view.ItemIcon(), "File Folder");
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FolderViewItems, ExpandingByTheCursorFillsTheNode) {
    stage.Folder("C:\\x\\a\\s");
    On("C:\\x\\a");
    EXPECT_FALSE(view.ItemExpanded());
    view.SetItemExpanded(true);
    EXPECT_TRUE(view.ItemExpanded());
    EXPECT_EQ(stage.Events(), "Expand(C:\\x\\a) BeforeAddItem(False) AfterAddItem(5)");
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemExpanded"));
    view.SetItemExpanded(false);
    EXPECT_FALSE(view.ItemExpanded());
    EXPECT_EQ(stage.Events(), "Collapse(C:\\x\\a)");
}

TEST_F(FolderViewItems, TheDisplayNameLeavesTheFolderAsItIs) {
    On("C:\\x\\a");
    view.SetItemDisplayName("Label");
    EXPECT_EQ(view.ItemDisplayName(), "Label");
    EXPECT_EQ(view.ItemName(), "a");
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\a"));
    EXPECT_FALSE(stage.Disk().FolderExists("C:\\x\\Label"));
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemDisplayName"));
}

TEST_F(FolderViewItems, TheNameIsThatOfTheFolder) {
    On("C:\\x\\a");
    EXPECT_EQ(view.ItemName(), "a");
}

TEST_F(FolderViewItems, TheNameOfAFolderThatHasGoneIsEmpty) {
    On("C:\\x\\a");
    stage.Remove("C:\\x\\a");
    EXPECT_EQ(view.ItemName(), "");
    EXPECT_EQ(view.ItemDisplayName(), "a");
}

TEST_F(FolderViewItems, TheNameOfASpecialRootIsEmpty) {
    for (const char* root : {"My Computer", "My Folders"}) {
        stage.ShowRoot(root);
        view.SetItemIndex(1);
        EXPECT_EQ(view.ItemName(), "") << root;
        EXPECT_EQ(view.ItemDisplayName(), root);
    }
}

TEST_F(FolderViewItems, TheNameOfADriveIsEmpty) {
    stage.ShowRoot("My Computer");
    view.SetItemIndex(stage.IndexOf("C:\\"));
    EXPECT_EQ(view.ItemName(), "");
}

TEST_F(FolderViewItems, SettingTheNameRenamesTheFolderAndTheLabelAndKeepsTheKey) {
    On("C:\\x\\b");
    view.SetItemName("new");
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\new"));
    EXPECT_FALSE(stage.Disk().FolderExists("C:\\x\\b"));
    EXPECT_EQ(view.ItemDisplayName(), "new");
    EXPECT_EQ(view.ItemPath(), "C:\\x\\b");
    EXPECT_EQ(view.ItemName(), "");
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemName"));
}

TEST_F(FolderViewItems, ARenamedFolderIsThrownOutByTheFirstClickOnItsParentAndComesBackByTheSecond) {
    On("C:\\x\\b");
    view.SetItemName("new");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, c}");
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, c, new}");
    EXPECT_TRUE(stage.Has("C:\\x\\new"));
}

TEST_F(FolderViewItems, ARefreshGivesARenamedFolderANodeOfItsNewPath) {
    On("C:\\x\\b");
    view.SetItemName("new");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a, c, new}");
    EXPECT_TRUE(stage.Has("C:\\x\\new"));
}

TEST_F(FolderViewItems, ANameThatIsTakenIsAnErrorAndChangesNothing) {
    On("C:\\x\\a");
    EXPECT_EQ(ErrorOf([&] { view.SetItemName("b"); }), frame::errors::fileExists);
    EXPECT_EQ(view.ItemDisplayName(), "a");
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\a"));
    EXPECT_THAT(stage.Changes(), IsEmpty());
}

TEST_F(FolderViewItems, ABadNameIsAnErrorAndChangesNothing) {
    On("C:\\x\\a");
    EXPECT_NE(ErrorOf([&] { view.SetItemName("a?b"); }), 0);
    EXPECT_EQ(view.ItemDisplayName(), "a");
    EXPECT_TRUE(stage.Disk().FolderExists("C:\\x\\a"));
}

TEST_F(FolderViewItems, SettingTheNameOfWhatIsNoFolderDoesNothing) {
    On("C:\\x\\a");
    stage.Remove("C:\\x\\a");
    view.SetItemName("new");
    EXPECT_EQ(view.ItemDisplayName(), "a");
    EXPECT_THAT(stage.Changes(), IsEmpty());
    stage.ShowRoot("My Folders");
    view.SetItemName("new");
    EXPECT_EQ(Labels(view), "My Folders");
}

TEST_F(FolderViewItems, SettingSelectedToTrueSelects) {
    On("C:\\x\\a");
    EXPECT_FALSE(view.ItemSelected());
    view.SetItemSelected(true);
    EXPECT_TRUE(view.ItemSelected());
    EXPECT_EQ(stage.Selected(), "C:\\x\\a");
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_THAT(stage.Changes(), ElementsAre("ItemSelected"));
}

TEST_F(FolderViewItems, SettingSelectedToFalseLeavesTheSelection) {
    On("C:\\x\\a");
    view.SetItemSelected(true);
    view.SetItemSelected(false);
    EXPECT_TRUE(view.ItemSelected());
    EXPECT_EQ(stage.Selected(), "C:\\x\\a");
}

TEST_F(FolderViewItems, SelectedItemIsTheIndexOfTheSelectedNode) {
    EXPECT_EQ(view.SelectedItem(), 0);
    stage.Select("C:\\x\\b");
    EXPECT_EQ(view.SelectedItem(), stage.IndexOf("C:\\x\\b"));
}

TEST_F(FolderViewItems, SettingSelectedItemSelectsWithoutTellingAnything) {
    view.SetSelectedItem(3);
    EXPECT_EQ(stage.Tree().SelectedItem()->Index(), 3);
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_THAT(stage.Changes(), ElementsAre("SelectedItem"));
}

TEST_F(FolderViewItems, SelectedItemOutOfRangeLeavesTheSelection) {
    view.SetSelectedItem(3);
    for (const int index : {0, -1, 5, 1'000'000}) {
        view.SetSelectedItem(index);
        EXPECT_EQ(view.SelectedItem(), 3) << index;
    }
}

TEST_F(FolderViewItems, CountsFollowTheTree) {
    EXPECT_EQ(view.ItemCount(), stage.Tree().Nodes.Count());
    stage.Tree().Nodes.Clear();
    EXPECT_EQ(view.ItemCount(), 0);
}

// Images

TEST_F(FolderViewItems, TheImageCursorTakesAnyNumber) {
    for (const int index : {0, -5, 1, 1'000'000}) {
        view.SetImageIndex(index);
        EXPECT_EQ(view.ImageIndex(), index);
    }
}

TEST_F(FolderViewItems, ImageKeyAndTagAreThoseOfTheImageAtTheCursor) {
    view.SetImageIndex(2);
    EXPECT_EQ(view.ImageKey(), "My Folders");
    EXPECT_EQ(view.ImageTag(), "");
    view.Image16.ListImages.Item(2).SetTag(Variant("tagged"));
    EXPECT_EQ(view.ImageTag(), "tagged");
    for (const int index : {0, -1, view.ImageCount() + 1}) {
        view.SetImageIndex(index);
        EXPECT_EQ(view.ImageKey(), "");
        EXPECT_EQ(view.ImageTag(), "");
    }
}

TEST_F(FolderViewItems, SettingImageKeyKeepsTheKeyOfTheImage) {
    view.SetImageIndex(2);
    view.SetImageKey("other");
    EXPECT_EQ(view.ImageKey(), "My Folders");
    EXPECT_EQ(view.Image16.ListImages.Item(2).Key(), "My Folders");
}

TEST_F(FolderViewItems, SettingImageTagKeepsTheTagOfTheImage) {
    view.SetImageIndex(2);
    view.SetImageTag("other");
    EXPECT_EQ(view.ImageTag(), "");
    EXPECT_EQ(view.Image16.ListImages.Item(2).Tag(), Variant());
}

TEST_F(FolderViewItems, WhatWasSetAsImageKeyAndTagIsSaved) {
    view.SetImageKey("key");
    view.SetImageTag("tag");
    frame::MemoryBag bag;
    stage.Save(bag);
    EXPECT_EQ(bag.ReadProperty("ImageKey", ""), Variant("key"));
    EXPECT_EQ(bag.ReadProperty("ImageTag", ""), Variant("tag"));
}

TEST_F(FolderViewItems, AddingAnImageGivesTheNumberOfImages) {
    const int before = view.ImageCount();
    const auto picture = std::make_shared<frame::Picture>(240.0f, 240.0f, "");
    EXPECT_EQ(view.ImageAddNew(Variant(picture), "mine"), before + 1);
    EXPECT_EQ(view.ImageCount(), before + 1);
    EXPECT_EQ(view.Image16.ListImages.Item(before + 1).Key(), "mine");
    EXPECT_EQ(view.Image16.ListImages.Item(before + 1).Picture(), picture);
}

TEST_F(FolderViewItems, AnImageThatCannotBeAddedGivesTheNumberOfTheError) {
    const int before = view.ImageCount();
    const auto picture = std::make_shared<frame::Picture>(240.0f, 240.0f, "");
    EXPECT_EQ(view.ImageAddNew(Variant(picture), "my computer"), frame::errors::keyNotUnique);
    EXPECT_EQ(view.ImageAddNew(Variant(frame::ObjectRef()), "none"), frame::errors::invalidPicture);
    EXPECT_GT(view.ImageAddNew(Variant("no picture"), "none"), 0);
    EXPECT_EQ(view.ImageCount(), before);
}

TEST_F(FolderViewItems, RemovingAnImageNamesItByItsKeyAndNotByTheCursor) {
    view.SetImageIndex(1);
    EXPECT_EQ(view.ImageRemove("My Folders"), Variant(0));
    EXPECT_EQ(ImageKeys(view).find("My Folders"), std::string::npos);
    EXPECT_EQ(view.ImageKey(), "My Computer");
    EXPECT_EQ(view.ImageRemove(Variant(1)), Variant(0));
    EXPECT_EQ(view.ImageKey(), "Drive Unavailable");
}

TEST_F(FolderViewItems, RemovingAnImageThatIsNotThereGivesTheNumberOfTheError) {
    const int before = view.ImageCount();
    EXPECT_EQ(view.ImageRemove("no such image"), Variant(frame::errors::elementNotFound));
    EXPECT_EQ(view.ImageRemove(Variant(before + 1)), Variant(frame::errors::indexOutOfBounds));
    EXPECT_EQ(view.ImageRemove(Variant(0)), Variant(frame::errors::indexOutOfBounds));
    EXPECT_EQ(view.ImageCount(), before);
}

}  // namespace
}  // namespace tessel::controls
