#pragma once

#include <QLoggingCategory>
#include <QObject>
#include <QString>
#include <memory>

#include "frame/host.h"

class QWidget;

namespace tessel::qt {

Q_DECLARE_LOGGING_CATEGORY(errorLog)  // "tessel.controls"

/// What the controls on some widgets share: the services, the module state, whether it is design time. A program has one, made
/// when its first control is; a form window of a designer gets one of its own by `attach`.
///
/// Ambient properties: `UserMode` is a property of the host; `Font` is that of the form; `DisplayName` the control's object name.
class Host : public QObject {
    Q_OBJECT
    Q_PROPERTY(bool userMode READ userMode WRITE setUserMode NOTIFY userModeChanged)

  public:
    /// Services in `replaced` that are not null stand in the place of this host's own; they must outlive it.
    static std::shared_ptr<Host> make(const frame::Services& replaced = {});
    /// The host of a widget: that of the nearest of it and its ancestors that has one, else the application's. A null widget is
    /// the application.
    static std::shared_ptr<Host> of(const QWidget* widget);
    /// Gives a widget, and all controls that are made on it from now on, a host; the application with `qApp`.
    static void attach(QObject* holder, std::shared_ptr<Host> host);
    /// Names a widget as the form of the controls on it. Without, the form is the window.
    static void setForm(QWidget* widget);
    /// The nearest ancestor that is a window or was named as form; the widget itself when it is one.
    static QWidget* formOf(QWidget* widget);

    ~Host() override;

    /// False is design time: controls take no input and refuse to have run-time properties set.
    bool userMode() const;
    /// Each control of the host hears of a change.
    void setUserMode(bool value);

    /// The host as the controls see it.
    frame::Host& frameHost() const;

  signals:
    /// An error that no caller could take: of an input's handler, of a property set or a method called through Qt. `where` names
    /// the object and the event or member. It is also logged as a warning of the category "tessel.controls".
    void unhandledError(int number, const QString& description, const QString& where);
    void userModeChanged(bool userMode);

  private:
    explicit Host(const frame::Services& replaced);

    struct Private;
    std::unique_ptr<Private> d;
};

}  // namespace tessel::qt
