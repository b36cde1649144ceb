#include <cmath>
#include <limits>

#include "controls/scorecard/ScoreCard.h"

namespace tessel::controls {

using frame::ControlError;
using frame::OLE_COLOR;
using frame::Variant;

namespace {

constexpr std::uint32_t black = 0, white = 0xFFFFFF, red = 0x0000FF, yellow = 0x00FFFF, green = 0x00FF00, cyan = 0xFFFF00;

/// Kept as a load finds it, thus any number.
template <class E>
bool Is(const Variant& value, E constant) {
    return value.ToDouble() == static_cast<double>(constant);
}

/// What a float cannot hold is error 6.
float Single(double value) { return Variant(value).ToSingle(); }

}  // namespace

void ScoreCard::DrawGauge() {
    if (IsEqual(own.ScoreMax, own.ScoreMin)) return;
    gauge::Lay(own.bar, Is(own.GaugeOrientation, tsGaugeOrientation::Vertical), Picture1.ScaleWidth(), Picture1.ScaleHeight());
    Picture1.SetPicture(nullptr);
    Picture1.Cls();
    own.bar.GaugeColor = own.Style == tsScoreCardStyle::GaugeRainbow ? ColorByValue() : Picture1.ForeColor();
    DrawBand(own.ScoreMin, own.Value, own.bar.GaugeColor);
    if (own.Style == tsScoreCardStyle::GaugeOverrun && IsBelow(own.ScoreStar, own.Value)) DrawBand(own.Value, own.ScoreStar, red);
    DrawBlocks();
    DrawTicks();
    DrawLimitLines();
    DrawMarker();
    PrintValue();
}

void ScoreCard::DrawBand(const Variant& from, const Variant& to, OLE_COLOR color) {
    Draw(gauge::Band(own.bar, PositionOf(from), PositionOf(to), color));
}

void ScoreCard::DrawBlocks() {
    if (own.ShowBlocks < 1) return;
    const std::int16_t width = gauge::GapWidth(own.ShowBlocks);
    Picture1.SetDrawWidth(width);
    const double minimum = own.ScoreMin.ToDouble();
    const float step = Single((own.ScoreMax.ToDouble() - minimum) / own.ShowBlocks);
    // Ends where the step is too small to count, too.
    float last = -std::numeric_limits<float>::infinity();
    for (float value = Single(minimum + double{step}); value > last && !IsBelow(own.ScoreMax, value); value += step) {
        DrawValueLine(value, 1, Picture1.BackColor(), width);
        last = value;
    }
}

void ScoreCard::DrawTicks() {
    constexpr float shortTick = 0.3f, longTick = 0.5f;
    constexpr int longEvery = 5;
    const double every = own.ShowTickLinesEvery.ToDouble();
    if (!(every > 0)) return;
    Picture1.SetDrawWidth(1);
    Draw(gauge::Axis(own.bar, own.TickLineColor));
    const float step = Single(every);
    std::int16_t count = 1;
    for (float value = Single(own.ScoreMin.ToDouble() + every); value <= own.ScoreMax.ToSingle(); value += step) {
        DrawValueLine(value, count % longEvery == 0 ? longTick : shortTick, own.TickLineColor, 1);
        if (count == std::numeric_limits<std::int16_t>::max()) throw ControlError(frame::errors::overflow);
        ++count;
    }
}

void ScoreCard::DrawLimitLines() {
    if (!own.ShowLimitLines) return;
    DrawValueLine(own.ScoreBad, 1, red, 1);
    DrawValueLine(own.ScoreMaybe, 1, yellow, 1);
    DrawValueLine(own.ScoreGood, 1, green, 1);
    DrawValueLine(own.ScoreStar, 1, cyan, 1);
}

void ScoreCard::DrawMarker() {
    constexpr std::int16_t flatWidth = 5;
    if (Is(own.ShowMarker, tsMarkerStyle::ShowLine)) {
        DrawValueLine(own.Value, 1, black, 1);
    } else if (Is(own.ShowMarker, tsMarkerStyle::ShowFlatBar)) {
        DrawValueLine(own.Value, 1, black, flatWidth);
        DrawValueLine(own.Value, 1, white, 1);
    } else if (Is(own.ShowMarker, tsMarkerStyle::ShowBar)) {
        DrawRaisedBar();
    }
}

// Drawn outside the range, too, where a value line is not.
void ScoreCard::DrawRaisedBar() {
    constexpr int lines = 5;
    Picture1.SetDrawWidth(1);
    const float base = PositionOf(own.Value) - 2;
    for (int line = 0; line < lines; ++line)
        Draw(gauge::CrossLine(own.bar, base + static_cast<float>(line), {0, own.bar.GaugeBreadth},
                              gauge::RaisedColor(own.bar, line)));
}

void ScoreCard::PrintValue() {
    const double number = own.ShowValue.ToDouble();
    const bool isPlace = number >= static_cast<double>(tsShowValue::AtLeft) && number <= static_cast<double>(tsShowValue::Adjust);
    if (!isPlace || number != std::trunc(number)) return;
    const std::string text = PercentText(own.Value);
    // Half the range, not the middle of it: kept so that saved designs print their text in the same place.
    const bool low = IsBelow(own.Value, (own.ScoreMax.ToDouble() - own.ScoreMin.ToDouble()) / 2);
    const gauge::Place place = gauge::TextPlace(ShowValue(), low, own.bar.vertical, {Picture1.ScaleWidth(), Picture1.ScaleHeight()},
                                                {Picture1.TextWidth(text), Picture1.TextHeight(text)});
    Picture1.SetCurrentX(place.x);
    Picture1.SetCurrentY(place.y);
    const OLE_COLOR before = Picture1.ForeColor();
    Picture1.SetForeColor(own.FontColor);
    Picture1.Print(text);
    Picture1.SetForeColor(before);
}

void ScoreCard::DrawValueLine(const Variant& value, float fraction, OLE_COLOR color, std::int16_t width) {
    if (IsBelow(value, own.ScoreMin) || IsBelow(own.ScoreMax, value)) return;
    Picture1.SetDrawWidth(width);
    const gauge::Across across = gauge::AcrossOf(own.bar, fraction);
    Draw(gauge::CrossLine(own.bar, PositionOf(value), across, color));
}

float ScoreCard::PositionOf(const Variant& value) const {
    return gauge::PositionOf(own.bar, value.ToDouble(), own.ScoreMin.ToDouble(), own.ScoreMax.ToDouble());
}

void ScoreCard::Draw(const frame::draw::Line& line) { Picture1.Line(line.x1, line.y1, line.x2, line.y2, line.color, line.box); }

}  // namespace tessel::controls
