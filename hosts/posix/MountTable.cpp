#include "hosts/posix/MountTable.h"

#include <sys/stat.h>

#include <algorithm>
#include <array>
#include <filesystem>
#include <system_error>
#include <thread>

#include "hosts/posix/TypeTexts.h"

namespace tessel::posix {
namespace {

std::vector<std::string_view> WordsOf(std::string_view line) {
    std::vector<std::string_view> words;
    for (std::size_t start = 0; start < line.size();) {
        const std::size_t end = std::min(line.find(' ', start), line.size());
        if (end > start) words.push_back(line.substr(start, end - start));
        start = end + 1;
    }
    return words;
}

/// Text with bytes written by their number: a backslash and three octal digits, as the table of mounts has them, or a backslash,
/// an x and two hexadecimal digits, as labels have them.
std::string Unescaped(std::string_view text) {
    const auto digit = [&](std::size_t at, int base) {
        if (at >= text.size()) return -1;
        const char c = text[at];
        int value = -1;
        if (c >= '0' && c <= '9') value = c - '0';
        if (c >= 'a' && c <= 'f') value = c - 'a' + 10;
        return value < base ? value : -1;
    };
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const int a = digit(i + 1, 8), b = digit(i + 2, 8), c = digit(i + 3, 8);
        const int high = digit(i + 2, 16), low = digit(i + 3, 16);
        if (text[i] == '\\' && a >= 0 && b >= 0 && c >= 0) {
            result += static_cast<char>(a * 64 + b * 8 + c);
            i += 3;
        } else if (text[i] == '\\' && i + 1 < text.size() && text[i + 1] == 'x' && high >= 0 && low >= 0) {
            result += static_cast<char>(high * 16 + low);
            i += 3;
        } else {
            result += text[i];
        }
    }
    return result;
}

template <std::size_t n>
bool IsOneOf(std::string_view text, const std::array<std::string_view, n>& all) {
    return std::find(all.begin(), all.end(), text) != all.end();
}

bool IsBelow(std::string_view path, std::string_view folder) {
    return path.starts_with(folder) && (path.size() == folder.size() || path[folder.size()] == '/');
}

/// Where no drive of the user's is mounted, whatever its type.
bool IsSystemPlace(std::string_view point) {
    static constexpr std::array<std::string_view, 11> places = {"/boot", "/dev", "/efi", "/etc", "/proc", "/run",
                                                                "/snap", "/sys", "/tmp", "/usr", "/var"};
    if (IsBelow(point, "/run/media") || IsBelow(point, "/run/mount")) return false;
    return std::any_of(places.begin(), places.end(), [&](std::string_view place) { return IsBelow(point, place); });
}

bool HoldsNoFiles(std::string_view type) {
    static constexpr std::array<std::string_view, 33> types = {
        "autofs",  "binder",   "binfmt_misc", "bpf",        "cgroup",          "cgroup2",    "configfs",    "debugfs",
        "devpts",  "devtmpfs", "efivarfs",    "fusectl",    "fuse.gvfsd-fuse", "fuse.lxcfs", "fuse.portal", "hugetlbfs",
        "mqueue",  "nfsd",     "none",        "nsfs",       "overlay",         "proc",       "pstore",      "ramfs",
        "resctrl", "rootfs",   "rpc_pipefs",  "securityfs", "selinuxfs",       "squashfs",   "sysfs",       "tmpfs",
        "tracefs"};
    return IsOneOf(type, types);
}

}  // namespace

std::vector<Mount> ParseMountInfo(std::string_view text) {
    constexpr std::size_t device = 2, root = 3, point = 4, firstOptional = 6;
    std::vector<Mount> mounts;
    for (std::size_t start = 0; start < text.size();) {
        const std::size_t end = std::min(text.find('\n', start), text.size());
        const auto words = WordsOf(text.substr(start, end - start));
        start = end + 1;
        if (words.size() < firstOptional) continue;
        // Any number of optional fields stands before a lone hyphen, and the type and the source behind it.
        const auto hyphen = std::find(words.begin() + firstOptional, words.end(), "-");
        if (words.end() - hyphen < 3) continue;
        mounts.push_back({std::string(words[device]), Unescaped(words[root]), Unescaped(words[point]), Unescaped(hyphen[1]),
                          Unescaped(hyphen[2])});
    }
    return mounts;
}

std::vector<Mount> UserMounts(std::vector<Mount> mounts) {
    std::vector<Mount> kept;
    for (Mount& mount : mounts) {
        std::erase_if(kept, [&](const Mount& other) { return IsBelow(other.point, mount.point); });  // covered
        const bool top = mount.point == "/";
        if (!top && (HoldsNoFiles(mount.type) || IsSystemPlace(mount.point))) continue;
        kept.push_back(std::move(mount));
    }
    std::stable_sort(kept.begin(), kept.end(), [](const Mount& a, const Mount& b) { return a.point < b.point; });
    std::vector<Mount> drives;
    for (Mount& mount : kept) {
        const bool again =
            std::any_of(drives.begin(), drives.end(), [&](const Mount& other) { return other.device == mount.device; });
        if (!again) drives.push_back(std::move(mount));
    }
    return drives;
}

