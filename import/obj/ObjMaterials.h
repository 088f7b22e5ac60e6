#pragma once

#include "ground/FileBytes.h"
#include "import/ModelReading.h"
#include "import/obj/MaterialFile.h"
#include "import/obj/ObjLook.h"
#include "import/text/FileText.h"

#include <deque>
#include <map>
#include <set>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace quarn {

/// The materials of an OBJ file, from the material files that it names; each is made once, when it
/// is asked for. What is missing is told.
class ObjMaterials {
public:
    /// @param warnings  receives the sentences; outlives this object
    ObjMaterials(const ModelReading& reading, std::vector<std::string>& warnings);

    /// @param statements  what the OBJ file has behind `mtllib`, of which each may name several
    void readLibraries(std::span<const std::string_view> statements);

    /// @param name  as the OBJ file has it; empty for none
    const ObjMaterial& at(std::string_view name);

    /// To be called when all materials have been asked for.
    void tellMissing();

private:
    /// What its materials' names lie in.
    struct Source {
        FileBytes bytes;
        FileText text;
    };

    void readStatement(std::string_view statement);
    void readLibrary(std::string_view name);
    void readNamesake();
    bool readFile(const NamedFile& file);
    void keepMaterials(std::string_view text, const std::string& file);

    const ModelReading& m_reading;
    std::vector<std::string>& m_warnings;
    TextureStore m_textures;
    std::set<std::string, std::less<>> m_asked; ///< libraries
    std::deque<Source> m_sources;
    std::unordered_map<std::string_view, FileMaterial> m_found;
    std::map<std::string, ObjMaterial, std::less<>> m_made;
    std::vector<std::string> m_missing; ///< materials that no library has
    bool m_misses_library = false;
};

} // namespace quarn
