#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "tests/ErrorOf.h"
#include "tests/controls/folderview/FolderViewTestHelp.h"

/// What the tables tell of the class: kinds of properties, help texts, numbers of events, saved state.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::MemoryBag;
using frame::Variant;
using frame::VarType;
using test::ErrorOf;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

const frame::Member& MemberOf(std::string_view name) {
    const frame::Member* member = FolderView::table.Find(name);
    if (!member) throw frame::ControlError(frame::errors::noSuchMember, std::string(name));
    return *member;
}

// Kinds

struct RunTimeProperty {
    const char* name;
    Variant value;
};
const RunTimeProperty runTimeProperties[] = {
    {"ImageIndex", 1}, {"ImageTag", "t"},   {"ImageKey", "k"},      {"ItemIndex", 1},
    {"ItemTag", "t"},  {"ItemName", "n"},   {"ItemExpanded", true}, {"ItemIcon", "My Computer"},
    {"Path", "C:\\x"}, {"SelectedItem", 1}, {"ItemSelected", true}, {"ItemDisplayName", "label"},
};

TEST(FolderViewTables, RunTimePropertiesAreRefusedAtDesignTime) {
    for (const RunTimeProperty& property : runTimeProperties) {
        Stage stage({.designTime = true});
        stage.ShowRoot("C:\\Temp");
        stage.View().SetPathRoot("C:\\Temp");
        stage.Clear();
        EXPECT_EQ(ErrorOf([&] { stage.View().Put(property.name, property.value); }), frame::errors::notPermitted) << property.name;
        EXPECT_THAT(stage.Changes(), IsEmpty()) << property.name;
    }
}

TEST(FolderViewTables, RunTimePropertiesReportAtRunTime) {
    for (const RunTimeProperty& property : runTimeProperties) {
        Stage stage;
        stage.ShowRoot("C:\\Temp");
        stage.View().SetItemIndex(1);
        stage.Changes();
        EXPECT_EQ(ErrorOf([&] { stage.View().Put(property.name, property.value); }), 0) << property.name;
        EXPECT_THAT(stage.Changes(), ElementsAre(property.name)) << property.name;
    }
}

TEST(FolderViewTables, ReadOnlyPropertiesRefuseAlways) {
    for (const char* name : {"ImageCount", "ItemCount", "ItemPath"}) {
        Stage run, design({.designTime = true});
        EXPECT_EQ(ErrorOf([&] { run.View().Put(name, 1); }), frame::errors::notAtRunTime) << name;
        EXPECT_EQ(ErrorOf([&] { design.View().Put(name, 1); }), frame::errors::notPermitted) << name;
        EXPECT_THAT(run.Changes(), IsEmpty()) << name;
    }
}

TEST(FolderViewTables, ARefusedSetLeavesTheBagAsItWas) {
    Stage stage({.designTime = true});
    for (const char* name : {"ItemCount", "ItemIndex", "ImageKey", "Path"}) (void)ErrorOf([&] { stage.View().Put(name, 1); });
    MemoryBag bag;
    stage.Save(bag);
    EXPECT_THAT(bag.Kept(), IsEmpty());
}

TEST(FolderViewTables, EveryOtherPropertyIsSetAtDesignTimeAndAtRunTime) {
    const std::vector<std::pair<const char*, Variant>> plain = {
        {"Enabled", false},           {"BorderStyle", 1},           {"Appearance", 0},
        {"FullRowSelect", true},      {"HotTracking", true},        {"OLEDropMode", 1},
        {"OLEDragMode", 0},           {"AllowLabelEdit", false},    {"PathRoot", "C:\\x"},
        {"AllowHiddenFolders", true}, {"AllowSystemFolders", true}, {"RefreshInterval", 500},
        {"MousePointer", 11},         {"AutoFillSubFolders", true},
    };
    for (const bool designTime : {false, true})
        for (const auto& [name, value] : plain) {
            Stage stage({.designTime = designTime});
            stage.View().Put(name, value);
            EXPECT_EQ(stage.View().Get(name), value) << name;
            EXPECT_THAT(stage.Changes(), ElementsAre(name)) << name;
        }
}

