#include "hosts/posix/Opener.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstddef>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <system_error>
#include <thread>
#include <utility>

namespace tessel::posix {
namespace {

// Letters and digits of ASCII, whatever the locale.
bool IsLetter(char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); }
bool IsDigit(char c) { return c >= '0' && c <= '9'; }
char Lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }

bool SameWithoutCase(std::string_view a, std::string_view b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [](char x, char y) { return Lower(x) == Lower(y); });
}

bool EndsWithoutCase(std::string_view text, std::string_view end) {
    return text.size() >= end.size() && SameWithoutCase(text.substr(text.size() - end.size()), end);
}

bool HasNul(std::string_view text) { return text.find('\0') != std::string_view::npos; }

/// The scheme of an address without its colon, or nothing. One letter is no scheme but a drive.
std::string_view SchemeOf(std::string_view target) {
    const std::size_t colon = target.find(':');
    if (colon == std::string_view::npos || colon < 2) return {};
    const std::string_view scheme = target.substr(0, colon);
    const auto belongs = [](char c) { return IsLetter(c) || IsDigit(c) || c == '+' || c == '-' || c == '.'; };
    if (!IsLetter(scheme[0]) || !std::all_of(scheme.begin(), scheme.end(), belongs)) return {};
    return scheme;
}

bool IsMailAddress(const std::string& target) {
    const std::size_t at = target.find('@');
    if (at == std::string::npos || at == 0 || at != target.rfind('@')) return false;
    if (target.find('.', at) == std::string::npos || target.find_first_of("/ \t\n\v\f\r") != std::string::npos) return false;
    struct stat status {};
    return lstat(target.c_str(), &status) != 0;
}

int HexDigit(char c) {
    if (IsDigit(c)) return c - '0';
    return Lower(c) >= 'a' && Lower(c) <= 'f' ? Lower(c) - 'a' + 10 : -1;
}

/// A percent sign that begins no escape stays.
std::string Unescaped(std::string_view text) {
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool room = text[i] == '%' && text.size() - i > 2;
        const int high = room ? HexDigit(text[i + 1]) : -1, low = room ? HexDigit(text[i + 2]) : -1;
        if (high < 0 || low < 0) {
            result += text[i];
            continue;
        }
        result += static_cast<char>(high * 16 + low);
        i += 2;
    }
    return result;
}

/// The path in what stands behind "file:", or nothing when it is one of another computer.
std::optional<std::string> PathOfFileAddress(std::string_view rest) {
    if (!rest.starts_with("//")) return Unescaped(rest);
    rest.remove_prefix(2);
    const std::size_t slash = std::min(rest.find('/'), rest.size());
    const std::string_view computer = rest.substr(0, slash);
    if (!computer.empty() && !SameWithoutCase(computer, "localhost")) return {};
    return Unescaped(rest.substr(slash));
}

/// Nothing when there is no current folder.
std::optional<std::string> Absolute(const std::string& path) {
    if (path.starts_with('/')) return path;
    std::error_code error;
    const std::string folder = std::filesystem::current_path(error).string();
    if (error) return {};
    return folder.ends_with('/') ? folder + path : folder + '/' + path;
}

bool ParentExists(std::string_view absolutePath) {
    while (absolutePath.ends_with('/')) absolutePath.remove_suffix(1);
    // With its slash, so that nothing but a folder counts.
    const std::string parent(absolutePath.substr(0, absolutePath.rfind('/') + 1));
    struct stat status {};
    return stat(parent.c_str(), &status) == 0;
}

int WhyNotFound(const std::string& path, int error) {
    switch (error) {
        case ENOENT:
        case ENOTDIR:
            return ParentExists(path) ? opened::fileMissing : opened::folderMissing;
        case ENAMETOOLONG:
            return opened::fileMissing;
        case EACCES:
            return opened::accessDenied;
        default:
            return opened::failed;
    }
}

/// Whether opening a file may mean running it. The file's own name counts as well as the one that leads to it.
bool MayRun(const std::string& path, mode_t mode) {
    if ((mode & (S_IXUSR | S_IXGRP | S_IXOTH)) != 0) return true;
    std::error_code error;
    const std::string real = std::filesystem::canonical(path, error).string();
    return error || EndsWithoutCase(path, ".desktop") || EndsWithoutCase(real, ".desktop");
}

enum class Use { Open, Print };

/// Why a path must not be handed to the program, or nothing.
std::optional<int> Refusal(const std::string& path, Use use) {
    struct stat status {};
    if (stat(path.c_str(), &status) != 0) return WhyNotFound(path, errno);
    if (faccessat(AT_FDCWD, path.c_str(), R_OK, AT_EACCESS) != 0) return errno == EACCES ? opened::accessDenied : opened::failed;
    if (S_ISDIR(status.st_mode)) return use == Use::Open ? std::optional<int>() : opened::noProgram;
    // Pipes, sockets and devices are no documents: a program might wait for them for ever.
    if (!S_ISREG(status.st_mode)) return opened::accessDenied;
    if (use == Use::Open && MayRun(path, status.st_mode)) return opened::accessDenied;
    return {};
}

