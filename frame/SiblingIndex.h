#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

#include "frame/Object.h"
#include "frame/Text.h"

namespace tessel::frame {

/// What a sibling is found by; nothing where it cannot be read, or where the index is no whole number.
std::optional<std::string> NameOf(Object& sibling);
std::optional<std::int32_t> IndexOf(Object& sibling);

/// Finds siblings by name as `Siblings::Find` does, without a search. A host adds what it has in its order and clears the index
/// when one of them has gone or has another name or index.
class SiblingIndex {
  public:
    /// The next place in the order; a sibling without a name has a place and is never found.
    void Add(const std::optional<std::string>& name, std::optional<std::int32_t> index);
    void Clear();
    /// How many places there are.
    int Count() const { return count_; }
    /// The place of the first of that name, and of that index when it is not below 0; -1 when there is none.
    int Find(std::string_view name, std::int32_t index) const;

  private:
    struct Named {
        int first = 0;
        std::unordered_map<std::int32_t, int> byIndex;
    };

    std::unordered_map<std::string, Named, HashNoCase, EqualNoCase> named_;
    int count_ = 0;
};

}  // namespace tessel::frame
