#pragma once

#include "host/import/ModelFolder.h"

#include <assimp/DefaultIOSystem.h>

#include <set>
#include <string>

namespace quarn {

/// The files that the reading library may open for a model: regular files of the model's folder.
/// Remembers the names that were refused.
class ModelFileAccess : public Assimp::DefaultIOSystem {
public:
    /// @param folder   outlives this object
    /// @param refused  receives each refused name once; outlives this object
    ModelFileAccess(const ModelFolder& folder, std::set<std::string>& refused);

    bool Exists(const char* path) const override;
    Assimp::IOStream* Open(const char* path, const char* mode) override;

private:
    bool mayRead(const char* path) const;

    const ModelFolder& m_folder;
    std::set<std::string>& m_refused;
};

} // namespace quarn
