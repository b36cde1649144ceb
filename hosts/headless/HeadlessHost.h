#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "frame/Control.h"
#include "frame/SiblingIndex.h"
#include "frame/Windows1252.h"
#include "hosts/headless/HostObject.h"
#include "hosts/headless/Log.h"
#include "hosts/headless/MemoryDisk.h"
#include "hosts/headless/Services.h"
#include "hosts/headless/VirtualClock.h"

namespace tessel::headless {

class HeadlessForm;
class HeadlessHost;

/// How a control is placed.
struct Placing {
    bool designTime = false;
    const frame::PropertyBag* saved = nullptr;     ///< loaded from it; placed new without
    std::optional<float> width = {}, height = {};  ///< in twips; the control's own size where there is none
    HostObject::Members extender = {};             ///< members that the host adds: `ToolTipText` and others
    frame::FontRef ambientFont = {};
    std::string displayName = {};  ///< the name where there is none
    bool show = true;
    bool logEvents = true;
    /// Called for each event, with the control's name, before the application's handlers: a script's.
    std::function<void(const std::string&, const frame::EventInfo&, frame::EventArguments)> onEvent = {};
};

/// The place of a control on the headless host. Its extender has `Name`, `Left`, `Top`, `Width`, `Height`, `Visible`, what it was
/// given, and behind them the control's own members. `ToolTipText` exists once it has been given or set.
class HeadlessSite final : public frame::Site {
  public:
    HeadlessSite(HeadlessHost& host, std::string name, const Placing& placing);
    ~HeadlessSite() override;

    const std::string& Name() const { return name_; }
    /// The application's handlers.
    frame::Handlers& ApplicationHandlers() { return handlers_; }
    bool Visible() const { return visible_; }
    /// Makes the control visible or not; a change calls `Show` or `Hide`.
    void SetVisible(bool value);
    void SetUserMode(bool value) { ambient_.userMode = value; }
    void SetAmbientFont(frame::FontRef font) { ambient_.font = std::move(font); }
    void SetDisplayName(std::string name) { ambient_.displayName = std::move(name); }

    const frame::AmbientProperties& Ambient() const override { return ambient_; }
    frame::Object& Extender() override;
    frame::Object* Parent() override;
    frame::Siblings& ParentControls() override;
    void PropertyChanged(std::string_view key) override;
    frame::EventSink& Events() override;
    std::string Path() const override { return name_; }
    void Redraw() override;

  private:
    class ExtenderObject;
    class LoggingSink;

    struct AmbientState final : frame::AmbientProperties {
        bool UserMode() const override { return userMode; }
        frame::FontRef Font() const override { return font->Copy(); }
        std::string DisplayName() const override { return displayName; }

        bool userMode = true;
        frame::FontRef font;
        std::string displayName;
    };

    HeadlessHost& headless_;
    HeadlessForm& form_;
    std::string name_;
    bool logEvents_;
    decltype(Placing::onEvent) onEvent_;
    AmbientState ambient_;
    frame::Handlers handlers_;
    std::unique_ptr<LoggingSink> sink_;
    std::unique_ptr<ExtenderObject> extender_;
    bool visible_ = false;
};

/// A form with what stands on it: controls and the host's own objects, in the order in which they came.
class HeadlessForm final : public SurfaceObject, public frame::Siblings {
  public:
    HeadlessForm(HeadlessHost& host, const std::string& name, Members members);

    int Count() const override { return static_cast<int>(items_.size()); }
    Object& Item(int index) override;
    Object* Find(std::string_view name, std::int32_t index = -1) override;
    void Add(Object& object);
    void Remove(const Object& object);
    /// What is set when something on the form has another name or index.
    const std::shared_ptr<bool>& Renamed() const { return renamed_; }

  private:
    std::vector<frame::Handle<Object>> items_;
    frame::SiblingIndex index_;  // of the items up to its count
    std::shared_ptr<bool> renamed_ = std::make_shared<bool>(false);
};

/// A host without a screen: a virtual clock, boxes that answer by themselves, a disk in memory on which the shell moves, copies and
/// deletes, and a log of all that happened. Everything works the same on every machine.
class HeadlessHost {
  public:
    /// `otherFiles` takes the place of the memory disk, where there is one. The shell then moves, copies and deletes nothing: it
    /// answers 120, for what a system does not offer.
    explicit HeadlessHost(frame::FileSystem* otherFiles = nullptr);
    ~HeadlessHost();

    frame::Host& Frame() { return *host_; }
    operator frame::Host&() { return *host_; }
    /// All services of this host, for one that puts its own in the place of some.
    frame::Services LentServices();

    /// The form that holds what is created next; "Form1" at first.
    HeadlessForm& Form() { return *form_; }
    /// Makes a form, or takes the one of that name, and sets what is given; it holds what is created next.
    HeadlessForm& NewForm(const std::string& name, HostObject::Members members = {});

    HeadlessForm* FindForm(std::string_view name);

    /// Makes, loads and shows a control. An error of its load passes to the caller, and the control is gone.
    frame::Control& Create(const frame::ControlClass& controlClass, const std::string& name, const Placing& placing = {});
    template <class C>
    C& Create(const std::string& name, const Placing& placing = {}) {
        return static_cast<C&>(Create(frame::ControlClass{nullptr, &Make<C>}, name, placing));
    }
    /// The site of a control that was created here and not yet destroyed; null otherwise.
    HeadlessSite* SiteOf(const frame::Control& control);
    HeadlessSite* FindSite(std::string_view name);
    void Destroy(frame::Control& control);
    /// Takes an object off the form that it stands on.
    void TakeOffForms(const frame::Object& object);

    /// What a control writes when its design is saved.
    static frame::MemoryBag Save(frame::Control& control);

    Log log;
    VirtualClock clock;
    ScriptedLoop loop{log};
    ScriptedDialogs dialogs{log};
    ScriptedMenus menus{log};
    ScriptedDrag drag{log};
    ScriptedFocus focus{log};
    ScriptedShell shell{log};
    ScriptedRandom random;
    FixedLocale locale;
    frame::Windows1252 codePage;
    FixedMetrics metrics;
    ScriptedPictures pictures{log, files};
    FixedApplication application;
    MemoryClipboard clipboard;
    MemoryDisk files;
    ErrorList errors;

    /// Shows the children of what is created from now on; nothing is shown without it.
    std::function<std::unique_ptr<frame::Peer>(frame::ChildControl&)> makePeer;

  private:
    friend class HeadlessSite;
    class EditLogger;
    class TreeEditLogger;
    class LoggingCanvas;
    class Peers;

    template <class C>
    static std::unique_ptr<frame::Control> Make(frame::Host& host) {
        return std::make_unique<C>(host);
    }

    frame::FileSystem* otherFiles_;
    std::unique_ptr<Peers> peers_;
    std::unique_ptr<frame::Host> host_;
    std::vector<std::unique_ptr<HeadlessForm>> forms_;
    HeadlessForm* form_ = nullptr;
    std::vector<std::unique_ptr<HeadlessSite>> sites_;
};

}  // namespace tessel::headless
