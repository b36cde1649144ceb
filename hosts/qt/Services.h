#pragma once

#include <QElapsedTimer>
#include <QFont>
#include <QPointer>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>
#include <random>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "frame/host.h"
#include "hosts/posix/Opener.h"
#include "hosts/qt/FileIcons.h"

/// The services of the Qt host.
namespace tessel::qt {

/// A turn delivers whatever is due. In a long run of turns windows are painted at most once a frame, and what is then still to be
/// painted is painted a frame later.
class EventLoop final : private QObject, public frame::MessageLoop {
  public:
    static constexpr int frame = 16;  // milliseconds

    explicit EventLoop(std::function<void()> settle);
    void Turn() override;
    void WantTurn() override;

  private:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void PaintHeld();

    QTimer soon_, nextFrame_;
    int turns_ = 0;  // that are running
    bool painted_ = false;
    QElapsedTimer sincePaint_;
    std::vector<QPointer<QObject>> held_;  // windows that are to be painted
};

/// Boxes and dialogs stand over the active window.
class WidgetDialogs final : public frame::Dialogs {
  public:
    int MsgBox(const std::string& text, int style, const std::string& title) override;
    void ShowOpen(const std::string& title, const std::string& filter, std::string& fileName) override;
    /// Error 445: no form of the library has a window on this host yet.
    void ShowModal(frame::Object& form) override;
};

/// What no control on this host asks for yet. Menus and drags are error 445; the clipboard is as one that another program holds.
class Unoffered final : public frame::Menus, public frame::DragAndDrop, public frame::Clipboard {
  public:
    void Popup(frame::Object& menu, frame::Object* defaultEntry) override;
    void Start(frame::ChildControl& source) override;
    void Clear() override {}
    bool Has(int /*format*/) override { return false; }
    bool Put(int /*format*/, std::string /*bytes*/) override { return false; }
    std::optional<std::string> Read(int /*format*/) override { return std::nullopt; }
};

class WidgetFocus final : public frame::Focus {
  public:
    void Set(frame::ChildControl& child) override;
};

class SystemClock final : public frame::Clock {
  public:
    frame::Date Now() override;
    void Start(frame::TimerClient& client, int interval) override;
    void Stop(frame::TimerClient& client) override;

  private:
    std::unordered_map<frame::TimerClient*, std::unique_ptr<QTimer>> timers_;
};

class Generator final : public frame::Random {
  public:
    Generator() { RestartFromClock(); }
    float Next() override;
    void Restart(double seed) override;
    void RestartFromClock() override;

  private:
    std::mt19937 engine_;
};

/// The user's locale.
class UserLocale final : public frame::Locale {
  public:
    std::string DateText(frame::Date date) override;
    std::string LongDateText(frame::Date date) override;
    std::string Grouped(std::int64_t number) override;
    frame::Date LocalTime(std::int64_t seconds) override;
};

class ImageLoader final : public frame::PictureLoader {
  public:
    frame::PictureRef LoadPicture(const std::string& fileName) override;
    frame::PictureRef FileIcon(const std::string& path, int flags) override;

  private:
    FileIcons icons_;
};

/// Measures as the widgets of this host paint. What was measured last is known: who prints a text asks for its width, its height
/// and the place of the next line.
class FontMetrics final : private QObject, public frame::TextMetrics {
  public:
    FontMetrics();
    frame::TextSize Measure(const frame::Font& font, std::string_view text, std::optional<float> wrapWidth) override;

  private:
    struct Asked {
        QFont font;
        std::string text;
        std::optional<float> wrapWidth;
        friend bool operator==(const Asked&, const Asked&) = default;
    };
    std::optional<Asked> last_;
    frame::TextSize size_;
};

/// The application's palette as system colours.
class PaletteColors final : public frame::SystemColors {
  public:
    frame::OLE_COLOR Color(int index) const override;
};

class Program final : public frame::Application {
  public:
    std::string Path() override;
    int ScreenMousePointer() override { return pointer_; }
    void SetScreenMousePointer(int pointer) override;
    ~Program() override { SetScreenMousePointer(0); }

  private:
    int pointer_ = 0;
};

/// Opens and prints with the desktop's programs. While a program starts, the message loop runs.
class DesktopShell final : public frame::Shell {
  public:
    explicit DesktopShell(posix::OpenerSettings settings = {}) : opener_(std::move(settings)) {}
    int Execute(std::string_view verb, const std::string& target) override;
    /// Error 445: no control on this host asks for it yet.
    frame::FileOperationResult Run(const frame::FileOperation& operation) override;

  private:
    posix::Opener opener_;
};

}  // namespace tessel::qt
