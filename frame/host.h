#pragma once

#include <cstdint>
#include <deque>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <typeindex>
#include <unordered_map>
#include <utility>
#include <vector>

#include "frame/Color.h"
#include "frame/Error.h"
#include "frame/FileSystem.h"
#include "frame/Font.h"
#include "frame/Object.h"
#include "frame/Picture.h"
#include "frame/Variant.h"

/// What a program must offer so that controls can live in it. A host implements the services, makes a `Host` of them, and
/// gives each control a `Site` (see Site.h).
namespace tessel::frame {

class Canvas;
class ChildControl;
class Control;
class DrawingSurface;
class Site;

/// The message loop of the thread.
class MessageLoop {
  public:
    virtual ~MessageLoop() = default;
    /// Delivers the timers and the input that are due, paints at most once a frame, and returns.
    virtual void Turn() = 0;
    /// Something changed, or was retired, that no running call from outside will see to: `Host::Settle` should run soon.
    /// May come often; one turn answers them all.
    virtual void WantTurn() {}
};

/// Styles and answers of message boxes.
namespace msgbox {
inline constexpr int ok = 0, yesNo = 4;                                             // buttons
inline constexpr int stop = 16, question = 32, exclamation = 48, information = 64;  // pictures
inline constexpr int answerOk = 1, answerCancel = 2, answerYes = 6, answerNo = 7;
}  // namespace msgbox

/// Boxes and dialogs. Each call waits for the user; meanwhile events of controls may come in.
class Dialogs {
  public:
    virtual ~Dialogs() = default;
    /// Shows a text with the buttons and the picture of `style` and gives the number of the button pressed.
    virtual int MsgBox(const std::string& text, int style = msgbox::ok, const std::string& title = {}) = 0;
    /// Lets the user choose a file to open. `filter` is "description|pattern|description|pattern". `fileName` stays as it is
    /// when the user cancels.
    virtual void ShowOpen(const std::string& title, const std::string& filter, std::string& fileName) = 0;
    /// Shows a form of the library until it closes itself.
    virtual void ShowModal(Object& form) = 0;
};

class Menus {
  public:
    virtual ~Menus() = default;
    /// Shows a menu at the pointer, with an entry as the default one or none; the entry picked runs its own action.
    virtual void Popup(Object& menu, Object* defaultEntry) = 0;
};

/// Drag and drop.
class DragAndDrop {
  public:
    virtual ~DragAndDrop() = default;
    /// Starts a drag from a child and returns when it has ended or been given to the system. What the drag carries, what it
    /// allows, its feedback and its end are asked and told by the inputs of the child, with a `DragData`; so is what is
    /// dragged over a child and dropped on it.
    virtual void Start(ChildControl& source) = 0;
};

class Focus {
  public:
    virtual ~Focus() = default;
    virtual void Set(ChildControl& child) = 0;
};

/// One who waits for a timer. `Tick` is called on the user-interface thread.
class TimerClient {
  public:
    virtual ~TimerClient() = default;
    virtual void Tick() = 0;
};

/// Time: the wall clock in local time, and the timers.
class Clock {
  public:
    virtual ~Clock() = default;
    virtual Date Now() = 0;
    /// Calls `client.Tick` each `interval` milliseconds (above 0) until it is stopped. A second start replaces the first.
    virtual void Start(TimerClient& client, int interval) = 0;
    virtual void Stop(TimerClient& client) = 0;
};

/// Uniform random numbers in [0, 1).
class Random {
  public:
    virtual ~Random() = default;
    virtual float Next() = 0;
    /// Starts a sequence that repeats for the same seed.
    virtual void Restart(double seed) = 0;
    virtual void RestartFromClock() = 0;
};

class Locale {
  public:
    virtual ~Locale() = default;
    /// The short date and time, as a moment turns into text by default.
    virtual std::string DateText(Date date) = 0;
    virtual std::string LongDateText(Date date) = 0;
    /// A whole number with its digits grouped.
    virtual std::string Grouped(std::int64_t number) = 0;
    /// Seconds since 1970 in Coordinated Universal Time as local time.
    virtual Date LocalTime(std::int64_t seconds) = 0;
};

/// The narrow character set of files and clipboard.
class CodePage {
  public:
    virtual ~CodePage() = default;
    /// Nothing when the text has a character that the set lacks.
    virtual std::optional<std::string> ToNarrow(std::string_view text) = 0;
    virtual std::string FromNarrow(std::string_view bytes) = 0;
};

class PictureLoader {
  public:
    virtual ~PictureLoader() = default;
    /// Error 53 for a missing file, 481 for one that is no picture; an empty name is an empty picture.
    virtual PictureRef LoadPicture(const std::string& fileName) = 0;
    /// The icon of a path as the system shows it, or null where there is none. `flags` as a shell icon request has them.
    virtual PictureRef FileIcon(const std::string& path, int flags) = 0;
};

struct TextSize {
    float width = 0, height = 0;
    friend bool operator==(const TextSize&, const TextSize&) = default;
};

class TextMetrics {
  public:
    virtual ~TextMetrics() = default;
    /// The size of a text in twips; lines part at line feeds (a carriage return before one
    /// counts to it), and at blanks where `wrapWidth` (in twips) is given.
    virtual TextSize Measure(const Font& font, std::string_view text, std::optional<float> wrapWidth = {}) = 0;
};

/// The program and its screen.
class Application {
  public:
    virtual ~Application() = default;
    /// The folder of the running program, with no separator at its end.
    virtual std::string Path() = 0;
    virtual int ScreenMousePointer() = 0;
    virtual void SetScreenMousePointer(int pointer) = 0;
};

/// A shell operation on files.
struct FileOperation {
    enum class Kind { Move = 1, Copy = 2, Delete = 3 };
    Kind kind = Kind::Copy;
    int flags = 0;
    std::vector<std::string> from, to;
};
struct FileOperationResult {
    int code = 0;  ///< 0 for success
    bool aborted = false;
    int systemError = 0;
};

class Shell {
  public:
    virtual ~Shell() = default;
    /// Opens or prints what `target` names (UTF-8; the host converts it where its shell wants another form) with the program that
    /// the system has for it. Above 32 for success, else 2 or 3 (not found), 31 (no program) or another number. `verb` is "open" or
    /// "print".
    virtual int Execute(std::string_view verb, const std::string& target) = 0;
    virtual FileOperationResult Run(const FileOperation& operation) = 0;
};

class Clipboard {
  public:
    virtual ~Clipboard() = default;
    virtual void Clear() = 0;
    virtual bool Has(int format) = 0;
    /// False when another program holds the clipboard.
    virtual bool Put(int format, std::string bytes) = 0;
    virtual std::optional<std::string> Read(int format) = 0;
};

/// What a screen shows of a child control. The child is the truth; a peer follows it and answers what only a screen knows.
class Peer {
  public:
    virtual ~Peer() = default;
    /// The child has changed since the last call. Comes once for any number of changes, from `Host::Flush`.
    virtual void Update() = 0;
};

class PeerFactory {
  public:
    virtual ~PeerFactory() = default;
    /// Null where the host shows nothing: the child works all the same.
    virtual std::unique_ptr<Peer> MakePeer(ChildControl& child) = 0;
    /// What shows or records the drawing of a surface, made before its first operation and owned by it; null for none.
    virtual std::unique_ptr<Canvas> MakeCanvas(DrawingSurface& surface, Object& owner) = 0;
};

/// Where errors go that no direct caller can take.
class ErrorSink {
  public:
    virtual ~ErrorSink() = default;
    /// Must not throw: it is called where nobody could catch.
    /// `where` names the object and the event, as "Link1.Label1.MouseDown".
    virtual void Unhandled(const ControlError& error, const std::string& where) = 0;
};

/// The services of a host. All must be there for the life of the `Host`.
struct Services {
    MessageLoop* loop = nullptr;
    Dialogs* dialogs = nullptr;
    Menus* menus = nullptr;
    DragAndDrop* drag = nullptr;
    Focus* focus = nullptr;
    Clock* clock = nullptr;
    Random* random = nullptr;
    Locale* locale = nullptr;
    CodePage* codePage = nullptr;
    PictureLoader* pictures = nullptr;
    TextMetrics* metrics = nullptr;
    const SystemColors* colors = nullptr;
    Application* application = nullptr;
    FileSystem* files = nullptr;
    Shell* shell = nullptr;
    Clipboard* clipboard = nullptr;
    PeerFactory* peers = nullptr;
    ErrorSink* errors = nullptr;
};

/// One user-interface thread of one program. Controls of one host share its module state; controls of two hosts share
/// nothing.
class Host {
  public:
    explicit Host(const Services& services);
    Host(const Host&) = delete;
    Host& operator=(const Host&) = delete;
    ~Host();

