#pragma once

#include <algorithm>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "frame/ClassTable.h"
#include "frame/Control.h"
#include "frame/Numbers.h"
#include "frame/Site.h"
#include "frame/Text.h"
#include "frame/host.h"

/// The least host in which a control can live, for tests and benchmarks of single classes: every service does nothing, except
/// that text has fixed metrics and that errors are kept.
namespace tessel::test {

/// Every character is 90 twips wide and every line 195 high, in every font.
class FixedMetrics final : public frame::TextMetrics {
  public:
    static constexpr float characterTwips = 90, lineTwips = 195;

    frame::TextSize Measure(const frame::Font&, std::string_view text, std::optional<float> wrapWidth) override {
        frame::TextSize size;
        for (std::size_t start = 0; start <= text.size();) {
            const std::size_t end = std::min(text.find('\n', start), text.size());
            AddLine(text.substr(start, end - start), wrapWidth, size);
            start = end + 1;
        }
        return size;
    }

  private:
    static float WidthOf(std::string_view line) { return characterTwips * static_cast<float>(frame::CharacterCount(line)); }

    /// Adds a line to the size, parted at blanks where it is too wide; a word is never parted.
    static void AddLine(std::string_view line, std::optional<float> wrapWidth, frame::TextSize& size) {
        std::size_t taken = line.size();
        if (wrapWidth && WidthOf(line) > *wrapWidth) {
            taken = line.find(' ');
            for (std::size_t next = taken; next < line.size() && WidthOf(line.substr(0, next)) <= *wrapWidth;
                 next = line.find(' ', next + 1))
                taken = next;
        }
        size.width = std::max(size.width, WidthOf(line.substr(0, taken)));
        size.height += lineTwips;
        if (taken < line.size()) AddLine(line.substr(taken + 1), wrapWidth, size);
    }
};

/// Keeps what has left a control where no caller could take it.
class KeptErrors final : public frame::ErrorSink {
  public:
    struct Kept {
        int number = 0;
        std::string where;
        friend bool operator==(const Kept&, const Kept&) = default;
    };
    void Unhandled(const frame::ControlError& error, const std::string& where) override {
        errors.push_back({error.Number(), where});
    }

    std::vector<Kept> errors;
};

namespace idle {

class Loop final : public frame::MessageLoop {
  public:
    void Turn() override {}
};
class Dialogs final : public frame::Dialogs {
  public:
    int MsgBox(const std::string&, int, const std::string&) override { return frame::msgbox::answerOk; }
    void ShowOpen(const std::string&, const std::string&, std::string&) override {}
    void ShowModal(frame::Object&) override {}
};
class Menus final : public frame::Menus {
  public:
    void Popup(frame::Object&, frame::Object*) override {}
};
class Drag final : public frame::DragAndDrop {
  public:
    void Start(frame::ChildControl&) override {}
};
class Focus final : public frame::Focus {
  public:
    void Set(frame::ChildControl&) override {}
};
class Clock final : public frame::Clock {
  public:
    frame::Date Now() override { return {}; }
    void Start(frame::TimerClient&, int) override {}
    void Stop(frame::TimerClient&) override {}
};
class Random final : public frame::Random {
  public:
    float Next() override { return 0; }
    void Restart(double) override {}
    void RestartFromClock() override {}
};
class Locale final : public frame::Locale {
  public:
    std::string DateText(frame::Date) override { return {}; }
    std::string LongDateText(frame::Date) override { return {}; }
    std::string Grouped(std::int64_t number) override { return frame::Decimal(number); }
    frame::Date LocalTime(std::int64_t) override { return {}; }
};
class CodePage final : public frame::CodePage {
  public:
    std::optional<std::string> ToNarrow(std::string_view text) override { return std::string(text); }
    std::string FromNarrow(std::string_view bytes) override { return std::string(bytes); }
};
class Pictures final : public frame::PictureLoader {
  public:
    frame::PictureRef LoadPicture(const std::string&) override { return std::make_shared<frame::Picture>(); }
    frame::PictureRef FileIcon(const std::string&, int) override { return nullptr; }
};
class Application final : public frame::Application {
  public:
    std::string Path() override { return {}; }
    int ScreenMousePointer() override { return 0; }
    void SetScreenMousePointer(int) override {}
};
/// A disk without anything on it, on which nothing can be made.
class Files final : public frame::FileSystem {
  public:
    char Separator() const override { return '/'; }
    bool IgnoresCase() const override { return false; }
    bool FileExists(std::string_view) override { return false; }
    bool FolderExists(std::string_view) override { return false; }
    bool DriveExists(std::string_view) override { return false; }
    frame::Status Stat(std::string_view, frame::FileRecord&) override { return frame::errors::fileNotFound; }
    frame::Status List(std::string_view, const std::function<bool(const frame::FileRecord&)>&) override {
        return frame::errors::pathNotFound;
    }
    std::vector<frame::DriveRecord> Drives() override { return {}; }
    std::string TypeText(std::int32_t) override { return {}; }
    frame::Status CreateFolder(std::string_view) override { return frame::errors::pathAccess; }
    frame::Status Rename(std::string_view, std::string_view) override { return frame::errors::fileNotFound; }
    frame::Status Delete(std::string_view) override { return frame::errors::fileNotFound; }
    frame::Status SetAttributes(std::string_view, std::int32_t) override { return frame::errors::fileNotFound; }
    std::string TemporaryFolder() override { return {}; }
    std::string SpecialFolder(int) override { return {}; }
    frame::Status OpenForReading(std::string_view, std::unique_ptr<frame::BinaryFile>&) override {
        return frame::errors::fileNotFound;
    }
    frame::Status WriteOver(std::string_view, std::string_view) override { return frame::errors::pathAccess; }
};
class Shell final : public frame::Shell {
  public:
    int Execute(std::string_view, const std::string&) override { return 2; }
    frame::FileOperationResult Run(const frame::FileOperation&) override { return {}; }
};
class Clipboard final : public frame::Clipboard {
  public:
    void Clear() override {}
    bool Has(int) override { return false; }
    bool Put(int, std::string) override { return false; }
    std::optional<std::string> Read(int) override { return {}; }
};
class Events final : public frame::EventSink {
  public:
    bool Wants(const frame::EventInfo&) const override { return false; }
    void Raise(const frame::EventInfo&, frame::EventArguments) override {}
};
class NoSiblings final : public frame::Siblings {
  public:
    int Count() const override { return 0; }
    frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }
};
/// An extender that adds nothing.
class Extender final : public frame::Object {
  public:
    const frame::ClassTable& Table() const override {
        static constexpr frame::ClassTable table{.name = "Extender", .members = {}};
        return table;
    }
};

}  // namespace idle

