#include <benchmark/benchmark.h>
#include <malloc.h>

#include <QApplication>
#include <QFileSystemModel>
#include <QTimer>
#include <QTreeView>
#include <QTreeWidget>
#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "bench/Contest.h"
#include "bench/FilePeers.h"
#include "bench/FileTrees.h"
#include "bench/qt/Run.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/FolderView.h"
#include "hosts/qt/Host.h"

/// The tree of folders in a window: filling a node and painting what is in view, and finding a node by its path, beside the
/// toolkit's own model of the disk and its tree of items.

namespace tessel::qt {
namespace {

using bench::Contest;
using bench::Expect;
using bench::FileTrees;

constexpr int width = 400, height = 600;

/// Runs events until something has come about; false after a minute.
bool RunUntil(const std::function<bool()>& cameAbout) {
    constexpr int mostSeconds = 60;
    const auto start = std::chrono::steady_clock::now();
    QTimer awake;
    awake.start(5);
    while (!cameAbout()) {
        if (std::chrono::steady_clock::now() - start > std::chrono::seconds(mostSeconds)) return false;
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    return true;
}

/// Paints all that is to be painted, as the next turn of the program would.
void PaintAll() {
    QCoreApplication::processEvents();
    QCoreApplication::sendPostedEvents();
    QCoreApplication::processEvents();
}

double HeldBytes() {
    const struct mallinfo2 memory = mallinfo2();
    return static_cast<double>(memory.uordblks + memory.hblkhd);
}

/// The library's widget in a window of its own.
class Shown {
  public:
    Shown() {
        view_ = new FolderView(&window_);
        window_.resize(width, height);
        view_->resize(width, height);
        window_.show();
        PaintAll();
    }

    controls::FolderView& Control() { return view_->folderView(); }
    child::TreeNodes& Tree() { return Control().TreeFolders.Tree(); }
    void Fill(const std::string& path) {
        Control().SetPathRoot(path);
        if (Control().ItemCount() > 0) Control().TreeFolders.Nodes.Item(1)->SetExpanded(true);
        PaintAll();
    }

  private:
    QWidget window_;
    FolderView* view_ = nullptr;
};

/// The toolkit's own model of the disk, folders only, in its own view.
class ToolkitView {
  public:
    ToolkitView() {
        model_.setFilter(QDir::Dirs | QDir::NoDotAndDotDot);
        view_.setUniformRowHeights(true);
        for (int column = 1; column < model_.columnCount(); ++column) view_.hideColumn(column);
        view_.setModel(&model_);
        view_.resize(width, height);
        view_.show();
        PaintAll();
    }
    bool Fill(const std::string& path, std::int64_t rows) {
        const QModelIndex root = model_.setRootPath(ToQt(path));
        view_.setRootIndex(root);
        const bool done = RunUntil([&] { return model_.rowCount(root) == rows; });
        PaintAll();
        return done;
    }

  private:
    QFileSystemModel model_;
    QTreeView view_;
};

/// From the path alone until all sub-folders are nodes and those in view are painted.
void FillNodeOnScreen(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().EmptyFolders(state.range(0));
    const auto nodes = static_cast<double>(state.range(0));
    Shown shown;
    shown.Fill(path);
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(bench::BareListing(path)); });
            shown.Fill("");
            const double before = HeldBytes();
            contest.Own([&] { shown.Fill(path); });
            contest.Figure("bytes_a_node", (HeldBytes() - before) / nodes);
            const double beforeToolkit = HeldBytes();
            ToolkitView toolkit;
            contest.Peer("toolkit", [&] { Expect(state, toolkit.Fill(path, state.range(0)) ? 1 : 0, 1); });
            contest.Figure("toolkit_bytes_a_node", (HeldBytes() - beforeToolkit) / nodes);
        }
    }
    Expect(state, shown.Control().ItemCount(), state.range(0) + 1);
}
BENCHMARK(FillNodeOnScreen)->Arg(10'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(FillNodeOnScreen)->Arg(50'000)->Iterations(3)->UseManualTime()->Unit(benchmark::kMillisecond);

/// Some of 100,000 nodes by their paths. The toolkit's tree of items is asked for the path as a text in a second column.
void FindByPath(benchmark::State& state) {
    constexpr std::size_t asked = 20;
    Shown shown;
    shown.Control().SetAutoFillSubFolders(true);
    shown.Fill(FileTrees::Instance().FolderTree());
    const child::TreeNodes& tree = shown.Tree();
    QTreeWidget toolkit;
    toolkit.setColumnCount(2);
    std::vector<QTreeWidgetItem*> items(tree.Count() + 1, nullptr);  // by node
    for (child::TreeNodes::Position place = 0; place < tree.Count(); ++place) {
        const child::NodeId node = tree.At(place), parent = tree.Parent(node);
        const QStringList texts{ToQt(std::string(tree.Text(node))), ToQt(std::string(tree.Key(node)))};
        items[node] = parent == child::noNode ? new QTreeWidgetItem(&toolkit, texts) : new QTreeWidgetItem(items[parent], texts);
    }
    std::vector<std::string> paths;
    for (std::size_t i = 1; i <= asked; ++i)
        paths.emplace_back(tree.Key(tree.At(static_cast<child::TreeNodes::Position>(i * (tree.Count() - 1) / asked))));
    std::size_t found = 0, toolkitFound = 0;
    {
        Contest contest(state);
        for (auto round : state) {
            found = toolkitFound = 0;
            contest.Own([&] {
                for (const std::string& path : paths) found += tree.FindKey(path) ? 1 : 0;
            });
            contest.Peer("toolkit", [&] {
                for (const std::string& path : paths)
                    toolkitFound += static_cast<std::size_t>(
                        toolkit.findItems(ToQt(path), Qt::MatchFixedString | Qt::MatchRecursive, 1).size());
            });
        }
    }
    Expect(state, tree.Count(), FileTrees::folderTreeNodes);
    Expect(state, static_cast<std::int64_t>(found), asked);
    Expect(state, static_cast<std::int64_t>(toolkitFound), asked);
}
BENCHMARK(FindByPath)->Iterations(3)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run(count, arguments); }
