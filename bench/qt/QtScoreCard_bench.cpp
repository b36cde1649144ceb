#include <benchmark/benchmark.h>

#include <QApplication>
#include <QPainter>
#include <QProgressBar>
#include <QVBoxLayout>
#include <functional>

#include "bench/Contest.h"
#include "bench/qt/Run.h"
#include "hosts/qt/ScoreCard.h"

/// A gauge in a window: a new score to painted pixels, beside the same lines, boxes and text straight on a painter, and beside the
/// toolkit's own bar.

namespace tessel::qt {
namespace {

using bench::Contest;
using bench::Expect;

constexpr int width = 400, height = 40, scores = 200;
constexpr int blocks = 20;
constexpr double tickEvery = 0.05;

/// The gauge as somebody would paint it who needs no control: all of it in one paint event.
class BareGauge final : public QWidget {
  public:
    void setScore(double score) {
        score_ = score;
        update();
    }
    std::int64_t painted = 0;

  protected:
    void paintEvent(QPaintEvent*) override {
        ++painted;
        QPainter painter(this);
        const int w = QWidget::width(), h = QWidget::height();
        const auto at = [&](double value) { return static_cast<int>(value * w); };
        const auto line = [&](double value, double part, const QColor& color, int pen) {
            painter.setPen(QPen(color, pen, Qt::SolidLine, Qt::RoundCap));
            const double margin = (1 - part) / 2;
            painter.drawLine(at(value), static_cast<int>(margin * h), at(value), static_cast<int>((1 - margin) * h));
        };
        painter.fillRect(rect(), QColor(0xC0, 0xC0, 0xC0));
        painter.fillRect(0, 0, at(score_), h, Qt::green);
        for (int i = 1; i <= blocks; ++i) line(static_cast<double>(i) / blocks, 1, QColor(0xC0, 0xC0, 0xC0), 2);
        painter.setPen(QPen(Qt::black, 1));
        painter.drawLine(0, h / 2, w, h / 2);
        int tick = 1;
        for (double value = tickEvery; value <= 1; value += tickEvery) line(value, tick++ % 5 == 0 ? 0.5 : 0.3, Qt::black, 1);
        line(0.2, 1, Qt::red, 1);
        line(0.4, 1, Qt::yellow, 1);
        line(0.6, 1, Qt::green, 1);
        line(0.8, 1, Qt::cyan, 1);
        line(score_, 1, Qt::black, 5);
        line(score_, 1, Qt::white, 1);
        painter.setPen(Qt::black);
        painter.drawText(rect(), Qt::AlignCenter, QString::number(qRound(score_ * 100)) + '%');
    }

  private:
    double score_ = 0;
};

/// A widget in a window of its own, painted as often as it is told.
template <class W>
struct Shown {
    QWidget window;
    W* widget = new W;

    Shown() {
        auto* column = new QVBoxLayout(&window);
        column->setContentsMargins(0, 0, 0, 0);
        widget->setFixedSize(width, height);
        column->addWidget(widget);
        window.show();
        QCoreApplication::processEvents();
    }
};

/// So many scores, each painted before the next.
void Run(const std::function<void(double)>& set) {
    for (int i = 0; i < scores; ++i) {
        set(static_cast<double>(i) / scores);
        QCoreApplication::sendPostedEvents();
        QCoreApplication::processEvents();
    }
}

void RedrawGauge(benchmark::State& state) {
    Shown<ScoreCard> own;
    ScoreCard& card = *own.widget;
    card.setStyle(ScoreCard::GaugeRainbow);
    card.setShowBlocks(blocks);
    card.setShowTickLinesEvery(tickEvery);
    card.setShowLimitLines(true);
    card.setShowMarker(ScoreCard::ShowFlatBar);
    card.setShowValue(ScoreCard::AtMiddle);
    Shown<BareGauge> bare;
    Shown<QProgressBar> bar;
    bar.widget->setRange(0, scores);
    {
        Contest contest(state);
        for (auto round : state) {
            contest.Own([&] { Run([&](double score) { card.control().SetValue(score); }); });
            contest.Peer("painter", [&] { Run([&](double score) { bare.widget->setScore(score); }); });
            contest.Peer("progress_bar",
                         [&] { Run([&](double score) { bar.widget->setValue(static_cast<int>(score * scores)); }); });
        }
    }
    Expect(state, own.window.grab().size() == QSize(width, height) ? 1 : 0, 1);
    Expect(state, bare.widget->painted >= scores ? 1 : 0, 1);
}
BENCHMARK(RedrawGauge)->Iterations(15)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run(count, arguments); }
