#pragma once

#include <filesystem>

namespace quarn {

/// Keeps other processes of this machine that do the same from looking at a folder while its files
/// are looked at and changed in one go. Where the folder cannot be locked it does nothing.
class FolderLock {
public:
    explicit FolderLock(const std::filesystem::path& folder);
    ~FolderLock();
    FolderLock(const FolderLock&) = delete;
    FolderLock& operator=(const FolderLock&) = delete;

private:
    int m_descriptor;
};

} // namespace quarn
