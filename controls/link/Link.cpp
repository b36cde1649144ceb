#include "controls/link/Link.h"

#include "frame/ResumeNext.h"
#include "frame/Text.h"

namespace tessel::controls {

using child::Label;
using frame::OLE_COLOR;
using frame::Variant;
using frame::VarType;

namespace {
constexpr frame::TextSize designSize{1215, 255};
}

Link::Link(frame::Host& host) : Control(host) {
    Label1.Move(0, 0, designSize.width, designSize.height);
    Label1.SetCaption("Label1");
    Label1.SetForeColor(own.ForeColor);
    Label1.MouseDown.To<&Link::LabelMouseDown>(*this);
    Label1.MouseMove.To<&Link::LabelMouseMove>(*this);
    Label1.MouseUp.To<&Link::LabelMouseUp>(*this);
    Label1.Click.To<&Link::LabelClick>(*this);
    Label1.DblClick.To<&Link::LabelDblClick>(*this);
    Label1.Change.To<&Link::LabelChange>(*this);
}

void Link::SetBackColor(OLE_COLOR value) {
    Label1.SetBackColor(value);
    PropertyChanged("BackColor");
}

void Link::SetEnabled(bool value) {
    Label1.SetEnabled(value);
    PropertyChanged("Enabled");
}

void Link::SetFont(const frame::FontRef& value) {
    Label1.SetFont(value);
    PropertyChanged("Font");
}

void Link::SetBorderStyle(child::LabelBorderConstants value) {
    Label1.SetBorderStyle(value);
    PropertyChanged("BorderStyle");
}

void Link::SetAlignment(child::AlignmentConstants value) {
    Label1.SetAlignment(value);
    PropertyChanged("Alignment");
}

void Link::SetAppearance(child::AppearanceConstants value) {
    Label1.SetAppearance(value);
    PropertyChanged("Appearance");
    Label1.SetForeColor(own.ForeColor);
}

void Link::SetAutoSize(bool value) {
    Label1.SetAutoSize(value);
    PropertyChanged("AutoSize");
}

void Link::SetCaption(const std::string& value) {
    Label1.SetCaption(value);
    PropertyChanged("Caption");
}

void Link::SetWordWrap(bool value) {
    Label1.SetWordWrap(value);
    PropertyChanged("WordWrap");
}

void Link::SetHighlightColor(OLE_COLOR value) {
    own.HighlightColor = value;
    PropertyChanged("HighlightColor");
}

void Link::SetUsedColor(OLE_COLOR value) {
    own.UsedColor = value;
    PropertyChanged("UsedColor");
}

void Link::SetLinkTo(const std::string& value) {
    own.LinkTo = value;
    PropertyChanged("LinkTo");
}

void Link::SetForeColor(OLE_COLOR value) {
    own.ForeColor = value;
    PropertyChanged("Forecolor");  // spelled as its key in saved designs
    Label1.SetForeColor(own.ForeColor);
}

void Link::SetBorderSize(float value) {
    own.BorderSize = value;
    PropertyChanged("BorderSize");
}

void Link::SetSuppressMessages(bool value) {
    own.SuppressMessages = value;
    PropertyChanged("SuppressMessages");
}

void Link::SetClickAction(ClickActionConstants value) {
    own.ClickAction = value;
    PropertyChanged("ClickAction");
}

void Link::Refresh() {
    Label1.Refresh();
    CopyToolTip();
}

std::string Link::OpenLink(const std::optional<Variant>& MyLinkTo) {
    return RunShell(MyLinkTo ? MyLinkTo->ToText() : own.LinkTo, Verb::Open);
}

std::string Link::PrintLink(const std::optional<Variant>& MyLinkTo) {
    return RunShell(MyLinkTo ? MyLinkTo->ToText() : own.LinkTo, Verb::Print);
}

void Link::ReadProperties(const frame::PropertyBag& bag) {
    Control::ReadProperties(bag);
    Label1.SetForeColor(own.ForeColor);
}

void Link::Resize() {
    if (own.sizing) return;
    Label1.SetLeft(0);
    Label1.SetTop(0);
    Label1.SetWidth(Surface().ScaleWidth());
    Label1.SetHeight(Surface().ScaleHeight());
}

void Link::Show() {
    if (UserMode()) CopyToolTip();
}

frame::TextSize Link::DesignSize() const { return designSize; }

void Link::LabelMouseDown(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseDown, button, shift, x, y);
    if (InActiveArea(x, y)) own.used = true;
    RunClickAction();
}

