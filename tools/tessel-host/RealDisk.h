#pragma once

#include <memory>
#include <string>

#include "frame/FileSystem.h"

namespace tessel::tools {

/// The machine's own file system; null on systems for which the project has none.
std::unique_ptr<frame::FileSystem> MakeRealDisk();

/// Gives a special folder of a disk made here another path; empty for none.
void SetSpecialFolder(frame::FileSystem& realDisk, int number, std::string path);

}  // namespace tessel::tools
