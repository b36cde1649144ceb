#include "hosts/qt/Splitter.h"

#include <QAccessible>
#include <QLabel>
#include <QPushButton>
#include <random>

#include "hosts/qt/SurfaceWidget.h"
#include "tests/hosts/qt/OnScreen.h"
#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

using Appearance = Splitter::tsAppearance;

/// An upright bar between two panes that share the window.
class SplitterTest : public tessel::test::QtTest {
  protected:
    SplitterTest() {
        left = Pane("left", {0, 0, 100, 300});
        right = Pane("right", {108, 0, 292, 300});
        bar = new Splitter(window);
        bar->setObjectName("bar");
        bar->setOrientation(Splitter::tsVertical);
        bar->setGeometry(100, 0, 8, 300);
        bar->setControlsTopLeft("left");
        bar->setControlsBottomRight("right");
        QObject::connect(bar, &Splitter::afterMove, bar, [this](frame::Variant& dx, frame::Variant& dy) {
            heard.push_back("AfterMove " + dx.ToText() + " " + dy.ToText());
        });
    }
    QLabel* Pane(const char* name, QRect place) {
        auto* pane = new QLabel(window);
        pane->setObjectName(name);
        pane->setGeometry(place);
        return pane;
    }
    /// The pointer goes to a place of the window with the left button held.
    void DragTo(QPoint place) { QTest::mouseMove(window->windowHandle(), place); }
    void Drag(QPoint from, QPoint to) {
        Press(window, from);
        DragTo(to);
        Release(window, to);
    }
    QWidget* Surface() { return bar->findChild<SurfaceWidget*>(); }
    QColor PixelAt(int x, int y) { return test::PixelOf(*bar, x, y); }
    static QAccessibleInterface* Accessible(QWidget* widget) { return QAccessible::queryAccessibleInterface(widget); }

    QLabel *left, *right;
    Splitter* bar;
};

TEST_F(SplitterTest, ADragMovesTheBarAndTheWidgetsThatItNames) {
    Show();
    Drag({104, 150}, {154, 150});
    EXPECT_EQ(bar->geometry(), QRect(150, 0, 8, 300));
    EXPECT_EQ(left->geometry(), QRect(0, 0, 150, 300));
    EXPECT_EQ(right->geometry(), QRect(158, 0, 242, 300));
    EXPECT_EQ(Events(), "AfterMove 750 0");
    EXPECT_EQ(Errors(), "");
}

TEST_F(SplitterTest, ThePointerStaysWhereItWasPressedHoweverManySteps) {
    Show();
    Press(window, {103, 150});
    for (int x = 104; x <= 200; ++x) {
        DragTo({x, 150});
        ASSERT_EQ(bar->x(), x - 3);
    }
    for (int x = 190; x > 60; x -= 13) {
        DragTo({x, 150});
        DragTo({x, 150});  // a move that is none moves nothing
        ASSERT_EQ(bar->x(), x - 3);
    }
    Release(window, {65, 150});
    EXPECT_EQ(right->geometry().right(), 399);
}

TEST_F(SplitterTest, AnEventMadeBeforeTheBarMovedCountsByThePointersPlaceOnTheScreen) {
    Show();
    Press(window, {104, 150});
    const auto move = [&](QPointF local, QPoint inWindow) {
        QMouseEvent event(QEvent::MouseMove, local, local, window->mapToGlobal(QPointF(inWindow)), Qt::NoButton, Qt::LeftButton,
                          {});
        QCoreApplication::sendEvent(Surface(), &event);
    };
    move({24, 150}, {124, 150});
    EXPECT_EQ(bar->x(), 120);
    move({34, 150}, {134, 150});  // measured from where the bar stood first
    EXPECT_EQ(bar->x(), 130);
    move({34, 150}, {134, 150});
    EXPECT_EQ(bar->x(), 130);
    Release(window, {134, 150});
}

