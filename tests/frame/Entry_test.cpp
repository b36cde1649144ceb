#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <memory>
#include <new>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "frame/Control.h"
#include "frame/Site.h"
#include "frame/host.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

using test::CountingPeer;
using test::ErrorOf;
using test::Quiet;
using test::TestControl;
using test::WatchedSite;

class Loop final : public MessageLoop {
  public:
    void Turn() override {
        if (onTurn) onTurn();
    }
    void WantTurn() override { ++wanted; }

    std::function<void()> onTurn;
    int wanted = 0;
};

/// Boxes during which something happens.
class Boxes final : public Dialogs {
  public:
    int MsgBox(const std::string&, int, const std::string&) override {
        Ask();
        return msgbox::answerOk;
    }
    void ShowOpen(const std::string&, const std::string&, std::string&) override { Ask(); }
    void ShowModal(Object&) override { Ask(); }

    std::function<void()> onAsk;

  private:
    void Ask() const {
        if (const auto ask = onAsk) ask();
    }
};

class AskingMenus final : public Menus {
  public:
    void Popup(Object&, Object*) override { ask(); }
    std::function<void()> ask;
};
class AskingDrag final : public DragAndDrop {
  public:
    void Start(ChildControl&) override { ask(); }
    std::function<void()> ask;
};
class AskingShell final : public Shell {
  public:
    int Execute(std::string_view, const std::string&) override {
        ask();
        return 33;
    }
    FileOperationResult Run(const FileOperation&) override {
        ask();
        return {};
    }
    std::function<void()> ask;
};

/// Gives every child a peer that counts.
class Screen final : public PeerFactory {
  public:
    std::unique_ptr<Peer> MakePeer(ChildControl&) override {
        if (!shows) return nullptr;
        auto peer = std::make_unique<CountingPeer>(updates);
        last = peer.get();
        return peer;
    }
    std::unique_ptr<Canvas> MakeCanvas(DrawingSurface&, Object&) override { return nullptr; }

    bool shows = true;
    int updates = 0;
    CountingPeer* last = nullptr;
};

/// A program with a screen that tells what it was asked.
struct Entries : testing::Test {
    TestControl& Add(const std::string& name = "Test1") {
        sites.push_back(std::make_unique<WatchedSite>(host, name));
        TestControl& control = sites.back()->Make<TestControl>();
        host.Flush();
        screen.updates = 0;
        loop.wanted = 0;
        return control;
    }
    WatchedSite& SiteOf(const TestControl& control) { return static_cast<WatchedSite&>(*control.Site()); }
    Handlers& HandlersOf(const TestControl& control) { return SiteOf(control).handlers; }
    void Destroy(TestControl& control) {
        const auto found = std::find_if(sites.begin(), sites.end(), [&](const auto& site) { return &site->Control() == &control; });
        auto leaving = std::move(*found);
        sites.erase(found);
        host.Retire(std::move(leaving));
    }
    template <class F>
    void Enter(F&& call) {
        Entry::Run(
            host, [] { return std::string("Test"); }, call);
    }
    const std::vector<headless::ErrorList::Report>& Errors() const { return others.errors.reports; }

    headless::HeadlessHost others;  // for the services that these tests do not watch
    Loop loop;
    Boxes boxes;
    AskingMenus menus;
    AskingDrag drag;
    AskingShell shell;
    Screen screen;
    Services Mixed() {
        Services services = others.LentServices();
        services.loop = &loop;
        services.dialogs = &boxes;
        services.menus = &menus;
        services.drag = &drag;
        services.shell = &shell;
        services.peers = &screen;
        return services;
    }
    Host host{Mixed()};
    std::vector<std::unique_ptr<WatchedSite>> sites;
};

// The end of a control

TEST_F(Entries, ASiteMayBeRetiredByItsHostWhileItStarts) {
    auto site = std::make_unique<WatchedSite>(host, "Test1");
    WatchedSite& started = *site;
    site->Adopt(std::make_unique<TestControl>(host));
    started.whenSized = [&] { host.Retire(std::move(site)); };
    started.Start(nullptr, 300.0f, 200.0f);
    EXPECT_EQ(started.Width(), 300) << "it is there until the host has a turn";
    EXPECT_EQ(started.Control().Site(), nullptr);
    host.Settle();
}

