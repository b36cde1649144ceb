#include <gtest/gtest.h>

#include <string>

#include "tests/controls/fileview/FileViewTestHelp.h"

/// The size of the whole tree.
namespace tessel::controls {
namespace {

using namespace fileviewtest;
using frame::Variant;

/// A tree that is too large to be measured at once.
class FileViewTotal : public testing::Test {
  protected:
    FileViewTotal() {
        for (int number = 0; number < many; ++number) stage.File("C:\\x\\sub\\" + std::to_string(number) + "\\one", 1);
        stage.ShowPath("C:\\x");
    }
    static constexpr int many = 5'000;
    Stage stage;
    FileView& view = stage.View();
};

TEST_F(FileViewTotal, OfALargeTreeIsNotKnownAtOnceButReadWhole) {
    EXPECT_FALSE(view.TotalSizeKnown());
    EXPECT_EQ(view.TotalSize(), Variant(many));
    EXPECT_TRUE(view.TotalSizeKnown());
}

class Told {
  public:
    void Ready() { ++count; }
    int count = 0;
};

TEST_F(FileViewTotal, BecomesKnownInIdleTime) {
    Told told;
    view.TotalSizeReady.To<&Told::Ready>(told);
    stage.host.clock.Advance(20);
    EXPECT_FALSE(view.TotalSizeKnown());
    stage.host.clock.Advance(1'000);
    EXPECT_TRUE(view.TotalSizeKnown());
    EXPECT_EQ(told.count, 1);
    stage.File("C:\\x\\later", 1);
    EXPECT_EQ(view.TotalSize(), Variant(many));
}

TEST_F(FileViewTotal, OfASmallTreeIsKnownAtOnce) {
    stage.File("C:\\y\\a", 3);
    stage.ShowPath("C:\\y");
    EXPECT_TRUE(view.TotalSizeKnown());
    stage.File("C:\\y\\later", 1);
    EXPECT_EQ(view.TotalSize(), Variant(3));
}

TEST_F(FileViewTotal, IsThatOfTheFolderShownWhateverWasMeasuredBefore) {
    stage.File("C:\\y\\a", 3);
    stage.ShowPath("C:\\y");
    stage.host.clock.Advance(1'000);
    EXPECT_EQ(view.TotalSize(), Variant(3));
}

TEST_F(FileViewTotal, StaysKnownWhenTheFolderHasGone) {
    EXPECT_EQ(view.TotalSize(), Variant(many));
    stage.Remove("C:\\x");
    view.SetFolderPath("C:\\x");
    view.Show();
    EXPECT_EQ(view.TotalSize(), Variant(many));
}

TEST_F(FileViewTotal, ARefreshLetsAMeasurementGoOn) {
    stage.host.clock.Advance(20);
    stage.Tick();
    EXPECT_FALSE(view.TotalSizeKnown());
    EXPECT_EQ(view.TotalSize(), Variant(many));
    stage.File("C:\\x\\new", 5);
    stage.Tick();
    EXPECT_EQ(view.TotalSize(), Variant(many + 5));
}

TEST_F(FileViewTotal, BecomesKnownHoweverOftenTheListIsRefreshed) {
    Told told;
    view.TotalSizeReady.To<&Told::Ready>(told);
    for (int round = 0; round < 8 && told.count == 0; ++round) {
        stage.Tick();
        stage.host.clock.Advance(20);
    }
    EXPECT_EQ(told.count, 1);
}

TEST_F(FileViewTotal, ASaveHoldsTheWholeSize) {
    frame::MemoryBag bag;
    stage.Save(bag);
    EXPECT_EQ(bag.ReadProperty("TotalSize", 0), Variant(many));
}

TEST_F(FileViewTotal, TheWorkEndsWithTheControl) {
    stage.Destroy();
    stage.host.clock.Advance(1'000);
    EXPECT_FALSE(stage.Lives());
}

}  // namespace
}  // namespace tessel::controls
