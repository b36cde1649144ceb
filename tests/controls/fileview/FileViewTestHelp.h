#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "controls/fileview/FileView.h"
#include "tests/HostUnderTest.h"

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
        bool heard = true;                   ///< somebody listens to each event
        frame::FileSystem* files = nullptr;  ///< in the place of the memory disk
    };

    Stage() : Stage(Options()) {}
    explicit Stage(const Options& options) : host(options.files), view_(NewView(options)) {
        host.loop.onTurn = [this] {
            ++turns;
            if (onTurn) onTurn();
        };
        Events();
    }
    ~Stage() { Destroy(); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    FileView& View() { return view_; }
    frame::Host& Frame() { return host.Frame(); }
    headless::MemoryDisk& Disk() { return host.files; }
    frame::Site& TheSite() { return *view_.Site(); }
    bool Lives() { return host.FindSite(name) != nullptr; }
    void Destroy() {
        if (Lives()) host.Destroy(view_);
    }
    void Save(frame::PropertyBag& bag) { TheSite().Save(bag); }

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
        Asked();
        turns = 0;
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
    /// The properties that were reported since the last call.
    std::vector<std::string> Changes() {
        ReadLog();
        return std::exchange(changes_, {});
    }
    /// The icons that the system was asked for since the last call: "S C:\a.txt".
    std::vector<std::string> Asked() {
        ReadLog();
        return std::exchange(asked_, {});
    }

    std::function<void()> onTurn;  ///< what comes in while the message loop has a turn
    int turns = 0;
    test::HostUnderTest host;

  private:
    static constexpr const char* name = "FileView1";

    FileView& NewView(const Options& options) {
        headless::Placing placing{.designTime = options.designTime,
                                  .saved = options.saved,
                                  .width = width,
                                  .height = height,
                                  .show = options.show,
                                  .logEvents = false};
        if (options.heard)
            placing.onEvent = [this](const std::string&, const frame::EventInfo& event, frame::EventArguments arguments) {
                Note(event, arguments);
            };
        return host.Create<FileView>(name, placing);
    }
    void Note(const frame::EventInfo& event, frame::EventArguments arguments) {
        std::string line(event.name);
        for (std::size_t i = 0; i < arguments.size(); ++i) {
            const frame::Variant value = arguments[i].Get();
            line += (i == 0 ? "(" : ", ") + (value.Type() == frame::VarType::Array ? "array" : value.ToText());
        }
        if (!arguments.empty()) line += ")";
        events_.push_back(line);
    }
    void ReadLog() {
        constexpr std::int32_t smallForm = 1;
        for (const headless::Log::Entry& entry : host.log.Take()) {
            const std::string kind = entry.at(0).ToText();
            if (kind == "changed") changes_.push_back(entry.at(2).ToText());
            if (kind == "icon") asked_.push_back(((entry.at(2).ToLong() & smallForm) != 0 ? "S " : "L ") + entry.at(1).ToText());
        }
    }

    std::vector<std::string> events_, changes_, asked_;
    FileView& view_;

  public:
    frame::Handlers& handlers = host.SiteOf(view_)->ApplicationHandlers();  ///< the application's; gone with the control
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
