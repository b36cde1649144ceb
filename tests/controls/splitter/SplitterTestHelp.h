#pragma once

#include <cstdio>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/Classes.h"
#include "frame/ClassTable.h"
#include "frame/Control.h"
#include "frame/Drawing.h"
#include "frame/Extender.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "tests/HostUnderTest.h"

/// What the tests of the splitter share. It is reached through its table alone: by the names of its members and of its inputs.
namespace tessel::controls::splittertest {

inline constexpr int horizontal = 0, vertical = 1;
inline constexpr int none = 0, flat = 1, raised = 2, sunken = 3, grooved = 4, serrated = 5;
inline constexpr float thick = 120;  ///< of a bar that has just been placed

inline const frame::ControlClass& SplitterClass() {
    const frame::ControlClass* found = FindControlClass("Splitter");
    if (!found) throw std::logic_error("There is no class Splitter");
    return *found;
}

/// The inner size of the form: `ScaleWidth` or `ScaleHeight`, in twips.
inline float Inner(test::HostUnderTest& host, std::string_view which) { return host.Form().Get(which).ToSingle(); }

// Input to the bar's own surface.

inline void Fire(frame::Control& bar, std::string_view event, std::vector<frame::Variant> arguments = {}) {
    const frame::Member* input = bar.Table().FindInput(event);
    if (!input) throw std::logic_error("There is no input " + std::string(event));
    input->call(bar, arguments);
}
inline void Mouse(frame::Control& bar, std::string_view event, float x, float y, std::int16_t button = 1) {
    Fire(bar, event, {button, std::int16_t{0}, x, y});
}
inline void Press(frame::Control& bar, float x, float y, std::int16_t button = 1) { Mouse(bar, "MouseDown", x, y, button); }
inline void MoveTo(frame::Control& bar, float x, float y) { Mouse(bar, "MouseMove", x, y); }
inline void Release(frame::Control& bar) { Mouse(bar, "MouseUp", 0, 0); }

/// Presses the bar at 50, 50 and moves the pointer by so much: one step of a drag.
inline void DragBy(frame::Control& bar, float dx, float dy) {
    Press(bar, 50, 50);
    MoveTo(bar, 50 + dx, 50 + dy);
    Release(bar);
}

// Drawing as text.

/// "S", "H", "D" and "L" for the edge colours of the system, hexadecimal digits for all others.
inline std::string ColorText(frame::OLE_COLOR color) {
    static const std::map<std::uint32_t, std::string> edges = {
        {0x80000010u, "S"}, {0x80000014u, "H"}, {0x80000015u, "D"}, {0x80000016u, "L"}};
    if (const auto found = edges.find(color.value); found != edges.end()) return found->second;
    char text[16];
    std::snprintf(text, sizeof text, "%X", static_cast<unsigned>(color.value));
    return text;
}

/// "line 0,7-0,0 S", "box 0,0-19,7 H", "fill 0,0-19,7 C0C000".
inline std::string LineText(std::string_view kind, double x1, double y1, double x2, double y2, const std::string& color) {
    const auto number = [](double value) { return frame::Variant(static_cast<float>(value)).ToText(); };
    return std::string(kind) + " " + number(x1) + "," + number(y1) + "-" + number(x2) + "," + number(y2) + " " + color;
}

inline std::vector<std::string> Drawn(const frame::RecordingCanvas& canvas) {
    static constexpr const char* kinds[] = {"line", "box", "fill"};
    std::vector<std::string> lines;
    for (const frame::DrawOp& op : canvas.operations) {
        const auto* line = std::get_if<frame::draw::Line>(&op);
        lines.push_back(
            line ? LineText(kinds[static_cast<int>(line->box)], line->x1, line->y1, line->x2, line->y2, ColorText(line->color))
                 : "operation " + std::to_string(op.index()));
    }
    return lines;
}

/// Whether the bar shows its highlight colour when it is painted.
inline bool ShowsHighlight(frame::Control& bar) {
    frame::RecordingCanvas canvas;
    bar.Surface().AddCanvas(canvas);
    bar.Paint();
    bar.Surface().RemoveCanvas(canvas);
    const auto* fill = canvas.operations.empty() ? nullptr : std::get_if<frame::draw::Line>(&canvas.operations.front());
    if (!fill || fill->box != frame::draw::Box::Filled) throw std::logic_error("The bar was not filled");
    return fill->color == bar.Get("HighlightColor").ToColor();
}

/// An object of the application with just the members that it was given. It writes down what is set on it, refuses what it is told
/// to refuse, and lets a test look in whenever a member is read or set.
class Thing final : public headless::HostObject {
  public:
    Thing(std::vector<std::string>& deeds, std::string path, const Members& members)
        : HostObject(std::move(path), members), deeds_(deeds) {
        for (const auto& member : members) names_.push_back(member.first);
    }

