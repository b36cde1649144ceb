#include "tools/tessel-host/DiskRequests.h"

#include <gtest/gtest.h>

#include "frame/Dates.h"
#include "tools/tessel-host/Session.h"

namespace tessel::tools {
namespace {

class DiskRequestsTest : public testing::Test {
  protected:
    /// The value of a reply as text; the error's number, as "error 13", when there is one.
    std::string Value(const std::string& line) {
        const Json reply = Json::parse(session_.Answer(line));
        return reply.contains("error") ? "error " + reply["error"]["number"].dump() : reply["value"].dump();
    }
    std::string Disk(const std::string& fields) { return Value(R"({"do":"disk",)" + fields + "}"); }

    Session session_;
};

TEST_F(DiskRequestsTest, TheDiskBeginsWithTheTemporaryFolder) {
    EXPECT_EQ(Disk(R"("list":"C:\\")"), R"([{"path":"C:\\Temp","size":0,"attributes":16}])");
}

TEST_F(DiskRequestsTest, WhatIsMadeIsListedTheWholeTreeBelow) {
    EXPECT_EQ(Disk(R"("folder":"C:\\x","attributes":2)"), "null");
    EXPECT_EQ(Disk(R"("file":"C:\\x\\y\\a.txt","text":"12345","attributes":1)"), "null");
    EXPECT_EQ(Disk(R"("file":"C:\\x\\b.bin","size":5000000000)"), "null");
    EXPECT_EQ(Disk(R"("list":"c:\\X")"), R"([{"path":"C:\\x\\y","size":0,"attributes":16},)"
                                         R"({"path":"C:\\x\\y\\a.txt","size":5,"attributes":1},)"
                                         R"({"path":"C:\\x\\b.bin","size":5000000000,"attributes":0}])");
    EXPECT_EQ(Disk(R"("remove":"C:\\x\\y")"), "null");
    EXPECT_EQ(Disk(R"("list":"C:\\x")"), R"([{"path":"C:\\x\\b.bin","size":5000000000,"attributes":0}])");
}

TEST_F(DiskRequestsTest, WhatExistsIsUpdated) {
    Disk(R"("file":"C:\\x\\a.txt","text":"12345","attributes":1)");
    EXPECT_EQ(Disk(R"("file":"C:\\x\\A.TXT","attributes":2)"), "null");
    EXPECT_EQ(Disk(R"("list":"C:\\x")"), R"([{"path":"C:\\x\\a.txt","size":5,"attributes":2}])");
    EXPECT_EQ(Disk(R"("folder":"C:\\x\\a.txt")"), "error 58");
}

TEST_F(DiskRequestsTest, NamesThatAreNoUtf8TravelAsElsewhere) {
    EXPECT_EQ(Disk("\"file\":\"C:\\\\x\\\\\xF4\x8F\xBF\xBF\""), "null");
    EXPECT_EQ(Disk(R"("list":"C:\\x")"), "[{\"path\":\"C:\\\\x\\\\\xF4\x8F\xBF\xBF\",\"size\":0,\"attributes\":0}]");
}

TEST_F(DiskRequestsTest, WhatIsMissingOrWrongIsRefused) {
    for (const char* fields :
         {R"("x":1)", R"("file":7)", R"("file":"C:\\a","size":-1)", R"("file":"C:\\a","unreadable":1)",
          R"("file":"C:\\a","picture":[1])", R"("file":"C:\\a","picture":[-1,1])", R"("drive":"C","ready":"no")"})
        EXPECT_EQ(Disk(fields), "error 5") << fields;
    EXPECT_EQ(Disk(R"("file":"C:\\a","modified":"soon")"), "error 13");
    EXPECT_EQ(Disk(R"("file":"C:\\a","size":"big")"), "error 13");
    EXPECT_EQ(Disk(R"("drive":"CD")"), "error 52");
    EXPECT_EQ(Disk(R"("file":"C:\\a*b")"), "error 52");
    EXPECT_EQ(Disk(R"("file":"a")"), "error 52");
    EXPECT_EQ(Disk(R"("list":"C:\\none")"), "error 76");
    EXPECT_EQ(Disk(R"("remove":"C:\\none")"), "error 53");
}

/// What the requests leave on a disk.
class CarryOutDiskTest : public testing::Test {
  protected:
    Json Carry(const std::string& fields) {
        const ObjectFinder none;
        return CarryOutDisk(disk_, Json::parse("{" + fields + "}"), [&](const Json& json) { return FromJson(json, none); });
    }
    headless::MemoryDisk disk_;
};

TEST_F(CarryOutDiskTest, AFileHasAllThatItIsGiven) {
    Carry(R"("file":"C:\\a.txt","text":"12","attributes":3,"created":"2001-02-03 04:05:06","modified":"2001-02-03 04:05:07",)"
          R"("accessed":"2001-02-03 04:05:08","type":"Letter","picture":[1500,900])");
    frame::FileRecord record;
    disk_.Stat("C:\\a.txt", record).Check();
    const auto created = headless::SecondsOf(*frame::ParseDate("2001-02-03 04:05:06"));
    EXPECT_EQ(record.created, created);
    EXPECT_EQ(record.modified, created + 1);
    EXPECT_EQ(record.accessed, created + 2);
    EXPECT_EQ(record.attributes, 3);
    EXPECT_EQ(disk_.TypeText(record.typeId), "Letter");
    EXPECT_EQ(disk_.PictureSize("C:\\a.txt"), std::pair(1500.0f, 900.0f));
    Carry(R"("file":"C:\\a.txt","unreadable":true)");
    std::unique_ptr<frame::BinaryFile> file;
    EXPECT_EQ(disk_.OpenForReading("C:\\a.txt", file).Number(), 70);
}

TEST_F(CarryOutDiskTest, ADriveHasAllThatItIsGiven) {
    Carry(R"("drive":"C","type":1,"volume":"WORK","share":"\\\\s\\n","ready":true,"readonly":true)");
    EXPECT_EQ(disk_.Drives()[0], (frame::DriveRecord{"C:", "C:\\", "C", 1, "\\\\s\\n", "WORK", true}));
    EXPECT_EQ(disk_.CreateFolder("C:\\x").Number(), 70);
    Carry(R"("drive":"C","readonly":false)");
    EXPECT_FALSE(disk_.CreateFolder("C:\\x").Failed());
    Carry(R"("drive":"C","ready":false)");
    EXPECT_FALSE(disk_.FolderExists("C:\\"));
    Carry(R"("remove":"C:\\")");
    EXPECT_TRUE(disk_.Drives().empty());
}

TEST_F(CarryOutDiskTest, TheFreeSpaceIsLimitedAndNullLiftsTheLimit) {
    Carry(R"("free":3)");
    EXPECT_EQ(disk_.WriteOver("C:\\a", "1234").Number(), 61);
    Carry(R"("free":null)");
    EXPECT_FALSE(disk_.WriteOver("C:\\a", "1234").Failed());
}

TEST_F(DiskRequestsTest, SpecialFoldersAreNamedInAnyCase) {
    EXPECT_EQ(Value(R"({"do":"special","name":"Personal","path":"C:\\Docs"})"), "null");
    EXPECT_EQ(Value(R"({"do":"special","name":"PERSONAL","path":""})"), "null");
    EXPECT_EQ(Value(R"({"do":"special","name":"My Documents","path":"C:\\Docs"})"), "error 5");
    EXPECT_EQ(Value(R"({"do":"special","name":"Personal"})"), "error 5");
}

TEST(RealDiskSession, HasNoMemoryDisk) {
    Session session(1000, DiskKind::Real);
    EXPECT_EQ(session.Answer(R"({"do":"disk","list":"C:\\"})"),
              R"({"error":{"number":5,"description":"The memory disk is not in use"},"log":[]})");
    EXPECT_EQ(session.Answer(R"({"do":"special","name":"Personal","path":"/data"})"), R"({"value":null,"log":[]})");
}

}  // namespace
}  // namespace tessel::tools
