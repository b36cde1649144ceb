#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <set>
#include <string>

#include "tests/ErrorOf.h"
#include "tests/controls/folderview/FolderViewTestHelp.h"

/// What fails while the tree is filled, and stops nothing.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::ControlError;
using frame::Variant;
using test::ErrorOf;
using testing::IsEmpty;

constexpr int applicationError = 1234;

class FolderViewFailure : public testing::Test {
  protected:
    FolderViewFailure() {
        for (const char* path : {"C:\\x\\a\\s", "C:\\x\\b\\t", "C:\\x\\c\\u"}) stage.Folder(path);
    }
    void Lock(const std::string& path, bool value = true) { stage.Disk().SetFolder(path, {.unreadable = value}).Check(); }
    Stage stage;
    FolderView& view = stage.View();
};

TEST_F(FolderViewFailure, AFolderThatCannotBeReadHasNoChildrenAndGivesNoError) {
    Lock("C:\\x\\b");
    stage.ShowRoot("C:\\x");
    for (const char* key : {"C:\\x\\a", "C:\\x\\b", "C:\\x\\c"}) {
        stage.Click(key);
        EXPECT_EQ(view.FolderPath(), key);
    }
    EXPECT_EQ(Labels(view), "x {a {s}, b, c {u}}");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(FolderViewFailure, AFolderThatCannotBeReadDoesNotStopAFillOfAll) {
    Lock("C:\\x\\b");
    view.SetAutoFillSubFolders(true);
    stage.ShowRoot("C:\\x");
    stage.Expand("C:\\x");
    EXPECT_EQ(Labels(view), "x {a {s}, b, c {u}}");
}

TEST_F(FolderViewFailure, AFolderThatCannotBeReadDoesNotStopARefresh) {
    Lock("C:\\x\\b");
    stage.ShowRoot("C:\\x");
    stage.Expand("C:\\x");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a {s}, b, c {u}}");
    Lock("C:\\x\\b", false);
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a {s}, b {t}, c {u}}");
}

TEST_F(FolderViewFailure, AFolderThatCanNoLongerBeReadKeepsItsChildren) {
    stage.ShowRoot("C:\\x");
    stage.Click("C:\\x\\b");
    Lock("C:\\x\\b");
    stage.Click("C:\\x\\b");
    stage.Expand("C:\\x\\b");
    view.Refresh();
    EXPECT_EQ(Labels(view), "x {a, b {t}, c}");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewFailure, AFolderThatCanNoLongerBeReadStillLosesWhatHasGone) {
    stage.ShowRoot("C:\\x");
    stage.Click("C:\\x\\b");
    Lock("C:\\x\\b");
    stage.Remove("C:\\x\\b\\t");
    stage.Click("C:\\x\\b");
    EXPECT_EQ(Labels(view), "x {a, b, c}");
}

TEST_F(FolderViewFailure, ARootThatCannotBeReadStandsAlone) {
    Lock("C:\\x");
    stage.ShowRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FolderViewFailure, ADriveThatCannotBeReadDoesNotStopTheOthers) {
    stage.Drive("A", {.type = frame::driveTypes::removable, .ready = false});
    stage.Drive("D", {.volume = "Work"});
    stage.Folder("D:\\d");
    stage.Disk().SetFolder("C:\\", {.unreadable = true}).Check();
    stage.ShowRoot("My Computer");
    EXPECT_EQ(Labels(view), "My Computer {(A:), Local Disk (C:), Work (D:) {d}}");
}

TEST_F(FolderViewFailure, MyDocumentsThatCannotBeReadStandsAlone) {
    stage.Folder("C:\\My Documents\\letters");
    Lock("C:\\My Documents");
    stage.ShowRoot("My Documents");
    EXPECT_EQ(Labels(view), "My Documents");
}

