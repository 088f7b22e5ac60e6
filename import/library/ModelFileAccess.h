#pragma once

#include "import/files/ModelFolder.h"

#include <assimp/DefaultIOSystem.h>

#include <set>
#include <string>
#include <string_view>

namespace quarn {

/// The files that the reading library may open for a model: regular files of the model's folder.
/// Remembers the names that were refused.
class ModelFileAccess : public Assimp::DefaultIOSystem {
public:
    /// @param folder   outlives this object
    /// @param refused  receives each refused name once; outlives this object
    ModelFileAccess(const ModelFolder& folder, std::set<std::string>& refused);

    /// Hands out other bytes for one file than those on the disk.
    /// @param bytes  outlive this object
    void replace(const std::filesystem::path& path, std::string_view bytes);

    bool Exists(const char* path) const override;
    Assimp::IOStream* Open(const char* path, const char* mode) override;

private:
    bool mayRead(const char* path) const;

    const ModelFolder& m_folder;
    std::set<std::string>& m_refused;
    std::filesystem::path m_replaced; ///< empty: none
    std::string_view m_bytes;
};

} // namespace quarn
