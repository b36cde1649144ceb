#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "frame/Drawing.h"
#include "frame/Member.h"
#include "frame/host.h"

namespace tessel::frame {

/// The units of a surface.
enum class ScaleModeConstants : std::int16_t {
    User = 0,
    Twips = 1,
    Points = 2,
    Pixels = 3,
    Characters = 4,
    Inches = 5,
    Millimetres = 6,
    Centimetres = 7
};

inline constexpr float twipsPerPixel = 15;

/// Something that can be drawn on: a control's own surface, a picture box, a form. Operations are given in the surface's scale,
/// go to every canvas that the host has added, and leave `CurrentX` and `CurrentY` where they end.
class DrawingSurface {
  public:
    explicit DrawingSurface(Host& host);
    virtual ~DrawingSurface() = default;

    // Operations.
    /// Clears what was drawn and sets `CurrentX` and `CurrentY` to the origin.
    void Cls();
    /// A line, or with `box` the box between the two corners; in `ForeColor` when no colour is given.
    void Line(float x1, float y1, float x2, float y2, std::optional<OLE_COLOR> color = {}, draw::Box box = draw::Box::None);
    /// The same by name: the flags are "", "B" (box) or "BF" (filled box), in any case; error 5 for others.
    void LineWithFlags(float x1, float y1, float x2, float y2, std::optional<OLE_COLOR> color, std::optional<std::string> flags);
    /// See `draw::Circle`. `CurrentX` and `CurrentY` become the centre.
    void Circle(float x, float y, float radius, std::optional<OLE_COLOR> color = {}, std::optional<float> start = {},
                std::optional<float> end = {}, std::optional<float> aspect = {});
    void PSet(float x, float y, std::optional<OLE_COLOR> color = {});
    /// RGB of the pixel at a point; -1 outside the surface and where nothing keeps pixels.
    std::int32_t Point(float x, float y) const;
    /// Prints a text at the current position and goes to the start of the next line.
    void Print(const std::string& text);
    /// Paints a picture at its natural size.
    void PaintPicture(const PictureRef& picture, float x, float y);

    /// The place in the surface's units of a place in twips from the corner of its inside.
    TextSize UnitsAt(float xTwips, float yTwips) const;
    float TextWidth(const std::string& text) const;
    float TextHeight(const std::string& text) const;

    // State.
    float CurrentX() const { return currentX_; }
    void SetCurrentX(float value) { currentX_ = value; }
    float CurrentY() const { return currentY_; }
    void SetCurrentY(float value) { currentY_ = value; }
    /// In pixels, at least 1: error 380 below.
    std::int16_t DrawWidth() const { return static_cast<std::int16_t>(pen_.width); }
    void SetDrawWidth(std::int16_t value);
    /// 0 (solid) to 6: error 380 outside.
    std::int16_t DrawStyle() const { return static_cast<std::int16_t>(pen_.style); }
    void SetDrawStyle(std::int16_t value);
    /// 1 to 16, 13 being the copy pen and 7 the XOR pen: error 380 outside.
    std::int16_t DrawMode() const { return static_cast<std::int16_t>(pen_.mode); }
    void SetDrawMode(std::int16_t value);
    /// A new scale takes the current position along. Error 380 outside 0 to 7.
    ScaleModeConstants ScaleMode() const { return scaleMode_; }
    void SetScaleMode(ScaleModeConstants value);
    // The inner size and the origin in the surface's own units. A set makes the scale a user's own (`ScaleMode` 0).
    float ScaleLeft() const { return scaleLeft_; }
    void SetScaleLeft(float value);
    float ScaleTop() const { return scaleTop_; }
    void SetScaleTop(float value);
    virtual float ScaleWidth() const;
    virtual void SetScaleWidth(float value);
    virtual float ScaleHeight() const;
    virtual void SetScaleHeight(float value);

    OLE_COLOR BackColor() const { return backColor_; }
    void SetBackColor(OLE_COLOR value);
    OLE_COLOR ForeColor() const { return foreColor_; }
    void SetForeColor(OLE_COLOR value);
    /// Never null: a set to null gives a font of the default name and size.
    const FontRef& Font() const { return font_.Get(); }
    void SetFont(const FontRef& value);

    /// What the surface shows, as a picture of its own; an empty one where no canvas keeps pixels.
    PictureRef Image() const;

    /// Those behind the system colours that it is drawn in.
    const SystemColors& Colors() const { return host_.Colors(); }

    /// A canvas that gets every operation from now on, after it has been told the size and the background. It must be there until
    /// it is removed.
    void AddCanvas(Canvas& canvas);
    void RemoveCanvas(Canvas& canvas) { std::erase(canvases_, &canvas); }
    /// The same for a canvas that lives as long as the surface; null is none.
    void AddCanvas(std::unique_ptr<Canvas> canvas);

