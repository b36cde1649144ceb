#pragma once

#include <QString>

namespace tessel::gallery {

/// Renders every page in a light and a dark palette into `folder`, as "links-light-1x.png" or "files-icons-light-1x.png": the last
/// part is the scale of the screen, which QT_SCALE_FACTOR sets before the program starts. Prints the names of the files. The status
/// to exit with.
int TakeShots(const QString& folder);

}  // namespace tessel::gallery
