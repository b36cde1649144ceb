#include "hosts/qt/DataListWidget.h"

#include "hosts/qt/Convert.h"
#include "hosts/qt/SqlRecordset.h"

namespace tessel::qt {

DataListWidget::DataListWidget(const frame::ControlClass& controlClass, QWidget* parent) : ControlWidget(controlClass, parent) {
    setSizePolicy(QSizePolicy::Preferred, QSizePolicy::Fixed);
}

QString DataListWidget::populate(QSqlQuery& query, const QVariant& textColumn, const QVariant& valueColumn,
                                 const QVariant& defaultText, const QVariant& defaultValue) {
    SqlRecordset records(query);
    return populate(records, textColumn, valueColumn, defaultText, defaultValue);
}

QString DataListWidget::populate(const QString& table, const QSqlDatabase& database, const QVariant& textColumn,
                                 const QVariant& valueColumn, const QVariant& defaultText, const QVariant& defaultValue) {
    SqlRecordset records(table, database);
    return populate(records, textColumn, valueColumn, defaultText, defaultValue);
}

QString DataListWidget::populate(frame::Object& records, const QVariant& textColumn, const QVariant& valueColumn,
                                 const QVariant& defaultText, const QVariant& defaultValue) {
    return call("Populate", {QVariant::fromValue(frame::ObjectRef(records)), textColumn, valueColumn, defaultText, defaultValue})
        .toString();
}

int DataListWidget::listHeight() const { return Pixels(dataList().listItems[0].Height()); }

QSize DataListWidget::preferredSize() const {
    constexpr int letters = 24;
    return {textArea(letters, 1).width(), listHeight()};
}

QSize DataListWidget::minimumSizeHint() const {
    if (!isSettled()) return sizeHint();
    constexpr int letters = 8;
    return {textArea(letters, 1).width(), listHeight()};
}

void DataListWidget::started() {
    followActive();
    updateGeometry();
}

void DataListWidget::propertyChanged(std::string_view key) {
    ControlWidget::propertyChanged(key);
    if (key == "Font") updateGeometry();
    // The setter goes on to show the other list when it has told.
    if (key == "Sorted")
        QMetaObject::invokeMethod(
            this, [this] { followActive(); }, Qt::QueuedConnection);
}

void DataListWidget::followActive() {
    controls::DataList& list = dataList();
    const bool focused = hasFocus();
    const auto& lists = list.listItems;
    giveFocusTo(lists[1].Visible() ? lists[1] : lists[0]);
    if (focused) setFocus();
}

}  // namespace tessel::qt
