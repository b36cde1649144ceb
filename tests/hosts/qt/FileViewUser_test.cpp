#include <QPlainTextEdit>
#include <QScrollBar>
#include <QVBoxLayout>

#include "frame/Text.h"
#include "hosts/headless/MemoryDisk.h"
#include "hosts/qt/FileView.h"
#include "hosts/qt/LabelEditor.h"
#include "hosts/qt/ListWidget.h"
#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

struct HasDisk {
    headless::MemoryDisk disk;
};

/// A list of files in a window, and who sits before it.
class FileViewUserTest : protected HasDisk, public test::QtTest {
  protected:
    static constexpr int nameColumn = 0, sizeColumn = 1;

    FileViewUserTest() : QtTest(nullptr, &disk) { window->resize(700, 300); }

    void File(const std::string& name, std::int64_t size = 0) { disk.SetFile("C:\\x\\" + name, {.size = size}).Check(); }
    void Folder(const std::string& name) { disk.SetFolder("C:\\x\\" + name, {}).Check(); }
    void Remove(const std::string& name) { disk.Remove("C:\\x\\" + name).Check(); }
    /// "100.txt" and so on.
    void Files(int first, int end) {
        for (int number = first; number < end; ++number) File(frame::Decimal(number) + ".txt", number);
    }
    /// A list that shows the folder, with the focus.
    FileView& Shown() {
        view = new FileView(window);
        view->setObjectName("FileView1");
        view->setGeometry(0, 0, 700, 300);
        const auto note = [this](const char* name) { return [this, name] { heard.push_back(name); }; };
        QObject::connect(view, &FileView::itemClick, view,
                         [this](int& index) { heard.push_back("ItemClick(" + frame::Decimal(index) + ")"); });
        QObject::connect(view, &FileView::click, view, note("Click"));
        QObject::connect(view, &FileView::dblClick, view, note("DblClick"));
        QObject::connect(view, &FileView::mouseDown, view, note("MouseDown"));
        QObject::connect(view, &FileView::mouseUp, view, note("MouseUp"));
        QObject::connect(view, &FileView::keyDown, view, note("KeyDown"));
        QObject::connect(view, &FileView::keyPress, view, note("KeyPress"));
        QObject::connect(view, &FileView::keyUp, view, note("KeyUp"));
        QObject::connect(view, &FileView::refreshFoundChanges, view, note("RefreshFoundChanges"));
        Show();
        view->setPathRoot("C:\\x");
        test::Settle();
        list().setFocus();
        Events();
        return *view;
    }

    ListWidget& list() { return *view->findChild<ListWidget*>(); }
    QWidget* port() { return list().viewport(); }
    child::ListView& inside() { return view->control().ListFiles; }
    child::ListRows& rows() { return inside().Rows(); }
    QRect CellOf(int row) { return list().visualRect(list().model()->index(row, 0)); }
    /// A point of the row's label, or of its large icon.
    QPoint LabelOf(int row) {
        constexpr int insideIcon = 18;
        const QRect cell = CellOf(row);
        if (view->view() == FileView::Icon) return {cell.center().x(), cell.top() + insideIcon};
        return cell.topLeft() + QPoint(30, cell.height() / 2);
    }
    void ClickRow(int row) { Click(port(), LabelOf(row)); }
    QPoint MiddleOf(int column) {
        const ListHeader& header = list().Header();
        return {header.sectionViewportPosition(column) + header.sectionSize(column) / 2, header.height() / 2};
    }
    void ClickHeader(int column) {
        Click(list().Header().viewport(), MiddleOf(column));
        test::Settle();
    }
    void Key(int key, Qt::KeyboardModifiers modifiers = {}) {
        QTest::keyClick(&list(), static_cast<Qt::Key>(key), modifiers);
        test::Settle();
    }
    std::string Labels() {
        std::string all;
        for (int row = 0; row < list().model()->rowCount(); ++row)
            all += (row == 0 ? "" : " | ") + list().model()->index(row, 0).data().toString().toStdString();
        return all;
    }
    /// The label of the row with the focus, with "*" behind it when that is selected.
    std::string Current() {
        const auto focus = inside().FocusRow();
        return focus ? rows().Text(*focus, 0) + (rows().Selected(*focus) ? "*" : "") : "";
    }
    std::string Selected() {
        std::string all;
        for (child::ListRows::Position row = 0; row < rows().Count(); ++row)
            if (rows().Selected(rows().At(row))) all += (all.empty() ? "" : " | ") + rows().Text(rows().At(row), 0);
        return all;
    }
    std::string FirstInView() { return rows().Text(rows().At(list().FirstVisible()), 0); }
    bool HasArrow(int column) {
        return !list().model()->headerData(column, Qt::Horizontal, Qt::DecorationRole).value<QPixmap>().isNull() ||
               !list().model()->headerData(column, Qt::Horizontal, Qt::DecorationRole).value<QIcon>().isNull();
    }
    QImage Painted(int column) {
        const ListHeader& header = list().Header();
        const QRect place(header.sectionViewportPosition(column), 0, header.sectionSize(column), header.height());
        MoveTo(window, {690, 290});  // a header under the pointer looks otherwise
        return list().Header().viewport()->grab(place).toImage();
    }

