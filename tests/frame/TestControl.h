#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "frame/ChildControl.h"
#include "frame/ClassTable.h"
#include "frame/Control.h"
#include "frame/Event.h"
#include "frame/PropertyBag.h"
#include "frame/Site.h"
#include "tests/ErrorOf.h"

/// A control, a child, a peer and a site for tests of the frame: small, with one member of each kind.
namespace tessel::test {

inline frame::MemoryBag BagOf(frame::MemoryBag::Contents contents) { return contents; }

/// Follows a child and counts how often it was told of changes.
class CountingPeer final : public frame::Peer {
  public:
    explicit CountingPeer(int& updates) : updates_(updates) {}
    void Update() override {
        ++updates_;
        if (onUpdate) onUpdate();
    }

    std::function<void()> onUpdate;

  private:
    int& updates_;
};

class TestChild final : public frame::ChildControl {
  public:
    TestChild(frame::Control& owner, std::string name) : ChildControl(owner, std::move(name)) {}

    const std::string& Text() const { return text_; }
    void SetText(const std::string& value) { Store(text_, value); }
    void ClickInput() {
        Enter("Click", [&] { Click(); });
    }
    void MouseDownInput(std::int16_t button, std::int16_t shift, float x, float y) {
        Enter("MouseDown", [&] { MouseDown(button, shift, x, y); });
    }

    frame::Slot<> Click;
    frame::Slot<std::int16_t, std::int16_t, float, float> MouseDown;
    int moves = 0;  ///< how often the place or size was told to be another

    const frame::ClassTable& Table() const override {
        static constexpr auto members = frame::Join(
            frame::childMembers, std::array{frame::property<&TestChild::Text, &TestChild::SetText>("Text", "The text.")});
        static constexpr frame::ClassTable table{.name = "TestChild", .members = members, .defaultMember = "Text"};
        return table;
    }

  protected:
    void Moved() override { ++moves; }

  private:
    std::string text_ = "as designed";
};

enum class Mood : std::int16_t { Calm = 0, Merry = 1 };

inline constexpr frame::Event<bool&, std::int32_t&, std::string&> Happened{
    "Happened", 1, {"Cancel", "Count", "Text"}, "Something has happened."};
inline constexpr frame::Event<> Quiet{"Quiet", 2};

/// One property of each kind and type, one child, two events, and a trace of its life.
class TestControl final : public frame::Control {
  public:
    explicit TestControl(frame::Host& host) : Control(host) {
        Child1.Click.To<&TestControl::ChildClick>(*this);
        Child1.MouseDown.To<&TestControl::ChildMouseDown>(*this);
    }
    ~TestControl() override {
        if (onEnd) onEnd();
    }

    std::int16_t Number() const { return own.Number; }
    void SetNumber(std::int16_t value) { Keep(own.Number, value, "Number"); }
    frame::OLE_COLOR Tint() const { return own.Tint; }
    void SetTint(frame::OLE_COLOR value) { Keep(own.Tint, value, "Tint"); }
    const std::string& Title() const { return own.Title; }
    void SetTitle(const std::string& value) { Keep(own.Title, value, "Title"); }
    float Amount() const { return own.Amount; }
    void SetAmount(float value) { Keep(own.Amount, value, "Amount"); }
    Mood Temper() const { return own.Temper; }
    void SetTemper(Mood value) { Keep(own.Temper, value, "Temper"); }
    const frame::FontRef& Face() const { return own.Face; }
    void SetFace(const frame::FontRef& value) { Keep(own.Face, value, "Face"); }
    const frame::PictureRef& Image() const { return own.Image; }
    void SetImage(const frame::PictureRef& value) { Keep(own.Image, value, "Image"); }
    const std::string& Text() const { return Child1.Text(); }
    void SetText(const std::string& value) {
        Child1.SetText(value);
        PropertyChanged("Text");
    }
    /// Set at run time only.
    std::int32_t Level() const { return own.Level; }
    void SetLevel(std::int32_t value) {
        RefuseAtDesignTime();
        Keep(own.Level, value, "Level");
    }
    std::int32_t Serial() const { return own.Serial; }
    std::int32_t Total() const { return 7; }

    void Tell() const { RaiseEvent(Quiet); }
    /// What the handlers make of the arguments, as "cancel count text".
    std::string Ask(bool cancel, std::int32_t count, std::string text) const {
        RaiseEvent(Happened, cancel, count, text);
        return std::string(cancel ? "True " : "False ") + std::to_string(count) + " " + text;
    }
    /// The same, where the handlers' changes are not read back.
    std::string Forward(bool cancel, std::int32_t count, std::string text) const {
        ForwardEvent(Happened, cancel, count, text);
        return std::string(cancel ? "True " : "False ") + std::to_string(count) + " " + text;
    }
    std::string ToolTip() const { return Extender().Get("ToolTipText").ToText(); }

    void Initialize() override { Note("Initialize"); }
    void InitProperties() override {
        Note("InitProperties");
        Control::InitProperties();
        if (onLoad) onLoad();
    }
    void ReadProperties(const frame::PropertyBag& bag) override {
        Note("ReadProperties");
        Control::ReadProperties(bag);
        if (onLoad) onLoad();
    }
    void Resize() override {
        Note("Resize");
        if (onResize) onResize();
    }
    void Show() override { Note("Show"); }
    void Paint() override { Note("Paint"); }
    void Hide() override { Note("Hide"); }
    void AmbientChanged(const std::string& name) override { Note("AmbientChanged:" + name); }
    void WriteProperties(frame::PropertyBag& bag) const override {
        Note("WriteProperties");
        Control::WriteProperties(bag);
    }
    frame::TextSize DesignSize() const override { return {1200, 600}; }

