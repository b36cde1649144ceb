#pragma once

#include "frame/child/PointerChild.h"

namespace tessel::child {

enum class AlignmentConstants : std::int16_t { LeftJustify = 0, RightJustify = 1, Center = 2 };
enum class LabelBorderConstants : std::int16_t { None = 0, FixedSingle = 1 };
enum class AppearanceConstants : std::int16_t { Flat = 0, ThreeD = 1 };

namespace names {
inline constexpr frame::Enumeration::Constant alignment[] = {{"LeftJustify", 0}, {"RightJustify", 1}, {"Center", 2}};
inline constexpr frame::Enumeration::Constant labelBorder[] = {{"None", 0}, {"FixedSingle", 1}};
inline constexpr frame::Enumeration::Constant appearance[] = {{"Flat", 0}, {"ThreeD", 1}};
}  // namespace names
inline constexpr frame::Enumeration alignmentConstants{"AlignmentConstants", names::alignment};
inline constexpr frame::Enumeration labelBorderConstants{"LabelBorderConstants", names::labelBorder};
inline constexpr frame::Enumeration appearanceConstants{"AppearanceConstants", names::appearance};

/// A piece of text. With `AutoSize` it is always as large as its text: with `WordWrap` too it keeps its width and takes the
/// height that the wrapped text needs.
class Label final : public PointerChild {
  public:
    Label(frame::Control& owner, std::string name);

    const std::string& Caption() const { return caption_; }
    /// A new text raises `Change`.
    void SetCaption(const std::string& value);
    bool AutoSize() const { return autoSize_; }
    void SetAutoSize(bool value);
    bool WordWrap() const { return wordWrap_; }
    void SetWordWrap(bool value);
    const frame::FontRef& Font() const { return font_.Get(); }
    void SetFont(const frame::FontRef& value);
    AlignmentConstants Alignment() const { return alignment_; }
    void SetAlignment(AlignmentConstants value) { Store(alignment_, value); }
    LabelBorderConstants BorderStyle() const { return borderStyle_; }
    void SetBorderStyle(LabelBorderConstants value);
    AppearanceConstants Appearance() const { return appearance_; }
    /// A new appearance resets the colour of the text to the system's; the background stays.
    void SetAppearance(AppearanceConstants value);
    frame::OLE_COLOR BackColor() const { return backColor_; }
    void SetBackColor(frame::OLE_COLOR value) { Store(backColor_, value); }
    frame::OLE_COLOR ForeColor() const { return foreColor_; }
    void SetForeColor(frame::OLE_COLOR value) { Store(foreColor_, value); }

    /// What a toolkit reports when it has changed the label by itself.
    void ChangeInput();
    /// Comes when the text is another, and when the label has changed its size by itself.
    frame::Slot<> Change;

    const frame::ClassTable& Table() const override;

  protected:
    void Moved() override;

  private:
    /// Takes the size that the text needs, where the label sizes itself. True when the size is another.
    bool Fit();
    void FitAndTell();
    void FontChanged();

    std::string caption_;
    frame::FontHolder font_{[this] { FontChanged(); }};
    frame::OLE_COLOR backColor_ = frame::colors::buttonFace;
    frame::OLE_COLOR foreColor_ = frame::colors::buttonText;
    AlignmentConstants alignment_ = AlignmentConstants::LeftJustify;
    LabelBorderConstants borderStyle_ = LabelBorderConstants::None;
    AppearanceConstants appearance_ = AppearanceConstants::ThreeD;
    bool autoSize_ = false, wordWrap_ = false;
};

}  // namespace tessel::child

namespace tessel::frame {
template <>
inline constexpr const Enumeration* enumerationOf<child::AlignmentConstants> = &child::alignmentConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::LabelBorderConstants> = &child::labelBorderConstants;
template <>
inline constexpr const Enumeration* enumerationOf<child::AppearanceConstants> = &child::appearanceConstants;
}  // namespace tessel::frame