    QPointer<FileView> view;
};

// Headers.

TEST_F(FileViewUserTest, ClickingAHeaderSortsAndShowsAnArrow) {
    File("a.txt", 30);
    File("b.txt", 10);
    File("c.txt", 20);
    Shown();
    const QImage plain = Painted(sizeColumn);
    const QRect line = CellOf(0);
    const int height = list().Header().height();
    EXPECT_EQ(Labels(), "a.txt | b.txt | c.txt");
    ClickHeader(sizeColumn);
    EXPECT_EQ(Labels(), "b.txt | c.txt | a.txt");
    EXPECT_TRUE(HasArrow(sizeColumn));
    const QImage down = Painted(sizeColumn);
    EXPECT_NE(down, plain);
    ClickHeader(sizeColumn);
    EXPECT_EQ(Labels(), "a.txt | c.txt | b.txt");
    const QImage up = Painted(sizeColumn);
    EXPECT_NE(up, plain);
    EXPECT_NE(up, down);
    EXPECT_EQ(list().Header().height(), height) << "rows do not jump when an arrow comes";
    EXPECT_EQ(CellOf(0), line);
    ClickHeader(nameColumn);
    EXPECT_EQ(Labels(), "a.txt | b.txt | c.txt");
    EXPECT_FALSE(HasArrow(sizeColumn));
    EXPECT_TRUE(HasArrow(nameColumn));
    EXPECT_EQ(Painted(sizeColumn), plain);
}

TEST_F(FileViewUserTest, TheFirstClickOnTheNamesTurnsTheirOrderRound) {
    File("a.txt");
    Folder("sub");
    File("b.txt");
    Shown();
    ClickHeader(nameColumn);
    EXPECT_EQ(Labels(), "b.txt | a.txt | sub");
    ClickHeader(nameColumn);
    EXPECT_EQ(Labels(), "sub | a.txt | b.txt");
}

TEST_F(FileViewUserTest, SizesStandAtTheRightOfTheirColumn) {
    File("a.txt", 1);
    Shown();
    EXPECT_TRUE(list().model()->headerData(sizeColumn, Qt::Horizontal, Qt::TextAlignmentRole).toInt() & Qt::AlignRight);
    EXPECT_FALSE(list().Header().isSectionHidden(sizeColumn));
    constexpr int sortedSize = 7, sortName = 12;
    EXPECT_TRUE(list().Header().isSectionHidden(sortedSize));
    EXPECT_TRUE(list().Header().isSectionHidden(sortName));
}

// The mouse and the keyboard.

