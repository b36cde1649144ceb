#pragma once

#include <QString>

#include "frame/Picture.h"

namespace tessel::qt {

/// The icon of a file, folder or drive in the icon theme, 16 or 32 pixels at scale 1, with a plane for scale 2 beside; where the
/// theme has none, that of the widget style. A file is told by its name alone: none is opened. Null when nothing stands at
/// the path, or the icon is empty. `flags` as a shell icon request has them: 1 for the small form, 2 for the open one.
frame::PictureRef FileIcon(const QString& path, int flags);

}  // namespace tessel::qt
