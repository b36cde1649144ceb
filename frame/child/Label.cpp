#include "frame/child/Label.h"

#include "frame/ClassTable.h"
#include "frame/Surface.h"

namespace tessel::child {

Label::Label(frame::Control& owner, std::string name) : PointerChild(owner, std::move(name)) {
    font_.Set(std::make_shared<frame::Font>());
}

void Label::SetCaption(const std::string& value) {
    if (!Store(caption_, value)) return;
    Fit();
    Change();
}

void Label::SetAutoSize(bool value) {
    if (Store(autoSize_, value)) FitAndTell();
}

void Label::SetWordWrap(bool value) {
    if (Store(wordWrap_, value)) FitAndTell();
}

void Label::SetFont(const frame::FontRef& value) {
    font_.Set(value ? value : std::make_shared<frame::Font>());
    FontChanged();
}

void Label::SetBorderStyle(LabelBorderConstants value) {
    if (Store(borderStyle_, value)) FitAndTell();
}

void Label::SetAppearance(AppearanceConstants value) {
    if (!Store(appearance_, value)) return;
    SetForeColor(value == AppearanceConstants::Flat ? frame::colors::windowText : frame::colors::buttonText);
}

void Label::ChangeInput() {
    Enter("Change", [&] { Change(); });
}

void Label::Moved() { FitAndTell(); }

void Label::FontChanged() {
    Changed();
    FitAndTell();
}

void Label::FitAndTell() {
    if (Fit()) Change();
}

bool Label::Fit() {
    if (!autoSize_) return false;
    const float border = borderStyle_ != LabelBorderConstants::None ? 2 * frame::borderTwips : 0;
    const auto room = wordWrap_ ? std::optional(Width() > border ? Width() - border : 0) : std::nullopt;
    const frame::TextSize text = Host().Metrics().Measure(*Font(), caption_, room);
    const float width = wordWrap_ ? Width() : text.width + border;
    const float height = text.height + border;
    if (width == Width() && height == Height()) return false;
    Place(Left(), Top(), width, height);
    return true;
}

namespace {

constexpr auto members =
    Join(frame::childMembers,
         std::array{
             frame::property<&Label::Caption, &Label::SetCaption>("Caption", "The text."),
             frame::property<&Label::AutoSize, &Label::SetAutoSize>("AutoSize", "Whether the label is as large as its text."),
             frame::property<&Label::WordWrap, &Label::SetWordWrap>("WordWrap", "Whether long lines go on in the next."),
             frame::property<&Label::Font, &Label::SetFont>("Font", "The font of the text."),
             frame::property<&Label::Alignment, &Label::SetAlignment>("Alignment", "Where the text stands in the label."),
             frame::property<&Label::BorderStyle, &Label::SetBorderStyle>("BorderStyle", "Whether the label has a border."),
             frame::property<&Label::Appearance, &Label::SetAppearance>("Appearance", "Flat or raised."),
             frame::property<&Label::BackColor, &Label::SetBackColor>("BackColor", "The colour behind the text."),
             frame::property<&Label::ForeColor, &Label::SetForeColor>("ForeColor", "The colour of the text."),
         });
constexpr auto inputs = frame::Join(pointerInputs, std::array{frame::input<&Label::ChangeInput>("Change")});
constexpr frame::ClassTable table{.name = "Label", .members = members, .inputs = inputs, .defaultMember = "Caption"};

}  // namespace

const frame::ClassTable& Label::Table() const { return table; }

}  // namespace tessel::child
