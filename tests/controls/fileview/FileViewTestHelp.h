#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/fileview/FileView.h"
#include "hosts/headless/HeadlessHost.h"

/// What the tests of the list of files share.
namespace tessel::controls::fileviewtest {

inline constexpr float width = 6000, height = 3000;  // twips: ten rows below the headers

/// A host with one list of files on a memory disk, of which a test sees each event with its arguments, each turn of the message
/// loop and each icon that the system is asked for.
class Stage {
  public:
    struct Options {
        bool designTime = false;
        const frame::PropertyBag* saved = nullptr;
        bool show = true;
    };

    Stage() : Stage(Options()) {}
    explicit Stage(const Options& options) : site_(std::make_unique<StageSite>(*this)), view_(NewView()) {
        site_->ambient.userMode = !options.designTime;
        site_->Start(options.saved, width, height);
        if (options.show) site_->Show();
        Events();
    }
    ~Stage() { Destroy(); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    FileView& View() { return view_; }
    frame::Host& Frame() { return frame_; }
    headless::MemoryDisk& Disk() { return others.files; }
    frame::Site& TheSite() { return *site_; }
    bool Lives() const { return site_ != nullptr; }
    void Destroy() {
        if (site_) frame_.Retire(std::move(site_));
    }
    void Save(frame::PropertyBag& bag) { site_->Save(bag); }

    // Setting up the disk. Times are seconds since 1970.
    void File(const std::string& path, std::int64_t size = 0, std::int64_t created = 0, std::int64_t modified = 0,
              std::int32_t attributes = 0) {
        Disk().SetFile(path, {.attributes = attributes, .size = size, .created = created, .modified = modified}).Check();
    }
    void Folder(const std::string& path, std::int32_t attributes = 0) {
        Disk().SetFolder(path, {.attributes = attributes}).Check();
    }
    void Remove(const std::string& path) { Disk().Remove(path).Check(); }

    /// Shows a folder, or a word, with nothing of what happened before in the logs.
    void ShowPath(const std::string& path) {
        view_.SetPathRoot(path);
        Events();
        turns = 0;
        asked.clear();
    }
    void Tick() { view_.RefreshTimer.TimerInput(); }

    /// What was raised since the last call, with arguments: "BeforePaint(False) AfterPaint".
    std::string Events() {
        std::string line;
        for (const std::string& event : std::exchange(events_, {})) line += (line.empty() ? "" : " ") + event;
        return line;
    }
    /// The same without those of adding items.
    std::string EventsOfPaints() {
        std::string line;
        for (const std::string& event : std::exchange(events_, {}))
            if (event.find("AddItem") == std::string::npos) line += (line.empty() ? "" : " ") + event;
        return line;
    }

    frame::Handlers handlers;          ///< the application's
    std::set<std::string> unwanted;    ///< events that nobody listens to
    std::function<void()> onTurn;      ///< what comes in while the message loop has a turn
    std::vector<std::string> changes;  ///< properties that were reported
    std::vector<std::string> asked;    ///< icons that the system was asked for: "S C:\a.txt"
    std::function<bool(const std::string&)> hasIcon = [](const std::string&) { return true; };
    int turns = 0;
    headless::HeadlessHost others;  ///< lends what no test watches

  private:
    struct Nobody final : frame::Siblings {
        int Count() const override { return 0; }
        frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }
    };
    struct State final : frame::AmbientProperties {
        bool UserMode() const override { return userMode; }
        frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
        std::string DisplayName() const override { return "FileView1"; }
        bool userMode = true;
    };
    struct Watching final : frame::EventSink {
        explicit Watching(Stage& watched) : stage(watched) {}
        bool Wants(const frame::EventInfo& event) const override { return !stage.unwanted.contains(std::string(event.name)); }
        void Raise(const frame::EventInfo& event, frame::EventArguments arguments) override {
            std::string line(event.name);
            for (std::size_t i = 0; i < arguments.size(); ++i) {
                const frame::Variant value = arguments[i].Get();
                line += (i == 0 ? "(" : ", ") + (value.Type() == frame::VarType::Array ? "array" : value.ToText());
            }
            if (!arguments.empty()) line += ")";
            stage.events_.push_back(line);
            stage.handlers.Raise(event, arguments);
        }
        Stage& stage;
    };
    struct StageSite final : frame::Site {
        explicit StageSite(Stage& watched) : Site(watched.frame_), stage(watched), sink(watched) {}
        const frame::AmbientProperties& Ambient() const override { return ambient; }
        frame::Object& Extender() override { return extender; }
        frame::Object* Parent() override { return nullptr; }
        frame::Siblings& ParentControls() override { return siblings; }
        void PropertyChanged(std::string_view key) override { stage.changes.emplace_back(key); }
        frame::EventSink& Events() override { return sink; }

