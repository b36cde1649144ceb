#include "frame/ChildControl.h"

#include <algorithm>

#include "frame/Control.h"

namespace tessel::frame {

ChildControl::ChildControl(Control& owner, std::string name) : owner_(owner), host_(owner.Host()), name_(std::move(name)) {
    owner_.AddChild(*this);
}

ChildControl::~ChildControl() {
    owner_.RemoveChild(*this);
    if (touched_) host_.Forget(*this);
}

std::string ChildControl::Path() const { return owner_.Path() + "." + name_; }

bool ChildControl::IsAttached() const { return owner_.Site() != nullptr; }

void ChildControl::Move(float left, float top, float width, float height) {
    const float before[] = {left_, top_, width_, height_};
    Place(left, top, width, height);
    const float after[] = {left_, top_, width_, height_};
    if (!std::equal(std::begin(before), std::end(before), after)) Moved();
}

void ChildControl::Place(float left, float top, float width, float height) {
    left_ = left;
    top_ = top;
    width_ = width > 0 ? width : 0;
    height_ = height > 0 ? height : 0;
    Changed();
}

void ChildControl::AttachPeer(std::unique_ptr<frame::Peer> peer) {
    peer_ = std::move(peer);
    if (!peer_) return;
    PeerAttached();
    Changed();
}

void ChildControl::Changed() {
    if (!peer_ || touched_) return;
    touched_ = true;
    host_.Touch(*this);
}

}  // namespace tessel::frame
