#include "controls/fileview/FileView.h"
#include "controls/fileview/FilterMatch.h"
#include "fileservices/PathHelpers.h"
#include "frame/ResumeNext.h"
#include "frame/Text.h"

/// How the list follows the disk. Only the rows in view are looked at, and new entries are looked for only when the list is short
/// or its end is in view.
namespace tessel::controls {

using frame::EqualsNoCase;
using frame::FileRecord;
using frame::ResumeNext;

namespace {
constexpr std::string_view removeThis = "RemoveThis";
}

void FileView::Refresh() {
    if (EqualsNoCase(own.PathRoot, "My Folders")) {
        own.MyFolders = frame::VariantArray(1, {});
        ListMyFolders();
    } else if (!EqualsNoCase(own.PathRoot, "My Computer")) {
        RefreshCheck();
    }
}

void FileView::TimerElapsed() {
    if (!UserMode() || EqualsNoCase(own.PathRoot, "My Folders") || EqualsNoCase(own.PathRoot, "My Computer")) return;
    RefreshCheck();
}

void FileView::RefreshCheck() {
    if (own.Busy || own.Path.empty() || ItemCount() == 0) return;
    constexpr std::int32_t shortList = 100;
    const std::int32_t keptIndex = own.ItemIndex;
    own.ChangesFound = false;
    std::int32_t marked = 0;
    bool endSeen = true;
    const std::int32_t first = ListFiles.TopIndex();
    std::int32_t last = first;
    ResumeNext next;
    for (std::int32_t index = first; index <= ItemCount(); ++index) {
        const auto position = static_cast<child::ListRows::Position>(index - 1);
        // The marked rows still stand in the list and push the last one in view down.
        const float bottom = ListFiles.Height() + ListFiles.RowHeight(position) * static_cast<float>(marked);
        if (index > first && bottom < ListFiles.RowTop(position)) {
            endSeen = false;
            break;
        }
        last = index;
        next([&] { marked += MarkIfGone(index) ? 1 : 0; });
    }
    RemoveMarkedRows(first, last);
    if (ItemCount() < shortList || endSeen) next([&] { AddNewEntries(); });
    FileRecord record;
    if (GetFolder(own.Path, record)) next([&] { MeasureAgain(LastFolder()); });
    next([&] { FinishPaint(); });
    own.ItemIndex = keptIndex;
    if (own.ChangesFound) next([&] { RaiseEvent(fileview::RefreshFoundChanges); });
}

/// Looks at one row. True when it is to be removed.
bool FileView::MarkIfGone(std::int32_t index) {
    const std::string full = JoinedPath(own.Path, Item(index)->SubItems(subItem::realName));
    if (Disk().FileExists(full)) {
        RefreshFileItem(index, full);
    } else if (Disk().FolderExists(full)) {
        RefreshFolderItem(index, full);
    } else if (!Disk().DriveExists(full)) {
        Item(index)->SetSubItems(subItem::refresh, std::string(removeThis));
        return true;
    }
    return false;
}

/// Finds out whether a file is other than its row says. The row keeps its texts: they change with the next listing.
void FileView::RefreshFileItem(std::int32_t index, const std::string& full) {
    FileRecord file;
    Disk().Stat(full, file).Check();
    const child::ListItemRef item = Item(index);
    const auto differs = [&](int column, std::string_view text) { return !EqualsNoCase(item->SubItems(column), text); };
    // No row ever says "True" or "False", so that every file in view counts as changed: kept so that applications which count on
    // RefreshFoundChanges at each refresh act the same.
    if (differs(subItem::changed, file.modified == file.created ? "True" : "False") ||
        differs(subItem::size, rows_.SizeText(file.size)) || differs(subItem::type, rows_.TypeText(file.typeId)) ||
        differs(subItem::modified, rows_.DateText(file.modified)) || differs(subItem::created, rows_.DateText(file.created)) ||
        differs(subItem::folder, fileservices::GetParentFolderName(full, Disk())) ||
        differs(subItem::sortedSize, FileViewRows::SortedSizeText(file.size)) ||
        differs(subItem::sortedModified, rows_.SortedDateText(file.modified)) ||
        differs(subItem::sortedCreated, rows_.SortedDateText(file.created)) ||
        differs(subItem::realName, fileservices::GetFileName(full, Disk().Separator())) || differs(subItem::sortName, item->Text()))
        own.ChangesFound = true;
    item->SetGhosted((file.attributes & frame::attributes::hidden) != 0);
    item->SetSubItems(subItem::refresh, "");
}

void FileView::RefreshFolderItem(std::int32_t index, const std::string& full) {
    FileRecord folder;
    if (!GetFolder(full, folder)) throw frame::ControlError(frame::errors::pathNotFound);
    const child::ListItemRef item = Item(index);
    const auto differs = [&](int column, std::string_view text) { return !EqualsNoCase(item->SubItems(column), text); };
    if (own.ShowFolderDetails) {
        const std::optional<std::int64_t> files = rows_.FilesIn(full);
        const bool changed = folder.modified != folder.created;
        if ((files && (differs(subItem::size, frame::Decimal(*files)) ||
                       differs(subItem::sortedSize, FileViewRows::SortedSizeText(*files)))) ||
            differs(subItem::modified, rows_.DateText(folder.modified)) ||
            differs(subItem::created, rows_.DateText(folder.created)) || differs(subItem::changed, changed ? "Yes" : "") ||
            differs(subItem::sortedModified, rows_.SortedDateText(folder.modified)) ||
            differs(subItem::sortedCreated, rows_.SortedDateText(folder.created)))
            own.ChangesFound = true;
    }
    const bool isRoot = Disk().DriveExists(full);
    if (differs(subItem::folder, fileservices::GetParentFolderName(full, Disk())) ||
        differs(subItem::realName, isRoot ? full : fileservices::GetFileName(full, Disk().Separator())) ||
        differs(subItem::sortName, " " + item->Text()))
        own.ChangesFound = true;
    item->SetGhosted((folder.attributes & frame::attributes::hidden) != 0);
    item->SetSubItems(subItem::refresh, "");
}

void FileView::RemoveMarkedRows(std::int32_t first, std::int32_t last) {
    child::ListRows& rows = ListFiles.Rows();
    for (std::int32_t index = last; index >= first; --index) {
        const RowId row = rows.At(static_cast<child::ListRows::Position>(index - 1));
        if (rows.Text(row, subItem::refresh) != removeThis) continue;
        rows.Remove(row);
        own.ChangesFound = true;
    }
}

void FileView::AddNewEntries() {
    constexpr std::int32_t foldersPerTurn = 30, filesPerTurn = 100;
    FileRecord record;
    if (!GetFolder(own.Path, record)) return;
    const std::string folder = LastFolder();
    std::unique_ptr<frame::FolderListing> listing;
    Disk().List(folder, listing).Check();
    const child::ListRows& rows = ListFiles.Rows();
    fileservices::Collect& collect = YieldEach(foldersPerTurn);
    if (own.ShowFolders)
        for (std::size_t index = 0; index < listing->FolderCount() && Site(); ++index) {
            const std::string_view name = listing->Name(index);
            if (FilterMatch(name, own.Filter) && !rows.Find(name))
                AddFolderItem(JoinedPath(folder, name), ListedEntry{folder, *listing, index});
            collect.CollectYield();
        }
    YieldEach(filesPerTurn);
    std::string path;
    for (std::size_t index = listing->FolderCount(); index < listing->Count() && Site(); ++index) {
        const std::string_view name = listing->Name(index);
        if (!FilterMatch(name, own.Filter)) continue;
        if (!rows.Find(name)) AddListedFile({folder, *listing, index}, path);
        collect.CollectYield();
    }
}

}  // namespace tessel::controls
