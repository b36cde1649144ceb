#include "frame/PropertyBag.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "frame/Font.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

using test::BagOf;

std::string Keys(const MemoryBag& bag) {
    std::string keys;
    for (const auto& [key, value] : bag.Kept()) keys += (keys.empty() ? "" : " ") + key;
    return keys;
}

TEST(MemoryBag, GivesTheStoredValueElseTheDefaultOfTheRead) {
    const MemoryBag bag = BagOf({{"Title", "one"}});
    EXPECT_EQ(bag.ReadProperty("Title", "none").ToText(), "one");
    EXPECT_EQ(bag.ReadProperty("Other", "none").ToText(), "none");
}

TEST(MemoryBag, TellsKeysApartByTheirCase) {
    const MemoryBag bag = BagOf({{"Forecolor", 1}});
    EXPECT_EQ(bag.ReadProperty("ForeColor", 2).ToLong(), 2);
    EXPECT_EQ(bag.ReadProperty("Forecolor", 2).ToLong(), 1);
}

TEST(MemoryBag, GivesAStoredValueOfAnyTypeAsItIs) {
    const MemoryBag bag = BagOf({{"Number", "12"}, {"Nothing", Variant()}});
    EXPECT_EQ(bag.ReadProperty("Number", 5).Type(), VarType::String);
    EXPECT_TRUE(bag.ReadProperty("Nothing", 5).IsEmpty());
}

TEST(MemoryBag, LeavesOutWhatEqualsItsDefaultWhateverItsType) {
    MemoryBag bag;
    bag.WriteProperty("Same", std::int16_t{30}, std::int32_t{30});
    bag.WriteProperty("Fraction", 30.0f, std::int16_t{30});
    bag.WriteProperty("Flag", true, std::int16_t{-1});
    bag.WriteProperty("Other", 31, 30);
    EXPECT_EQ(Keys(bag), "Other");
}

TEST(MemoryBag, KeepsATextThatOnlyLooksLikeTheNumberOfItsDefault) {
    MemoryBag bag;
    bag.WriteProperty("Number", "30", 30);
    EXPECT_EQ(Keys(bag), "Number");
}

TEST(MemoryBag, ComparesFontsByTheirMembers) {
    MemoryBag bag;
    bag.WriteProperty("Equal", std::make_shared<Font>("Arial", 10), std::make_shared<Font>("Arial", 10));
    bag.WriteProperty("Other", std::make_shared<Font>("Arial", 10), std::make_shared<Font>("Arial", 12));
    EXPECT_EQ(Keys(bag), "Other");
}

TEST(MemoryBag, TakesAnEarlierValueAwayWhenTheDefaultIsWritten) {
    MemoryBag bag = BagOf({{"Title", "one"}});
    bag.WriteProperty("Title", "none", "none");
    EXPECT_EQ(Keys(bag), "");
    EXPECT_EQ(bag.ReadProperty("Title", "another").ToText(), "another");
}

TEST(MemoryBag, HoldsOneValueForAKeyThatIsWrittenTwice) {
    MemoryBag bag;
    bag.WriteProperty("Title", "one", "");
    bag.WriteProperty("Title", "two", "");
    ASSERT_EQ(bag.Kept().size(), 1u);
    EXPECT_EQ(bag.Kept()[0].second.ToText(), "two");
}

TEST(MemoryBag, RemembersEachWriteInItsOrderWithItsDefault) {
    MemoryBag bag;
    bag.WriteProperty("B", 1, 1);
    bag.WriteProperty("A", 2, 3);
    bag.WriteProperty("B", 4, 1);
    ASSERT_EQ(bag.Written().size(), 3u);
    EXPECT_EQ(bag.Written()[0].key, "B");
    EXPECT_EQ(bag.Written()[1].key, "A");
    EXPECT_EQ(bag.Written()[1].value.ToLong(), 2);
    EXPECT_EQ(bag.Written()[1].otherwise.ToLong(), 3);
    EXPECT_EQ(bag.Written()[2].value.ToLong(), 4);
}

TEST(MemoryBag, TakesAValueThatIsSetOverOneThatStandsThere) {
    MemoryBag bag = BagOf({{"Title", "one"}});
    bag.Set("Title", "two");
    bag.Set("Other", Variant());
    EXPECT_EQ(Keys(bag), "Title Other");
    EXPECT_EQ(bag.ReadProperty("Title", "none").ToText(), "two");
    EXPECT_TRUE(bag.Written().empty());
}

}  // namespace
}  // namespace tessel::frame
