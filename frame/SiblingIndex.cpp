#include "frame/SiblingIndex.h"

#include "frame/ResumeNext.h"
#include "frame/Variant.h"

namespace tessel::frame {

std::optional<std::string> NameOf(Object& sibling) {
    std::optional<std::string> name;
    ResumeNext next;
    next([&] { name = sibling.Get("Name").ToText(); });
    return name;
}

std::optional<std::int32_t> IndexOf(Object& sibling) {
    std::optional<std::int32_t> index;
    ResumeNext next;
    next([&] {
        if (!sibling.Has("Index")) return;
        const Variant value = sibling.Get("Index");
        if (value == Variant(value.ToLong())) index = value.ToLong();
    });
    return index;
}

void SiblingIndex::Add(const std::optional<std::string>& name, std::optional<std::int32_t> index) {
    const int place = count_++;
    if (!name) return;
    Named& named = named_.try_emplace(*name, Named{place, {}}).first->second;
    if (index) named.byIndex.try_emplace(*index, place);
}

void SiblingIndex::Clear() {
    named_.clear();
    count_ = 0;
}

int SiblingIndex::Find(std::string_view name, std::int32_t index) const {
    const auto named = named_.find(name);
    if (named == named_.end()) return -1;
    if (index < 0) return named->second.first;
    const auto found = named->second.byIndex.find(index);
    return found != named->second.byIndex.end() ? found->second : -1;
}

}  // namespace tessel::frame
