#include "apps/gallery/FileStatus.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QLocale>

namespace tessel::gallery {

FileStatus::FileStatus(qt::FileView* files, QWidget* parent)
    : QWidget(parent), files_(files), count_(new QLabel), size_(new QLabel) {
    count_->setObjectName("count");
    size_->setObjectName("size");
    auto* row = new QHBoxLayout(this);
    row->setContentsMargins({});
    row->addWidget(count_);
    row->addStretch(1);
    row->addWidget(size_);
    connect(files_, &qt::FileView::beforePaint, size_, &QLabel::clear);
    connect(files_, &qt::FileView::afterAddItem, this, [this] {
        constexpr int often = 256;
        if (files_->itemCount() % often == 0) followCount();
    });
    connect(files_, &qt::FileView::afterPaint, this, [this] {
        followCount();
        followSize();
    });
    connect(files_, &qt::FileView::totalSizeReady, this, &FileStatus::followSize);
}

void FileStatus::setSearched(const QString& folder) {
    searched_ = folder;
    size_->clear();
}

void FileStatus::waitForSize() {
    Q_UNUSED(files_->totalSize());
    followSize();
}

void FileStatus::followCount() {
    const int count = files_->itemCount();
    const QString number = QLocale().toString(count);
    if (!searched_.isEmpty())
        count_->setText(count == 1 ? tr("1 file found below %1").arg(searched_)
                                   : tr("%1 files found below %2").arg(number, searched_));
    else
        count_->setText(count == 1 ? tr("1 item") : tr("%1 items").arg(number));
}

void FileStatus::followSize() {
    if (!files_->totalSizeKnown()) {
        size_->setText(tr("measuring…"));
        return;
    }
    const auto bytes = static_cast<qint64>(files_->totalSize().toDouble());
    size_->setText(tr("%1 in all").arg(QLocale().formattedDataSize(bytes, 1, QLocale::DataSizeTraditionalFormat)));
}

}  // namespace tessel::gallery
