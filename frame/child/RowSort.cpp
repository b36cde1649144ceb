#include "frame/child/RowSort.h"

#include <algorithm>
#include <utility>

#include "frame/Text.h"

namespace tessel::child {

namespace {

/// The ordered bytes of many texts, one behind the other.
class OrderedTexts {
  public:
    explicit OrderedTexts(std::size_t count) { ends_.reserve(count + 1); }

    void Add(std::string_view text) {
        AppendOrdered(bytes_, text);
        ends_.push_back(bytes_.size());
    }
    std::string_view At(std::size_t index) const {
        return std::string_view(bytes_).substr(ends_[index], ends_[index + 1] - ends_[index]);
    }
    std::size_t Count() const { return ends_.size() - 1; }
    /// The length of the beginning that all have in common.
    std::size_t Common() const {
        std::string_view common = Count() > 0 ? At(0) : std::string_view();
        for (std::size_t i = 1; i < Count() && !common.empty(); ++i) {
            const std::string_view text = At(i);
            const auto differs = std::mismatch(common.begin(), common.end(), text.begin(), text.end()).first;
            common = common.substr(0, static_cast<std::size_t>(differs - common.begin()));
        }
        return common.size();
    }

  private:
    std::string bytes_;
    std::vector<std::size_t> ends_ = {0};
};

constexpr std::size_t wordBytes = 8;

/// Bytes of a text as a number that orders as they do; zeros where it has ended.
std::uint64_t WordAt(std::string_view text, std::size_t start) {
    std::uint64_t word = 0;
    for (std::size_t i = start; i < start + wordBytes; ++i)
        word = word << 8 | (i < text.size() ? static_cast<unsigned char>(text[i]) : 0);
    return word;
}

/// The places of rows, by their ids: what a source captured lies in the order of ids.
std::vector<std::uint32_t> PlacesById(const std::vector<RowId>& rows) {
    constexpr std::uint32_t none = 0xFFFFFFFFu;
    const RowId last = rows.empty() ? 0 : *std::max_element(rows.begin(), rows.end());
    std::vector<std::uint32_t> places(std::size_t{last} + 1, none);
    for (std::size_t place = 0; place < rows.size(); ++place) places[rows[place]] = static_cast<std::uint32_t>(place);
    std::erase(places, none);
    return places;
}

template <class T, class Order>
void SortStably(T first, T last, bool ascending, Order order) {
    if (ascending)
        std::stable_sort(first, last, [&](const auto& a, const auto& b) { return order(a) < order(b); });
    else
        std::stable_sort(first, last, [&](const auto& a, const auto& b) { return order(a) > order(b); });
}

}  // namespace

void AppendOrdered(std::string& out, std::string_view text) {
    constexpr char32_t lastEscaped = frame::escapedByteBase + 0xFF;
    for (std::size_t position = 0; position < text.size();) {
        const char unit = text[position];
        if (static_cast<unsigned char>(unit) < 0x80) {
            out.push_back(unit >= 'A' && unit <= 'Z' ? static_cast<char>(unit - 'A' + 'a') : unit);
            ++position;
            continue;
        }
        const char32_t character = frame::FoldCase(frame::NextCharacter(text, position));
        if (character < frame::escapedByteBase || character > lastEscaped) {
            frame::AppendCharacter(out, character);
            continue;
        }
        out.push_back(static_cast<char>(0xE0 | character >> 12));
        out.push_back(static_cast<char>(0x80 | (character >> 6 & 0x3F)));
        out.push_back(static_cast<char>(0x80 | (character & 0x3F)));
    }
}

RowKey RowSort::KeyOf(RowId row) const { return {texts_.Text(row, column_), texts_.SortNumber(row, column_)}; }

int RowSort::Compare(RowId row, const RowKey& key) const {
    const auto number = key.number ? texts_.SortNumber(row, column_) : std::nullopt;
    if (number) return *number < *key.number ? -1 : *number > *key.number ? 1 : 0;
    scratch_.clear();
    texts_.AppendText(row, column_, scratch_);
    return frame::CompareNoCase(scratch_, key.text);
}

void RowSort::Sort(std::vector<RowId>& rows, bool ascending) const {
    if (!SortByNumbers(rows, ascending)) SortByTexts(rows, ascending);
}

bool RowSort::SortByNumbers(std::vector<RowId>& rows, bool ascending) const {
    struct Numbered {
        std::uint64_t number;
        RowId row;
    };
    std::vector<Numbered> numbered;
    for (const RowId row : rows) {
        const auto number = texts_.SortNumber(row, column_);
        if (!number) return false;
        if (numbered.empty()) numbered.reserve(rows.size());
        numbered.push_back({*number, row});
    }
    SortStably(numbered.begin(), numbered.end(), ascending, [](const Numbered& entry) { return entry.number; });
    std::transform(numbered.begin(), numbered.end(), rows.begin(), [](const Numbered& entry) { return entry.row; });
    return true;
}

/// Eight bytes of a row's ordered text, and how many it had left there: 9 for more than these.
struct RowSort::Word {
    std::uint64_t bytes = 0;
    std::uint32_t left = 0;
    std::uint32_t from = 0;  // the row's place before the sort
    std::uint32_t text = 0;  // its number among the texts

    std::pair<std::uint64_t, std::uint32_t> Order() const { return {bytes, left}; }
};

/// Sorts by the first eight bytes behind what all have in common, then each run of equals by the next eight, and so on: no two
/// texts are ever compared as a whole.
void RowSort::SortByTexts(std::vector<RowId>& rows, bool ascending) const {
    std::vector<Word> words(rows.size());
    OrderedTexts texts(rows.size());
    for (const std::uint32_t place : PlacesById(rows)) {
        scratch_.clear();
        texts_.AppendText(rows[place], column_, scratch_);
        words[place] = {0, 0, place, static_cast<std::uint32_t>(texts.Count())};
        texts.Add(scratch_);
    }

    struct Run {
        std::size_t first, last, depth;
    };
    std::vector<Run> runs = {{0, words.size(), texts.Common()}};
    while (!runs.empty()) {
        const Run run = runs.back();
        runs.pop_back();
        for (std::size_t i = run.first; i < run.last; ++i) {
            const std::string_view text = texts.At(words[i].text);
            words[i].bytes = WordAt(text, run.depth);
            words[i].left = static_cast<std::uint32_t>(std::min(text.size() - run.depth, wordBytes + 1));
        }
        const auto at = [&](std::size_t index) { return words.begin() + static_cast<std::ptrdiff_t>(index); };
        SortStably(at(run.first), at(run.last), ascending, [](const Word& word) { return word.Order(); });
        for (std::size_t first = run.first, last = first; first < run.last; first = last) {
            while (last < run.last && words[last].Order() == words[first].Order()) ++last;
            if (last - first > 1 && words[first].left > wordBytes) runs.push_back({first, last, run.depth + wordBytes});
        }
    }
    std::vector<RowId> sorted(rows.size());
    std::transform(words.begin(), words.end(), sorted.begin(), [&](const Word& word) { return rows[word.from]; });
    rows = std::move(sorted);
}

}  // namespace tessel::child
