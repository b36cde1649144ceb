#include "frame/Font.h"

#include <gtest/gtest.h>

#include <array>
#include <limits>
#include <memory>
#include <string>

#include "frame/Picture.h"
#include "frame/Variant.h"
#include "tests/frame/TestControl.h"

namespace tessel::frame {
namespace {

using test::ErrorOf;

TEST(Font, IsTheOrdinaryOneAtFirst) {
    const Font font;
    EXPECT_EQ(font.Name(), "MS Sans Serif");
    EXPECT_EQ(font.Size(), 8.25);
    EXPECT_EQ(font.Weight(), 400);
    EXPECT_EQ(font.Charset(), 0);
    EXPECT_FALSE(font.Bold() || font.Italic() || font.Underline() || font.Strikethrough());
}

TEST(Font, KeepsItsSizeToFourDecimals) {
    Font font("Arial", 10.123456);
    EXPECT_EQ(font.Size(), 10.1235);
    font.SetSize(9.75);
    EXPECT_EQ(font.Size(), 9.75);
    font.SetSize(2048);
    EXPECT_EQ(font.Size(), 2048);
}

TEST(Font, RefusesASizeThatIsNoneAndKeepsTheOldOne) {
    Font font("Arial", 10);
    for (const double size :
         {0.0, -1.0, 2048.1, 1e300, std::numeric_limits<double>::quiet_NaN(), std::numeric_limits<double>::infinity()})
        EXPECT_EQ(ErrorOf([&] { font.SetSize(size); }), errors::invalidValue) << size;
    EXPECT_EQ(font.Size(), 10);
    EXPECT_EQ(ErrorOf([] { Font("Arial", 0); }), errors::invalidValue);
}

TEST(Font, NeverHasTheSizeZero) {
    Font font("Arial", 10);
    test::ErrorOf([&] { font.SetSize(0.00001); });
    EXPECT_GT(font.Size(), 0);
}

TEST(Font, IsBoldByItsWeight) {
    Font font;
    font.SetBold(true);
    EXPECT_EQ(font.Weight(), 700);
    font.SetWeight(600);
    EXPECT_TRUE(font.Bold());
    font.SetBold(true);
    EXPECT_EQ(font.Weight(), 700);
    font.SetWeight(500);
    EXPECT_FALSE(font.Bold());
    font.SetBold(false);
    EXPECT_EQ(font.Weight(), 400);
}

TEST(Font, IsReadAndSetByName) {
    Font font;
    font.Put("name", "Arial");
    font.Put("SIZE", "12.5");
    font.Put("Bold", true);
    font.Put("Italic", -1);
    font.Put("Underline", "True");
    font.Put("Strikethrough", 1);
    font.Put("Charset", 2);
    EXPECT_EQ(font.Name(), "Arial");
    EXPECT_EQ(font.Size(), 12.5);
    EXPECT_EQ(font.Get("Weight").ToLong(), 700);
    EXPECT_TRUE(font.Italic() && font.Underline() && font.Strikethrough());
    EXPECT_EQ(font.Charset(), 2);
    EXPECT_EQ(ErrorOf([&] { font.Put("Size", 0); }), errors::invalidValue);
    EXPECT_EQ(Variant(ObjectRef(font)).ToText(), "Arial");
}

/// Fonts that differ from the ordinary one in one member each.
std::array<FontRef, 7> Altered() {
    std::array<FontRef, 7> fonts;
    for (FontRef& font : fonts) font = std::make_shared<Font>();
    fonts[0]->SetName("Arial");
    fonts[1]->SetSize(9);
    fonts[2]->SetWeight(500);
    fonts[3]->SetItalic(true);
    fonts[4]->SetUnderline(true);
    fonts[5]->SetStrikethrough(true);
    fonts[6]->SetCharset(1);
    return fonts;
}

TEST(Font, EqualsAnotherWhenAllMembersDo) {
    const Font plain;
    EXPECT_TRUE(plain.EqualsObject(Font()));
    for (const FontRef& font : Altered()) {
        EXPECT_FALSE(plain.EqualsObject(*font));
        EXPECT_FALSE(font->EqualsObject(plain));
    }
    EXPECT_FALSE(plain.EqualsObject(Picture()));
}

TEST(Font, CopiesEveryMemberAndGoesItsOwnWay) {
    for (const FontRef& font : Altered()) {
        const FontRef copy = font->Copy();
        EXPECT_TRUE(copy->EqualsObject(*font));
        copy->SetSize(72);
        EXPECT_FALSE(copy->EqualsObject(*font));
    }
}

TEST(Font, DoesNotTellTheHoldersOfTheOneItWasCopiedFrom) {
    const auto font = std::make_shared<Font>();
    int told = 0;
    FontHolder holder([&] { ++told; });
    holder.Set(font);
    font->Copy()->SetBold(true);
    EXPECT_EQ(told, 0);
}

// Holders

TEST(FontHolder, HearsOfEachMemberThatChangesOnce) {
    const auto font = std::make_shared<Font>();
    int told = 0;
    FontHolder holder([&] { ++told; });
    holder.Set(font);
    font->SetName("Arial");
    font->SetSize(9);
    font->SetBold(true);
    font->SetItalic(true);
    font->SetUnderline(true);
    font->SetStrikethrough(true);
    font->SetWeight(500);
    font->SetCharset(1);
    EXPECT_EQ(told, 8);
}

TEST(FontHolder, HearsNothingOfASetThatChangesNothingOrIsRefused) {
    const auto font = std::make_shared<Font>("Arial", 9);
    int told = 0;
    FontHolder holder([&] { ++told; });
    holder.Set(font);
    font->SetName("Arial");
    font->SetSize(9.00001);
    font->SetBold(false);
    ErrorOf([&] { font->SetSize(-1); });
    EXPECT_EQ(told, 0);
}

TEST(FontHolder, FindsTheNewValueWhenItIsTold) {
    const auto font = std::make_shared<Font>();
    double seen = 0;
    FontHolder holder([&] { seen = font->Size(); });
    holder.Set(font);
    font->SetSize(20);
    EXPECT_EQ(seen, 20);
}

TEST(FontHolder, IsNotToldOfAnotherFontThatItTakes) {
    int told = 0;
    FontHolder holder([&] { ++told; });
    holder.Set(std::make_shared<Font>());
    holder.Set(std::make_shared<Font>("Arial", 20));
    holder.Set(nullptr);
    EXPECT_EQ(told, 0);
    EXPECT_EQ(holder.Get(), nullptr);
}

TEST(FontHolder, HearsNothingMoreOfAFontThatItLetGo) {
    const auto font = std::make_shared<Font>();
    int told = 0;
    {
        FontHolder holder([&] { ++told; });
        holder.Set(font);
        holder.Set(std::make_shared<Font>());
        font->SetBold(true);
        holder.Set(font);
    }
    font->SetBold(false);
    EXPECT_EQ(told, 0);
}

TEST(FontHolder, IsOneOfManyWhoAllHear) {
    const auto font = std::make_shared<Font>();
    std::string told;
    FontHolder one([&] { told += "1"; }), two([&] { told += "2"; }), silent;
    one.Set(font);
    two.Set(font);
    silent.Set(font);
    font->SetBold(true);
    EXPECT_EQ(told, "12");
}

TEST(FontHolder, IsToldOnceWhenItTakesTheSameFontTwice) {
    const auto font = std::make_shared<Font>();
    int told = 0;
    FontHolder holder([&] { ++told; });
    holder.Set(font);
    holder.Set(font);
    font->SetBold(true);
    EXPECT_EQ(told, 1);
}

TEST(FontHolder, MayLetGoAndTakeOthersAlongWhileItIsTold) {
    const auto font = std::make_shared<Font>();
    std::string told;
    auto second = std::make_unique<FontHolder>([&] { told += "2"; });
    FontHolder third([&] { told += "3"; });
    FontHolder first([&] {
        told += "1";
        second.reset();
        third.Set(font);
        first.Set(nullptr);
    });
    first.Set(font);
    second->Set(font);
    font->SetBold(true);
    EXPECT_EQ(told, "1");
    font->SetBold(false);
    EXPECT_EQ(told, "13");
}

TEST(FontHolder, MayTakeTheLastReferenceToTheFontAwayWhileItIsTold) {
    std::string told;
    FontHolder second([&] { told += "2"; });
    FontHolder first([&] {
        told += "1";
        first.Set(nullptr);
        second.Set(nullptr);
    });
    first.Set(std::make_shared<Font>());
    second.Set(first.Get());
    first.Get()->SetBold(true);
    EXPECT_EQ(told, "1");
    EXPECT_EQ(second.Get(), nullptr);
}

TEST(FontHolder, KeepsItsFontAlive) {
    FontHolder holder;
    holder.Set(std::make_shared<Font>());
    const std::weak_ptr<Font> font = holder.Get();
    EXPECT_FALSE(font.expired());
    holder.Set(nullptr);
    EXPECT_TRUE(font.expired());
}

}  // namespace
}  // namespace tessel::frame
