#pragma once

#include <QSqlDatabase>

#include "apps/gallery/Page.h"
#include "hosts/qt/DataList.h"

class QCheckBox;
class QComboBox;
class QFormLayout;
class QLabel;

namespace tessel::gallery {

/// Lists of pairs from a database: the languages of the world, and countries that lead to their subdivisions.
class ListsPage final : public Page {
    Q_OBJECT

  public:
    explicit ListsPage(QWidget* parent = nullptr);
    ~ListsPage() override;

    QString title() const override { return "Lists"; }
    QString hint() const override { return tr("Open a list and type the first letters of what you look for."); }
    QStringList poses() const override { return {"", "locked"}; }
    void pose(const QString& name) override;

  private:
    /// A list with what it has to say beside it.
    struct Row {
        qt::DataList* list = nullptr;
        QLabel* says = nullptr;
    };
    Row makeRow(QFormLayout* form, const QString& caption, const char* name);
    QLayout* makeChoices();

    void fill();
    void fillSubdivisions();
    QVariant defaultText() const;
    void tell(const Row& row);
    void say(const QString& problem);

    QSqlDatabase database_;
    Row countries_, subdivisions_, languages_;
    QCheckBox* sorted_ = nullptr;
    QCheckBox* locked_ = nullptr;
    QCheckBox* defaults_ = nullptr;
    QComboBox* style_ = nullptr;
    QLabel* problem_ = nullptr;
};

}  // namespace tessel::gallery
