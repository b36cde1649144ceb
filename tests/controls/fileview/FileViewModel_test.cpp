#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <random>
#include <string>
#include <vector>

#include "frame/Text.h"
#include "tests/controls/fileview/FileViewTestHelp.h"

/// Thousands of random changes under a shown folder, with refreshes and paints between, beside a plain model of what the list has
/// to show and to tell.
namespace tessel::controls {
namespace {

using namespace fileviewtest;

struct Thing {
    bool isFolder = false;
    std::int64_t size = 0, modified = 0;
};

/// The folder as it stands, and the rows as they must be.
class Model {
  public:
    struct Line {
        std::string name;
        bool isFolder = false, selected = false;
        std::string size;  // as its sorted text tells, from the time at which the row was made
        friend bool operator==(const Line&, const Line&) = default;
    };

    std::map<std::string, Thing> disk;
    std::vector<Line> lines;
    std::string events;

    void Paint() {
        events = "ChangedFolder(False) BeforePaint(False)";
        lines.clear();
        for (const bool folders : {true, false})
            for (const auto& [name, thing] : disk)
                if (thing.isFolder == folders) Add(name, thing);
        events += " AfterPaint";
    }
    void Refresh() {
        events.clear();
        if (lines.empty()) return;
        bool changed = false, endSeen = true;
        const std::size_t rowsOfView = 11;
        std::size_t marked = 0;
        std::vector<std::size_t> gone;
        for (std::size_t index = 0; index < lines.size(); ++index) {
            if (index >= rowsOfView + marked) {
                endSeen = false;
                break;
            }
            const auto found = disk.find(lines[index].name);
            if (found == disk.end()) {
                ++marked;
                gone.push_back(index);
                changed = true;
            } else if (!found->second.isFolder || !lines[index].isFolder) {
                changed = true;
            }
        }
        for (auto index = gone.rbegin(); index != gone.rend(); ++index)
            lines.erase(lines.begin() + static_cast<std::ptrdiff_t>(*index));
        if (lines.size() < 100 || endSeen)
            for (const bool folders : {true, false})
                for (const auto& [name, thing] : disk)
                    if (thing.isFolder == folders && !Has(name)) Add(name, thing);
        events += (events.empty() ? "" : " ") + std::string("AfterPaint");
        if (changed) events += " RefreshFoundChanges";
    }

  private:
    bool Has(const std::string& name) const {
        return std::any_of(lines.begin(), lines.end(), [&](const Line& line) { return line.name == name; });
    }
    void Add(const std::string& name, const Thing& thing) {
        lines.push_back({name, thing.isFolder, false, FileViewRows::SortedSizeText(thing.isFolder ? 0 : thing.size)});
        events += (events.empty() ? "" : " ") + std::string("BeforeAddItem(False, C:\\x\\") + name + ") AfterAddItem(" +
                  frame::Decimal(static_cast<std::int64_t>(lines.size())) + ")";
    }
};

class FileViewModel : public testing::TestWithParam<unsigned> {
  protected:
    unsigned Below(unsigned end) { return random() % end; }
    std::string Name() { return "n" + std::to_string(Below(160)); }

    void Change() {
        const std::string name = Name(), path = "C:\\x\\" + name;
        const auto found = model.disk.find(name);
        const bool there = found != model.disk.end();
        const auto size = static_cast<std::int64_t>(Below(100'000)), time = static_cast<std::int64_t>(Below(2'000'000'000));
        switch (Below(6)) {
            case 0:
            case 1:
            case 2:
                if (there) break;
                model.disk[name] = {Below(4) == 0, size, time};
                model.disk[name].isFolder ? stage.Folder(path) : stage.File(path, size, time, time);
                break;
            case 3:
                if (!there) break;
                stage.Remove(path);
                model.disk.erase(found);
                break;
            case 4: {
                const std::string other = Name();
                if (!there || model.disk.contains(other)) break;
                stage.Disk().Rename(path, other).Check();
                model.disk[other] = found->second;
                model.disk.erase(name);
                break;
            }
            default:
                if (!there || found->second.isFolder) break;
                stage.File(path, size, time, time);
                found->second.size = size;
                break;
        }
    }
    void Select() {
        if (model.lines.empty()) return;
        const std::size_t line = Below(static_cast<unsigned>(model.lines.size()));
        const bool value = Below(2) == 0;
        view.ListFiles.ListItems.Item(static_cast<std::int32_t>(line) + 1)->SetSelected(value);
        model.lines[line].selected = value;
    }
    std::vector<Model::Line> Shown() {
        std::vector<Model::Line> lines;
        for (std::int32_t index = 1; index <= view.ItemCount(); ++index) {
            const child::ListItemRef item = view.ListFiles.ListItems.Item(index);
            lines.push_back({item->Text(), item->SubItems(12).starts_with(' '), item->Selected(), item->SubItems(7)});
            EXPECT_EQ(item->SubItems(10), item->Text());
        }
        return lines;
    }

    std::mt19937 random{GetParam()};
    Stage stage;
    FileView& view = stage.View();
    Model model;
};

TEST_P(FileViewModel, TheListShowsAndTellsWhatThePlainModelSays) {
    stage.Folder("C:\\x");
    view.SetMultiSelect(true);
    stage.ShowPath("C:\\x");
    for (int step = 0; step < 3'000; ++step) {
        for (unsigned changes = Below(5); changes > 0; --changes) Change();
        Select();
        const int kept = view.ItemIndex();
        if (Below(20) == 0) {
            model.Paint();
            view.Show();
            ASSERT_EQ(view.ItemIndex(), model.lines.empty() ? 0 : 1);
        } else {
            model.Refresh();
            stage.Tick();
            ASSERT_EQ(view.ItemIndex(), kept);
        }
        ASSERT_EQ(stage.Events(), model.events) << "step " << step;
        ASSERT_TRUE(Shown() == model.lines) << "step " << step << ": " << Rows(view);
        ASSERT_EQ(Message(view).empty(), !model.lines.empty() || (model.events.empty() && view.FolderPath().empty()));
    }
    EXPECT_GT(model.disk.size(), 20u);
}

INSTANTIATE_TEST_SUITE_P(Seeds, FileViewModel, testing::Values(1u, 2u, 3u));

}  // namespace
}  // namespace tessel::controls
