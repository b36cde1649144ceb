#pragma once

#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "frame/FileSystem.h"
#include "hosts/posix/DiskListing.h"
#include "hosts/posix/DiskSettings.h"
#include "hosts/posix/MountTable.h"

namespace tessel::posix {

/// The disk of this machine. A path is bytes as the system has them; it may be longer than the system takes at once.
///
/// Hidden is what begins with a point; it cannot be set. Read-only is what the user has no permission to write, by owner, group and
/// mode; setting it takes the permission from all, clearing it gives it to the owner. Links are followed but for renaming, deleting
/// and the sizes of trees. Type texts come from the desktop's mime database, by extension.
class DiskFileSystem final : public frame::FileSystem {
  public:
    explicit DiskFileSystem(DiskSettings settings = DiskSettings::OfThisProcess());

    /// Puts a path in the place of the user's own; an empty one means that there is none.
    void SetSpecialFolder(int number, std::string path) { special_[number] = std::move(path); }

    char Separator() const override { return '/'; }
    bool IgnoresCase() const override { return false; }
    bool FileExists(std::string_view path) override;
    bool FolderExists(std::string_view path) override;
    bool DriveExists(std::string_view path) override;
    frame::Status Stat(std::string_view path, frame::FileRecord& record) override;
    frame::Status List(std::string_view folder, std::unique_ptr<frame::FolderListing>& listing) override;
    frame::Status Count(std::string_view folder, frame::FolderCounts& counts) override;
    std::unique_ptr<frame::TreeSize> MeasureTree(std::string_view folder) override;
    std::vector<frame::DriveRecord> Drives() override;
    std::string TypeText(std::int32_t typeId) override { return maker_.types.Text(typeId); }
    frame::Status CreateFolder(std::string_view path) override;
    frame::Status CreateFile(std::string_view path, bool overwrite) override;
    frame::Status DeleteFile(std::string_view path, bool force) override;
    frame::Status Rename(std::string_view path, std::string_view newName) override;
    frame::Status SetAttributes(std::string_view path, std::int32_t value) override;
    std::string TemporaryFolder() override { return settings_.temporaryFolder; }
    std::string SpecialFolder(int number) override;
    frame::Status OpenForReading(std::string_view path, std::unique_ptr<frame::BinaryFile>& file) override;
    frame::Status WriteOver(std::string_view path, std::string_view bytes) override;

  private:
    int FactsOf(std::string_view path, EntryFacts& facts);
    std::vector<Mount> Mounts();

    DiskSettings settings_;
    RecordMaker maker_;
    MountProbe probe_;
    std::map<int, std::string> special_;
};

}  // namespace tessel::posix
