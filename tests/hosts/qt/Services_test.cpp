#include <QAbstractButton>
#include <QFile>
#include <QMessageBox>
#include <QSignalSpy>
#include <QTemporaryDir>
#include <cstdlib>

#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

class ServicesTest : public test::QtTest {};

TEST_F(ServicesTest, TheReplacedShellAndBoxesAreAsked) {
    Link* link = Shown();
    shell.executeResults = {31};
    Click(link, {100, 20});
    ASSERT_EQ(log.Of("msgbox").size(), 1u);
    EXPECT_EQ(log.Of("msgbox")[0][1].ToText(), "Error 31: No application associated with file 'a.txt'");
    EXPECT_EQ(Executed(), "open a.txt");
}

/// Whoever asks for files must not fall into nothing: a service that is not offered still answers.
TEST_F(ServicesTest, AHostHasAllItsServices) {
    const std::shared_ptr<Host> made = Host::make();
    frame::Host& own = made->frameHost();
    EXPECT_FALSE(own.Files().FileExists("no such file"));
    EXPECT_EQ(own.Files().Separator(), '/');
    EXPECT_FALSE(own.Clipboard().Has(1));
}

TEST_F(ServicesTest, APrintPressPrints) {
    Link* link = Shown();
    link->setClickAction(Link::Print_Link);
    Click(link, {100, 20});
    EXPECT_EQ(Executed(), "print a.txt");
}

TEST_F(ServicesTest, TargetsAreDataAsTheyStand) {
    Link* link = Shown();
    for (const char* target : {"--help", "$(x)", "a b'c\"", "two\nlines", "-", "%s", "caf\xC3\xA9"}) {
        link->setLinkTo(target);
        Click(link, {100, 20});
        EXPECT_EQ(Executed(), std::string("open ") + target);
    }
}

TEST_F(ServicesTest, ALinkWithoutATargetOpensItsCaption) {
    Link* link = Shown();
    link->setLinkTo("");
    link->setCaption("c.txt");
    Click(link, {100, 20});
    EXPECT_EQ(Executed(), "open c.txt");
    link->setCaption("");
    Click(link, {100, 20});
    EXPECT_EQ(Executed(), "");
}

class CountingErrors final : public frame::ErrorSink {
  public:
    void Unhandled(const frame::ControlError& error, const std::string&) override { numbers.push_back(error.Number()); }
    std::vector<int> numbers;
};

TEST_F(ServicesTest, AReplacedErrorSinkTakesTheErrors) {
    CountingErrors sink;
    frame::Services replaced;
    replaced.errors = &sink;
    {
        auto other = Host::make(replaced);
        QSignalSpy spy(other.get(), &Host::unhandledError);
        QWidget form;
        Host::attach(&form, other);
        Link link(&form);
        link.setBag("{");
        EXPECT_EQ(spy.count(), 0);
    }
    test::Settle();
    EXPECT_EQ(sink.numbers, std::vector<int>{380});
}

TEST_F(ServicesTest, ReplacedMetricsDecideTheSize) {
    headless::FixedMetrics metrics;
    frame::Services replaced;
    replaced.metrics = &metrics;
    {
        auto other = Host::make(replaced);
        QWidget form;
        Host::attach(&form, other);
        Link link(&form);
        link.setAutoSize(true);
        link.setCaption("12345");
        EXPECT_EQ(link.size(), QSize(30, 13));
        EXPECT_EQ(link.sizeHint(), QSize(30, 13));
    }
    test::Settle();
}

TEST_F(ServicesTest, AHostMeasuresTextsByTheirLines) {
    frame::TextMetrics& metrics = host->frameHost().Metrics();
    const frame::Font font("DejaVu Sans", 12);
    const frame::TextSize one = metrics.Measure(font, "one");
    const frame::TextSize two = metrics.Measure(font, "one\ntwo");
    EXPECT_GT(one.width, 0);
    EXPECT_NEAR(two.height, 2 * one.height, 16);
    EXPECT_EQ(metrics.Measure(font, "one\r\none"), metrics.Measure(font, "one\none"));
    EXPECT_EQ(metrics.Measure(font, "one\none").width, one.width);
    EXPECT_GT(metrics.Measure(font, "one\n").height, one.height);
    EXPECT_EQ(metrics.Measure(font, "").width, 0);
    const frame::TextSize wrapped = metrics.Measure(font, "several words in a row", 1200);
    EXPECT_LE(wrapped.width, 1200);
    EXPECT_GE(wrapped.height, 2 * one.height);
    EXPECT_GT(metrics.Measure(font, "&").width, 0);
}

