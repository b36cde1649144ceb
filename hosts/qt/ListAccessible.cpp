#include "hosts/qt/ListAccessible.h"

#include <QPointer>
#include <algorithm>

#include "hosts/qt/Convert.h"
#include "hosts/qt/ListWidget.h"

namespace tessel::qt {

using Position = child::ListRows::Position;

namespace {

ListAccessible* TableOf(ListWidget& list) { return static_cast<ListAccessible*>(QAccessible::queryAccessibleInterface(&list)); }

QAccessibleInterface* MakeAccessible(const QString&, QObject* object) {
    auto* list = qobject_cast<ListWidget*>(object);
    return list ? new ListAccessible(*list) : nullptr;
}

/// The header of a column.
class HeaderCell final : public QAccessibleInterface {
  public:
    HeaderCell(ListWidget& list, int column) : list_(&list), column_(column) {}

    bool isValid() const override { return list_ && list_->List() && column_ < list_->Header().count(); }
    QObject* object() const override { return nullptr; }
    QAccessible::Role role() const override { return QAccessible::ColumnHeader; }
    QAccessible::State state() const override {
        QAccessible::State state;
        state.invalid = !isValid();
        return state;
    }
    QString text(QAccessible::Text which) const override {
        if (!isValid() || which != QAccessible::Name) return {};
        return list_->Model().headerData(column_, Qt::Horizontal).toString();
    }
    void setText(QAccessible::Text, const QString&) override {}
    QRect rect() const override {
        if (!isValid()) return {};
        const ListHeader& header = list_->Header();
        const QRect place(header.sectionViewportPosition(column_), 0, header.sectionSize(column_), header.height());
        return {header.mapToGlobal(place.topLeft()), place.size()};
    }
    QAccessibleInterface* parent() const override { return list_ ? TableOf(*list_) : nullptr; }
    QAccessibleInterface* child(int) const override { return nullptr; }
    QAccessibleInterface* childAt(int, int) const override { return nullptr; }
    int childCount() const override { return 0; }
    int indexOfChild(const QAccessibleInterface*) const override { return -1; }
    int Column() const { return column_; }

  private:
    QPointer<ListWidget> list_;
    int column_;
};

}  // namespace

void ListAccessible::Install() {
    static const bool installed = (QAccessible::installFactory(MakeAccessible), true);
    Q_UNUSED(installed);
}

ListAccessible::ListAccessible(ListWidget& list) : RowAccessible(list, QAccessible::List), list_(list) {}

ListAccessible::~ListAccessible() { ForgetHeaders(); }

void ListAccessible::Forget() const {
    RowAccessible::Forget();
    ForgetHeaders();
}

void ListAccessible::ForgetHeaders() const {
    for (const QAccessible::Id id : std::as_const(headers_)) QAccessible::deleteAccessibleInterface(id);
    headers_.clear();
}

QAccessible::Role ListAccessible::CellRole() const {
    return role() == QAccessible::Table ? QAccessible::Cell : QAccessible::ListItem;
}

void ListAccessible::AddState(int, QAccessible::State& state) const {
    state.multiSelectable = state.extSelectable = list_.List()->MultiSelect();
}

QList<QAccessibleInterface*> ListAccessible::HeadersOf(int column) const {
    return HeaderRows() > 0 ? QList<QAccessibleInterface*>{child(column)} : QList<QAccessibleInterface*>();
}

QAccessible::Role ListAccessible::role() const {
    const bool isReport = list_.List() && list_.List()->View() == child::ListViewConstants::Report;
    return isReport ? QAccessible::Table : QAccessible::List;
}

QAccessible::State ListAccessible::state() const {
    QAccessible::State state = QAccessibleWidget::state();
    state.multiSelectable = state.extSelectable = list_.List() && list_.List()->MultiSelect();
    return state;
}

int ListAccessible::HeaderRows() const { return role() == QAccessible::Table && list_.Header().isVisibleTo(&list_) ? 1 : 0; }

int ListAccessible::ColumnAt(int place) const {
    if (role() != QAccessible::Table) return place == 0 ? 0 : -1;
    for (int visual = 0; visual < list_.Header().count(); ++visual) {
        const int column = list_.Header().logicalIndex(visual);
        if (!list_.Header().isSectionHidden(column) && place-- == 0) return column;
    }
    return -1;
}

int ListAccessible::PlaceOf(int column) const {
    if (role() != QAccessible::Table) return 0;
    int place = 0;
    for (int visual = 0; visual < list_.Header().visualIndex(column); ++visual)
        if (!list_.Header().isSectionHidden(list_.Header().logicalIndex(visual))) ++place;
    return place;
}

int ListAccessible::columnCount() const {
    return role() == QAccessible::Table ? list_.Header().count() - list_.Header().hiddenSectionCount() : 1;
}

int ListAccessible::childCount() const { return (rowCount() + HeaderRows()) * columnCount(); }

QAccessibleInterface* ListAccessible::child(int index) const {
    if (index < 0 || index >= childCount()) return nullptr;
    const int column = ColumnAt(index % columnCount()), row = index / columnCount() - HeaderRows();
    return row < 0 ? HeaderOf(column) : CellOf(list_.Model().index(row, column));
}

QAccessibleInterface* ListAccessible::HeaderOf(int column) const {
    const auto found = headers_.find(column);
    if (found != headers_.end()) return QAccessible::accessibleInterface(*found);
    auto* cell = new HeaderCell(list_, column);
    headers_[column] = QAccessible::registerAccessibleInterface(cell);
    return cell;
}

QAccessibleInterface* ListAccessible::childAt(int x, int y) const {
    if (HeaderRows() > 0) {
        const QPoint at = list_.Header().mapFromGlobal(QPoint(x, y));
        if (list_.Header().rect().contains(at)) {
            const int column = list_.Header().logicalIndexAt(at);
            return column >= 0 ? HeaderOf(column) : nullptr;
        }
    }
    return RowAccessible::childAt(x, y);
}

int ListAccessible::indexOfChild(const QAccessibleInterface* child) const {
    if (const auto* header = dynamic_cast<const HeaderCell*>(child)) return PlaceOf(header->Column());
    return RowAccessible::indexOfChild(child);
}

int ListAccessible::selectedRowCount() const { return list_.List() ? static_cast<int>(list_.List()->Rows().SelectedCount()) : 0; }

QList<int> ListAccessible::selectedRows() const {
    QList<int> rows;
    for (int row = 0; rows.size() < selectedRowCount() && row < rowCount(); ++row)
        if (isRowSelected(row)) rows << row;
    return rows;
}

QString ListAccessible::columnDescription(int column) const {
    return list_.Model().headerData(ColumnAt(column), Qt::Horizontal).toString();
}

bool ListAccessible::selectRow(int row) {
    if (!list_.List() || row < 0 || row >= rowCount()) return false;
    if (list_.List()->MultiSelect()) {
        const child::RowRange rows{static_cast<Position>(row), 1};
        list_.List()->SelectionInput({&rows, 1}, {});
    } else {
        list_.List()->SelectInput(row + 1, child::ListSelectConstants::Only);
    }
    return true;
}

bool ListAccessible::unselectRow(int row) {
    if (!isRowSelected(row)) return false;
    const child::RowRange rows{static_cast<Position>(row), 1};
    list_.List()->SelectionInput({}, {&rows, 1});
    return true;
}

}  // namespace tessel::qt
