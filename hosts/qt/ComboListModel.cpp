#include "hosts/qt/ComboListModel.h"

#include "hosts/qt/Convert.h"

namespace tessel::qt {

void ComboListModel::Disconnect() {
    beginResetModel();
    list_ = nullptr;
    rows_ = 0;
    endResetModel();
}

bool ComboListModel::Follow() {
    if (!list_ || IsFresh()) return false;
    beginResetModel();
    revision_ = list_->Revision();
    rows_ = list_->ListCount();
    endResetModel();
    return true;
}

QVariant ComboListModel::data(const QModelIndex& index, int role) const {
    if (!list_ || !index.isValid() || (role != Qt::DisplayRole && role != Qt::EditRole)) return {};
    // The list may be ahead of what is shown.
    if (index.row() >= list_->ListCount()) return {};
    return ToQt(list_->Rows().Text(static_cast<child::ComboRows::Position>(index.row())));
}

QModelIndexList ComboListModel::match(const QModelIndex& start, int role, const QVariant& value, int hits,
                                      Qt::MatchFlags flags) const {
    const bool typeAhead = hits == 1 && role == Qt::DisplayRole && (flags & Qt::MatchTypeMask) == Qt::MatchStartsWith &&
                           (flags & Qt::MatchWrap) && !(flags & Qt::MatchCaseSensitive);
    if (!typeAhead) return QAbstractListModel::match(start, role, value, hits, flags);
    if (!IsFresh()) return {};
    const auto from = static_cast<child::ComboRows::Position>(std::max(0, start.row()));
    const auto found = list_->Rows().FindStart(FromQt(value.toString()), from);
    if (!found) return {};
    return {index(static_cast<int>(*found), 0)};
}

}  // namespace tessel::qt