TEST(FolderViewTables, BackColorCanOnlyBeRead) {
    Stage run, design({.designTime = true});
    EXPECT_EQ(run.View().Get("BackColor"), Variant(frame::OLE_COLOR(0x80000005)));
    EXPECT_NE(ErrorOf([&] { run.View().Put("BackColor", 255); }), 0);
    EXPECT_NE(ErrorOf([&] { design.View().Put("BackColor", 255); }), 0);
    EXPECT_EQ(run.View().BackColor(), frame::OLE_COLOR(0x80000005));
}

// Words and numbers

TEST(FolderViewTables, PropertiesHaveTheirHelpTexts) {
    const std::vector<std::pair<std::string_view, std::string_view>> texts = {
        {"FullRowSelect",
         "Returns/sets a value which determines if the entire row of the selected item is highlighted and clicking anywhere on an "
         "item's row causes it to be selected."},
        {"HotTracking", "Returns/sets a value which determines if items are highlighted as the mousepointer passes over them."},
        {"PathRoot",
         "Shows or sets the root path for the control.  Used to initialise the control.  Special folders are 'My Computer', 'My "
         "Documents' and 'My Folders'."},
        {"OLEDropMode", "Returns/Sets whether this control can act as an OLE drop target."},
        {"OLEDragMode",
         "Returns/Sets whether this control can act as an OLE drag/drop source, and whether this process is started automatically "
         "or under programmatic control."},
        {"AllowLabelEdit", "If set TRUE allows the user to edit folder names."},
        {"AllowHiddenFolders", "When set true, hidden folders are shown as well as normal folders"},
        {"AllowSystemFolders", "When set true, system folders are shown as well as normal folders"},
        {"ImageCount", "Count of the number of images in the list"},
        {"ImageIndex", "Index to the current image used for programming"},
        {"ImageTag", "Tag for the current (ImageIndex) image."},
        {"ImageKey", "Key of the current image (using ImageIndex)"},
        {"RefreshInterval", "Returns/sets the number of milliseconds between automatic refreshes.  0 is none. 1000 is 1 second."},
        {"ItemIndex", "Returns or sets the index to the folder items (used in programming)"},
        {"ItemTag", "Tag associated with each folder item displayed"},
        {"ItemExpanded", "Returns true if the item referenced by ItemIndex is expanded, false otherwise."},
        {"ItemIcon", "Returns or sets the folder items icon image by key (see ImageKey)"},
        {"ItemCount", "Returns the number of folder items in the list."},
        {"ItemName", "Returns the real name of the item referenced by ItemIndex (normally the same as DisplayName)."},
        {"ItemDisplayName", "Returns the display name of the item referenced by ItemIndex."},
        {"ItemSelected",
         "Returns TRUE if the item referenced by ItemIndex is selected, FALSE if not.  Setting to TRUE changes the selected item."},
        {"ItemPath", "Returns the full path of the item referenced by ItemIndex."},
        {"Path", "Shows the current path of the current folder selected."},
        {"SelectedItem", "Sets and returns the index of the currently selected item"},
        {"AutoFillSubFolders", "Automatically fill in sub-folders (creates the + symbol if sub-folders exist but is slower)."},
        {"GetMyFolders", "Gets the special string list for My Folders."},
        {"ImageAddNew", "Adds a new image to the list of images"},
        {"ImageRemove", "Removes the current (ImageIndex) image from the list of images"},
        {"AddNewFolder", "Adds a new folder (if the special folder 'My Folders' is selected it create a new virtual folder."},
    };
    for (const auto& [name, text] : texts) EXPECT_EQ(MemberOf(name).help, text) << name;
}

TEST(FolderViewTables, StockMembersHaveTheStockNumbers) {
    const std::vector<std::pair<std::string_view, int>> numbers = {{"Enabled", -514},   {"Font", -512},      {"BorderStyle", -504},
                                                                   {"BackColor", -501}, {"ForeColor", -513}, {"Appearance", -520},
                                                                   {"Refresh", -550}};
    for (const auto& [name, number] : numbers) EXPECT_EQ(FolderView::table.NumberOf(MemberOf(name)), number) << name;
}

