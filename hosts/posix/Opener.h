#pragma once

#include <sys/types.h>

#include <chrono>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

/// What a host on a POSIX system offers, whatever its toolkit.
namespace tessel::posix {

/// The programs that open and print. Each is a name looked up in PATH, or a path, with its first arguments; what is to be opened
/// comes behind them as one argument more. The exit status tells how it went: 0 well, 2 no such file, 3 and 4 no program for it,
/// anything else a failure.
struct OpenerSettings {
    std::vector<std::string> openCommand = {"xdg-open"};
    std::vector<std::string> printCommand = {"lp", "--"};
    /// How long a program is waited for. One that still runs then counts as a success: some stay until the document is closed.
    std::chrono::milliseconds wait{10'000};
};

/// What `Opener::Execute` answers.
namespace opened {
inline constexpr int failed = 1, fileMissing = 2, folderMissing = 3, accessDenied = 5, noProgram = 31, success = 42;
}  // namespace opened

/// Opens and prints what a link names, as `frame::Shell::Execute` asks. A target is data: no shell ever sees it, no byte of it is
/// changed but where a rule here says so, and it cannot become an option of the program.
///
/// A target is one of these, the first that fits:
/// - "file:" and a path, without a computer or with "localhost", its percent escapes decoded: a path;
/// - a scheme of two or more characters, ":", and anything: an address;
/// - an e-mail address that is not the name of a file: an address, with "mailto:" before it;
/// - all else: a path. One that is not absolute begins in the current folder.
///
/// A path is handed on as an absolute one. A file that could itself be run is never opened, so that following a link runs no
/// code that the link brought: that is a file with an execute permission, and one named ".desktop".
///
/// May be asked from several threads at a time. Installs no signal handler and changes nothing of the program that it works in.
class Opener {
  public:
    explicit Opener(OpenerSettings settings = {});
    Opener(const Opener&) = delete;
    Opener& operator=(const Opener&) = delete;
    ~Opener();

    /// `verb` is "open", or "print", which is for files alone. Waits for the program, at most as long as the settings say.
    int Execute(std::string_view verb, const std::string& target);

  private:
    int Run(const std::vector<std::string>& command, const std::string& argument);
    void Reap();

    OpenerSettings settings_;
    std::mutex guard_;            // of what follows
    std::vector<pid_t> running_;  // programs that were not waited for to their end
};

}  // namespace tessel::posix