TEST_F(SplitterTest, AReleaseThatAnotherWindowHadEndsTheDrag) {
    Show();
    Press(window, {104, 150});
    DragTo({124, 150});
    EXPECT_EQ(bar->x(), 120);
    QObject::connect(bar, &Splitter::mouseUp, bar, [this](short& button) { heard.push_back("MouseUp " + std::to_string(button)); });
    heard.clear();
    // The button is held no more when the pointer comes back.
    QMouseEvent back(QEvent::MouseMove, QPointF(34, 150), QPointF(34, 150), window->mapToGlobal(QPointF(154, 150)), Qt::NoButton,
                     Qt::NoButton, {});
    QCoreApplication::sendEvent(Surface(), &back);
    EXPECT_EQ(bar->x(), 120);
    EXPECT_EQ(Events(), "MouseUp 1");
}

TEST_F(SplitterTest, ABarBetweenPixelsDoesNotTremble) {
    Show();
    bar->extender().Put("Left", 1506.5f);  // 100.43 pixels
    Press(window, {104, 150});
    DragTo({114, 150});
    heard.clear();
    EXPECT_NEAR(bar->extender().Get("Left").ToSingle(), 1656.5f, 0.01f);
    const float place = bar->extender().Get("Left").ToSingle();
    for (int again = 0; again < 5; ++again) DragTo({114, 150});
    EXPECT_NEAR(bar->extender().Get("Left").ToSingle(), place, 0.01f);
    DragTo({104, 150});
    EXPECT_NEAR(bar->extender().Get("Left").ToSingle(), 1506.5f, 0.01f);
    Release(window, {104, 150});
}

TEST_F(SplitterTest, TheLimitsHoldInADrag) {
    bar->setMinTopLeft(50 * 15);
    bar->setMinBottomRight(100 * 15);
    Show();
    Drag({104, 150}, {10, 150});
    EXPECT_EQ(bar->x(), 50);
    EXPECT_EQ(left->width(), 50);
    Drag({54, 150}, {395, 150});
    EXPECT_EQ(bar->x(), 400 - 100 - 8);
    EXPECT_EQ(right->width(), 100);
}

TEST_F(SplitterTest, OneOfAnArrayIsFoundByItsIndex) {
    for (int i = 0; i < 3; ++i) {
        QLabel* pane = Pane("cell", {0, 100 * i, 100, 100});
        pane->setProperty("Index", i);
    }
    bar->setControlsTopLeft(" left , CELL(1) ,nobody");
    Show();
    Drag({104, 150}, {124, 150});
    const auto cells = window->findChildren<QLabel*>("cell");
    EXPECT_EQ(cells[0]->width(), 100);
    EXPECT_EQ(cells[1]->width(), 120);
    EXPECT_EQ(cells[2]->width(), 100);
    EXPECT_EQ(left->width(), 120);
}

TEST_F(SplitterTest, AnotherBarMovesLikeAnyControl) {
    auto* across = new Splitter(window);
    across->setObjectName("across");
    across->setGeometry(108, 150, 292, 8);
    bar->setControlsBottomRight("right,across");
    Show();
    Drag({104, 50}, {124, 50});
    EXPECT_EQ(across->geometry(), QRect(128, 150, 272, 8));
    EXPECT_EQ(across->extender().Get("Left"), frame::Variant(1920.0f));
}

TEST_F(SplitterTest, ThePointerTellsTheWay) {
    Show();
    EXPECT_EQ(Surface()->cursor().shape(), Qt::SizeHorCursor);
    bar->setOrientation(Splitter::tsHorizontal);
    EXPECT_EQ(Surface()->cursor().shape(), Qt::SizeVerCursor);
    bar->setMousePointer(2);
    EXPECT_EQ(Surface()->cursor().shape(), Qt::CrossCursor);
}

TEST_F(SplitterTest, TheHighlightComesWithThePointerAndGoesWithIt) {
    bar->setAppearance(Appearance::tsNone);
    bar->setHighlightColor(Qt::red);
    bar->setBackColor(Qt::yellow);
    Show();
    EXPECT_EQ(PixelAt(4, 150), QColor(Qt::yellow));
    MoveTo(bar, {4, 150});
    EXPECT_EQ(PixelAt(4, 150), QColor(Qt::red));
    MoveTo(window, {300, 150});
    EXPECT_EQ(PixelAt(4, 150), QColor(Qt::yellow));
}

