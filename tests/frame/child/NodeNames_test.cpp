#include "frame/child/NodeNames.h"

#include <gtest/gtest.h>

#include <map>
#include <optional>
#include <random>
#include <string>
#include <utility>

#include "frame/Text.h"

namespace tessel::child {
namespace {

TEST(NameStore, HoldsATextOnceThatEndsTheKey) {
    NameStore store;
    const auto path = store.Add(1, "Pictures", "/home/somebody/Pictures");
    const auto root = store.Add(2, "Disk (C:)", "C:\\");
    EXPECT_EQ(store.Read(path).text, "Pictures");
    EXPECT_EQ(store.Read(path).key, "/home/somebody/Pictures");
    EXPECT_EQ(store.Read(path).row, 1u);
    EXPECT_EQ(store.Read(root).text, "Disk (C:)");
    EXPECT_EQ(store.Read(root).key, "C:\\");
    constexpr std::size_t head = 12;
    EXPECT_EQ(store.SizeOf(path), head + 24);
    EXPECT_EQ(store.SizeOf(root), head + 12);
    EXPECT_EQ(store.Size(), store.SizeOf(path) + store.SizeOf(root));
}

TEST(NameStore, HoldsEmptyNames) {
    NameStore store;
    const auto nothing = store.Add(1, "", ""), onlyText = store.Add(2, "a", ""), onlyKey = store.Add(3, "", "b");
    EXPECT_EQ(store.Read(nothing).text, "");
    EXPECT_EQ(store.Read(nothing).key, "");
    EXPECT_EQ(store.Read(onlyText).text, "a");
    EXPECT_EQ(store.Read(onlyText).key, "");
    EXPECT_EQ(store.Read(onlyKey).text, "");
    EXPECT_EQ(store.Read(onlyKey).key, "b");
}

TEST(NameStore, HoldsNamesLongerThanAPage) {
    NameStore store;
    const std::string longKey(100'000, 'k'), longText(40'000, 't');
    const auto before = store.Add(1, "before", "1"), large = store.Add(2, longText, longKey), after = store.Add(3, "after", "3");
    EXPECT_EQ(store.Read(before).text, "before");
    EXPECT_EQ(store.Read(large).text, longText);
    EXPECT_EQ(store.Read(large).key, longKey);
    EXPECT_EQ(store.Read(after).text, "after");
    EXPECT_EQ(store.Read(after).key, "3");
}

TEST(NodeNames, TakesTheNodesOwnNamesAgain) {
    NodeNames names;
    names.Begin(1, "text", "key");
    names.SetText(1, names.Key(1));
    EXPECT_EQ(names.Text(1), "key");
    names.SetKey(1, names.Text(1).substr(1));
    EXPECT_EQ(names.Key(1), "ey");
    EXPECT_EQ(names.FindKey("EY"), std::optional<NodeId>(1));
    EXPECT_EQ(names.FindKey("key"), std::nullopt);
}

TEST(NodeNames, OneTextSetOverAndOverLeavesTheOthers) {
    NodeNames names;
    for (NodeId node = 1; node <= 50; ++node) names.Begin(node, "text", "/key/" + frame::Decimal(node));
    for (int number = 0; number < 5'000; ++number) names.SetText(7, "again " + frame::Decimal(number));
    for (NodeId node = 1; node <= 50; ++node) {
        EXPECT_EQ(names.FindKey("/KEY/" + frame::Decimal(node)), std::optional(node));
        EXPECT_EQ(names.Text(node), node == 7 ? "again 4999" : "text");
    }
}

TEST(NodeNames, AnyChangesKeepNamesAndKeysTrue) {
    NodeNames names;
    std::map<NodeId, std::pair<std::string, std::string>> expected;
    std::mt19937 random(3);
    const auto draw = [&](unsigned end) { return static_cast<NodeId>(random() % end); };
    int fresh = 0;
    for (int step = 0; step < 30'000; ++step) {
        const NodeId node = 1 + draw(400);
        const auto known = expected.find(node);
        const std::string text(draw(40), 'x');
        const std::string key = draw(8) == 0 ? "" : "/key " + frame::Decimal(++fresh) + "/" + (draw(2) ? text : "");
        if (known == expected.end()) {
            names.Begin(node, text, key);
            expected[node] = {text, key};
        } else if (const NodeId what = draw(3); what == 0) {
            names.End(node);
            expected.erase(known);
        } else if (what == 1) {
            names.SetText(node, text);
            known->second.first = text;
        } else {
            const std::string before = known->second.second;
            names.SetKey(node, key);
            known->second.second = key;
            ASSERT_EQ(names.FindKey(before), std::nullopt);
        }
    }
    for (const auto& [node, name] : expected) {
        ASSERT_EQ(names.Text(node), name.first);
        ASSERT_EQ(names.Key(node), name.second);
        ASSERT_EQ(names.FindKey(name.second), name.second.empty() ? std::nullopt : std::optional(node));
    }
}

}  // namespace
}  // namespace tessel::child
