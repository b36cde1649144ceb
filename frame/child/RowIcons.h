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
    /// False for the empty key.
    virtual bool Has(std::string_view key) const = 0;
    virtual std::int32_t Count() const = 0;
    /// Another number after each change of the keys.
    virtual std::uint32_t Revision() const = 0;
};

enum class IconSize : std::uint8_t { Large, Small };

/// The icons that rows name, each key kept once: a row holds a small number.
class RowIcons {
  public:
    using IconId = std::uint32_t;
    static constexpr IconId none = 0;

    /// The image list behind a size; null for none, which lacks every key.
    void Bind(IconSize size, const KeySet* keys);

    /// The number of a key, or of an image's index from 1; 0 and an empty value are no icon. Error 35601 for a key that the image
    /// list lacks, as every list lacks the empty one, 35600 for an index outside of it; `icon` then stays as it was.
    frame::Status FindKey(IconSize size, std::string_view key, IconId& icon);
    frame::Status Find(IconSize size, const frame::Variant& value, IconId& icon);
    /// What was set: a key, an index, or empty.
    frame::Variant Value(IconId icon) const;
    /// Forgets all keys; only when no row names one any more.
    void Clear();

  private:
    /// A key that was found lately, good while the image list has that revision: a listing has few keys and asks for them often.
    struct Recent {
        std::string_view key = {};
        IconId icon = none;
        std::uint32_t revision = 0;
    };
    static constexpr std::size_t recentCount = 16;
    using RecentKeys = std::array<Recent, recentCount>;

    static std::size_t RecentPlace(std::string_view key);
    const KeySet* Keys(IconSize size) const { return keys_[static_cast<std::size_t>(size)]; }
    IconId Take(frame::Variant value);

    std::array<const KeySet*, 2> keys_{};
    std::array<RecentKeys, 2> recent_{};
    std::deque<frame::Variant> values_;                   // by number from 1; what is inside never moves
    std::unordered_map<std::string_view, IconId> ofKey_;  // the keys stand in `values_`
    std::unordered_map<std::int32_t, IconId> ofIndex_;
};

}  // namespace tessel::child
