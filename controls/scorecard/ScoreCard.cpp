#include "controls/scorecard/ScoreCard.h"

#include <array>
#include <optional>

#include "controls/scorecard/ScorePictures.h"
#include "frame/Text.h"

namespace tessel::controls {

using child::ImageList;
using child::PictureBox;
using frame::OLE_COLOR;
using frame::OwnSurface;
using frame::Variant;
using frame::VarType;

namespace {

constexpr frame::TextSize designSize{300, 300};  // of a small picture in its frame

/// What a picture style shows; nothing for any other style.
struct PictureStyle {
    std::string_view family;
    int side;
};
std::optional<PictureStyle> PictureStyleOf(tsScoreCardStyle style) {
    switch (style) {
        case tsScoreCardStyle::ScoreCardSmall:
            return {{scoreFamilies[0], smallSide}};
        case tsScoreCardStyle::ScoreCardLarge:
            return {{scoreFamilies[0], largeSide}};
        case tsScoreCardStyle::SmileySmall:
            return {{scoreFamilies[1], smallSide}};
        case tsScoreCardStyle::SmileyLarge:
            return {{scoreFamilies[1], largeSide}};
        case tsScoreCardStyle::TrafficLightSmall:
            return {{scoreFamilies[2], smallSide}};
        case tsScoreCardStyle::TrafficLightLarge:
            return {{scoreFamilies[2], largeSide}};
        case tsScoreCardStyle::WeatherSmall:
            return {{scoreFamilies[3], smallSide}};
        case tsScoreCardStyle::WeatherLarge:
            return {{scoreFamilies[3], largeSide}};
        default:
            return std::nullopt;
    }
}

void Fill(ImageList& images, const ScorePictures& pictures, int side) {
    images.SetUseMaskColor(false);  // the pictures are clear where they are to be
    for (std::size_t family = 0; family < scoreFamilies.size(); ++family)
        for (int grade = 1; grade <= scoreGrades; ++grade)
            images.ListImages.Add({}, std::string(scoreFamilies[family]) + frame::Decimal(grade), pictures.Of(family, grade, side));
}

/// A value that is first kept from falling below one number, then from rising above another.
float Between(float value, const Variant& least, const Variant& most) {
    if (IsBelow(value, least)) value = least.ToSingle();
    if (IsBelow(most, value)) value = most.ToSingle();
    return value;
}

}  // namespace

ScoreCard::ScoreCard(frame::Host& host) : Control(host) {
    Picture1.SetScaleMode(frame::ScaleModeConstants::Pixels);
    Picture1.Move(0, 0, designSize.width, designSize.height);
    Picture1.Click.To<&ScoreCard::PictureClick>(*this);
    Picture1.DblClick.To<&ScoreCard::PictureDblClick>(*this);
    Picture1.KeyDown.To<&ScoreCard::PictureKeyDown>(*this);
    Picture1.KeyPress.To<&ScoreCard::PictureKeyPress>(*this);
    Picture1.KeyUp.To<&ScoreCard::PictureKeyUp>(*this);
    Picture1.MouseDown.To<&ScoreCard::PictureMouseDown>(*this);
    Picture1.MouseMove.To<&ScoreCard::PictureMouseMove>(*this);
    Picture1.MouseUp.To<&ScoreCard::PictureMouseUp>(*this);
    ImageList32.SetVisible(false);
    ImageList16.SetVisible(false);
    const auto& pictures = host.Module<ScorePictures>();
    Fill(ImageList32, pictures, largeSide);
    Fill(ImageList16, pictures, smallSide);
}

void ScoreCard::SetBackColor(OLE_COLOR value) {
    Picture1.SetBackColor(value);
    PropertyChanged("BackColor");
    Redraw();
}

void ScoreCard::SetForeColor(OLE_COLOR value) {
    Picture1.SetForeColor(value);
    PropertyChanged("ForeColor");
    Redraw();
}

void ScoreCard::SetEnabled(bool value) {
    Surface().SetEnabled(value);
    PropertyChanged("Enabled");
}

void ScoreCard::SetFont(const frame::FontRef& value) {
    Picture1.SetFont(value);
    PropertyChanged("Font");
}

void ScoreCard::SetBorderStyle(std::int16_t value) {
    Picture1.SetBorderStyle(value);
    PropertyChanged("BorderStyle");
    Resize();
}

void ScoreCard::SetValue(const Variant& value) {
    own.Value = value.ToSingle();
    PropertyChanged("Value");
    Redraw();
}

void ScoreCard::SetStyle(tsScoreCardStyle value) {
    if (value == own.Style) return;
    own.Style = value;
    Redraw();
    PropertyChanged("Style");
}

void ScoreCard::SetScoreStar(float value) {
    own.ScoreStar = Between(value, own.ScoreGood, own.ScoreMax);
    PropertyChanged("ScoreStar");
    Redraw();
}

void ScoreCard::SetScoreGood(float value) {
    own.ScoreGood = Between(value, own.ScoreMaybe, own.ScoreStar);
    PropertyChanged("ScoreGood");
    Redraw();
}

void ScoreCard::SetScoreMaybe(float value) {
    own.ScoreMaybe = Between(value, own.ScoreBad, own.ScoreGood);
    PropertyChanged("ScoreMaybe");
    Redraw();
}

// No redraw: kept so that existing programs look the same.
void ScoreCard::SetScoreBad(float value) {
    own.ScoreBad = Between(value, own.ScoreMin, own.ScoreMaybe);
    PropertyChanged("ScoreBad");
}

void ScoreCard::SetScoreMin(float value) {
    if (!IsBelow(value, own.ScoreMax)) value = Variant(own.ScoreMax.ToDouble() - 1).ToSingle();
    own.ScoreMin = value;
    for (AnyNumber* threshold : {&own.ScoreBad, &own.ScoreMaybe, &own.ScoreGood, &own.ScoreStar})
        if (IsBelow(*threshold, own.ScoreMin)) *threshold = own.ScoreMin;
    PropertyChanged("ScoreMin");
    Redraw();
}

void ScoreCard::SetScoreMax(float value) {
    if (!IsBelow(own.ScoreMin, value)) value = Variant(own.ScoreMin.ToDouble() + 1).ToSingle();
    own.ScoreMax = value;
    for (AnyNumber* threshold : {&own.ScoreBad, &own.ScoreMaybe, &own.ScoreGood, &own.ScoreStar})
        if (IsBelow(own.ScoreMax, *threshold)) *threshold = own.ScoreMax;
    PropertyChanged("ScoreMax");
    Redraw();
}

void ScoreCard::SetShowLimitLines(bool value) {
    own.ShowLimitLines = value;
    PropertyChanged("ShowLimitLines");
    Redraw();
}

void ScoreCard::SetShowTickLinesEvery(const Variant& value) {
    own.ShowTickLinesEvery = value.ToDouble() < 0 ? AnyNumber(std::int16_t{0}) : AnyNumber(value);
    PropertyChanged("ShowTickLinesEvery");
    Redraw();
}

void ScoreCard::SetTickLineColor(OLE_COLOR value) {
    own.TickLineColor = value;
    PropertyChanged("TickLineColor");
    Redraw();
}

void ScoreCard::SetFontColor(OLE_COLOR value) {
    own.FontColor = value;
    PropertyChanged("FontColor");
    Redraw();
}

void ScoreCard::SetShowValue(tsShowValue value) {
    const AnyNumber number(frame::ToVariant(value));
    if (!IsEqual(number, own.ShowValue)) {
        if (value >= tsShowValue::None && value <= tsShowValue::Adjust) own.ShowValue = number;
        Redraw();
    }
    PropertyChanged("ShowValue");
}

void ScoreCard::SetToolTipStyle(tsToolTipStyle value) {
    if (value < tsToolTipStyle::None || value > tsToolTipStyle::ShowBothAsTip) return;
    own.ToolTipStyle = value;
    PropertyChanged("ToolTipStyle");
}

void ScoreCard::SetToolTip(const std::string& value) {
    own.ToolTip = value;
    PropertyChanged("ToolTip");
}

void ScoreCard::SetShowMarker(tsMarkerStyle value) {
    own.ShowMarker = AnyNumber(frame::ToVariant(value));
    PropertyChanged("ShowMarker");
    Redraw();
}

void ScoreCard::SetShowBlocks(std::int16_t value) {
    constexpr std::int16_t most = 100;
    if (value < 0 || value > most) return;
    own.ShowBlocks = value;
    PropertyChanged("ShowBlocks");
    Redraw();
}

void ScoreCard::SetGaugeOrientation(tsGaugeOrientation value) {
    own.GaugeOrientation = AnyNumber(frame::ToVariant(value));
    PropertyChanged("GaugeOrientation");
    Redraw();
}

int ScoreCard::Grade() const {
    int grade = 1;
    if (Reaches(own.Value, own.ScoreBad)) grade = 2;
    if (Reaches(own.Value, own.ScoreMaybe)) grade = 3;
    if (Reaches(own.Value, own.ScoreGood)) grade = 4;
    if (Reaches(own.Value, own.ScoreStar)) grade = 5;
    return grade;
}

void ScoreCard::InitProperties() {
    Control::InitProperties();
    Redraw();
}

void ScoreCard::ReadProperties(const frame::PropertyBag& bag) {
    Control::ReadProperties(bag);
    Redraw();
}

void ScoreCard::Resize() {
    if (const auto style = PictureStyleOf(own.Style)) return TakeSizeOfPicture(static_cast<float>(style->side));
    Picture1.Move(0, 0, Surface().ScaleWidth(), Surface().ScaleHeight());
    Redraw();
}

frame::TextSize ScoreCard::DesignSize() const { return designSize; }

void ScoreCard::PictureClick() { ForwardEvent(frame::stock::Click); }
void ScoreCard::PictureDblClick() { ForwardEvent(frame::stock::DblClick); }
void ScoreCard::PictureKeyDown(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(frame::stock::KeyDown, keyCode, shift); }
void ScoreCard::PictureKeyPress(std::int16_t keyAscii) { ForwardEvent(frame::stock::KeyPress, keyAscii); }
void ScoreCard::PictureKeyUp(std::int16_t keyCode, std::int16_t shift) { ForwardEvent(frame::stock::KeyUp, keyCode, shift); }
void ScoreCard::PictureMouseDown(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseDown, button, shift, x, y);
}
void ScoreCard::PictureMouseMove(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseMove, button, shift, x, y);
}
void ScoreCard::PictureMouseUp(std::int16_t button, std::int16_t shift, float x, float y) {
    ForwardEvent(frame::stock::MouseUp, button, shift, x, y);
}

