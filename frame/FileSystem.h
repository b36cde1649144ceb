#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "frame/Error.h"

namespace tessel::frame {

/// Attribute bits of a file or folder.
namespace attributes {
inline constexpr int readOnly = 1, hidden = 2, system = 4, directory = 16, archive = 32;
}

/// The type text of every folder, in every language: pictures made at design time stand under this word.
inline constexpr std::string_view folderTypeText = "File Folder";

/// What a listing captures of one entry beside its name; texts are made from it when they are read. Times are whole seconds since
/// 1970-01-01 in Coordinated Universal Time. Where a file system keeps no time of creation, `created` equals `modified`.
struct FileRecord {
    std::int64_t size = 0;  ///< bytes; of a folder 0
    std::int64_t created = 0, modified = 0, accessed = 0;
    std::int32_t attributes = 0;  ///< bits of `attributes`
    std::int32_t typeId = 0;      ///< names the type text, `FileSystem::TypeText`

    bool IsFolder() const { return (attributes & attributes::directory) != 0; }
    friend bool operator==(const FileRecord&, const FileRecord&) = default;
};

/// The entries of one folder as they stood when it was opened: the names are there at once, the rest is read entry by entry, so
/// that who lists a large folder can stop, yield or pass entries over at any place.
///
/// Folders come first, then files, each in name order: by bytes where case counts, without regard to case where it does not.
/// Whatever is no folder is a file; a link counts as what it leads to, and as a file when it leads nowhere.
class FolderListing {
  public:
    FolderListing() = default;
    FolderListing(const FolderListing&) = delete;
    FolderListing& operator=(const FolderListing&) = delete;
    virtual ~FolderListing() = default;

    std::size_t Count() const { return entries_.size(); }
    /// The first so many entries are folders.
    std::size_t FolderCount() const { return folders_; }
    bool IsFolder(std::size_t index) const { return index < folders_; }
    /// Valid as long as the listing.
    std::string_view Name(std::size_t index) const { return {names_.data() + entries_[index].start, entries_[index].length}; }

    /// Whether the entry is a link, which counts as what it leads to.
    bool IsLink(std::size_t index) const { return entries_[index].isLink; }

    /// Reads what stands on the disk now. 53 when the entry has gone, 70 when it may not be read.
    virtual Status Stat(std::size_t index, FileRecord& record) = 0;
    /// Reads the bits `hidden` and `system` of an entry, and no more than these take: nothing of the disk where names tell them.
    virtual Status StatHiding(std::size_t index, std::int32_t& attributes);
    /// Gives back what the listing holds of the system until the next `Stat`: for a listing that is kept while its sub-folders are
    /// listed.
    virtual void Rest() {}

  protected:
    struct Entry {
        std::uint32_t start;  // of its name, which a NUL ends
        std::uint16_t length;
        bool isLink = false;
    };

    /// False when the names have become too many for a listing (4 GiB).
    bool Add(std::string_view name);

    std::string names_;
    std::vector<Entry> entries_;
    std::size_t folders_ = 0;
};

struct FolderCounts {
    std::int64_t files = 0, folders = 0;
    friend bool operator==(const FolderCounts&, const FolderCounts&) = default;
};

/// Sums the sizes of all files below a folder, in steps, so that a large tree can be measured in idle time.
/// Links are not followed and count nothing; other disks that are mounted inside, and folders that cannot be read, are left out.
class TreeSize {
  public:
    virtual ~TreeSize() = default;
    /// Looks at some `entries` more; false when all have been seen.
    virtual bool Step(std::size_t entries) = 0;
    /// The bytes found so far.
    std::int64_t Bytes() const { return bytes_; }
    /// Goes to the end.
    std::int64_t Finish();

