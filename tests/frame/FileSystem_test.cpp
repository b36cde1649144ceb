#include "frame/FileSystem.h"

#include <gtest/gtest.h>

namespace tessel::frame {
namespace {

class Names final : public FolderListing {
  public:
    using FolderListing::Add;
    Status Stat(std::size_t index, FileRecord& record) override {
        constexpr int permissionDenied = 70;
        record.attributes = attributes::hidden | attributes::readOnly;
        return index == 0 ? Status() : Status(permissionDenied);
    }
    void CallThemFolders() { folders_ = Count(); }
    void CallTheLastALink() { entries_.back().isLink = true; }
};

TEST(FolderListing, KeepsTheNamesThatItIsGiven) {
    Names names;
    EXPECT_TRUE(names.Add("sub"));
    names.CallThemFolders();
    const std::string longest(65'535, 'x');
    EXPECT_TRUE(names.Add(longest));
    EXPECT_TRUE(names.Add(""));
    EXPECT_FALSE(names.Add(longest + "x"));
    ASSERT_EQ(names.Count(), 3u);
    EXPECT_EQ(names.Name(0), "sub");
    EXPECT_EQ(names.Name(1), longest);
    EXPECT_EQ(names.Name(2), "");
    EXPECT_TRUE(names.IsFolder(0));
    EXPECT_FALSE(names.IsFolder(1));
    EXPECT_EQ(names.FolderCount(), 1u);
}

TEST(FolderListing, KnowsALink) {
    Names names;
    names.Add("a");
    names.Add("b");
    names.CallTheLastALink();
    EXPECT_FALSE(names.IsLink(0));
    EXPECT_TRUE(names.IsLink(1));
}

TEST(FolderListing, ReadsWhatHidesAnEntryLikeTheRest) {
    Names names;
    names.Add("a");
    names.Add("b");
    std::int32_t hiding = 0;
    EXPECT_EQ(names.StatHiding(0, hiding).Number(), 0);
    EXPECT_EQ(hiding, attributes::hidden);
    EXPECT_EQ(names.StatHiding(1, hiding).Number(), 70);
}

class Countdown final : public TreeSize {
  public:
    bool Step(std::size_t) override {
        if (left_ == 0) return false;
        bytes_ += left_--;
        return left_ > 0;
    }

  private:
    std::int64_t left_ = 10;
};

TEST(TreeSize, IsFinishedInAsManyStepsAsItTakes) {
    Countdown tree;
    EXPECT_EQ(tree.Finish(), 55);
    EXPECT_EQ(tree.Bytes(), 55);
}

TEST(SpecialFolderNumbers, FollowTheTableWithoutRegardToCase) {
    EXPECT_EQ(SpecialFolderNumber("personal"), 5);
    EXPECT_EQ(SpecialFolderNumber("PERSONAL"), 5);
    EXPECT_EQ(SpecialFolderNumber("Desktop"), 0);
    EXPECT_EQ(SpecialFolderNumber("Templates"), 21);
    EXPECT_EQ(SpecialFolderNumber("My Documents"), -1);
    EXPECT_EQ(SpecialFolderNumber(""), -1);
}

}  // namespace
}  // namespace tessel::frame
