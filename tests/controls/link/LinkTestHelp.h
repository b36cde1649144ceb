#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/link/Link.h"
#include "tests/HostUnderTest.h"

/// What the tests of the link share. All links are 2000 twips wide and 600 high, unless a test says otherwise.
namespace tessel::controls::linktest {

inline constexpr frame::OLE_COLOR blue = 0xC00000, red = 0x0000C0, purple = 0x800080;
inline constexpr std::int16_t leftButton = 1, rightButton = 2, middleButton = 4, noShift = 0;
inline constexpr float width = 2000, height = 600;

inline Link& NewLink(test::HostUnderTest& host, const std::string& name = "Link1") {
    return host.Create<Link>(name, {.width = width, .height = height});
}

inline Link& LoadedLink(test::HostUnderTest& host, const frame::PropertyBag& saved) {
    return host.Create<Link>("Link1", {.saved = &saved, .width = width, .height = height});
}

inline void MoveTo(Link& link, float x, float y) { link.Label1.MouseMoveInput(0, noShift, x, y); }
inline void MoveInside(Link& link) { MoveTo(link, 1000, 300); }
inline void MoveIntoStrip(Link& link) { MoveTo(link, 10, 300); }
inline void PressAt(Link& link, float x, float y) { link.Label1.MouseDownInput(leftButton, noShift, x, y); }
inline void PressInside(Link& link) { PressAt(link, 1000, 300); }
inline void PressInStrip(Link& link) { PressAt(link, 10, 300); }

/// The state that the colour of the text shows.
inline std::string Shown(const Link& link) {
    const frame::OLE_COLOR color = link.Label1.ForeColor();
    if (color == link.ForeColor()) return "unused";
    if (color == link.HighlightColor()) return "hovered";
    return color == link.UsedColor() ? "used" : "neither";
}

/// Whether the active area has the point, as the colour tells.
inline bool Highlights(Link& link, float x, float y) {
    link.SetForeColor(link.ForeColor());
    MoveTo(link, x, y);
    return Shown(link) == "hovered";
}

/// Whether the link counts as used: leaves the mouse in the strip.
inline bool IsUsed(Link& link) {
    MoveIntoStrip(link);
    return Shown(link) == "used";
}

/// The second values of the entries of a kind, from `first` on, as text.
inline std::vector<std::string> Told(const headless::Log& log, std::string_view kind, std::size_t first) {
    std::vector<std::string> lines;
    for (const auto& entry : log.Of(kind)) lines.push_back(entry.at(first).ToText());
    return lines;
}
inline std::vector<std::string> Changes(const test::HostUnderTest& host) { return Told(host.log, "changed", 2); }
inline std::vector<std::string> Boxes(const test::HostUnderTest& host) { return Told(host.log, "msgbox", 1); }

/// What the shell was asked for: "open a.txt".
inline std::vector<std::string> Requests(const test::HostUnderTest& host) {
    std::vector<std::string> lines;
    for (const auto& entry : host.log.Of("execute")) lines.push_back(entry.at(1).ToText() + " " + entry.at(2).ToText());
    return lines;
}

/// The arguments of the last event, as text: "1 0 1000 300".
inline std::string LastArguments(const test::HostUnderTest& host) {
    std::string line;
    for (const auto& value : host.log.Of("event").back().at(3).ToArray().items) line += (line.empty() ? "" : " ") + value.ToText();
    return line;
}

/// A host with one link, of which a test sees more: what is reported and repainted at the moment at which it is, and code
/// that runs while a box stands or the shell works. A text is ten times the font's size wide for each character.
class WatchedHost {
  public:
    explicit WatchedHost(const frame::PropertyBag* saved = nullptr) {
        auto made = std::make_unique<WatchedSite>(*this);
        site_ = made.get();
        owned_ = std::move(made);
        site_->Adopt(std::make_unique<Link>(frame_));
        site_->Start(saved, width, height);
        site_->Show();
        Flush();
        repaints = 0;
    }
    ~WatchedHost() { DestroyLink(); }
    WatchedHost(const WatchedHost&) = delete;
    WatchedHost& operator=(const WatchedHost&) = delete;

