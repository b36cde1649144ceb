#include "fileservices/DiskEntry.h"

#include <array>
#include <typeinfo>

#include "fileservices/PathHelpers.h"
#include "frame/ChildControl.h"
#include "frame/ClassTable.h"
#include "frame/Error.h"
#include "frame/Text.h"

namespace tessel::fileservices {

namespace errors = frame::errors;

// DiskEntry.

std::string DiskEntry::Name() const {
    if (Disk().DriveExists(path_)) return {};
    return std::string(GetFileName(path_, Disk().Separator()));
}

void DiskEntry::SetName(const std::string& value) {
    const std::string parent = GetParentFolderName(path_, Disk());
    Disk().Rename(path_, value).Check();
    path_ = BuildPath(parent, value, Disk().Separator());
}

std::string DiskEntry::Type() const { return Disk().TypeText(Record().typeId); }

void DiskEntry::SetAttributes(std::int32_t value) { Disk().SetAttributes(path_, value).Check(); }

FolderRef DiskEntry::ParentFolder() const {
    std::string parent = GetParentFolderName(path_, Disk());
    return parent.empty() ? nullptr : std::make_shared<Folder>(host_, std::move(parent));
}

bool DiskEntry::EqualsObject(const Object& other) const {
    const auto* entry = dynamic_cast<const DiskEntry*>(&other);
    if (!entry || typeid(*entry) != typeid(*this) || &entry->host_ != &host_) return false;
    return Disk().IgnoresCase() ? frame::EqualsNoCase(entry->path_, path_) : entry->path_ == path_;
}

// File and Folder.

frame::FileRecord File::Record() const {
    frame::FileRecord record;
    Disk().Stat(FullPath(), record).Check();
    if (record.IsFolder()) throw frame::ControlError(errors::fileNotFound);
    return record;
}

frame::FileRecord Folder::Record() const {
    frame::FileRecord record;
    const frame::Status status = Disk().Stat(FullPath(), record);
    const bool missing = status.Number() == errors::fileNotFound || (!status.Failed() && !record.IsFolder());
    if (missing) throw frame::ControlError(errors::pathNotFound);
    status.Check();
    return record;
}

std::int64_t Folder::Bytes() const {
    (void)Record();  // a folder that is missing has no size, where one that cannot be read has 0
    return Disk().MeasureTree(FullPath())->Finish();
}

FilesRef Folder::Files() const { return std::make_shared<EntryCollection<File>>(Host(), FullPath()); }
FoldersRef Folder::SubFolders() const { return std::make_shared<EntryCollection<Folder>>(Host(), FullPath()); }

// EntryCollection.

template <class T>
constexpr bool holdsFolders = std::is_same_v<T, Folder>;

template <class T>
std::int32_t EntryCollection<T>::Count() const {
    frame::FolderCounts counts;
    if (listing_) {
        counts.folders = static_cast<std::int64_t>(listing_->FolderCount());
        counts.files = static_cast<std::int64_t>(listing_->Count()) - counts.folders;
    } else {
        host_.Files().Count(folder_, counts).Check();
    }
    return static_cast<std::int32_t>(holdsFolders<T> ? counts.folders : counts.files);
}

template <class T>
std::shared_ptr<T> EntryCollection<T>::Item(const frame::Variant& key) const {
    if (key.IsNumber()) return At(key.ToLong());
    auto entry = std::make_shared<T>(host_, BuildPath(folder_, key.ToText(), host_.Files().Separator()));
    (void)entry->Record();  // fails when there is none
    return entry;
}

template <class T>
std::shared_ptr<T> EntryCollection<T>::At(std::int32_t number) const {
    const frame::FolderListing& listing = Listing();
    if (number < 1 || number > Count()) throw frame::ControlError(errors::subscript);
    const std::size_t index = static_cast<std::size_t>(number - 1) + (holdsFolders<T> ? 0 : listing.FolderCount());
    return std::make_shared<T>(host_, BuildPath(folder_, listing.Name(index), host_.Files().Separator()));
}

template <class T>
const frame::FolderListing& EntryCollection<T>::Listing() const {
    if (!listing_) {
        host_.Files().List(folder_, listing_).Check();
        listing_->Rest();
    }
    return *listing_;
}

namespace {

constexpr std::array entryMembers = {
    frame::property<&DiskEntry::Name, &DiskEntry::SetName>("Name", "The name; setting it renames."),
    frame::property<&DiskEntry::FullPath>("Path", "The whole path."),
    frame::property<&DiskEntry::Size>("Size", "The size in bytes; of a folder the sum of all in it."),
    frame::property<&DiskEntry::Type>("Type", "The system's description of the type."),
    frame::property<&DiskEntry::Attributes, &DiskEntry::SetAttributes>("Attributes", "1 read-only, 2 hidden, 4 system."),
    frame::property<&DiskEntry::DateCreated>("DateCreated", "When it was made."),
    frame::property<&DiskEntry::DateLastModified>("DateLastModified", "When it was last changed."),
    frame::property<&DiskEntry::DateLastAccessed>("DateLastAccessed", "When it was last looked into."),
    frame::property<&DiskEntry::ParentFolder>("ParentFolder", "The folder that holds it; none at the root of a drive."),
};
constexpr frame::ClassTable fileTable{.name = "File", .members = entryMembers, .defaultMember = "Path"};

constexpr auto folderMembers =
    frame::Join(entryMembers, std::array{
                                  frame::property<&Folder::Files>("Files", "The files in it."),
                                  frame::property<&Folder::SubFolders>("SubFolders", "The folders in it."),
                              });
constexpr frame::ClassTable folderTable{.name = "Folder", .members = folderMembers, .defaultMember = "Path"};

template <class T>
constexpr std::array collectionMembers = {
    frame::property<&EntryCollection<T>::Count>("Count", "How many there are."),
    frame::property<&EntryCollection<T>::Item>("Item", "One by its number, from 1, or by its name."),
};
template <class T>
constexpr frame::ClassTable collectionTable{
    .name = holdsFolders<T> ? "SubFolders" : "Files", .members = collectionMembers<T>, .defaultMember = "Item"};

}  // namespace

const frame::ClassTable& File::Table() const { return fileTable; }
const frame::ClassTable& Folder::Table() const { return folderTable; }
template <class T>
const frame::ClassTable& EntryCollection<T>::Table() const {
    return collectionTable<T>;
}

template class EntryCollection<File>;
template class EntryCollection<Folder>;

}  // namespace tessel::fileservices
