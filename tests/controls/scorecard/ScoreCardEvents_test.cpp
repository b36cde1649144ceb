#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <ostream>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "frame/Event.h"
#include "tests/controls/scorecard/ScoreCardTestHelp.h"

/// The events of the picture box that a score card forwards, and what an application may do inside them.
namespace tessel::controls {
namespace {

using frame::ControlError;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using namespace scoretest;
namespace stock = frame::stock;

/// An event of the card: how an application hears it, the input that leads to it, and its arguments as text.
struct Input {
    const char* name;
    void (*hear)(frame::Handlers&, std::function<void()>);
    void (*ignore)(frame::Handlers&);
    void (*send)(child::PictureBox&);
    const char* arguments;
};

template <const auto& Event>
void Hear(frame::Handlers& handlers, std::function<void()> act) {
    handlers.On(Event, [act = std::move(act)](auto&...) { act(); });
}
template <const auto& Event>
void Ignore(frame::Handlers& handlers) {
    handlers.Remove(Event);
}

constexpr Input inputs[] = {
    {"Click", Hear<stock::Click>, Ignore<stock::Click>, [](child::PictureBox& picture) { picture.ClickInput(); }, ""},
    {"DblClick", Hear<stock::DblClick>, Ignore<stock::DblClick>, [](child::PictureBox& picture) { picture.DblClickInput(); }, ""},
    {"KeyDown", Hear<stock::KeyDown>, Ignore<stock::KeyDown>, [](child::PictureBox& picture) { picture.KeyDownInput(65, 3); },
     "65 3"},
    {"KeyPress", Hear<stock::KeyPress>, Ignore<stock::KeyPress>, [](child::PictureBox& picture) { picture.KeyPressInput(97); },
     "97"},
    {"KeyUp", Hear<stock::KeyUp>, Ignore<stock::KeyUp>, [](child::PictureBox& picture) { picture.KeyUpInput(112, 4); }, "112 4"},
    {"MouseDown", Hear<stock::MouseDown>, Ignore<stock::MouseDown>,
     [](child::PictureBox& picture) { picture.MouseDownInput(1, 2, 10.5f, 7); }, "1 2 10.5 7"},
    {"MouseMove", Hear<stock::MouseMove>, Ignore<stock::MouseMove>,
     [](child::PictureBox& picture) { picture.MouseMoveInput(0, 0, -3, 1000); }, "0 0 -3 1000"},
    {"MouseUp", Hear<stock::MouseUp>, Ignore<stock::MouseUp>,
     [](child::PictureBox& picture) { picture.MouseUpInput(2, 1, 0.25f, 19); }, "2 1 0.25 19"}};

void PrintTo(const Input& input, std::ostream* out) { *out << input.name; }

void SendAll(child::PictureBox& picture) {
    for (const Input& input : inputs) input.send(picture);
}

std::string LastArguments(const HostUnderTest& host) {
    std::string line;
    for (const auto& value : host.log.Of("event").back().at(3).ToArray().items) line += (line.empty() ? "" : " ") + value.ToText();
    return line;
}

class ScoreCardEvents : public testing::TestWithParam<Input> {
  protected:
    frame::Handlers& Handlers() { return card.host.SiteOf(card.control)->ApplicationHandlers(); }
    void On(std::function<void()> act) { GetParam().hear(Handlers(), std::move(act)); }
    void Send() { GetParam().send(card.picture); }
    static std::string Repeated(int times) {
        std::string names = GetParam().name;
        for (int i = 1; i < times; ++i) names += std::string(" ") + GetParam().name;
        return names;
    }

