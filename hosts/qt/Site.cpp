#include "hosts/qt/Site.h"

#include "frame/Extender.h"
#include "frame/Text.h"
#include "hosts/qt/ControlWidget.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Form.h"

namespace tessel::qt {

/// Beside the geometry the host has the outer widget's tool tip, and its `Index` where the program has set that property.
class Site::WidgetExtender final : public frame::Extender {
  public:
    explicit WidgetExtender(Site& site) : Extender(site), site_(site), outer_(site) {}

    std::string Name() const override { return site_.outer_ ? FromQt(site_.outer_->objectName()) : std::string(); }
    bool Visible() const override { return site_.outer_ && !site_.outer_->isHidden(); }
    void SetVisible(bool value) override {
        if (site_.outer_) site_.outer_->setVisible(value);
    }

  protected:
    const Object& More() const override { return outer_; }

  private:
    class OuterMembers final : public frame::Object {
      public:
        explicit OuterMembers(Site& site) : site_(site) {}
        std::string ToolTipText() const { return site_.outer_ ? FromQt(site_.outer_->toolTip()) : std::string(); }
        void SetToolTipText(const std::string& value) {
            if (site_.outer_) site_.outer_->setToolTip(ToQt(value));
        }
        std::int32_t Index() const {
            const QVariant index = site_.outer_ ? site_.outer_->property("Index") : QVariant();
            if (!index.isValid()) throw frame::ControlError(frame::errors::noSuchMember);
            return index.toInt();
        }
        bool Has(frame::MemberKey key) const override {
            if (frame::EqualsNoCase(key.Name(), "Index")) return site_.outer_ && site_.outer_->property("Index").isValid();
            return Object::Has(key);
        }
        const frame::ClassTable& Table() const override {
            static constexpr std::array rows = {
                frame::property<&OuterMembers::ToolTipText, &OuterMembers::SetToolTipText>("ToolTipText"),
                frame::property<&OuterMembers::Index>("Index"),
            };
            static constexpr frame::ClassTable table{.name = "Extender", .members = rows};
            return table;
        }

      private:
        Site& site_;
    };

    Site& site_;
    OuterMembers outer_;
};

Site::Site(std::shared_ptr<qt::Host> host, ControlWidget& outer)
    : frame::Site(host->frameHost()),
      qt_(std::move(host)),
      outer_(&outer),
      surface_(new SurfaceWidget(&outer)),
      extender_(std::make_unique<WidgetExtender>(*this)) {
    surface_->resize(outer.size());
    surface_->show();
}

Site::~Site() {
    if (!surface_) return;
    surface_->Show(nullptr);
    surface_->deleteLater();
}

void Site::LetGo() {
    name_ = DisplayName();
    outer_ = nullptr;
    if (!surface_) return;
    surface_->hide();
    surface_->setParent(nullptr);
}

frame::Object& Site::Extender() { return *extender_; }

frame::Object* Site::Parent() { return outer_ ? &Form::of(*Host::formOf(outer_)) : nullptr; }

frame::Siblings& Site::ParentControls() {
    if (!outer_) frame::ThrowObjectGone();
    return Form::of(*Host::formOf(outer_));
}

void Site::PropertyChanged(std::string_view key) {
    if (outer_ && outer_->live_) outer_->propertyChanged(key);
}

void Site::Repaint() {
    if (surface_) surface_->Follow();
}

void Site::Redraw() {
    if (surface_) surface_->DrawAnew();
}

void Site::Placed() {
    if (outer_ && outer_->settled_) outer_->followPlace();
}

void Site::Sized() {
    if (outer_ && outer_->live_) outer_->followSize();
}

bool Site::UserMode() const { return qt_->userMode(); }

frame::FontRef Site::Font() const { return FromQt(outer_ ? Host::formOf(outer_)->font() : QFont()); }

std::string Site::DisplayName() const {
    if (!outer_) return name_;
    return outer_->objectName().isEmpty() ? outer_->metaObject()->className() : FromQt(outer_->objectName());
}

bool Site::Wants(const frame::EventInfo& event) const { return outer_ && outer_->live_ && outer_->hears(event); }

void Site::Raise(const frame::EventInfo& event, frame::EventArguments arguments) {
    if (outer_) outer_->raise(event, arguments);
}

}  // namespace tessel::qt