TEST_F(Entries, RetiringOutsideAnyCallFreesAtOnce) {
    TestControl& control = Add();
    bool gone = false;
    control.onEnd = [&] { gone = true; };
    Destroy(control);
    EXPECT_TRUE(gone);
}

TEST_F(Entries, AControlDestroyedByItsOwnHandlerIsDetachedAtOnceAndFreedWhenTheCallHasReturned) {
    TestControl& control = Add();
    const Handle<TestControl> handle(control);
    int clicks = -1;
    control.onEnd = [&] { clicks = control.clicks; };
    HandlersOf(control).On(stock::Click, [&] {
        Destroy(control);
        EXPECT_TRUE(handle);
        EXPECT_EQ(control.Site(), nullptr);
    });
    control.Child1.ClickInput();
    EXPECT_FALSE(handle);
    EXPECT_EQ(clicks, 1);  // its own reaction to the click still ran
    EXPECT_TRUE(Errors().empty());
}

TEST_F(Entries, ARetiredControlRaisesAndTellsNothingMore) {
    TestControl& control = Add();
    WatchedSite& site = SiteOf(control);
    int heard = 0;
    site.handlers.On(Quiet, [&] { ++heard; });
    site.handlers.On(stock::Click, [&] {
        Destroy(control);
        control.Tell();
        control.SetNumber(4);
        control.Surface().SetWidth(100);
        EXPECT_TRUE(site.changed.empty());
        EXPECT_EQ(ErrorOf([&] { control.ToolTip(); }), errors::objectGone);
    });
    control.Child1.ClickInput();
    EXPECT_EQ(heard, 0);
}

TEST_F(Entries, AControlDestroyedInANestedCallIsFreedWhenTheOutermostHasReturned) {
    TestControl& outer = Add("Outer");
    TestControl& inner = Add("Inner");
    const Handle<TestControl> handle(outer);
    HandlersOf(outer).On(stock::Click, [&] {
        inner.Child1.ClickInput();
        EXPECT_TRUE(handle);
    });
    HandlersOf(inner).On(stock::Click, [&] { Destroy(outer); });
    outer.Child1.ClickInput();
    EXPECT_FALSE(handle);
    EXPECT_EQ(inner.clicks, 1);
}

TEST_F(Entries, TwoControlsMayDestroyEachOther) {
    TestControl& one = Add("One");
    TestControl& other = Add("Other");
    const Handle<TestControl> first(one), second(other);
    HandlersOf(one).On(stock::Click, [&] {
        other.Child1.ClickInput();
        Destroy(other);
        EXPECT_TRUE(first);
        EXPECT_TRUE(second);
    });
    HandlersOf(other).On(stock::Click, [&] { Destroy(one); });
    one.Child1.ClickInput();
    EXPECT_FALSE(first);
    EXPECT_FALSE(second);
    EXPECT_TRUE(Errors().empty());
}

TEST_F(Entries, AControlDestroyedWhileABoxIsOpenIsFreedAfterTheCallThatAsked) {
    TestControl& control = Add();
    const Handle<TestControl> handle(control);
    boxes.onAsk = [&] {
        boxes.onAsk = nullptr;
        control.Child1.ClickInput();
        EXPECT_TRUE(handle);
    };
    HandlersOf(control).On(stock::Click, [&] { Destroy(control); });
    Enter([&] {
        EXPECT_EQ(host.MsgBox("Sure?"), msgbox::answerOk);
        EXPECT_TRUE(handle);
    });
    EXPECT_FALSE(handle);
}

TEST_F(Entries, AControlDestroyedInABoxThatADirectCallerAskedOutlivesThatCall) {
    TestControl& control = Add();
    const Handle<TestControl> handle(control);
    boxes.onAsk = [&] { Destroy(control); };
    host.MsgBox("Sure?");
    EXPECT_TRUE(handle);  // the one who asked may be this control
    Enter([] {});
    EXPECT_FALSE(handle);
}

TEST_F(Entries, AControlDestroyedByAnEventThatADirectCallerRaisedOutlivesThatCall) {
    TestControl& control = Add();
    const Handle<TestControl> handle(control);
    HandlersOf(control).On(Quiet, [&] { Destroy(control); });
    control.Tell();
    ASSERT_TRUE(handle);
    EXPECT_EQ(control.Number(), 30);
    Enter([] {});
    EXPECT_FALSE(handle);
}

