#include "frame/child/RowIcons.h"

namespace tessel::child {

using frame::Status;
using frame::Variant;
namespace errors = frame::errors;

void RowIcons::Bind(IconSize size, const KeySet* keys) {
    keys_[static_cast<std::size_t>(size)] = keys;
    recent_[static_cast<std::size_t>(size)] = {};
}

Status RowIcons::FindKey(IconSize size, std::string_view key, IconId& icon) {
    const KeySet* keys = Keys(size);
    if (!keys || key.empty()) return errors::elementNotFound;
    Recent& recent = recent_[static_cast<std::size_t>(size)][RecentPlace(key)];
    const std::uint32_t revision = keys->Revision();
    if (recent.key != key || recent.revision != revision) {
        if (!keys->Has(key)) return errors::elementNotFound;
        const auto known = ofKey_.find(key);
        const IconId found = known != ofKey_.end() ? known->second : Take(key);
        const std::string_view kept = values_[found - 1].Text();
        if (known == ofKey_.end()) ofKey_.emplace(kept, found);
        recent = {kept, found, revision};
    }
    icon = recent.icon;
    return {};
}

std::size_t RowIcons::RecentPlace(std::string_view key) {
    const auto byte = [](char unit) { return static_cast<std::size_t>(static_cast<unsigned char>(unit)); };
    return (key.size() + byte(key.front()) * 3 + byte(key.back()) * 5) % recentCount;
}

Status RowIcons::Find(IconSize size, const Variant& value, IconId& icon) {
    if (value.IsString()) return FindKey(size, value.Text(), icon);
    const std::int32_t index = value.ToLong();
    if (index == 0) {
        icon = none;
        return {};
    }
    if (!Keys(size) || index < 1 || index > Keys(size)->Count()) return errors::indexOutOfBounds;
    const auto known = ofIndex_.find(index);
    icon = known != ofIndex_.end() ? known->second : Take(index);
    if (known == ofIndex_.end()) ofIndex_.emplace(index, icon);
    return {};
}

Variant RowIcons::Value(IconId icon) const { return icon == none ? Variant() : values_[icon - 1]; }

void RowIcons::Clear() {
    ofKey_.clear();
    ofIndex_.clear();
    values_.clear();
    recent_ = {};
}

RowIcons::IconId RowIcons::Take(Variant value) {
    values_.push_back(std::move(value));
    return static_cast<IconId>(values_.size());
}

}  // namespace tessel::child
