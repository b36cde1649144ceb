#pragma once

#include <QPointer>
#include <QRect>
#include <QWidget>
#include <string>

#include "frame/ClassTable.h"
#include "frame/Font.h"
#include "frame/Object.h"

namespace tessel::qt {

/// A place and a size in twips.
struct TwipsRect {
    float left = 0, top = 0, width = 0, height = 0;
};

/// A widget of the application by name, as controls that restyle and move their siblings reach it: the members of the table
/// below, and behind them every property that the widget has for Qt. Names are looked up without regard to case. `Caption` and
/// `Text` are the widget's text, title or window title; `Index` is a dynamic property of that name (error 438 without).
///
/// The geometry is in twips of the parent widget; what was set reads as it was set until the widget gets another place or size.
class WidgetObject : public frame::Object {
  public:
    explicit WidgetObject(QWidget& widget) : widget_(&widget) {}

    /// Null once it has gone.
    QWidget* widget() const { return widget_; }

    frame::Variant Get(frame::MemberKey key, frame::Arguments arguments = {}) override;
    void Put(frame::MemberKey key, const frame::Variant& value, frame::Arguments arguments = {}) override;
    /// Reads the property: methods cannot be called.
    frame::Variant Call(frame::MemberKey key, frame::Arguments arguments = {}) override { return Get(key, arguments); }
    bool Has(frame::MemberKey key) const override;
    std::string Path() const override { return widget_ ? Name() : std::string(); }
    const frame::ClassTable& Table() const override;

    // Error 91 for each when the widget has gone.
    std::string Name() const;
    float Left() const { return Place().left; }
    void SetLeft(float value) { SetPart(&TwipsRect::left, value); }
    float Top() const { return Place().top; }
    void SetTop(float value) { SetPart(&TwipsRect::top, value); }
    float Width() const { return Place().width; }
    void SetWidth(float value) { SetPart(&TwipsRect::width, value); }
    float Height() const { return Place().height; }
    void SetHeight(float value) { SetPart(&TwipsRect::height, value); }
    bool Visible() const { return !Live().isHidden(); }
    void SetVisible(bool value) { Live().setVisible(value); }
    bool Enabled() const;
    void SetEnabled(bool value) { Live().setEnabled(value); }
    frame::OLE_COLOR BackColor() const;
    void SetBackColor(frame::OLE_COLOR value);
    frame::OLE_COLOR ForeColor() const;
    void SetForeColor(frame::OLE_COLOR value);
    frame::FontRef Font() const;
    void SetFont(const frame::FontRef& value);
    std::string ToolTipText() const;
    void SetToolTipText(const std::string& value);

  protected:
    QWidget& Live() const;

  private:
    TwipsRect Place() const;
    void SetPart(float TwipsRect::*part, float value);
    /// The name of the Qt property that stands behind a member; empty when there is none.
    QByteArray PropertyFor(frame::MemberKey key) const;

    QPointer<QWidget> widget_;
    TwipsRect set_;
    QRect pixelsSet_;  // the geometry asked for by `set_`; the widget may have got another
};

/// The rows of the members that every widget has.
inline constexpr std::array widgetMembers = {
    frame::property<&WidgetObject::Name>("Name", "The object name of the widget."),
    frame::property<&WidgetObject::Left, &WidgetObject::SetLeft>("Left", "Left edge in twips of the parent widget."),
    frame::property<&WidgetObject::Top, &WidgetObject::SetTop>("Top", "Top edge in twips of the parent widget."),
    frame::property<&WidgetObject::Width, &WidgetObject::SetWidth>("Width", "Width in twips."),
    frame::property<&WidgetObject::Height, &WidgetObject::SetHeight>("Height", "Height in twips."),
    frame::property<&WidgetObject::Visible, &WidgetObject::SetVisible>("Visible", "Whether the widget is to be seen."),
    frame::property<&WidgetObject::Enabled, &WidgetObject::SetEnabled>("Enabled", "Whether the widget takes input."),
    frame::property<&WidgetObject::BackColor, &WidgetObject::SetBackColor>("BackColor", "The colour of its background role."),
    frame::property<&WidgetObject::ForeColor, &WidgetObject::SetForeColor>("ForeColor", "The colour of its foreground role."),
    frame::property<&WidgetObject::Font, &WidgetObject::SetFont>("Font", "The font; none lets the widget follow its parent again."),
    frame::property<&WidgetObject::ToolTipText, &WidgetObject::SetToolTipText>("ToolTipText", "The tool tip."),
};

}  // namespace tessel::qt
