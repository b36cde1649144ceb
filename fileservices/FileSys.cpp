#include "fileservices/FileSys.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::fileservices {

using frame::Variant;
using Kind = frame::FileOperation::Kind;

namespace {
constexpr int renameOnCollision = 8, allowUndo = 64;
}

std::int32_t FileSys::FileSizeKB(double bytes) const {  // NOLINT: a row calls it
    constexpr double kilobyte = 1024;
    if (bytes == 0) return 0;
    if (bytes < kilobyte) return 1;
    const double size = std::floor((bytes + kilobyte - 1) / kilobyte);
    if (!(size <= std::numeric_limits<std::int32_t>::max())) throw frame::ControlError(frame::errors::overflow);
    return static_cast<std::int32_t>(size);
}

std::string FileSys::FileSizeText(double bytes) const { return host_.Locale().Grouped(FileSizeKB(bytes)) + " KB"; }

std::string FileSys::DriveTypeWord(const DriveRef& drive) const {  // NOLINT: a row calls it
    if (!drive) frame::ThrowObjectGone();
    switch (drive->DriveType()) {
        case frame::driveTypes::removable:
            return "Removable Disk";
        case frame::driveTypes::fixed:
            return "Local Disk";
        case frame::driveTypes::network:
            if (!drive->IsReady()) return "Drive Unavailable";
            return drive->DriveLetter().empty() ? "Network Folder" : "Network Disk";
        case frame::driveTypes::compactDisk:
            return "Compact Disk";
        case frame::driveTypes::ramDisk:
            return "RAM Disk";
        default:
            return "Unknown Disk";
    }
}

std::string FileSys::FileOpCopy(std::int32_t, const Variant& sources, const Variant& destination) const {
    return RunFileOperation(Kind::Copy, renameOnCollision, sources, destination);
}

std::string FileSys::FileOpMove(std::int32_t, const Variant& sources, const Variant& destination) const {
    return RunFileOperation(Kind::Move, renameOnCollision, sources, destination);
}

std::string FileSys::FileOpDelete(std::int32_t, const Variant& sources, bool permanent) const {
    return RunFileOperation(Kind::Delete, permanent ? 0 : allowUndo, sources, "");
}

std::string FileSys::PathListForOperation(const Variant& paths) {
    std::string list;
    if (paths.Type() == frame::VarType::Array) {
        const std::vector<Variant>& items = paths.ToArray().items;
        for (std::size_t i = 0; i < items.size(); ++i) {
            if (i > 0) list += '\0';
            list += items[i].ToText();
        }
    } else {
        // A path with a comma in its name falls apart: lists that came as one text cannot be told from it.
        list = paths.ToText();
        std::replace(list.begin(), list.end(), ',', '\0');
    }
    return list.append(2, '\0');
}

std::vector<std::string> FileSys::PathsIn(std::string_view list) {
    std::vector<std::string> paths;
    while (!list.empty() && list.front() != '\0') {
        const std::string_view path = list.substr(0, list.find('\0'));
        paths.emplace_back(path);
        list.remove_prefix(std::min(path.size() + 1, list.size()));
    }
    return paths;
}

std::string FileSys::RunFileOperation(Kind kind, int flags, const Variant& from, const Variant& to) const {
    const frame::FileOperationResult result = host_.Run(
        {.kind = kind, .flags = flags, .from = PathsIn(PathListForOperation(from)), .to = PathsIn(PathListForOperation(to))});
    if (result.code != 0) return frame::Decimal(result.systemError);
    return result.aborted ? "Operation cancelled" : "";
}

std::string FileSys::ShellRunVerb(std::int32_t, const std::string& path, std::string_view verb) const {
    constexpr int fileNotFound = 2, pathNotFound = 3, noProgram = 31, lastFailure = 32;
    if (path.empty()) return "No file specified.";
    const int result = host_.Execute(verb, path);
    if (result > lastFailure) return "";
    if (result == noProgram) return "No application associated with file";
    if (result == fileNotFound || result == pathNotFound) return "Unable to find file";
    return "Unable to view file";
}

namespace {

constexpr std::array members = {
    frame::method<&FileSys::FileSizeKB>("FileSizeKB", "A size in kilobytes, rounded up.", {"Size"}),
    frame::method<&FileSys::FileSizeText>("FileSizeText", "A size as text, in kilobytes.", {"Size"}),
    frame::method<&FileSys::DriveTypeWord>("DriveTypeWord", "The word for the type of a drive.", {"Drive"}),
    frame::method<&FileSys::FileOpCopy>("FileOpCopy", "Copies through the shell.", {"Window", "Sources", "Destination"}),
    frame::method<&FileSys::FileOpMove>("FileOpMove", "Moves through the shell.", {"Window", "Sources", "Destination"}),
    frame::method<&FileSys::FileOpDelete>("FileOpDelete", "Deletes through the shell.", {"Window", "Sources", "Permanent"}),
    frame::method<&FileSys::ShellOpenFile>("ShellOpenFile", "Opens what a path names.", {"Window", "Path"}),
    frame::method<&FileSys::ShellPrintFile>("ShellPrintFile", "Prints what a path names.", {"Window", "Path"}),
};
constexpr frame::ClassTable table{.name = "FileSys", .members = members};

}  // namespace

const frame::ClassTable& FileSys::Table() const { return table; }

}  // namespace tessel::fileservices
