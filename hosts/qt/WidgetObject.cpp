#include "hosts/qt/WidgetObject.h"

#include <QMetaProperty>

#include "frame/Error.h"
#include "frame/Text.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Services.h"

namespace tessel::qt {

using frame::Variant;

QWidget& WidgetObject::Live() const {
    if (!widget_) frame::ThrowObjectGone();
    return *widget_;
}

Variant WidgetObject::Get(frame::MemberKey key, frame::Arguments arguments) {
    if (!key.ByNumber() && Table().Find(key)) return Object::Get(key, arguments);
    const QByteArray property = PropertyFor(key);
    if (property.isEmpty()) throw frame::ControlError(frame::errors::noSuchMember);
    if (!arguments.empty()) throw frame::ControlError(frame::errors::wrongArguments);
    return FromQt(Live().property(property.constData()));
}

void WidgetObject::Put(frame::MemberKey key, const Variant& value, frame::Arguments arguments) {
    if (!key.ByNumber() && Table().Find(key)) return Object::Put(key, value, arguments);
    const QByteArray property = PropertyFor(key);
    if (property.isEmpty()) throw frame::ControlError(frame::errors::noSuchMember);
    if (!arguments.empty()) throw frame::ControlError(frame::errors::wrongArguments);
    QVariant converted = ToQt(value, {}, PaletteColors());
    const QVariant present = Live().property(property.constData());
    if (present.isValid() && !converted.convert(present.metaType())) throw frame::ControlError(frame::errors::typeMismatch);
    const int declared = Live().metaObject()->indexOfProperty(property.constData());
    if (declared >= 0 && !Live().metaObject()->property(declared).isWritable())
        throw frame::ControlError(frame::errors::notAtRunTime);
    Live().setProperty(property.constData(), converted);
}

bool WidgetObject::Has(frame::MemberKey key) const {
    if (key.ByNumber() || !widget_) return false;
    return Table().Find(key) || !PropertyFor(key).isEmpty();
}

QByteArray WidgetObject::PropertyFor(frame::MemberKey key) const {
    if (key.ByNumber()) return {};
    const auto is = [&](std::string_view name) { return frame::EqualsNoCase(key.Name(), name); };
    const QMetaObject* meta = Live().metaObject();
    if (is("Caption") || is("Text"))
        for (const char* name : {"text", "title", "plainText", "windowTitle"})
            if (meta->indexOfProperty(name) >= 0) return name;
    for (int i = meta->propertyCount() - 1; i >= 0; --i)
        if (is(meta->property(i).name())) return meta->property(i).name();
    for (const QByteArray& name : Live().dynamicPropertyNames())
        if (is(std::string_view(name.constData(), static_cast<std::size_t>(name.size())))) return name;
    return {};
}

std::string WidgetObject::Name() const { return FromQt(Live().objectName()); }

TwipsRect WidgetObject::Place() const {
    const QRect pixels = Live().geometry();
    const auto each = [](int now, int then, float set) { return now == then ? set : Twips(now); };
    return {each(pixels.x(), pixelsSet_.x(), set_.left), each(pixels.y(), pixelsSet_.y(), set_.top),
            each(pixels.width(), pixelsSet_.width(), set_.width), each(pixels.height(), pixelsSet_.height(), set_.height)};
}

void WidgetObject::SetPart(float TwipsRect::*part, float value) {
    set_ = Place();
    set_.*part = value;
    pixelsSet_ = PixelRect(set_.left, set_.top, set_.width, set_.height);
    Live().setGeometry(pixelsSet_);
}

bool WidgetObject::Enabled() const {
    const QWidget& widget = Live();
    return widget.isEnabledTo(widget.parentWidget());
}

frame::OLE_COLOR WidgetObject::BackColor() const { return FromQt(Live().palette().color(Live().backgroundRole())); }

void WidgetObject::SetBackColor(frame::OLE_COLOR value) {
    QWidget& widget = Live();
    QPalette palette = widget.palette();
    palette.setColor(widget.backgroundRole(), ToQt(value, PaletteColors()));
    widget.setPalette(palette);
    widget.setAutoFillBackground(true);
}

frame::OLE_COLOR WidgetObject::ForeColor() const { return FromQt(Live().palette().color(Live().foregroundRole())); }

void WidgetObject::SetForeColor(frame::OLE_COLOR value) {
    QWidget& widget = Live();
    QPalette palette = widget.palette();
    palette.setColor(widget.foregroundRole(), ToQt(value, PaletteColors()));
    widget.setPalette(palette);
}

frame::FontRef WidgetObject::Font() const { return FromQt(Live().font()); }

void WidgetObject::SetFont(const frame::FontRef& value) { Live().setFont(value ? ToQt(*value) : QFont()); }

std::string WidgetObject::ToolTipText() const { return FromQt(Live().toolTip()); }

void WidgetObject::SetToolTipText(const std::string& value) { Live().setToolTip(ToQt(value)); }

constexpr frame::ClassTable widgetTable{.name = "Widget", .members = widgetMembers};

const frame::ClassTable& WidgetObject::Table() const { return widgetTable; }

}  // namespace tessel::qt
