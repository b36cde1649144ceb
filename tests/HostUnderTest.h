#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "frame/Control.h"
#include "hosts/headless/HeadlessHost.h"

/// Tests of controls run on the headless host, and the same tests again on the host for Qt: they name it `test::HostUnderTest`, and
/// what they are linked with makes it one or the other.
namespace tessel::test {

/// The place of a control on the host.
class SiteUnderTest {
  public:
    virtual ~SiteUnderTest() = default;
    virtual frame::Control& Control() const = 0;
    /// The application's handlers.
    virtual frame::Handlers& ApplicationHandlers() = 0;
    virtual std::string Name() const = 0;
    virtual bool Visible() const = 0;
    virtual void SetVisible(bool value) = 0;
    virtual void SetUserMode(bool value) = 0;
    virtual void SetDisplayName(const std::string& name) = 0;
    virtual void SetAmbientFont(const frame::FontRef& font) = 0;

    frame::Object& Extender() { return Site().Extender(); }
    float Left() const { return Site().Left(); }
    float Top() const { return Site().Top(); }
    float Width() const { return Site().Width(); }
    float Height() const { return Site().Height(); }
    void SetPlace(float left, float top) { Site().SetPlace(left, top); }
    void SetSize(float width, float height) { Site().SetSize(width, height); }

  private:
    frame::Site& Site() const { return *Control().Site(); }
};

/// What each of the two hosts does for tests. `Scripted` has the clock, the boxes, the shell, the disk and the log.
class TestHost {
  public:
    virtual ~TestHost() = default;
    virtual headless::HeadlessHost& Scripted() = 0;
    virtual frame::Host& Frame() = 0;
    virtual frame::Object& Form() = 0;
    virtual frame::Siblings& OnForm() = 0;
    virtual frame::Control& Create(const frame::ControlClass& controlClass, const std::string& name,
                                   const headless::Placing& placing) = 0;
    virtual SiteUnderTest* SiteOf(const frame::Control& control) = 0;
    virtual SiteUnderTest* FindSite(std::string_view name) = 0;
    virtual void Destroy(frame::Control& control) = 0;
};
std::unique_ptr<TestHost> MakeTestHost(frame::FileSystem* otherFiles);

class HostUnderTest {
    std::unique_ptr<TestHost> host_;
    headless::HeadlessHost& scripted_ = host_->Scripted();

  public:
    /// `otherFiles` takes the place of the memory disk, where there is one.
    explicit HostUnderTest(frame::FileSystem* otherFiles = nullptr) : host_(MakeTestHost(otherFiles)) {}

    frame::Host& Frame() { return host_->Frame(); }
    operator frame::Host&() { return Frame(); }
    /// The form that holds what is created.
    frame::Object& Form() { return host_->Form(); }
    frame::Siblings& OnForm() { return host_->OnForm(); }

    /// Makes, loads and shows a control. An error of its load passes to the caller, and the control is gone.
    frame::Control& Create(const frame::ControlClass& controlClass, const std::string& name,
                           const headless::Placing& placing = {}) {
        return host_->Create(controlClass, name, placing);
    }
    template <class C>
    C& Create(const std::string& name, const headless::Placing& placing = {}) {
        return static_cast<C&>(Create(ClassOf<C>(), name, placing));
    }
    /// The site of a control that was created here and not yet destroyed; null otherwise.
    SiteUnderTest* SiteOf(const frame::Control& control) { return host_->SiteOf(control); }
    SiteUnderTest* FindSite(std::string_view name) { return host_->FindSite(name); }
    void Destroy(frame::Control& control) { host_->Destroy(control); }
    static frame::MemoryBag Save(frame::Control& control) { return headless::HeadlessHost::Save(control); }

    headless::Log& log = scripted_.log;
    headless::VirtualClock& clock = scripted_.clock;
    headless::ScriptedLoop& loop = scripted_.loop;
    headless::ScriptedDialogs& dialogs = scripted_.dialogs;
    headless::ScriptedShell& shell = scripted_.shell;
    headless::ScriptedRandom& random = scripted_.random;
    headless::FixedMetrics& metrics = scripted_.metrics;
    headless::ScriptedPictures& pictures = scripted_.pictures;
    headless::MemoryDisk& files = scripted_.files;
    headless::ErrorList& errors = scripted_.errors;

  private:
    template <class C>
    static const frame::ControlClass& ClassOf() {
        static const frame::ControlClass controlClass{&TableOf<C>(), &Make<C>};
        return controlClass;
    }
    template <class C>
    static std::unique_ptr<frame::Control> Make(frame::Host& host) {
        return std::make_unique<C>(host);
    }
    template <class C>
    static const frame::ClassTable& TableOf() {
        if constexpr (requires { C::table; }) {
            return C::table;
        } else {  // a control of the tests
            static constexpr frame::ClassTable table{.name = "Owner", .members = {}};
            return table;
        }
    }
};

}  // namespace tessel::test
