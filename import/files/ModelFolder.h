#pragma once

#include <cstddef>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace quarn {

/// A file that a model names.
struct NamedFile {
    std::filesystem::path path;
    bool differs_in_case = false; ///< the model's name for it has other capital and small letters
};

/// The sentence for a file whose name differs in capital and small letters alone.
/// @param reference  as the model names it
std::string otherCaseText(std::string_view reference, const NamedFile& file);

/// The folder of a model file: the only place from which the files that the model names are read.
/// Names inside a model are hostile until they are resolved here.
class ModelFolder {
public:
    /// How many names of files are looked at for one that differs in case alone.
    static constexpr std::size_t MOST_ENTRIES = 100'000;

    /// @param model_file    the model, which exists
    /// @param most_entries  of the folder and those below it together; beyond it files are found by
    ///                      their exact names alone
    explicit ModelFolder(const std::filesystem::path& model_file,
                         std::size_t most_entries = MOST_ENTRIES);

    /// True when `path`, with its links followed, lies in the folder or below it.
    bool contains(const std::filesystem::path& path) const;

    /// The file that a model means by `reference`: relative to the folder, with slashes of either
    /// kind, with or without percent escapes. A path from another machine counts by its file name.
    /// Where no name fits, one that differs in capital and small letters (of ASCII) alone does; for
    /// that each folder is listed once, so that files which come later are not found. From one
    /// thread at a time.
    /// @return an existing regular file in the folder or below it, or nothing
    std::optional<NamedFile> find(std::string_view reference) const;

    /// True when `reference` is an absolute path or climbs out of the folder.
    bool leadsOutside(std::string_view reference) const;

private:
    std::optional<std::filesystem::path> fileInside(const std::string& relative) const;
    std::optional<std::filesystem::path> fileOfOtherCase(const std::string& relative) const;

    /// The names of a folder by what they are in small letters, the first of those that are alike.
    using Names = std::map<std::string, std::filesystem::path>;

    const Names& namesIn(const std::filesystem::path& folder) const;
    std::optional<std::filesystem::path> entryOfOtherCase(const std::filesystem::path& folder,
                                                          const std::filesystem::path& name) const;

    std::filesystem::path m_folder;
    std::filesystem::path m_model;
    mutable std::size_t m_entries_left;
    mutable std::map<std::filesystem::path, Names> m_listed;
};

} // namespace quarn
