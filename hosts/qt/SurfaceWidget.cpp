#include "hosts/qt/SurfaceWidget.h"

#include <qdrawutil.h>

#include <QEvent>
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
    if (surface.Picture()) painter.drawImage(QPoint(), ToQt(*surface.Picture(), devicePixelRatioF()));
    if (canvas) painter.drawImage(QPoint(), canvas->Image());
    if (surface.BorderStyle() == 0) return;
    if (surface.Appearance() != 0)
        qDrawWinPanel(&painter, rect(), palette(), true);
    else
        qDrawPlainRect(&painter, rect(), palette().color(QPalette::WindowText));
}

void SurfaceWidget::resizeEvent(QResizeEvent*) { drawnFor_ = 0; }

void SurfaceWidget::changeEvent(QEvent* event) {
    if (event->type() == QEvent::PaletteChange) drawnFor_ = 0;
    QWidget::changeEvent(event);
}

}  // namespace tessel::qt
