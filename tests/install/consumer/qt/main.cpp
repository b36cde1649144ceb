#include <QApplication>
#include <iostream>

#include "hosts/qt/Link.h"

int main(int count, char** arguments) {
    QApplication program(count, arguments);
    tessel::qt::Link link;
    link.setCaption("Read the manual");
    link.setLinkTo("/no such folder/manual.txt");
    link.setSuppressMessages(true);
    QObject::connect(&link, &tessel::qt::Link::mouseDown,
                     [](short& button, short&, float&, float&) { std::cout << "pressed with button " << button << '\n'; });
    link.show();
    link.press();
    std::cout << link.openLink().toStdString() << '\n';
}
