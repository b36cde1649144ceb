#include "frame/FileSystem.h"

#include <gtest/gtest.h>

namespace tessel::frame {
namespace {

class Names final : public FolderListing {
  public:
    using FolderListing::Add;
    Status Stat(std::size_t, FileRecord&) override { return {}; }
    void CallThemFolders() { folders_ = Count(); }
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
