#include "hosts/qt/TreeModel.h"

#include <string>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

void TreeModel::Follow(const std::vector<child::RowChange>& changes) {
    if (IsConnected()) FollowRows(changes);
}

RowModel::RowKey TreeModel::KeyOf(child::NodeId node) const { return KeyFor(node, tree_.Tree().Ref(node).serial); }

std::optional<RowModel::Position> TreeModel::PositionOf(RowKey key) const {
    const child::NodeRef node{NumberOf(key), SerialOf(key)};
    return tree_.Tree().Lives(node) ? tree_.Tree().RowOf(node.node) : std::nullopt;
}

QString TreeModel::HeldText(Position position, int) const { return ToQt(tree_.Tree().Text(tree_.Tree().AtRow(position))); }

QPixmap TreeModel::HeldIcon(Position position, int) const {
    return IconOf(tree_.ImageList(), tree_.Tree().ShownImage(tree_.Tree().AtRow(position)), 1);
}

}  // namespace tessel::qt
