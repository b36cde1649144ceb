#pragma once

#include "frame/Surface.h"
#include "frame/child/PointerChild.h"

namespace tessel::child {

/// A box that is drawn on and that keeps what was drawn: its pixels at scale 1 can be read back with `Point`, and `Image` gives
/// them as a picture. They are those of the screen's canvas where that keeps them, printed text among them; else those of a raster
/// of its own, where text leaves none. Its size is in its owner's twips, its inside in its own scale.
class PictureBox final : public KeyChild, public frame::DrawingSurface {
  public:
    PictureBox(frame::Control& owner, std::string name);

    /// The picture behind what is drawn. A new one, or none, clears the drawing; with `AutoSize` the box takes its size.
    const frame::PictureRef& Picture() const { return Behind(); }
    void SetPicture(const frame::PictureRef& value);
    /// The canvas that keeps what was drawn.
    const frame::Canvas& Drawn() const { return *Kept(); }
    bool AutoSize() const { return autoSize_; }
    void SetAutoSize(bool value);
    /// 0 none, any other number a border of two pixels on each side.
    std::int16_t BorderStyle() const { return borderStyle_; }
    void SetBorderStyle(std::int16_t value);
    std::int16_t MousePointer() const { return mousePointer_; }
    void SetMousePointer(std::int16_t value) { Store(mousePointer_, value); }

    /// From the inside of the border.
    std::pair<float, float> InputPoint(float x, float y) const override;

    const frame::ClassTable& Table() const override;

  protected:
    frame::TextSize InnerSize() const override;
    void LookChanged() override { Changed(); }
    void Moved() override { Resized(); }

  private:
    float Border() const { return borderStyle_ != 0 ? 2 * frame::borderTwips : 0; }
    void FitPicture();

    bool autoSize_ = false;
    std::int16_t borderStyle_ = 1, mousePointer_ = 0;
};

}  // namespace tessel::child