TEST_F(Entries, SettlingFreesWhatWasRetiredInADirectCallAndTellsThePeers) {
    TestControl& control = Add("One");
    TestControl& other = Add("Other");
    const Handle<TestControl> handle(control);
    HandlersOf(control).On(Quiet, [&] {
        Destroy(control);
        EXPECT_EQ(loop.wanted, 1);
        host.Settle();
        EXPECT_TRUE(handle);
    });
    control.Tell();
    other.Child1.SetText("changed");
    host.Settle();
    EXPECT_FALSE(handle);
    EXPECT_EQ(screen.updates, 1);
}

TEST_F(Entries, TheHostIsBusyWhileACallIsRunning) {
    TestControl& control = Add();
    bool busy = false;
    HandlersOf(control).On(Quiet, [&] { busy = host.Busy(); });
    control.Tell();
    EXPECT_TRUE(busy);
    EXPECT_FALSE(host.Busy());
    Enter([&] { EXPECT_TRUE(host.Busy()); });
    Enter([] { throw ControlError(errors::internal); });
    EXPECT_FALSE(host.Busy());
}

TEST_F(Entries, WhatIsRetiredAndNeverFreedGoesWithTheHost) {
    bool gone = false;
    {
        headless::HeadlessHost program;
        auto& control = program.Create<TestControl>("Test1");
        control.onEnd = [&] { gone = true; };
        program.SiteOf(control)->ApplicationHandlers().On(Quiet, [&] { program.Destroy(control); });
        control.Tell();
        EXPECT_FALSE(gone);
    }
    EXPECT_TRUE(gone);
}

TEST_F(Entries, AControlWhoseEndRetiresAnotherTakesThatAlong) {
    TestControl& one = Add("One");
    TestControl& other = Add("Other");
    const Handle<TestControl> second(other);
    one.onEnd = [&] { Destroy(other); };
    Destroy(one);
    EXPECT_FALSE(second);
    EXPECT_TRUE(sites.empty());
}

TEST_F(Entries, AControlWhoseEndRetiresAnotherDoesSoInACallToo) {
    TestControl& one = Add("One");
    TestControl& other = Add("Other");
    const Handle<TestControl> second(other);
    one.onEnd = [&] { Destroy(other); };
    Enter([&] { Destroy(one); });
    EXPECT_FALSE(second);
}

TEST_F(Entries, ManyControlsMayGoInOneCall) {
    std::vector<TestControl*> controls;
    int gone = 0;
    for (int i = 0; i < 20; ++i) {
        controls.push_back(&Add("Test" + std::to_string(i)));
        controls.back()->onEnd = [&] { ++gone; };
    }
    HandlersOf(*controls[7]).On(stock::Click, [&] {
        for (TestControl* control : controls) Destroy(*control);
        EXPECT_EQ(gone, 0);
    });
    controls[7]->Child1.ClickInput();
    EXPECT_EQ(gone, 20);
}

// Errors

struct Thrown {
    std::function<void()> raise;
    int number;
    std::string description;
};

TEST_F(Entries, ExceptionsOfEveryKindEndAtUnhandled) {
    const Thrown kinds[] = {
        {[] { throw ControlError(errors::diskFull); }, errors::diskFull, ErrorText(errors::diskFull)},
        {[] { throw ControlError(1234, "own words"); }, 1234, "own words"},
        {[] { throw std::bad_alloc(); }, errors::outOfMemory, ErrorText(errors::outOfMemory)},
        {[] { throw std::runtime_error("a bug"); }, errors::internal, "a bug"},
    };
    for (const Thrown& thrown : kinds) {
        Enter(thrown.raise);
        ASSERT_FALSE(Errors().empty());
        EXPECT_EQ(Errors().back().error.Number(), thrown.number);
        EXPECT_EQ(Errors().back().error.Description(), thrown.description);
        EXPECT_EQ(Errors().back().where, "Test");
    }
    EXPECT_EQ(Errors().size(), std::size(kinds));
}