/// A form whose host has its own boxes; only the shell is scripted.
class BoxTest : public test::QtTest {
  protected:
    BoxTest() {
        frame::Services replaced;
        replaced.shell = &shell;
        Host::attach(window, Host::make(replaced));
        shell.executeResults = {2};
    }
    /// Runs `act`, which opens a box, and what the user does with it.
    void WithBox(const std::function<void()>& act, const std::function<void(QMessageBox&)>& user) {
        QTimer poll;
        QObject::connect(&poll, &QTimer::timeout, &poll, [&] {
            const QPointer<QMessageBox> box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            if (!box) return;
            poll.stop();
            seen = true;
            user(*box);
            if (box) box->close();
        });
        poll.start(0);
        act();
    }
    bool seen = false;
};

TEST_F(BoxTest, AFailureIsShownInABoxOfTheToolkitAsPlainText) {
    QPointer<Link> link = Shown();
    link->setLinkTo("<b>no</b> & such");
    WithBox([&] { link->press(); },
            [&](QMessageBox& box) {
                EXPECT_EQ(box.text(), "Error 2: Unable to find file '<b>no</b> & such'");
                EXPECT_EQ(box.textFormat(), Qt::PlainText);
                box.button(QMessageBox::Ok)->click();
            });
    EXPECT_TRUE(seen);
    EXPECT_TRUE(link);
}

TEST_F(BoxTest, ALinkIsDeletedWhileItsBoxIsOpen) {
    QPointer<Link> link = Shown();
    WithBox([&] { link->press(); }, [&](QMessageBox&) { delete link.data(); });
    EXPECT_TRUE(seen);
    test::Settle();
    EXPECT_FALSE(link);
}

TEST_F(BoxTest, TheFormIsClosedWhileTheBoxIsOpen) {
    QPointer<Link> link = Shown();
    WithBox([&] { link->press(); }, [&](QMessageBox&) { delete window.data(); });
    EXPECT_TRUE(seen);
    test::Settle();
    EXPECT_FALSE(link);
}

TEST_F(BoxTest, ChangesMadeWhileTheBoxIsOpenAreSeen) {
    Link* link = Shown();
    const QImage before = link->grab().toImage();
    QImage during;
    WithBox([&] { link->press(); },
            [&](QMessageBox&) {
                link->setCaption("quite another");
                test::Settle();
                during = link->grab().toImage();
            });
    EXPECT_NE(during, before);
}

TEST_F(ServicesTest, APictureIsLoadedOrRefusedByNumber) {
    frame::PictureLoader& pictures = host->frameHost().Pictures();
    QTemporaryDir folder;
    QImage image(4, 2, QImage::Format_RGB32);
    image.fill(Qt::red);
    ASSERT_TRUE(image.save(folder.filePath("a.png")));
    QFile text(folder.filePath("text.png"));
    ASSERT_TRUE(text.open(QIODevice::WriteOnly));
    text.write("no picture");
    text.close();
    EXPECT_EQ(pictures.LoadPicture(folder.filePath("a.png").toStdString())->Width(), 60);
    EXPECT_EQ(test::ErrorOf([&] { pictures.LoadPicture(folder.filePath("none.png").toStdString()); }), 53);
    EXPECT_EQ(test::ErrorOf([&] { pictures.LoadPicture(folder.filePath("text.png").toStdString()); }), 481);
    EXPECT_EQ(pictures.LoadPicture("")->Plane(1), nullptr);
}

TEST_F(ServicesTest, ManyChangesCostOneUpdate) {
    Link* link = Shown();
    test::Settle();
    struct Paints final : QObject {
        bool eventFilter(QObject*, QEvent* event) override {
            if (event->type() == QEvent::Paint) ++count;
            return false;
        }
        int count = 0;
    } paints;
    window->childAt(At(link, {100, 20}))->installEventFilter(&paints);
    for (int i = 0; i < 2000; ++i) link->control().SetForeColor(static_cast<std::uint32_t>(i));
    test::Settle();
    EXPECT_GE(paints.count, 1);
    EXPECT_LE(paints.count, 2);
}

}  // namespace
}  // namespace tessel::qt
