#include "controls/datalist/DataList.h"

#include <limits>

#include "frame/ResumeNext.h"
#include "frame/Text.h"

namespace tessel::controls {

using child::ComboList;
using frame::OLE_COLOR;
using frame::ResumeNext;
using frame::Variant;
using frame::VarType;

namespace {

constexpr frame::TextSize designSize{2175, ComboList::heightTwips};
constexpr std::int32_t notFound = -1;

/// The last 4 characters of 5 blanks and a text.
std::string LastFour(std::string_view text) {
    constexpr std::size_t wanted = 4;
    std::string padded = "     " + std::string(text);
    std::size_t surplus = frame::CharacterCount(padded) - wanted, at = 0;
    for (; surplus > 0; --surplus) frame::NextCharacter(padded, at);
    return padded.substr(at);
}

}  // namespace

DataList::DataList(frame::Host& host) : Control(host) {
    own.Font = std::make_shared<frame::Font>();
    for (ComboList& list : listItems) {
        list.SetWidth(designSize.width);
        list.Click.To<&DataList::ListClick>(*this);
        list.DblClick.To<&DataList::ListDblClick>(*this);
        list.KeyDown.To<&DataList::ListKeyDown>(*this);
        list.KeyPress.To<&DataList::ListKeyPress>(*this);
        list.KeyUp.To<&DataList::ListKeyUp>(*this);
    }
    listItems[0].HeightChanged.To<&DataList::ListHeightChanged>(*this);
    labItem.Move(0, 0, designSize.width, designSize.height);
}

std::string DataList::Populate(const frame::ObjectRef& ListRecordset, const Variant& TextColumn, const Variant& ValueColumn,
                               const std::optional<Variant>& DefaultText, const std::optional<Variant>& DefaultValue) {
    ResumeNext next;
    std::unique_ptr<frame::RecordReader> records;
    std::size_t textColumn = 0, valueColumn = 0;
    const auto inColumn = [&](const char* which, const Variant& column) {
        const std::string why = next.Description();
        std::string message;
        next([&] { message = which + column.ToText() + " - " + why; });
        return message;
    };
    next([&] {
        records = frame::RecordReader::For(ListRecordset);
        records->MoveFirst();
    });
    if (next.Failed()) return next.Description();
    next([&] { textColumn = records->Column(TextColumn); });
    if (next.Failed()) return inColumn("TextColumn=", TextColumn);
    next([&] { valueColumn = records->Column(ValueColumn); });
    if (next.Failed()) return inColumn("ValueColumn=", ValueColumn);

    own.busy = true;
    for (ComboList& list : listItems) list.Clear();
    own.itemCounter = 0;
    if (DefaultText) AddDefaultPair(*DefaultText, DefaultValue);
    const std::string why = AddRows(*records, textColumn, valueColumn);
    Host().Turn();
    own.busy = false;
    return why;
}

/// In resume-next mode a test for the end that fails goes on with the row, and after a step that fails the row comes again. The
/// second of two failures with no sound row between them ends the walk, which would have no end, and its words are given.
std::string DataList::AddRows(frame::RecordReader& records, std::size_t textColumn, std::size_t valueColumn) {
    constexpr int tooMany = 2;
    std::string text;
    ResumeNext test, row, step;
    for (int failures = 0;;) {
        if (test.Value([&] { return records.AtEnd(); }, false)) return {};
        if (test.Failed() && ++failures == tooMany) return test.Description();
        row([&] {
            records.Text(textColumn, text);
            AddText(text, records.Value(valueColumn));
        });
        step([&] { records.MoveNext(); });
        if (step.Failed() && ++failures == tooMany) return step.Description();
        if (!test.Failed() && !step.Failed()) {
            failures = 0;
            continue;
        }
        test.Clear();
        step.Clear();
    }
}

/// The value is taken to 16 bits: one that does not fit leaves the one that was there.
void DataList::AddDefaultPair(const Variant& text, const std::optional<Variant>& value) {
    ResumeNext next;
    next([&] { own.DefaultText = text.ToText(); });
    next([&] { own.DefaultValue = (value ? *value : Variant(own.DefaultValue)).ToInteger(); });
    next([&] { AddEntry(own.DefaultText, own.DefaultValue); });
    next([&] { ActiveList().SetListIndex(ActiveList().NewIndex()); });
}

void DataList::SetLocked(bool value) {
    own.Locked = value;
    PropertyChanged("Locked");
}

std::int32_t DataList::Value() const {
    const std::int32_t index = ActiveList().ListIndex();
    return index != notFound ? ActiveList().ItemData(index) : own.DefaultValue;
}

void DataList::SetValue(std::int32_t value) {
    RefuseAtDesignTime();
    ResumeNext next;
    const std::int32_t index = ActiveList().FindData(value);
    if (index == notFound) {
        next([&] { SelectDefault(); });
    } else {
        next([&] { ActiveList().SetListIndex(index); });
        next([&] { labItem.SetCaption(ActiveList().List(index)); });
    }
    PropertyChanged("Value");
}

void DataList::SetLockedAlways(bool value) {
    own.LockedAlways = value;
    PropertyChanged("LockedAlways");
}

std::string DataList::AddItem(const Variant& Text, const Variant& Value) {
    own.busy = true;
    std::string result = AddEntry(Text, Value);
    Host().Turn();
    own.busy = false;
    return result;
}

void DataList::SetDefaultValue(std::int32_t value) {
    own.DefaultValue = value;
    PropertyChanged("DefaultValue");
}

void DataList::SetDefaultText(const std::string& value) {
    own.DefaultText = value;
    PropertyChanged("DefaultText");
}

void DataList::SetStyle(DataListStyleConstants value) {
    own.Style = value;
    PropertyChanged("Style");
}

void DataList::SetBackColor(OLE_COLOR value) {
    own.BackColor = value;
    PropertyChanged("BackColor");
    for (ComboList& list : listItems) list.SetBackColor(value);
}

void DataList::SetForeColor(OLE_COLOR value) {
    own.ForeColor = value;
    PropertyChanged("ForeColor");
    for (ComboList& list : listItems) list.SetForeColor(value);
}

void DataList::SetEnabled(bool value) {
    own.Enabled = value;
    PropertyChanged("Enabled");
    for (ComboList& list : listItems) list.SetEnabled(value);
}

void DataList::SetFont(const frame::FontRef& value) {
    own.Font = value;
    PropertyChanged("Font");
    for (ComboList& list : listItems) list.SetFont(value);
    labItem.SetFont(value);
}

void DataList::SetAppearance(child::AppearanceConstants value) {
    own.Appearance = value;
    PropertyChanged("Appearance");
    for (ComboList& list : listItems) list.SetAppearance(value);
    labItem.SetAppearance(value);
}

void DataList::Refresh() { CopyToolTip(); }

std::string DataList::Text() const { return ActiveList().ListIndex() != notFound ? ActiveList().Text() : own.DefaultText; }

void DataList::SetText(const std::string& value) {
    const std::int32_t index = ActiveList().FindText(value);
    if (index == notFound) {
        SelectDefault();
    } else {
        labItem.SetCaption(ActiveList().List(index));
        ActiveList().SetListIndex(index);
    }
    own.Text = value;
    PropertyChanged("Text");
}

Variant DataList::Clear() {
    for (ComboList& list : listItems) list.Clear();
    labItem.SetCaption({});
    return {};
}

Variant DataList::RemoveItem(std::int32_t Value) {
    const std::int32_t index = ActiveList().FindData(Value);
    if (index == notFound) return false;
    ActiveList().RemoveItem(index);
    return true;
}

void DataList::SetSorted(bool value) {
    own.Sorted = value;
    PropertyChanged("Sorted");
    own.activeIndex = own.Sorted ? 1 : 0;
    MoveItems(listItems[1 - own.activeIndex], ActiveList());
    ApplyLockState();
}

std::int16_t DataList::ListCount() const { return Variant(ActiveList().ListCount()).ToInteger(); }

void DataList::SetListCount(std::int16_t value) {
    RefuseAtDesignTime();
    own.ListCount = value;
    PropertyChanged("ListCount");
}

void DataList::SetOnlyUniqueValues(bool value) {
    own.OnlyUniqueValues = value;
    PropertyChanged("OnlyUniqueValues");
}

void DataList::Initialize() {
    own.busy = false;
    labItem.SetCaption({});
    for (ComboList& list : listItems) list.Move(0, 0, list.Width(), list.Height());
    labItem.Move(0, 0, labItem.Width(), labItem.Height());
    own.activeIndex = 0;
    ApplyLockState();
}

void DataList::ReadProperties(const frame::PropertyBag& bag) {
    Control::ReadProperties(bag);
    const auto set = [this](auto& child) {
        child.SetEnabled(own.Enabled);
        child.SetFont(own.Font);
        child.SetAppearance(own.Appearance);
        // Behind the appearance, which gives a label the system's colour.
        child.SetBackColor(own.BackColor);
        child.SetForeColor(own.ForeColor);
    };
    for (ComboList& list : listItems) set(list);
    set(labItem);
    ApplyLockState();
}

void DataList::Resize() {
    Surface().SetHeight(listItems[0].Height());
    labItem.SetHeight(listItems[0].Height());
    for (ComboList& list : listItems) list.SetWidth(Surface().Width());
    labItem.SetWidth(Surface().Width());
}

void DataList::Show() {
    if (UserMode())
        CopyToolTip();
    else
        ShowDesignPicture();
}

void DataList::AmbientChanged(const std::string&) { ShowDesignPicture(); }

frame::TextSize DataList::DesignSize() const { return designSize; }

void DataList::ListClick() {
    if (!own.busy) ForwardEvent(datalist::Click);
    labItem.SetCaption(ActiveList().Text());
}

void DataList::ListDblClick() { ForwardEvent(datalist::DblClick); }

void DataList::ListKeyDown(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(datalist::KeyDown, keyCode, shift); }

void DataList::ListKeyPress(std::int16_t keyAscii) { ForwardEvent(datalist::KeyPress, keyAscii); }

void DataList::ListKeyUp(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(datalist::KeyUp, keyCode, shift); }

void DataList::ListHeightChanged() {
    if (Site()) Resize();
}

std::string DataList::AddEntry(const Variant& text, const Variant& value) {
    if (text.IsString()) return AddText(text.Text(), value);
    ResumeNext next;
    return AddText(next.Value([&] { return text.ToText(); }, {}), value);  // a test that fails refuses too
}

/// A counter that is full stays so: the item is added, under its last number.
std::string DataList::AddText(std::string_view text, const Variant& value) {
    if (text.empty()) return "Blank text item not allowed.";
    ResumeNext next;
    if (own.OnlyUniqueValues && next.If([&] { return ActiveList().HasData(value.ToLong()); })) {
        std::string message;
        next([&] { message = "Item with value " + value.ToText() + " already exists."; });
        return message;
    }
    CountItem();
    const std::int32_t data = next.Value([&] { return value.ToLong(); }, 0);
    if (own.Style == DataListStyleConstants::ID_and_Text || own.Style == DataListStyleConstants::Count_and_Text) {
        const std::string displayed = next.Value([&] { return Displayed(text, value); }, {});
        next([&] { ActiveList().Add(displayed, data); });
    } else {
        next([&] { ActiveList().Add(text, data); });
    }
    return {};
}

void DataList::CountItem() {
    if (own.itemCounter < std::numeric_limits<std::int16_t>::max()) ++own.itemCounter;
}

std::string DataList::Displayed(std::string_view text, const Variant& value) const {
    const bool counts = own.Style == DataListStyleConstants::Count_and_Text;
    std::string shown = LastFour(counts ? frame::Decimal(own.itemCounter) : value.ToText()) + " - ";
    shown += text;
    return shown;
}

std::string DataList::SelectDefault() {
    const std::int32_t index = ActiveList().FindData(own.DefaultValue);
    if (index == notFound) return "No default value set.";
    ActiveList().SetListIndex(index);
    return {};
}

void DataList::MoveItems(ComboList& from, ComboList& to) {
    own.busy = true;
    to.Clear();
    for (std::int32_t i = 0; i < from.ListCount(); ++i) AddEntry(from.List(i), from.ItemData(i));
    if (from.ListIndex() >= 0) {
        const std::int32_t index = to.FindData(from.ItemData(from.ListIndex()));
        if (index != notFound) to.SetListIndex(index);
    }
    from.Clear();
    own.busy = false;
}

void DataList::ApplyLockState() {
    const bool locked = own.LockedAlways || own.Locked;
    labItem.SetVisible(locked);
    for (std::size_t i = 0; i < std::size(listItems); ++i) listItems[i].SetVisible(!locked && i == own.activeIndex);
}

/// The form designer shows the control's name as a chosen item.
void DataList::ShowDesignPicture() {
    if (UserMode() || !Site()) return;
    ResumeNext next;
    next([&] { listItems[0].Clear(); });
    next([&] { listItems[0].AddItem(Site()->Ambient().DisplayName()); });
    next([&] { listItems[0].SetListIndex(0); });
}

// The children cover the control, so that the host's tool tip would never appear. Not every host has one.
void DataList::CopyToolTip() {
    ResumeNext next;
    next([&] { Extender().Get("Name"); });
    const auto copy = [&](frame::ChildControl& child) {
        next([&] { child.SetToolTipText(Extender().Get("ToolTipText").ToText()); });
    };
    for (ComboList& list : listItems) copy(list);
    copy(labItem);
}

struct DataList::Tables {
    // Every stock name but that of the font has an ordinary number here.
    static constexpr std::array members = {
        frame::method<&DataList::Populate>("Populate", "Fills the list from a recordset; gives what went wrong, or nothing.",
                                           {"ListRecordset", "TextColumn", "ValueColumn", "DefaultText", "DefaultValue"}),
        frame::property<&DataList::Locked, &DataList::SetLocked>(
            "Locked", "Locks the control from user setting but still responds to program setting."),
        frame::runTimeProperty<&DataList::Value, &DataList::SetValue>(
            "Value", "Sets or returns the value corresponding to the recordset text and data items."),
        frame::property<&DataList::LockedAlways, &DataList::SetLockedAlways>("LockedAlways",
                                                                             "Overrides the Locked property if set to true"),
        frame::method<&DataList::AddItem>("AddItem", "Adds an item; gives why it was refused, or nothing.", {"Text", "Value"}),
        frame::property<&DataList::DefaultValue, &DataList::SetDefaultValue>("DefaultValue", "The value when nothing is chosen."),
        frame::property<&DataList::DefaultText, &DataList::SetDefaultText>("DefaultText", "The text when nothing is chosen."),
        frame::property<&DataList::Style, &DataList::SetStyle>("Style", "Sets the style for the control"),
        frame::property<&DataList::BackColor, &DataList::SetBackColor>(
            "BackColor", "Returns/sets the background color used to display text and graphics in an object."),
        frame::property<&DataList::ForeColor, &DataList::SetForeColor>(
            "ForeColor", "Returns/sets the foreground color used to display text and graphics in an object."),
        frame::property<&DataList::Enabled, &DataList::SetEnabled>(
            "Enabled", "Returns/sets a value that determines whether an object can respond to user-generated events."),
        frame::property<&DataList::Font, &DataList::SetFont>("Font", "Returns a Font object.", frame::dispatch::font),
        frame::property<&DataList::Appearance, &DataList::SetAppearance>(
            "Appearance", "Returns/sets whether or not an object is painted with 3-D effects."),
        frame::method<&DataList::Refresh>("Refresh", "Forces a complete repaint of a object."),
        frame::property<&DataList::Text, &DataList::SetText>("Text", "Reads the current text setting in the list."),
        frame::method<&DataList::Clear>("Clear", "Clears all items from the list."),
        frame::method<&DataList::RemoveItem>("RemoveItem", "Removes the requested item from the list.", {"Value"}),
        frame::property<&DataList::Sorted, &DataList::SetSorted>("Sorted", "Sorts the list alphabetically"),
        frame::runTimeProperty<&DataList::ListCount, &DataList::SetListCount>(
            "ListCount", "Returns the number of items in the list portion of a control."),
        frame::property<&DataList::OnlyUniqueValues, &DataList::SetOnlyUniqueValues>(
            "OnlyUniqueValues", "When set, you can only add items with unique values"),
    };
    static constexpr std::array<const frame::EventInfo*, 8> events = {
        &datalist::Click, &datalist::DblClick,      &datalist::KeyDown,       &datalist::KeyPress,
        &datalist::KeyUp, &frame::stock::MouseDown, &frame::stock::MouseMove, &frame::stock::MouseUp};

