#pragma once

/// Dispatch numbers of stock members: the same in every control that uses them.
namespace tessel::frame::dispatch {
inline constexpr int autoSize = -500;
inline constexpr int backColor = -501;
inline constexpr int borderStyle = -504;
inline constexpr int font = -512;
inline constexpr int foreColor = -513;
inline constexpr int enabled = -514;
inline constexpr int text = -517;
inline constexpr int caption = -518;
inline constexpr int appearance = -520;
inline constexpr int refresh = -550;
inline constexpr int click = -600;
inline constexpr int dblClick = -601;
inline constexpr int keyDown = -602;
inline constexpr int keyPress = -603;
inline constexpr int keyUp = -604;
inline constexpr int mouseDown = -605;
inline constexpr int mouseMove = -606;
inline constexpr int mouseUp = -607;
}  // namespace tessel::frame::dispatch
