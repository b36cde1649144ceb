#pragma once

#include <QAbstractListModel>

#include "frame/child/ComboList.h"

namespace tessel::qt {

/// The rows of a drop-down list as a model that holds none of them.
class ComboListModel final : public QAbstractListModel {
    Q_OBJECT

  public:
    ComboListModel(const child::ComboList& list, QObject* parent) : QAbstractListModel(parent), list_(&list) {}
    /// The list goes: the model is empty from now on.
    void Disconnect();
    /// Reads all anew where rows have changed. Gives whether they have.
    bool Follow();
    /// Whether the model shows the list as it is.
    bool IsFresh() const { return list_ && revision_ == list_->Revision(); }

    int rowCount(const QModelIndex& parent = {}) const override { return parent.isValid() ? 0 : rows_; }
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    /// Type-ahead asks for the next row whose text begins so; that is searched in the list's own texts.
    QModelIndexList match(const QModelIndex& start, int role, const QVariant& value, int hits, Qt::MatchFlags flags) const override;

  private:
    const child::ComboList* list_;  // null once it has gone
    std::uint64_t revision_ = 0;
    int rows_ = 0;
};

}  // namespace tessel::qt
