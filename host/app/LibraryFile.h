#pragma once

#include "ground/Result.h"

#include <filesystem>

namespace quarn {

/// An opened shared library; closed, and unloaded if nobody else has it open, at the end of its
/// life. May hold nothing.
class LibraryFile {
public:
    LibraryFile() = default;
    /// Opens a library at once and wholly; its names stay its own.
    /// @return an error with the linker's words
    static Result<LibraryFile> open(const std::filesystem::path& file);
    /// Whether this very file is in the process already.
    static bool isOpen(const std::filesystem::path& file);

    ~LibraryFile();
    LibraryFile(LibraryFile&& other) noexcept;
    LibraryFile& operator=(LibraryFile&& other) noexcept;

    /// The address of an exported name, or null.
    void* find(const char* name) const;

private:
    explicit LibraryFile(void* opened) : m_opened(opened) {}
    void* m_opened = nullptr;
};

} // namespace quarn
