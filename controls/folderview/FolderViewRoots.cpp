#include "controls/folderview/FolderView.h"
#include "controls/folderview/FolderWords.h"
#include "fileservices/FileSystemObject.h"
#include "frame/ResumeNext.h"

/// How the tree is built from its root.
namespace tessel::controls {

using child::NodeImage;
using fileservices::FolderRef;
using frame::EqualsNoCase;
using frame::ResumeNext;

void FolderView::RebuildTree() {
    ResumeNext next;
    bool cancel = false;
    next([&] { RaiseEvent(folderview::BeforePaint, cancel); });
    if (cancel || !Site()) return;
    Tree().Clear();
    FillRoot();
    own.Path = own.PathRoot;
    next([&] { RaiseEvent(folderview::AfterPaint); });
    next([&] { RaiseEvent(folderview::ChangedFolder); });
}

void FolderView::FillRoot() {
    if (own.PathRoot.empty()) return;
    if (!UserMode()) return ShowDesign();
    if (EqualsNoCase(own.PathRoot, folderwords::myComputer)) return FillMyComputer();
    if (EqualsNoCase(own.PathRoot, folderwords::myFolders)) return FillMyFolders();
    if (EqualsNoCase(own.PathRoot, folderwords::myDocuments)) return FillMyDocuments();
    FillRealRoot();
}

void FolderView::ShowDesign() {
    ResumeNext next;
    NodeId node = child::noNode;
    next([&] { return Tree().Add(node, own.PathRoot); });
    next([&] { return Tree().SetImageKey(node, NodeImage::Plain, folderwords::myComputer); });
}

void FolderView::FillRealRoot() {
    const FolderRef folder = TakeFolder(own.PathRoot);
    if (!folder) return;
    ResumeNext next;
    next([&] { FillSubFolders(AddFolderNode(*folder, {}), folder); });
}

/// The root of one of the words. Its image is the one under the same word, where there is one.
FolderView::NodeRef FolderView::AddSpecialRoot(std::string_view word) {
    Tree().Clear();
    NodeId root = child::noNode;
    Tree().Add(root, word, word).Check();
    ResumeNext next;
    next([&] { return Tree().SetImageKey(root, NodeImage::Plain, word); });
    Tree().SetSorted(root, true);
    return Tree().Ref(root);
}

void FolderView::FillMyComputer() {
    const NodeRef root = AddSpecialRoot(folderwords::myComputer);
    for (const frame::DriveRecord& drive : Disk().Drives()) {
        if (!Site() || !Lives(root)) return;
        const NodeRef node = AddDriveNode(drive, root);
        // A drive that does not answer is left alone: a look into it may take for ever.
        if (Lives(node) && drive.isReady) FillSubFolders(node, TakeFolder(drive.root));
    }
}

void FolderView::FillMyDocuments() {
    const NodeRef root = AddSpecialRoot(folderwords::myDocuments);
    ResumeNext next;
    next([&] { return Tree().SetKey(root.node, own.PersonalPath); });
    const FolderRef folder = TakeFolder(own.PersonalPath);
    if (!folder) return;
    next([&] { SetFolderImage(root.node, *folder); });
    FillSubFolders(root, folder);
}

void FolderView::FillMyFolders() {
    own.MyFolders.assign(1, std::string());
    const NodeRef root = AddSpecialRoot(folderwords::myFolders);
    Tree().SetSelected(root.node);
    own.ItemIndex = IndexOf(root.node);
}

}  // namespace tessel::controls
