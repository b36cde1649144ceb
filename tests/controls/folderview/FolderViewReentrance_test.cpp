#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstddef>
#include <functional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "tests/ErrorOf.h"
#include "tests/controls/folderview/FolderViewTestHelp.h"

/// What an application may do inside the events of the tree, and while a message box is open: everything.
namespace tessel::controls {
namespace {

using namespace foldertest;
using frame::ControlError;
using frame::Variant;
using test::ErrorOf;

constexpr int applicationError = 1234;

/// Something that the user or the host does, which raises events.
struct Act {
    const char* name;
    void (*prepare)(Stage& stage);
    void (*run)(Stage& stage);
};
const Act acts[] = {
    {"BuildAFolder", [](Stage&) {}, [](Stage& stage) { stage.View().SetPathRoot("C:\\x"); }},
    {"BuildTheDrives", [](Stage&) {}, [](Stage& stage) { stage.View().SetPathRoot("My Computer"); }},
    {"BuildMyDocuments", [](Stage&) {}, [](Stage& stage) { stage.View().SetPathRoot("My Documents"); }},
    {"BuildMyFolders", [](Stage&) {}, [](Stage& stage) { stage.View().SetPathRoot("My Folders"); }},
    {"Show", [](Stage& stage) { stage.ShowRoot("C:\\x"); }, [](Stage& stage) { stage.TheSite().Show(); }},
    {"AddMyFolder", [](Stage& stage) { stage.ShowRoot("My Folders"); }, [](Stage& stage) { stage.View().AddNewFolder("C:\\x"); }},
    {"MakeAFolder",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.View().SetItemIndex(1);
         stage.Select("C:\\x");
     },
     [](Stage& stage) { stage.View().AddNewFolder("made"); }},
    {"Click", [](Stage& stage) { stage.ShowRoot("C:\\x"); }, [](Stage& stage) { stage.Click("C:\\x\\a"); }},
    {"Press",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.Expand("C:\\x");
     },
     [](Stage& stage) { stage.Press("C:\\x\\a"); }},
    {"ClickWhatHasGone",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.Remove("C:\\x\\a");
     },
     [](Stage& stage) { stage.Click("C:\\x\\a"); }},
    {"Expand",
     [](Stage& stage) {
         stage.View().SetAutoFillSubFolders(true);
         stage.ShowRoot("C:\\x");
         stage.Folder("C:\\x\\new");
     },
     [](Stage& stage) { stage.Expand("C:\\x"); }},
    {"ExpandWhatHasGone",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.Remove("C:\\x\\a");
     },
     [](Stage& stage) { stage.Expand("C:\\x\\a"); }},
    {"Collapse",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.Expand("C:\\x");
     },
     [](Stage& stage) { stage.Collapse("C:\\x"); }},
    {"Refresh",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.Expand("C:\\x");
         for (const char* path : {"C:\\x\\m", "C:\\x\\n\\deep"}) stage.Folder(path);
         stage.Remove("C:\\x\\b");
     },
     [](Stage& stage) { stage.Tick(); }},
    {"GoUp",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.Click("C:\\x\\a");
     },
     [](Stage& stage) { stage.View().GoUp(); }},
    {"ExpandByTheCursor",
     [](Stage& stage) {
         stage.ShowRoot("C:\\x");
         stage.View().SetItemIndex(stage.IndexOf("C:\\x\\a"));
     },
     [](Stage& stage) { stage.View().SetItemExpanded(true); }},
};

/// Something that the application does meanwhile. `arguments` are those of the event; none for a message box.
struct Deed {
    const char* name;
    void (*run)(Stage& stage, frame::EventArguments arguments);
};

void RemoveLast(Stage& stage) {
    if (stage.View().ItemCount() > 0) stage.Tree().Nodes.Remove(Variant(stage.View().ItemCount()));
}
template <class F>
void EachNode(Stage& stage, F visit) {
    std::vector<std::string> keys;
    for (std::int32_t index = 1; index <= stage.View().ItemCount(); ++index) keys.push_back(stage.Tree().Nodes.Item(index)->Key());
    for (const std::string& key : keys)
        if (!key.empty() && stage.Has(key)) visit(key);
}

