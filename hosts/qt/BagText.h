#pragma once

#include <QByteArray>

#include "frame/PropertyBag.h"

namespace tessel::qt {

/// The saved state of a control as a JSON object in ASCII characters: numbers, strings and booleans as themselves, an empty value
/// and no object as null, a date as
/// `{"date":days}`, a font as `{"font":name,"size":points,...}`, a picture as `{"picture":its file as PNG in base
/// 64,"source":...}`, a number that JSON lacks as `{"number":"inf"}`. Error 13 for a value of another kind.
QByteArray BagText(const frame::MemoryBag& bag);

/// Error 380 for a text that is none of those.
frame::MemoryBag BagOf(const QByteArray& text);

}  // namespace tessel::qt
