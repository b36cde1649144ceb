#include "hosts/qt/ListModel.h"

#include <QIcon>
#include <QPixmap>
#include <algorithm>
#include <array>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

using child::RowChange;
using child::RowRef;
using Position = child::ListRows::Position;

namespace {

// An index carries the row that it was made for.
static_assert(sizeof(quintptr) >= sizeof(std::uint64_t));
constexpr int rowBits = 32;

quintptr IdOf(RowRef row) { return static_cast<quintptr>(row.serial) << rowBits | row.row; }
RowRef RowOf(quintptr id) { return {static_cast<child::RowId>(id), static_cast<std::uint32_t>(id >> rowBits)}; }

bool IsChanged(const RowChange& change) { return change.kind == RowChange::Kind::Changed; }

}  // namespace

Qt::Alignment ToQt(child::AlignmentConstants alignment) {
    static constexpr std::array alignments = {Qt::AlignLeft, Qt::AlignRight, Qt::AlignHCenter};
    const auto number = static_cast<std::size_t>(alignment);
    return number < alignments.size() ? alignments[number] : Qt::AlignLeft;
}

QPixmap IconOf(child::ImageList* images, const frame::Variant& icon, double scale) {
    const child::ListImage* image = images ? images->Images().Find(icon) : nullptr;
    if (!image || !image->ShownPicture()) return {};
    const QImage pixels = ToQt(*image->ShownPicture(), scale);
    if (pixels.isNull()) return {};
    const QSize size = QSizeF(images->ImageWidth() * scale, images->ImageHeight() * scale).toSize();
    QPixmap result =
        QPixmap::fromImage(pixels.size() == size ? pixels : pixels.scaled(size, Qt::IgnoreAspectRatio, Qt::SmoothTransformation));
    result.setDevicePixelRatio(scale);
    return result;
}

void ListModel::Disconnect() {
    if (!list_) return;
    beginResetModel();
    list_ = nullptr;
    rows_ = 0;
    endResetModel();
}

void ListModel::Follow(const std::vector<RowChange>& changes) {
    if (!list_) return;
    FollowHeaders();
    FollowRows(changes);
}

void ListModel::FollowHeaders() {
    if (headers_ == list_->ColumnHeaders.Revision()) return;
    headers_ = list_->ColumnHeaders.Revision();
    const int columns = std::max(1, static_cast<int>(list_->ColumnHeaders.Count()));
    if (columns > columns_) {
        beginInsertColumns({}, columns_, columns - 1);
        columns_ = columns;
        endInsertColumns();
    } else if (columns < columns_) {
        beginRemoveColumns({}, columns, columns_ - 1);
        columns_ = columns;
        endRemoveColumns();
    }
    emit headerDataChanged(Qt::Horizontal, 0, columns_ - 1);
}

void ListModel::FollowRows(std::span<const RowChange> changes) {
    if (changes.empty()) return;
    const int count = static_cast<int>(list_->Rows().Count());
    const auto reset = [](const RowChange& change) { return change.kind == RowChange::Kind::Reset; };
    if (std::any_of(changes.begin(), changes.end(), reset)) {
        beginResetModel();
        rows_ = count;
        endResetModel();
        return;
    }
    const auto steps = static_cast<std::size_t>(std::count_if(changes.begin(), changes.end(), std::not_fn(IsChanged)));
    if (steps > 1 || (steps == 1 && changes.size() > 1)) return Rearrange();
    const RowChange& change = changes.front();
    const int first = static_cast<int>(change.first), end = static_cast<int>(change.first + change.count);
    switch (change.kind) {
        case RowChange::Kind::Inserted:
            coming_ = change;
            beginInsertRows({}, first, end - 1);
            coming_ = {RowChange::Kind::Changed, 0, 0};
            rows_ = count;
            return endInsertRows();
        case RowChange::Kind::Removed:
            coming_ = change;
            beginRemoveRows({}, first, end - 1);
            coming_ = {RowChange::Kind::Changed, 0, 0};
            rows_ = count;
            return endRemoveRows();
        case RowChange::Kind::Reordered:
            return Rearrange();
        case RowChange::Kind::Changed:
        case RowChange::Kind::Reset:
            break;
    }
    int top = rows_, bottom = 0;
    for (const RowChange& step : changes) {
        top = std::min(top, static_cast<int>(step.first));
        bottom = std::max(bottom, static_cast<int>(step.first + step.count));
    }
    emit dataChanged(index(top, 0), index(std::min(bottom, rows_) - 1, columns_ - 1));
}

