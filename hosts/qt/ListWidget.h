#pragma once

#include <QAbstractItemView>
#include <QBasicTimer>
#include <QPixmap>
#include <QPointer>
#include <optional>
#include <unordered_map>
#include <unordered_set>
#include <vector>

#include "frame/child/ListView.h"
#include "frame/child/ListViewPeer.h"
#include "hosts/qt/DropInput.h"
#include "hosts/qt/KeyInput.h"
#include "hosts/qt/LabelEditor.h"
#include "hosts/qt/ListHeader.h"
#include "hosts/qt/ListLayout.h"
#include "hosts/qt/ListModel.h"
#include "hosts/qt/PointerInput.h"

namespace tessel::qt {

/// Shows a list in each of its four views, and reports what the user does with it.
///
/// It keeps nothing of a row: rows stand in cells of one size, and what is painted is read from the list. The list says which rows
/// are selected, the selection model of this widget does not; its current index is the focus row.
///
/// A scrolled view stays with the rows that it shows when rows come and go above them, and when all rows are read anew while one
/// that was seen is still there; at its start it stays there. Another order leaves it scrolled as it is.
class ListWidget final : public QAbstractItemView {
    Q_OBJECT

  public:
    using Position = child::ListRows::Position;

    explicit ListWidget(child::ListView& list);
    ~ListWidget() override;
    /// The list goes: nothing of it is read and nothing reported from now on.
    void Disconnect();
    /// The list, for those who answer questions about its rows; null once it has gone.
    child::ListView* List() const { return list_; }
    const ListModel& Model() const { return model_; }
    ListHeader& Header() { return header_; }

    /// Takes over what has changed.
    void Follow();
    void BeginEdit(child::RowId row);

    // Answers for the list, in pixels of its inside, which has the headers at its top.
    std::optional<Position> RowAtInside(QPointF point) const;
    QRectF PlaceInside(Position row) const;
    Position FirstVisible() const { return layout_.FirstVisible(Scrolled()); }
    void ScrollToTop(Position row);
    void MakeVisible(Position row);

    // What a view answers.
    QRect visualRect(const QModelIndex& index) const override;
    void scrollTo(const QModelIndex& index, ScrollHint hint = EnsureVisible) override;
    QModelIndex indexAt(const QPoint& point) const override;

  protected:
    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    int horizontalOffset() const override { return Scrolled().x(); }
    int verticalOffset() const override { return Scrolled().y(); }
    bool isIndexHidden(const QModelIndex&) const override { return false; }
    void setSelection(const QRect&, QItemSelectionModel::SelectionFlags) override {}
    QRegion visualRegionForSelection(const QItemSelection&) const override { return {}; }
    void updateGeometries() override;
    void dataChanged(const QModelIndex& first, const QModelIndex& last, const QList<int>& roles) override;
    // What these do by themselves the list does.
    void rowsInserted(const QModelIndex&, int, int) override {}
    void rowsAboutToBeRemoved(const QModelIndex&, int, int) override {}

