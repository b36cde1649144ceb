#pragma once

#include <QObject>
#include <memory>
#include <unordered_set>
#include <vector>

#include "frame/SiblingIndex.h"
#include "frame/Site.h"
#include "hosts/qt/WidgetObject.h"

namespace tessel::qt {

/// A form with what stands on it: its named widgets in the order of their creation, without the inner parts of the toolkit (names
/// that begin with "qt_"), of the library's own controls, and of windows and forms that stand on it. A control is met as its
/// extender. Qt does not tell how old a widget is: those that are met in one look are taken in the order of the widgets' tree.
class Form final : public QObject, public WidgetObject, public frame::Siblings {
  public:
    /// The form of a widget, made when first asked for; it goes with its widget.
    static Form& of(QWidget& formWidget);

    int Count() const override;
    frame::Object& Item(int index) override;
    frame::Object* Find(std::string_view name, std::int32_t index = -1) override;

    using WidgetObject::Get;
    const frame::ClassTable& Table() const override;

    /// The inner size in twips.
    float ScaleWidth() const;
    float ScaleHeight() const;

  protected:
    /// Sees what comes to stand on the form and what leaves it.
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    explicit Form(QWidget& widget);
    struct Member {
        QPointer<QWidget> widget;
        std::unique_ptr<WidgetObject> object;  // none for a control, which brings its own
    };

    bool IsOfThisForm(const Member& member) const;
    void Look();
    void LookInto(QWidget& parent, std::unordered_set<const QWidget*>& known);
    void Watch(QWidget& widget);
    void ForgetMembers() { looked_ = false; }
    /// Makes the index anew; false when it cannot be kept right.
    bool Indexed();

    std::vector<Member> members_;
    frame::SiblingIndex index_;
    bool looked_ = false;        // the members are those that there are
    bool indexed_ = false;       // so is the index
    bool indexMayMove_ = false;  // a widget's `Index` is a property of its class, whose changes are not told
};

}  // namespace tessel::qt
