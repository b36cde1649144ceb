#include <benchmark/benchmark.h>
#include <malloc.h>

#include <algorithm>

#include <cstdint>
#include <cstdlib>
#include <memory>
#include <new>
#include <numeric>
#include <random>
#include <string>
#include <string_view>
#include <vector>

#include "frame/Control.h"
#include "frame/Text.h"
#include "frame/child/ImageList.h"
#include "frame/child/TreeView.h"
#include "hosts/headless/HeadlessHost.h"

/// What the nodes of a large tree cost: filling it, finding a node by key and by index, its rows, removal, and memory.

namespace {

std::size_t liveBytes = 0;  // as the allocator hands them out
constexpr std::size_t blockHeader = sizeof(std::size_t);

}  // namespace

// Not inlined: the compiler would take the parts of the pair for strangers.
[[gnu::noinline]] void* operator new(std::size_t size) {
    void* memory = std::malloc(size);
    if (!memory) throw std::bad_alloc();
    liveBytes += malloc_usable_size(memory) + blockHeader;
    return memory;
}
[[gnu::noinline]] void operator delete(void* memory) noexcept {
    if (memory) liveBytes -= malloc_usable_size(memory) + blockHeader;
    std::free(memory);
}
[[gnu::noinline]] void operator delete(void* memory, std::size_t) noexcept { operator delete(memory); }

namespace tessel {
namespace {

constexpr auto asChild = child::TreeRelationshipConstants::Child;

class Owner final : public frame::Control {
  public:
    explicit Owner(frame::Host& host) : Control(host) {
        for (const char* key : {"Folder", "OPEN_Folder"})
            Image16.ListImages.Add({}, key, std::make_shared<frame::Picture>(240.0f, 240.0f, ""));
        tree.SetImageList(&Image16);
    }
    frame::TextSize DesignSize() const override { return {3000, 2000}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Owner", .members = {}};
        return table;
    }

    child::ImageList Image16{*this, "Image16"};
    child::TreeView tree{*this, "TreeFolders"};
};

/// A tree of folders: under one root, or 100 in each.
struct Folders {
    Folders() : owner(host.Create<Owner>("FolderView1", {.logEvents = false})), nodes(owner.tree.Tree()) {}

    void AddFolder(std::string_view path, std::string_view name, child::NodeId parent) {
        child::NodeId node = child::noNode;
        nodes.Add(node, name, path, parent, asChild).Check();
        nodes.SetImageKey(node, child::NodeImage::Plain, "Folder").Check();
        nodes.SetImageKey(node, child::NodeImage::Selected, "OPEN_Folder").Check();
        nodes.SetSorted(node, true);
        nameBytes += name.size();
        keyBytes += path.size();
    }
    /// `names` in the order in which they are to come.
    void FillFlat(const std::vector<std::string>& names) {
        AddFolder("/home/somebody", "somebody", child::noNode);
        for (const std::string& name : names) AddFolder("/home/somebody/" + name, name, nodes.At(0));
    }
    void FillDeep(int count) {
        constexpr int perFolder = 100;
        AddFolder("/home/somebody", "somebody", child::noNode);
        std::string path;
        for (int number = 1; number < count; ++number) {
            const child::NodeId parent = nodes.At(static_cast<child::TreeNodes::Position>((number - 1) / perFolder));
            const std::string name = "Folder " + frame::Decimal(number);
            path.assign(nodes.Key(parent));
            AddFolder(path + "/" + name, name, parent);
        }
    }
    void ExpandAll() {
        for (child::TreeNodes::Position position = 0; position < nodes.Count(); ++position)
            nodes.SetExpanded(nodes.At(position), true);
    }
    void Clear() {
        nodes.Clear();
        nameBytes = keyBytes = 0;
    }

