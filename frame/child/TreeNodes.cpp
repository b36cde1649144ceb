#include "frame/child/TreeNodes.h"

#include <algorithm>
#include <utility>

#include "frame/Text.h"

namespace tessel::child {

using frame::Status;
using frame::Variant;
using Relationship = TreeRelationshipConstants;

Status TreeNodes::Add(NodeId& added, std::string_view text, std::string_view key, NodeId relative, Relationship relationship) {
    if (FindKey(key)) return frame::errors::keyNotUnique;
    const NodeId parent = relative == noNode || relationship == Relationship::Child ? relative : Parent(relative);
    Settle(parent);
    const NodeShape::Place place =
        Sorted(parent) ? SortedPlace(parent, text, ChildCount(parent)) : PlaceFor(parent, relative, relationship);

    const NodeId node = TakeId();
    names_.Begin(node, text, key);
    shape_.Insert(node, parent, place);
    order_.Append(node);
    if (childTexts_) childTexts_->Add(node, ChildHash(parent, text));
    if (Journals()) {
        if (const auto row = RowOf(node)) journal_.Inserted(*row);
        if (ChildCount(parent) == 1) JournalRow(parent);  // it has a sign from now on
    }
    changed_();
    added = node;
    return {};
}

NodeShape::Place TreeNodes::PlaceFor(NodeId parent, NodeId relative, Relationship relationship) const {
    if (relationship == Relationship::First) return 0;
    const bool isBeside = relative != noNode && (relationship == Relationship::Next || relationship == Relationship::Previous);
    if (!isBeside) return ChildCount(parent);
    return shape_.PlaceOf(relative) + (relationship == Relationship::Next ? 1 : 0);
}

void TreeNodes::Remove(NodeId node) {
    if (selected_ != noNode && IsWithin(selected_, node)) SelectBeside(node);
    const NodeId parent = Parent(node);
    if (Journals())
        if (const auto row = RowOf(node)) journal_.Removed(*row, shape_.RowsWith(node));

    std::vector<NodeId> leaving;
    for (NodeId each = node; each != noNode; each = shape_.NextWithin(each, node)) leaving.push_back(each);
    shape_.Remove(node);
    for (const NodeId each : leaving) Forget(each);
    if (Journals() && ChildCount(parent) == 0) JournalRow(parent);
    changed_();
}

/// Where the selection goes when the node does that has it, itself or below it.
void TreeNodes::SelectBeside(NodeId leaving) {
    NodeId other = Next(leaving);
    if (other == noNode) other = Previous(leaving);
    if (other == noNode) other = Parent(leaving);
    SetSelected(other);
}

void TreeNodes::Forget(NodeId node) {
    if (childTexts_) childTexts_->Remove(node);
    order_.Remove(PositionOf(node));
    if (Has(node, tagged)) tags_.erase(node);
    if (Has(node, colored)) colors_.erase(node);
    unsettled_.erase(node);
    names_.End(node);
    nodes_[node] = Node();
    free_.push_back(node);
}

void TreeNodes::Clear() {
    nodes_.Clear();
    lastId_ = noNode;
    free_.clear();
    order_.Clear();
    shape_.Clear();
    names_.Clear();
    childTexts_.reset();
    icons_.Clear();
    tags_.clear();
    colors_.clear();
    unsettled_.clear();
    selected_ = noNode;
    if (followed_) journal_.Reset();
    changed_();
}

NodeId TreeNodes::TakeId() {
    NodeId node = lastId_ + 1;
    if (free_.empty()) {
        lastId_ = node;
    } else {
        node = free_.back();
        free_.pop_back();
    }
    nodes_.MakeRoom(node);
    nodes_[node].serial = ++lastSerial_;
    return node;
}

NodeId TreeNodes::Root(NodeId node) const {
    while (Parent(node) != noNode) node = Parent(node);
    return node;
}

void TreeNodes::SetText(NodeId node, std::string_view text) {
    if (Text(node) == text) return;
    if (childTexts_) childTexts_->Remove(node);
    names_.SetText(node, text);
    if (childTexts_) childTexts_->Add(node, ChildHash(Parent(node), Text(node)));
    Unsettle(node);
    NodeChanged(node);
}

std::optional<NodeId> TreeNodes::FindChild(NodeId parent, std::string_view text) const {
    if (!childTexts_) {
        auto index = std::make_unique<HashIndex>();
        for (const NodeId node : order_.All()) index->Add(node, ChildHash(Parent(node), Text(node)));
        childTexts_ = std::move(index);
    }
    std::optional<NodeId> first;
    childTexts_->Candidates(ChildHash(parent, text), [&](NodeId node) {
        if (Parent(node) != parent || !frame::EqualsNoCase(Text(node), text)) return;
        if (!first || shape_.PlaceOf(node) < shape_.PlaceOf(*first)) first = node;
    });
    return first;
}

std::uint32_t TreeNodes::ChildHash(NodeId parent, std::string_view text) const {
    constexpr std::uint32_t golden = 0x9E3779B9u;
    return HashIndex::HashOf(text) ^ parent * golden;
}

Status TreeNodes::SetKey(NodeId node, std::string_view key) {
    const auto other = FindKey(key);
    if (other && *other != node) return frame::errors::keyNotUnique;
    names_.SetKey(node, key);
    return {};
}

std::string TreeNodes::FullPath(NodeId node, std::string_view separator) const {
    std::vector<NodeId> way;
    for (; node != noNode; node = Parent(node)) way.push_back(node);
    std::string path;
    for (std::size_t i = way.size(); i-- > 0;) {
        path += Text(way[i]);
        if (i > 0) path += separator;
    }
    return path;
}

void TreeNodes::SetExpanded(NodeId node, bool value) {
    if (Expanded(node) == value) return;
    const auto row = Journals() ? RowOf(node) : std::nullopt;
    const NodeShape::Row before = shape_.RowsWith(node);
    shape_.SetExpanded(node, value);
    const NodeShape::Row after = shape_.RowsWith(node);
    if (row && after > before) journal_.Inserted(*row + 1, after - before);
    if (row && after < before) journal_.Removed(*row + 1, before - after);
    NodeChanged(node);
}

void TreeNodes::SetSelected(NodeId node) {
    if (node == selected_) return;
    const NodeId before = std::exchange(selected_, node);
    if (Journals()) {
        JournalRow(before);
        JournalRow(node);
    }
    changed_();
}

void TreeNodes::SetFlag(NodeId node, std::uint8_t flag, bool value) {
    if (Has(node, flag) == value) return;
    nodes_[node].flags ^= flag;
    NodeChanged(node);
}

Variant TreeNodes::Tag(NodeId node) const { return Has(node, tagged) ? tags_.find(node)->second : Variant(); }

void TreeNodes::SetTag(NodeId node, Variant value) {
    tags_[node] = std::move(value);
    nodes_[node].flags |= tagged;
}

TreeNodes::Colors TreeNodes::ColorsOf(NodeId node) const { return Has(node, colored) ? colors_.find(node)->second : Colors(); }

void TreeNodes::SetColors(NodeId node, const Colors& colors) {
    if (ColorsOf(node) == colors) return;
    colors_[node] = colors;
    nodes_[node].flags |= colored;
    NodeChanged(node);
}

Variant TreeNodes::ShownImage(NodeId node) const {
    RowIcons::IconId image = RowIcons::none;
    if (node == selected_) image = ImageOf(node, NodeImage::Selected);
    if (image == RowIcons::none && Expanded(node)) image = ImageOf(node, NodeImage::Expanded);
    return icons_.Value(image != RowIcons::none ? image : ImageOf(node, NodeImage::Plain));
}

Status TreeNodes::SetImage(NodeId node, NodeImage which, const Variant& value) {
    RowIcons::IconId image = ImageOf(node, which);
    const Status status = icons_.Find(IconSize::Small, value, image);
    StoreImage(node, which, image);
    return status;
}

Status TreeNodes::SetImageKey(NodeId node, NodeImage which, std::string_view key) {
    RowIcons::IconId image = ImageOf(node, which);
    const Status status = icons_.FindKey(IconSize::Small, key, image);
    StoreImage(node, which, image);
    return status;
}

Status TreeNodes::CheckImage(const Variant& value) {
    RowIcons::IconId image = RowIcons::none;
    return icons_.Find(IconSize::Small, value, image);
}

void TreeNodes::StoreImage(NodeId node, NodeImage which, RowIcons::IconId image) {
    RowIcons::IconId& stored = nodes_[node].images[static_cast<std::size_t>(which)];
    if (std::exchange(stored, image) != image) NodeChanged(node);
}

void TreeNodes::Follow() {
    followed_ = true;
    journal_.Reset();
}

void TreeNodes::Unfollow() {
    if (!std::exchange(followed_, false)) return;
    journal_.Take();
}

void TreeNodes::NodeChanged(NodeId node) {
    if (Journals()) JournalRow(node);
    changed_();
}

void TreeNodes::JournalRow(NodeId node) {
    if (node == noNode) return;
    if (const auto row = RowOf(node)) journal_.Changed(*row);
}

}  // namespace tessel::child
