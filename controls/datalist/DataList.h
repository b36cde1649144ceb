#pragma once

#include "frame/Control.h"
#include "frame/Recordset.h"
#include "frame/child/ComboList.h"
#include "frame/child/Label.h"

/// The events that come from the active list, under ordinary numbers. Those of the mouse are declared and never raised.
namespace tessel::controls::datalist {
inline constexpr frame::Event<> Click = frame::stock::Click.Numbered(1);
inline constexpr frame::Event<> DblClick = frame::stock::DblClick.Numbered(2);
inline constexpr frame::Event<std::int16_t&, std::int16_t&> KeyDown = frame::stock::KeyDown.Numbered(3);
inline constexpr frame::Event<std::int16_t&> KeyPress = frame::stock::KeyPress.Numbered(4);
inline constexpr frame::Event<std::int16_t&, std::int16_t&> KeyUp = frame::stock::KeyUp.Numbered(5);
}  // namespace tessel::controls::datalist

namespace tessel::controls {

/// How an item is displayed: its text alone, or behind its value or its number in the order of adding. Any other number displays
/// the text alone.
enum class DataListStyleConstants : std::int16_t { Text_Only = 0, ID_and_Text = 1, Count_and_Text = 2 };

/// A drop-down list of pairs of a text and a 32-bit value, filled from a recordset or by hand, read and set by value or by text.
/// A default pair stands in when nothing is chosen. When locked it shows the chosen text as a plain label.
///
/// It has two lists, an unsorted and a sorted one, of which one is active at a time and holds the items.
class DataList final : public frame::Control {
  public:
    explicit DataList(frame::Host& host);

    /// Fills the active list from a recordset: each row is added as `AddItem` does it, one that is refused is dropped in silence.
    /// Gives the empty string, or what went wrong: the data source's own text; a column that is not there, with the lists as they
    /// were. A column is given by its name or by its number. A `DefaultText` makes a default pair, which is the first item and is
    /// chosen; its value must fit into 16 bits, else the pair keeps the value that `DefaultValue` had. The recordset is left at its
    /// end.
    std::string Populate(const frame::ObjectRef& ListRecordset, const frame::Variant& TextColumn, const frame::Variant& ValueColumn,
                         const std::optional<frame::Variant>& DefaultText = {},
                         const std::optional<frame::Variant>& DefaultValue = {});
    /// A new one shows when `Sorted` is set or at the next load; so does `LockedAlways`, which overrides it.
    bool Locked() const { return own.Locked; }
    void SetLocked(bool value);
    /// The value of the chosen item, `DefaultValue` when none is. A value that no item has chooses the default item, where there is
    /// one. Error 387 for a set at design time.
    std::int32_t Value() const;
    void SetValue(std::int32_t value);
    bool LockedAlways() const { return own.LockedAlways; }
    void SetLockedAlways(bool value);
    /// Gives the empty string, or why there is no new item: a blank text; a value that is there already with `OnlyUniqueValues`.
    std::string AddItem(const frame::Variant& Text, const frame::Variant& Value);
    std::int32_t DefaultValue() const { return own.DefaultValue; }
    void SetDefaultValue(std::int32_t value);
    const std::string& DefaultText() const { return own.DefaultText; }
    void SetDefaultText(const std::string& value);
    /// A new style applies to items that are added later.
    DataListStyleConstants Style() const { return own.Style; }
    void SetStyle(DataListStyleConstants value);
    frame::OLE_COLOR BackColor() const { return own.BackColor; }
    void SetBackColor(frame::OLE_COLOR value);
    frame::OLE_COLOR ForeColor() const { return own.ForeColor; }
    void SetForeColor(frame::OLE_COLOR value);
    bool Enabled() const { return own.Enabled; }
    void SetEnabled(bool value);
    const frame::FontRef& Font() const { return own.Font; }
    void SetFont(const frame::FontRef& value);
    child::AppearanceConstants Appearance() const { return own.Appearance; }
    void SetAppearance(child::AppearanceConstants value);
    /// Copies the host's tool tip to the children; there is no repaint.
    void Refresh();
    /// The displayed text of the chosen item, `DefaultText` when none is. A text that no item displays, without regard to case,
    /// chooses the default item, where there is one.
    std::string Text() const;
    void SetText(const std::string& value);
    /// The numbers of `Count_and_Text` go on until the next `Populate`.
    frame::Variant Clear();
    /// Removes the first item of this value. Gives whether there was one.
    frame::Variant RemoveItem(std::int32_t Value);
    /// Each set moves the items from the other list to the one it names, which is cleared before. They are added as they are
    /// displayed, so that a value or number in front comes twice.
    bool Sorted() const { return own.Sorted; }
    void SetSorted(bool value);
    /// Error 6 above 32,767. A set at run time changes what is saved and nothing else; at design time it is error 387.
    std::int16_t ListCount() const;
    void SetListCount(std::int16_t value);
    bool OnlyUniqueValues() const { return own.OnlyUniqueValues; }
    void SetOnlyUniqueValues(bool value);

