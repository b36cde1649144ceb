#include <benchmark/benchmark.h>
#include <malloc.h>

#include <cstdint>
#include <cstdlib>
#include <memory>
#include <new>
#include <string>

#include "bench/Contest.h"
#include "bench/FilePeers.h"
#include "bench/FileTrees.h"
#include "controls/fileview/FileView.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/posix/DiskFileSystem.h"

/// The list of files on the real disk without a screen: listing, sorting, refreshing, searching and measuring, beside the bare
/// calls of the system that the same takes, and beside programs that do it. A million files are listed where TESSEL_BENCH_MILLION
/// is set.

namespace {

std::size_t liveBytes = 0;  // as the allocator hands them out

}  // namespace

// Not inlined: the compiler would take the parts of the pair for strangers.
[[gnu::noinline]] void* operator new(std::size_t size) {
    void* memory = std::malloc(size);
    if (!memory) throw std::bad_alloc();
    liveBytes += malloc_usable_size(memory);
    return memory;
}
[[gnu::noinline]] void operator delete(void* memory) noexcept {
    liveBytes -= malloc_usable_size(memory);
    std::free(memory);
}
[[gnu::noinline]] void operator delete(void* memory, std::size_t) noexcept { operator delete(memory); }

namespace tessel::bench {
namespace {

namespace controls = tessel::controls;
namespace fileview = tessel::controls::fileview;

/// One list of files on a host whose disk is the real one and whose message loop has nothing to do.
class Stage {
  public:
    Stage() : view_(NewView()) {
        site_->Start(nullptr, 6000, 3000);
        site_->Show();
    }
    ~Stage() { frame_.Retire(std::move(site_)); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    controls::FileView& View() { return view_; }

    void ListenToRows() {
        handlers_.On(fileview::BeforeAddItem, [](bool& cancel, std::string& fileName) { cancel = fileName.empty(); });
        handlers_.On(fileview::AfterAddItem, [this](std::int32_t& index) { lastIndex_ = index; });
    }
    /// The bytes that a row takes, told once.
    double BytesARow() const { return view_.ItemCount() > 0 ? static_cast<double>(rowBytes_) / view_.ItemCount() : 0; }

    void Clear() {
        view_.ItemClear();
        headless_.log.Clear();
    }
    void List(const std::string& path) {
        const std::size_t before = liveBytes;
        view_.SetPathRoot(path);
        rowBytes_ = liveBytes - before;
    }

  private:
    struct State final : frame::AmbientProperties {
        bool UserMode() const override { return true; }
        frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
        std::string DisplayName() const override { return "FileView1"; }
    };
    struct Nobody final : frame::Siblings {
        int Count() const override { return 0; }
        frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }
    };
    struct Place final : frame::Site {
        explicit Place(Stage& stage) : Site(stage.frame_), handlers(stage.handlers_) {}
        const frame::AmbientProperties& Ambient() const override { return state; }
        frame::Object& Extender() override { return extender; }
        frame::Object* Parent() override { return nullptr; }
        frame::Siblings& ParentControls() override { return siblings; }
        void PropertyChanged(std::string_view) override {}
        frame::EventSink& Events() override { return handlers; }

        frame::Handlers& handlers;
        State state;
        Nobody siblings;
        headless::HostObject extender{"FileView1", {}};
    };
    struct IdleLoop final : frame::MessageLoop {
        void Turn() override {}
    };
    /// A shell that keeps its icons, as those of desktops do.
    struct KeptIcons final : frame::PictureLoader {
        frame::PictureRef LoadPicture(const std::string&) override { return nullptr; }
        frame::PictureRef FileIcon(const std::string&, int flags) override { return flags & 1 ? small : large; }
        static frame::PictureRef Square(int side) {
            const auto pixels = static_cast<std::size_t>(side) * static_cast<std::size_t>(side);
            return std::make_shared<frame::Picture>(
                std::vector<frame::PixelPlane>{{1, side, side, std::vector<std::uint32_t>(pixels, 0xFFFF0000)}}, "");
        }
        frame::PictureRef small = Square(16), large = Square(32);
    };

    frame::Services Mixed() {
        frame::Services services = headless_.LentServices();
        services.loop = &loop_;
        services.pictures = &icons_;
        return services;
    }
    controls::FileView& NewView() {
        auto made = std::make_unique<controls::FileView>(frame_);
        controls::FileView& view = *made;
        site_->Adopt(std::move(made));
        return view;
    }

    posix::DiskFileSystem disk_;
    headless::HeadlessHost headless_{&disk_};
    IdleLoop loop_;
    KeptIcons icons_;
    frame::Handlers handlers_;
    frame::Host frame_{Mixed()};
    std::unique_ptr<Place> site_ = std::make_unique<Place>(*this);
    controls::FileView& view_;
    std::int32_t lastIndex_ = 0;
    std::size_t rowBytes_ = 0;
};

void Expect(benchmark::State& state, std::int64_t found, std::int64_t expected) {
    if (found != expected) state.SkipWithError(("found " + std::to_string(found) + " of " + std::to_string(expected)).c_str());
}

/// From the path alone to complete rows.
void Listing(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Flat(state.range(0));
    Stage stage, heard;
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
    Stage stage;
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
    Stage stage;
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
    Stage stage;
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
    Stage stage;
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
    Stage stage;
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
    Stage stage;
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
