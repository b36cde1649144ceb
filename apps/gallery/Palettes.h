#pragma once

#include <QPalette>

namespace tessel::gallery {

enum class Scheme { Light, Dark };

/// A palette of the scheme, the same on every desktop.
QPalette PaletteOf(Scheme scheme);

/// Makes the whole application follow a palette, with icons that can be seen on it where the desktop brings none of its own.
void Follow(const QPalette& palette);

}  // namespace tessel::gallery