TEST_F(FileViewUserTest, AClickSelectsARowAndTellsTheApplication) {
    Files(100, 105);
    Shown();
    ClickRow(2);
    EXPECT_EQ(Selected(), "102.txt");
    EXPECT_EQ(view->itemIndex(), 3);
    EXPECT_EQ(Events(), "MouseDown ItemClick(3) MouseUp Click");
}

TEST_F(FileViewUserTest, TheKeyboardMovesTheSelection) {
    Files(100, 200);
    Shown();
    ClickRow(0);
    Events();
    Key(Qt::Key_Down);
    EXPECT_EQ(Current(), "101.txt*");
    EXPECT_EQ(Events(), "KeyDown KeyUp");
    EXPECT_EQ(view->selectedItem(), 2);
    EXPECT_EQ(view->itemIndex(), 1) << "only clicks move the cursor of the properties";
    Key(Qt::Key_End);
    EXPECT_EQ(Selected(), "199.txt");
    EXPECT_TRUE(port()->rect().contains(CellOf(99).center()));
    Key(Qt::Key_PageUp);
    EXPECT_LT(view->selectedItem(), 95);
    EXPECT_EQ(Selected() + "*", Current());
    Key(Qt::Key_Home);
    EXPECT_EQ(Selected(), "100.txt");
    EXPECT_EQ(FirstInView(), "100.txt");
    EXPECT_TRUE(Errors().empty());
}

TEST_F(FileViewUserTest, SeveralRowsAreSelectedWhereThatIsAllowed) {
    Files(100, 105);
    Shown().setMultiSelect(true);
    ClickRow(1);
    Key(Qt::Key_Down, Qt::ShiftModifier);
    Key(Qt::Key_Down, Qt::ShiftModifier);
    EXPECT_EQ(Selected(), "101.txt | 102.txt | 103.txt");
}

TEST_F(FileViewUserTest, TypingFindsRows) {
    for (const char* name : {"alpha", "beta", "bravo", "gamma"}) File(name);
    Shown();
    ClickRow(0);
    Events();
    QTest::keyClicks(&list(), "br");
    EXPECT_EQ(Current(), "bravo*");
    EXPECT_EQ(view->selectedItem(), 3);
    EXPECT_EQ(Events(), "KeyDown KeyPress KeyUp KeyDown KeyPress KeyUp");
}

TEST_F(FileViewUserTest, TheIndexIsThatOfTheOrderWhichTheUserSees) {
    File("a.txt", 30);
    File("b.txt", 10);
    File("c.txt", 20);
    Shown();
    ClickHeader(sizeColumn);
    ClickRow(0);
    EXPECT_EQ(view->itemIndex(), 1);
    EXPECT_EQ(view->itemName(), "b.txt");
}

TEST_F(FileViewUserTest, AListThatIsNotEnabledTakesNothing) {
    Files(100, 105);
    Shown().setControlEnabled(false);
    test::Settle();
    ClickRow(2);
    EXPECT_EQ(Selected(), "");
    EXPECT_EQ(Events(), "");
}

// Size.

TEST_F(FileViewUserTest, TheListFillsAWindowOfAnySize) {
    Files(100, 103);
    Shown();
    delete window->layout();
    auto* layout = new QVBoxLayout(window);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(view);
    for (const QSize size : {QSize(500, 400), QSize(300, 150), QSize(800, 200)}) {
        window->resize(size);
        test::Settle();
        EXPECT_EQ(view->size(), size);
        EXPECT_EQ(list().mapTo(window.data(), QPoint()), QPoint());
        EXPECT_EQ(list().size(), size);
    }
}

// Views.

TEST_F(FileViewUserTest, TheViewChangesToIconsAndBack) {
    Files(100, 160);
    Shown();
    ClickRow(1);
    Key(Qt::Key_Down);
    const QRect line = CellOf(2);
    for (const auto other : {FileView::Icon, FileView::SmallIcon, FileView::List}) {
        view->setView(other);
        test::Settle();
        EXPECT_FALSE(list().Header().isVisible());
        EXPECT_NE(CellOf(2), line);
        EXPECT_EQ(Current(), "102.txt*");
        ClickRow(4);
        EXPECT_EQ(Selected(), "104.txt");
        ClickRow(2);
        view->setView(FileView::Report);
        test::Settle();
        EXPECT_TRUE(list().Header().isVisible());
        EXPECT_EQ(CellOf(2), line);
        EXPECT_EQ(Current(), "102.txt*");
    }
}

