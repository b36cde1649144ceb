#pragma once

#include <QList>
#include <QString>

namespace tessel::gallery {

/// Something of this machine as a score from 0 (bad) to 1 (good).
struct Reading {
    enum class Kind { Disk, Memory, Processor };
    Kind kind = Kind::Disk;
    QString name;
    QString detail;
    double score = 0;
};

/// The free space of the disks, the memory that is left, and the processors that nobody waits for. Only what this system tells.
QList<Reading> ReadMachine();
/// The same of a machine that is always the same.
QList<Reading> SampleReadings();

}  // namespace tessel::gallery
