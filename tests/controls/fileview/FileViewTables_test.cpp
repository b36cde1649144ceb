#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "tests/ErrorOf.h"
#include "tests/controls/fileview/FileViewTestHelp.h"

/// What the tables tell of the class: numbers, events, saved state.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::MemoryBag;
using frame::Variant;
using test::ErrorOf;
using testing::ElementsAreArray;
using testing::Pair;
using testing::UnorderedElementsAre;

int NumberOf(std::string_view name) { return FileView::table.NumberOf(*FileView::table.Find(name)); }

TEST(FileViewTables, MembersHaveTheirPlacesInTheInterface) {
    const std::vector<std::pair<std::string_view, int>> some = {
        {"BackColor", -501},  {"Font", -512},        {"Appearance", -520},      {"MousePointer", 6}, {"View", 22},
        {"path", 23},         {"PathRoot", 24},      {"RefreshInterval", 34},   {"TotalSize", 35},   {"ItemIndex", 41},
        {"SelectedItem", 49}, {"ImageTag", 53},      {"Refresh", -550},         {"GoUp", 55},        {"Search", 56},
        {"ItemClear", 61},    {"ItemSetupIcon", 64}, {"ImageLoadFileType", 65},
    };
    for (const auto& [name, number] : some) EXPECT_EQ(NumberOf(name), number) << name;
}

TEST(FileViewTables, EventsHaveTheirNumbersInOrder) {
    int number = 0;
    for (const frame::EventInfo* event : FileView::table.events) EXPECT_EQ(event->number, ++number) << event->name;
    EXPECT_EQ(number, 29);
    EXPECT_EQ(FileView::table.FindEvent("MouseUp")->number, 28);
    EXPECT_EQ(FileView::table.FindEvent("BeforePopup")->number, 29);
}

TEST(FileViewTables, TheBagIsWrittenInTheOrderInWhichItIsRead) {
    Stage stage;
    MemoryBag bag;
    stage.Save(bag);
    std::vector<std::string> keys;
    for (const MemoryBag::Write& write : bag.Written()) keys.push_back(write.key);
    EXPECT_THAT(keys, ElementsAreArray({"BackColor",
                                        "ForeColor",
                                        "Enabled",
                                        "Font",
                                        "BorderStyle",
                                        "Path",
                                        "PathRoot",
                                        "LimitToRoot",
                                        "ShowFolders",
                                        "MousePointer",
                                        "MouseIcon",
                                        "Picture",
                                        "PictureAlignment",
                                        "Arrange",
                                        "Appearance",
                                        "HideColumnHeaders",
                                        "HideSelection",
                                        "MultiSelect",
                                        "AllowColumnReorder",
                                        "FlatScrollBar",
                                        "FullRowSelect",
                                        "GridLines",
                                        "HotTracking",
                                        "HoverSelection",
                                        "ItemIndex",
                                        "ItemDisplayName",
                                        "ItemCount",
                                        "ItemIcon",
                                        "LabelWrap",
                                        "View",
                                        "ItemSmallIcon",
                                        "ItemSelected",
                                        "ItemTag",
                                        "ImageIndex",
                                        "ImageCount",
                                        "ImageSmall",
                                        "ImageKey",
                                        "ShowFolderDetails",
                                        "ItemBold",
                                        "ItemName",
                                        "OLEDragMode",
                                        "OLEDropMode",
                                        "RefreshInterval",
                                        "Filter",
                                        "TotalSize",
                                        "AllowHiddenFiles",
                                        "AllowSystemFiles",
                                        "AllowLabelEdit",
                                        "ImageTag",
                                        "ItemPath",
                                        "SelectedItem",
                                        "ItemSize",
                                        "ItemType"}));
}

TEST(FileViewTables, ANewControlHasItsDefaults) {
    Stage stage;
    const FileView& view = stage.View();
    EXPECT_EQ(view.FolderPath(), "");
    EXPECT_TRUE(view.LimitToRoot());
    EXPECT_TRUE(view.ShowFolders());
    EXPECT_FALSE(view.ShowFolderDetails());
    EXPECT_FALSE(view.AllowHiddenFiles());
    EXPECT_FALSE(view.AllowSystemFiles());
    EXPECT_TRUE(view.AllowLabelEdit());
    EXPECT_EQ(view.OLEDragMode(), child::OLEDragConstants::Automatic);
    EXPECT_EQ(view.OLEDropMode(), child::OLEDropConstants::Automatic);
    EXPECT_EQ(view.RefreshInterval(), 0);
    EXPECT_EQ(view.TotalSize(), Variant(0));
    EXPECT_EQ(view.BackColor(), frame::OLE_COLOR(0x80000005));
    EXPECT_TRUE(view.RefreshTimer.Enabled());
    EXPECT_EQ(view.ListFiles.LabelEdit(), child::ListLabelEditConstants::Automatic);
}

