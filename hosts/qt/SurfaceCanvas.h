#pragma once

#include <QImage>
#include <QWidget>

#include "frame/Surface.h"
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

}  // namespace tessel::qt
