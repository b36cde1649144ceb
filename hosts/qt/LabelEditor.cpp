#include "hosts/qt/LabelEditor.h"

#include <QKeyEvent>

namespace tessel::qt {

LabelEditor::LabelEditor(const QString& text, QWidget* parent) : QLineEdit(text, parent) {
    setObjectName("qt_tessel_label_editor");
    setTextMargins(0, 0, 0, 0);
    selectAll();
}

bool LabelEditor::event(QEvent* event) {
    // What the program has as shortcuts stays text here.
    if (event->type() == QEvent::ShortcutOverride) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Escape || key == Qt::Key_Return || key == Qt::Key_Enter) event->accept();
    }
    return QLineEdit::event(event);
}

void LabelEditor::keyPressEvent(QKeyEvent* event) {
    switch (event->key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
            End(true);
            break;
        case Qt::Key_Escape:
            End(false);
            break;
        default:
            QLineEdit::keyPressEvent(event);
            break;
    }
    event->accept();
}

void LabelEditor::keyReleaseEvent(QKeyEvent* event) {
    QLineEdit::keyReleaseEvent(event);
    event->accept();
}

void LabelEditor::focusOutEvent(QFocusEvent* event) {
    QLineEdit::focusOutEvent(event);
    if (event->reason() != Qt::ActiveWindowFocusReason && event->reason() != Qt::PopupFocusReason) End(true);
}

void LabelEditor::End(bool accept) {
    if (over_) return;
    over_ = true;
    if (accept)
        emit accepted(text());
    else
        emit givenUp();
}

}  // namespace tessel::qt
