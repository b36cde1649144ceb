#pragma once

#include <QSqlDatabase>
#include <QSqlQuery>

#include "controls/datalist/DataList.h"
#include "hosts/qt/ControlWidget.h"

namespace tessel::qt {

/// What a user of a desktop expects of a list of pairs beside what the control does: it asks a layout for a useful width and for
/// the height of a combo box, the focus goes to the list that is shown, and a program fills it from a query in one line.
class DataListWidget : public ControlWidget {
    Q_OBJECT

  public:
    controls::DataList& dataList() const { return static_cast<controls::DataList&>(control()); }

    /// Fills the list from a query, which is run when it has not run yet, or from a table. A column is given by its name or its
    /// number. Gives the empty string, or what went wrong.
    QString populate(QSqlQuery& query, const QVariant& textColumn, const QVariant& valueColumn, const QVariant& defaultText = {},
                     const QVariant& defaultValue = {});
    QString populate(QSqlQuery&& query, const QVariant& textColumn, const QVariant& valueColumn, const QVariant& defaultText = {},
                     const QVariant& defaultValue = {}) {
        return populate(query, textColumn, valueColumn, defaultText, defaultValue);
    }
    QString populate(const QString& table, const QSqlDatabase& database, const QVariant& textColumn, const QVariant& valueColumn,
                     const QVariant& defaultText = {}, const QVariant& defaultValue = {});
    /// The same from rows of the program's own.
    QString populate(frame::Object& records, const QVariant& textColumn, const QVariant& valueColumn,
                     const QVariant& defaultText = {}, const QVariant& defaultValue = {});

    QSize minimumSizeHint() const override;

  protected:
    DataListWidget(const frame::ControlClass& controlClass, QWidget* parent);

    QSize preferredSize() const override;
    void started() override;
    void propertyChanged(std::string_view key) override;

  private:
    void followActive();
    int listHeight() const;
};

}  // namespace tessel::qt
