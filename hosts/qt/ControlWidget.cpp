#include "hosts/qt/ControlWidget.h"

#include <QEvent>
#include <QFontMetrics>
#include <QHideEvent>
#include <QLayout>
#include <QShowEvent>

#include "frame/Text.h"
#include "hosts/qt/BagText.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Site.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

namespace {

bool Holds(const QLayout& layout, QWidget* widget) {
    if (layout.indexOf(widget) >= 0) return true;
    for (int i = 0; i < layout.count(); ++i) {
        const QLayout* inner = layout.itemAt(i)->layout();
        if (inner && Holds(*inner, widget)) return true;
    }
    return false;
}

}  // namespace

ControlWidget::ControlWidget(const frame::ControlClass& controlClass, QWidget* parent)
    : QWidget(parent), class_(controlClass), host_(Host::of(parent)) {
    adopt();
    connect(host_.get(), &Host::userModeChanged, this, [this] { ambientChanged("UserMode"); });
    connect(this, &QObject::objectNameChanged, this, [this] { ambientChanged("DisplayName"); });
}

ControlWidget::~ControlWidget() {
    site_->LetGo();
    host_->frameHost().Retire(std::move(site_));
}

template <class F>
void ControlWidget::enter(const char* where, F&& call) const {
    // The call may end this widget; its site lives until the call has ended.
    const std::shared_ptr<Host> host = host_;
    Site* const site = site_.get();
    frame::Entry::Run(
        host->frameHost(), [&] { return site->Path() + "." + where; }, [&] { call(*site); });
}

frame::Control& ControlWidget::control() const {
    settle();
    return site_->Control();
}

frame::Object& ControlWidget::extender() const {
    settle();
    return site_->Extender();
}

// The control's life.

void ControlWidget::adopt() {
    site_ = std::make_unique<Site>(host_, *this);
    enter("Initialize", [&](Site& site) { site.Adopt(class_.make(host_->frameHost())); });
    site_->surface()->Show(&site_->Control(), [this] {
        if (settled_) enter("Paint", [](Site& site) { site.Paint(); });
    });
    site_->surface()->setAttribute(Qt::WA_TransparentForMouseEvents, designTime());
}

void ControlWidget::place(const frame::PropertyBag* saved) {
    const bool sized = testAttribute(Qt::WA_Resized);
    std::optional<float> width, height;
    if (settled_) {  // a loaded state belongs to a fresh control
        takeSize();
        width = site_->Width();
        height = site_->Height();
        const float left = site_->Left(), top = site_->Top();
        live_ = settled_ = false;
        site_->LetGo();
        host_->frameHost().Retire(std::move(site_));
        adopt();
        site_->SetPlace(left, top);
    } else if (sized) {
        width = Twips(this->width());
        height = Twips(this->height());
        site_->SetPlace(Twips(x()), Twips(y()));
    }
    settled_ = live_ = true;
    taken_ = size();
    const QPointer<ControlWidget> alive = this;
    enter(saved ? "ReadProperties" : "InitProperties", [&](Site& site) { site.Start(saved, width, height); });
    if (!alive) return;
    followFirstLook(saved ? Came::Loaded : Came::New);
    if (!alive) return;
    started();
    if (shown_) enter("Show", [](Site& site) { site.Show(); });
}

/// What the widget and the control both know is brought together.
void ControlWidget::followFirstLook(Came came) {
    const QPointer<ControlWidget> alive = this;
    if (came == Came::New && testAttribute(Qt::WA_SetFont) && class_.table->Find("Font")) put("Font", font());
    if (!alive || !class_.table->Find("Enabled")) return;
    if (testAttribute(Qt::WA_ForceDisabled))
        put("Enabled", false);
    else if (!designTime())
        setEnabled(controlEnabled());
}

void ControlWidget::settle() const {
    auto& self = const_cast<ControlWidget&>(*this);
    if (!settled_) return self.place(nullptr);
    self.takeSize();
    self.takePlace();
}

void ControlWidget::ambientChanged(const std::string& name) {
    if (name == "UserMode") site_->surface()->setAttribute(Qt::WA_TransparentForMouseEvents, designTime());
    if (!settled_) return;
    const QPointer<ControlWidget> alive = this;
    enter("AmbientChanged", [&](Site& site) { site.AmbientChanged(name); });
    if (alive && name == "UserMode" && !designTime() && class_.table->Find("Enabled")) setEnabled(controlEnabled());
}

// Properties, methods and saved state by name.

QVariant ControlWidget::get(const char* member) const {
    settle();
    QVariant value;
    enter(member, [&](Site& site) {
        const frame::Member* row = class_.table->Find(member);
        value = ToQt(site.Control().Get(member), row ? row->type : frame::TypeInfo(), site.Host().Colors());
    });
    return value;
}

void ControlWidget::put(const char* member, const QVariant& value) {
    settle();
    enter(member, [&](Site& site) { site.Control().Put(member, FromQt(value)); });
}

QVariant ControlWidget::call(const char* member, const QVariantList& arguments) {
    settle();
    QVariant result;
    enter(member, [&](Site& site) {
        std::vector<frame::Variant> values;
        for (const QVariant& argument : arguments) values.push_back(FromQt(argument));
        const frame::Member* row = class_.table->Find(member);
        result = ToQt(site.Control().Call(member, values), row ? row->type : frame::TypeInfo(), site.Host().Colors());
    });
    return result;
}

