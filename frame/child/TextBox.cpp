#include "frame/child/TextBox.h"

#include "frame/ClassTable.h"

namespace tessel::child {

TextBox::TextBox(frame::Control& owner, std::string name) : KeyChild(owner, std::move(name)) {
    font_.Set(std::make_shared<frame::Font>());
}

void TextBox::SetText(const std::string& value) {
    if (Store(text_, value)) Change();
}

void TextBox::SetFont(const frame::FontRef& value) {
    font_.Set(value ? value : std::make_shared<frame::Font>());
    Changed();
}

void TextBox::ChangeInput(const std::string& text) {
    Enter("Change", [&] { SetText(text); });
}

namespace {

constexpr auto members = frame::Join(
    frame::childMembers,
    std::array{
        frame::property<&TextBox::Text, &TextBox::SetText>("Text", "The text."),
        frame::property<&TextBox::Locked, &TextBox::SetLocked>("Locked", "Whether the user may read the text only."),
        frame::property<&TextBox::MultiLine, &TextBox::SetMultiLine>("MultiLine", "Whether the text may have several lines."),
        frame::property<&TextBox::Alignment, &TextBox::SetAlignment>("Alignment", "The alignment of the text."),
        frame::property<&TextBox::BorderStyle, &TextBox::SetBorderStyle>("BorderStyle", "The border."),
        frame::property<&TextBox::Appearance, &TextBox::SetAppearance>("Appearance", "Whether the border has depth."),
        frame::property<&TextBox::Font, &TextBox::SetFont>("Font", "The font."),
        frame::property<&TextBox::BackColor, &TextBox::SetBackColor>("BackColor", "The background colour."),
        frame::property<&TextBox::ForeColor, &TextBox::SetForeColor>("ForeColor", "The colour of the text."),
    });
constexpr auto inputs = frame::Join(keyInputs, std::array{frame::input<&TextBox::ChangeInput>("Change", {"Text"})});
constexpr frame::ClassTable table{.name = "TextBox", .members = members, .inputs = inputs, .defaultMember = "Text"};

}  // namespace

const frame::ClassTable& TextBox::Table() const { return table; }

}  // namespace tessel::child
