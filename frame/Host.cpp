#include <algorithm>
#include <cassert>

#include "frame/ChildControl.h"
#include "frame/Control.h"
#include "frame/Site.h"
#include "frame/host.h"

namespace tessel::frame {

Host::Host(const Services& services) : services_(services) {
    assert(services.loop && services.dialogs && services.menus && services.drag && services.focus && services.clock &&
           services.random && services.locale && services.codePage && services.pictures && services.metrics && services.colors &&
           services.application && services.files && services.shell && services.clipboard && services.peers && services.errors);
}

Host::~Host() { FreeRetired(); }

void Host::Turn() {
    const LoopCall call(*this);
    services_.loop->Turn();
}

int Host::MsgBox(const std::string& text, int style, const std::string& title) {
    const LoopCall call(*this);
    return services_.dialogs->MsgBox(text, style, title);
}

void Host::ShowOpen(const std::string& title, const std::string& filter, std::string& fileName) {
    const LoopCall call(*this);
    services_.dialogs->ShowOpen(title, filter, fileName);
}

void Host::ShowModal(Object& form) {
    const LoopCall call(*this);
    services_.dialogs->ShowModal(form);
}

void Host::Popup(Object& menu, Object* defaultEntry) {
    const LoopCall call(*this);
    services_.menus->Popup(menu, defaultEntry);
}

void Host::StartDrag(ChildControl& source) {
    const LoopCall call(*this);
    services_.drag->Start(source);
}

int Host::Execute(std::string_view verb, const std::string& target) {
    const LoopCall call(*this);
    return services_.shell->Execute(verb, target);
}

FileOperationResult Host::Run(const FileOperation& operation) {
    const LoopCall call(*this);
    return services_.shell->Run(operation);
}

void Host::Unhandled(const ControlError& error, const std::string& where) { services_.errors->Unhandled(error, where); }

void Host::Flush() {
    if (flushing_) return;
    struct Flushing {
        explicit Flushing(bool& running) : flag(running) { running = true; }
        ~Flushing() { flag = false; }
        bool& flag;
    } const running(flushing_);
    const Callout callout(*this);
    while (!touched_.empty()) {
        ChildControl* child = touched_.front();
        touched_.pop_front();
        child->touched_ = false;
        if (!child->peer_) continue;
        try {
            child->peer_->Update();
        } catch (const ControlError& error) {
            Unhandled(error, child->Path() + ".Update");
        } catch (const std::exception& error) {
            Unhandled(ControlError(errors::internal, error.what()), child->Path() + ".Update");
        }
    }
}

void Host::Settle() {
    Flush();
    if (depth_ == 0) FreeRetired();
}

void Host::Touch(ChildControl& child) {
    touched_.push_back(&child);
    if (entries_ == 0) services_.loop->WantTurn();
}

void Host::Forget(ChildControl& child) { std::erase(touched_, &child); }

void Host::Retire(std::unique_ptr<Site> site) {
    site->Detach();
    retired_.push_back(std::move(site));
    if (depth_ == 0)
        FreeRetired();
    else
        services_.loop->WantTurn();
}

void Host::FreeRetired() {
    while (!retired_.empty()) {
        const auto leaving = std::move(retired_);
        retired_.clear();
    }
}

}  // namespace tessel::frame
