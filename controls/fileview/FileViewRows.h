#pragma once

#include <array>
#include <cstdint>
#include <deque>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "frame/FileSystem.h"
#include "frame/child/RowTexts.h"
#include "frame/host.h"

namespace tessel::controls {

/// The sub-items of the rows of `FileView`.
namespace subItem {
inline constexpr int text = 0, size = 1, type = 2, modified = 3, created = 4, changed = 5, folder = 6, sortedSize = 7,
                     sortedModified = 8, sortedCreated = 9, realName = 10, refresh = 11, sortName = 12;
}

/// Texts one behind the other, in pages: no room in reserve, and nothing moves.
class TextArena {
  public:
    /// Where the text now stands. Longer ones than a page are cut; error 7 when there are more than 4 GiB.
    std::uint32_t Add(std::string_view text);
    std::string_view At(std::uint32_t start, std::size_t length) const {
        return {pages_[start / pageSize].get() + start % pageSize, length};
    }
    /// Puts a text in the place of one that is at least as long.
    void Replace(std::uint32_t start, std::string_view text);
    void Clear();

  private:
    static constexpr std::size_t pageSize = 1U << 16;
    std::vector<std::unique_ptr<char[]>> pages_;
    std::size_t used_ = 0;
};

/// What the rows of `FileView` are made of: of each file and folder what the disk told when it was added. Every text is made when
/// it is read. The number of files in a folder takes its time: the first of a listing are counted at once, the others when they are
/// read, or some at a time by `CountSome`.
class FileViewRows final : public child::RowSource {
  public:
    using RowId = child::RowId;
    enum class Details : std::uint8_t { Hidden, Shown };

    explicit FileViewRows(frame::Host& host) : host_(host) {}

    /// What the row shows that is added next under this number.
    void CaptureFile(RowId row, std::string_view name, std::string_view folder, const frame::FileRecord& file);
    void CaptureFolder(RowId row, std::string_view name, std::string_view folder, const frame::FileRecord& record, Details details);
    void Clear();

    bool HasUncounted() const { return !uncounted_.empty(); }
    void CountSome(std::size_t folders);

    // What the same columns would hold of a file or folder as the disk tells it now.
    std::string SizeText(std::int64_t bytes) const;
    std::string DateText(std::int64_t seconds) const;
    static std::string SortedSizeText(std::int64_t number);
    std::string SortedDateText(std::int64_t seconds) const;
    const std::string& TypeText(std::int32_t typeId) const;
    /// Nothing when they cannot be counted.
    std::optional<std::int64_t> FilesIn(const std::string& folder) const;

    std::string Text(RowId row, int column) const override;
    void AppendText(RowId row, int column, std::string& out) const override;
    std::optional<std::uint64_t> SortNumber(RowId row, int column) const override;

  private:
    static constexpr std::int64_t notCounted = -1, notCountable = -2;

    struct Record {
        std::int64_t size = 0;  // of a folder the number of files in it
        std::int64_t modified = 0, created = 0;
        std::uint32_t nameStart = 0;
        std::uint32_t folder = 0;
        std::int32_t typeId = 0;
        std::uint16_t nameLength = 0;
        bool isFolder = false;
        bool isBare = false;  // a folder that shows no details
    };

    Record& Capture(RowId row, std::string_view name, std::string_view folder, const frame::FileRecord& entry);
    std::uint32_t FolderNumber(std::string_view folder);
    std::string_view Name(const Record& record) const { return names_.At(record.nameStart, record.nameLength); }
    std::int64_t Counted(Record& record) const;
    std::string DetailText(Record& record, int column) const;
    std::uint64_t TimeNumber(std::int64_t seconds) const;
    std::int64_t LocalSeconds(std::int64_t seconds) const;

    frame::Host& host_;
    mutable child::RowPages<Record> records_;  // the counts become known while they are read
    TextArena names_;
    std::deque<std::string> folders_;
    std::unordered_map<std::string_view, std::uint32_t> folderNumbers_;  // the keys stand in `folders_`
    std::uint32_t lastFolder_ = 0;
    std::deque<RowId> uncounted_;  // may name rows that have been counted, or have gone
    std::size_t countedAtOnce_ = 0;
    mutable std::unordered_map<std::int32_t, std::string> types_;

    /// What local time is ahead of Coordinated Universal Time in a span that was asked for lately.
    struct Ahead {
        std::int64_t span = INT64_MIN;
        std::int64_t seconds = 0;
        bool isSteady = true;  // throughout the span
    };
    mutable std::array<Ahead, 1024> aheadInWeeks_{};
    mutable std::array<Ahead, 256> aheadInQuarters_{};  // of an hour
};

}  // namespace tessel::controls