void ScoreCard::Redraw() {
    if (const auto style = PictureStyleOf(own.Style))
        ShowPicture(style->family, style->side == smallSide ? ImageList16 : ImageList32);
    else if (own.Style == tsScoreCardStyle::FlashCard)
        DrawFlashCard();
    else if (own.Style >= tsScoreCardStyle::Gauge && own.Style <= tsScoreCardStyle::GaugeRainbow)
        DrawGauge();
    SetTip();
}

void ScoreCard::ShowPicture(std::string_view family, const ImageList& images) {
    Resize();
    Picture1.Cls();
    Picture1.SetPicture(images.ListImages.Item(std::string(family) + frame::Decimal(Grade())).Picture());
}

void ScoreCard::DrawFlashCard() {
    Picture1.SetPicture(nullptr);
    Picture1.Cls();
    const OLE_COLOR color = ColorByValue();
    Picture1.Line(0, 0, Picture1.ScaleWidth(), Picture1.ScaleHeight(), color, frame::draw::Box::Filled);
}

OLE_COLOR ScoreCard::ColorByValue() {
    static constexpr std::array<std::uint32_t, scoreGrades> ofGrade = {0, 0x0000FF, 0x00FFFF, 0x00FF00, 0xFFFF00};
    own.bar.GaugeColor = ofGrade.at(static_cast<std::size_t>(Grade() - 1));
    return own.bar.GaugeColor;
}

