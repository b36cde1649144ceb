#pragma once

#include <string>
#include <string_view>

#include "frame/FileSystem.h"

/// Paths as texts. Any bytes may be given; nothing is asked of a disk where a separator is all that is needed.
///
/// A path is a root, which may be empty, and names parted by separators; several separators in a row count as one, and those at
/// the end count nothing. A root is one separator; where that is the backslash also "C:", "C:\", "\\server\name" and
/// "\\server\name\".
namespace tessel::fileservices {

/// Joins two parts with exactly one separator, whatever they end and begin with. An empty parent gives `name` as it stands.
std::string BuildPath(std::string_view parent, std::string_view name, char separator);

/// The last name of a path, a part of it; empty for a root.
std::string_view GetFileName(std::string_view path, char separator);

/// What stands behind the last point of the last name, a part of the path; empty where there is none.
std::string_view GetExtensionName(std::string_view path, char separator);

/// The path without its last name, a part of it: a root keeps its separator, "C:\a" gives "C:\". Empty for a root and for a lone
/// name.
std::string_view GetParentFolderName(std::string_view path, char separator);

/// The same where drives may stand anywhere: empty for the root of a drive, and a parent that is one is spelt as one.
std::string GetParentFolderName(std::string_view path, frame::FileSystem& files);

}  // namespace tessel::fileservices
