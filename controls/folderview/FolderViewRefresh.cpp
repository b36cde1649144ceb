#include <memory>

#include "controls/folderview/FolderView.h"
#include "controls/folderview/FolderWords.h"
#include "fileservices/CommonFile.h"
#include "fileservices/FileSystemObject.h"
#include "frame/ResumeNext.h"

/// How the tree follows the disk: each node is looked at, and new folders are looked for below those in view.
namespace tessel::controls {

using fileservices::CommonFile;
using fileservices::FolderRef;
using frame::EqualsNoCase;
using frame::ResumeNext;

namespace {

/// Of a drive that does not answer: a look into it may take for ever.
bool IsUnreadyDrive(frame::Host& host, const std::string& path) {
    if (!host.Files().DriveExists(path)) return false;
    ResumeNext next;
    return next.Value([&] { return !fileservices::FileSystemObject(host).GetDrive(path)->IsReady(); }, false);
}

}  // namespace

void FolderView::Refresh() { RefreshTree(); }

void FolderView::TimerElapsed() {
    if (UserMode()) RefreshTree();
}

void FolderView::RefreshTree() {
    std::vector<NodeRef> nodes;
    nodes.reserve(Tree().Count());
    for (child::TreeNodes::Position position = 0; position < Tree().Count(); ++position)
        nodes.push_back(Tree().Ref(Tree().At(position)));
    for (const NodeRef node : nodes)
        if (Lives(node)) RefreshNodeStatus(node.node);
    for (const NodeRef node : nodes) {
        if (!Site()) return;
        if (Lives(node) && TreeFolders.IsInView(node.node)) RefreshNodeChildren(node);
    }
}

void FolderView::RefreshNodeStatus(NodeId node) {
    const std::string_view key = Tree().Key(node);
    if (key.empty() || folderwords::IsWord(key)) return;
    const NodeId parent = Tree().Parent(node);
    if (parent != child::noNode && EqualsNoCase(Tree().Key(parent), folderwords::myFolders))
        return RefreshMyFolder(node, std::string(key));
    if (Disk().DriveExists(key)) return RefreshDrive(node, std::string(key));
    if (!Disk().FolderExists(key)) Tree().Remove(node);
}

/// A folder of "My Folders" stays in the tree whatever becomes of it, as one that is unavailable.
void FolderView::RefreshMyFolder(NodeId node, const std::string& path) {
    const bool exists = Disk().FolderExists(path);
    const bool unavailable = Tree().Checked(node);
    if (exists == !unavailable) return;
    if (!exists) {
        Tree().SetText(node, UnavailableText(path));
        Tree().SetChecked(node, true);
        return;
    }
    ResumeNext next;
    next([&] {
        const FolderRef folder = TakeFolder(path);
        if (!folder) throw frame::ControlError(frame::errors::pathNotFound);
        SetFolderImage(node, *folder);
        Tree().SetText(node, Host().Module<CommonFile>().FolderDisplayName(folder));
        Tree().SetChecked(node, false);
    });
}

/// Another disk may have been put in.
void FolderView::RefreshDrive(NodeId node, const std::string& root) {
    ResumeNext next;
    next([&] {
        const fileservices::DriveRef drive = fileservices::FileSystemObject(Host()).GetDrive(root);
        Tree().SetText(node, Host().Module<CommonFile>().DriveDisplayName(drive));
        SetDriveImage(node, drive);
    });
}

void FolderView::RefreshNodeChildren(NodeRef node) {
    const std::string key = KeyOf(node);
    if (IsUnreadyDrive(Host(), key)) return;
    const FolderRef folder = TakeFolder(key);
    if (!folder) return;
    ResumeNext next;
    std::unique_ptr<frame::FolderListing> listing;
    next([&] { return Disk().List(folder->FullPath(), listing); });
    if (!listing) return;
    EachSubFolder(node, folder->FullPath(), *listing, [&](const ListedFolder& listed) {
        if (!Tree().FindKey(listed.path)) AddListedFolder(node, listed);
    });
}

}  // namespace tessel::controls