    // Services that let the host's own code or the user's input run. Each flushes the peers first and keeps every control
    // alive until it has returned.
    void Turn();
    int MsgBox(const std::string& text, int style = msgbox::ok, const std::string& title = {});
    void ShowOpen(const std::string& title, const std::string& filter, std::string& fileName);
    void ShowModal(Object& form);
    void Popup(Object& menu, Object* defaultEntry);
    void StartDrag(ChildControl& source);
    int Execute(std::string_view verb, const std::string& target);
    FileOperationResult Run(const FileOperation& operation);

    // Services that answer at once.
    frame::Clock& Clock() { return *services_.clock; }
    frame::Focus& Focus() { return *services_.focus; }
    frame::Random& Random() { return *services_.random; }
    frame::Locale& Locale() { return *services_.locale; }
    frame::CodePage& CodePage() { return *services_.codePage; }
    PictureLoader& Pictures() { return *services_.pictures; }
    TextMetrics& Metrics() { return *services_.metrics; }
    const SystemColors& Colors() { return *services_.colors; }
    frame::Application& Application() { return *services_.application; }
    FileSystem& Files() { return *services_.files; }
    frame::Clipboard& Clipboard() { return *services_.clipboard; }
    PeerFactory& Peers() { return *services_.peers; }

    /// State that all controls of this host share, made on first use: the page store, the wand slots, the records of the file
    /// services. `T` is made from nothing or from this host.
    template <class T>
    T& Module();

