#pragma once

#include <QBasicTimer>
#include <deque>
#include <optional>
#include <vector>

#include "frame/child/TreeView.h"
#include "hosts/qt/RowView.h"
#include "hosts/qt/TreeModel.h"

namespace tessel::qt {

/// Shows a tree, one node below the other, and reports what the user does with it. Before a node stand the lines and the sign, as
/// the style draws branches, and the check box.
///
/// The contents are as wide as the widest row that was in view since the rows last went away or all changed: no text is measured
/// that was not seen.
class TreeWidget final : public RowView {
    Q_OBJECT

  public:
    explicit TreeWidget(child::TreeView& tree);
    ~TreeWidget() override;
    void Disconnect() override;
    child::DragChild* Child() const override { return tree_; }
    /// The tree, for those who answer questions about its nodes; null once it has gone.
    child::TreeView* Tree() const { return tree_; }
    bool IsSelected(Position row) const override { return NodeAt(row) == Nodes().Selected(); }

    /// Takes over what has changed.
    void Follow();
    void BeginEdit(child::NodeId node);

    /// The rows that are within the window, in whole or in part.
    child::RowRange InView() const;
    /// Brings the label into view too, as far as the window is wide enough.
    void MakeVisible(Position row) override;
    void ReportSelection(Position row, Qt::KeyboardModifiers modifiers) override;
    /// Expands the node of a row as the user does, or collapses it.
    void TurnSign(Position row);
    void TurnCheck(Position row) { tree_->CheckInput(IndexAt(row)); }
    /// Where sign and box of a row stand, in pixels of the viewport; empty for none.
    QRect SignPlace(Position row) const { return ToViewport(PartsOf(row).sign); }
    QRect BoxPlace(Position row) const { return ToViewport(PartsOf(row).box); }
    QRect LabelPlace(Position row) const { return ToViewport(LabelOf(row, LabelText(row)).mark); }

  protected:
    Label LabelOf(Position row, const QString& text) const override;
    std::optional<Position> FocusPosition() const override;
    child::ImageList* Images() const override { return view_.pictures ? tree_->ImageList() : nullptr; }
    std::optional<RowKey> EditedRow() const override;

    void ReportScroll(Position first) override { tree_->ScrollInput(IndexAt(first)); }
    void ReportEditWanted(Position row) override { tree_->EditInput(IndexAt(row)); }
    void ReportEditEnd(const std::string& text) override { tree_->EndEditInput(text); }
    void ReportEditGivenUp() override { tree_->GiveUpEditInput(); }

    void PressAt(const QMouseEvent& event) override;
    void DoubleClickAt(const QMouseEvent& event) override;
    bool ActByKey(const QKeyEvent& event) override;
    std::optional<Position> FindFrom(Position first, const QString& text) const override;

    void PaintRow(QPainter& painter, Position row, const Colors& colors) override;
    QString FullTextAt(QPoint viewport) const override;

    /// Its sign and its box are not the node.
    std::optional<Position> HitRow(QPoint viewport) const override;
    void FitCells() override;
    void changeEvent(QEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;
    void mousePressEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void timerEvent(QTimerEvent* event) override;

  private:
    /// What the tree looks like besides.
    struct TreeLook {
        bool lines = true, signs = true, pictures = true, atTop = true, boxes = false, scrolls = true;
        int indent = 0;
        child::NodeRef dropHighlight;
        bool operator==(const TreeLook&) const = default;
    };
    /// What stands before a row's label, in pixels of the contents, and where the label begins.
    struct Parts {
        QRect sign, box;
        int label = 0;
    };

    TreeLook TreeLookNow() const;
    void TellStates(const std::vector<child::RowChange>& changes);

    const child::TreeNodes& Nodes() const { return tree_->Tree(); }
    child::NodeId NodeAt(Position row) const { return Nodes().AtRow(row); }
    std::int32_t IndexOf(child::NodeId node) const { return static_cast<std::int32_t>(Nodes().PositionOf(node)) + 1; }
    std::int32_t IndexAt(Position row) const { return IndexOf(NodeAt(row)); }

    // Geometry.
    /// How many columns of lines and signs stand before a label, each as wide as the other.
    int ColumnsBefore(int level) const;
    int ColumnWidth() const;
    Parts PartsOf(Position row) const;
    QFont FontOf(child::NodeId node) const;
    int TextWidth(child::NodeId node, const QString& text) const;
    int WidestInView() const;

    // Painting.
    void PaintBranches(QPainter& painter, Position row, const Colors& colors) const;
    void PaintBox(QPainter& painter, Position row, const QRect& box, const Colors& colors) const;

    // What the user does.
    void PressNode(Position row);
    void ExpandBySelecting(child::NodeRef node, child::NodeRef before);
    bool MoveByKey(const QKeyEvent& event);
    bool TurnByKey(const QKeyEvent& event);
    void MoveSideways(Position from, ListLayout::Step step);
    void GoTo(child::NodeId node);
    void ExpandAll(child::NodeId node);
    void ExpandMore();

    child::TreeView* tree_;
    TreeModel model_;
    TreeLook view_;
    bool followedOnce_ = false;
    int seenWidth_ = 0;                     // of the widest row that was in view
    std::deque<child::NodeRef> expanding_;  // still to be expanded, with all below them that had come by then
    QBasicTimer expandTimer_;
};

}  // namespace tessel::qt
