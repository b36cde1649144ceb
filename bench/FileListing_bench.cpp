#include <benchmark/benchmark.h>

#include <cstdint>
#include <cstdlib>
#include <string>

#include "bench/Contest.h"
#include "bench/FilePeers.h"
#include "bench/FileTrees.h"
#include "bench/LiveBytes.h"
#include "bench/Stage.h"
#include "controls/fileview/FileView.h"

/// The list of files on the real disk without a screen: listing, sorting, refreshing, searching and measuring, beside the bare
/// calls of the system that the same takes, and beside programs that do it. A million files are listed where TESSEL_BENCH_MILLION
/// is set.

namespace tessel::bench {
namespace {

namespace controls = tessel::controls;
namespace fileview = tessel::controls::fileview;

/// One list of files that tells what its rows take.
class FileStage : public Stage<controls::FileView> {
  public:
    FileStage() : Stage(6000, 3000) {}

    void ListenToRows() {
        Handlers().On(fileview::BeforeAddItem, [](bool& cancel, std::string& fileName) { cancel = fileName.empty(); });
        Handlers().On(fileview::AfterAddItem, [this](std::int32_t& index) { lastIndex_ = index; });
    }
    /// The bytes that a row takes, told once.
    double BytesARow() { return View().ItemCount() > 0 ? static_cast<double>(rowBytes_) / View().ItemCount() : 0; }

    void Clear() {
        View().ItemClear();
        ForgetLog();
    }
    void List(const std::string& path) {
        const std::size_t before = liveBytes;
        View().SetPathRoot(path);
        rowBytes_ = liveBytes - before;
    }

