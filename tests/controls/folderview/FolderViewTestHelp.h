#pragma once

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "controls/folderview/FolderView.h"
#include "frame/Text.h"
#include "tests/HostUnderTest.h"

/// What the tests of the tree of folders share.
namespace tessel::controls::foldertest {

inline constexpr float width = 6000, height = 30'000;  // twips: more than a hundred rows
inline constexpr float rowHeight = child::TreeView::rowHeightTwips;

/// A file system that counts what is asked of the disk behind it, and fails where a test wants it.
class WatchedDisk final : public frame::FileSystem {
  public:
    frame::FileSystem* disk = nullptr;  ///< the one behind; there is one before anything is asked

    int calls = 0;                  ///< all that was asked
    int steps = 0;                  ///< of these, what can fail
    int failingStep = -1;           ///< the step, counted from 0, that fails
    bool failsFromThereOn = false;  ///< and all that follow
    int failure = frame::errors::permissionDenied;
    std::vector<std::string> listed;  ///< the folders that were listed

    char Separator() const override { return disk->Separator(); }
    bool IgnoresCase() const override { return disk->IgnoresCase(); }
    bool FileExists(std::string_view path) override { return Counted(disk->FileExists(path)); }
    bool FolderExists(std::string_view path) override { return Counted(disk->FolderExists(path)); }
    bool DriveExists(std::string_view path) override { return Counted(disk->DriveExists(path)); }
    frame::Status Stat(std::string_view path, frame::FileRecord& record) override {
        if (Fails()) return failure;
        return disk->Stat(path, record);
    }
    frame::Status List(std::string_view folder, std::unique_ptr<frame::FolderListing>& listing) override {
        listed.emplace_back(folder);
        if (Fails()) return failure;
        std::unique_ptr<frame::FolderListing> inner;
        if (const frame::Status status = disk->List(folder, inner); status.Failed()) return status;
        listing = std::make_unique<WatchedListing>(*this, std::move(inner));
        return {};
    }
    frame::Status Count(std::string_view folder, frame::FolderCounts& counts) override {
        if (Fails()) return failure;
        return disk->Count(folder, counts);
    }
    std::unique_ptr<frame::TreeSize> MeasureTree(std::string_view folder) override { return Counted(disk->MeasureTree(folder)); }
    std::vector<frame::DriveRecord> Drives() override { return Counted(disk->Drives()); }
    std::string TypeText(std::int32_t typeId) override { return Counted(disk->TypeText(typeId)); }
    frame::Status CreateFolder(std::string_view path) override { return Fails() ? failure : disk->CreateFolder(path); }
    frame::Status CreateFile(std::string_view path, bool overwrite) override {
        return Fails() ? failure : disk->CreateFile(path, overwrite);
    }
    frame::Status DeleteFile(std::string_view path, bool force) override {
        return Fails() ? failure : disk->DeleteFile(path, force);
    }
    frame::Status Rename(std::string_view path, std::string_view newName) override {
        return Fails() ? failure : disk->Rename(path, newName);
    }
    frame::Status SetAttributes(std::string_view path, std::int32_t value) override {
        return Fails() ? failure : disk->SetAttributes(path, value);
    }
    std::string TemporaryFolder() override { return Counted(disk->TemporaryFolder()); }
    std::string SpecialFolder(int number) override { return Counted(disk->SpecialFolder(number)); }
    frame::Status OpenForReading(std::string_view path, std::unique_ptr<frame::BinaryFile>& file) override {
        return Fails() ? failure : disk->OpenForReading(path, file);
    }
    frame::Status WriteOver(std::string_view path, std::string_view bytes) override {
        return Fails() ? failure : disk->WriteOver(path, bytes);
    }

  private:
    struct WatchedListing final : frame::FolderListing {
        WatchedListing(WatchedDisk& watching, std::unique_ptr<frame::FolderListing> inner)
            : owner(watching), behind(std::move(inner)) {
            for (std::size_t index = 0; index < behind->Count(); ++index) Add(behind->Name(index));
            folders_ = behind->FolderCount();
        }
        frame::Status Stat(std::size_t index, frame::FileRecord& record) override {
            return owner.Fails() ? owner.failure : behind->Stat(index, record);
        }
        void Rest() override { behind->Rest(); }
        WatchedDisk& owner;
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
};

/// A place on a node, as far right and down as it begins: on a screen a node begins behind its sign.
inline frame::TextSize PlaceOn(const child::TreeView& tree, const std::string& key) {
    constexpr float step = 60, right = 3000, bottom = 9000;
    for (float y = 0; y < bottom; y += step)
        for (float x = 0; x < right; x += step)
            if (const child::TreeNodeRef node = tree.HitTest(x, y); node && node->Key() == key) return {x, y};
    ADD_FAILURE() << key << " is not in view";
    return {};
}

/// A host with one tree of folders on a memory disk, of which a test sees each event with its arguments, each message box and
/// each icon that the system is asked for.
class Stage {
  public:
    struct Options {
        bool designTime = false;
        const frame::PropertyBag* saved = nullptr;
        bool show = true;
        float height = foldertest::height;
        bool heard = true;                   ///< somebody listens to each event
        frame::FileSystem* files = nullptr;  ///< in the place of the memory disk
    };

