#include "import/obj/ObjPieces.h"

#include <algorithm>
#include <unordered_map>

namespace quarn {

namespace {

/// The indices of some corners, or null where none of them names anything.
const std::uint32_t* someOf(const std::vector<std::uint32_t>& indices, std::size_t begin,
                            std::size_t end) {
    if (indices.empty())
        return nullptr;
    const auto* const first = indices.data() + begin;
    const auto* const last = indices.data() + end;
    return std::find_if(first, last, [](std::uint32_t i) { return i != OBJ_NO_INDEX; }) == last
               ? nullptr
               : first;
}

class Pieces {
public:
    explicit Pieces(ObjContent& content) : m_content(content) {}

    void take() {
        for (const ObjPart& part : m_content.parts)
            for (std::size_t i = 0; i < part.sections.size(); ++i)
                takeSection(part, part.sections[i],
                            i + 1 < part.sections.size() ? part.sections[i + 1] : endOf(part));
        nameAfterMaterials();
    }

private:
    static ObjSection endOf(const ObjPart& part) {
        return {{},
                part.runs.size(),
                part.corners.size(),
                part.line_runs.size(),
                part.line_corners.size(),
                part.points.size()};
    }

    void takeSection(const ObjPart& part, const ObjSection& begin, const ObjSection& end) {
        for (const ObjChange& change : begin.changes)
            take(change);
        if (begin.runs < end.runs)
            piece().elements.faces.push_back(
                {{part.runs.data() + begin.runs, end.runs - begin.runs},
                 part.corners.data() + begin.corners,
                 someOf(part.corner_textures, begin.corners, end.corners),
                 someOf(part.corner_normals, begin.corners, end.corners),
                 m_content.colors.empty() ? nullptr : part.corners.data() + begin.corners});
        if (begin.line_runs < end.line_runs)
            piece().elements.lines.push_back(
                {.runs = {part.line_runs.data() + begin.line_runs, end.line_runs - begin.line_runs},
                 .places = part.line_corners.data() + begin.line_corners});
        if (begin.points < end.points)
            piece().elements.points.emplace_back(part.points.data() + begin.points,
                                                 end.points - begin.points);
    }

    void take(const ObjChange& change) {
        if (change.kind == ObjChange::Kind::library) {
            m_content.libraries.push_back(change.name);
        } else if (change.kind == ObjChange::Kind::material) {
            m_material = change.name;
        } else if (change.name != m_object) {
            m_object = change.name;
            nameAfterMaterials();
        }
    }

    ObjPiece& piece() {
        const auto [known, is_new] = m_of_material.try_emplace(m_material, m_content.pieces.size());
        if (is_new)
            m_content.pieces.push_back({m_object, m_material, {}});
        return m_content.pieces[known->second];
    }

    /// Ends the object in hand.
    void nameAfterMaterials() {
        const bool is_unnamed = m_of_material.size() > 1 && m_content.pieces.back().name.empty();
        for (const auto& [material, piece] : m_of_material)
            if (is_unnamed)
                m_content.pieces[piece].name = material;
        m_of_material.clear();
    }

    ObjContent& m_content;
    std::string_view m_object;
    std::string_view m_material;
    std::unordered_map<std::string_view, std::size_t> m_of_material; ///< pieces of the object
};

} // namespace

void takePieces(ObjContent& content) {
    Pieces(content).take();
}

} // namespace quarn
