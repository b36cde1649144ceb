#include <QAccessible>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QLineEdit>
#include <QMenu>
#include <QPushButton>
#include <cmath>

#include "hosts/qt/LabelPeer.h"
#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

class UserTest : public test::QtTest {
  protected:
    static frame::OLE_COLOR Shows(Link* link) { return link->control().Label1.ForeColor(); }
    static frame::OLE_COLOR Highlight(Link* link) { return link->control().HighlightColor(); }
    QWidget* Under(Link* link, QPoint place) {
        QWidget* child = window->childAt(At(link, place));
        return child ? child : window.data();
    }
    static void Key(QWidget* widget, QEvent::Type type, int key, bool repeats) {
        QKeyEvent event(type, key, Qt::NoModifier, {}, repeats);
        QCoreApplication::sendEvent(widget, &event);
    }
    void OpenMenu(Link* link, const std::function<void(QMenu&)>& user) {
        WithMenu(
            [&] {
                QContextMenuEvent event(QContextMenuEvent::Mouse, {50, 20}, link->mapToGlobal(QPoint(50, 20)));
                QCoreApplication::sendEvent(link, &event);
            },
            [&](QWidget* menu) { user(*qobject_cast<QMenu*>(menu)); });
    }
    static QAction* Entry(QMenu& menu, const QString& text) {
        for (QAction* action : menu.actions()) {
            if (action->text().remove('&') == text) return action;
        }
        return nullptr;
    }
    void Palette(const QColor& back, const QColor& text) {
        QPalette palette;
        for (const auto role : {QPalette::Window, QPalette::Button, QPalette::Base}) palette.setColor(role, back);
        for (const auto role : {QPalette::WindowText, QPalette::ButtonText, QPalette::Text}) palette.setColor(role, text);
        QApplication::setPalette(palette);
    }
    ~UserTest() override { QApplication::setPalette(QPalette()); }
    QImage Seen(QWidget* widget) { return widget->grab().toImage().convertToFormat(QImage::Format_RGB32); }
};

double Luminance(const QColor& color) {
    const auto part = [](double value) { return value <= 0.04045 ? value / 12.92 : std::pow((value + 0.055) / 1.055, 2.4); };
    return 0.2126 * part(color.redF()) + 0.7152 * part(color.greenF()) + 0.0722 * part(color.blueF());
}
double Contrast(const QColor& one, const QColor& two) {
    const double a = Luminance(one), b = Luminance(two);
    return (std::max(a, b) + 0.05) / (std::min(a, b) + 0.05);
}
/// The greatest contrast of a pixel of the picture with its corner.
double BestContrast(const QImage& image) {
    const QColor paper = image.pixelColor(0, 0);
    double best = 1;
    for (int y = 0; y < image.height(); ++y) {
        for (int x = 0; x < image.width(); ++x) best = std::max(best, Contrast(paper, image.pixelColor(x, y)));
    }
    return best;
}

// Hover.

TEST_F(UserTest, TheMouseOnTheLinkHighlightsIt) {
    Link* link = Shown();
    MoveTo(link, {100, 20});
    EXPECT_EQ(Shows(link), Highlight(link));
    EXPECT_EQ(link->foreColor(), QColor(0, 0, 0xC0));
}

TEST_F(UserTest, TheHighlightIsSeen) {
    Link* link = Shown();
    link->setHighlightColor(Qt::red);
    link->setForeColor(Qt::blue);
    const auto has = [&](bool red) {
        const QImage image = Seen(link);
        for (int y = 0; y < image.height(); ++y) {
            for (int x = 0; x < image.width(); ++x) {
                const QColor at = image.pixelColor(x, y);
                if (red ? at.red() > at.blue() + 100 : at.blue() > at.red() + 100) return true;
            }
        }
        return false;
    };
    EXPECT_TRUE(has(false));
    MoveTo(link, {100, 20});
    EXPECT_TRUE(has(true));
    MoveAway();
    EXPECT_FALSE(has(true));
    EXPECT_TRUE(has(false));
}