void ScoreCard::SetTip() {
    if (!UserMode()) return;
    switch (own.ToolTipStyle) {
        case tsToolTipStyle::ShowTextAsTip:
            return Picture1.SetToolTipText(own.ToolTip);
        case tsToolTipStyle::ShowValueAsTip:
            return Picture1.SetToolTipText(PercentText(own.Value));
        case tsToolTipStyle::ShowBothAsTip:
            return Picture1.SetToolTipText(own.ToolTip + ' ' + PercentText(own.Value));
        case tsToolTipStyle::None:
            break;
    }
    Picture1.SetToolTipText({});
}

// One plain step, width - inner width + side, nears the end by a fifteenth and stops a little short of it: a whole step is there at
// once. A box whose scale somebody has changed may have no such size.
void ScoreCard::TakeSizeOfPicture(float side) {
    constexpr int mostSteps = 100;
    for (int step = 0; step < mostSteps && Picture1.ScaleWidth() != side; ++step) {
        const float width = Picture1.Width() + (side - Picture1.ScaleWidth()) * frame::twipsPerPixel;
        if (width == Picture1.Width()) break;
        Picture1.SetWidth(width);
    }
    const float width = Picture1.Width();
    Picture1.Move(0, 0, width, width);
    Surface().SetWidth(width);
    Surface().SetHeight(width);
}

