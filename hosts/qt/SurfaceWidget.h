#pragma once

#include <QCursor>
#include <QWidget>
#include <functional>
#include <memory>
#include <vector>

#include "frame/Control.h"
#include "frame/Drawing.h"
#include "frame/child/Raster.h"

namespace tessel::qt {

/// What a control draws on its own surface, in the pixels of the screen: sharp at any scale. The drawing persists until it is
/// cleared, and is begun anew when the screen's scale changes.
class SurfaceCanvas final : public frame::Canvas {
  public:
    SurfaceCanvas(frame::DrawingSurface& surface, QWidget& shown) : surface_(surface), shown_(shown) {}

    void Draw(const frame::DrawOp& op, const frame::Pen& pen, const frame::Scale& scale, frame::OLE_COLOR background,
              frame::OLE_COLOR foreground) override;
    /// What was drawn; a null image when nothing was.
    QImage Image() const;

  private:
    void FitScreen(frame::OLE_COLOR background);
    void Print(const frame::draw::Print& op, const frame::Scale& scale, frame::OLE_COLOR foreground);
    void Paint(const frame::draw::PaintPicture& op, const frame::Scale& scale);
    template <class F>
    void WithPainter(F&& paint);

    frame::DrawingSurface& surface_;
    QWidget& shown_;
    child::Raster raster_{0, 0, 0};
    double ratio_ = 0;  // of the pixels to those at scale 1
};

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
