#include "apps/gallery/PanesPage.h"

#include <gtest/gtest.h>

#include <QCalendarWidget>
#include <QComboBox>
#include <QPlainTextEdit>
#include <QTest>
#include <QWindow>

namespace tessel::gallery {
namespace {

class PanesPageTest : public testing::Test {
  protected:
    PanesPageTest() {
        page_.resize(800, 600);
        page_.show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(&page_));
    }
    QWidget* Named(const char* name) { return page_.findChild<QWidget*>(name); }
    qt::Splitter* Bar(const char* name) { return page_.findChild<qt::Splitter*>(name); }
    QRect Place(const char* name) { return Named(name)->geometry(); }
    /// Whether the panes and bars cover the area without a gap and without standing over each other.
    bool FillTheArea() {
        const QRect area = Named("panesArea")->rect();
        QRegion covered;
        int sum = 0;
        for (const char* name : {"calendar", "leftBar", "chart", "middleBar", "notes", "rightBar", "costs"}) {
            covered += Place(name);
            sum += Place(name).width() * Place(name).height();
        }
        return covered == QRegion(area) && sum == area.width() * area.height();
    }
    void Drag(const char* bar, QPoint by) {
        QWidget* widget = Named(bar);
        const QPoint from = widget->mapTo(&page_, widget->rect().center());
        QTest::mousePress(page_.windowHandle(), Qt::LeftButton, {}, from);
        for (int part = 1; part <= 4; ++part) QTest::mouseMove(page_.windowHandle(), from + by * part / 4);
        QTest::mouseRelease(page_.windowHandle(), Qt::LeftButton, {}, from + by);
    }

    PanesPage page_;
};

TEST_F(PanesPageTest, ThePanesFillTheAreaAtAnySize) {
    EXPECT_TRUE(FillTheArea());
    for (const QSize size : {QSize(500, 400), QSize(1201, 777), QSize(640, 480)}) {
        page_.resize(size);
        QCoreApplication::processEvents();
        EXPECT_TRUE(FillTheArea()) << size.width();
    }
}

TEST_F(PanesPageTest, TheMiddleBarMovesTheOtherTwo) {
    const QRect left = Place("leftBar"), right = Place("rightBar");
    Drag("middleBar", {60, 0});
    EXPECT_EQ(Place("leftBar").width(), left.width() + 60);
    EXPECT_EQ(Place("rightBar").x(), right.x() + 60);
    EXPECT_TRUE(FillTheArea());
    Drag("rightBar", {0, -40});
    EXPECT_EQ(Place("rightBar").y(), right.y() - 40);
    EXPECT_TRUE(FillTheArea());
}

TEST_F(PanesPageTest, ABarKeepsItsPartWhenThePageGrows) {
    Drag("middleBar", {100, 0});
    const double part = static_cast<double>(Place("middleBar").x()) / Named("panesArea")->width();
    page_.resize(1200, 900);
    QCoreApplication::processEvents();
    EXPECT_NEAR(static_cast<double>(Place("middleBar").x()) / Named("panesArea")->width(), part, 0.002);
    EXPECT_TRUE(FillTheArea());
}

TEST_F(PanesPageTest, NoPaneIsSqueezedAway) {
    Drag("leftBar", {0, 2000});
    EXPECT_GE(Place("chart").height(), 90);
    Drag("middleBar", {-2000, 0});
    EXPECT_GE(Place("calendar").width(), 90);
    EXPECT_TRUE(FillTheArea());
}

TEST_F(PanesPageTest, TheLookOfTheBarsIsChosen) {
    auto* choice = page_.findChild<QComboBox*>("appearances");
    choice->setCurrentIndex(choice->findText("Serrated"));
    for (const char* bar : {"middleBar", "leftBar", "rightBar"}) EXPECT_EQ(Bar(bar)->appearance(), qt::Splitter::tsSerrated);
}

TEST_F(PanesPageTest, EachDayHasItsNotes) {
    auto* calendar = page_.findChild<QCalendarWidget*>("calendar");
    auto* notes = page_.findChild<QPlainTextEdit*>("notes");
    calendar->setSelectedDate({2001, 2, 3});
    notes->setPlainText("the party");
    calendar->setSelectedDate({2001, 2, 4});
    EXPECT_EQ(notes->toPlainText(), "");
    calendar->setSelectedDate({2001, 2, 3});
    EXPECT_EQ(notes->toPlainText(), "the party");
}

}  // namespace
}  // namespace tessel::gallery
