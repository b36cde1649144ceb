#include <QApplication>
#include <QClipboard>
#include <QImage>
#include <QPixmap>
#include <QScreen>
#include <QSocketNotifier>
#include <QWidget>
#include <algorithm>
#include <iostream>
#include <string>

#include "hosts/qt/Host.h"
#include "hosts/qt/Link.h"

/// A window of links for a test that works it with a real mouse and keyboard: it says what happens on standard output, and answers
/// requests of standard input. The arguments are targets, each as "name=target"; the links stand in one column, 300 by 24 pixels
/// each, every 30 pixels from (20, 10) of the screen on.
namespace {

using tessel::qt::Link;

class Window final : public QWidget {
  public:
    explicit Window(const QStringList& links) {
        setWindowTitle("desktop_links");
        setWindowFlag(Qt::FramelessWindowHint);
        setGeometry(0, 0, 640, 480);
        connect(tessel::qt::Host::of(this).get(), &tessel::qt::Host::unhandledError, this,
                [](int number, const QString&, const QString& where) {
                    std::cout << "error " << number << ' ' << where.toStdString() << std::endl;
                });
        for (const QString& link : links) add(link.section('=', 0, 0), link.section('=', 1));
    }

    void answer(const std::string& line) {
        const QStringList words = QString::fromStdString(line).split(' ');
        Link* link = words.size() > 1 ? findChild<Link*>(words[1]) : nullptr;
        if (words[0] == "color" && link)
            std::cout << "color " << strongestColor(*link).name().toStdString() << std::endl;
        else if (words[0] == "open" && link)
            std::cout << "open " << link->openLink().toStdString() << std::endl;
        else if (words[0] == "focus")
            std::cout << "focus " << (focusWidget() ? focusWidget()->objectName().toStdString() : "") << std::endl;
        else if (words[0] == "popup")
            std::cout << "popup " << (QApplication::activePopupWidget() ? "open" : "none") << std::endl;
        else if (words[0] == "clipboard")
            std::cout << "clipboard " << QGuiApplication::clipboard()->text().toStdString() << std::endl;
        else if (words[0] == "cursor" && link)
            std::cout << "cursor "
                      << (link->childAt(link->rect().center())->cursor().shape() == Qt::PointingHandCursor ? "hand" : "other")
                      << std::endl;
        else
            std::cout << "what?" << std::endl;
    }

  private:
    void add(const QString& name, const QString& target) {
        auto* link = new Link(this);
        link->setObjectName(name);
        link->setGeometry(20, 10 + 30 * count_++, 300, 24);
        link->setCaption(name);
        link->setLinkTo(target);
        if (name.startsWith("quiet")) link->setSuppressMessages(true);
        if (name.contains("Print")) link->setClickAction(Link::Print_Link);
        const auto say = [name](const char* event) { std::cout << name.toStdString() << ' ' << event << std::endl; };
        connect(link, &Link::mouseDown, this, [say] { say("MouseDown"); });
        connect(link, &Link::mouseUp, this, [say] { say("MouseUp"); });
        connect(link, &Link::click, this, [say] { say("Click"); });
        connect(link, &Link::dblClick, this, [say] { say("DblClick"); });
    }

    /// The most colourful pixel that the screen shows of a link.
    QColor strongestColor(const Link& link) const {
        const QImage seen = screen()->grabWindow(0, link.x() + x(), link.y() + y(), link.width(), link.height()).toImage();
        QColor strongest;
        int strength = -1;
        for (int row = 0; row < seen.height(); ++row)
            for (int column = 0; column < seen.width(); ++column) {
                const QColor color = seen.pixelColor(column, row);
                const int parts[] = {color.red(), color.green(), color.blue()};
                const int spread = *std::max_element(parts, parts + 3) - *std::min_element(parts, parts + 3);
                if (spread <= strength) continue;
                strength = spread;
                strongest = color;
            }
        return strongest;
    }

    int count_ = 0;
};

}  // namespace

int main(int count, char** arguments) {
    QApplication program(count, arguments);
    QApplication::setStyle("Fusion");
    Window window(QApplication::arguments().mid(1));
    window.show();
    window.activateWindow();
    QSocketNotifier input(0, QSocketNotifier::Read);
    QObject::connect(&input, &QSocketNotifier::activated, &window, [&window] {
        std::string line;
        if (std::getline(std::cin, line))
            window.answer(line);
        else
            QApplication::quit();
    });
    std::cout << "ready" << std::endl;
    return QApplication::exec();
}
