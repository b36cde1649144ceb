#pragma once

#include "controls/splitter/Splitter.h"
#include "hosts/qt/ControlWidget.h"

namespace tessel::qt {

/// What a user of a desktop expects of a bar beside what the control does: a pointer that tells which way it moves, a place in the
/// Tab order with a visible mark, the arrow keys, and a value for assistive programs.
///
/// The arrow keys along its way move the bar by `keyStep` pixels, with Shift by one; Home and End move it to its limits. They do
/// what a drag does: the controls follow, and `afterMove` comes.
///
/// The bar moves by its own place, so it stands on a form without a layout.
class SplitterWidget : public ControlWidget {
    Q_OBJECT

  public:
    static constexpr int keyStep = 8;

    controls::Splitter& splitter() const { return static_cast<controls::Splitter&>(control()); }

    /// Where the bar stands along its way and the limits of it, in pixels of the form.
    double position() const;
    double nearEnd() const;
    double farEnd() const;
    /// Moves it there, within the limits, as a drag does.
    void moveTo(double position);

  protected:
    SplitterWidget(const frame::ControlClass& controlClass, QWidget* parent);

    void started() override;
    void propertyChanged(std::string_view key) override;
    void keyPressEvent(QKeyEvent* event) override;
    void moveEvent(QMoveEvent* event) override;

  private:
    bool isUpright() const { return splitter().Orientation() == controls::tsOrientation::tsVertical; }
    void follow();
    void moveBy(float twips);
};

}  // namespace tessel::qt