const Deed deeds[] = {
    {"ShowsAnotherRoot", [](Stage& stage, frame::EventArguments) { stage.View().SetPathRoot("C:\\y"); }},
    {"ShowsTheDrives", [](Stage& stage, frame::EventArguments) { stage.View().SetPathRoot("My Computer"); }},
    {"ShowsNothing", [](Stage& stage, frame::EventArguments) { stage.View().SetPathRoot(""); }},
    {"BuildsAnew", [](Stage& stage, frame::EventArguments) { stage.View().Show(); }},
    {"ClearsTheNodes", [](Stage& stage, frame::EventArguments) { stage.Tree().Nodes.Clear(); }},
    {"ClearsAndAddsNodes",
     [](Stage& stage, frame::EventArguments) {
         stage.Tree().Nodes.Clear();
         for (const char* key : {"C:\\x", "C:\\y", "C:\\none"}) stage.Tree().Nodes.Add({}, {}, key, "own");
     }},
    {"RemovesTheNodeInHand",
     [](Stage& stage, frame::EventArguments arguments) {
         if (!arguments.empty() && arguments[0].Get().Type() == frame::VarType::Object)
             stage.Tree().Nodes.Remove(arguments[0].Get());
         else
             RemoveLast(stage);
     }},
    {"RemovesTheRoot",
     [](Stage& stage, frame::EventArguments) {
         if (stage.View().ItemCount() > 0) stage.Tree().Nodes.Remove(Variant(1));
     }},
    {"RemovesAllButTheRoot",
     [](Stage& stage, frame::EventArguments) {
         while (stage.View().ItemCount() > 1) RemoveLast(stage);
     }},
    {"TakesTheKeysAway",
     [](Stage& stage, frame::EventArguments) {
         for (std::int32_t index = 1; index <= stage.View().ItemCount(); ++index)
             stage.Tree().Nodes.Item(index)->SetKey("own" + std::to_string(index)).Check();
     }},
    {"SetsThePath",
     [](Stage& stage, frame::EventArguments) {
         stage.View().SetFolderPath("C:\\x\\b");
         stage.View().SetFolderPath("nowhere");
     }},
    {"SetsEveryProperty",
     [](Stage& stage, frame::EventArguments) {
         FolderView& view = stage.View();
         view.SetItemIndex(1);
         view.SetItemDisplayName("label");
         view.SetItemTag("tag");
         view.SetItemSelected(true);
         view.SetSelectedItem(view.ItemCount());
         view.SetAllowHiddenFolders(true);
         view.SetAutoFillSubFolders(!view.AutoFillSubFolders());
         view.SetRefreshInterval(1000);
         for (const frame::Member& member : FolderView::table.members)
             if (!member.isMethod) (void)view.Get(member.name);
     }},
    {"Refreshes",
     [](Stage& stage, frame::EventArguments) {
         stage.View().Refresh();
         stage.Tick();
     }},
    {"ExpandsAll", [](Stage& stage, frame::EventArguments) { EachNode(stage, [&](const auto& key) { stage.Expand(key); }); }},
    {"CollapsesAll", [](Stage& stage, frame::EventArguments) { EachNode(stage, [&](const auto& key) { stage.Collapse(key); }); }},
    {"ClicksAll", [](Stage& stage, frame::EventArguments) { EachNode(stage, [&](const auto& key) { stage.Click(key); }); }},
    {"GoesUp",
     [](Stage& stage, frame::EventArguments) {
         if (stage.View().ItemCount() > 0) stage.View().SetSelectedItem(stage.View().ItemCount());
         stage.View().GoUp();
     }},
    {"AddsAFolder",
     [](Stage& stage, frame::EventArguments) {
         stage.View().SetItemIndex(1);
         stage.View().SetSelectedItem(1);
         stage.View().AddNewFolder("C:\\y");
         stage.View().AddNewFolder("extra");
         stage.View().AddNewFolder();
     }},
    {"EmptiesTheDisk",
     [](Stage& stage, frame::EventArguments) {
         (void)stage.Disk().Remove("C:\\x");
         (void)stage.Disk().Remove("C:\\My Documents");
         (void)stage.Disk().Remove("D:");
     }},
    {"ChangesTheDisk",
     [](Stage& stage, frame::EventArguments) {
         (void)stage.Disk().Remove("C:\\x\\a");
         (void)stage.Disk().Remove("C:\\x\\b");
         stage.Folder("C:\\x\\a\\other");
     }},
    {"ClearsTheImages",
     [](Stage& stage, frame::EventArguments) {
         stage.Tree().SetImageList(nullptr);
         stage.View().Image16.ListImages.Clear();
         stage.Tree().SetImageList(&stage.View().Image16);
     }},
    {"CancelsWhatItCan",
     [](Stage&, frame::EventArguments arguments) {
         if (!arguments.empty() && arguments[0].Get().Type() == frame::VarType::Boolean) arguments[0].Set(true);
     }},
    {"TakesTheNodeAway",
     [](Stage&, frame::EventArguments arguments) {
         if (!arguments.empty() && arguments[0].Get().Type() == frame::VarType::Object)
             arguments[0].As<child::TreeNodeRef>() = nullptr;
     }},
    {"SetsTheIndexAside",
     [](Stage&, frame::EventArguments arguments) {
         if (!arguments.empty() && arguments[0].Get().Type() == frame::VarType::Long) arguments[0].Set(-7);
     }},
    {"GoesToDesignTime", [](Stage& stage, frame::EventArguments) { stage.SetUserMode(false); }},
    {"Fails", [](Stage&, frame::EventArguments) { throw ControlError(applicationError); }},
};

