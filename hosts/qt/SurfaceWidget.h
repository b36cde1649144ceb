#pragma once

#include <QCursor>
#include <QWidget>
#include <functional>

#include "frame/Control.h"
#include "hosts/qt/SurfaceCanvas.h"

namespace tessel::qt {

/// The surface of a control: its background, its picture, what it has drawn; its children stand on it.
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
    SurfaceCanvas* canvas = nullptr;  ///< of the control

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;

  private:
    frame::Control* control_ = nullptr;
    QCursor pointer_;
    std::function<void()> needsDrawing_;
    double drawnFor_ = 0;  // the scale of the screen; 0 when the drawing is out of date
};

}  // namespace tessel::qt
