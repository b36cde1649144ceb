#include <gtest/gtest.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <random>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "frame/Text.h"
#include "tests/controls/folderview/FolderViewTestHelp.h"

/// Thousands of random changes of the disk, clicks, expansions and refreshes, beside a plain model of what the tree has to show
/// and to tell.
namespace tessel::controls {
namespace {

using namespace foldertest;

std::string NameOf(const std::string& path) { return path.substr(path.rfind('\\') + 1); }
std::string ParentOf(const std::string& path) { return path.substr(0, path.rfind('\\')); }
bool IsWithin(const std::string& path, const std::string& folder) { return path == folder || path.starts_with(folder + "\\"); }

/// The folders as they stand, and the nodes as they must be.
class Model {
  public:
    struct Node {
        std::string key, text, parent;
        bool expanded = false, checked = false;
        friend bool operator==(const Node&, const Node&) = default;
    };

    std::set<std::string> disk;
    std::vector<Node> nodes;  ///< in the order of their indexes
    std::vector<std::string> myFolders{""};
    std::string root, path, selected, events, messages;
    std::int32_t cursor = 0;
    bool autoFill = false;
    bool selectionGone = false;  ///< the selected node was taken out, and the tree has chosen another

    bool IsMyFolders() const { return root == word; }
    bool Exists(const std::string& folder) const { return disk.contains(folder); }
    Node* Find(const std::string& key) {
        const auto found = std::find_if(nodes.begin(), nodes.end(), [&](const Node& node) { return node.key == key; });
        return found == nodes.end() ? nullptr : &*found;
    }
    std::int32_t IndexOf(const std::string& key) { return static_cast<std::int32_t>(Find(key) - nodes.data()) + 1; }

    void Build() {
        nodes.clear();
        selected.clear();
        events = "BeforePaint(False)";
        if (IsMyFolders()) {
            nodes.push_back({word, word, ""});
            myFolders = {""};
            selected = word;
            cursor = 1;
        } else if (Exists(root)) {
            Add(root, "");
            Fill(root);
        }
        path = root;
        Tell("AfterPaint ChangedFolder");
    }
    void Click(const std::string& key) {
        selected = key;
        Tell("NodeClick(" + key + ")");
        cursor = IndexOf(key);
        Fill(key);
        Report(key);
    }
    void Expand(const std::string& key) {
        Find(key)->expanded = true;
        Tell("Expand(" + key + ")");
        if (key == word) return;
        if (!Exists(key)) {
            TellGone(key);
            return;
        }
        Fill(key);
        if (!autoFill) return;
        for (const std::string& child : ChildrenOf(key)) Fill(child);
    }
    void Collapse(const std::string& key) {
        Find(key)->expanded = false;
        Tell("Collapse(" + key + ")");
    }
    std::int32_t GoUp() {
        const Node* node = Find(selected);
        if (!node || node->parent.empty()) return 0;
        const std::string parent = node->parent;
        selected = parent;
        Report(parent);
        return Find(parent) ? IndexOf(parent) : 0;
    }
    void SetPath(const std::string& value) {
        if (value == path) return;
        if (Find(value)) selected = value;
        path = value;
    }
    void Refresh() {
        for (std::size_t index = 0; index < nodes.size();) {
            Node& node = nodes[index];
            const bool exists = Exists(node.key);
            if (node.key != word && node.parent == word) {
                if (exists && node.checked) {
                    node.text = NameOf(node.key);
                    node.checked = false;
                } else if (!exists && !node.checked) {
                    node.text = node.key + " (Unavailable)";
                    node.checked = true;
                }
            } else if (node.key != word && !exists) {
                Remove(node.key);  // what comes behind takes its place
                continue;
            }
            ++index;
        }
        for (std::size_t index = 0; index < nodes.size(); ++index) {
            const std::string key = nodes[index].key;
            if (!IsInView(key)) continue;
            for (const std::string& folder : SubFoldersOf(key))
                if (!Find(folder)) AddBelow(folder, key);
        }
    }
    std::int32_t AddMyFolder(const std::string& folder) {
        if (Exists(folder)) {
            AddBelow(folder, word);
            Fill(folder);
        } else {
            nodes.push_back({folder, folder + " (Unavailable)", word, false, true});
        }
        myFolders.push_back(folder);
        return IndexOf(folder);
    }
    std::int32_t CreateSubFolder(const std::string& name) {
        const std::string parent = selected;
        if (!Exists(parent) || Exists(parent + "\\" + name)) return 0;
        const std::string made = parent + "\\" + name;
        disk.insert(made);
        // A node of that label is there when the folder has gone since.
        if (!AddBelow(made, parent)) return -1;
        Tell("AfterAddItem(" + std::to_string(nodes.size()) + ")");
        return static_cast<std::int32_t>(nodes.size());
    }
    std::vector<std::string> ChildrenOf(const std::string& key) const {
        std::vector<const Node*> children;
        for (const Node& node : nodes)
            if (node.parent == key && node.key != root) children.push_back(&node);
        std::stable_sort(children.begin(), children.end(), [](const Node* a, const Node* b) { return a->text < b->text; });
        std::vector<std::string> keys;
        for (const Node* child : children) keys.push_back(child->key);
        return keys;
    }

