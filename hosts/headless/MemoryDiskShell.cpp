#include "hosts/headless/MemoryDisk.h"

#include <algorithm>

#include "frame/Text.h"
#include "hosts/headless/MemoryDiskParts.h"

namespace tessel::headless {

namespace errors = frame::errors;
using frame::Status;
using namespace memorydisk;

namespace {

/// The numbers that the shell's system has for failures.
namespace systemErrors {
constexpr int fileNotFound = 2, pathNotFound = 3, accessDenied = 5, writeProtected = 19, notReady = 21, nameInUse = 80,
              badOperation = 87, diskFull = 112, sameFile = 113, badName = 123, insideItself = 125;
}

int SystemErrorOf(Status status) {
    switch (status.Number()) {
        case 0:
            return 0;
        case errors::fileNotFound:
            return systemErrors::fileNotFound;
        case errors::pathNotFound:
            return systemErrors::pathNotFound;
        case errors::diskNotReady:
            return systemErrors::notReady;
        case errors::diskFull:
            return systemErrors::diskFull;
        case errors::badFileName:
            return systemErrors::badName;
        default:
            return systemErrors::accessDenied;
    }
}

}  // namespace

/// One operation of the shell; each step gives the system's error number, 0 for success.
class MemoryDisk::Operation {
  public:
    Operation(MemoryDisk& disk, const frame::FileOperation& operation) : disk_(disk), operation_(operation) {}

    int Run() {
        using Kind = frame::FileOperation::Kind;
        if (const int error = Check()) return error;
        if (operation_.kind == Kind::Delete) return Delete();
        if (operation_.kind == Kind::Move || operation_.kind == Kind::Copy) return Transfer(operation_.kind == Kind::Move);
        return systemErrors::badOperation;
    }

  private:
    static constexpr int renameOnCollision = 8, allowUndo = 64;

    bool Flag(int flag) const { return (operation_.flags & flag) != 0; }

    int Check() {
        if (operation_.from.empty()) return systemErrors::badOperation;
        for (const std::string& source : operation_.from) {
            const Place place = disk_.Find(source);
            if (!place.entry) return SystemErrorOf(place.status);
            if (place.IsRoot()) return systemErrors::accessDenied;
        }
        if (operation_.kind == frame::FileOperation::Kind::Delete) return 0;
        if (operation_.to.size() != 1) return systemErrors::badOperation;
        const Place target = disk_.Find(operation_.to.front());
        if (!target.drive) return systemErrors::pathNotFound;
        return target.drive->ready ? 0 : systemErrors::notReady;
    }

    int Delete() {
        for (const std::string& source : operation_.from) {
            const Place place = disk_.Find(source);
            if (!place.entry) return systemErrors::fileNotFound;  // it stood in a folder that is already gone
            if (place.drive->readOnly) return systemErrors::writeProtected;
            std::string path = place.Path();
            auto entry = place.folder->Release(place.leaf);
            if (Flag(allowUndo)) disk_.recycled_.emplace_back(std::move(path), std::move(entry));
        }
        return 0;
    }

    int Transfer(bool moves) {
        Place target = disk_.Find(operation_.to.front());
        if (target.drive->readOnly) return systemErrors::writeProtected;
        const bool single = operation_.from.size() == 1;
        std::string name;  // the new one; empty: each keeps its own
        if (target.entry && !target.entry->isFolder && !single) return systemErrors::nameInUse;
        if (!target.entry || !target.entry->isFolder) {
            if (single) name = target.leaf;
            if (!target.entry && !IsGoodName(target.leaf)) return systemErrors::badName;
            const std::string folder = single ? FolderOf(*target.drive, operation_.to.front()) : operation_.to.front();
            if (const Status made = disk_.SetFolder(folder, {}); made.Failed()) return SystemErrorOf(made);
            target = disk_.Find(folder);
        }
        for (const std::string& source : operation_.from) {
            const Place place = disk_.Find(source);
            if (!place.entry) return systemErrors::fileNotFound;
            if (moves && place.drive->readOnly) return systemErrors::writeProtected;
            if (const int error = Put(place, *target.entry, name.empty() ? place.entry->name : name, moves)) return error;
        }
        return 0;
    }

    std::string FolderOf(const Drive& drive, std::string_view path) {
        std::vector<std::string_view> names;
        disk_.DriveOf(path, names);
        std::string folder = drive.root;
        for (std::size_t i = 0; i + 1 < names.size(); ++i) folder = Joined(folder, names[i]);
        return folder;
    }

    static bool Holds(const Entry& outer, const Entry& inner) {
        if (&outer == &inner) return true;
        return std::any_of(outer.children.begin(), outer.children.end(),
                           [&](const auto& child) { return child.second->isFolder && Holds(*child.second, inner); });
    }

    static std::string FreeName(const Entry& folder, const std::string& name) {
        std::string candidate = "Copy of " + name;
        for (int number = 2; folder.children.contains(candidate); ++number)
            candidate = "Copy (" + frame::Decimal(number) + ") of " + name;
        return candidate;
    }

    int Put(const Place& source, Entry& folder, std::string name, bool moves) {
        if (source.entry->isFolder && Holds(*source.entry, folder)) return systemErrors::insideItself;
        const Entry* standing = folder.Child(name);
        if (standing == source.entry && (moves || !Flag(renameOnCollision))) return systemErrors::sameFile;
        if (standing && Flag(renameOnCollision)) name = FreeName(folder, name);
        return moves ? Move(*source.folder, *source.entry, folder, name) : Copy(*source.entry, folder, name);
    }

    int Move(Entry& from, Entry& entry, Entry& folder, const std::string& name) {
        Entry* standing = folder.Child(name);
        if (standing && standing->isFolder != entry.isFolder) return systemErrors::nameInUse;
        if (standing && entry.isFolder) {  // merged
            while (!entry.children.empty()) {
                Entry& child = *entry.children.begin()->second;
                if (const int error = Move(entry, child, *standing, child.name)) return error;
            }
            from.Release(entry.name);
            return 0;
        }
        if (standing) folder.Release(name);
        auto moved = from.Release(entry.name);
        moved->name = name;
        folder.Take(std::move(moved));
        return 0;
    }

    int Copy(const Entry& entry, Entry& folder, const std::string& name) {
        Entry* standing = folder.Child(name);
        if (standing && standing->isFolder != entry.isFolder) return systemErrors::nameInUse;
        if (entry.unreadable) return systemErrors::accessDenied;
        if (const Status charged = disk_.Charge(static_cast<std::size_t>(entry.size)); charged.Failed())
            return SystemErrorOf(charged);
        if (!standing || !entry.isFolder) {
            auto copy = disk_.NewEntry(name, entry.isFolder);
            copy->attributes = entry.attributes;
            copy->size = entry.size;
            copy->contents = entry.contents;
            copy->modified = entry.modified;
            copy->type = entry.type;
            copy->picture = entry.picture;
            if (standing) folder.Release(name);
            standing = &folder.Take(std::move(copy));
        }
        for (const auto& child : entry.children)
            if (const int error = Copy(*child.second, *standing, child.second->name)) return error;
        return 0;
    }

    MemoryDisk& disk_;
    const frame::FileOperation& operation_;
};

frame::FileOperationResult MemoryDisk::Run(const frame::FileOperation& operation) {
    const int error = Operation(*this, operation).Run();
    return {.code = error, .aborted = false, .systemError = error};
}

}  // namespace tessel::headless
