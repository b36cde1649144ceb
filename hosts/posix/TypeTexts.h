#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace tessel::posix {

/// What stands behind the last point of a name; empty where a name has no other point than one at its beginning, and for an
/// extension that is too long to be one.
std::string_view TypeExtension(std::string_view name);

/// The descriptions of types, from the desktop's shared mime database: by the extension alone, so that no file is opened for its
/// type. The database is read when the first text is asked for.
class TypeTexts {
  public:
    /// `folders` are those that hold a folder "mime", the one that counts most first; `languages` the user's, the first one first
    /// ("de_AT", "de"). English is always understood.
    TypeTexts(std::vector<std::string> folders, std::vector<std::string> languages);
    TypeTexts(const TypeTexts&) = delete;
    TypeTexts& operator=(const TypeTexts&) = delete;

    static constexpr std::int32_t folderId = 0, plainId = 1;
    /// The number of a file's type; equal for equal extensions.
    std::int32_t IdOf(std::string_view fileName);
    /// "File Folder" for a folder, the database's words for an extension that it knows, "XYZ File" and "File" for others.
    std::string Text(std::int32_t id);

  private:
    struct Glob {
        int weight;
        std::string type;
    };
    /// An extension that was asked for lately: a folder has few, and they come by turns.
    struct Recent {
        std::string_view extension = {};  // a key of `ids_`
        std::int32_t id = plainId;
    };
    struct TextHash {
        using is_transparent = void;
        std::size_t operator()(std::string_view text) const { return std::hash<std::string_view>()(text); }
    };
    template <class T>
    using ByText = std::unordered_map<std::string, T, TextHash, std::equal_to<>>;

    void ReadGlobs();
    void ReadGlobFile(const std::string& text);
    std::string TypeOf(const std::string& extension) const;
    std::string CommentOf(const std::string& type) const;

    std::vector<std::string> folders_, languages_;
    ByText<std::int32_t> ids_;                     // by extension, as it is written
    std::vector<std::string> extensions_, texts_;  // by id; a text is empty until it was asked for
    std::array<Recent, 64> recent_{};
    bool read_ = false;
    ByText<Glob> exact_, caseless_;
};

/// The text of the comment in one of the languages, else of the one without a language; empty where there is none.
std::string CommentIn(std::string_view typeFile, const std::vector<std::string>& languages);

/// The contents of a file, empty where it cannot be read or is larger than `most`.
std::string SmallFile(const std::string& path, std::size_t most = 16 << 20);

}  // namespace tessel::posix