    static constexpr const char* word = "My Folders";

  private:
    void Tell(const std::string& event) { events += (events.empty() ? "" : " ") + event; }
    std::vector<std::string> SubFoldersOf(const std::string& folder) const {
        std::vector<std::string> found;
        for (const std::string& other : disk)
            if (ParentOf(other) == folder) found.push_back(other);
        return found;
    }
    bool IsInView(const std::string& key) {
        for (std::string parent = Find(key)->parent; !parent.empty(); parent = Find(parent)->parent)
            if (!Find(parent)->expanded) return false;
        return true;
    }
    void Add(const std::string& folder, const std::string& parent) {
        Tell("BeforeAddItem(False)");
        nodes.push_back({folder, NameOf(folder), parent});
        Tell("AfterAddItem(" + std::to_string(nodes.size()) + ")");
    }
    bool AddBelow(const std::string& folder, const std::string& parent) {
        for (const std::string& child : ChildrenOf(parent))
            if (Find(child)->text == NameOf(folder)) return false;
        Add(folder, parent);
        return true;
    }
    void Fill(const std::string& key) {
        for (const std::string& folder : SubFoldersOf(key)) AddBelow(folder, key);
        for (const std::string& child : ChildrenOf(key))
            if (!Exists(child)) Remove(child);
    }
    void Report(const std::string& key) {
        if (key == path) return;
        if (key != word && !Exists(key)) {
            TellGone(key);
            return;
        }
        path = key;
        Tell("ChangedFolder");
    }
    void TellGone(const std::string& key) {
        messages += (messages.empty() ? "" : " ") + Stage::NotAccessible(Find(key)->text);
        Remove(key);
    }
    bool IsBelow(std::string key, const std::string& ancestor) {
        while (!key.empty() && key != ancestor) key = Find(key)->parent;
        return !key.empty();
    }
    void Remove(const std::string& key) {
        if (!selected.empty() && IsBelow(selected, key)) {
            const std::string parent = Find(key)->parent;
            const std::vector<std::string> siblings = ChildrenOf(parent);
            const auto place = std::find(siblings.begin(), siblings.end(), key);
            selected = parent;
            if (place != siblings.end() && place != siblings.begin()) selected = place[-1];
            if (place != siblings.end() && place + 1 != siblings.end()) selected = place[1];
            selectionGone = true;
        }
        std::vector<std::string> leaving;
        for (const Node& node : nodes)
            if (IsBelow(node.key, key)) leaving.push_back(node.key);
        std::erase_if(nodes,
                      [&](const Node& node) { return std::find(leaving.begin(), leaving.end(), node.key) != leaving.end(); });
    }
};

struct Trial {
    const char* name;
    const char* root;
    unsigned seed;
};

class FolderViewModel : public testing::TestWithParam<Trial> {
  protected:
    static constexpr const char* top = "C:\\x";

