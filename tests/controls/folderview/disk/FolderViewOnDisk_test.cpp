#include <gtest/gtest.h>

#include <array>
#include <filesystem>
#include <string>

#include "frame/Text.h"
#include "tests/controls/folderview/FolderViewTestHelp.h"
#include "tests/hosts/RealDisk.h"

/// The tree over the disk of this machine: what no other file system has.
namespace tessel::controls {
namespace {

using namespace foldertest;
namespace fs = std::filesystem;

class FolderViewOnDisk : public testing::Test {
  protected:
    FolderViewOnDisk() { folder.Make("x"); }

    std::string At(const std::string& name = {}) const { return folder / (name.empty() ? "x" : "x/" + name); }
    void Make(const std::string& name) { folder.Make("x/" + name); }
    void Link(const std::string& target, const std::string& name) { fs::create_symlink(target, At(name)); }
    void Show(const std::string& name = {}) { stage.ShowRoot(At(name)); }
    std::string TextOf(const std::string& key) { return stage.Node(key)->Text(); }
    std::string ImageOf(const std::string& key) { return stage.Node(key)->Image().ToText(); }

    test::RealDisk real;
    test::TestFolder& folder = real.folder;
    Stage stage{{.files = &real.files}};
    FolderView& view = stage.View();
};

// Names.

TEST_F(FolderViewOnDisk, AnyBytesMakeAName) {
    const std::array names = {
        std::string("-rf"),  std::string("a\nb"), std::string("a\\b:*?"), std::string("comma,"), std::string(251, 'x') + "\xE4",
        std::string("\xC4"), std::string("\xE4"), std::string("\xFF\xFE")};
    for (const std::string& name : names) Make(name + "/below\n" + name.substr(0, 9));
    Show();
    const auto expectAll = [&] {
        EXPECT_EQ(stage.Tree().Tree().ChildCount(stage.Node(At())->Ref().node), names.size());
        for (const std::string& name : names) {
            ASSERT_TRUE(stage.Has(At(name))) << name;
            EXPECT_EQ(TextOf(At(name)), name);
        }
    };
    expectAll();
    for (const std::string& name : names) {
        stage.Click(At(name));
        EXPECT_EQ(view.FolderPath(), At(name));
        EXPECT_EQ(view.ItemName(), name);
        EXPECT_TRUE(stage.Has(At(name) + "/below\n" + name.substr(0, 9))) << name;
    }
    stage.Clear();
    stage.Expand(At());
    stage.Tick();
    EXPECT_EQ(stage.Events(), "Expand(" + At() + ")") << "each is found again under its name";
    expectAll();
}

TEST_F(FolderViewOnDisk, FoldersOfAnyBytesAreMadeAndRenamed) {
    Make("\xFF");
    Show();
    stage.Select(At("\xFF"));
    view.SetItemIndex(stage.IndexOf(At("\xFF")));
    EXPECT_NE(view.AddNewFolder("new\n\xFE"), 0);
    EXPECT_TRUE(fs::is_directory(At("\xFF/new\n\xFE")));
    view.SetItemName("\xFD");
    EXPECT_TRUE(fs::is_directory(At("\xFD/new\n\xFE")));
    EXPECT_FALSE(fs::exists(At("\xFF")));
    EXPECT_EQ(TextOf(At("\xFF")), "\xFD");
    stage.Expand(At());
    EXPECT_EQ(Labels(view), "x") << "the key stays with a rename, and the folder of this key has gone";
    stage.Tick();
    EXPECT_TRUE(stage.Has(At("\xFD")));
}

TEST_F(FolderViewOnDisk, APathMayBeLongerThanTheSystemTakesAtOnce) {
    std::string path = At();
    Show();
    int depth = 0;
    for (; path.size() < 9'000; ++depth) {
        const std::string parent = path;
        path += "/" + std::string(200, static_cast<char>('a' + path.size() % 26));
        real.files.CreateFolder(path).Check();
        stage.Expand(parent);
        ASSERT_TRUE(stage.Has(path)) << depth;
    }
    EXPECT_EQ(view.ItemCount(), depth + 1);
    stage.Click(path);
    EXPECT_EQ(view.FolderPath(), path);
    view.Refresh();
    EXPECT_EQ(view.ItemCount(), depth + 1);
    view.GoUp();
    EXPECT_EQ(view.FolderPath() + "/", path.substr(0, path.rfind('/') + 1));
}

TEST_F(FolderViewOnDisk, OfNamesThatDifferInCaseAloneTheFirstIsShown) {
    Make("same/lower");
    Make("Same/upper");
    Show();
    stage.Expand(At());
    EXPECT_EQ(Labels(view), "x {Same}");
    stage.Expand(At("Same"));
    EXPECT_EQ(Labels(view), "x {Same {upper}}");
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {Same {upper}}");
    fs::remove_all(At("Same"));
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {same}");
    stage.Expand(At("same"));
    EXPECT_EQ(Labels(view), "x {same {lower}}");
    EXPECT_EQ(stage.Messages(), "");
}

// Permissions.

TEST_F(FolderViewOnDisk, AFolderThatMayNotBeReadHasNoChildrenAndGivesNoError) {
    Make("closed/below");
    Make("open/below");
    folder.SetMode("x/closed", 0);
    const test::LesserUser lesser(folder);
    view.SetAutoFillSubFolders(true);
    Show();
    stage.Expand(At());
    EXPECT_EQ(Labels(view), "x {closed, open {below}}");
    stage.Click(At("closed"));
    EXPECT_EQ(view.FolderPath(), At("closed"));
    stage.Expand(At("closed"));
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {closed, open {below}}");
    Show("closed");
    EXPECT_EQ(Labels(view), "closed");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(FolderViewOnDisk, FoldersThatMayOnlyBeNamedAreLeftOut) {
    Make("names/below");
    folder.SetMode("x/names", 0444);
    const test::LesserUser lesser(folder);
    Show("names");
    EXPECT_EQ(Labels(view), "names");
}

TEST_F(FolderViewOnDisk, AFolderThatMayOnlyBePassedIsARootWithoutChildren) {
    Make("passed/below/deep");
    folder.SetMode("x/passed", 0111);
    const test::LesserUser lesser(folder);
    Show("passed");
    EXPECT_EQ(Labels(view), "passed");
    Show("passed/below");
    EXPECT_EQ(Labels(view), "below {deep}");
}

TEST_F(FolderViewOnDisk, PermissionMayGoAndComeBackBetweenRefreshes) {
    Make("a/below/deep");
    const test::LesserUser lesser(folder);
    Show();
    stage.Expand(At());
    stage.Expand(At("a"));
    EXPECT_EQ(Labels(view), "x {a {below}}");
    folder.SetMode("x/a", 0);
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {a}") << "what cannot be seen counts as gone";
    folder.SetMode("x/a", 0755);
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {a {below}}");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewOnDisk, WithoutPermissionNoFolderIsMadeOrRenamed) {
    Make("a");
    folder.SetMode("x", 0555);
    const test::LesserUser lesser(folder);
    Show();
    stage.Select(At());
    view.SetItemIndex(stage.IndexOf(At("a")));
    EXPECT_EQ(view.AddNewFolder("new"), 0);
    EXPECT_THROW(view.SetItemName("b"), frame::ControlError);
    EXPECT_EQ(Labels(view), "x {a}");
    EXPECT_TRUE(fs::exists(At("a")));
}

// Links.

TEST_F(FolderViewOnDisk, LinksToFoldersAreShownAndFollowedWhenTheyAreOpened) {
    Make("sub/below");
    folder.Write("x/file", "1");
    Link("sub", "tosub");
    Link("tosub", "totosub");
    Link("file", "tofile");
    Link("nowhere", "dangling");
    Link("round", "round");
    Show();
    EXPECT_EQ(Labels(view), "x {sub, tosub, totosub}");
    stage.Expand(At("totosub"));
    EXPECT_EQ(Labels(view), "x {sub, tosub, totosub {below}}");
    EXPECT_TRUE(stage.Has(At("totosub/below")));
    stage.Click(At("tosub"));
    EXPECT_EQ(Labels(view), "x {sub, tosub {below}, totosub {below}}");
    EXPECT_EQ(view.FolderPath(), At("tosub"));
    for (const char* name : {"dangling", "round", "tofile", "file"}) {
        Show(name);
        EXPECT_EQ(Labels(view), "") << name;
    }
    Show("totosub");
    EXPECT_EQ(Labels(view), "totosub {below}");
}

TEST_F(FolderViewOnDisk, ALinkThatLosesItsTargetGoesWithTheNextRefresh) {
    Make("sub/below");
    Link("sub", "tosub");
    Show();
    stage.Expand(At());
    stage.Expand(At("tosub"));
    fs::rename(At("sub"), folder / "sub");
    stage.Tick();
    EXPECT_EQ(Labels(view), "x");
    fs::rename(folder / "sub", At("sub"));
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {sub, tosub}");
}

TEST_F(FolderViewOnDisk, ALoopOfLinksIsOpenedOneLevelAtATime) {
    constexpr int levels = 10;
    Make("sub");
    Link("../sub", "sub/again");
    Show("sub");
    std::string path = At("sub");
    for (int level = 1; level <= levels; ++level, path += "/again") {
        stage.Expand(path);
        EXPECT_EQ(view.ItemCount(), level + 1);
        EXPECT_TRUE(stage.Has(path + "/again"));
    }
    for (int tick = 0; tick < 3; ++tick) stage.Tick();
    EXPECT_LE(view.ItemCount(), levels + 2) << "a refresh looks no further than one level below what is in view";
}

TEST_F(FolderViewOnDisk, ALoopOfLinksIsFilledTwoLevelsAtATimeWithSubFolders) {
    constexpr int levels = 10;
    Make("sub");
    Link("../sub", "sub/again");
    view.SetAutoFillSubFolders(true);
    Show("sub");
    std::string path = At("sub");
    for (int level = 1; level <= levels; ++level, path += "/again") {
        stage.Expand(path);
        EXPECT_EQ(view.ItemCount(), level + 2);
    }
    EXPECT_TRUE(stage.Has(path + "/again"));
}

TEST_F(FolderViewOnDisk, ALoopOfLinksEndsWhereTheSystemFollowsNoFurther) {
    constexpr int more = 100;
    Make("sub");
    Link("../sub", "sub/again");
    view.SetAutoFillSubFolders(true);
    Show("sub");
    std::string path = At("sub");
    int level = 0;
    for (; level < more && stage.Has(path); ++level, path += "/again") stage.Expand(path);
    EXPECT_GT(level, 10);
    EXPECT_LT(level, more);
    stage.Tick();
    EXPECT_LE(view.ItemCount(), level + 1);
    EXPECT_EQ(stage.Messages(), "");
}

// Many.

TEST_F(FolderViewOnDisk, FiftyThousandFoldersAreFilledOnceAndInOrder) {
    constexpr int count = 50'000;
    constexpr int first = 100'000;  // as many digits for all
    const test::TestFolder many(test::TestFolder::QuickParent());
    for (int number = first + count - 1; number >= first; --number) many.Make(frame::Decimal(number));
    view.SetPathRoot(many.Path());
    EXPECT_EQ(view.ItemCount(), count + 1);
    const child::TreeNodes& nodes = stage.Tree().Tree();
    const child::NodeId root = stage.Node(many.Path())->Ref().node;
    EXPECT_EQ(nodes.ChildCount(root), static_cast<std::size_t>(count));
    int expected = first;
    bool inOrder = true;
    for (child::NodeId node = nodes.FirstChild(root); node != child::noNode; node = nodes.Next(node))
        inOrder = inOrder && nodes.Text(node) == frame::Decimal(expected++);
    EXPECT_TRUE(inOrder);
    EXPECT_EQ(expected, first + count);
    stage.Clear();
    stage.watched.calls = 0;
    stage.Expand(many.Path());
    EXPECT_EQ(stage.Events(), "Expand(" + many.Path() + ")");
    EXPECT_EQ(view.ItemCount(), count + 1);
    EXPECT_LT(stage.watched.calls, 2 * count) << "one look at each";
}

// Folders that go, come and are renamed.

TEST_F(FolderViewOnDisk, AFolderMayVanishWhileItIsFilled) {
    for (const char* name : {"a", "b", "c"}) Make(name);
    stage.handlers.On(folderview::AfterAddItem, [&](std::int32_t& index) {
        constexpr int a = 2;
        if (index == a) fs::remove_all(At());
    });
    Show();
    EXPECT_EQ(Labels(view), "x");
    EXPECT_EQ(view.FolderPath(), At());
    stage.Tick();
    EXPECT_EQ(Labels(view), "");
    EXPECT_EQ(stage.Messages(), "");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(FolderViewOnDisk, AFolderMayVanishWhileItsSubFoldersAreFilled) {
    for (const char* name : {"a/s", "b/s", "c/s"}) Make(name);
    Show();
    view.SetAutoFillSubFolders(true);
    stage.handlers.On(folderview::BeforeAddItem, [&](bool&) { fs::remove_all(At("b")); });
    stage.Expand(At());
    EXPECT_EQ(Labels(view), "x {a {s}, b, c {s}}");
    stage.Click(At("b"));
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("b"));
    EXPECT_EQ(Labels(view), "x {a {s}, c {s}}");
}

TEST_F(FolderViewOnDisk, AFolderMayVanishBetweenRefreshes) {
    for (const char* name : {"a/s/deep", "b/s"}) Make(name);
    Show();
    for (const char* name : {"", "a", "a/s", "b"}) stage.Expand(At(name));
    EXPECT_EQ(Labels(view), "x {a {s {deep}}, b {s}}");
    fs::remove_all(At("a"));
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {b {s}}");
    folder.Write("x/a", "now a file");
    fs::remove_all(At("b"));
    folder.Write("x/b", "now a file");
    stage.Tick();
    EXPECT_EQ(Labels(view), "x");
    fs::remove_all(At());
    stage.Tick();
    EXPECT_EQ(Labels(view), "");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewOnDisk, ARenamedFolderComesUnderItsNewName) {
    for (const char* name : {"a/s", "c"}) Make(name);
    Show();
    for (const char* name : {"", "a"}) stage.Expand(At(name));
    stage.Clear();
    fs::rename(At("a"), At("z"));
    stage.Tick();
    EXPECT_EQ(Labels(view), "x {c, z}");
    EXPECT_EQ(stage.Events(), "BeforeAddItem(False) AfterAddItem(3)");
    stage.Expand(At("z"));
    EXPECT_EQ(Labels(view), "x {c, z {s}}");
    fs::rename(At("z"), At("Z"));
    stage.Tick();
    EXPECT_TRUE(stage.Has(At("Z")));
    EXPECT_EQ(stage.Node(At("Z"))->Key(), At("Z"));
    EXPECT_EQ(Labels(view), "x {c, Z}");
}

TEST_F(FolderViewOnDisk, ARenamedFolderThatIsClickedTellsThatItWasMoved) {
    Make("a/s");
    Show();
    fs::rename(At("a"), At("b"));
    stage.Click(At("a"));
    EXPECT_EQ(stage.Messages(), Stage::NotAccessible("a"));
    EXPECT_EQ(Labels(view), "x");
    stage.Click(At());
    EXPECT_EQ(Labels(view), "x {b}");
}

TEST_F(FolderViewOnDisk, HiddenIsWhatBeginsWithAPoint) {
    for (const char* name : {".hidden", "seen"}) Make(name);
    Show();
    EXPECT_EQ(Labels(view), "x {seen}");
    view.SetAllowHiddenFolders(true);
    stage.Expand(At());
    EXPECT_EQ(Labels(view), "x {.hidden, seen}");
    EXPECT_EQ(ImageOf(At(".hidden")), "HIDDEN_" + ImageOf(At("seen")));
}

// Drives.

/// Mounts of the table alone: a mount below the folder of a test would be none of the user's.
class FolderViewOnMounts : public FolderViewOnDisk {
  protected:
    static constexpr const char *usb = "/media/tessel-usb/", *net = "/mnt/tessel-net/";

    void MountUsb() { real.mounts += "2 1 8:17 / /media/tessel-usb rw - ext4 /dev/none rw\n"; }
    void MountNet() { real.mounts += "3 1 0:44 / /mnt/tessel-net rw - nfs4 server:/export rw\n"; }
    std::string Drives() {
        std::string line;
        for (child::TreeNodeRef node = stage.Node("My Computer")->Child(); node; node = node->Next())
            line += (line.empty() ? "" : " | ") + node->Key();
        return line;
    }
    /// How often the disk was asked for what can fail.
    template <class F>
    int StepsOf(F run) {
        stage.watched.steps = 0;
        run();
        return stage.watched.steps;
    }
};

TEST_F(FolderViewOnMounts, MyComputerListsTheMounts) {
    MountUsb();
    MountNet();
    stage.ShowRoot("My Computer");
    EXPECT_EQ(Drives(), std::string(net) + " | / | " + usb);
    EXPECT_EQ(TextOf(usb), "tessel-usb ");
    EXPECT_EQ(TextOf(net), "export on 'server' ");
    EXPECT_TRUE(stage.Has("/tmp")) << "the root's folders have one separator";
    stage.Click(usb);
    EXPECT_EQ(view.FolderPath(), usb);
    view.GoUp();
    EXPECT_EQ(view.FolderPath(), "My Computer");
}

TEST_F(FolderViewOnMounts, MountsComeWithTheNextBuildAndGoWithTheNextRefresh) {
    const std::string before = real.mounts;
    stage.ShowRoot("My Computer");
    EXPECT_EQ(Drives(), "/");
    MountUsb();
    stage.Tick();
    EXPECT_EQ(Drives(), "/");
    view.Show();
    EXPECT_EQ(Drives(), std::string("/ | ") + usb);
    real.mounts = before;
    stage.Tick();
    EXPECT_EQ(Drives(), "/");
    EXPECT_EQ(stage.Messages(), "");
}

TEST_F(FolderViewOnMounts, AnUnreachableNetworkMountIsShownUnavailableAndNotLookedInto) {
    MountNet();
    const auto build = [&] { stage.ShowRoot("My Computer"); };
    const auto tick = [&] { stage.Tick(); };
    const int ready = StepsOf(build);
    EXPECT_NE(ImageOf(net), "Drive Unavailable");
    stage.Expand("My Computer");
    const int readyTick = StepsOf(tick);
    real.deadMounts = {"/mnt/tessel-net"};
    EXPECT_EQ(StepsOf(tick), readyTick - 1);
    EXPECT_EQ(ImageOf(net), "Drive Unavailable");
    EXPECT_LT(StepsOf(build), ready);
    EXPECT_EQ(ImageOf(net), "Drive Unavailable");
    EXPECT_EQ(TextOf(net), "export on 'server' ");
    real.deadMounts.clear();
    stage.Tick();
    EXPECT_NE(ImageOf(net), "Drive Unavailable");
}

TEST_F(FolderViewOnDisk, MyFoldersTellsOfFoldersThatHaveGoneAndComeBack) {
    folder.Make("usb");
    stage.ShowRoot("My Folders");
    view.AddNewFolder(folder / "usb");
    view.AddNewFolder(At("none"));
    EXPECT_EQ(TextOf(folder / "usb"), "usb");
    EXPECT_EQ(TextOf(At("none")), At("none") + " (Unavailable)");
    fs::rename(folder / "usb", At("none"));
    stage.Tick();
    EXPECT_EQ(TextOf(folder / "usb"), (folder / "usb") + " (Unavailable)");
    EXPECT_EQ(TextOf(At("none")), "none");
}

// The user's documents.

TEST_F(FolderViewOnDisk, MyDocumentsAreThoseOfTheUsersSettings) {
    folder.Make("documents/letters");
    stage.ShowRoot("My Documents");
    EXPECT_EQ(Labels(view), "My Documents {letters}");
    EXPECT_EQ(Keys(view), (folder / "documents") + " | " + folder / "documents/letters");
    real.SetDocuments("Dokumente \xFF");
    folder.Make("Dokumente \xFF/Briefe");
    Stage later({.files = &real.files});
    later.ShowRoot("my documents");
    EXPECT_EQ(Labels(later.View()), "My Documents {Briefe}");
    later.Click(folder / "Dokumente \xFF/Briefe");
    EXPECT_EQ(later.View().FolderPath(), folder / "Dokumente \xFF/Briefe");
}

}  // namespace
}  // namespace tessel::controls
