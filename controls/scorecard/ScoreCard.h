#pragma once

#include "controls/scorecard/Gauge.h"
#include "frame/Control.h"
#include "frame/child/ImageList.h"
#include "frame/child/PictureBox.h"

namespace tessel::controls {

/// How the score is shown: as one of five graded pictures, as a card in one colour, or as a gauge. Any other number shows nothing.
enum class tsScoreCardStyle : std::int16_t {
    ScoreCardSmall = 0,
    ScoreCardLarge = 1,
    SmileySmall = 2,
    SmileyLarge = 3,
    TrafficLightSmall = 4,
    TrafficLightLarge = 5,
    FlashCard = 6,
    Gauge = 7,
    GaugeOverrun = 8,
    GaugeRainbow = 9,
    WeatherSmall = 10,
    WeatherLarge = 11
};
enum class tsToolTipStyle : std::int32_t { None = 0, ShowTextAsTip = 1, ShowValueAsTip = 2, ShowBothAsTip = 3 };

/// Shows one number, the score, against four thresholds.
///
/// `ScoreMin` <= `ScoreBad` <= `ScoreMaybe` <= `ScoreGood` <= `ScoreStar` <= `ScoreMax`, and `ScoreMin` < `ScoreMax`: the setters
/// see to it, a load does not. The score itself may lie outside the range.
class ScoreCard final : public frame::Control {
  public:
    explicit ScoreCard(frame::Host& host);

    // Look, held by `Picture1`.
    frame::OLE_COLOR BackColor() const { return Picture1.BackColor(); }
    void SetBackColor(frame::OLE_COLOR value);
    frame::OLE_COLOR ForeColor() const { return Picture1.ForeColor(); }
    void SetForeColor(frame::OLE_COLOR value);
    /// Held by the control's own surface.
    bool Enabled() const { return Surface().Enabled(); }
    void SetEnabled(bool value);
    const frame::FontRef& Font() const { return Picture1.Font(); }
    void SetFont(const frame::FontRef& value);
    std::int16_t BorderStyle() const { return Picture1.BorderStyle(); }
    void SetBorderStyle(std::int16_t value);
    /// Repaints what is drawn; draws nothing anew.
    void Refresh() { Picture1.Refresh(); }

    /// The score. A set converts to a 32-bit float: error 13 for what is no number, 6 for one that is too large.
    const frame::Variant& Value() const { return own.Value; }
    void SetValue(const frame::Variant& value);
    tsScoreCardStyle Style() const { return own.Style; }
    /// The present style again is no change at all.
    void SetStyle(tsScoreCardStyle value);

    // The thresholds: a set that would cross a neighbour lands on it and never pushes it.
    float ScoreStar() const { return own.ScoreStar.ToSingle(); }
    void SetScoreStar(float value);
    float ScoreGood() const { return own.ScoreGood.ToSingle(); }
    void SetScoreGood(float value);
    float ScoreMaybe() const { return own.ScoreMaybe.ToSingle(); }
    void SetScoreMaybe(float value);
    float ScoreBad() const { return own.ScoreBad.ToSingle(); }
    /// Shows at the next redraw, alone of its kind.
    void SetScoreBad(float value);
    // The limits: a set at or beyond the other one lands one away from it, and takes along the thresholds that would lie outside.
    float ScoreMin() const { return own.ScoreMin.ToSingle(); }
    void SetScoreMin(float value);
    float ScoreMax() const { return own.ScoreMax.ToSingle(); }
    void SetScoreMax(float value);

    bool ShowLimitLines() const { return own.ShowLimitLines; }
    void SetShowLimitLines(bool value);
    /// In units of the score; 0 for no tick lines, which any value below becomes. More than 32,766 tick lines are error 6, after
    /// they have been drawn.
    const frame::Variant& ShowTickLinesEvery() const { return own.ShowTickLinesEvery; }
    void SetShowTickLinesEvery(const frame::Variant& value);
    frame::OLE_COLOR TickLineColor() const { return own.TickLineColor; }
    void SetTickLineColor(frame::OLE_COLOR value);
    /// The colour of the value text.
    frame::OLE_COLOR FontColor() const { return own.FontColor; }
    void SetFontColor(frame::OLE_COLOR value);
    tsShowValue ShowValue() const { return frame::FromVariant<tsShowValue>(own.ShowValue); }
    /// A value outside 0 to 6 is not taken.
    void SetShowValue(tsShowValue value);
    tsToolTipStyle ToolTipStyle() const { return own.ToolTipStyle; }
    /// A value outside 0 to 3 is ignored. A new one shows at the next redraw.
    void SetToolTipStyle(tsToolTipStyle value);
    const std::string& ToolTip() const { return own.ToolTip; }
    /// Shows at the next redraw.
    void SetToolTip(const std::string& value);
    tsMarkerStyle ShowMarker() const { return frame::FromVariant<tsMarkerStyle>(own.ShowMarker); }
    void SetShowMarker(tsMarkerStyle value);
    std::int16_t ShowBlocks() const { return own.ShowBlocks; }
    /// A value outside 0 to 100 is ignored.
    void SetShowBlocks(std::int16_t value);
    tsGaugeOrientation GaugeOrientation() const { return frame::FromVariant<tsGaugeOrientation>(own.GaugeOrientation); }
    void SetGaugeOrientation(tsGaugeOrientation value);

