#pragma once

#include <QCoreApplication>
#include <QWidget>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "controls/Classes.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/DataList.h"
#include "hosts/qt/FileView.h"
#include "hosts/qt/FolderView.h"
#include "hosts/qt/Form.h"
#include "hosts/qt/Host.h"
#include "hosts/qt/Link.h"
#include "hosts/qt/ScoreCard.h"
#include "hosts/qt/Services.h"
#include "hosts/qt/Splitter.h"
#include "tests/hosts/qt/OwnerWidget.h"

/// The host for Qt with the clock, the boxes, the shell and the log of the headless host, for tests that run on both.
namespace tessel::qt::test {

/// A widget of the library that writes what its control tells into a log, and lets handlers hear it, before it goes on as usual.
template <class Widget>
class Tapped final : public Widget {
  public:
    Tapped(QWidget* form, headless::Log& log, bool logEvents, decltype(headless::Placing::onEvent) onEvent)
        : Widget(form), log_(log), logEvents_(logEvents), onEvent_(std::move(onEvent)) {}

    frame::Handlers handlers;

  protected:
    bool hears(const frame::EventInfo& event) const override {
        return logEvents_ || onEvent_ || handlers.Wants(event) || Widget::hears(event);
    }
    void raise(const frame::EventInfo& event, frame::EventArguments arguments) override {
        // A handler may destroy the widget.
        const QPointer<Tapped> alive = this;
        const std::string name = FromQt(this->objectName());
        if (logEvents_) log_.AddEvent(name, event, arguments);
        if (onEvent_) onEvent_(name, event, arguments);
        if (alive && handlers.Wants(event)) {
            frame::Handlers present = handlers;
            present.Raise(event, arguments);
        }
        if (alive) Widget::raise(event, arguments);
    }
    void propertyChanged(std::string_view key) override {
        log_.Add({"changed", FromQt(this->objectName()), key});
        Widget::propertyChanged(key);
    }

  private:
    headless::Log& log_;
    bool logEvents_;
    decltype(headless::Placing::onEvent) onEvent_;
};

class TestSite {
  public:
    TestSite(ControlWidget& widget, frame::Handlers& handlers) : widget_(&widget), handlers_(handlers) {}

    ControlWidget* widget() const { return widget_; }
    frame::Handlers& ApplicationHandlers() { return handlers_; }
    frame::Object& Extender() { return widget_->extender(); }
    frame::Control& Control() const { return widget_->control(); }
    std::string Name() const { return FromQt(widget_->objectName()); }
    float Left() const { return Site().Left(); }
    float Top() const { return Site().Top(); }
    float Width() const { return Site().Width(); }
    float Height() const { return Site().Height(); }
    void SetPlace(float left, float top) { Site().SetPlace(left, top); }
    void SetSize(float width, float height) { Site().SetSize(width, height); }
    bool Visible() const { return !widget_->isHidden(); }
    void SetVisible(bool value) { widget_->setVisible(value); }
    void SetUserMode(bool value) { widget_->host()->setUserMode(value); }
    void SetDisplayName(const std::string& name) { widget_->setObjectName(ToQt(name)); }
    void SetAmbientFont(const frame::FontRef& font) { Host::formOf(widget_)->setFont(ToQt(*font)); }

  private:
    frame::Site& Site() const { return *widget_->control().Site(); }

    QPointer<ControlWidget> widget_;
    frame::Handlers& handlers_;
};

/// The loop of the host for Qt, which tells of each turn as the headless one does.
class ToldLoop final : public frame::MessageLoop {
  public:
    ToldLoop(headless::Log& log, std::function<void()> settle) : log_(log), real_(std::move(settle)) {}
    void Turn() override {
        log_.Add({"yield"});
        if (onTurn) onTurn();
        real_.Turn();
    }
    void WantTurn() override { real_.WantTurn(); }

    std::function<void()> onTurn;  ///< what comes in meanwhile, before what the window system has

  private:
    headless::Log& log_;
    EventLoop real_;
};

class QtTestHost {
    headless::HeadlessHost lent_;

