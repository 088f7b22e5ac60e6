#include "host/import/ModelFileAccess.h"

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

bool ModelFileAccess::Exists(const char* path) const {
    return mayRead(path);
}

Assimp::IOStream* ModelFileAccess::Open(const char* path, const char* mode) {
    const bool reading = mode != nullptr && mode[0] == 'r';
    return reading && mayRead(path) ? DefaultIOSystem::Open(path, mode) : nullptr;
}

} // namespace quarn