struct ScoreCard::Tables {
    static constexpr std::array members = {
        frame::property<&ScoreCard::BackColor, &ScoreCard::SetBackColor>(
            "BackColor", "Returns/sets the background color used to display text and graphics in an object.",
            frame::dispatch::backColor),
        frame::property<&ScoreCard::ForeColor, &ScoreCard::SetForeColor>(
            "ForeColor", "Returns/sets the foreground color used to display text and graphics in an object.",
            frame::dispatch::foreColor),
        frame::property<&ScoreCard::Enabled, &ScoreCard::SetEnabled>(
            "Enabled", "Returns/sets a value that determines whether an object can respond to user-generated events.",
            frame::dispatch::enabled),
        frame::property<&ScoreCard::Font, &ScoreCard::SetFont>("Font", "Returns a Font object.", frame::dispatch::font),
        frame::property<&ScoreCard::BorderStyle, &ScoreCard::SetBorderStyle>(
            "BorderStyle", "Returns/sets the border style for an object.", frame::dispatch::borderStyle),
        frame::method<&ScoreCard::Refresh>("Refresh", "Forces a complete repaint of a object.", {}, frame::dispatch::refresh),
        frame::property<&ScoreCard::Value, &ScoreCard::SetValue>("Value", "Returns/sets the score that the control shows."),
        frame::property<&ScoreCard::Style, &ScoreCard::SetStyle>("Style",
                                                                 "Style for the control, either an image or a gauge style type."),
        frame::property<&ScoreCard::ScoreStar, &ScoreCard::SetScoreStar>("ScoreStar",
                                                                         "Score above which the control shows star marks"),
        frame::property<&ScoreCard::ScoreGood, &ScoreCard::SetScoreGood>("ScoreGood",
                                                                         "Score above which the control shows a good mark"),
        frame::property<&ScoreCard::ScoreMaybe, &ScoreCard::SetScoreMaybe>("ScoreMaybe",
                                                                           "Score above which the control shows a maybe mark"),
        frame::property<&ScoreCard::ScoreBad, &ScoreCard::SetScoreBad>("ScoreBad",
                                                                       "Score above which the control shows a bad mark"),
        frame::property<&ScoreCard::ScoreMin, &ScoreCard::SetScoreMin>("ScoreMin", "Minimum score allowed"),
        frame::property<&ScoreCard::ScoreMax, &ScoreCard::SetScoreMax>("ScoreMax", "Maximum score allowed"),
        frame::property<&ScoreCard::ShowLimitLines, &ScoreCard::SetShowLimitLines>(
            "ShowLimitLines", "Shows the limit (bad,maybe,good,star) lines on the control"),
        frame::property<&ScoreCard::ShowTickLinesEvery, &ScoreCard::SetShowTickLinesEvery>(
            "ShowTickLinesEvery", "Shows tick lines every interval on the control.  0 means no tick lines."),
        frame::property<&ScoreCard::TickLineColor, &ScoreCard::SetTickLineColor>("TickLineColor",
                                                                                 "Sets the line color for the tick marks"),
        frame::property<&ScoreCard::FontColor, &ScoreCard::SetFontColor>("FontColor",
                                                                         "The color used for the value displayed on the control"),
        frame::property<&ScoreCard::ShowValue, &ScoreCard::SetShowValue>("ShowValue",
                                                                         "Show the value on the control as text (eg 93%)."),
        frame::property<&ScoreCard::ToolTipStyle, &ScoreCard::SetToolTipStyle>("ToolTipStyle",
                                                                               "Returns/sets what the tool tip shows."),
        frame::property<&ScoreCard::ToolTip, &ScoreCard::SetToolTip>(
            "ToolTip",
            "Returns/sets the text displayed when the mouse is paused over the control.  Overwrites ToolTipText, see "
            "ToolTipStyle."),
        frame::property<&ScoreCard::ShowMarker, &ScoreCard::SetShowMarker>("ShowMarker",
                                                                           "Shows the marker for the value of the gauge."),
        frame::property<&ScoreCard::ShowBlocks, &ScoreCard::SetShowBlocks>(
            "ShowBlocks", "Sets the number of blocks the gauge is split into.  Looks like an LED display."),
        frame::property<&ScoreCard::GaugeOrientation, &ScoreCard::SetGaugeOrientation>(
            "GaugeOrientation", "Changes the gauge orientation from horizontal to vertical."),
    };
    static constexpr std::array<const frame::EventInfo*, 8> events = {
        &frame::stock::Click, &frame::stock::DblClick,  &frame::stock::KeyDown,   &frame::stock::KeyPress,
        &frame::stock::KeyUp, &frame::stock::MouseDown, &frame::stock::MouseMove, &frame::stock::MouseUp,
    };
    static constexpr std::array kept = {
        frame::childKey<&ScoreCard::Picture1, &PictureBox::BackColor, &PictureBox::SetBackColor>("BackColor", VarType::Long,
                                                                                                 0x8000000F),
        frame::childKey<&ScoreCard::Picture1, &PictureBox::ForeColor, &PictureBox::SetForeColor>("ForeColor", VarType::Long,
                                                                                                 0x80000012),
        frame::surfaceKey<&OwnSurface::Enabled, &OwnSurface::SetEnabled>("Enabled", VarType::Boolean, true),
        frame::childKey<&ScoreCard::Picture1, &PictureBox::Font, &PictureBox::SetFont>("Font", frame::ambientFont),
        frame::childKey<&ScoreCard::Picture1, &PictureBox::BorderStyle, &PictureBox::SetBorderStyle>("BorderStyle",
                                                                                                     VarType::Integer, 1),
        frame::key<&ScoreCard::own, &Own::Value>("Value", VarType::Double, 0.5),
        frame::key<&ScoreCard::own, &Own::Style>("Style", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::ScoreStar>("ScoreStar", VarType::Double, 0.8),
        frame::key<&ScoreCard::own, &Own::ScoreGood>("ScoreGood", VarType::Double, 0.6),
        frame::key<&ScoreCard::own, &Own::ScoreMaybe>("ScoreMaybe", VarType::Double, 0.4),
        frame::key<&ScoreCard::own, &Own::ScoreBad>("ScoreBad", VarType::Double, 0.2),
        frame::key<&ScoreCard::own, &Own::ScoreMin>("ScoreMin", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::ScoreMax>("ScoreMax", VarType::Integer, 1),
        frame::key<&ScoreCard::own, &Own::ShowLimitLines>("ShowLimitLines", VarType::Boolean, false),
        frame::key<&ScoreCard::own, &Own::ShowTickLinesEvery>("ShowTickLinesEvery", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::TickLineColor>("TickLineColor", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::FontColor>("FontColor", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::ShowValue>("ShowValue", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::ToolTipStyle>("ToolTipStyle", VarType::Integer, 3),
        frame::key<&ScoreCard::own, &Own::ToolTip>("ToolTip", ""),
        frame::key<&ScoreCard::own, &Own::ShowMarker>("ShowMarker", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::ShowBlocks>("ShowBlocks", VarType::Integer, 0),
        frame::key<&ScoreCard::own, &Own::GaugeOrientation>("GaugeOrientation", VarType::Integer, 0),
    };
    static constexpr std::array<std::string_view, kept.size()> savedOrder = {
        "BackColor",      "ForeColor",          "Enabled",       "Font",       "BorderStyle",     "Value",
        "Style",          "ScoreStar",          "ScoreGood",     "ScoreMaybe", "ScoreMin",        "ScoreMax",
        "ShowLimitLines", "ShowTickLinesEvery", "TickLineColor", "FontColor",  "ShowValue",       "ToolTipStyle",
        "ToolTip",        "ScoreBad",           "ShowMarker",    "ShowBlocks", "GaugeOrientation"};
    static constexpr std::array parts = {frame::part<&ScoreCard::Picture1>("Picture1"),
                                         frame::part<&ScoreCard::ImageList32>("ImageList32"),
                                         frame::part<&ScoreCard::ImageList16>("ImageList16")};
};

constexpr frame::ClassTable ScoreCard::table{.name = "ScoreCard",
                                             .members = Tables::members,
                                             .events = Tables::events,
                                             .bag = Tables::kept,
                                             .savedOrder = Tables::savedOrder,
                                             .parts = Tables::parts};

}  // namespace tessel::controls
