#include "apps/gallery/Readings.h"

#include <QCoreApplication>
#include <QFile>
#include <QLocale>
#include <QSet>
#include <QStorageInfo>
#include <QThread>
#include <algorithm>

namespace tessel::gallery {

namespace {

QString Tr(const char* text) { return QCoreApplication::translate("Readings", text); }

Reading DiskReading(const QString& name, double free, double total) {
    const QLocale locale;
    return {Reading::Kind::Disk, name,
            Tr("%1 of %2 free")
                .arg(locale.formattedDataSize(static_cast<qint64>(free)), locale.formattedDataSize(static_cast<qint64>(total))),
            free / total};
}

Reading MemoryReading(double available, double total) {
    const QLocale locale;
    return {
        Reading::Kind::Memory, Tr("Memory"),
        Tr("%1 of %2 left")
            .arg(locale.formattedDataSize(static_cast<qint64>(available)), locale.formattedDataSize(static_cast<qint64>(total))),
        available / total};
}

Reading ProcessorReading(double load, int processors) {
    return {Reading::Kind::Processor, Tr("Processors"),
            Tr("load %1 on %2 of them").arg(QLocale().toString(load, 'f', 2)).arg(processors),
            std::clamp(1 - load / processors, 0.0, 1.0)};
}

void AddDisks(QList<Reading>& readings) {
    constexpr qsizetype mostDisks = 3;
    QSet<QByteArray> seen;
    for (const QStorageInfo& disk : QStorageInfo::mountedVolumes()) {
        if (!disk.isValid() || !disk.isReady() || disk.bytesTotal() <= 0 || seen.contains(disk.device())) continue;
        if (disk.isReadOnly() || readings.size() == mostDisks) continue;
        seen << disk.device();
        readings << DiskReading(disk.displayName(), static_cast<double>(disk.bytesAvailable()),
                                static_cast<double>(disk.bytesTotal()));
    }
}

/// A line of /proc/meminfo in bytes; 0 where there is none.
double MemoryLine(const QByteArray& text, const char* name) {
    const qsizetype place = text.indexOf(QByteArray(name) + ':');
    if (place < 0) return 0;
    const QByteArray line = text.mid(place, text.indexOf('\n', place) - place).simplified();
    constexpr double kilobyte = 1024;
    return line.split(' ').value(1).toDouble() * kilobyte;
}

void AddMemory(QList<Reading>& readings) {
    QFile file("/proc/meminfo");
    if (!file.open(QIODevice::ReadOnly)) return;
    const QByteArray text = file.readAll();
    const double total = MemoryLine(text, "MemTotal"), available = MemoryLine(text, "MemAvailable");
    if (total > 0) readings << MemoryReading(available, total);
}

void AddProcessors(QList<Reading>& readings) {
    QFile file("/proc/loadavg");
    if (!file.open(QIODevice::ReadOnly)) return;
    bool isNumber = false;
    const double load = file.readAll().split(' ').value(0).toDouble(&isNumber);
    if (isNumber) readings << ProcessorReading(load, std::max(1, QThread::idealThreadCount()));
}

}  // namespace

QList<Reading> ReadMachine() {
    QList<Reading> readings;
    AddDisks(readings);
    AddMemory(readings);
    AddProcessors(readings);
    return readings;
}

QList<Reading> SampleReadings() {
    constexpr double gigabyte = 1e9;
    return {DiskReading("/", 17 * gigabyte, 120 * gigabyte), DiskReading("/home", 412 * gigabyte, 500 * gigabyte),
            DiskReading("/media/photos", 28 * gigabyte, 64 * gigabyte), MemoryReading(10.6 * gigabyte, 16 * gigabyte),
            ProcessorReading(1.34, 4)};
}

}  // namespace tessel::gallery
