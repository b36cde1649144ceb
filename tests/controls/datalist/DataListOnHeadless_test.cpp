#include <gtest/gtest.h>

#include "tests/controls/datalist/DataListTestHelp.h"

/// What a host may be and the one for Qt is not: without tool tips, or with one that reaches the children only at the next Show.
namespace tessel::controls {
namespace {

using test::ErrorOf;
using namespace datalisttest;

TEST(DataListOnHeadless, WithoutAScreenItIs315TwipsHigh) {
    Stage stage;
    EXPECT_EQ(stage.TheSite().Height(), 315);
}

TEST(DataListOnHeadless, EachShowCopiesTheToolTipAfresh) {
    Stage stage(Stage::Options{.toolTip = "First", .show = false});
    EXPECT_EQ(ToolTips(stage), " |  | ");
    auto& site = *stage.host.SiteOf(stage.Control());
    site.SetVisible(true);
    EXPECT_EQ(ToolTips(stage), "First | First | First");
    site.Extender().Put("ToolTipText", "Second");
    EXPECT_EQ(ToolTips(stage), "First | First | First");
    site.SetVisible(false);
    site.SetVisible(true);
    EXPECT_EQ(ToolTips(stage), "Second | Second | Second");
}

TEST(DataListOnHeadless, AHostWithoutToolTipsLeavesTheChildrensOwnWithoutAnError) {
    Stage stage;
    stage.List(0).Put("ToolTipText", "First");
    stage.List(1).Put("ToolTipText", "Second");
    stage.Label().Put("ToolTipText", "Third");
    EXPECT_EQ(ErrorOf([&] { Call(stage.Control(), "Refresh"); }), 0);
    EXPECT_EQ(ErrorOf([&] { stage.TheSite().Show(); }), 0);
    EXPECT_EQ(ToolTips(stage), "First | Second | Third");
    EXPECT_TRUE(stage.host.errors.reports.empty());
}

}  // namespace
}  // namespace tessel::controls