        Stage& stage;
        State ambient;
        headless::HostObject extender{"FileView1", {}};
        Nobody siblings;
        Watching sink;
    };
    struct Turning final : frame::MessageLoop {
        explicit Turning(Stage& watched) : stage(watched) {}
        void Turn() override {
            ++stage.turns;
            if (stage.onTurn) stage.onTurn();
        }
        Stage& stage;
    };
    struct Icons final : frame::PictureLoader {
        explicit Icons(Stage& watched) : stage(watched) {}
        frame::PictureRef LoadPicture(const std::string&) override { return std::make_shared<frame::Picture>(); }
        frame::PictureRef FileIcon(const std::string& path, int flags) override {
            constexpr int small = 1;
            stage.asked.push_back(((flags & small) != 0 ? "S " : "L ") + path);
            if (!stage.hasIcon(path)) return nullptr;
            return std::make_shared<frame::Picture>(240.0f, 240.0f, "");
        }
        Stage& stage;
    };

    frame::Services Mixed() {
        frame::Services services = others.LentServices();
        services.loop = &loop_;
        services.pictures = &pictures_;
        return services;
    }
    FileView& NewView() {
        auto made = std::make_unique<FileView>(frame_);
        FileView& view = *made;
        site_->Adopt(std::move(made));
        return view;
    }

    std::vector<std::string> events_;
    Turning loop_{*this};
    Icons pictures_{*this};
    frame::Host frame_{Mixed()};
    std::unique_ptr<StageSite> site_;
    FileView& view_;
};

/// A text of each row: "src | a.txt". Column 0 is the label.
inline std::string Rows(const FileView& view, int column = 0) {
    std::string line;
    const child::ListRows& rows = view.ListFiles.Rows();
    for (child::ListRows::Position position = 0; position < rows.Count(); ++position)
        line += (position == 0 ? "" : " | ") + rows.Text(rows.At(position), column);
    return line;
}

/// All texts of a row, from the label on: "a.txt|1 KB|TXT File|…".
inline std::string Row(const FileView& view, std::int32_t index) {
    constexpr int lastColumn = 12;
    std::string line;
    const child::ListRows& rows = view.ListFiles.Rows();
    for (int column = 0; column <= lastColumn; ++column)
        line += (column == 0 ? "" : "|") + rows.Text(rows.At(static_cast<child::ListRows::Position>(index - 1)), column);
    return line;
}

inline std::string SubItem(const FileView& view, std::int32_t index, int column) {
    return view.ListFiles.ListItems.Item(index)->SubItems(column);
}

/// The message over the list; empty when none is seen.
inline std::string Message(const FileView& view) { return view.txtMessage.Visible() ? view.txtMessage.Text() : std::string(); }

inline std::string Keys(const child::ImageList& images) {
    std::string line;
    for (std::int32_t index = 1; index <= images.ListImages.Count(); ++index)
        line += (index == 1 ? "" : " | ") + images.ListImages.Item(index).Key();
    return line;
}

}  // namespace tessel::controls::fileviewtest