    bool viewportEvent(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;
    void wheelEvent(QWheelEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void mouseDoubleClickEvent(QMouseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override { event->ignore(); }
    void timerEvent(QTimerEvent* event) override;
    void dragEnterEvent(QDragEnterEvent* event) override;
    void dragMoveEvent(QDragMoveEvent* event) override;
    void dragLeaveEvent(QDragLeaveEvent* event) override;
    void dropEvent(QDropEvent* event) override;

  private:
    static constexpr int edge = 4;  // pixels beside icons and texts

    /// What the list looks like besides its rows.
    struct Look {
        child::ListViewConstants view = child::ListViewConstants::Report;
        child::ListArrangeConstants arrange = child::ListArrangeConstants::None;
        bool wrap = true, hideHeaders = false, hideSelection = false, fullRow = false, grid = false, hot = false, enabled = true;
        frame::OLE_COLOR back, fore;
        child::ListBorderConstants border = child::ListBorderConstants::FixedSingle;
        child::AppearanceConstants appearance = child::AppearanceConstants::ThreeD;
        QFont font;
        frame::PictureRef picture;
        child::ListPictureAlignmentConstants alignment = child::ListPictureAlignmentConstants::TopLeft;
        const child::ImageList* images = nullptr;
        std::uint32_t imagesRevision = 0;
        bool takesDrops = false;
        std::int16_t pointer = 0;
        frame::PictureRef pointerIcon;
        bool operator==(const Look&) const = default;
    };
    /// The colours in which rows are painted.
    struct Colors {
        QColor back, text, pale, mark, markedText, faintMark, grid;
    };
    /// Where the parts of a row's label stand in its cell, in pixels of the contents.
    struct Label {
        QRect icon, text, mark;
    };

    // Following.
    Look LookNow() const;
    void TakeLook();
    void FollowScroll(const std::vector<child::RowChange>& changes);
    void FollowFocus();
    void FollowEdit();
    void RememberSeen();
    void LayOut();
    void FitCells();
    int SampledTextWidth() const;
    void FitScrollBars();
    void UpdateRows(Position first, Position count);

    // Geometry.
    bool IsReport() const { return look_.view == child::ListViewConstants::Report; }
    bool IsLargeIcons() const { return look_.view == child::ListViewConstants::Icon; }
    QPoint Scrolled() const;
    void Scroll(QPoint offset);
    QRect ToViewport(QRect contents) const;
    QPoint ToContents(QPoint viewport) const;
    QPointF InsideOffset() const;
    QRect ColumnCell(Position row, int column) const;
    Label LabelOf(Position row, const QString& text) const;
    std::optional<Position> HitRow(QPoint viewport) const;
    child::ImageList* Images() const;
    QSize ImageSize() const;
    QString LabelText(Position row) const { return OneLine(model_.Text(static_cast<int>(row), 0)); }
    static QString OneLine(QString text);

    // Painting.
    Colors ColorsNow() const;
    void PaintBackground(QPainter& painter) const;
    void PaintRow(QPainter& painter, Position row, const Colors& colors);
    void PaintSubItems(QPainter& painter, Position row, const QColor& text) const;
    void PaintIcon(QPainter& painter, Position row, QRect place, bool marked, const Colors& colors);
    void PaintGrid(QPainter& painter, const QRect& exposed, const Colors& colors) const;
    QString FullTextAt(QPoint viewport) const;

    // What the user does.
    bool Settle();
    QMouseEvent Inside(const QMouseEvent& event) const;
    void PressRow(Position row, const QMouseEvent& event);
    void PressBeside(const QMouseEvent& event);
    void Hover(QPoint at);
    void BeginBand();
    void MoveBand();
    std::vector<child::RowRange> BandRows() const;
    void EndBand();
    bool MoveByKey(const QKeyEvent& event);
    bool SelectByKey(const QKeyEvent& event);
    void TypeAhead(const QString& typed);
    void SelectByKeyboard(Position row, Qt::KeyboardModifiers modifiers);
    void OpenEditSoon(Position row);
    void EndEditor();
    void PlaceEditor();
    void FitColumn(int column);
    std::int32_t IndexOf(Position row) const { return static_cast<std::int32_t>(row) + 1; }
    std::optional<Position> FocusPosition() const;

    child::ListView* list_;
    ListModel model_;
    ListHeader header_;
    ListLayout layout_;
    Look look_;
    PointerInput pointer_;
    KeyInput* keys_;
    DropInput drops_;

    bool followedOnce_ = false;
    bool following_ = false;  // scrolling is not the user's
    bool focusedByMouse_ = false;
    Position sampledFor_ = 0;
    int sampledWidth_ = 0;
    struct Seen {
        child::RowRef row;
        int place = 0;  // from the edge where the view begins
    };
    std::vector<Seen> seen_;  // what was in view lately
    std::unordered_map<const frame::Picture*, std::pair<frame::PictureRef, QPixmap>> icons_;
    double iconScale_ = 0;

    std::optional<Position> pressedSelected_;  // the release selects
    std::optional<child::RowRef> clickEdits_;  // the click was on the label of the selected row
    std::optional<QPoint> pressedBeside_;      // in the contents
    QPoint pressedAt_, pointerAt_;
    Qt::KeyboardModifiers pressedWith_;
    std::optional<QRect> band_;  // in the contents
    std::vector<child::RowRange> bandRows_;
    std::unordered_set<Position> bandKeeps_;
    std::optional<Position> hot_;
    QBasicTimer hoverTimer_, editTimer_, bandTimer_, typeTimer_;
    QString typed_;

    QPointer<LabelEditor> editor_;
    child::RowRef edited_;
};

}  // namespace tessel::qt
