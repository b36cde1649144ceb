#include <benchmark/benchmark.h>

#include <QApplication>
#include <QImage>
#include <QPainter>
#include <QWidget>
#include <memory>

#include "bench/Contest.h"
#include "bench/qt/Run.h"
#include "frame/ClassTable.h"
#include "frame/child/PictureBox.h"
#include "hosts/qt/ControlWidget.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/SurfaceCanvas.h"

/// What it costs to draw a gauge on a picture box: a bar, blocks, ticks, limits, a marker and a value as text, each time from the
/// begin, until its pixels are there. Beside it the same on the toolkit's painter over an image. "Shown" has the painting of the
/// widget too.

namespace tessel::qt {
namespace {

constexpr int pixelsWide = 400, pixelsHigh = 40, gauges = 200;
constexpr frame::OLE_COLOR face = 0xF0F0F0, bar = 0x00A000, gap = 0xFFFFFF, tick = 0x404040, limit = 0x0000C0, mark = 0xC00000;

class Dial final : public frame::Control {
  public:
    using Control::Control;
    frame::TextSize DesignSize() const override { return {Twips(pixelsWide), Twips(pixelsHigh)}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Dial", .members = {}};
        return table;
    }

    child::PictureBox Picture1{*this, "Picture1"};
};

class Shown final : public ControlWidget {
  public:
    Shown() : ControlWidget(Class(), nullptr) {
        resize(pixelsWide, pixelsHigh);
        child::PictureBox& box = Box();
        box.SetBorderStyle(0);
        box.Move(0, 0, Twips(pixelsWide), Twips(pixelsHigh));
        box.SetScaleMode(frame::ScaleModeConstants::Pixels);
        box.SetBackColor(face);
        show();
        box.Host().Settle();
    }
    child::PictureBox& Box() const { return static_cast<Dial&>(control()).Picture1; }

  protected:
    bool hears(const frame::EventInfo&) const override { return false; }
    void raise(const frame::EventInfo&, frame::EventArguments) override {}

  private:
    static const frame::ControlClass& Class() {
        static constexpr frame::ClassTable table{.name = "Dial", .members = {}};
        static const frame::ControlClass controlClass{
            &table, [](frame::Host& host) -> std::unique_ptr<frame::Control> { return std::make_unique<Dial>(host); }};
        return controlClass;
    }
};

/// A gauge in the terms of a canvas that has these four operations: 31 of them.
template <class Surface>
void Gauge(const Surface& on, int value) {
    on.Clear();
    on.Fill(0, 0, value, pixelsHigh, bar);
    for (int block = 1; block < 10; ++block) on.Line(block * pixelsWide / 10, 0, block * pixelsWide / 10, pixelsHigh, 3, gap);
    for (int line = 1; line < 16; ++line)
        on.Line(line * pixelsWide / 16, pixelsHigh - 8, line * pixelsWide / 16, pixelsHigh, 1, tick);
    for (int third = 1; third <= 3; ++third) on.Line(third * pixelsWide / 4, 0, third * pixelsWide / 4, pixelsHigh, 1, limit);
    on.Fill(value - 2, 0, value + 2, pixelsHigh, mark);
    on.Text(pixelsWide / 2 - 12, pixelsHigh / 2 - 7, "93%");
}

struct OnBox {
    child::PictureBox& box;

    void Clear() const {
        box.SetPicture(nullptr);
        box.Cls();
    }
    void Fill(int x1, int y1, int x2, int y2, frame::OLE_COLOR color) const {
        box.SetDrawWidth(1);
        box.Line(F(x1), F(y1), F(x2), F(y2), color, frame::draw::Box::Filled);
    }
    void Line(int x1, int y1, int x2, int y2, std::int16_t pen, frame::OLE_COLOR color) const {
        box.SetDrawWidth(pen);
        box.Line(F(x1), F(y1), F(x2), F(y2), color);
    }
    void Text(int x, int y, const char* text) const {
        box.SetCurrentX(F(x));
        box.SetCurrentY(F(y));
        box.Print(text);
    }
    static float F(int value) { return static_cast<float>(value); }
};

struct OnPainter {
    QPainter& painter;
    QFont font;

