#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "tests/ErrorOf.h"
#include "tests/controls/fileview/FileViewTestHelp.h"

/// What an application may do inside the events of a listing: everything.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::ControlError;
using test::ErrorOf;

constexpr int applicationError = 1234;

/// One event at which the application does something, once.
struct Moment {
    const char* name;
    void (*on)(Stage& stage, std::function<void()> run);
};

template <class F>
auto Once(F run) {
    return [run = std::move(run), done = false](auto&...) mutable {
        if (!std::exchange(done, true)) run();
    };
}

const Moment moments[] = {
    {"ChangedFolder",
     [](Stage& stage, std::function<void()> run) { stage.handlers.On(fileview::ChangedFolder, Once(std::move(run))); }},
    {"BeforePaint",
     [](Stage& stage, std::function<void()> run) { stage.handlers.On(fileview::BeforePaint, Once(std::move(run))); }},
    {"BeforeAddFolder",
     [](Stage& stage, std::function<void()> run) {
         stage.handlers.On(fileview::BeforeAddItem, [once = Once(std::move(run))](bool&, std::string& path) mutable {
             if (path == "C:\\x\\g") once();
         });
     }},
    {"BeforeAddFile",
     [](Stage& stage, std::function<void()> run) {
         stage.handlers.On(fileview::BeforeAddItem, [once = Once(std::move(run))](bool&, std::string& path) mutable {
             if (path == "C:\\x\\b") once();
         });
     }},
    {"AfterAddFolder",
     [](Stage& stage, std::function<void()> run) {
         stage.handlers.On(fileview::AfterAddItem, [once = Once(std::move(run))](std::int32_t& index) mutable {
             if (index == 2) once();
         });
     }},
    {"AfterAddFile",
     [](Stage& stage, std::function<void()> run) {
         stage.handlers.On(fileview::AfterAddItem, [once = Once(std::move(run))](std::int32_t& index) mutable {
             if (index == 4) once();
         });
     }},
    {"AfterPaint", [](Stage& stage, std::function<void()> run) { stage.handlers.On(fileview::AfterPaint, Once(std::move(run))); }},
    {"Turn", [](Stage& stage, std::function<void()> run) { stage.onTurn = Once(std::move(run)); }},
};

class FileViewReentrance : public testing::TestWithParam<Moment> {
  protected:
    FileViewReentrance() {
        for (const char* name : {"a", "b", "c"}) stage.File(std::string("C:\\x\\") + name, 1);
        for (const char* name : {"f", "g"}) stage.Folder(std::string("C:\\x\\") + name);
        for (int number = 100; number < 220; ++number) stage.File("C:\\x\\z" + std::to_string(number), 1);
        stage.File("C:\\y\\other", 7);
    }
    void At(std::function<void()> run) {
        GetParam().on(stage, [this, run = std::move(run)] {
            ++times;
            run();
        });
    }
    bool IsAt(std::string_view name) const { return GetParam().name == name; }
    /// The list works as ever.
    void ExpectUsable() {
        stage.handlers = {};
        stage.onTurn = nullptr;
        stage.ShowPath("C:\\y");
        EXPECT_EQ(Rows(view), "other");
        EXPECT_EQ(view.TotalSize(), frame::Variant(7));
        stage.Tick();
        EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    }
    static constexpr int all = 125;
    Stage stage;
    FileView& view = stage.View();
    int times = 0;
};

TEST_P(FileViewReentrance, SettingPathMovesTheListingOnlyWhereItHasNotBegun) {
    At([&] { view.SetFolderPath("C:\\y"); });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    const bool before = IsAt("ChangedFolder") || IsAt("BeforePaint");
    EXPECT_EQ(view.ItemCount(), before ? 1 : all);
    EXPECT_EQ(view.FolderPath(), "C:\\y");
    ExpectUsable();
}

TEST_P(FileViewReentrance, ListingAnewInsideAListingInterleavesTheTwo) {
    At([&] { view.SetPathRoot("C:\\y"); });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    const std::string rows = Rows(view);
    const bool before = IsAt("ChangedFolder") || IsAt("BeforePaint");
    EXPECT_EQ(rows.substr(0, 5), "other");
    // What the outer listing had still to add stands behind; none of it where the inner one came first or last.
    const std::string last = rows.size() > 5 ? rows.substr(rows.size() - 4) : "";
    EXPECT_EQ(last, before || IsAt("AfterPaint") ? "" : "z219");
    ExpectUsable();
}

