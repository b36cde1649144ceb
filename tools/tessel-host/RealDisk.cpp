#include "tools/tessel-host/RealDisk.h"

#ifdef __unix__
#include "hosts/posix/DiskFileSystem.h"
#endif

namespace tessel::tools {

std::unique_ptr<frame::FileSystem> MakeRealDisk() {
#ifdef __unix__
    return std::make_unique<posix::DiskFileSystem>();
#else
    return nullptr;
#endif
}

void SetSpecialFolder([[maybe_unused]] frame::FileSystem& realDisk, [[maybe_unused]] int number,
                      [[maybe_unused]] std::string path) {
#ifdef __unix__
    static_cast<posix::DiskFileSystem&>(realDisk).SetSpecialFolder(number, std::move(path));
#endif
}

}  // namespace tessel::tools
