#pragma once

#include <QPointer>

#include "controls/link/Link.h"
#include "hosts/qt/ControlWidget.h"

namespace tessel::qt {

/// What a user of a desktop expects of a link beside what the control does: a pointing hand, a place in the Tab order with a
/// visible ring, Enter and Space as a press in its middle, a context menu, a name for assistive programs.
class LinkWidget : public ControlWidget {
    Q_OBJECT

  public:
    ~LinkWidget() override;

    controls::Link& link() const { return static_cast<controls::Link&>(control()); }
    /// What a press opens or prints: `LinkTo`, the caption when that is empty.
    QString target() const;
    /// A press and release of the left button in the middle, as the keys and assistive programs do it.
    void press();
    QSize minimumSizeHint() const override;
    bool hasHeightForWidth() const override;
    int heightForWidth(int width) const override;

  public slots:
    /// Opens the target, whatever `ClickAction` says; nothing for an empty one.
    void openTarget();
    /// Puts the target on the clipboard as text.
    void copyTarget();

  protected:
    LinkWidget(const frame::ControlClass& controlClass, QWidget* parent);

    QSize preferredSize() const override;
    bool sizesItself() const override { return link().AutoSize(); }
    void started() override;
    void propertyChanged(std::string_view key) override;
    bool event(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void contextMenuEvent(QContextMenuEvent* event) override;

  private:
    void pressMiddle();
    void releaseMiddle(bool click);
    void follow();
    /// Not while it is disabled, and not at design time.
    bool takesInput() const;
    QSize textSize(std::optional<float> wrapWidth) const;

    class Ring;
    QPointer<QWidget> ring_;  // stands beside this widget on what holds both, while there is a focus
    int heldKey_ = 0;         // whose release is awaited
};

}  // namespace tessel::qt