TEST_P(FileViewReentrance, ListingTheSameAnewInsideAListingAddsTheRestTwice) {
    At([&] { view.Show(); });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    EXPECT_GE(view.ItemCount(), all);
    for (std::int32_t index = 1; index <= view.ItemCount(); ++index) EXPECT_EQ(SubItem(view, index, 6), "C:\\x");
    ExpectUsable();
}

TEST_P(FileViewReentrance, ClearingInsideAListingKeepsWhatComesAfter) {
    At([&] { view.ItemClear(); });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    EXPECT_LE(view.ItemCount(), all);
    for (std::int32_t index = 1; index <= view.ItemCount(); ++index)
        EXPECT_EQ(SubItem(view, index, 10), view.ListFiles.ListItems.Item(index)->Text());
    ExpectUsable();
}

TEST_P(FileViewReentrance, RemovingRowsInsideAListingKeepsTheOthers) {
    At([&] {
        while (view.ItemCount() > 0) view.ItemRemove(frame::Variant(view.ItemCount()));
    });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    EXPECT_LE(view.ItemCount(), all);
    ExpectUsable();
}

TEST_P(FileViewReentrance, SearchingInsideAListingInterleavesTheTwo) {
    At([&] { view.Search("other", "C:\\", true); });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    ExpectUsable();
}

TEST_P(FileViewReentrance, RefreshingInsideAListingDoesNothing) {
    At([&] {
        stage.File("C:\\x\\new");
        view.Refresh();
        stage.Tick();
    });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    ExpectUsable();
}

TEST_P(FileViewReentrance, EveryPropertyCanBeReadAndSetInsideAListing) {
    At([&] {
        for (const frame::Member& member : FileView::table.members)
            if (!member.isMethod) (void)view.Get(member.name);
        view.SetShowFolders(true);
        view.SetFilter("*");
        view.SetItemIndex(1);
        view.SetItemDisplayName("label");
        view.SetItemIcon("File Folder");
        view.ListFiles.SetSortKey(7);
        view.ListFiles.SetSorted(true);
    });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    EXPECT_GE(view.ItemCount(), all);
    ExpectUsable();
}

TEST_P(FileViewReentrance, TheDiskMayChangeInsideAListing) {
    At([&] {
        stage.Remove("C:\\x");
        stage.Folder("C:\\x");
    });
    view.SetPathRoot("C:\\x");
    EXPECT_EQ(times, 1);
    EXPECT_LE(view.ItemCount(), all);
    for (std::int32_t index = 1; index <= view.ItemCount(); ++index) EXPECT_FALSE(Row(view, index).empty());
    ExpectUsable();
}

TEST_P(FileViewReentrance, AnErrorOfTheApplicationEndsNoListingThatHasBegun) {
    At([&] { throw ControlError(applicationError); });
    const bool outside = IsAt("ChangedFolder") || IsAt("BeforePaint") || IsAt("AfterPaint");
    EXPECT_EQ(ErrorOf([&] { view.SetPathRoot("C:\\x"); }), outside ? applicationError : 0);
    EXPECT_EQ(times, 1);
    EXPECT_EQ(view.ItemCount(), IsAt("ChangedFolder") || IsAt("BeforePaint") ? 0 : all);
    ExpectUsable();
}

