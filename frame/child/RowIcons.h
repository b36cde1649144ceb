#pragma once

#include <array>
#include <cstdint>
#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>

#include "frame/Error.h"
#include "frame/Variant.h"

namespace tessel::child {

/// The keys of an image list, as those who show its images see them.
class KeySet {
  public:
    virtual ~KeySet() = default;
    virtual bool Has(std::string_view key) const = 0;
    virtual std::int32_t Count() const = 0;
};

enum class IconSize : std::uint8_t { Large, Small };

/// The icons that rows name, each key kept once: a row holds a small number.
class RowIcons {
  public:
    using IconId = std::uint32_t;
    static constexpr IconId none = 0;

    /// The image list behind a size; null for none, which lacks every key.
    void Bind(IconSize size, const KeySet* keys) { keys_[static_cast<std::size_t>(size)] = keys; }

    /// The number of a key, or of an image's index from 1. The empty key, 0 and an empty value are no icon. Error 35601 for a
    /// key that the image list lacks, 35600 for an index outside of it; `icon` then stays as it was.
    frame::Status FindKey(IconSize size, std::string_view key, IconId& icon);
    frame::Status Find(IconSize size, const frame::Variant& value, IconId& icon);
    /// What was set: a key, an index, or empty.
    frame::Variant Value(IconId icon) const;
    /// Forgets all keys; only when no row names one any more.
    void Clear();

  private:
    const KeySet* Keys(IconSize size) const { return keys_[static_cast<std::size_t>(size)]; }
    IconId Take(frame::Variant value);

    std::array<const KeySet*, 2> keys_{};
    std::deque<frame::Variant> values_;                   // by number from 1; what is inside never moves
    std::unordered_map<std::string_view, IconId> ofKey_;  // the keys stand in `values_`
    std::unordered_map<std::int32_t, IconId> ofIndex_;
};

}  // namespace tessel::child
