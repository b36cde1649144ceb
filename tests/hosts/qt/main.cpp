#include <gmock/gmock.h>

#include <QApplication>

/// Tests with widgets.
int main(int count, char** arguments) {
    testing::InitGoogleMock(&count, arguments);
    QApplication program(count, arguments);
    QApplication::setStyle("Fusion");
    QApplication::setQuitOnLastWindowClosed(false);
    return RUN_ALL_TESTS();
}
