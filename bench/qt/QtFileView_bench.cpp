#include <benchmark/benchmark.h>
#include <malloc.h>

#include <QApplication>
#include <QFileSystemModel>
#include <QHeaderView>
#include <QPaintEvent>
#include <QTimer>
#include <QTreeView>
#include <chrono>
#include <ctime>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "bench/Contest.h"
#include "bench/FilePeers.h"
#include "bench/FileTrees.h"
#include "bench/qt/Run.h"
#include "hosts/posix/DiskFileSystem.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/FileView.h"
#include "hosts/qt/Host.h"
#include "hosts/qt/ListWidget.h"

/// The list of files on the screen: until all rows are listed and painted, how soon the first are seen, how long the program does
/// not answer meanwhile, sorting, following the disk and searching, beside the toolkit's own model of the disk and its tree view.

namespace tessel::qt {
namespace {

using bench::Contest;
using bench::Expect;
using bench::FileTrees;

constexpr int width = 800, height = 600;

/// Two clocks: of the wall, and of the processor on this thread, which runs on its own when others use the machine.
struct Moment {
    double wall = 0, thread = 0;  // milliseconds

    static Moment Now() {
        const auto read = [](clockid_t clock) {
            timespec now{};
            clock_gettime(clock, &now);
            return static_cast<double>(now.tv_sec) * 1e3 + static_cast<double>(now.tv_nsec) / 1e6;
        };
        return {read(CLOCK_MONOTONIC), read(CLOCK_THREAD_CPUTIME_ID)};
    }
    Moment operator-(const Moment& start) const { return {wall - start.wall, thread - start.thread}; }
};

/// Tells of each paint that has been carried out.
class Program final : public QApplication {
  public:
    using QApplication::QApplication;
    bool notify(QObject* receiver, QEvent* event) override {
        const bool result = QApplication::notify(receiver, event);
        if (event->type() == QEvent::Paint && painted) painted(receiver);
        return result;
    }

    std::function<void(QObject*)> painted;
};

Program& TheProgram() { return *static_cast<Program*>(qApp); }

/// Runs events until nothing more is painted.
void PaintAll() {
    bool isPainted = true;
    TheProgram().painted = [&](QObject*) { isPainted = true; };
    while (isPainted) {
        isPainted = false;
        QCoreApplication::processEvents();
    }
    TheProgram().painted = nullptr;
}

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

/// Runs events until the program has nothing to do on any thread.
void RunUntilQuiet() {
    constexpr double busy = 2;  // milliseconds of 50
    double used = busy;
    while (used >= busy) {
        const double start = bench::ProcessorTime();
        const auto begin = std::chrono::steady_clock::now();
        RunUntil([&] { return std::chrono::steady_clock::now() - begin > std::chrono::milliseconds(50); });
        used = bench::ProcessorTime() - start;
    }
}

/// The memory that is handed out, large blocks among it.
double HeldBytes() {
    const struct mallinfo2 memory = mallinfo2();
    return static_cast<double>(memory.uordblks + memory.hblkhd);
}

/// The real disk, and when names were read.
class TimedDisk final : public frame::FileSystem {
  public:
    std::function<void()> beforeNames, afterNames;