  protected:
    /// The inner size in twips.
    virtual TextSize InnerSize() const = 0;
    /// The canvas whose pixels are read back: the first one that keeps them; null for none.
    const Canvas* Kept() const;
    /// The surface has this picture behind the drawing from now on, or none; what was drawn is wiped.
    void Wipe(const PictureRef& picture);
    /// The picture behind the drawing.
    const PictureRef& Behind() const { return behind_; }
    /// Tells every canvas the inner size.
    void Resized();
    /// Something of the surface's look has changed.
    virtual void LookChanged() {}
    /// How this surface's units become pixels at scale 1.
    Scale PixelScale() const;

    /// How many twips a unit of the present scale has.
    TextSize TwipsPerUnit() const;

    Host& SurfaceHost() const { return host_; }

  private:
    void Emit(const DrawOp& op);
    void TellSize(Canvas& canvas) const;
    OLE_COLOR Background() const { return OleTranslateColor(backColor_, host_.Colors()); }

    Host& host_;
    std::vector<Canvas*> canvases_;
    std::vector<std::unique_ptr<Canvas>> ownCanvases_;
    Pen pen_;
    ScaleModeConstants scaleMode_ = ScaleModeConstants::Twips;
    float scaleLeft_ = 0, scaleTop_ = 0, userWidth_ = 0, userHeight_ = 0;
    float currentX_ = 0, currentY_ = 0;
    OLE_COLOR backColor_ = colors::buttonFace;
    OLE_COLOR foreColor_ = colors::buttonText;
    PictureRef behind_;
    FontHolder font_{[this] { LookChanged(); }};
};

/// Two pixels on each side where a border is drawn.
inline constexpr float borderTwips = 2 * twipsPerPixel;

/// The rows of the drawing members by name, as surfaces of unknown class are drawn on.
inline constexpr std::array drawingMembers = {
    method<&DrawingSurface::Cls>("Cls", "Clears what was drawn."),
    method<&DrawingSurface::LineWithFlags>("Line", "Draws a line, or a box with the flags B or BF.",
                                           {"X1", "Y1", "X2", "Y2", "Color", "Flags"}),
    method<&DrawingSurface::Circle>("Circle", "Draws a circle, an ellipse or an arc.",
                                    {"X", "Y", "Radius", "Color", "Start", "End", "Aspect"}),
    method<&DrawingSurface::PSet>("PSet", "Sets a point.", {"X", "Y", "Color"}),
    method<&DrawingSurface::Point>("Point", "The colour of a point; -1 outside.", {"X", "Y"}),
    method<&DrawingSurface::Print>("Print", "Prints a text at the current position.", {"Text"}),
    method<&DrawingSurface::PaintPicture>("PaintPicture", "Paints a picture at its natural size.", {"Picture", "X", "Y"}),
    method<&DrawingSurface::TextWidth>("TextWidth", "The width of a text.", {"Text"}),
    method<&DrawingSurface::TextHeight>("TextHeight", "The height of a text.", {"Text"}),
    property<&DrawingSurface::CurrentX, &DrawingSurface::SetCurrentX>("CurrentX", "The current position."),
    property<&DrawingSurface::CurrentY, &DrawingSurface::SetCurrentY>("CurrentY", "The current position."),
    property<&DrawingSurface::DrawWidth, &DrawingSurface::SetDrawWidth>("DrawWidth", "The pen's width in pixels."),
    property<&DrawingSurface::DrawStyle, &DrawingSurface::SetDrawStyle>("DrawStyle", "The pen's style; 0 is solid."),
    property<&DrawingSurface::DrawMode, &DrawingSurface::SetDrawMode>("DrawMode", "The pen's mode: 13 copies, 7 is XOR."),
    property<&DrawingSurface::ScaleMode, &DrawingSurface::SetScaleMode>("ScaleMode", "The unit of the surface's scale."),
    property<&DrawingSurface::ScaleLeft, &DrawingSurface::SetScaleLeft>("ScaleLeft", "The coordinate of the left edge."),
    property<&DrawingSurface::ScaleTop, &DrawingSurface::SetScaleTop>("ScaleTop", "The coordinate of the top edge."),
    property<&DrawingSurface::ScaleWidth, &DrawingSurface::SetScaleWidth>("ScaleWidth", "The inner width in the surface's scale."),
    property<&DrawingSurface::ScaleHeight, &DrawingSurface::SetScaleHeight>("ScaleHeight",
                                                                            "The inner height in the surface's scale."),
    property<&DrawingSurface::BackColor, &DrawingSurface::SetBackColor>("BackColor", "The background colour."),
    property<&DrawingSurface::ForeColor, &DrawingSurface::SetForeColor>("ForeColor",
                                                                        "The colour of text and of lines without one."),
    property<&DrawingSurface::Font, &DrawingSurface::SetFont>("Font", "The font of printed text."),
};

}  // namespace tessel::frame
