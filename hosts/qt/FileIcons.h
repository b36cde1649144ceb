#pragma once

#include <QString>
#include <map>
#include <tuple>

#include "frame/Picture.h"

namespace tessel::qt {

/// The icons of files, folders and drives in the icon theme, 16 or 32 pixels at scale 1, with a plane for scale 2 beside; where the
/// theme has none, those of the widget style. Each is made once: what looks the same is the same picture.
class FileIcons {
  public:
    /// A file is told by its name alone: none is opened. Null when nothing stands at the path, or the icon is empty. `flags` as a
    /// shell icon request has them: 1 for the small form, 2 for the open one.
    frame::PictureRef Of(const QString& path, int flags);

  private:
    std::map<std::tuple<QString, int, int>, frame::PictureRef> known_;  // by theme's name, style's icon, side
    QString look_;                                                      // the theme and style whose icons they are
};

}  // namespace tessel::qt