TEST_F(SplitterTest, TheDrawingFollowsSizeAndPalette) {
    bar->setAppearance(Appearance::tsNone);
    Show();
    bar->resize(20, 200);
    EXPECT_EQ(PixelAt(15, 190), QApplication::palette().color(QPalette::Window));
    QPalette dark;
    dark.setColor(QPalette::Window, QColor(40, 40, 40));
    QApplication::setPalette(dark);
    tessel::test::Settle();
    EXPECT_EQ(PixelAt(15, 190), QColor(40, 40, 40));
    QApplication::setPalette(QPalette());
}

TEST_F(SplitterTest, RefreshDrawsAnew) {
    bar->setAppearance(Appearance::tsFlat);
    Show();
    bar->clearFocus();
    bar->setForeColor(Qt::red);
    bar->refresh();
    EXPECT_EQ(PixelAt(0, 150), QColor(Qt::red));
}

TEST_F(SplitterTest, TheArrowKeysMoveItAlongItsWay) {
    Show();
    QObject::connect(bar, &Splitter::keyDown, bar,
                     [this](short& code, short&) { heard.push_back("KeyDown " + std::to_string(code)); });
    bar->setFocus(Qt::TabFocusReason);
    QTest::keyClick(bar, Qt::Key_Right);
    EXPECT_EQ(Events(), "KeyDown 39 AfterMove 120 0");
    EXPECT_EQ(bar->x(), 108);
    EXPECT_EQ(left->width(), 108);
    QTest::keyClick(bar, Qt::Key_Left, Qt::ShiftModifier);
    EXPECT_EQ(bar->x(), 107);
    QTest::keyClick(bar, Qt::Key_Up);
    EXPECT_EQ(bar->x(), 107);
    bar->setMinBottomRight(60 * 15);
    QTest::keyClick(bar, Qt::Key_End);
    EXPECT_EQ(bar->x(), 400 - 60 - 8);
    bar->setMinTopLeft(30 * 15);
    QTest::keyClick(bar, Qt::Key_Home);
    EXPECT_EQ(bar->x(), 30);
    EXPECT_EQ(left->width(), 30);
}

TEST_F(SplitterTest, TheTabKeyLeadsToItAndItsFocusIsSeen) {
    auto* button = new QPushButton(window);
    button->setGeometry(200, 200, 50, 20);
    QWidget::setTabOrder(button, bar);
    Show();
    button->setFocus();
    const QImage before = bar->grab().toImage();
    QTest::keyClick(button, Qt::Key_Tab);
    EXPECT_EQ(QApplication::focusWidget(), bar);
    EXPECT_EQ(PixelAt(0, 150), QApplication::palette().color(QPalette::Highlight));
    QTest::keyClick(bar, Qt::Key_Tab);
    EXPECT_NE(QApplication::focusWidget(), bar);
    EXPECT_EQ(bar->grab().toImage(), before);
}

TEST_F(SplitterTest, AssistivePrograms) {
    bar->setMinTopLeft(20 * 15);
    bar->setMinBottomRight(40 * 15);
    Show();
    QAccessibleInterface* accessible = Accessible(bar);
    ASSERT_TRUE(accessible);
    EXPECT_EQ(accessible->role(), QAccessible::Splitter);
    EXPECT_FALSE(accessible->text(QAccessible::Name).isEmpty());
    EXPECT_EQ(accessible->childCount(), 0);
    QAccessibleValueInterface* value = accessible->valueInterface();
    ASSERT_TRUE(value);
    EXPECT_EQ(value->currentValue().toDouble(), 100);
    EXPECT_EQ(value->minimumValue().toDouble(), 20);
    EXPECT_EQ(value->maximumValue().toDouble(), 400 - 40 - 8);
    value->setCurrentValue(180);
    EXPECT_EQ(bar->x(), 180);
    EXPECT_EQ(left->width(), 180);
    value->setCurrentValue(1000);
    EXPECT_EQ(bar->x(), 352);
    bar->setAccessibleName("Between");
    EXPECT_EQ(accessible->text(QAccessible::Name), "Between");
}

