#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "controls/splitter/BarDrawing.h"
#include "frame/Control.h"

namespace tessel::controls {

namespace splitter {
inline constexpr frame::Event<frame::Variant&, frame::Variant&> AfterMove{
    "AfterMove", 9, {"dx", "dy"}, "Occurs after the splitter has been moved."};
}

/// A bar that the user drags to share the space between the controls on its two sides, which are named in two lists. It has no
/// child: it draws on its own surface, and reaches its siblings by name, afresh at each step of a drag.
///
/// An entry of a list is `Name`, or `Name(Index)` for one of an array of controls. Entries stand between commas; blanks around
/// them and names that nobody has do not matter.
class Splitter final : public frame::Control {
  public:
    explicit Splitter(frame::Host& host);

    /// The least distance from the top or left of the form.
    float MinTopLeft() const { return own.MinTopLeft; }
    void SetMinTopLeft(float value);
    /// The least distance from the bottom or right of the form. It wins where the form is too small for both.
    float MinBottomRight() const { return own.MinBottomRight; }
    void SetMinBottomRight(float value);
    frame::OLE_COLOR BackColor() const { return Surface().BackColor(); }
    void SetBackColor(frame::OLE_COLOR value);
    frame::OLE_COLOR ForeColor() const { return Surface().ForeColor(); }
    void SetForeColor(frame::OLE_COLOR value);
    bool Enabled() const { return Surface().Enabled(); }
    void SetEnabled(bool value);
    void Refresh();
    tsOrientation Orientation() const { return own.Orientation; }
    /// Puts the bar into the middle of the form, at run time too.
    void SetOrientation(tsOrientation value);
    const std::string& ControlsTopLeft() const { return own.ControlsTopLeft; }
    void SetControlsTopLeft(const std::string& value);
    const std::string& ControlsBottomRight() const { return own.ControlsBottomRight; }
    void SetControlsBottomRight(const std::string& value);
    std::int16_t MousePointer() const { return Surface().MousePointer(); }
    void SetMousePointer(std::int16_t value);
    const frame::PictureRef& MouseIcon() const { return Surface().MouseIcon(); }
    void SetMouseIcon(const frame::PictureRef& value);
    tsAppearance Appearance() const { return own.Appearance; }
    void SetAppearance(tsAppearance value);
    frame::OLE_COLOR HighlightColor() const { return own.HighlightColor; }
    void SetHighlightColor(frame::OLE_COLOR value);
    /// 42 while a control is searched for, 0 afterwards. A run-time property.
    const frame::Variant& Ident() const { return own.Ident; }
    void SetIdent(const frame::Variant& value);

    /// Moves the bar as a drag by so many of the form's units does: within the limits, with the controls named and `AfterMove`.
    void MoveBy(float distance);
    /// Where the bar stands along its way, and how far it may go, in the form's units. The far end is not known on a form without a
    /// size.
    float Place() const;
    float NearEnd() const { return own.MinTopLeft; }
    std::optional<float> FarEnd() const;

    void InitProperties() override;
    void Show() override;
    void Paint() override;
    frame::TextSize DesignSize() const override;
    const frame::ClassTable& Table() const override { return table; }
    static const frame::ClassTable table;

  private:
    struct Tables;
    /// The names by which a move along the bar's way reads and sets an object, and a form's length.
    struct Way {
        const char *place, *extent, *formExtent;
    };

    void SurfaceClick();
    void SurfaceDblClick();
    void SurfaceKeyDown(std::int16_t keyCode, std::int16_t shift);
    void SurfaceKeyPress(std::int16_t keyAscii);
    void SurfaceKeyUp(std::int16_t keyCode, std::int16_t shift);
    void SurfaceMouseDown(std::int16_t button, std::int16_t shift, float x, float y);
    void SurfaceMouseMove(std::int16_t button, std::int16_t shift, float x, float y);
    void SurfaceMouseUp(std::int16_t button, std::int16_t shift, float x, float y);

    frame::Object* FormObject() const;
    void PutInTheMiddle();
    frame::Object* FindControl(std::string_view entry);
    bool InActiveArea(float x, float y) const;
    void Hover(float x, float y);
    void DragStep(float x, float y);
    void MoveControls(float dx, float dy);
    void Draw();
    /// Null for an orientation that is none.
    const Way* TheWay() const;
    float OwnThickness() const;
    /// Error 91 without a form.
    float FormExtent(const Way& way) const;

    struct Own {
        frame::Variant Ident = std::int16_t{0};
        frame::OLE_COLOR HighlightColor = 0xC0C000;
        tsAppearance Appearance = tsAppearance::tsGrooved;
        tsOrientation Orientation = tsOrientation::tsHorizontal;
        std::string ControlsTopLeft, ControlsBottomRight;
        float MinTopLeft = 0, MinBottomRight = 0;
        bool dragging = false;  // a mouse button is down on the bar
        float pressX = 0, pressY = 0;
        bool unplaced = false;     // new, and not yet put at its place
        bool highlighted = false;  // shows `HighlightColor`
    };
    Own own;
};

}  // namespace tessel::controls
