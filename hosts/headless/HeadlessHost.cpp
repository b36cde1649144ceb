#include "hosts/headless/HeadlessHost.h"

#include <algorithm>
#include <optional>
#include <utility>

#include "frame/ClassTable.h"
#include "frame/Extender.h"
#include "frame/Text.h"
#include "frame/child/ListView.h"
#include "frame/child/Raster.h"
#include "frame/child/TreeView.h"

namespace tessel::headless {

using frame::Variant;

/// Beside the geometry the host has what it was given, and a tool tip once one is set.
class HeadlessSite::ExtenderObject final : public frame::Extender {
  public:
    ExtenderObject(HeadlessSite& site, const HostObject::Members& members)
        : Extender(site), site_(site), given_(site.name_, members) {
        given_.TellWhenRenamed(site.form_.Renamed());
    }

    std::string Name() const override { return site_.name_; }
    bool Visible() const override { return site_.visible_; }
    void SetVisible(bool value) override { site_.SetVisible(value); }

  protected:
    const Object& More() const override { return given_; }

  private:
    struct GivenMembers final : HostObject {
        using HostObject::HostObject;
        static bool IsToolTip(frame::MemberKey key) { return !key.ByNumber() && frame::EqualsNoCase(key.Name(), "ToolTipText"); }
        bool Has(frame::MemberKey key) const override { return IsToolTip(key) || HostObject::Has(key); }
        void Put(frame::MemberKey key, const Variant& value, frame::Arguments arguments = {}) override {
            if (IsToolTip(key) && !HostObject::Has(key)) SetMember("ToolTipText", {});
            HostObject::Put(key, value, arguments);
        }
    };

    HeadlessSite& site_;
    GivenMembers given_;
};

/// Writes each event into the log, then lets the script and the application handle it.
class HeadlessSite::LoggingSink final : public frame::EventSink {
  public:
    explicit LoggingSink(HeadlessSite& site) : site_(site) {}
    bool Wants(const frame::EventInfo& event) const override {
        return site_.logEvents_ || site_.onEvent_ || site_.handlers_.Wants(event);
    }
    void Raise(const frame::EventInfo& event, frame::EventArguments arguments) override {
        if (site_.logEvents_) site_.headless_.log.AddEvent(site_.name_, event, arguments);
        if (site_.onEvent_) site_.onEvent_(site_.name_, event, arguments);
        if (site_.handlers_.Wants(event)) site_.handlers_.Raise(event, arguments);
    }

