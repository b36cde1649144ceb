#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "frame/Variant.h"

namespace tessel::frame {

/// The keyed store of a control's saved state, given by the host to the load and save handlers. Keys are case-sensitive.
class PropertyBag {
  public:
    virtual ~PropertyBag() = default;
    /// The stored value, or `otherwise` when the key is absent.
    virtual Variant ReadProperty(std::string_view key, const Variant& otherwise) const = 0;
    virtual void WriteProperty(std::string_view key, const Variant& value, const Variant& otherwise) = 0;
};

/// A bag in memory that leaves out what equals its default, as hosts do, and remembers each write in its order.
class MemoryBag final : public PropertyBag {
  public:
    struct Write {
        std::string key;
        Variant value;
        Variant otherwise;
    };
    using Contents = std::vector<std::pair<std::string, Variant>>;

    MemoryBag() = default;
    MemoryBag(Contents contents) : contents_(std::move(contents)) {}

    Variant ReadProperty(std::string_view key, const Variant& otherwise) const override;
    void WriteProperty(std::string_view key, const Variant& value, const Variant& otherwise) override;

    /// Puts a value under a key, whatever its default.
    void Set(std::string_view key, Variant value);
    const Contents& Kept() const { return contents_; }
    const std::vector<Write>& Written() const { return written_; }

  private:
    Contents contents_;
    std::vector<Write> written_;
};

}  // namespace tessel::frame
