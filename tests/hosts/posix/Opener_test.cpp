#include "hosts/posix/Opener.h"

#include <fcntl.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <limits.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <utility>
#include <vector>

namespace tessel::posix {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

using namespace std::string_literals;

std::string ContentOf(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// The text with `end` behind each part, as its parts.
std::vector<std::string> Parts(const std::string& text, char end) {
    std::vector<std::string> parts;
    for (std::size_t from = 0; from < text.size();) {
        const std::size_t to = std::min(text.find(end, from), text.size());
        parts.push_back(text.substr(from, to - from));
        from = to + 1;
    }
    return parts;
}

/// A folder of its own, which is the current one while the test runs, with programs that note what they are given.
class OpenerTest : public testing::Test {
  protected:
    OpenerTest() {
        std::string name = (std::filesystem::temp_directory_path() / "openerXXXXXX").string();
        if (mkdtemp(name.data()) == nullptr)
            throw std::filesystem::filesystem_error("mkdtemp", std::error_code(errno, std::generic_category()));
        root = std::filesystem::canonical(name).string();
        folder = root + "/here";
        std::filesystem::create_directory(folder);
        chmod(root.c_str(), 0755);
        std::filesystem::current_path(folder);
        settings.openCommand = {Program("opener"), "first word", "--"};
        settings.printCommand = {Program("printer"), "-x"};
        settings.wait = std::chrono::minutes(1);
    }

    ~OpenerTest() override {
        std::filesystem::current_path(before);
        std::error_code error;
        std::filesystem::remove_all(root, error);
    }

    /// Writes a program that notes its arguments, runs `more`, and ends with `status`.
    std::string Program(const std::string& name, int status = 0, const std::string& more = {}) {
        std::string path = root + '/' + name;
        std::ofstream(path) << "#!/bin/sh\nroot='" << root << "'\nprintf '%s\\0' \"$@\" > \"$root/" << name << ".given\"\n"
                            << more << "\nexit " << status << '\n';
        chmod(path.c_str(), 0755);
        return path;
    }

    std::string File(const std::string& name, mode_t mode = 0644) {
        std::string path = name.starts_with('/') ? name : folder + '/' + name;
        std::ofstream(path) << "text";
        chmod(path.c_str(), mode);
        return path;
    }

    int Execute(std::string_view verb, const std::string& target) {
        std::filesystem::remove(root + "/opener.given");
        std::filesystem::remove(root + "/printer.given");
        return Opener(settings).Execute(verb, target);
    }
    int Open(const std::string& target) { return Execute("open", target); }
    int Print(const std::string& target) { return Execute("print", target); }

    /// What a program was given at the last call; nothing when it was not run.
    std::optional<std::vector<std::string>> Given(const std::string& name = "opener") {
        if (!std::filesystem::exists(root + '/' + name + ".given")) return {};
        return Parts(ContentOf(root + '/' + name + ".given"), '\0');
    }

    /// The one argument behind those of the command.
    std::string Handed() {
        const auto given = Given();
        if (!given) return "(not run)";
        return given->size() == 3 && given->at(0) == "first word" && given->at(1) == "--" ? given->at(2) : "(other arguments)";
    }

    const std::filesystem::path before = std::filesystem::current_path();
    std::string root, folder;
    OpenerSettings settings;
};

// Files

TEST_F(OpenerTest, AFileIsHandedOnByItsAbsolutePathBehindTheCommandsOwnArguments) {
    const std::string file = File("a.txt");
    EXPECT_EQ(Open(file), opened::success);
    EXPECT_GT(opened::success, 32);
    EXPECT_THAT(*Given(), ElementsAre("first word", "--", file));
    EXPECT_EQ(Open("a.txt"), opened::success);
    EXPECT_EQ(Handed(), file);
    EXPECT_FALSE(Given("printer"));
}

TEST_F(OpenerTest, AFileIsPrintedByThePrintCommand) {
    const std::string file = File("a.txt");
    EXPECT_EQ(Print("a.txt"), opened::success);
    EXPECT_THAT(*Given("printer"), ElementsAre("-x", file));
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, HostileNamesArriveAsTheyAre) {
    for (const std::string& name :
         {"--help"s, "-rf"s, "$(touch made)"s, "`touch made`"s, "a b'c\""s, "two\nlines\n"s, "\xff\xfe\x80"s, "*"s, "%s%n"s,
          "a;touch made"s, "~"s, "$HOME"s, " a "s, "\\"s, "100%41"s, "\xc3\xa4@"s}) {
        const std::string file = File(name);
        EXPECT_EQ(Open(name), opened::success) << name;
        EXPECT_EQ(Handed(), file);
        EXPECT_EQ(Print(name), opened::success) << name;
        EXPECT_THAT(*Given("printer"), ElementsAre("-x", file));
    }
    EXPECT_FALSE(std::filesystem::exists("made"));
}

TEST_F(OpenerTest, AFolderIsOpenedAndNotPrinted) {
    std::filesystem::create_directory("sub.desktop");
    EXPECT_EQ(Open("sub.desktop"), opened::success);
    EXPECT_EQ(Handed(), folder + "/sub.desktop");
    EXPECT_EQ(Open("."), opened::success);
    EXPECT_EQ(Handed(), folder + "/.");
    EXPECT_EQ(Open("/"), opened::success);
    EXPECT_EQ(Handed(), "/");
    EXPECT_EQ(Print("sub.desktop"), opened::noProgram);
    EXPECT_FALSE(Given("printer"));
}

TEST_F(OpenerTest, AMissingFileIsToldFromAMissingFolder) {
    File("a.txt");
    for (const char* const missing : {"none", "none/", "../none", "/none", "a:b", "C:\\x"}) EXPECT_EQ(Open(missing), 2) << missing;
    for (const char* const missing : {"none/a.txt", "none/none/", "/none/a.txt", "a.txt/b"}) EXPECT_EQ(Open(missing), 3) << missing;
    EXPECT_EQ(Print("none"), 2);
    EXPECT_EQ(Print("none/a.txt"), 3);
    EXPECT_EQ(Open(folder + "/none"), 2);
    std::filesystem::create_symlink("none", "dangling");
    EXPECT_EQ(Open("dangling"), 2);
    EXPECT_FALSE(Given());
    EXPECT_FALSE(Given("printer"));
}

TEST_F(OpenerTest, AnEmptyTargetAndOneWithANulAreMissing) {
    File("a");
    for (const std::string& target :
         {""s, "a\0"s, "a\0b"s, "\0"s, "http://a.b/\0"s, "file:a%00"s, "file:"s, "file://"s, "file://localhost"s}) {
        EXPECT_EQ(Open(target), 2) << target;
        EXPECT_EQ(Print(target), 2) << target;
    }
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, ANameTooLongForTheSystemIsMissing) {
    EXPECT_EQ(Open(std::string(NAME_MAX + 1, 'a')), 2);
    std::string path = "/";
    while (path.size() <= PATH_MAX) path += "./";
    EXPECT_EQ(Open(path), 2);
    EXPECT_EQ(Print(path + "a"), 2);
    EXPECT_EQ(Open("file://" + path), 2);
    EXPECT_EQ(Open(std::string(1'000'000, 'a')), 2);
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, ACurrentFolderThatIsGoneIsAMissingFolder) {
    const std::string file = File(root + "/a.txt");
    std::filesystem::remove(folder);
    EXPECT_EQ(Open("a.txt"), 3);
    EXPECT_FALSE(Given());
    EXPECT_EQ(Open(file), opened::success);
}

TEST_F(OpenerTest, ALinkThatLeadsToItselfIsAnotherFailure) {
    std::filesystem::create_symlink("loop", "loop");
    EXPECT_EQ(Open("loop"), opened::failed);
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, WhatMayNotBeReadIsDenied) {
    File("secret.txt", 0);
    std::filesystem::create_directory("closed");
    File("closed/a.txt");
    chmod("closed", 0);
    // Root may read all; what counts is the effective user.
    const uid_t user = geteuid();
    const uid_t nobody = 65534;
    ASSERT_EQ(seteuid(user == 0 ? nobody : user), 0);
    const int secret = Open(folder + "/secret.txt"), closed = Open(folder + "/closed"), inside = Open(folder + "/closed/a.txt");
    const int printed = Print(folder + "/secret.txt");
    ASSERT_EQ(seteuid(user), 0);
    chmod("closed", 0700);
    EXPECT_EQ(secret, 5);
    EXPECT_EQ(closed, 5);
    EXPECT_EQ(inside, 5);
    EXPECT_EQ(printed, 5);
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, AFileThatCouldBeRunIsNotOpened) {
    for (const mode_t mode : {0744, 0654, 0645, 0755}) {
        File("run", mode);
        EXPECT_EQ(Open("run"), 5) << mode;
    }
    File("a.desktop");
    File("b.DeskTop");
    std::filesystem::create_symlink("a.desktop", "innocent.txt");
    std::filesystem::create_symlink("run", "also innocent.txt");
    for (const char* const name : {"a.desktop", "b.DeskTop", "innocent.txt", "also innocent.txt", "file:a%2Edesktop"})
        EXPECT_EQ(Open(name), 5) << name;
    EXPECT_FALSE(Given());

    EXPECT_EQ(Print("run"), opened::success);
    std::ofstream("script.sh") << "#!/bin/sh\n";
    EXPECT_EQ(Open("script.sh"), opened::success);
    File("a.desktop.txt");
    EXPECT_EQ(Open("a.desktop.txt"), opened::success);
}

TEST_F(OpenerTest, APipeOrADeviceIsNoDocument) {
    ASSERT_EQ(mkfifo("pipe", 0644), 0);
    EXPECT_EQ(Open("pipe"), 5);
    EXPECT_EQ(Print("pipe"), 5);
    EXPECT_EQ(Open("/dev/null"), 5);
    EXPECT_FALSE(Given());
}

// Addresses

TEST_F(OpenerTest, AnAddressIsHandedOnAsItIs) {
    for (const char* const address : {"http://a.example/b?c=d&e=%20#f", "HTTPS://a.example", "mailto:a@b.example", "ftp:x",
                                      "a+b-c.9:", "zz:", "http://$(touch made)", "http://a b'c\"\n--help", "http://\xff"}) {
        EXPECT_EQ(Open(address), opened::success) << address;
        EXPECT_EQ(Handed(), address);
        EXPECT_EQ(Print(address), opened::noProgram) << address;
    }
    EXPECT_FALSE(Given("printer"));
    EXPECT_FALSE(std::filesystem::exists("made"));
}

TEST_F(OpenerTest, WhatOnlyLooksLikeASchemeIsAPath) {
    for (const char* const name : {"c:", "9a:b", "-a:b", "+a:b", "a_b:c", "a b:c", ":b", "\xc3\xa4\xc3\xa4:b"}) {
        EXPECT_EQ(Open(name), 2) << name;
        const std::string file = File(name);
        EXPECT_EQ(Open(name), opened::success) << name;
        EXPECT_EQ(Handed(), file);
    }
}

TEST_F(OpenerTest, AMailAddressIsOpenedAsOne) {
    for (const char* const address : {"me@home.example", "-me@home.example", "$(a)@b.c", "a.b@c.d.e"}) {
        EXPECT_EQ(Open(address), opened::success) << address;
        EXPECT_EQ(Handed(), "mailto:"s + address);
        EXPECT_EQ(Print(address), opened::noProgram) << address;
    }
    for (const char* const other : {"me@home", "a.b@home", "a@b@c.example", "a b@c.example", "a@b.c\n", "@c.example", "me.example"})
        EXPECT_EQ(Open(other), 2) << other;
    EXPECT_EQ(Open("a/b@c.example"), 3);
}

TEST_F(OpenerTest, AFileNamedLikeAMailAddressIsAFile) {
    const std::string file = File("me@home.example");
    EXPECT_EQ(Open("me@home.example"), opened::success);
    EXPECT_EQ(Handed(), file);
    EXPECT_EQ(Print("me@home.example"), opened::success);
}

TEST_F(OpenerTest, AFileAddressIsAPath) {
    const std::string file = File("a b%.txt");
    for (const std::string& address : {"file://" + folder + "/a%20b%25.txt", "FILE://LocalHost" + folder + "/a b%.txt",
                                       "file:" + folder + "/a%20b%25%2etxt", "file:a%20b%.txt"s}) {
        EXPECT_EQ(Open(address), opened::success) << address;
        EXPECT_EQ(Handed(), file);
    }
    EXPECT_EQ(Print("file://" + folder + "/a%20b%25.txt"), opened::success);
    EXPECT_THAT(*Given("printer"), ElementsAre("-x", file));
    const std::string dashed = File("--help");
    EXPECT_EQ(Open("file:%2d%2Dhelp"), opened::success);
    EXPECT_EQ(Handed(), dashed);
    EXPECT_EQ(Open("file://" + folder + "/none"), 2);
    EXPECT_EQ(Open("file://" + folder + "/none/none"), 3);
}

TEST_F(OpenerTest, AFileOfAnotherComputerIsNotFoundNorOpenedHere) {
    EXPECT_EQ(Open("file://elsewhere" + File("a.txt")), 3);
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, AFileAddressThatEndsInsideAnEscapeKeepsItsPercentSign) {
    for (const char* const name : {"a%", "a%4", "a%4g", "a%g4", "%%41"}) {
        const std::string file = File(name == "%%41"s ? "%A" : name);
        EXPECT_EQ(Open("file:"s + name), opened::success) << name;
        EXPECT_EQ(Handed(), file);
    }
}

// The programs

TEST_F(OpenerTest, TheExitStatusBecomesTheAnswer) {
    File("a.txt");
    for (const auto& [status, answer] :
         {std::pair(0, 42), {1, 1}, {2, 2}, {3, 31}, {4, 31}, {5, 1}, {126, 1}, {127, 31}, {255, 1}}) {
        Program("opener", status);
        Program("printer", status);
        EXPECT_EQ(Open("a.txt"), answer) << status;
        EXPECT_EQ(Open("http://a.example"), answer) << status;
        EXPECT_EQ(Print("a.txt"), answer) << status;
    }
    Program("opener", 0, "kill -9 $$");
    EXPECT_EQ(Open("a.txt"), opened::failed);
}

TEST_F(OpenerTest, AMissingProgramIsNoProgram) {
    File("a.txt");
    File("not a program");
    File("no format", 0755);
    for (const char* const program :
         {"surely-no-program-of-this-name", "/none/opener", "./not a program", "./no format", "./a.txt/x", ""}) {
        settings.openCommand = settings.printCommand = {program};
        EXPECT_EQ(Open("a.txt"), 31) << program;
        EXPECT_EQ(Open("http://a.example"), 31) << program;
        EXPECT_EQ(Print("a.txt"), 31) << program;
    }
    settings.openCommand = {};
    EXPECT_EQ(Open("a.txt"), 31);
    EXPECT_EQ(Open("none"), 2);
}

TEST_F(OpenerTest, AProgramIsLookedUpInThePath) {
    File("a.txt");
    settings.openCommand = {"true"};
    EXPECT_EQ(Open("a.txt"), opened::success);
    settings.openCommand = {"false"};
    EXPECT_EQ(Open("a.txt"), opened::failed);
}

TEST_F(OpenerTest, AnUnknownVerbHasNoProgram) {
    File("a.txt");
    for (const char* const verb : {"", "edit", "Open", "open "}) EXPECT_EQ(Execute(verb, "a.txt"), 31) << verb;
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, AnAddressTooLongForTheSystemIsAnotherFailure) {
    EXPECT_EQ(Open("http://" + std::string(8'000'000, 'a')), opened::failed);
    EXPECT_FALSE(Given());
}

TEST_F(OpenerTest, AProgramGetsNoDescriptorOfThisOne) {
    const std::string file = File("a.txt");
    const int descriptor = open(File("leak").c_str(), O_RDONLY);
    const int high = fcntl(descriptor, F_DUPFD, 200);
    ASSERT_GE(descriptor, 0);
    ASSERT_GE(high, 200);
    Program("opener", 0,
            "list=$(for fd in /proc/$$/fd/*; do echo \"${fd##*/} $(readlink $fd)\"; done)\necho \"$list\" > $root/files");
    EXPECT_EQ(Open(file), opened::success);
    const std::string files = ContentOf(root + "/files");
    EXPECT_THAT(files, HasSubstr("0 /dev/null\n"));
    EXPECT_THAT(files, HasSubstr("1 /dev/null\n"));
    EXPECT_THAT(files, HasSubstr("2 /dev/null\n"));
    EXPECT_THAT(files, Not(HasSubstr("leak")));
    EXPECT_THAT(files, Not(HasSubstr("200 ")));
    EXPECT_EQ(fcntl(descriptor, F_GETFD), 0) << "this program keeps its own";
    close(descriptor);
    close(high);
}

TEST_F(OpenerTest, AProgramRunsInASessionOfItsOwnWithTheSameEnvironmentAndFolder) {
    const std::string file = File("a.txt");
    Program("opener", 0,
            "read -r pid name state parent group session rest < /proc/$$/stat\n"
            "echo \"$(($pid == $$)) $(($group == $$)) $(($session == $$))\" > $root/session\n"
            "cat /proc/$$/environ > $root/environment\npwd > $root/folder");
    std::string environment;
    for (char** entry = environ; *entry != nullptr; ++entry) environment += *entry + "\0"s;
    EXPECT_EQ(Open(file), opened::success);
    EXPECT_EQ(ContentOf(root + "/session"), "1 1 1\n");
    EXPECT_EQ(ContentOf(root + "/environment"), environment);
    EXPECT_EQ(ContentOf(root + "/folder"), folder + '\n');
}

TEST_F(OpenerTest, AProgramGetsTheUsualSignals) {
    const std::string file = File("a.txt");
    // No script: a shell changes its own signals. The target becomes the status of the program itself.
    settings.openCommand = {"cp", "/proc/self/status"};
    sigset_t blocked, previous;
    sigemptyset(&blocked);
    sigaddset(&blocked, SIGTERM);
    sigprocmask(SIG_BLOCK, &blocked, &previous);
    const auto pipe = signal(SIGPIPE, SIG_IGN);
    EXPECT_EQ(Open(file), opened::success);
    signal(SIGPIPE, pipe);
    sigprocmask(SIG_SETMASK, &previous, nullptr);
    const std::string status = ContentOf(file);
    for (const auto& [label, number] : {std::pair("SigBlk:\t"s, SIGTERM), {"SigIgn:\t"s, SIGPIPE}}) {
        ASSERT_THAT(status, HasSubstr(label));
        constexpr int hexadecimal = 16;
        const auto mask = std::stoull(status.substr(status.find(label) + label.size()), nullptr, hexadecimal);
        EXPECT_EQ(mask >> (number - 1) & 1, 0u) << label;
    }
}

TEST_F(OpenerTest, ASlowProgramIsASuccessAndLeavesNoZombie) {
    const std::string file = File("a.txt");
    ASSERT_EQ(mkfifo((root + "/go").c_str(), 0644), 0);
    settings.wait = std::chrono::milliseconds(50);
    const std::string slow = Program("slow", 1, "read -r word < $root/go");
    settings.printCommand = {slow};
    Opener opener(settings);
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(opener.Execute("print", file), opened::success);
    EXPECT_GE(std::chrono::steady_clock::now() - start, settings.wait);
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), 0) << "it must still run";

