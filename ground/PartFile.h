#pragma once

#include <cstddef>
#include <filesystem>
#include <span>
#include <sys/types.h>

namespace quarn {

/// A file under a temporary name, `.quarn-HOST-PROCESS-NUMBER.part`, which goes away unless it is
/// renamed. Every operation but the constructor tells the reason of a failure in errno.
class PartFile {
public:
    /// Makes it. Where that fails it is not open, and errno tells why.
    /// @param mode  the permissions, less what the user's mask takes away
    PartFile(const std::filesystem::path& folder, mode_t mode);
    PartFile(const PartFile&) = delete;
    PartFile& operator=(const PartFile&) = delete;
    ~PartFile();

    bool isOpen() const { return m_descriptor >= 0; }
    int descriptor() const { return m_descriptor; }
    /// Where it is until it is renamed.
    const std::filesystem::path& path() const { return m_path; }

    bool write(std::span<const std::byte> bytes) const;
    bool flushToDisk() const;
    /// False where the last bytes could not be written.
    bool close();
    /// Gives it its lasting name, which replaces a file of that name.
    bool renameTo(const std::filesystem::path& path);

private:
    std::filesystem::path m_path;
    int m_descriptor = -1;
    bool m_exists = false;
};

/// Removes the part files in a folder whose programs ran on this machine and have ended; those of
/// other machines and of programs at work stay, and so does all else. What cannot be removed stays
/// without a word. Reads the names of all files in the folder.
void removeLeftParts(const std::filesystem::path& folder);

} // namespace quarn
