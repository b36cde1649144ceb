#include "hosts/qt/ControlWidget.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QImage>
#include <QPixmap>
#include <string>

#include "frame/ClassTable.h"

namespace tessel::qt {
namespace {

/// A control that draws on its own surface: a red line along its top edge, and nothing else.
class Drawer final : public frame::Control {
  public:
    using Control::Control;
    frame::TextSize DesignSize() const override { return {600, 300}; }
    void Resize() override { trace += "Resize "; }
    void Show() override { trace += "Show "; }
    void Hide() override { trace += "Hide "; }
    void Paint() override {
        trace += "Paint ";
        Surface().Cls();
        Surface().SetDrawWidth(2);
        Surface().Line(0, 0, Surface().ScaleWidth(), 0, frame::OLE_COLOR(0x0000FF));
    }
    const frame::ClassTable& Table() const override { return table; }
    static const frame::ClassTable table;

    std::string trace;
};

constexpr frame::ClassTable Drawer::table{.name = "Drawer", .members = {}};
const frame::ControlClass drawerClass{
    &Drawer::table, [](frame::Host& host) -> std::unique_ptr<frame::Control> { return std::make_unique<Drawer>(host); }};

class DrawerWidget final : public ControlWidget {
  public:
    explicit DrawerWidget(QWidget* parent = nullptr) : ControlWidget(drawerClass, parent) {}
    Drawer& drawer() const { return static_cast<Drawer&>(control()); }

  protected:
    bool hears(const frame::EventInfo&) const override { return false; }
    void raise(const frame::EventInfo&, frame::EventArguments) override {}
};

class ControlWidgetTest : public testing::Test {
  protected:
    /// What the control was told since the last call.
    std::string Told() {
        QCoreApplication::processEvents();
        return std::exchange(widget.drawer().trace, {});
    }

    DrawerWidget widget;
};

TEST_F(ControlWidgetTest, PaintComesAfterShowAndAgainForANewSizeAndNotForEachRepaint) {
    EXPECT_EQ(Told(), "Resize ");
    widget.show();
    EXPECT_EQ(Told(), "Show Paint ");
    widget.update();
    EXPECT_EQ(Told(), "");
    widget.resize(80, 40);
    EXPECT_EQ(Told(), "Resize Paint ");
    widget.hide();
    EXPECT_EQ(Told(), "Hide ");
    widget.show();
    EXPECT_EQ(Told(), "Show ");
}

TEST_F(ControlWidgetTest, PaintComesAgainForANewPalette) {
    widget.show();
    Told();
    widget.setPalette(QPalette(Qt::darkGray));
    EXPECT_EQ(Told(), "Paint ");
}

TEST_F(ControlWidgetTest, PictureOfAWidgetThatWasNeverShownHasTheDrawing) {
    const QImage seen = widget.grab().toImage();
    EXPECT_EQ(seen.pixelColor(seen.width() / 2, 0), QColor(Qt::red));
    EXPECT_NE(seen.pixelColor(seen.width() / 2, seen.height() / 2), QColor(Qt::red));
}

TEST_F(ControlWidgetTest, WhatWasDrawnPersists) {
    widget.show();
    Told();
    widget.drawer().Surface().PSet(300, 150, frame::OLE_COLOR(0xFF0000));
    for (int picture = 0; picture < 2; ++picture) {
        const QImage seen = widget.grab().toImage();
        const qreal scale = seen.devicePixelRatio();
        EXPECT_EQ(seen.pixelColor(static_cast<int>(20 * scale), static_cast<int>(10 * scale)), QColor(Qt::blue)) << picture;
    }
    EXPECT_EQ(Told(), "");
}

}  // namespace
}  // namespace tessel::qt