TEST_F(UserTest, TheEdgeStripIsOffTheLink) {
    Link* link = Shown();
    MoveTo(link, {100, 20});
    for (const QPoint edge : {QPoint(1, 20), QPoint(199, 20), QPoint(100, 0), QPoint(100, 39)}) {
        MoveTo(link, {100, 20});
        EXPECT_EQ(Shows(link), Highlight(link));
        MoveTo(link, edge);
        EXPECT_EQ(Shows(link), link->control().ForeColor()) << edge.x() << "," << edge.y();
    }
}

TEST_F(UserTest, AFastLeaveInEachDirectionEndsTheHighlight) {
    Link* link = Shown("Link1", {100, 100, 100, 40});
    for (const QPoint outside : {QPoint(-60, 20), QPoint(250, 20), QPoint(50, -80), QPoint(50, 150)}) {
        MoveTo(link, {50, 20});
        EXPECT_EQ(Shows(link), Highlight(link));
        MoveTo(link, outside);
        EXPECT_EQ(Shows(link), link->control().ForeColor()) << outside.x() << "," << outside.y();
    }
}

TEST_F(UserTest, WithoutAStripAHoveredLinkStaysHighlighted) {
    Link* link = Shown();
    link->setBorderSize(0);
    MoveTo(link, {100, 20});
    MoveAway();
    EXPECT_EQ(Shows(link), Highlight(link));
}

TEST_F(UserTest, AUsedLinkShowsItsUsedColourAfterTheLeave) {
    Link* link = Shown();
    Click(link, {100, 20});
    MoveAway();
    EXPECT_EQ(Shows(link), link->control().UsedColor());
}

TEST_F(UserTest, APressInTheStripRunsTheActionWithoutMarkingTheLinkUsed) {
    Link* link = Shown();
    Click(link, {1, 20});
    EXPECT_EQ(Executed(), "open a.txt");
    MoveAway();
    EXPECT_EQ(Shows(link), link->control().ForeColor());
}

TEST_F(UserTest, LeavingTheWindowEndsTheHighlight) {
    Link* link = Shown("Link1", {0, 0, 400, 300});
    MoveTo(link, {200, 150});
    EXPECT_EQ(Shows(link), Highlight(link));
    QCursor::setPos(window->mapToGlobal(QPoint(700, 700)));
    test::Settle();
    EXPECT_EQ(Shows(link), link->control().ForeColor());
}

TEST_F(UserTest, HidingAHoveredLinkEndsTheHighlight) {
    Link* link = Shown();
    MoveTo(link, {100, 20});
    link->hide();
    test::Settle();
    link->move(20, 200);
    link->show();
    test::Settle();
    EXPECT_EQ(Shows(link), link->control().ForeColor());
}

TEST_F(UserTest, DisablingAHoveredLinkEndsTheHighlightAtTheNextMove) {
    Link* link = Shown();
    MoveTo(link, {100, 20});
    link->setEnabled(false);
    MoveAway();
    link->setEnabled(true);
    MoveTo(window, {380, 280});
    EXPECT_EQ(Shows(link), link->control().ForeColor());
}

// The pointer.

TEST_F(UserTest, TheLinkHasAPointingHand) {
    Link* link = Shown();
    EXPECT_EQ(Under(link, {100, 20})->cursor().shape(), Qt::PointingHandCursor);
}

// Keys.

