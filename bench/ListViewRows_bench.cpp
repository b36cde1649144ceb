#include <benchmark/benchmark.h>
#include <malloc.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <new>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "frame/Text.h"
#include "frame/child/ImageList.h"
#include "frame/child/ListView.h"
#include "hosts/headless/HeadlessHost.h"

/// What a row of a large listing costs: the list, the events around each row, and a peer that follows.

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

namespace tessel {
namespace {

constexpr int rowCount = 100'000;
constexpr int textColumns = 12;

/// What a listing captures of a file: 48 bytes, and the name among all names.
struct Record {
    std::uint64_t size = 0;
    std::int64_t created = 0, modified = 0, accessed = 0;
    std::uint32_t nameStart = 0;
    std::uint16_t nameLength = 0;
    std::uint16_t attributes = 0;
    std::uint16_t typeId = 0;
};

std::string NameOf(int row) { return "Holiday picture " + frame::Decimal(row * 7919LL % 100'000) + ".txt"; }

/// Texts one behind the other, in pages: no room in reserve, and nothing moves.
class Names {
  public:
    static constexpr std::size_t pageSize = 1u << 16;

    /// Where the text now stands; it is short.
    std::uint32_t Add(std::string_view text) {
        if (pages_.empty() || used_ + text.size() > pageSize) {
            pages_.push_back(std::make_unique<char[]>(pageSize));
            used_ = 0;
        }
        text.copy(pages_.back().get() + used_, text.size());
        const std::size_t start = (pages_.size() - 1) * pageSize + used_;
        used_ += text.size();
        return static_cast<std::uint32_t>(start);
    }
    std::string_view At(std::uint32_t start, std::size_t length) const {
        return {pages_[start / pageSize].get() + start % pageSize, length};
    }
    void Clear() { pages_.clear(); }
    std::size_t Bytes() const { return pages_.size() * pageSize; }

  private:
    std::vector<std::unique_ptr<char[]>> pages_;
    std::size_t used_ = 0;
};

class Records final : public child::RowSource {
  public:
    void Capture(child::RowId row, std::string_view name, int number) {
        records_.MakeRoom(row);
        records_[row] = {static_cast<std::uint64_t>(number) * 7919 % 100'003 * 4321,
                         1'600'000'000 + number * 7919LL % 100'003,
                         1'700'000'000 - number * 7907LL % 100'003,
                         1'700'000'000,
                         names_.Add(name),
                         static_cast<std::uint16_t>(name.size()),
                         32,
                         static_cast<std::uint16_t>(number % 5)};
    }
    void AppendText(child::RowId row, int column, std::string& out) const override {
        if (column == 0 || column == 10 || column == 12)
            out += Name(records_[row]);
        else
            out += Text(row, column);
    }
    std::optional<std::uint64_t> SortNumber(child::RowId row, int column) const override {
        const Record& record = records_[row];
        switch (column) {
            case 7:
                return record.size + 1;
            case 8:
                return static_cast<std::uint64_t>(record.modified);
            case 9:
                return static_cast<std::uint64_t>(record.created);
            default:
                return std::nullopt;
        }
    }
    std::string Text(child::RowId row, int column) const override {
        const Record& record = records_[row];
        switch (column) {
            case 0:
            case 10:
            case 12:
                return std::string(Name(record));
            case 1:
                return frame::Decimal(static_cast<std::int64_t>(record.size / 1024)) + " KB";
            case 2:
                return types[record.typeId];
            case 3:
                return Time(record.modified);
            case 4:
                return Time(record.created);
            case 5:
                return record.modified == record.created ? "" : "Yes";
            case 6:
                return "/home/somebody/Pictures/Holidays";
            case 7:
                return Digits(record.size);
            case 8:
                return Time(record.modified);
            case 9:
                return Time(record.created);
            default:
                return {};
        }
    }
    void Clear() {
        records_.Clear();
        names_.Clear();
    }
    std::size_t Bytes() const { return records_.Size() * sizeof(Record) + names_.Bytes(); }

  private:
    static constexpr std::array types = {"Text Document", "JPEG Image", "PDF Document", "Folder", "Archive"};

    std::string_view Name(const Record& record) const { return names_.At(record.nameStart, record.nameLength); }
    static std::string Digits(std::uint64_t number) {
        std::array<char, 24> text;
        const int length = std::snprintf(text.data(), text.size(), "%012llu", static_cast<unsigned long long>(number));
        return std::string(text.data(), static_cast<std::size_t>(length));
    }
    static std::string Time(std::int64_t seconds) {
        std::array<char, 64> text;
        const auto part = [](std::int64_t number) { return static_cast<int>(number); };
        const std::int64_t days =
            seconds / 86'400;  // of years of 12 months of 31 days: enough for texts that order as the times do
        const int length = std::snprintf(text.data(), text.size(), "%04d-%02d-%02d %02d:%02d:%02d", 1970 + part(days / 372),
                                         1 + part(days / 31 % 12), 1 + part(days % 31), part(seconds / 3600 % 24),
                                         part(seconds / 60 % 60), part(seconds % 60));
        return std::string(text.data(), static_cast<std::size_t>(length));
    }

    child::RowPages<Record> records_;
    Names names_;
};

constexpr frame::Event<bool&, std::string&> BeforeAddItem{"BeforeAddItem", 1, {"Cancel", "Filename"}};
constexpr frame::Event<std::int32_t&> AfterAddItem{"AfterAddItem", 2, {"Index"}};

/// Adds rows as a file list does: an event before that may refuse the row, and one after.
class Lister final : public frame::Control {
  public:
    explicit Lister(frame::Host& host) : Control(host) {
        ListFiles.Rows().SetSource(&records);
        for (child::ImageList* images : {&Image16, &Image32})
            images->ListImages.Add({}, "txt", std::make_shared<frame::Picture>(240.0f, 240.0f, ""));
        ListFiles.SetSmallIcons(&Image16);
        ListFiles.SetIcons(&Image32);
    }
    void AddItem(int number) {
        bool cancel = false;
        std::string fileName = NameOf(number);
        RaiseEvent(BeforeAddItem, cancel, fileName);
        if (cancel) return;
        child::ListRows& rows = ListFiles.Rows();
        records.Capture(rows.NextId(), fileName, number);
        const child::RowId row = rows.AddFromSource();
        rows.Fill(row);
        rows.SetIconKey(row, child::IconSize::Small, "txt").Check();
        rows.SetIconKey(row, child::IconSize::Large, "txt").Check();
        rows.SetGhosted(row, number % 10 == 0);
        auto index = static_cast<std::int32_t>(rows.PositionOf(row)) + 1;
        RaiseEvent(AfterAddItem, index);
    }
    void Clear() {
        ListFiles.ListItems.Clear();
        records.Clear();
    }

    frame::TextSize DesignSize() const override { return {3000, 2000}; }
    const frame::ClassTable& Table() const override {
        static constexpr const frame::EventInfo* events[] = {&BeforeAddItem, &AfterAddItem};
        static constexpr frame::ClassTable table{.name = "Lister", .members = {}, .events = events};
        return table;
    }

    Records records;
    child::ImageList Image16{*this, "Image16"}, Image32{*this, "Image32"};
    child::ListView ListFiles{*this, "ListFiles"};
};

/// Reads the journal as a screen does, and the texts of the rows in view.
class Screen final : public frame::Peer {
  public:
    explicit Screen(child::ListView& list) : list_(list) {}
    void Update() override {
        for (const child::RowChange& change : list_.Rows().TakeChanges()) seen_ += change.count;
        constexpr child::ListRows::Position rowsInView = 40;
        for (child::ListRows::Position row = 0; row < std::min(rowsInView, list_.Rows().Count()); ++row)
            for (int column = 0; column < 6; ++column) seen_ += list_.Rows().Text(list_.Rows().At(row), column).size();
        benchmark::DoNotOptimize(seen_);
    }

  private:
    child::ListView& list_;
    std::size_t seen_ = 0;
};

void ReportRows(benchmark::State& state, std::size_t bytes) {
    state.SetItemsProcessed(state.iterations() * rowCount);
    state.counters["time/row"] = benchmark::Counter(static_cast<double>(state.iterations()) * rowCount,
                                                    benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
    state.counters["bytes/row"] = static_cast<double>(bytes) / rowCount;
}

/// A lister whose application listens to the events or not.
struct Application {
    Application() : lister(host.Create<Lister>("FileView1", {.logEvents = false})) {}

    void ListenToBoth() {
        host.SiteOf(lister)->ApplicationHandlers().On(BeforeAddItem,
                                                      [](bool& cancel, std::string& fileName) { cancel = fileName.empty(); });
        host.SiteOf(lister)->ApplicationHandlers().On(AfterAddItem, [this](std::int32_t& index) { lastIndex = index; });
    }
    /// Lists again and again; every `turn` rows the peers look, where it is not 0.
    void Run(benchmark::State& state, int turn = 0) {
        std::size_t bytes = 0;
        for (auto _ : state) {
            state.PauseTiming();
            lister.Clear();
            host.Frame().Flush();
            const std::size_t before = liveBytes;
            state.ResumeTiming();
            for (int row = 0; row < rowCount; ++row) {
                lister.AddItem(row);
                if (turn > 0 && row % turn == turn - 1) host.Frame().Flush();
            }
            bytes = bytes > 0 ? bytes : liveBytes - before;  // the first listing: later ones find room that is there already
        }
        state.counters["captured"] = static_cast<double>(lister.records.Bytes()) / rowCount;
        ReportRows(state, bytes);
    }

    headless::HeadlessHost host;
    std::int32_t lastIndex = 0;
    Lister& lister;
};

void RowsWithoutListener(benchmark::State& state) { Application().Run(state); }
BENCHMARK(RowsWithoutListener)->Unit(benchmark::kMillisecond);

void RowsWithListenerOnBothEvents(benchmark::State& state) {
    Application application;
    application.ListenToBoth();
    application.Run(state);
}
BENCHMARK(RowsWithListenerOnBothEvents)->Unit(benchmark::kMillisecond);

void RowsWithListenerAndPeerEvery1000(benchmark::State& state) {
    Application application;
    application.ListenToBoth();
    application.lister.ListFiles.AttachPeer(std::make_unique<Screen>(application.lister.ListFiles));
    application.Run(state, 1'000);
}
BENCHMARK(RowsWithListenerAndPeerEvery1000)->Unit(benchmark::kMillisecond);

/// By name, and by size.
void RowsIntoASortedList(benchmark::State& state) {
    Application application;
    application.lister.ListFiles.SetSortKey(static_cast<int>(state.range(0)));
    application.lister.ListFiles.SetSorted(true);
    application.ListenToBoth();
    application.lister.ListFiles.AttachPeer(std::make_unique<Screen>(application.lister.ListFiles));
    application.Run(state, 1'000);
}
BENCHMARK(RowsIntoASortedList)->Arg(textColumns)->Arg(7)->Unit(benchmark::kMillisecond);

/// What a peer costs that takes every text of every row at once.
void NaivePeerWith12EagerTexts(benchmark::State& state) {
    Application application;
    for (int row = 0; row < rowCount; ++row) application.lister.AddItem(row);
    const child::ListRows& rows = application.lister.ListFiles.Rows();
    std::size_t bytes = 0;
    for (auto _ : state) {
        const std::size_t before = liveBytes;
        std::vector<std::vector<std::string>> all;
        for (child::ListRows::Position position = 0; position < rows.Count(); ++position) {
            std::vector<std::string>& texts = all.emplace_back();
            texts.reserve(textColumns);
            for (int column = 0; column < textColumns; ++column) texts.push_back(rows.Text(rows.At(position), column));
        }
        bytes = liveBytes - before;
        benchmark::DoNotOptimize(all.data());
    }
    ReportRows(state, bytes);
}
BENCHMARK(NaivePeerWith12EagerTexts)->Unit(benchmark::kMillisecond);

/// Sorting the whole list by a column, from the order of another.
void SortOfAllRows(benchmark::State& state, int key) {
    Application application;
    for (int row = 0; row < rowCount; ++row) application.lister.AddItem(row);
    child::ListView& list = application.lister.ListFiles;
    constexpr int another = 2;
    for (auto _ : state) {
        state.PauseTiming();
        list.SetSortKey(another);
        list.SetSorted(true);
        state.ResumeTiming();
        list.SetSortKey(key);
    }
    ReportRows(state, 0);
}
BENCHMARK_CAPTURE(SortOfAllRows, name, textColumns)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(SortOfAllRows, size, 7)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(SortOfAllRows, modified, 8)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(SortOfAllRows, textsThatAreMade, 3)->Unit(benchmark::kMillisecond);

void SortTurnedRound(benchmark::State& state) {
    Application application;
    for (int row = 0; row < rowCount; ++row) application.lister.AddItem(row);
    child::ListView& list = application.lister.ListFiles;
    list.SetSortKey(textColumns);
    list.SetSorted(true);
    bool descending = false;
    for (auto _ : state) {
        descending = !descending;
        list.SetSortOrder(descending ? child::ListSortOrderConstants::Descending : child::ListSortOrderConstants::Ascending);
    }
    ReportRows(state, 0);
}
BENCHMARK(SortTurnedRound)->Unit(benchmark::kMillisecond);

/// One search a row, as a refresh of the list does.
void FindItemForEachRow(benchmark::State& state) {
    Application application;
    for (int row = 0; row < rowCount; ++row) application.lister.AddItem(row);
    const child::ListView& list = application.lister.ListFiles;
    const std::size_t before = liveBytes;
    list.FindItem("");
    const std::size_t bytes = liveBytes - before;
    for (auto _ : state)
        for (int row = 0; row < rowCount; ++row) benchmark::DoNotOptimize(list.FindItem(NameOf(row)));
    ReportRows(state, bytes);
}
BENCHMARK(FindItemForEachRow)->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel

BENCHMARK_MAIN();
