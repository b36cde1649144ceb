#pragma once

#include "frame/Control.h"
#include "frame/child/Label.h"

namespace tessel::controls {

/// What a press of the mouse does. Any other number does nothing.
enum class ClickActionConstants : std::int16_t { Do_nothing = 0, Open_Link = 1, Print_Link = 2 };

/// A hyperlink label: a text that changes colour while the mouse rests on it, remembers that it was used, and on a press of
/// the mouse opens or prints what it names: a file, a web address or an e-mail address.
class Link final : public frame::Control {
  public:
    explicit Link(frame::Host& host);

    // Text and look, held by `Label1`.
    frame::OLE_COLOR BackColor() const { return Label1.BackColor(); }
    void SetBackColor(frame::OLE_COLOR value);
    bool Enabled() const { return Label1.Enabled(); }
    void SetEnabled(bool value);
    const frame::FontRef& Font() const { return Label1.Font(); }
    void SetFont(const frame::FontRef& value);
    child::LabelBorderConstants BorderStyle() const { return Label1.BorderStyle(); }
    void SetBorderStyle(child::LabelBorderConstants value);
    child::AlignmentConstants Alignment() const { return Label1.Alignment(); }
    void SetAlignment(child::AlignmentConstants value);
    child::AppearanceConstants Appearance() const { return Label1.Appearance(); }
    /// Shows `ForeColor` again, whether the link was used or not: a new appearance resets the label's colours.
    void SetAppearance(child::AppearanceConstants value);
    bool AutoSize() const { return Label1.AutoSize(); }
    void SetAutoSize(bool value);
    const std::string& Caption() const { return Label1.Caption(); }
    /// The control takes the size of its label, whether that sizes itself or not.
    void SetCaption(const std::string& value);
    bool WordWrap() const { return Label1.WordWrap(); }
    void SetWordWrap(bool value);

    /// The colour of the text while the mouse is in the active area. A new one shows at the next hover.
    frame::OLE_COLOR HighlightColor() const { return own.HighlightColor; }
    void SetHighlightColor(frame::OLE_COLOR value);
    /// The colour of the text of a link that has been used. A new one shows at the next hover.
    frame::OLE_COLOR UsedColor() const { return own.UsedColor; }
    void SetUsedColor(frame::OLE_COLOR value);
    /// What to open or print: a file name, a web address or an e-mail address.
    const std::string& LinkTo() const { return own.LinkTo; }
    void SetLinkTo(const std::string& value);
    /// The colour of the text that has not yet been used. Shows at once, whatever the hover state.
    frame::OLE_COLOR ForeColor() const { return own.ForeColor; }
    void SetForeColor(frame::OLE_COLOR value);
    /// Width of the strip along the four edges, in twips, that counts as off the link: by it the control senses the mouse
    /// leaving. 0 leaves no strip, and then a hovered link stays highlighted.
    float BorderSize() const { return own.BorderSize; }
    void SetBorderSize(float value);
    bool SuppressMessages() const { return own.SuppressMessages; }
    void SetSuppressMessages(bool value);
    ClickActionConstants ClickAction() const { return own.ClickAction; }
    void SetClickAction(ClickActionConstants value);

    /// Repaints the text and copies the host's tool tip to it.
    void Refresh();
    /// Opens `MyLinkTo`, or `LinkTo` when it is missing; nothing for an empty target. Gives the empty string, or the message of
    /// the failure, which has also been shown unless `SuppressMessages` is set.
    std::string OpenLink(const std::optional<frame::Variant>& MyLinkTo = {});
    /// The same for printing.
    std::string PrintLink(const std::optional<frame::Variant>& MyLinkTo = {});

    void ReadProperties(const frame::PropertyBag& bag) override;
    void Resize() override;
    void Show() override;
    frame::TextSize DesignSize() const override;
    const frame::ClassTable& Table() const override { return table; }
    static const frame::ClassTable table;

    child::Label Label1{*this, "Label1"};

  private:
    struct Tables;

    enum class Verb : std::uint8_t { Open, Print };

    void LabelMouseDown(std::int16_t button, std::int16_t shift, float x, float y);
    void LabelMouseMove(std::int16_t button, std::int16_t shift, float x, float y);
    void LabelMouseUp(std::int16_t button, std::int16_t shift, float x, float y);
    void LabelClick();
    void LabelDblClick();
    void LabelChange();

    bool InActiveArea(float x, float y) const;
    void RunClickAction();
    std::string RunShell(const std::string& target, Verb verb);
    void CopyToolTip();

    struct Own {
        ClickActionConstants ClickAction = ClickActionConstants::Open_Link;
        bool SuppressMessages = false;
        float BorderSize = 30;
        frame::OLE_COLOR ForeColor = 0xC00000;
        frame::OLE_COLOR HighlightColor = 0x0000C0;
        frame::OLE_COLOR UsedColor = 0x800080;
        std::string LinkTo;
        bool used = false;    // for the life of the object, never saved
        bool sizing = false;  // the control is following its label: Resize stands still
    };
    Own own;
};

}  // namespace tessel::controls

namespace tessel::controls::names {
inline constexpr frame::Enumeration::Constant clickAction[] = {{"Do_nothing", 0}, {"Open_Link", 1}, {"Print_Link", 2}};
inline constexpr frame::Enumeration clickActionConstants{"ClickActionConstants", clickAction};
}  // namespace tessel::controls::names

template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::ClickActionConstants> =
    &tessel::controls::names::clickActionConstants;