TEST_F(UserTest, TabGoesThroughTheLinksInTheirOrder) {
    auto* field = new QLineEdit(window);
    Link* one = Add("One", {20, 60, 100, 20});
    Link* two = Add("Two", {20, 100, 100, 20});
    auto* button = new QPushButton(window);
    Show();
    field->setFocus();
    std::string order;
    for (int i = 0; i < 4; ++i) {
        QTest::keyClick(window->windowHandle(), Qt::Key_Tab);
        QWidget* focus = QApplication::focusWidget();
        order += focus == one ? "one " : focus == two ? "two " : focus == button ? "button " : focus == field ? "field " : "other ";
    }
    EXPECT_EQ(order, "one two button field ");
    QTest::keyClick(window->windowHandle(), Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_EQ(QApplication::focusWidget(), button);
    EXPECT_EQ(two->focusProxy(), nullptr);
}

TEST_F(UserTest, TheFocusIsSeenAroundTheLinkAndGoesWithIt) {
    Link* link = Shown("Link1", {60, 60, 120, 30});
    auto* field = new QLineEdit(window);
    field->setGeometry(250, 250, 50, 20);
    field->show();
    window->setFocus();
    test::Settle();
    const auto around = [&](const QImage& image, QRect place) { return image.copy(place.adjusted(-10, -10, 10, 10)); };
    const QImage before = Seen(window);
    link->setFocus(Qt::TabFocusReason);
    test::Settle();
    const QImage focused = Seen(window);
    EXPECT_NE(around(focused, link->geometry()), around(before, link->geometry()));
    // What differs is a ring: nothing inside the text's place.
    EXPECT_EQ(focused.copy(link->geometry().adjusted(4, 4, -4, -4)), before.copy(link->geometry().adjusted(4, 4, -4, -4)));
    const QRect old = link->geometry();
    link->move(60, 160);
    test::Settle();
    const QImage moved = Seen(window);
    EXPECT_TRUE(test::InkOf(around(moved, old)).isEmpty());
    EXPECT_EQ(around(moved, link->geometry()), around(focused, old));
    link->hide();
    test::Settle();
    EXPECT_TRUE(test::InkOf(around(Seen(window), link->geometry())).isEmpty());
    link->show();
    link->move(old.topLeft());
    field->setFocus();
    test::Settle();
    EXPECT_EQ(around(Seen(window), old), around(before, old));
}

TEST_F(UserTest, TheRingIsNoMemberOfTheForm) {
    Link* link = Shown();
    Form& form = Form::of(*window);
    const int count = form.Count();
    link->setFocus(Qt::TabFocusReason);
    test::Settle();
    EXPECT_EQ(form.Count(), count);
}

TEST_F(UserTest, EnterAndSpaceAreAPressInTheMiddle) {
    Link* link = Shown();
    std::string places;
    QObject::connect(link, &Link::mouseDown, link, [&](short& button, short&, float& x, float& y) {
        places +=
            std::to_string(button) + " " + std::to_string(static_cast<int>(x)) + "," + std::to_string(static_cast<int>(y)) + "; ";
    });
    Listen(link);
    link->setFocus(Qt::TabFocusReason);
    for (const auto key : {Qt::Key_Return, Qt::Key_Enter, Qt::Key_Space}) {
        QTest::keyPress(window->windowHandle(), key);
        EXPECT_EQ(Events(), "MouseDown");
        EXPECT_EQ(Executed(), "open a.txt");
        QTest::keyRelease(window->windowHandle(), key);
        EXPECT_EQ(Events(), "MouseUp Click");
    }
    EXPECT_EQ(places, "1 1500,300; 1 1500,300; 1 1500,300; ");
    EXPECT_EQ(Executed(), "");
}

TEST_F(UserTest, AKeyPressMarksTheLinkUsed) {
    Link* link = Shown();
    link->setFocus(Qt::TabFocusReason);
    QTest::keyClick(window->windowHandle(), Qt::Key_Space);
    MoveTo(link, {100, 20});
    MoveAway();
    EXPECT_EQ(Shows(link), link->control().UsedColor());
}

TEST_F(UserTest, AKeyHeldDownPressesOnce) {
    Link* link = Shown();
    Listen(link);
    link->setFocus(Qt::TabFocusReason);
    Key(link, QEvent::KeyPress, Qt::Key_Space, false);
    for (int i = 0; i < 5; ++i) {
        Key(link, QEvent::KeyRelease, Qt::Key_Space, true);
        Key(link, QEvent::KeyPress, Qt::Key_Space, true);
    }
    EXPECT_EQ(Events(), "MouseDown");
    Key(link, QEvent::KeyRelease, Qt::Key_Space, false);
    EXPECT_EQ(Events(), "MouseUp Click");
    EXPECT_EQ(Executed(), "open a.txt");
}

TEST_F(UserTest, AReleaseWithoutAPressIsNothing) {
    Link* link = Shown();
    Listen(link);
    link->setFocus(Qt::TabFocusReason);
    Key(link, QEvent::KeyRelease, Qt::Key_Return, false);
    EXPECT_EQ(Events(), "");
}

TEST_F(UserTest, FocusLostWhileAKeyIsHeldIsNoClick) {
    Link* link = Shown();
    auto* field = new QLineEdit(window);
    field->show();
    Listen(link);
    link->setFocus(Qt::TabFocusReason);
    QTest::keyPress(window->windowHandle(), Qt::Key_Space);
    field->setFocus();
    QTest::keyRelease(window->windowHandle(), Qt::Key_Space);
    EXPECT_EQ(Events(), "MouseDown MouseUp");
    link->setFocus(Qt::TabFocusReason);
    QTest::keyClick(window->windowHandle(), Qt::Key_Space);
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
}

TEST_F(UserTest, OtherKeysGoOnToTheForm) {
    Link* link = Shown();
    struct Window final : QObject {
        bool eventFilter(QObject*, QEvent* event) override {
            if (event->type() == QEvent::KeyPress) ++keys;
            return false;
        }
        int keys = 0;
    } filter;
    window->installEventFilter(&filter);
    link->setFocus(Qt::TabFocusReason);
    QTest::keyClick(window->windowHandle(), Qt::Key_Escape);
    QTest::keyClick(window->windowHandle(), Qt::Key_A);
    EXPECT_EQ(filter.keys, 2);
    QTest::keyClick(window->windowHandle(), Qt::Key_Return);
    EXPECT_EQ(filter.keys, 2);
}

TEST_F(UserTest, ControlCCopiesTheTarget) {
    Link* link = Shown();
    Listen(link);
    link->setFocus(Qt::TabFocusReason);
    QApplication::clipboard()->setText("before");
    QTest::keyClick(window->windowHandle(), Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(), "a.txt");
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "");
    link->setLinkTo("");
    link->setCaption("the caption");
    link->copyTarget();
    EXPECT_EQ(QApplication::clipboard()->text(), "the caption");
}