  public:
    /// `otherFiles` takes the place of the memory disk, where there is one.
    explicit QtTestHost(frame::FileSystem* otherFiles = nullptr) : lent_(otherFiles) { form_->show(); }
    QtTestHost(const QtTestHost&) = delete;
    QtTestHost& operator=(const QtTestHost&) = delete;
    ~QtTestHost() {
        form_.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    frame::Host& Frame() { return host_->frameHost(); }
    operator frame::Host&() { return Frame(); }
    qt::Form& Form() { return qt::Form::of(*form_); }
    QWidget& form() { return *form_; }

    template <class C>
    C& Create(const std::string& name, const headless::Placing& placing = {}) {
        if constexpr (requires { C::table; })
            return static_cast<C&>(Create(*FindClass<C>(), name, placing));
        else  // a control of the tests
            return static_cast<C&>(CreateIn([&]() -> ControlWidget& { return Placed<OwnerWidget<C>>(placing); }, name, placing));
    }
    frame::Control& Create(const frame::ControlClass& controlClass, const std::string& name,
                           const headless::Placing& placing = {}) {
        return CreateIn([&]() -> ControlWidget& { return Make(controlClass, placing); }, name, placing);
    }
    template <class F>
    frame::Control& CreateIn(F&& make, const std::string& name, const headless::Placing& placing) {
        const std::size_t reports = errors.reports.size();
        host_->setUserMode(!placing.designTime);
        form_->setFont(FormFont(placing.ambientFont ? placing.ambientFont : std::make_shared<frame::Font>()));
        ControlWidget& widget = make();
        widget.setObjectName(ToQt(name));
        if (placing.saved) widget.load(*placing.saved);
        frame::Control& control = widget.control();
        frame::Site& site = *control.Site();
        for (const auto& [member, value] : placing.extender) site.Extender().Put(member, value);
        site.SetSize(placing.width.value_or(site.Width()), placing.height.value_or(site.Height()));
        if (placing.show) widget.show();
        if (errors.reports.size() > reports) {
            const frame::ControlError error = errors.reports[reports].error;
            errors.reports.erase(errors.reports.begin() + static_cast<std::ptrdiff_t>(reports), errors.reports.end());
            Destroy(control);
            throw error;
        }
        return control;
    }

    /// The site of a control that was created here and not yet destroyed; null otherwise.
    TestSite* SiteOf(const frame::Control& control) {
        for (const auto& site : sites_)
            if (site->widget() && &site->widget()->control() == &control) return site.get();
        return nullptr;
    }
    TestSite* FindSite(std::string_view name) {
        for (const auto& site : sites_)
            if (site->widget() && frame::EqualsNoCase(site->Name(), name)) return site.get();
        return nullptr;
    }
    void Destroy(frame::Control& control) {
        if (TestSite* site = SiteOf(control)) delete site->widget();
    }
    static frame::MemoryBag Save(frame::Control& control) { return headless::HeadlessHost::Save(control); }

    headless::Log& log = lent_.log;
    headless::VirtualClock& clock = lent_.clock;
    headless::ScriptedDialogs& dialogs = lent_.dialogs;
    headless::ScriptedShell& shell = lent_.shell;
    headless::ScriptedRandom& random = lent_.random;
    headless::FixedMetrics& metrics = lent_.metrics;
    headless::ScriptedPictures& pictures = lent_.pictures;
    headless::MemoryDisk& files = lent_.files;
    headless::ErrorList& errors = lent_.errors;
    ToldLoop loop{log, [this] { Frame().Settle(); }};

  private:
    /// All services of the headless host but those that make the screen.
    frame::Services Scripted() {
        frame::Services services = lent_.LentServices();
        services.loop = &loop;
        services.peers = nullptr;
        services.focus = nullptr;
        return services;
    }
    /// The font by which the form's controls are given this one.
    static QFont FormFont(const frame::FontRef& font) {
        QFont result = ToQt(*font);
        result.setFamily(ToQt(font->Name()));
        return result;
    }
    template <class C>
    static const frame::ControlClass* FindClass() {
        return controls::FindControlClass(C::table.name);
    }
    ControlWidget& Make(const frame::ControlClass& controlClass, const headless::Placing& placing) {
        if (controlClass.table->name == "DataList") return Placed<DataList>(placing);
        if (controlClass.table->name == "FileView") return Placed<FileView>(placing);
        if (controlClass.table->name == "FolderView") return Placed<FolderView>(placing);
        if (controlClass.table->name == "Link") return Placed<Link>(placing);
        if (controlClass.table->name == "ScoreCard") return Placed<ScoreCard>(placing);
        if (controlClass.table->name == "Splitter") return Placed<Splitter>(placing);
        throw frame::ControlError(frame::errors::notSupported);
    }
    template <class Widget>
    ControlWidget& Placed(const headless::Placing& placing) {
        auto* widget = new Tapped<Widget>(form_.get(), log, placing.logEvents, placing.onEvent);
        sites_.push_back(std::make_unique<TestSite>(*widget, widget->handlers));
        return *widget;
    }

    std::shared_ptr<qt::Host> host_ = qt::Host::make(Scripted());
    std::unique_ptr<QWidget> form_ = [this] {
        auto form = std::make_unique<QWidget>();
        form->setObjectName("Form1");
        form->resize(800, 600);
        qt::Host::attach(form.get(), host_);
        return form;
    }();
    std::vector<std::unique_ptr<TestSite>> sites_;
};

}  // namespace tessel::qt::test
