#pragma once

#include "frame/child/TreeView.h"
#include "hosts/qt/TreeWidget.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

/// Shows a tree.
class TreeViewPeer final : public child::TreeViewPeer, public WidgetPeer, private child::TreeScreen {
  public:
    explicit TreeViewPeer(child::TreeView& tree);
    ~TreeViewPeer() override;

    void Update() override;
    child::TreeScreen* Screen() override;
    void EditBegan(child::NodeId node) override;

  private:
    TreeViewPeer(child::TreeView& tree, TreeWidget* widget);

    std::optional<Row> RowAt(float x, float y) override;
    RowsInView InView() override;
    void MakeVisible(Row row) override;

    QPointer<TreeWidget> shown_;
    bool follows_ = false;
};

}  // namespace tessel::qt
