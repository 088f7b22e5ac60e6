#include "import/library/ModelFileAccess.h"

#include <assimp/MemoryIOWrapper.h>

namespace quarn {

ModelFileAccess::ModelFileAccess(const ModelFolder& folder, std::set<std::string>& refused)
    : m_folder(folder), m_refused(refused) {}

bool ModelFileAccess::mayRead(const char* path) const {
    if (!m_folder.contains(path)) {
        m_refused.insert(path);
        return false;
    }
    std::error_code failure; // a pipe or a device could block or never end
    return std::filesystem::is_regular_file(path, failure);
}

void ModelFileAccess::replace(const std::filesystem::path& path, std::string_view bytes) {
    m_replaced = path;
    m_bytes = bytes;
}

bool ModelFileAccess::Exists(const char* path) const {
    return mayRead(path);
}

Assimp::IOStream* ModelFileAccess::Open(const char* path, const char* mode) {
    const bool reading = mode != nullptr && mode[0] == 'r';
    if (!reading || !mayRead(path)) {
        return nullptr;
    }
    if (!m_replaced.empty() && m_replaced == path) {
        return new Assimp::MemoryIOStream(reinterpret_cast<const std::uint8_t*>(m_bytes.data()),
                                          m_bytes.size()); // the caller owns it
    }
    return DefaultIOSystem::Open(path, mode);
}

} // namespace quarn