TEST_P(FileViewReentrance, TheControlMayBeDestroyedInsideAListing) {
    At([&] { stage.Destroy(); });
    frame::Entry::Run(
        stage.Frame(), [] { return std::string("test"); }, [&] { view.SetPathRoot("C:\\x"); });
    EXPECT_EQ(times, 1);
    EXPECT_FALSE(stage.Lives());
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_P(FileViewReentrance, TheControlMayBeDestroyedWhenItIsShown) {
    stage.handlers = {};
    view.SetFolderPath("C:\\x");
    At([&] { stage.Destroy(); });
    stage.TheSite().Show();
    EXPECT_EQ(times, 1);
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

std::string NameOfMoment(const testing::TestParamInfo<Moment>& tested) { return tested.param.name; }
INSTANTIATE_TEST_SUITE_P(EveryEvent, FileViewReentrance, testing::ValuesIn(moments), NameOfMoment);

// Refreshes, searches and the user's folders.

class FileViewReentranceElsewhere : public testing::Test {
  protected:
    Stage stage;
    FileView& view = stage.View();
};

TEST_F(FileViewReentranceElsewhere, TheControlMayBeDestroyedInARefresh) {
    for (const char* name : {"AfterAddItem", "BeforeAddItem", "AfterPaint", "RefreshFoundChanges"}) {
        Stage inner;
        inner.File("C:\\x\\a");
        inner.ShowPath("C:\\x");
        inner.File("C:\\x\\b");
        const auto destroy = [&](auto&...) { inner.Destroy(); };
        if (std::string(name) == "AfterAddItem") inner.handlers.On(fileview::AfterAddItem, destroy);
        if (std::string(name) == "BeforeAddItem") inner.handlers.On(fileview::BeforeAddItem, destroy);
        if (std::string(name) == "AfterPaint") inner.handlers.On(fileview::AfterPaint, destroy);
        if (std::string(name) == "RefreshFoundChanges") inner.handlers.On(fileview::RefreshFoundChanges, destroy);
        inner.Tick();
        EXPECT_FALSE(inner.Lives()) << name;
        EXPECT_TRUE(inner.host.errors.reports.empty()) << name;
    }
}

TEST_F(FileViewReentranceElsewhere, AnErrorInARefreshIsPassedOver) {
    stage.File("C:\\x\\a");
    stage.ShowPath("C:\\x");
    stage.handlers.On(fileview::AfterPaint, [] { throw ControlError(applicationError); });
    stage.handlers.On(fileview::RefreshFoundChanges, [] { throw ControlError(applicationError); });
    stage.Tick();
    EXPECT_EQ(stage.Events(), "AfterPaint RefreshFoundChanges");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(FileViewReentranceElsewhere, RowsMayGoWhileARefreshAddsOthers) {
    for (const char* name : {"a", "b", "c"}) stage.File(std::string("C:\\x\\") + name);
    stage.ShowPath("C:\\x");
    stage.File("C:\\x\\d");
    stage.File("C:\\x\\e");
    stage.handlers.On(fileview::BeforeAddItem, [&](bool&, std::string&) { view.ItemClear(); });
    stage.Tick();
    EXPECT_EQ(Rows(view), "e");
}

TEST_F(FileViewReentranceElsewhere, TheControlMayBeDestroyedInASearch) {
    stage.File("C:\\x\\a");
    stage.File("C:\\x\\sub\\b");
    stage.handlers.On(fileview::AfterAddItem, [&](std::int32_t&) { stage.Destroy(); });
    frame::Entry::Run(
        stage.Frame(), [] { return std::string("test"); }, [&] { view.Search("*", "C:\\x", true); });
    EXPECT_FALSE(stage.Lives());
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

TEST_F(FileViewReentranceElsewhere, TheControlMayBeDestroyedInATurnOfASearch) {
    stage.File("C:\\x\\a");
    stage.onTurn = [&] { stage.Destroy(); };
    frame::Entry::Run(
        stage.Frame(), [] { return std::string("test"); }, [&] { view.Search("*", "C:\\x", true); });
    EXPECT_FALSE(stage.Lives());
}

TEST_F(FileViewReentranceElsewhere, TheControlMayBeDestroyedWhileItAsksForItsFolders) {
    stage.handlers.On(fileview::NeedMyFolders, [&](frame::Variant& folders) {
        folders = frame::VariantArray(1, {"C:\\", "C:\\Temp"});
        stage.Destroy();
    });
    frame::Entry::Run(
        stage.Frame(), [] { return std::string("test"); }, [&] { view.SetPathRoot("My Folders"); });
    EXPECT_FALSE(stage.Lives());
}

TEST_F(FileViewReentranceElsewhere, TheUsersFoldersMayChangeWhileTheyAreListed) {
    stage.handlers.On(fileview::NeedMyFolders, [&](frame::Variant& folders) {
        folders = frame::VariantArray(1, {"C:\\", "C:\\Temp"});
    });
    bool once = true;
    stage.handlers.On(fileview::AfterAddItem, [&](std::int32_t&) {
        if (!std::exchange(once, false)) return;
        stage.handlers.On(fileview::NeedMyFolders, [](frame::Variant&) {});
        view.Refresh();
    });
    view.SetPathRoot("My Folders");
    EXPECT_EQ(Rows(view), "Temp");
}

TEST_F(FileViewReentranceElsewhere, AnErrorInASearchEndsItNot) {
    stage.File("C:\\x\\a");
    stage.File("C:\\x\\sub\\b");
    stage.handlers.On(fileview::BeforeAddItem, [](bool&, std::string&) { throw ControlError(applicationError); });
    view.Search("*", "C:\\x", true);
    EXPECT_EQ(Rows(view), "a | b");
}

}  // namespace
}  // namespace tessel::controls