TEST(FolderViewTables, EventsHaveTheirNumbersAndArguments) {
    struct Expected {
        std::string_view name;
        int number;
        std::vector<std::string_view> arguments;
    };
    const std::vector<Expected> expected = {
        {"AfterDelete", 1, {"Filename"}},
        {"BeforeDelete", 2, {"Cancel", "Filename"}},
        {"BeforeLabelEdit", 3, {"Cancel"}},
        {"AfterLabelEdit", 4, {"Cancel", "NewString"}},
        {"OLECompleteDrag", 5, {"Effect"}},
        {"OLEDragDrop", 6, {"Data", "Effect", "Button", "Shift", "X", "Y"}},
        {"OLEDragOver", 7, {"Data", "Effect", "Button", "Shift", "X", "Y", "State"}},
        {"OLEGiveFeedback", 8, {"Effect", "DefaultCursors"}},
        {"OLESetData", 9, {"Data", "DataFormat"}},
        {"OLEStartDrag", 10, {"Data", "AllowedEffects"}},
        {"Collapse", 11, {"Node"}},
        {"Expand", 12, {"Node"}},
        {"NodeClick", 13, {"Node"}},
        {"BeforePaint", 14, {"Cancel"}},
        {"AfterPaint", 15, {}},
        {"AfterAddItem", 16, {"Index"}},
        {"BeforeAddItem", 17, {"Cancel"}},
        {"ChangedFolder", 18, {}},
        {"BeforePopup", 19, {"Cancel", "Filename"}},
        {"Click", -600, {}},
        {"DblClick", -601, {}},
        {"KeyDown", -602, {"KeyCode", "Shift"}},
        {"KeyPress", -603, {"KeyAscii"}},
        {"KeyUp", -604, {"KeyCode", "Shift"}},
        {"MouseDown", -605, {"Button", "Shift", "X", "Y"}},
        {"MouseMove", -606, {"Button", "Shift", "X", "Y"}},
        {"MouseUp", -607, {"Button", "Shift", "X", "Y"}},
    };
    EXPECT_EQ(FolderView::table.events.size(), expected.size());
    for (const Expected& event : expected) {
        const frame::EventInfo* found = FolderView::table.FindEvent(event.name);
        ASSERT_NE(found, nullptr) << event.name;
        EXPECT_EQ(found->number, event.number) << event.name;
        std::vector<std::string_view> arguments;
        for (const frame::Parameter& parameter : found->parameters.All()) arguments.push_back(parameter.name);
        EXPECT_EQ(arguments, event.arguments) << event.name;
    }
}

TEST(FolderViewTables, TheDragModesHaveNamesForTheirNumbers) {
    Stage stage;
    for (const int value : {0, 1, 2}) {
        stage.View().Put("OLEDropMode", value);
        EXPECT_EQ(stage.View().Get("OLEDropMode"), Variant(value));
    }
    for (const int value : {0, 1}) {
        stage.View().Put("OLEDragMode", value);
        EXPECT_EQ(stage.View().Get("OLEDragMode"), Variant(value));
    }
}

TEST(FolderViewTables, MethodsAreReachedByName) {
    Stage stage;
    stage.Folder("C:\\x\\a");
    stage.ShowRoot("C:\\x");
    std::vector<Variant> none;
    EXPECT_TRUE(stage.View().Call("Refresh", none).IsEmpty());
    EXPECT_EQ(stage.View().Call("GoUp", none), Variant(0));
    EXPECT_EQ(stage.View().Call("GetMyFolders", none).Type(), VarType::Array);
    std::vector<Variant> folder = {"C:\\y"};
    stage.View().SetItemIndex(0);
    EXPECT_EQ(stage.View().Call("AddNewFolder", folder), Variant(0));
    EXPECT_EQ(stage.View().Call("AddNewFolder", none), Variant(0));
    std::vector<Variant> image = {"My Folders"};
    EXPECT_EQ(stage.View().Call("ImageRemove", image), Variant(0));
}

// Saved state

