#include <QCoreApplication>
#include <QWidget>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "frame/Text.h"
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
#include "tests/HostUnderTest.h"

namespace tessel::test {
namespace {

using qt::ControlWidget;
using qt::FromQt;
using qt::ToQt;

/// A widget of the library that writes what its control tells into a log, and lets handlers hear it, before it goes on as usual.
template <class Widget>
class Tapped final : public Widget {
  public:
    template <class... Made>
    Tapped(headless::Log& log, const headless::Placing& placing, Made&&... made)
        : Widget(std::forward<Made>(made)...), log_(log), logEvents_(placing.logEvents), onEvent_(placing.onEvent) {}

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

/// A control of the tests as a widget.
class OwnerWidget : public ControlWidget {
  public:
    OwnerWidget(const frame::ControlClass& controlClass, QWidget* form) : ControlWidget(controlClass, form) {}

  protected:
    bool hears(const frame::EventInfo&) const override { return false; }
    void raise(const frame::EventInfo&, frame::EventArguments) override {}
};

class QtSiteUnderTest final : public SiteUnderTest {
  public:
    QtSiteUnderTest(ControlWidget& widget, frame::Handlers& handlers) : widget_(&widget), handlers_(handlers) {}

    ControlWidget* widget() const { return widget_; }
    frame::Control& Control() const override { return widget_->control(); }
    frame::Handlers& ApplicationHandlers() override { return handlers_; }
    std::string Name() const override { return FromQt(widget_->objectName()); }
    bool Visible() const override { return !widget_->isHidden(); }
    void SetVisible(bool value) override { widget_->setVisible(value); }
    void SetUserMode(bool value) override { widget_->host()->setUserMode(value); }
    void SetDisplayName(const std::string& name) override { widget_->setObjectName(ToQt(name)); }
    void SetAmbientFont(const frame::FontRef& font) override { qt::Host::formOf(widget_)->setFont(ToQt(*font)); }

  private:
    QPointer<ControlWidget> widget_;
    frame::Handlers& handlers_;
};

/// The loop of the host for Qt, which tells of each turn as the headless one does.
class ToldLoop final : public frame::MessageLoop {
  public:
    ToldLoop(headless::ScriptedLoop& told, std::function<void()> settle) : told_(told), real_(std::move(settle)) {}
    /// What the test lets come in is there before what the window system has.
    void Turn() override {
        told_.Turn();
        real_.Turn();
    }
    void WantTurn() override { real_.WantTurn(); }

  private:
    headless::ScriptedLoop& told_;
    qt::EventLoop real_;
};

/// The host for Qt with the clock, the boxes, the shell and the log of the headless host.
class QtTestHost final : public TestHost {
  public:
    explicit QtTestHost(frame::FileSystem* otherFiles) : lent_(otherFiles) { form_->show(); }
    QtTestHost(const QtTestHost&) = delete;
    QtTestHost& operator=(const QtTestHost&) = delete;
    ~QtTestHost() override {
        form_.reset();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    headless::HeadlessHost& Scripted() override { return lent_; }
    frame::Host& Frame() override { return host_->frameHost(); }
    frame::Object& Form() override { return qt::Form::of(*form_); }
    frame::Siblings& OnForm() override { return qt::Form::of(*form_); }

    frame::Control& Create(const frame::ControlClass& controlClass, const std::string& name,
                           const headless::Placing& placing) override {
        headless::ErrorList& errors = lent_.errors;
        const std::size_t reports = errors.reports.size();
        host_->setUserMode(!placing.designTime);
        form_->setFont(FormFont(placing.ambientFont ? placing.ambientFont : std::make_shared<frame::Font>()));
        ControlWidget& widget = Make(controlClass, placing);
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

    SiteUnderTest* SiteOf(const frame::Control& control) override { return Find(control); }
    SiteUnderTest* FindSite(std::string_view name) override {
        for (const auto& site : sites_)
            if (site->widget() && frame::EqualsNoCase(site->Name(), name)) return site.get();
        return nullptr;
    }
    void Destroy(frame::Control& control) override {
        if (QtSiteUnderTest* site = Find(control)) delete site->widget();
    }

  private:
    /// All services of the headless host but those that make the screen.
    frame::Services Scripted(frame::MessageLoop& loop) {
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
    QtSiteUnderTest* Find(const frame::Control& control) {
        for (const auto& site : sites_)
            if (site->widget() && &site->widget()->control() == &control) return site.get();
        return nullptr;
    }
    ControlWidget& Make(const frame::ControlClass& controlClass, const headless::Placing& placing) {
        const std::string_view name = controlClass.table->name;
        if (name == "DataList") return Placed<qt::DataList>(placing);
        if (name == "FileView") return Placed<qt::FileView>(placing);
        if (name == "FolderView") return Placed<qt::FolderView>(placing);
        if (name == "Link") return Placed<qt::Link>(placing);
        if (name == "ScoreCard") return Placed<qt::ScoreCard>(placing);
        if (name == "Splitter") return Placed<qt::Splitter>(placing);
        return Placed<OwnerWidget>(placing, controlClass);
    }
    template <class Widget, class... Class>
    ControlWidget& Placed(const headless::Placing& placing, const Class&... controlClass) {
        auto* widget = new Tapped<Widget>(lent_.log, placing, controlClass..., form_.get());
        sites_.push_back(std::make_unique<QtSiteUnderTest>(*widget, widget->handlers));
        return *widget;
    }

    headless::HeadlessHost lent_;
    ToldLoop loop_{lent_.loop, [this] { Frame().Settle(); }};
    std::shared_ptr<qt::Host> host_ = qt::Host::make(Scripted(loop_));
    std::unique_ptr<QWidget> form_ = [this] {
        auto form = std::make_unique<QWidget>();
        form->setObjectName("Form1");
        form->resize(800, 600);
        qt::Host::attach(form.get(), host_);
        return form;
    }();
    std::vector<std::unique_ptr<QtSiteUnderTest>> sites_;
};

}  // namespace

std::unique_ptr<TestHost> MakeTestHost(frame::FileSystem* otherFiles) { return std::make_unique<QtTestHost>(otherFiles); }

}  // namespace tessel::test
