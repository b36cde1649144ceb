#include "frame/Site.h"

#include <gtest/gtest.h>

#include <limits>
#include <memory>

#include "hosts/headless/HeadlessHost.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

using test::BagOf;
using test::TestControl;

struct Sites : testing::Test {
    TestControl& Adopt() {
        auto made = std::make_unique<TestControl>(host.Frame());
        TestControl& control = *made;
        site.Adopt(std::move(made));
        return control;
    }
    TestControl& Start() {
        TestControl& control = Adopt();
        site.Start(nullptr);
        control.trace.clear();
        site.moves = 0;
        return control;
    }

    headless::HeadlessHost host;
    test::WatchedSite site{host, "Test1"};
};

TEST_F(Sites, AdoptingGivesTheDesignSizeAndInitializesAndNothingElse) {
    const TestControl& control = Adopt();
    EXPECT_EQ(control.trace, "Initialize");
    EXPECT_EQ(control.Site(), &site);
    EXPECT_EQ(&site.Control(), &control);
    EXPECT_EQ(site.Width(), 1200);
    EXPECT_EQ(site.Height(), 600);
}

TEST_F(Sites, StartingWithoutASizeResizesOnce) {
    const TestControl& control = Adopt();
    site.Start(nullptr);
    EXPECT_EQ(control.trace, "Initialize InitProperties Resize");
}

TEST_F(Sites, StartingWithTheDesignSizeResizesOnce) {
    const TestControl& control = Adopt();
    site.Start(nullptr, 1200.0f, 600.0f);
    EXPECT_EQ(control.trace, "Initialize InitProperties Resize");
}

TEST_F(Sites, StartingWithAnotherSizeResizesOnce) {
    const TestControl& control = Adopt();
    site.Start(nullptr, 300.0f, 400.0f);
    EXPECT_EQ(control.trace, "Initialize InitProperties Resize");
    EXPECT_EQ(site.Width(), 300);
    EXPECT_EQ(site.Height(), 400);
}

TEST_F(Sites, StartingWithOneExtentKeepsTheOther) {
    Adopt();
    site.Start(nullptr, {}, 400.0f);
    EXPECT_EQ(site.Width(), 1200);
    EXPECT_EQ(site.Height(), 400);
}

TEST_F(Sites, StartingFromSavedStateReadsIt) {
    const TestControl& control = Adopt();
    const MemoryBag bag = BagOf({{"Number", 4}});
    site.Start(&bag);
    EXPECT_EQ(control.trace, "Initialize ReadProperties Resize");
    EXPECT_EQ(control.Number(), 4);
}

TEST_F(Sites, AControlThatTakesItsOldSizeBackIsResizedOnceForEachChange) {
    TestControl& control = Adopt();
    control.onResize = [&] { control.Surface().SetWidth(1200); };
    site.Start(nullptr, 300.0f);
    EXPECT_EQ(site.Width(), 1200);
    EXPECT_EQ(control.trace, "Initialize InitProperties Resize Resize");
}

TEST_F(Sites, ANewSizeResizesTheControl) {
    TestControl& control = Start();
    site.SetSize(300, 400);
    EXPECT_EQ(control.trace, "Resize");
    EXPECT_EQ(control.Surface().Width(), 300);
    EXPECT_EQ(control.Surface().Height(), 400);
    EXPECT_EQ(site.moves, 1);
}

TEST_F(Sites, ASizeThatChangesNothingRaisesNoResize) {
    TestControl& control = Start();
    site.SetSize(1200, 600);
    control.Surface().SetWidth(1200);
    control.Surface().SetHeight(600);
    EXPECT_EQ(control.trace, "");
    EXPECT_EQ(site.moves, 0);
}

TEST_F(Sites, ASizeSetByTheControlItselfResizesItToo) {
    TestControl& control = Start();
    control.Surface().SetWidth(300);
    EXPECT_EQ(control.trace, "Resize");
    EXPECT_EQ(site.Width(), 300);
    EXPECT_EQ(site.Height(), 600);
    control.Surface().SetHeight(400);
    EXPECT_EQ(control.trace, "Resize Resize");
    EXPECT_EQ(site.Height(), 400);
}

TEST_F(Sites, TheNewSizeStandsWhenTheControlIsResized) {
    TestControl& control = Start();
    float seen = 0;
    control.onResize = [&] { seen = control.Surface().ScaleWidth(); };
    site.SetSize(300, 400);
    EXPECT_EQ(seen, 300);
}

TEST_F(Sites, ASizeThatIsNegativeOrNoNumberBecomesZero) {
    TestControl& control = Start();
    site.SetSize(-300, -0.5f);
    EXPECT_EQ(site.Width(), 0);
    EXPECT_EQ(site.Height(), 0);
    site.SetSize(-1, -2);
    EXPECT_EQ(control.trace, "Resize");
    site.SetSize(std::numeric_limits<float>::quiet_NaN(), 10);
    EXPECT_EQ(site.Width(), 0);
    EXPECT_EQ(site.Height(), 10);
}

TEST_F(Sites, ANewPlaceMovesTheSiteWithoutResizing) {
    TestControl& control = Start();
    site.SetPlace(-15, 30);
    site.SetPlace(-15, 30);
    EXPECT_EQ(site.Left(), -15);
    EXPECT_EQ(site.Top(), 30);
    EXPECT_EQ(site.moves, 1);
    EXPECT_EQ(control.trace, "");
}

TEST_F(Sites, IsNamedAsTheHostKnowsTheControl) {
    Start();
    EXPECT_EQ(site.Path(), "Test1");
}

TEST_F(Sites, DetachedIsNoLongerAskedOrToldByTheControl) {
    TestControl& control = Start();
    site.Detach();
    control.SetNumber(4);
    control.Surface().SetBackColor(0);
    EXPECT_TRUE(site.changed.empty());
    EXPECT_EQ(site.repaints, 0);
    EXPECT_EQ(control.Site(), nullptr);
}

TEST_F(Sites, OwnsTheControl) {
    bool gone = false;
    {
        test::WatchedSite other(host, "Test2");
        other.Make<TestControl>().onEnd = [&] { gone = true; };
        EXPECT_FALSE(gone);
    }
    EXPECT_TRUE(gone);
}

}  // namespace
}  // namespace tessel::frame
