#pragma once

#include <QCursor>

#include "frame/Picture.h"

namespace tessel::qt {

/// The pointer of a number of `MousePointer`: 0 and unknown numbers are the arrow. 99 is the picture, with its hot spot in the
/// middle.
QCursor CursorOf(int pointer, const frame::PictureRef& icon = {});

}  // namespace tessel::qt
