#include <benchmark/benchmark.h>
#include <malloc.h>

#include <QAbstractTableModel>
#include <QApplication>
#include <QHeaderView>
#include <QScrollBar>
#include <QTableView>
#include <QTreeView>
#include <QTreeWidget>
#include <array>
#include <ctime>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "bench/qt/Run.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/qt/ControlWidget.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Host.h"
#include "hosts/qt/ListWidget.h"
#include "tests/frame/child/ListOwner.h"

/// What it costs to show many rows that are there already, to paint the first of them, and to scroll on by a page: this library's
/// list beside the toolkit's views over a model that holds its texts, and beside a widget that is filled item by item.

namespace tessel::qt {
namespace {

constexpr int columns = 3, width = 800, height = 600;

using Texts = std::array<QString, columns>;

std::string TextAt(std::uint32_t row, int column) {
    switch (column) {
        case 0:
            return "Holiday picture " + frame::Decimal(row * 7919LL % 1'000'003) + ".txt";
        case 1:
            return frame::Decimal(row * 31LL % 4096) + " KB";
        default:
            return "Text document";
    }
}

/// Texts made when asked, from the number of the row alone.
class Source final : public child::RowSource {
  public:
    std::string Text(child::RowId row, int column) const override { return TextAt(row, column); }
};

/// The texts of all rows, held.
class HeldTexts final : public QAbstractTableModel {
  public:
    int rowCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : static_cast<int>(rows_.size()); }
    int columnCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : columns; }
    QVariant data(const QModelIndex& index, int role) const override {
        if (role != Qt::DisplayRole) return {};
        return rows_[static_cast<std::size_t>(index.row())][static_cast<std::size_t>(index.column())];
    }
    void Take(std::vector<Texts> rows) {
        beginResetModel();
        rows_ = std::move(rows);
        endResetModel();
    }

  private:
    std::vector<Texts> rows_;
};

std::vector<Texts> AllTexts(std::uint32_t count) {
    std::vector<Texts> rows(count);
    for (std::uint32_t row = 0; row < count; ++row)
        for (int column = 0; column < columns; ++column)
            rows[row][static_cast<std::size_t>(column)] = QString::fromStdString(TextAt(row, column));
    return rows;
}

class Shown final : public ControlWidget {
  public:
    Shown() : ControlWidget(Class(), nullptr) {}

  protected:
    bool hears(const frame::EventInfo&) const override { return false; }
    void raise(const frame::EventInfo&, frame::EventArguments) override {}

  private:
    static const frame::ControlClass& Class() {
        static constexpr frame::ClassTable table{.name = "ListOwner", .members = {}};
        static const frame::ControlClass controlClass{
            &table, [](frame::Host& host) -> std::unique_ptr<frame::Control> { return std::make_unique<test::ListOwner>(host); }};
        return controlClass;
    }
};

/// The memory that is handed out, large blocks among it.
double HeldBytes() {
    const struct mallinfo2 memory = mallinfo2();
    return static_cast<double>(memory.uordblks + memory.hblkhd);
}

/// Measures the three phases of one view: until its rows are taken over, until the first are painted, and one page further.
class Phases {
  public:
    explicit Phases(benchmark::State& state) : state_(state) {}
    ~Phases() {
        const auto rounds = static_cast<double>(state_.iterations());
        const auto rows = static_cast<double>(state_.range(0));
        state_.counters["1_rows_ms"] = taken_ / rounds;
        state_.counters["2_first_paint_ms"] = painted_ / rounds;
        state_.counters["3_page_ms"] = paged_ / rounds;
        state_.counters["bytes_a_row"] = bytes_ / rounds / rows;
    }
    template <class Take>
    void Measure(QAbstractScrollArea& view, Take&& take) {
        const double before = HeldBytes();
        const double taken = Time(take);
        const double painted = Time([&] { view.grab(); });
        bytes_ += HeldBytes() - before;
        QScrollBar& bar = *view.verticalScrollBar();
        bar.setValue(bar.maximum() / 2);
        view.grab();
        const double paged = Time([&] {
            bar.triggerAction(QAbstractSlider::SliderPageStepAdd);
            view.grab();
        });
        taken_ += taken;
        painted_ += painted;
        paged_ += paged;
        state_.SetIterationTime((taken + painted) / 1000);
    }

