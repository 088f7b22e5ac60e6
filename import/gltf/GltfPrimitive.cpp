#include "import/gltf/GltfPrimitive.h"

#include "import/gltf/DracoDecoding.h"
#include "import/gltf/GltfContainer.h"

#include <utility>

namespace quarn::gltf {

namespace {

/// More sets of four joints than any file has.
constexpr int MOST_INFLUENCES = 8;

class PrimitiveFinder {
public:
    PrimitiveFinder(const PrimitiveSource& source, const Json& json)
        : m_source(source), m_json(json) {}

    Result<Primitive> find(std::uint64_t coordinate_set) {
        const std::uint64_t mode = wholeNumber(member(m_json, "mode")).value_or(4);
        if (mode > 6)
            return damaged(m_source.reading,
                           "one of its meshes is made in the unknown mode " + std::to_string(mode));
        m_found.mode = static_cast<PrimitiveMode>(mode);
        if (const Result<void> done = decompress(); !done)
            return done.error();
        const std::string texture = "TEXCOORD_" + std::to_string(coordinate_set);
        std::optional<Accessor> positions;
        for (const Result<void>& found :
             {attribute("POSITION", 3, positions), attribute("NORMAL", 3, m_found.normals),
              attribute(texture.c_str(), 2, m_found.texture_coordinates),
              attribute("COLOR_0", 3, m_found.colors), findInfluences(), findTargets(),
              findIndices()})
            if (!found)
                return found.error();
        m_found.positions = std::move(*positions);
        if (const Result<void> alike = checkCounts(); !alike)
            return alike.error();
        return std::move(m_found);
    }

private:
    const Json& statedAttribute(const char* name) const {
        return member(member(m_json, "attributes"), name);
    }

    Result<void> attribute(const char* name, unsigned components, std::optional<Accessor>& found) {
        const auto decoded = m_draco.attributes.find(name);
        if (decoded != m_draco.attributes.end()) {
            found = decoded->second;
            return found->components >= components
                       ? Result<void>()
                       : damaged(m_source.reading, "its compressed part has too few numbers");
        }
        return accessor(statedAttribute(name), components, found);
    }

    Result<void> accessor(const Json& which, unsigned components, std::optional<Accessor>& found) {
        if (which.is_null())
            return {};
        Result<Accessor> read = m_source.accessors.at(which, components);
        if (!read)
            return read.error();
        found = std::move(read.value());
        return {};
    }

    Result<void> decompress() {
        const Json& compressed = extension(m_json, "KHR_draco_mesh_compression");
        if (compressed.is_null())
            return {};
        const Result<DracoLimits> limits = claimed();
        if (!limits)
            return limits.error();
        const Result<Bytes> bytes = m_source.buffers.view(
            wholeNumber(member(compressed, "bufferView")).value_or(UINT64_MAX));
        if (!bytes)
            return bytes.error();
        std::map<std::string, std::uint32_t> ids;
        const Json& attributes = member(compressed, "attributes");
        for (auto at = attributes.begin(); attributes.is_object() && at != attributes.end(); ++at)
            if (const auto id = wholeNumber(at.value()); id && *id <= UINT32_MAX)
                ids.emplace(at.key(), static_cast<std::uint32_t>(*id));
        Result<DracoMesh> mesh = decodeDraco(bytes.value(), ids, limits.value());
        if (!mesh)
            return damaged(m_source.reading,
                           "the compressed bytes of one of its meshes cannot be read: " +
                               mesh.message());
        m_draco = std::move(mesh.value());
        restoreNormalized();
        return {};
    }

