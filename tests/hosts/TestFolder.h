#pragma once

#include <fcntl.h>
#include <grp.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <string_view>

namespace tessel::test {

/// A folder of the real disk that is there as long as the test.
class TestFolder {
  public:
    explicit TestFolder(const std::filesystem::path& parent = std::filesystem::temp_directory_path()) {
        std::string name = (parent / "tessel-test-XXXXXX").string();
        if (!mkdtemp(name.data())) std::abort();
        path_ = name;
    }
    TestFolder(const TestFolder&) = delete;
    TestFolder& operator=(const TestFolder&) = delete;
    ~TestFolder() {
        std::error_code error;
        std::filesystem::remove_all(path_, error);
        if (!error) return;
        GiveRights(path_);
        std::filesystem::remove_all(path_, error);
    }

    /// For a great many entries: a folder that the system keeps in memory, where it has one.
    static std::filesystem::path QuickParent() {
        const char* inMemory = "/dev/shm";
        return access(inMemory, W_OK) == 0 ? std::filesystem::path(inMemory) : std::filesystem::temp_directory_path();
    }

    const std::string& Path() const { return path_; }
    std::string operator/(std::string_view name) const { return path_ + "/" + std::string(name); }

    void Write(std::string_view name, std::string_view contents) const {
        std::ofstream(*this / name, std::ios::binary) << contents;
    }
    std::string Read(std::string_view name) const {
        std::ifstream file(*this / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    void Make(std::string_view name) const { std::filesystem::create_directories(*this / name); }
    void SetMode(std::string_view name, mode_t mode) const { chmod((*this / name).c_str(), mode); }
    mode_t Mode(std::string_view name) const {
        struct stat facts {};
        stat((*this / name).c_str(), &facts);
        return facts.st_mode & 07777;
    }
    void SetTimes(std::string_view name, std::int64_t modified, std::int64_t accessed) const {
        const std::array<timespec, 2> times = {timespec{accessed, 999'999'999}, timespec{modified, 999'999'999}};
        utimensat(AT_FDCWD, (*this / name).c_str(), times.data(), 0);
    }
    /// What stands in it, hidden or not.
    std::size_t EntryCount() const {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(path_), {}));
    }

  private:
    /// A test may have taken the user's own rights away.
    static void GiveRights(const std::filesystem::path& folder) {
        std::error_code error;
        std::filesystem::permissions(folder, std::filesystem::perms::owner_all, error);
        for (const auto& entry : std::filesystem::directory_iterator(folder, error))
            if (entry.is_directory(error) && !entry.is_symlink(error)) GiveRights(entry.path());
    }

    std::string path_;
};

/// Takes the superuser's rights away for a while, so that permissions count in a test whoever runs it. Hands the folder of the test
/// to the lesser user.
class LesserUser {
  public:
    explicit LesserUser(const TestFolder& folder) : wasSuper_(geteuid() == 0) {
        if (!wasSuper_) return;
        for (const auto& entry : std::filesystem::recursive_directory_iterator(folder.Path())) Give(entry.path().string());
        Give(folder.Path());
        if (setegid(nobody) != 0 || seteuid(nobody) != 0) std::abort();
    }
    LesserUser(const LesserUser&) = delete;
    LesserUser& operator=(const LesserUser&) = delete;
    ~LesserUser() {
        if (wasSuper_ && (seteuid(0) != 0 || setegid(0) != 0)) std::abort();
    }

  private:
    static constexpr unsigned nobody = 65534;
    static void Give(const std::string& path) {
        if (lchown(path.c_str(), nobody, nobody) != 0) std::abort();
    }

    bool wasSuper_;
};

}  // namespace tessel::test