TEST_F(Entries, EvenWhatIsNoExceptionEndsAtUnhandled) {
    EXPECT_NO_THROW(Enter([] { throw 42; }));
    ASSERT_EQ(Errors().size(), 1u);
    EXPECT_EQ(Errors()[0].error.Number(), errors::internal);
}

TEST_F(Entries, AnErrorOfAHandlerIsReportedWithObjectAndEvent) {
    TestControl& control = Add();
    HandlersOf(control).On(stock::Click, [] { throw ControlError(errors::diskFull); });
    control.Child1.ClickInput();
    ASSERT_EQ(Errors().size(), 1u);
    EXPECT_EQ(Errors()[0].where, "Test1.Child1.Click");
    EXPECT_EQ(control.clicks, 0);  // the error left the control's own routine too
}

TEST_F(Entries, AnErrorOfANestedCallDoesNotReachTheOuterOne) {
    TestControl& outer = Add("Outer");
    TestControl& inner = Add("Inner");
    HandlersOf(outer).On(stock::Click, [&] { inner.Child1.ClickInput(); });
    HandlersOf(inner).On(stock::Click, [] { throw ControlError(errors::diskFull); });
    outer.Child1.ClickInput();
    ASSERT_EQ(Errors().size(), 1u);
    EXPECT_EQ(Errors()[0].where, "Inner.Child1.Click");
    EXPECT_EQ(outer.clicks, 1);
}

TEST_F(Entries, ThePlaceIsNamedOnlyWhenThereIsSomethingToReport) {
    int asked = 0;
    const auto where = [&] {
        ++asked;
        return std::string("Test");
    };
    Entry::Run(host, where, [] {});
    EXPECT_EQ(asked, 0);
    Entry::Run(host, where, [] { throw ControlError(5); });
    EXPECT_EQ(asked, 1);
}

TEST_F(Entries, AfterAnErrorControlsAreFreedAsBefore) {
    TestControl& control = Add();
    const Handle<TestControl> handle(control);
    HandlersOf(control).On(stock::Click, [&] {
        Destroy(control);
        throw ControlError(errors::diskFull);
    });
    control.Child1.ClickInput();
    EXPECT_FALSE(handle);
    EXPECT_EQ(Errors().size(), 1u);
    TestControl& next = Add();
    const Handle<TestControl> second(next);
    Destroy(next);
    EXPECT_FALSE(second);
}

TEST_F(Entries, ABoxThatFailsLeavesNoCallOpen) {
    TestControl& control = Add();
    const Handle<TestControl> handle(control);
    boxes.onAsk = [] { throw ControlError(errors::internal); };
    EXPECT_EQ(ErrorOf([&] { host.MsgBox("Sure?"); }), errors::internal);
    Destroy(control);
    EXPECT_FALSE(handle);
}

// Peers

TEST_F(Entries, APeerHearsOnceOfManyChangesWhenTheCallHasEnded) {
    TestControl& control = Add();
    Enter([&] {
        control.Child1.SetText("a");
        control.Child1.SetText("b");
        control.Child1.SetVisible(false);
        control.Child1.Move(1, 2, 3, 4);
        EXPECT_EQ(screen.updates, 0);
    });
    EXPECT_EQ(screen.updates, 1);
    Enter([] {});
    EXPECT_EQ(screen.updates, 1);
}

TEST_F(Entries, APeerHearsNothingOfASetThatChangesNothing) {
    TestControl& control = Add();
    Enter([&] {
        control.Child1.SetText("as designed");
        control.Child1.SetEnabled(true);
    });
    EXPECT_EQ(screen.updates, 0);
}

TEST_F(Entries, EachChangedChildIsToldOnce) {
    TestControl& one = Add("One");
    TestControl& other = Add("Other");
    Enter([&] {
        one.Child1.SetText("a");
        other.Child1.SetText("a");
        one.Child1.SetText("b");
    });
    EXPECT_EQ(screen.updates, 2);
}

TEST_F(Entries, ANestedCallLeavesThePeersToTheOutermost) {
    TestControl& control = Add();
    Enter([&] {
        Enter([&] { control.Child1.SetText("a"); });
        EXPECT_EQ(screen.updates, 0);
    });
    EXPECT_EQ(screen.updates, 1);
}

