#pragma once

#include <gtest/gtest.h>
#include <QPixmap>
#include <QTest>
#include <QWidget>
#include <memory>

#include "hosts/headless/HeadlessHost.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Host.h"
#include "tests/hosts/qt/OwnerWidget.h"

namespace tessel::qt::test {

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

/// What is painted at a point of a widget, at any scale of the screen.
inline QColor PixelOf(QWidget& widget, int x, int y) {
    const QPixmap seen = widget.grab();
    const double scale = seen.devicePixelRatio();
    return seen.toImage().pixelColor(static_cast<int>((x + 0.5) * scale), static_cast<int>((y + 0.5) * scale));
}

/// A picture of one colour, with a plane for each scale.
inline frame::PictureRef Square(int size, std::uint32_t color, std::vector<double> scales = {1}) {
    std::vector<frame::PixelPlane> planes;
    for (const double scale : scales) {
        const int side = static_cast<int>(size * scale);
        planes.push_back({scale, side, side, std::vector<std::uint32_t>(static_cast<std::size_t>(side * side), color)});
    }
    return std::make_shared<frame::Picture>(std::move(planes), "");
}

}  // namespace tessel::qt::test