    /// From 1 for a score below `ScoreBad` to 5 for one that reaches `ScoreStar`.
    int Grade() const;

    void InitProperties() override;
    void ReadProperties(const frame::PropertyBag& bag) override;
    /// With a picture style the control takes the size at which the inside of its frame is as large as the picture.
    void Resize() override;
    frame::TextSize DesignSize() const override;
    const frame::ClassTable& Table() const override { return table; }
    static const frame::ClassTable table;

    child::PictureBox Picture1{*this, "Picture1"};
    child::ImageList ImageList32{*this, "ImageList32"};
    child::ImageList ImageList16{*this, "ImageList16"};

  private:
    struct Tables;

    void PictureClick();
    void PictureDblClick();
    void PictureKeyDown(std::int16_t keyCode, std::int16_t shift);
    void PictureKeyPress(std::int16_t keyAscii);
    void PictureKeyUp(std::int16_t keyCode, std::int16_t shift);
    void PictureMouseDown(std::int16_t button, std::int16_t shift, float x, float y);
    void PictureMouseMove(std::int16_t button, std::int16_t shift, float x, float y);
    void PictureMouseUp(std::int16_t button, std::int16_t shift, float x, float y);

    void Redraw();
    void ShowPicture(std::string_view family, const child::ImageList& images);
    void DrawFlashCard();
    frame::OLE_COLOR ColorByValue();
    void SetTip();
    void TakeSizeOfPicture(float side);

    // The gauge, in the order of its layers.
    void DrawGauge();
    void DrawBand(const frame::Variant& from, const frame::Variant& to, frame::OLE_COLOR color);
    void DrawBlocks();
    void DrawTicks();
    void DrawLimitLines();
    void DrawMarker();
    void DrawRaisedBar();
    void PrintValue();
    void DrawValueLine(const frame::Variant& value, float fraction, frame::OLE_COLOR color, std::int16_t width);
    float PositionOf(const frame::Variant& value) const;
    void Draw(const frame::draw::Line& line);

    struct Own {
        AnyNumber GaugeOrientation = std::int16_t{0};
        std::int16_t ShowBlocks = 0;
        AnyNumber ShowMarker = std::int16_t{0};
        AnyNumber ScoreBad = 0.2;
        std::string ToolTip;
        tsToolTipStyle ToolTipStyle = tsToolTipStyle::ShowBothAsTip;
        AnyNumber ShowValue = std::int16_t{0};
        frame::OLE_COLOR FontColor;
        frame::OLE_COLOR TickLineColor;
        bool ShowLimitLines = false;
        AnyNumber ShowTickLinesEvery = std::int16_t{0};
        AnyNumber Value = 0.5;
        tsScoreCardStyle Style = tsScoreCardStyle::ScoreCardSmall;
        AnyNumber ScoreStar = 0.8, ScoreGood = 0.6, ScoreMaybe = 0.4;
        AnyNumber ScoreMin = std::int16_t{0}, ScoreMax = std::int16_t{1};
        gauge::Frame bar;  // laid anew at each drawing
    };
    Own own;
};

}  // namespace tessel::controls

namespace tessel::controls::names {
inline constexpr frame::Enumeration::Constant scoreCardStyle[] = {
    {"ScoreCardSmall", 0},    {"ScoreCardLarge", 1},    {"SmileySmall", 2},   {"SmileyLarge", 3},
    {"TrafficLightSmall", 4}, {"TrafficLightLarge", 5}, {"FlashCard", 6},     {"Gauge", 7},
    {"GaugeOverrun", 8},      {"GaugeRainbow", 9},      {"WeatherSmall", 10}, {"WeatherLarge", 11}};
inline constexpr frame::Enumeration tsScoreCardStyleNames{"tsScoreCardStyle", scoreCardStyle};
inline constexpr frame::Enumeration::Constant toolTipStyle[] = {
    {"None", 0}, {"ShowTextAsTip", 1}, {"ShowValueAsTip", 2}, {"ShowBothAsTip", 3}};
inline constexpr frame::Enumeration tsToolTipStyleNames{"tsToolTipStyle", toolTipStyle};
}  // namespace tessel::controls::names

template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::tsScoreCardStyle> =
    &tessel::controls::names::tsScoreCardStyleNames;
template <>
inline constexpr const tessel::frame::Enumeration* tessel::frame::enumerationOf<tessel::controls::tsToolTipStyle> =
    &tessel::controls::names::tsToolTipStyleNames;
