#include "hosts/qt/ListLayout.h"

#include <gtest/gtest.h>

#include <string>

namespace tessel::qt {
namespace {

using Flow = ListLayout::Flow;
using Step = ListLayout::Step;

ListLayout Layout(Flow flow, std::uint32_t count) {
    return {.flow = flow, .count = count, .cell = {50, 20}, .window = {160, 90}, .contentWidth = 300};
}

std::string Touched(const ListLayout& layout, QRect rectangle) {
    std::string result;
    for (const child::RowRange range : layout.Touched(rectangle))
        result += (result.empty() ? "" : " ") + std::to_string(range.first) + "+" + std::to_string(range.count);
    return result;
}

TEST(ListLayout, RowsStandOneBelowTheOther) {
    const ListLayout layout = Layout(Flow::Rows, 10);
    EXPECT_EQ(layout.Contents(), QSize(300, 200));
    EXPECT_EQ(layout.CellOf(3), QRect(0, 60, 300, 20));
    EXPECT_EQ(layout.At({250, 61}), 3u);
    EXPECT_EQ(layout.At({5, 200}), std::nullopt);
    EXPECT_EQ(layout.At({5, -1}), std::nullopt);
    EXPECT_EQ(Touched(layout, QRect(0, 15, 10, 30)), "0+3");
    EXPECT_EQ(Touched(layout, QRect(0, 190, 10, 300)), "9+1");
}

TEST(ListLayout, AcrossGoesOnDownwards) {
    const ListLayout layout = Layout(Flow::Across, 10);  // three in a line
    EXPECT_EQ(layout.Contents(), QSize(150, 80));
    EXPECT_EQ(layout.CellOf(4), QRect(50, 20, 50, 20));
    EXPECT_EQ(layout.At({149, 79}), std::nullopt);
    EXPECT_EQ(layout.At({49, 79}), 9u);
    EXPECT_EQ(layout.At({155, 5}), std::nullopt);
    EXPECT_EQ(Touched(layout, QRect(60, 10, 100, 20)), "1+2 4+2");
    EXPECT_EQ(Touched(layout, QRect(0, 0, 160, 90)), "0+10");
}

TEST(ListLayout, DownGoesOnToTheRight) {
    const ListLayout layout = Layout(Flow::Down, 10);  // four in a column
    EXPECT_EQ(layout.Contents(), QSize(150, 80));
    EXPECT_EQ(layout.CellOf(5), QRect(50, 20, 50, 20));
    EXPECT_EQ(layout.At({120, 30}), 9u);
    EXPECT_EQ(layout.At({120, 50}), std::nullopt);
    EXPECT_EQ(layout.At({20, 85}), std::nullopt);
    EXPECT_EQ(Touched(layout, QRect(10, 10, 60, 20)), "0+2 4+2");
}

TEST(ListLayout, StepsFollowTheFlow) {
    const ListLayout rows = Layout(Flow::Rows, 10), across = Layout(Flow::Across, 10), down = Layout(Flow::Down, 10);
    EXPECT_EQ(rows.Next(0, Step::Up), 0u);
    EXPECT_EQ(rows.Next(9, Step::Down), 9u);
    EXPECT_EQ(rows.Next(0, Step::PageDown), 3u);
    EXPECT_EQ(rows.Next(9, Step::PageDown), 9u);
    EXPECT_EQ(rows.Next(5, Step::First), 0u);
    EXPECT_EQ(rows.Next(5, Step::Last), 9u);
    EXPECT_EQ(across.Next(1, Step::Down), 4u);
    EXPECT_EQ(across.Next(7, Step::Down), 9u);
    EXPECT_EQ(across.Next(4, Step::Left), 3u);
    EXPECT_EQ(across.Next(1, Step::Up), 1u);
    EXPECT_EQ(down.Next(1, Step::Right), 5u);
    EXPECT_EQ(down.Next(6, Step::Right), 9u);
    EXPECT_EQ(down.Next(3, Step::Down), 4u);
    EXPECT_EQ(down.Next(4, Step::Left), 0u);
}

TEST(ListLayout, TheFirstInViewIsTheFirstThatBeginsInView) {
    const ListLayout layout = Layout(Flow::Rows, 10);
    EXPECT_EQ(layout.FirstVisible({0, 0}), 0u);
    EXPECT_EQ(layout.FirstVisible({0, 1}), 1u);
    EXPECT_EQ(layout.FirstVisible({0, 40}), 2u);
    ListLayout low = layout;
    low.window = {160, 10};
    EXPECT_EQ(low.FirstVisible({0, 45}), 2u);
}

TEST(ListLayout, ScrollingStopsAtTheEnd) {
    const ListLayout layout = Layout(Flow::Rows, 10);
    EXPECT_EQ(layout.ToTop(2), QPoint(0, 40));
    EXPECT_EQ(layout.ToTop(9), QPoint(0, 110));
    EXPECT_EQ(layout.IntoView(1, {0, 10}), QPoint(0, 10));
    EXPECT_EQ(layout.IntoView(0, {0, 10}), QPoint(0, 0));
    EXPECT_EQ(layout.IntoView(6, {0, 10}), QPoint(0, 50));
}

TEST(ListLayout, AMillionRowsDoNotOverflow) {
    const ListLayout layout = Layout(Flow::Rows, 100'000'000);
    EXPECT_EQ(layout.CellOf(99'999'999).top(), 1'999'999'980);
    EXPECT_EQ(layout.At({0, 1'999'999'999}), 99'999'999u);
    EXPECT_EQ(Layout(Flow::Rows, 0).Contents(), QSize(300, 0));
    EXPECT_EQ(Touched(Layout(Flow::Across, 0), QRect(0, 0, 100, 100)), "");
}

}  // namespace
}  // namespace tessel::qt
