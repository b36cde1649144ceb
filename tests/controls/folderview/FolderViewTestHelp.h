#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/folderview/FolderView.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"

/// What the tests of the tree of folders share.
namespace tessel::controls::foldertest {

inline constexpr float width = 6000, height = 30'000;  // twips: more than a hundred rows
inline constexpr float rowHeight = child::TreeView::rowHeightTwips;

/// A file system that counts what is asked of the memory disk behind it, and fails where a test wants it.
class WatchedDisk final : public frame::FileSystem {
  public:
    explicit WatchedDisk(frame::FileSystem& disk) : disk_(disk) {}

    int calls = 0;                  ///< all that was asked
    int steps = 0;                  ///< of these, what can fail
    int failingStep = -1;           ///< the step, counted from 0, that fails
    bool failsFromThereOn = false;  ///< and all that follow
    int failure = frame::errors::permissionDenied;
    std::vector<std::string> listed;  ///< the folders that were listed

    char Separator() const override { return disk_.Separator(); }
    bool IgnoresCase() const override { return disk_.IgnoresCase(); }
    bool FileExists(std::string_view path) override { return Counted(disk_.FileExists(path)); }
    bool FolderExists(std::string_view path) override { return Counted(disk_.FolderExists(path)); }
    bool DriveExists(std::string_view path) override { return Counted(disk_.DriveExists(path)); }
    frame::Status Stat(std::string_view path, frame::FileRecord& record) override {
        if (Fails()) return failure;
        return disk_.Stat(path, record);
    }
    frame::Status List(std::string_view folder, std::unique_ptr<frame::FolderListing>& listing) override {
        listed.emplace_back(folder);
        if (Fails()) return failure;
        std::unique_ptr<frame::FolderListing> inner;
        if (const frame::Status status = disk_.List(folder, inner); status.Failed()) return status;
        listing = std::make_unique<WatchedListing>(*this, std::move(inner));
        return {};
    }
    frame::Status Count(std::string_view folder, frame::FolderCounts& counts) override {
        if (Fails()) return failure;
        return disk_.Count(folder, counts);
    }
    std::unique_ptr<frame::TreeSize> MeasureTree(std::string_view folder) override { return Counted(disk_.MeasureTree(folder)); }
    std::vector<frame::DriveRecord> Drives() override { return Counted(disk_.Drives()); }
    std::string TypeText(std::int32_t typeId) override { return Counted(disk_.TypeText(typeId)); }
    frame::Status CreateFolder(std::string_view path) override { return Fails() ? failure : disk_.CreateFolder(path); }
    frame::Status CreateFile(std::string_view path, bool overwrite) override {
        return Fails() ? failure : disk_.CreateFile(path, overwrite);
    }
    frame::Status DeleteFile(std::string_view path, bool force) override {
        return Fails() ? failure : disk_.DeleteFile(path, force);
    }
    frame::Status Rename(std::string_view path, std::string_view newName) override {
        return Fails() ? failure : disk_.Rename(path, newName);
    }
    frame::Status SetAttributes(std::string_view path, std::int32_t value) override {
        return Fails() ? failure : disk_.SetAttributes(path, value);
    }
    std::string TemporaryFolder() override { return Counted(disk_.TemporaryFolder()); }
    std::string SpecialFolder(int number) override { return Counted(disk_.SpecialFolder(number)); }
    frame::Status OpenForReading(std::string_view path, std::unique_ptr<frame::BinaryFile>& file) override {
        return Fails() ? failure : disk_.OpenForReading(path, file);
    }
    frame::Status WriteOver(std::string_view path, std::string_view bytes) override {
        return Fails() ? failure : disk_.WriteOver(path, bytes);
    }

