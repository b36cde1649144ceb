#pragma once

#include <cstdint>
#include <memory>

#include "frame/DragData.h"
#include "frame/child/PointerChild.h"

namespace tessel::child {

enum class OLEDragConstants : std::int32_t { Manual = 0, Automatic = 1 };
enum class OLEDropConstants : std::int32_t { None = 0, Manual = 1, Automatic = 2 };
enum class DragOverConstants : std::int16_t { Enter = 0, Leave = 1, Over = 2 };

namespace names {
inline constexpr frame::Enumeration::Constant oleDrag[] = {{"Manual", 0}, {"Automatic", 1}};
inline constexpr frame::Enumeration::Constant oleDrop[] = {{"None", 0}, {"Manual", 1}, {"Automatic", 2}};
inline constexpr frame::Enumeration::Constant dragOver[] = {{"Enter", 0}, {"Leave", 1}, {"Over", 2}};
}  // namespace names
inline constexpr frame::Enumeration oleDragConstants{"OLEDragConstants", names::oleDrag};
inline constexpr frame::Enumeration oleDropConstants{"OLEDropConstants", names::oleDrop};
inline constexpr frame::Enumeration dragOverConstants{"DragOverConstants", names::dragOver};

}  // namespace tessel::child

namespace tessel::frame {
template <>
inline constexpr const Enumeration* enumerationOf<child::OLEDragConstants> = &child::oleDragConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::OLEDropConstants> = &child::oleDropConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::DragOverConstants> = &child::dragOverConstants;
}  // namespace tessel::frame

namespace tessel::child {

using DragDataRef = std::shared_ptr<frame::DragData>;

/// The base of children that a drag may leave and that a drop may reach.
///
/// A drag begins when the program calls `OLEDrag`; by itself the child starts none. The host then reports in this order:
/// `OLEStartDragInput` (the program fills the data and says what it allows; with no effect allowed there is no drag),
/// `OLESetDataInput` when a target asks for a format that was only promised, `OLEGiveFeedbackInput` as the effect under the
/// pointer changes, and at last `OLECompleteDragInput` with the effect of the drop, 0 for none. No `MouseUp` follows. What is
/// dragged over the child and dropped on it is reported by `OLEDragOverInput` and `OLEDragDropInput`, while `OLEDropMode` is not
/// `None`. Effects are those of `frame::dropEffects`, as a sum; what the program makes of them stands in the argument afterwards.
class DragChild : public KeyChild {
  public:
    using KeyChild::KeyChild;

    OLEDragConstants OLEDragMode() const { return oleDragMode_; }
    void SetOLEDragMode(OLEDragConstants value) { Store(oleDragMode_, value); }
    OLEDropConstants OLEDropMode() const { return oleDropMode_; }
    void SetOLEDropMode(OLEDropConstants value) { Store(oleDropMode_, value); }
    /// Starts a drag from this child; returns when the host has taken it.
    void OLEDrag();

    // What a peer reports. Coordinates are in twips of the child; buttons and shift as for the mouse.
    void OLEStartDragInput(const DragDataRef& data, std::int32_t& allowedEffects);
    void OLESetDataInput(const DragDataRef& data, std::int16_t& dataFormat);
    void OLEGiveFeedbackInput(std::int32_t& effect, bool& defaultCursors);
    void OLECompleteDragInput(std::int32_t& effect);
    void OLEDragOverInput(const DragDataRef& data, std::int32_t& effect, std::int16_t button, std::int16_t shift, float x, float y,
                          DragOverConstants state);
    void OLEDragDropInput(const DragDataRef& data, std::int32_t& effect, std::int16_t button, std::int16_t shift, float x, float y);

    // Where the events go.
    frame::Slot<const DragDataRef&, std::int32_t&> OLEStartDrag;
    frame::Slot<const DragDataRef&, std::int16_t&> OLESetData;
    frame::Slot<std::int32_t&, bool&> OLEGiveFeedback;
    frame::Slot<std::int32_t&> OLECompleteDrag;
    frame::Slot<const DragDataRef&, std::int32_t&, std::int16_t, std::int16_t, float, float, DragOverConstants> OLEDragOver;
    frame::Slot<const DragDataRef&, std::int32_t&, std::int16_t, std::int16_t, float, float> OLEDragDrop;

  private:
    OLEDragConstants oleDragMode_ = OLEDragConstants::Manual;
    OLEDropConstants oleDropMode_ = OLEDropConstants::None;
};

/// The rows of such children, beside those of every child.
inline constexpr std::array dragMembers = {
    frame::property<&DragChild::OLEDragMode, &DragChild::SetOLEDragMode>("OLEDragMode", "Who starts a drag from the child."),
    frame::property<&DragChild::OLEDropMode, &DragChild::SetOLEDropMode>("OLEDropMode", "Who takes what is dropped on the child."),
    frame::method<&DragChild::OLEDrag>("OLEDrag", "Starts a drag from the child."),
};
/// The rows of what a peer reports, those of keys and mouse among them.
inline constexpr auto dragInputs = frame::Join(
    keyInputs,
    std::array{
        frame::input<&DragChild::OLEStartDragInput>("OLEStartDrag", {"Data", "AllowedEffects"}),
        frame::input<&DragChild::OLESetDataInput>("OLESetData", {"Data", "DataFormat"}),
        frame::input<&DragChild::OLEGiveFeedbackInput>("OLEGiveFeedback", {"Effect", "DefaultCursors"}),
        frame::input<&DragChild::OLECompleteDragInput>("OLECompleteDrag", {"Effect"}),
        frame::input<&DragChild::OLEDragOverInput>("OLEDragOver", {"Data", "Effect", "Button", "Shift", "X", "Y", "State"}),
        frame::input<&DragChild::OLEDragDropInput>("OLEDragDrop", {"Data", "Effect", "Button", "Shift", "X", "Y"}),
    });

}  // namespace tessel::child
