#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <ostream>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "controls/link/Link.h"
#include "tests/HostUnderTest.h"
#include "tests/controls/link/LinkTestHelp.h"

/// What an application may do to a link from inside the link's own events.
namespace tessel::controls {
namespace {

using frame::ControlError;
using frame::Font;
using frame::OLE_COLOR;
using frame::Variant;
using test::HostUnderTest;
using testing::ElementsAre;
using testing::EndsWith;
using testing::IsEmpty;
using namespace linktest;

/// An event of the link: how an application hears it, and the input that leads to it.
struct Input {
    const char* name;
    void (*hear)(frame::Handlers&, std::function<void()>);
    void (*ignore)(frame::Handlers&);
    void (*send)(Link&);
};

template <const auto& Event>
void Hear(frame::Handlers& handlers, std::function<void()> act) {
    handlers.On(Event, [act = std::move(act)](auto&...) { act(); });
}
template <const auto& Event>
void Ignore(frame::Handlers& handlers) {
    handlers.Remove(Event);
}

constexpr Input click = {"Click", Hear<frame::stock::Click>, Ignore<frame::stock::Click>,
                         [](Link& link) { link.Label1.ClickInput(); }};
constexpr Input dblClick = {"DblClick", Hear<frame::stock::DblClick>, Ignore<frame::stock::DblClick>,
                            [](Link& link) { link.Label1.DblClickInput(); }};
constexpr Input mouseDown = {"MouseDown", Hear<frame::stock::MouseDown>, Ignore<frame::stock::MouseDown>, PressInside};
constexpr Input mouseMove = {"MouseMove", Hear<frame::stock::MouseMove>, Ignore<frame::stock::MouseMove>, MoveInside};
constexpr Input mouseUp = {"MouseUp", Hear<frame::stock::MouseUp>, Ignore<frame::stock::MouseUp>,
                           [](Link& link) { link.Label1.MouseUpInput(leftButton, noShift, 1000, 300); }};

void PrintTo(const Input& input, std::ostream* out) { *out << input.name; }

/// For each property a value that a new link does not have.
std::vector<std::pair<std::string, Variant>> OtherValues() {
    return {{"BackColor", OLE_COLOR(1)},
            {"Enabled", false},
            {"Font", std::make_shared<Font>("Courier", 20)},
            {"BorderStyle", 1},
            {"Alignment", 2},
            {"Appearance", 0},
            {"AutoSize", true},
            {"Caption", "A longer caption"},
            {"WordWrap", true},
            {"HighlightColor", OLE_COLOR(2)},
            {"UsedColor", OLE_COLOR(3)},
            {"LinkTo", "b.txt"},
            {"ForeColor", OLE_COLOR(4)},
            {"BorderSize", 0},
            {"SuppressMessages", true},
            {"ClickAction", 2}};
}

/// One link that opens "a.txt", under a handler of one of its events.
class LinkHandlers : public testing::TestWithParam<Input> {
  protected:
    LinkHandlers() { link().SetLinkTo("a.txt"); }

    Link& link() { return *link_; }
    /// What the reaction to the input asks of the shell, when it comes so many times.
    std::vector<std::string> Reaction(std::size_t times = 1, const std::string& request = "open a.txt") const {
        return GetParam().name == std::string("MouseDown") ? std::vector<std::string>(times, request) : std::vector<std::string>{};
    }
    static std::string Repeated(const std::string& name, int times) {
        std::string names = name;
        for (int i = 1; i < times; ++i) names += " " + name;
        return names;
    }
    void On(std::function<void()> act) { GetParam().hear(host.SiteOf(link())->ApplicationHandlers(), std::move(act)); }
    void Send() { GetParam().send(link()); }
    /// All inputs, each of which would raise its event.
    static void SendAll(Link& target) {
        for (const Input& input : {click, dblClick, mouseMove, mouseUp}) input.send(target);
    }

    HostUnderTest host;

