#pragma once

#include <functional>
#include <string>
#include <utility>

#include "frame/Control.h"
#include "frame/Text.h"
#include "frame/child/ImageList.h"
#include "frame/child/ListView.h"

namespace tessel::test {

/// A control with nothing but a list and its image lists, which writes down what it hears from the list, parted by " | ".
class ListOwner final : public frame::Control {
  public:
    explicit ListOwner(frame::Host& host) : Control(host) {
        list.ItemClick.To<&ListOwner::ItemClicked>(*this);
        list.ColumnClick.To<&ListOwner::ColumnClicked>(*this);
        list.BeforeLabelEdit.To<&ListOwner::EditBegins>(*this);
        list.AfterLabelEdit.To<&ListOwner::EditEnds>(*this);
        list.LabelEditGivenUp.To<&ListOwner::EditGivenUp>(*this);
        list.MouseDown.To<&ListOwner::MousePressed>(*this);
        list.KeyDown.To<&ListOwner::KeyPressed>(*this);
        list.DblClick.To<&ListOwner::DoubleClicked>(*this);
        list.OLEStartDrag.To<&ListOwner::DragStarts>(*this);
        list.OLESetData.To<&ListOwner::DataWanted>(*this);
        list.OLEGiveFeedback.To<&ListOwner::Feedback>(*this);
        list.OLECompleteDrag.To<&ListOwner::DragDone>(*this);
        list.OLEDragOver.To<&ListOwner::DraggedOver>(*this);
        list.OLEDragDrop.To<&ListOwner::Dropped>(*this);
    }
    frame::TextSize DesignSize() const override { return {3000, 2000}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "ListOwner", .members = {}};
        return table;
    }
    /// What was heard since the last call.
    std::string Heard() { return std::exchange(heard, ""); }

    child::ImageList Image16{*this, "Image16"}, Image32{*this, "Image32"};
    child::ListView list{*this, "ListFiles"};
    std::string heard;

    // What a handler does besides.
    std::function<void()> atItemClick;
    std::function<void(bool&)> atEditBegin;
    std::function<void(bool&, std::string&)> atEditEnd;

  private:
    void Hear(const std::string& what) { heard += (heard.empty() ? "" : " | ") + what; }
    static std::string Number(double number) { return frame::Decimal(static_cast<std::int64_t>(number)); }

    void ItemClicked(std::int32_t index) {
        const auto item = list.SelectedItem();
        Hear("ItemClick " + (item ? item->Text() : "-") + " " + Number(index));
        if (atItemClick) atItemClick();
    }
    void ColumnClicked(std::int32_t index) { Hear("ColumnClick " + Number(index)); }
    void EditBegins(bool& cancel) {
        Hear("BeforeLabelEdit");
        if (atEditBegin) atEditBegin(cancel);
    }
    void EditEnds(bool& cancel, std::string& newString) {
        Hear("AfterLabelEdit " + newString);
        if (atEditEnd) atEditEnd(cancel, newString);
    }
    void EditGivenUp() { Hear("LabelEditGivenUp"); }
    void MousePressed(std::int16_t button, std::int16_t, float, float y) { Hear("MouseDown " + Number(button) + " " + Number(y)); }
    void KeyPressed(std::int16_t keyCode, std::int16_t shift) { Hear("KeyDown " + Number(keyCode) + " " + Number(shift)); }
    void DoubleClicked() { Hear("DblClick"); }
    void DragStarts(const child::DragDataRef& data, std::int32_t& allowedEffects) {
        Hear("OLEStartDrag");
        data->Files.Add("/a");
        allowedEffects = frame::dropEffects::copy | frame::dropEffects::move;
    }
    void DataWanted(const child::DragDataRef& data, std::int16_t& dataFormat) {
        Hear("OLESetData " + Number(dataFormat));
        data->SetData({}, frame::filesFormat);
        dataFormat = frame::filesFormat;
    }
    void Feedback(std::int32_t& effect, bool& defaultCursors) {
        Hear("OLEGiveFeedback " + Number(effect));
        defaultCursors = false;
    }
    void DragDone(std::int32_t& effect) { Hear("OLECompleteDrag " + Number(effect)); }
    void DraggedOver(const child::DragDataRef& data, std::int32_t& effect, std::int16_t, std::int16_t shift, float, float y,
                     child::DragOverConstants state) {
        Hear("OLEDragOver " + Number(data->Files.Count()) + " " + Number(shift) + " " + Number(y) + " " +
             Number(static_cast<int>(state)));
        effect &= frame::dropEffects::copy;
    }
    void Dropped(const child::DragDataRef& data, std::int32_t& effect, std::int16_t, std::int16_t, float x, float) {
        Hear("OLEDragDrop " + Number(data->Files.Count()) + " " + Number(x));
        effect = frame::dropEffects::none;
    }
};

}  // namespace tessel::test
