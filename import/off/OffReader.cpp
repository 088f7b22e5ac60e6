#include "import/off/OffReader.h"

#include "import/WritingProgram.h"
#include "import/assembly/CornerPieces.h"
#include "import/files/ModelFileCheck.h"
#include "import/off/OffBody.h"
#include "import/text/FileText.h"
#include "import/text/LineCursor.h"

#include <string>

namespace quarn {

namespace {

CornerElements elementsOf(const OffHeader& header, const OffBody& body) {
    CornerElements elements;
    for (const OffPart& part : body.parts) {
        const std::uint32_t* const places = part.corners.data();
        const std::uint32_t* const vertex_colors = header.has_colors ? places : nullptr;
        if (!part.runs.empty())
            elements.faces.push_back(
                {part.runs, places, header.has_textures ? places : nullptr,
                 header.has_normals ? places : nullptr,
                 part.corner_colors.empty() ? vertex_colors : part.corner_colors.data()});
        if (!part.line_runs.empty())
            elements.lines.push_back({.runs = part.line_runs, .places = part.line_corners.data()});
        if (!part.points.empty())
            elements.points.emplace_back(part.points);
    }
    return elements;
}

Result<SourceScene> sceneOf(const OffHeader& header, const OffBody& body,
                            const ModelReading& reading) {
    SourceScene scene;
    std::uint64_t without_corners = 0;
    for (const OffPart& part : body.parts)
        without_corners += part.without_corners;
    if (without_corners > 0)
        scene.warnings.push_back(std::to_string(without_corners) +
                                 " faces were left out: they have no corners.");
    const CornerTables tables{body.places, body.textures, body.normals, body.colors};
    CornerPieces pieces(tables, reading, scene);
    if (header.faces == 0)
        pieces.addAllAsPoints();
    else if (const Result<void> added = pieces.add(elementsOf(header, body), {}); !added)
        return added.error();
    pieces.tellDropped();
    return scene;
}

} // namespace

Result<SourceScene> readOff(const ModelReading& reading) {
    constexpr std::string_view REPAIR = "The file may be damaged; export the model again.";
    constexpr std::string_view SMALLER = "Use a smaller model.";
    const Result<FileText> file = FileText::of(reading.bytes, reading.budget);
    if (!file)
        return cannotReadModel(reading.path, file.message(), SMALLER);
    const std::string_view text = file.value().text();
    const char line_break = lineBreakOf(text);
    const Result<OffHeader> header = readOffHeader(text, line_break);
    if (!header)
        return cannotReadModel(reading.path, header.message(), REPAIR);
    const Result<OffBody> body = readOffBody(header.value(), text, line_break, reading);
    if (!body)
        return cannotReadModel(reading.path, body.message(), REPAIR);
    Result<SourceScene> scene = sceneOf(header.value(), body.value(), reading);
    if (!scene)
        return cannotReadModel(reading.path, scene.message(), SMALLER);
    scene.value().up = upAxisOf(reading.up, {}, {});
    return scene;
}

} // namespace quarn
