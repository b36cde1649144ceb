#pragma once

#include <cstdint>
#include <string>

#include "frame/Event.h"
#include "frame/child/DragChild.h"

/// The events of `FileView`.
namespace tessel::controls::fileview {

inline constexpr frame::Event<std::int32_t&> AfterAddItem{
    "AfterAddItem", 1, {"Index"}, "Occurs when an item has been added to the list."};
inline constexpr frame::Event<bool&, std::string&> BeforeAddItem{
    "BeforeAddItem", 2, {"Cancel", "Filename"}, "Occurs before an item is added to the list; can be cancelled."};
inline constexpr frame::Event<> AfterPaint{"AfterPaint", 3, {}, "Occurs when the list has been filled or refreshed."};
inline constexpr frame::Event<bool&> BeforePaint{
    "BeforePaint", 4, {"Cancel"}, "Occurs before the list is filled anew; can be cancelled."};
inline constexpr frame::Event<frame::Variant&> AfterDelete{
    "AfterDelete", 5, {"FileList"}, "Occurs when files were to be deleted, whether that succeeded or not."};
inline constexpr frame::Event<bool&, frame::Variant&> BeforeDelete{
    "BeforeDelete", 6, {"Cancel", "FileList"}, "Occurs before files are deleted; can be cancelled."};
inline constexpr frame::Event<std::string&> AfterOpenItem{
    "AfterOpenItem", 7, {"Filename"}, "Occurs when a file has been opened or printed."};
inline constexpr frame::Event<bool&, std::string&> BeforeOpenItem{
    "BeforeOpenItem", 8, {"Cancel", "Filename"}, "Occurs before a file is opened or printed; can be cancelled."};
inline constexpr frame::Event<bool&, std::string&> AfterLabelEdit{
    "AfterLabelEdit", 9, {"Cancel", "NewString"}, "Occurs when the user has edited a label, before the file is renamed."};
inline constexpr frame::Event<bool&> BeforeLabelEdit{
    "BeforeLabelEdit", 10, {"Cancel"}, "Occurs before the user edits a label; can be cancelled."};
inline constexpr frame::Event<frame::Variant&> NeedMyFolders{
    "NeedMyFolders", 11, {"MyFolders"}, "Occurs when the list of the user's own folders is needed."};
inline constexpr frame::Event<std::int32_t&> ItemClick{"ItemClick", 12, {"Index"}, "Occurs when an item is clicked."};
inline constexpr frame::Event<> RefreshFoundChanges{
    "RefreshFoundChanges", 13, {}, "Occurs when a refresh has found items that have changed or gone."};
inline constexpr frame::Event<bool&> ChangedFolder{
    "ChangedFolder", 14, {"Cancel"}, "Occurs when another folder is about to be shown; can be cancelled."};
inline constexpr frame::Event<child::DragDataRef&, std::int32_t&> OLEStartDrag{
    "OLEStartDrag", 15, {"Data", "AllowedEffects"}, "Occurs when a drag starts from the list."};
inline constexpr frame::Event<child::DragDataRef&, std::int16_t&> OLESetData{
    "OLESetData", 16, {"Data", "DataFormat"}, "Occurs when a target asks for data that was only promised."};
inline constexpr frame::Event<std::int32_t&, bool&> OLEGiveFeedback{
    "OLEGiveFeedback", 17, {"Effect", "DefaultCursors"}, "Occurs when a drag's effect is to be shown."};
inline constexpr frame::Event<child::DragDataRef&, std::int32_t&, std::int16_t&, std::int16_t&, float&, float&, std::int16_t&>
    OLEDragOver{"OLEDragOver",
                18,
                {"Data", "Effect", "Button", "Shift", "X", "Y", "State"},
                "Occurs when something is dragged over the list."};
inline constexpr frame::Event<child::DragDataRef&, std::int32_t&, std::int16_t&, std::int16_t&, float&, float&> OLEDragDrop{
    "OLEDragDrop", 19, {"Data", "Effect", "Button", "Shift", "X", "Y"}, "Occurs when something is dropped on the list."};
inline constexpr frame::Event<std::int32_t&> OLECompleteDrag{
    "OLECompleteDrag", 20, {"Effect"}, "Occurs when a drag from the list has ended."};
inline constexpr auto Click = frame::stock::Click.Numbered(21);
inline constexpr auto DblClick = frame::stock::DblClick.Numbered(22);
inline constexpr auto KeyDown = frame::stock::KeyDown.Numbered(23);
inline constexpr auto KeyPress = frame::stock::KeyPress.Numbered(24);
inline constexpr auto KeyUp = frame::stock::KeyUp.Numbered(25);
inline constexpr auto MouseDown = frame::stock::MouseDown.Numbered(26);
inline constexpr auto MouseMove = frame::stock::MouseMove.Numbered(27);
inline constexpr auto MouseUp = frame::stock::MouseUp.Numbered(28);
inline constexpr frame::Event<bool&, std::string&> BeforePopup{
    "BeforePopup", 29, {"Cancel", "Filename"}, "Occurs before a menu is shown; can be cancelled."};

}  // namespace tessel::controls::fileview
