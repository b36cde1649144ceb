#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/fileview/FileViewEvents.h"
#include "controls/fileview/FileViewRows.h"
#include "controls/fileview/IdleWork.h"
#include "fileservices/Collect.h"
#include "frame/Control.h"
#include "frame/child/ImageList.h"
#include "frame/child/ListView.h"
#include "frame/child/PictureBox.h"
#include "frame/child/TextBox.h"
#include "frame/child/Timer.h"

namespace tessel::controls {

/// A list of files: of a folder, of all drives, of folders that the application names, or of what a search has found.
///
/// Items are reached by a cursor: `ItemIndex` chooses one, and the properties `Item...` read and write it. In the same way
/// `ImageSmall` and `ImageIndex` choose an image of the two image lists for the properties `Image...`.
///
/// A path is a folder or one of three words, in any case: "My Documents", "My Computer" (the drives), "My Folders" (the folders
/// that the event `NeedMyFolders` gives).
///
/// While a folder is listed or searched the message loop has turns, and each item raises events: afterwards anything may have
/// changed. A listing goes on with the entries that it began with, whatever was shown meanwhile; it stops when the host has let go
/// of the control.
class FileView final : public frame::Control {
  public:
    explicit FileView(frame::Host& host);

    // Look, held by `ListFiles`.
    frame::OLE_COLOR BackColor() const { return ListFiles.BackColor(); }
    void SetBackColor(frame::OLE_COLOR value);
    frame::OLE_COLOR ForeColor() const { return ListFiles.ForeColor(); }
    void SetForeColor(frame::OLE_COLOR value);
    bool Enabled() const { return ListFiles.Enabled(); }
    void SetEnabled(bool value);
    const frame::FontRef& Font() const { return ListFiles.Font(); }
    void SetFont(const frame::FontRef& value);
    child::ListBorderConstants BorderStyle() const { return ListFiles.BorderStyle(); }
    void SetBorderStyle(child::ListBorderConstants value);
    std::int16_t MousePointer() const { return ListFiles.MousePointer(); }
    void SetMousePointer(std::int16_t value);
    const frame::PictureRef& MouseIcon() const { return ListFiles.MouseIcon(); }
    void SetMouseIcon(const frame::PictureRef& value);
    const frame::PictureRef& Picture() const { return ListFiles.Picture(); }
    void SetPicture(const frame::PictureRef& value);
    child::ListPictureAlignmentConstants PictureAlignment() const { return ListFiles.PictureAlignment(); }
    void SetPictureAlignment(child::ListPictureAlignmentConstants value);
    child::ListArrangeConstants Arrange() const { return ListFiles.Arrange(); }
    void SetArrange(child::ListArrangeConstants value);
    child::AppearanceConstants Appearance() const { return ListFiles.Appearance(); }
    void SetAppearance(child::AppearanceConstants value);
    bool HideColumnHeaders() const { return ListFiles.HideColumnHeaders(); }
    void SetHideColumnHeaders(bool value);
    bool HideSelection() const { return ListFiles.HideSelection(); }
    void SetHideSelection(bool value);
    bool MultiSelect() const { return ListFiles.MultiSelect(); }
    void SetMultiSelect(bool value);
    bool AllowColumnReorder() const { return ListFiles.AllowColumnReorder(); }
    void SetAllowColumnReorder(bool value);
    bool FlatScrollBar() const { return ListFiles.FlatScrollBar(); }
    void SetFlatScrollBar(bool value);
    bool FullRowSelect() const { return ListFiles.FullRowSelect(); }
    void SetFullRowSelect(bool value);
    bool GridLines() const { return ListFiles.GridLines(); }
    void SetGridLines(bool value);
    bool HotTracking() const { return ListFiles.HotTracking(); }
    void SetHotTracking(bool value);
    bool HoverSelection() const { return ListFiles.HoverSelection(); }
    void SetHoverSelection(bool value);
    bool LabelWrap() const { return ListFiles.LabelWrap(); }
    void SetLabelWrap(bool value);
    child::ListViewConstants View() const { return ListFiles.View(); }
    void SetView(child::ListViewConstants value);

