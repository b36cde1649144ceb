#include <QAbstractItemView>
#include <QApplication>
#include <QComboBox>
#include <QEvent>
#include <QLineEdit>
#include <QSocketNotifier>
#include <QToolTip>
#include <QWidget>
#include <iostream>
#include <string>

#include "hosts/qt/DataList.h"
#include "hosts/qt/ScoreCard.h"
#include "hosts/qt/Splitter.h"

/// A form with a bar between two text boxes, a score and a list of pairs, for a test that works it with a real mouse and keyboard:
/// it says what happens on standard output, and answers requests of standard input. All lengths are pixels.
namespace {

using namespace tessel::qt;

void Say(const QString& line) { std::cout << line.toStdString() << std::endl; }

class Window final : public QWidget {
  public:
    Window() : left_(new QLineEdit(this)), right_(new QLineEdit(this)), bar_(new Splitter(this)), card_(new ScoreCard(this)) {
        setWindowTitle("desktop_controls");
        setWindowFlag(Qt::FramelessWindowHint);
        setGeometry(0, 0, 640, 480);
        makeBar();
        makeCard();
        makeList();
    }

    void answer(const QString& request) {
        const QString verb = request.section(' ', 0, 0), rest = request.section(' ', 1);
        Say(verb + ' ' + answered(verb, rest));
    }

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (watched == bar_ && event->type() == QEvent::Move) Say(QString("bar Moved %1").arg(bar_->x()));
        return QWidget::eventFilter(watched, event);
    }

  private:
    void makeBar() {
        left_->setObjectName("left");
        left_->setGeometry(0, 20, 220, 60);
        right_->setObjectName("right");
        right_->setGeometry(228, 20, 412, 60);
        bar_->setObjectName("bar");
        bar_->setOrientation(Splitter::tsVertical);
        bar_->setGeometry(220, 20, 8, 60);
        bar_->setControlsTopLeft("left");
        bar_->setControlsBottomRight("right");
        bar_->setMinTopLeft(50 * 15);
        bar_->setMinBottomRight(60 * 15);
        bar_->installEventFilter(this);
        connect(bar_, &Splitter::afterMove, this, [] { Say("bar AfterMove"); });
    }

    void makeCard() {
        card_->setObjectName("card");
        card_->setGeometry(20, 120, 160, 40);
        card_->setStyle(ScoreCard::Gauge);
        card_->setGeometry(20, 120, 160, 40);
        card_->setToolTip("Health");
        card_->setValue(0.5);
        const auto mouse = [](const char* name) {
            return [name](short& button, short& shift, float& x, float& y) {
                Say(QString("card %1 %2 %3 %4 %5").arg(name).arg(button).arg(shift).arg(x).arg(y));
            };
        };
        connect(card_, &ScoreCard::mouseDown, this, mouse("MouseDown"));
        connect(card_, &ScoreCard::mouseUp, this, mouse("MouseUp"));
        connect(card_, &ScoreCard::mouseMove, this,
                [this](short& button, short&, float& x, float& y) { moved_ = QString("%1 %2 %3").arg(button).arg(x).arg(y); });
        connect(card_, &ScoreCard::click, this, [] { Say("card Click"); });
        connect(card_, &ScoreCard::dblClick, this, [] { Say("card DblClick"); });
        card_->setFocusPolicy(Qt::StrongFocus);
        connect(card_, &ScoreCard::keyDown, this,
                [](short& key, short& shift) { Say(QString("card KeyDown %1 %2").arg(key).arg(shift)); });
        connect(card_, &ScoreCard::keyPress, this, [](short& ascii) { Say(QString("card KeyPress %1").arg(ascii)); });
        connect(card_, &ScoreCard::keyUp, this,
                [](short& key, short& shift) { Say(QString("card KeyUp %1 %2").arg(key).arg(shift)); });
    }

    void makeList() {
        list_ = new DataList(this);
        list_->setObjectName("list");
        list_->setGeometry(20, 200, 200, 30);
        int value = 0;
        for (const char* text : {"Red", "Green", "Blue", "Grey"}) list_->addItem(text, ++value);
        connect(list_, &DataList::click, this, [] { Say("list Click"); });
    }

    QString answered(const QString& verb, const QString& rest) {
        if (verb == "place") return placeOf(*findChild<QWidget*>(rest));
        if (verb == "focus") return nameOfFocus();
        if (verb == "tip") return QToolTip::isVisible() ? QToolTip::text() : QString();
        if (verb == "moved") return moved_;
        if (verb == "popup") return QApplication::activePopupWidget() ? "open" : "none";
        if (verb == "text") return list_->text();
        if (verb == "shown") return shown();
        if (verb == "row") return placeOfRow(rest.toInt());
        if (verb == "current") return combo()->view()->currentIndex().data().toString();
        if (verb == "lock") {
            list_->setLocked(rest == "on");
            list_->setSorted(list_->sorted());
            return rest;
        }
        return "what?";
    }

    /// The control that has the focus, or that the part with it belongs to.
    QString nameOfFocus() const {
        for (QWidget* widget = focusWidget(); widget && widget != this; widget = widget->parentWidget())
            if (widget->parentWidget() == this) return widget->objectName();
        return {};
    }

    static QString placeOf(const QWidget& widget) {
        const QPoint corner = widget.mapToGlobal(QPoint(0, 0));
        return QString("%1 %2 %3 %4").arg(corner.x()).arg(corner.y()).arg(widget.width()).arg(widget.height());
    }

    QString placeOfRow(int row) const {
        const QAbstractItemView* view = combo()->view();
        const QPoint center = view->viewport()->mapToGlobal(view->visualRect(view->model()->index(row, 0)).center());
        return QString("%1 %2").arg(center.x()).arg(center.y());
    }

    QComboBox* combo() const { return list_->findChild<QComboBox*>("listItems(0)"); }

    /// Which part of the list is seen.
    QString shown() const {
        QStringList parts;
        for (const char* part : {"labItem", "listItems(0)", "listItems(1)"})
            if (list_->findChild<QWidget*>(part)->isVisible()) parts << part;
        return parts.join(' ');
    }

    QLineEdit *left_, *right_;
    Splitter* bar_;
    ScoreCard* card_;
    DataList* list_ = nullptr;
    QString moved_;  // what the card heard of the pointer last
};

}  // namespace

int main(int count, char** arguments) {
    QApplication program(count, arguments);
    QApplication::setStyle("Fusion");
    Window window;
    window.show();
    window.activateWindow();
    QSocketNotifier input(0, QSocketNotifier::Read);
    QObject::connect(&input, &QSocketNotifier::activated, &window, [&window] {
        std::string line;
        if (std::getline(std::cin, line))
            window.answer(QString::fromStdString(line));
        else
            QApplication::quit();
    });
    std::cout << "ready" << std::endl;
    return QApplication::exec();
}
