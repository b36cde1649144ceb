#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "controls/link/Link.h"
#include "tests/HostUnderTest.h"
#include "tests/controls/link/LinkTestHelp.h"

/// What a host may be and the one for Qt is not: without tool tips, with one that is no text, with one that reaches the label only
/// when the link is shown again.
namespace tessel::controls {
namespace {

using test::HostUnderTest;
using testing::IsEmpty;
using namespace linktest;

TEST(LinkOnHeadless, EachShowCopiesTheToolTipAfresh) {
    HostUnderTest host;
    auto& link = host.Create<Link>("Link1", {.extender = {{"ToolTipText", "First"}}, .show = false});
    EXPECT_EQ(link.Label1.ToolTipText(), "");
    auto& site = *host.SiteOf(link);
    site.SetVisible(true);
    EXPECT_EQ(link.Label1.ToolTipText(), "First");
    site.Extender().Put("ToolTipText", "Second");
    EXPECT_EQ(link.Label1.ToolTipText(), "First");
    site.SetVisible(false);
    EXPECT_EQ(link.Label1.ToolTipText(), "First");
    site.SetVisible(true);
    EXPECT_EQ(link.Label1.ToolTipText(), "Second");
    site.Extender().Put("ToolTipText", "");
    site.SetVisible(false);
    site.SetVisible(true);
    EXPECT_EQ(link.Label1.ToolTipText(), "");
}

TEST(LinkOnHeadless, HostWithoutToolTipsLeavesTheLabelsOwnWithoutAnError) {
    HostUnderTest host;
    Link& link = NewLink(host);
    link.Label1.SetToolTipText("The label's own");
    auto& site = *host.SiteOf(link);
    site.SetVisible(false);
    EXPECT_NO_THROW(site.SetVisible(true));
    EXPECT_NO_THROW(link.Refresh());
    EXPECT_EQ(link.Label1.ToolTipText(), "The label's own");
    EXPECT_THAT(host.errors.reports, IsEmpty());
}

TEST(LinkOnHeadless, ToolTipThatIsNoTextIsSkipped) {
    HostUnderTest host;
    auto& link = host.Create<Link>("Link1", {.extender = {{"ToolTipText", headless::ListOf(std::vector<std::string>{"a"})}}});
    EXPECT_EQ(link.Label1.ToolTipText(), "");
    link.Label1.SetToolTipText("The label's own");
    EXPECT_NO_THROW(link.Refresh());
    EXPECT_EQ(link.Label1.ToolTipText(), "The label's own");
}

}  // namespace
}  // namespace tessel::controls
