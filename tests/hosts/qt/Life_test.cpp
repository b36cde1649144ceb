#include <QLoggingCategory>
#include <functional>
#include <stdexcept>

#include "tests/hosts/qt/QtTest.h"

namespace tessel::qt {
namespace {

/// A message box during which anything may happen.
class BusyBox final : public frame::Dialogs {
  public:
    int MsgBox(const std::string&, int, const std::string&) override {
        ++shown;
        if (during) std::exchange(during, {})();
        return frame::msgbox::answerOk;
    }
    void ShowOpen(const std::string&, const std::string&, std::string&) override {}
    void ShowModal(frame::Object&) override {}

    std::function<void()> during;
    int shown = 0;
};

enum class When { MouseDown, MouseMove, MouseUp, Click, DblClick, CaptionChanged, LinkToChanged, KeyPress, Box, Error };
enum class How { Delete, DeleteLater, DeleteForm, NewBag, EmptyBag, BadBag, AutoSize, Caption, Hide, Disable, Reparent, DropHost };

constexpr const char* whenNames[] = {"MouseDown",      "MouseMove",     "MouseUp",  "Click", "DblClick",
                                     "CaptionChanged", "LinkToChanged", "KeyPress", "Box",   "Error"};
constexpr const char* howNames[] = {"Delete",   "DeleteLater", "DeleteForm", "NewBag",  "EmptyBag", "BadBag",
                                    "AutoSize", "Caption",     "Hide",       "Disable", "Reparent", "DropHost"};

class LifeTest : public test::QtTest, public testing::WithParamInterface<std::tuple<When, How>> {
  protected:
    LifeTest() : QtTest(&box) {}

    void Happen(How how, QPointer<Link> link) {
        if (!link || happened) return;
        happened = true;
        switch (how) {
            case How::Delete:
                delete link.data();
                break;
            case How::DeleteLater:
                link->deleteLater();
                break;
            case How::DeleteForm:
                delete window.data();
                break;
            case How::NewBag:
                link->setBag("{\"Caption\":\"loaded\",\"LinkTo\":\"b.txt\"}");
                EXPECT_EQ(link->caption(), "loaded");
                break;
            case How::EmptyBag:
                link->setBag("");
                EXPECT_EQ(link->linkTo(), "");
                break;
            case How::BadBag:
                link->setBag("{");
                break;
            case How::AutoSize:
                link->setAutoSize(true);
                break;
            case How::Caption:
                link->setCaption("another and longer caption");
                break;
            case How::Hide:
                link->hide();
                break;
            case How::Disable:
                link->setEnabled(false);
                break;
            case How::Reparent:
                link->setParent(nullptr);
                own.reset(link);
                break;
            case How::DropHost:
                delete link.data();
                Host::attach(window, nullptr);
                host.reset();
                break;
        }
    }

