#pragma once

#include "engine/scene/EnvironmentPicture.h"
#include "ground/Result.h"

#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>

namespace quarn {

class Document;

/// The file that an absolute path stands for in a document: that one, or where there is none, the
/// one of its name beside the document's own file.
std::filesystem::path surroundingsFile(const Document& document, const std::filesystem::path& path);

/// The picture of the surroundings of a document. It is read once for each state of its file.
class SurroundingsPicture {
public:
    /// Reads the file unless it was read as it is now.
    /// @return an error in a sentence where it cannot be read
    Result<void> read(const std::filesystem::path& file);
    /// The same of a document that is to be drawn; what a person has to know is told once for each
    /// state of the file.
    /// @param path  that the document keeps
    /// @return null where there is none
    std::shared_ptr<const EnvironmentPicture> pictureFor(const Document& document,
                                                         const std::filesystem::path& path);

private:
    struct FileState {
        std::filesystem::path file;
        std::filesystem::file_time_type written;
        std::uintmax_t bytes = 0;
        friend bool operator==(const FileState&, const FileState&) = default;
    };

    static FileState stateOf(const std::filesystem::path& file);
    void tell(const Document& document);

    std::optional<FileState> m_read; ///< none: nothing was read yet
    std::shared_ptr<const EnvironmentPicture> m_picture;
    std::string m_trouble; ///< why there is none
    std::size_t m_moved_pixels = 0;
    bool m_is_told = false;
};

} // namespace quarn
