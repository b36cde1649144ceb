#include "hosts/posix/DiskSettings.h"

#include <algorithm>
#include <cstdlib>

namespace tessel::posix {
namespace {

std::string Environment(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : "";
}

std::string WithoutEnd(std::string path) {
    while (path.size() > 1 && path.ends_with('/')) path.pop_back();
    return path;
}

/// A folder that the environment names; `otherwise` when that is not absolute.
std::string FolderFromEnvironment(const char* name, const std::string& otherwise) {
    const std::string path = Environment(name);
    return path.starts_with('/') ? WithoutEnd(path) : otherwise;
}

std::vector<std::string> Parts(const std::string& text, char mark) {
    std::vector<std::string> parts;
    for (std::size_t start = 0; start < text.size();) {
        const std::size_t end = std::min(text.find(mark, start), text.size());
        if (end > start) parts.push_back(text.substr(start, end - start));
        start = end + 1;
    }
    return parts;
}

/// The languages of messages as the environment orders them, each also without its country.
std::vector<std::string> UserLanguages() {
    std::string locale;
    for (const char* name : {"LANG", "LC_MESSAGES", "LC_ALL"})  // the last one set counts
        if (const std::string value = Environment(name); !value.empty()) locale = value;
    if (locale.empty() || locale == "C" || locale == "POSIX" || locale.starts_with("C.")) return {};
    std::vector<std::string> wanted = Parts(Environment("LANGUAGE"), ':');
    wanted.push_back(locale);
    std::vector<std::string> languages;
    for (const std::string& name : wanted) {
        const std::string plain = name.substr(0, name.find_first_of(".@"));
        languages.push_back(plain);
        if (const std::size_t country = plain.find('_'); country != std::string::npos)
            languages.push_back(plain.substr(0, country));
        if (plain.starts_with("en")) break;  // understood without being named: nothing behind it is needed
    }
    return languages;
}

}  // namespace

DiskSettings DiskSettings::OfThisProcess() {
    DiskSettings settings;
    settings.user = DiskUser::OfThisProcess();
    settings.home = FolderFromEnvironment("HOME", "/");
    settings.configHome = FolderFromEnvironment("XDG_CONFIG_HOME", settings.home + "/.config");
    settings.dataHome = FolderFromEnvironment("XDG_DATA_HOME", settings.home + "/.local/share");
    settings.dataFolders = Parts(Environment("XDG_DATA_DIRS"), ':');
    if (settings.dataFolders.empty()) settings.dataFolders = {"/usr/local/share", "/usr/share"};
    settings.languages = UserLanguages();
    settings.temporaryFolder = FolderFromEnvironment("TMPDIR", "/tmp");
    return settings;
}

std::map<std::string, std::string> ParseUserFolders(std::string_view text, const std::string& home) {
    constexpr std::string_view before = "XDG_", behind = "_DIR=\"";
    std::map<std::string, std::string> folders;
    for (std::size_t start = 0; start < text.size();) {
        const std::size_t end = std::min(text.find('\n', start), text.size());
        std::string_view line = text.substr(start, end - start);
        start = end + 1;
        while (line.starts_with(' ') || line.starts_with('\t')) line.remove_prefix(1);
        const std::size_t mark = line.find(behind);
        if (!line.starts_with(before) || mark == std::string_view::npos) continue;
        const std::string name(line.substr(before.size(), mark - before.size()));
        line.remove_prefix(mark + behind.size());
        std::string path;
        bool closed = false;
        for (std::size_t i = 0; i < line.size() && !closed; ++i) {
            closed = line[i] == '"';
            if (line[i] == '\\' && i + 1 < line.size()) ++i;  // takes what follows as it is
            if (!closed) path += line[i];
        }
        constexpr std::string_view homeMark = "$HOME";
        if (path == homeMark || path.starts_with("$HOME/")) path.replace(0, homeMark.size(), home);
        if (closed && path.starts_with('/')) folders[name] = WithoutEnd(path);
    }
    return folders;
}

}  // namespace tessel::posix