    Stage() : Stage(Options()) {}
    explicit Stage(const Options& options) : view_(NewView(options)) { Clear(); }
    ~Stage() { Destroy(); }
    Stage(const Stage&) = delete;
    Stage& operator=(const Stage&) = delete;

    FolderView& View() { return view_; }
    child::TreeView& Tree() { return view_.TreeFolders; }
    frame::Host& Frame() { return host.Frame(); }
    headless::MemoryDisk& Disk() { return host.files; }
    frame::Site& TheSite() { return *view_.Site(); }
    bool Lives() { return host.FindSite(name) != nullptr; }
    void Destroy() {
        if (Lives()) host.Destroy(view_);
    }
    void Save(frame::PropertyBag& bag) { TheSite().Save(bag); }
    void SetUserMode(bool value) { host.SiteOf(view_)->SetUserMode(value); }
    void Resize(float newWidth, float newHeight) { TheSite().SetSize(newWidth, newHeight); }

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
        Changes();
        Asked();
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
        const frame::TextSize place = PlaceOn(Tree(), key);
        Tree().MouseDownInput(1, 0, place.width, place.height);
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
    std::string Messages() {
        ReadLog();
        return Joined(std::exchange(messages_, {}), " ");
    }
    static std::string NotAccessible(const std::string& text) {
        return text + " is not accessible.\r\n\r\nThis folder was moved or removed./16/Folder Not Accessible";
    }
    /// The properties that were reported since the last call.
    std::vector<std::string> Changes() {
        ReadLog();
        return std::exchange(changes_, {});
    }
    /// The icons that the system was asked for since the last call: "closed C:\x".
    std::vector<std::string> Asked() {
        ReadLog();
        return std::exchange(asked_, {});
    }

    std::function<bool(const std::string&)> hasIcon = [](const std::string&) { return true; };
    std::function<void(frame::EventArguments)> onEvent;  ///< what comes in with an event, before the application's handlers
    std::function<void()> onMessage;                     ///< what comes in while a message box is open
    WatchedDisk watched;
    test::HostUnderTest host{&watched};

  private:
    static constexpr const char* name = "FolderView1";

    FolderView& NewView(const Options& options) {
        watched.disk = options.files ? options.files : &host.files;
        host.pictures.onIcon = [this](const std::string&) {
            const bool known = hasIcon(IconOf(host.log.Entries().back()));
            host.pictures.icons.assign(1, known);
        };
        host.dialogs.onMsgBox = [this] {
            if (onMessage) onMessage();
        };
        headless::Placing placing{.designTime = options.designTime,
                                  .saved = options.saved,
                                  .width = width,
                                  .height = options.height,
                                  .show = options.show,
                                  .logEvents = false};
        if (options.heard)
            placing.onEvent = [this](const std::string&, const frame::EventInfo& event, frame::EventArguments arguments) {
                Note(event, arguments);
            };
        return host.Create<FolderView>(name, placing);
    }
    void Note(const frame::EventInfo& event, frame::EventArguments arguments) {
        std::string line(event.name);
        for (std::size_t i = 0; i < arguments.size(); ++i) line += (i == 0 ? "(" : ", ") + TextOf(arguments[i].Get());
        if (!arguments.empty()) line += ")";
        events_.push_back(line);
        if (onEvent) onEvent(arguments);
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
    static std::string IconOf(const headless::Log::Entry& entry) {
        constexpr std::int32_t closedSmall = 0x6605, openSmall = 0x6607;
        const std::int32_t flags = entry.at(2).ToLong();
        return (flags == closedSmall ? "closed " : flags == openSmall ? "open " : "other ") + entry.at(1).ToText();
    }
    void ReadLog() {
        for (const headless::Log::Entry& entry : host.log.Take()) {
            const std::string kind = entry.at(0).ToText();
            if (kind == "changed") changes_.push_back(entry.at(2).ToText());
            if (kind == "icon") asked_.push_back(IconOf(entry));
            if (kind == "msgbox")
                messages_.push_back(entry.at(1).ToText() + "/" + entry.at(2).ToText() + "/" + entry.at(3).ToText());
        }
    }
    static std::string Joined(const std::vector<std::string>& parts, const char* between) {
        std::string line;
        for (const std::string& part : parts) line += (line.empty() ? "" : between) + part;
        return line;
    }

    std::vector<std::string> events_, messages_, changes_, asked_;
    FolderView& view_;

  public:
    frame::Handlers& handlers = host.SiteOf(view_)->ApplicationHandlers();  ///< the application's; gone with the control
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
