#include "fileservices/CommonFile.h"

#include <algorithm>
#include <array>
#include <limits>
#include <string_view>
#include <vector>

#include "fileservices/FileSys.h"
#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::fileservices {

namespace errors = frame::errors;
namespace msgbox = frame::msgbox;

std::string CommonFile::FolderDisplayName(const FolderRef& folder) const {
    if (!folder) frame::ThrowObjectGone();
    if (std::string name = folder->Name(); !name.empty()) return name;
    if (!files_.DriveExists(folder->FullPath())) return "Unknown drive or folder";
    return DriveDisplayName(files_.GetDrive(folder->FullPath()));
}

std::string CommonFile::DriveDisplayName(const DriveRef& drive) const {
    if (!drive) frame::ThrowObjectGone();
    std::string name;
    if (!drive->ShareName().empty())
        name = ShareDisplayName(drive->ShareName());
    else if (drive->IsReady())
        name = (drive->VolumeName().empty() ? host_.Module<FileSys>().DriveTypeWord(drive) : drive->VolumeName()) + " ";
    if (!drive->DriveLetter().empty()) name += "(" + drive->DriveLetter() + ":)";
    return name;
}

std::string CommonFile::ShareDisplayName(const std::string& share) const {  // NOLINT: a row calls it
    // Behind the two empty parts at the beginning.
    constexpr std::size_t server = 2, name = 3;
    std::vector<std::string_view> parts;
    for (std::size_t start = 0; start <= share.size();) {
        const std::size_t end = std::min(share.find('\\', start), share.size());
        parts.push_back(std::string_view(share).substr(start, end - start));
        start = end + 1;
    }
    if (parts.size() <= name) throw frame::ControlError(errors::subscript);
    return std::string(parts[name]).append(" on '").append(parts[server]).append("' ");
}

std::string CommonFile::UniqueFolderPath(const frame::Variant& parent, const std::string& name) const {
    const std::string folder = parent.ToText();
    std::string path = files_.BuildPath(folder, name.empty() ? "New Folder" : name);
    for (std::int32_t counter = 1; files_.FolderExists(path); ++counter) {
        if (counter == std::numeric_limits<std::int32_t>::max()) throw frame::ControlError(errors::overflow);
        const std::string number = "(" + frame::Decimal(counter) + ")";
        path = files_.BuildPath(folder, name.empty() ? "New Folder " + number : ("Copy " + number).append(" of ").append(name));
    }
    return path;
}

void CommonFile::DataObjectFileList(const frame::ObjectRef& data, std::string& list) const {  // NOLINT: a row calls it
    const frame::ObjectRef files = data->Inner("Files");
    list.clear();
    const std::int32_t count = files->Get("Count").ToLong();
    for (std::int32_t i = 1; i <= count; ++i) {
        frame::Variant index[] = {i};
        if (i > 1) list += ',';
        list += files->Get("Item", index).ToText();
    }
}

int CommonFile::ConfirmExtensionChange() const {
    return host_.MsgBox(
        "If you change a filename extension, the file may become unusable.\r\n\r\nAre you sure you want to change it?",
        msgbox::yesNo + msgbox::exclamation, "Rename");
}

int CommonFile::ShowFolderNotAccessible(const std::string& path) const {
    return host_.MsgBox(path + " is not accessible.\r\n\r\nThis folder was moved or removed.", msgbox::ok + msgbox::stop,
                        "Folder Not Accessible");
}

int CommonFile::ShowBadNameCharacters() const {
    return host_.MsgBox("A file cannot contain any of the following characters:\r\n              \\ / : * ? \" < > |",
                        msgbox::ok + msgbox::stop, "Rename");
}

namespace {

constexpr std::array members = {
    frame::method<&CommonFile::FolderDisplayName>("FolderDisplayName", "A folder's name as users see it.", {"Folder"}),
    frame::method<&CommonFile::DriveDisplayName>("DriveDisplayName", "A drive's name as users see it.", {"Drive"}),
    frame::method<&CommonFile::ShareDisplayName>("ShareDisplayName", "A network share's name as users see it.", {"Share"}),
    frame::method<&CommonFile::UniqueFolderPath>("UniqueFolderPath", "The path of a folder that does not exist yet.",
                                                 {"Parent", "Name"}),
    frame::method<&CommonFile::DataObjectFileList>("DataObjectFileList", "The paths of a drag object, parted by commas.",
                                                   {"Data", "List"}),
    frame::method<&CommonFile::ConfirmExtensionChange>("ConfirmExtensionChange", "Asks whether to change an extension."),
    frame::method<&CommonFile::ShowFolderNotAccessible>("ShowFolderNotAccessible", "Tells that a folder has gone.", {"Path"}),
    frame::method<&CommonFile::ShowBadNameCharacters>("ShowBadNameCharacters", "Tells what no file name may contain."),
};
constexpr frame::ClassTable table{.name = "CommonFile", .members = members};

}  // namespace

const frame::ClassTable& CommonFile::Table() const { return table; }

}  // namespace tessel::fileservices
