#include "hosts/qt/PictureBoxPeer.h"

#include <QFocusEvent>
#include <QKeyEvent>
#include <QPaintEvent>
#include <QPainter>
#include <QStyle>
#include <QStyleOptionFocusRect>

#include "hosts/qt/Convert.h"
#include "hosts/qt/Cursors.h"
#include "hosts/qt/KeyInput.h"
#include "hosts/qt/PointerInput.h"
#include "hosts/qt/SurfaceCanvas.h"

namespace tessel::qt {

namespace {

constexpr int borderPixels = static_cast<int>(frame::borderTwips / frame::twipsPerPixel);

/// The light of a sunken border comes from the top left: the outer ring and the inner one, darker there and lighter below, on a
/// dark ground as on a light one.
void PaintSunkenBorder(QPainter& painter, const QRect& place, const QColor& ground) {
    const auto ring = [&](const QRect& outline, const QColor& topLeft, const QColor& bottomRight) {
        painter.fillRect(outline.left(), outline.top(), outline.width(), 1, topLeft);
        painter.fillRect(outline.left(), outline.top(), 1, outline.height(), topLeft);
        painter.fillRect(outline.left(), outline.bottom(), outline.width(), 1, bottomRight);
        painter.fillRect(outline.right(), outline.top(), 1, outline.height(), bottomRight);
    };
    const auto mixed = [&](const QColor& other, float share) {
        const auto part = [share](float a, float b) { return a + (b - a) * share; };
        return QColor::fromRgbF(part(ground.redF(), other.redF()), part(ground.greenF(), other.greenF()),
                                part(ground.blueF(), other.blueF()));
    };
    ring(place, mixed(Qt::black, 0.4f), mixed(Qt::white, 0.6f));
    ring(place.adjusted(1, 1, -1, -1), mixed(Qt::black, 0.65f), mixed(Qt::white, 0.2f));
}

}  // namespace

/// Paints what was drawn on its box, and reports the mouse and the keys.
class PictureBoxWidget final : public QWidget {
  public:
    explicit PictureBoxWidget(child::PictureBox& box) : box_(&box), pointer_(box, *this), keys_(new KeyInput(box, this)) {
        setMouseTracking(true);
        setFocusPolicy(Qt::StrongFocus);
        setAttribute(Qt::WA_OpaquePaintEvent);
    }

    /// The box goes: nothing is asked or reported from now on.
    void Disconnect() {
        box_ = nullptr;
        pointer_.Disconnect();
        keys_->Disconnect();
    }
    void Follow();

  protected:
    void paintEvent(QPaintEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override { pointer_.Press(*event); }
    void mouseMoveEvent(QMouseEvent* event) override { pointer_.Move(*event); }
    void mouseReleaseEvent(QMouseEvent* event) override { pointer_.Release(*event); }
    void mouseDoubleClickEvent(QMouseEvent* event) override { pointer_.DoubleClick(*event); }
    void leaveEvent(QEvent*) override { pointer_.Leave(); }
    void keyPressEvent(QKeyEvent* event) override {
        keys_->Press(*event);
        QWidget::keyPressEvent(event);
    }
    void focusInEvent(QFocusEvent* event) override {
        const auto reason = event->reason();
        focusShows_ = reason == Qt::TabFocusReason || reason == Qt::BacktabFocusReason || reason == Qt::ShortcutFocusReason;
        QWidget::focusInEvent(event);
    }

  private:
    int Border() const { return box_->BorderStyle() != 0 ? borderPixels : 0; }
    /// Of this host; null on one that was given other canvases.
    SurfaceCanvas* Canvas() const { return dynamic_cast<SurfaceCanvas*>(const_cast<frame::Canvas*>(&box_->Drawn())); }

    child::PictureBox* box_;  // null once it has gone
    PointerInput pointer_;
    KeyInput* keys_;
    bool focusShows_ = false;
};

void PictureBoxWidget::Follow() {
    if (!box_) return;
    if (SurfaceCanvas* canvas = Canvas()) canvas->ShowOn(this, {Border(), Border()});
    if (box_->MousePointer() != 0)
        setCursor(CursorOf(box_->MousePointer()));
    else if (testAttribute(Qt::WA_SetCursor))
        unsetCursor();
    update();
}

void PictureBoxWidget::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    const QColor ground = palette().color(QPalette::Window);
    if (!box_) return painter.fillRect(rect(), ground);
    const QRect inside = rect().adjusted(Border(), Border(), -Border(), -Border());
    if (Border() != 0) PaintSunkenBorder(painter, rect(), ground);
    painter.setClipRect(inside, Qt::IntersectClip);
    const SurfaceCanvas* canvas = Canvas();
    const QImage drawn = canvas ? canvas->Image() : QImage();
    if (drawn.isNull() || drawn.deviceIndependentSize().toSize() != inside.size())
        painter.fillRect(inside, ToQt(box_->BackColor(), box_->Colors()));
    if (!drawn.isNull())
        painter.drawImage(inside.topLeft(), drawn);
    else if (box_->Picture())
        painter.drawImage(inside.topLeft(), ToQt(*box_->Picture(), devicePixelRatioF()));
    if (!hasFocus() || !focusShows_) return;
    QStyleOptionFocusRect option;
    option.initFrom(this);
    option.rect = inside;
    option.backgroundColor = ToQt(box_->BackColor(), box_->Colors());
    style()->drawPrimitive(QStyle::PE_FrameFocusRect, &option, &painter, this);
}

PictureBoxPeer::PictureBoxPeer(child::PictureBox& box) : PictureBoxPeer(box, new PictureBoxWidget(box)) {}

PictureBoxPeer::PictureBoxPeer(child::PictureBox& box, PictureBoxWidget* widget) : WidgetPeer(box, widget), shown_(widget) {}

PictureBoxPeer::~PictureBoxPeer() {
    if (shown_) shown_->Disconnect();
}

void PictureBoxPeer::Update() {
    if (!shown_) return;
    FollowChild();
    shown_->Follow();
}

}  // namespace tessel::qt