struct Key {
    std::string_view name;
    VarType type;
    Variant otherwise;
};
const std::vector<Key>& Bag() {
    using enum VarType;
    static const std::vector<Key> bag = {
        {"Enabled", Boolean, true},
        {"Font", Object, frame::ObjectRef()},
        {"BorderStyle", Integer, 0},
        {"Appearance", Integer, 1},
        {"FullRowSelect", Boolean, false},
        {"HotTracking", Boolean, false},
        {"LabelEdit", Integer, 0},
        {"OLEDropMode", Long, 2},
        {"OLEDragMode", Long, 1},
        {"AllowLabelEdit", Boolean, true},
        {"PathRoot", String, ""},
        {"AllowHiddenFolders", Boolean, false},
        {"AllowSystemFolders", Boolean, false},
        {"ForeColor", Long, frame::OLE_COLOR(0x80000012)},
        {"ImageCount", Integer, 0},
        {"ImageIndex", Integer, 0},
        {"ImageTag", String, ""},
        {"ImageKey", String, ""},
        {"RefreshInterval", Integer, 0},
        {"ItemIndex", Integer, 0},
        {"ItemTag", String, ""},
        {"ItemExpanded", Boolean, false},
        {"ItemIcon", String, ""},
        {"ItemCount", Integer, 0},
        {"Path", String, ""},
        {"ItemName", String, ""},
        {"ItemDisplayName", String, ""},
        {"ItemSelected", Boolean, false},
        {"ItemPath", String, ""},
        {"MousePointer", Integer, 0},
        {"MouseIcon", Object, frame::ObjectRef()},
        {"SelectedItem", Integer, 0},
        {"AutoFillSubFolders", Boolean, false},
    };
    return bag;
}

/// A bag that writes down what it is asked for.
class AskedBag final : public frame::PropertyBag {
  public:
    Variant ReadProperty(std::string_view key, const Variant& otherwise) const override {
        asked.push_back({std::string(key), otherwise});
        return otherwise;
    }
    void WriteProperty(std::string_view, const Variant&, const Variant&) override {}
    mutable std::vector<std::pair<std::string, Variant>> asked;
};

TEST(FolderViewTables, TheBagIsReadInItsOrderWithItsDefaults) {
    AskedBag bag;
    Stage stage({.saved = &bag});
    ASSERT_EQ(bag.asked.size(), Bag().size());
    for (std::size_t index = 0; index < Bag().size(); ++index) {
        const Key& key = Bag()[index];
        EXPECT_EQ(bag.asked[index].first, key.name);
        EXPECT_EQ(bag.asked[index].second.Type(), key.type) << key.name;
        EXPECT_TRUE(key.name == "Font" || bag.asked[index].second == key.otherwise) << key.name;
    }
}

TEST(FolderViewTables, TheBagIsWrittenInTheOrderInWhichItIsReadWithTheSameDefaults) {
    Stage stage;
    MemoryBag bag;
    stage.Save(bag);
    ASSERT_EQ(bag.Written().size(), Bag().size());
    for (std::size_t index = 0; index < Bag().size(); ++index) {
        const Key& key = Bag()[index];
        EXPECT_EQ(bag.Written()[index].key, key.name);
        EXPECT_EQ(bag.Written()[index].otherwise.Type(), key.type) << key.name;
        EXPECT_TRUE(key.name == "Font" || bag.Written()[index].otherwise == key.otherwise) << key.name;
    }
}

TEST(FolderViewTables, ANewControlSavesNothing) {
    Stage stage;
    MemoryBag bag;
    stage.Save(bag);
    EXPECT_THAT(bag.Kept(), IsEmpty());
}

TEST(FolderViewTables, ANewControlHasTheDefaultsOfTheBag) {
    Stage fresh;
    const MemoryBag empty;
    Stage loaded({.saved = &empty});
    for (Stage* stage : {&fresh, &loaded}) {
        const FolderView& view = stage->View();
        EXPECT_TRUE(view.Enabled());
        EXPECT_EQ(view.BorderStyle(), child::TreeBorderConstants::None);
        EXPECT_EQ(view.Appearance(), child::AppearanceConstants::ThreeD);
        EXPECT_FALSE(view.FullRowSelect());
        EXPECT_FALSE(view.HotTracking());
        EXPECT_EQ(view.TreeFolders.LabelEdit(), child::TreeLabelEditConstants::Automatic);
        EXPECT_EQ(view.OLEDropMode(), child::OLEDropConstants::Automatic);
        EXPECT_EQ(view.OLEDragMode(), child::OLEDragConstants::Automatic);
        EXPECT_TRUE(view.AllowLabelEdit());
        EXPECT_EQ(view.PathRoot(), "");
        EXPECT_FALSE(view.AllowHiddenFolders());
        EXPECT_FALSE(view.AllowSystemFolders());
        EXPECT_EQ(view.ForeColor(), frame::OLE_COLOR(0x80000012));
        EXPECT_EQ(view.ImageIndex(), 0);
        EXPECT_EQ(view.RefreshInterval(), 0);
        EXPECT_EQ(view.ItemIndex(), 0);
        EXPECT_EQ(view.FolderPath(), "");
        EXPECT_EQ(view.MousePointer(), 0);
        EXPECT_EQ(view.MouseIcon(), nullptr);
        EXPECT_FALSE(view.AutoFillSubFolders());
        EXPECT_EQ(view.ItemCount(), 0);
        EXPECT_EQ(ImageKeys(view), designImages);
    }
}

