#pragma once

#include "frame/PointerTarget.h"
#include "frame/Surface.h"

namespace tessel::frame {

class Control;

/// The surface that a control itself is. It takes the mouse and the keys where no child covers it.
class OwnSurface final : public DrawingSurface, public KeyTarget {
  public:
    explicit OwnSurface(Control& control);

    /// The control's size in twips, held by its site; a set leads to `Resize`. 0 once the host has let go.
    float Width() const;
    void SetWidth(float value);
    float Height() const;
    void SetHeight(float value);

    bool Enabled() const { return enabled_; }
    void SetEnabled(bool value);
    std::int16_t MousePointer() const { return mousePointer_; }
    void SetMousePointer(std::int16_t value);
    const PictureRef& MouseIcon() const { return mouseIcon_; }
    void SetMouseIcon(const PictureRef& value);
    std::int16_t Appearance() const { return appearance_; }
    void SetAppearance(std::int16_t value);
    std::int16_t BorderStyle() const { return borderStyle_; }
    void SetBorderStyle(std::int16_t value);
    const PictureRef& Picture() const { return picture_; }
    void SetPicture(const PictureRef& value);
    /// The control has another size: what the site says.
    void SizeChanged() { Resized(); }
    /// Has the surface drawn anew: the control's `Paint` runs.
    void Refresh();

    frame::Host& InputHost() const override { return SurfaceHost(); }
    TextSize InputExtent() const override { return {Width(), Height()}; }
    /// From the inside of the border, in the surface's own scale.
    std::pair<float, float> InputPoint(float x, float y) const override;

  protected:
    TextSize InnerSize() const override;
    void LookChanged() override;
    bool TakesInput() const override;
    std::string InputPath() const override;

  private:
    float Border() const { return borderStyle_ != 0 ? 2 * borderTwips : 0; }

    Control& control_;
    bool enabled_ = true;
    std::int16_t mousePointer_ = 0, appearance_ = 1, borderStyle_ = 0;
    PictureRef mouseIcon_, picture_;
};

}  // namespace tessel::frame