TEST_F(UserTest, ADisabledLinkIsLeftOutByTab) {
    Link* link = Shown();
    auto* field = new QLineEdit(window);
    field->show();
    link->setEnabled(false);
    field->setFocus();
    QTest::keyClick(window->windowHandle(), Qt::Key_Tab);
    EXPECT_NE(QApplication::focusWidget(), link);
}

TEST_F(UserTest, ALinkDisabledUnderTheFocusTakesNoKeys) {
    Link* link = Shown();
    Listen(link);
    link->setFocus(Qt::TabFocusReason);
    link->control().SetEnabled(false);
    test::Settle();
    QTest::keyClick(window->windowHandle(), Qt::Key_Return);
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "");
}

TEST_F(UserTest, ADisabledLinkIsNotPressedByTheProgram) {
    Link* link = Shown();
    Listen(link);
    link->setEnabled(false);
    link->press();
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "");
}

TEST_F(UserTest, AtDesignTimeNeitherKeysNorAssistiveProgramsPress) {
    host->setUserMode(false);
    Link* link = Shown();
    Listen(link);
    link->setFocus(Qt::TabFocusReason);
    QTest::keyClick(window->windowHandle(), Qt::Key_Return);
    EXPECT_EQ(Events(), "");
    QAccessible::queryAccessibleInterface(link)->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "");
}

// The menu.

TEST_F(UserTest, TheMenuOpensAndCopies) {
    Link* link = Shown();
    link->setClickAction(Link::Do_nothing);
    OpenMenu(link, [&](QMenu& menu) {
        ASSERT_TRUE(Entry(menu, "Open"));
        ASSERT_TRUE(Entry(menu, "Copy"));
        EXPECT_EQ(menu.defaultAction(), Entry(menu, "Open"));
        Entry(menu, "Open")->trigger();
    });
    EXPECT_TRUE(menuSeen);
    EXPECT_EQ(Executed(), "open a.txt");
    OpenMenu(link, [&](QMenu& menu) { Entry(menu, "Copy")->trigger(); });
    EXPECT_EQ(QApplication::clipboard()->text(), "a.txt");
}

