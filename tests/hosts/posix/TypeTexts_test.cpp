#include "hosts/posix/TypeTexts.h"

#include <gtest/gtest.h>

#include "tests/hosts/TestFolder.h"

namespace tessel::posix {
namespace {

class TypeTextsTest : public testing::Test {
  protected:
    void Globs(const std::string& place, const std::string& lines) {
        folder_.Make(place + "/mime/t");
        folder_.Write(place + "/mime/globs2", "# generated\n" + lines);
    }
    void Type(const std::string& place, const std::string& name, const std::string& comments) {
        folder_.Write(place + "/mime/t/" + name + ".xml",
                      "<?xml version=\"1.0\"?>\n<mime-type type=\"t/" + name + "\">\n" + comments + "\n</mime-type>\n");
    }
    std::string TextOf(std::string_view fileName, std::vector<std::string> languages = {}) {
        TypeTexts types({folder_ / "own", folder_ / "shared"}, std::move(languages));
        return types.Text(types.IdOf(fileName));
    }

    test::TestFolder folder_;
};

TEST(TypeExtension, IsWhatStandsBehindTheLastPoint) {
    EXPECT_EQ(TypeExtension("a.txt"), "txt");
    EXPECT_EQ(TypeExtension("a.tar.gz"), "gz");
    EXPECT_EQ(TypeExtension(".bashrc"), "");
    EXPECT_EQ(TypeExtension(".a.txt"), "txt");
    EXPECT_EQ(TypeExtension("a."), "");
    EXPECT_EQ(TypeExtension("a"), "");
    EXPECT_EQ(TypeExtension(""), "");
    EXPECT_EQ(TypeExtension("a." + std::string(33, 'x')), "");
}

TEST_F(TypeTextsTest, TheDatabaseTellsByExtensionWithoutRegardToCase) {
    Globs("shared", "50:t/plain:*.txt\n");
    Type("shared", "plain", "<comment>plain text</comment>");
    EXPECT_EQ(TextOf("a.txt"), "plain text");
    EXPECT_EQ(TextOf("a.TXT"), "plain text");
    EXPECT_EQ(TextOf("a.txu"), "TXU File");
    EXPECT_EQ(TextOf("txt"), "File");
}

TEST_F(TypeTextsTest, TheUsersLanguageCountsBeforeEnglish) {
    Globs("shared", "50:t/plain:*.txt\n");
    Type("shared", "plain",
         "<comment>plain text</comment><comment xml:lang=\"de\">Textdokument</comment><comment xml:lang='de_CH'>Text &amp; "
         "&lt;&#228;&#xE4;&gt;</comment>");
    EXPECT_EQ(TextOf("a.txt", {"de_CH", "de"}), "Text & <\xC3\xA4\xC3\xA4>");
    EXPECT_EQ(TextOf("a.txt", {"de_AT", "de"}), "Textdokument");
    EXPECT_EQ(TextOf("a.txt", {"fr"}), "plain text");
    Type("shared", "plain", "<comment xml:lang=\"de\">Textdokument</comment>");
    EXPECT_EQ(TextOf("a.txt", {"fr"}), "TXT File") << "no text that the user understands";
}

TEST_F(TypeTextsTest, TheHeavierPatternCountsAndTheExactCase) {
    Globs("shared",
          "60:t/a:*.x\n50:t/b:*.x\n50:t/c:*.c\n50:t/cpp:*.C:cs\n50:t/tar:*.tar.x\n50:t/make:Makefile\n50:t/"
          "odd:*.[ab]\nnonsense\n:::\n");
    for (const char* name : {"a", "b", "c", "cpp"}) Type("shared", name, std::string("<comment>type ") + name + "</comment>");
    EXPECT_EQ(TextOf("1.x"), "type a");
    EXPECT_EQ(TextOf("1.tar.x"), "type a") << "one extension, one type";
    EXPECT_EQ(TextOf("1.c"), "type c");
    EXPECT_EQ(TextOf("1.C"), "type cpp");
    EXPECT_EQ(TextOf("1.a"), "A File");
}

TEST_F(TypeTextsTest, TheUsersOwnTypesOverruleTheSharedOnes) {
    Globs("shared", "50:t/a:*.x\n50:t/a:*.y\n80:t/heavy:*.z\n");
    Globs("own", "50:t/b:*.x\n50:t/a:__NOGLOBS__\n50:t/b:*.z\n");
    for (const char* name : {"a", "b", "heavy"}) Type("shared", name, std::string("<comment>type ") + name + "</comment>");
    EXPECT_EQ(TextOf("1.x"), "type b");
    EXPECT_EQ(TextOf("1.y"), "Y File") << "taken away";
    EXPECT_EQ(TextOf("1.z"), "type heavy");
    Type("own", "b", "<comment>my b</comment>");
    EXPECT_EQ(TextOf("1.x"), "my b");
}

TEST_F(TypeTextsTest, NumbersStayAndTextsAreReadOnce) {
    Globs("shared", "50:t/plain:*.txt\n");
    Type("shared", "plain", "<comment>plain text</comment>");
    TypeTexts types({folder_ / "shared"}, {});
    const auto id = types.IdOf("a.txt");
    EXPECT_EQ(types.IdOf("b.txt"), id);
    EXPECT_NE(types.IdOf("b.doc"), id);
    EXPECT_EQ(types.IdOf("c.txt"), id);
    EXPECT_EQ(types.IdOf("none"), TypeTexts::plainId);
    EXPECT_EQ(types.Text(id), "plain text");
    Type("shared", "plain", "<comment>other</comment>");
    EXPECT_EQ(types.Text(id), "plain text");
    EXPECT_EQ(types.Text(TypeTexts::folderId), "File Folder");
}

TEST_F(TypeTextsTest, BadFilesOfTheDatabaseDoNoHarm) {
    Globs("shared",
          std::string("50:t/a:*.a\n50:t/b:*.b\n50:../../secret:*.s\n50:t/d:*.d\n50:t/e:*.e\0x\n99999999999999:t/b:*.b\n50", 85));
    Type("shared", "a", "<comment>");
    Type("shared", "b", "<comment xml:lang=>x</comment><comment>&#xFFFFFFFF;&nope;&</comment>");
    folder_.Write("secret.xml", "<comment>secret</comment>");
    EXPECT_EQ(TextOf("1.a"), "A File");
    EXPECT_FALSE(TextOf("1.b").empty());
    EXPECT_EQ(TextOf("1.s"), "S File");
    EXPECT_EQ(TextOf("1.d"), "D File");
}

TEST(SmallFile, IsReadUpToALimit) {
    test::TestFolder folder;
    folder.Write("a", std::string(100'000, 'x'));
    EXPECT_EQ(SmallFile(folder / "a").size(), 100'000u);
    EXPECT_EQ(SmallFile(folder / "a", 99'999), "");
    EXPECT_EQ(SmallFile(folder / "none"), "");
    EXPECT_EQ(SmallFile(folder.Path()), "");
}

}  // namespace
}  // namespace tessel::posix
