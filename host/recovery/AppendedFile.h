#pragma once

#include "ground/Result.h"

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <span>

namespace quarn {

/// A file that is only ever appended to, for its user alone.
class AppendedFile {
public:
    AppendedFile() = default;
    ~AppendedFile() { close(); }
    AppendedFile(AppendedFile&& other) noexcept;
    AppendedFile& operator=(AppendedFile&& other) noexcept;
    AppendedFile(const AppendedFile&) = delete;
    AppendedFile& operator=(const AppendedFile&) = delete;

    // An error is part of a sentence: no space is left, no permission, ...

    /// Makes an empty file where nothing of that name is.
    static Result<AppendedFile> make(const std::filesystem::path& path);
    Result<void> append(std::span<const std::uint8_t> bytes);
    /// Waits until all of it is on the disk.
    Result<void> flush();
    /// Takes off what stands behind this size. @return whether it is gone
    bool cutTo(std::uint64_t size);
    void close();

    bool isOpen() const { return m_descriptor >= 0; }
    std::uint64_t size() const { return m_size; }
    /// Whether this file is what the path names.
    bool isAt(const std::filesystem::path& path) const;

private:
    int m_descriptor = -1;
    std::uint64_t m_size = 0;
};

/// Gives a file another name, over one that is there, and waits until that is on the disk too where
/// the folder can be flushed.
Result<void> moveOver(const std::filesystem::path& from, const std::filesystem::path& to);

} // namespace quarn
