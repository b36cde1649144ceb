#include "hosts/qt/TreeViewPeer.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QAccessible>
#include <QLineEdit>
#include <QMimeData>
#include <QUrl>
#include <algorithm>
#include <cstdlib>

#include "tests/hosts/qt/tree/TreeOnScreen.h"

namespace tessel::qt::test {
namespace {

using child::NodeId;
using child::NodeImage;
using child::noNode;
using child::TreeLabelEditConstants;
using child::TreeStyleConstants;
using frame::Variant;

// Following.

TEST(TreeViewPeer, TheTreeIsAWidgetUnderItsName) {
    TreeOnScreen screen;
    EXPECT_EQ(screen.view().objectName(), "TreeFolders");
    EXPECT_EQ(screen.view().size(), QSize(300, 240));
    EXPECT_TRUE(screen.view().isVisible());
}

TEST(TreeViewPeer, ShowsWhatTheProgramExpandsAndCollapses) {
    Sample screen;
    EXPECT_EQ(screen.Rows(), "docs+ music+ zoo");
    screen.tree.SetExpanded(screen.Node("docs"), true);
    screen.Settle();
    EXPECT_EQ(screen.Rows(), "docs- .letters+ .bills music+ zoo");
    screen.nodes().Remove(screen.Node("letters"));
    screen.Settle();
    EXPECT_EQ(screen.Rows(), "docs- .bills music+ zoo");
    screen.tree.SetExpanded(screen.Node("docs"), false);
    screen.Settle();
    EXPECT_EQ(screen.Rows(), "docs+ music+ zoo");
}

TEST(TreeViewPeer, ALabelStandsDeeperByTheIndentationOfItsLevel) {
    Sample screen;
    screen.tree.SetExpanded(screen.Node("docs"), true);
    screen.Settle();
    const auto left = [&](const char* text) { return screen.view().LabelPlace(screen.Row(text)).left(); };
    EXPECT_EQ(left("letters") - left("docs"), 19);
    screen.tree.SetIndentation(30 * 15);
    screen.Settle();
    EXPECT_EQ(left("letters") - left("docs"), 30);
    const int before = left("docs");
    screen.tree.SetLineStyle(child::TreeLineStyleConstants::TreeLines);
    screen.Settle();
    EXPECT_EQ(left("docs"), before - 30);
    EXPECT_TRUE(screen.view().SignPlace(screen.Row("docs")).isEmpty());
    EXPECT_FALSE(screen.view().SignPlace(screen.Row("letters")).isEmpty());
}

// What the screen answers.

TEST(TreeViewPeer, ANodeIsHitOnItsLabelAndNotOnItsSign) {
    Sample screen;
    ASSERT_TRUE(screen.HitAt(screen.LabelPoint("music")));
    EXPECT_EQ(screen.HitAt(screen.LabelPoint("music"))->Text(), "music");
    EXPECT_FALSE(screen.HitAt(screen.SignPoint("music")));
    const QPoint beside(screen.port()->width() - 8, screen.CellOf("music").center().y());
    EXPECT_FALSE(screen.HitAt(beside));
    screen.tree.SetFullRowSelect(true);
    ASSERT_TRUE(screen.HitAt(beside));
    EXPECT_EQ(screen.HitAt(beside)->Text(), "music");
    EXPECT_FALSE(screen.HitAt(screen.SignPoint("music")));
    EXPECT_FALSE(screen.HitAt({beside.x(), screen.port()->height() - 4}));
}

TEST(TreeViewPeer, TheScreenSaysWhatIsInViewAndScrollsToWhatIsNot) {
    Nodes100 screen;
    const auto inView = [&](int number) { return screen.tree.IsInView(screen.Node("node " + frame::Decimal(number))); };
    const int rows = screen.port()->height() / screen.CellOf("node 0").height();
    EXPECT_TRUE(inView(0));
    EXPECT_TRUE(inView(rows - 1));
    EXPECT_FALSE(inView(rows + 1));
    screen.tree.EnsureVisible(screen.Node("node 60"));
    EXPECT_TRUE(inView(60));
    EXPECT_FALSE(inView(61));
    EXPECT_TRUE(screen.port()->rect().contains(screen.CellOf("node 60")));
    screen.tree.EnsureVisible(screen.Node("node 58"));
    EXPECT_FALSE(inView(61));
    screen.tree.EnsureVisible(screen.Node("node 3"));
    EXPECT_EQ(screen.TopText(), "node 3");
}

TEST(TreeViewPeer, MakingADeepNodeVisibleExpandsWhatIsAbove) {
    Sample screen;
    screen.tree.EnsureVisible(screen.Node("bert"));
    EXPECT_EQ(screen.Rows(), "docs- .letters- ..anna ..bert .bills music+ zoo");
    EXPECT_EQ(screen.Events(), "Expand docs - | Expand letters -");
}

TEST(TreeViewPeer, AScrolledTreeStaysWithTheNodesThatItShows) {
    Nodes100 screen;
    screen.ScrollTo(40);
    ASSERT_EQ(screen.TopText(), "node 40");
    for (int number = 0; number < 5; ++number) screen.Add("child", screen.Node("node 2"));
    screen.Settle();
    EXPECT_EQ(screen.TopText(), "node 40");
    screen.tree.SetExpanded(screen.Node("node 2"), true);
    screen.Settle();
    EXPECT_EQ(screen.TopText(), "node 40");
    EXPECT_EQ(screen.view().FirstVisible(), 45u);
    const int place = screen.CellOf("node 41").top();
    screen.nodes().Remove(screen.Node("node 2"));
    screen.nodes().Remove(screen.Node("node 40"));
    screen.Settle();
    EXPECT_EQ(screen.CellOf("node 41").top(), place);
    screen.Add("child", screen.Node("node 39"));
    screen.tree.SetExpanded(screen.Node("node 39"), true);
    screen.Settle();
    EXPECT_EQ(screen.TopText(), "node 39");
}

TEST(TreeViewPeer, LabelsWiderThanTheWindowAreScrolledTo) {
    Sample screen(160, 200);
    EXPECT_EQ(screen.view().horizontalScrollBar()->maximum(), 0);
    screen.Add("a name that is by far wider than the window", screen.Node("zoo"));
    screen.Settle();
    EXPECT_EQ(screen.view().horizontalScrollBar()->maximum(), 0);  // it is not shown
    screen.tree.SetExpanded(screen.Node("zoo"), true);
    screen.Settle();
    EXPECT_GT(screen.view().horizontalScrollBar()->maximum(), 50);
    screen.view().horizontalScrollBar()->setValue(screen.view().horizontalScrollBar()->maximum());
    const QRect label = screen.view().LabelPlace(screen.Row("a name that is by far wider than the window"));
    EXPECT_LE(label.right(), screen.port()->width());
    screen.tree.SetScroll(false);
    screen.Settle();
    EXPECT_FALSE(screen.view().horizontalScrollBar()->isVisible());
}

TEST(TreeViewPeer, AScrollBarThatComesDoesNotCoverTheSelection) {
    TreeOnScreen screen;
    for (int i = 0; i < 40; ++i) screen.Add("node " + std::to_string(i));
    screen.Settle();
    screen.tree.EnsureVisible(screen.Node("node 25"));
    screen.tree.SetSelectedItem(screen.tree.NodeOf(screen.Node("node 25")));
    screen.Settle();
    const int height = screen.port()->height();
    ASSERT_LE(screen.CellOf("node 25").bottom(), screen.port()->rect().bottom());
    screen.tree.NodeOf(screen.Node("node 20"))->SetText(std::string(80, 'm'));
    screen.Settle();
    QCoreApplication::processEvents();
    ASSERT_LT(screen.port()->height(), height);
    EXPECT_LE(screen.CellOf("node 25").bottom(), screen.port()->rect().bottom());
}

TEST(TreeViewPeer, TheKeysBringADeepLabelIntoViewSideways) {
    TreeOnScreen screen(160, 400);
    NodeId parent = noNode;
    for (int level = 0; level < 12; ++level) {
        parent = screen.Add("level " + frame::Decimal(level), parent);
        screen.tree.SetExpanded(parent, true);
    }
    screen.Settle();
    screen.Key(Qt::Key_End);
    EXPECT_EQ(screen.Selected(), "level 11");
    EXPECT_TRUE(screen.port()->rect().contains(screen.view().LabelPlace(screen.Row("level 11")).adjusted(2, 0, -2, 0)));
    screen.Key(Qt::Key_Home);
    EXPECT_TRUE(screen.port()->rect().contains(screen.view().LabelPlace(screen.Row("level 0"))));
}

// The mouse.

TEST(TreeViewPeer, APressSelectsAfterTheMouseWasReported) {
    Sample screen;
    screen.Click("music");
    const std::string heard = screen.owner.Heard();
    EXPECT_THAT(heard, testing::StartsWith("MouseDown 1 "));
    EXPECT_THAT(heard, testing::EndsWith(" | NodeClick music*"));
}

TEST(TreeViewPeer, AClickOnTheSignTurnsItAndSelectsNothing) {
    Sample screen;
    screen.ClickSign("docs");
    EXPECT_EQ(screen.Events(), "Expand docs -");
    EXPECT_EQ(screen.Rows(), "docs- .letters+ .bills music+ zoo");
    screen.ClickSign("docs");
    EXPECT_EQ(screen.Events(), "Collapse docs +");
    EXPECT_EQ(screen.Rows(), "docs+ music+ zoo");
    EXPECT_TRUE(screen.view().SignPlace(screen.Row("zoo")).isEmpty());
}

TEST(TreeViewPeer, BesideTheLabelNothingIsSelectedUnlessWholeRowsAre) {
    Sample screen;
    const QPoint beside(screen.port()->width() - 8, screen.CellOf("music").center().y());
    screen.ClickAt(beside);
    EXPECT_EQ(screen.Selected(), "");
    screen.tree.SetFullRowSelect(true);
    screen.ClickAt(beside);
    EXPECT_EQ(screen.Selected(), "music");
    screen.ClickAt({beside.x(), screen.port()->height() - 4});
    EXPECT_EQ(screen.Selected(), "music");
}

TEST(TreeViewPeer, ADoubleClickExpandsWhatHasChildren) {
    Sample screen;
    struct Hearer {
        void Clicked() { owner.heard += "DblClick | "; }
        tessel::test::TreeOwner& owner;
    } hearer{screen.owner};
    screen.tree.DblClick.To<&Hearer::Clicked>(hearer);
    const auto twice = [&](const char* text) {
        screen.Click(text);
        screen.owner.Heard();
        QTest::mouseDClick(screen.port(), Qt::LeftButton, {}, screen.LabelPoint(text));
        return screen.owner.Heard();
    };
    EXPECT_THAT(twice("docs"), testing::HasSubstr("DblClick |  | Expand docs -"));
    EXPECT_THAT(twice("docs"), testing::HasSubstr("Collapse docs +"));
    EXPECT_THAT(twice("zoo"), testing::Not(testing::HasSubstr("Expand")));
}

TEST(TreeViewPeer, TheRightButtonSelectsNothing) {
    Sample screen;
    QTest::mouseClick(screen.port(), Qt::RightButton, {}, screen.LabelPoint("music"));
    EXPECT_EQ(screen.Selected(), "");
    EXPECT_THAT(screen.owner.Heard(), testing::StartsWith("MouseDown 2"));
}

TEST(TreeViewPeer, ABoxIsTurnedByTheMouseAndBySpace) {
    Sample screen;
    EXPECT_TRUE(screen.view().BoxPlace(screen.Row("music")).isEmpty());
    screen.tree.SetCheckboxes(true);
    screen.Settle();
    screen.ClickAt(screen.view().BoxPlace(screen.Row("music")).center());
    EXPECT_EQ(screen.Events(), "NodeCheck music on");
    EXPECT_EQ(screen.Selected(), "");
    screen.Click("music");
    screen.Events();
    screen.Key(Qt::Key_Space);
    EXPECT_EQ(screen.Events(), "NodeCheck music off");
}

TEST(TreeViewPeer, WithSingleSelAClickExpandsAndCollapsesWhatWasSelected) {
    Sample screen;
    screen.tree.SetSingleSel(true);
    screen.Click("docs");
    EXPECT_EQ(screen.Rows(), "docs-* .letters+ .bills music+ zoo");
    screen.Click("letters");
    EXPECT_EQ(screen.Rows(), "docs- .letters-* ..anna ..bert .bills music+ zoo");
    screen.Click("music");
    EXPECT_EQ(screen.Rows(), "docs- .letters+ .bills music-* .rock zoo");
}

// The keyboard.

TEST(TreeViewPeer, ArrowsMoveAndSelect) {
    Sample screen;
    screen.Key(Qt::Key_Down);
    EXPECT_EQ(screen.Selected(), "docs");
    screen.Key(Qt::Key_Down);
    screen.Key(Qt::Key_Down);
    EXPECT_EQ(screen.Selected(), "zoo");
    screen.Key(Qt::Key_Down);
    EXPECT_EQ(screen.Events(), "NodeClick docs* | NodeClick music* | NodeClick zoo*");
    screen.Key(Qt::Key_Up);
    EXPECT_EQ(screen.Selected(), "music");
}

TEST(TreeViewPeer, RightExpandsAndGoesInLeftCollapsesAndGoesOut) {
    Sample screen;
    screen.Click("docs");
    screen.Events();
    screen.Key(Qt::Key_Right);
    EXPECT_EQ(screen.Events(), "Expand docs -");
    screen.Key(Qt::Key_Right);
    EXPECT_EQ(screen.Events(), "NodeClick letters*");
    screen.Key(Qt::Key_Down);
    screen.Key(Qt::Key_Right);  // has no children
    EXPECT_EQ(screen.Events(), "NodeClick bills*");
    screen.Key(Qt::Key_Left);
    EXPECT_EQ(screen.Selected(), "docs");
    screen.Events();
    screen.Key(Qt::Key_Left);
    EXPECT_EQ(screen.Events(), "Collapse docs +");
    screen.Key(Qt::Key_Left);
    EXPECT_EQ(screen.Events(), "");
    EXPECT_EQ(screen.Rows(), "docs+* music+ zoo");
}

TEST(TreeViewPeer, FromRightToLeftTheSidewaysKeysAndTheSignsAreMirrored) {
    Sample screen;
    const QPoint before = screen.SignPoint("docs");
    screen.view().setLayoutDirection(Qt::RightToLeft);
    EXPECT_EQ(screen.SignPoint("docs").x(), screen.port()->width() - 1 - before.x());
    EXPECT_LT(screen.LabelPoint("docs").x(), screen.SignPoint("docs").x());
    screen.Click("docs");
    screen.Key(Qt::Key_Left);
    EXPECT_EQ(screen.Rows(), "docs-* .letters+ .bills music+ zoo");
    screen.Key(Qt::Key_Right);
    EXPECT_EQ(screen.Rows(), "docs+* music+ zoo");
    screen.ClickSign("docs");
    EXPECT_EQ(screen.Rows(), "docs-* .letters+ .bills music+ zoo");
}

TEST(TreeViewPeer, HomeEndAndPagesMoveFarAndScroll) {
    Nodes100 screen;
    screen.Key(Qt::Key_End);
    EXPECT_EQ(screen.Selected(), "node 99");
    EXPECT_TRUE(screen.port()->rect().contains(screen.CellOf("node 99")));
    screen.Key(Qt::Key_PageUp);
    EXPECT_LT(screen.Row(screen.Selected()), 95u);
    screen.Key(Qt::Key_Home);
    EXPECT_EQ(screen.Selected(), "node 0");
    EXPECT_EQ(screen.TopText(), "node 0");
    screen.Key(Qt::Key_PageDown);
    EXPECT_GT(screen.Row(screen.Selected()), 5u);
}

TEST(TreeViewPeer, PlusAndMinusTurnTheSelectedNode) {
    Sample screen;
    screen.Click("docs");
    screen.Events();
    QTest::keyClick(&screen.view(), '+');
    QTest::keyClick(&screen.view(), '+');
    EXPECT_EQ(screen.Events(), "Expand docs -");
    screen.Key(Qt::Key_Minus, Qt::KeypadModifier);
    EXPECT_EQ(screen.Events(), "Collapse docs +");
}

TEST(TreeViewPeer, TheAsteriskExpandsAllThatIsLoaded) {
    Sample screen;
    screen.owner.atExpand = [&](const child::TreeNodeRef& node) {
        if (node->Text() == "letters") screen.Add("late child", screen.Add("late", node->Ref().node));
    };
    screen.Click("docs");
    screen.Events();
    screen.Key(Qt::Key_Asterisk, Qt::KeypadModifier);
    EXPECT_EQ(screen.Events(), "Expand docs - | Expand letters -");
    EXPECT_EQ(screen.Rows(), "docs-* .letters- ..anna ..bert ..late+ .bills music+ zoo");
}

TEST(TreeViewPeer, ExpandingAHugeBranchLetsTheProgramGoOnAndAKeyEndsIt) {
    TreeOnScreen screen;
    const NodeId root = screen.Add("root");
    constexpr int branches = 20'000;
    for (int branch = 0; branch < branches; ++branch) screen.Add("leaf", screen.Add("branch", root));
    screen.Settle();
    screen.Click("root");
    QTest::keyClick(&screen.view(), '*');
    const auto expanded = [&] {
        int count = 0;
        for (NodeId node = screen.nodes().FirstChild(root); node != noNode; node = screen.nodes().Next(node))
            count += screen.nodes().Expanded(node) ? 1 : 0;
        return count;
    };
    const int first = expanded();
    EXPECT_GT(first, 0);
    ASSERT_LT(first, branches);
    EXPECT_TRUE(QTest::qWaitFor([&] { return expanded() > first; }));
    screen.Key(Qt::Key_Shift);
    const int last = expanded();
    QTest::qWait(20);
    EXPECT_EQ(expanded(), last);
}

TEST(TreeViewPeer, BackspaceGoesToTheParent) {
    Sample screen;
    screen.tree.EnsureVisible(screen.Node("bert"));
    screen.Click("bert");
    screen.Key(Qt::Key_Backspace);
    EXPECT_EQ(screen.Selected(), "letters");
    screen.Key(Qt::Key_Backspace);
    screen.Key(Qt::Key_Backspace);
    EXPECT_EQ(screen.Selected(), "docs");
}

TEST(TreeViewPeer, TypingFindsVisibleNodesByTheirBeginning) {
    Sample screen;
    screen.tree.SetExpanded(screen.Node("docs"), true);
    screen.Settle();
    QTest::keyClicks(&screen.view(), "mu");
    EXPECT_EQ(screen.Selected(), "music");
    QTest::qWait(QApplication::keyboardInputInterval() + 50);
    QTest::keyClicks(&screen.view(), "B");
    EXPECT_EQ(screen.Selected(), "bills");
    QTest::qWait(QApplication::keyboardInputInterval() + 50);
    QTest::keyClicks(&screen.view(), "an");  // its branch is collapsed
    EXPECT_EQ(screen.Selected(), "bills");
}

TEST(TreeViewPeer, FromASelectionInACollapsedBranchTheKeysStartAtTheBranch) {
    Sample screen;
    screen.nodes().SetSelected(screen.Node("bert"));
    screen.Settle();
    EXPECT_EQ(screen.view().currentIndex().data().toString(), "docs");
    screen.Key(Qt::Key_Down);
    EXPECT_EQ(screen.Selected(), "music");
}

TEST(TreeViewPeer, EnterIsLeftToTheProgram) {
    Sample screen;
    screen.Click("docs");
    QKeyEvent press(QEvent::KeyPress, Qt::Key_Return, {}, "\r");
    QCoreApplication::sendEvent(&screen.view(), &press);
    EXPECT_EQ(screen.Rows(), "docs+* music+ zoo");
}

// The label edit.

struct EditedTree : Sample {
    EditedTree() {
        Click("music");
        owner.Heard();
        tree.StartLabelEdit();
        Settle();
    }
    LabelEditor* editor() {
        auto* editor = window.findChild<LabelEditor*>();
        return editor && editor->isVisible() ? editor : nullptr;
    }
};

TEST(TreeViewPeer, AnEditIsAcceptedByEnter) {
    EditedTree screen;
    ASSERT_TRUE(screen.editor());
    EXPECT_TRUE(screen.editor()->hasFocus());
    EXPECT_EQ(screen.editor()->selectedText(), "music");
    EXPECT_TRUE(screen.editor()->geometry().contains(screen.LabelPoint("music")));
    QTest::keyClicks(screen.editor(), "new*");
    QTest::keyClick(screen.editor(), Qt::Key_Down);
    QTest::keyClick(screen.editor(), Qt::Key_Return);
    EXPECT_EQ(screen.Events(), "BeforeLabelEdit | AfterLabelEdit new*");
    EXPECT_FALSE(screen.editor());
    EXPECT_TRUE(screen.view().hasFocus());
    EXPECT_EQ(screen.Rows(), "docs+ new*+* zoo");
}

TEST(TreeViewPeer, AnEditIsGivenUpByEscape) {
    EditedTree screen;
    QTest::keyClicks(screen.editor(), "new");
    QTest::keyClick(screen.editor(), Qt::Key_Escape);
    EXPECT_EQ(screen.Events(), "BeforeLabelEdit | LabelEditGivenUp");
    EXPECT_EQ(screen.Rows(), "docs+ music+* zoo");
}

TEST(TreeViewPeer, AnEditTakesWhatAnInputMethodComposes) {
    EditedTree screen;
    QInputMethodEvent composed;
    composed.setCommitString(QString::fromUtf8("\xE6\x97\xA5\xE6\x9C\xAC"));
    QCoreApplication::sendEvent(screen.editor(), &composed);
    QTest::keyClick(screen.editor(), Qt::Key_Return);
    EXPECT_EQ(screen.Selected(), "\xE6\x97\xA5\xE6\x9C\xAC");
}

TEST(TreeViewPeer, AnEditWhoseNodeGoesIsOver) {
    EditedTree screen;
    screen.nodes().Remove(screen.Node("music"));
    screen.Settle();
    EXPECT_FALSE(screen.editor());
    EXPECT_TRUE(screen.view().hasFocus());
}

TEST(TreeViewPeer, AnEditWhoseBranchIsCollapsedIsGivenUp) {
    Sample screen;
    screen.tree.SetExpanded(screen.Node("music"), true);
    screen.Settle();
    screen.Click("rock");
    screen.tree.StartLabelEdit();
    ASSERT_TRUE(screen.window.findChild<LabelEditor*>());
    screen.Events();
    screen.tree.SetExpanded(screen.Node("music"), false);
    screen.Settle();
    EXPECT_TRUE(QTest::qWaitFor([&] { return !screen.tree.Editing(); }));
    EXPECT_EQ(screen.Events(), "Collapse music + | LabelEditGivenUp");
    EXPECT_EQ(screen.nodes().Text(screen.Node("rock")), "rock");
}

TEST(TreeViewPeer, ASlowSecondClickOnTheLabelOrF2OpensItsEdit) {
    Sample screen;
    screen.Click("music");
    QTest::qWait(1);
    screen.Click("music");
    EXPECT_FALSE(screen.tree.Editing());
    EXPECT_TRUE(QTest::qWaitFor([&] { return screen.tree.Editing(); }));
    QTest::keyClick(screen.window.findChild<LabelEditor*>(), Qt::Key_Escape);
    ASSERT_FALSE(screen.tree.Editing());
    screen.Key(Qt::Key_F2);
    EXPECT_TRUE(screen.tree.Editing());
}

TEST(TreeViewPeer, AManualTreeOpensNoEditByTheUser) {
    Sample screen;
    screen.tree.SetLabelEdit(TreeLabelEditConstants::Manual);
    screen.Click("music");
    screen.Key(Qt::Key_F2);
    screen.Click("music");
    QTest::qWait(QApplication::doubleClickInterval() + 50);
    EXPECT_FALSE(screen.tree.Editing());
}

// Drops.

TEST(TreeViewPeer, ADropTargetIsShownAsIfItWereSelected) {
    Sample screen;
    screen.tree.SetFullRowSelect(true);
    screen.Settle();
    const auto mark = [&](const char* text) {
        return screen.Pixel({screen.port()->width() - 8, screen.CellOf(text).center().y()});
    };
    const QColor base = screen.view().palette().color(QPalette::Base);
    EXPECT_EQ(mark("zoo"), base);
    screen.tree.SetDropHighlight(screen.tree.NodeOf(screen.Node("zoo")));
    screen.Settle();
    EXPECT_EQ(mark("zoo"), screen.view().palette().color(QPalette::Active, QPalette::Highlight));
    EXPECT_EQ(mark("music"), base);
    screen.tree.SetDropHighlight(nullptr);
    screen.Settle();
    EXPECT_EQ(mark("zoo"), base);
}

TEST(TreeViewPeer, WhatIsDraggedOverTheTreeIsReportedWhereItTakesDrops) {
    Sample screen;
    struct Hearer {
        void Over(const child::DragDataRef& data, std::int32_t& effect, std::int16_t, std::int16_t, float, float y,
                  child::DragOverConstants) {
            files = data->Files.Count();
            hit = tree.HitTest(Twips(30), y);
            effect = frame::dropEffects::copy;
        }
        child::TreeView& tree;
        int files;
        child::TreeNodeRef hit;
    } hearer{screen.tree, 0, nullptr};
    screen.tree.OLEDragOver.To<&Hearer::Over>(hearer);
    EXPECT_FALSE(screen.port()->acceptDrops());
    screen.tree.SetOLEDropMode(child::OLEDropConstants::Manual);
    screen.Settle();
    ASSERT_TRUE(screen.port()->acceptDrops());
    QMimeData mime;
    mime.setUrls({QUrl::fromLocalFile("/a"), QUrl::fromLocalFile("/b")});
    QDragEnterEvent entered(screen.LabelPoint("music"), Qt::CopyAction | Qt::MoveAction, &mime, Qt::LeftButton, {});
    QCoreApplication::sendEvent(screen.port(), &entered);
    EXPECT_EQ(entered.dropAction(), Qt::CopyAction);
    EXPECT_EQ(hearer.files, 2);
    ASSERT_TRUE(hearer.hit);
    EXPECT_EQ(hearer.hit->Text(), "music");
}

// Looks.

/// Nearly the same colour: the style's mark of the focus may lie on it.
testing::AssertionResult Near(const QColor& seen, const QColor& wanted) {
    constexpr int most = 30;
    const int far = std::max(
        {std::abs(seen.red() - wanted.red()), std::abs(seen.green() - wanted.green()), std::abs(seen.blue() - wanted.blue())});
    if (far <= most) return testing::AssertionSuccess();
    return testing::AssertionFailure() << seen.name().toStdString() << " is not " << wanted.name().toStdString();
}

struct Pictured : Sample {
    Pictured() {
        owner.Image16.SetUseMaskColor(false);
        owner.Image16.Images().Add({}, "red", Square(16, 0xFF0000FF));
        owner.Image16.Images().Add({}, "green", Square(16, 0xFF00FF00));
        owner.Image16.Images().Add({}, "blue", Square(16, 0xFFFF0000));
        tree.SetImageList(&owner.Image16);
        nodes().SetImageKey(Node("docs"), NodeImage::Plain, "red").Check();
        nodes().SetImageKey(Node("docs"), NodeImage::Selected, "green").Check();
        nodes().SetImageKey(Node("docs"), NodeImage::Expanded, "blue").Check();
        tree.SetFullRowSelect(true);
        Settle();
    }
    QColor Icon() {
        const QRect sign = view().SignPlace(Row("docs"));
        return Pixel({sign.right() + 12, sign.center().y()});
    }
};

TEST(TreeViewPeer, ANodeShowsTheImageOfItsState) {
    Pictured screen;
    EXPECT_EQ(screen.Icon(), QColor(Qt::red));
    screen.tree.SetExpanded(screen.Node("docs"), true);
    screen.Settle();
    EXPECT_EQ(screen.Icon(), QColor(Qt::blue));
    screen.nodes().SetSelected(screen.Node("docs"));
    screen.Settle();
    EXPECT_TRUE(Near(screen.Icon(), Qt::green));
    screen.tree.SetStyle(TreeStyleConstants::PlusMinusText);
    screen.Settle();
    EXPECT_FALSE(Near(screen.Icon(), Qt::green));
}

TEST(TreeViewPeer, TheImagesOfADisabledTreeArePale) {
    Pictured screen;
    screen.tree.SetEnabled(false);
    screen.Settle();
    EXPECT_GT(screen.Icon().red(), 240);
    EXPECT_GT(screen.Icon().green(), 100);
}

TEST(TreeViewPeer, OnlyNodesWithChildrenHaveASignAndOnlyInStylesWithSigns) {
    Sample screen;
    EXPECT_FALSE(screen.view().SignPlace(screen.Row("docs")).isEmpty());
    EXPECT_TRUE(screen.view().SignPlace(screen.Row("zoo")).isEmpty());
    const auto painted = [&](const char* text) {
        const QRect cell(0, screen.CellOf(text).top() + 2, 19, screen.CellOf(text).height() - 4);
        const QImage image = screen.port()->grab(cell).toImage();
        for (int y = 0; y < image.height(); ++y)
            for (int x = 0; x < image.width(); ++x)
                if (image.pixelColor(x, y) != screen.view().palette().color(QPalette::Base)) return true;
        return false;
    };
    screen.view().clearFocus();
    screen.tree.SetStyle(TreeStyleConstants::PlusPictureText);
    screen.Settle();
    EXPECT_TRUE(painted("docs"));
    EXPECT_FALSE(painted("zoo"));
    screen.tree.SetStyle(TreeStyleConstants::TreelinesPictureText);
    screen.Settle();
    EXPECT_TRUE(screen.view().SignPlace(screen.Row("docs")).isEmpty());
}

TEST(TreeViewPeer, AHiddenSelectionShowsOnlyWithTheFocus) {
    Sample screen;
    screen.tree.SetFullRowSelect(true);
    screen.nodes().SetSelected(screen.Node("music"));
    screen.Settle();
    const auto mark = [&] { return screen.Pixel({screen.port()->width() - 8, screen.CellOf("music").center().y()}); };
    const QColor base = screen.view().palette().color(QPalette::Base);
    EXPECT_TRUE(Near(mark(), screen.view().palette().color(QPalette::Active, QPalette::Highlight)));
    screen.view().clearFocus();
    EXPECT_EQ(mark(), base);
    screen.tree.SetHideSelection(false);
    screen.Settle();
    EXPECT_NE(mark(), base);
}

TEST(TreeViewPeer, ANodeMayHaveItsOwnColoursAndBeBold) {
    Sample screen;
    screen.tree.SetFullRowSelect(true);
    screen.nodes().SetColors(screen.Node("music"), {frame::Rgb(10, 200, 30), {}});
    screen.tree.SetBackColor(frame::Rgb(200, 220, 240));
    screen.Settle();
    const auto at = [&](const char* text) { return screen.Pixel({screen.port()->width() - 8, screen.CellOf(text).center().y()}); };
    EXPECT_EQ(at("music"), QColor(10, 200, 30));
    EXPECT_EQ(at("zoo"), QColor(200, 220, 240));
    screen.tree.SetFullRowSelect(false);
    screen.Settle();
    screen.nodes().SetText(screen.Node("docs"), "MMMMMMMMMMMM");
    screen.Settle();
    const int thin = screen.view().LabelPlace(screen.Row("MMMMMMMMMMMM")).width();
    screen.nodes().SetBold(screen.Node("MMMMMMMMMMMM"), true);
    screen.Settle();
    EXPECT_GT(screen.view().LabelPlace(screen.Row("MMMMMMMMMMMM")).width(), thin);
}

TEST(TreeViewPeer, HotTrackingShowsTheNodeUnderThePointer) {
    Sample screen;
    screen.tree.SetHotTracking(true);
    screen.tree.SetFullRowSelect(true);
    screen.Settle();
    const auto at = [&](const char* text) { return screen.Pixel({screen.port()->width() - 8, screen.CellOf(text).center().y()}); };
    const QColor base = screen.view().palette().color(QPalette::Base);
    screen.Move(screen.LabelPoint("music"));
    EXPECT_NE(at("music"), base);
    EXPECT_EQ(at("zoo"), base);
    QEvent left(QEvent::Leave);
    QCoreApplication::sendEvent(screen.port(), &left);
    EXPECT_EQ(at("music"), base);
}

TEST(TreeViewPeer, SystemColoursAreThoseOfThePalette) {
    TreeOnScreen screen;
    QPalette dark;
    dark.setColor(QPalette::Base, QColor(20, 20, 20));
    dark.setColor(QPalette::Text, QColor(240, 240, 240));
    screen.window.setPalette(dark);
    EXPECT_EQ(screen.Pixel({100, 100}), QColor(20, 20, 20));
}

// Assistive programs.

TEST(TreeViewPeer, AssistiveProgramsSeeNodesWithTheirLevelAndState) {
    Sample screen;
    screen.tree.SetExpanded(screen.Node("docs"), true);
    screen.Settle();
    screen.Click("letters");
    QAccessibleInterface* const tree = QAccessible::queryAccessibleInterface(&screen.view());
    ASSERT_TRUE(tree);
    EXPECT_EQ(tree->role(), QAccessible::Tree);
    EXPECT_EQ(tree->childCount(), 5);
    QAccessibleInterface* const docs = tree->child(0);
    QAccessibleInterface* const letters = tree->child(1);
    EXPECT_EQ(docs->role(), QAccessible::TreeItem);
    EXPECT_EQ(docs->text(QAccessible::Name), "docs");
    EXPECT_EQ(docs->text(QAccessible::Description), "Level 1");
    EXPECT_EQ(letters->text(QAccessible::Description), "Level 2");
    EXPECT_TRUE(docs->state().expandable && docs->state().expanded && !docs->state().collapsed);
    EXPECT_TRUE(letters->state().collapsed && letters->state().selected && letters->state().focused);
    EXPECT_FALSE(tree->child(2)->state().expandable);
    EXPECT_EQ(tree->focusChild(), letters);
    EXPECT_EQ(tree->indexOfChild(letters), 1);
    const QPoint at = letters->rect().center();
    EXPECT_EQ(tree->childAt(at.x(), at.y()), letters);
    EXPECT_EQ(tree->tableInterface()->selectedRows(), QList<int>{1});
}

TEST(TreeViewPeer, AssistiveProgramsToggleAndSelectNodes) {
    Sample screen;
    QAccessibleInterface* const tree = QAccessible::queryAccessibleInterface(&screen.view());
    QAccessibleInterface* const music = tree->child(1);
    ASSERT_TRUE(music->actionInterface());
    EXPECT_EQ(music->actionInterface()->actionNames(),
              (QStringList{QAccessibleActionInterface::toggleAction(), QAccessibleActionInterface::pressAction()}));
    music->actionInterface()->doAction(QAccessibleActionInterface::toggleAction());
    EXPECT_EQ(screen.Rows(), "docs+ music- .rock zoo");
    EXPECT_EQ(tree->childCount(), 4);
    music->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    EXPECT_EQ(screen.Selected(), "music");
    QAccessibleInterface* const rock = tree->child(2);
    EXPECT_EQ(rock->actionInterface()->actionNames(), QStringList{QAccessibleActionInterface::pressAction()});
    music->actionInterface()->doAction(QAccessibleActionInterface::toggleAction());
    EXPECT_FALSE(rock->isValid());
    EXPECT_EQ(tree->childCount(), 3);
}

// Handlers that end or change the tree.

TEST(TreeViewPeer, AControlThatItsOwnEventEndsBreaksNothing) {
    const auto ends = [](auto&& act) {
        Sample screen;
        bool ended = false;
        screen.owner.atClick = screen.owner.atExpand = [&](const child::TreeNodeRef&) {
            ended = true;
            screen.widget.reset();
        };
        act(screen);
        EXPECT_TRUE(ended);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    };
    ends([](Sample& screen) { screen.Click("docs"); });
    ends([](Sample& screen) { screen.ClickSign("docs"); });
    ends([](Sample& screen) { screen.Key(Qt::Key_Down); });
    ends([](Sample& screen) {
        screen.nodes().SetSelected(screen.Node("docs"));
        screen.Settle();
        screen.Key(Qt::Key_Asterisk);
    });
    ends([](Sample& screen) {
        screen.tree.SetSingleSel(true);
        screen.Click("docs");
    });
    ends([](Sample& screen) { QTest::keyClicks(&screen.view(), "m"); });
}

TEST(TreeViewPeer, AControlThatItsEditEndsBreaksNothing) {
    EditedTree screen;
    screen.owner.atEditEnd = [&](bool&, std::string&) { screen.widget.reset(); };
    QTest::keyClick(screen.editor(), Qt::Key_Return);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    EXPECT_FALSE(screen.window.findChild<TreeWidget*>());
}

TEST(TreeViewPeer, NodesClearedByAClickAreGone) {
    Sample screen;
    screen.owner.atClick = [&](const child::TreeNodeRef&) { screen.nodes().Clear(); };
    screen.Click("docs");
    EXPECT_EQ(screen.view().model()->rowCount(), 0);
    screen.ClickAt({30, 10});
    for (const Qt::Key key : {Qt::Key_Down, Qt::Key_Right, Qt::Key_PageDown, Qt::Key_Asterisk, Qt::Key_Backspace, Qt::Key_F2})
        screen.Key(key);
    QTest::keyClicks(&screen.view(), "x");
    EXPECT_TRUE(screen.errors.reports.empty());
}

}  // namespace
}  // namespace tessel::qt::test