  private:
    HeadlessSite& site_;
};

HeadlessSite::HeadlessSite(HeadlessHost& host, std::string name, const Placing& placing)
    : Site(host.Frame()),
      headless_(host),
      form_(host.Form()),
      name_(std::move(name)),
      logEvents_(placing.logEvents),
      onEvent_(placing.onEvent),
      sink_(std::make_unique<LoggingSink>(*this)) {
    ambient_.userMode = !placing.designTime;
    ambient_.font = placing.ambientFont ? placing.ambientFont : std::make_shared<frame::Font>();
    ambient_.displayName = placing.displayName.empty() ? name_ : placing.displayName;
    extender_ = std::make_unique<ExtenderObject>(*this, placing.extender);
}

HeadlessSite::~HeadlessSite() = default;

void HeadlessSite::SetVisible(bool value) {
    if (value == visible_) return;
    visible_ = value;
    if (visible_)
        Show();
    else
        Hide();
}

void HeadlessSite::Redraw() {
    if (visible_) Paint();
}

frame::Object& HeadlessSite::Extender() { return *extender_; }
frame::Object* HeadlessSite::Parent() { return &form_; }
frame::Siblings& HeadlessSite::ParentControls() { return form_; }
frame::EventSink& HeadlessSite::Events() { return *sink_; }

void HeadlessSite::PropertyChanged(std::string_view key) { headless_.log.Add({"changed", name_, key}); }

HeadlessForm::HeadlessForm(HeadlessHost& host, const std::string& name, Members members) : SurfaceObject(host.Frame(), name, {}) {
    SetMember("Name", name);
    for (const char* place : {"Left", "Top"}) SetMember(place, 0.0f);
    SetMember("Width", InnerSize().width);
    SetMember("Height", InnerSize().height);
    SetMember("Picture", frame::ObjectRef());
    SetMember("MouseIcon", frame::ObjectRef());
    SetMember("MousePointer", std::int16_t{0});
    Take(std::move(members));
}

frame::Object& HeadlessForm::Item(int index) {
    if (index < 0 || index >= Count()) throw frame::ControlError(frame::errors::subscript);
    return *items_[static_cast<std::size_t>(index)];
}

frame::Object* HeadlessForm::Find(std::string_view name, std::int32_t index) {
    for (;;) {
        if (std::exchange(*renamed_, false)) index_.Clear();
        for (int next = index_.Count(); next < Count(); ++next) {
            Object* item = items_[static_cast<std::size_t>(next)].Get();
            index_.Add(item ? frame::NameOf(*item) : std::nullopt, item ? frame::IndexOf(*item) : std::nullopt);
        }
        const int place = index_.Find(name, index);
        if (place < 0) return nullptr;
        if (Object* found = items_[static_cast<std::size_t>(place)].Get()) return found;
        *renamed_ = true;  // it has gone without a word: another one may stand behind it
    }
}

void HeadlessForm::Add(Object& object) {
    if (auto* own = dynamic_cast<HostObject*>(&object)) own->TellWhenRenamed(renamed_);
    items_.emplace_back(object);
}

void HeadlessForm::Remove(const Object& object) {
    std::erase_if(items_, [&](const frame::Handle<Object>& item) { return item.Get() == &object; });
    *renamed_ = true;
}

/// Writes drawing operations into the log, in the units in which the surface received them, and keeps the pixels. A surface that
/// nobody draws on, and of which none is read, has no plane of them.
class HeadlessHost::LoggingCanvas final : public frame::Canvas {
  public:
    LoggingCanvas(Log& log, frame::Object& owner) : log_(log), owner_(owner) {}

    void Draw(const frame::DrawOp& op, const frame::Pen& pen, const frame::Scale& scale, frame::OLE_COLOR background,
              frame::OLE_COLOR foreground) override {
        std::visit([this](const auto& operation) { log_.Add(EntryOf(operation)); }, op);
        if (frame::IsPenChange(op)) return;  // each operation brings its pen
        Plane().Draw(op, pen, scale, background, foreground);
    }
    void Wipe(frame::OLE_COLOR background, const frame::PictureRef& picture) override {
        background_ = background;
        behind_ = picture;
        if (plane_) plane_->Wipe(background, picture);
    }
    void Resize(int width, int height, frame::OLE_COLOR background) override {
        width_ = width;
        height_ = height;
        background_ = background;
        if (plane_) plane_->Resize(width, height, background);
    }
    bool KeepsPixels() const override { return true; }
    std::optional<frame::OLE_COLOR> Pixel(int x, int y) const override { return Plane().Pixel(x, y); }
    std::vector<frame::PixelPlane> Planes() const override { return Plane().Planes(); }

  private:
    child::Raster& Plane() const {
        if (!plane_) {
            plane_.emplace(width_, height_, background_);
            plane_->Wipe(background_, behind_);
        }
        return *plane_;
    }
    static Variant Given(std::optional<float> value) { return value ? Variant(*value) : Variant(); }
    template <class... Values>
    Log::Entry Entry(const char* name, Values... values) const {
        return {"draw", owner_.Path(), name, Variant(values)...};
    }

