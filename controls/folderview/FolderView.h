#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "controls/folderview/FolderViewEvents.h"
#include "fileservices/DiskEntry.h"
#include "fileservices/Drive.h"
#include "frame/Control.h"
#include "frame/FileSystem.h"
#include "frame/child/ImageList.h"
#include "frame/child/PictureBox.h"
#include "frame/child/Timer.h"
#include "frame/child/TreeView.h"

namespace tessel::controls {

/// A tree of folders. Its root is a folder or one of three words, in any case: "My Computer" (the drives), "My Documents",
/// "My Folders" (folders that the application adds by `AddNewFolder`).
///
/// A node stands for a folder, a drive or such a word. Its key is the folder's path; the node of "My Documents" has the path of
/// that folder too. What is below a node is read when it is clicked or expanded, one level at a time.
///
/// Nodes are reached by a cursor: `ItemIndex` chooses one, and the properties `Item...` read and write it. In the same way
/// `ImageIndex` chooses an image for the properties `Image...`.
///
/// While the tree is filled each node raises events: afterwards anything may have changed. A fill goes on with the folders that it
/// began with; it ends when its node has gone, or when the host has let go of the control.
class FolderView final : public frame::Control {
  public:
    explicit FolderView(frame::Host& host);

    // Look, held by `TreeFolders`.
    frame::OLE_COLOR BackColor() const { return TreeFolders.BackColor(); }
    frame::OLE_COLOR ForeColor() const { return TreeFolders.ForeColor(); }
    void SetForeColor(frame::OLE_COLOR value);
    bool Enabled() const { return TreeFolders.Enabled(); }
    void SetEnabled(bool value);
    const frame::FontRef& Font() const { return TreeFolders.Font(); }
    void SetFont(const frame::FontRef& value);
    child::TreeBorderConstants BorderStyle() const { return TreeFolders.BorderStyle(); }
    void SetBorderStyle(child::TreeBorderConstants value);
    child::AppearanceConstants Appearance() const { return TreeFolders.Appearance(); }
    void SetAppearance(child::AppearanceConstants value);
    std::int16_t MousePointer() const { return TreeFolders.MousePointer(); }
    void SetMousePointer(std::int16_t value);
    const frame::PictureRef& MouseIcon() const { return TreeFolders.MouseIcon(); }
    void SetMouseIcon(const frame::PictureRef& value);
    bool FullRowSelect() const { return TreeFolders.FullRowSelect(); }
    void SetFullRowSelect(bool value);
    bool HotTracking() const { return TreeFolders.HotTracking(); }
    void SetHotTracking(bool value);

    /// Where the tree begins; empty for no tree. A set builds it anew. A path that names no folder gives an empty tree.
    const std::string& PathRoot() const { return own.PathRoot; }
    void SetPathRoot(const std::string& value);
    /// The key of the current node. Known to late-bound callers as `Path`. A set selects the node that has this key, where there is
    /// one, and fills and expands nothing; no `ChangedFolder` comes.
    const std::string& FolderPath() const { return own.Path; }
    void SetFolderPath(const std::string& value);
    /// Whether the sub-folders of a node are filled too when it is expanded, so that those with sub-folders have their sign.
    bool AutoFillSubFolders() const { return own.AutoFillSubFolders; }
    void SetAutoFillSubFolders(bool value);
    /// Whether hidden folders are added; from the next fill on.
    bool AllowHiddenFolders() const { return own.AllowHiddenFolders; }
    void SetAllowHiddenFolders(bool value);
    bool AllowSystemFolders() const { return own.AllowSystemFolders; }
    void SetAllowSystemFolders(bool value);
    /// Whether labels can be edited; a set makes the tree's own `LabelEdit` manual or automatic.
    bool AllowLabelEdit() const { return own.AllowLabelEdit; }
    void SetAllowLabelEdit(bool value);
    child::OLEDragConstants OLEDragMode() const { return own.OLEDragMode; }
    void SetOLEDragMode(child::OLEDragConstants value);
    child::OLEDropConstants OLEDropMode() const { return own.OLEDropMode; }
    void SetOLEDropMode(child::OLEDropConstants value);
    /// Milliseconds between two refreshes; 0 for none. Error 380 below 0.
    std::int32_t RefreshInterval() const { return RefreshTimer.Interval(); }
    void SetRefreshInterval(std::int32_t value);

    std::int32_t ItemCount() const { return TreeFolders.Nodes.Count(); }
    std::int32_t ImageCount() const { return Image16.ListImages.Count(); }

