#include "import/library/LibraryExtensions.h"

#include <assimp/Importer.hpp>

#include <cctype>
#include <sstream>

namespace quarn {

/// From "*.3ds;*.obj".
std::vector<std::string> libraryExtensions() {
    aiString list;
    const Assimp::Importer importer;
    importer.GetExtensionList(list);
    std::istringstream stream(list.C_Str());
    std::vector<std::string> extensions;
    for (std::string pattern; std::getline(stream, pattern, ';');) {
        std::string extension = pattern.substr(pattern.rfind('.') + 1);
        for (char& c : extension)
            c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
        extensions.push_back(extension);
    }
    return extensions;
}

} // namespace quarn
