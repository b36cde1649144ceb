#pragma once

#include <string>
#include <string_view>

#include "frame/Error.h"

namespace tessel::posix {

/// Puts `bytes` at the start of a file, which keeps what stood behind them; makes the file where there is none.
///
/// The new contents are written and synced beside the file and take its name in one step, wherever the file keeps its owner, its
/// mode and its links that way. Where it would not (it has several names, attributes of its own, another owner, or its folder
/// cannot be written) the file is copied aside and synced first, room for the new end is taken, and then it is written in place; a
/// failure puts the old bytes back. The copy stands beside the file, or in `otherFolder` where that is not possible, under the
/// file's name with an ending of its own (".saved"), and stays only when a crash or a failing disk kept the file from being whole.
///
/// A link is followed: the file that it leads to is written.
frame::Status WriteOverFile(std::string_view path, std::string_view bytes, const std::string& otherFolder);

}  // namespace tessel::posix
