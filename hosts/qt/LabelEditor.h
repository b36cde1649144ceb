#pragma once

#include <QLineEdit>

namespace tessel::qt {

/// The edit of a row's label. It ends once: accepted by Enter and when the focus goes elsewhere in the window, or given up by
/// Escape. No key of it reaches the list.
class LabelEditor final : public QLineEdit {
    Q_OBJECT

  public:
    LabelEditor(const QString& text, QWidget* parent);

  signals:
    void accepted(const QString& text);
    void givenUp();

  protected:
    bool event(QEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;

  private:
    void End(bool accept);

    bool over_ = false;
};

}  // namespace tessel::qt
