#pragma once

#include <QHeaderView>

#include "frame/child/ListView.h"

namespace tessel::qt {

/// The headers of a report: follows the columns of a list, their order, widths and icons, and reports what the user does to them.
/// Columns of width 0 are hidden. Where the list has images for headers they are as high as one with an image, whether one is seen
/// or not: rows keep their places when a sort shows its arrow.
class ListHeader final : public QHeaderView {
    Q_OBJECT

  public:
    ListHeader(child::ListView& list, QWidget* parent);
    void Disconnect() { list_ = nullptr; }
    /// True when columns have come to stand elsewhere, or the headers want another height.
    bool Follow();
    QSize sizeHint() const override;

  signals:
    /// The user has asked that a column becomes as wide as what is seen of it, by clicking its edge twice.
    void fitWanted(int column);

  private:
    template <class F>
    void Report(F&& input);

    child::ListView* list_;  // null once it has gone
    bool following_ = false;
    std::uint32_t revision_ = 0;
    const child::ImageList* images_ = nullptr;
    std::uint32_t imagesRevision_ = 0;
};

}  // namespace tessel::qt
