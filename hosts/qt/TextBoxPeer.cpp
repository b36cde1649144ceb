#include "hosts/qt/TextBoxPeer.h"

#include <QBoxLayout>
#include <QFrame>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QTextBlock>
#include <algorithm>
#include <utility>

#include "hosts/qt/Convert.h"
#include "hosts/qt/KeyInput.h"
#include "hosts/qt/LabelPeer.h"
#include "hosts/qt/ListModel.h"
#include "hosts/qt/PointerInput.h"

namespace tessel::qt {

/// The border of a text box around its edit, and what it reports.
class TextBoxWidget final : public QFrame {
  public:
    explicit TextBoxWidget(child::TextBox& box);
    /// The text box goes: nothing is reported from now on.
    void Disconnect();
    void Follow();

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void changeEvent(QEvent* event) override;

  private:
    void TakeEdit();
    void TakeText();
    void TakeColors();
    void Edited();
    QString Text() const { return lines_ ? lines_->toPlainText() : line_->text(); }

    child::TextBox* box_;  // null once it has gone
    PointerInput pointer_;
    KeyInput* keys_;
    QLineEdit* line_ = nullptr;  // one of the two is there
    QPlainTextEdit* lines_ = nullptr;
    QWidget* pressed_ = nullptr;  // what gets the mouse: the edit, or the inside of one with several lines
    bool following_ = false;
    enum class Swap { None, Asked, Now };
    Swap swap_ = Swap::None;  // of the edit for one of the other kind, while nothing is seen
    std::string reported_;    // the text when it was last the same here and there
};

TextBoxWidget::TextBoxWidget(child::TextBox& box) : box_(&box), pointer_(box, *this), keys_(new KeyInput(box, this)) {
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    TakeEdit();
}

void TextBoxWidget::Disconnect() {
    box_ = nullptr;
    pointer_.Disconnect();
    keys_->Disconnect();
}

void TextBoxWidget::TakeEdit() {
    const bool wantsLines = box_->MultiLine();
    if (line_ || lines_) {
        if (wantsLines == (lines_ != nullptr)) return;
        // A window that is being destroyed hides what stands on it, and takes no new widgets then.
        if (!isVisible() && swap_ != Swap::Now) {
            if (std::exchange(swap_, Swap::Asked) == Swap::Asked) return;
            QMetaObject::invokeMethod(
                this,
                [this] {
                    swap_ = Swap::Now;
                    Follow();
                    swap_ = Swap::None;
                },
                Qt::QueuedConnection);
            return;
        }
        // What goes may be the sender of an event that is on the stack.
        QWidget* const leaving = lines_ ? static_cast<QWidget*>(lines_) : line_;
        leaving->removeEventFilter(this);
        pressed_->removeEventFilter(this);
        leaving->disconnect(this);
        leaving->hide();
        leaving->deleteLater();
        line_ = nullptr;
        lines_ = nullptr;
    }
    QWidget* edit = nullptr;
    if (wantsLines) {
        lines_ = new QPlainTextEdit(this);
        lines_->setFrameStyle(QFrame::NoFrame);
        lines_->setTabChangesFocus(true);
        connect(lines_, &QPlainTextEdit::textChanged, this, [this] { Edited(); });
        edit = lines_;
        pressed_ = lines_->viewport();
    } else {
        line_ = new QLineEdit(this);
        line_->setFrame(false);
        connect(line_, &QLineEdit::textChanged, this, [this] { Edited(); });
        edit = line_;
        pressed_ = line_;
    }
    layout()->addWidget(edit);
    edit->installEventFilter(this);
    if (pressed_ != edit) pressed_->installEventFilter(this);
    setFocusProxy(edit);
    edit->show();
    reported_.clear();
}

void TextBoxWidget::Follow() {
    if (!box_) return;
    following_ = true;
    TakeEdit();
    if (box_->BorderStyle() == child::LabelBorderConstants::None)
        setFrameStyle(QFrame::NoFrame);
    else if (box_->Appearance() == child::AppearanceConstants::Flat)
        setFrameStyle(QFrame::Box | QFrame::Plain);
    else
        setFrameStyle(QFrame::StyledPanel | QFrame::Sunken);
    const QFont font = ToQt(*box_->Font());
    if (this->font() != font) setFont(font);
    TakeText();
    const Qt::Alignment alignment = ToQt(box_->Alignment());
    if (line_) {
        line_->setAlignment(alignment | Qt::AlignVCenter);
        line_->setReadOnly(box_->Locked());
    } else {
        QTextOption option = lines_->document()->defaultTextOption();
        if (option.alignment() != alignment) {
            option.setAlignment(alignment);
            lines_->document()->setDefaultTextOption(option);
        }
        lines_->setReadOnly(box_->Locked());
    }
    TakeColors();
    following_ = false;
}

void TextBoxWidget::TakeText() {
    // The same text stays as the user left it, with the cursor where it is.
    if (box_->Text() == reported_ && !reported_.empty()) return;
    const QString text = ToQt(box_->Text());
    reported_ = box_->Text();
    if (text == Text()) return;
    if (line_) {
        const int cursor = line_->cursorPosition();
        line_->setText(text);
        line_->setCursorPosition(std::min(cursor, static_cast<int>(text.size())));
        return;
    }
    const int cursor = lines_->textCursor().position();
    lines_->setPlainText(text);
    QTextCursor place = lines_->textCursor();
    place.setPosition(std::min(cursor, static_cast<int>(lines_->document()->characterCount()) - 1));
    lines_->setTextCursor(place);
}

void TextBoxWidget::TakeColors() {
    constexpr int middle = 128;
    const frame::SystemColors& system = box_->Host().Colors();
    const frame::OLE_COLOR back = box_->BackColor(), fore = box_->ForeColor();
    QPalette wanted;
    if (back != frame::colors::windowBackground) wanted.setColor(QPalette::Base, ToQt(back, system));
    if (fore != frame::colors::windowText) {
        QColor text = ToQt(fore, system);
        const QColor behind = parentWidget() && back == frame::colors::windowBackground
                                  ? parentWidget()->palette().color(QPalette::Base)
                                  : ToQt(back, system);
        if (back.IsSystem() && behind.lightness() < middle) text = Readable(text, behind);
        wanted.setColor(QPalette::Active, QPalette::Text, text);
        wanted.setColor(QPalette::Inactive, QPalette::Text, text);
    }
    QWidget* const edit = lines_ ? static_cast<QWidget*>(lines_) : line_;
    if (edit->property("tessel_palette").value<QPalette>() == wanted) return;
    edit->setProperty("tessel_palette", wanted);
    edit->setPalette(wanted);
}

void TextBoxWidget::Edited() {
    if (following_ || !box_) return;
    reported_ = FromQt(Text());
    box_->ChangeInput(reported_);
}

bool TextBoxWidget::eventFilter(QObject* watched, QEvent* event) {
    if (!box_) return QFrame::eventFilter(watched, event);
    // The mouse's event in the box's own pixels.
    const auto inside = [&] {
        const auto& mouse = static_cast<const QMouseEvent&>(*event);
        const QPointF moved = pressed_->mapTo(this, mouse.position());
        return QMouseEvent(mouse.type(), moved, mouse.scenePosition(), mouse.globalPosition(), mouse.button(), mouse.buttons(),
                           mouse.modifiers());
    };
    switch (event->type()) {
        case QEvent::KeyPress:
            if (watched != pressed_ || line_) keys_->Press(static_cast<const QKeyEvent&>(*event));
            break;
        case QEvent::MouseButtonPress:
            if (watched == pressed_) pointer_.Press(inside());
            break;
        case QEvent::MouseMove:
            if (watched == pressed_) pointer_.Move(inside());
            break;
        case QEvent::MouseButtonRelease:
            if (watched == pressed_) pointer_.Release(inside());
            break;
        case QEvent::MouseButtonDblClick:
            if (watched == pressed_) pointer_.DoubleClick(inside());
            break;
        case QEvent::Leave:
            if (watched == pressed_) pointer_.Leave();
            break;
        default:
            return QFrame::eventFilter(watched, event);
    }
    // A handler may have ended the text box, or have turned it into the other kind of edit.
    return !box_ || (watched != pressed_ && watched != line_ && watched != lines_);
}

void TextBoxWidget::changeEvent(QEvent* event) {
    QFrame::changeEvent(event);
    if (event->type() == QEvent::PaletteChange && box_ && (line_ || lines_)) TakeColors();
}

TextBoxPeer::TextBoxPeer(child::TextBox& box) : TextBoxPeer(box, new TextBoxWidget(box)) {}

TextBoxPeer::TextBoxPeer(child::TextBox& box, TextBoxWidget* widget) : WidgetPeer(box, widget), shown_(widget) {}

TextBoxPeer::~TextBoxPeer() {
    if (shown_) shown_->Disconnect();
}

void TextBoxPeer::Update() {
    if (!shown_) return;
    FollowChild();
    shown_->Follow();
}

}  // namespace tessel::qt
