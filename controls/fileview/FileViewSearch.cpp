#include "controls/fileview/FileView.h"
#include "controls/fileview/FilterMatch.h"
#include "fileservices/FileSystemObject.h"
#include "frame/ResumeNext.h"
#include "frame/Text.h"

/// Searching: the files of a folder come before those of the folders in it.
namespace tessel::controls {

using frame::FileRecord;
using frame::ResumeNext;

/// A folder whose sub-folders are being gone through. The walk keeps them in a list of its own, so that no depth of a tree is too
/// much.
class FileView::PlaceInTree {
  public:
    explicit PlaceInTree(std::string path) : folder(std::move(path)) {}

    std::string folder;
    std::unique_ptr<frame::FolderListing> listing;        // null where the folder cannot be read
    std::vector<std::optional<std::int32_t>> attributes;  // of the sub-folders; nothing for one that cannot be read
    std::size_t nextFolder = 0;

    bool AtEnd() const { return !listing || nextFolder >= listing->FolderCount(); }
};

frame::Variant FileView::Search(const std::string& SearchFor, const std::string& SearchRoot, bool SearchSubdirectories) {
    // The arguments may be places that the application changes while events are raised.
    const std::string pattern = SearchFor, root = SearchRoot;
    own.Path.clear();
    SetTotal(0);
    ClearRows();
    ClearExeImages();
    own.AddCancelled = false;
    if (frame::EqualsNoCase(root, "My Documents"))
        SearchFolder(own.PersonalPath, SearchSubdirectories, pattern);
    else if (frame::EqualsNoCase(root, "My Computer"))
        SearchDrives(SearchSubdirectories, pattern);
    else if (frame::EqualsNoCase(root, "My Folders"))
        SearchMyFolders(SearchSubdirectories, pattern);
    else
        SearchFolder(root, SearchSubdirectories, pattern);
    FinishPaint();
    return {};
}

void FileView::SearchDrives(bool subdirectories, const std::string& pattern) {
    for (const frame::DriveRecord& drive : Disk().Drives()) SearchFolder(drive.root, subdirectories, pattern);
}

void FileView::SearchMyFolders(bool subdirectories, const std::string& pattern) {
    const frame::Variant folders = own.MyFolders;
    for (int index = 1; index <= folders.ToArray().UpperBound(); ++index) {
        const std::string path = folders.ToArray().At(index).ToText();
        if (Disk().FolderExists(path)) SearchFolder(path, subdirectories, pattern);
    }
}

void FileView::SearchFolder(const std::string& root, bool subdirectories, const std::string& pattern) {
    own.Busy = true;
    if (own.AddCancelled) return;
    ResumeNext next;
    std::string folder = root;
    next([&] { folder = fileservices::FileSystemObject(Host()).GetFolder(root)->FullPath(); });
    std::vector<PlaceInTree> places;
    places.emplace_back(std::move(folder));
    SearchFiles(places.back(), pattern);
    while (!places.empty() && Site()) {
        PlaceInTree& place = places.back();
        if (place.AtEnd()) {
            places.pop_back();
            next([&] { Host().Turn(); });
            if (!places.empty()) EndSubFolder(places.back(), pattern);
            continue;
        }
        const std::optional<std::int32_t> attributes = place.attributes[place.nextFolder];
        if (!attributes || !AttributesAllowed(*attributes)) {
            ++place.nextFolder;
        } else if (subdirectories && !own.AddCancelled && !place.listing->IsLink(place.nextFolder)) {
            PlaceInTree below(JoinedPath(place.folder, place.listing->Name(place.nextFolder)));
            places.push_back(std::move(below));
            SearchFiles(places.back(), pattern);
        } else {
            EndSubFolder(place, pattern);
        }
    }
    own.Busy = false;
}

/// A sub-folder is done with. One whose name matches is offered as a file too, which a folder never is: only the turn remains.
void FileView::EndSubFolder(PlaceInTree& place, const std::string& pattern) {
    ResumeNext next;
    if (FilterMatch(place.listing->Name(place.nextFolder++), pattern)) next([&] { Host().Turn(); });
}

void FileView::SearchFiles(PlaceInTree& place, const std::string& pattern) {
    if (Disk().List(place.folder, place.listing).Failed()) {
        place.listing.reset();
        return;
    }
    ResumeNext next;
    frame::FolderListing& listing = *place.listing;
    for (std::size_t index = listing.FolderCount(); index < listing.Count() && Site(); ++index) {
        const std::string_view name = listing.Name(index);
        if (!FilterMatch(name, pattern)) continue;
        FileRecord file;
        if (listing.Stat(index, file).Failed() || file.IsFolder() || !AttributesAllowed(file.attributes)) continue;
        std::string path = JoinedPath(place.folder, name);
        next([&] { AddFoundFile({name, place.folder, file}, path); });
        next([&] { Host().Turn(); });
        AddToTotal(static_cast<double>(file.size));
    }
    for (std::size_t index = 0; index < listing.FolderCount(); ++index) {
        std::int32_t attributes = 0;
        const bool failed = listing.StatHiding(index, attributes).Failed();
        place.attributes.push_back(failed ? std::nullopt : std::optional(attributes));
    }
    listing.Rest();
}

}  // namespace tessel::controls