  private:
    struct WatchedListing final : frame::FolderListing {
        WatchedListing(WatchedDisk& watching, std::unique_ptr<frame::FolderListing> inner)
            : disk(watching), behind(std::move(inner)) {
            for (std::size_t index = 0; index < behind->Count(); ++index) Add(behind->Name(index));
            folders_ = behind->FolderCount();
        }
        frame::Status Stat(std::size_t index, frame::FileRecord& record) override {
            return disk.Fails() ? disk.failure : behind->Stat(index, record);
        }
        void Rest() override { behind->Rest(); }
        WatchedDisk& disk;
        std::unique_ptr<frame::FolderListing> behind;
    };

    template <class T>
    T Counted(T result) {
        ++calls;
        return result;
    }
    bool Fails() {
        ++calls;
        const int step = steps++;
        return failingStep >= 0 && (step == failingStep || (failsFromThereOn && step > failingStep));
    }

    frame::FileSystem& disk_;
};

/// A host with one tree of folders on a memory disk, of which a test sees each event with its arguments, each message box and
/// each icon that the system is asked for.
class Stage {
  public:
    struct Options {
        bool designTime = false;
        const frame::PropertyBag* saved = nullptr;
        bool show = true;
        float height = foldertest::height;
    };

    Stage() : Stage(Options()) {}
    explicit Stage(const Options& options) : site_(std::make_unique<StageSite>(*this)), view_(NewView()) {
        site_->ambient.userMode = !options.designTime;
        site_->Start(options.saved, width, options.height);
        if (options.show) site_->Show();
        Clear();
    }
    ~Stage() { Destroy(); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    FolderView& View() { return view_; }
    child::TreeView& Tree() { return view_.TreeFolders; }
    frame::Host& Frame() { return frame_; }
    headless::MemoryDisk& Disk() { return others.files; }
    frame::Site& TheSite() { return *site_; }
    bool Lives() const { return site_ != nullptr; }
    void Destroy() {
        if (site_) frame_.Retire(std::move(site_));
    }
    void Save(frame::PropertyBag& bag) { site_->Save(bag); }
    void SetUserMode(bool value) { site_->ambient.userMode = value; }
    void Resize(float newWidth, float newHeight) { site_->SetSize(newWidth, newHeight); }

    // Setting up the disk.
    void Folder(const std::string& path, std::int32_t attributes = 0) {
        Disk().SetFolder(path, {.attributes = attributes}).Check();
    }
    void Remove(const std::string& path) { Disk().Remove(path).Check(); }
    void Drive(const std::string& letter, const headless::MemoryDisk::DriveFacts& facts) { Disk().SetDrive(letter, facts).Check(); }

    /// Shows a folder, or a word, with nothing of what happened before in the logs.
    void ShowRoot(const std::string& path) {
        view_.SetPathRoot(path);
        Clear();
    }
    void Clear() {
        Events();
        Messages();
        changes.clear();
        asked.clear();
    }
    void Tick() { view_.RefreshTimer.TimerInput(); }

    // What the user does with a node. All but `Press` are the tree's own part of it.
    child::TreeNodeRef Node(const std::string& key) { return Tree().Nodes.Item(frame::Variant(key)); }
    std::int32_t IndexOf(const std::string& key) { return Node(key)->Index(); }
    bool Has(const std::string& key) { return Tree().Tree().FindKey(key).has_value(); }
    void Click(const std::string& key) { Tree().NodeClickInput(IndexOf(key)); }
    void Expand(const std::string& key) { Tree().ExpandInput(IndexOf(key)); }
    void Collapse(const std::string& key) { Tree().CollapseInput(IndexOf(key)); }
    /// A press of the left button on the node, which must have a row in view.
    void Press(const std::string& key) {
        constexpr float middle = rowHeight / 2;
        Tree().MouseDownInput(1, 0, 0, static_cast<float>(*Tree().Tree().RowOf(Node(key)->Ref().node)) * rowHeight + middle);
    }
    void Select(const std::string& key) { Node(key)->SetSelected(true); }
    /// The key of the selected node; empty for none.
    std::string Selected() { return Tree().SelectedItem() ? Tree().SelectedItem()->Key() : std::string(); }

    /// What was raised since the last call, with arguments: "BeforePaint(False) AfterPaint".
    std::string Events() { return Joined(std::exchange(events_, {}), " "); }
    /// The same without those of adding nodes.
    std::string EventsButAdding() {
        std::vector<std::string> some;
        for (const std::string& event : std::exchange(events_, {}))
            if (event.find("AddItem") == std::string::npos) some.push_back(event);
        return Joined(some, " ");
    }
    /// The message boxes since the last call: text, style and title of each.
    std::string Messages() { return Joined(std::exchange(messages_, {}), " "); }
    static std::string NotAccessible(const std::string& text) {
        return text + " is not accessible.\r\n\r\nThis folder was moved or removed./16/Folder Not Accessible";
    }

    headless::HeadlessHost others;  ///< lends what no test watches
    WatchedDisk watched{others.files};
    frame::Handlers handlers;          ///< the application's
    std::set<std::string> unwanted;    ///< events that nobody listens to
    std::vector<std::string> changes;  ///< properties that were reported
    std::vector<std::string> asked;    ///< icons that the system was asked for: "closed C:\x"
    std::function<bool(const std::string&)> hasIcon = [](const std::string&) { return true; };
    std::function<void(frame::EventArguments)> onEvent;  ///< what comes in with an event, before the application's handlers
    std::function<void()> onMessage;                     ///< what comes in while a message box is open
    std::uint32_t iconColor = 0xFFFF0000;                ///< of the first pixel of each icon; the others are black

  private:
    struct Nobody final : frame::Siblings {
        int Count() const override { return 0; }
        frame::Object& Item(int) override { throw frame::ControlError(frame::errors::subscript); }
    };
    struct State final : frame::AmbientProperties {
        bool UserMode() const override { return userMode; }
        frame::FontRef Font() const override { return std::make_shared<frame::Font>(); }
        std::string DisplayName() const override { return "FolderView1"; }
        bool userMode = true;
    };
    struct Watching final : frame::EventSink {
        explicit Watching(Stage& told) : stage(told) {}
        bool Wants(const frame::EventInfo& event) const override { return !stage.unwanted.contains(std::string(event.name)); }
        void Raise(const frame::EventInfo& event, frame::EventArguments arguments) override {
            std::string line(event.name);
            for (std::size_t i = 0; i < arguments.size(); ++i) line += (i == 0 ? "(" : ", ") + TextOf(arguments[i].Get());
            if (!arguments.empty()) line += ")";
            Stage& told = stage;
            told.events_.push_back(line);
            if (told.onEvent) told.onEvent(arguments);
            told.handlers.Raise(event, arguments);
        }
        /// A node as its key; "gone" when it is no longer in the tree.
        static std::string TextOf(const frame::Variant& value) {
            if (value.Type() != frame::VarType::Object) return value.ToText();
            const frame::ObjectRef object = value.ToObject();
            const auto* node = dynamic_cast<const child::TreeNode*>(object.Get());
            if (!node) return "object";
            try {
                return node->Key();
            } catch (const frame::ControlError&) {
                return "gone";
            }
        }
        Stage& stage;
    };
    struct StageSite final : frame::Site {
        explicit StageSite(Stage& told) : Site(told.frame_), stage(told), sink(told) {}
        const frame::AmbientProperties& Ambient() const override { return ambient; }
        frame::Object& Extender() override { return extender; }
        frame::Object* Parent() override { return nullptr; }
        frame::Siblings& ParentControls() override { return siblings; }
        void PropertyChanged(std::string_view key) override { stage.changes.emplace_back(key); }
        frame::EventSink& Events() override { return sink; }

        Stage& stage;
        State ambient;
        headless::HostObject extender{"FolderView1", {}};
        Nobody siblings;
        Watching sink;
    };
    struct Icons final : frame::PictureLoader {
        explicit Icons(Stage& told) : stage(told) {}
        frame::PictureRef LoadPicture(const std::string&) override { return std::make_shared<frame::Picture>(); }
        frame::PictureRef FileIcon(const std::string& path, int flags) override {
            constexpr int closedSmall = 0x6605, openSmall = 0x6607, side = 16;
            const std::string form = flags == closedSmall ? "closed " : flags == openSmall ? "open " : "other ";
            stage.asked.push_back(form + path);
            if (!stage.hasIcon(form + path)) return nullptr;
            constexpr std::uint32_t black = 0xFF000000;
            std::vector<std::uint32_t> pixels(std::size_t{side} * side, black);
            pixels.front() = stage.iconColor;
            std::vector<frame::PixelPlane> planes{{1, side, side, std::move(pixels)}};
            return std::make_shared<frame::Picture>(std::move(planes), form + path);
        }
        Stage& stage;
    };

    struct Boxes final : frame::Dialogs {
        explicit Boxes(Stage& told) : stage(told) {}
        int MsgBox(const std::string& text, int style, const std::string& title) override {
            Stage& told = stage;
            told.messages_.push_back(text + "/" + frame::Decimal(style) + "/" + title);
            if (told.onMessage) told.onMessage();
            return frame::msgbox::answerOk;
        }
        void ShowOpen(const std::string&, const std::string&, std::string&) override {}
        void ShowModal(frame::Object&) override {}
        Stage& stage;
    };

    static std::string Joined(const std::vector<std::string>& parts, const char* between) {
        std::string line;
        for (const std::string& part : parts) line += (line.empty() ? "" : between) + part;
        return line;
    }
    frame::Services Mixed() {
        frame::Services services = others.LentServices();
        services.pictures = &pictures_;
        services.dialogs = &boxes_;
        services.files = &watched;
        return services;
    }
    FolderView& NewView() {
        auto made = std::make_unique<FolderView>(frame_);
        FolderView& view = *made;
        site_->Adopt(std::move(made));
        return view;
    }

    std::vector<std::string> events_, messages_;
    Boxes boxes_{*this};
    Icons pictures_{*this};
    frame::Host frame_{Mixed()};
    std::unique_ptr<StageSite> site_;
    FolderView& view_;
};

/// The labels below a node as they stand, each with its children in braces: "a {s, t}, b"; of all nodes by itself.
inline std::string Labels(const FolderView& view, child::NodeId parent = child::noNode) {
    const child::TreeNodes& nodes = view.TreeFolders.Tree();
    std::string line;
    for (child::NodeId node = nodes.FirstChild(parent); node != child::noNode; node = nodes.Next(node)) {
        line += (line.empty() ? "" : ", ") + std::string(nodes.Text(node));
        if (nodes.HasChildren(node)) line += " {" + Labels(view, node) + "}";
    }
    return line;
}

/// The keys of all nodes in the order of their indexes.
inline std::string Keys(const FolderView& view) {
    const child::TreeNodes& nodes = view.TreeFolders.Tree();
    std::string line;
    for (child::TreeNodes::Position position = 0; position < nodes.Count(); ++position)
        line += (position == 0 ? "" : " | ") + std::string(nodes.Key(nodes.At(position)));
    return line;
}

/// The keys of all images in their order.
inline std::string ImageKeys(const FolderView& view) {
    const child::ListImages& images = view.Image16.ListImages;
    std::string line;
    for (std::int32_t index = 1; index <= images.Count(); ++index) line += (index == 1 ? "" : " | ") + images.Item(index).Key();
    return line;
}

inline constexpr const char* designImages = "My Computer | My Folders | Drive Unavailable | FolderUnavailable";

/// What "My Folders" holds: " | C:\x" for the empty first element and one more.
inline std::string MyFolders(const FolderView& view) {
    std::string line;
    const frame::Variant list = view.GetMyFolders();
    const frame::VariantArray& folders = list.ToArray();
    for (int index = folders.LowerBound(); index <= folders.UpperBound(); ++index)
        line += (index == folders.LowerBound() ? "" : " | ") + folders.At(index).ToText();
    return line;
}

}  // namespace tessel::controls::foldertest
