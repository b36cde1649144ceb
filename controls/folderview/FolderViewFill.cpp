#include <algorithm>
#include <memory>

#include "controls/folderview/FolderView.h"
#include "controls/folderview/FolderWords.h"
#include "fileservices/CommonFile.h"
#include "fileservices/FileSystemObject.h"
#include "fileservices/PathHelpers.h"
#include "frame/ResumeNext.h"

/// How nodes are filled, and how the user goes through them.
namespace tessel::controls {

using child::TreeNodeRef;
using child::TreeRelationshipConstants;
using fileservices::CommonFile;
using fileservices::FileSystemObject;
using fileservices::FolderRef;
using frame::EqualsNoCase;
using frame::FileRecord;
using frame::ResumeNext;

// Folders and drives as nodes.

bool FolderView::FolderPassesFilter(const FoundFolder& folder) const {
    if (folder.IsRootFolder()) return true;
    if (!own.AllowHiddenFolders && (folder.record.attributes & frame::attributes::hidden) != 0) return false;
    return own.AllowSystemFolders || (folder.record.attributes & frame::attributes::system) == 0;
}

FolderView::NodeRef FolderView::AddFolderNode(const FoundFolder& folder, std::optional<NodeRef> parent) {
    if (!FolderPassesFilter(folder)) return {};
    // The labels are compared with the name, so that a folder whose label was changed counts as missing: kept so that
    // applications which set labels act the same.
    if (parent && (!Lives(*parent) || Tree().FindChild(parent->node, folder.name))) return {};
    ResumeNext next;
    bool cancel = false;
    next([&] { RaiseEvent(folderview::BeforeAddItem, cancel); });
    if (cancel || !Site() || (parent && !Lives(*parent))) return {};

    std::string rootText;
    if (folder.IsRootFolder())
        next([&] {
            const auto root = std::make_shared<fileservices::Folder>(Host(), std::string(folder.path));
            rootText = Host().Module<CommonFile>().FolderDisplayName(root);
        });
    NodeId node = child::noNode;
    const std::string_view text = folder.IsRootFolder() ? std::string_view(rootText) : folder.name;
    const auto relationship = parent ? TreeRelationshipConstants::Child : TreeRelationshipConstants::Last;
    if (Tree().Add(node, text, folder.path, parent ? parent->node : child::noNode, relationship).Failed()) return {};
    SetFolderImage(node, folder);
    return TellAdded(node);
}

FolderView::NodeRef FolderView::AddFolderNode(const fileservices::Folder& folder, std::optional<NodeRef> parent) {
    const FileRecord record = folder.Record();
    const std::string name = folder.Name();
    return AddFolderNode({folder.FullPath(), name, record}, parent);
}

FolderView::NodeRef FolderView::AddDriveNode(const frame::DriveRecord& record, NodeRef parent) {
    ResumeNext next;
    bool cancel = false;
    next([&] { RaiseEvent(folderview::BeforeAddItem, cancel); });
    if (cancel || !Site() || !Lives(parent)) return {};

    const auto drive = std::make_shared<fileservices::Drive>(record);
    std::string text;
    next([&] { text = Host().Module<CommonFile>().DriveDisplayName(drive); });
    NodeId node = child::noNode;
    if (Tree().Add(node, text, record.root, parent.node, TreeRelationshipConstants::Child).Failed()) return {};
    SetDriveImage(node, drive);
    return TellAdded(node);
}

FolderView::NodeRef FolderView::TellAdded(NodeId node) {
    Tree().SetSorted(node, true);
    const NodeRef added = Tree().Ref(node);
    ResumeNext next;
    std::int32_t index = IndexOf(node);
    next([&] { RaiseEvent(folderview::AfterAddItem, index); });
    return Lives(added) ? added : NodeRef();
}

// Filling.

/// Null for what is no folder that can be reached.
FolderRef FolderView::TakeFolder(const std::string& path) const {
    if (folderwords::IsWordOnly(path)) return nullptr;
    ResumeNext next;
    return next.Value([&] { return FileSystemObject(Host()).GetFolder(path); }, nullptr);
}

/// Without a folder, and with one that cannot be read, the node just loses the children that have gone.
void FolderView::FillSubFolders(NodeRef node, const FolderRef& folder) {
    ResumeNext next;
    std::unique_ptr<frame::FolderListing> listing;
    std::vector<NodeId> onDisk;
    if (folder && Lives(node)) next([&] { return Disk().List(folder->FullPath(), listing); });
    if (listing) onDisk = AddSubFolders(node, folder->FullPath(), *listing);
    PurgeChildren(node, onDisk);
}

/// Gives the children that are on the disk for certain, in order; none once the application may have acted meanwhile.
std::vector<FolderView::NodeId> FolderView::AddSubFolders(NodeRef node, const std::string& folder, frame::FolderListing& listing) {
    std::vector<NodeId> onDisk;
    EachSubFolder(node, folder, listing, [&](const ListedFolder& listed) {
        const auto known = Tree().FindChild(node.node, listed.name);
        const NodeRef child = known ? Tree().Ref(*known) : AddListedFolder(node, listed);
        if (Lives(child) && Tree().Key(child.node) == listed.path) onDisk.push_back(child.node);
    });
    if (HearsOfNewNodes()) return {};
    std::sort(onDisk.begin(), onDisk.end());
    return onDisk;
}

void FolderView::EachSubFolder(NodeRef node, const std::string& folder, frame::FolderListing& listing,
                               const std::function<void(const ListedFolder&)>& visit) const {
    std::string path = fileservices::BuildPath(folder, "", Disk().Separator());
    const std::size_t stem = path.size();
    for (std::size_t index = 0; index < listing.FolderCount() && Site() && Lives(node); ++index) {
        const std::string_view name = listing.Name(index);
        path.replace(stem, std::string::npos, name);
        visit({path, name, listing, index});
    }
}

FolderView::NodeRef FolderView::AddListedFolder(NodeRef parent, const ListedFolder& listed) {
    FileRecord record;
    if (listed.listing.Stat(listed.index, record).Failed() || !record.IsFolder()) return {};
    return AddFolderNode({listed.path, listed.name, record}, parent);
}

bool FolderView::HearsOfNewNodes() const {
    if (!Site()) return true;
    const frame::EventSink& events = Site()->Events();
    return events.Wants(folderview::BeforeAddItem) || events.Wants(folderview::AfterAddItem);
}

/// Takes out the children whose folders have gone. `onDisk`, in order, need no look.
void FolderView::PurgeChildren(NodeRef node, const std::vector<NodeId>& onDisk) {
    if (!Site() || !Lives(node)) return;
    for (NodeId child = Tree().FirstChild(node.node); child != child::noNode;) {
        const NodeId following = Tree().Next(child);
        if (!std::binary_search(onDisk.begin(), onDisk.end(), child) && !Disk().FolderExists(Tree().Key(child)))
            Tree().Remove(child);
        child = following;
    }
}

// Going through the tree.

void FolderView::ExpandNode(NodeRef node) {
    const std::string key = KeyOf(node);
    if (!Lives(node) || folderwords::IsWordOnly(key)) return;
    if (!NodePathExists(key)) return TellGone(node);
    FillSubFolders(node, TakeFolder(key));
    if (!own.AutoFillSubFolders || !Lives(node)) return;
    std::vector<NodeRef> children;
    children.reserve(Tree().ChildCount(node.node));
    for (NodeId child = Tree().FirstChild(node.node); child != child::noNode; child = Tree().Next(child))
        children.push_back(Tree().Ref(child));
    for (const NodeRef child : children) {
        if (!Site()) return;
        if (Lives(child)) FillSubFolders(child, TakeFolder(KeyOf(child)));
    }
}

void FolderView::ClickNode(const TreeNodeRef& clicked) {
    ResumeNext next;
    next([&] { ForwardEvent(folderview::NodeClick, clicked); });
    const NodeRef node = clicked->Ref();
    if (!Site() || !Lives(node)) return;
    own.ItemIndex = IndexOf(node.node);
    const std::string key = KeyOf(node);
    FolderRef folder;
    if (!folderwords::IsWordOnly(key)) {
        // Not the number of a folder that has gone: kept so that such a node goes only with the message.
        constexpr int removing = -1;
        next.Clear();
        folder = next.Value([&] { return FileSystemObject(Host()).GetFolder(key); }, nullptr);
        if (next.Number() == removing) return RemoveNode(node);
    }
    // Of "My Computer" and "My Folders" this takes out what cannot be reached now: kept so that applications act the same.
    FillSubFolders(node, folder);
    ReportPathChange(node);
}

void FolderView::ReportPathChange(NodeRef node) {
    const std::string key = KeyOf(node);
    if (key.empty() || EqualsNoCase(key, own.Path) || !Site()) return;
    if (folderwords::IsWord(key) || NodePathExists(key)) {
        own.Path = key;
        ResumeNext next;
        next([&] { RaiseEvent(folderview::ChangedFolder); });
        return;
    }
    TellGone(node);
    ResetMouseState();
}

/// Tells the user that a node's folder has gone, and takes the node out.
void FolderView::TellGone(NodeRef node) {
    const std::string text(Tree().Text(node.node));
    ResumeNext next;
    next([&] { Host().Module<CommonFile>().ShowFolderNotAccessible(text); });
    RemoveNode(node);
}

bool FolderView::NodePathExists(const std::string& key) const {
    return folderwords::IsWordOnly(key) || Disk().FolderExists(key) || Disk().DriveExists(key);
}

void FolderView::RemoveNode(NodeRef node) {
    if (Lives(node)) Tree().Remove(node.node);
}

std::int32_t FolderView::GoUp() {
    const NodeId selected = Tree().Selected();
    const NodeId parent = selected != child::noNode ? Tree().Parent(selected) : child::noNode;
    if (parent == child::noNode) return 0;
    const NodeRef above = Tree().Ref(parent);
    Tree().SetSelected(parent);
    ReportPathChange(above);
    return Lives(above) ? IndexOf(parent) : 0;
}

void FolderView::SetFolderPath(const std::string& value) {
    RefuseAtDesignTime();
    if (EqualsNoCase(value, own.Path)) return;
    if (const auto node = Tree().FindKey(value)) Tree().SetSelected(*node);
    own.Path = value;
    PropertyChanged("Path");
}

}  // namespace tessel::controls