    static QColor Color(frame::OLE_COLOR color) { return {frame::Red(color), frame::Green(color), frame::Blue(color)}; }
    void Clear() const { painter.fillRect(0, 0, pixelsWide, pixelsHigh, Color(face)); }
    void Fill(int x1, int y1, int x2, int y2, frame::OLE_COLOR color) const {
        painter.fillRect(x1, y1, x2 - x1 + 1, y2 - y1 + 1, Color(color));
    }
    void Line(int x1, int y1, int x2, int y2, int pen, frame::OLE_COLOR color) const {
        painter.setPen(QPen(Color(color), pen));
        painter.drawLine(x1, y1, x2, y2);
    }
    void Text(int x, int y, const char* text) const {
        painter.setFont(font);
        painter.setPen(Qt::black);
        painter.drawText(QRectF(x, y, pixelsWide, pixelsHigh), Qt::AlignLeft | Qt::AlignTop, text);
    }
};

int ValueOf(int pass) { return 20 + pass * 360 / gauges; }

/// How many pixels are those of the bar.
std::int64_t BarOf(const QImage& image) {
    std::int64_t count = 0;
    for (int x = 0; x < image.width(); ++x) count += image.pixelColor(x, 10) == OnPainter::Color(bar) ? 1 : 0;
    return count;
}

void Drawn(benchmark::State& state) {
    Shown widget;
    child::PictureBox& box = widget.Box();
    const auto& canvas = dynamic_cast<const SurfaceCanvas&>(box.Drawn());
    QImage image(pixelsWide, pixelsHigh, QImage::Format_ARGB32_Premultiplied);
    const QFont font = ToQt(*box.Font());
    bench::Contest contest(state);
    for (auto round : state) {
        contest.Own([&] {
            for (int pass = 0; pass < gauges; ++pass) {
                Gauge(OnBox{box}, ValueOf(pass));
                benchmark::DoNotOptimize(canvas.Image().constBits());
            }
        });
        contest.Peer("painter", [&] {
            for (int pass = 0; pass < gauges; ++pass) {
                QPainter painter(&image);
                Gauge(OnPainter{painter, font}, ValueOf(pass));
            }
        });
        const std::int64_t drawn = BarOf(canvas.Image());
        bench::Expect(state, std::abs(drawn - BarOf(image)) <= 12 && drawn > pixelsWide / 2 ? drawn : 0, drawn);
    }
}

/// Shows an image.
class Painted final : public QWidget {
  public:
    QImage image{pixelsWide, pixelsHigh, QImage::Format_ARGB32_Premultiplied};

  protected:
    void paintEvent(QPaintEvent*) override { QPainter(this).drawImage(QPoint(), image); }
};

void ShownToo(benchmark::State& state) {
    Shown widget;
    child::PictureBox& box = widget.Box();
    Painted painted;
    painted.resize(pixelsWide, pixelsHigh);
    painted.show();
    const QFont font = ToQt(*box.Font());
    QApplication::processEvents();
    bench::Contest contest(state);
    for (auto round : state) {
        contest.Own([&] {
            for (int pass = 0; pass < gauges; ++pass) {
                Gauge(OnBox{box}, ValueOf(pass));
                widget.repaint();
            }
        });
        contest.Peer("painter", [&] {
            for (int pass = 0; pass < gauges; ++pass) {
                {
                    QPainter painter(&painted.image);
                    Gauge(OnPainter{painter, font}, ValueOf(pass));
                }
                painted.repaint();
            }
        });
    }
}

BENCHMARK(Drawn)->Iterations(25)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(ShownToo)->Iterations(25)->UseManualTime()->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace tessel::qt

int main(int count, char** arguments) { return tessel::bench::Run(count, arguments); }