    unsigned Below(unsigned end) { return random() % end; }
    bool Chance(unsigned of) { return Below(of) == 0; }
    std::string Folder() {
        std::string path = top;
        for (unsigned depth = Below(3) + 1; depth > 0; --depth) path += "\\n" + std::to_string(Below(5));
        return path;
    }
    std::string AnyNode() {
        return model.nodes.empty() ? std::string() : model.nodes[Below(static_cast<unsigned>(model.nodes.size()))].key;
    }

    void ChangeDisk() {
        const std::string path = Folder();
        switch (Below(4)) {
            case 0:
            case 1:
                stage.Folder(path);
                for (std::string folder = path; folder != "C:"; folder = ParentOf(folder)) model.disk.insert(folder);
                break;
            case 2: {
                const std::string gone = Chance(40) ? top : path;
                if (!model.Exists(gone)) break;
                stage.Remove(gone);
                std::erase_if(model.disk, [&](const std::string& folder) { return IsWithin(folder, gone); });
                break;
            }
            default: {
                const std::string name = "n" + std::to_string(Below(5)), other = ParentOf(path) + "\\" + name;
                if (!model.Exists(path) || model.Exists(other)) break;
                stage.Disk().Rename(path, name).Check();
                std::set<std::string> moved;
                for (const std::string& folder : model.disk)
                    moved.insert(IsWithin(folder, path) ? other + folder.substr(path.size()) : folder);
                model.disk = std::move(moved);
            }
        }
    }
    void Act() {
        const std::string node = AnyNode();
        const unsigned act = Below(20);
        if (act == 0) {
            view.Show();
            model.Build();
        } else if (act == 1) {
            view.SetAutoFillSubFolders(model.autoFill = !model.autoFill);
        } else if (act == 2) {
            const std::string path = Folder();
            view.SetFolderPath(path);
            model.SetPath(path);
        } else if (act < 6) {
            // A node that comes into view with a refresh is read by this one or by the next.
            for (bool told = true; told;) {
                stage.Tick();
                const std::string events = stage.Events();
                told = !events.empty();
                refreshed += (refreshed.empty() || events.empty() ? "" : " ") + events;
            }
            model.Refresh();
        } else if (node.empty()) {
            return;
        } else if (act < 10) {
            stage.Click(node);
            model.Click(node);
        } else if (act < 14) {
            stage.Expand(node);
            model.Expand(node);
        } else if (act < 16) {
            stage.Collapse(node);
            model.Collapse(node);
        } else if (act == 16) {
            const std::int32_t index = model.GoUp();
            EXPECT_EQ(view.GoUp(), index);
        } else if (act == 17) {
            stage.Select(node);
            model.selected = node;
        } else if (model.IsMyFolders()) {
            AddMyFolder();
        } else {
            CreateFolder();
        }
    }
    /// An entry that has no node yet: what a second one brings is not for a model to say.
    void AddMyFolder() {
        const std::string folder = std::string(top) + "\\n" + std::to_string(Below(5));
        if (model.Find(folder) || model.nodes.empty()) return;
        view.SetItemIndex(model.cursor = 1);
        const std::int32_t index = model.AddMyFolder(folder);
        EXPECT_EQ(view.AddNewFolder(folder), index);
    }
    void CreateFolder() {
        view.SetItemIndex(model.cursor = 1);
        const std::string name = "n" + std::to_string(Below(5));
        const std::string key = model.selected + "\\" + name;
        if (model.Find(key) && !model.Exists(key)) return;
        const std::int32_t index = model.CreateSubFolder(name);
        EXPECT_EQ(view.AddNewFolder(name), index);
    }

