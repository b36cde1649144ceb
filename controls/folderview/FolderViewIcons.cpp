#include "controls/folderview/FolderView.h"
#include "fileservices/FileIcon.h"
#include "fileservices/FileSys.h"
#include "frame/ResumeNext.h"

/// The images of the nodes: one pair, closed and open, for each type of folder and kind of drive, and pale copies of them for
/// hidden folders. An image is added when its key is needed for the first time.
namespace tessel::controls {

using child::NodeImage;
using fileservices::FileIcon;
using frame::ResumeNext;

namespace {
constexpr std::string_view openPrefix = "OPEN_", hiddenPrefix = "HIDDEN_";
std::string Prefixed(std::string_view prefix, std::string_view key) { return std::string(prefix).append(key); }
}  // namespace

void FolderView::SetFolderImage(NodeId node, const FoundFolder& folder) {
    const std::string key = SetImages(node, folder.path, Disk().TypeText(folder.record.typeId));
    if (!folder.IsRootFolder() && (folder.record.attributes & frame::attributes::hidden) != 0) SetHiddenImages(node, key);
}

void FolderView::SetFolderImage(NodeId node, const fileservices::Folder& folder) {
    const frame::FileRecord record = folder.Record();
    const std::string name = folder.Name();
    SetFolderImage(node, {folder.FullPath(), name, record});
}

void FolderView::SetDriveImage(NodeId node, const fileservices::DriveRef& drive) {
    SetImages(node, drive->RootPath(), Host().Module<fileservices::FileSys>().DriveTypeWord(drive));
}

/// Gives the key under which the images stand: that of the drive where the path is the top folder of one.
std::string FolderView::SetImages(NodeId node, std::string_view path, std::string key) {
    if (Tree().SetImageKey(node, NodeImage::Plain, key).Failed()) {
        AddFolderIcons(std::string(path), key);
        ResumeNext again;
        again([&] { return Tree().SetImageKey(node, NodeImage::Plain, key); });
    }
    ResumeNext next;
    next([&] { return Tree().SetImageKey(node, NodeImage::Selected, Prefixed(openPrefix, key)); });
    return key;
}

/// `key` becomes that of the icon.
void FolderView::AddFolderIcons(const std::string& path, std::string& key) {
    using fileservices::IconForm;
    const auto add = [&](IconForm form, std::string_view prefix) {
        ResumeNext next;
        const bool drawn = next.Value(
            [&] { return Host().Module<FileIcon>().GetFileIcon(path, fileservices::IconSize::Small, TempPic, key, form); }, false);
        if (drawn) next([&] { Image16.ListImages.Add({}, Prefixed(prefix, key), TempPic.Picture()); });
    };
    add(IconForm::Closed, {});
    add(IconForm::Open, openPrefix);
}

void FolderView::SetHiddenImages(NodeId node, const std::string& key) {
    SetPaleImage(node, NodeImage::Plain, key);
    SetPaleImage(node, NodeImage::Selected, Prefixed(openPrefix, key));
}

void FolderView::SetPaleImage(NodeId node, NodeImage which, const std::string& key) {
    const std::string paleKey = Prefixed(hiddenPrefix, key);
    if (!Tree().SetImageKey(node, which, paleKey).Failed()) return;
    ResumeNext next;
    next([&] {
        TempPic.SetPicture(FileIcon::WashedOut(Image16.ListImages.Item(key).Picture(), Image16.MaskColor()));
        Image16.ListImages.Add({}, paleKey, TempPic.Picture());
    });
    next([&] { return Tree().SetImageKey(node, which, paleKey); });
}

}  // namespace tessel::controls
