#include "hosts/qt/Form.h"

#include <algorithm>

#include "frame/ChildControl.h"
#include "frame/Error.h"
#include "hosts/qt/ControlWidget.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Host.h"

namespace tessel::qt {

namespace {
constexpr const char* formName = "qt_tessel_form";
}

Form& Form::of(QWidget& formWidget) {
    if (auto* known = formWidget.findChild<QObject*>(formName, Qt::FindDirectChildrenOnly)) return *static_cast<Form*>(known);
    return *new Form(formWidget);
}

Form::Form(QWidget& widget) : QObject(&widget), WidgetObject(widget) { setObjectName(formName); }

int Form::Count() const {
    const_cast<Form*>(this)->Look();
    return static_cast<int>(members_.size());
}

frame::Object& Form::Item(int index) {
    if (index < 0 || index >= Count()) throw frame::ControlError(frame::errors::subscript);
    Member& member = members_[static_cast<std::size_t>(index)];
    if (auto* control = qobject_cast<ControlWidget*>(member.widget.data())) return control->extender();
    return *member.object;
}

void Form::Look() {
    std::erase_if(members_, [this](const Member& member) { return !IsOfThisForm(member); });
    LookInto(Live());
}

/// Not one that has gone or is going, lost its name, or moved to another form.
bool Form::IsOfThisForm(const Member& member) const {
    if (!member.widget || member.widget->objectName().isEmpty() || member.widget->isWindow()) return false;
    if (!member.object && !qobject_cast<ControlWidget*>(member.widget.data())) return false;
    const QWidget* parent = member.widget->parentWidget();
    return parent && Host::formOf(const_cast<QWidget*>(parent)) == widget();
}

void Form::LookInto(const QWidget& parent) {
    for (QObject* child : parent.children()) {
        auto* widget = qobject_cast<QWidget*>(child);
        if (!widget || widget->isWindow() || Host::formOf(widget) == widget || widget->objectName().startsWith("qt_tessel_"))
            continue;
        const bool inner = widget->objectName().isEmpty() || widget->objectName().startsWith("qt_");
        auto* control = qobject_cast<ControlWidget*>(widget);
        const auto is = [&](const Member& member) { return member.widget == widget; };
        if (!inner && std::none_of(members_.begin(), members_.end(), is))
            members_.push_back({widget, control ? nullptr : std::make_unique<WidgetObject>(*widget)});
        LookInto(*widget);
    }
}

float Form::ScaleWidth() const { return Twips(Live().contentsRect().width()); }
float Form::ScaleHeight() const { return Twips(Live().contentsRect().height()); }

const frame::ClassTable& Form::Table() const {
    static constexpr auto members =
        frame::Join(widgetMembers, std::array{frame::property<&Form::ScaleWidth>("ScaleWidth", "The inner width in twips."),
                                              frame::property<&Form::ScaleHeight>("ScaleHeight", "The inner height in twips.")});
    static constexpr frame::ClassTable table{.name = "Form", .members = members};
    return table;
}

}  // namespace tessel::qt