bool IsNetworkMount(const Mount& mount) {
    static constexpr std::array<std::string_view, 22> types = {"9p",
                                                               "afs",
                                                               "ceph",
                                                               "cifs",
                                                               "coda",
                                                               "davfs",
                                                               "fuse.ceph",
                                                               "fuse.curlftpfs",
                                                               "fuse.davfs2",
                                                               "fuse.glusterfs",
                                                               "fuse.rclone",
                                                               "fuse.s3fs",
                                                               "fuse.smbnetfs",
                                                               "fuse.sshfs",
                                                               "gfs2",
                                                               "lustre",
                                                               "ncpfs",
                                                               "nfs",
                                                               "nfs4",
                                                               "smb3",
                                                               "smbfs",
                                                               "virtiofs"};
    return IsOneOf(mount.type, types);
}

std::string ShareName(std::string_view source) {
    std::string_view server, name;
    if (source.starts_with("//")) {
        source.remove_prefix(2);
        const std::size_t slash = std::min(source.find('/'), source.size());
        server = source.substr(0, slash);
        name = source.substr(std::min(slash + 1, source.size()));
    } else {
        const std::size_t bracket = source.starts_with('[') ? source.find(']') : 0;  // an address with colons of its own
        const std::size_t colon = bracket == std::string_view::npos ? bracket : source.find(':', bracket);
        if (colon == std::string_view::npos) return {};
        server = source.substr(0, colon);
        name = source.substr(colon + 1);
        if (name.size() > 1 && name.starts_with('/')) name.remove_prefix(1);
    }
    while (name.size() > 1 && name.ends_with('/')) name.remove_suffix(1);
    if (server.empty() || name.empty()) return {};
    return "\\\\" + std::string(server) + "\\" + std::string(name);
}

int DriveTypeOf(const Mount& mount, const std::string& deviceFolder) {
    static constexpr std::array<std::string_view, 3> discs = {"iso9660", "udf", "cd9660"};
    static constexpr std::array<std::string_view, 2> memory = {"tmpfs", "ramfs"};
    if (IsNetworkMount(mount)) return frame::driveTypes::network;
    if (IsOneOf(mount.type, discs)) return frame::driveTypes::compactDisk;
    if (IsOneOf(mount.type, memory)) return frame::driveTypes::ramDisk;
    for (const char* file : {"/removable", "/../removable"})  // of the disk itself, and of the disk that has the partition
        if (SmallFile(deviceFolder + "/" + mount.device + file).starts_with('1')) return frame::driveTypes::removable;
    const bool media = IsBelow(mount.point, "/media") || IsBelow(mount.point, "/run/media");
    return media ? frame::driveTypes::removable : frame::driveTypes::fixed;
}

MountProbe::MountProbe(std::function<bool(const std::string&)> ask, std::chrono::milliseconds wait)
    : shared_(std::make_shared<Shared>()), wait_(wait) {
    shared_->ask = std::move(ask);
}

std::vector<bool> MountProbe::Ask(const std::vector<std::string>& points) {
    enum class Answer { None, No, Yes };
    const auto answers = std::make_shared<std::vector<Answer>>(points.size(), Answer::None);
    std::size_t asked = 0;
    std::unique_lock lock(shared_->mutex);
    for (std::size_t i = 0; i < points.size(); ++i) {
        if (!shared_->running.insert(points[i]).second) continue;
        try {
            std::thread([shared = shared_, answers, i, point = points[i]] {
                const bool well = shared->ask(point);
                const std::lock_guard inner(shared->mutex);
                (*answers)[i] = well ? Answer::Yes : Answer::No;
                shared->running.erase(point);
                shared->answered.notify_all();
            }).detach();
            ++asked;
        } catch (const std::system_error&) {  // no more threads: as good as no answer
            shared_->running.erase(points[i]);
        }
    }
    shared_->answered.wait_for(lock, wait_, [&] {
        return static_cast<std::size_t>(
                   std::count_if(answers->begin(), answers->end(), [](Answer answer) { return answer != Answer::None; })) == asked;
    });
    std::vector<bool> well;
    for (const Answer answer : *answers) well.push_back(answer == Answer::Yes);
    return well;
}

std::vector<frame::DriveRecord> DrivesOf(const std::vector<Mount>& mounts, MountProbe& probe,
                                         const std::function<std::string(const Mount&)>& label, const std::string& deviceFolder) {
    std::vector<std::string> points;
    points.reserve(mounts.size());
    for (const Mount& mount : mounts) points.push_back(mount.point);
    const std::vector<bool> ready = probe.Ask(points);
    std::vector<frame::DriveRecord> drives;
    for (std::size_t i = 0; i < mounts.size(); ++i) {
        const Mount& mount = mounts[i];
        frame::DriveRecord drive;
        drive.root = mount.DriveRoot();
        drive.path = drive.root;
        drive.type = DriveTypeOf(mount, deviceFolder);
        if (drive.type == frame::driveTypes::network) drive.shareName = ShareName(mount.source);
        drive.isReady = ready[i];
        if (drive.isReady) {
            drive.volumeName = label(mount);
            if (drive.volumeName.empty()) drive.volumeName = mount.point.substr(mount.point.rfind('/') + 1);
        }
        drives.push_back(std::move(drive));
    }
    return drives;
}

std::string LabelOf(const Mount& mount, const std::string& labelFolder) {
    struct stat source {};
    if (!mount.source.starts_with('/') || stat(mount.source.c_str(), &source) != 0 || !S_ISBLK(source.st_mode)) return {};
    std::error_code error;
    for (std::filesystem::directory_iterator link(labelFolder, error), end; !error && link != end; link.increment(error)) {
        struct stat target {};
        if (stat(link->path().c_str(), &target) == 0 && S_ISBLK(target.st_mode) && target.st_rdev == source.st_rdev)
            return Unescaped(link->path().filename().string());
    }
    return {};
}

}  // namespace tessel::posix
