#pragma once

#include <QDate>
#include <QMap>

#include "apps/gallery/Page.h"
#include "hosts/qt/Splitter.h"

class QCalendarWidget;
class QComboBox;
class QPlainTextEdit;
class QTableWidget;

namespace tessel::gallery {

/// A planner in four panes: a calendar, notes for its days, what things cost, and that as a chart. Three bars part them; two of the
/// bars are themselves moved by the third.
class PanesPage final : public Page {
    Q_OBJECT

  public:
    explicit PanesPage(QWidget* parent = nullptr);

    QString title() const override { return "Panes"; }
    QString hint() const override { return tr("Drag a bar, or go to it with the Tab key and use the arrow keys, Home and End."); }
    QStringList poses() const override { return {"grooved", "serrated", "raised"}; }
    void pose(const QString& name) override;

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    class Chart;

    QWidget* makeChoices();
    void makePanes();
    qt::Splitter* makeBar(const char* name, qt::Splitter::tsOrientation orientation, const QString& before, const QString& behind);
    /// Gives the panes the whole area, parted where the bars stand in relation to it.
    void layOut();
    /// Keeps where the bars stand in relation to the area.
    void keepParts();
    void chooseDay();
    void chooseAppearance(const QString& name);

    QComboBox* appearances_ = nullptr;
    QWidget* area_;  // the form of the bars, without a layout
    QCalendarWidget* calendar_ = nullptr;
    QPlainTextEdit* notes_ = nullptr;
    QTableWidget* costs_ = nullptr;
    Chart* chart_ = nullptr;
    qt::Splitter *middle_ = nullptr, *left_ = nullptr, *right_ = nullptr;
    double middlePart_ = 0.42, leftPart_ = 0.55, rightPart_ = 0.45;
    QMap<QDate, QString> notesOfDays_;
    QDate day_;  // whose notes are shown
};

}  // namespace tessel::gallery
