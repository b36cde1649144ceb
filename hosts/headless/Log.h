#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "frame/Event.h"
#include "frame/Variant.h"

namespace tessel::headless {

/// What happened, in order: each entry begins with its kind ("event", "changed", "msgbox", "execute", "draw" and others),
/// followed by what that kind tells.
class Log {
  public:
    using Entry = std::vector<frame::Variant>;

    void Add(Entry entry) { entries_.push_back(std::move(entry)); }
    /// An event of an object with its arguments as they stand.
    void AddEvent(std::string_view object, const frame::EventInfo& event, frame::EventArguments arguments);
    const std::vector<Entry>& Entries() const { return entries_; }
    std::vector<Entry> Take() { return std::exchange(entries_, {}); }
    void Clear() { entries_.clear(); }

    /// The names of the events that an object raised, or of all, parted by blanks: "MouseDown Click".
    std::string EventNames(std::string_view object = {}) const;
    /// The entries of one kind.
    std::vector<Entry> Of(std::string_view kind) const;

  private:
    std::vector<Entry> entries_;
};

/// An array as a log entry holds it.
frame::Variant ListOf(std::vector<frame::Variant> items);
frame::Variant ListOf(const std::vector<std::string>& items);

}  // namespace tessel::headless