    Log::Entry EntryOf(const frame::draw::Cls&) const { return Entry("Cls"); }
    Log::Entry EntryOf(const frame::draw::Line& op) const {
        static constexpr const char* flags[] = {"", "B", "BF"};
        return Entry("Line", op.x1, op.y1, op.x2, op.y2, op.color, flags[static_cast<int>(op.box)]);
    }
    Log::Entry EntryOf(const frame::draw::Circle& op) const {
        return Entry("Circle", op.x, op.y, op.radius, op.color, Given(op.start), Given(op.end), Given(op.aspect));
    }
    Log::Entry EntryOf(const frame::draw::PSet& op) const { return Entry("PSet", op.x, op.y, op.color); }
    Log::Entry EntryOf(const frame::draw::Print& op) const { return Entry("Print", op.text, op.x, op.y); }
    Log::Entry EntryOf(const frame::draw::PaintPicture& op) const {
        return Entry("PaintPicture", op.x, op.y, frame::ObjectRef(op.picture));
    }
    Log::Entry EntryOf(const frame::draw::DrawWidth& op) const { return Entry("DrawWidth", op.value); }
    Log::Entry EntryOf(const frame::draw::DrawStyle& op) const { return Entry("DrawStyle", op.value); }
    Log::Entry EntryOf(const frame::draw::DrawMode& op) const { return Entry("DrawMode", op.value); }

    Log& log_;
    frame::Object& owner_;
    int width_ = 0, height_ = 0;
    frame::OLE_COLOR background_ = 0;
    frame::PictureRef behind_;
    mutable std::optional<child::Raster> plane_;
};

/// Tells of label edits that open; the list's own fixed rule answers for the screen.
class HeadlessHost::EditLogger final : public child::ListViewPeer {
  public:
    EditLogger(Log& log, child::ListView& list) : log_(log), list_(list) {}
    void Update() override {}
    child::ListScreen* Screen() override { return nullptr; }
    void EditBegan(child::RowId) override { log_.Add({"edit", list_.Path()}); }

  private:
    Log& log_;
    child::ListView& list_;
};

/// The same of a tree.
class HeadlessHost::TreeEditLogger final : public child::TreeViewPeer {
  public:
    TreeEditLogger(Log& log, child::TreeView& tree) : log_(log), tree_(tree) {}
    void Update() override {}
    child::TreeScreen* Screen() override { return nullptr; }
    void EditBegan(child::NodeId) override { log_.Add({"edit", tree_.Path()}); }

  private:
    Log& log_;
    child::TreeView& tree_;
};

/// Children are shown where a program asks for it; every surface is logged.
class HeadlessHost::Peers final : public frame::PeerFactory {
  public:
    explicit Peers(HeadlessHost& host) : host_(host) {}
    std::unique_ptr<frame::Peer> MakePeer(frame::ChildControl& child) override {
        if (host_.makePeer) return host_.makePeer(child);
        if (auto* list = dynamic_cast<child::ListView*>(&child)) return std::make_unique<EditLogger>(host_.log, *list);
        if (auto* tree = dynamic_cast<child::TreeView*>(&child)) return std::make_unique<TreeEditLogger>(host_.log, *tree);
        return nullptr;
    }
    std::unique_ptr<frame::Canvas> MakeCanvas(frame::DrawingSurface&, frame::Object& owner) override {
        return std::make_unique<LoggingCanvas>(host_.log, owner);
    }

