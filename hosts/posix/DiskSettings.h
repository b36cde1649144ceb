#pragma once

#include <chrono>
#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "hosts/posix/DiskListing.h"

namespace tessel::posix {

/// Where the real disk finds what it does not know by itself. A program takes `OfThisProcess`; a test sets what it needs.
struct DiskSettings {
    DiskUser user = {};
    std::string home = {}, configHome = {}, dataHome = {};  ///< without a separator at the end
    std::vector<std::string> dataFolders = {};              ///< shared ones, the one that counts most first
    std::vector<std::string> languages = {};                ///< the user's, as the mime database names them: "de_AT", "de"
    std::string temporaryFolder = "/tmp";
    std::function<std::string()> mountTable = {};           ///< gives the text of a table of mounts
    std::function<bool(const std::string&)> askMount = {};  ///< whether a mount is in order; may block, comes on other threads
    std::chrono::milliseconds mountWait{2'000};             ///< one that has not answered by then is not ready
    std::string deviceFolder = "/sys/dev/block", labelFolder = "/dev/disk/by-label";
    bool useStatx = true;  ///< without it there are no times of creation

    static DiskSettings OfThisProcess();
};

/// The folders that the text of a file user-dirs.dirs names, by their names there ("DOCUMENTS"). Lines that it does not understand
/// are passed over, as are folders that are not absolute.
std::map<std::string, std::string> ParseUserFolders(std::string_view text, const std::string& home);

}  // namespace tessel::posix
