#include <QApplication>
#include <QSplitter>
#include <QVBoxLayout>
#include <QWidget>
#include <memory>
#include <string>
#include <vector>

#include "bench/Contest.h"
#include "bench/qt/Run.h"
#include "frame/Text.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Form.h"
#include "hosts/qt/Splitter.h"

/// What a step of a drag costs among 1,000 named widgets of which the bar moves 20, beside the bare calls that set the same
/// geometry, and beside the toolkit's splitter that moves a handle between two panes with 20 widgets in their layouts.

namespace tessel::qt {
namespace {

constexpr int siblings = 1'000, named = 20, steps = 200;

/// A form with the bar in its middle: half of the widgets named stand on its left, half on its right.
struct Stage {
    Stage() {
        window.setObjectName("form");
        window.resize(1000, 800);
        QStringList left, right;
        for (int i = 0; i < siblings; ++i) {
            auto* widget = new QWidget(&window);
            widget->setObjectName(QString("widget%1").arg(i));
            const bool moves = i % (siblings / named) == 0;
            const bool isLeft = i < siblings / 2;
            widget->setGeometry(moves && !isLeft ? 508 : 0, i % 700, moves ? 500 : 4, 4);
            if (!moves) continue;
            (isLeft ? left : right) << widget->objectName();
            (isLeft ? grown : shrunk).push_back(widget);
        }
        bar = new Splitter(&window);
        bar->setObjectName("bar");
        bar->setOrientation(Splitter::tsVertical);
        bar->setGeometry(500, 0, 8, 800);
        bar->setControlsTopLeft(left.join(", "));
        bar->setControlsBottomRight(right.join(", "));
        window.show();
        QApplication::processEvents();
    }
    QWidget window;
    Splitter* bar;
    std::vector<QWidget*> grown, shrunk;
};

/// To and fro by a pixel.
int Direction(int step) { return step % 2 == 0 ? 1 : -1; }

/// The sizes and places that a step sets, in the same calls and order.
void SetBare(Stage& stage, int way) {
    stage.bar->move(stage.bar->x() + way, 0);
    for (QWidget* widget : stage.grown) {
        const QRect place = widget->geometry();
        widget->setGeometry(place.x(), place.y(), place.width() + way, place.height());
    }
    for (QWidget* widget : stage.shrunk) {
        const QRect place = widget->geometry();
        widget->setGeometry(place.x(), place.y(), place.width() - way, place.height());
        widget->setGeometry(place.x() + way, place.y(), place.width() - way, place.height());
    }
}

void DragStep(benchmark::State& state) {
    Stage stage, bare;
    QSplitter toolkit;
    for (int pane = 0; pane < 2; ++pane) {
        auto* holder = new QWidget;
        auto* column = new QVBoxLayout(holder);
        for (int i = 0; i < named / 2; ++i) column->addWidget(new QWidget);
        toolkit.addWidget(holder);
    }
    toolkit.resize(1000, 800);
    toolkit.show();
    QApplication::processEvents();

    auto& surface = stage.bar->control().Surface();
    surface.MouseDownInput(1, 0, 60, 6000);
    bench::Contest contest(state);
    for (auto round : state) {
        contest.Own([&] {
            for (int step = 0; step < steps; ++step)
                surface.MouseMoveInput(1, 0, 60.0f + 15.0f * static_cast<float>(Direction(step)), 6000);
        });
        contest.Peer("bare", [&] {
            for (int step = 0; step < steps; ++step) SetBare(bare, Direction(step));
        });
        contest.Peer("toolkit", [&] {
            for (int step = 0; step < steps; ++step) {
                const int left = toolkit.sizes()[0] + Direction(step);
                toolkit.setSizes({left, toolkit.width() - toolkit.handleWidth() - left});
            }
        });
    }
    bench::Expect(state, stage.grown.front()->width(), 500);
    surface.MouseMoveInput(1, 0, 75, 6000);
    bench::Expect(state, stage.grown.front()->width(), 501);
}

/// One look-up by name among all.
void Find(benchmark::State& state) {
    Stage stage;
    Form& form = Form::of(stage.window);
    int at = 0;
    std::vector<std::string> names;
    for (int i = 0; i < siblings; ++i) names.push_back("WIDGET" + frame::Decimal(i));
    for (auto round : state) benchmark::DoNotOptimize(form.Find(names[static_cast<std::size_t>(at++ % siblings)]));
}

BENCHMARK(DragStep)->Iterations(30)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(Find);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run(count, arguments); }
