#include "apps/gallery/Sample.h"

#include <QDateTime>
#include <QDir>
#include <QFile>
#include <QFileInfo>

namespace tessel::gallery {

std::unique_ptr<QTemporaryDir> MakeSample() {
    struct Sample {
        const char* name;
        qint64 size;
        int daysBefore;
    };
    static constexpr Sample samples[] = {
        {"Letters/To the council.odt", 48'213, 3},
        {"Letters/Thanks.odt", 18'990, 40},
        {"Music/Nocturne.ogg", 7'412'981, 400},
        {"Photographs/Harbour.jpg", 3'381'204, 12},
        {"Photographs/Lighthouse.jpg", 2'917'733, 12},
        {"Photographs/Pier.png", 912'430, 13},
        {"Source/main.cpp", 5'120, 1},
        {"Source/window.cpp", 20'311, 1},
        {"Accounts 2025.ods", 61'440, 320},
        {"Accounts 2026.ods", 72'704, 2},
        {"backup.tar.gz", 184'320'512, 30},
        {"Garden plan.svg", 88'210, 75},
        {"Minutes of May.pdf", 240'118, 180},
        {"Minutes of June.pdf", 251'904, 150},
        {"notes.txt", 1'204, 0},
        {"Packing list.txt", 380, 9},
        {"Recipes.html", 33'870, 210},
        {"Timetable.csv", 9'410, 61},
        {"Window.png", 402'113, 5},
        {"addresses.json", 15'023, 33},
    };
    auto folder = std::make_unique<QTemporaryDir>(QDir::tempPath() + "/Club-XXXXXX");
    const QDateTime now(QDate(2026, 6, 21), QTime(16, 40));
    for (const Sample& sample : samples) {
        const QString name = folder->filePath(sample.name);
        QDir().mkpath(QFileInfo(name).path());
        QFile file(name);
        if (!file.open(QIODevice::WriteOnly)) continue;
        file.resize(sample.size);
        constexpr int minutesApart = 37;
        file.setFileTime(now.addDays(-sample.daysBefore).addSecs(-60LL * minutesApart * (sample.size % minutesApart)),
                         QFileDevice::FileModificationTime);
    }
    return folder;
}

}  // namespace tessel::gallery
