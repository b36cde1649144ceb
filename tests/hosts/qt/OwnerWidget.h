#pragma once

#include <memory>

#include "hosts/qt/ControlWidget.h"

namespace tessel::qt::test {

/// A control of the tests as a widget, which nobody listens to.
template <class Owner>
class OwnerWidget : public ControlWidget {
  public:
    explicit OwnerWidget(QWidget* parent) : ControlWidget(Class(), parent) {}
    Owner& owner() const { return static_cast<Owner&>(control()); }

  protected:
    bool hears(const frame::EventInfo&) const override { return false; }
    void raise(const frame::EventInfo&, frame::EventArguments) override {}

  private:
    static const frame::ControlClass& Class() {
        static constexpr frame::ClassTable table{.name = "Owner", .members = {}};
        static const frame::ControlClass controlClass{
            &table, [](frame::Host& host) -> std::unique_ptr<frame::Control> { return std::make_unique<Owner>(host); }};
        return controlClass;
    }
};

}  // namespace tessel::qt::test
