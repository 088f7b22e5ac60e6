#include "host/app/LibraryFile.h"

#include <dlfcn.h>

#include <utility>

namespace quarn {

Result<LibraryFile> LibraryFile::open(const std::filesystem::path& file) {
    if (void* opened = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL))
        return LibraryFile(opened);
    const char* reason = dlerror();
    return Error{reason ? reason : "unknown reason"};
}

bool LibraryFile::isOpen(const std::filesystem::path& file) {
    void* opened = dlopen(file.c_str(), RTLD_LAZY | RTLD_NOLOAD);
    if (!opened)
        return false;
    dlclose(opened);
    return true;
}

LibraryFile::~LibraryFile() {
    if (m_opened)
        dlclose(m_opened);
}

LibraryFile::LibraryFile(LibraryFile&& other) noexcept
    : m_opened(std::exchange(other.m_opened, nullptr)) {}

LibraryFile& LibraryFile::operator=(LibraryFile&& other) noexcept {
    std::swap(m_opened, other.m_opened);
    return *this;
}

void* LibraryFile::find(const char* name) const {
    return m_opened ? dlsym(m_opened, name) : nullptr;
}

} // namespace quarn