class FolderViewReentrance : public testing::TestWithParam<Act> {
  protected:
    static void SetUpDisk(Stage& stage) {
        for (const char* path :
             {"C:\\x\\a\\s", "C:\\x\\a\\t", "C:\\x\\b\\u", "C:\\x\\c", "C:\\y\\other", "C:\\My Documents\\letters"})
            stage.Folder(path);
        stage.Drive("D", {.volume = "Work"});
        stage.Folder("D:\\d");
    }
    static void Prepare(Stage& stage) {
        SetUpDisk(stage);
        GetParam().prepare(stage);
        stage.Clear();
    }
    /// How many events and message boxes the act brings.
    static int Moments() {
        Stage stage;
        Prepare(stage);
        int moments = 0;
        stage.onEvent = [&](frame::EventArguments) { ++moments; };
        stage.onMessage = [&] { ++moments; };
        GetParam().run(stage);
        return moments;
    }
    /// Carries out the act; at one of its moments `deed` runs, once.
    template <class D>
    static void RunWith(Stage& stage, int moment, D deed) {
        int now = 0;
        bool busy = false;
        const auto come = [&](frame::EventArguments arguments) {
            if (busy || now++ != moment) return;
            busy = true;
            deed(arguments);
            busy = false;
        };
        stage.onEvent = come;
        stage.onMessage = [&] { come({}); };
        frame::Entry::Run(
            stage.Frame(), [] { return std::string("test"); }, [&] { GetParam().run(stage); });
        stage.onEvent = nullptr;
        stage.onMessage = nullptr;
    }
    static void ExpectSound(Stage& stage) {
        std::set<std::string> keys;
        for (std::int32_t index = 1; index <= stage.View().ItemCount(); ++index) {
            const child::TreeNodeRef node = stage.Tree().Nodes.Item(index);
            EXPECT_EQ(node->Index(), index);
            EXPECT_TRUE(node->Key().empty() || keys.insert(frame::FoldCase(node->Key())).second) << node->Key();
        }
    }
    /// The tree works as ever.
    static void ExpectUsable(Stage& stage) {
        FolderView& view = stage.View();
        stage.SetUserMode(true);
        stage.Disk().SetFolder("C:\\y\\other\\deep", {}).Check();
        view.SetAutoFillSubFolders(false);
        stage.ShowRoot("C:\\y");
        EXPECT_TRUE(Labels(view).starts_with("y {")) << Labels(view);
        EXPECT_TRUE(stage.Has("C:\\y\\other"));
        EXPECT_EQ(view.FolderPath(), "C:\\y");
        stage.Click("C:\\y\\other");
        EXPECT_EQ(stage.EventsButAdding(), "NodeClick(C:\\y\\other) ChangedFolder");
        EXPECT_TRUE(stage.Has("C:\\y\\other\\deep"));
        stage.Remove("C:\\y\\other");
        view.Refresh();
        EXPECT_FALSE(stage.Has("C:\\y\\other"));
        EXPECT_EQ(stage.Messages(), "");
    }
};

TEST_P(FolderViewReentrance, TheApplicationMayDoAnythingAtAnyMoment) {
    const int moments = Moments();
    ASSERT_GT(moments, 0);
    for (const Deed& deed : deeds)
        for (int moment = 0; moment < moments; ++moment) {
            SCOPED_TRACE(std::string(deed.name) + " at moment " + std::to_string(moment));
            Stage stage;
            Prepare(stage);
            bool done = false;
            RunWith(stage, moment, [&](frame::EventArguments arguments) {
                done = true;
                deed.run(stage, arguments);
            });
            EXPECT_TRUE(done);
            for (const auto& report : stage.host.errors.reports) EXPECT_EQ(report.error.Number(), applicationError);
            ExpectSound(stage);
            ExpectUsable(stage);
        }
}