    // The node that `ItemIndex` chooses. Without one the getters give 0, false or the empty string, and a set is passed over.
    /// From 1; 0 when there is none. A set outside 1 to `ItemCount` makes it 0.
    std::int32_t ItemIndex() const { return own.ItemIndex; }
    void SetItemIndex(std::int32_t value);
    /// The node's key.
    std::string ItemPath() const;
    /// The folder's name on the disk; empty for what is no existing folder, and at the root of a drive. A set renames the folder
    /// and gives the node this label; the key stays. Error 58 when the name is taken.
    std::string ItemName() const;
    void SetItemName(const std::string& value);
    /// The node's label. A set leaves the folder as it is.
    std::string ItemDisplayName() const;
    void SetItemDisplayName(const std::string& value);
    /// The key of the node's image. Error 35601 for a key that is not among the images.
    std::string ItemIcon() const;
    void SetItemIcon(const std::string& value);
    /// A set to true selects the node, one to false leaves it as it is.
    bool ItemSelected() const;
    void SetItemSelected(bool value);
    bool ItemExpanded() const;
    void SetItemExpanded(bool value);
    std::string ItemTag() const;
    void SetItemTag(const std::string& value);

    /// The index of the selected node, 0 when there is none. A set outside 1 to `ItemCount` is passed over; no `ChangedFolder`
    /// comes.
    std::int32_t SelectedItem() const;
    void SetSelectedItem(std::int32_t value);

    /// The image that `ImageKey` and `ImageTag` read, from 1. Any number is taken.
    std::int32_t ImageIndex() const { return own.ImageIndex; }
    void SetImageIndex(std::int32_t value);
    /// Empty where `ImageIndex` names no image. A set is kept and saved, and leaves the image as it is: kept so that saved designs
    /// act the same.
    std::string ImageKey() const;
    void SetImageKey(const std::string& value);
    std::string ImageTag() const;
    void SetImageTag(const std::string& value);

    /// Makes the tree true to the disk: takes out the folders that have gone and adds new ones below the nodes in view. Nothing is
    /// told but the adding of nodes.
    void Refresh();
    /// Selects the parent of the selected node. Gives its index, or 0 when there is none.
    std::int32_t GoUp();
    /// The folders that "My Folders" shows, as an array of strings; the first, at 0, is empty.
    frame::Variant GetMyFolders() const;
    /// Adds an image. Gives the number of images, or the number of the error that prevented it.
    std::int32_t ImageAddNew(const frame::Variant& MyImage, const std::string& MyKey);
    /// Removes an image by key or index. Gives 0, or the number of the error that prevented it.
    frame::Variant ImageRemove(const frame::Variant& MyKey);
    /// With the cursor (`ItemIndex`) on "My Folders": shows the folder of this path there, whether it exists or not. With the
    /// cursor on "My Computer" or on nothing: does nothing. Elsewhere: makes a folder of this name in the folder of the selected
    /// node; without a name one of the name "New Folder", whose label edit is opened. Gives the index of the node, or 0.
    std::int32_t AddNewFolder(const std::optional<std::string>& NewFolderName = {});

    void Initialize() override;
    void Resize() override;
    void Show() override;
    frame::TextSize DesignSize() const override;
    const frame::ClassTable& Table() const override { return table; }
    static const frame::ClassTable table;

    child::ImageList Image16{*this, "Image16"};
    child::TreeView TreeFolders{*this, "TreeFolders"};
    child::PictureBox TempPic{*this, "TempPic"};
    child::Timer RefreshTimer{*this, "RefreshTimer"};

  private:
    struct Tables;
    using NodeId = child::NodeId;
    using NodeRef = child::NodeRef;

    /// A folder that is to become a node, as a listing or a look at its path has found it. `name` is empty at the root of a drive.
    struct FoundFolder {
        std::string_view path, name;
        const frame::FileRecord& record;
        bool IsRootFolder() const { return name.empty(); }
    };

    /// Where a listing has found a sub-folder.
    struct ListedFolder {
        std::string_view path, name;
        frame::FolderListing& listing;
        std::size_t index;
    };

    void DesignTree();
    void DesignPictures();
    void Connect();

    void TreeClick();
    void TreeDblClick();
    void TreeKeyDown(std::int16_t keyCode, std::int16_t shift);
    void TreeKeyPress(std::int16_t keyAscii);
    void TreeKeyUp(std::int16_t keyCode, std::int16_t shift);
    void TreeMouseDown(std::int16_t button, std::int16_t shift, float x, float y);
    void TreeMouseMove(std::int16_t button, std::int16_t shift, float x, float y);
    void TreeMouseUp(std::int16_t button, std::int16_t shift, float x, float y);
    void TreeNodeClick(const child::TreeNodeRef& node);
    void TreeExpand(const child::TreeNodeRef& node);
    void TreeCollapse(const child::TreeNodeRef& node);
    void TimerElapsed();

    void ClickNode(const child::TreeNodeRef& node);
    void ResetMouseState();

    template <auto Set, class T>
    void SetStock(std::string_view key, const T& value);