    /// An error that has left a control where no caller can take it.
    void Unhandled(const ControlError& error, const std::string& where);

    /// Tells the peers of all changed children. Runs by itself before every service that may let the user in, and when the
    /// outermost call from outside has ended. Whoever asks a screen something calls it before.
    void Flush();
    /// What a host does at a turn of its message loop: flushes, and frees what was retired if nothing is running.
    void Settle();
    /// Whether a call into or out of any control of this host is running: the host must not be destroyed meanwhile.
    bool Busy() const { return depth_ != 0; }
    void Touch(ChildControl& child);
    void Forget(ChildControl& child);

    /// Ends a control's life: it is detached at once (it hears no input and raises nothing more; a routine of it that is running
    /// goes on to its end) and freed when no call into or out of any control of this host is running.
    void Retire(std::unique_ptr<Site> site);

  private:
    friend class Entry;
    friend class Callout;
    friend class LoopCall;

    void FreeRetired();

    struct ModuleBase {
        virtual ~ModuleBase() = default;
    };
    template <class T>
    struct ModuleOf;

    Services services_;
    std::unordered_map<std::type_index, std::unique_ptr<ModuleBase>> modules_;
    std::deque<ChildControl*> touched_;
    std::vector<std::unique_ptr<Site>> retired_;
    int depth_ = 0;    // entries and callouts that are running
    int entries_ = 0;  // entries since the innermost loop that a service runs: the end of the last one flushes
    bool flushing_ = false;
};

/// A call that leaves the library (an event, a box, a turn): what it destroys is freed only after it has returned.
class Callout {
  public:
    explicit Callout(Host& host) : host_(host) { ++host_.depth_; }
    Callout(const Callout&) = delete;
    Callout& operator=(const Callout&) = delete;
    ~Callout() { --host_.depth_; }

  private:
    Host& host_;
};

/// A callout that may run the message loop: calls from outside that come in meanwhile are outermost ones.
class LoopCall {
  public:
    explicit LoopCall(Host& host) : callout_(host), host_(host), entries_(std::exchange(host.entries_, 0)) { host_.Flush(); }
    LoopCall(const LoopCall&) = delete;
    LoopCall& operator=(const LoopCall&) = delete;
    ~LoopCall() { host_.entries_ = entries_; }

  private:
    Callout callout_;
    Host& host_;
    int entries_;
};

/// The one way in for every call from outside that is no direct C++ call: input of a peer, a timer's tick, a menu entry, a
/// generated setter. While it runs no control is freed; an error that leaves the control goes to `Host::Unhandled`; when the
/// outermost one ends, the peers are flushed and retired controls are freed.
class Entry {
  public:
    /// Runs `call`. `where` gives the place's name and is asked only when there is something to report.
    template <class F, class Where>
    static void Run(Host& host, Where&& where, F&& call) {
        const Entry entry(host);
        try {
            call();
        } catch (const ControlError& error) {
            host.Unhandled(error, where());
        } catch (const std::bad_alloc&) {
            host.Unhandled(ControlError(errors::outOfMemory), where());
        } catch (const std::exception& error) {
            host.Unhandled(ControlError(errors::internal, error.what()), where());
        } catch (...) {
            host.Unhandled(ControlError(errors::internal), where());
        }
    }

    Entry(const Entry&) = delete;
    Entry& operator=(const Entry&) = delete;

  private:
    explicit Entry(Host& host) : host_(host) {
        ++host_.depth_;
        ++host_.entries_;
    }
    ~Entry() {
        if (host_.entries_ == 1) host_.Flush();
        --host_.entries_;
        if (--host_.depth_ == 0) host_.FreeRetired();
    }

    Host& host_;
};

template <class T>
struct Host::ModuleOf final : ModuleBase {
    explicit ModuleOf(Host& host) requires std::is_constructible_v<T, Host&> : state(host) {}
    explicit ModuleOf(Host&) requires(!std::is_constructible_v<T, Host&>) {}
    T state;
};

template <class T>
T& Host::Module() {
    auto& slot = modules_[std::type_index(typeid(T))];
    if (!slot) slot = std::make_unique<ModuleOf<T>>(*this);
    return static_cast<ModuleOf<T>&>(*slot).state;
}

}  // namespace tessel::frame
