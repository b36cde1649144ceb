#include "hosts/qt/TreeViewPeer.h"

#include "hosts/qt/Convert.h"

namespace tessel::qt {

TreeViewPeer::TreeViewPeer(child::TreeView& tree) : TreeViewPeer(tree, new TreeWidget(tree)) {}

TreeViewPeer::TreeViewPeer(child::TreeView& tree, TreeWidget* widget) : WidgetPeer(tree, widget), shown_(widget) {}

TreeViewPeer::~TreeViewPeer() {
    if (shown_) shown_->Disconnect();
}

void TreeViewPeer::Update() {
    if (!shown_) return;
    FollowChild();
    shown_->Follow();
    follows_ = true;
}

// Until the tree was shown for the first time the fixed rule answers.
child::TreeScreen* TreeViewPeer::Screen() { return shown_ && follows_ ? this : nullptr; }

void TreeViewPeer::EditBegan(child::NodeId node) {
    if (shown_) shown_->BeginEdit(node);
}

std::optional<TreeViewPeer::Row> TreeViewPeer::RowAt(float x, float y) {
    return shown_->RowAtInside({PixelsExactly(x), PixelsExactly(y)});
}

TreeViewPeer::RowsInView TreeViewPeer::InView() {
    const child::RowRange rows = shown_->InView();
    return {rows.first, rows.count};
}

void TreeViewPeer::MakeVisible(Row row) { shown_->MakeVisible(row); }

}  // namespace tessel::qt
