#pragma once

#include <cstdint>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "frame/Object.h"
#include "frame/Variant.h"

namespace tessel::frame {

/// The number of the format in which a drag or the clipboard carries a list of files.
inline constexpr std::int16_t filesFormat = 15;

/// Effects of a drop, as a sum.
namespace dropEffects {
inline constexpr std::int32_t none = 0, copy = 1, move = 2;
}

/// The paths that a drag carries, numbered from 1.
class DragFiles final : public Object {
  public:
    std::int32_t Count() const { return static_cast<std::int32_t>(paths_.size()); }
    /// Error 9 for an index outside 1 to `Count`.
    const std::string& Item(std::int32_t index) const;
    void Add(const std::string& path) { paths_.push_back(path); }
    void Clear() { paths_.clear(); }

    const ClassTable& Table() const override;

  private:
    std::vector<std::string> paths_;
};

/// What a drag carries: formats that its source has promised, and files. Shared by the source, the target and the host.
class DragData final : public Object {
  public:
    /// Takes every format and every file away.
    void Clear();
    /// Promises a format. A source without the data yet gives it when a target asks.
    void SetData(const std::optional<Variant>& data, std::int16_t format);
    /// Whether the format is there: promised, or for the format of files, any file.
    bool GetFormat(std::int16_t format) const;

    DragFiles Files;

    const ClassTable& Table() const override;

  private:
    std::set<std::int16_t> formats_;
};

}  // namespace tessel::frame
