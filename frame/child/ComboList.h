#pragma once

#include "frame/Font.h"
#include "frame/child/ComboRows.h"
#include "frame/child/Label.h"

namespace tessel::child {

/// The peer of a drop-down list. It keeps no rows: it reads those of the list, by position, and reads all anew when the list's
/// `Revision` is another. What the user chooses is `ChooseInput`.
class ComboListPeer : public frame::Peer {
  public:
    /// The height that a list of this look and font has on the screen, in twips.
    virtual float NaturalHeight() = 0;
};

/// A drop-down list of texts, each with a 32-bit number. Whether it keeps its rows sorted is fixed in its design. Indexes count
/// from 0, and -1 is none. The list fixes its height: 315 twips without a screen.
class ComboList final : public KeyChild {
  public:
    static constexpr float heightTwips = 315;

    ComboList(frame::Control& owner, std::string name, ComboRows::Order order);

    /// The text of a row. Error 381 for an index outside.
    std::string List(std::int32_t index) const;
    std::int32_t ItemData(std::int32_t index) const;
    void SetItemData(std::int32_t index, std::int32_t value);
    /// The row that is chosen. A set from code raises `Click`, whatever was chosen before. Error 380 for an index outside.
    std::int32_t ListIndex() const;
    void SetListIndex(std::int32_t index);
    std::int32_t ListCount() const { return static_cast<std::int32_t>(rows_.Size()); }
    /// The row that was added last; -1 once a row has been removed since.
    std::int32_t NewIndex() const;
    /// The text of the row that is chosen; empty for none.
    std::string Text() const;
    bool Sorted() const { return rows_.Ordering() == ComboRows::Order::ByText; }

    void AddItem(const std::string& text) { Add(text, 0); }
    /// The same with a number. A row that is chosen stays so wherever it moves.
    void Add(std::string_view text, std::int32_t data);
    /// When the chosen row goes, none is chosen. Raises no event. Error 5 for an index outside.
    void RemoveItem(std::int32_t index);
    void Clear();

    // The first row of a number or of a text without regard to case, in constant time; -1 for none.
    std::int32_t FindData(std::int32_t data) const;
    std::int32_t FindText(std::string_view text) const;
    bool HasData(std::int32_t data) const { return rows_.HasData(data); }

    /// The rows, for peers.
    const ComboRows& Rows() const { return rows_; }
    /// Another number after each change of rows.
    std::uint64_t Revision() const { return revision_; }

    const frame::FontRef& Font() const { return font_.Get(); }
    void SetFont(const frame::FontRef& value);
    AppearanceConstants Appearance() const { return appearance_; }
    void SetAppearance(AppearanceConstants value) { Store(appearance_, value); }
    frame::OLE_COLOR BackColor() const { return backColor_; }
    void SetBackColor(frame::OLE_COLOR value) { Store(backColor_, value); }
    frame::OLE_COLOR ForeColor() const { return foreColor_; }
    void SetForeColor(frame::OLE_COLOR value) { Store(foreColor_, value); }

    /// What a peer reports: the user has chosen a row. Raises `Click`.
    void ChooseInput(std::int32_t index);
    /// A click, which chooses a row where one is given.
    void ListClickInput(std::optional<std::int32_t> index);
    /// The natural height may be another: the style has changed.
    void HeightInput();

    /// The list has taken another height by itself.
    frame::Slot<> HeightChanged;

    const frame::ClassTable& Table() const override;

  protected:
    void PeerAttached() override { TakeHeight(); }
    void Moved() override { TakeHeight(); }

  private:
    static constexpr RowId none = RowChains::none;

    ComboRows::Position Checked(std::int32_t index, int error) const;
    /// Gives whether it is another.
    bool TakeHeight();
    void RowsChanged();
    void FontChanged();

    ComboRows rows_;
    RowId chosen_ = none, new_ = none;
    std::uint64_t revision_ = 0;
    frame::FontHolder font_{[this] { FontChanged(); }};
    frame::OLE_COLOR backColor_ = frame::colors::windowBackground;
    frame::OLE_COLOR foreColor_ = frame::colors::windowText;
    AppearanceConstants appearance_ = AppearanceConstants::ThreeD;
};

}  // namespace tessel::child