    /// What is shown; empty after a search. Known to late-bound callers as `Path`. A set shows nothing by itself.
    const std::string& FolderPath() const { return own.Path; }
    void SetFolderPath(const std::string& value);
    /// Where the view begins. A set shows it.
    const std::string& PathRoot() const { return own.PathRoot; }
    void SetPathRoot(const std::string& value);
    /// Whether `GoUp` stays below `PathRoot`. Counts only where that is a real path.
    bool LimitToRoot() const { return own.LimitToRoot; }
    void SetLimitToRoot(bool value);
    /// Whether the folders in a folder are listed too. A set lists anew.
    bool ShowFolders() const { return own.ShowFolders; }
    void SetShowFolders(bool value);
    /// Whether folders show their number of files and their dates; from the next listing on.
    bool ShowFolderDetails() const { return own.ShowFolderDetails; }
    void SetShowFolderDetails(bool value);
    bool AllowHiddenFiles() const { return own.AllowHiddenFiles; }
    void SetAllowHiddenFiles(bool value);
    bool AllowSystemFiles() const { return own.AllowSystemFiles; }
    void SetAllowSystemFiles(bool value);
    /// Whether labels can be edited; a set makes the list's own `LabelEdit` manual or automatic.
    bool AllowLabelEdit() const { return own.AllowLabelEdit; }
    void SetAllowLabelEdit(bool value);
    /// A pattern as `FilterMatch` reads it, for files and folders alike; from the next listing on.
    const std::string& Filter() const { return own.Filter; }
    void SetFilter(const std::string& value);
    child::OLEDragConstants OLEDragMode() const { return own.OLEDragMode; }
    void SetOLEDragMode(child::OLEDragConstants value);
    child::OLEDropConstants OLEDropMode() const { return own.OLEDropMode; }
    void SetOLEDropMode(child::OLEDropConstants value);
    /// Milliseconds between two refreshes; 0 for none. Error 380 below 0. A control that was saved with 0 loads with 10,000: kept
    /// so that saved designs act the same.
    std::int32_t RefreshInterval() const { return RefreshTimer.Interval(); }
    void SetRefreshInterval(std::int32_t value);

    /// The bytes in the whole tree of the folder that is shown, or of the files that a search has found. Of a large tree they are
    /// summed up in idle time; reading waits until they are known.
    frame::Variant TotalSize() const;
    /// Whether reading `TotalSize` needs no waiting. `TotalSizeReady` tells when idle time has made it known.
    bool TotalSizeKnown() const { return own.unmeasured.empty(); }
    frame::Slot<> TotalSizeReady;
    std::int32_t ItemCount() const { return ListFiles.ListItems.Count(); }
    std::int32_t ImageCount() const { return Images().Count(); }
    /// `Path` and the item's name: after a search, where `Path` is empty, the name alone.
    std::string ItemPath() const;
    /// In bytes, of a folder the number of files in it; 0 for more than 32 bits hold.
    std::int32_t ItemSize() const;
    std::string ItemType() const;

    /// The item that the properties `Item...` mean, from 1; 0 when there is none. A set outside 1 to `ItemCount` is passed over.
    std::int32_t ItemIndex() const { return own.ItemIndex; }
    void SetItemIndex(std::int32_t value);
    /// What the item's label shows.
    std::string ItemDisplayName() const;
    void SetItemDisplayName(const std::string& value);
    /// The item's name on the disk. A set changes the label and renames; error 58 when the name is taken.
    std::string ItemName() const;
    void SetItemName(const std::string& value);
    /// The key of the item's large image. A key that the image list lacks is passed over.
    std::string ItemIcon() const;
    void SetItemIcon(const std::string& value);
    std::string ItemSmallIcon() const;
    void SetItemSmallIcon(const std::string& value);
    bool ItemSelected() const;
    void SetItemSelected(bool value);
    std::string ItemTag() const;
    void SetItemTag(const std::string& value);
    /// Kept for the application; nothing in the list changes.
    bool ItemBold() const { return own.ItemBold; }
    void SetItemBold(bool value);
    /// The index of the selected item, 0 when there is none.
    std::int32_t SelectedItem() const;
    /// The new value is tested, the stored one is selected (error 35600 for 0, which only a load changes): kept so that saved
    /// designs act the same.
    void SetSelectedItem(std::int32_t value);
    /// The image that `ImageKey` and `ImageTag` mean, from 1. Any number is taken.
    std::int32_t ImageIndex() const { return own.ImageIndex; }
    void SetImageIndex(std::int32_t value);
    /// Whether the properties and methods `Image...` mean the small images.
    bool ImageSmall() const { return own.ImageSmall; }
    void SetImageSmall(bool value);
    std::string ImageKey() const;
    void SetImageKey(const std::string& value);
    std::string ImageTag() const;
    void SetImageTag(const std::string& value);

