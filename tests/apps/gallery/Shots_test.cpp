#include "apps/gallery/Shots.h"

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QImage>
#include <QTemporaryDir>

#include "apps/gallery/Page.h"
#include "apps/gallery/Window.h"

namespace tessel::gallery {
namespace {

TEST(ShotsTest, EveryStateOfEveryPageIsRenderedLightAndDark) {
    const QTemporaryDir folder;
    const QString shots = folder.filePath("new/shots");
    ASSERT_EQ(TakeShots(shots), 0);
    qsizetype states = 0;
    const Window window;
    for (const Page* page : window.pages()) states += page->poses().size();
    const QStringList files = QDir(shots).entryList({"*.png"});
    EXPECT_EQ(files.size(), 2 * states);
    for (const QString& file : files) EXPECT_EQ(QImage(QDir(shots).filePath(file)).size(), window.size()) << file.toStdString();
    EXPECT_TRUE(files.contains("links-dark-1x.png"));
    EXPECT_TRUE(files.contains("files-report-light-1x.png"));
}

TEST(ShotsTest, AFolderThatCannotBeMadeIsAFailure) {
    const QTemporaryDir folder;
    QFile file(folder.filePath("file"));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    EXPECT_EQ(TakeShots(folder.filePath("file/shots")), 1);
}

}  // namespace
}  // namespace tessel::gallery
