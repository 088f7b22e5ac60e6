#include "import/files/ModelFolder.h"

#include <algorithm>

namespace quarn {
namespace {

namespace fs = std::filesystem;

std::string withSlashes(std::string_view reference) {
    std::string text(reference);
    std::replace(text.begin(), text.end(), '\\', '/');
    if (text.starts_with("file://")) {
        text.erase(0, 7);
    } else if (text.starts_with("//")) {
        text.erase(0, 2); // so BLEND files write what counts from their own folder
    }
    return text;
}

int hexDigit(char c) {
    if (c >= '0' && c <= '9') {
        return c - '0';
    }
    const char lower = static_cast<char>(c | 0x20);
    return lower >= 'a' && lower <= 'f' ? lower - 'a' + 10 : -1;
}

std::string withoutEscapes(const std::string& text) {
    std::string plain;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool escape = text[i] == '%' && i + 2 < text.size() && hexDigit(text[i + 1]) >= 0 &&
                            hexDigit(text[i + 2]) >= 0;
        plain += escape ? static_cast<char>(hexDigit(text[i + 1]) * 16 + hexDigit(text[i + 2]))
                        : text[i];
        i += escape ? 2 : 0;
    }
    return plain;
}

bool isAbsolute(const std::string& text) {
    const bool drive = text.size() > 1 && text[1] == ':';
    return drive || text.starts_with('/');
}

std::string inSmallLetters(std::string text) {
    for (char& c : text)
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
    return text;
}

} // namespace

std::string otherCaseText(std::string_view reference, const NamedFile& file) {
    return "The file '" + file.path.filename().string() + "' was read for '" +
           std::string(reference) + "': the names differ in capital and small letters.";
}

ModelFolder::ModelFolder(const fs::path& model_file, std::size_t most_entries)
    : m_entries_left(most_entries) {
    std::error_code ignored;
    m_model = fs::absolute(model_file, ignored).lexically_normal();
    m_folder = fs::weakly_canonical(m_model.parent_path(), ignored);
}

bool ModelFolder::contains(const fs::path& path) const {
    std::error_code failure;
    const fs::path absolute = fs::absolute(path, failure);
    if (failure) {
        return false;
    }
    if (absolute.lexically_normal() == m_model) {
        return true; // also where the model itself is a link
    }
    const fs::path real = fs::weakly_canonical(absolute, failure);
    if (failure) {
        return false;
    }
    const auto [folder_end, unused] =
        std::mismatch(m_folder.begin(), m_folder.end(), real.begin(), real.end());
    return folder_end == m_folder.end();
}

std::optional<fs::path> ModelFolder::fileInside(const std::string& relative) const {
    if (relative.empty() || relative.find('\0') != std::string::npos) {
        return std::nullopt;
    }
    const fs::path path = m_folder / relative;
    std::error_code failure;
    if (!contains(path) || !fs::is_regular_file(path, failure)) {
        return std::nullopt;
    }
    return path;
}

const ModelFolder::Names& ModelFolder::namesIn(const fs::path& folder) const {
    const auto [listed, is_new] = m_listed.try_emplace(folder);
    Names& names = listed->second;
    if (!is_new)
        return names;
    std::error_code failure;
    for (fs::directory_iterator at(folder, failure), end;
         !failure && at != end && m_entries_left > 0; at.increment(failure), --m_entries_left) {
        const fs::path found = at->path().filename();
        const auto [same, is_first] = names.try_emplace(inSmallLetters(found.string()), found);
        if (!is_first && found < same->second)
            same->second = found;
    }
    return names;
}

/// The first of a folder's names that differs from `name` in case alone.
std::optional<fs::path> ModelFolder::entryOfOtherCase(const fs::path& folder,
                                                      const fs::path& name) const {
    const Names& names = namesIn(folder);
    const auto found = names.find(inSmallLetters(name.string()));
    return found != names.end() ? std::optional(found->second) : std::nullopt;
}

std::optional<fs::path> ModelFolder::fileOfOtherCase(const std::string& relative) const {
    const fs::path wanted = fs::path(relative).lexically_normal();
    if (relative.find('\0') != std::string::npos || wanted.is_absolute() ||
        (!wanted.empty() && *wanted.begin() == ".."))
        return std::nullopt;
    fs::path found;
    for (const fs::path& part : wanted) {
        std::error_code failure;
        const bool is_exact = fs::exists(m_folder / found / part, failure);
        const std::optional<fs::path> entry =
            is_exact ? part : entryOfOtherCase(m_folder / found, part);
        if (!entry)
            return std::nullopt;
        found /= *entry;
    }
    return fileInside(found.string());
}

std::optional<NamedFile> ModelFolder::find(std::string_view reference) const {
    const std::string text = withSlashes(reference);
    const std::string plain = withoutEscapes(text);
    if (auto file = fileInside(text))
        return NamedFile{*file};
    for (const std::string& name : {plain, plain.substr(plain.rfind('/') + 1)}) {
        if (auto file = fileInside(name))
            return NamedFile{*file};
        if (auto file = fileOfOtherCase(name))
            return NamedFile{*file, true};
    }
    return std::nullopt;
}

bool ModelFolder::leadsOutside(std::string_view reference) const {
    const std::string text = withoutEscapes(withSlashes(reference));
    return isAbsolute(text) || !contains(m_folder / text);
}

} // namespace quarn
