#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <random>
#include <string>
#include <vector>

#include "bench/Contest.h"
#include "bench/FilePeers.h"
#include "bench/FileTrees.h"
#include "bench/LiveBytes.h"
#include "bench/Stage.h"
#include "controls/folderview/FolderView.h"

/// The tree of folders on the real disk without a screen: filling a node, refreshing and finding, beside the bare calls of the
/// system that the same takes.

namespace tessel::bench {
namespace {

namespace folderview = tessel::controls::folderview;

constexpr int width = 4000;
constexpr int shownNodes = 1 + static_cast<int>(FileTrees::wideFolders);

class TreeStage : public Stage<controls::FolderView> {
  public:
    explicit TreeStage(int rows = 20) : Stage(width, rows * static_cast<int>(child::TreeView::rowHeightTwips)) {}

    child::TreeNodes& Tree() { return View().TreeFolders.Tree(); }
    void ListenToNodes() {
        Handlers().On(folderview::BeforeAddItem, [this](bool& cancel) { cancel = ++offered_ < 0; });
        Handlers().On(folderview::AfterAddItem, [this](std::int32_t& index) { lastIndex_ = index; });
    }
    void Clear() {
        View().SetPathRoot("");
        ForgetLog();
    }
    void Fill(const std::string& path) { View().SetPathRoot(path); }
    /// The tree with all of its two levels: those of the first are in view.
    void FillTree(const std::string& path) {
        View().SetAutoFillSubFolders(true);
        Fill(path);
        View().TreeFolders.Nodes.Item(1)->SetExpanded(true);
    }
    std::vector<std::string> Keys() {
        std::vector<std::string> keys;
        for (child::TreeNodes::Position place = 0; place < Tree().Count(); ++place) keys.emplace_back(Tree().Key(Tree().At(place)));
        return keys;
    }

  private:
    std::int64_t offered_ = 0;
    std::int32_t lastIndex_ = 0;
};

/// From the path alone to the node with all of its sub-folders.
void FillNode(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().EmptyFolders(state.range(0));
    TreeStage stage, heard;
    heard.ListenToNodes();
    stage.Fill(path);
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(BareListing(path)); });
            stage.Clear();
            const std::size_t before = liveBytes;
            contest.Own([&] { stage.Fill(path); });
            contest.Figure("bytes_a_node", static_cast<double>(liveBytes - before) / stage.View().ItemCount());
            heard.Clear();
            contest.Peer("with_listener", [&] { heard.Fill(path); });
        }
    }
    Expect(state, stage.View().ItemCount(), state.range(0) + 1);
    Expect(state, heard.View().ItemCount(), state.range(0) + 1);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(FillNode)->Arg(1'000)->Iterations(21)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(FillNode)->Arg(10'000)->Iterations(9)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(FillNode)->Arg(50'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

/// A click on a node that is filled already: its sub-folders are found again.
void FillNodeAgain(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().EmptyFolders(state.range(0));
    TreeStage stage;
    stage.Fill(path);
    child::TreeView& tree = stage.View().TreeFolders;
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(BareListing(path)); });
            tree.Nodes.Item(1)->SetExpanded(false);
            contest.Own([&] { tree.Nodes.Item(1)->SetExpanded(true); });
        }
    }
    Expect(state, stage.View().ItemCount(), state.range(0) + 1);
}
BENCHMARK(FillNodeAgain)->Arg(10'000)->Iterations(9)->UseManualTime()->Unit(benchmark::kMillisecond);

/// A look at all folders of a tree of which 100 are in view. The bare calls ask once for each, and list those in view.
void Refresh(benchmark::State& state, TreeStage& stage) {
    const std::vector<std::string> keys = stage.Keys();
    std::vector<std::string> inView;
    for (const std::string& key : keys)
        if (stage.View().TreeFolders.IsInView(*stage.Tree().FindKey(key))) inView.push_back(key);
    Expect(state, static_cast<std::int64_t>(inView.size()), shownNodes);
    std::int64_t found = 0;
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] {
                found = BareExistence(keys);
                for (const std::string& folder : inView) benchmark::DoNotOptimize(BareListing(folder));
            });
            contest.Peer("bare_existence", [&] { found = BareExistence(keys); });
            contest.Own([&] { stage.View().Refresh(); });
        }
    }
    Expect(state, found, FileTrees::folderTreeNodes);
    Expect(state, stage.View().ItemCount(), FileTrees::folderTreeNodes);
}

/// Those in view have all the others below them.
void RefreshWithFullFoldersInView(benchmark::State& state) {
    TreeStage stage(shownNodes);
    stage.FillTree(FileTrees::Instance().FolderTree());
    Refresh(state, stage);
}
BENCHMARK(RefreshWithFullFoldersInView)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

/// Those in view are empty, so that nearly all is asking for each folder.
void RefreshWithEmptyFoldersInView(benchmark::State& state) {
    TreeStage stage(shownNodes);
    stage.FillTree(FileTrees::Instance().FolderTree());
    const child::NodeId wide = stage.Tree().FirstChild(stage.Tree().At(0));
    stage.View().TreeFolders.SetExpanded(wide, true);
    stage.View().TreeFolders.EnsureVisible(stage.Tree().LastChild(wide));
    Refresh(state, stage);
}
BENCHMARK(RefreshWithEmptyFoldersInView)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

/// Each folder by its path, in any order, as a path that is set selects its node.
void FindByPath(benchmark::State& state) {
    TreeStage stage;
    stage.FillTree(FileTrees::Instance().FolderTree());
    std::vector<std::string> shuffled = stage.Keys();
    std::shuffle(shuffled.begin(), shuffled.end(), std::mt19937(7));
    const std::vector<std::string> keys(shuffled.begin(), shuffled.end());  // side by side in memory as they are asked for
    std::int64_t found = 0;
    {
        Contest contest(state);
        for (auto round : state) {
            found = 0;
            const double time = Contest::Time([&] {
                for (const std::string& key : keys) found += stage.Tree().FindKey(key) ? 1 : 0;
            });
            contest.Figure("ns_a_path", time * 1e6 / static_cast<double>(keys.size()));
            state.SetIterationTime(time / 1e3);
        }
    }
    Expect(state, found, FileTrees::folderTreeNodes);
}
BENCHMARK(FindByPath)->Iterations(9)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::bench

BENCHMARK_MAIN();
