#pragma once

#include <gtest/gtest.h>
#include <QApplication>
#include <QHeaderView>
#include <QPainter>
#include <QScrollBar>
#include <QTest>
#include <memory>
#include <string>

#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/qt/ControlWidget.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Host.h"
#include "hosts/qt/ListViewPeer.h"
#include "hosts/qt/ListWidget.h"
#include "tests/frame/child/ListOwner.h"

namespace tessel::qt::test {

/// A control of the tests as a widget, which nobody listens to.
template <class Owner>
class OwnerWidget final : public ControlWidget {
  public:
    explicit OwnerWidget(QWidget* parent) : ControlWidget(Class(), parent) {}
    Owner& owner() const { return static_cast<Owner&>(control()); }

  protected:
    bool hears(const frame::EventInfo&) const override { return false; }
    void raise(const frame::EventInfo&, frame::EventArguments) override {}

  private:
    static const frame::ControlClass& Class() {
        static constexpr frame::ClassTable table{.name = "Owner", .members = {}};
        static const frame::ControlClass controlClass{
            &table, [](frame::Host& host) -> std::unique_ptr<frame::Control> { return std::make_unique<Owner>(host); }};
        return controlClass;
    }
};

/// A window with one control of the tests on it, and the services of the headless host behind it but for those of the screen.
template <class Owner>
class OnScreen {
  public:
    OnScreen(int width, int height) {
        window.resize(width, height);
        widget->resize(width, height);
        window.show();
        window.activateWindow();
        if (!QTest::qWaitForWindowActive(&window)) ADD_FAILURE() << "the window did not become active";
    }
    ~OnScreen() {
        widget.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
    void Settle() { host->frameHost().Settle(); }

  private:
    headless::HeadlessHost lent_;
    frame::Services Lent() {
        frame::Services services = lent_.LentServices();
        services.loop = nullptr;
        services.peers = nullptr;
        services.focus = nullptr;
        services.colors = nullptr;
        services.metrics = nullptr;
        return services;
    }

  public:
    headless::ErrorList& errors = lent_.errors;
    std::shared_ptr<qt::Host> host = qt::Host::make(Lent());
    QWidget window;
    std::unique_ptr<OwnerWidget<Owner>> widget = [this] {
        Host::attach(&window, host);
        return std::make_unique<OwnerWidget<Owner>>(&window);
    }();
};

/// A list that fills its window.
class ListOnScreen : public OnScreen<tessel::test::ListOwner> {
  public:
    explicit ListOnScreen(int width = 400, int height = 200) : OnScreen(width, height) {
        list.Move(0, 0, Twips(width), Twips(height));
        Settle();
        view().setFocus();
    }

    /// Adds rows "row 0", "row 1" and so on, whose sub-item is their number.
    void AddRows(int count) {
        const int first = static_cast<int>(rows().Count());
        for (int row = first; row < first + count; ++row) {
            const auto id = rows().Add("row " + frame::Decimal(row));
            rows().SetText(id, 1, frame::Decimal(row));
        }
        Settle();
    }
    child::ListRows& rows() { return list.Rows(); }
    ListWidget& view() { return *window.findChild<ListWidget*>(); }
    QWidget* port() { return view().viewport(); }
    QPoint LabelPoint(int row) { return CellOf(row).topLeft() + QPoint(12, CellOf(row).height() / 2); }
    QRect CellOf(int row) { return view().visualRect(view().model()->index(row, 0)); }
    void Click(int row, Qt::KeyboardModifiers modifiers = {}) {
        QTest::mouseClick(port(), Qt::LeftButton, modifiers, LabelPoint(row));
    }
    void Key(int key, Qt::KeyboardModifiers modifiers = {}) { QTest::keyClick(&view(), static_cast<Qt::Key>(key), modifiers); }

    /// What is painted at a point of the inside, at any scale of the screen.
    QColor Pixel(int x, int y) {
        const QPixmap seen = port()->grab();
        const double scale = seen.devicePixelRatio();
        return seen.toImage().pixelColor(static_cast<int>((x + 0.5) * scale), static_cast<int>((y + 0.5) * scale));
    }
    QColor Pixel(QPoint at) { return Pixel(at.x(), at.y()); }

    /// The texts of the selected rows, with "*" behind that of the focus row, and of a focus row that is not selected in brackets.
    std::string Selection() {
        std::string result;
        for (child::ListRows::Position row = 0; row < rows().Count(); ++row) {
            const auto id = rows().At(row);
            const bool isFocus = list.FocusRow() == id;
            if (!rows().Selected(id) && !isFocus) continue;
            if (!result.empty()) result += ", ";
            const std::string text = rows().Text(id, 0);
            result += rows().Selected(id) ? text + (isFocus ? "*" : "") : "(" + text + ")";
        }
        return result;
    }

    tessel::test::ListOwner& owner = widget->owner();
    child::ListView& list = owner.list;
};

}  // namespace tessel::qt::test