TEST_F(FolderViewFailure, ASpecialFolderThatTheSystemLacksGivesARootWithoutAPath) {
    test::HostUnderTest host;
    host.files.SetSpecialFolder(5, "");
    auto& other = host.Create<FolderView>("FolderView1");
    other.SetPathRoot("My Documents");
    EXPECT_EQ(Labels(other), "My Documents");
    EXPECT_EQ(Keys(other), "");
    other.Refresh();
    EXPECT_EQ(Labels(other), "My Documents");
}

// Errors of the application

TEST_F(FolderViewFailure, ErrorsOfTheApplicationWhileAddingEndNoFill) {
    stage.handlers.On(folderview::AfterAddItem, [](std::int32_t&) { throw ControlError(applicationError); });
    EXPECT_EQ(ErrorOf([&] { view.SetPathRoot("C:\\x"); }), 0);
    EXPECT_EQ(Labels(view), "x {a, b, c}");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    stage.handlers.On(folderview::BeforeAddItem, [](bool&) { throw ControlError(applicationError); });
    EXPECT_EQ(ErrorOf([&] { stage.Click("C:\\x\\a"); }), 0);
    EXPECT_EQ(Labels(view), "x {a {s}, b, c}");
}

TEST_F(FolderViewFailure, ErrorsOfTheApplicationWhileAddingEndNoRefresh) {
    stage.ShowRoot("C:\\x");
    stage.Expand("C:\\x");
    stage.handlers.On(folderview::BeforeAddItem, [](bool&) { throw ControlError(applicationError); });
    stage.handlers.On(folderview::AfterAddItem, [](std::int32_t&) { throw ControlError(applicationError); });
    EXPECT_EQ(ErrorOf([&] { view.Refresh(); }), 0);
    EXPECT_EQ(Labels(view), "x {a {s}, b {t}, c {u}}");
    stage.Folder("C:\\x\\new");
    stage.Tick();
    EXPECT_TRUE(stage.Has("C:\\x\\new"));
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

// The disk fails at any step

struct Act {
    const char* name;
    void (*run)(Stage& stage);
};
const Act acts[] = {
    {"BuildAFolder", [](Stage& stage) { stage.View().SetPathRoot("C:\\x"); }},
    {"BuildTheDrives", [](Stage& stage) { stage.View().SetPathRoot("My Computer"); }},
    {"BuildMyDocuments", [](Stage& stage) { stage.View().SetPathRoot("My Documents"); }},
    {"BuildMyFolders",
     [](Stage& stage) {
         stage.View().SetPathRoot("My Folders");
         stage.View().AddNewFolder("C:\\x");
         stage.View().AddNewFolder("C:\\none");
     }},
    {"Click",
     [](Stage& stage) {
         stage.View().SetPathRoot("C:\\x");
         if (stage.Has("C:\\x\\a")) stage.Click("C:\\x\\a");
     }},
    {"Expand",
     [](Stage& stage) {
         stage.View().SetAutoFillSubFolders(true);
         stage.View().SetPathRoot("C:\\x");
         if (stage.Has("C:\\x")) stage.Expand("C:\\x");
     }},
    {"Refresh",
     [](Stage& stage) {
         stage.View().SetPathRoot("C:\\x");
         if (stage.Has("C:\\x")) stage.Expand("C:\\x");
         stage.Folder("C:\\x\\new");
         stage.View().Refresh();
     }},
    {"RefreshTheDrives",
     [](Stage& stage) {
         stage.View().SetPathRoot("My Computer");
         if (stage.Has("My Computer")) stage.Expand("My Computer");
         stage.View().Refresh();
     }},
    {"GoUp",
     [](Stage& stage) {
         stage.View().SetPathRoot("C:\\x");
         if (stage.Has("C:\\x\\a")) stage.Select("C:\\x\\a");
         stage.View().GoUp();
     }},
    {"SetThePath",
     [](Stage& stage) {
         stage.View().SetPathRoot("C:\\x");
         stage.View().SetFolderPath("C:\\x\\a");
     }},
    {"MakeAFolder",
     [](Stage& stage) {
         stage.View().SetPathRoot("C:\\x");
         stage.View().SetItemIndex(1);
         if (stage.Has("C:\\x")) stage.Select("C:\\x");
         stage.View().AddNewFolder("made");
     }},
};

class FolderViewFailingStep : public testing::TestWithParam<Act> {
  protected:
    static void SetUpDisk(Stage& stage) {
        for (const char* path : {"C:\\x\\a\\s", "C:\\x\\b", "C:\\x\\c\\u", "C:\\My Documents\\letters"}) stage.Folder(path);
        stage.Folder("C:\\x\\h", frame::attributes::hidden);
        stage.Drive("A", {.type = frame::driveTypes::removable, .ready = false});
        stage.Drive("D", {.volume = "Work"});
        stage.Folder("D:\\d");
        stage.View().SetAllowHiddenFolders(true);
    }
    /// No key stands twice, each node is below the folder that holds it, and the tree works as ever once the disk does.
    static void ExpectSoundAndUsable(Stage& stage) {
        FolderView& view = stage.View();
        EXPECT_TRUE(stage.host.errors.reports.empty());
        std::set<std::string> keys;
        for (std::int32_t index = 1; index <= view.ItemCount(); ++index) {
            const child::TreeNodeRef node = stage.Tree().Nodes.Item(index);
            EXPECT_TRUE(node->Key().empty() || keys.insert(frame::FoldCase(node->Key())).second) << node->Key();
            EXPECT_FALSE(node->Text().empty()) << node->Key();
        }
        stage.ShowRoot("C:\\x");
        EXPECT_TRUE(Labels(view).starts_with("x {a, b, c, h")) << Labels(view);
        stage.Click("C:\\x\\a");
        EXPECT_EQ(view.FolderPath(), "C:\\x\\a");
        EXPECT_TRUE(stage.Has("C:\\x\\a\\s"));
        stage.Expand("C:\\x");
        view.Refresh();
        EXPECT_TRUE(stage.Has("C:\\x\\c\\u"));
    }
};

TEST_P(FolderViewFailingStep, NoErrorLeavesTheControlAndTheTreeStaysSound) {
    int steps = 0;
    {
        Stage whole;
        SetUpDisk(whole);
        whole.watched.steps = 0;
        GetParam().run(whole);
        steps = whole.watched.steps;
    }
    ASSERT_GT(steps, 0);
    for (const bool onward : {false, true})
        for (int step = 0; step < steps; ++step) {
            SCOPED_TRACE("step " + std::to_string(step) + (onward ? " and all behind it" : ""));
            Stage stage;
            SetUpDisk(stage);
            stage.watched.steps = 0;
            stage.watched.failingStep = step;
            stage.watched.failsFromThereOn = onward;
            EXPECT_EQ(ErrorOf([&] { GetParam().run(stage); }), 0);
            stage.watched.failingStep = -1;
            ExpectSoundAndUsable(stage);
        }
}

TEST_P(FolderViewFailingStep, MissingIconsStopNothing) {
    Stage stage;
    SetUpDisk(stage);
    stage.hasIcon = [](const std::string&) { return false; };
    GetParam().run(stage);
    ExpectSoundAndUsable(stage);
}

TEST_P(FolderViewFailingStep, AnIconThatFailsStopsNothing) {
    Stage stage;
    SetUpDisk(stage);
    stage.hasIcon = [](const std::string&) -> bool { throw ControlError(applicationError); };
    EXPECT_EQ(ErrorOf([&] { GetParam().run(stage); }), 0);
    ExpectSoundAndUsable(stage);
}

std::string NameOfAct(const testing::TestParamInfo<Act>& tested) { return tested.param.name; }
INSTANTIATE_TEST_SUITE_P(EveryAct, FolderViewFailingStep, testing::ValuesIn(acts), NameOfAct);

TEST_F(FolderViewFailure, ThePathIsKeptThroughAFailingBuild) {
    stage.watched.failingStep = 0;
    stage.watched.failsFromThereOn = true;
    stage.watched.steps = 0;
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Events(), "BeforePaint(False) AfterPaint ChangedFolder");
}

}  // namespace
}  // namespace tessel::controls