TEST_F(SplitterTest, ADisabledBarStaysWhereItIs) {
    bar->setEnabled(false);
    Show();
    Drag({104, 150}, {154, 150});
    bar->moveTo(200);
    EXPECT_EQ(bar->x(), 100);
}

TEST_F(SplitterTest, AHandlerMayEndTheBar) {
    Show();
    const QPointer<Splitter> alive = bar;
    QObject::connect(bar, &Splitter::afterMove, window, [alive] { delete alive; });
    Press(window, {104, 150});
    DragTo({154, 150});
    Release(window, {154, 150});
    EXPECT_FALSE(alive);
    EXPECT_EQ(left->width(), 150);
}

TEST_F(SplitterTest, AKeyHandlerMayEndTheBar) {
    Show();
    const QPointer<Splitter> alive = bar;
    QObject::connect(bar, &Splitter::keyDown, window, [alive] { delete alive; });
    QTest::keyClick(bar, Qt::Key_Right);
    EXPECT_FALSE(alive);
}

TEST_F(SplitterTest, ALoadedBarTakesTheMouseToo) {
    bar->setBag(bar->bag());
    Show();
    Drag({104, 150}, {154, 150});
    EXPECT_EQ(bar->x(), 150);
    EXPECT_EQ(left->width(), 150);
}

TEST_F(SplitterTest, AControlUnderChildrenIsNotDisturbed) {
    Link* link = Shown("Link1", {200, 100, 100, 40});
    EXPECT_FALSE(link->control().Surface().Listens());
    Listen(link);
    Click(link, {50, 20});
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
}

// Siblings by name.

TEST_F(SplitterTest, FindIsTheSearchWhateverHappensToTheSiblings) {
    Form& form = Form::of(*window);
    std::mt19937 random(11);
    const auto below = [&](std::size_t bound) { return static_cast<std::size_t>(random() % bound); };
    const auto name = [&] { return std::string(1, static_cast<char>((below(2) ? 'a' : 'A') + below(6))); };
    QWidget box(window), elsewhere;
    box.setObjectName("box");
    std::vector<QPointer<QWidget>> widgets;
    std::size_t found = 0;
    for (int step = 0; step < 4'000; ++step) {
        std::erase(widgets, nullptr);
        const auto any = [&]() -> QWidget& { return *widgets[below(widgets.size())]; };
        switch (widgets.empty() ? 0 : below(10)) {
            case 0:
                if (widgets.size() > 30) break;
                if (below(6) == 0)
                    widgets.emplace_back(new Link(window));
                else
                    widgets.emplace_back(new QWidget(below(3) ? window.data() : &box));
                if (below(4)) widgets.back()->setObjectName(name().c_str());
                break;
            case 1:
                delete &any();
                break;
            case 2:
                any().setObjectName(below(5) ? name().c_str() : "");
                break;
            case 3:
                any().setProperty("Index", below(4) ? QVariant(static_cast<int>(below(3))) : QVariant());
                break;
            case 4: {
                QWidget* const parents[] = {window, &box, &elsewhere};
                any().setParent(parents[below(3)]);
                break;
            }
            case 5:
                Host::setForm(below(4) ? new QWidget(window) : &any());
                break;
            default:
                break;
        }
        const std::string wanted = name();
        const int index = static_cast<int>(below(4)) - 1;
        frame::Object* const expected = form.Siblings::Find(wanted, index);
        ASSERT_EQ(form.Find(wanted, index), expected) << "step " << step;
        if (expected) ++found;
    }
    EXPECT_GT(found, 1'000u);
}

TEST_F(SplitterTest, AnIndexInAnySpellingIsFoundAsItStands) {
    QLabel* pane = Pane("cell", {0, 0, 10, 10});
    Form& form = Form::of(*window);
    EXPECT_EQ(form.Find("cell", 1), nullptr);
    pane->setProperty("index", 1);
    EXPECT_NE(form.Find("CELL", 1), nullptr);
    pane->setProperty("index", {});
    EXPECT_EQ(form.Find("cell", 1), nullptr);
}

}  // namespace
}  // namespace tessel::qt
