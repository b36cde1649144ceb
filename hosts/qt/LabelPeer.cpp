#include "hosts/qt/LabelPeer.h"

#include <qdrawutil.h>

#include <QPainter>
#include <QStyle>
#include <array>
#include <cmath>

#include "hosts/qt/Convert.h"
#include "hosts/qt/PointerInput.h"
#include "hosts/qt/TextLayout.h"

namespace tessel::qt {

namespace {

constexpr double readableContrast = 4.5;

double Luminance(const QColor& color) {
    const auto linear = [](double part) { return part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4); };
    return 0.2126 * linear(color.redF()) + 0.7152 * linear(color.greenF()) + 0.0722 * linear(color.blueF());
}

double Contrast(const QColor& a, const QColor& b) {
    const double first = Luminance(a), second = Luminance(b);
    return (std::max(first, second) + 0.05) / (std::min(first, second) + 0.05);
}

bool IsDark(const QColor& background) {
    constexpr double middle = 0.179;  // black and white are equally far from it
    return Luminance(background) < middle;
}

bool IsSystemColor(frame::OLE_COLOR color) { return (color.value & 0x80000000u) != 0; }

/// `share` of the second colour in the first.
QColor Mixed(const QColor& first, const QColor& second, float share) {
    const auto part = [share](float a, float b) { return a + (b - a) * share; };
    return QColor::fromRgbF(part(first.redF(), second.redF()), part(first.greenF(), second.greenF()),
                            part(first.blueF(), second.blueF()));
}

}  // namespace

QColor Readable(const QColor& color, const QColor& background) {
    constexpr int steps = 32;
    for (int step = 0; step < steps; ++step) {
        const QColor lighter = Mixed(color, Qt::white, static_cast<float>(step) / steps);
        if (Contrast(lighter, background) >= readableContrast) return lighter;
    }
    return Qt::white;
}

/// Paints what its label says, and reports the mouse.
class LabelWidget final : public QWidget {
  public:
    explicit LabelWidget(child::Label& label) : input(label, *this) { setMouseTracking(true); }

    struct Look {
        QString text;
        QFont font;
        Qt::Alignment alignment = Qt::AlignLeft;
        bool wrap = false, border = false, sunken = false;
        frame::OLE_COLOR back, fore;
        const frame::SystemColors* system = nullptr;
    };
    void Show(Look look) {
        look_ = std::move(look);
        update();
    }
    PointerInput input;

  protected:
    void paintEvent(QPaintEvent*) override;
    void mousePressEvent(QMouseEvent* event) override { input.Press(*event); }
    void mouseMoveEvent(QMouseEvent* event) override { input.Move(*event); }
    void mouseReleaseEvent(QMouseEvent* event) override { input.Release(*event); }
    void mouseDoubleClickEvent(QMouseEvent* event) override { input.DoubleClick(*event); }
    void leaveEvent(QEvent*) override { input.Leave(); }
    void changeEvent(QEvent* event) override {
        if (event->type() == QEvent::PaletteChange || event->type() == QEvent::EnabledChange) update();
        QWidget::changeEvent(event);
    }

  private:
    QColor TextColor(const QColor& background) const;

    Look look_;
};

QColor LabelWidget::TextColor(const QColor& background) const {
    QColor color = ToQt(look_.fore, *look_.system);
    if (IsSystemColor(look_.back) && IsDark(background)) color = Readable(color, background);
    constexpr float faded = 0.5f;
    return isEnabled() ? color : Mixed(color, background, faded);
}

void LabelWidget::paintEvent(QPaintEvent*) {
    if (!look_.system) return;
    QPainter painter(this);
    const bool shows = IsSurroundings(look_.back);
    const QColor background = shows ? palette().color(QPalette::Window) : ToQt(look_.back, *look_.system);
    if (!shows) painter.fillRect(rect(), background);
    QRect inside = rect();
    if (look_.border) {
        if (look_.sunken)
            qDrawWinPanel(&painter, rect(), palette(), true);
        else
            qDrawPlainRect(&painter, rect(), palette().color(QPalette::WindowText));
        constexpr int border = static_cast<int>(frame::borderTwips / frame::twipsPerPixel);
        inside.adjust(border, border, -border, -border);
    }
    painter.setFont(look_.font);
    painter.setPen(TextColor(background));
    PaintText(painter, inside, look_.text, QStyle::visualAlignment(layoutDirection(), look_.alignment), look_.wrap);
}

LabelPeer::LabelPeer(child::Label& label) : LabelPeer(label, new LabelWidget(label)) {}

LabelPeer::LabelPeer(child::Label& label, LabelWidget* widget) : WidgetPeer(label, widget), label_(label), shown_(widget) {}

LabelPeer::~LabelPeer() {
    if (shown_) shown_->input.Disconnect();
}

void LabelPeer::Update() {
    if (!shown_) return;
    FollowChild();
    static constexpr std::array alignments = {Qt::AlignLeft, Qt::AlignRight, Qt::AlignHCenter};
    const auto alignment = static_cast<std::size_t>(label_.Alignment());
    shown_->Show({.text = ToQt(label_.Caption()),
                  .font = ToQt(*label_.Font()),
                  .alignment = alignment < alignments.size() ? alignments[alignment] : Qt::AlignLeft,
                  .wrap = label_.WordWrap(),
                  .border = label_.BorderStyle() != child::LabelBorderConstants::None,
                  .sunken = label_.Appearance() != child::AppearanceConstants::Flat,
                  .back = label_.BackColor(),
                  .fore = label_.ForeColor(),
                  .system = &label_.Host().Colors()});
}

}  // namespace tessel::qt
