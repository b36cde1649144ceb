#pragma once

#include <QAbstractItemView>
#include <QBasicTimer>
#include <QPixmap>
#include <QPointer>
#include <optional>
#include <unordered_map>
#include <vector>

#include "frame/Color.h"
#include "frame/child/DragChild.h"
#include "frame/child/Label.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/DropInput.h"
#include "hosts/qt/KeyInput.h"
#include "hosts/qt/LabelEditor.h"
#include "hosts/qt/ListLayout.h"
#include "hosts/qt/PointerInput.h"
#include "hosts/qt/RowModel.h"

namespace tessel::qt {

/// What the list and the tree share: rows in cells of one size, each with an icon and a label, which one of the child's things
/// fills.
///
/// It keeps nothing of a row: what is painted is read from the child. The child says which rows are selected, the selection model
/// of this widget does not; its current index is the focus row.
///
/// A scrolled view stays with the rows that it shows when rows come and go above them, and when all rows are read anew while one
/// that was seen is still there; at its start it stays there. Another order leaves it scrolled as it is.
///
/// The mouse and the keys are reported first, then what they mean to the child. Any report may end the child.
class RowView : public QAbstractItemView {
    Q_OBJECT

  public:
    using Position = RowModel::Position;
    using RowKey = RowModel::RowKey;

    /// The child goes: nothing of it is read and nothing reported from now on.
    virtual void Disconnect();
    /// Null once it has gone.
    virtual child::DragChild* Child() const = 0;
    const RowModel& Model() const { return rows_; }
    virtual bool IsSelected(Position row) const = 0;

    // Answers for the child, in pixels of its inside.
    std::optional<Position> RowAtInside(QPointF point) const;
    QRectF PlaceInside(Position row) const;
    Position FirstVisible() const { return layout_.FirstVisible(Scrolled()); }
    void ScrollToTop(Position row);
    virtual void MakeVisible(Position row);

    // What a view answers.
    QRect visualRect(const QModelIndex& index) const override;
    void scrollTo(const QModelIndex& index, ScrollHint hint = EnsureVisible) override;
    QModelIndex indexAt(const QPoint& point) const override;

  protected:
    static constexpr int edge = 4;  // pixels beside icons and texts

    /// What list and tree look like besides their rows.
    struct Look {
        bool hideSelection = false, fullRow = false, hot = false, enabled = true;
        frame::OLE_COLOR back, fore;
        bool border = true, flat = false;
        QFont font;
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
    /// Where the parts of a row's label stand in its cell, in pixels of the contents, and where the row is hit.
    struct Label {
        QRect icon, text, mark, reach;
    };
    /// How an icon is painted.
    struct IconLook {
        bool pale = false, tinted = false;
    };

    RowView(child::DragChild& child, const RowModel& rows);

    // What the child says of its rows. Asked while it is there.
    virtual Label LabelOf(Position row, const QString& text) const = 0;
    virtual std::optional<Position> FocusPosition() const = 0;
    virtual child::ImageList* Images() const = 0;
    virtual std::optional<RowKey> EditedRow() const = 0;

    // What it is told. Each may end it.
    virtual void ReportScroll(Position first) = 0;
    virtual void ReportEditWanted(Position row) = 0;
    virtual void ReportEditEnd(const std::string& text) = 0;
    virtual void ReportEditGivenUp() = 0;
    virtual void ReportSelection(Position row, Qt::KeyboardModifiers modifiers) = 0;

    // What the user does, after the report of the mouse or the key.
    virtual void PressAt(const QMouseEvent& event) = 0;
    virtual void ReleaseAt(const QMouseEvent&) {}
    /// What the press began ends without its release, which another window had.
    virtual void LosePress() {}
    /// The pointer is moved with the left button held; `isFar` by more than a click may.
    virtual void DragTo(bool /*isFar*/) {}
    virtual void DoubleClickAt(const QMouseEvent&) {}
    virtual void Hover(QPoint at);
    /// Whether the row under the pointer matters.
    virtual bool SensesRows() const { return look_.hot; }
    /// Whether the key means something to the child.
    virtual bool ActByKey(const QKeyEvent& event) = 0;
    /// The first row from one on, and round to it, that begins with a text without regard to case.
    virtual std::optional<Position> FindFrom(Position first, const QString& text) const = 0;

    // Painting.
    virtual void PaintBehind(QPainter&) const {}
    virtual void PaintRow(QPainter& painter, Position row, const Colors& colors) = 0;
    virtual void PaintAbove(QPainter&, const QRect& /*exposed, in the contents*/, const Colors&) const {}
    virtual QString FullTextAt(QPoint viewport) const = 0;
    /// Whether scrolled pixels stay right.
    virtual bool ScrollsPixels() const { return true; }