    /// The memory that a compressed mesh may take is that of what its accessors claim.
    Result<DracoLimits> claimed() {
        constexpr std::uint64_t MEMORY_OF_VERTEX = 128;
        constexpr std::uint64_t MEMORY_OF_INDEX = 64;
        const Result<Accessor> positions =
            m_source.accessors.described(statedAttribute("POSITION"));
        const Result<Accessor> indices = m_source.accessors.described(member(m_json, "indices"));
        if (!positions || !indices)
            return positions ? indices.error() : positions.error();
        const DracoLimits limits{positions.value().count, indices.value().count};
        for (const Result<void>& taken :
             {takeMemory(m_source.reading, limits.vertices, MEMORY_OF_VERTEX, "compressed meshes"),
              takeMemory(m_source.reading, limits.indices, MEMORY_OF_INDEX, "compressed meshes")})
            if (!taken)
                return taken.error();
        return limits;
    }

    /// Whether integers are shares of one is said outside of the compressed bytes.
    void restoreNormalized() {
        for (auto& [name, decoded] : m_draco.attributes) {
            const Result<Accessor> stated =
                m_source.accessors.described(statedAttribute(name.c_str()));
            decoded.is_normalized = stated ? stated.value().is_normalized : decoded.is_normalized;
        }
    }

    Result<void> findIndices() {
        if (!m_draco.indices.bytes.empty()) {
            m_found.indices = m_draco.indices;
            m_found.mode = PrimitiveMode::triangles;
            return {};
        }
        return accessor(member(m_json, "indices"), 1, m_found.indices);
    }

    Result<void> findInfluences() {
        for (int set = 0; set < MOST_INFLUENCES; ++set) {
            std::optional<Accessor> joints;
            std::optional<Accessor> weights;
            const std::string number = std::to_string(set);
            for (const Result<void>& found : {attribute(("JOINTS_" + number).c_str(), 4, joints),
                                              attribute(("WEIGHTS_" + number).c_str(), 4, weights)})
                if (!found)
                    return found.error();
            if (!joints || !weights)
                break;
            m_found.influences.push_back({std::move(*joints), std::move(*weights)});
        }
        return {};
    }

    Result<void> findTargets() {
        for (const Json& target : elements(member(m_json, "targets"))) {
            MorphTarget& found = m_found.targets.emplace_back();
            for (const Result<void>& read :
                 {accessor(member(target, "POSITION"), 3, found.positions),
                  accessor(member(target, "NORMAL"), 3, found.normals)})
                if (!read)
                    return read.error();
        }
        return {};
    }

    bool fits(const std::optional<Accessor>& accessor) const {
        return !accessor || accessor->count == m_found.positions.count;
    }

    /// The shape does not depend on them.
    void dropUnfit(std::optional<Accessor>& accessor, const char* what) {
        if (fits(accessor))
            return;
        m_source.warnings.push_back(std::string("The ") + what +
                                    " of a mesh were left out: " + accessor->name + " has " +
                                    std::to_string(accessor->count) + " of them for " +
                                    std::to_string(m_found.positions.count) + " vertices.");
        accessor.reset();
    }

    Result<void> checkCounts() {
        dropUnfit(m_found.normals, "normals");
        dropUnfit(m_found.texture_coordinates, "texture coordinates");
        dropUnfit(m_found.colors, "colours");
        bool are_fit = true;
        for (const MorphTarget& target : m_found.targets)
            are_fit = are_fit && fits(target.positions) && fits(target.normals);
        for (const Influences& set : m_found.influences)
            are_fit = are_fit && fits(set.joints) && fits(set.weights);
        return are_fit ? Result<void>()
                       : damaged(m_source.reading, "what moves the vertices of " +
                                                       m_found.positions.name +
                                                       " has another count than they");
    }

    const PrimitiveSource& m_source;
    const Json& m_json;
    Primitive m_found;
    DracoMesh m_draco;
};

} // namespace

bool hasPositions(const Json& primitive) {
    return !member(member(primitive, "attributes"), "POSITION").is_null();
}

Result<Primitive> findPrimitive(const PrimitiveSource& source, const Json& primitive,
                                std::uint64_t coordinate_set) {
    return PrimitiveFinder(source, primitive).find(coordinate_set);
}

} // namespace quarn::gltf