    void Initialize() override;
    void ReadProperties(const frame::PropertyBag& bag) override;
    void Resize() override;
    void Show() override;
    void AmbientChanged(const std::string& name) override;
    frame::TextSize DesignSize() const override;
    const frame::ClassTable& Table() const override { return table; }
    static const frame::ClassTable table;

    child::ComboList listItems[2] = {{*this, "listItems(0)", child::ComboRows::Order::AsAdded},
                                     {*this, "listItems(1)", child::ComboRows::Order::ByText}};
    child::Label labItem{*this, "labItem"};

  private:
    struct Tables;

    void ListClick();
    void ListDblClick();
    void ListKeyDown(std::int16_t keyCode, std::int16_t shift);
    void ListKeyPress(std::int16_t keyAscii);
    void ListKeyUp(std::int16_t keyCode, std::int16_t shift);
    void ListHeightChanged();

    child::ComboList& ActiveList() { return listItems[own.activeIndex]; }
    const child::ComboList& ActiveList() const { return listItems[own.activeIndex]; }
    std::string AddEntry(const frame::Variant& text, const frame::Variant& value);
    std::string AddText(std::string_view text, const frame::Variant& value);
    void AddDefaultPair(const frame::Variant& text, const std::optional<frame::Variant>& value);
    std::string AddRows(frame::RecordReader& records, std::size_t textColumn, std::size_t valueColumn);
    void CountItem();
    std::string Displayed(std::string_view text, const frame::Variant& value) const;
    std::string SelectDefault();
    void MoveItems(child::ComboList& from, child::ComboList& to);
    void ApplyLockState();
    void ShowDesignPicture();
    void CopyToolTip();

    struct Own {
        bool busy = false;  // a fill is going on: Click is held back
        bool OnlyUniqueValues = false;
        std::int16_t ListCount = 0;  // as it was loaded or set; the getter does not read it
        frame::OLE_COLOR BackColor = frame::colors::windowBackground;
        frame::OLE_COLOR ForeColor = 0;
        bool Enabled = true;
        frame::FontRef Font;
        child::AppearanceConstants Appearance = child::AppearanceConstants::Flat;
        std::string Text;  // that was set last
        bool Sorted = false;
        DataListStyleConstants Style = DataListStyleConstants::Text_Only;
        std::string DefaultText;
        std::int32_t DefaultValue = 0;
        bool LockedAlways = false;
        frame::Variant Value;  // as it was loaded, not used afterwards
        bool Locked = false;
        std::size_t activeIndex = 0;   // of `listItems`
        std::int16_t itemCounter = 0;  // items added since the last Populate
    };
    Own own;
};

}  // namespace tessel::controls

namespace tessel::controls::names {
inline constexpr frame::Enumeration::Constant dataListStyle[] = {{"Text_Only", 0}, {"ID_and_Text", 1}, {"Count_and_Text", 2}};
inline constexpr frame::Enumeration dataListStyleConstants{"DataListStyleConstants", dataListStyle};
}  // namespace tessel::controls::names

template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::DataListStyleConstants> =
    &tessel::controls::names::dataListStyleConstants;
