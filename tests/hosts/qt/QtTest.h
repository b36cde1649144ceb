#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QApplication>
#include <QCoreApplication>
#include <QCursor>
#include <QImage>
#include <QPointer>
#include <QTest>
#include <QTimer>
#include <QWidget>
#include <QWindow>
#include <functional>
#include <string>
#include <vector>

#include "hosts/headless/Services.h"
#include "hosts/qt/Form.h"
#include "hosts/qt/Host.h"
#include "hosts/qt/Link.h"
#include "tests/ErrorOf.h"

namespace tessel::test {

inline std::string Joined(const std::vector<std::string>& parts) {
    std::string all;
    for (const std::string& part : parts) all += (all.empty() ? "" : " ") + part;
    return all;
}

/// Whatever was left for the next turns of the event loop is done: timers of no time, and what is deleted later.
inline void Settle() {
    for (int turn = 0; turn < 4; ++turn) {
        QCoreApplication::processEvents();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
}

/// A window with a host of its own whose shell and boxes are scripted: no program is started and no box waits.
class QtTest : public testing::Test {
  protected:
    explicit QtTest(frame::Dialogs* boxes = nullptr, frame::FileSystem* files = nullptr) {
        frame::Services replaced;
        replaced.shell = &shell;
        replaced.dialogs = boxes ? boxes : &dialogs;
        replaced.files = files;
        host = qt::Host::make(replaced);
        window = new QWidget;
        window->setObjectName("frmMain");
        window->resize(400, 300);
        qt::Host::attach(window, host);
        QObject::connect(host.get(), &qt::Host::unhandledError, host.get(),
                         [this](int number, const QString& description, const QString& where) {
                             errors.push_back(std::to_string(number) + " " + where.toStdString());
                             descriptions.push_back(description.toStdString());
                         });
    }
    ~QtTest() override {
        delete window.data();
        host.reset();
        LetGo();
        Settle();
    }

    /// The user lets go of the buttons, wherever the pointer is.
    static void LetGo() {
        if (QGuiApplication::mouseButtons() == Qt::NoButton) {
            QTestPrivate::qtestMouseButtons = Qt::NoButton;
            return;
        }
        QWindow elsewhere;
        elsewhere.setGeometry(600, 400, 50, 50);
        elsewhere.show();
        for (const Qt::MouseButton button : {Qt::LeftButton, Qt::RightButton, Qt::MiddleButton}) {
            if (QGuiApplication::mouseButtons() & button) QTest::mouseRelease(&elsewhere, button, {}, {10, 10});
        }
    }

    qt::Link* Add(const char* name = "Link1", QRect place = {20, 20, 200, 40}) {
        auto* link = new qt::Link(window);
        link->setObjectName(name);
        link->setGeometry(place);
        return link;
    }
    void Show() {
        window->show();
        window->activateWindow();
        ASSERT_TRUE(QTest::qWaitForWindowActive(window));
        MoveAway();
        Settle();
    }
    /// A shown link in a shown window.
    qt::Link* Shown(const char* name = "Link1", QRect place = {20, 20, 200, 40}) {
        qt::Link* link = Add(name, place);
        link->setLinkTo("a.txt");
        Show();
        return link;
    }

    // The user's hand, as the window system reports it: places are those of the link.
    QPoint At(QWidget* widget, QPoint place) const { return widget->mapTo(widget->window(), place); }
    void MoveTo(QWidget* widget, QPoint place) {
        const QPoint there = At(widget, place);
        const QPointer<QWindow> handle(widget->window()->windowHandle());
        // The pointer itself moves, which the window system reports, but not where it believes the pointer to be there already.
        if (QTestPrivate::qtestMouseButtons == Qt::NoButton) {
            QCursor::setPos(widget->mapToGlobal(place));
            QCoreApplication::processEvents();
            if (!handle || !QRect({}, handle->size()).contains(there)) return;
        }
        QTest::mouseMove(handle, there);
    }
    void MoveAway() { MoveTo(window, {390, 290}); }
    void Press(QWidget* widget, QPoint place, Qt::MouseButton button = Qt::LeftButton, Qt::KeyboardModifiers keys = {}) {
        const QPoint there = At(widget, place);
        QWindow* handle = widget->window()->windowHandle();
        if (QTestPrivate::qtestMouseButtons == Qt::NoButton) MoveTo(widget, place);
        QTest::mousePress(handle, button, keys, there);
    }
    void Release(QWidget* widget, QPoint place, Qt::MouseButton button = Qt::LeftButton, Qt::KeyboardModifiers keys = {}) {
        QTest::mouseRelease(widget->window()->windowHandle(), button, keys, At(widget, place));
    }
    void Click(QWidget* widget, QPoint place, Qt::MouseButton button = Qt::LeftButton) {
        const QPoint there = At(widget, place);
        QWindow* handle = widget->window()->windowHandle();
        MoveTo(widget, place);
        QTest::mousePress(handle, button, {}, there);
        QTest::mouseRelease(handle, button, {}, there);
    }
    void DoubleClick(QWidget* widget, QPoint place) {
        MoveTo(widget, place);
        QTest::mouseDClick(widget->window()->windowHandle(), Qt::LeftButton, {}, At(widget, place));
        QTest::mouseRelease(widget->window()->windowHandle(), Qt::LeftButton, {}, At(widget, place));
    }

    /// Writes down the events of a link, without the moves.
    void Listen(qt::Link* link) {
        const auto note = [this](const char* name) { return [this, name] { heard.push_back(name); }; };
        QObject::connect(link, &qt::Link::mouseDown, link, note("MouseDown"));
        QObject::connect(link, &qt::Link::mouseUp, link, note("MouseUp"));
        QObject::connect(link, &qt::Link::click, link, note("Click"));
        QObject::connect(link, &qt::Link::dblClick, link, note("DblClick"));
        QObject::connect(link, &qt::Link::keyDown, link, note("KeyDown"));
        QObject::connect(link, &qt::Link::keyPress, link, note("KeyPress"));
        QObject::connect(link, &qt::Link::keyUp, link, note("KeyUp"));
    }
    std::string Events() { return Joined(std::exchange(heard, {})); }
    /// What the shell was asked since the last time: "open a.txt".
    std::string Executed() {
        std::vector<std::string> asked;
        for (const auto& entry : log.Of("execute")) asked.push_back(entry[1].ToText() + " " + entry[2].ToText());
        log.Clear();
        return Joined(asked);
    }
    std::string Errors() { return Joined(std::exchange(errors, {})); }

    /// Runs `act`, which opens a menu, and what the user does with it.
    void WithMenu(const std::function<void()>& act, const std::function<void(QWidget*)>& user) {
        QTimer poll;
        menuSeen = false;
        QObject::connect(&poll, &QTimer::timeout, &poll, [&] {
            QWidget* menu = QApplication::activePopupWidget();
            if (!menu) return;
            poll.stop();
            menuSeen = true;
            const QPointer<QWidget> guarded(menu);
            user(menu);
            if (guarded) guarded->close();
        });
        poll.start(0);
        act();
        Settle();
    }

    headless::Log log;
    headless::ScriptedShell shell{log};
    headless::ScriptedDialogs dialogs{log};
    std::shared_ptr<qt::Host> host;
    QPointer<QWidget> window;
    std::vector<std::string> heard, errors, descriptions;
    bool menuSeen = false;
};

/// The pixels of a picture that differ from its corner, as the rectangle around them.
inline QRect InkOf(const QImage& image) {
    const QRgb paper = image.pixel(0, 0);
    QRect ink;
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) {
            if (image.pixel(x, y) != paper) ink |= QRect(x, y, 1, 1);
        }
    }
    return ink;
}

}  // namespace tessel::test