    Link& TheLink() { return static_cast<Link&>(site_->Control()); }
    frame::Handlers& ApplicationHandlers() { return site_->handlers; }
    void DestroyLink() {
        if (owned_) frame_.Retire(std::move(owned_));
    }
    void Flush() { frame_.Flush(); }

    std::function<void(std::string_view key)> onPropertyChanged;
    std::function<void()> whileBoxStands, whileShellWorks;
    std::vector<std::string> boxes, requests;
    int shellResult = 33;
    int repaints = 0;
    headless::HeadlessHost others;  ///< lends the services that no test of the link watches

  private:
    struct Nobody final : frame::Siblings {
        int Count() const override { return 0; }
        frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }
    };
    struct RunTime final : frame::AmbientProperties {
        bool UserMode() const override { return true; }
        frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
        std::string DisplayName() const override { return "Link1"; }
    };
    struct WatchedSite final : frame::Site {
        explicit WatchedSite(WatchedHost& watched) : Site(watched.frame_), host(watched) {}
        const frame::AmbientProperties& Ambient() const override { return ambient; }
        frame::Object& Extender() override { return extender; }
        frame::Object* Parent() override { return nullptr; }
        frame::Siblings& ParentControls() override { return siblings; }
        void PropertyChanged(std::string_view key) override {
            if (host.onPropertyChanged) host.onPropertyChanged(key);
        }
        frame::EventSink& Events() override { return handlers; }

        WatchedHost& host;
        RunTime ambient;
        headless::HostObject extender{"Link1", {}};
        Nobody siblings;
        frame::Handlers handlers;
    };
    struct Boxing final : frame::Dialogs {
        explicit Boxing(WatchedHost& watched) : host(watched) {}
        int MsgBox(const std::string& text, int, const std::string&) override {
            host.boxes.push_back(text);
            RunOnce(host.whileBoxStands);
            return frame::msgbox::answerOk;
        }
        void ShowOpen(const std::string&, const std::string&, std::string&) override {}
        void ShowModal(frame::Object&) override {}
        WatchedHost& host;
    };
    struct Shelling final : frame::Shell {
        explicit Shelling(WatchedHost& watched) : host(watched) {}
        int Execute(std::string_view verb, const std::string& target) override {
            const int result = host.shellResult;
            host.requests.push_back(std::string(verb) + " " + target);
            RunOnce(host.whileShellWorks);
            return result;
        }
        frame::FileOperationResult Run(const frame::FileOperation&) override { return {}; }
        WatchedHost& host;
    };
    struct FontMetrics final : frame::TextMetrics {
        frame::TextSize Measure(const frame::Font& font, std::string_view text, std::optional<float>) override {
            const auto size = static_cast<float>(font.Size());
            return {static_cast<float>(text.size()) * size * 10, size * 20};
        }
    };
    struct CountingPeers final : frame::PeerFactory {
        struct Counter final : frame::Peer {
            explicit Counter(WatchedHost& watched) : host(watched) {}
            void Update() override { ++host.repaints; }
            WatchedHost& host;
        };
        explicit CountingPeers(WatchedHost& watched) : host(watched) {}
        std::unique_ptr<frame::Peer> MakePeer(frame::ChildControl&) override { return std::make_unique<Counter>(host); }
        std::unique_ptr<frame::Canvas> MakeCanvas(frame::DrawingSurface&, frame::Object&) override { return nullptr; }
        WatchedHost& host;
    };

    static void RunOnce(std::function<void()>& action) {
        if (const auto run = std::exchange(action, nullptr)) run();
    }

    Boxing dialogs_{*this};
    Shelling shell_{*this};
    FontMetrics metrics_;
    CountingPeers peers_{*this};
    frame::Services Mixed() {
        frame::Services services = others.LentServices();
        services.dialogs = &dialogs_;
        services.metrics = &metrics_;
        services.shell = &shell_;
        services.peers = &peers_;
        return services;
    }
    frame::Host frame_{Mixed()};
    std::unique_ptr<frame::Site> owned_;
    WatchedSite* site_ = nullptr;
};

}  // namespace tessel::controls::linktest
