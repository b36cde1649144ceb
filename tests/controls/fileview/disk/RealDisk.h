#pragma once

#include <string>
#include <vector>

#include "hosts/posix/DiskFileSystem.h"
#include "tests/hosts/TestFolder.h"

namespace tessel::controls::fileviewtest {

/// The disk of this machine, of which a test sees a folder of its own. Mounts, the user's documents and the temporary folder are
/// those of the test.
class RealDisk {
  public:
    RealDisk() {
        folder.Make("tmp");
        folder.Make("documents");
        files.SetSpecialFolder(documentsNumber, folder / "documents");
    }

    test::TestFolder folder;
    std::string mounts = "1 0 8:1 / / rw - ext4 /dev/sda1 rw\n";
    std::vector<std::string> deadMounts;  ///< mount points that do not answer well
    posix::DiskFileSystem files{Settings()};

  private:
    static constexpr int documentsNumber = 5;

    posix::DiskSettings Settings() {
        return {.user = posix::DiskUser::OfThisProcess(),
                .home = folder / "home",
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

}  // namespace tessel::controls::fileviewtest