    frame::Variant Get(frame::MemberKey key, frame::Arguments arguments = {}) override {
        const std::string name = Known(key);
        if (const auto watch = onGet) watch(name);
        if (unreadable.contains(name)) throw frame::ControlError(frame::errors::invalidValue);
        return HostObject::Get(key, arguments);
    }
    void Put(frame::MemberKey key, const frame::Variant& value, frame::Arguments arguments = {}) override {
        const std::string name = Known(key);
        if (unsettable.contains(name)) throw frame::ControlError(frame::errors::invalidValue);
        deeds_.push_back(Path() + "." + name + "=" + value.ToText());
        HostObject::Put(key, value, arguments);
        if (const auto watch = onPut) watch(name);
    }

    /// As it stands, without a look of the watcher.
    float Number(std::string_view name) const { return Find(name)->ToSingle(); }

    std::set<std::string> unreadable, unsettable;
    std::function<void(const std::string&)> onGet, onPut;

  private:
    std::string Known(frame::MemberKey key) const {
        if (key.ByNumber()) return std::to_string(key.Number());
        for (const std::string& name : names_)
            if (frame::EqualsNoCase(name, key.Name())) return name;
        return std::string(key.Name());
    }

    std::vector<std::string>& deeds_;
    std::vector<std::string> names_;
};

/// How the bar of a stage is made.
struct Casting {
    bool designTime = false;
    const frame::PropertyBag* saved = nullptr;
    float width = 3000, height = 1000;
    bool show = true;
};

/// A host with one bar, "Splitter1", of which a test sees and controls everything: the form, what stands on it, each reading and
/// each setting, in order. The form "Form1" is 6000 wide and 4000 high.
class Stage {
  public:
    explicit Stage(const Casting& casting = {}) : designTime(casting.designTime) {
        auto made = std::make_unique<StageSite>(*this);
        site_ = made.get();
        owned_ = std::move(made);
        site_->Adopt(SplitterClass().make(frame_));
        bar_ = &site_->Control();
        bar_->Surface().AddCanvas(canvas);
        site_->Start(casting.saved, casting.width, casting.height);
        if (casting.show) site_->Show();
    }
    ~Stage() { DestroyBar(); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    frame::Control& Bar() { return *bar_; }
    frame::Site& Site() { return *site_; }
    frame::Object& Extender() { return site_->Extender(); }
    frame::Host& Frame() { return frame_; }
    bool Destroyed() const { return !owned_; }
    void DestroyBar() {
        if (owned_) frame_.Retire(std::move(owned_));
    }

    /// A bar at a place with a size and a lie, put there without a trace.
    void Lay(int orientation, float left, float top, float width, float height) {
        Bar().Put("Orientation", orientation);
        site_->SetPlace(left, top);
        site_->SetSize(width, height);
        Forget();
    }
    void LayHorizontal(float top) { Lay(horizontal, 0, top, 6000, thick); }
    void LayVertical(float left) { Lay(vertical, left, 0, thick, 4000); }

    /// A control of the application on the form, 1000 wide and 800 high.
    Thing& Add(const std::string& name, headless::HostObject::Members more = {}) {
        headless::HostObject::Members members = {
            {"Name", name}, {"Left", 100.0f}, {"Top", 200.0f}, {"Width", 1000.0f}, {"Height", 800.0f}};
        for (auto& member : more) members.push_back(std::move(member));
        return AddBare(name, members);
    }
    /// A member of a control array.
    Thing& AddMember(const std::string& name, int index) {
        headless::HostObject::Members members = {{"Name", name},  {"Index", index},   {"Left", 100.0f},
                                                 {"Top", 200.0f}, {"Width", 1000.0f}, {"Height", 800.0f}};
        return AddBare(name + "(" + std::to_string(index) + ")", members);
    }
    /// An object with these members and no others.
    Thing& AddBare(const std::string& path, const headless::HostObject::Members& members) {
        things_.push_back(std::make_unique<Thing>(deeds, path, members));
        standing.push_back(things_.back().get());
        return *things_.back();
    }

    void Forget() {
        deeds.clear();
        canvas.operations.clear();
    }

    /// What was set and raised, in order: "Splitter1.Top=500", "Text1.Height=900", "changed Orientation", "AfterMove(0, 100)". The
    /// events of the mouse are among it.
    std::vector<std::string> deeds;
    std::vector<std::string> Deeds(std::string_view beginning) const {
        std::vector<std::string> found;
        for (const auto& deed : deeds)
            if (deed.starts_with(beginning)) found.push_back(deed);
        return found;
    }
    /// What was set, without the events of the mouse.
    std::vector<std::string> Moves() const {
        std::vector<std::string> found;
        for (const auto& deed : deeds)
            if (!deed.starts_with("Mouse")) found.push_back(deed);
        return found;
    }

    bool designTime = false;
    headless::HeadlessHost others;  ///< lends the services that these tests do not watch
    frame::RecordingCanvas canvas;  ///< what the bar draws
    Thing form{deeds, "Form1", {{"Name", "Form1"}, {"ScaleWidth", 6000.0f}, {"ScaleHeight", 4000.0f}}};
    frame::Object* parent = &form;
    std::vector<frame::Object*> standing;  ///< what stands on the form; null is one that cannot be had
    bool countFails = false;
    std::set<std::string> unreadable, unsettable;                          ///< of the bar's extender
    std::map<std::string, std::function<void(frame::EventArguments)>> on;  ///< the application's handlers
    std::function<void(std::string_view)> onPropertyChanged;

  private:
    struct Standing final : frame::Siblings {
        explicit Standing(Stage& owner) : stage(owner) {}
        int Count() const override {
            if (stage.countFails) throw frame::ControlError(frame::errors::notSupported);
            return static_cast<int>(stage.standing.size());
        }
        frame::Object& Item(int index) override {
            if (index < 0 || index >= static_cast<int>(stage.standing.size()) || !stage.standing[static_cast<std::size_t>(index)])
                throw frame::ControlError(frame::errors::subscript);
            return *stage.standing[static_cast<std::size_t>(index)];
        }
        Stage& stage;
    };
    struct Ambients final : frame::AmbientProperties {
        explicit Ambients(Stage& owner) : stage(owner) {}
        bool UserMode() const override { return !stage.designTime; }
        frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
        std::string DisplayName() const override { return "Splitter1"; }
        Stage& stage;
    };
    struct Sink final : frame::EventSink {
        explicit Sink(Stage& owner) : stage(owner) {}
        bool Wants(const frame::EventInfo&) const override { return true; }
        void Raise(const frame::EventInfo& event, frame::EventArguments arguments) override {
            std::string values;
            for (const auto& argument : arguments) values += (values.empty() ? "" : ", ") + argument.Get().ToText();
            stage.deeds.push_back(std::string(event.name) + "(" + values + ")");
            const auto found = stage.on.find(std::string(event.name));
            if (found == stage.on.end()) return;
            const auto handler = found->second;
            handler(arguments);
        }
        Stage& stage;
    };
    struct BarExtender final : frame::Extender {
        BarExtender(Stage& owner, frame::Site& site) : Extender(site), stage(owner) {}
        std::string Name() const override { return "Splitter1"; }
        bool Visible() const override { return true; }
        void SetVisible(bool) override {}
        frame::Variant Get(frame::MemberKey key, frame::Arguments arguments = {}) override {
            if (!key.ByNumber() && stage.unreadable.contains(std::string(key.Name())))
                throw frame::ControlError(frame::errors::invalidValue);
            return Extender::Get(key, arguments);
        }
        void Put(frame::MemberKey key, const frame::Variant& value, frame::Arguments arguments = {}) override {
            if (!key.ByNumber() && stage.unsettable.contains(std::string(key.Name())))
                throw frame::ControlError(frame::errors::invalidValue);
            if (!key.ByNumber()) stage.deeds.push_back("Splitter1." + std::string(key.Name()) + "=" + value.ToText());
            Extender::Put(key, value, arguments);
        }

      protected:
        const frame::Object& More() const override { return more; }

      private:
        Stage& stage;
        headless::HostObject more{"Splitter1", {}};
    };
    struct StageSite final : frame::Site {
        explicit StageSite(Stage& owner) : Site(owner.frame_), stage(owner) {}
        const frame::AmbientProperties& Ambient() const override { return ambient; }
        frame::Object& Extender() override { return extender; }
        frame::Object* Parent() override { return stage.parent; }
        frame::Siblings& ParentControls() override { return siblings; }
        void PropertyChanged(std::string_view key) override {
            stage.deeds.push_back("changed " + std::string(key));
            if (const auto handler = stage.onPropertyChanged) handler(key);
        }
        frame::EventSink& Events() override { return sink; }

        Stage& stage;
        Ambients ambient{stage};
        BarExtender extender{stage, *this};
        Standing siblings{stage};
        Sink sink{stage};
    };

    std::vector<std::unique_ptr<Thing>> things_;
    frame::Host frame_{others.LentServices()};
    std::unique_ptr<frame::Site> owned_;
    StageSite* site_ = nullptr;
    frame::Control* bar_ = nullptr;
};

}  // namespace tessel::controls::splittertest