    const frame::ClassTable& Table() const override;

    struct Own {
        std::int16_t Number = 0;
        frame::OLE_COLOR Tint;
        std::string Title;
        float Amount = 0;
        Mood Temper = Mood::Calm;
        frame::FontRef Face;
        frame::PictureRef Image;
        std::int32_t Level = 0;
        std::int32_t Serial = 0;
    };
    Own own;
    TestChild Child1{*this, "Child1"};
    mutable std::string trace;  ///< the handlers that ran, parted by blanks
    int clicks = 0;             ///< counted after the event has been raised
    std::function<void()> onEnd, onLoad, onResize;

  private:
    void Note(std::string_view handler) const {
        if (!trace.empty()) trace += ' ';
        trace += handler;
    }
    template <class T>
    void Keep(T& field, const T& value, std::string_view key) {
        field = value;
        PropertyChanged(key);
    }
    void ChildClick() {
        ForwardEvent(frame::stock::Click);
        ++clicks;
    }
    void ChildMouseDown(std::int16_t button, std::int16_t shift, float x, float y) {
        ForwardEvent(frame::stock::MouseDown, button, shift, x, y);
    }
};

inline const frame::ClassTable& TestControl::Table() const {
    using C = TestControl;
    using frame::VarType;
    static constexpr std::array members = {
        frame::property<&C::Number, &C::SetNumber>("Number", "A number."),
        frame::property<&C::Tint, &C::SetTint>("Tint", "A colour."),
        frame::property<&C::Title, &C::SetTitle>("Title", "A text."),
        frame::property<&C::Amount, &C::SetAmount>("Amount", "A fraction."),
        frame::property<&C::Temper, &C::SetTemper>("Temper", "An enumeration."),
        frame::property<&C::Face, &C::SetFace>("Face", "A font.", frame::dispatch::font),
        frame::property<&C::Image, &C::SetImage>("Image", "A picture."),
        frame::property<&C::Text, &C::SetText>("Text", "The text of the child."),
        frame::runTimeProperty<&C::Level, &C::SetLevel>("Level", "Set at run time only."),
        frame::readOnlyProperty<&C::Serial>("Serial", "Never set."),
        frame::property<&C::Total>("Total", "Without a setter."),
        frame::method<&C::Ask>("Ask", "Raises an event.", {"Cancel", "Count", "Text"}),
    };
    static constexpr const frame::EventInfo* events[] = {&Happened, &Quiet, &frame::stock::Click, &frame::stock::MouseDown};
    static constexpr std::array kept = {
        frame::key<&C::own, &Own::Number>("Number", VarType::Integer, 30),
        frame::key<&C::own, &Own::Tint>("Tint", VarType::Long, 0x8000000F),
        frame::key<&C::own, &Own::Title>("Title", "untitled"),
        frame::key<&C::own, &Own::Amount>("Amount", VarType::Integer, 2),
        frame::key<&C::own, &Own::Temper>("Temper", VarType::Integer, 1),
        frame::key<&C::own, &Own::Face>("Face", frame::ambientFont),
        frame::key<&C::own, &Own::Image>("Image", frame::noObject),
        frame::childKey<&C::Child1, &TestChild::Text, &TestChild::SetText>("Text", "as designed"),
        frame::key<&C::own, &Own::Level>("Level", VarType::Long, 5),
        frame::key<&C::own, &Own::Serial>("Serial", VarType::Long, 0),
    };
    static constexpr std::array parts = {frame::part<&C::Child1>("Child1")};
    static constexpr frame::ClassTable table{
        .name = "TestControl", .members = members, .events = events, .bag = kept, .parts = parts, .defaultMember = "Title"};
    return table;
}

/// A site that keeps what it was told. Its events go to `handlers`.
class WatchedSite final : public frame::Site, private frame::AmbientProperties, private frame::Siblings {
  public:
    WatchedSite(frame::Host& host, std::string name) : frame::Site(host), name_(std::move(name)) {}

    /// Makes, loads and places a control.
    template <class C>
    C& Make(const frame::PropertyBag* saved = nullptr) {
        auto control = std::make_unique<C>(Host());
        C& made = *control;
        Adopt(std::move(control));
        Start(saved);
        return made;
    }

    bool userMode = true;
    frame::FontRef font = std::make_shared<frame::Font>();
    std::vector<std::string> changed;
    int moves = 0, repaints = 0;
    std::function<void()> whenSized;
    frame::Handlers handlers;

    const frame::AmbientProperties& Ambient() const override { return *this; }
    frame::Object& Extender() override { frame::ThrowObjectGone(); }
    frame::Object* Parent() override { return nullptr; }
    frame::Siblings& ParentControls() override { return *this; }
    void PropertyChanged(std::string_view key) override { changed.emplace_back(key); }
    frame::EventSink& Events() override { return handlers; }
    void Repaint() override { ++repaints; }

  protected:
    void Placed() override { ++moves; }
    void Sized() override {
        ++moves;
        if (whenSized) whenSized();
    }

  private:
    bool UserMode() const override { return userMode; }
    frame::FontRef Font() const override { return font->Copy(); }
    std::string DisplayName() const override { return name_; }
    int Count() const override { return 0; }
    frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }

    std::string name_;
};

}  // namespace tessel::test
