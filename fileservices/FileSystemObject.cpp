#include "fileservices/FileSystemObject.h"

#include <array>

#include "fileservices/PathHelpers.h"
#include "frame/ClassTable.h"
#include "frame/Error.h"

namespace tessel::fileservices {

FileRef FileSystemObject::GetFile(const std::string& path) const {
    if (!FileExists(path)) throw frame::ControlError(frame::errors::fileNotFound);
    return std::make_shared<File>(host_, path);
}

FolderRef FileSystemObject::GetFolder(const std::string& path) const {
    const char separator = Disk().Separator();
    std::string folder = path;
    if (fileservices::GetFileName(path, separator).empty()) {  // a root, however it is spelt
        if (const std::string root = BuildPath(path, ""); DriveExists(root)) folder = root;
    } else if (!DriveExists(path)) {
        folder.resize(path.find_last_not_of(separator) + 1);
    }
    auto found = std::make_shared<Folder>(host_, std::move(folder));
    (void)found->Record();  // fails when there is none
    return found;
}

std::string FileSystemObject::BuildPath(const std::string& parent, const std::string& name) const {
    return fileservices::BuildPath(parent, name, Disk().Separator());
}

std::string FileSystemObject::GetExtensionName(const std::string& path) const {
    return std::string(fileservices::GetExtensionName(path, Disk().Separator()));
}

std::string FileSystemObject::GetFileName(const std::string& path) const {
    return std::string(fileservices::GetFileName(path, Disk().Separator()));
}

std::string FileSystemObject::GetParentFolderName(const std::string& path) const {
    return fileservices::GetParentFolderName(path, Disk());
}

FolderRef FileSystemObject::GetSpecialFolder(std::int32_t number) const {
    constexpr std::int32_t temporaryFolder = 2;
    if (number != temporaryFolder) throw frame::ControlError(frame::errors::invalidCall);
    return GetFolder(Disk().TemporaryFolder());
}

std::string FileSystemObject::GetTempName() const {
    constexpr int draws = 8;
    constexpr std::string_view digits = "0123456789abcdef";
    std::string name = "tmp";
    for (int i = 0; i < draws; ++i) {
        const float drawn = host_.Random().Next() * static_cast<float>(digits.size());
        const bool inRange = drawn >= 0 && drawn < static_cast<float>(digits.size());
        name += digits[inRange ? static_cast<std::size_t>(drawn) : 0];
    }
    return name + ".tmp";
}

std::shared_ptr<TextStream> FileSystemObject::CreateTextFile(const std::string& path, std::optional<bool> overwrite,
                                                             std::optional<bool> unicode) const {
    Disk().CreateFile(path, overwrite.value_or(false)).Check();
    if (unicode.value_or(false)) Disk().WriteOver(path, "\xFF\xFE").Check();
    return std::make_shared<TextStream>();
}

void FileSystemObject::DeleteFile(const std::string& path, std::optional<bool> force) const {
    Disk().DeleteFile(path, force.value_or(false)).Check();
}

namespace {

using Fso = FileSystemObject;

constexpr std::array streamMembers = {frame::method<&TextStream::Close>("Close", "Closes the file.")};
constexpr frame::ClassTable streamTable{.name = "TextStream", .members = streamMembers};

constexpr std::array members = {
    frame::method<&Fso::FileExists>("FileExists", "Whether there is such a file.", {"Path"}),
    frame::method<&Fso::FolderExists>("FolderExists", "Whether there is such a folder.", {"Path"}),
    frame::method<&Fso::DriveExists>("DriveExists", "Whether the path is the root of a drive.", {"Path"}),
    frame::method<&Fso::GetFile>("GetFile", "The file of a path.", {"Path"}),
    frame::method<&Fso::GetFolder>("GetFolder", "The folder of a path.", {"Path"}),
    frame::method<&Fso::GetDrive>("GetDrive", "The drive of a letter, path or share.", {"Path"}),
    frame::property<&Fso::Drives>("Drives", "All drives."),
    frame::method<&Fso::BuildPath>("BuildPath", "Joins two parts of a path.", {"Parent", "Name"}),
    frame::method<&Fso::GetExtensionName>("GetExtensionName", "The extension of a path, without the point.", {"Path"}),
    frame::method<&Fso::GetFileName>("GetFileName", "The last name of a path.", {"Path"}),
    frame::method<&Fso::GetParentFolderName>("GetParentFolderName", "A path without its last name.", {"Path"}),
    frame::method<&Fso::GetSpecialFolder>("GetSpecialFolder", "The temporary folder, by the number 2.", {"Number"}),
    frame::method<&Fso::GetTempName>("GetTempName", "A random file name."),
    frame::method<&Fso::CreateFolder>("CreateFolder", "Makes a folder.", {"Path"}),
    frame::method<&Fso::CreateTextFile>("CreateTextFile", "Makes an empty file.", {"Path", "Overwrite", "Unicode"}),
    frame::method<&Fso::DeleteFile>("DeleteFile", "Deletes a file.", {"Path", "Force"}),
};
constexpr frame::ClassTable table{.name = "FileSystem", .members = members};

}  // namespace

const frame::ClassTable& TextStream::Table() const { return streamTable; }
const frame::ClassTable& FileSystemObject::Table() const { return table; }

}  // namespace tessel::fileservices
