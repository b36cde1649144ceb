#include "controls/folderview/FolderView.h"
#include "controls/folderview/FolderWords.h"
#include "fileservices/CommonFile.h"
#include "fileservices/DesignImages.h"
#include "fileservices/PathHelpers.h"
#include "frame/ResumeNext.h"

/// The node and the image under the cursor, and new folders.
namespace tessel::controls {

using fileservices::FolderRef;
using frame::EqualsNoCase;
using frame::ResumeNext;
using frame::Variant;

void FolderView::SetItemIndex(std::int32_t value) {
    RefuseAtDesignTime();
    own.ItemIndex = ItemIndexValid(value) ? value : 0;
    PropertyChanged("ItemIndex");
}

std::string FolderView::ItemPath() const { return ItemIndexValid(own.ItemIndex) ? CurrentItem()->Key() : std::string(); }

std::string FolderView::ItemName() const {
    const FolderRef folder = TakeFolder(ItemPath());
    return folder ? folder->Name() : std::string();
}

void FolderView::SetItemName(const std::string& value) {
    RefuseAtDesignTime();
    const FolderRef folder = TakeFolder(ItemPath());
    if (!folder) return;
    folder->SetName(value);
    CurrentItem()->SetText(value);
    PropertyChanged("ItemName");
}

std::string FolderView::ItemDisplayName() const { return ItemIndexValid(own.ItemIndex) ? CurrentItem()->Text() : std::string(); }

void FolderView::SetItemDisplayName(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetText(value);
    PropertyChanged("ItemDisplayName");
}

std::string FolderView::ItemIcon() const { return ItemIndexValid(own.ItemIndex) ? CurrentItem()->Image().ToText() : std::string(); }

void FolderView::SetItemIcon(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetImage(value).Check();
    PropertyChanged("ItemIcon");
}

bool FolderView::ItemSelected() const { return ItemIndexValid(own.ItemIndex) && CurrentItem()->Selected(); }

void FolderView::SetItemSelected(bool value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    if (value) CurrentItem()->SetSelected(true);
    PropertyChanged("ItemSelected");
}

bool FolderView::ItemExpanded() const { return ItemIndexValid(own.ItemIndex) && CurrentItem()->Expanded(); }

void FolderView::SetItemExpanded(bool value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetExpanded(value);
    PropertyChanged("ItemExpanded");
}

std::string FolderView::ItemTag() const { return ItemIndexValid(own.ItemIndex) ? CurrentItem()->Tag().ToText() : std::string(); }

void FolderView::SetItemTag(const std::string& value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(own.ItemIndex)) return;
    CurrentItem()->SetTag(value);
    PropertyChanged("ItemTag");
}

std::int32_t FolderView::SelectedItem() const {
    const NodeId selected = Tree().Selected();
    return selected != child::noNode ? IndexOf(selected) : 0;
}

void FolderView::SetSelectedItem(std::int32_t value) {
    RefuseAtDesignTime();
    if (!ItemIndexValid(value)) return;
    Tree().SetSelected(TreeFolders.Nodes.At(value));
    PropertyChanged("SelectedItem");
}

// Images.

void FolderView::SetImageIndex(std::int32_t value) {
    RefuseAtDesignTime();
    own.ImageIndex = value;
    PropertyChanged("ImageIndex");
}

std::string FolderView::ImageKey() const {
    return ImageIndexValid() ? Image16.ListImages.Item(own.ImageIndex).Key() : std::string();
}

void FolderView::SetImageKey(const std::string& value) {
    RefuseAtDesignTime();
    own.ImageKey = value;
    PropertyChanged("ImageKey");
}

std::string FolderView::ImageTag() const {
    return ImageIndexValid() ? Image16.ListImages.Item(own.ImageIndex).Tag().ToText() : std::string();
}

void FolderView::SetImageTag(const std::string& value) {
    RefuseAtDesignTime();
    own.ImageTag = value;
    PropertyChanged("ImageTag");
}

std::int32_t FolderView::ImageAddNew(const Variant& MyImage, const std::string& MyKey) {
    ResumeNext next;
    next([&] { Image16.ListImages.Add({}, MyKey, frame::FromVariant<frame::PictureRef>(MyImage)); });
    return next.Failed() ? next.Number() : ImageCount();
}

Variant FolderView::ImageRemove(const Variant& MyKey) {
    ResumeNext next;
    next([&] { Image16.ListImages.Remove(MyKey); });
    return std::int32_t{next.Number()};
}

// New folders.

Variant FolderView::GetMyFolders() const { return frame::VariantArray(0, {own.MyFolders.begin(), own.MyFolders.end()}); }

std::int32_t FolderView::AddNewFolder(const std::optional<std::string>& NewFolderName) {
    const std::string name = NewFolderName.value_or("");
    const std::string key = ItemPath();
    if (EqualsNoCase(key, folderwords::myFolders)) return AddMyFolder(name);
    if (key.empty() || EqualsNoCase(key, folderwords::myComputer)) return 0;
    return CreateSubFolder(name);
}

std::int32_t FolderView::AddMyFolder(const std::string& path) {
    const auto root = Tree().FindKey(folderwords::myFolders);
    if (!root) return 0;
    const NodeRef parent = Tree().Ref(*root);
    NodeRef added;
    if (const FolderRef folder = TakeFolder(path)) {
        ResumeNext next;
        next([&] { added = AddFolderNode(*folder, parent); });
        if (Lives(added)) FillSubFolders(added, folder);
    } else {
        added = AddUnavailableFolder(path, parent);
    }
    own.MyFolders.push_back(path);
    return Lives(added) ? IndexOf(added.node) : 0;
}

FolderView::NodeRef FolderView::AddUnavailableFolder(const std::string& path, NodeRef root) {
    NodeId node = child::noNode;
    if (Tree().Add(node, UnavailableText(path), path, root.node, child::TreeRelationshipConstants::Child).Failed()) return {};
    ResumeNext next;
    next([&] { return Tree().SetImageKey(node, child::NodeImage::Plain, fileservices::designimages::folderUnavailable); });
    Tree().SetChecked(node, true);
    Tree().SetSorted(node, true);
    return Tree().Ref(node);
}

/// The folder comes to be in that of the selected node, wherever the cursor is: kept so that applications act the same.
std::int32_t FolderView::CreateSubFolder(const std::string& name) {
    const NodeId selected = Tree().Selected();
    if (selected == child::noNode) return 0;
    const NodeRef parent = Tree().Ref(selected);
    const std::string folder = KeyOf(parent);
    if (!TakeFolder(folder)) return 0;
    const std::string path = name.empty() ? Host().Module<fileservices::CommonFile>().UniqueFolderPath(folder, "")
                                          : fileservices::BuildPath(folder, name, Disk().Separator());
    if (Disk().CreateFolder(path).Failed()) return 0;
    const FolderRef made = TakeFolder(path);
    if (!made) return 0;
    ResumeNext next;
    NodeRef added;
    next([&] { added = AddFolderNode(*made, parent); });
    if (!Lives(added)) return 0;
    std::int32_t index = IndexOf(added.node);
    next([&] { RaiseEvent(folderview::AfterAddItem, index); });  // a second time for a folder that was made
    if (!Lives(added)) return 0;
    if (name.empty()) {
        Tree().SetSelected(added.node);
        next([&] { TreeFolders.StartLabelEdit(); });
    }
    return Lives(added) ? IndexOf(added.node) : 0;
}

}  // namespace tessel::controls
