#include "hosts/qt/RowModel.h"

#include <algorithm>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

using child::RowChange;
using Position = RowModel::Position;

namespace {

// An index carries the row that it was made for.
static_assert(sizeof(quintptr) >= sizeof(std::uint64_t));
constexpr int numberBits = 32;

}  // namespace

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

bool Moves(const RowChange& change) { return change.kind != RowChange::Kind::Changed; }

RowModel::RowKey RowModel::KeyFor(std::uint32_t number, std::uint32_t serial) {
    return static_cast<RowKey>(serial) << numberBits | number;
}

std::uint32_t RowModel::SerialOf(RowKey key) { return static_cast<std::uint32_t>(key >> numberBits); }

void RowModel::Disconnect() {
    if (!connected_) return;
    beginResetModel();
    connected_ = false;
    rows_ = 0;
    endResetModel();
}

void RowModel::FollowRows(std::span<const RowChange> changes) {
    if (changes.empty()) return;
    const int count = static_cast<int>(HeldRows());
    const auto reset = [](const RowChange& change) { return change.kind == RowChange::Kind::Reset; };
    if (std::any_of(changes.begin(), changes.end(), reset)) {
        beginResetModel();
        rows_ = count;
        endResetModel();
        return;
    }
    const auto steps = static_cast<std::size_t>(std::count_if(changes.begin(), changes.end(), Moves));
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
    emit dataChanged(index(top, 0), index(std::min(bottom, rows_) - 1, columnCount() - 1));
}

void RowModel::Rearrange() {
    const int count = static_cast<int>(HeldRows());
    if (count > rows_) {
        beginInsertRows({}, rows_, count - 1);
        rows_ = count;
        endInsertRows();
    }
    emit layoutAboutToBeChanged();
    QModelIndexList from, to;
    const auto moved = [&](const QModelIndex& index) {
        const auto position = PositionOf(index.internalId());
        from << index;
        to << (position ? createIndex(static_cast<int>(*position), index.column(), index.internalId()) : QModelIndex());
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

QModelIndex RowModel::index(int row, int column, const QModelIndex& parent) const {
    if (!connected_ || parent.isValid() || row < 0 || row >= rows_ || column < 0 || column >= columnCount()) return {};
    const auto position = HeldAt(row);
    return createIndex(row, column, position ? KeyAt(*position) : 0);
}

// The child is ahead of what was told of it: those who hear that a step comes still see the rows before it.
std::optional<Position> RowModel::HeldAt(int row) const {
    auto position = static_cast<Position>(row);
    if (position >= coming_.first && coming_.kind == RowChange::Kind::Inserted) position += coming_.count;
    if (position >= coming_.first && coming_.kind == RowChange::Kind::Removed) {
        if (position - coming_.first < coming_.count) return std::nullopt;
        position -= coming_.count;
    }
    return position < HeldRows() ? std::optional(position) : std::nullopt;
}

QString RowModel::Text(int row, int column) const {
    const auto position = connected_ ? HeldAt(row) : std::nullopt;
    return position ? HeldText(*position, column) : QString();
}

QVariant RowModel::data(const QModelIndex& index, int role) const {
    if (!connected_ || !index.isValid()) return {};
    const auto position = HeldAt(index.row());
    if (!position) return {};
    if (role == Qt::DisplayRole || role == Qt::EditRole) return HeldText(*position, index.column());
    if (role != Qt::DecorationRole) return {};
    const QPixmap icon = HeldIcon(*position, index.column());
    return icon.isNull() ? QVariant() : QVariant(icon);
}

Qt::ItemFlags RowModel::flags(const QModelIndex& index) const {
    if (!index.isValid()) return {};
    return Qt::ItemIsSelectable | Qt::ItemIsEnabled | Qt::ItemNeverHasChildren;
}

}  // namespace tessel::qt