TEST(FolderViewTables, WhatIsSavedComesBackWithALoad) {
    const std::vector<std::pair<std::string, Variant>> values = {
        {"Enabled", false},
        {"BorderStyle", 1},
        {"Appearance", 0},
        {"FullRowSelect", true},
        {"HotTracking", true},
        {"LabelEdit", 1},
        {"OLEDropMode", 1},
        {"OLEDragMode", 0},
        {"AllowLabelEdit", false},
        {"PathRoot", "C:\\x"},
        {"AllowHiddenFolders", true},
        {"AllowSystemFolders", true},
        {"ForeColor", 255},
        {"ImageCount", 9},
        {"ImageIndex", 3},
        {"ImageTag", "tag"},
        {"ImageKey", "key"},
        {"RefreshInterval", 1500},
        {"ItemIndex", 4},
        {"ItemTag", "item tag"},
        {"ItemExpanded", true},
        {"ItemIcon", "icon"},
        {"ItemCount", 12},
        {"Path", "C:\\y"},
        {"ItemName", "name"},
        {"ItemDisplayName", "label"},
        {"ItemSelected", true},
        {"ItemPath", "C:\\z"},
        {"MousePointer", 11},
        {"SelectedItem", 2},
        {"AutoFillSubFolders", true},
    };
    const MemoryBag bag(MemoryBag::Contents(values.begin(), values.end()));
    Stage stage({.saved = &bag, .show = false});
    MemoryBag again;
    stage.Save(again);
    EXPECT_EQ(again.Kept().size(), values.size());
    for (const auto& [key, value] : values) EXPECT_EQ(again.ReadProperty(key, Variant()), value) << key;
}

TEST(FolderViewTables, PicturesAndFontsComeBackWithALoad) {
    Stage stage;
    const auto icon = std::make_shared<frame::Picture>(240.0f, 240.0f, "pointer");
    auto font = std::make_shared<frame::Font>();
    font->SetSize(20);
    stage.View().SetMouseIcon(icon);
    stage.View().SetFont(font);
    MemoryBag bag;
    stage.Save(bag);
    Stage loaded({.saved = &bag});
    EXPECT_EQ(loaded.View().MouseIcon(), icon);
    EXPECT_EQ(loaded.View().Font()->Size(), stage.View().Font()->Size());
}

TEST(FolderViewTables, ALoadRaisesNothingAndFillsNothing) {
    const MemoryBag bag(MemoryBag::Contents{{"PathRoot", Variant("C:\\Temp")}, {"ItemCount", Variant(5)}});
    Stage stage({.saved = &bag, .show = false});
    EXPECT_EQ(stage.View().ItemCount(), 0);
    EXPECT_EQ(stage.View().FolderPath(), "");
    stage.TheSite().Show();
    EXPECT_EQ(stage.Events(), "BeforePaint(False) BeforeAddItem(False) AfterAddItem(1) AfterPaint ChangedFolder");
    EXPECT_EQ(stage.View().FolderPath(), "C:\\Temp");
}

TEST(FolderViewTables, LoadedAllowLabelEditLeavesTheTreesOwnEditAsLoaded) {
    const MemoryBag bag(MemoryBag::Contents{{"AllowLabelEdit", Variant(false)}, {"LabelEdit", Variant(1)}});
    Stage stage({.saved = &bag});
    EXPECT_FALSE(stage.View().AllowLabelEdit());
    EXPECT_EQ(stage.View().TreeFolders.LabelEdit(), child::TreeLabelEditConstants::Manual);
}

TEST(FolderViewTables, TheItemPropertiesAreKeptForTheBagAndNotRead) {
    const MemoryBag bag(MemoryBag::Contents{{"ItemName", Variant("kept")},
                                            {"ItemPath", Variant("kept")},
                                            {"ItemTag", Variant("kept")},
                                            {"ItemIcon", Variant("kept")},
                                            {"ImageKey", Variant("kept")},
                                            {"ImageTag", Variant("kept")},
                                            {"ItemCount", Variant(7)},
                                            {"ImageCount", Variant(7)},
                                            {"ItemSelected", Variant(true)},
                                            {"SelectedItem", Variant(7)}});
    Stage stage({.saved = &bag});
    const FolderView& view = stage.View();
    EXPECT_EQ(view.ItemName() + view.ItemPath() + view.ItemTag() + view.ItemIcon() + view.ImageKey() + view.ImageTag(), "");
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(view.ImageCount(), 4);
    EXPECT_FALSE(view.ItemSelected());
    EXPECT_EQ(view.SelectedItem(), 0);
}

