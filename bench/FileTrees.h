#pragma once

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <map>
#include <string>
#include <string_view>

/// Folders of files for benchmarks, made when first asked for and taken away when the program ends. They stand below
/// TESSEL_BENCH_DIR where that is set, else below the system's temporary folder.
namespace tessel::bench {

inline constexpr std::array<std::string_view, 8> usualExtensions = {".txt", ".jpg", ".pdf", ".html", ".cpp", ".h", ".png", ".zip"};

/// Files like "Holiday picture 00042.pdf", with sizes and dates of all kinds. The sizes are holes: no block is written.
class FileMaker {
  public:
    explicit FileMaker(const std::string& folder) : folder_(open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC)) {
        if (folder_ < 0) Fail("a folder of the benchmark cannot be opened");
    }
    FileMaker(const FileMaker&) = delete;
    FileMaker& operator=(const FileMaker&) = delete;
    ~FileMaker() { close(folder_); }

    void Make(const std::string& name, std::int64_t number) const {
        constexpr std::int64_t oldest = 1'600'000'000, span = 100'000'000, sizes = 100'003;
        const int file = openat(folder_, name.c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, 0644);
        const timespec moment{oldest + number * 7919 * 7919 % span, 0};
        const std::array<timespec, 2> times = {moment, moment};
        if (file < 0 || ftruncate(file, number * 7919 % sizes) != 0 || futimens(file, times.data()) != 0)
            Fail("a file of the benchmark cannot be made");
        close(file);
    }
    [[noreturn]] static void Fail(const char* what) {
        std::perror(what);
        std::exit(1);
    }

  private:
    int folder_;
};

inline std::string FileName(std::int64_t number, std::string_view extension) {
    std::array<char, 32> text{};
    // Not in the order of the names.
    const int length =
        std::snprintf(text.data(), text.size(), "Holiday picture %07lld", static_cast<long long>(number * 7919 % 10'000'000));
    return std::string(text.data(), static_cast<std::size_t>(length)).append(extension);
}

class FileTrees {
  public:
    static FileTrees& Instance() {
        static FileTrees trees;
        return trees;
    }
    FileTrees(const FileTrees&) = delete;
    FileTrees& operator=(const FileTrees&) = delete;

    /// So many files in one folder, with eight usual extensions.
    const std::string& Flat(std::int64_t files) {
        return Made("flat" + std::to_string(files), [&](const std::string& path) {
            const FileMaker maker(path);
            for (std::int64_t i = 0; i < files; ++i)
                maker.Make(FileName(i, usualExtensions[static_cast<std::size_t>(i) % usualExtensions.size()]), i);
        });
    }
    const std::string& WithoutExtension(std::int64_t files) {
        return Made("plain" + std::to_string(files), [&](const std::string& path) {
            // Second names of files that are there: quicker to make.
            std::int64_t number = 0;
            for (const auto& file : std::filesystem::directory_iterator(Flat(files)))
                std::filesystem::create_hard_link(file.path(), path + "/" + FileName(number++, {}));
        });
    }
    /// So many folders, each with three files in it.
    const std::string& Folders(std::int64_t folders) {
        return Made("folders" + std::to_string(folders), [&](const std::string& path) {
            for (std::int64_t i = 0; i < folders; ++i) {
                const std::string folder = path + "/Holidays " + std::to_string(i * 7919 % folders);
                std::filesystem::create_directory(folder);
                const FileMaker maker(folder);
                for (std::int64_t file = 0; file < 3; ++file) maker.Make(FileName(file, ".jpg"), i + file);
            }
        });
    }
    /// So many folders with nothing in them.
    const std::string& EmptyFolders(std::int64_t folders) {
        return Made("empty" + std::to_string(folders), [&](const std::string& path) {
            for (std::int64_t i = 0; i < folders; ++i)
                std::filesystem::create_directory(path + "/Holidays " + std::to_string(i * 7919 % folders));
        });
    }
    static constexpr std::int64_t wideFolders = 99, foldersEach = 1010;
    /// About 100,000 folders: itself, 99 in it, and 1,010 in each of these.
    static constexpr std::int64_t folderTreeNodes = 1 + wideFolders * (1 + foldersEach);
    const std::string& FolderTree() {
        return Made("foldertree", [&](const std::string& path) {
            for (std::int64_t wide = 0; wide < wideFolders; ++wide) {
                const std::string folder = path + "/Year " + std::to_string(1900 + wide);
                std::filesystem::create_directory(folder);
                for (std::int64_t i = 0; i < foldersEach; ++i)
                    std::filesystem::create_directory(folder + "/Place " + std::to_string(i));
            }
        });
    }
    static constexpr std::int64_t treeFiles = 204'000, treeMatches = treeFiles / 8;
    /// 200,000 files in 2,040 folders in two levels. Each eighth file is a text. They are further names of the files of `Flat`:
    /// quicker to make.
    const std::string& Tree() {
        return Made("tree", [&](const std::string& path) {
            constexpr std::int64_t wide = 40, below = 50, filesEach = 100;
            constexpr std::int64_t different = 100'000;
            const std::string files = Flat(different) + "/";
            std::int64_t number = 0;
            const auto fill = [&](const std::string& folder) {
                for (std::int64_t i = 0; i < filesEach; ++i, ++number) {
                    const std::string_view extension = usualExtensions[static_cast<std::size_t>(number) % usualExtensions.size()];
                    std::filesystem::create_hard_link(files + FileName(number % different, extension),
                                                      folder + "/" + FileName(number, extension));
                }
            };
            for (std::int64_t year = 0; year < wide; ++year) {
                const std::string folder = path + "/Year " + std::to_string(1990 + year);
                std::filesystem::create_directory(folder);
                fill(folder);
                for (std::int64_t place = 0; place < below; ++place) {
                    const std::string inner = folder + "/Place " + std::to_string(place);
                    std::filesystem::create_directory(inner);
                    fill(inner);
                }
            }
        });
    }

  private:
    FileTrees() {
        const char* given = std::getenv("TESSEL_BENCH_DIR");
        const std::filesystem::path below = given && *given ? std::filesystem::path(given) : std::filesystem::temp_directory_path();
        std::string name = (below / "tessel-bench-XXXXXX").string();
        if (!mkdtemp(name.data())) FileMaker::Fail("no folder for the benchmark");
        root_ = name;
    }
    ~FileTrees() {
        std::error_code error;
        std::filesystem::remove_all(root_, error);
    }
    template <class F>
    const std::string& Made(const std::string& name, F&& fill) {
        const auto [known, isNew] = paths_.try_emplace(name, root_ + "/" + name);
        if (isNew) {
            std::filesystem::create_directory(known->second);
            fill(known->second);
        }
        return known->second;
    }

    std::string root_;
    std::map<std::string, std::string> paths_;
};

}  // namespace tessel::bench
