#include "apps/gallery/Shots.h"

#include <QApplication>
#include <QDir>
#include <QPixmap>
#include <QTextStream>

#include "apps/gallery/Page.h"
#include "apps/gallery/Window.h"

namespace tessel::gallery {

int TakeShots(const QString& folder) {
    QTextStream out(stdout), complaint(stderr);
    if (!QDir().mkpath(folder)) {
        complaint << "gallery: cannot make the folder " << folder << '\n';
        return 1;
    }
    for (const auto& [scheme, name] : {std::pair(Scheme::Light, "light"), std::pair(Scheme::Dark, "dark")}) {
        Follow(PaletteOf(scheme));
        Window window;
        window.show();
        for (qsizetype i = 0; i < window.pages().size(); ++i) {
            Page* page = window.pages()[i];
            window.choose(static_cast<int>(i));
            for (const QString& pose : page->poses()) {
                QApplication::processEvents();
                page->pose(pose);
                QApplication::processEvents();
                const QString what = page->title().toLower() + (pose.isEmpty() ? QString() : '-' + pose);
                const QString file = QString("%1/%2-%3-%4x.png").arg(folder, what, name).arg(window.devicePixelRatioF());
                if (!window.grab().save(file)) {
                    complaint << "gallery: cannot write " << file << '\n';
                    return 1;
                }
                out << file << '\n';
            }
        }
    }
    return 0;
}

}  // namespace tessel::gallery
