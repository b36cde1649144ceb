#include "hosts/posix/TypeTexts.h"

#include <algorithm>
#include <charconv>
#include <fstream>
#include <optional>

#include "frame/FileSystem.h"
#include "frame/Text.h"

namespace tessel::posix {
namespace {

constexpr std::size_t longestExtension = 32;

char Lower(char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; }
char Upper(char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; }

template <class Change>
std::string Changed(std::string_view text, Change change) {
    std::string changed(text);
    std::transform(changed.begin(), changed.end(), changed.begin(), change);
    return changed;
}

/// The part of `text` up to a mark, which goes with it.
std::string_view TakeUpTo(std::string_view& text, char mark) {
    const std::size_t end = std::min(text.find(mark), text.size());
    const std::string_view part = text.substr(0, end);
    text.remove_prefix(std::min(end + 1, text.size()));
    return part;
}

std::string Unescaped(std::string_view text) {
    static constexpr std::pair<std::string_view, char> names[] = {
        {"lt", '<'}, {"gt", '>'}, {"amp", '&'}, {"quot", '"'}, {"apos", '\''}};
    std::string result;
    while (!text.empty()) {
        result += TakeUpTo(text, '&');
        const std::size_t end = text.find(';');
        if (text.empty() || end == std::string_view::npos) break;
        std::string_view name = text.substr(0, end);
        text.remove_prefix(end + 1);
        if (name.starts_with('#')) {
            name.remove_prefix(1);
            const bool hexadecimal = name.starts_with('x');
            if (hexadecimal) name.remove_prefix(1);
            std::uint32_t code = 0;
            std::from_chars(name.data(), name.data() + name.size(), code, hexadecimal ? 16 : 10);
            frame::AppendCharacter(result, static_cast<char32_t>(code));
        } else {
            for (const auto& [known, character] : names)
                if (known == name) result += character;
        }
    }
    return result;
}

}  // namespace

std::string SmallFile(const std::string& path, std::size_t most) {
    std::ifstream file(path, std::ios::binary);
    std::string text;
    char block[1 << 14];
    while (file.read(block, sizeof block), file.gcount() > 0) {
        text.append(block, static_cast<std::size_t>(file.gcount()));
        if (text.size() > most) return {};
    }
    return text;
}

std::string_view TypeExtension(std::string_view name) {
    const std::size_t point = name.rfind('.');
    if (point == std::string_view::npos || point == 0) return {};
    const std::string_view extension = name.substr(point + 1);
    return extension.size() <= longestExtension ? extension : std::string_view();
}

std::string CommentIn(std::string_view typeFile, const std::vector<std::string>& languages) {
    constexpr std::string_view opening = "<comment", closing = "</comment>", languageMark = "xml:lang=";
    std::size_t best = languages.size() + 1;
    std::string_view text;
    for (std::size_t at = 0; (at = typeFile.find(opening, at)) != std::string_view::npos;) {
        const std::size_t tagEnd = typeFile.find('>', at);
        if (tagEnd == std::string_view::npos) break;
        const std::string_view tag = typeFile.substr(at + opening.size(), tagEnd - at - opening.size());
        const std::size_t end = typeFile.find(closing, tagEnd);
        if (end == std::string_view::npos) break;
        std::size_t rank = languages.size();
        if (const std::size_t mark = tag.find(languageMark); mark != std::string_view::npos) {
            std::string_view language = tag.substr(mark + languageMark.size());
            const char quote = language.empty() ? '"' : language.front();
            if (!language.empty()) language.remove_prefix(1);
            language = TakeUpTo(language, quote);
            rank = static_cast<std::size_t>(std::find(languages.begin(), languages.end(), language) - languages.begin());
            if (rank == languages.size()) rank = languages.size() + 1;  // not the user's
        }
        if (rank < best) {
            best = rank;
            text = typeFile.substr(tagEnd + 1, end - tagEnd - 1);
        }
        at = end;
    }
    return Unescaped(text);
}

TypeTexts::TypeTexts(std::vector<std::string> folders, std::vector<std::string> languages)
    : folders_(std::move(folders)),
      languages_(std::move(languages)),
      extensions_(2),
      texts_{std::string(frame::folderTypeText), "File"} {}

std::int32_t TypeTexts::IdOf(std::string_view fileName) {
    const std::string_view extension = TypeExtension(fileName);
    if (extension.empty()) return plainId;
    const auto byte = [](char unit) { return static_cast<std::size_t>(static_cast<unsigned char>(unit)); };
    Recent& recent = recent_[(extension.size() + byte(extension.front()) * 3 + byte(extension.back()) * 5) % recent_.size()];
    if (extension == recent.extension) return recent.id;
    auto known = ids_.find(extension);
    if (known == ids_.end()) {
        known = ids_.emplace(std::string(extension), static_cast<std::int32_t>(texts_.size())).first;
        extensions_.emplace_back(extension);
        texts_.emplace_back();
    }
    recent = {known->first, known->second};
    return recent.id;
}

std::string TypeTexts::Text(std::int32_t id) {
    const auto index = static_cast<std::size_t>(id);
    if (id < 0 || index >= texts_.size()) return {};
    if (texts_[index].empty()) {
        if (!read_) ReadGlobs();
        read_ = true;
        const std::string& extension = extensions_[index];
        if (const std::string type = TypeOf(extension); !type.empty()) texts_[index] = CommentOf(type);
        if (texts_[index].empty()) texts_[index] = Changed(extension, Upper) + " File";
    }
    return texts_[index];
}

void TypeTexts::ReadGlobs() {
    // From the folder that counts least to the one that counts most, so that each can overrule those before it.
    std::vector<std::string> rising(folders_.rbegin(), folders_.rend());
    for (const std::string& folder : rising) ReadGlobFile(SmallFile(folder + "/mime/globs2"));
}

void TypeTexts::ReadGlobFile(const std::string& text) {
    ByText<Glob> exact, caseless;  // of this file; of two of equal weight the first one counts
    const auto offer = [](ByText<Glob>& globs, std::string extension, int weight, std::string_view type) {
        const auto [known, isNew] = globs.try_emplace(std::move(extension), Glob{weight, std::string(type)});
        if (!isNew && known->second.weight < weight) known->second = {weight, std::string(type)};
    };
    std::string_view rest = text;
    while (!rest.empty()) {
        std::string_view line = TakeUpTo(rest, '\n');
        if (line.starts_with('#')) continue;
        const std::string_view weightText = TakeUpTo(line, ':');
        const std::string_view type = TakeUpTo(line, ':'), glob = TakeUpTo(line, ':');
        int weight = 0;
        std::from_chars(weightText.data(), weightText.data() + weightText.size(), weight);
        if (glob == "__NOGLOBS__") {
            for (ByText<Glob>* globs : {&exact_, &caseless_})
                std::erase_if(*globs, [&](const auto& known) { return known.second.type == type; });
            continue;
        }
        if (!glob.starts_with("*.")) continue;
        const std::string_view extension = glob.substr(2);
        if (extension.empty() || extension.find_first_of("*?[.") != std::string_view::npos) continue;
        if (line.starts_with("cs"))
            offer(exact, std::string(extension), weight, type);
        else
            offer(caseless, Changed(extension, Lower), weight, type);
    }
    const auto take = [](ByText<Glob>& into, ByText<Glob>& from) {
        for (auto& [extension, glob] : from) {
            const auto [known, isNew] = into.try_emplace(extension, glob);
            if (!isNew && known->second.weight <= glob.weight) known->second = std::move(glob);
        }
    };
    take(exact_, exact);
    take(caseless_, caseless);
}

std::string TypeTexts::TypeOf(const std::string& extension) const {
    if (const auto found = exact_.find(extension); found != exact_.end()) return found->second.type;
    const auto found = caseless_.find(Changed(extension, Lower));
    return found != caseless_.end() ? found->second.type : std::string();
}

std::string TypeTexts::CommentOf(const std::string& type) const {
    if (type.find("..") != std::string::npos) return {};
    for (std::string file : folders_) {
        file.append("/mime/").append(type).append(".xml");
        if (std::string comment = CommentIn(SmallFile(file), languages_); !comment.empty()) return comment;
    }
    return {};
}

}  // namespace tessel::posix
