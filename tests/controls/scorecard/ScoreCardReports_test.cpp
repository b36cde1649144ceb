#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "hosts/headless/HeadlessHost.h"
#include "tests/controls/scorecard/ScoreCardTestHelp.h"

/// What a host may do to a score card at the moment at which the card reports a change.
namespace tessel::controls {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using namespace scoretest;

/// A host with one card that runs code inside a report.
class ReportingHost {
  public:
    explicit ReportingHost(const MemoryBag::Contents& contents) {
        const MemoryBag saved(contents);
        auto made = std::make_unique<ReportingSite>(*this);
        owned_ = std::move(made);
        owned_->Adopt(ScoreCardClass().make(lent.Frame()));
        owned_->Start(&saved, Outer(longSide), Outer(shortSide));
        owned_->Show();
        control_ = &owned_->Control();
    }
    ~ReportingHost() { Destroy(); }
    ReportingHost(const ReportingHost&) = delete;
    ReportingHost& operator=(const ReportingHost&) = delete;

    frame::Control& Control() const { return *control_; }
    void Destroy() {
        if (owned_) lent.Frame().Retire(std::move(owned_));
    }
    /// Sets a property from outside, so that a card that goes meanwhile is freed at the end.
    void Put(const std::string& name, const Variant& value) {
        frame::Entry::Run(
            lent.Frame(), [] { return std::string("Put"); }, [&] { Control().Put(name, value); });
    }

    headless::HeadlessHost lent;
    std::function<void(std::string_view key)> onReport;
    Lines reported;

  private:
    struct Nobody final : frame::Siblings {
        int Count() const override { return 0; }
        frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }
    };
    struct RunTime final : frame::AmbientProperties {
        bool UserMode() const override { return true; }
        frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
        std::string DisplayName() const override { return "ScoreCard1"; }
    };
    struct ReportingSite final : frame::Site {
        explicit ReportingSite(ReportingHost& reporting) : Site(reporting.lent.Frame()), host(reporting) {}
        const frame::AmbientProperties& Ambient() const override { return ambient; }
        frame::Object& Extender() override { return extender; }
        frame::Object* Parent() override { return nullptr; }
        frame::Siblings& ParentControls() override { return siblings; }
        void PropertyChanged(std::string_view key) override {
            host.reported.emplace_back(key);
            // Once: what it does is reported too.
            if (const auto run = std::exchange(host.onReport, nullptr)) run(key);
        }
        frame::EventSink& Events() override { return handlers; }

        ReportingHost& host;
        RunTime ambient;
        headless::HostObject extender{"ScoreCard1", {}};
        Nobody siblings;
        frame::Handlers handlers;
    };

    std::unique_ptr<frame::Site> owned_;
    frame::Control* control_ = nullptr;
};

TEST(ScoreCardReports, AHostMayDestroyTheCardInEachReport) {
    for (const int style : {style::scoreCardSmall, style::flashCard, style::gauge}) {
        for (const auto& [key, value] : OtherValues(style::smileyLarge)) {
            ReportingHost host({{"Style", style}});
            host.onReport = [&](std::string_view) { host.Destroy(); };
            host.Put(key, value);
            EXPECT_THAT(host.reported, ElementsAre(key));
            EXPECT_THAT(host.lent.errors.reports, IsEmpty()) << key;
        }
    }
}

TEST(ScoreCardReports, AHostMaySetEveryPropertyInEachReport) {
    for (const int style : {style::scoreCardSmall, style::flashCard, style::gauge}) {
        for (const auto& [key, value] : OtherValues(style::smileyLarge)) {
            ReportingHost host({{"Style", style}});
            host.onReport = [&](std::string_view) {
                for (const auto& [other, otherValue] : OtherValues(style::smileyLarge)) host.Control().Put(other, otherValue);
            };
            host.Put(key, value);
            EXPECT_EQ(host.Control().Get("Value"), Variant(0.25)) << key;
            EXPECT_EQ(host.Control().Get("Style"), Variant(style::smileyLarge)) << key;
            EXPECT_NE(PictureOf(host.Control()).Picture(), nullptr) << key;
            EXPECT_THAT(host.lent.errors.reports, IsEmpty()) << key;
        }
    }
}

TEST(ScoreCardReports, ARedrawShowsWhatTheHostHasSetInTheReport) {
    ReportingHost host({{"Style", style::flashCard}});
    host.onReport = [&](std::string_view) { host.Control().Put("Value", 0.9); };
    host.Put("Value", 0.1);
    EXPECT_EQ(host.Control().Get("Value"), Variant(0.9f));
    EXPECT_EQ(PictureOf(host.Control()).Point(5, 5), static_cast<std::int32_t>(cyan));
    EXPECT_THAT(host.reported, ElementsAre("Value", "Value"));
}

TEST(ScoreCardReports, AHostMayBringALimitToTheOtherInAReport) {
    for (const auto* name : {"ScoreMin", "ScoreMax"}) {
        ReportingHost host(GaugeBag({{"ShowBlocks", 10}, {"ShowLimitLines", true}}));
        host.onReport = [&](std::string_view) {
            host.Control().Put("ScoreMin", 99);
            host.Control().Put("ScoreMax", 99);
        };
        host.Put(name, 50);
        EXPECT_LT(host.Control().Get("ScoreMin").ToSingle(), host.Control().Get("ScoreMax").ToSingle()) << name;
        EXPECT_THAT(host.lent.errors.reports, IsEmpty());
    }
}

TEST(ScoreCardReports, AnErrorOfTheHostLeavesTheNewValueWithoutARedraw) {
    ReportingHost host({{"Style", style::flashCard}});
    host.onReport = [](std::string_view) { throw frame::ControlError(1234); };
    host.Put("Value", 0.9);
    ASSERT_EQ(host.lent.errors.reports.size(), 1u);
    EXPECT_EQ(host.lent.errors.reports[0].error.Number(), 1234);
    EXPECT_EQ(host.Control().Get("Value"), Variant(0.9f));
    EXPECT_EQ(PictureOf(host.Control()).Point(5, 5), static_cast<std::int32_t>(yellow));
}

}  // namespace
}  // namespace tessel::controls
