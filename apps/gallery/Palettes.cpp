#include "apps/gallery/Palettes.h"

#include <QApplication>
#include <QColor>
#include <QIcon>
#include <QStandardPaths>

namespace tessel::gallery {

QPalette PaletteOf(Scheme scheme) {
    if (scheme == Scheme::Light) {
        QPalette palette(QColor(0xEF, 0xEF, 0xEF));
        palette.setColor(QPalette::Base, Qt::white);
        palette.setColor(QPalette::Highlight, QColor(0x2A, 0x6F, 0xB5));
        palette.setColor(QPalette::HighlightedText, Qt::white);
        palette.setColor(QPalette::Shadow, QColor(0x76, 0x76, 0x76));
        return palette;
    }
    const QColor window(0x2B, 0x2D, 0x30), base(0x1E, 0x1F, 0x22), text(0xE6, 0xE6, 0xE6), faint(0x8C, 0x8F, 0x94);
    QPalette palette(text, QColor(0x3A, 0x3D, 0x41), QColor(0x50, 0x54, 0x59), QColor(0x18, 0x19, 0x1B), QColor(0x33, 0x35, 0x39),
                     text, Qt::white, base, window);
    palette.setColor(QPalette::AlternateBase, window);
    palette.setColor(QPalette::Highlight, QColor(0x4A, 0x90, 0xD9));
    palette.setColor(QPalette::HighlightedText, Qt::white);
    palette.setColor(QPalette::Shadow, QColor(0x10, 0x11, 0x12));
    palette.setColor(QPalette::Link, QColor(0x7F, 0xB4, 0xF0));
    palette.setColor(QPalette::PlaceholderText, faint);
    palette.setColor(QPalette::ToolTipBase, QColor(0x3A, 0x3D, 0x41));
    palette.setColor(QPalette::ToolTipText, text);
    for (const auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, faint);
    return palette;
}

void Follow(const QPalette& palette) {
    static const bool desktopHasIcons = !QIcon::themeName().isEmpty() && QIcon::themeName() != "hicolor";
    if (!desktopHasIcons) {
        QIcon::setThemeSearchPaths(
            QStandardPaths::locateAll(QStandardPaths::GenericDataLocation, "icons", QStandardPaths::LocateDirectory));
        constexpr int middle = 128;
        QIcon::setThemeName(palette.color(QPalette::Window).lightness() < middle ? "breeze-dark" : "breeze");
    }
    QApplication::setPalette(palette);
}

}  // namespace tessel::gallery