void ControlWidget::propertyChanged(std::string_view key) {
    if (key == "Enabled" && !designTime()) setEnabled(controlEnabled());
}

QByteArray ControlWidget::bag() const {
    settle();
    QByteArray text;
    enter("WriteProperties", [&](Site& site) {
        frame::MemoryBag saved;
        site.Save(saved);
        text = BagText(saved);
    });
    return text;
}

void ControlWidget::setBag(const QByteArray& bag) {
    std::optional<frame::MemoryBag> saved;
    if (!bag.isEmpty()) {
        enter("bag", [&](Site&) { saved = BagOf(bag); });
        if (!saved) return;
    }
    if (saved || settled_) place(saved ? &*saved : nullptr);
}

QSize ControlWidget::textArea(int letters, int lines) const {
    const QFontMetrics metrics = fontMetrics();
    return {letters * metrics.averageCharWidth(), lines * metrics.lineSpacing()};
}

void ControlWidget::giveFocusTo(const frame::ChildControl& child) {
    if (const auto* peer = dynamic_cast<const WidgetPeer*>(child.Peer())) setFocusProxy(peer->widget());
}

void ControlWidget::setPointer(const QCursor& pointer) { site_->surface()->SetPointer(pointer); }

// Size and place.

// A designer asks before it has loaded the control, which must not be settled by that.
QSize ControlWidget::sizeHint() const {
    const QSize own = PixelRect(0, 0, site_->Width(), site_->Height()).size();
    if (!settled_) return own;
    const QSize preferred = sizesItself() ? own : preferredSize();
    return preferred.isValid() ? preferred : own;
}

bool ControlWidget::inLayout() const {
    const QWidget* parent = parentWidget();
    return parent && !isWindow() && parent->layout() && Holds(*parent->layout(), const_cast<ControlWidget*>(this));
}

// A widget that is not shown hears of its new size only when it is: so the size is asked, not awaited.
void ControlWidget::takeSize() {
    if (!settled_ || size() == taken_ || !testAttribute(Qt::WA_Resized)) return;
    taken_ = size();
    enter("Resize", [&](Site& site) { site.SetSize(Twips(width()), Twips(height())); });
}

// In a layout the widget keeps the size that it was given, and the control stands in it as large as it likes.
void ControlWidget::followSize() {
    const QSize own = PixelRect(0, 0, site_->Width(), site_->Height()).size();
    if (!inLayout()) {
        taken_ = own;
        if (size() != own) resize(own);
    } else {
        updateGeometry();
    }
    const int left = layoutDirection() == Qt::RightToLeft ? width() - own.width() : 0;
    site_->surface()->setGeometry(QRect({left, 0}, own));
}

void ControlWidget::followPlace() {
    const QPoint place(Pixels(site_->Left()), Pixels(site_->Top()));
    if (pos() != place) move(place);
}

void ControlWidget::resizeEvent(QResizeEvent*) {
    takeSize();
    if (settled_) followSize();
}

void ControlWidget::moveEvent(QMoveEvent*) { takePlace(); }

void ControlWidget::takePlace() {
    if (!settled_ || pos() == QPoint(Pixels(site_->Left()), Pixels(site_->Top()))) return;
    enter("Move", [&](Site& site) { site.SetPlace(Twips(x()), Twips(y())); });
}

void ControlWidget::showEvent(QShowEvent* event) {
    if (event->spontaneous()) return;
    settle();
    shown_ = true;
    enter("Show", [](Site& site) { site.Show(); });
}

void ControlWidget::hideEvent(QHideEvent* event) {
    if (event->spontaneous() || !settled_ || !shown_) return;
    shown_ = false;
    enter("Hide", [](Site& site) { site.Hide(); });
}

void ControlWidget::keyPressEvent(QKeyEvent* event) {
    const QPointer<ControlWidget> alive = this;
    if (!designTime()) site_->surface()->ReportKey(*event);
    if (alive) QWidget::keyPressEvent(event);
}

// The surface shows the focus where the control takes the keys there.
void ControlWidget::focusInEvent(QFocusEvent* event) {
    QWidget::focusInEvent(event);
    site_->surface()->update();
}

void ControlWidget::focusOutEvent(QFocusEvent* event) {
    QWidget::focusOutEvent(event);
    site_->surface()->update();
}

bool ControlWidget::event(QEvent* event) {
    if (event->type() == QEvent::Polish) settle();
    return QWidget::event(event);
}

void ControlWidget::changeEvent(QEvent* event) {
    QWidget::changeEvent(event);
    if (!settled_) return;
    switch (event->type()) {
        case QEvent::EnabledChange:
            takeEnabled();
            break;
        case QEvent::FontChange:
            if (testAttribute(Qt::WA_SetFont))
                put("Font", font());
            else
                ambientChanged("Font");
            break;
        case QEvent::LayoutDirectionChange:
            followSize();
            break;
        default:
            break;
    }
}

void ControlWidget::takeEnabled() {
    if (designTime() || !class_.table->Find("Enabled")) return;
    const bool enabled = isEnabledTo(parentWidget());
    if (controlEnabled() != enabled) setControlEnabled(enabled);
}

}  // namespace tessel::qt