/// How a program is started: in a session of its own, with the usual signals, and without the files of this one.
class StartPlan {
  public:
    StartPlan() {
        posix_spawn_file_actions_init(&files_);
        posix_spawn_file_actions_addopen(&files_, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        // A program that stays must not hold the pipe that this one writes to; descriptors that are missing would be taken by
        // the first files that it opens.
        posix_spawn_file_actions_addopen(&files_, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
        posix_spawn_file_actions_addopen(&files_, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
        posix_spawn_file_actions_addclosefrom_np(&files_, STDERR_FILENO + 1);

        sigset_t none, ordinary;
        sigemptyset(&none);
        sigemptyset(&ordinary);
        for (const int number : {SIGCHLD, SIGPIPE, SIGHUP, SIGINT, SIGTERM}) sigaddset(&ordinary, number);
        posix_spawnattr_init(&attributes_);
        posix_spawnattr_setsigmask(&attributes_, &none);
        posix_spawnattr_setsigdefault(&attributes_, &ordinary);
        posix_spawnattr_setflags(&attributes_, POSIX_SPAWN_SETSID | POSIX_SPAWN_SETSIGMASK | POSIX_SPAWN_SETSIGDEF);
    }
    StartPlan(const StartPlan&) = delete;
    StartPlan& operator=(const StartPlan&) = delete;
    ~StartPlan() {
        posix_spawnattr_destroy(&attributes_);
        posix_spawn_file_actions_destroy(&files_);
    }

    /// An error number, or 0 with the program's number in `program`.
    int Start(std::vector<std::string> words, pid_t& program) const {
        std::vector<char*> arguments;
        arguments.reserve(words.size() + 1);
        for (std::string& word : words) arguments.push_back(word.data());
        arguments.push_back(nullptr);
        return posix_spawnp(&program, arguments[0], &files_, &attributes_, arguments.data(), environ);
    }

  private:
    posix_spawn_file_actions_t files_{};
    posix_spawnattr_t attributes_{};
};

int AnswerOfStart(int error) {
    const bool none = error == ENOENT || error == ENOTDIR || error == EACCES || error == ENOEXEC;
    return none ? opened::noProgram : opened::failed;
}

int AnswerOfEnd(int status) {
    if (!WIFEXITED(status)) return opened::failed;
    switch (WEXITSTATUS(status)) {
        case 0:
            return opened::success;
        case 2:
            return opened::fileMissing;
        case 3:    // a tool that the program needs is missing
        case 4:    // no program could take the target
        case 127:  // a script's way to say that a command is missing
            return opened::noProgram;
        default:
            return opened::failed;
    }
}

}  // namespace

Opener::Opener(OpenerSettings settings) : settings_(std::move(settings)) {}

Opener::~Opener() { Reap(); }

int Opener::Execute(std::string_view verb, const std::string& target) {
    Reap();
    if (verb != "open" && verb != "print") return opened::noProgram;
    const Use use = verb == "open" ? Use::Open : Use::Print;
    if (target.empty() || HasNul(target)) return opened::fileMissing;

    std::optional<std::string> path = target;
    const std::string_view scheme = SchemeOf(target);
    if (SameWithoutCase(scheme, "file")) {
        path = PathOfFileAddress(std::string_view(target).substr(scheme.size() + 1));
        if (!path) return opened::folderMissing;
        if (path->empty() || HasNul(*path)) return opened::fileMissing;
    } else if (!scheme.empty() || IsMailAddress(target)) {
        if (use == Use::Print) return opened::noProgram;
        return Run(settings_.openCommand, scheme.empty() ? "mailto:" + target : target);
    }

    path = Absolute(*path);
    if (!path) return opened::folderMissing;
    if (const std::optional<int> refusal = Refusal(*path, use)) return *refusal;
    return Run(use == Use::Open ? settings_.openCommand : settings_.printCommand, *path);
}

int Opener::Run(const std::vector<std::string>& command, const std::string& argument) {
    if (command.empty()) return opened::noProgram;
    std::vector<std::string> words = command;
    words.push_back(argument);
    pid_t program = 0;
    if (const int error = StartPlan().Start(std::move(words), program)) return AnswerOfStart(error);

    using std::chrono::steady_clock;
    constexpr std::chrono::milliseconds pause{2};
    const steady_clock::time_point start = steady_clock::now();
    while (true) {
        int status = 0;
        const pid_t ended = waitpid(program, &status, WNOHANG);
        if (ended == program) return AnswerOfEnd(status);
        // Somebody else in this program collects all children: the end is known, how it went is not.
        if (ended < 0) return opened::success;
        if (std::chrono::duration_cast<std::chrono::milliseconds>(steady_clock::now() - start) >= settings_.wait) break;
        std::this_thread::sleep_for(pause);
    }
    const std::lock_guard lock(guard_);
    running_.push_back(program);
    return opened::success;
}

/// Takes leave of the programs that have ended since.
void Opener::Reap() {
    const std::lock_guard lock(guard_);
    std::erase_if(running_, [](pid_t program) { return waitpid(program, nullptr, WNOHANG) != 0; });
}

}  // namespace tessel::posix
