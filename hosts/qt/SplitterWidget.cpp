#include "hosts/qt/SplitterWidget.h"

#include <QAccessibleWidget>
#include <QKeyEvent>
#include <QPointer>
#include <algorithm>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

double SplitterWidget::position() const { return PixelsExactly(splitter().Place()); }

double SplitterWidget::nearEnd() const { return std::min(PixelsExactly(splitter().NearEnd()), farEnd()); }

double SplitterWidget::farEnd() const {
    const auto end = splitter().FarEnd();
    return end ? PixelsExactly(*end) : position();
}

void SplitterWidget::moveTo(double position) { moveBy(Twips(position) - splitter().Place()); }

void SplitterWidget::moveBy(float twips) {
    if (!isEnabled() || !host()->userMode()) return;
    controls::Splitter& bar = splitter();
    frame::Entry::Run(
        bar.Host(), [&] { return bar.Path() + ".MoveBy"; }, [&] { bar.MoveBy(twips); });
}

void SplitterWidget::started() { follow(); }

void SplitterWidget::propertyChanged(std::string_view key) {
    if (key == "Orientation") follow();
    ControlWidget::propertyChanged(key);
}

void SplitterWidget::follow() { setPointer(isUpright() ? Qt::SizeHorCursor : Qt::SizeVerCursor); }

void SplitterWidget::keyPressEvent(QKeyEvent* event) {
    const QPointer<SplitterWidget> alive = this;
    ControlWidget::keyPressEvent(event);
    if (!alive) return;
    const float step = Twips(event->modifiers() & Qt::ShiftModifier ? 1 : keyStep);
    const int back = isUpright() ? Qt::Key_Left : Qt::Key_Up, forth = isUpright() ? Qt::Key_Right : Qt::Key_Down;
    if (event->key() == back)
        moveBy(-step);
    else if (event->key() == forth)
        moveBy(step);
    else if (event->key() == Qt::Key_Home)
        moveTo(nearEnd());
    else if (event->key() == Qt::Key_End)
        moveTo(farEnd());
    else
        return;
    if (alive) event->accept();
}

void SplitterWidget::moveEvent(QMoveEvent* event) {
    ControlWidget::moveEvent(event);
    if (!isSettled() || !QAccessible::isActive()) return;
    QAccessibleValueChangeEvent moved(this, position());
    QAccessible::updateAccessibility(&moved);
}

// What assistive programs see.

namespace {

class AccessibleBar final : public QAccessibleWidget, public QAccessibleValueInterface {
  public:
    explicit AccessibleBar(SplitterWidget& bar) : QAccessibleWidget(&bar, QAccessible::Splitter), bar_(bar) {}

    void* interface_cast(QAccessible::InterfaceType type) override {
        if (type == QAccessible::ValueInterface) return static_cast<QAccessibleValueInterface*>(this);
        return QAccessibleWidget::interface_cast(type);
    }
    QString text(QAccessible::Text kind) const override {
        const QString given = QAccessibleWidget::text(kind);
        if (kind == QAccessible::Name && given.isEmpty()) return SplitterWidget::tr("Splitter");
        return given;
    }
    // Its surface is no part of its own.
    int childCount() const override { return 0; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }

    QVariant currentValue() const override { return bar_.position(); }
    void setCurrentValue(const QVariant& value) override { bar_.moveTo(value.toDouble()); }
    QVariant minimumValue() const override { return bar_.nearEnd(); }
    QVariant maximumValue() const override { return bar_.farEnd(); }
    QVariant minimumStepSize() const override { return 1; }

  private:
    SplitterWidget& bar_;
};

QAccessibleInterface* MakeAccessibleBar(const QString&, QObject* object) {
    auto* bar = qobject_cast<SplitterWidget*>(object);
    return bar ? new AccessibleBar(*bar) : nullptr;
}

}  // namespace

SplitterWidget::SplitterWidget(const frame::ControlClass& controlClass, QWidget* parent) : ControlWidget(controlClass, parent) {
    QAccessible::installFactory(MakeAccessibleBar);
    setFocusPolicy(Qt::TabFocus);
}

}  // namespace tessel::qt