void Link::LabelMouseMove(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseMove, button, shift, x, y);
    if (InActiveArea(x, y))
        Label1.SetForeColor(own.HighlightColor);
    else if (own.used)
        Label1.SetForeColor(own.UsedColor);
    else
        Label1.SetForeColor(own.ForeColor);
}

void Link::LabelMouseUp(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseUp, button, shift, x, y);
}

void Link::LabelClick() { ForwardEvent(frame::stock::Click); }

void Link::LabelDblClick() { ForwardEvent(frame::stock::DblClick); }

// Makes no test of AutoSize: the control always follows its label.
void Link::LabelChange() {
    own.sizing = true;
    Surface().SetWidth(Label1.Width());
    Surface().SetHeight(Label1.Height());
    own.sizing = false;
}

bool Link::InActiveArea(float x, float y) const {
    const double border = own.BorderSize;
    const bool offLeft = x < border;
    const bool offRight = x > double{Label1.Width()} - border;
    const bool offTop = y < border;
    const bool offBottom = y > double{Label1.Height()} - border;
    return !(offLeft || offRight || offTop || offBottom);
}

void Link::RunClickAction() {
    const std::string target = own.LinkTo.empty() ? Label1.Caption() : own.LinkTo;
    if (own.ClickAction == ClickActionConstants::Open_Link)
        RunShell(target, Verb::Open);
    else if (own.ClickAction == ClickActionConstants::Print_Link)
        RunShell(target, Verb::Print);
}

std::string Link::RunShell(const std::string& target, Verb verb) {
    constexpr int greatestFailure = 32;
    if (target.empty()) return {};
    const int code = Host().Execute(verb == Verb::Print ? "print" : "open", target);
    if (code > greatestFailure) return {};
    std::string message = [&] {
        switch (code) {
            case 31:
                return "No application associated with file";
            case 2:
            case 3:
                return "Unable to find file";
            default:
                return verb == Verb::Print ? "Unable to print file" : "Unable to view file";
        }
    }();
    if (!own.SuppressMessages) Host().MsgBox("Error " + frame::Decimal(code) + ": " + message + " '" + target + "'");
    return message;
}

// The label covers the control, so that the host's tool tip would never appear. Not every host has one.
void Link::CopyToolTip() {
    frame::ResumeNext next;
    next([&] { Label1.SetToolTipText(Extender().Get("ToolTipText").ToText()); });
}