TEST_F(UserTest, TheMenuOfALinkWithoutATargetOffersTheCaption) {
    Link* link = Shown();
    link->setLinkTo("");
    link->setCaption("http://example.org/");
    OpenMenu(link, [&](QMenu& menu) { Entry(menu, "Open")->trigger(); });
    EXPECT_EQ(Executed(), "open http://example.org/");
}

TEST_F(UserTest, TheMenuOfALinkToNothingDoesNothing) {
    Link* link = Shown();
    link->setLinkTo("");
    link->setCaption("");
    OpenMenu(link, [&](QMenu& menu) { Entry(menu, "Open")->trigger(); });
    link->openTarget();
    EXPECT_EQ(Executed(), "");
}

TEST_F(UserTest, ALinkDeletedWhileItsMenuIsOpenBreaksNothing) {
    QPointer<Link> link = Shown();
    OpenMenu(link, [&](QMenu&) { delete link.data(); });
    EXPECT_TRUE(menuSeen);
    EXPECT_FALSE(link);
}

TEST_F(UserTest, AMenuPolicyOfTheProgramIsHeeded) {
    Link* link = Shown();
    link->setContextMenuPolicy(Qt::NoContextMenu);
    WithMenu([&] { Click(link, {50, 20}, Qt::RightButton); }, [](QWidget*) {});
    EXPECT_FALSE(menuSeen);
}

TEST_F(UserTest, ADisabledLinkHasNoMenu) {
    Link* link = Shown();
    link->setEnabled(false);
    WithMenu([&] { Click(link, {50, 20}, Qt::RightButton); }, [](QWidget*) {});
    EXPECT_FALSE(menuSeen);
}

TEST_F(UserTest, AtDesignTimeThereIsNoMenu) {
    host->setUserMode(false);
    Link* link = Shown();
    WithMenu([&] { Click(link, {50, 20}, Qt::RightButton); }, [](QWidget*) {});
    EXPECT_FALSE(menuSeen);
}

// Assistive programs.

QAccessibleInterface* Assistive(Link* link) { return QAccessible::queryAccessibleInterface(link); }

TEST_F(UserTest, AssistiveProgramsMeetALinkWithItsCaptionAndTarget) {
    Link* link = Shown();
    link->setCaption("Read me");
    QAccessibleInterface* told = Assistive(link);
    ASSERT_TRUE(told && told->isValid());
    EXPECT_EQ(told->role(), QAccessible::Link);
    EXPECT_EQ(told->text(QAccessible::Name), "Read me");
    EXPECT_EQ(told->text(QAccessible::Description), "a.txt");
    EXPECT_TRUE(told->state().focusable);
    EXPECT_FALSE(told->state().disabled);
    EXPECT_EQ(told->rect(), QRect(link->mapToGlobal(QPoint(0, 0)), link->size()));
    link->setEnabled(false);
    EXPECT_TRUE(told->state().disabled);
}

TEST_F(UserTest, WhatTheProgramSaysToAssistiveProgramsGoesFirst) {
    Link* link = Shown();
    link->setAccessibleName("Manual");
    link->setAccessibleDescription("Opens the manual");
    EXPECT_EQ(Assistive(link)->text(QAccessible::Name), "Manual");
    EXPECT_EQ(Assistive(link)->text(QAccessible::Description), "Opens the manual");
}

TEST_F(UserTest, AssistiveProgramsPressAndFocusTheLink) {
    Link* link = Shown();
    Listen(link);
    QAccessibleActionInterface* actions = Assistive(link)->actionInterface();
    ASSERT_TRUE(actions);
    ASSERT_TRUE(actions->actionNames().contains(QAccessibleActionInterface::pressAction()));
    actions->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(Events(), "MouseDown MouseUp Click");
    EXPECT_EQ(Executed(), "open a.txt");
    ASSERT_TRUE(actions->actionNames().contains(QAccessibleActionInterface::setFocusAction()));
    actions->doAction(QAccessibleActionInterface::setFocusAction());
    EXPECT_EQ(QApplication::focusWidget(), link);
    actions->doAction("no such action");
    EXPECT_EQ(Executed(), "");
}