    frame::Status List(std::string_view folder, std::unique_ptr<frame::FolderListing>& listing) override {
        if (beforeNames) beforeNames();
        const frame::Status status = disk_.List(folder, listing);
        if (afterNames) afterNames();
        return status;
    }
    char Separator() const override { return disk_.Separator(); }
    bool IgnoresCase() const override { return disk_.IgnoresCase(); }
    bool FileExists(std::string_view path) override { return disk_.FileExists(path); }
    bool FolderExists(std::string_view path) override { return disk_.FolderExists(path); }
    bool DriveExists(std::string_view path) override { return disk_.DriveExists(path); }
    frame::Status Stat(std::string_view path, frame::FileRecord& record) override { return disk_.Stat(path, record); }
    frame::Status Count(std::string_view folder, frame::FolderCounts& counts) override { return disk_.Count(folder, counts); }
    std::unique_ptr<frame::TreeSize> MeasureTree(std::string_view folder) override { return disk_.MeasureTree(folder); }
    std::vector<frame::DriveRecord> Drives() override { return disk_.Drives(); }
    std::string TypeText(std::int32_t typeId) override { return disk_.TypeText(typeId); }
    frame::Status CreateFolder(std::string_view path) override { return disk_.CreateFolder(path); }
    frame::Status CreateFile(std::string_view path, bool overwrite) override { return disk_.CreateFile(path, overwrite); }
    frame::Status DeleteFile(std::string_view path, bool force) override { return disk_.DeleteFile(path, force); }
    frame::Status Rename(std::string_view path, std::string_view newName) override { return disk_.Rename(path, newName); }
    frame::Status SetAttributes(std::string_view path, std::int32_t value) override { return disk_.SetAttributes(path, value); }
    std::string TemporaryFolder() override { return disk_.TemporaryFolder(); }
    std::string SpecialFolder(int number) override { return disk_.SpecialFolder(number); }
    frame::Status OpenForReading(std::string_view path, std::unique_ptr<frame::BinaryFile>& file) override {
        return disk_.OpenForReading(path, file);
    }
    frame::Status WriteOver(std::string_view path, std::string_view bytes) override { return disk_.WriteOver(path, bytes); }

  private:
    posix::DiskFileSystem disk_;
};

/// The longest time between two ticks of a timer that should come each millisecond, less what the reading of names took.
class Stalls {
  public:
    explicit Stalls(TimedDisk& disk) : disk_(disk) {
        timer_.setTimerType(Qt::PreciseTimer);
        timer_.callOnTimeout([this] { Tick(); });
        disk_.beforeNames = [this] { reading_ = Moment::Now(); };
        disk_.afterNames = [this] {
            const Moment took = Moment::Now() - reading_;
            last_.wall += took.wall;
            last_.thread += took.thread;
        };
        last_ = Moment::Now();
        timer_.start(1);
    }
    Stalls(const Stalls&) = delete;
    Stalls& operator=(const Stalls&) = delete;
    ~Stalls() { disk_.beforeNames = disk_.afterNames = nullptr; }

    Moment Longest() {
        Tick();
        return longest_;
    }

  private:
    void Tick() {
        const Moment now = Moment::Now(), gap = now - last_;
        longest_.wall = std::max(longest_.wall, gap.wall);
        longest_.thread = std::max(longest_.thread, gap.thread);
        last_ = now;
    }

    TimedDisk& disk_;
    QTimer timer_;
    Moment reading_, last_, longest_;
};

/// The library's widget in a window of its own, on a host with the timed disk.
class Shown {
  public:
    Shown() {
        frame::Services services;
        services.files = &disk;
        Host::attach(&window_, Host::make(services));
        view_ = new FileView(&window_);
        window_.resize(width, height);
        view_->resize(width, height);
        window_.show();
        PaintAll();
    }

    controls::FileView& Control() { return static_cast<controls::FileView&>(view_->control()); }
    FileView& Widget() { return *view_; }
    ListWidget& List() { return *view_->findChild<ListWidget*>(); }
    void ShowPath(const std::string& path) {
        Control().SetPathRoot(path);
        Settle();
    }
    void Settle() {
        view_->host()->frameHost().Settle();
        PaintAll();
    }
    void Clear() {
        Control().ItemClear();
        Settle();
    }

    TimedDisk disk;

