#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"
#include "import/assembly/CornerPieces.h"
#include "import/off/OffHeader.h"

#include <array>
#include <cstdint>
#include <string_view>
#include <vector>

namespace quarn {

/// Faces of an OFF file, as many as one thread reads at a time.
struct OffPart {
    std::string_view text;
    std::uint64_t first = 0; ///< of the file's vertices and faces, the one in its first filled line
    std::vector<FaceRun> runs{};
    std::vector<std::uint32_t> corners{};
    std::vector<std::array<float, 4>> face_colors{}; ///< none, or by face; negative: it has none
    std::vector<std::uint32_t> corner_colors{};      ///< of faces with colours of their own
    std::vector<FaceRun> line_runs{};
    std::vector<std::uint32_t> line_corners{};
    std::vector<std::uint32_t> points{};
    std::uint64_t without_corners = 0;
    float largest_color = 0.0F;
    const char* bad_place = nullptr; ///< of the first line that is damaged; null: none is
    std::string why_bad{};
};

/// What stands in an OFF file below its head.
struct OffBody {
    std::vector<KM_3dPoint> places;
    std::vector<KM_2fPoint> textures;
    std::vector<KM_3fVector> normals;
    std::vector<KM_Color> colors; ///< those of the vertices, then those of faces
    bool has_face_colors = false;
    std::vector<OffPart> parts;
};

/// Reads the vertices and faces of an OFF file, in parts that several threads share.
/// @param text  the whole file; outlives the body
/// @return an error, a part of a sentence
Result<OffBody> readOffBody(const OffHeader& header, std::string_view text, char line_break,
                            const ModelReading& reading);

} // namespace quarn
