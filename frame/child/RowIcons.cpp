#include "frame/child/RowIcons.h"

namespace tessel::child {

using frame::Status;
using frame::Variant;
namespace errors = frame::errors;

Status RowIcons::FindKey(IconSize size, std::string_view key, IconId& icon) {
    if (key.empty()) {
        icon = none;
        return {};
    }
    if (!Keys(size) || !Keys(size)->Has(key)) return errors::elementNotFound;
    const auto known = ofKey_.find(key);
    icon = known != ofKey_.end() ? known->second : Take(key);
    if (known == ofKey_.end()) ofKey_.emplace(values_.back().Text(), icon);
    return {};
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
}

RowIcons::IconId RowIcons::Take(Variant value) {
    values_.push_back(std::move(value));
    return static_cast<IconId>(values_.size());
}

}  // namespace tessel::child