TEST(FolderViewTables, AKeyOfAnotherTypeIsConverted) {
    const MemoryBag bag(MemoryBag::Contents{{"RefreshInterval", Variant("250")}, {"AllowHiddenFolders", Variant(1)}});
    Stage stage({.saved = &bag});
    EXPECT_EQ(stage.View().RefreshInterval(), 250);
    EXPECT_TRUE(stage.View().AllowHiddenFolders());
}

TEST(FolderViewTables, AValueThatCannotBeConvertedFailsTheLoad) {
    const MemoryBag bag(MemoryBag::Contents{{"RefreshInterval", Variant("soon")}});
    EXPECT_EQ(ErrorOf([&] { Stage stage({.saved = &bag}); }), frame::errors::typeMismatch);
}

// The tree

TEST(FolderViewTables, StockPropertiesAreThoseOfTheTree) {
    Stage stage;
    FolderView& view = stage.View();
    view.Put("Enabled", false);
    view.Put("BorderStyle", 1);
    view.Put("Appearance", 0);
    view.Put("MousePointer", 11);
    view.Put("ForeColor", 255);
    view.Put("FullRowSelect", true);
    view.Put("HotTracking", true);
    const child::TreeView& tree = stage.Tree();
    EXPECT_FALSE(tree.Enabled());
    EXPECT_EQ(tree.BorderStyle(), child::TreeBorderConstants::FixedSingle);
    EXPECT_EQ(tree.Appearance(), child::AppearanceConstants::Flat);
    EXPECT_EQ(tree.MousePointer(), 11);
    EXPECT_EQ(tree.ForeColor(), frame::OLE_COLOR(255));
    EXPECT_TRUE(tree.FullRowSelect());
    EXPECT_TRUE(tree.HotTracking());
    EXPECT_THAT(stage.Changes(),
                ElementsAre("Enabled", "BorderStyle", "Appearance", "MousePointer", "ForeColor", "FullRowSelect", "HotTracking"));
    const auto font = std::make_shared<frame::Font>();
    view.SetFont(font);
    EXPECT_EQ(view.Font(), font);
    EXPECT_EQ(tree.Font(), font);
}

TEST(FolderViewTables, AllowLabelEditTurnsTheTreesOwnEditOff) {
    Stage stage;
    stage.View().SetAllowLabelEdit(true);
    EXPECT_EQ(stage.Tree().LabelEdit(), child::TreeLabelEditConstants::Manual);
    stage.View().SetAllowLabelEdit(false);
    EXPECT_EQ(stage.Tree().LabelEdit(), child::TreeLabelEditConstants::Automatic);
}

TEST(FolderViewTables, TheTreeFillsTheControl) {
    Stage stage;
    stage.Resize(4500, 2400);
    EXPECT_EQ(stage.Tree().Width(), 4500);
    EXPECT_EQ(stage.Tree().Height(), 2400);
}

TEST(FolderViewTables, TheTreeDrawsFromTheImageList) {
    Stage stage;
    EXPECT_EQ(stage.Tree().ImageList(), &stage.View().Image16);
}

TEST(FolderViewTables, ANegativeIntervalIsRefused) {
    Stage stage;
    EXPECT_EQ(ErrorOf([&] { stage.View().SetRefreshInterval(-1); }), frame::errors::invalidValue);
}

TEST(FolderViewTables, TheFilterAndTheRootAloneRefillTheTree) {
    Stage stage;
    stage.Folder("C:\\x\\hidden", frame::attributes::hidden);
    stage.ShowRoot("C:\\x");
    stage.View().SetAllowHiddenFolders(true);
    stage.View().SetAllowSystemFolders(true);
    stage.View().SetAutoFillSubFolders(true);
    EXPECT_EQ(stage.Events(), "");
    EXPECT_EQ(Labels(stage.View()), "x");
}

}  // namespace
}  // namespace tessel::controls