    /// Looks whether the rows in view still stand on the disk and whether something has come; lists "My Folders" anew.
    void Refresh();
    /// Shows the folder above, where `PathRoot` and `LimitToRoot` allow it.
    frame::Variant GoUp();
    /// Shows the files below `SearchRoot` whose names match; folders are never among them. `Path` is empty afterwards. The
    /// application stops it by cancelling `BeforeAddItem`.
    frame::Variant Search(const std::string& SearchFor, const std::string& SearchRoot, bool SearchSubdirectories);
    /// Adds an image. Gives the number of images, or the number of the error that prevented it.
    std::int32_t ImageAddNew(const frame::Variant& MyImage, const std::string& MyKey);
    /// Removes an image by key or index. Gives 0, or the number of the error that prevented it.
    frame::Variant ImageRemove(const frame::Variant& MyKey);
    /// Adds a file or folder, wherever it is. Gives its index, or 0 when it was not added.
    std::int32_t ItemAddNew(const std::string& Filename);
    /// Takes an item off the list, the current one where none is given; the disk is not touched.
    std::int32_t ItemRemove(const std::optional<frame::Variant>& Index = {});
    std::int32_t ItemClear();
    /// Gives a file's item the icon that the system shows for it. Gives the icon's key.
    std::string ItemSetupIcon(std::int32_t Index);
    /// Loads the icon of a type of files by way of a temporary file. Whether there is one.
    bool ImageLoadFileType(const std::string& ExtensionName);

    void Initialize() override;
    void Resize() override;
    void Show() override;
    void Paint() override;
    void WriteProperties(frame::PropertyBag& bag) const override;
    frame::TextSize DesignSize() const override;
    const frame::ClassTable& Table() const override { return table; }
    static const frame::ClassTable table;

  private:
    struct Tables;
    class PlaceInTree;
    using RowId = child::RowId;

    /// A file that is to become a row, as a listing or a look at its path has found it.
    struct FoundFile {
        std::string_view name, folder;
        const frame::FileRecord& record;
    };

    /// Where a listing has found an entry.
    struct ListedEntry {
        const std::string& folder;
        frame::FolderListing& listing;
        std::size_t index;
    };

    FileViewRows rows_{Host()};  // serves `ListFiles`, so it stands before it

  public:
    child::ImageList Image32{*this, "Image32"};
    child::ImageList Image16{*this, "Image16"};
    child::ListView ListFiles{*this, "ListFiles"};
    child::PictureBox TempPic{*this, "TempPic"};
    child::TextBox txtMessage{*this, "txtMessage"};
    child::Timer RefreshTimer{*this, "RefreshTimer"};

  private:
    void DesignList();
    void DesignPictures();
    void Connect();

    void ListClick();
    void ListDblClick();
    void ListKeyDown(std::int16_t keyCode, std::int16_t shift);
    void ListKeyPress(std::int16_t keyAscii);
    void ListKeyUp(std::int16_t keyCode, std::int16_t shift);
    void ListMouseDown(std::int16_t button, std::int16_t shift, float x, float y);
    void ListMouseMove(std::int16_t button, std::int16_t shift, float x, float y);
    void ListMouseUp(std::int16_t button, std::int16_t shift, float x, float y);
    void ListItemClick(std::int32_t index);
    void ListColumnClick(std::int32_t index);
    void TimerElapsed();

    template <auto Set, class T>
    void SetStock(std::string_view key, const T& value);

    // Items and images.
    bool ItemIndexValid(std::int32_t index) const { return index >= 1 && index <= ItemCount(); }
    bool ImageIndexValid() const { return own.ImageIndex >= 1 && own.ImageIndex <= ImageCount(); }
    child::ListItemRef Item(std::int32_t index) const { return ListFiles.ListItems.Item(index); }
    child::ListItemRef CurrentItem() const { return Item(own.ItemIndex); }
    std::string ItemText(int subItem) const;
    std::string ItemFullPath(std::int32_t index) const;
    child::ListImages& Images() { return own.ImageSmall ? Image16.ListImages : Image32.ListImages; }
    const child::ListImages& Images() const { return own.ImageSmall ? Image16.ListImages : Image32.ListImages; }
    void SortByColumn(std::int32_t column);
    void RenameItem(const std::string& newName, bool& putBack);

    // Icons.
    void SetFileItemIcons(RowId row, std::string_view folder, std::string_view name);
    void SetFolderItemIcons(RowId row, const std::string& path, std::string key);
    void LoadIconPair(const std::string& path, std::string& key);
    void ClearExeImages();

