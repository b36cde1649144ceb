#pragma once

#include <sys/types.h>

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "frame/FileSystem.h"
#include "hosts/posix/DiskPlace.h"
#include "hosts/posix/FolderReader.h"
#include "hosts/posix/TypeTexts.h"

namespace tessel::posix {

/// Whose permissions count: the effective user and all groups.
struct DiskUser {
    uid_t user = 0;
    std::vector<gid_t> groups = {};

    /// By the mode alone, as the owner, a member of the group or anyone else; the superuser may write where anyone may.
    bool MayWrite(mode_t mode, uid_t owner, gid_t group) const;

    static DiskUser OfThisProcess();
};

/// What turns an entry of the disk into a record.
struct RecordMaker {
    FactReader facts;
    DiskUser user;
    TypeTexts types;

    frame::FileRecord RecordOf(std::string_view name, const EntryFacts& entry);
    /// Hidden is what begins with a point.
    static std::int32_t HidingOf(std::string_view name) { return name.starts_with('.') ? frame::attributes::hidden : 0; }
};

/// The entries of a folder on the disk, which stays open for the reading of records.
class DiskListing final : public frame::FolderListing {
  public:
    explicit DiskListing(RecordMaker& maker) : maker_(maker) {}

    /// Reads the names.
    frame::Status Open(std::string_view path);
    frame::Status Stat(std::size_t index, frame::FileRecord& record) override;
    frame::Status StatHiding(std::size_t index, std::int32_t& attributes) override;
    void Rest() override { folder_.Close(); }

  private:
    FolderReader::Kind KindOf(const FolderReader::Entry& entry);
    bool LeadsToFolder(const char* name, FolderReader::Kind kind);
    void Order(std::size_t first, std::size_t end);

    RecordMaker& maker_;
    std::string path_;
    Descriptor folder_;
};

/// Counts files and folders as a listing would.
frame::Status CountEntries(FactReader& facts, std::string_view path, frame::FolderCounts& counts);

/// Sums a tree, holding a few folders open however deep it is. Pseudo file systems have the size 0.
class DiskTreeSize final : public frame::TreeSize {
  public:
    DiskTreeSize(FactReader facts, std::string_view path);
    bool Step(std::size_t entries) override;

  private:
    /// A folder on the way down.
    struct Level {
        Descriptor folder;  // closed while the walk is far below
        std::uint64_t device = 0, inode = 0;
        std::string below;     // the names of the sub-folders still to be seen, each ended by a NUL
        std::size_t next = 0;  // in `below`
    };

    void Enter(Descriptor folder);
    void LookAt(const FolderReader::Entry& entry);
    bool GoOn();
    bool GoUp();

    FactReader facts_;
    FolderReader reader_;
    std::vector<Level> levels_;
    std::uint64_t device_ = 0;
    bool reading_ = false;  // the entries of the last level
};

}  // namespace tessel::posix
