#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"
#include "import/assembly/CornerPieces.h"
#include "import/obj/ObjPart.h"

#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// What an OBJ file has of one object and one material.
struct ObjPiece {
    std::string_view name;     ///< empty: the file gives none
    std::string_view material; ///< likewise
    CornerElements elements;
};

/// An OBJ file whose statements are read. Neither copied nor moved while its pieces are in use.
struct ObjContent {
    std::vector<ObjPart> parts; ///< without the tables, which are joined here
    std::vector<KM_3dPoint> places;
    std::vector<KM_2fPoint> textures;
    std::vector<KM_3fVector> normals;
    std::vector<KM_Color> colors; ///< none, or by place
    std::vector<ObjPiece> pieces; ///< in the file's order
    std::vector<std::string_view> libraries;
    std::vector<std::string> faults; ///< sentences: what cannot be used, with its line
};

/// Reads the statements of an OBJ file, in parts that several threads share.
/// @param text  the whole file; outlives the content
/// @return an error, a part of a sentence, where the reading was given up or needs too much memory
Result<ObjContent> readObjContent(std::string_view text, const ModelReading& reading);

} // namespace quarn
