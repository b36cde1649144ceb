#pragma once

#include "frame/child/Label.h"

namespace tessel::child {

/// A text that the user can edit.
class TextBox final : public KeyChild {
  public:
    TextBox(frame::Control& owner, std::string name);

    const std::string& Text() const { return text_; }
    /// A new text raises `Change`.
    void SetText(const std::string& value);
    /// Whether the user may read the text only.
    bool Locked() const { return locked_; }
    void SetLocked(bool value) { Store(locked_, value); }
    /// Whether the text may have several lines, parted by line feeds.
    bool MultiLine() const { return multiLine_; }
    void SetMultiLine(bool value) { Store(multiLine_, value); }
    AlignmentConstants Alignment() const { return alignment_; }
    void SetAlignment(AlignmentConstants value) { Store(alignment_, value); }
    LabelBorderConstants BorderStyle() const { return borderStyle_; }
    void SetBorderStyle(LabelBorderConstants value) { Store(borderStyle_, value); }
    AppearanceConstants Appearance() const { return appearance_; }
    void SetAppearance(AppearanceConstants value) { Store(appearance_, value); }
    /// Never null: a set to null gives a font of the default name and size.
    const frame::FontRef& Font() const { return font_.Get(); }
    void SetFont(const frame::FontRef& value);
    frame::OLE_COLOR BackColor() const { return backColor_; }
    void SetBackColor(frame::OLE_COLOR value) { Store(backColor_, value); }
    frame::OLE_COLOR ForeColor() const { return foreColor_; }
    void SetForeColor(frame::OLE_COLOR value) { Store(foreColor_, value); }

    /// What a peer reports when the user has edited the text.
    void ChangeInput(const std::string& text);

    frame::Slot<> Change;

    const frame::ClassTable& Table() const override;

  private:
    std::string text_;
    frame::FontHolder font_{[this] { Changed(); }};
    frame::OLE_COLOR backColor_ = frame::colors::windowBackground;
    frame::OLE_COLOR foreColor_ = frame::colors::windowText;
    AlignmentConstants alignment_ = AlignmentConstants::LeftJustify;
    LabelBorderConstants borderStyle_ = LabelBorderConstants::FixedSingle;
    AppearanceConstants appearance_ = AppearanceConstants::ThreeD;
    bool locked_ = false, multiLine_ = false;
};

}  // namespace tessel::child
