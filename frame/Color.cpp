#include "frame/Color.h"

#include <array>

namespace tessel::frame {

namespace {

class Classic final : public SystemColors {
  public:
    OLE_COLOR Color(int index) const override {
        static constexpr std::array<std::uint32_t, 25> table = {
            0xC0C0C0, 0x808000, 0x800000, 0x808080, 0xC0C0C0, 0xFFFFFF, 0x000000, 0x000000, 0x000000,
            0xFFFFFF, 0xC0C0C0, 0xC0C0C0, 0x808080, 0x800000, 0xFFFFFF, 0xC0C0C0, 0x808080, 0x808080,
            0x000000, 0xC0C0C0, 0xFFFFFF, 0x000000, 0xC0C0C0, 0x000000, 0xE1FFFF};
        return index >= 0 && index < static_cast<int>(table.size()) ? table[static_cast<std::size_t>(index)] : 0;
    }
};

}  // namespace

OLE_COLOR OleTranslateColor(OLE_COLOR color, const SystemColors& system) {
    return color.IsSystem() ? system.Color(static_cast<int>(color.value & 0xFF)) : OLE_COLOR(color.value & 0xFFFFFF);
}

const SystemColors& ClassicColors() {
    static const Classic classic;
    return classic;
}

}  // namespace tessel::frame
