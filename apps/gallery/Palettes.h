#pragma once

#include <QPalette>

namespace tessel::gallery {

enum class Scheme { Light, Dark };

/// A palette of the scheme, the same on every desktop.
QPalette PaletteOf(Scheme scheme);

}  // namespace tessel::gallery
