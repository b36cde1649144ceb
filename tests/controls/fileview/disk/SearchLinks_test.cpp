#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "controls/fileview/FileView.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/posix/DiskFileSystem.h"
#include "tests/hosts/TestFolder.h"

/// The list of files on the real disk, where that has what the disk in memory lacks.
namespace tessel::controls {
namespace {

namespace fs = std::filesystem;

class SearchLinks : public testing::Test {
  protected:
    /// Folder and name of each row, below the folder of the test: "/sub/a.txt | /b.txt".
    std::string Rows() const {
        std::string line;
        const child::ListRows& rows = view_.ListFiles.Rows();
        for (child::ListRows::Position position = 0; position < rows.Count(); ++position) {
            const std::string path =
                rows.Text(rows.At(position), subItem::folder) + "/" + rows.Text(rows.At(position), subItem::realName);
            line += (position == 0 ? "" : " | ") + path.substr(folder_.Path().size());
        }
        return line;
    }
    int Turns() const { return static_cast<int>(host_.log.Of("yield").size()); }

    test::TestFolder folder_;
    posix::DiskFileSystem disk_;
    headless::HeadlessHost host_{&disk_};
    FileView& view_{host_.Create<FileView>("FileView1")};
};

TEST_F(SearchLinks, ASearchDoesNotFollowLinksToFolders) {
    folder_.Make("sub");
    folder_.Make("other");
    folder_.Write("a.txt", "a");
    folder_.Write("sub/b.txt", "b");
    fs::create_symlink(folder_.Path(), folder_ / "sub/up");
    fs::create_symlink("../other", folder_ / "sub/beside");
    folder_.Write("other/c.txt", "c");
    view_.Search("*.txt", folder_.Path(), true);
    EXPECT_EQ(Rows(), "/a.txt | /other/c.txt | /sub/b.txt");
    EXPECT_EQ(view_.TotalSize(), frame::Variant(3));
}

TEST_F(SearchLinks, ASearchBeginsInALinkAndFindsLinksToFiles) {
    folder_.Make("sub");
    folder_.Write("sub/b.txt", "b");
    fs::create_symlink("b.txt", folder_ / "sub/c.txt");
    fs::create_symlink("sub", folder_ / "tosub");
    view_.Search("*.txt", folder_ / "tosub", true);
    EXPECT_EQ(Rows(), "/tosub/b.txt | /tosub/c.txt");
}

/// The entry itself counts as any other sub-folder.
TEST_F(SearchLinks, ALinkToAFolderThatMatchesHasItsTurnOfTheMessageLoop) {
    folder_.Make("sub");
    fs::create_symlink("..", folder_ / "sub/up");
    view_.Search("none", folder_.Path(), true);
    const int without = Turns();
    host_.log.Clear();
    view_.Search("up", folder_.Path(), true);
    EXPECT_EQ(Turns(), without + 1);
}

TEST_F(SearchLinks, AListingShowsALinkToAFolderAsAFolder) {
    folder_.Make("sub");
    fs::create_symlink("sub", folder_ / "tosub");
    view_.SetPathRoot(folder_.Path());
    EXPECT_EQ(Rows(), "/sub | /tosub");
}

}  // namespace
}  // namespace tessel::controls
