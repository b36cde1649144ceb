#pragma once

#include <string_view>

#include "frame/Text.h"

/// The words that stand where a path may stand, and are the keys of their nodes. They compare without regard to case.
namespace tessel::controls::folderwords {

inline constexpr std::string_view myComputer = "My Computer";
inline constexpr std::string_view myDocuments = "My Documents";
inline constexpr std::string_view myFolders = "My Folders";

/// Whether the key is of a node that stands for no folder. "My Documents" has the path of its folder as its key.
inline bool IsWordOnly(std::string_view key) { return frame::EqualsNoCase(key, myComputer) || frame::EqualsNoCase(key, myFolders); }
inline bool IsWord(std::string_view text) { return IsWordOnly(text) || frame::EqualsNoCase(text, myDocuments); }

}  // namespace tessel::controls::folderwords
