#include "hosts/qt/Host.h"

#include <QApplication>
#include <QPointer>
#include <QWidget>

#include "frame/Control.h"
#include "frame/Windows1252.h"
#include "frame/child/PictureBox.h"
#include "hosts/posix/DiskFileSystem.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Services.h"
#include "hosts/qt/Site.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

Q_LOGGING_CATEGORY(errorLog, "tessel.controls")

namespace {

constexpr const char* holderName = "qt_tessel_host";
constexpr const char* formProperty = "qt_tessel_is_form";

/// Keeps a host for a widget or the application.
struct Holder final : QObject {
    explicit Holder(QObject* parent) : QObject(parent) { setObjectName(holderName); }
    std::shared_ptr<Host> host;
};

Holder* HolderOf(const QObject* object) {
    return object ? static_cast<Holder*>(object->findChild<QObject*>(holderName, Qt::FindDirectChildrenOnly)) : nullptr;
}

/// Children are shown as widgets, a control's own drawing on its surface.
struct Peers final : frame::PeerFactory {
    std::unique_ptr<frame::Peer> MakePeer(frame::ChildControl& child) override { return qt::MakePeer(child); }
    std::unique_ptr<frame::Canvas> MakeCanvas(frame::DrawingSurface& surface, frame::Object& owner) override {
        if (dynamic_cast<child::PictureBox*>(&owner)) return std::make_unique<SurfaceCanvas>(surface);
        auto* control = dynamic_cast<frame::Control*>(&owner);
        if (!control || &surface != &control->Surface()) return nullptr;
        SurfaceWidget& widget = *static_cast<Site*>(control->Site())->surface();
        auto canvas = std::make_unique<SurfaceCanvas>(surface, widget);
        widget.canvas = canvas.get();
        return canvas;
    }
};

}  // namespace

struct Host::Private final : frame::ErrorSink {
    explicit Private(Host& owner) : host(owner), loop([this] { frameHost->Settle(); }) {}

    void Unhandled(const frame::ControlError& error, const std::string& where) override {
        qCWarning(errorLog, "%s: error %d, %s", where.c_str(), error.Number(), error.Description().c_str());
        emit host.unhandledError(error.Number(), ToQt(error.Description()), ToQt(where));
    }

    Host& host;
    EventLoop loop;
    WidgetDialogs dialogs;
    Unoffered unoffered;
    WidgetFocus focus;
    SystemClock clock;
    Generator random;
    UserLocale locale;
    frame::Windows1252 codePage;
    ImageLoader pictures;
    FontMetrics metrics;
    PaletteColors colors;
    posix::DiskFileSystem files;
    Program application;
    DesktopShell shell;
    Peers peers;
    bool userMode = true;
    std::unique_ptr<frame::Host> frameHost;
};

Host::Host(const frame::Services& replaced) : d(std::make_unique<Private>(*this)) {
    const auto either = [](auto* given, auto* own) -> decltype(given) { return given ? given : own; };
    d->frameHost = std::make_unique<frame::Host>(frame::Services{
        .loop = either(replaced.loop, &d->loop),
        .dialogs = either(replaced.dialogs, &d->dialogs),
        .menus = either(replaced.menus, &d->unoffered),
        .drag = either(replaced.drag, &d->unoffered),
        .focus = either(replaced.focus, &d->focus),
        .clock = either(replaced.clock, &d->clock),
        .random = either(replaced.random, &d->random),
        .locale = either(replaced.locale, &d->locale),
        .codePage = either(replaced.codePage, &d->codePage),
        .pictures = either(replaced.pictures, &d->pictures),
        .metrics = either(replaced.metrics, &d->metrics),
        .colors = either(replaced.colors, &d->colors),
        .application = either(replaced.application, &d->application),
        .files = either(replaced.files, &d->files),
        .shell = either(replaced.shell, &d->shell),
        .clipboard = either(replaced.clipboard, &d->unoffered),
        .peers = either(replaced.peers, &d->peers),
        .errors = either(replaced.errors, d.get()),
    });
}

Host::~Host() = default;

std::shared_ptr<Host> Host::make(const frame::Services& replaced) {
    // The last one who lets go may stand inside a call of this host; where the application ends no call is left.
    return {new Host(replaced), [](Host* host) {
                if (QCoreApplication::closingDown())
                    delete host;
                else
                    host->deleteLater();
            }};
}

std::shared_ptr<Host> Host::of(const QWidget* widget) {
    for (const QWidget* at = widget; at; at = at->parentWidget())
        if (const Holder* holder = HolderOf(at); holder && holder->host) return holder->host;
    if (const Holder* holder = HolderOf(qApp); !holder || !holder->host) attach(qApp, make());
    return HolderOf(qApp)->host;
}

void Host::attach(QObject* holder, std::shared_ptr<Host> host) {
    Holder* known = HolderOf(holder);
    if (!known) known = new Holder(holder);
    known->host = std::move(host);
}

void Host::setForm(QWidget* widget) { widget->setProperty(formProperty, true); }

QWidget* Host::formOf(QWidget* widget) {
    while (!widget->isWindow() && !widget->property(formProperty).toBool() && widget->parentWidget())
        widget = widget->parentWidget();
    return widget;
}

bool Host::userMode() const { return d->userMode; }

void Host::setUserMode(bool value) {
    if (d->userMode == value) return;
    d->userMode = value;
    emit userModeChanged(value);
}

frame::Host& Host::frameHost() const { return *d->frameHost; }

}  // namespace tessel::qt