    std::ofstream(root + "/go") << "on\n";
    siginfo_t ended{};
    ASSERT_EQ(waitid(P_ALL, 0, &ended, WEXITED | WNOWAIT), 0);
    EXPECT_EQ(ended.si_status, 1);
    EXPECT_EQ(opener.Execute("open", "none"), 2);
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1);
    EXPECT_EQ(errno, ECHILD);
}

TEST_F(OpenerTest, TheEndOfAnOpenerTakesLeaveOfWhatHasEnded) {
    const std::string file = File("a.txt");
    ASSERT_EQ(mkfifo((root + "/go").c_str(), 0644), 0);
    settings.wait = {};
    settings.openCommand = {Program("slow", 0, "read -r word < $root/go")};
    {
        Opener opener(settings);
        EXPECT_EQ(opener.Execute("open", file), opened::success);
        std::ofstream(root + "/go") << "on\n";
        siginfo_t ended{};
        ASSERT_EQ(waitid(P_ALL, 0, &ended, WEXITED | WNOWAIT), 0);
    }
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1);
}

TEST_F(OpenerTest, AProgramThatEndsInTimeLeavesNoZombieAndNoHandler) {
    const std::string file = File("a.txt");
    EXPECT_EQ(Open(file), opened::success);
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1);
    EXPECT_EQ(errno, ECHILD);
    struct sigaction action {};
    ASSERT_EQ(sigaction(SIGCHLD, nullptr, &action), 0);
    EXPECT_EQ(action.sa_handler, SIG_DFL);
}

TEST_F(OpenerTest, WhereTheHostIgnoresItsChildrenAnEndIsASuccess) {
    const std::string file = File("a.txt");
    Program("opener", 1);
    const auto previous = signal(SIGCHLD, SIG_IGN);
    const int answer = Open(file);
    signal(SIGCHLD, previous);
    EXPECT_EQ(answer, opened::success);
    EXPECT_EQ(Handed(), file);
}

TEST_F(OpenerTest, AnEndlessWaitMayBeAskedFor) {
    const std::string file = File("a.txt");
    settings.wait = std::chrono::milliseconds::max();
    Program("opener", 4);
    EXPECT_EQ(Open(file), 31);
}

TEST(OpenerSettings, AreTheSystemsUsualPrograms) {
    const OpenerSettings settings;
    EXPECT_THAT(settings.openCommand, ElementsAre("xdg-open"));
    EXPECT_THAT(settings.printCommand, ElementsAre("lp", "--"));
    EXPECT_EQ(settings.wait, std::chrono::seconds(10));
}

}  // namespace
}  // namespace tessel::posix
