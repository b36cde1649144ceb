#include "hosts/qt/Services.h"

#include <QApplication>
#include <QDateTime>
#include <QEventLoop>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontMetricsF>
#include <QImageReader>
#include <QLocale>
#include <QMessageBox>
#include <QPointer>
#include <QThread>
#include <array>
#include <cmath>
#include <utility>

#include "frame/ChildControl.h"
#include "frame/Dates.h"
#include "hosts/qt/Convert.h"
#include "hosts/qt/Cursors.h"
#include "hosts/qt/TextLayout.h"
#include "hosts/qt/WidgetPeer.h"

namespace tessel::qt {

namespace {

QWidget* WindowForDialogs() {
    QWidget* modal = QApplication::activeModalWidget();
    return modal ? modal : QApplication::activeWindow();
}

[[noreturn]] void NotOffered() { throw frame::ControlError(frame::errors::notSupported); }

}  // namespace

// The message loop.

EventLoop::EventLoop(std::function<void()> settle) {
    soon_.setSingleShot(true);
    soon_.setInterval(0);
    soon_.callOnTimeout(std::move(settle));
    nextFrame_.setSingleShot(true);
    nextFrame_.callOnTimeout([this] { PaintHeld(); });
    qApp->installEventFilter(this);
}

void EventLoop::Turn() {
    ++turns_;
    QCoreApplication::processEvents();
    --turns_;
    if (std::exchange(painted_, false)) sincePaint_.start();
}

/// A window that asks to be painted before the frame is over waits for the next.
bool EventLoop::eventFilter(QObject* watched, QEvent* event) {
    if (turns_ == 0 || event->type() != QEvent::UpdateRequest || !watched->isWidgetType()) return false;
    if (!sincePaint_.isValid() || sincePaint_.hasExpired(frame)) {
        painted_ = true;
        return false;
    }
    held_.emplace_back(watched);
    if (!nextFrame_.isActive()) nextFrame_.start(frame);
    return true;
}

void EventLoop::PaintHeld() {
    for (const QPointer<QObject>& window : std::exchange(held_, {}))
        if (window) QCoreApplication::postEvent(window, new QEvent(QEvent::UpdateRequest), Qt::LowEventPriority);
}

void EventLoop::WantTurn() {
    if (!soon_.isActive()) soon_.start();
}

// Boxes and dialogs.

int WidgetDialogs::MsgBox(const std::string& text, int style, const std::string& title) {
    struct Button {
        int answer;
        QMessageBox::StandardButton button;
    };
    static constexpr Button ok{1, QMessageBox::Ok}, cancel{2, QMessageBox::Cancel}, abort{3, QMessageBox::Abort},
        retry{4, QMessageBox::Retry}, ignore{5, QMessageBox::Ignore}, yes{6, QMessageBox::Yes}, no{7, QMessageBox::No};
    static const std::vector<std::vector<Button>> sets = {{ok},      {ok, cancel},   {abort, retry, ignore}, {yes, no, cancel},
                                                          {yes, no}, {retry, cancel}};
    constexpr int buttonBits = 0xF, pictureBits = 0x70;
    const auto set = static_cast<std::size_t>(style & buttonBits);
    const std::vector<Button>& buttons = set < sets.size() ? sets[set] : sets.front();

    // The window may go while the box stands, and takes the box along.
    const QPointer<QMessageBox> box = new QMessageBox(WindowForDialogs());
    box->setTextFormat(Qt::PlainText);
    box->setText(ToQt(text));
    box->setWindowTitle(title.empty() ? QGuiApplication::applicationDisplayName() : ToQt(title));
    switch (style & pictureBits) {
        case frame::msgbox::stop:
            box->setIcon(QMessageBox::Critical);
            break;
        case frame::msgbox::question:
            box->setIcon(QMessageBox::Question);
            break;
        case frame::msgbox::exclamation:
            box->setIcon(QMessageBox::Warning);
            break;
        case frame::msgbox::information:
            box->setIcon(QMessageBox::Information);
            break;
        default:
            break;
    }
    for (const Button& button : buttons) box->addButton(button.button);
    box->setDefaultButton(buttons.front().button);
    box->setEscapeButton(buttons.back().button);
    const int pressed = box->exec();
    delete box;
    for (const Button& button : buttons)
        if (button.button == pressed) return button.answer;
    return buttons.back().answer;
}

void WidgetDialogs::ShowOpen(const std::string& title, const std::string& filter, std::string& fileName) {
    const QStringList parts = ToQt(filter).split('|');
    QStringList filters;
    for (qsizetype i = 0; i + 1 < parts.size(); i += 2)
        filters << QString("%1 (%2)").arg(parts[i], QString(parts[i + 1]).replace(';', ' '));
    const QString chosen = QFileDialog::getOpenFileName(WindowForDialogs(), ToQt(title), ToQt(fileName), filters.join(";;"));
    if (!chosen.isEmpty()) fileName = FromQt(chosen);
}

void WidgetDialogs::ShowModal(frame::Object&) { NotOffered(); }

void Unoffered::Popup(frame::Object&, frame::Object*) { NotOffered(); }
void Unoffered::Start(frame::ChildControl&) { NotOffered(); }

void WidgetFocus::Set(frame::ChildControl& child) {
    if (const auto* peer = dynamic_cast<WidgetPeer*>(child.Peer())) peer->widget()->setFocus(Qt::OtherFocusReason);
}

// Time and chance.

frame::Date SystemClock::Now() {
    const QDateTime now = QDateTime::currentDateTime();
    return frame::DateFrom(
        {now.date().year(), now.date().month(), now.date().day(), now.time().hour(), now.time().minute(), now.time().second()});
}

void SystemClock::Start(frame::TimerClient& client, int interval) {
    auto& timer = timers_[&client];
    timer = std::make_unique<QTimer>();
    timer->callOnTimeout([&client] { client.Tick(); });
    timer->start(interval);
}

void SystemClock::Stop(frame::TimerClient& client) {
    const auto found = timers_.find(&client);
    if (found == timers_.end()) return;
    found->second->stop();
    found->second.release()->deleteLater();  // its tick may be on the stack
    timers_.erase(found);
}

float Generator::Next() {
    constexpr int bits = 24;  // what a 32-bit float holds exactly
    return static_cast<float>(engine_() >> (32 - bits)) / static_cast<float>(1 << bits);
}

void Generator::Restart(double seed) {
    constexpr double range = 4'294'967'296.0;
    const double whole = std::isfinite(seed) ? std::fmod(std::floor(std::fabs(seed) * 1000), range) : 0;
    engine_.seed(static_cast<std::mt19937::result_type>(whole));
}

void Generator::RestartFromClock() { engine_.seed(std::random_device()()); }

// The user's locale.

namespace {

/// Nothing for a moment that no calendar of Qt has.
QDateTime MomentOf(frame::Date date) {
    const frame::DateParts parts = frame::PartsOf(date);
    return {QDate(parts.year, parts.month, parts.day), QTime(parts.hour, parts.minute, parts.second)};
}

}  // namespace

std::string UserLocale::DateText(frame::Date date) { return FromQt(QLocale().toString(MomentOf(date), QLocale::ShortFormat)); }

std::string UserLocale::LongDateText(frame::Date date) {
    return FromQt(QLocale().toString(MomentOf(date).date(), QLocale::LongFormat));
}

std::string UserLocale::Grouped(std::int64_t number) { return FromQt(QLocale().toString(static_cast<qlonglong>(number))); }

frame::Date UserLocale::LocalTime(std::int64_t seconds) {
    const QDateTime local = QDateTime::fromSecsSinceEpoch(seconds);
    return frame::DateFrom({local.date().year(), local.date().month(), local.date().day(), local.time().hour(),
                            local.time().minute(), local.time().second()});
}

// Pictures, text and colours.

frame::PictureRef ImageLoader::LoadPicture(const std::string& fileName) {
    if (fileName.empty()) return std::make_shared<frame::Picture>();
    const QString name = ToQt(fileName);
    if (!QFileInfo(name).isFile()) throw frame::ControlError(frame::errors::fileNotFound);
    QImageReader reader(name);
    reader.setAutoTransform(true);
    const QImage image = reader.read();
    if (image.isNull()) throw frame::ControlError(frame::errors::invalidPicture);
    return FromQt(image, name);
}

frame::PictureRef ImageLoader::FileIcon(const std::string& path, int flags) { return icons_.Of(ToQt(path), flags); }

FontMetrics::FontMetrics() {
    QObject::connect(qApp, &QGuiApplication::fontDatabaseChanged, this, [this] { last_.reset(); });
}

frame::TextSize FontMetrics::Measure(const frame::Font& font, std::string_view text, std::optional<float> wrapWidth) {
    Asked asked{ToQt(font), std::string(text), wrapWidth};
    if (last_ == asked) return size_;
    const QSizeF size =
        TextSizeOf(asked.font, ToQt(text), wrapWidth ? std::optional<double>(*wrapWidth / frame::twipsPerPixel) : std::nullopt);
    last_ = std::move(asked);
    size_ = {Twips(std::ceil(size.width())), Twips(std::ceil(size.height()))};
    return size_;
}

frame::OLE_COLOR PaletteColors::Color(int index) const {
    using Role = QPalette::ColorRole;
    static constexpr std::array roles = {
        Role::Mid,
        Role::Window,
        Role::Highlight,
        Role::Mid,
        Role::Window,
        Role::Base,
        Role::Dark,
        Role::WindowText,
        Role::Text,
        Role::HighlightedText,
        Role::Window,
        Role::Window,
        Role::Dark,
        Role::Highlight,
        Role::HighlightedText,
        Role::Window,
        Role::Dark,
        Role::PlaceholderText,
        Role::WindowText,
        Role::WindowText,
        Role::Light,
        Role::Shadow,
        Role::Midlight,
        Role::ToolTipText,
        Role::ToolTipBase,
    };
    if (index < 0 || index >= static_cast<int>(roles.size())) return frame::Rgb(0, 0, 0);
    constexpr int greyText = 17;
    const QPalette palette = QGuiApplication::palette();
    const auto group = index == greyText ? QPalette::Disabled : QPalette::Active;
    return FromQt(palette.color(group, index == greyText ? Role::WindowText : roles[static_cast<std::size_t>(index)]));
}

// The program and the desktop.

std::string Program::Path() { return FromQt(QCoreApplication::applicationDirPath()); }

void Program::SetScreenMousePointer(int pointer) {
    if (pointer == pointer_) return;
    if (pointer_ != 0) QGuiApplication::restoreOverrideCursor();
    pointer_ = pointer;
    if (pointer_ != 0) QGuiApplication::setOverrideCursor(CursorOf(pointer_));
}

int DesktopShell::Execute(std::string_view verb, const std::string& target) {
    int result = posix::opened::failed;
    const std::unique_ptr<QThread> starter(QThread::create([&] { result = opener_.Execute(verb, target); }));
    QEventLoop loop;
    QObject::connect(starter.get(), &QThread::finished, &loop, &QEventLoop::quit);
    starter->start();
    QGuiApplication::setOverrideCursor(Qt::BusyCursor);
    loop.exec();  // ends early when the program does
    QGuiApplication::restoreOverrideCursor();
    starter->wait();
    return result;
}

frame::FileOperationResult DesktopShell::Run(const frame::FileOperation&) { NotOffered(); }

}  // namespace tessel::qt
