#include "frame/child/TextBox.h"

#include <gtest/gtest.h>

#include "frame/ClassTable.h"
#include "hosts/headless/HeadlessHost.h"

namespace tessel::child {
namespace {

class Paper final : public frame::Control {
  public:
    explicit Paper(frame::Host& host) : Control(host) { Text1.Change.To<&Paper::Changed>(*this); }
    frame::TextSize DesignSize() const override { return {1500, 1500}; }
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Paper", .members = {}};
        return table;
    }

    int changes = 0;
    TextBox Text1{*this, "Text1"};

  private:
    void Changed() { ++changes; }
};

class TextBoxTest : public testing::Test {
  protected:
    headless::HeadlessHost host;
    Paper& paper = host.Create<Paper>("Paper1");
    TextBox& box = paper.Text1;
};

TEST_F(TextBoxTest, NewTextRaisesChangeAndTheSameDoesNot) {
    box.SetText("a");
    EXPECT_EQ(paper.changes, 1);
    box.SetText("a");
    EXPECT_EQ(paper.changes, 1);
    box.SetText("");
    EXPECT_EQ(paper.changes, 2);
}

TEST_F(TextBoxTest, EditOfTheUserIsTheTextAndRaisesChange) {
    box.ChangeInput("typed");
    EXPECT_EQ(box.Text(), "typed");
    EXPECT_EQ(paper.changes, 1);
    box.ChangeInput("typed");
    EXPECT_EQ(paper.changes, 1);
}

TEST_F(TextBoxTest, LooksLikeAPieceOfAWindowAtFirst) {
    EXPECT_EQ(box.BackColor(), frame::colors::windowBackground);
    EXPECT_EQ(box.ForeColor(), frame::colors::windowText);
    EXPECT_EQ(box.Text(), "");
    EXPECT_FALSE(box.Locked());
    EXPECT_FALSE(box.MultiLine());
    ASSERT_TRUE(box.Font());
}

TEST_F(TextBoxTest, FontIsNeverNull) {
    const auto font = std::make_shared<frame::Font>("Arial", 12);
    box.SetFont(font);
    EXPECT_EQ(box.Font(), font);
    box.SetFont(nullptr);
    ASSERT_TRUE(box.Font());
    EXPECT_EQ(box.Font()->Name(), frame::Font().Name());
}

TEST_F(TextBoxTest, TextIsItsDefaultMember) {
    box.SetText("12");
    EXPECT_EQ(frame::Variant(frame::ObjectRef(box)).ToLong(), 12);
}

TEST_F(TextBoxTest, EveryPropertyCanBeSetByName) {
    box.Put("Text", "b");
    box.Put("Locked", true);
    box.Put("MultiLine", true);
    box.Put("Alignment", 2);
    box.Put("BorderStyle", 0);
    box.Put("Appearance", 0);
    box.Put("BackColor", 1);
    box.Put("ForeColor", 2);
    EXPECT_EQ(box.Text(), "b");
    EXPECT_TRUE(box.Locked());
    EXPECT_TRUE(box.MultiLine());
    EXPECT_EQ(box.Alignment(), AlignmentConstants::Center);
    EXPECT_EQ(box.BorderStyle(), LabelBorderConstants::None);
    EXPECT_EQ(box.Appearance(), AppearanceConstants::Flat);
    EXPECT_EQ(box.BackColor(), frame::OLE_COLOR(1));
    EXPECT_EQ(box.ForeColor(), frame::OLE_COLOR(2));
}

}  // namespace
}  // namespace tessel::child