    headless::HeadlessHost host;
    Owner& owner;
    child::TreeNodes& nodes;
    std::size_t nameBytes = 0, keyBytes = 0;
};

std::vector<std::string> Names(int count, bool shuffled) {
    std::vector<std::string> names;
    for (int number = 0; number < count; ++number) names.push_back("Folder " + frame::Decimal(1'000'000 + number));
    if (shuffled) std::shuffle(names.begin(), names.end(), std::mt19937(5));
    return names;
}

std::vector<child::TreeNodes::Position> Positions(const child::TreeNodes& nodes) {
    std::vector<child::TreeNodes::Position> positions(nodes.Count());
    std::iota(positions.begin(), positions.end(), 0u);
    std::shuffle(positions.begin(), positions.end(), std::mt19937(7));
    return positions;
}

int CountOf(const benchmark::State& state) { return static_cast<int>(state.range(0)); }

void ReportNodes(benchmark::State& state) {
    const auto nodes = static_cast<double>(state.iterations()) * CountOf(state);
    state.counters["time/node"] = benchmark::Counter(nodes, benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

/// `measure` fills an empty tree.
template <class F>
void Fill(benchmark::State& state, F&& measure) {
    Folders folders;
    double bytes = 0, names = 0, keys = 0;
    for (auto _ : state) {
        state.PauseTiming();
        folders.Clear();
        const std::size_t before = liveBytes;
        state.ResumeTiming();
        measure(folders);
        if (bytes > 0) continue;
        bytes = static_cast<double>(liveBytes - before) / CountOf(state);
        names = static_cast<double>(folders.nameBytes) / CountOf(state);
        keys = static_cast<double>(folders.keyBytes) / CountOf(state);
    }
    ReportNodes(state);
    state.counters["bytes/node"] = bytes;
    state.counters["above name"] = bytes - names;
    state.counters["above both"] = bytes - names - keys;
}

void FillOneFolderInOrder(benchmark::State& state) {
    const auto names = Names(CountOf(state) - 1, false);
    Fill(state, [&](Folders& folders) { folders.FillFlat(names); });
}
BENCHMARK(FillOneFolderInOrder)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void FillOneFolderInAnyOrder(benchmark::State& state) {
    const auto names = Names(CountOf(state) - 1, true);
    Fill(state, [&](Folders& folders) { folders.FillFlat(names); });
}
BENCHMARK(FillOneFolderInAnyOrder)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void FillDeepTree(benchmark::State& state) {
    Fill(state, [&](Folders& folders) { folders.FillDeep(CountOf(state)); });
}
BENCHMARK(FillDeepTree)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

/// With a search for the name among the children before each, as a folder that is read again does it.
void FillOneFolderAskingForEachName(benchmark::State& state) {
    const auto names = Names(CountOf(state) - 1, false);
    Fill(state, [&](Folders& folders) {
        folders.AddFolder("/home/somebody", "somebody", child::noNode);
        const child::NodeId root = folders.nodes.At(0);
        for (const std::string& name : names)
            if (!folders.nodes.FindChild(root, name)) folders.AddFolder("/home/somebody/" + name, name, root);
    });
}
BENCHMARK(FillOneFolderAskingForEachName)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

/// `ask` is asked once for each node, in a random order.
template <class F>
void Ask(benchmark::State& state, F&& ask) {
    Folders folders;
    folders.FillDeep(CountOf(state));
    folders.ExpandAll();
    const auto positions = Positions(folders.nodes);
    for (auto _ : state)
        for (const auto position : positions) benchmark::DoNotOptimize(ask(folders.nodes, position));
    ReportNodes(state);
}

/// The keys in the order of the nodes, as a refresh asks for them, or in any order.
void FindByKey(benchmark::State& state, bool shuffled) {
    Folders folders;
    folders.FillDeep(CountOf(state));
    auto positions = Positions(folders.nodes);
    if (!shuffled) std::sort(positions.begin(), positions.end());
    std::vector<std::string> keys;
    for (const auto position : positions) keys.emplace_back(folders.nodes.Key(folders.nodes.At(position)));
    for (auto _ : state)
        for (const std::string& key : keys) benchmark::DoNotOptimize(folders.nodes.FindKey(key));
    ReportNodes(state);
}
BENCHMARK_CAPTURE(FindByKey, inOrder, false)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(FindByKey, inAnyOrder, true)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void ItemByIndex(benchmark::State& state) {
    Ask(state, [](const child::TreeNodes& nodes, auto position) { return nodes.At(position); });
}
BENCHMARK(ItemByIndex)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void IndexOfNode(benchmark::State& state) {
    Ask(state, [](const child::TreeNodes& nodes, auto position) { return nodes.PositionOf(position + 1); });
}
BENCHMARK(IndexOfNode)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void NodeOfRow(benchmark::State& state) {
    Ask(state, [](const child::TreeNodes& nodes, auto position) { return nodes.AtRow(position); });
}
BENCHMARK(NodeOfRow)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void RowOfNode(benchmark::State& state) {
    Ask(state, [](const child::TreeNodes& nodes, auto position) { return nodes.RowOf(position + 1); });
}
BENCHMARK(RowOfNode)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void WalkSiblings(benchmark::State& state) {
    Folders folders;
    folders.FillFlat(Names(CountOf(state) - 1, true));
    for (auto _ : state)
        for (child::NodeId node = folders.nodes.FirstChild(folders.nodes.At(0)); node != child::noNode;
             node = folders.nodes.Next(node))
            benchmark::DoNotOptimize(node);
    ReportNodes(state);
}
BENCHMARK(WalkSiblings)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

/// `remove` empties a tree.
template <class F>
void Empty(benchmark::State& state, F&& remove) {
    Folders folders;
    for (auto _ : state) {
        state.PauseTiming();
        folders.Clear();
        folders.FillDeep(CountOf(state));
        state.ResumeTiming();
        remove(folders.nodes);
    }
    ReportNodes(state);
}

void RemoveSubtree(benchmark::State& state) {
    Empty(state, [](child::TreeNodes& nodes) { nodes.Remove(nodes.At(0)); });
}
BENCHMARK(RemoveSubtree)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void RemoveOneByOneFromTheEnd(benchmark::State& state) {
    Empty(state, [](child::TreeNodes& nodes) {
        while (nodes.Count() > 0) nodes.Remove(nodes.At(nodes.Count() - 1));
    });
}
BENCHMARK(RemoveOneByOneFromTheEnd)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void ClearTree(benchmark::State& state) {
    Empty(state, [](child::TreeNodes& nodes) { nodes.Clear(); });
}
BENCHMARK(ClearTree)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

void SortAllSiblings(benchmark::State& state) {
    const auto names = Names(CountOf(state) - 1, true);
    Folders folders;
    for (auto _ : state) {
        state.PauseTiming();
        folders.Clear();
        folders.AddFolder("/home/somebody", "somebody", child::noNode);
        const child::NodeId root = folders.nodes.At(0);
        folders.nodes.SetSorted(root, false);
        for (const std::string& name : names) folders.AddFolder("/home/somebody/" + name, name, root);
        state.ResumeTiming();
        folders.nodes.SetSorted(root, true);
    }
    ReportNodes(state);
}
BENCHMARK(SortAllSiblings)->RangeMultiplier(10)->Range(1'000, 100'000)->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel

BENCHMARK_MAIN();