    /// Kept as it was loaded, whatever it is, and saved from the public property.
    static constexpr frame::BagKey value{
        "Value",
        frame::ValueDefault(VarType::Integer, 0),
        frame::ValueDefault(VarType::Integer, 0),
        true,
        [](Control& control, const Variant& loaded) { static_cast<DataList&>(control).own.Value = loaded; },
        [](const Control& control) -> Variant { return static_cast<const DataList&>(control).Value(); }};
    static constexpr std::array kept = {
        frame::key<&DataList::own, &Own::Locked>("Locked", VarType::Boolean, false),
        value,
        frame::key<&DataList::own, &Own::LockedAlways>("LockedAlways", VarType::Boolean, false),
        frame::key<&DataList::own, &Own::DefaultValue>("DefaultValue", VarType::Integer, 0),
        frame::key<&DataList::own, &Own::DefaultText>("DefaultText", ""),
        frame::key<&DataList::own, &Own::Style>("Style", VarType::Integer, 0),
        frame::key<&DataList::own, &Own::BackColor>("BackColor", VarType::Long, 0x80000005),
        frame::key<&DataList::own, &Own::ForeColor>("ForeColor", VarType::Long, 0),
        frame::key<&DataList::own, &Own::Enabled>("Enabled", VarType::Boolean, true),
        frame::key<&DataList::own, &Own::Font>("Font", frame::ambientFont),
        frame::key<&DataList::own, &Own::Appearance>("Appearance", VarType::Integer, 0),
        frame::key<&DataList::own, &Own::Text>("Text", ""),
        frame::key<&DataList::own, &Own::Sorted>("Sorted", VarType::Boolean, false),
        frame::key<&DataList::own, &Own::ListCount>("ListCount", VarType::Integer, 0),
        frame::key<&DataList::own, &Own::OnlyUniqueValues>("OnlyUniqueValues", VarType::Boolean, false),
    };
    static Variant ToolTip(const Control& control) { return static_cast<const DataList&>(control).listItems[0].ToolTipText(); }
    // Twice: kept so that saved designs read the same.
    static constexpr std::array behind = {frame::SavedKey{"ToolTipText", frame::noDefault, &ToolTip},
                                          frame::SavedKey{"ToolTipText", frame::TextDefault(""), &ToolTip}};
    static constexpr std::array parts = {
        frame::Part{"listItems(0)", [](Object& control) -> Object& { return static_cast<DataList&>(control).listItems[0]; }},
        frame::Part{"listItems(1)", [](Object& control) -> Object& { return static_cast<DataList&>(control).listItems[1]; }},
        frame::part<&DataList::labItem>("labItem"),
    };
};

constexpr frame::ClassTable DataList::table{.name = "DataList",
                                            .members = Tables::members,
                                            .events = Tables::events,
                                            .bag = Tables::kept,
                                            .savedBehind = Tables::behind,
                                            .parts = Tables::parts,
                                            .defaultMember = "Value"};

}  // namespace tessel::controls
