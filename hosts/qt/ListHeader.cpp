#include "hosts/qt/ListHeader.h"

#include <QPixmap>
#include <QScopedValueRollback>
#include <QStyleOptionHeader>

#include "hosts/qt/Convert.h"

namespace tessel::qt {

ListHeader::ListHeader(child::ListView& list, QWidget* parent) : QHeaderView(Qt::Horizontal, parent), list_(&list) {
    setMinimumSectionSize(1);
    setSectionsClickable(true);
    setHighlightSections(false);
    setStretchLastSection(false);
    setFocusPolicy(Qt::NoFocus);
    connect(this, &QHeaderView::sectionClicked, this, [this](int column) { Report([&] { list_->ColumnClickInput(column + 1); }); });
    connect(this, &QHeaderView::sectionResized, this,
            [this](int column, int, int width) { Report([&] { list_->ColumnWidthInput(column + 1, Twips(width)); }); });
    connect(this, &QHeaderView::sectionMoved, this,
            [this](int column, int, int place) { Report([&] { list_->ColumnMoveInput(column + 1, place + 1); }); });
    connect(this, &QHeaderView::sectionHandleDoubleClicked, this, [this](int column) {
        if (!following_ && list_) emit fitWanted(column);
    });
}

template <class F>
void ListHeader::Report(F&& input) {
    if (following_ || !list_) return;
    input();
}

bool ListHeader::Follow() {
    if (!list_) return false;
    const child::ColumnHeaders& headers = list_->ColumnHeaders;
    const child::ImageList* const images = list_->ColumnHeaderIcons();
    const std::uint32_t imagesRevision = images ? images->Revision() : 0;
    setSectionsMovable(list_->AllowColumnReorder());
    if (images != images_ || imagesRevision != imagesRevision_) viewport()->update();
    const bool otherHeight = (images != nullptr) != (images_ != nullptr);
    images_ = images;
    imagesRevision_ = imagesRevision;
    if (headers.Revision() == revision_) return otherHeight;
    revision_ = headers.Revision();
    const QScopedValueRollback following(following_, true);
    for (int column = 0; column < count(); ++column) {
        const bool isKnown = column < headers.Count();
        const int width = isKnown ? Pixels(headers.Item(column + 1).Width()) : 0;
        // A list without headers shows its texts all the same.
        setSectionHidden(column, isKnown && headers.Item(column + 1).Width() <= 0);
        if (isKnown && !isSectionHidden(column) && sectionSize(column) != width) resizeSection(column, std::max(1, width));
    }
    for (int place = 0; place < headers.Count() && place < count(); ++place) {
        const int from = visualIndex(headers.InView(place + 1).Index() - 1);
        if (from != place) moveSection(from, place);
    }
    viewport()->update();
    return true;
}

QSize ListHeader::sizeHint() const {
    const QSize size = QHeaderView::sizeHint();
    if (!images_) return size;
    QStyleOptionHeader option;
    initStyleOption(&option);
    const int side = style()->pixelMetric(QStyle::PM_SmallIconSize, nullptr, this);
    option.icon = QPixmap(side, side);
    option.text = "A";
    return size.expandedTo({0, style()->sizeFromContents(QStyle::CT_HeaderSection, &option, {}, this).height()});
}

}  // namespace tessel::qt
