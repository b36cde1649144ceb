#pragma once

#include <string_view>

#include "frame/Picture.h"

/// The pictures that stand in the image lists of the two file controls from the start.
namespace tessel::fileservices::designimages {

inline constexpr std::string_view driveUnavailable = "Drive Unavailable";
inline constexpr std::string_view folderUnavailable = "FolderUnavailable";
inline constexpr std::string_view fileFolder = "File Folder";
inline constexpr std::string_view myComputer = "My Computer";
inline constexpr std::string_view myFolders = "My Folders";
inline constexpr std::string_view sortDown = "SortDown";
inline constexpr std::string_view sortUp = "SortUp";

/// The picture of one of these names, `side` pixels wide and high (a multiple of 16); a clear one for any other name.
frame::PictureRef Draw(std::string_view name, int side);

}  // namespace tessel::fileservices::designimages