// The message.

TEST_F(FileViewUserTest, AnEmptyFolderShowsItsMessageBelowTheHeaders) {
    disk.SetFolder("C:\\x", {}).Check();
    Shown();
    auto* message = view->findChild<QPlainTextEdit*>();
    ASSERT_NE(message, nullptr);
    EXPECT_TRUE(message->isVisible());
    EXPECT_EQ(message->toPlainText(), "There are no items to show in this folder.");
    const QRect place(message->mapTo(view.data(), QPoint()), message->size());
    EXPECT_TRUE(view->rect().contains(place)) << place.width() << "x" << place.height();
    EXPECT_GE(place.top(), list().Header().geometry().bottom());
    EXPECT_EQ(view->childAt(place.center())->window(), window);
    EXPECT_TRUE(message->isAncestorOf(view->childAt(place.center()))) << "it stands over the list";
    EXPECT_TRUE(message->isReadOnly());
    view->setPathRoot("C:\\none");
    test::Settle();
    EXPECT_EQ(view->findChild<QPlainTextEdit*>()->toPlainText(), "Folder 'C:\\none' does not exist.");
    File("a.txt");
    view->setPathRoot("C:\\x");
    test::Settle();
    EXPECT_FALSE(view->findChild<QPlainTextEdit*>()->isVisible());
    ClickRow(0);
    EXPECT_EQ(Selected(), "a.txt");
}

// Refreshing and sorting under the user's eyes.

TEST_F(FileViewUserTest, ARefreshKeepsTheSelectionTheCurrentRowAndThePlace) {
    Files(100, 300);
    Shown();
    list().verticalScrollBar()->setValue(list().verticalScrollBar()->maximum() / 2);
    const auto first = static_cast<int>(list().FirstVisible());
    ASSERT_GT(first, 20);
    ClickRow(first + 4);
    const std::string current = Current(), top = FirstInView();
    const int place = CellOf(first + 4).top();
    Remove(frame::Decimal(100 + first + 2) + ".txt");
    view->refresh();
    test::Settle();
    EXPECT_EQ(rows().Count(), 199u);
    EXPECT_EQ(Current(), current);
    EXPECT_EQ(Selected() + "*", current);
    EXPECT_EQ(FirstInView(), top);
    EXPECT_EQ(CellOf(first + 3).top(), place - CellOf(first).height()) << "one row less stands above it";
    Key(Qt::Key_Down);
    EXPECT_EQ(view->selectedItem(), first + 5);
}

TEST_F(FileViewUserTest, ASortKeepsTheSelectionAndTheCurrentRow) {
    Files(100, 300);
    Shown();
    ClickRow(3);
    ClickHeader(sizeColumn);
    ClickHeader(sizeColumn);
    EXPECT_EQ(rows().Text(rows().At(0), 0), "299.txt");
    EXPECT_EQ(Current(), "103.txt*");
    EXPECT_EQ(Selected(), "103.txt");
    list().setFocus();
    Key(Qt::Key_Up);
    EXPECT_EQ(Current(), "104.txt*");
}

TEST_F(FileViewUserTest, ASortLeavesTheListScrolledAsItIs) {
    Files(100, 300);
    Shown();
    list().verticalScrollBar()->setValue(list().verticalScrollBar()->maximum() / 2);
    const int scrolled = list().verticalScrollBar()->value();
    ClickHeader(sizeColumn);
    EXPECT_EQ(list().verticalScrollBar()->value(), scrolled);
    ClickHeader(sizeColumn);
    EXPECT_EQ(list().verticalScrollBar()->value(), scrolled);
}

