#include "hosts/qt/LinkWidget.h"

#include <QAccessibleWidget>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QFocusFrame>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QMenu>
#include <QPainter>

#include "hosts/qt/Convert.h"
#include "hosts/qt/Site.h"

namespace tessel::qt {

namespace {

constexpr std::int16_t leftButton = 1, noShift = 0;

bool Presses(int key) { return key == Qt::Key_Return || key == Qt::Key_Enter || key == Qt::Key_Space || key == Qt::Key_Select; }

}  // namespace

/// Stands around the text, so that nothing of it is covered.
class LinkWidget::Ring final : public QFocusFrame {
  public:
    Ring() { setObjectName("qt_tessel_ring"); }

  protected:
    void paintEvent(QPaintEvent*) override {
        constexpr double width = 1.5, rounding = 2.5;
        QPainter painter(this);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(QPen(palette().color(QPalette::Highlight), width));
        painter.drawRoundedRect(QRectF(rect()).adjusted(width / 2, width / 2, -width / 2, -width / 2), rounding, rounding);
    }
};

LinkWidget::~LinkWidget() { delete ring_; }

QString LinkWidget::target() const { return ToQt(link().LinkTo().empty() ? link().Caption() : link().LinkTo()); }

void LinkWidget::press() {
    const QPointer<LinkWidget> alive = this;
    pressMiddle();
    if (alive) releaseMiddle(true);
}

// As the control's own press does it, in the middle of the label.
void LinkWidget::pressMiddle() {
    if (!takesInput()) return;
    child::Label& label = link().Label1;
    label.MouseDownInput(leftButton, noShift, label.Width() / 2, label.Height() / 2);
}

void LinkWidget::releaseMiddle(bool click) {
    if (!takesInput()) return;
    const QPointer<LinkWidget> alive = this;
    child::Label& label = link().Label1;
    label.MouseUpInput(leftButton, noShift, label.Width() / 2, label.Height() / 2);
    if (click && alive) link().Label1.ClickInput();
}

void LinkWidget::openTarget() { call("OpenLink", {target()}); }

void LinkWidget::copyTarget() { QGuiApplication::clipboard()->setText(target()); }

// Size and look.

QSize LinkWidget::textSize(std::optional<float> wrapWidth) const {
    const child::Label& label = link().Label1;
    const float border = label.BorderStyle() != child::LabelBorderConstants::None ? 2 * frame::borderTwips : 0;
    if (wrapWidth) wrapWidth = std::max(*wrapWidth - border, frame::twipsPerPixel);
    const frame::TextSize text = host()->frameHost().Metrics().Measure(*label.Font(), label.Caption(), wrapWidth);
    return PixelRect(0, 0, text.width + border, text.height + border).size();
}

QSize LinkWidget::preferredSize() const { return textSize({}); }

QSize LinkWidget::minimumSizeHint() const {
    if (!isSettled() || sizesItself()) return sizeHint();
    constexpr int least = 16;
    return {least, textSize({}).height()};
}

bool LinkWidget::hasHeightForWidth() const { return isSettled() && link().WordWrap(); }

int LinkWidget::heightForWidth(int width) const { return textSize(Twips(width)).height(); }

void LinkWidget::started() { follow(); }

void LinkWidget::propertyChanged(std::string_view key) {
    if (key == "Caption") {
        QAccessibleEvent named(this, QAccessible::NameChanged);
        QAccessible::updateAccessibility(&named);
    }
    follow();
    ControlWidget::propertyChanged(key);
}

void LinkWidget::follow() {
    const bool leads = host()->userMode() && link().ClickAction() != controls::ClickActionConstants::Do_nothing;
    setPointer(leads ? Qt::PointingHandCursor : Qt::ArrowCursor);
    updateGeometry();
}

bool LinkWidget::takesInput() const { return isEnabled() && host()->userMode(); }

bool LinkWidget::event(QEvent* event) {
    // Before a shortcut of the window that copies what is selected there.
    if (event->type() == QEvent::ShortcutOverride && static_cast<QKeyEvent*>(event)->matches(QKeySequence::Copy)) event->accept();
    const bool result = ControlWidget::event(event);
    // The label covers this widget and shows its own copy of the tool tip.
    if (event->type() == QEvent::ToolTipChange && isVisible()) call("Refresh", {});
    return result;
}

// Keys.

void LinkWidget::keyPressEvent(QKeyEvent* event) {
    if (event->matches(QKeySequence::Copy)) return copyTarget();
    if (!Presses(event->key()) || !takesInput()) return ControlWidget::keyPressEvent(event);
    if (event->isAutoRepeat() || heldKey_ != 0) return;
    heldKey_ = event->key();
    pressMiddle();
}

void LinkWidget::keyReleaseEvent(QKeyEvent* event) {
    if (event->isAutoRepeat() || event->key() != heldKey_) return ControlWidget::keyReleaseEvent(event);
    heldKey_ = 0;
    releaseMiddle(true);
}

void LinkWidget::focusInEvent(QFocusEvent* event) {
    ControlWidget::focusInEvent(event);
    if (isWindow()) return;
    delete ring_;
    auto* ring = new Ring;
    ring->setWidget(this);
    ring_ = ring;
}

void LinkWidget::focusOutEvent(QFocusEvent* event) {
    ControlWidget::focusOutEvent(event);
    delete ring_;
    if (std::exchange(heldKey_, 0) != 0) releaseMiddle(false);
}

void LinkWidget::contextMenuEvent(QContextMenuEvent* event) {
    if (!takesInput()) return ControlWidget::contextMenuEvent(event);
    auto* menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    QAction* open = menu->addAction(tr("&Open"), this, &LinkWidget::openTarget);
    menu->addAction(tr("&Copy"), this, &LinkWidget::copyTarget);
    for (QAction* action : menu->actions()) action->setEnabled(!target().isEmpty());
    menu->setDefaultAction(open);
    const bool byMouse = event->reason() == QContextMenuEvent::Mouse;
    menu->popup(byMouse ? event->globalPos() : mapToGlobal(rect().bottomLeft()));
}

// What assistive programs see.

namespace {

class AccessibleLink final : public QAccessibleWidget {
  public:
    explicit AccessibleLink(LinkWidget& link) : QAccessibleWidget(&link, QAccessible::Link), link_(link) {}

    QString text(QAccessible::Text kind) const override {
        if (kind == QAccessible::Name && link_.accessibleName().isEmpty()) return ToQt(link_.link().Caption());
        if (kind == QAccessible::Description && link_.accessibleDescription().isEmpty()) return link_.target();
        return QAccessibleWidget::text(kind);
    }
    // The text is the link's own name, no part that is read again.
    int childCount() const override { return 0; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }
    QStringList actionNames() const override { return {pressAction(), setFocusAction()}; }
    void doAction(const QString& name) override {
        if (name == pressAction())
            link_.press();
        else
            QAccessibleWidget::doAction(name);
    }

  private:
    LinkWidget& link_;
};

QAccessibleInterface* MakeAccessibleLink(const QString&, QObject* object) {
    auto* link = qobject_cast<LinkWidget*>(object);
    return link ? new AccessibleLink(*link) : nullptr;
}

}  // namespace

LinkWidget::LinkWidget(const frame::ControlClass& controlClass, QWidget* parent) : ControlWidget(controlClass, parent) {
    QAccessible::installFactory(MakeAccessibleLink);
    setFocusPolicy(Qt::TabFocus);
    connect(host().get(), &Host::userModeChanged, this, [this] {
        if (isSettled()) follow();
    });
    setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Preferred);
}

}  // namespace tessel::qt
