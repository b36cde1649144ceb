#pragma once

#include <QFont>
#include <QImage>
#include <QPoint>
#include <QPointer>
#include <QRect>
#include <QWidget>
#include <cstddef>
#include <variant>
#include <vector>

#include "frame/Surface.h"
#include "frame/child/Raster.h"

namespace tessel::qt {

/// What was drawn on a surface, in the pixels of the screen: sharp at any scale.
///
/// The drawing is kept as what was done since it was last wiped, and painted when somebody wants to see it: at the scale of the
/// screen, and at scale 1 for those who read it back. So it is drawn anew, and is sharp, when the scale or the palette changes.
/// Where more was done than `maximumKept` the pixels are kept in its place, and scaled.
class SurfaceCanvas final : public frame::Canvas {
  public:
    /// As large as the inside of its surface.
    explicit SurfaceCanvas(frame::DrawingSurface& surface) : surface_(surface) {}
    /// As large as the inside of the widget that shows it.
    SurfaceCanvas(frame::DrawingSurface& surface, QWidget& shown) : surface_(surface), shown_(&shown), sizedByWidget_(true) {}

    /// The widget that shows the drawing from `corner` on; null for none.
    void ShowOn(QWidget* widget, QPoint corner);

    void Draw(const frame::DrawOp& op, const frame::Pen& pen, const frame::Scale& scale, frame::OLE_COLOR background,
              frame::OLE_COLOR foreground) override;
    void Wipe(frame::OLE_COLOR background, const frame::PictureRef& picture) override;
    void Resize(int width, int height, frame::OLE_COLOR background) override;
    bool KeepsPixels() const override { return true; }
    std::optional<frame::OLE_COLOR> Pixel(int x, int y) const override;
    std::vector<frame::PixelPlane> Planes() const override;

    /// What its widget is to paint, from the corner on; a null image when nothing was drawn since the surface was wiped: then its
    /// background and its picture are all there is. It shares the canvas's pixels, so it is good until something is drawn.
    QImage Image() const;

    /// In bytes, with texts and pictures.
    static constexpr std::size_t maximumKept = std::size_t{4} * 1024 * 1024;

  private:
    /// One operation, with all that it was drawn with. Its colours are those that it was given, so that those of the system follow
    /// the palette.
    struct Stroke {
        frame::DrawOp op;
        frame::Pen pen;
        frame::Scale scale;
        frame::OLE_COLOR foreground;
        QFont font;
    };
    struct Size {
        int width = 0, height = 0;
        friend bool operator==(const Size&, const Size&) = default;
    };
    using Step = std::variant<Stroke, Size>;
    /// The drawing at one scale, up to a step.
    struct Plane {
        double scale = 0;
        child::Raster raster{0, 0, 0};
        std::size_t done = 0;
        bool begun = false;
    };

    void Keep(Step step, std::size_t bytes);
    Size SizeOfWidget() const;
    void TakeSize(Size size);
    double ScreenScale() const;
    frame::OLE_COLOR Rgb(frame::OLE_COLOR color) const;

    Plane& PlaneOf(double scale) const;
    void Begin(Plane& plane) const;
    void BeginFrom(Plane& plane, const Plane& other) const;
    void CatchUp(Plane& plane) const;
    void Do(Plane& plane, const Stroke& stroke) const;
    void Do(Plane& plane, const Size& size) const;
    void Paint(Plane& plane, const frame::Picture& picture, QPointF place) const;
    void Print(Plane& plane, const Stroke& stroke, const frame::draw::Print& print) const;

    QRectF BoundsOf(const Stroke& stroke) const;
    void Damage(const QRectF& bounds);
    void DamageAll();

    frame::DrawingSurface& surface_;
    QPointer<QWidget> shown_;
    bool sizedByWidget_ = false;
    QPoint corner_;

    frame::PictureRef behind_;
    Size sizeAtFirst_, size_;  // when it was wiped, and now
    std::vector<Step> steps_;  // since then
    std::size_t kept_ = 0;     // their bytes
    const frame::Picture* lastPicture_ = nullptr;
    bool cut_ = false;  // steps are missing, which the planes have

    mutable std::vector<Plane> planes_;
    mutable qint64 palette_ = 0;  // with which they were drawn
    mutable QRect damaged_;       // that the widget knows of
};

}  // namespace tessel::qt