  private:
    QWidget window_;
    FileView* view_ = nullptr;
};

/// The toolkit's own.
class ToolkitView {
  public:
    ToolkitView() {
        view_.setUniformRowHeights(true);
        view_.setRootIsDecorated(false);
        view_.resize(width, height);
        view_.setModel(&model_);
        view_.show();
        PaintAll();
    }
    bool ShowPath(const std::string& path, std::int64_t rows) {
        bool isLoaded = false;
        const auto connection = QObject::connect(&model_, &QFileSystemModel::directoryLoaded, &model_, [&] { isLoaded = true; });
        view_.setRootIndex(model_.setRootPath(ToQt(path)));
        const bool done = RunUntil([&] { return isLoaded && model_.rowCount(view_.rootIndex()) == rows; });
        QObject::disconnect(connection);
        PaintAll();
        return done;
    }
    QFileSystemModel& Model() { return model_; }
    int Rows() { return model_.rowCount(view_.rootIndex()); }

  private:
    QFileSystemModel model_;
    QTreeView view_;
};

void OnScreen(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Flat(state.range(0));
    Shown shown, heard;
    std::int64_t offered = 0, added = 0;
    QObject::connect(&heard.Widget(), &FileView::beforeAddItem, &heard.Widget(), [&](bool&, std::string&) { ++offered; });
    QObject::connect(&heard.Widget(), &FileView::afterAddItem, &heard.Widget(), [&](int&) { ++added; });
    const auto rows = static_cast<double>(state.range(0));
    shown.ShowPath(path);
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(bench::BareListing(path)); });
            shown.Clear();
            const double before = HeldBytes();
            contest.Own([&] { shown.ShowPath(path); });
            contest.Figure("bytes_a_row", (HeldBytes() - before) / rows);
            heard.Clear();
            contest.Peer("with_listener", [&] { heard.ShowPath(path); });
        }
        const double before = HeldBytes();
        ToolkitView toolkit;
        contest.Peer("toolkit", [&] { Expect(state, toolkit.ShowPath(path, state.range(0)) ? 1 : 0, 1); });
        contest.Figure("toolkit_bytes_a_row", (HeldBytes() - before) / rows);
    }
    Expect(state, shown.List().Model().rowCount(), state.range(0));
    Expect(state, added, state.iterations() * state.range(0));
    Expect(state, offered, added);
}
BENCHMARK(OnScreen)->Arg(1'000)->Iterations(9)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(OnScreen)->Arg(10'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(OnScreen)->Arg(100'000)->Iterations(3)->UseManualTime()->Unit(benchmark::kMillisecond);

/// How soon after the names are known the first rows have been painted, and the longest time without an answer. The time of the
/// round is that to the first paint.
void FirstRows(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Flat(state.range(0));
    Shown shown;
    const QObject* viewport = shown.List().viewport();
    {
        Contest contest(state);
        for (auto round : state) {
            shown.Clear();
            Moment known, first;
            {
                Stalls stalls(shown.disk);
                const auto count = shown.disk.afterNames;
                shown.disk.afterNames = [&] {
                    count();
                    known = Moment::Now();
                };
                TheProgram().painted = [&](QObject* painted) {
                    if (painted == viewport && first.wall == 0 && shown.List().Model().rowCount() > 0)
                        first = Moment::Now() - known;
                };
                shown.Control().SetPathRoot(path);
                if (first.wall == 0) shown.Settle();  // painted at the end only
                const Moment longest = stalls.Longest();
                contest.Figure("stall_ms", longest.thread);
                contest.Figure("stall_wall_ms", longest.wall);
            }
            if (first.wall == 0) first = Moment::Now() - known;
            shown.Settle();
            contest.Figure("first_paint_ms", first.thread);
            contest.Figure("first_paint_wall_ms", first.wall);
            state.SetIterationTime(first.thread / 1e3);
        }
    }
    Expect(state, shown.List().Model().rowCount(), state.range(0));
}
BENCHMARK(FirstRows)->Arg(100'000)->Iterations(3)->UseManualTime()->Unit(benchmark::kMillisecond);

/// Clicks on column headers beside the same of the toolkit's model, each with the rows in the order of another column.
void SortOnScreen(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Flat(state.range(0));
    Shown shown;
    shown.ShowPath(path);
    ToolkitView toolkit;
    Expect(state, toolkit.ShowPath(path, state.range(0)) ? 1 : 0, 1);
    RunUntilQuiet();
    constexpr int nameColumn = 1, sizeColumn = 2, modifiedColumn = 4;
    struct Click {
        const char* name;
        int column, toolkitColumn;
    };
    constexpr std::array clicks = {Click{"size", sizeColumn, 1}, Click{"modified", modifiedColumn, 3},
                                   Click{"name", nameColumn, 0}};
    {
        Contest contest(state);
        for (auto round : state) {
            double all = 0;
            for (const Click& click : clicks) {
                const double own = Contest::Time([&] {
                    shown.Control().ListFiles.ColumnClick(click.column);
                    shown.Settle();
                });
                contest.Figure(std::string(click.name) + "_ms", own);
                contest.Figure(std::string(click.name) + "_toolkit_ms", Contest::Time([&] {
                                   toolkit.Model().sort(click.toolkitColumn, Qt::AscendingOrder);
                                   PaintAll();
                               }));
                all += own;
            }
            state.SetIterationTime(all / 1e3);
        }
    }
    Expect(state, shown.List().Model().rowCount(), state.range(0));
}
BENCHMARK(SortOnScreen)->Arg(100'000)->Iterations(1)->UseManualTime()->Unit(benchmark::kMillisecond);

/// One new file in the folder, with the end of the list in view. The toolkit notices it by itself, and is done when all is quiet.
void RefreshOnScreen(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Flat(state.range(0));
    const bench::FileMaker maker(path);
    std::vector<std::string> made;
    const auto makeNew = [&] {
        made.push_back("Brand new " + std::to_string(made.size()) + ".txt");
        maker.Make(made.back(), 1);
    };
    {
        Contest contest(state);
        Shown shown;
        shown.ShowPath(path);
        for (auto round : state) {
            makeNew();
            shown.Control().ListFiles.SetTopIndex(shown.Control().ItemCount());
            shown.Settle();
            RunUntilQuiet();
            contest.Peer("bare", [&] { benchmark::DoNotOptimize(bench::BareListing(path)); });
            contest.Own([&] {
                shown.Control().Refresh();
                shown.Settle();
            });
        }
        const auto rows = state.range(0) + static_cast<std::int64_t>(made.size());
        Expect(state, shown.List().Model().rowCount(), rows);
        ToolkitView toolkit;
        Expect(state, toolkit.ShowPath(path, rows) ? 1 : 0, 1);
        RunUntilQuiet();
        contest.Peer("toolkit", [&] {
            makeNew();
            RunUntil([&] { return toolkit.Rows() > rows; });
            RunUntilQuiet();
        });
    }
    for (const std::string& name : made) unlink((path + "/" + name).c_str());
}
BENCHMARK(RefreshOnScreen)->Arg(100'000)->Iterations(3)->UseManualTime()->Unit(benchmark::kMillisecond);

void SearchOnScreen(benchmark::State& state) {
    const std::string& path = FileTrees::Instance().Tree();
    Shown shown;
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Peer("bare", [&] {
                benchmark::DoNotOptimize(bench::FromTop(
                    path, [](int folder) { return bench::BareMatch(folder, "*.txt", bench::Depth::NamesAndFacts); }));
            });
            shown.Clear();
            contest.Own([&] {
                shown.Control().Search("*.txt", path, true);
                shown.Settle();
            });
            contest.Program("find", {"find", path, "-name", "*.txt"});
        }
    }
    Expect(state, shown.List().Model().rowCount(), FileTrees::treeMatches);
}
BENCHMARK(SearchOnScreen)->Iterations(1)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run<tessel::qt::Program>(count, arguments); }