    // Listing.
    void PaintList();
    void ShowDesign();
    void ListFolder();
    void AddSubFolders(const std::string& folder, frame::FolderListing& listing);
    void AddFiles(const std::string& folder, frame::FolderListing& listing);
    void ListDrives();
    void ListMyFolders();
    void AddUnavailableFolder(const std::string& path);
    std::int32_t AddItemByPath(const std::string& path);
    std::int32_t AddFileItem(std::string path);
    std::int32_t AddListedFile(const ListedEntry& listed, std::string& path);
    std::int32_t AddFoundFile(const FoundFile& file, std::string& path);
    bool HearsOfNewItems() const { return Site() && Site()->Events().Wants(fileview::BeforeAddItem); }
    std::int32_t AddFolderItem(std::string path, std::optional<ListedEntry> listed = {});
    RowId AddFolderRow(const std::string& full, const std::string* parent, const frame::FileRecord& record);
    RowId AddRootRow(const std::string& full, const std::string& path, const frame::FileRecord& record);
    FileViewRows::Details DetailsWanted() const {
        return own.ShowFolderDetails ? FileViewRows::Details::Shown : FileViewRows::Details::Hidden;
    }
    std::int32_t AddDriveItem(const frame::DriveRecord& drive);
    std::int32_t TellAdded(RowId row);
    void FinishPaint();
    void ShowMessage(const std::string& text);
    void ClearRows();
    bool AttributesAllowed(std::int32_t attributes) const;
    /// Makes a folder the one that was handled last, where it can be read. That one is shared by all lists of files of the host.
    bool GetFolder(const std::string& path, frame::FileRecord& record);
    std::string& LastFolder();

    // Refreshing.
    void RefreshCheck();
    bool MarkIfGone(std::int32_t index);
    void RefreshFileItem(std::int32_t index, const std::string& full);
    void RefreshFolderItem(std::int32_t index, const std::string& full);
    void RemoveMarkedRows(std::int32_t first, std::int32_t last);
    void AddNewEntries();

    // Searching.
    void SearchDrives(bool subdirectories, const std::string& pattern);
    void SearchMyFolders(bool subdirectories, const std::string& pattern);
    void SearchFolder(const std::string& root, bool subdirectories, const std::string& pattern);
    void SearchFiles(PlaceInTree& place, const std::string& pattern);
    void EndSubFolder(PlaceInTree& place, const std::string& pattern);

    // Total size.
    void SetTotal(double bytes);
    void AddToTotal(double bytes) { own.TotalSize += bytes; }
    void AddTreeToTotal(const std::string& folder);
    void MeasureAgain(const std::string& folder);
    void FinishTotal() const;
    /// Before the control itself changes the disk, which is not to change what a listing has found.
    void FinishCounting();
    /// Some of what reading would wait for; false when nothing is left.
    bool WorkInIdleTime();

    frame::FileSystem& Disk() const { return Host().Files(); }
    std::string JoinedPath(std::string_view folder, std::string_view name) const;
    /// Sets after how many calls without a limit the message loop has a turn.
    fileservices::Collect& YieldEach(std::int32_t limit) const;

    struct Own {
        std::string Path, PathRoot;
        bool LimitToRoot = true, ShowFolders = true, ShowFolderDetails = false;
        bool AllowHiddenFiles = false, AllowSystemFiles = false, AllowLabelEdit = true;
        std::string Filter;
        std::int32_t ItemIndex = 0, ImageIndex = 0;
        bool ImageSmall = false, ItemBold = false;
        child::OLEDragConstants OLEDragMode = child::OLEDragConstants::Automatic;
        child::OLEDropConstants OLEDropMode = child::OLEDropConstants::Automatic;

        // Saved and loaded only: the properties read the row or the image.
        std::string ItemName, ItemDisplayName, ItemIcon, ItemSmallIcon, ItemTag, ItemPath, ItemType, ImageKey, ImageTag;
        std::int32_t ItemCount = 0, ItemSize = 0, ImageCount = 0, SelectedItem = 0;
        std::int16_t ItemSelected = 0;

        mutable double TotalSize = 0;                                      // bytes, without what is not yet measured
        mutable std::vector<std::unique_ptr<frame::TreeSize>> unmeasured;  // each counts when its end is reached
        std::string unmeasuredFolder;
        std::string PersonalPath;
        frame::Variant MyFolders = frame::VariantArray(1, {});
        std::string MyFolderEntry;  // the folder that was entered last from "My Folders"
        bool AtMyFolders = false;
        child::RowRef LastAddedItem;
        bool Busy = false;  // a listing or a search runs, or has not found its folder: nothing is refreshed
        int listings = 0;   // that add rows at this moment, one within the turns of another
        bool ChangesFound = false;
        bool AddCancelled = false;  // the application has cancelled the adding of a file: a search ends
    };
    Own own;
    IdleWork idleWork_{Host(), [this] { return Path() + ".IdleWork"; }, [this] { return WorkInIdleTime(); }};
};

}  // namespace tessel::controls
