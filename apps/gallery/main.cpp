#include <QApplication>
#include <QCommandLineParser>
#include <QStandardPaths>

#include "apps/gallery/Palettes.h"
#include "apps/gallery/Shots.h"
#include "apps/gallery/Window.h"

/// gallery [--shots folder]
int main(int count, char** arguments) {
    QApplication program(count, arguments);
    QApplication::setApplicationName("tesselcontrols4-gallery");
    QApplication::setApplicationDisplayName("Tesselcontrols4 Gallery");

    QCommandLineParser parser;
    parser.setApplicationDescription("Shows the controls of Tesselcontrols4 at work.");
    parser.addHelpOption();
    const QCommandLineOption shots("shots", "Renders every page into a folder and ends.", "folder");
    parser.addOption(shots);
    parser.process(program);

    if (parser.isSet(shots)) {
        QStandardPaths::setTestModeEnabled(true);  // the user's own files are none of a picture's
        QApplication::setStyle("Fusion");
        return tessel::gallery::TakeShots(parser.value(shots));
    }
    tessel::gallery::Follow(QApplication::palette());
    tessel::gallery::Window window;
    window.show();
    return QApplication::exec();
}
