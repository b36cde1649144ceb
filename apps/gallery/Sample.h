#pragma once

#include <QTemporaryDir>
#include <memory>

namespace tessel::gallery {

/// A folder of files as a club might keep them, for pictures: the same in each. Their sizes are real, their contents empty.
std::unique_ptr<QTemporaryDir> MakeSample();

}  // namespace tessel::gallery
