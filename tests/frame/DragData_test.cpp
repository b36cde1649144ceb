#include "frame/DragData.h"

#include <gtest/gtest.h>

#include "frame/Error.h"

namespace tessel::frame {
namespace {

TEST(DragData, HasTheFormatOfFilesOnceItIsPromisedOrHoldsAFile) {
    DragData data;
    EXPECT_FALSE(data.GetFormat(filesFormat));
    data.Files.Add("C:\\a");
    EXPECT_TRUE(data.GetFormat(filesFormat));
    data.Files.Clear();
    EXPECT_FALSE(data.GetFormat(filesFormat));
    data.SetData({}, filesFormat);
    EXPECT_TRUE(data.GetFormat(filesFormat));
    EXPECT_FALSE(data.GetFormat(1));
}

TEST(DragData, IsEmptyAfterClear) {
    DragData data;
    data.SetData({}, 1);
    data.Files.Add("C:\\a");
    data.Clear();
    EXPECT_FALSE(data.GetFormat(1));
    EXPECT_EQ(data.Files.Count(), 0);
}

TEST(DragData, NumbersItsFilesFromOne) {
    DragData data;
    data.Files.Add("C:\\a");
    data.Files.Add("C:\\b");
    EXPECT_EQ(data.Files.Item(1), "C:\\a");
    EXPECT_EQ(data.Files.Item(2), "C:\\b");
    EXPECT_THROW(data.Files.Item(0), ControlError);
    EXPECT_THROW(data.Files.Item(3), ControlError);
}

TEST(DragData, IsFilledByName) {
    DragData data;
    Variant path[] = {"C:\\a"};
    data.Inner("files")->Call("Add", path);
    Variant first[] = {1}, files[] = {filesFormat};
    EXPECT_EQ(data.Inner("Files")->Get("Item", first), Variant("C:\\a"));
    EXPECT_EQ(data.Call("GetFormat", files), Variant(true));
    Variant promise[] = {Variant::Missing(), 7}, promised[] = {7};
    data.Call("SetData", promise);
    EXPECT_EQ(data.Call("GetFormat", promised), Variant(true));
}

}  // namespace
}  // namespace tessel::frame