  private:
    template <class F>
    static double Time(F&& call) {
        const std::clock_t start = std::clock();  // of the processor: others may use it meanwhile
        call();
        return 1000.0 * static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC;
    }

    benchmark::State& state_;
    double taken_ = 0, painted_ = 0, paged_ = 0, bytes_ = 0;
};

void List(benchmark::State& state) {
    const Source source;
    Phases phases(state);
    for (auto round : state) {
        Shown widget;
        widget.resize(width, height);
        child::ListView& list = static_cast<test::ListOwner&>(widget.control()).list;
        list.Move(0, 0, Twips(width), Twips(height));
        for (int column = 0; column < columns; ++column) list.Headers().Add({}, {}, "Column", 3000.0f);
        list.SetView(static_cast<child::ListViewConstants>(state.range(1)));
        widget.show();
        list.Host().Settle();
        list.Rows().SetSource(&source);
        for (std::int64_t row = 0; row < state.range(0); ++row) list.Rows().Fill(list.Rows().AddFromSource());
        phases.Measure(*widget.findChild<ListWidget*>(), [&] { list.Host().Settle(); });
    }
}

/// The same rows in a hundred parts, each of which is taken over; without painting.
void ListInParts(benchmark::State& state) {
    constexpr std::int64_t parts = 100;
    const Source source;
    for (auto round : state) {
        Shown widget;
        widget.resize(width, height);
        child::ListView& list = static_cast<test::ListOwner&>(widget.control()).list;
        list.Move(0, 0, Twips(width), Twips(height));
        for (int column = 0; column < columns; ++column) list.Headers().Add({}, {}, "Column", 3000.0f);
        widget.show();
        list.Rows().SetSource(&source);
        std::clock_t spent = 0;
        for (std::int64_t part = 0; part < parts; ++part) {
            for (std::int64_t row = 0; row < state.range(0) / parts; ++row) list.Rows().Fill(list.Rows().AddFromSource());
            const std::clock_t start = std::clock();
            list.Host().Settle();
            spent += std::clock() - start;
        }
        state.SetIterationTime(static_cast<double>(spent) / CLOCKS_PER_SEC);
    }
}

template <class View>
void HeldModel(benchmark::State& state) {
    Phases phases(state);
    const auto count = static_cast<std::uint32_t>(state.range(0));
    for (auto round : state) {
        HeldTexts model;
        View view;
        if constexpr (std::is_same_v<View, QTreeView>) {
            view.setUniformRowHeights(true);
            view.setRootIsDecorated(false);
        }
        view.resize(width, height);
        view.setModel(&model);
        view.show();
        std::vector<Texts> texts = AllTexts(count);
        phases.Measure(view, [&] { model.Take(std::move(texts)); });
    }
}

void ItemByItem(benchmark::State& state) {
    Phases phases(state);
    const auto count = static_cast<std::uint32_t>(state.range(0));
    for (auto round : state) {
        QTreeWidget view;
        view.setColumnCount(columns);
        view.setUniformRowHeights(true);
        view.setRootIsDecorated(false);
        view.resize(width, height);
        view.show();
        const std::vector<Texts> texts = AllTexts(count);
        phases.Measure(view, [&] {
            QList<QTreeWidgetItem*> items;
            items.reserve(count);
            for (const Texts& row : texts) items << new QTreeWidgetItem(QStringList(row.begin(), row.end()));
            view.addTopLevelItems(items);
        });
    }
}

constexpr int report = 3, largeIcons = 0;

BENCHMARK(List)
    ->Args({100'000, report})
    ->Args({1'000'000, report})
    ->Args({100'000, largeIcons})
    ->Iterations(5)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);
BENCHMARK(ListInParts)->Arg(100'000)->Arg(1'000'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(HeldModel<QTableView>)->Arg(100'000)->Arg(1'000'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(HeldModel<QTreeView>)->Arg(100'000)->Arg(1'000'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(ItemByItem)->Arg(100'000)->Arg(1'000'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run(count, arguments); }