TEST_P(FolderViewReentrance, TheApplicationMayDestroyTheControlAtAnyMoment) {
    const int moments = Moments();
    for (int moment = 0; moment < moments; ++moment) {
        SCOPED_TRACE("moment " + std::to_string(moment));
        Stage stage;
        Prepare(stage);
        RunWith(stage, moment, [&](frame::EventArguments) { stage.Destroy(); });
        EXPECT_FALSE(stage.Lives());
        EXPECT_TRUE(stage.host.errors.reports.empty());
    }
}

TEST_P(FolderViewReentrance, NothingIsToldOfAControlThatWasDestroyed) {
    const int moments = Moments();
    for (int moment = 0; moment < moments; ++moment) {
        SCOPED_TRACE("moment " + std::to_string(moment));
        Stage stage;
        Prepare(stage);
        std::string told;
        RunWith(stage, moment, [&](frame::EventArguments) {
            stage.Destroy();
            told = stage.Events() + stage.Messages();
        });
        EXPECT_EQ(stage.Events(), "");
        EXPECT_EQ(stage.Messages(), "");
    }
}

TEST_P(FolderViewReentrance, DoingAnythingAtEveryMomentEndsToo) {
    for (const Deed& deed : deeds) {
        SCOPED_TRACE(deed.name);
        Stage stage;
        Prepare(stage);
        int depth = 0;
        const auto come = [&](frame::EventArguments arguments) {
            if (depth >= 1) return;
            ++depth;
            (void)ErrorOf([&] { deed.run(stage, arguments); });
            --depth;
        };
        stage.onEvent = come;
        stage.onMessage = [&] { come({}); };
        EXPECT_EQ(ErrorOf([&] { GetParam().run(stage); }), 0);
        stage.onEvent = nullptr;
        stage.onMessage = nullptr;
        ExpectSound(stage);
        ExpectUsable(stage);
    }
}

std::string NameOfAct(const testing::TestParamInfo<Act>& tested) { return tested.param.name; }
INSTANTIATE_TEST_SUITE_P(EveryAct, FolderViewReentrance, testing::ValuesIn(acts), NameOfAct);

// What comes of it.

class FolderViewReentranceResults : public testing::Test {
  protected:
    FolderViewReentranceResults() {
        for (const char* path : {"C:\\x\\a\\s", "C:\\x\\b", "C:\\x\\c", "C:\\y\\other"}) stage.Folder(path);
    }
    template <class F>
    static auto Once(F run) {
        return [run, done = false](auto&...) mutable {
            if (!std::exchange(done, true)) run();
        };
    }
    Stage stage;
    FolderView& view = stage.View();
};

TEST_F(FolderViewReentranceResults, ARootThatIsSetAtTheEndOfABuildStays) {
    stage.handlers.On(folderview::AfterPaint, Once([&] { view.SetPathRoot("C:\\y"); }));
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(view), "y {other}");
    EXPECT_EQ(view.PathRoot(), "C:\\y");
    EXPECT_EQ(view.FolderPath(), "C:\\y");
    EXPECT_EQ(stage.EventsButAdding(), "BeforePaint(False) AfterPaint BeforePaint(False) AfterPaint ChangedFolder ChangedFolder");
}

TEST_F(FolderViewReentranceResults, ARootThatIsSetBeforeABuildIsTheOneThatIsBuilt) {
    stage.handlers.On(folderview::BeforePaint, Once([&] { view.SetPathRoot("C:\\y"); }));
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(view), "y {other}");
    EXPECT_EQ(view.FolderPath(), "C:\\y");
}

TEST_F(FolderViewReentranceResults, ClearingTheNodesInsideAFillEndsIt) {
    stage.handlers.On(folderview::BeforeAddItem, [&](bool&) {
        if (view.ItemCount() == 2) stage.Tree().Nodes.Clear();
    });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(view.ItemCount(), 0);
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FolderViewReentranceResults, RemovingEachNodeInHandLeavesTheRoot) {
    stage.handlers.On(folderview::AfterAddItem, [&](std::int32_t& index) {
        if (index > 1) stage.Tree().Nodes.Remove(Variant(index));
    });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x");
    EXPECT_EQ(stage.Events(),
              "BeforePaint(False) BeforeAddItem(False) AfterAddItem(1) BeforeAddItem(False) AfterAddItem(2) BeforeAddItem(False) "
              "AfterAddItem(2) BeforeAddItem(False) AfterAddItem(2) AfterPaint ChangedFolder");
}

TEST_F(FolderViewReentranceResults, AnIndexThatAHandlerSetsCountsNothing) {
    stage.handlers.On(folderview::AfterAddItem, [](std::int32_t& index) { index = 99; });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b, c}");
}