    std::vector<Model::Node> Shown() {
        std::vector<Model::Node> nodes;
        for (std::int32_t index = 1; index <= view.ItemCount(); ++index) {
            const child::TreeNodeRef node = stage.Tree().Nodes.Item(index);
            const child::TreeNodeRef parent = node->Parent();
            nodes.push_back({node->Key(), node->Text(), parent ? parent->Key() : std::string(), node->Expanded(), node->Checked()});
        }
        return nodes;
    }
    /// A node whose children do not stand by their texts. Among the entries of "My Folders" a text that was set moves nothing by
    /// itself.
    std::string OutOfOrder() {
        for (const Model::Node& node : model.nodes) {
            if (node.key == Model::word) continue;
            std::vector<std::string> keys;
            for (child::TreeNodeRef child = stage.Node(node.key)->Child(); child; child = child->Next())
                keys.push_back(child->Key());
            if (keys != model.ChildrenOf(node.key)) return node.key;
        }
        return {};
    }
    /// Which node the tree selects for one that has gone depends on the order of the entries, which is the tree's affair.
    void TakeSelection() {
        if (!model.IsMyFolders() || !std::exchange(model.selectionGone, false)) return;
        model.selected = stage.Selected();
    }

    std::mt19937 random{GetParam().seed};
    Stage stage{Stage::Options{.height = 300'000}};
    FolderView& view = stage.View();
    Model model;
    std::string refreshed;
};

TEST_P(FolderViewModel, TheTreeShowsAndTellsWhatThePlainModelSays) {
    stage.Folder(top);
    model.disk = {"C:\\Temp", top};
    model.root = GetParam().root;
    stage.ShowRoot(model.root);
    model.Build();
    std::size_t most = 0, told = 0, removed = 0;
    for (int step = 0; step < 5'000; ++step) {
        for (unsigned changes = Below(3); changes > 0; --changes) ChangeDisk();
        model.events.clear();
        model.messages.clear();
        refreshed.clear();
        Act();
        std::string events = stage.Events();
        if (!refreshed.empty()) events = refreshed;
        SCOPED_TRACE("step " + std::to_string(step));
        TakeSelection();
        ASSERT_EQ(events, model.events);
        const std::string messages = stage.Messages();
        ASSERT_EQ(messages, model.messages);
        const std::vector<Model::Node> shown = Shown();
        ASSERT_TRUE(shown == model.nodes) << Labels(view);
        ASSERT_EQ(stage.Selected(), model.selected);
        ASSERT_EQ(view.FolderPath(), model.path);
        ASSERT_EQ(view.ItemIndex(), model.cursor);
        std::string listed;
        for (const std::string& folder : model.myFolders) listed += (&folder == &model.myFolders.front() ? "" : " | ") + folder;
        ASSERT_EQ(MyFolders(view), listed);
        ASSERT_EQ(OutOfOrder(), "") << Labels(view);
        most = std::max(most, shown.size());
        told += events.find("AddItem") != std::string::npos;
        removed += !messages.empty();
    }
    EXPECT_GT(most, 15u);
    EXPECT_GT(told, 100u);
    EXPECT_GT(removed, 10u);
}

const Trial trials[] = {
    {"Folder1", "C:\\x", 1},         {"Folder2", "C:\\x", 2},         {"Folder3", "C:\\x", 3},
    {"MyFolders1", "My Folders", 4}, {"MyFolders2", "My Folders", 5}, {"MyFolders3", "My Folders", 6},
};
std::string NameOfTrial(const testing::TestParamInfo<Trial>& tested) { return tested.param.name; }
INSTANTIATE_TEST_SUITE_P(Seeds, FolderViewModel, testing::ValuesIn(trials), NameOfTrial);

}  // namespace
}  // namespace tessel::controls