    Card card;
};

INSTANTIATE_TEST_SUITE_P(Inputs, ScoreCardEvents, testing::ValuesIn(inputs),
                         [](const auto& row) { return std::string(row.param.name); });

TEST_P(ScoreCardEvents, AreForwardedWithTheirArguments) {
    Send();
    EXPECT_EQ(card.host.log.EventNames("ScoreCard1"), GetParam().name);
    EXPECT_EQ(LastArguments(card.host), GetParam().arguments);
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
}

TEST_P(ScoreCardEvents, ComeInEveryStyle) {
    for (const auto& [key, value] : MemoryBag::Contents{{"Style", style::flashCard}, {"Style", style::gauge}, {"Style", 12}}) {
        card.Put(key, value);
        card.host.log.Clear();
        Send();
        EXPECT_EQ(card.host.log.EventNames(), GetParam().name);
    }
}

TEST_P(ScoreCardEvents, LeadToNothingElse) {
    const MemoryBag before = card.host.Save(card.control);
    Send();
    EXPECT_THAT(card.Happened(), IsEmpty());
    const MemoryBag after = card.host.Save(card.control);
    EXPECT_EQ(after.Kept(), before.Kept());
    EXPECT_EQ(card.ShownImage(), "ImageList16 ScoreCard3");
}

TEST_P(ScoreCardEvents, ComeOnceForEachInput) {
    for (int i = 0; i < 3; ++i) Send();
    EXPECT_EQ(card.host.log.EventNames(), Repeated(3));
}

TEST_P(ScoreCardEvents, HandlerThatDestroysTheCardIsItsLast) {
    On([&] { card.host.Destroy(card.control); });
    Send();
    EXPECT_EQ(card.host.FindSite("ScoreCard1"), nullptr);
    EXPECT_EQ(card.host.OnForm().Count(), 0);
    EXPECT_EQ(card.host.log.EventNames(), GetParam().name);
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
}

TEST_P(ScoreCardEvents, DestroyedCardRaisesAndReportsNothingMore) {
    On([&] {
        card.host.Destroy(card.control);
        SendAll(card.picture);
        for (const auto& [key, value] : OtherValues(style::gauge)) card.control.Put(key, value);
        card.control.Call("Refresh");
        card.control.Resize();
        card.control.Show();
        EXPECT_EQ(card.control.Get("Value"), Variant(0.25));
    });
    card.host.log.Clear();
    Send();
    EXPECT_EQ(card.host.log.EventNames(), GetParam().name);
    EXPECT_THAT(card.host.log.Of("changed"), IsEmpty());
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
}

TEST_P(ScoreCardEvents, HandlerMaySetEveryProperty) {
    const auto values = OtherValues(style::gauge);
    On([&] {
        for (const auto& [key, value] : values) card.Put(key, value);
    });
    Send();
    for (const auto& [key, value] : values) EXPECT_EQ(card.Get(key), value) << key;
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
    EXPECT_GT(CountOf(card.Drawn(), "Cls"), 0u);
}

TEST_P(ScoreCardEvents, HandlerMayGoThroughAllStyles) {
    On([&] {
        for (int value = -1; value <= 12; ++value) card.Put("Style", value);
        card.Put("Style", style::weatherLarge);
    });
    Send();
    EXPECT_EQ(card.ShownImage(), "ImageList32 Weather3");
    EXPECT_EQ(card.Size(), "540 540");
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
}

TEST_P(ScoreCardEvents, HandlerThatRaisesItsOwnEventAgainComesToItsEnd) {
    constexpr int depth = 50;
    int level = 0;
    On([&] {
        if (++level < depth) Send();
    });
    Send();
    EXPECT_EQ(card.host.log.EventNames(), Repeated(depth));
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
}

TEST_P(ScoreCardEvents, HandlerThatRaisesAllOtherEventsHolds) {
    bool inside = false;
    On([&] {
        if (!std::exchange(inside, true)) SendAll(card.picture);
    });
    Send();
    EXPECT_THAT(card.host.log.Of("event"), SizeIs(9));
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
}

TEST_P(ScoreCardEvents, ErrorOfAHandlerIsReportedWithItsPlaceAndItsWords) {
    On([] { throw ControlError(1234, "The handler's own words"); });
    Send();
    ASSERT_THAT(card.host.errors.reports, SizeIs(1));
    const auto& report = card.host.errors.reports[0];
    EXPECT_EQ(report.error.Number(), 1234);
    EXPECT_EQ(report.error.Description(), "The handler's own words");
    EXPECT_EQ(report.where, std::string("ScoreCard1.Picture1.") + GetParam().name);
}

TEST_P(ScoreCardEvents, ErrorOfADrawingInAHandlerIsReported) {
    On([&] {
        card.Put("Style", style::gauge);
        card.Put("ShowTickLinesEvery", 1e-5);
    });
    Send();
    ASSERT_THAT(card.host.errors.reports, SizeIs(1));
    EXPECT_EQ(card.host.errors.reports[0].error.Number(), frame::errors::overflow);
    GetParam().ignore(Handlers());
    card.Put("ShowTickLinesEvery", 0);
    EXPECT_EQ(CountOf(card.Redrawn(), "Box"), 1u);
}

TEST_P(ScoreCardEvents, FailureThatIsNoNumberedErrorIsReportedToo) {
    On([] { throw std::runtime_error("The application's own"); });
    Send();
    ASSERT_THAT(card.host.errors.reports, SizeIs(1));
    EXPECT_EQ(card.host.errors.reports[0].error.Number(), frame::errors::internal);
}

TEST_P(ScoreCardEvents, HandlerMayHideResizeAndSaveTheCard) {
    card.Put("Style", style::gauge);
    On([&] {
        auto& site = *card.host.SiteOf(card.control);
        site.SetVisible(false);
        site.SetSize(Outer(60), Outer(50));
        site.SetVisible(true);
        EXPECT_THAT(card.host.Save(card.control).Written(), SizeIs(23));
    });
    Send();
    EXPECT_EQ(card.picture.Width(), Outer(60));
    EXPECT_EQ(card.picture.Height(), Outer(50));
    EXPECT_THAT(card.host.errors.reports, IsEmpty());
}

TEST_P(ScoreCardEvents, AnotherCardOfTheSameNameIsUntouched) {
    frame::Control* second = nullptr;
    On([&] {
        card.host.Destroy(card.control);
        second = &card.host.Create(ScoreCardClass(), "ScoreCard1");
    });
    Send();
    ASSERT_NE(second, nullptr);
    card.host.log.Clear();
    GetParam().send(PictureOf(*second));
    EXPECT_EQ(card.host.log.EventNames("ScoreCard1"), GetParam().name);  // the handler went with the first
    EXPECT_NE(card.host.SiteOf(*second), nullptr);
    EXPECT_EQ(second->Get("Value"), Variant(0.5));
}

TEST(ScoreCardForwarding, WhatAHandlerSetsInTheArgumentsIsNotReadBack) {
    Card card;
    card.host.SiteOf(card.control)->ApplicationHandlers().On(stock::KeyDown, [](std::int16_t& code, std::int16_t& shift) {
        code = 0;
        shift = 0;
    });
    for (int i = 0; i < 2; ++i) {
        card.picture.KeyDownInput(65, 3);
        EXPECT_EQ(LastArguments(card.host), "65 3");
    }
}

TEST(ScoreCardForwarding, PlacesOfTheMouseAreInTwipsOfThePictureBoxThoughItDrawsInPixels) {
    for (const int borderStyle : {0, 1}) {
        Card card(GaugeBag({{"BorderStyle", borderStyle}}));
        ASSERT_EQ(card.picture.ScaleMode(), frame::ScaleModeConstants::Pixels);
        const float border = borderStyle != 0 ? frame::borderTwips : 0;
        // As a screen reports them, from the corner of the box.
        const auto [x, y] = card.picture.InputPoint(307.5f + border, 150 + border);
        card.picture.MouseDownInput(1, 2, x, y);
        EXPECT_EQ(LastArguments(card.host), "1 2 307.5 150") << borderStyle;
        card.picture.MouseMoveInput(1, 0, x, y);
        EXPECT_EQ(LastArguments(card.host), "1 0 307.5 150") << borderStyle;
        card.picture.MouseUpInput(2, 1, x, y);
        EXPECT_EQ(LastArguments(card.host), "2 1 307.5 150") << borderStyle;
        EXPECT_EQ(card.host.log.EventNames("ScoreCard1"), "MouseDown MouseMove MouseUp");
    }
}

TEST(ScoreCardForwarding, PlacesOfTheMouseStartAtTheInsideOfTheBorder) {
    Card card(GaugeBag());
    const auto [left, top] = card.picture.InputPoint(0, 0);
    card.picture.MouseMoveInput(0, 0, left, top);
    EXPECT_EQ(LastArguments(card.host), "0 0 -30 -30");
    const auto [right, bottom] = card.picture.InputPoint(card.picture.Width(), card.picture.Height());
    card.picture.MouseMoveInput(0, 0, right, bottom);
    EXPECT_EQ(LastArguments(card.host), "0 0 1530 330") << "100 by 20 pixels and the border";
}

TEST(ScoreCardForwarding, EventsComeAtDesignTimeAndWhileDisabledAsTheyAreReported) {
    Card card(Options{.placedNew = true, .designTime = true});
    card.Put("Enabled", false);
    SendAll(card.picture);
    EXPECT_EQ(card.host.log.EventNames(), "Click DblClick KeyDown KeyPress KeyUp MouseDown MouseMove MouseUp");
}

TEST(ScoreCardForwarding, ALoadAndADrawingRaiseNothing) {
    Card card(GaugeBag());
    for (const auto& [key, value] : OtherValues(style::gauge)) card.Put(key, value);
    card.control.Call("Refresh");
    EXPECT_EQ(card.host.log.EventNames(), "");
}

}  // namespace
}  // namespace tessel::controls
