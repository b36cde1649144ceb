#pragma once

#include "frame/ChildControl.h"
#include "frame/PointerTarget.h"

namespace tessel::child {

/// A child that is a target of input.
template <class Target>
class InputChild : public frame::ChildControl, public Target {
  public:
    using ChildControl::ChildControl;

    frame::Host& InputHost() const override { return Host(); }
    frame::TextSize InputExtent() const override { return {Width(), Height()}; }

  protected:
    bool TakesInput() const override { return IsAttached(); }
    std::string InputPath() const override { return Path(); }
};

/// The base of children that take the mouse. A peer reports what the user does; the events go to the child's control.
class PointerChild : public InputChild<frame::PointerTarget> {
  public:
    using InputChild::InputChild;
};

/// The base of children that take the keys too.
class KeyChild : public InputChild<frame::KeyTarget> {
  public:
    using InputChild::InputChild;
};

using frame::keyInputs;
using frame::pointerInputs;

}  // namespace tessel::child
