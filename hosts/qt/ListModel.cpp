#include "hosts/qt/ListModel.h"

#include <algorithm>
#include <array>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

using child::RowRef;

Qt::Alignment ToQt(child::AlignmentConstants alignment) {
    static constexpr std::array alignments = {Qt::AlignLeft, Qt::AlignRight, Qt::AlignHCenter};
    const auto number = static_cast<std::size_t>(alignment);
    return number < alignments.size() ? alignments[number] : Qt::AlignLeft;
}

void ListModel::Follow(const std::vector<child::RowChange>& changes) {
    if (!IsConnected()) return;
    FollowHeaders();
    FollowRows(changes);
}

void ListModel::FollowHeaders() {
    if (headers_ == list_.ColumnHeaders.Revision()) return;
    headers_ = list_.ColumnHeaders.Revision();
    const int columns = std::max(1, static_cast<int>(list_.ColumnHeaders.Count()));
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

std::optional<RowModel::Position> ListModel::PositionOf(RowKey key) const {
    const RowRef row{NumberOf(key), SerialOf(key)};
    return list_.Rows().Lives(row) ? std::optional(list_.Rows().PositionOf(row.row)) : std::nullopt;
}

QString ListModel::HeldText(Position position, int column) const {
    return ToQt(list_.Rows().Text(list_.Rows().At(position), column));
}

QPixmap ListModel::HeldIcon(Position position, int column) const {
    if (column != 0 || !list_.SmallIcons()) return {};
    return IconOf(list_.SmallIcons(), list_.Rows().Icon(list_.Rows().At(position), child::IconSize::Small), 1);
}

QVariant ListModel::data(const QModelIndex& index, int role) const {
    if (role != Qt::TextAlignmentRole) return RowModel::data(index, role);
    if (!IsConnected() || !index.isValid() || index.column() >= list_.ColumnHeaders.Count()) return {};
    return QVariant(ToQt(list_.ColumnHeaders.Item(index.column() + 1).Alignment()) | Qt::AlignVCenter);
}

QVariant ListModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (!IsConnected() || orientation != Qt::Horizontal || section < 0 || section >= list_.ColumnHeaders.Count()) return {};
    const child::ColumnHeader& header = list_.ColumnHeaders.Item(section + 1);
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
        const QPixmap pixels = IconOf(list_.ColumnHeaderIcons(), icon, scale);
        if (!pixels.isNull()) result.addPixmap(pixels);
    }
    return result;
}

}  // namespace tessel::qt
