#include "controls/fileview/FileView.h"
#include "fileservices/FileIcon.h"
#include "fileservices/FileSystemObject.h"
#include "fileservices/PathHelpers.h"
#include "frame/ResumeNext.h"
#include "frame/Text.h"

/// The icons of the items. One image for each kind of file, under its extension, and one for each program, under its name.
namespace tessel::controls {

using child::IconSize;
using frame::Variant;

namespace {

constexpr std::string_view programExtension = "exe";

bool IsProgram(std::string_view extension) { return frame::EqualsNoCase(extension, programExtension); }

void RemovePrograms(child::ListImages& images) {
    for (std::int32_t index = images.Count(); index >= 1; --index)
        if (images.Item(index).Tag() == Variant(programExtension)) images.Remove(index);
}

}  // namespace

void FileView::SetFileItemIcons(RowId row, std::string_view folder, std::string_view name) {
    child::ListRows& rows = ListFiles.Rows();
    const std::string_view extension = fileservices::GetExtensionName(name, Disk().Separator());
    frame::ResumeNext next;
    if (!IsProgram(extension)) {
        next([&] { return rows.SetIconKey(row, IconSize::Small, extension); });
        if (!next.Failed()) {
            next([&] { return rows.SetIconKey(row, IconSize::Large, extension); });
            return;
        }
        next.Clear();
    }
    // The images have no such key yet, or every file has its own.
    std::string key(extension);
    LoadIconPair(JoinedPath(folder, name), key);
    next([&] { return rows.SetIconKey(row, IconSize::Small, key); });
    next([&] { return rows.SetIconKey(row, IconSize::Large, key); });
}

void FileView::SetFolderItemIcons(RowId row, const std::string& path, std::string key) {
    child::ListRows& rows = ListFiles.Rows();
    frame::ResumeNext next;
    next([&] { return rows.SetIconKey(row, IconSize::Small, key); });
    if (next.Failed()) {
        next.Clear();
        LoadIconPair(path, key);
        next([&] { return rows.SetIconKey(row, IconSize::Small, key); });
    }
    next([&] { return rows.SetIconKey(row, IconSize::Large, key); });
}

/// Asks the system for both icons of a path and adds them to the image lists. `key` becomes the key under which they stand. A key
/// that is there already leaves its image as it was.
void FileView::LoadIconPair(const std::string& path, std::string& key) {
    using fileservices::IconForm;
    const auto load = [&](child::ImageList& images, fileservices::IconSize size) {
        frame::ResumeNext next;
        if (!next.Value(
                [&] { return Host().Module<fileservices::FileIcon>().GetFileIcon(path, size, TempPic, key, IconForm::Closed); },
                false))
            return;
        const bool isProgram = IsProgram(key);
        if (isProgram) key = fileservices::GetFileName(path, Disk().Separator());
        next([&] {
            child::ListImage& image = images.ListImages.Add({}, key, TempPic.Picture());
            if (isProgram) image.SetTag(programExtension);
        });
    };
    load(Image16, fileservices::IconSize::Small);
    load(Image32, fileservices::IconSize::Large);
}

/// So that programs' images do not pile up. The list lets go of its images before they change.
void FileView::ClearExeImages() {
    ListFiles.SetSmallIcons(nullptr);
    ListFiles.SetIcons(nullptr);
    ListFiles.SetColumnHeaderIcons(nullptr);
    RemovePrograms(Image16.ListImages);
    RemovePrograms(Image32.ListImages);
    ListFiles.SetSmallIcons(&Image16);
    ListFiles.SetIcons(&Image32);
    ListFiles.SetColumnHeaderIcons(&Image16);
}

std::string FileView::ItemSetupIcon(std::int32_t Index) {
    if (!ItemIndexValid(Index)) return {};
    frame::ResumeNext next;
    const child::ListItemRef item = Item(Index);
    next([&] {
        const std::string path = ItemFullPath(Index);
        if (!Disk().FileExists(path)) throw frame::ControlError(frame::errors::fileNotFound);
        SetFileItemIcons(item->Ref().row, fileservices::GetParentFolderName(path, Disk()),
                         fileservices::GetFileName(path, Disk().Separator()));
    });
    return next.Value([&] { return item->Icon().ToText(); }, {});
}

bool FileView::ImageLoadFileType(const std::string& ExtensionName) {
    if (ExtensionName.empty()) return false;
    if (Image16.ListImages.FindKey(ExtensionName)) return true;
    FinishCounting();
    const fileservices::FileSystemObject files(Host());
    frame::ResumeNext next;
    std::string path;
    next([&] { path = files.BuildPath(files.GetSpecialFolder(2)->FullPath(), files.GetTempName() + "." + ExtensionName); });
    next([&] { files.CreateTextFile(path, true, false)->Close(); });
    std::string key;
    LoadIconPair(path, key);
    next([&] { files.DeleteFile(path, true); });
    return Image16.ListImages.FindKey(ExtensionName) != nullptr;
}

}  // namespace tessel::controls