TEST_F(UserTest, ADisabledLinkIsNotPressedByAssistivePrograms) {
    Link* link = Shown();
    Listen(link);
    link->setEnabled(false);
    Assistive(link)->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(Events(), "");
    EXPECT_EQ(Executed(), "");
}

TEST_F(UserTest, ALinkDeletedByItsAssistivePressBreaksNothing) {
    QPointer<Link> link = Shown();
    QObject::connect(link.data(), &Link::mouseDown, qApp, [&] { delete link.data(); });
    Assistive(link)->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_FALSE(link);
}

// Colours.

TEST(ReadableTest, WhatCanBeReadStaysAsItIs) {
    EXPECT_EQ(Readable(Qt::blue, Qt::white), QColor(Qt::blue));
    EXPECT_EQ(Readable(Qt::yellow, Qt::black), QColor(Qt::yellow));
}

TEST(ReadableTest, DarkTextOnADarkGroundIsLightenedUntilItCanBeRead) {
    for (const QColor back : {QColor(0, 0, 0), QColor(0x20, 0x20, 0x20), QColor(0x31, 0x36, 0x3B), QColor(0, 0, 80)}) {
        for (const QColor text : {QColor(0, 0, 0xC0), QColor(0xC0, 0, 0), QColor(0x80, 0, 0x80), QColor(Qt::black), back}) {
            EXPECT_GE(Contrast(Readable(text, back), back), 4.49)
                << text.name().toStdString() << " on " << back.name().toStdString();
        }
    }
}

TEST(ReadableTest, ItEndsWhereWhiteIsNotEnough) {
    for (int grey = 0; grey < 256; ++grey) {
        const QColor back(grey, grey, grey);
        EXPECT_TRUE(Readable(back, back).isValid());
        EXPECT_TRUE(Readable(Qt::red, back).isValid());
    }
}

TEST_F(UserTest, TheDefaultColoursCanBeReadOnADarkPaletteAndStayAsTheyAre) {
    Palette(QColor(0x20, 0x20, 0x20), Qt::white);
    Link* link = Shown();
    QFont font("DejaVu Sans");
    font.setPixelSize(24);
    font.setBold(true);
    link->setFont(font);
    test::Settle();
    const QByteArray bag = link->bag();
    EXPECT_GE(BestContrast(Seen(link)), 4.4);
    MoveTo(link, {100, 20});
    EXPECT_GE(BestContrast(Seen(link)), 4.4);
    Click(link, {100, 20});
    MoveAway();
    EXPECT_EQ(Shows(link), link->control().UsedColor());
    EXPECT_GE(BestContrast(Seen(link)), 4.4);
    EXPECT_EQ(link->foreColor(), QColor(0, 0, 0xC0));
    EXPECT_EQ(link->control().ForeColor(), frame::OLE_COLOR(0xC00000));
    EXPECT_EQ(link->bag(), bag);
}

TEST_F(UserTest, APaletteThatTurnsDarkIsFollowed) {
    Link* link = Shown();
    QFont font("DejaVu Sans");
    font.setPixelSize(24);
    font.setBold(true);
    link->setFont(font);
    test::Settle();
    Palette(QColor(0x20, 0x20, 0x20), Qt::white);
    test::Settle();
    EXPECT_GE(BestContrast(Seen(window)), 4.4);
    Palette(Qt::white, Qt::black);
    test::Settle();
    EXPECT_EQ(Seen(window).pixelColor(0, 0), QColor(Qt::white));
}

TEST_F(UserTest, ADarkPaletteOfTheFormAloneIsFollowed) {
    Link* link = Shown();
    QFont font("DejaVu Sans");
    font.setPixelSize(24);
    font.setBold(true);
    link->setFont(font);
    QPalette dark = window->palette();
    dark.setColor(QPalette::Window, QColor(0x20, 0x20, 0x20));
    dark.setColor(QPalette::Button, QColor(0x20, 0x20, 0x20));
    window->setPalette(dark);
    test::Settle();
    const QImage seen = Seen(window).copy(link->geometry());
    EXPECT_EQ(seen.pixelColor(0, 0), QColor(0x20, 0x20, 0x20));
    EXPECT_GE(BestContrast(seen), 4.4);
}