TEST_F(Entries, ThePeersFollowEvenWhenTheCallFailed) {
    TestControl& control = Add();
    Enter([&] {
        control.Child1.SetText("a");
        throw ControlError(errors::internal);
    });
    EXPECT_EQ(screen.updates, 1);
}

TEST_F(Entries, ThePeersFollowBeforeEveryCallThatLetsTheUserIn) {
    TestControl& control = Add();
    int seen = -1;
    const auto look = [&] { seen = screen.updates; };
    loop.onTurn = boxes.onAsk = menus.ask = drag.ask = shell.ask = look;
    std::string name;
    const std::pair<const char*, std::function<void()>> calls[] = {
        {"Turn", [&] { host.Turn(); }},
        {"MsgBox", [&] { host.MsgBox("text"); }},
        {"ShowOpen", [&] { host.ShowOpen("title", "filter", name); }},
        {"ShowModal", [&] { host.ShowModal(control); }},
        {"Popup", [&] { host.Popup(control, nullptr); }},
        {"StartDrag", [&] { host.StartDrag(control.Child1); }},
        {"Execute", [&] { host.Execute("open", "a.txt"); }},
        {"Run", [&] { host.Run({}); }},
    };
    Enter([&] {
        int changes = 0;
        for (const auto& [call, run] : calls) {
            control.Child1.SetText(call);
            seen = -1;
            screen.updates = 0;
            run();
            EXPECT_EQ(seen, 1) << call;
            ++changes;
        }
        EXPECT_EQ(changes, 8);
    });
}

TEST_F(Entries, EveryCallThatLetsTheUserInKeepsTheControlsAlive) {
    const std::pair<const char*, std::function<void(TestControl&)>> calls[] = {
        {"Turn", [&](TestControl&) { host.Turn(); }},
        {"MsgBox", [&](TestControl&) { host.MsgBox("text"); }},
        {"ShowModal", [&](TestControl& control) { host.ShowModal(control); }},
        {"Popup", [&](TestControl& control) { host.Popup(control, nullptr); }},
        {"StartDrag", [&](TestControl& control) { host.StartDrag(control.Child1); }},
        {"Execute", [&](TestControl&) { host.Execute("open", "a.txt"); }},
        {"Run", [&](TestControl&) { host.Run({}); }},
    };
    for (const auto& [call, run] : calls) {
        TestControl& control = Add();
        const Handle<TestControl> handle(control);
        bool alive = false;
        loop.onTurn = boxes.onAsk = menus.ask = drag.ask = shell.ask = [&] {
            Destroy(control);
            alive = static_cast<bool>(handle);
        };
        run(control);
        EXPECT_TRUE(alive) << call;
        loop.onTurn = boxes.onAsk = nullptr;
        Enter([] {});
        EXPECT_FALSE(handle) << call;
    }
}

TEST_F(Entries, ACallThatComesInWhileABoxIsOpenIsAnOutermostOne) {
    TestControl& control = Add();
    boxes.onAsk = [&] {
        EXPECT_EQ(screen.updates, 1);
        control.Child1.ClickInput();
        EXPECT_EQ(screen.updates, 2);
    };
    HandlersOf(control).On(stock::Click, [&] {
        control.Child1.SetText("clicked");
        Enter([&] { control.Child1.SetText("clicked inside"); });
        EXPECT_EQ(screen.updates, 1);
    });
    Enter([&] {
        control.Child1.SetText("before");
        host.MsgBox("Sure?");
        control.Child1.SetText("after");
        Enter([] {});
        EXPECT_EQ(screen.updates, 2);
    });
    EXPECT_EQ(screen.updates, 3);
}

TEST_F(Entries, AChildThatIsChangedByItsPeerIsToldAgain) {
    TestControl& control = Add();
    screen.last->onUpdate = [&] { control.Child1.SetText("answer"); };
    Enter([&] { control.Child1.SetText("question"); });
    EXPECT_EQ(screen.updates, 2);
}

TEST_F(Entries, APeerThatAsksForAFlushIsNotToldInsideItself) {
    TestControl& control = Add();
    int depth = 0, deepest = 0;
    screen.last->onUpdate = [&] {
        deepest = std::max(deepest, ++depth);
        if (screen.updates == 1) control.Child1.SetText("answer");
        host.Flush();
        --depth;
    };
    Enter([&] { control.Child1.SetText("question"); });
    EXPECT_EQ(deepest, 1);
    EXPECT_EQ(screen.updates, 2);
}