  private:
    HeadlessHost& host_;
};

HeadlessHost::HeadlessHost(frame::FileSystem* otherFiles)
    : files([this] { return SecondsOf(clock.Now()); }), otherFiles_(otherFiles), peers_(std::make_unique<Peers>(*this)) {
    shell.carryOut = [this](const frame::FileOperation& operation) {
        constexpr int notOffered = 120;
        if (otherFiles_) return frame::FileOperationResult{.code = notOffered, .aborted = false, .systemError = notOffered};
        return files.Run(operation);
    };
    host_ = std::make_unique<frame::Host>(LentServices());
    NewForm("Form1");
}

frame::Services HeadlessHost::LentServices() {
    return {.loop = &loop,
            .dialogs = &dialogs,
            .menus = &menus,
            .drag = &drag,
            .focus = &focus,
            .clock = &clock,
            .random = &random,
            .locale = &locale,
            .codePage = &codePage,
            .pictures = &pictures,
            .metrics = &metrics,
            .colors = &frame::ClassicColors(),
            .application = &application,
            .files = otherFiles_ ? otherFiles_ : &files,
            .shell = &shell,
            .clipboard = &clipboard,
            .peers = peers_.get(),
            .errors = &errors};
}

HeadlessHost::~HeadlessHost() {
    while (!sites_.empty()) Destroy(sites_.back()->Control());
}

HeadlessForm& HeadlessHost::NewForm(const std::string& name, HostObject::Members members) {
    if (HeadlessForm* known = FindForm(name)) {
        known->Take(std::move(members));
        form_ = known;
        return *known;
    }
    forms_.push_back(std::make_unique<HeadlessForm>(*this, name, std::move(members)));
    form_ = forms_.back().get();
    return *form_;
}

HeadlessForm* HeadlessHost::FindForm(std::string_view name) {
    const auto found =
        std::find_if(forms_.begin(), forms_.end(), [&](const auto& form) { return frame::EqualsNoCase(form->Path(), name); });
    return found != forms_.end() ? found->get() : nullptr;
}

frame::Control& HeadlessHost::Create(const frame::ControlClass& controlClass, const std::string& name, const Placing& placing) {
    auto control = controlClass.make(*host_);
    Placing placed = placing;
    std::vector<std::pair<std::string, Variant>> place;
    std::erase_if(placed.extender, [&](const auto& member) {
        const auto is = [&](std::string_view known) { return frame::EqualsNoCase(member.first, known); };
        if (is("Left") || is("Top")) place.push_back(member);
        if (is("Width") && !placed.width) placed.width = member.second.ToSingle();
        if (is("Height") && !placed.height) placed.height = member.second.ToSingle();
        if (is("Visible")) placed.show = placed.show && member.second.ToBoolean();
        return is("Left") || is("Top") || is("Width") || is("Height") || is("Visible") || is("Name");
    });
    auto made = std::make_unique<HeadlessSite>(*this, name, placed);
    HeadlessSite& site = *made;
    sites_.push_back(std::move(made));
    try {
        site.Adopt(std::move(control));
        for (const auto& [member, value] : place) site.Extender().Put(member, value);
        Form().Add(site.Extender());
        site.Start(placed.saved, placed.width, placed.height);
        if (placed.show) site.SetVisible(true);
    } catch (...) {
        Destroy(site.Control());
        throw;
    }
    return site.Control();
}

HeadlessSite* HeadlessHost::SiteOf(const frame::Control& control) {
    const auto found = std::find_if(sites_.begin(), sites_.end(), [&](const auto& site) { return &site->Control() == &control; });
    return found != sites_.end() ? found->get() : nullptr;
}

HeadlessSite* HeadlessHost::FindSite(std::string_view name) {
    const auto found =
        std::find_if(sites_.begin(), sites_.end(), [&](const auto& site) { return frame::EqualsNoCase(site->Name(), name); });
    return found != sites_.end() ? found->get() : nullptr;
}

void HeadlessHost::Destroy(frame::Control& control) {
    const auto found = std::find_if(sites_.begin(), sites_.end(), [&](const auto& site) { return &site->Control() == &control; });
    if (found == sites_.end()) return;
    TakeOffForms((*found)->Extender());
    auto site = std::move(*found);
    sites_.erase(found);
    host_->Retire(std::move(site));
}

void HeadlessHost::TakeOffForms(const frame::Object& object) {
    for (const auto& form : forms_) form->Remove(object);
}

frame::MemoryBag HeadlessHost::Save(frame::Control& control) {
    frame::MemoryBag bag;
    control.WriteProperties(bag);
    return bag;
}

}  // namespace tessel::headless