    // Following.
    template <class Rows>
    static Look LookOf(const Rows& child, const child::ImageList* images) {
        return {.hideSelection = child.HideSelection(),
                .fullRow = child.FullRowSelect(),
                .hot = child.HotTracking(),
                .enabled = child.Enabled(),
                .back = child.BackColor(),
                .fore = child.ForeColor(),
                .border = static_cast<int>(child.BorderStyle()) != 0,
                .flat = child.Appearance() == child::AppearanceConstants::Flat,
                .font = ToQt(*child.Font()),
                .images = images,
                .imagesRevision = images ? images->Revision() : 0,
                .takesDrops = child.OLEDropMode() != child::OLEDropConstants::None,
                .pointer = child.MousePointer(),
                .pointerIcon = child.MouseIcon()};
    }
    void TakeLook(const Look& look);
    /// A widget that is not shown yet has its size all the same.
    void TakeSize();
    /// Whether all that has moved stands behind what is in view, by the layout as it is now.
    bool IsBehindView(const std::vector<child::RowChange>& changes) const;
    void FollowScroll(const std::vector<child::RowChange>& changes);
    void FollowFocus();
    void FollowEdit();
    void RememberSeen();
    /// The first row that is seen as a whole, as `Follow` began; 0 for none.
    RowKey FirstSeen() const { return seen_.empty() ? 0 : seen_.front().row; }
    /// Cells, contents and window into `layout_`, scroll bars by it. A row with the focus that was in view is not covered by a bar
    /// that comes.
    virtual void LayOut();
    /// As a whole, in the window of the last layout.
    bool IsFocusInView() const;
    void MakeFocusVisible();
    virtual void FitCells() = 0;
    virtual int SidewaysStep() const;
    void UpdateRows(Position first, Position count);

    // Geometry.
    QPoint Scrolled() const;
    void Scroll(QPoint offset);
    QRect ToViewport(QRect contents) const;
    QPoint ToContents(QPoint viewport) const;
    QPointF InsideOffset() const;
    virtual std::optional<Position> HitRow(QPoint viewport) const;
    QSize ImageSize() const;
    int LineHeight() const;
    /// A label in one line: an icon and the text beside it.
    Label LineLabel(QRect cell, int textWidth) const;
    QString LabelText(Position row) const { return OneLine(rows_.Text(static_cast<int>(row), 0)); }
    static QString OneLine(QString text);

    // Painting, in parts.
    Colors ColorsNow() const;
    bool ShowsMark() const { return !look_.hideSelection || hasFocus() || editor_; }
    void PaintMark(QPainter& painter, QRect contents, bool isMarked, bool isHot, const Colors& colors) const;
    void PaintIcon(QPainter& painter, QRect contents, const frame::Variant& key, IconLook how, const Colors& colors);
    void PaintLine(QPainter& painter, QRect viewport, const QString& text, Qt::Alignment alignment) const;
    void PaintFocus(QPainter& painter, QRect viewport, const QColor& back) const;
    /// Each text runs in its own direction, so that a name reads the same in a view from right to left.
    static void DirectBy(QPainter& painter, const QString& text);
    static bool IsDark(const QColor& color);
    static QColor Mixed(const QColor& first, const QColor& second, float share);

    // Input, in parts.
    /// Lets the host settle. False when the child has gone.
    bool Settle();
    QMouseEvent Inside(const QMouseEvent& event) const;
    void SelectByKeyboard(Position row, Qt::KeyboardModifiers modifiers);
    /// The row that a key moves to; nothing for a key that moves nowhere.
    std::optional<ListLayout::Step> StepOf(const QKeyEvent& event) const;
    /// The click that has begun on this row opens its edit, unless more comes.
    void EditByClick(Position row) { clickEdits_ = rows_.KeyAt(row); }
    void TypeAhead(const QString& typed);

    // The label edit.
    void BeginEdit(Position row);
    virtual QRect EditorPlace(Position row) const;
    QRect LineEditorPlace(Position row, int least) const;
    int WantedEditorWidth() const;
    void PlaceEditor();
    void EndEditor();

    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    int horizontalOffset() const override { return Scrolled().x(); }
    int verticalOffset() const override { return Scrolled().y(); }
    bool isIndexHidden(const QModelIndex&) const override { return false; }
    void setSelection(const QRect&, QItemSelectionModel::SelectionFlags) override {}
    QRegion visualRegionForSelection(const QItemSelection&) const override { return {}; }
    void updateGeometries() override { LayOut(); }
    void dataChanged(const QModelIndex& first, const QModelIndex& last, const QList<int>& roles) override;
    // What these do by themselves the child does.
    void rowsInserted(const QModelIndex&, int, int) override {}
    void rowsAboutToBeRemoved(const QModelIndex&, int, int) override {}

    bool viewportEvent(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;
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

    ListLayout layout_;
    QSize laidOutFor_;  // the view's size at that time
    Look look_;
    bool following_ = false;  // scrolling is not the user's
    std::optional<Position> hot_;
    QPoint pressedAt_, pointerAt_;
    Qt::KeyboardModifiers pressedWith_;
    QString typed_;
    QPointer<LabelEditor> editor_;

  private:
    struct Seen {
        RowKey row = 0;
        int place = 0;  // from the edge where the view begins
    };

    const RowModel& rows_;
    PointerInput pointer_;
    KeyInput* keys_;
    DropInput drops_;

    bool focusedByMouse_ = false;
    std::vector<Seen> seen_;  // what was in view lately
    std::unordered_map<const frame::Picture*, std::pair<frame::PictureRef, QPixmap>> icons_;
    double iconScale_ = 0;
    std::optional<RowKey> clickEdits_;  // the click was on the label of the selected row
    QBasicTimer editTimer_, typeTimer_;
    RowKey edited_ = 0;
};

}  // namespace tessel::qt
