#pragma once

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "controls/Classes.h"
#include "frame/Control.h"
#include "frame/Drawing.h"
#include "frame/PropertyBag.h"
#include "frame/child/ImageList.h"
#include "frame/child/PictureBox.h"
#include "tests/ErrorOf.h"
#include "tests/HostUnderTest.h"

/// What the tests of the score card share. They drive the control by name alone.
namespace tessel::controls::scoretest {

using frame::MemoryBag;
using frame::OLE_COLOR;
using frame::Variant;
using frame::VarType;
using test::ErrorOf;
using test::HostUnderTest;
using Lines = std::vector<std::string>;

namespace style {
inline constexpr int scoreCardSmall = 0, scoreCardLarge = 1, smileySmall = 2, smileyLarge = 3, trafficSmall = 4, trafficLarge = 5,
                     flashCard = 6, gauge = 7, gaugeOverrun = 8, gaugeRainbow = 9, weatherSmall = 10, weatherLarge = 11;
}
inline constexpr std::uint32_t black = 0, white = 0xFFFFFF, red = 0x0000FF, yellow = 0x00FFFF, green = 0x00FF00, cyan = 0xFFFF00,
                               buttonFace = 0x8000000F, buttonText = 0x80000012;

/// For each property a value that a new card does not have, in an order in which none is clamped.
inline frame::MemoryBag::Contents OtherValues(int style) {
    return {{"BackColor", frame::OLE_COLOR(1)},
            {"ForeColor", frame::OLE_COLOR(2)},
            {"Enabled", false},
            {"Font", std::make_shared<frame::Font>("Courier", 20)},
            {"BorderStyle", 0},
            {"Value", 0.25},
            {"Style", style},
            {"ScoreMin", -1},
            {"ScoreMax", 2},
            {"ScoreStar", 1.5},
            {"ScoreGood", 0.5},
            {"ScoreMaybe", 0.25},
            {"ScoreBad", -0.5},
            {"ShowLimitLines", true},
            {"ShowTickLinesEvery", 0.25},
            {"TickLineColor", frame::OLE_COLOR(3)},
            {"FontColor", frame::OLE_COLOR(4)},
            {"ShowValue", 6},
            {"ToolTipStyle", 1},
            {"ToolTip", "A score"},
            {"ShowMarker", 2},
            {"ShowBlocks", 10},
            {"GaugeOrientation", 1}};
}

/// A border of two pixels on each side and an inner size in pixels, as a size in twips.
constexpr float Outer(float innerPixels) { return (innerPixels + 4) * 15; }
/// The inner size of the cards, in pixels; a vertical one has the two exchanged.
inline constexpr float longSide = 100, shortSide = 20;

// Drawing as text: "Box 0 0 50 20 #FF w1", with the width of the pen.

inline std::string Shortest(float value) {
    char text[32];
    return {text, std::to_chars(text, text + sizeof text, value + 0.0f).ptr};
}
inline std::string Hex(std::uint32_t color) {
    char text[16];
    text[0] = '#';
    std::string result(text, std::to_chars(text + 1, text + sizeof text, color, 16).ptr);
    for (char& digit : result) digit = digit >= 'a' && digit <= 'f' ? static_cast<char>(digit - 'a' + 'A') : digit;
    return result;
}
inline std::string Corners(float x1, float y1, float x2, float y2) {
    return Shortest(x1) + " " + Shortest(y1) + " " + Shortest(x2) + " " + Shortest(y2);
}
inline std::string LineText(float x1, float y1, float x2, float y2, std::uint32_t color, int width = 1) {
    return "Line " + Corners(x1, y1, x2, y2) + " " + Hex(color) + " w" + std::to_string(width);
}
inline std::string BoxText(float x1, float y1, float x2, float y2, std::uint32_t color, int width = 1) {
    return "Box " + Corners(x1, y1, x2, y2) + " " + Hex(color) + " w" + std::to_string(width);
}
inline std::string PrintText(const std::string& text, float x, float y, std::uint32_t color = black) {
    return "Print " + text + " " + Shortest(x) + " " + Shortest(y) + " " + Hex(color);
}
inline std::size_t CountOf(const Lines& lines, std::string_view start) {
    return static_cast<std::size_t>(
        std::count_if(lines.begin(), lines.end(), [&](const std::string& line) { return line.rfind(start, 0) == 0; }));
}

/// Writes what is drawn into a log. More than a drawing can have ends it with a failure, so that no test runs for ever.
class Recorder final : public frame::Canvas {
  public:
    void Start(headless::Log& log) { log_ = &log; }
    void Draw(const frame::DrawOp& op, const frame::Pen& pen, const frame::Scale&, OLE_COLOR, OLE_COLOR foreground) override {
        constexpr int most = 300'000;
        if (!log_) return;
        if (++count_ > most) throw std::runtime_error("a drawing without an end");
        const std::string line = Line(op, pen, foreground);
        if (!line.empty()) log_->Add({"seen", line});
    }

