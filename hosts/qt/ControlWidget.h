#pragma once

#include <QByteArray>
#include <QVariant>
#include <QWidget>
#include <memory>
#include <string_view>

#include "frame/Control.h"
#include "hosts/qt/Host.h"

namespace tessel::qt {

class Site;

/// The base of the library's controls as widgets. The classes themselves (`Link` and the others) have the members of their
/// control as Qt properties, slots and signals.
///
/// A widget is placed new, or loaded by `setBag`: whichever comes first of setting the bag, using a property, and being shown.
/// Errors of what is called through Qt go to `Host::unhandledError`; code that wants them as exceptions uses the control itself.
/// Arguments of signals that are references can be set by slots of direct connections.
class ControlWidget : public QWidget {
    Q_OBJECT
    /// The saved state as text of ASCII characters. Set to an empty text it makes a new control, not a loaded one.
    Q_PROPERTY(QByteArray bag READ bag WRITE setBag DESIGNABLE false)

  public:
    ~ControlWidget() override;

    std::shared_ptr<Host> host() const { return host_; }
    /// The control: its members as C++ functions, with exceptions for errors.
    frame::Control& control() const;
    /// The control's members and those that the host adds (`Name`, `Left`, `Top`, `Width`, `Height`, `Visible`, `ToolTipText`),
    /// by name, as its siblings reach it.
    frame::Object& extender() const;

    /// The control's own `Enabled`, as it is saved; at design time the widget stays as it is.
    bool controlEnabled() const { return get("Enabled").toBool(); }
    void setControlEnabled(bool value) { put("Enabled", value); }

    QByteArray bag() const;
    /// A control that was in use already is replaced by a fresh one that is loaded.
    void setBag(const QByteArray& bag);
    /// The same from saved state in a form of the program's own.
    void load(const frame::PropertyBag& saved) { place(&saved); }

    /// The size of the control; `preferredSize` for one in a layout that does not size itself.
    QSize sizeHint() const override;

  protected:
    /// `controlClass` makes the control.
    ControlWidget(const frame::ControlClass& controlClass, QWidget* parent);

    /// Whether it is decided how the control came.
    bool isSettled() const { return settled_; }

    // What generated classes are made of.
    QVariant get(const char* member) const;
    void put(const char* member, const QVariant& value);
    QVariant call(const char* member, const QVariantList& arguments);
    virtual bool hears(const frame::EventInfo& event) const = 0;
    virtual void raise(const frame::EventInfo& event, frame::EventArguments arguments) = 0;
    /// The control has changed the property of this key by itself or on demand.
    virtual void propertyChanged(std::string_view key);

    /// The size that a layout should give; invalid for any.
    virtual QSize preferredSize() const { return {}; }
    /// Whether the control takes the size that it likes, whatever it is given.
    virtual bool sizesItself() const { return false; }
    /// A fresh control has come: loaded or placed new.
    virtual void started() {}

    bool event(QEvent* event) override;
    void changeEvent(QEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void moveEvent(QMoveEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    /// Reports the key to a control that takes the keys on its own surface.
    void keyPressEvent(QKeyEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;

    /// Room for so many letters in so many lines.
    QSize textArea(int letters, int lines) const;
    /// The widget's focus goes to what shows this child.
    void giveFocusTo(const frame::ChildControl& child);

    /// The pointer over the control where it asks for none of its own.
    void setPointer(const QCursor& pointer);

    /// Runs a call into the control; its errors are reported as of this member or event.
    template <class F>
    void enter(const char* where, F&& call) const;

  private:
    friend class Site;

    void adopt();
    void place(const frame::PropertyBag* saved);
    void settle() const;
    enum class Came { New, Loaded };
    void followFirstLook(Came came);
    void takeSize();
    void takePlace();
    void takeEnabled();
    bool inLayout() const;
    /// The site has another size or place.
    void followSize();
    void followPlace();
    void ambientChanged(const std::string& name);
    bool designTime() const { return !host_->userMode(); }

    const frame::ControlClass& class_;
    std::shared_ptr<Host> host_;
    std::unique_ptr<Site> site_;
    bool live_ = false;     // the control may speak: this object is whole, and the control is loaded or being loaded
    bool settled_ = false;  // it is decided how the control came
    bool shown_ = false;
    QSize taken_;  // the widget's size that the control has been given
};

}  // namespace tessel::qt
