#include "frame/child/DragChild.h"

namespace tessel::child {

void DragChild::OLEDrag() { Host().StartDrag(*this); }

void DragChild::OLEStartDragInput(const DragDataRef& data, std::int32_t& allowedEffects) {
    Enter("OLEStartDrag", [&] { OLEStartDrag(data, allowedEffects); });
}
void DragChild::OLESetDataInput(const DragDataRef& data, std::int16_t& dataFormat) {
    Enter("OLESetData", [&] { OLESetData(data, dataFormat); });
}
void DragChild::OLEGiveFeedbackInput(std::int32_t& effect, bool& defaultCursors) {
    Enter("OLEGiveFeedback", [&] { OLEGiveFeedback(effect, defaultCursors); });
}
void DragChild::OLECompleteDragInput(std::int32_t& effect) {
    Enter("OLECompleteDrag", [&] { OLECompleteDrag(effect); });
}
void DragChild::OLEDragOverInput(const DragDataRef& data, std::int32_t& effect, std::int16_t button, std::int16_t shift, float x,
                                 float y, DragOverConstants state) {
    Enter("OLEDragOver", [&] { OLEDragOver(data, effect, button, shift, x, y, state); });
}
void DragChild::OLEDragDropInput(const DragDataRef& data, std::int32_t& effect, std::int16_t button, std::int16_t shift, float x,
                                 float y) {
    Enter("OLEDragDrop", [&] { OLEDragDrop(data, effect, button, shift, x, y); });
}

}  // namespace tessel::child