    BusyBox box;
    std::unique_ptr<Link> own;
    bool happened = false;
};

TEST_P(LifeTest, NothingBreaks) {
    const auto [when, how] = GetParam();
    const QPointer<Link> link = Shown();
    const auto act = [this, how = how, link] { Happen(how, link); };
    // Hears after that.
    const auto listen = [&](auto signal) { QObject::connect(link.data(), signal, qApp, act); };
    switch (when) {
        case When::MouseDown:
        case When::KeyPress:
            listen(&Link::mouseDown);
            break;
        case When::MouseMove:
            listen(&Link::mouseMove);
            break;
        case When::MouseUp:
            listen(&Link::mouseUp);
            break;
        case When::Click:
            listen(&Link::click);
            break;
        case When::DblClick:
            listen(&Link::dblClick);
            break;
        case When::CaptionChanged:
            listen(&Link::captionChanged);
            break;
        case When::LinkToChanged:
            listen(&Link::linkToChanged);
            break;
        case When::Box:
            shell.executeResults = {2};
            box.during = act;
            break;
        case When::Error:
            QObject::connect(host.get(), &Host::unhandledError, qApp, act);
            QObject::connect(link.data(), &Link::mouseDown, qApp, [] { throw frame::ControlError(5); });
            break;
    }
    QWindow* const handle = window->windowHandle();
    const QPointer<QWindow> alive(handle);
    const QPoint at = At(link, {100, 20});
    if (when == When::CaptionChanged) {
        link->setCaption("first");
    } else if (when == When::LinkToChanged) {
        link->setProperty("LinkTo", "first");
    } else if (when == When::KeyPress) {
        link->setFocus(Qt::TabFocusReason);
        QTest::keyPress(handle, Qt::Key_Return);
        if (alive) QTest::keyRelease(handle, Qt::Key_Return);
    } else {
        MoveTo(link, {100, 20});
        if (alive && when == When::DblClick) {
            QTest::mouseDClick(handle, Qt::LeftButton, {}, at);
        } else if (alive) {
            QTest::mousePress(handle, Qt::LeftButton, {}, at);
        }
        if (alive) {
            QTest::mouseRelease(handle, Qt::LeftButton, {}, at);
        } else {
            LetGo();
        }
        if (alive) MoveAway();
    }
    EXPECT_TRUE(happened);
    test::Settle();
    if (how == How::Delete || how == How::DeleteLater || how == How::DeleteForm || how == How::DropHost) {
        EXPECT_FALSE(link);
        return;
    }
    ASSERT_TRUE(link);
    link->grab();
    // It still works: what it is told, it does.
    if (how == How::Reparent) return;
    link->show();
    link->setEnabled(true);
    link->setCaption("works");
    EXPECT_EQ(link->control().Caption(), "works");
    test::Settle();
    Executed();
    link->setLinkTo("works.txt");
    const QPointer<Link> before = link;
    link->press();
    ASSERT_TRUE(before);
    if (when != When::Error) {
        EXPECT_EQ(Executed(), "open works.txt");
    }
}

INSTANTIATE_TEST_SUITE_P(
    Nasty, LifeTest,
    testing::Combine(testing::Values(When::MouseDown, When::MouseMove, When::MouseUp, When::Click, When::DblClick,
                                     When::CaptionChanged, When::LinkToChanged, When::KeyPress, When::Box, When::Error),
                     testing::Values(How::Delete, How::DeleteLater, How::DeleteForm, How::NewBag, How::EmptyBag, How::BadBag,
                                     How::AutoSize, How::Caption, How::Hide, How::Disable, How::Reparent, How::DropHost)),
    [](const auto& each) {
        return std::string(whenNames[static_cast<int>(std::get<0>(each.param))]) +
               howNames[static_cast<int>(std::get<1>(each.param))];
    });

class LifeStoryTest : public test::QtTest {};

TEST_F(LifeStoryTest, ALinkWhoseSlotClosesTheFormStillOpensItsTarget) {
    Link* link = Shown();
    QObject::connect(link, &Link::mouseDown, qApp, [this] { delete window.data(); });
    Press(link, {100, 20});
    EXPECT_EQ(Executed(), "open a.txt");
}

TEST_F(LifeStoryTest, ALinkOnTheStackEndsBeforeItsWindow) {
    { Link link(window); }
    {
        Link alone;
        alone.setCaption("x");
    }
    EXPECT_EQ(Errors(), "");
}

TEST_F(LifeStoryTest, TheHostOutlivesItsControls) {
    auto other = Host::make();
    const std::weak_ptr<Host> watch = other;
    auto* form = new QWidget;
    Host::attach(form, other);
    auto* link = new Link(form);
    other.reset();
    EXPECT_FALSE(watch.expired());
    EXPECT_EQ(link->host(), watch.lock());
    delete form;
    test::Settle();
    EXPECT_TRUE(watch.expired());
}

TEST_F(LifeStoryTest, ManyLinksComeAndGo) {
    Show();
    for (int i = 0; i < 200; ++i) {
        auto* link = new Link(window);
        link->setCaption(QString::number(i));
        link->show();
        if (i % 2) {
            delete link;
        } else {
            link->deleteLater();
        }
    }
    test::Settle();
    EXPECT_TRUE(window->findChildren<Link*>().isEmpty());
}

TEST_F(LifeStoryTest, AnErrorOfASlotReachesTheHostWithItsPlace) {
    Link* link = Shown("lnkHome");
    QObject::connect(link, &Link::mouseDown, qApp, [link] { link->extender().Get("NoSuchMember"); });
    Press(link, {100, 20});
    Release(link, {100, 20});
    ASSERT_EQ(errors.size(), 1u);
    EXPECT_THAT(errors[0], testing::StartsWith("438 "));
    EXPECT_THAT(errors[0], testing::HasSubstr("lnkHome"));
    EXPECT_THAT(errors[0], testing::HasSubstr("MouseDown"));
    EXPECT_EQ(descriptions[0], frame::ErrorText(438));
}

TEST_F(LifeStoryTest, AnErrorInASlotEndsTheRoutineThatRaised) {
    Link* link = Shown();
    QObject::connect(link, &Link::mouseDown, qApp, [] { throw frame::ControlError(5); });
    Press(link, {100, 20});
    EXPECT_EQ(Executed(), "");
    Release(link, {100, 20});
    EXPECT_THAT(Errors(), testing::StartsWith("5 "));
}

TEST_F(LifeStoryTest, AnyExceptionOfASlotIsReportedAndNoneCrossesTheEventLoop) {
    Link* link = Shown();
    const std::vector<std::function<void()>> throwers = {[] { throw std::runtime_error("boom"); }, [] { throw 42; },
                                                         [] { throw std::bad_alloc(); }, [] { throw frame::ControlError(76); }};
    for (const auto& thrower : throwers) {
        const auto connection = QObject::connect(link, &Link::click, qApp, thrower);
        Click(link, {100, 20});
        QObject::disconnect(connection);
    }
    ASSERT_EQ(errors.size(), 4u);
    EXPECT_THAT(errors[0], testing::StartsWith("51 "));
    EXPECT_EQ(descriptions[0], "boom");
    EXPECT_THAT(errors[1], testing::StartsWith("51 "));
    EXPECT_THAT(errors[2], testing::StartsWith("7 "));
    EXPECT_THAT(errors[3], testing::StartsWith("76 "));
}

TEST_F(LifeStoryTest, ASlotOfAChangedSignalThatThrowsIsReported) {
    Link* link = Shown();
    QObject::connect(link, &Link::captionChanged, qApp, [] { throw frame::ControlError(5); });
    link->setCaption("x");
    EXPECT_THAT(Errors(), testing::StartsWith("5 "));
    EXPECT_EQ(link->caption(), "x");
}

std::vector<std::string> logged;
void Keep(QtMsgType type, const QMessageLogContext& context, const QString& text) {
    logged.push_back(std::string(type == QtWarningMsg ? "warning " : "other ") + (context.category ? context.category : "") + " " +
                     text.toStdString());
}

TEST_F(LifeStoryTest, AnErrorIsLoggedAsAWarningOfItsCategory) {
    Link* link = Shown();
    logged.clear();
    const auto before = qInstallMessageHandler(Keep);
    link->setBag("{");
    qInstallMessageHandler(before);
    ASSERT_EQ(logged.size(), 1u);
    EXPECT_THAT(logged[0], testing::StartsWith("warning tessel.controls "));
    EXPECT_THAT(logged[0], testing::HasSubstr("Link1"));
    EXPECT_STREQ(errorLog().categoryName(), "tessel.controls");
}

TEST_F(LifeStoryTest, AnErrorOfTheControlItselfIsAnExceptionForItsCaller) {
    Link* link = Add();
    EXPECT_EQ(test::ErrorOf([&] { link->control().Get("NoSuchMember"); }), 438);
    EXPECT_EQ(test::ErrorOf([&] { link->extender().Put("NoSuchMember", frame::Variant(1)); }), 438);
    EXPECT_EQ(Errors(), "");
}

TEST_F(LifeStoryTest, AHostWithoutListenersSwallowsNoControl) {
    QObject::disconnect(host.get(), nullptr, nullptr, nullptr);
    Link* link = Shown();
    link->setBag("nonsense");
    EXPECT_EQ(link->linkTo(), "a.txt");
}

}  // namespace
}  // namespace tessel::qt
