#pragma once

#include <functional>
#include <string>
#include <utility>

#include "frame/Control.h"
#include "frame/Text.h"
#include "frame/child/ImageList.h"
#include "frame/child/TreeView.h"

namespace tessel::test {

/// A control with nothing but a tree and its images, which writes down what it hears from the tree, parted by " | ".
class TreeOwner final : public frame::Control {
  public:
    explicit TreeOwner(frame::Host& host) : Control(host) {
        tree.NodeClick.To<&TreeOwner::NodeClicked>(*this);
        tree.NodeCheck.To<&TreeOwner::NodeChecked>(*this);
        tree.Expand.To<&TreeOwner::Expanded>(*this);
        tree.Collapse.To<&TreeOwner::Collapsed>(*this);
        tree.BeforeLabelEdit.To<&TreeOwner::EditBegins>(*this);
        tree.AfterLabelEdit.To<&TreeOwner::EditEnds>(*this);
        tree.LabelEditGivenUp.To<&TreeOwner::EditGivenUp>(*this);
        tree.MouseDown.To<&TreeOwner::MousePressed>(*this);
        tree.KeyUp.To<&TreeOwner::KeyReleased>(*this);
        tree.OLEStartDrag.To<&TreeOwner::DragStarts>(*this);
    }
    frame::TextSize DesignSize() const override { return {3000, 2000}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "TreeOwner", .members = {}};
        return table;
    }
    /// What was heard since the last call.
    std::string Heard() { return std::exchange(heard, ""); }

    child::ImageList Image16{*this, "Image16"};
    child::TreeView tree{*this, "TreeFolders"};
    std::string heard;

    // What a handler does besides.
    std::function<void(const child::TreeNodeRef&)> atClick, atExpand;
    std::function<void(bool&)> atEditBegin;
    std::function<void(bool&, std::string&)> atEditEnd;

  private:
    void Hear(const std::string& what) { heard += (heard.empty() ? "" : " | ") + what; }

    void NodeClicked(const child::TreeNodeRef& node) {
        Hear("NodeClick " + node->Text() + (node->Selected() ? "*" : ""));
        if (atClick) atClick(node);
    }
    void NodeChecked(const child::TreeNodeRef& node) { Hear("NodeCheck " + node->Text() + (node->Checked() ? " on" : " off")); }
    void Expanded(const child::TreeNodeRef& node) {
        Hear("Expand " + node->Text() + (node->Expanded() ? " -" : " +"));
        if (atExpand) atExpand(node);
    }
    void Collapsed(const child::TreeNodeRef& node) { Hear("Collapse " + node->Text() + (node->Expanded() ? " -" : " +")); }
    void EditBegins(bool& cancel) {
        Hear("BeforeLabelEdit");
        if (atEditBegin) atEditBegin(cancel);
    }
    void EditEnds(bool& cancel, std::string& newString) {
        Hear("AfterLabelEdit " + newString);
        if (atEditEnd) atEditEnd(cancel, newString);
    }
    void EditGivenUp() { Hear("LabelEditGivenUp"); }
    void MousePressed(std::int16_t button, std::int16_t, float, float y) {
        Hear("MouseDown " + frame::Decimal(button) + " " + frame::Decimal(static_cast<std::int64_t>(y)));
    }
    void KeyReleased(std::int16_t keyCode, std::int16_t) { Hear("KeyUp " + frame::Decimal(keyCode)); }
    void DragStarts(const child::DragDataRef&, std::int32_t& allowedEffects) {
        Hear("OLEStartDrag");
        allowedEffects = 3;
    }
};

}  // namespace tessel::test
