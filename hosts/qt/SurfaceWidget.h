#pragma once

#include <QCursor>
#include <QWidget>
#include <functional>
#include <memory>

#include "frame/Control.h"
#include "hosts/qt/KeyInput.h"
#include "hosts/qt/PointerInput.h"
#include "hosts/qt/SurfaceCanvas.h"

namespace tessel::qt {

/// The surface of a control: its background, its picture, what it has drawn; its children stand on it. Mouse and keys go to the
/// control where it listens to them on its own surface: the places are then measured from where the control stands to the fraction
/// of a pixel, and from where it stands by now, so that a control which moves under the pointer neither lags nor trembles.
class SurfaceWidget final : public QWidget {
  public:
    explicit SurfaceWidget(QWidget* parent);

    /// The control whose surface is shown; null for none, when its site is no longer in its host. `needsDrawing` is called before
    /// the surface is painted first, and again when it has another size or other colours: what was drawn persists until then.
    void Show(frame::Control* control, std::function<void()> needsDrawing = {});
    /// The pointer over the surface where the control asks for none of its own.
    void SetPointer(const QCursor& pointer);
    /// Follows the look of the surface.
    void Follow();
    /// Reports a key that the control's widget got, to a control that listens.
    void ReportKey(const QKeyEvent& event);
    /// Has the surface drawn anew before it is next painted.
    void DrawAnew();
    SurfaceCanvas* canvas = nullptr;  ///< of the control

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void leaveEvent(QEvent* event) override;

  private:
    int Border() const;  // in pixels; there must be a control
    QMouseEvent AtTruePlace(const QMouseEvent& event) const;

    frame::Control* control_ = nullptr;
    std::unique_ptr<PointerInput> pointerInput_;  // none for a control that does not listen
    KeyInput* keyInput_ = nullptr;
    QCursor pointer_;
    std::function<void()> needsDrawing_;
    double drawnFor_ = 0;  // the scale of the screen; 0 when the drawing is out of date
};

}  // namespace tessel::qt
