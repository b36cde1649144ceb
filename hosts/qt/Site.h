#pragma once

#include <QPointer>
#include <memory>
#include <string>

#include "frame/Site.h"
#include "hosts/qt/Host.h"
#include "hosts/qt/SurfaceWidget.h"

namespace tessel::qt {

class ControlWidget;

/// The place of one control on the Qt host: it stands between the control and the outer widget, which a program knows. It owns the
/// surface on which the children stand, and may outlive the outer widget while a call into the control is running.
class Site final : public frame::Site, private frame::EventSink, private frame::AmbientProperties {
  public:
    Site(std::shared_ptr<qt::Host> host, ControlWidget& outer);
    ~Site() override;

    SurfaceWidget* surface() const { return surface_; }
    /// The outer widget; null once it has let go.
    ControlWidget* outer() const { return outer_; }
    /// The outer widget goes, or takes another control: from now on nothing of it is touched.
    void LetGo();

    const frame::AmbientProperties& Ambient() const override { return *this; }
    frame::Object& Extender() override;
    frame::Object* Parent() override;
    frame::Siblings& ParentControls() override;
    void PropertyChanged(std::string_view key) override;
    frame::EventSink& Events() override { return *this; }
    std::string Path() const override { return DisplayName(); }
    void Repaint() override;
    void Redraw() override;

  protected:
    void Placed() override;
    void Sized() override;

  private:
    class WidgetExtender;

    bool UserMode() const override;
    frame::FontRef Font() const override;
    std::string DisplayName() const override;
    bool Wants(const frame::EventInfo& event) const override;
    void Raise(const frame::EventInfo& event, frame::EventArguments arguments) override;

    std::shared_ptr<qt::Host> qt_;
    ControlWidget* outer_;
    std::string name_;  // that the outer widget had
    QPointer<SurfaceWidget> surface_;
    std::unique_ptr<WidgetExtender> extender_;
};

}  // namespace tessel::qt
