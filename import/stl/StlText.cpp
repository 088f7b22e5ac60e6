#include "import/stl/StlText.h"

#include "engine/scene/PlacedMesh.h"
#include "import/ReadingProgress.h"
#include "import/assembly/MeshCleaning.h"
#include "import/files/ModelFileCheck.h"
#include "import/stl/StlMesh.h"
#include "import/stl/StlWords.h"
#include "import/text/LineCursor.h"

#include <atomic>

namespace quarn {

namespace {

/// The corners of a solid, each for itself.
class TextFacets {
public:
    explicit TextFacets(std::span<const KM_3fPoint> corners) : m_corners(corners) {}

    KM_3fPoint corner(std::uint32_t number) const { return m_corners[number]; }
    static bool hasColors() { return false; }
    static KM_Color color(std::uint32_t) { return {}; }

private:
    std::span<const KM_3fPoint> m_corners;
};

class TextReading {
public:
    explicit TextReading(const ModelReading& reading)
        : m_reading(reading), m_file(textOf(reading.bytes)),
          m_texts(partsOfStl(withoutByteOrderMark(m_file))) {}

    Result<SourceScene> read() {
        if (!readParts())
            return failed();
        const KM_3dPoint origin = nearbyOrigin(box());
        if (origin != KM_3dPoint::Origin) {
            m_origin = origin;
            if (!readParts())
                return failed();
        }
        joinParts();
        makeSolids();
        return std::move(m_scene);
    }

private:
    struct Solid {
        std::string_view name;
        std::size_t first_corner = 0;
    };

    /// @return false, with the reason kept, where the file cannot be read
    bool readParts() {
        m_parts.clear();
        m_parts.resize(m_texts.size());
        ReadingProgress progress(m_reading.watch, ReadingStep::read, m_file.size());
        std::atomic<bool> is_stopped = false;
        std::atomic<std::uint64_t> taken = 0;
        tbb::parallel_for(std::size_t{0}, m_texts.size(), [&](std::size_t i) {
            if (is_stopped)
                return;
            m_parts[i] = readStlPart(m_texts[i], m_origin);
            const std::uint64_t bytes = 3 * sizeof(KM_3fPoint) * m_parts[i].corners.size();
            const Result<void> room = m_reading.budget.take(bytes, "triangles");
            taken += room ? bytes : 0;
            if (room && progress.goesOn(m_texts[i].size()))
                return;
            if (!is_stopped.exchange(true))
                m_why = room ? "it was given up" : room.message();
        });
        m_reading.budget.giveBack(taken);
        for (std::size_t i = 0; i < m_parts.size() && m_why.empty(); ++i)
            if (m_parts[i].fault != nullptr)
                m_why = "line " + std::to_string(lineNumberAt(m_file, m_parts[i].fault)) + " " +
                        m_parts[i].why;
        return m_why.empty();
    }

    Error failed() const {
        return cannotReadModel(m_reading.path, m_why,
                               "Export the model again or restore the file.");
    }

    KM_BoundingBox box() const {
        KM_BoundingBox all;
        for (const StlPart& part : m_parts)
            all.Union(part.extent.box());
        return all;
    }

    void joinParts() {
        std::size_t corners = 0;
        for (const StlPart& part : m_parts)
            corners += part.corners.size();
        m_corners.reserve(corners);
        m_solids.push_back({});
        bool is_ended = false;
        for (StlPart& part : m_parts) {
            for (const StlPart::Solid& solid : part.solids)
                m_solids.push_back({solid.name, m_corners.size() + solid.first_corner});
            is_ended = part.ends_solid || (is_ended && part.solids.empty());
            m_corners.insert(m_corners.end(), part.corners.begin(), part.corners.end());
            part.corners = {};
        }
        if (!is_ended)
            m_scene.warnings.emplace_back("Its last solid has no end: the file may be cut short.");
    }

    void makeSolids() {
        std::uint64_t dropped = 0;
        for (std::size_t i = 0; i < m_solids.size(); ++i) {
            const std::size_t begin = m_solids[i].first_corner;
            const std::size_t end =
                i + 1 < m_solids.size() ? m_solids[i + 1].first_corner : m_corners.size();
            if (begin == end)
                continue;
            const TextFacets facets({m_corners.data() + begin, end - begin});
            SourceMesh piece;
            piece.name = KM_wString::FromUtf8(m_solids[i].name);
            piece.origin = m_origin;
            piece.mesh = StlMesh(facets, (end - begin) / 3).make();
            const std::size_t unusable = dropUnusableTriangles(*piece.mesh);
            if (unusable > 0)
                dropUnusedVertices(*piece.mesh);
            dropped += unusable;
            m_scene.places.push_back({{}, m_scene.meshes.size(), {}});
            m_scene.meshes.push_back(std::move(piece));
        }
        if (dropped > 0)
            m_scene.warnings.push_back(leftOutText(dropped, m_corners.size() / 3, "triangles"));
    }

    const ModelReading& m_reading;
    std::string_view m_file;
    std::vector<std::string_view> m_texts; ///< the parts of the file
    std::vector<StlPart> m_parts;          ///< what they hold
    KM_3dPoint m_origin;
    std::string m_why;
    std::vector<KM_3fPoint> m_corners; ///< of all parts
    std::vector<Solid> m_solids;       ///< the first has what stands before any begins
    SourceScene m_scene;
};

} // namespace

Result<SourceScene> readTextStl(const ModelReading& reading) {
    return TextReading(reading).read();
}

} // namespace quarn