/// A test sets `makePeer` before it adopts a control whose children are to be shown.
class TestPeers final : public frame::PeerFactory {
  public:
    std::unique_ptr<frame::Peer> MakePeer(frame::ChildControl& child) override { return makePeer ? makePeer(child) : nullptr; }
    std::unique_ptr<frame::Canvas> MakeCanvas(frame::DrawingSurface&, frame::Object&) override { return nullptr; }

    std::function<std::unique_ptr<frame::Peer>(frame::ChildControl&)> makePeer;
};

/// The services come first: they outlive the `Host`.
struct TestServices {
    idle::Loop loop;
    idle::Dialogs dialogs;
    idle::Menus menus;
    idle::Drag drag;
    idle::Focus focus;
    idle::Clock clock;
    idle::Random random;
    idle::Locale locale;
    idle::CodePage codePage;
    idle::Pictures pictures;
    FixedMetrics metrics;
    idle::Application application;
    idle::Files files;
    idle::Shell shell;
    idle::Clipboard clipboard;
    TestPeers peers;
    KeptErrors errors;

    frame::Services All() {
        return {.loop = &loop,
                .dialogs = &dialogs,
                .menus = &menus,
                .drag = &drag,
                .focus = &focus,
                .clock = &clock,
                .random = &random,
                .locale = &locale,
                .codePage = &codePage,
                .pictures = &pictures,
                .metrics = &metrics,
                .colors = &frame::ClassicColors(),
                .application = &application,
                .files = &files,
                .shell = &shell,
                .clipboard = &clipboard,
                .peers = &peers,
                .errors = &errors};
    }
};

class TestHost final : private TestServices, public frame::Host {
  public:
    TestHost() : frame::Host(All()) {}

    TestPeers& PeerMaker() { return peers; }
    const std::vector<KeptErrors::Kept>& Errors() const { return errors.errors; }
};

/// The place of one control: at run time unless `userMode` is set to false, without a parent and without siblings.
class TestSite final : public frame::Site, private frame::AmbientProperties {
  public:
    TestSite(TestHost& host, std::string name) : frame::Site(host), name_(std::move(name)) {}

    /// Makes, adopts and starts a control.
    template <class C>
    C& Make() {
        auto control = std::make_unique<C>(Host());
        C& made = *control;
        Adopt(std::move(control));
        Start(nullptr);
        return made;
    }
    /// Who hears the events from now on; null for nobody.
    void Listen(frame::EventSink* sink) { sink_ = sink; }

    bool userMode = true;
    std::vector<std::string> changedProperties;

    const frame::AmbientProperties& Ambient() const override { return *this; }
    frame::Object& Extender() override { return extender_; }
    frame::Object* Parent() override { return nullptr; }
    frame::Siblings& ParentControls() override { return siblings_; }
    void PropertyChanged(std::string_view key) override { changedProperties.emplace_back(key); }
    frame::EventSink& Events() override { return sink_ ? *sink_ : noEvents_; }

  private:
    bool UserMode() const override { return userMode; }
    frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
    std::string DisplayName() const override { return name_; }

    std::string name_;
    idle::Extender extender_;
    idle::NoSiblings siblings_;
    idle::Events noEvents_;
    frame::EventSink* sink_ = nullptr;
};

}  // namespace tessel::test
