#include "frame/Font.h"

#include <algorithm>
#include <cmath>

#include "frame/ClassTable.h"
#include "frame/Error.h"

namespace tessel::frame {

template <class T>
void Font::Store(T& field, const T& value) {
    if (field == value) return;
    field = value;
    const auto holders = holders_;  // a holder may let go, or others may come, while it is told
    const FontRef alive = holders.empty() ? nullptr : holders.front()->font_;
    for (FontHolder* holder : holders)
        if (std::find(holders_.begin(), holders_.end(), holder) != holders_.end() && holder->changed_) holder->changed_();
}

void Font::SetName(const std::string& value) { Store(name_, value); }

void Font::SetSize(double value) {
    constexpr double largest = 2048, decimals = 10'000;
    const double kept = std::nearbyint(value * decimals) / decimals;
    if (!(kept > 0 && value <= largest)) throw ControlError(errors::invalidValue);
    Store(size_, kept);
}

void Font::SetBold(bool value) { Store(weight_, value ? boldWeight : normalWeight); }
void Font::SetItalic(bool value) { Store(italic_, value); }
void Font::SetUnderline(bool value) { Store(underline_, value); }
void Font::SetStrikethrough(bool value) { Store(strikethrough_, value); }
void Font::SetWeight(std::int16_t value) { Store(weight_, value); }
void Font::SetCharset(std::int16_t value) { Store(charset_, value); }

FontRef Font::Copy() const {
    auto copy = std::make_shared<Font>();
    copy->name_ = name_;
    copy->size_ = size_;
    copy->weight_ = weight_;
    copy->charset_ = charset_;
    copy->italic_ = italic_;
    copy->underline_ = underline_;
    copy->strikethrough_ = strikethrough_;
    return copy;
}

bool Font::EqualsObject(const Object& other) const {
    const auto* font = dynamic_cast<const Font*>(&other);
    return font && font->name_ == name_ && font->size_ == size_ && font->weight_ == weight_ && font->charset_ == charset_ &&
           font->italic_ == italic_ && font->underline_ == underline_ && font->strikethrough_ == strikethrough_;
}

void FontHolder::Set(FontRef font) {
    if (font_) std::erase(font_->holders_, this);
    font_ = std::move(font);
    if (font_) font_->holders_.push_back(this);
}

namespace {

constexpr std::array members = {
    property<&Font::Name, &Font::SetName>("Name", "The name of the type face."),
    property<&Font::Size, &Font::SetSize>("Size", "The size in points."),
    property<&Font::Bold, &Font::SetBold>("Bold", "Whether the weight is bold."),
    property<&Font::Italic, &Font::SetItalic>("Italic", "Whether the face is slanted."),
    property<&Font::Underline, &Font::SetUnderline>("Underline", "Whether the text is underlined."),
    property<&Font::Strikethrough, &Font::SetStrikethrough>("Strikethrough", "Whether the text is struck through."),
    property<&Font::Weight, &Font::SetWeight>("Weight", "The weight: 400 is normal, 700 bold."),
    property<&Font::Charset, &Font::SetCharset>("Charset", "The number of the character set."),
};
constexpr ClassTable table{.name = "Font", .members = members, .defaultMember = "Name"};

}  // namespace

const ClassTable& Font::Table() const { return table; }

}  // namespace tessel::frame
