#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "hosts/headless/HeadlessHost.h"
#include "hosts/posix/DiskFileSystem.h"

namespace tessel::bench {

/// One control on a host whose disk is the real one and whose message loop has nothing to do.
template <class ControlType>
class Stage {
  public:
    Stage(int width, int height) : view_(NewView()) {
        site_->Start(nullptr, static_cast<float>(width), static_cast<float>(height));
        site_->Show();
    }
    ~Stage() { frame_.Retire(std::move(site_)); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    ControlType& View() { return view_; }
    frame::Handlers& Handlers() { return handlers_; }
    void ForgetLog() { headless_.log.Clear(); }

  private:
    struct State final : frame::AmbientProperties {
        bool UserMode() const override { return true; }
        frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
        std::string DisplayName() const override { return "Control1"; }
    };
    struct Nobody final : frame::Siblings {
        int Count() const override { return 0; }
        frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }
    };
    struct Place final : frame::Site {
        explicit Place(Stage& stage) : Site(stage.frame_), handlers(stage.handlers_) {}
        const frame::AmbientProperties& Ambient() const override { return state; }
        frame::Object& Extender() override { return extender; }
        frame::Object* Parent() override { return nullptr; }
        frame::Siblings& ParentControls() override { return siblings; }
        void PropertyChanged(std::string_view) override {}
        frame::EventSink& Events() override { return handlers; }

        frame::Handlers& handlers;
        State state;
        Nobody siblings;
        headless::HostObject extender{"Control1", {}};
    };
    struct IdleLoop final : frame::MessageLoop {
        void Turn() override {}
    };
    /// A shell that keeps its icons, as those of desktops do.
    struct KeptIcons final : frame::PictureLoader {
        frame::PictureRef LoadPicture(const std::string&) override { return nullptr; }
        frame::PictureRef FileIcon(const std::string&, int flags) override { return flags & 1 ? small : large; }
        static frame::PictureRef Square(int side) {
            const auto pixels = static_cast<std::size_t>(side) * static_cast<std::size_t>(side);
            return std::make_shared<frame::Picture>(
                std::vector<frame::PixelPlane>{{1, side, side, std::vector<std::uint32_t>(pixels, 0xFFFF0000)}}, "");
        }
        frame::PictureRef small = Square(16), large = Square(32);
    };

    frame::Services Mixed() {
        frame::Services services = headless_.LentServices();
        services.loop = &loop_;
        services.pictures = &icons_;
        return services;
    }
    ControlType& NewView() {
        auto made = std::make_unique<ControlType>(frame_);
        ControlType& view = *made;
        site_->Adopt(std::move(made));
        return view;
    }

    posix::DiskFileSystem disk_;
    headless::HeadlessHost headless_{&disk_};
    IdleLoop loop_;
    KeptIcons icons_;
    frame::Handlers handlers_;
    frame::Host frame_{Mixed()};
    std::unique_ptr<Place> site_ = std::make_unique<Place>(*this);
    ControlType& view_;
};

}  // namespace tessel::bench
