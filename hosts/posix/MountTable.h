#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "frame/FileSystem.h"

namespace tessel::posix {

/// A line of the table of mounts.
struct Mount {
    std::string device;  ///< "8:1"
    std::string root;    ///< the folder of the device that is mounted
    std::string point;   ///< where it is mounted, without a separator at its end but for "/"
    std::string type;    ///< "ext4"
    std::string source;  ///< "/dev/sda1", "server:/export"

    /// The mount point as the root of a drive: with the separator at its end.
    std::string DriveRoot() const { return point == "/" ? point : point + "/"; }
    friend bool operator==(const Mount&, const Mount&) = default;
};

/// Reads the text of /proc/self/mountinfo; lines that it does not understand are passed over.
std::vector<Mount> ParseMountInfo(std::string_view text);

/// The mounts that a user would call drives, by mount point: "/" and what holds files of the user's own. Left out are pseudo file
/// systems, memory, images of packages, what stands below /boot, /dev, /efi, /etc, /proc, /run, /snap, /sys, /tmp, /usr and /var
/// (removable media below /run/media stay), a file system that is mounted a second time, and a mount that another one covers.
std::vector<Mount> UserMounts(std::vector<Mount> mounts);

bool IsNetworkMount(const Mount& mount);
/// "\\server\name" of "server:/name" and "//server/name"; empty for any other source.
std::string ShareName(std::string_view source);
/// `deviceFolder` is where the system tells about devices, "/sys/dev/block".
int DriveTypeOf(const Mount& mount, const std::string& deviceFolder);

/// Finds out which mounts answer. A mount may keep whoever asks it waiting for ever: so it is asked on a thread of its own, which
/// is left behind when it does not come back in time. While it hangs the mount is not asked again.
class MountProbe {
  public:
    /// `ask` returns whether the mount at a path is in order; it may block, and is called on other threads.
    MountProbe(std::function<bool(const std::string&)> ask, std::chrono::milliseconds wait);

    /// For each mount point whether it has answered well. Takes no longer than the wait, however many there are.
    std::vector<bool> Ask(const std::vector<std::string>& points);

  private:
    struct Shared {
        std::function<bool(const std::string&)> ask;
        std::mutex mutex;
        std::condition_variable answered;
        std::set<std::string> running;
    };

    std::shared_ptr<Shared> shared_;
    std::chrono::milliseconds wait_;
};

/// The drives of a table. `label` gives the name of the volume of a mount, if it has one; without one a drive is called by the last
/// part of its mount point.
std::vector<frame::DriveRecord> DrivesOf(const std::vector<Mount>& mounts, MountProbe& probe,
                                         const std::function<std::string(const Mount&)>& label, const std::string& deviceFolder);

/// The label of the volume on a block device, by the links in a folder such as "/dev/disk/by-label".
std::string LabelOf(const Mount& mount, const std::string& labelFolder);

}  // namespace tessel::posix