    // Nodes and images.
    child::TreeNodes& Tree() { return TreeFolders.Tree(); }
    const child::TreeNodes& Tree() const { return TreeFolders.Tree(); }
    bool Lives(NodeRef node) const { return Tree().Lives(node); }
    std::int32_t IndexOf(NodeId node) const { return static_cast<std::int32_t>(Tree().PositionOf(node)) + 1; }
    std::string KeyOf(NodeRef node) const { return Lives(node) ? std::string(Tree().Key(node.node)) : std::string(); }
    void RemoveNode(NodeRef node);
    bool ItemIndexValid(std::int32_t index) const { return index >= 1 && index <= ItemCount(); }
    child::TreeNodeRef CurrentItem() const { return TreeFolders.Nodes.Item(own.ItemIndex); }
    bool ImageIndexValid() const { return own.ImageIndex >= 1 && own.ImageIndex <= ImageCount(); }

    // Building.
    void RebuildTree();
    void FillRoot();
    void ShowDesign();
    void FillRealRoot();
    void FillMyComputer();
    void FillMyDocuments();
    void FillMyFolders();
    NodeRef AddSpecialRoot(std::string_view name);

    // Filling.
    /// Adds a folder at the top level, or below another node. Names no node when it was not added, or has gone again.
    NodeRef AddFolderNode(const FoundFolder& folder, std::optional<NodeRef> parent);
    NodeRef AddFolderNode(const fileservices::Folder& folder, std::optional<NodeRef> parent);
    NodeRef AddListedFolder(NodeRef parent, const ListedFolder& listed);
    NodeRef AddDriveNode(const frame::DriveRecord& record, NodeRef parent);
    NodeRef TellAdded(NodeId node);
    bool FolderPassesFilter(const FoundFolder& folder) const;
    fileservices::FolderRef TakeFolder(const std::string& path) const;
    void FillSubFolders(NodeRef node, const fileservices::FolderRef& folder);
    std::vector<NodeId> AddSubFolders(NodeRef node, const std::string& folder, frame::FolderListing& listing);
    /// Visits the sub-folders of a listing as long as the node is there.
    void EachSubFolder(NodeRef node, const std::string& folder, frame::FolderListing& listing,
                       const std::function<void(const ListedFolder&)>& visit) const;
    void PurgeChildren(NodeRef node, const std::vector<NodeId>& onDisk);
    bool HearsOfNewNodes() const;

    // Going through the tree.
    void ExpandNode(NodeRef node);
    void ReportPathChange(NodeRef node);
    void TellGone(NodeRef node);
    bool NodePathExists(const std::string& key) const;

    // Icons.
    void SetFolderImage(NodeId node, const FoundFolder& folder);
    void SetFolderImage(NodeId node, const fileservices::Folder& folder);
    void SetDriveImage(NodeId node, const fileservices::DriveRef& drive);
    std::string SetImages(NodeId node, std::string_view path, std::string key);
    void AddFolderIcons(const std::string& path, std::string& key);
    void SetHiddenImages(NodeId node, const std::string& key);
    void SetPaleImage(NodeId node, child::NodeImage which, const std::string& key);

    // Refreshing.
    void RefreshTree();
    void RefreshNodeStatus(NodeId node);
    void RefreshMyFolder(NodeId node, const std::string& path);
    void RefreshDrive(NodeId node, const std::string& root);
    void RefreshNodeChildren(NodeRef node);

    // New folders.
    std::int32_t AddMyFolder(const std::string& path);
    NodeRef AddUnavailableFolder(const std::string& path, NodeRef root);
    static std::string UnavailableText(const std::string& path) { return path + " (Unavailable)"; }
    std::int32_t CreateSubFolder(const std::string& name);

    frame::FileSystem& Disk() const { return Host().Files(); }

    struct Own {
        bool AutoFillSubFolders = false;
        std::string Path, PathRoot;
        std::int32_t ItemIndex = 0, ImageIndex = 0;
        bool AllowHiddenFolders = false, AllowSystemFolders = false, AllowLabelEdit = true;
        child::OLEDropConstants OLEDropMode = child::OLEDropConstants::Automatic;
        child::OLEDragConstants OLEDragMode = child::OLEDragConstants::Automatic;

        // Saved and loaded only: the properties read the node or the image.
        std::string ItemPath, ItemName, ItemDisplayName, ItemTag, ItemIcon, ImageTag, ImageKey;
        std::int32_t ItemCount = 0, ImageCount = 0, SelectedItem = 0;
        bool ItemSelected = false, ItemExpanded = false;

        float MouseX = 0, MouseY = 0;  // where the pointer was last
        bool MouseIsDown = false;
        std::vector<std::string> MyFolders{std::string()};  // the first is always empty
        std::string PersonalPath;
    };
    Own own;
};

}  // namespace tessel::controls