  private:
    std::int32_t lastIndex_ = 0;
    std::size_t rowBytes_ = 0;
};

/// From the path alone to complete rows.
void Listing(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Flat(state.range(0));
    FileStage stage, heard;
    heard.ListenToRows();
    stage.List(path);
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(BareListing(path)); });
            stage.Clear();
            contest.Own([&] { stage.List(path); });
            contest.Figure("bytes_a_row", stage.BytesARow());
            heard.Clear();
            contest.Peer("with_listener", [&] { heard.List(path); });
            contest.Peer("std_filesystem", [&] { benchmark::DoNotOptimize(StandardListing(path)); });
            contest.Program("ls", {"ls", "-lU", path});
        }
    }
    Expect(state, stage.View().ItemCount(), state.range(0));
    Expect(state, heard.View().ItemCount(), state.range(0));
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(Listing)->Arg(1'000)->Iterations(21)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(Listing)->Arg(10'000)->Iterations(9)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(Listing)->Arg(100'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

void ListingWithoutExtension(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().WithoutExtension(state.range(0));
    FileStage stage;
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(BareListing(path)); });
            stage.Clear();
            contest.Own([&] { stage.List(path); });
            contest.Figure("bytes_a_row", stage.BytesARow());
        }
    }
    Expect(state, stage.View().ItemCount(), state.range(0));
}
BENCHMARK(ListingWithoutExtension)->Arg(100'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

/// With every count read.
void ListingFoldersWithCounts(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Folders(state.range(0));
    FileStage stage;
    stage.View().SetShowFolderDetails(true);
    const child::ListRows& rows = stage.View().ListFiles.Rows();
    std::int64_t counted = 0;
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(BareCounting(path)); });
            stage.Clear();
            contest.Own([&] {
                stage.List(path);
                counted = 0;
                for (child::ListRows::Position row = 0; row < rows.Count(); ++row)
                    counted += rows.Text(rows.At(row), controls::subItem::size) == "3" ? 1 : 0;
            });
        }
    }
    Expect(state, counted, state.range(0));
}
BENCHMARK(ListingFoldersWithCounts)->Arg(10'000)->Iterations(9)->UseManualTime()->Unit(benchmark::kMillisecond);

/// A click on a column header, with the rows in the order of another column.
void SortByClick(benchmark::State& state, int column, int before) {
    FileStage stage;
    stage.List(FileTrees::Instance().Flat(state.range(0)));
    child::ListView& list = stage.View().ListFiles;
    {
        Contest contest(state);
        for (auto round : state) {
            list.ColumnClick(before);
            contest.Own([&] { list.ColumnClick(column); });
        }
    }
    Expect(state, stage.View().ItemCount(), state.range(0));
}
constexpr int nameColumn = 1, sizeColumn = 2, modifiedColumn = 4;
BENCHMARK_CAPTURE(SortByClick, name, nameColumn, sizeColumn)
    ->Arg(100'000)
    ->Iterations(9)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(SortByClick, size, sizeColumn, nameColumn)
    ->Arg(100'000)
    ->Iterations(9)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(SortByClick, modified, modifiedColumn, nameColumn)
    ->Arg(100'000)
    ->Iterations(9)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);

/// A look at the folder while the end of the list is in view: one file has come.
void RefreshWithOneNewFile(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Flat(state.range(0));
    FileStage stage;
    stage.List(path);
    controls::FileView& view = stage.View();
    const FileMaker maker(path);
    std::vector<std::string> made;
    std::int64_t expected = view.ItemCount();
    const auto refreshWithNew = [&] {
        made.push_back("Brand new " + std::to_string(made.size()) + ".txt");
        maker.Make(made.back(), 1);
        ++expected;
        view.ListFiles.SetTopIndex(view.ItemCount());
    };
    refreshWithNew();
    const double first = Contest::Time([&] { view.Refresh(); });  // makes the index of the names
    {
        Contest contest(state);
        contest.Figure("first_refresh_ms", first);
        for (auto round : state) {
            refreshWithNew();
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(BareListing(path)); });
            contest.Own([&] { view.Refresh(); });
        }
    }
    Expect(state, view.ItemCount(), expected);
    for (const std::string& name : made) unlink((path + "/" + name).c_str());
}
BENCHMARK(RefreshWithOneNewFile)->Arg(100'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

/// Texts in a tree of 200,000 files. The bare walk reads no facts; a row of the list has those of its file.
void SearchOfATree(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Tree();
    FileStage stage;
    const char* pattern = "*.txt";
    {
        Contest contest(state);
        for (auto round : state) {
            const auto walk = [&](Depth depth) {
                return FromTop(path, [&](int folder) { return BareMatch(folder, pattern, depth); });
            };
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(walk(Depth::Names)); });
            contest.Peer("bare_with_facts", [&] { benchmark::DoNotOptimize(walk(Depth::NamesAndFacts)); });
            stage.Clear();
            contest.Own([&] { stage.View().Search(pattern, path, true); });
            contest.Program("find", {"find", path, "-name", pattern});
        }
    }
    Expect(state, stage.View().ItemCount(), FileTrees::treeMatches);
}
BENCHMARK(SearchOfATree)->Iterations(7)->UseManualTime()->Unit(benchmark::kMillisecond);

void TotalSizeOfATree(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Tree();
    FileStage stage;
    std::int64_t own = 0, bare = 0;
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { bare = FromTop(path, BareSize); });
            stage.Clear();
            stage.List(path);
            contest.Own([&] { own = static_cast<std::int64_t>(stage.View().TotalSize().ToDouble()); });
            contest.Peer("std_filesystem", [&] { benchmark::DoNotOptimize(StandardSize(path)); });
            contest.Program("du", {"du", "-s", "-l", "--apparent-size", path});
        }
    }
    Expect(state, own, bare);
}
BENCHMARK(TotalSizeOfATree)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::bench

int main(int count, char** arguments) {
    if (std::getenv("TESSEL_BENCH_MILLION"))
        benchmark::RegisterBenchmark("Listing", tessel::bench::Listing)
            ->Arg(1'000'000)
            ->Iterations(3)
            ->UseManualTime()
            ->Unit(benchmark::kMillisecond);
    benchmark::Initialize(&count, arguments);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
