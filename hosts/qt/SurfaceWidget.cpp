#include "hosts/qt/SurfaceWidget.h"

#include <qdrawutil.h>

#include <QEvent>
#include <QGuiApplication>
#include <QPainter>

#include "hosts/qt/Convert.h"
#include "hosts/qt/Cursors.h"

namespace tessel::qt {

SurfaceWidget::SurfaceWidget(QWidget* parent) : QWidget(parent) {
    setObjectName("qt_tessel_surface");
    setMouseTracking(true);
}

void SurfaceWidget::Show(frame::Control* control, std::function<void()> needsDrawing) {
    control_ = control;
    needsDrawing_ = std::move(needsDrawing);
    drawnFor_ = 0;
    if (pointerInput_) pointerInput_->Disconnect();
    if (keyInput_) keyInput_->Disconnect();
    if (control_ && control_->Surface().Listens()) {
        pointerInput_ = std::make_unique<PointerInput>(control_->Surface(), *this);
        keyInput_ = new KeyInput(control_->Surface(), this);
    }
    Follow();
}

void SurfaceWidget::SetPointer(const QCursor& pointer) {
    pointer_ = pointer;
    Follow();
}

void SurfaceWidget::Follow() {
    if (!control_) return;
    const frame::OwnSurface& surface = control_->Surface();
    if (surface.MousePointer() != 0)
        setCursor(CursorOf(surface.MousePointer(), surface.MouseIcon()));
    else
        setCursor(pointer_);
    if (canvas) canvas->ShowOn(this, {Border(), Border()});
    update();
}

int SurfaceWidget::Border() const {
    return control_->Surface().BorderStyle() != 0 ? static_cast<int>(frame::borderTwips / frame::twipsPerPixel) : 0;
}

void SurfaceWidget::DrawAnew() {
    drawnFor_ = 0;
    update();
}

void SurfaceWidget::paintEvent(QPaintEvent*) {
    if (!control_) return;
    if (needsDrawing_ && drawnFor_ != devicePixelRatioF()) {
        drawnFor_ = devicePixelRatioF();
        needsDrawing_();
        if (!control_) return;
    }
    const frame::OwnSurface& surface = control_->Surface();
    QPainter painter(this);
    if (!IsSurroundings(surface.BackColor())) painter.fillRect(rect(), ToQt(surface.BackColor(), control_->Host().Colors()));
    const QPoint corner(Border(), Border());
    if (surface.Picture()) painter.drawImage(corner, ToQt(*surface.Picture(), devicePixelRatioF()));
    if (canvas) painter.drawImage(corner, canvas->Image());
    if (surface.BorderStyle() != 0) {
        if (surface.Appearance() != 0)
            qDrawWinPanel(&painter, rect(), palette(), true);
        else
            qDrawPlainRect(&painter, rect(), palette().color(QPalette::WindowText));
    }
    if (!keyInput_ || !parentWidget() || !parentWidget()->hasFocus()) return;
    constexpr int focusMark = 2;
    qDrawPlainRect(&painter, rect(), palette().color(QPalette::Highlight), focusMark);
}

void SurfaceWidget::resizeEvent(QResizeEvent*) { drawnFor_ = 0; }

void SurfaceWidget::changeEvent(QEvent* event) {
    if (event->type() == QEvent::PaletteChange) drawnFor_ = 0;
    QWidget::changeEvent(event);
}

// Input.

/// Where the event happened on the control. The pointer's place on the screen is the truth: the widget may have moved since the
/// event was made, and stands on whole pixels, where the control stands between them.
QMouseEvent SurfaceWidget::AtTruePlace(const QMouseEvent& event) const {
    QPointF place = mapFromGlobal(event.globalPosition());
    const frame::Site* site = control_ ? control_->Site() : nullptr;
    const QWidget* outer = parentWidget();
    if (site && outer && outer->pos() == QPoint(Pixels(site->Left()), Pixels(site->Top())))
        place += QPointF(outer->x() - PixelsExactly(site->Left()), outer->y() - PixelsExactly(site->Top()));
    return {event.type(),   place,           event.scenePosition(), event.globalPosition(),
            event.button(), event.buttons(), event.modifiers(),     event.pointingDevice()};
}

void SurfaceWidget::mousePressEvent(QMouseEvent* event) {
    if (!pointerInput_) return QWidget::mousePressEvent(event);
    pointerInput_->Press(AtTruePlace(*event));
}

void SurfaceWidget::mouseMoveEvent(QMouseEvent* event) {
    if (!pointerInput_) return QWidget::mouseMoveEvent(event);
    pointerInput_->Move(AtTruePlace(*event));
}

void SurfaceWidget::mouseReleaseEvent(QMouseEvent* event) {
    if (!pointerInput_) return QWidget::mouseReleaseEvent(event);
    pointerInput_->Release(AtTruePlace(*event));
}

void SurfaceWidget::mouseDoubleClickEvent(QMouseEvent* event) {
    if (!pointerInput_) return QWidget::mouseDoubleClickEvent(event);
    pointerInput_->DoubleClick(AtTruePlace(*event));
}

void SurfaceWidget::leaveEvent(QEvent* event) {
    if (!pointerInput_) return QWidget::leaveEvent(event);
    // A box that opens in the middle of a drag is no leaving.
    if (QGuiApplication::mouseButtons() == Qt::NoButton) pointerInput_->Leave();
}

void SurfaceWidget::ReportKey(const QKeyEvent& event) {
    if (keyInput_) keyInput_->Press(event);
}

}  // namespace tessel::qt