TEST_F(UserTest, AnOwnBackgroundShowsTheOwnColours) {
    Palette(QColor(0x20, 0x20, 0x20), Qt::white);
    Link* link = Shown();
    link->setBackColor(Qt::white);
    link->setForeColor(QColor(0, 0, 0xC0));
    QFont font("DejaVu Sans");
    font.setPixelSize(30);
    font.setBold(true);
    link->setFont(font);
    test::Settle();
    const QImage seen = Seen(link);
    EXPECT_EQ(seen.pixelColor(0, 0), QColor(Qt::white));
    bool exact = false;
    for (int y = 0; y < seen.height(); ++y) {
        for (int x = 0; x < seen.width(); ++x) exact |= seen.pixelColor(x, y) == QColor(0, 0, 0xC0);
    }
    EXPECT_TRUE(exact);
}

// Directions and scales.

TEST_F(UserTest, FromRightToLeftTheTextStandsAtTheRight) {
    Link* link = Shown();
    link->setCaption("text");
    test::Settle();
    const QRect left = test::InkOf(Seen(link));
    EXPECT_LT(left.right(), 100);
    link->setLayoutDirection(Qt::RightToLeft);
    test::Settle();
    const QRect right = test::InkOf(Seen(link));
    EXPECT_GT(right.left(), 100);
    EXPECT_EQ(link->alignment(), Link::LeftJustify);
    link->setAlignment(Link::RightJustify);
    test::Settle();
    EXPECT_LT(test::InkOf(Seen(link)).right(), 100);
    link->setAlignment(Link::Center);
    test::Settle();
    EXPECT_NEAR(test::InkOf(Seen(link)).center().x(), 100, 3);
}

TEST_F(UserTest, TheDirectionOfTheFormIsFollowed) {
    Link* link = Shown();
    link->setCaption("text");
    window->setLayoutDirection(Qt::RightToLeft);
    test::Settle();
    EXPECT_GT(test::InkOf(Seen(link)).left(), 100);
}

TEST_F(UserTest, AtScaleTwoTheTextIsDrawnInFinePixels) {
    Link* link = Shown();
    link->setCaption("sharp S8&g");
    QPixmap fine(link->size() * 2);
    fine.setDevicePixelRatio(2);
    fine.fill(Qt::white);
    link->render(&fine);
    const QImage image = fine.toImage().convertToFormat(QImage::Format_RGB32);
    int uneven = 0;
    for (int y = 0; y + 1 < image.height(); y += 2) {
        for (int x = 0; x + 1 < image.width(); x += 2) {
            if (image.pixel(x, y) != image.pixel(x + 1, y) || image.pixel(x, y) != image.pixel(x, y + 1)) ++uneven;
        }
    }
    EXPECT_GT(uneven, 20);
}

TEST_F(UserTest, AnAmpersandIsACharacterOfTheText) {
    Link* link = Shown();
    link->setAutoSize(true);
    link->setCaption("a & b");
    const int with = link->width();
    link->setCaption("a  b");
    EXPECT_GT(with, link->width());
}

TEST_F(UserTest, ATextThatLooksLikeMarkupIsText) {
    Link* link = Shown();
    link->setAutoSize(true);
    link->setCaption("<b>x</b>");
    const int with = link->width();
    link->setCaption("x");
    EXPECT_GT(with, link->width() * 3);
}

TEST_F(UserTest, TheToolTipIsThatOfTheLink) {
    Link* link = Shown();
    link->extender().Put("ToolTipText", frame::Variant("Hint"));
    EXPECT_EQ(link->toolTip(), "Hint");
    link->setToolTip("Other");
    EXPECT_EQ(link->extender().Get("ToolTipText"), frame::Variant("Other"));
    EXPECT_EQ(Under(link, {100, 20})->toolTip(), "Other");
}

}  // namespace
}  // namespace tessel::qt