  private:
    Link* link_ = &NewLink(host);
};

INSTANTIATE_TEST_SUITE_P(Events, LinkHandlers, testing::Values(click, dblClick, mouseDown, mouseMove, mouseUp),
                         [](const auto& row) { return std::string(row.param.name); });

TEST_P(LinkHandlers, HandlerThatDestroysTheLinkLetsItFinishItsReaction) {
    On([&] { host.Destroy(link()); });
    Send();
    EXPECT_EQ(host.FindSite("Link1"), nullptr);
    EXPECT_EQ(host.OnForm().Count(), 0);
    EXPECT_EQ(Requests(host), Reaction());
    EXPECT_EQ(host.log.EventNames(), GetParam().name);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, DestroyedLinkRaisesAndReportsNothingMore) {
    On([&] {
        Link& gone = link();
        host.Destroy(gone);
        SendAll(gone);
        gone.SetForeColor(0x111111);
        gone.SetCaption("A caption that changes the size");
        gone.SetAutoSize(true);
        gone.Refresh();
        gone.Resize();
        gone.Show();
        EXPECT_EQ(gone.ForeColor(), OLE_COLOR(0x111111));
    });
    host.log.Clear();
    Send();
    EXPECT_EQ(host.log.EventNames(), GetParam().name);
    EXPECT_THAT(Changes(host), IsEmpty());
    EXPECT_EQ(Requests(host), Reaction());
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, DestroyedLinkCanStillOpenAndPrint) {
    std::vector<std::string> results;
    host.shell.executeResults = {2, 31};
    On([&] {
        Link& gone = link();
        host.Destroy(gone);
        results = {gone.OpenLink("b.txt"), gone.PrintLink("c.txt")};
    });
    Send();
    EXPECT_THAT(results, ElementsAre("Unable to find file", "No application associated with file"));
    EXPECT_EQ(Boxes(host).size(), 2u);
}

TEST_P(LinkHandlers, HandlerMaySetEveryProperty) {
    const auto values = OtherValues();
    On([&] {
        for (const auto& [name, value] : values) link().Put(name, value);
    });
    Send();
    for (const auto& [name, value] : values) EXPECT_EQ(link().Get(name), value) << name;
    EXPECT_EQ(Requests(host), Reaction(1, "print b.txt"));
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, EachPropertySetByItselfHolds) {
    for (const auto& [name, value] : OtherValues()) {
        auto& other = NewLink(host, "Link2");
        GetParam().hear(host.SiteOf(other)->ApplicationHandlers(), [&other, key = name, kept = value] { other.Put(key, kept); });
        GetParam().send(other);
        EXPECT_EQ(other.Get(name), value) << name;
        host.Destroy(other);
    }
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, HandlerThatRaisesItsOwnEventAgainEndsWithEachReactionDone) {
    constexpr int depth = 50;
    int level = 0;
    On([&] {
        if (++level < depth) Send();
    });
    Send();
    EXPECT_EQ(host.log.EventNames(), Repeated(GetParam().name, depth));
    EXPECT_EQ(Requests(host), Reaction(depth));
    EXPECT_THAT(host.errors.reports, IsEmpty());
    EXPECT_EQ(Shown(link()), GetParam().name == std::string("MouseMove") ? "hovered" : "unused");
}

TEST_P(LinkHandlers, HandlerThatRaisesAllOtherEventsHolds) {
    bool inside = false;
    On([&] {
        if (std::exchange(inside, true)) return;
        SendAll(link());
    });
    Send();
    EXPECT_EQ(host.log.Of("event").size(), 5u);
    EXPECT_EQ(Requests(host), Reaction());
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, DestroyedInTheInnermostOfNestedEventsEachReactionIsStillDone) {
    int level = 0;
    Link& target = link();
    On([&] {
        if (++level < 4)
            GetParam().send(target);
        else
            host.Destroy(target);
    });
    Send();
    EXPECT_EQ(host.log.EventNames(), Repeated(GetParam().name, 4));
    EXPECT_EQ(Requests(host), Reaction(4));
    EXPECT_EQ(host.FindSite("Link1"), nullptr);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, ErrorOfAHandlerIsReportedWithItsPlaceAndItsWords) {
    On([] { throw ControlError(1234, "The handler's own words"); });
    Send();
    ASSERT_EQ(host.errors.reports.size(), 1u);
    const auto& report = host.errors.reports[0];
    EXPECT_EQ(report.error.Number(), 1234);
    EXPECT_EQ(report.error.Description(), "The handler's own words");
    EXPECT_EQ(report.where, std::string("Link1.Label1.") + GetParam().name);
}

TEST_P(LinkHandlers, ErrorOfAHandlerSkipsTheReactionAndTheLinkGoesOnWorking) {
    On([] { throw ControlError(1234); });
    Send();
    EXPECT_THAT(Requests(host), IsEmpty());
    EXPECT_EQ(Shown(link()), "unused");
    GetParam().ignore(host.SiteOf(link())->ApplicationHandlers());
    Send();
    EXPECT_EQ(Requests(host), Reaction());
    EXPECT_EQ(host.errors.reports.size(), 1u);
    MoveInside(link());
    EXPECT_EQ(Shown(link()), "hovered");
    PressInside(link());
    EXPECT_TRUE(IsUsed(link()));
}

TEST_P(LinkHandlers, FailureThatIsNoNumberedErrorIsReportedToo) {
    On([] { throw std::runtime_error("The application's own"); });
    Send();
    ASSERT_EQ(host.errors.reports.size(), 1u);
    EXPECT_EQ(host.errors.reports[0].error.Number(), frame::errors::internal);
    EXPECT_EQ(host.errors.reports[0].where, std::string("Link1.Label1.") + GetParam().name);
    MoveInside(link());
    EXPECT_EQ(link().Get("Caption"), Variant("Label1"));
}

TEST_P(LinkHandlers, ErrorInANestedEventIsReportedOnceAndTheOuterReactionIsDone) {
    int level = 0;
    On([&] {
        if (++level == 1)
            Send();
        else
            throw ControlError(1234);
    });
    Send();
    EXPECT_EQ(host.errors.reports.size(), 1u);
    EXPECT_EQ(Requests(host), Reaction());
}

TEST_P(LinkHandlers, HandlerThatDestroysTheLinkAndFailsIsReported) {
    On([&] {
        host.Destroy(link());
        throw ControlError(1234);
    });
    Send();
    ASSERT_EQ(host.errors.reports.size(), 1u);
    EXPECT_EQ(host.errors.reports[0].error.Number(), 1234);
    EXPECT_THAT(host.errors.reports[0].where, EndsWith(std::string("Label1.") + GetParam().name));
    EXPECT_EQ(host.FindSite("Link1"), nullptr);
    EXPECT_THAT(Requests(host), IsEmpty());
}

TEST_P(LinkHandlers, AnotherLinkOfTheSameNameIsUntouchedByTheReactionOfTheFirst) {
    Link* second = nullptr;
    On([&] {
        host.Destroy(link());
        second = &NewLink(host, "Link1");
        second->SetLinkTo("b.txt");
    });
    Send();
    ASSERT_NE(second, nullptr);
    EXPECT_EQ(host.FindSite("Link1"), host.SiteOf(*second));
    EXPECT_EQ(host.OnForm().Count(), 1);
    EXPECT_EQ(Requests(host), Reaction());
    EXPECT_EQ(Shown(*second), "unused");
    EXPECT_FALSE(IsUsed(*second));

    host.log.Clear();
    PressInside(*second);
    EXPECT_THAT(Requests(host), ElementsAre("open b.txt"));
    EXPECT_EQ(host.log.EventNames("Link1"), "MouseDown");  // the handler went with the first
    EXPECT_NE(host.SiteOf(*second), nullptr);
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, HandlerMayReplaceItselfAndRemoveItself) {
    int first = 0, second = 0;
    On([&] {
        ++first;
        On([&] {
            ++second;
            GetParam().ignore(host.SiteOf(link())->ApplicationHandlers());
        });
    });
    for (int i = 0; i < 3; ++i) Send();
    EXPECT_EQ(first, 1);
    EXPECT_EQ(second, 1);
    EXPECT_EQ(Requests(host), Reaction(3));
}

TEST_P(LinkHandlers, HandlerMayHideResizeAndSaveTheLink) {
    On([&] {
        auto& site = *host.SiteOf(link());
        site.SetVisible(false);
        site.SetSize(3000, 900);
        site.SetVisible(true);
        site.SetUserMode(false);
        EXPECT_EQ(host.Save(link()).Written().size(), 16u);
    });
    Send();
    EXPECT_EQ(link().Label1.Width(), 3000);
    EXPECT_EQ(link().Label1.Height(), 900);
    EXPECT_EQ(Requests(host), Reaction());
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST_P(LinkHandlers, HandlerMayOpenAndPrint) {
    On([&] {
        link().OpenLink("b.txt");
        link().PrintLink("c.txt");
    });
    Send();
    std::vector<std::string> expected = {"open b.txt", "print c.txt"};
    for (const auto& request : Reaction()) expected.push_back(request);
    EXPECT_EQ(Requests(host), expected);
}

TEST_P(LinkHandlers, HandlerOfOneLinkMayDestroyAllOthers) {
    for (int i = 2; i < 10; ++i) NewLink(host, "Link" + std::to_string(i));
    On([&] {
        for (int i = 2; i < 10; ++i) host.Destroy(host.FindSite("Link" + std::to_string(i))->Control());
    });
    Send();
    EXPECT_EQ(host.OnForm().Count(), 1);
    EXPECT_EQ(Requests(host), Reaction());
}

// The reaction of a link that its handler has destroyed.

TEST(LinkReaction, PressOfADestroyedLinkShowsItsFailure) {
    HostUnderTest host;
    auto& link = NewLink(host);
    link.SetLinkTo("a.txt");
    host.shell.executeResults = {2};
    Hear<frame::stock::MouseDown>(host.SiteOf(link)->ApplicationHandlers(), [&] { host.Destroy(link); });
    PressInStrip(link);
    EXPECT_THAT(Boxes(host), ElementsAre("Error 2: Unable to find file 'a.txt'"));
}

TEST(LinkReaction, PressOfADestroyedLinkStillTakesItsCaptionAndItsAction) {
    HostUnderTest host;
    auto& link = NewLink(host);
    link.SetCaption("www.example.org");
    Hear<frame::stock::MouseDown>(host.SiteOf(link)->ApplicationHandlers(), [&] {
        host.Destroy(link);
        link.SetClickAction(ClickActionConstants::Print_Link);
    });
    PressInside(link);
    EXPECT_THAT(Requests(host), ElementsAre("print www.example.org"));
}

TEST(LinkReaction, MoveOfADestroyedLinkStillColoursItsText) {
    HostUnderTest host;
    auto& link = NewLink(host);
    Hear<frame::stock::MouseMove>(host.SiteOf(link)->ApplicationHandlers(), [&] { host.Destroy(link); });
    // The entry keeps the link until its colour has been seen.
    frame::Entry::Run(
        host.Frame(), [] { return std::string(); },
        [&] {
            MoveInside(link);
            EXPECT_EQ(host.FindSite("Link1"), nullptr);
            EXPECT_EQ(link.Label1.ForeColor(), red);
        });
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST(LinkReaction, InputToADestroyedLinkRaisesNothing) {
    HostUnderTest host;
    auto& link = NewLink(host);
    link.SetLinkTo("a.txt");
    frame::Entry::Run(
        host.Frame(), [] { return std::string(); },
        [&] {
            host.Destroy(link);
            for (const Input& input : {click, dblClick, mouseDown, mouseMove, mouseUp}) input.send(link);
        });
    EXPECT_EQ(host.log.EventNames(), "");
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

// Destroyed while the shell works or a box stands.

TEST(LinkReaction, LinkDestroyedWhileTheShellWorksStillShowsAndReturnsTheFailure) {
    WatchedHost host;
    auto& link = host.TheLink();
    host.shellResult = 2;
    host.whileShellWorks = [&] { host.DestroyLink(); };
    EXPECT_EQ(link.OpenLink("a.txt"), "Unable to find file");
    EXPECT_THAT(host.boxes, ElementsAre("Error 2: Unable to find file 'a.txt'"));
}

TEST(LinkReaction, LinkDestroyedWhileItsBoxStandsStillReturnsTheFailure) {
    WatchedHost host;
    auto& link = host.TheLink();
    host.shellResult = 31;
    host.whileBoxStands = [&] { host.DestroyLink(); };
    EXPECT_EQ(link.PrintLink("a.txt"), "No application associated with file");
}

TEST(LinkReaction, LinkDestroyedWhileTheBoxOfItsPressStandsEndsQuietly) {
    WatchedHost host;
    auto& link = host.TheLink();
    host.shellResult = 2;
    int events = 0;
    Hear<frame::stock::MouseDown>(host.ApplicationHandlers(), [&] { ++events; });
    host.whileBoxStands = [&] {
        host.DestroyLink();
        PressInside(link);
    };
    PressInside(link);
    EXPECT_EQ(events, 1);
    EXPECT_THAT(host.requests, ElementsAre("open Label1"));
    EXPECT_THAT(host.others.errors.reports, IsEmpty());
}

}  // namespace
}  // namespace tessel::controls