  protected:
    std::int64_t bytes_ = 0;
};

/// What `DriveRecord::type` says.
namespace driveTypes {
inline constexpr int unknown = 0, removable = 1, fixed = 2, network = 3, compactDisk = 4, ramDisk = 5;
}

struct DriveRecord {
    std::string path;    ///< as `Drive.Path` gives it: "C:", "/media/usb/"
    std::string root;    ///< the path of its top folder, which is how `DriveExists` knows it: "C:\", "/media/usb/"
    std::string letter;  ///< empty where drives have none
    int type = driveTypes::unknown;
    std::string shareName;  ///< "\\server\name" of a network drive, else empty
    std::string volumeName;
    bool isReady = true;
    friend bool operator==(const DriveRecord&, const DriveRecord&) = default;
};

/// The names that special folders are asked for, and their numbers for `FileSystem::SpecialFolder`. Compare without regard to case.
struct SpecialFolderName {
    std::string_view name;
    int number;
};
inline constexpr std::array<SpecialFolderName, 17> specialFolderNames = {{
    {"DESKTOP", 0},
    {"PROGRAMS", 2},
    {"CONTROLS", 3},
    {"PRINTERS", 4},
    {"PERSONAL", 5},
    {"FAVORITES", 6},
    {"STARTUP", 7},
    {"RECENT", 8},
    {"SENDTO", 9},
    {"BITBUCKET", 10},
    {"STARTMENU", 11},
    {"DESKTOPDIRECTORY", 16},
    {"DRIVES", 17},
    {"NETWORK", 18},
    {"NETHOOD", 19},
    {"FONTS", 20},
    {"TEMPLATES", 21},
}};
/// Below 0 when the name stands not in the table.
int SpecialFolderNumber(std::string_view name);

/// A file opened for binary reading. Positions and sizes are in bytes.
class BinaryFile {
  public:
    virtual ~BinaryFile() = default;
    /// Reads up to `size` bytes at `position`; `read` tells how many there were. 57 when the disk fails.
    virtual Status Read(std::int64_t position, char* bytes, std::size_t size, std::size_t& read) = 0;
    virtual std::int64_t Size() const = 0;
};

/// The file system as the library sees it. Paths are UTF-8 in the system's own separator, with whatever bytes the names on the disk
/// have; every call works on the disk as it is now and keeps nothing.
///
/// Failures are numbers: 52 bad name, 53 no such file, 57 the device fails, 58 the name is taken, 61 disk full, 70 permission
/// denied (a protected disk or file too), 71 disk not ready, 75 cannot be done with what stands there, 76 no such folder.
class FileSystem {
  public:
    virtual ~FileSystem() = default;

    virtual char Separator() const = 0;
    /// Whether names compare without regard to case.
    virtual bool IgnoresCase() const = 0;

    /// Whether there is something that is no folder.
    virtual bool FileExists(std::string_view path) = 0;
    /// True for the root of a drive that is ready.
    virtual bool FolderExists(std::string_view path) = 0;
    /// Whether the path is the root of a drive, ready or not, in its one spelling: with the separator at its end.
    virtual bool DriveExists(std::string_view path) = 0;

    /// 53 where nothing stands, 76 where the folder is missing that should hold it.
    virtual Status Stat(std::string_view path, FileRecord& record) = 0;
    /// 76 when there is no such folder, 70 when it may not be read.
    virtual Status List(std::string_view folder, std::unique_ptr<FolderListing>& listing) = 0;
    /// How many entries `List` would give, without what only names and order cost.
    virtual Status Count(std::string_view folder, FolderCounts& counts) = 0;
    /// Never null. A folder that cannot be read has the size 0.
    virtual std::unique_ptr<TreeSize> MeasureTree(std::string_view folder) = 0;

    virtual std::vector<DriveRecord> Drives() = 0;
    /// The description of a type; empty for a number that no record had.
    virtual std::string TypeText(std::int32_t typeId) = 0;

    /// 58 when the name is taken, 76 without the folder that is to hold it.
    virtual Status CreateFolder(std::string_view path) = 0;
    /// Makes an empty file; 58 when there is one and it is not to be overwritten, 70 when a folder has the name.
    virtual Status CreateFile(std::string_view path, bool overwrite) = 0;
    /// 53 when there is no such file, 70 for a read-only one without `force`.
    virtual Status DeleteFile(std::string_view path, bool force) = 0;
    /// Gives a file or folder another name in its folder. Replaces nothing: 58 when the name is taken.
    virtual Status Rename(std::string_view path, std::string_view newName) = 0;
    /// Changes the bits that differ from the present ones; the directory bit is passed over. 5 when one differs that the file
    /// system cannot keep, and then nothing has changed.
    virtual Status SetAttributes(std::string_view path, std::int32_t value) = 0;

    virtual std::string TemporaryFolder() = 0;
    /// The path of a special folder by its number; empty when there is none.
    virtual std::string SpecialFolder(int number) = 0;

    /// 53 or 76 when it is missing, 70 when it may not be read, 75 for a folder.
    virtual Status OpenForReading(std::string_view path, std::unique_ptr<BinaryFile>& file) = 0;
    /// Puts `bytes` at the start of the file, which keeps what stood behind them; makes the file where there is none. After a
    /// failure the file is as it was; after a crash it is the old one or the new one, never something between, as far as the
    /// file system can give that.
    virtual Status WriteOver(std::string_view path, std::string_view bytes) = 0;
};

}  // namespace tessel::frame
