#include "frame/child/ComboList.h"

#include "frame/ClassTable.h"

namespace tessel::child {

using frame::ControlError;

ComboList::ComboList(frame::Control& owner, std::string name, ComboRows::Order order)
    : KeyChild(owner, std::move(name)), rows_(order) {
    font_.Set(std::make_shared<frame::Font>());
    TakeHeight();
}

ComboRows::Position ComboList::Checked(std::int32_t index, int error) const {
    if (index < 0 || index >= ListCount()) throw ControlError(error);
    return static_cast<ComboRows::Position>(index);
}

std::string ComboList::List(std::int32_t index) const {
    return std::string(rows_.Text(Checked(index, frame::errors::invalidArrayIndex)));
}

std::int32_t ComboList::ItemData(std::int32_t index) const { return rows_.Data(Checked(index, frame::errors::invalidArrayIndex)); }

void ComboList::SetItemData(std::int32_t index, std::int32_t value) {
    rows_.SetData(Checked(index, frame::errors::invalidArrayIndex), value);
}

std::int32_t ComboList::ListIndex() const { return chosen_ != none ? static_cast<std::int32_t>(rows_.PositionOf(chosen_)) : -1; }

void ComboList::SetListIndex(std::int32_t index) {
    chosen_ = index != -1 ? rows_.RowAt(Checked(index, frame::errors::invalidValue)) : none;
    Changed();
    Click();
}

std::int32_t ComboList::NewIndex() const { return new_ != none ? static_cast<std::int32_t>(rows_.PositionOf(new_)) : -1; }

std::string ComboList::Text() const { return chosen_ != none ? std::string(rows_.Text(rows_.PositionOf(chosen_))) : std::string(); }

void ComboList::Add(std::string_view text, std::int32_t data) {
    new_ = rows_.Add(text, data);
    RowsChanged();
}

void ComboList::RemoveItem(std::int32_t index) {
    const ComboRows::Position position = Checked(index, frame::errors::invalidCall);
    if (rows_.RowAt(position) == chosen_) chosen_ = none;
    new_ = none;
    rows_.Remove(position);
    RowsChanged();
}

void ComboList::Clear() {
    chosen_ = new_ = none;
    rows_.Clear();
    RowsChanged();
}

std::int32_t ComboList::FindData(std::int32_t data) const {
    const auto found = rows_.FindData(data);
    return found ? static_cast<std::int32_t>(*found) : -1;
}

std::int32_t ComboList::FindText(std::string_view text) const {
    const auto found = rows_.FindText(text);
    return found ? static_cast<std::int32_t>(*found) : -1;
}

void ComboList::SetFont(const frame::FontRef& value) {
    font_.Set(value ? value : std::make_shared<frame::Font>());
    FontChanged();
}

void ComboList::FontChanged() {
    Changed();
    if (TakeHeight()) HeightChanged();
}

void ComboList::ChooseInput(std::int32_t index) {
    Enter("Click", [&] { SetListIndex(index); });
}

void ComboList::ListClickInput(std::optional<std::int32_t> index) {
    Enter("Click", [&] {
        if (index)
            SetListIndex(*index);
        else
            Click();
    });
}

void ComboList::HeightInput() {
    Enter("Resize", [&] {
        if (TakeHeight()) HeightChanged();
    });
}

bool ComboList::TakeHeight() {
    auto* const shown = dynamic_cast<ComboListPeer*>(Peer());
    const float height = shown ? shown->NaturalHeight() : heightTwips;
    if (Height() == height) return false;
    Place(Left(), Top(), Width(), height);
    return true;
}

void ComboList::RowsChanged() {
    ++revision_;
    Changed();
}

namespace {

/// The members that every child has, with a height that is the list's own.
constexpr auto common = [] {
    auto rows = frame::childMembers;
    for (frame::Member& row : rows)
        if (row.name == "Height") row = frame::property<&ComboList::Height>("Height", "Height in twips, which the list fixes.");
    return rows;
}();
constexpr auto members = frame::Join(
    common,
    std::array{
        frame::property<&ComboList::List>("List", "The text of a row, from 0."),
        frame::property<&ComboList::ItemData, &ComboList::SetItemData>("ItemData", "The number of a row, from 0."),
        frame::property<&ComboList::ListIndex, &ComboList::SetListIndex>("ListIndex", "The row that is chosen; -1 for none."),
        frame::property<&ComboList::ListCount>("ListCount", "How many rows there are."),
        frame::property<&ComboList::NewIndex>("NewIndex", "The row that was added last; -1 for none."),
        frame::property<&ComboList::Text>("Text", "The text of the row that is chosen."),
        frame::property<&ComboList::Sorted>("Sorted", "Whether the list keeps its rows sorted."),
        frame::property<&ComboList::Font, &ComboList::SetFont>("Font", "The font of the texts."),
        frame::property<&ComboList::Appearance, &ComboList::SetAppearance>("Appearance", "Whether the border has depth."),
        frame::property<&ComboList::BackColor, &ComboList::SetBackColor>("BackColor", "The background colour."),
        frame::property<&ComboList::ForeColor, &ComboList::SetForeColor>("ForeColor", "The colour of the texts."),
        frame::method<&ComboList::AddItem>("AddItem", "Adds a row.", {"Item"}),
        frame::method<&ComboList::RemoveItem>("RemoveItem", "Removes a row.", {"Index"}),
        frame::method<&ComboList::Clear>("Clear", "Removes all rows."),
    });
constexpr auto inputs = [] {
    auto rows = keyInputs;
    for (frame::Member& row : rows)
        if (row.name == "Click") row = frame::input<&ComboList::ListClickInput>("Click", {"Index"});
    return rows;
}();
constexpr frame::ClassTable table{.name = "ComboList", .members = members, .inputs = inputs, .defaultMember = "Text"};

}  // namespace

const frame::ClassTable& ComboList::Table() const { return table; }

}  // namespace tessel::child