TEST_F(Entries, AChildThatHasGoneIsNotTold) {
    TestControl& control = Add();
    auto added = std::make_unique<test::TestChild>(control, "Added");
    added->AttachPeer(screen.MakePeer(*added));
    host.Flush();
    screen.updates = 0;
    Enter([&] {
        added->SetText("changed");
        control.Child1.SetText("changed");
        added.reset();
    });
    EXPECT_EQ(screen.updates, 1);
}

TEST_F(Entries, AControlDestroyedByAPeersUpdateIsFreedAfterIt) {
    TestControl& control = Add();
    const Handle<TestControl> handle(control);
    screen.last->onUpdate = [&] {
        Destroy(control);
        EXPECT_TRUE(handle);
    };
    Enter([&] { control.Child1.SetText("changed"); });
    EXPECT_FALSE(handle);
    EXPECT_TRUE(Errors().empty());
}

TEST_F(Entries, APeerThatFailsIsReportedAndTheOthersFollow) {
    TestControl& one = Add("One");
    screen.last->onUpdate = [] { throw ControlError(errors::internal); };
    TestControl& other = Add("Other");
    Enter([&] {
        one.Child1.SetText("a");
        other.Child1.SetText("a");
    });
    EXPECT_EQ(screen.updates, 2);
    EXPECT_EQ(Errors().size(), 1u);
    Enter([&] { other.Child1.SetText("b"); });
    EXPECT_EQ(screen.updates, 3);
}

TEST_F(Entries, ANewPeerIsToldOnce) {
    TestControl& control = Add();
    control.Child1.AttachPeer(screen.MakePeer(control.Child1));
    host.Flush();
    EXPECT_EQ(screen.updates, 1);
}

TEST_F(Entries, APeerThatIsTakenAwayHearsNothing) {
    TestControl& control = Add();
    control.Child1.SetText("changed");
    control.Child1.AttachPeer(nullptr);
    host.Flush();
    control.Child1.SetText("again");
    host.Flush();
    EXPECT_EQ(screen.updates, 0);
}

TEST_F(Entries, AdoptingAControlMakesAPeerForEachChild) {
    screen.updates = 0;
    sites.push_back(std::make_unique<WatchedSite>(host, "Test1"));
    const TestControl& control = sites.back()->Make<TestControl>();
    EXPECT_NE(control.Child1.Peer(), nullptr);
    host.Flush();
    EXPECT_EQ(screen.updates, 1);
}

TEST_F(Entries, AChangeFromOutsideAsksForATurn) {
    TestControl& control = Add();
    control.Child1.SetText("a");
    EXPECT_EQ(loop.wanted, 1);
    control.Child1.SetText("b");
    EXPECT_EQ(loop.wanted, 1);
    host.Flush();
    control.Child1.SetText("c");
    EXPECT_EQ(loop.wanted, 2);
}

TEST_F(Entries, AChangeInsideACallAsksForNoTurn) {
    TestControl& control = Add();
    Enter([&] { control.Child1.SetText("a"); });
    EXPECT_EQ(loop.wanted, 0);
}

TEST_F(Entries, AChangeOfAChildThatIsNotShownAsksForNothing) {
    screen.shows = false;
    TestControl& control = Add();
    control.Child1.SetText("a");
    host.Flush();
    EXPECT_EQ(loop.wanted, 0);
    EXPECT_EQ(screen.updates, 0);
}

// Module state

struct Counter {
    int value = 0;
};
struct Knowing {
    explicit Knowing(Host& ofHost) : host(ofHost) {}
    Host& host;
};

TEST_F(Entries, ModuleStateIsOneForAHostAndAnotherForTheNext) {
    host.Module<Counter>().value = 5;
    EXPECT_EQ(host.Module<Counter>().value, 5);
    EXPECT_EQ(others.Frame().Module<Counter>().value, 0);
}

TEST_F(Entries, ModuleStateMayKnowItsHost) { EXPECT_EQ(&host.Module<Knowing>().host, &host); }

}  // namespace
}  // namespace tessel::frame
