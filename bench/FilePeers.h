#pragma once

#include <dirent.h>
#include <fcntl.h>
#include <fnmatch.h>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

/// What the file list is measured against: the bare calls of the system, the standard library, and the system's own programs.
namespace tessel::bench {

extern "C" char** environ;

/// Calls `each(folder, name, type)` for every entry of an open folder, in the system's order.
template <class F>
void EachEntry(int folder, F&& each) {
    constexpr std::size_t bufferSize = 1 << 16, nameOffset = 19, typeOffset = 18, lengthOffset = 16;
    const auto buffer = std::make_unique<char[]>(bufferSize);
    for (long got = 0; (got = syscall(SYS_getdents64, folder, buffer.get(), bufferSize)) > 0;)
        for (long place = 0; place < got;) {
            const char* entry = buffer.get() + place;
            unsigned short length = 0;
            std::memcpy(&length, entry + lengthOffset, sizeof length);
            const char* name = entry + nameOffset;
            if (std::strcmp(name, ".") != 0 && std::strcmp(name, "..") != 0)
                each(name, static_cast<unsigned char>(entry[typeOffset]));
            place += length;
        }
}

inline std::int64_t StatOf(int folder, const char* name) {
    struct statx told {};
    statx(folder, name, AT_SYMLINK_NOFOLLOW, STATX_BASIC_STATS | STATX_BTIME, &told);
    return S_ISREG(told.stx_mode) ? static_cast<std::int64_t>(told.stx_size) : 0;
}

inline int OpenBelow(int folder, const char* name) { return openat(folder, name, O_RDONLY | O_DIRECTORY | O_CLOEXEC); }

/// The facts of every entry of one folder; gives their sizes, so that nothing is left out.
inline std::int64_t BareListing(const std::string& path) {
    std::int64_t sum = 0;
    const int folder = OpenBelow(AT_FDCWD, path.c_str());
    EachEntry(folder, [&](const char* name, unsigned char) { sum += StatOf(folder, name); });
    close(folder);
    return sum;
}

/// How many of the paths are folders: one question each.
inline std::int64_t BareExistence(const std::vector<std::string>& paths) {
    std::int64_t count = 0;
    for (const std::string& path : paths) {
        struct statx told {};
        if (statx(AT_FDCWD, path.c_str(), 0, STATX_TYPE, &told) == 0 && S_ISDIR(told.stx_mode)) ++count;
    }
    return count;
}

enum class Depth { Names, NamesAndFacts };

/// The facts of every entry, and the number of entries in each folder among them.
inline std::int64_t BareCounting(const std::string& path) {
    std::int64_t count = 0;
    const int folder = OpenBelow(AT_FDCWD, path.c_str());
    EachEntry(folder, [&](const char* name, unsigned char type) {
        count += StatOf(folder, name) & 1;
        if (type != DT_DIR) return;
        const int below = OpenBelow(folder, name);
        EachEntry(below, [&](const char*, unsigned char) { ++count; });
        close(below);
    });
    close(folder);
    return count;
}

/// How many names of a tree match; with `NamesAndFacts` the facts of those that do are read too.
inline std::int64_t BareMatch(int folder, const char* pattern, Depth depth) {
    std::int64_t count = 0;
    std::vector<std::string> below;
    EachEntry(folder, [&](const char* name, unsigned char type) {
        if (type == DT_DIR) {
            below.emplace_back(name);
        } else if (fnmatch(pattern, name, 0) == 0) {
            ++count;
            if (depth == Depth::NamesAndFacts) count += StatOf(folder, name) < 0 ? 1 : 0;
        }
    });
    for (const std::string& name : below) {
        const int next = OpenBelow(folder, name.c_str());
        count += BareMatch(next, pattern, depth);
        close(next);
    }
    return count;
}

inline std::int64_t BareSize(int folder) {
    std::int64_t sum = 0;
    std::vector<std::string> below;
    EachEntry(folder, [&](const char* name, unsigned char type) {
        if (type == DT_DIR)
            below.emplace_back(name);
        else
            sum += StatOf(folder, name);
    });
    for (const std::string& name : below) {
        const int next = OpenBelow(folder, name.c_str());
        sum += BareSize(next);
        close(next);
    }
    return sum;
}

/// Runs one of the functions above from the top of a tree.
template <class F>
std::int64_t FromTop(const std::string& path, F&& walk) {
    const int folder = OpenBelow(AT_FDCWD, path.c_str());
    const std::int64_t result = walk(folder);
    close(folder);
    return result;
}

inline std::int64_t StandardListing(const std::string& path) {
    std::int64_t sum = 0;
    for (const auto& entry : std::filesystem::directory_iterator(path)) {
        sum += static_cast<std::int64_t>(entry.file_size());
        sum += entry.last_write_time().time_since_epoch().count() & 1;
    }
    return sum;
}

inline std::int64_t StandardSize(const std::string& path) {
    std::int64_t sum = 0;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(path))
        if (entry.is_regular_file()) sum += static_cast<std::int64_t>(entry.file_size());
    return sum;
}

/// The processor time of all threads of this program, in milliseconds: others may use the processor meanwhile.
inline double ProcessorTime() {
    timespec now{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) * 1e3 + static_cast<double>(now.tv_nsec) / 1e6;
}

inline double ProcessorTimeOfChildren() {
    rusage used{};
    getrusage(RUSAGE_CHILDREN, &used);
    const auto part = [](const timeval& time) {
        return static_cast<double>(time.tv_sec) * 1e3 + static_cast<double>(time.tv_usec) / 1e3;
    };
    return part(used.ru_utime) + part(used.ru_stime);
}

/// Runs a program with what it says thrown away. False when it failed.
inline bool RunProgram(const std::vector<std::string>& words) {
    std::vector<char*> arguments;
    for (const std::string& word : words) arguments.push_back(const_cast<char*>(word.c_str()));
    arguments.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    pid_t child = 0;
    const int error = posix_spawnp(&child, arguments[0], &actions, nullptr, arguments.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    int status = 0;
    return error == 0 && waitpid(child, &status, 0) == child && WIFEXITED(status) && WEXITSTATUS(status) == 0;
}

}  // namespace tessel::bench
