#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

#include "frame/Dates.h"
#include "frame/FileSystem.h"
#include "frame/host.h"

namespace tessel::headless {

/// A moment in seconds since 1970, Coordinated Universal Time, as the headless host's locale turns it into local time.
std::int64_t SecondsOf(frame::Date date);

/// A file system in memory: drives with letters, the backslash, names without regard to case, and attributes.
///
/// A path is a drive ("C:\x\a.txt") or a share ("\\server\name\a.txt", where there is a drive of that share without a letter) and
/// names; "." and ".." are followed, trailing blanks and points of a name count nothing. A name has at most 255 bytes and none of
/// \ / : * ? " < > | or of the control characters.
///
/// At first there is the fixed drive C with the folder C:\Temp, which is the temporary folder. The special folder 5 ("Personal") is
/// C:\My Documents; it exists once it is made.
class MemoryDisk final : public frame::FileSystem {
  public:
    /// `now` gives the time of what is made, in seconds since 1970.
    explicit MemoryDisk(std::function<std::int64_t()> now = {});
    ~MemoryDisk() override;

    // Setting up. What exists already is updated: what is not given stays. Neither protection nor the free space counts here.

    struct DriveFacts {
        std::optional<int> type = {};  ///< `frame::driveTypes`; fixed at first
        std::optional<std::string> volume = {}, share = {};
        std::optional<bool> ready = {}, readOnly = {};
    };
    struct Facts {
        std::optional<std::int32_t> attributes = {};
        std::optional<std::int64_t> size = {};  ///< reads as NUL bytes behind the contents
        std::optional<std::string> contents = {};
        std::optional<std::int64_t> created = {}, modified = {}, accessed = {};
        std::optional<std::string> type = {};                 ///< the type text
        std::optional<bool> unreadable = {};                  ///< a file that cannot be opened, a folder that cannot be listed
        std::optional<std::pair<float, float>> picture = {};  ///< the size of the picture that the file holds, in twips
    };

    /// A drive by its letter, with or without colon and separator; an empty one is a network drive known by its share alone.
    frame::Status SetDrive(std::string_view letter, const DriveFacts& facts);
    /// Makes the drive and the folders on the way.
    frame::Status SetFile(std::string_view path, const Facts& facts);
    frame::Status SetFolder(std::string_view path, const Facts& facts);
    /// Takes away a file, a folder with all in it, or a drive.
    frame::Status Remove(std::string_view path);
    /// Limits the bytes that can still be written; nothing lifts the limit.
    void SetFree(std::optional<std::int64_t> bytes) { free_ = bytes; }
    /// Nothing, or an empty path: there is no such folder.
    void SetSpecialFolder(int number, std::string path) { special_[number] = std::move(path); }

    // Looking on.

    struct Listed {
        std::string path;
        std::int64_t size = 0;
        std::int32_t attributes = 0;
        friend bool operator==(const Listed&, const Listed&) = default;
    };
    /// All that is below a folder, each folder right before what it holds. 76 without such a folder.
    frame::Status ListTree(std::string_view folder, std::vector<Listed>& all);
    std::optional<std::pair<float, float>> PictureSize(std::string_view path);
    /// The paths of what was deleted and can be restored, the last one last.
    std::vector<std::string> Recycled() const;
    /// Puts back what was deleted last under this path, as long as nothing stands there.
    frame::Status Restore(std::string_view path);

    /// Moves, copies or deletes by the shell's rules. Refused whole, before anything is touched, when a source is missing or is a
    /// drive, when a path is not absolute, and when there is not just one target.
    ///
    /// What stands in `to` goes there: into it where it is a folder; under this very name where nothing stands there and there is
    /// one source; else into a new folder. With flag 8 what meets a name in use becomes "Copy of a.txt", "Copy (2) of a.txt";
    /// without it a file replaces a file, and a folder is merged into a folder. With flag 64 what is deleted can be restored.
    /// A copy is created now and keeps the rest. What was done before a failure stays.
    frame::FileOperationResult Run(const frame::FileOperation& operation);

    char Separator() const override { return '\\'; }
    bool IgnoresCase() const override { return true; }
    bool FileExists(std::string_view path) override;
    bool FolderExists(std::string_view path) override;
    bool DriveExists(std::string_view path) override;
    frame::Status Stat(std::string_view path, frame::FileRecord& record) override;
    frame::Status List(std::string_view folder, std::unique_ptr<frame::FolderListing>& listing) override;
    frame::Status Count(std::string_view folder, frame::FolderCounts& counts) override;
    std::unique_ptr<frame::TreeSize> MeasureTree(std::string_view folder) override;
    std::vector<frame::DriveRecord> Drives() override;
    std::string TypeText(std::int32_t typeId) override;
    frame::Status CreateFolder(std::string_view path) override;
    frame::Status CreateFile(std::string_view path, bool overwrite) override;
    frame::Status DeleteFile(std::string_view path, bool force) override;
    frame::Status Rename(std::string_view path, std::string_view newName) override;
    frame::Status SetAttributes(std::string_view path, std::int32_t value) override;
    std::string TemporaryFolder() override;
    std::string SpecialFolder(int number) override;
    frame::Status OpenForReading(std::string_view path, std::unique_ptr<frame::BinaryFile>& file) override;
    frame::Status WriteOver(std::string_view path, std::string_view bytes) override;

  private:
    struct Entry;
    struct Drive;
    struct Place;
    class Listing;
    class Measure;
    class Reader;
    class Operation;
    struct NameOrder {
        using is_transparent = void;
        bool operator()(std::string_view a, std::string_view b) const;
    };
    using Children = std::map<std::string, std::unique_ptr<Entry>, NameOrder>;

    /// The drive of a path, and the names behind it; null when no drive is meant.
    Drive* DriveOf(std::string_view path, std::vector<std::string_view>& names);
    Place Find(std::string_view path);
    /// A place where something is to be made: the folder on the way exists, the name is good and free, the drive can be written.
    frame::Status FindNew(std::string_view path, Place& place);
    frame::Status Charge(std::size_t bytes);
    std::unique_ptr<Entry> NewEntry(std::string_view name, bool isFolder) const;
    frame::Status Set(std::string_view path, bool isFolder, const Facts& facts);
    frame::FileRecord RecordOf(const Entry& entry);
    std::int32_t TypeIdOf(const Entry& entry);

    std::function<std::int64_t()> now_;
    std::map<std::string, std::unique_ptr<Drive>, std::less<>> drives_;  // by the folded root, letters before shares
    std::map<int, std::string> special_;
    std::optional<std::int64_t> free_;
    std::vector<std::string> types_;
    std::unordered_map<std::string, std::int32_t> typeIds_;
    std::vector<std::pair<std::string, std::unique_ptr<Entry>>> recycled_;
};

}  // namespace tessel::headless
