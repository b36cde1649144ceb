#pragma once

#include <cstdint>
#include <string>

#include "frame/Event.h"
#include "frame/child/DragChild.h"
#include "frame/child/TreeNode.h"

/// The events of `FolderView`. Those of the mouse and the keys are the stock ones, under their stock numbers.
namespace tessel::controls::folderview {

inline constexpr frame::Event<std::string&> AfterDelete{"AfterDelete", 1, {"Filename"}, "Occurs when a folder has been deleted."};
inline constexpr frame::Event<bool&, std::string&> BeforeDelete{
    "BeforeDelete", 2, {"Cancel", "Filename"}, "Occurs before a folder is deleted; can be cancelled."};
inline constexpr frame::Event<bool&> BeforeLabelEdit{
    "BeforeLabelEdit", 3, {"Cancel"}, "Occurs before the user edits a label; can be cancelled."};
inline constexpr frame::Event<bool&, std::string&> AfterLabelEdit{
    "AfterLabelEdit", 4, {"Cancel", "NewString"}, "Occurs when the user has edited a label, before the folder is renamed."};
inline constexpr frame::Event<std::int32_t&> OLECompleteDrag{
    "OLECompleteDrag", 5, {"Effect"}, "Occurs when a drag from the tree has ended."};
inline constexpr frame::Event<child::DragDataRef&, std::int32_t&, std::int16_t&, std::int16_t&, float&, float&> OLEDragDrop{
    "OLEDragDrop", 6, {"Data", "Effect", "Button", "Shift", "X", "Y"}, "Occurs when something is dropped on the tree."};
inline constexpr frame::Event<child::DragDataRef&, std::int32_t&, std::int16_t&, std::int16_t&, float&, float&, std::int16_t&>
    OLEDragOver{"OLEDragOver",
                7,
                {"Data", "Effect", "Button", "Shift", "X", "Y", "State"},
                "Occurs when something is dragged over the tree."};
inline constexpr frame::Event<std::int32_t&, bool&> OLEGiveFeedback{
    "OLEGiveFeedback", 8, {"Effect", "DefaultCursors"}, "Occurs when a drag's effect is to be shown."};
inline constexpr frame::Event<child::DragDataRef&, std::int16_t&> OLESetData{
    "OLESetData", 9, {"Data", "DataFormat"}, "Occurs when a target asks for data that was only promised."};
inline constexpr frame::Event<child::DragDataRef&, std::int32_t&> OLEStartDrag{
    "OLEStartDrag", 10, {"Data", "AllowedEffects"}, "Occurs when a drag starts from the tree."};
inline constexpr frame::Event<child::TreeNodeRef&> Collapse{"Collapse", 11, {"Node"}, "Occurs when a node has been collapsed."};
inline constexpr frame::Event<child::TreeNodeRef&> Expand{
    "Expand", 12, {"Node"}, "Occurs when a node has been expanded, before it is filled."};
inline constexpr frame::Event<child::TreeNodeRef&> NodeClick{
    "NodeClick", 13, {"Node"}, "Occurs when a node is clicked: at the press of the button and again for the click."};
inline constexpr frame::Event<bool&> BeforePaint{
    "BeforePaint", 14, {"Cancel"}, "Occurs before the tree is built anew; can be cancelled."};
inline constexpr frame::Event<> AfterPaint{"AfterPaint", 15, {}, "Occurs when the tree has been built."};
inline constexpr frame::Event<std::int32_t&> AfterAddItem{
    "AfterAddItem", 16, {"Index"}, "Occurs when a folder or drive has been added to the tree."};
inline constexpr frame::Event<bool&> BeforeAddItem{
    "BeforeAddItem", 17, {"Cancel"}, "Occurs before a folder or drive is added to the tree; can be cancelled."};
inline constexpr frame::Event<> ChangedFolder{"ChangedFolder", 18, {}, "Occurs when the current path has changed."};
inline constexpr frame::Event<bool&, std::string&> BeforePopup{
    "BeforePopup", 19, {"Cancel", "Filename"}, "Occurs before a menu is shown; can be cancelled."};

}  // namespace tessel::controls::folderview