TEST(FileViewTables, ALoadBringsTenSecondsWhereTheSaveLeftZeroOut) {
    Stage stage;
    MemoryBag bag;
    stage.Save(bag);
    EXPECT_THAT(bag.Kept(), testing::IsEmpty());
    Stage loaded({.saved = &bag});
    EXPECT_EQ(loaded.View().RefreshInterval(), 10'000);
    MemoryBag again;
    loaded.Save(again);
    EXPECT_THAT(again.Kept(), UnorderedElementsAre(Pair("RefreshInterval", Variant(10'000))));
}

TEST(FileViewTables, ALoadedControlRefreshesEveryTenSeconds) {
    const MemoryBag bag(MemoryBag::Contents{{"Path", Variant("C:\\x")}});
    Stage stage({.saved = &bag, .show = false});
    stage.Folder("C:\\x\\sub");
    stage.TheSite().Show();
    stage.Events();
    stage.host.clock.Advance(10'000);
    EXPECT_EQ(stage.Events(), "AfterPaint");
}

TEST(FileViewTables, ALoadPaintsNothingAndReportsOnlyThePictures) {
    const MemoryBag bag(MemoryBag::Contents{{"PathRoot", Variant("C:\\x")}, {"AllowLabelEdit", Variant(true)}});
    Stage stage({.saved = &bag, .show = false});
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(stage.View().FolderPath(), "");
    EXPECT_THAT(stage.Changes(), testing::ElementsAre("MouseIcon", "Picture"));
    EXPECT_EQ(stage.View().ListFiles.LabelEdit(), child::ListLabelEditConstants::Automatic);
}

TEST(FileViewTables, TheItemPropertiesAreKeptForTheBagAndNotRead) {
    const MemoryBag bag(
        MemoryBag::Contents{{"ItemName", Variant("kept")}, {"ItemCount", Variant(7)}, {"ItemSelected", Variant(5)}});
    Stage stage({.saved = &bag});
    EXPECT_EQ(stage.View().ItemName(), "");
    EXPECT_EQ(stage.View().ItemCount(), 0);
    MemoryBag saved;
    stage.Save(saved);
    EXPECT_EQ(saved.ReadProperty("ItemName", ""), Variant("kept"));
    EXPECT_EQ(saved.ReadProperty("ItemCount", 0), Variant(7));
    EXPECT_EQ(saved.ReadProperty("ItemSelected", 0), Variant(5));
}

TEST(FileViewTables, ReadOnlyPropertiesRefuseAlways) {
    for (const char* name : {"TotalSize", "ItemCount", "ImageCount", "ItemPath", "ItemSize", "ItemType"}) {
        Stage run, design({.designTime = true});
        EXPECT_EQ(ErrorOf([&] { run.View().Put(name, 1); }), frame::errors::notAtRunTime) << name;
        EXPECT_EQ(ErrorOf([&] { design.View().Put(name, 1); }), frame::errors::notPermitted) << name;
    }
}

TEST(FileViewTables, AllowLabelEditTurnsTheListsOwnEditOff) {
    Stage stage;
    stage.View().SetAllowLabelEdit(true);
    EXPECT_EQ(stage.View().ListFiles.LabelEdit(), child::ListLabelEditConstants::Manual);
    stage.View().SetAllowLabelEdit(false);
    EXPECT_EQ(stage.View().ListFiles.LabelEdit(), child::ListLabelEditConstants::Automatic);
}

TEST(FileViewTables, ANegativeIntervalIsRefused) {
    Stage stage;
    EXPECT_EQ(ErrorOf([&] { stage.View().SetRefreshInterval(-1); }), frame::errors::invalidValue);
}

TEST(FileViewTables, StockPropertiesAreThoseOfTheList) {
    Stage stage;
    FileView& view = stage.View();
    view.Put("GridLines", true);
    view.Put("View", 0);
    view.Put("MultiSelect", true);
    view.Put("BorderStyle", 0);
    EXPECT_TRUE(view.ListFiles.GridLines());
    EXPECT_EQ(view.ListFiles.View(), child::ListViewConstants::Icon);
    EXPECT_TRUE(view.ListFiles.MultiSelect());
    EXPECT_EQ(view.ListFiles.BorderStyle(), child::ListBorderConstants::None);
    EXPECT_THAT(stage.Changes(), testing::ElementsAre("GridLines", "View", "MultiSelect", "BorderStyle"));
}

TEST(FileViewTables, MethodsAreReachedByName) {
    Stage stage;
    stage.File("C:\\x\\a.txt");
    std::vector<Variant> search = {"*.txt", "C:\\x", false};
    EXPECT_TRUE(stage.View().Call("Search", search).IsEmpty());
    EXPECT_EQ(stage.View().Get("ItemCount"), Variant(1));
    std::vector<Variant> none;
    EXPECT_EQ(stage.View().Call("ItemRemove", none), Variant(0));
    EXPECT_EQ(stage.View().Get("ItemCount"), Variant(0));
    EXPECT_TRUE(stage.View().Call("GoUp", none).IsEmpty());
}

}  // namespace
}  // namespace tessel::controls
