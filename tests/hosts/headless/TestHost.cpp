#include <map>

#include "tests/HostUnderTest.h"

namespace tessel::test {
namespace {

class HeadlessSiteUnderTest final : public SiteUnderTest {
  public:
    explicit HeadlessSiteUnderTest(headless::HeadlessSite& site) : site_(site) {}

    frame::Control& Control() const override { return site_.Control(); }
    frame::Handlers& ApplicationHandlers() override { return site_.ApplicationHandlers(); }
    std::string Name() const override { return site_.Name(); }
    bool Visible() const override { return site_.Visible(); }
    void SetVisible(bool value) override { site_.SetVisible(value); }
    void SetUserMode(bool value) override { site_.SetUserMode(value); }
    void SetDisplayName(const std::string& name) override { site_.SetDisplayName(name); }
    void SetAmbientFont(const frame::FontRef& font) override { site_.SetAmbientFont(font); }

  private:
    headless::HeadlessSite& site_;
};

class HeadlessTestHost final : public TestHost {
  public:
    explicit HeadlessTestHost(frame::FileSystem* otherFiles) : host_(otherFiles) {}

    headless::HeadlessHost& Scripted() override { return host_; }
    frame::Host& Frame() override { return host_.Frame(); }
    frame::Object& Form() override { return host_.Form(); }
    frame::Siblings& OnForm() override { return host_.Form(); }
    frame::Control& Create(const frame::ControlClass& controlClass, const std::string& name,
                           const headless::Placing& placing) override {
        return host_.Create(controlClass, name, placing);
    }
    SiteUnderTest* SiteOf(const frame::Control& control) override { return Of(host_.SiteOf(control)); }
    SiteUnderTest* FindSite(std::string_view name) override { return Of(host_.FindSite(name)); }
    void Destroy(frame::Control& control) override { host_.Destroy(control); }

  private:
    SiteUnderTest* Of(headless::HeadlessSite* site) {
        if (!site) return nullptr;
        auto& found = sites_[site];
        if (!found) found = std::make_unique<HeadlessSiteUnderTest>(*site);
        return found.get();
    }

    headless::HeadlessHost host_;
    std::map<headless::HeadlessSite*, std::unique_ptr<SiteUnderTest>> sites_;
};

}  // namespace

std::unique_ptr<TestHost> MakeTestHost(frame::FileSystem* otherFiles) { return std::make_unique<HeadlessTestHost>(otherFiles); }

}  // namespace tessel::test