struct Link::Tables {
    static constexpr std::array members = {
        frame::property<&Link::BackColor, &Link::SetBackColor>(
            "BackColor", "Returns/sets the background color used to display text and graphics in an object."),
        frame::property<&Link::Enabled, &Link::SetEnabled>(
            "Enabled", "Returns/sets a value that determines whether an object can respond to user-generated events.",
            frame::dispatch::enabled),
        frame::property<&Link::Font, &Link::SetFont>("Font", "Returns a Font object.", frame::dispatch::font),
        frame::property<&Link::BorderStyle, &Link::SetBorderStyle>("BorderStyle", "Returns/sets the border style for an object.",
                                                                   frame::dispatch::borderStyle),
        frame::method<&Link::Refresh>("Refresh", "Forces a complete repaint of a object.", {}, frame::dispatch::refresh),
        frame::property<&Link::Alignment, &Link::SetAlignment>("Alignment", "Returns/sets the alignment of the text."),
        frame::property<&Link::Appearance, &Link::SetAppearance>(
            "Appearance", "Returns/sets whether or not an object is painted with 3-D effects.", frame::dispatch::appearance),
        frame::property<&Link::AutoSize, &Link::SetAutoSize>("AutoSize", "Determines whether the control is as large as its text.",
                                                             frame::dispatch::autoSize),
        frame::property<&Link::Caption, &Link::SetCaption>("Caption", "Returns/sets the text displayed in the control.",
                                                           frame::dispatch::caption),
        frame::property<&Link::WordWrap, &Link::SetWordWrap>("WordWrap", "Determines whether long lines go on in the next line."),
        frame::property<&Link::HighlightColor, &Link::SetHighlightColor>("HighlightColor", "Color set when hovered over"),
        frame::property<&Link::UsedColor, &Link::SetUsedColor>("UsedColor", "Color used when link has been used"),
        frame::property<&Link::LinkTo, &Link::SetLinkTo>("LinkTo", "String to link to - could be a filename, URL or email address"),
        frame::property<&Link::ForeColor, &Link::SetForeColor>("ForeColor",
                                                               "The color of the font text that has not yet been used (clicked)."),
        frame::property<&Link::BorderSize, &Link::SetBorderSize>(
            "BorderSize",
            "Defines the size of the border around the control.  This senses the mouse moving off the control and hence defines "
            "the active area of the control."),
        frame::property<&Link::SuppressMessages, &Link::SetSuppressMessages>(
            "SuppressMessages", "Suppress error messages from open and print  actions"),
        frame::method<&Link::OpenLink>("OpenLink", "Open the item in LinkTo", {"MyLinkTo"}),
        frame::method<&Link::PrintLink>("PrintLink", "Open the item in LinkTo", {"MyLinkTo"}),
        frame::property<&Link::ClickAction, &Link::SetClickAction>("ClickAction", "The action to take when the control is clicked"),
    };
    // The key events are declared for the interface's sake: a label takes no keys.
    static constexpr std::array<const frame::EventInfo*, 8> events = {
        &frame::stock::Click, &frame::stock::DblClick,  &frame::stock::KeyDown,   &frame::stock::KeyPress,
        &frame::stock::KeyUp, &frame::stock::MouseDown, &frame::stock::MouseMove, &frame::stock::MouseUp,
    };
    static constexpr std::array kept = {
        frame::childKey<&Link::Label1, &Label::BackColor, &Label::SetBackColor>("BackColor", VarType::Long, 0x8000000F),
        frame::childKey<&Link::Label1, &Label::Enabled, &Label::SetEnabled>("Enabled", VarType::Boolean, true),
        frame::childKey<&Link::Label1, &Label::Font, &Label::SetFont>("Font", frame::ambientFont),
        frame::childKey<&Link::Label1, &Label::BorderStyle, &Label::SetBorderStyle>("BorderStyle", VarType::Integer, 0),
        frame::childKey<&Link::Label1, &Label::Alignment, &Label::SetAlignment>("Alignment", VarType::Integer, 0),
        frame::childKey<&Link::Label1, &Label::Appearance, &Label::SetAppearance>("Appearance", VarType::Integer, 1),
        frame::childKey<&Link::Label1, &Label::AutoSize, &Label::SetAutoSize>("AutoSize", VarType::Boolean, false),
        frame::childKey<&Link::Label1, &Label::Caption, &Label::SetCaption>("Caption", "Label1"),
        frame::childKey<&Link::Label1, &Label::WordWrap, &Label::SetWordWrap>("WordWrap", VarType::Boolean, false),
        frame::key<&Link::own, &Own::HighlightColor>("HighlightColor", VarType::Long, 192),
        frame::key<&Link::own, &Own::UsedColor>("UsedColor", VarType::Long, 0x800080),
        frame::key<&Link::own, &Own::LinkTo>("LinkTo", ""),
        frame::key<&Link::own, &Own::ForeColor>("Forecolor", VarType::Long, 0xC00000),
        frame::key<&Link::own, &Own::BorderSize>("BorderSize", VarType::Integer, 30),
        frame::key<&Link::own, &Own::SuppressMessages>("SuppressMessages", VarType::Boolean, false),
        frame::key<&Link::own, &Own::ClickAction>("ClickAction", VarType::Integer, 1),
    };
    static constexpr std::array parts = {frame::part<&Link::Label1>("Label1")};
};

constexpr frame::ClassTable Link::table{
    .name = "Link", .members = Tables::members, .events = Tables::events, .bag = Tables::kept, .parts = Tables::parts};

}  // namespace tessel::controls
