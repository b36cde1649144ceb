#include "hosts/headless/Log.h"

#include <algorithm>
#include <iterator>

namespace tessel::headless {

using frame::Variant;

void Log::AddEvent(std::string_view object, const frame::EventInfo& event, frame::EventArguments arguments) {
    std::vector<Variant> values;
    values.reserve(arguments.size());
    for (const frame::EventArgument& argument : arguments) values.push_back(argument.Get());
    Add({"event", object, event.name, ListOf(std::move(values))});
}

std::string Log::EventNames(std::string_view object) const {
    std::string names;
    for (const Entry& entry : entries_) {
        if (!(entry[0] == Variant("event")) || (!object.empty() && !(entry[1] == Variant(object)))) continue;
        if (!names.empty()) names += ' ';
        names += entry[2].Text();
    }
    return names;
}

std::vector<Log::Entry> Log::Of(std::string_view kind) const {
    std::vector<Entry> found;
    std::copy_if(entries_.begin(), entries_.end(), std::back_inserter(found),
                 [&](const Entry& entry) { return entry[0] == Variant(kind); });
    return found;
}

Variant ListOf(std::vector<Variant> items) { return frame::VariantArray(0, std::move(items)); }

Variant ListOf(const std::vector<std::string>& items) { return ListOf(std::vector<Variant>(items.begin(), items.end())); }

}  // namespace tessel::headless
