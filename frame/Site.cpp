#include "frame/Site.h"

#include "frame/Control.h"
#include "frame/ResumeNext.h"
#include "frame/SiblingIndex.h"
#include "frame/Text.h"

namespace tessel::frame {

Object* Siblings::Find(std::string_view name, std::int32_t index) {
    for (int i = 0; i < Count(); ++i) {
        Object* item = nullptr;
        ResumeNext next;
        next([&] { item = &Item(i); });
        if (!item) continue;
        const auto itsName = NameOf(*item);
        if (!itsName || !EqualsNoCase(*itsName, name)) continue;
        if (index < 0 || IndexOf(*item) == index) return item;
    }
    return nullptr;
}

Site::Site(frame::Host& host) : host_(host) {}

Site::~Site() {
    Detach();
    if (control_) control_->DropPeers();
}

void Site::SetPlace(float left, float top) {
    if (left == left_ && top == top_) return;
    left_ = left;
    top_ = top;
    const Callout callout(host_);
    Placed();
}

void Site::SetSize(float width, float height) {
    width = width > 0 ? width : 0;
    height = height > 0 ? height : 0;
    if (width == width_ && height == height_) return;
    width_ = width;
    height_ = height;
    const Callout callout(host_);
    Sized();
    if (!control_) return;
    control_->Surface().SizeChanged();
    control_->Resize();
}

void Site::Adopt(std::unique_ptr<frame::Control> control) {
    control_ = std::move(control);
    control_->site_ = this;
    const auto size = control_->DesignSize();
    width_ = size.width;
    height_ = size.height;
    control_->Surface().AddCanvas(host_.Peers().MakeCanvas(control_->Surface(), *control_));
    control_->TakePeers();
    control_->Initialize();
    control_->TakePeers();  // of the children that it has made
}

void Site::Start(const PropertyBag* saved, std::optional<float> width, std::optional<float> height) {
    const Callout callout(host_);
    if (saved)
        control_->ReadProperties(*saved);
    else
        control_->InitProperties();
    const auto extent = [](float given) { return given > 0 ? given : 0; };
    width_ = extent(width.value_or(width_));
    height_ = extent(height.value_or(height_));
    Sized();
    control_->Surface().SizeChanged();
    control_->Resize();
}

void Site::Show() { control_->Show(); }
void Site::Hide() { control_->Hide(); }
void Site::Paint() { control_->Paint(); }
void Site::AmbientChanged(const std::string& name) { control_->AmbientChanged(name); }
void Site::Save(PropertyBag& bag) { control_->WriteProperties(bag); }

void Site::Detach() {
    if (control_) control_->site_ = nullptr;
}

}  // namespace tessel::frame
