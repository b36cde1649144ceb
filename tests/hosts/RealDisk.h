#pragma once

#include <string>
#include <vector>

#include "hosts/posix/DiskFileSystem.h"
#include "tests/hosts/TestFolder.h"

namespace tessel::test {

/// The disk of this machine, of which a test sees a folder of its own. Mounts, the user's settings and documents, and the temporary
/// folder are those of the test.
class RealDisk {
  public:
    RealDisk() {
        folder.Make("tmp");
        SetDocuments("documents");
    }

    /// Makes a folder, below that of the test, the user's documents.
    void SetDocuments(const std::string& name) {
        folder.Make(name);
        folder.Make("config");
        folder.Write("config/user-dirs.dirs", "XDG_DOCUMENTS_DIR=\"" + folder / name + "\"\n");
    }

    TestFolder folder;
    std::string mounts = "1 0 8:1 / / rw - ext4 /dev/sda1 rw\n";
    std::vector<std::string> deadMounts;  ///< mount points that do not answer well
    posix::DiskFileSystem files{Settings()};

  private:
    posix::DiskSettings Settings() {
        return {.user = posix::DiskUser::OfThisProcess(),
                .home = folder / "home",
                .configHome = folder / "config",
                .temporaryFolder = folder / "tmp",
                .mountTable = [this] { return mounts; },
                .askMount =
                    [this](const std::string& point) {
                        for (const std::string& dead : deadMounts)
                            if (point == dead) return false;
                        return true;
                    },
                .deviceFolder = folder / "devices",
                .labelFolder = folder / "labels"};
    }
};

}  // namespace tessel::test
