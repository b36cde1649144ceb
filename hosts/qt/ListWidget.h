#pragma once

#include <QBasicTimer>
#include <optional>
#include <unordered_set>
#include <vector>

#include "frame/child/ListView.h"
#include "frame/child/ListViewPeer.h"
#include "hosts/qt/ListHeader.h"
#include "hosts/qt/ListModel.h"
#include "hosts/qt/RowView.h"

namespace tessel::qt {

/// Shows a list in each of its four views, and reports what the user does with it.
class ListWidget final : public RowView {
    Q_OBJECT

  public:
    explicit ListWidget(child::ListView& list);
    ~ListWidget() override;
    void Disconnect() override;
    child::DragChild* Child() const override { return list_; }
    /// The list, for those who answer questions about its rows; null once it has gone.
    child::ListView* List() const { return list_; }
    ListHeader& Header() { return header_; }
    bool IsSelected(Position row) const override { return list_->Rows().Selected(list_->Rows().At(row)); }

    /// Takes over what has changed.
    void Follow();
    void BeginEdit(child::RowId row);

    QRect visualRect(const QModelIndex& index) const override;
    QModelIndex indexAt(const QPoint& point) const override;

  protected:
    Label LabelOf(Position row, const QString& text) const override;
    std::optional<Position> FocusPosition() const override;
    child::ImageList* Images() const override { return IsLargeIcons() ? list_->Icons() : list_->SmallIcons(); }
    std::optional<RowKey> EditedRow() const override;

    void ReportScroll(Position first) override { list_->ScrollInput(IndexOf(first)); }
    void ReportEditWanted(Position row) override { list_->EditInput(IndexOf(row)); }
    void ReportEditEnd(const std::string& text) override { list_->EndEditInput(text); }
    void ReportEditGivenUp() override { list_->GiveUpEditInput(); }
    void ReportSelection(Position row, Qt::KeyboardModifiers modifiers) override;

    void PressAt(const QMouseEvent& event) override;
    void ReleaseAt(const QMouseEvent& event) override;
    void LosePress() override;
    void DragTo(bool isFar) override;
    void Hover(QPoint at) override;
    bool SensesRows() const override { return list_->HotTracking() || list_->HoverSelection(); }
    bool ActByKey(const QKeyEvent& event) override { return MoveByKey(event) || SelectByKey(event); }
    std::optional<Position> FindFrom(Position first, const QString& text) const override;

    void PaintBehind(QPainter& painter) const override;
    void PaintRow(QPainter& painter, Position row, const Colors& colors) override;
    void PaintAbove(QPainter& painter, const QRect& exposed, const Colors& colors) const override;
    QString FullTextAt(QPoint viewport) const override;
    bool ScrollsPixels() const override { return !view_.picture; }

    void LayOut() override;
    void FitCells() override;
    int SidewaysStep() const override;
    QRect EditorPlace(Position row) const override;

    void updateGeometries() override;
    void changeEvent(QEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;
    void wheelEvent(QWheelEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void timerEvent(QTimerEvent* event) override;

  private:
    /// What the list looks like besides.
    struct ViewLook {
        child::ListViewConstants view = child::ListViewConstants::Report;
        child::ListArrangeConstants arrange = child::ListArrangeConstants::None;
        bool wrap = true, hideHeaders = false, grid = false;
        frame::PictureRef picture;
        child::ListPictureAlignmentConstants alignment = child::ListPictureAlignmentConstants::TopLeft;
        bool operator==(const ViewLook&) const = default;
    };

    ViewLook ViewLookNow() const;
    int SampledTextWidth() const;

    // Geometry.
    bool IsReport() const { return view_.view == child::ListViewConstants::Report; }
    bool IsLargeIcons() const { return view_.view == child::ListViewConstants::Icon; }
    QRect ColumnCell(Position row, int column) const;

    // Painting.
    void PaintSubItems(QPainter& painter, Position row, const QColor& text) const;
    void PaintGrid(QPainter& painter, const QRect& exposed, const Colors& colors) const;

    // What the user does.
    void PressRow(Position row, const QMouseEvent& event);
    void PressBeside(const QMouseEvent& event);
    void BeginBand();
    void MoveBand();
    std::vector<child::RowRange> BandRows() const;
    void EndBand();
    bool MoveByKey(const QKeyEvent& event);
    bool SelectByKey(const QKeyEvent& event);
    void FitColumn(int column);
    std::int32_t IndexOf(Position row) const { return static_cast<std::int32_t>(row) + 1; }

    child::ListView* list_;
    ListModel model_;
    ListHeader header_;
    ViewLook view_;

    bool followedOnce_ = false;
    Position sampledFor_ = 0;
    int sampledWidth_ = 0;

    std::optional<Position> pressedSelected_;  // the release selects
    std::optional<QPoint> pressedBeside_;      // in the contents
    std::optional<QRect> band_;                // in the contents
    std::vector<child::RowRange> bandRows_;
    std::unordered_set<Position> bandKeeps_;
    QBasicTimer hoverTimer_, bandTimer_;
};

}  // namespace tessel::qt