void ListModel::Rearrange() {
    const int count = static_cast<int>(list_->Rows().Count());
    if (count > rows_) {
        beginInsertRows({}, rows_, count - 1);
        rows_ = count;
        endInsertRows();
    }
    emit layoutAboutToBeChanged();
    QModelIndexList from, to;
    const auto moved = [&](const QModelIndex& index) {
        const RowRef row = RowOf(index.internalId());
        from << index;
        to << (list_->Rows().Lives(row)
                   ? createIndex(static_cast<int>(list_->Rows().PositionOf(row.row)), index.column(), IdOf(row))
                   : QModelIndex());
    };
    // Those who heard the signal have made more of them.
    for (const QModelIndex& index : persistentIndexList()) moved(index);
    changePersistentIndexList(from, to);
    emit layoutChanged();
    if (count == rows_) return;
    beginRemoveRows({}, count, rows_ - 1);
    rows_ = count;
    endRemoveRows();
}

QModelIndex ListModel::index(int row, int column, const QModelIndex& parent) const {
    if (!list_ || parent.isValid() || row < 0 || row >= rows_ || column < 0 || column >= columns_) return {};
    const auto position = PositionOf(row);
    const child::ListRows& rows = list_->Rows();
    return createIndex(row, column, position ? IdOf(rows.Ref(rows.At(*position))) : 0);
}

// The list is ahead of what was told of it: those who hear that a step comes still see the rows before it.
std::optional<Position> ListModel::PositionOf(int row) const {
    auto position = static_cast<Position>(row);
    if (position >= coming_.first && coming_.kind == RowChange::Kind::Inserted) position += coming_.count;
    if (position >= coming_.first && coming_.kind == RowChange::Kind::Removed) {
        if (position - coming_.first < coming_.count) return std::nullopt;
        position -= coming_.count;
    }
    return position < list_->Rows().Count() ? std::optional(position) : std::nullopt;
}

QString ListModel::Text(int row, int column) const {
    const auto position = list_ ? PositionOf(row) : std::nullopt;
    return position ? ToQt(list_->Rows().Text(list_->Rows().At(*position), column)) : QString();
}

QVariant ListModel::data(const QModelIndex& index, int role) const {
    if (!list_ || !index.isValid()) return {};
    const auto position = PositionOf(index.row());
    if (!position) return {};
    switch (role) {
        case Qt::DisplayRole:
        case Qt::EditRole:
            return Text(index.row(), index.column());
        case Qt::DecorationRole:
            if (index.column() != 0 || !list_->SmallIcons()) return {};
            return IconOf(list_->SmallIcons(), list_->Rows().Icon(list_->Rows().At(*position), child::IconSize::Small), 1);
        case Qt::TextAlignmentRole:
            if (index.column() >= list_->ColumnHeaders.Count()) return {};
            return QVariant(ToQt(list_->ColumnHeaders.Item(index.column() + 1).Alignment()) | Qt::AlignVCenter);
        default:
            return {};
    }
}

QVariant ListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (!list_ || orientation != Qt::Horizontal || section < 0 || section >= list_->ColumnHeaders.Count()) return {};
    const child::ColumnHeader& header = list_->ColumnHeaders.Item(section + 1);
    switch (role) {
        case Qt::DisplayRole:
            return ToQt(header.Text());
        case Qt::DecorationRole:
            return header.Icon().IsEmpty() ? QVariant() : QVariant(HeaderIcon(header.Icon()));
        case Qt::TextAlignmentRole:
            return QVariant(ToQt(header.Alignment()) | Qt::AlignVCenter);
        default:
            return {};
    }
}

QIcon ListModel::HeaderIcon(const frame::Variant& icon) const {
    QIcon result;
    for (const double scale : {1.0, 2.0, 3.0}) {
        const QPixmap pixels = IconOf(list_->ColumnHeaderIcons(), icon, scale);
        if (!pixels.isNull()) result.addPixmap(pixels);
    }
    return result;
}

Qt::ItemFlags ListModel::flags(const QModelIndex& index) const {
    if (!index.isValid()) return {};
    return Qt::ItemIsSelectable | Qt::ItemIsEnabled | Qt::ItemNeverHasChildren;
}

}  // namespace tessel::qt
