#include "controls/fileview/FileView.h"
#include "controls/fileview/FilterMatch.h"
#include "fileservices/CommonFile.h"
#include "fileservices/DesignImages.h"
#include "fileservices/FileSys.h"
#include "fileservices/FileSystemObject.h"
#include "fileservices/PathHelpers.h"
#include "frame/ResumeNext.h"
#include "frame/Text.h"

/// How the list is filled.
namespace tessel::controls {

using frame::EqualsNoCase;
using frame::FileRecord;
using frame::ResumeNext;

namespace {

constexpr std::string_view myDocuments = "My Documents", myComputer = "My Computer", myFolders = "My Folders";
constexpr std::int32_t entriesPerTurn = 100;

/// The folder that a list of files handled last. It stays when another cannot be read, and a row may be made of it.
struct FolderInHand {
    std::string path;
};

}  // namespace

void FileView::PaintList() {
    if (!Site()) return;
    if (!UserMode()) return ShowDesign();
    bool cancel = false;
    RaiseEvent(fileview::ChangedFolder, cancel);
    if (cancel) return;
    RaiseEvent(fileview::BeforePaint, cancel);
    if (cancel) return;
    ClearRows();
    ClearExeImages();
    if (own.Path.empty()) return;
    if (EqualsNoCase(own.Path, myComputer)) {
        ListDrives();
    } else if (EqualsNoCase(own.Path, myFolders)) {
        ListMyFolders();
    } else {
        if (EqualsNoCase(own.Path, myDocuments)) own.Path = own.PersonalPath;
        ListFolder();
    }
    FinishPaint();
}

void FileView::ShowDesign() {
    ClearRows();
    ShowMessage(Site()->Ambient().DisplayName() + ": PathRoot set to '" + own.PathRoot + "'");
}

void FileView::ListFolder() {
    own.Busy = true;
    ShowMessage("");
    if (!Disk().FolderExists(own.Path)) {
        // Stays busy, so that nothing is refreshed in a folder that has gone.
        ShowMessage("Folder '" + own.Path + "' does not exist.");
        return;
    }
    ResumeNext next;
    std::string folder = own.Path;
    next([&] { folder = fileservices::FileSystemObject(Host()).GetFolder(folder)->FullPath(); });
    SetTotal(0);
    next([&] { AddTreeToTotal(folder); });
    std::unique_ptr<frame::FolderListing> listing;
    next([&] { return Disk().List(folder, listing); });
    ++own.listings;
    if (own.ShowFolders && listing) AddSubFolders(folder, *listing);
    if (listing) AddFiles(folder, *listing);
    --own.listings;
    own.Busy = false;
}

void FileView::AddSubFolders(const std::string& folder, frame::FolderListing& listing) {
    ResumeNext next;
    fileservices::Collect& collect = YieldEach(entriesPerTurn);
    for (std::size_t index = 0; index < listing.FolderCount() && Site(); ++index) {
        const std::string_view name = listing.Name(index);
        if (FilterMatch(name, own.Filter))
            next([&] { AddFolderItem(JoinedPath(folder, name), ListedEntry{folder, listing, index}); });
        next([&] { collect.CollectYield(); });
    }
}

void FileView::AddFiles(const std::string& folder, frame::FolderListing& listing) {
    ResumeNext next;
    fileservices::Collect& collect = YieldEach(entriesPerTurn);
    std::string path;
    for (std::size_t index = listing.FolderCount(); index < listing.Count() && Site(); ++index) {
        if (FilterMatch(listing.Name(index), own.Filter)) next([&] { AddListedFile({folder, listing, index}, path); });
        next([&] { collect.CollectYield(); });
    }
}

void FileView::ListDrives() {
    for (const frame::DriveRecord& drive : Disk().Drives()) AddDriveItem(drive);
}

void FileView::ListMyFolders() {
    if (own.MyFolders.ToArray().UpperBound() == 0) RaiseEvent(fileview::NeedMyFolders, own.MyFolders);
    SetTotal(0);
    own.MyFolderEntry.clear();
    own.AtMyFolders = true;
    ClearRows();
    const frame::Variant folders = own.MyFolders;
    for (int index = 1; index <= folders.ToArray().UpperBound() && Site(); ++index) {
        const std::string path = folders.ToArray().At(index).ToText();
        if (!Disk().FolderExists(path)) {
            AddUnavailableFolder(path);
            continue;
        }
        AddTreeToTotal(path);
        AddFolderItem(path);
    }
}

void FileView::AddUnavailableFolder(const std::string& path) {
    child::ListRows& rows = ListFiles.Rows();
    const RowId row = rows.Add(path + " (Unavailable)");
    ResumeNext next;
    next([&] { return rows.SetIconKey(row, child::IconSize::Large, fileservices::designimages::folderUnavailable); });
    next([&] { return rows.SetIconKey(row, child::IconSize::Small, fileservices::designimages::folderUnavailable); });
    rows.SetText(row, subItem::sortName, " " + path);
}

// Rows.

std::int32_t FileView::AddItemByPath(const std::string& path) {
    return Disk().FileExists(path) ? AddFileItem(path) : AddFolderItem(path);
}

std::int32_t FileView::AddFileItem(std::string path) {
    FileRecord record;
    if (Disk().Stat(path, record).Failed() || record.IsFolder()) return 0;
    const std::string name(fileservices::GetFileName(path, Disk().Separator()));
    const std::string folder = fileservices::GetParentFolderName(path, Disk());
    return AddFoundFile({name, folder, record}, path);
}

/// `path` is a place for the path of the file, which is made only when somebody hears of it.
std::int32_t FileView::AddListedFile(const ListedEntry& listed, std::string& path) {
    FileRecord record;
    if (listed.listing.Stat(listed.index, record).Failed() || record.IsFolder()) return 0;
    const std::string_view name = listed.listing.Name(listed.index);
    if (HearsOfNewItems()) {
        path = listed.folder;
        if (!path.ends_with(Disk().Separator())) path += Disk().Separator();
        path += name;
    }
    return AddFoundFile({name, listed.folder, record}, path);
}

/// Once the application has agreed the row is whole in one step: nothing runs until `AfterAddItem`.
std::int32_t FileView::AddFoundFile(const FoundFile& file, std::string& path) {
    if (!AttributesAllowed(file.record.attributes)) return 0;
    ResumeNext next;
    bool cancel = false;
    next([&] { RaiseEvent(fileview::BeforeAddItem, cancel, path); });
    if (cancel) {
        own.AddCancelled = true;
        return 0;
    }
    child::ListRows& rows = ListFiles.Rows();
    if (rows.Count() == 0) ShowMessage("");
    const RowId row = rows.NextId();
    rows_.CaptureFile(row, file.name, file.folder, file.record);
    rows.AddFromSource();
    rows.Fill(row);
    SetFileItemIcons(row, file.folder, file.name);
    rows.SetGhosted(row, (file.record.attributes & frame::attributes::hidden) != 0);
    return TellAdded(row);
}

std::int32_t FileView::TellAdded(RowId row) {
    ResumeNext next;
    auto index = static_cast<std::int32_t>(ListFiles.Rows().PositionOf(row)) + 1;
    next([&] { RaiseEvent(fileview::AfterAddItem, index); });
    return index;
}

/// The application may change the path in `BeforeAddItem`: it comes before anything is asked of the disk.
std::int32_t FileView::AddFolderItem(std::string path, std::optional<ListedEntry> listed) {
    ResumeNext next;
    bool cancel = false;
    const std::string offered = path;
    next([&] { RaiseEvent(fileview::BeforeAddItem, cancel, path); });
    if (cancel) return 0;
    FileRecord record;
    const bool isListed = listed && path == offered;
    if (isListed && !listed->listing.Stat(listed->index, record).Failed() && record.IsFolder()) {
        LastFolder() = path;
    } else if (!GetFolder(path, record)) {
        // The row is made of the folder that was handled last, where there is one.
        if (LastFolder().empty() || Disk().Stat(LastFolder(), record).Failed() || !record.IsFolder()) return 0;
    }
    const bool isDrive = Disk().DriveExists(path);
    if (!isDrive && !AttributesAllowed(record.attributes)) return 0;
    if (ItemCount() == 0) ShowMessage("");
    const std::string full = LastFolder();
    const std::string* parent = isListed && full == path ? &listed->folder : nullptr;
    const RowId row = Disk().DriveExists(full) ? AddRootRow(full, path, record) : AddFolderRow(full, parent, record);
    own.LastAddedItem = ListFiles.Rows().Ref(row);
    if (rows_.HasUncounted()) idleWork_.Start();
    SetFolderItemIcons(row, full, rows_.TypeText(record.typeId));
    if (!isDrive) ListFiles.Rows().SetGhosted(row, (record.attributes & frame::attributes::hidden) != 0);
    return TellAdded(row);
}

FileView::RowId FileView::AddFolderRow(const std::string& full, const std::string* parent, const FileRecord& record) {
    child::ListRows& rows = ListFiles.Rows();
    const RowId row = rows.NextId();
    rows_.CaptureFolder(row, fileservices::GetFileName(full, Disk().Separator()),
                        parent ? *parent : fileservices::GetParentFolderName(full, Disk()), record, DetailsWanted());
    rows.AddFromSource();
    rows.Fill(row);
    return row;
}

/// The root of a drive has no name and no folder that holds it: it is shown as the drive, and known by its path.
FileView::RowId FileView::AddRootRow(const std::string& full, const std::string& path, const FileRecord& record) {
    ResumeNext next;
    std::string text;
    next([&] {
        const fileservices::FileSystemObject files(Host());
        text = Host().Module<fileservices::CommonFile>().FolderDisplayName(files.GetFolder(full));
    });
    child::ListRows& rows = ListFiles.Rows();
    rows_.CaptureFolder(rows.NextId(), "", full, record, DetailsWanted());
    const RowId row = rows.Add(text);
    rows.Fill(row);
    rows.SetText(row, subItem::folder, "");
    rows.SetText(row, subItem::realName, path);
    rows.SetText(row, subItem::sortName, " " + text);
    return row;
}

std::int32_t FileView::AddDriveItem(const frame::DriveRecord& record) {
    ResumeNext next;
    bool cancel = false;
    std::string path = record.path;
    next([&] { RaiseEvent(fileview::BeforeAddItem, cancel, path); });
    if (cancel) return 0;
    const auto drive = std::make_shared<fileservices::Drive>(record);
    std::string text;
    next([&] { text = Host().Module<fileservices::CommonFile>().DriveDisplayName(drive); });
    child::ListRows& rows = ListFiles.Rows();
    const RowId row = rows.Add(text);
    SetFolderItemIcons(row, record.root, Host().Module<fileservices::FileSys>().DriveTypeWord(drive));
    rows.SetText(row, subItem::realName, record.root);
    return TellAdded(row);
}

bool FileView::GetFolder(const std::string& path, FileRecord& record) {
    if (Disk().Stat(path, record).Failed() || !record.IsFolder()) return false;
    ResumeNext next;
    std::string full = path;
    const char separator = Disk().Separator();
    if (path.ends_with(separator) || fileservices::GetFileName(path, separator).empty())  // not as folders are spelt
        next([&] { full = fileservices::FileSystemObject(Host()).GetFolder(path)->FullPath(); });
    LastFolder() = full;
    return true;
}

std::string& FileView::LastFolder() { return Host().Module<FolderInHand>().path; }

void FileView::ClearRows() {
    ListFiles.ListItems.Clear();
    rows_.Clear();
}

bool FileView::AttributesAllowed(std::int32_t attributes) const {
    if (!own.AllowHiddenFiles && (attributes & frame::attributes::hidden) != 0) return false;
    return own.AllowSystemFiles || (attributes & frame::attributes::system) == 0;
}

// The end of a listing.

void FileView::FinishPaint() {
    if (ItemCount() == 0) {
        own.ItemIndex = 0;
        if (txtMessage.Text().empty()) ShowMessage("There are no items to show in this folder.");
    } else {
        own.ItemIndex = 1;
        ShowMessage("");
    }
    RaiseEvent(fileview::AfterPaint);
}

void FileView::ShowMessage(const std::string& text) {
    if (text.empty()) {
        txtMessage.SetText("");
        txtMessage.SetVisible(false);
        return;
    }
    constexpr float edge = 120, belowHeaders = 180, perPoint = 30;  // twips
    const bool report = ListFiles.View() == child::ListViewConstants::Report;
    const float top = report ? belowHeaders + perPoint * static_cast<float>(ListFiles.Font()->Size()) : edge;
    txtMessage.SetFont(ListFiles.Font());
    txtMessage.SetForeColor(ListFiles.ForeColor());
    txtMessage.SetBackColor(ListFiles.BackColor());
    txtMessage.SetText(text);
    txtMessage.Move(edge, top, ListFiles.Width() - 2 * edge, txtMessage.Height());
    txtMessage.SetVisible(true);
}

frame::Variant FileView::GoUp() {
    std::string target(myFolders);
    if (!EqualsNoCase(own.Path, own.MyFolderEntry)) {
        target = fileservices::GetParentFolderName(own.Path, Disk());
        if (target.empty()) target = own.PathRoot;
    }
    bool allowed = true;
    if (EqualsNoCase(own.PathRoot, myDocuments))
        allowed = !EqualsNoCase(own.Path, own.PersonalPath);
    else if (!EqualsNoCase(own.PathRoot, myComputer) && !EqualsNoCase(own.PathRoot, myFolders))
        allowed = !own.LimitToRoot || frame::StartsWithNoCase(target, own.PathRoot);
    if (allowed) {
        own.Path = target;
        PaintList();
    }
    return {};
}

}  // namespace tessel::controls
