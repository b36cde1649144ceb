#pragma once

#include <QSqlDatabase>

#include "apps/gallery/Page.h"
#include "hosts/qt/DataList.h"

class QCheckBox;
class QComboBox;
class QGridLayout;
class QLabel;
class QPlainTextEdit;

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
        QLabel* caption = nullptr;
        qt::DataList* list = nullptr;
        QLabel* says = nullptr;
    };
    QWidget* makeLists();
    Row makeRow(QGridLayout* grid, const QString& caption, const char* name);
    QLayout* makeChoices();
    QWidget* makeLog();
    void listen(qt::DataList* list);
    void log(const QString& line);

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
    QPlainTextEdit* log_ = nullptr;
};

}  // namespace tessel::gallery
