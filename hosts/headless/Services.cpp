#include "hosts/headless/Services.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>

#include "frame/ChildControl.h"
#include "frame/Dates.h"
#include "frame/Text.h"
#include "hosts/headless/MemoryDisk.h"

namespace tessel::headless {

using frame::Variant;

namespace {

/// The front of a queue, or `otherwise` when it is empty.
template <class T, class U>
T TakeFrom(std::deque<T>& queue, U&& otherwise) {
    if (queue.empty()) return std::forward<U>(otherwise);
    T front = std::move(queue.front());
    queue.pop_front();
    return front;
}

Variant PathOf(const frame::Object* object) { return object ? Variant(object->Path()) : Variant(); }

}  // namespace

int ScriptedDialogs::MsgBox(const std::string& text, int style, const std::string& title) {
    constexpr int buttons = 15;
    log_.Add({"msgbox", text, style, title});
    if (onMsgBox) onMsgBox();
    const bool asksYesNo = (style & buttons) == frame::msgbox::yesNo;
    return TakeFrom(answers, asksYesNo ? frame::msgbox::answerYes : frame::msgbox::answerOk);
}

void ScriptedDialogs::ShowOpen(const std::string& title, const std::string& filter, std::string& fileName) {
    log_.Add({"dialog", title, filter, fileName});
    if (auto chosen = TakeFrom(fileNames, std::nullopt)) fileName = *chosen;
}

void ScriptedDialogs::ShowModal(frame::Object&) {
    if (const auto act = TakeFrom(forms, std::function<void()>())) act();
}

void ScriptedMenus::Popup(frame::Object& menu, frame::Object* defaultEntry) {
    log_.Add({"popup", menu.Path(), PathOf(defaultEntry)});
    if (const auto pick = TakeFrom(picks, std::function<void()>())) pick();
}

void ScriptedDrag::Start(frame::ChildControl& source) { log_.Add({"drag", source.Path()}); }

void ScriptedFocus::Set(frame::ChildControl& child) { log_.Add({"focus", child.Path()}); }

int ScriptedShell::Execute(std::string_view verb, const std::string& target) {
    constexpr int success = 33;
    log_.Add({"execute", verb, target});
    return TakeFrom(executeResults, success);
}

frame::FileOperationResult ScriptedShell::Run(const frame::FileOperation& operation) {
    log_.Add({"operation", static_cast<int>(operation.kind), operation.flags, ListOf(operation.from), ListOf(operation.to)});
    if (operationResults.empty() && carryOut) return carryOut(operation);
    return TakeFrom(operationResults, frame::FileOperationResult{});
}

float ScriptedRandom::Next() {
    constexpr int floatDigits = 24;
    if (!queue.empty()) return TakeFrom(queue, 0.0f);
    return static_cast<float>(generator_() >> (32 - floatDigits)) / static_cast<float>(1 << floatDigits);
}

void ScriptedRandom::Restart(double seed) {
    const auto bits = std::bit_cast<std::uint64_t>(seed);
    generator_.seed(static_cast<std::uint32_t>(bits ^ bits >> 32));
}

std::string FixedLocale::DateText(frame::Date date) { return frame::DateText(date); }

std::string FixedLocale::LongDateText(frame::Date date) {
    static constexpr std::array days = {"Sunday", "Monday", "Tuesday", "Wednesday", "Thursday", "Friday", "Saturday"};
    static constexpr std::array months = {"January", "February", "March",     "April",   "May",      "June",
                                          "July",    "August",   "September", "October", "November", "December"};
    const frame::DateParts parts = frame::PartsOf(date);
    const auto midnight = static_cast<std::int64_t>(frame::DateFrom({parts.year, parts.month, parts.day}).days);
    const auto weekday = static_cast<std::size_t>(((midnight - 1) % 7 + 7) % 7);  // day 1 was a Sunday
    return std::string(days[weekday]) + ", " + months[static_cast<std::size_t>(parts.month - 1)] + " " + frame::Decimal(parts.day) +
           ", " + frame::Decimal(parts.year);
}

std::string FixedLocale::Grouped(std::int64_t number) {
    constexpr int group = 3;
    std::string digits = frame::Decimal(number);
    const std::ptrdiff_t first = number < 0 ? 1 : 0;
    for (auto place = static_cast<std::ptrdiff_t>(digits.size()) - group; place > first; place -= group)
        digits.insert(static_cast<std::size_t>(place), ",");
    return digits;
}

frame::Date FixedLocale::LocalTime(std::int64_t seconds) {
    constexpr double epoch = 25'569, secondsPerDay = 86'400;
    const double days = epoch + static_cast<double>(seconds) / secondsPerDay;
    const double midnight = std::floor(days);
    return {days < 0 ? midnight - (days - midnight) : days};  // the fraction counts forward from midnight
}

namespace {

/// The lines that a line of text takes when no line may have more than `limit` characters: words go on while they fit, and a
/// word that is longer than a line is cut.
std::vector<std::size_t> WrappedLengths(std::string_view line, std::size_t limit) {
    std::vector<std::size_t> lengths(1, 0);
    bool first = true;
    for (std::size_t start = 0; start <= line.size(); first = false) {
        const std::size_t end = std::min(line.find(' ', start), line.size());
        const std::size_t word = frame::CharacterCount(line.substr(start, end - start));
        const std::size_t blank = first ? 0 : 1;
        if (lengths.back() + blank + word > limit && lengths.back() > 0)
            lengths.push_back(word);
        else
            lengths.back() += blank + word;
        while (lengths.back() > limit) {
            const std::size_t rest = lengths.back() - limit;
            lengths.back() = limit;
            lengths.push_back(rest);
        }
        start = end + 1;
    }
    return lengths;
}

}  // namespace

frame::TextSize FixedMetrics::Measure(const frame::Font&, std::string_view text, std::optional<float> wrapWidth) {
    constexpr float characterWidth = 6 * 15, lineHeight = 13 * 15;
    constexpr float widestLine = 1e9f;  // in characters; below what a size_t holds
    std::vector<std::size_t> lengths;
    for (std::size_t start = 0; start <= text.size();) {
        const std::size_t end = std::min(text.find('\n', start), text.size());
        std::string_view line = text.substr(start, end - start);
        if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
        if (wrapWidth) {
            const float limit = std::min(std::max(1.0f, *wrapWidth / characterWidth), widestLine);
            const auto wrapped = WrappedLengths(line, static_cast<std::size_t>(limit));
            lengths.insert(lengths.end(), wrapped.begin(), wrapped.end());
        } else {
            lengths.push_back(frame::CharacterCount(line));
        }
        start = end + 1;
    }
    const std::size_t widest = *std::max_element(lengths.begin(), lengths.end());
    return {static_cast<float>(widest) * characterWidth, static_cast<float>(lengths.size()) * lineHeight};
}

frame::PictureRef ScriptedPictures::LoadPicture(const std::string& fileName) {
    if (fileName.empty()) return std::make_shared<frame::Picture>();
    if (!disk_.FileExists(fileName)) throw frame::ControlError(frame::errors::fileNotFound);
    const auto size = disk_.PictureSize(fileName);
    if (!size) throw frame::ControlError(frame::errors::invalidPicture);
    return std::make_shared<frame::Picture>(size->first, size->second, fileName);
}

frame::PictureRef ScriptedPictures::FileIcon(const std::string& path, int flags) {
    log_.Add({"icon", path, flags});
    if (onIcon) onIcon(path);
    bool known = true;
    if (!icons.empty()) {
        known = icons.front();
        icons.pop_front();
    }
    if (!known) return nullptr;
    constexpr int smallForm = 1;
    const int side = flags & smallForm ? 16 : 32;
    constexpr std::uint32_t blue = 0xFFFF0000;
    const auto pixels = static_cast<std::size_t>(side) * static_cast<std::size_t>(side);
    std::vector<frame::PixelPlane> planes{{1, side, side, std::vector<std::uint32_t>(pixels, blue)}};
    return std::make_shared<frame::Picture>(std::move(planes), path);
}

void MemoryClipboard::Clear() {
    if (!held) contents.clear();
}

bool MemoryClipboard::Put(int format, std::string bytes) {
    if (held) return false;
    contents[format] = std::move(bytes);
    return true;
}

std::optional<std::string> MemoryClipboard::Read(int format) {
    const auto found = contents.find(format);
    if (held || found == contents.end()) return std::nullopt;
    return found->second;
}

}  // namespace tessel::headless
