#include "hosts/qt/Form.h"

#include <QChildEvent>
#include <algorithm>
#include <optional>
#include <utility>

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
    // Kept as a property: the form may have a thousand children, and is asked for each name of a drag.
    if (auto* known = formWidget.property(formName).value<QObject*>()) return *static_cast<Form*>(known);
    auto* form = new Form(formWidget);
    formWidget.setProperty(formName, QVariant::fromValue<QObject*>(form));
    return *form;
}

Form::Form(QWidget& widget) : QObject(&widget), WidgetObject(widget) { setObjectName(formName); }

int Form::Count() const {
    const_cast<Form*>(this)->Look();
    return static_cast<int>(members_.size());
}

frame::Object& Form::Item(int index) {
    if (index < 0 || index >= Count()) throw frame::ControlError(frame::errors::subscript);
    Member& member = members_[static_cast<std::size_t>(index)];
    if (!member.widget) frame::ThrowObjectGone();
    if (auto* control = qobject_cast<ControlWidget*>(member.widget.data())) return control->extender();
    return *member.object;
}

frame::Object* Form::Find(std::string_view name, std::int32_t index) {
    Look();
    if (!Indexed() && index >= 0) return Siblings::Find(name, index);
    const int place = index_.Find(name, index);
    if (place < 0) return nullptr;
    if (members_[static_cast<std::size_t>(place)].widget) return &Item(place);
    ForgetMembers();  // it is going: another one may stand behind it
    return Find(name, index);
}

bool Form::Indexed() {
    if (!std::exchange(indexed_, true)) {
        index_.Clear();
        indexMayMove_ = false;
        for (const Member& member : members_) {
            if (!member.widget) {
                index_.Add({}, {});
                continue;
            }
            const QWidget& widget = *member.widget;
            std::optional<std::int32_t> index;
            if (member.object)
                index = frame::IndexOf(*member.object);
            else if (const QVariant given = widget.property("Index"); given.isValid())
                index = given.toInt();
            for (const char* spelling : {"Index", "index"})
                if (widget.metaObject()->indexOfProperty(spelling) >= 0) indexMayMove_ = true;
            index_.Add(FromQt(widget.objectName()), index);
        }
    }
    return !indexMayMove_;
}

/// The members stay as they were found until a widget comes, goes, moves, or gets another name.
void Form::Look() {
    if (std::exchange(looked_, true)) return;
    indexed_ = false;
    std::erase_if(members_, [this](const Member& member) { return !IsOfThisForm(member); });
    std::unordered_set<const QWidget*> known;
    for (const Member& member : members_) known.insert(member.widget);
    Watch(Live());
    LookInto(Live(), known);
}

void Form::Watch(QWidget& widget) {
    widget.installEventFilter(this);
    connect(&widget, &QObject::objectNameChanged, this, &Form::ForgetMembers, Qt::UniqueConnection);
    connect(&widget, &QObject::destroyed, this, &Form::ForgetMembers, Qt::UniqueConnection);
}

bool Form::eventFilter(QObject* /*watched*/, QEvent* event) {
    switch (event->type()) {
        case QEvent::ChildAdded:
            if (static_cast<QChildEvent*>(event)->child()->isWidgetType()) ForgetMembers();
            break;
        case QEvent::ChildRemoved:  // of a child that has gone it is not told whether it was a widget
        case QEvent::ParentChange:
            ForgetMembers();
            break;
        case QEvent::DynamicPropertyChange: {
            const QByteArray name = static_cast<QDynamicPropertyChangeEvent*>(event)->propertyName();
            if (name.startsWith("qt_tessel_")) ForgetMembers();
            if (name.compare("Index", Qt::CaseInsensitive) == 0) indexed_ = false;
            break;
        }
        default:
            break;
    }
    return false;
}

/// Not one that has gone or is going, lost its name, or moved to another form.
bool Form::IsOfThisForm(const Member& member) const {
    if (!member.widget || member.widget->objectName().isEmpty() || member.widget->isWindow()) return false;
    if (!member.object && !qobject_cast<ControlWidget*>(member.widget.data())) return false;
    const QWidget* parent = member.widget->parentWidget();
    return parent && Host::formOf(const_cast<QWidget*>(parent)) == widget();
}

void Form::LookInto(QWidget& parent, std::unordered_set<const QWidget*>& known) {
    for (QObject* child : parent.children()) {
        auto* widget = qobject_cast<QWidget*>(child);
        if (!widget || !QPointer(widget)) continue;  // nor one that is going
        Watch(*widget);                              // a window too: it may become a part
        if (widget->isWindow() || Host::formOf(widget) == widget || widget->objectName().startsWith("qt_tessel_")) continue;
        const bool inner = widget->objectName().isEmpty() || widget->objectName().startsWith("qt_");
        if (!inner && known.insert(widget).second) {
            const bool control = qobject_cast<ControlWidget*>(widget) != nullptr;
            members_.push_back({widget, control ? nullptr : std::make_unique<WidgetObject>(*widget)});
        }
        LookInto(*widget, known);
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
