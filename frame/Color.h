#pragma once

#include <compare>
#include <cstdint>

namespace tessel::frame {

/// A colour: 0x00BBGGRR with red in the low byte, or a system colour 0x800000NN. Stored and handed on without change;
/// `OleTranslateColor` makes RGB of it where the parts of a colour are needed.
struct OLE_COLOR {
    std::uint32_t value = 0;

    constexpr OLE_COLOR() = default;
    constexpr OLE_COLOR(std::uint32_t bits) : value(bits) {}
    constexpr bool IsSystem() const { return (value & 0x80000000u) != 0; }
    friend constexpr bool operator==(OLE_COLOR, OLE_COLOR) = default;
};

namespace colors {
inline constexpr OLE_COLOR windowBackground = 0x80000005u;
inline constexpr OLE_COLOR windowText = 0x80000008u;
inline constexpr OLE_COLOR buttonFace = 0x8000000Fu;
inline constexpr OLE_COLOR buttonShadow = 0x80000010u;
inline constexpr OLE_COLOR buttonText = 0x80000012u;
inline constexpr OLE_COLOR buttonHighlight = 0x80000014u;
inline constexpr OLE_COLOR darkShadow = 0x80000015u;
inline constexpr OLE_COLOR lightEdge = 0x80000016u;
}  // namespace colors

constexpr OLE_COLOR Rgb(int red, int green, int blue) {
    return static_cast<std::uint32_t>((red & 0xFF) | (green & 0xFF) << 8 | (blue & 0xFF) << 16);
}
constexpr int Red(OLE_COLOR rgb) { return static_cast<int>(rgb.value & 0xFF); }
constexpr int Green(OLE_COLOR rgb) { return static_cast<int>(rgb.value >> 8 & 0xFF); }
constexpr int Blue(OLE_COLOR rgb) { return static_cast<int>(rgb.value >> 16 & 0xFF); }

/// The colours that stand behind 0x80000000 to 0x80000018 on a screen; a host gives its own, `ClassicColors` is a fixed set.
class SystemColors {
  public:
    virtual ~SystemColors() = default;
    /// RGB of the system colour with this index (the low byte of 0x800000NN); black for an index that has none.
    virtual OLE_COLOR Color(int index) const = 0;
};

/// RGB of a colour: a system colour is looked up, any other loses its high byte.
OLE_COLOR OleTranslateColor(OLE_COLOR color, const SystemColors& system);

/// A fixed palette of system colours: grey faces, white windows, black text.
const SystemColors& ClassicColors();

}  // namespace tessel::frame