TEST_F(FileViewUserTest, TheTimerRefreshesTheListByItself) {
    Files(100, 110);
    Shown().setRefreshInterval(1);
    Remove("104.txt");
    File("new.txt");
    EXPECT_TRUE(QTest::qWaitFor([&] { return Labels().find("new.txt") != std::string::npos; }));
    EXPECT_EQ(Labels().find("104.txt"), std::string::npos);
    EXPECT_NE(Events().find("RefreshFoundChanges"), std::string::npos);
}

// Editing a label.

class FileViewEditTest : public FileViewUserTest {
  protected:
    LabelEditor* Editor() { return view->findChild<LabelEditor*>(); }
    /// The user types into the label of a row.
    void Edit(int row, const char* typed) {
        ClickRow(row);
        inside().StartLabelEdit();
        test::Settle();
        ASSERT_NE(Editor(), nullptr);
        Editor()->selectAll();
        QTest::keyClicks(Editor(), typed);
    }
};

TEST_F(FileViewEditTest, AnOpenEditSurvivesARefresh) {
    Files(100, 120);
    Shown();
    Edit(5, "half a na");
    Remove("102.txt");
    File("new.txt");
    view->refresh();
    test::Settle();
    ASSERT_NE(Editor(), nullptr);
    EXPECT_TRUE(Editor()->isVisible());
    EXPECT_TRUE(Editor()->hasFocus());
    EXPECT_EQ(Editor()->text(), "half a na");
    EXPECT_TRUE(CellOf(4).intersects(Editor()->geometry())) << "over its row, which stands higher";
    EXPECT_FALSE(CellOf(5).contains(Editor()->geometry().center()));
    QTest::keyClicks(Editor(), "me");
    QTest::keyClick(Editor(), Qt::Key_Escape);
    test::Settle();
    EXPECT_EQ(Editor(), nullptr);
    EXPECT_EQ(rows().Text(rows().At(4), 0), "105.txt");
}

TEST_F(FileViewEditTest, AnOpenEditFollowsItsRowIntoAnotherOrder) {
    Files(100, 110);
    Shown();
    Edit(1, "name");
    view->control().ListFiles.SetSortOrder(child::ListSortOrderConstants::Descending);
    view->control().ListFiles.SetSorted(true);
    test::Settle();
    ASSERT_NE(Editor(), nullptr);
    EXPECT_EQ(Editor()->text(), "name");
    EXPECT_TRUE(CellOf(8).intersects(Editor()->geometry()));
}

TEST_F(FileViewEditTest, AnEditEndsWithItsRow) {
    Files(100, 110);
    Shown();
    Edit(3, "name");
    Remove("103.txt");
    view->refresh();
    test::Settle();
    EXPECT_EQ(Editor(), nullptr);
    EXPECT_EQ(rows().Count(), 9u);
    EXPECT_TRUE(list().hasFocus());
    EXPECT_EQ(Errors(), "");
}

// While a listing goes on.

TEST_F(FileViewUserTest, ALongListingLetsTheUserIn) {
    Files(100, 1000);
    Shown();
    std::vector<int> seen;
    QTimer::singleShot(0, view.data(), [&] {
        seen.push_back(view->itemCount());
        ClickRow(1);
        Key(Qt::Key_Down);
    });
    view->setPathRoot("C:\\x");
    ASSERT_EQ(seen.size(), 1u);
    EXPECT_LT(seen[0], 900);
    EXPECT_EQ(view->itemCount(), 900);
    test::Settle();
    EXPECT_EQ(Current(), "102.txt*");
    EXPECT_EQ(Errors(), "");
}

TEST_F(FileViewUserTest, TheUserMayCloseTheWindowWhileAListingGoesOn) {
    Files(100, 1000);
    Shown();
    QTimer::singleShot(0, view.data(), [&] { delete window.data(); });
    view->setPathRoot("C:\\x");
    EXPECT_TRUE(view.isNull());
    EXPECT_EQ(Errors(), "");
}

}  // namespace
}  // namespace tessel::qt
