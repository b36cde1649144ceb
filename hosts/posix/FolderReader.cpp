#include "hosts/posix/FolderReader.h"

#include <dirent.h>
#include <sys/syscall.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace tessel::posix {
namespace {

constexpr std::size_t bufferSize = 1 << 16;

/// An entry as the system writes it, its name behind it.
struct Head {
    std::uint64_t inode;
    std::int64_t offset;
    unsigned short length;
    unsigned char type;
};
constexpr std::size_t nameOffset = 19;

FolderReader::Kind KindOf(unsigned char type) {
    switch (type) {
        case DT_DIR:
            return FolderReader::Kind::Folder;
        case DT_LNK:
            return FolderReader::Kind::Link;
        case DT_UNKNOWN:
            return FolderReader::Kind::Unknown;
        default:
            return FolderReader::Kind::File;
    }
}

bool IsDots(const char* name) { return name[0] == '.' && (name[1] == '\0' || (name[1] == '.' && name[2] == '\0')); }

}  // namespace

FolderReader::FolderReader() : buffer_(new char[bufferSize]) {}
FolderReader::~FolderReader() = default;

void FolderReader::Start(int folder) {
    folder_ = folder;
    error_ = 0;
    position_ = end_ = 0;
}

bool FolderReader::Next(Entry& entry) {
    while (true) {
        if (position_ >= end_) {
            const long got = syscall(SYS_getdents64, folder_, buffer_.get(), bufferSize);
            if (got <= 0) {
                error_ = got < 0 && errno != ENOENT ? errno : 0;  // ENOENT: the folder was deleted meanwhile
                return false;
            }
            position_ = 0;
            end_ = static_cast<std::size_t>(got);
        }
        const char* start = buffer_.get() + position_;
        Head head{};
        std::memcpy(&head, start, nameOffset);
        position_ += head.length;
        const char* name = start + nameOffset;
        if (IsDots(name)) continue;
        entry = {name, std::strlen(name), KindOf(head.type)};
        return true;
    }
}

}  // namespace tessel::posix
