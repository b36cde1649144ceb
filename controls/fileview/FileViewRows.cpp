#include "controls/fileview/FileViewRows.h"

#include <chrono>

#include "fileservices/FileSys.h"
#include "fileservices/PathHelpers.h"
#include "frame/Dates.h"
#include "frame/ResumeNext.h"
#include "frame/Text.h"

namespace tessel::controls {

namespace {

constexpr std::string_view changedText = "Yes";
constexpr std::size_t sortedSizeDigits = 12;
constexpr std::int64_t firstUnorderedSize = 1'000'000'000'000;  // from here on the digits are too few to order by

/// The text, or an empty one where it cannot be made: a date outside the calendar, a size without a number.
template <class F>
std::string OrEmpty(F&& text) {
    frame::ResumeNext next;
    return next.Value(text, {});
}

}  // namespace

// TextArena.

std::uint32_t TextArena::Add(std::string_view text) {
    constexpr std::size_t mostPages = (std::size_t{1} << 32) / pageSize;
    text = text.substr(0, pageSize);
    if (pages_.empty() || used_ + text.size() > pageSize) {
        if (pages_.size() == mostPages) throw frame::ControlError(frame::errors::outOfMemory);
        pages_.push_back(std::make_unique<char[]>(pageSize));
        used_ = 0;
    }
    text.copy(pages_.back().get() + used_, text.size());
    const std::size_t start = (pages_.size() - 1) * pageSize + used_;
    used_ += text.size();
    return static_cast<std::uint32_t>(start);
}

void TextArena::Replace(std::uint32_t start, std::string_view text) {
    text.copy(pages_[start / pageSize].get() + start % pageSize, text.size());
}

void TextArena::Clear() {
    pages_.clear();
    used_ = 0;
}

// Capturing.

void FileViewRows::CaptureFile(RowId row, std::string_view name, std::string_view folder, const frame::FileRecord& file) {
    Capture(row, name, folder, file).size = file.size;
}

void FileViewRows::CaptureFolder(RowId row, std::string_view name, std::string_view folder, const frame::FileRecord& record,
                                 Details details) {
    constexpr std::size_t mostAtOnce = 64;
    Record& captured = Capture(row, name, folder, record);
    captured.isFolder = true;
    captured.isBare = details == Details::Hidden;
    captured.size = notCounted;
    if (countedAtOnce_ < mostAtOnce) {
        ++countedAtOnce_;
        Counted(captured);
    } else {
        uncounted_.push_back(row);
    }
}

/// A row number that is used again keeps the place of its name, where that is large enough, so that a list which changes for days
/// does not grow by the names of what has gone.
FileViewRows::Record& FileViewRows::Capture(RowId row, std::string_view name, std::string_view folder,
                                            const frame::FileRecord& entry) {
    constexpr std::size_t longestName = 0xFFFF;
    name = name.substr(0, longestName);
    records_.MakeRoom(row);
    Record& record = records_[row];
    std::uint32_t start = record.nameStart;
    if (!name.empty() && name.size() <= record.nameLength)
        names_.Replace(start, name);
    else
        start = names_.Add(name);
    record = {.modified = entry.modified,
              .created = entry.created,
              .nameStart = start,
              .folder = FolderNumber(folder),
              .typeId = entry.typeId,
              .nameLength = static_cast<std::uint16_t>(name.size())};
    return record;
}

std::uint32_t FileViewRows::FolderNumber(std::string_view folder) {
    if (lastFolder_ < folders_.size() && folders_[lastFolder_] == folder) return lastFolder_;
    const auto found = folderNumbers_.find(folder);
    if (found != folderNumbers_.end()) return lastFolder_ = found->second;
    lastFolder_ = static_cast<std::uint32_t>(folders_.size());
    folderNumbers_.emplace(folders_.emplace_back(folder), lastFolder_);
    return lastFolder_;
}

void FileViewRows::Clear() {
    records_.Clear();
    names_.Clear();
    folderNumbers_.clear();
    folders_.clear();
    uncounted_.clear();
    countedAtOnce_ = 0;
}

// Counting.

std::optional<std::int64_t> FileViewRows::FilesIn(const std::string& folder) const {
    frame::FolderCounts counts;
    if (host_.Files().Count(folder, counts).Failed()) return std::nullopt;
    return counts.files;
}

std::int64_t FileViewRows::Counted(Record& record) const {
    if (record.size != notCounted) return record.size;
    const std::string path = fileservices::BuildPath(folders_[record.folder], Name(record), host_.Files().Separator());
    return record.size = FilesIn(path).value_or(notCountable);
}

void FileViewRows::CountSome(std::size_t folders) {
    for (; folders > 0 && !uncounted_.empty(); --folders) {
        Record& record = records_[uncounted_.front()];
        uncounted_.pop_front();
        if (record.isFolder) Counted(record);
    }
}

// Texts.

std::string FileViewRows::SizeText(std::int64_t bytes) const {
    return OrEmpty([&] { return host_.Module<fileservices::FileSys>().FileSizeText(static_cast<double>(bytes)); });
}

std::string FileViewRows::DateText(std::int64_t seconds) const {
    return OrEmpty([&] { return host_.Locale().DateText(host_.Locale().LocalTime(seconds)); });
}

std::string FileViewRows::SortedSizeText(std::int64_t number) {
    const std::string digits = frame::Decimal(number);
    return digits.size() < sortedSizeDigits ? std::string(sortedSizeDigits - digits.size(), '0') + digits : digits;
}

std::string FileViewRows::SortedDateText(std::int64_t seconds) const {
    return OrEmpty([&] { return frame::SortableDateText(host_.Locale().LocalTime(seconds)); });
}

const std::string& FileViewRows::TypeText(std::int32_t typeId) const {
    const auto [found, isNew] = types_.try_emplace(typeId);
    if (isNew) found->second = host_.Files().TypeText(typeId);
    return found->second;
}

std::string FileViewRows::Text(RowId row, int column) const {
    std::string text;
    AppendText(row, column, text);
    return text;
}

void FileViewRows::AppendText(RowId row, int column, std::string& out) const {
    Record& record = records_[row];
    switch (column) {
        case subItem::sortName:
            if (record.isFolder) out += ' ';
            [[fallthrough]];
        case subItem::text:
        case subItem::realName:
            out += Name(record);
            break;
        case subItem::type:
            out += TypeText(record.typeId);
            break;
        case subItem::folder:
            out += folders_[record.folder];
            break;
        case subItem::sortedSize:
            if (const std::int64_t size = Counted(record); size >= 0) out += SortedSizeText(size);
            break;
        case subItem::sortedModified:
            out += SortedDateText(record.modified);
            break;
        case subItem::sortedCreated:
            out += SortedDateText(record.created);
            break;
        default:
            if (!record.isBare) out += DetailText(record, column);
            break;
    }
}

std::string FileViewRows::DetailText(Record& record, int column) const {
    switch (column) {
        case subItem::size:
            if (!record.isFolder) return SizeText(record.size);
            return Counted(record) >= 0 ? frame::Decimal(record.size) : std::string();
        case subItem::modified:
            return DateText(record.modified);
        case subItem::created:
            return DateText(record.created);
        case subItem::changed:
            return record.modified == record.created ? std::string() : std::string(changedText);
        default:
            return {};
    }
}

// Sorting.

std::optional<std::uint64_t> FileViewRows::SortNumber(RowId row, int column) const {
    Record& record = records_[row];
    switch (column) {
        case subItem::sortedSize: {
            const std::int64_t size = Counted(record);
            if (size >= firstUnorderedSize) return std::nullopt;
            return size >= 0 ? static_cast<std::uint64_t>(size) + 1 : 0;
        }
        case subItem::sortedModified:
            return TimeNumber(record.modified);
        case subItem::sortedCreated:
            return TimeNumber(record.created);
        case subItem::changed:
            return !record.isBare && record.modified != record.created ? 1 : 0;
        default:
            return std::nullopt;
    }
}

/// By local time, as the texts tell it: when clocks are turned back an hour comes twice.
std::uint64_t FileViewRows::TimeNumber(std::int64_t seconds) const {
    constexpr std::int64_t aboveAnyDate = std::int64_t{1} << 40;
    frame::ResumeNext next;
    const std::int64_t local = next.Value([&] { return LocalSeconds(seconds); }, -aboveAnyDate);
    return static_cast<std::uint64_t>(local + aboveAnyDate);
}

std::int64_t FileViewRows::LocalSeconds(std::int64_t seconds) const {
    constexpr std::int64_t secondsPerQuarter = 15 * 60, secondsPerWeek = 7 * 24 * 60 * 60;
    // Farther away the texts of a whole quarter might not all exist.
    constexpr std::int64_t wellInside = std::int64_t{60} * 60 * 24 * 365 * 1000;
    const auto reckon = [&](std::int64_t moment) {
        namespace calendar = std::chrono;
        const frame::DateParts parts = frame::PartsOf(host_.Locale().LocalTime(moment));
        const calendar::sys_days day =
            calendar::year(parts.year) / calendar::month(static_cast<unsigned>(parts.month)) / static_cast<unsigned>(parts.day);
        const calendar::sys_seconds local =
            day + calendar::hours(parts.hour) + calendar::minutes(parts.minute) + calendar::seconds(parts.second);
        return static_cast<std::int64_t>(local.time_since_epoch().count());
    };
    if (seconds < 0 || seconds > wellInside) return reckon(seconds);
    const auto aheadAt = [&](std::int64_t moment) { return reckon(moment) - moment; };
    const auto spanOf = [&](auto& spans, std::int64_t length) -> Ahead& {
        const std::int64_t span = seconds / length;
        Ahead& ahead = spans[static_cast<std::size_t>(span) % spans.size()];
        if (ahead.span != span) {
            const std::int64_t start = aheadAt(span * length);
            ahead = {span, start, length == secondsPerQuarter || start == aheadAt((span + 1) * length)};
        }
        return ahead;
    };
    // Clocks are not changed and changed back within a week: what holds at both ends holds between them.
    const Ahead& inWeek = spanOf(aheadInWeeks_, secondsPerWeek);
    return seconds + (inWeek.isSteady ? inWeek : spanOf(aheadInQuarters_, secondsPerQuarter)).seconds;
}

}  // namespace tessel::controls
