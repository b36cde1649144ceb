#include <benchmark/benchmark.h>
#include <malloc.h>

#include <QApplication>
#include <QScrollBar>
#include <QStandardItemModel>
#include <QTreeView>
#include <QTreeWidget>
#include <ctime>
#include <memory>
#include <string>

#include "bench/qt/Run.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/qt/ControlWidget.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Host.h"
#include "hosts/qt/TreeWidget.h"
#include "tests/frame/child/TreeOwner.h"

/// What it costs to fill a node with many children, to expand it until the first of them are painted, to scroll on by a page, to
/// find one by its text, and to collapse it: this library's tree beside the toolkit's tree view over a model of items, and beside
/// its tree widget.

namespace tessel::qt {
namespace {

constexpr int width = 400, height = 600;

std::string TextAt(std::int64_t child) { return "Holiday pictures " + frame::Decimal(child * 7919LL % 1'000'003); }
QString ToText(std::int64_t child) { return QString::fromStdString(TextAt(child)); }

class Shown final : public ControlWidget {
  public:
    Shown() : ControlWidget(Class(), nullptr) {}

  protected:
    bool hears(const frame::EventInfo&) const override { return false; }
    void raise(const frame::EventInfo&, frame::EventArguments) override {}

  private:
    static const frame::ControlClass& Class() {
        static constexpr frame::ClassTable table{.name = "TreeOwner", .members = {}};
        static const frame::ControlClass controlClass{
            &table, [](frame::Host& host) -> std::unique_ptr<frame::Control> { return std::make_unique<test::TreeOwner>(host); }};
        return controlClass;
    }
};

/// The memory that is handed out, large blocks among it.
double HeldBytes() {
    const struct mallinfo2 memory = mallinfo2();
    return static_cast<double>(memory.uordblks + memory.hblkhd);
}

/// Measures the phases of one tree; each call is named by what it does to the tree.
class Phases {
  public:
    explicit Phases(benchmark::State& state) : state_(state) {}
    template <class Fill, class Expand, class Find, class Collapse>
    void Measure(QAbstractScrollArea& view, Fill&& fill, Expand&& expand, Find&& find, Collapse&& collapse) {
        const double before = HeldBytes();
        Add("1_fill_ms", Time(fill));
        view.grab();
        const double expanded = Time([&] {
            expand();
            view.grab();
        });
        Add("2_expand_and_paint_ms", expanded);
        Add("bytes_a_node", (HeldBytes() - before) / static_cast<double>(state_.range(0)));
        QScrollBar& bar = *view.verticalScrollBar();
        bar.setValue(bar.maximum() / 2);
        view.grab();
        Add("3_page_ms", Time([&] {
                bar.triggerAction(QAbstractSlider::SliderPageStepAdd);
                view.grab();
            }));
        Add("4_find_ms", Time(find));
        Add("5_find_again_ms", Time(find));
        Add("6_collapse_and_paint_ms", Time([&] {
                collapse();
                view.grab();
            }));
        state_.SetIterationTime(expanded / 1000);
    }

  private:
    template <class F>
    static double Time(F&& call) {
        const std::clock_t start = std::clock();  // of the processor: others may use it meanwhile
        call();
        return 1000.0 * static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC;
    }
    void Add(const char* name, double value) { state_.counters[name] += value / static_cast<double>(state_.max_iterations); }

    benchmark::State& state_;
};

void Tree(benchmark::State& state) {
    Phases phases(state);
    for (auto round : state) {
        Shown widget;
        widget.resize(width, height);
        child::TreeView& tree = static_cast<test::TreeOwner&>(widget.control()).tree;
        tree.Move(0, 0, Twips(width), Twips(height));
        widget.show();
        tree.Host().Settle();
        child::NodeId root = child::noNode;
        const auto fill = [&] {
            tree.Tree().Add(root, "root").Check();
            for (std::int64_t child = 0; child < state.range(0); ++child) {
                child::NodeId node = child::noNode;
                tree.Tree().Add(node, TextAt(child), {}, root, child::TreeRelationshipConstants::Child).Check();
            }
            tree.Host().Settle();
        };
        const auto turn = [&](bool expanded) {
            tree.SetExpanded(root, expanded);
            tree.Host().Settle();
        };
        const auto find = [&] {
            if (!tree.Tree().FindChild(root, TextAt(state.range(0) - 1))) state.SkipWithError("nothing found");
        };
        phases.Measure(
            *widget.findChild<TreeWidget*>(), fill, [&] { turn(true); }, find, [&] { turn(false); });
    }
}

void HeldModel(benchmark::State& state) {
    Phases phases(state);
    for (auto round : state) {
        QStandardItemModel model;
        QTreeView view;
        view.setHeaderHidden(true);
        view.setUniformRowHeights(true);
        view.resize(width, height);
        view.setModel(&model);
        view.show();
        auto* const root = new QStandardItem("root");
        model.appendRow(root);
        const auto fill = [&] {
            QList<QStandardItem*> children;
            for (std::int64_t child = 0; child < state.range(0); ++child) children << new QStandardItem(ToText(child));
            root->appendRows(children);
        };
        const auto find = [&] {
            if (model.findItems(ToText(state.range(0) - 1), Qt::MatchFixedString | Qt::MatchRecursive).isEmpty())
                state.SkipWithError("nothing found");
        };
        phases.Measure(
            view, fill, [&] { view.expand(root->index()); }, find, [&] { view.collapse(root->index()); });
    }
}

void ItemByItem(benchmark::State& state) {
    Phases phases(state);
    for (auto round : state) {
        QTreeWidget view;
        view.setHeaderHidden(true);
        view.setUniformRowHeights(true);
        view.resize(width, height);
        view.show();
        auto* const root = new QTreeWidgetItem(QStringList{"root"});
        view.addTopLevelItem(root);
        const auto fill = [&] {
            QList<QTreeWidgetItem*> children;
            for (std::int64_t child = 0; child < state.range(0); ++child)
                children << new QTreeWidgetItem(QStringList{ToText(child)});
            root->addChildren(children);
        };
        const auto find = [&] {
            if (view.findItems(ToText(state.range(0) - 1), Qt::MatchFixedString | Qt::MatchRecursive).isEmpty())
                state.SkipWithError("nothing found");
        };
        phases.Measure(
            view, fill, [&] { view.expandItem(root); }, find, [&] { view.collapseItem(root); });
    }
}

BENCHMARK(Tree)->Arg(50'000)->Arg(500'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(HeldModel)->Arg(50'000)->Arg(500'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(ItemByItem)->Arg(50'000)->Arg(500'000)->Iterations(5)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run(count, arguments); }