TEST_F(FolderViewReentranceResults, RemovingTheClickedNodeEndsTheClick) {
    stage.ShowRoot("C:\\x");
    stage.handlers.On(folderview::NodeClick, [&](child::TreeNodeRef& node) { stage.Tree().Nodes.Remove(Variant(node)); });
    stage.Click("C:\\x\\a");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\a)");
    EXPECT_EQ(Labels(view), "x {b, c}");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewReentranceResults, RemovingTheExpandedNodeEndsTheExpansion) {
    stage.ShowRoot("C:\\x");
    stage.handlers.On(folderview::Expand, [&](child::TreeNodeRef& node) { stage.Tree().Nodes.Remove(Variant(node)); });
    stage.Expand("C:\\x\\a");
    EXPECT_EQ(stage.Events(), "Expand(C:\\x\\a)");
    EXPECT_EQ(Labels(view), "x {b, c}");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewReentranceResults, AnotherNodeInTheArgumentMovesNothing) {
    stage.ShowRoot("C:\\x");
    stage.handlers.On(folderview::NodeClick, [&](child::TreeNodeRef& node) { node = stage.Node("C:\\x\\b"); });
    stage.Click("C:\\x\\a");
    EXPECT_EQ(view.ItemCount(), 5);
    EXPECT_TRUE(stage.Has("C:\\x\\a\\s"));
    EXPECT_EQ(view.FolderPath(), "C:\\x\\a");
}

TEST_F(FolderViewReentranceResults, APathThatAClickHandlerSetsIsTheOneToCompareWith) {
    stage.ShowRoot("C:\\x");
    stage.handlers.On(folderview::NodeClick, [&](child::TreeNodeRef&) { view.SetFolderPath("C:\\x\\b"); });
    stage.Click("C:\\x\\b");
    EXPECT_EQ(stage.Events(), "NodeClick(C:\\x\\b)");
    stage.Click("C:\\x\\a");
    EXPECT_EQ(stage.EventsButAdding(), "NodeClick(C:\\x\\a) ChangedFolder");
    EXPECT_EQ(view.FolderPath(), "C:\\x\\a");
}

TEST_F(FolderViewReentranceResults, AFolderThatIsDeletedInsideAClickIsToldAsGone) {
    stage.ShowRoot("C:\\x");
    stage.handlers.On(folderview::NodeClick, [&](child::TreeNodeRef&) { stage.Remove("C:\\x\\b"); });
    stage.Click("C:\\x\\b");
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("b"));
    EXPECT_EQ(Labels(view), "x {a, c}");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
}

TEST_F(FolderViewReentranceResults, AFolderThatComesBackWhileTheMessageIsOpenIsTakenOutAllTheSame) {
    stage.ShowRoot("C:\\x");
    stage.Remove("C:\\x\\b");
    stage.onMessage = [&] { stage.Folder("C:\\x\\b"); };
    stage.Expand("C:\\x\\b");
    EXPECT_FALSE(stage.Has("C:\\x\\b"));
    stage.Click("C:\\x");
    EXPECT_TRUE(stage.Has("C:\\x\\b"));
}

TEST_F(FolderViewReentranceResults, ATreeThatIsBuiltAnewWhileTheMessageIsOpenStays) {
    stage.ShowRoot("C:\\x");
    stage.Remove("C:\\x\\b");
    stage.onMessage = [&] { view.SetPathRoot("C:\\y"); };
    stage.Expand("C:\\x\\b");
    EXPECT_EQ(Labels(view), "y {other}");
}

TEST_F(FolderViewReentranceResults, FoldersThatAreMadeInsideAFillComeWithTheNext) {
    int number = 0;
    stage.handlers.On(folderview::AfterAddItem, [&](std::int32_t&) {
        if (number < 5) stage.Folder("C:\\x\\z" + std::to_string(number++));
    });
    view.SetPathRoot("C:\\x");
    EXPECT_LE(number, 5);
    stage.Click("C:\\x");
    EXPECT_EQ(Labels(view), "x {a, b, c, z0, z1, z2, z3, z4}");
}

TEST_F(FolderViewReentranceResults, AHandlerOfChangedFolderMayGoUp) {
    stage.ShowRoot("C:\\x");
    stage.handlers.On(folderview::ChangedFolder, Once([&] { view.GoUp(); }));
    stage.Click("C:\\x\\a");
    EXPECT_EQ(stage.EventsButAdding(), "NodeClick(C:\\x\\a) ChangedFolder ChangedFolder");
    EXPECT_EQ(view.FolderPath(), "C:\\x");
    EXPECT_EQ(stage.Selected(), "C:\\x");
}

}  // namespace
}  // namespace tessel::controls