  private:
    static std::string Line(const frame::DrawOp& op, const frame::Pen& pen, OLE_COLOR foreground) {
        namespace draw = frame::draw;
        if (std::holds_alternative<draw::Cls>(op)) return "Cls";
        if (std::holds_alternative<draw::DrawWidth>(op)) return {};  // stands with each line
        if (const auto* print = std::get_if<draw::Print>(&op)) return PrintText(print->text, print->x, print->y, foreground.value);
        const auto* line = std::get_if<draw::Line>(&op);
        if (!line || line->box == draw::Box::Outline) return "Another operation";
        const auto text = line->box == draw::Box::Filled ? BoxText : LineText;
        return text(line->x1, line->y1, line->x2, line->y2, line->color.value, pen.width);
    }

    headless::Log* log_ = nullptr;
    int count_ = 0;
};

inline const frame::ControlClass& ScoreCardClass() {
    const frame::ControlClass* found = FindControlClass("ScoreCard");
    if (!found) throw std::runtime_error("there is no score card");
    return *found;
}

inline child::PictureBox& PictureOf(frame::Control& control) {
    return dynamic_cast<child::PictureBox&>(*control.Inner("Picture1"));
}

struct Options {
    MemoryBag::Contents saved = {};
    bool placedNew = false;  ///< no saved state at all
    bool designTime = false;
    float width = Outer(longSide), height = Outer(shortSide);
    frame::FontRef ambientFont = {};
};

/// One score card, watched from the moment when it has been made.
class Card {
  public:
    explicit Card(const Options& options) : control(Make(options)), picture(PictureOf(control)) {
        picture.AddCanvas(recorder_);
        recorder_.Start(host.log);
        host.log.Clear();
    }
    explicit Card(MemoryBag::Contents saved) : Card(Options{.saved = std::move(saved)}) {}
    Card() : Card(Options{.placedNew = true}) {}

    void Put(const std::string& name, const Variant& value) { control.Put(name, value); }
    Variant Get(const std::string& name) { return control.Get(name); }
    float Number(const std::string& name) { return control.Get(name).ToSingle(); }

    /// What has happened since the last call, in order: "changed Value", "Cls", "Box 0 0 50 20 #FF w1".
    Lines Happened() {
        Lines lines;
        for (const headless::Log::Entry& entry : host.log.Take()) {
            if (entry.at(0) == Variant("changed")) lines.push_back("changed " + entry.at(2).ToText());
            if (entry.at(0) == Variant("seen")) lines.push_back(entry.at(1).ToText());
        }
        return lines;
    }
    /// What was drawn since the last call, and what was reported.
    Lines Drawn() { return Part(false); }
    Lines Changed() { return Part(true); }
    /// The drawing of one more redraw.
    Lines Redrawn() {
        host.log.Clear();
        Put("FontColor", Get("FontColor"));
        return Drawn();
    }
    std::string ToolTip() const { return picture.ToolTipText(); }

    child::ImageList& ImageList(const std::string& name) { return dynamic_cast<child::ImageList&>(*control.Inner(name)); }
    /// The image that the card shows: "ImageList16 Smiley3".
    std::string ShownImage() {
        if (!picture.Picture()) return "nothing";
        for (const auto* list : {"ImageList16", "ImageList32"})
            if (const child::ListImage* image = ImageList(list).ListImages.FindPicture(*picture.Picture()))
                return std::string(list) + " " + image->Key();
        return "another picture";
    }
    /// The control's size in twips: "300 300", to a hundredth.
    std::string Size() {
        const auto rounded = [](float value) { return Shortest(std::round(value * 100) / 100); };
        return rounded(host.SiteOf(control)->Width()) + " " + rounded(host.SiteOf(control)->Height());
    }

  private:
    frame::Control& Make(const Options& options) {
        const MemoryBag saved(options.saved);
        return host.Create(ScoreCardClass(), "ScoreCard1",
                           {.designTime = options.designTime,
                            .saved = options.placedNew ? nullptr : &saved,
                            .width = options.width,
                            .height = options.height,
                            .ambientFont = options.ambientFont});
    }
    Lines Part(bool changes) {
        constexpr std::string_view start = "changed ";
        Lines part;
        for (const std::string& line : Happened())
            if ((line.rfind(start, 0) == 0) == changes) part.push_back(changes ? line.substr(start.size()) : line);
        return part;
    }

    Recorder recorder_;  // outlives the picture box that draws on it

  public:
    HostUnderTest host;
    frame::Control& control;
    child::PictureBox& picture;
};

/// The saved state of a gauge from 0 to 100 that stands at 50, with what a test adds or puts in the place of it.
inline MemoryBag::Contents GaugeBag(const MemoryBag::Contents& other = {}) {
    MemoryBag bag({{"Style", style::gauge},
                   {"ScoreMin", 0},
                   {"ScoreMax", 100},
                   {"ScoreBad", 20},
                   {"ScoreMaybe", 40},
                   {"ScoreGood", 60},
                   {"ScoreStar", 80},
                   {"Value", 50}});
    for (const auto& [key, value] : other) bag.Set(key, value);
    return bag.Kept();
}
/// The same upright.
inline Options Upright(const MemoryBag::Contents& other = {}) {
    MemoryBag bag(GaugeBag(other));
    bag.Set("GaugeOrientation", 1);
    return {.saved = bag.Kept(), .width = Outer(shortSide), .height = Outer(longSide)};
}

}  // namespace tessel::controls::scoretest
