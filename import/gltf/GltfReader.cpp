#include "import/gltf/GltfReader.h"

#include "import/assembly/RoundingTold.h"
#include "import/files/ModelFileCheck.h"
#include "import/gltf/GltfContainer.h"
#include "import/gltf/GltfExtensions.h"
#include "import/gltf/GltfMeshes.h"
#include "import/gltf/GltfPoses.h"
#include "import/gltf/GltfViews.h"
#include "import/library/LibraryReader.h"

#include <tuple>
#include <utility>

namespace quarn {

namespace gltf {

namespace {

/// A place in the scene, in the document and in what draws it.
constexpr std::uint64_t MEMORY_OF_PLACE = 1024;

class SceneReader {
public:
    SceneReader(const ModelReading& reading, const Json& json, Bytes binary)
        : m_reading(reading), m_json(json), m_buffers(reading, json, binary, m_result.warnings),
          m_accessors(reading, json, m_buffers),
          m_materials(reading, json, m_buffers, m_result.warnings), m_source{reading, m_buffers,
                                                                             m_accessors,
                                                                             m_result.warnings},
          m_meshes(m_source, m_materials) {}

    Result<SourceScene> read() {
        Result<Nodes> nodes = followNodes(m_reading, m_json, m_result.warnings);
        if (!nodes)
            return nodes.error();
        m_nodes = std::move(nodes.value());
        for (std::size_t i = 0; i < m_nodes.shown.size(); ++i) {
            m_share = static_cast<double>(i) / static_cast<double>(m_nodes.shown.size());
            if (const Result<void> done = readNode(m_nodes.shown[i]); !done)
                return done.error();
        }
        m_meshes.tellLosses();
        m_materials.tellLosses();
        if (const std::string passed_over = passedOverText(m_json); !passed_over.empty())
            m_result.warnings.push_back(passed_over);
        normalizeIntensities(m_result.lights);
        if (const std::string rounded = roundingText(m_result); !rounded.empty())
            m_result.warnings.push_back(rounded);
        m_result.units = UnitSystem::meters;
        const bool is_asked = m_reading.up != UpAxis::by_format;
        m_result.up.axis = is_asked ? m_reading.up : UpAxis::y;
        m_result.up.reason = is_asked ? TakenUpAxis::Reason::asked : TakenUpAxis::Reason::format;
        return std::move(m_result);
    }

private:
    using Pieces = std::vector<std::size_t>; ///< of the scene

    Result<void> readNode(std::uint64_t index) {
        const Json& node = element(member(m_json, "nodes"), index);
        const KM_Xform& world_from_node = m_nodes.world_from_node[index];
        if (auto camera = cameraOf(m_json, node, world_from_node)) {
            const std::wstring number = std::to_wstring(m_result.cameras.size() + 1);
            if (camera->name.IsEmpty())
                camera->name = KM_wString(L"Camera " + number);
            m_result.cameras.push_back(std::move(*camera));
        }
        if (auto light = lightOf(m_json, node, world_from_node))
            m_result.lights.push_back(std::move(*light));
        const auto mesh = wholeNumber(member(node, "mesh"));
        if (!mesh)
            return {};
        const Result<Pieces> pieces = piecesOf(index, node, *mesh);
        if (!pieces)
            return pieces.error();
        return pieces.value().empty() ? Result<void>()
                                      : place(node, world_from_node, pieces.value());
    }

    PoseSource poses() { return {m_reading, m_json, m_nodes, m_accessors}; }

    Result<void> place(const Json& node, const KM_Xform& world_from_node, const Pieces& pieces) {
        const Result<std::vector<KM_Xform>> instances =
            instancesAt(poses(), node, MEMORY_OF_PLACE * pieces.size());
        if (!instances)
            return instances.error();
        const KM_wString name = KM_wString::FromUtf8(text(member(node, "name")));
        // A skin's joints place its mesh, whatever its node does.
        const bool has_skin = wholeNumber(member(node, "skin")).has_value();
        const KM_Xform world = has_skin ? KM_Xform::Identity() : world_from_node;
        for (const KM_Xform& node_from_instance : instances.value())
            for (const std::size_t piece : pieces)
                m_result.places.push_back({name, piece, world * node_from_instance});
        return {};
    }

    /// The pieces of a mesh, which nodes share unless they bend them each in their own way.
    Result<Pieces> piecesOf(std::uint64_t node_index, const Json& node, std::uint64_t index) {
        const bool has_weights = !member(node, "weights").is_null();
        const auto key = std::tuple(index, wholeNumber(member(node, "skin")),
                                    has_weights ? std::optional(node_index) : std::nullopt);
        const auto found = m_pieces.find(key);
        if (found != m_pieces.end())
            return found->second;
        const Json& mesh = element(member(m_json, "meshes"), index);
        if (mesh.is_null())
            return damaged(m_reading, "node " + std::to_string(node_index) + " names mesh " +
                                          std::to_string(index) + ", which is not there");
        const Result<Pose> pose = poseAt(poses(), node, mesh);
        if (!pose)
            return pose.error();
        Result<Pieces> pieces = readMesh(mesh, index, pose.value());
        if (pieces)
            m_pieces.emplace(key, pieces.value());
        return pieces;
    }

    Result<Pieces> readMesh(const Json& mesh, std::uint64_t index, const Pose& pose) {
        const std::span<const Json> primitives = elements(member(mesh, "primitives"));
        const std::string given = text(member(mesh, "name"));
        const std::string own = given.empty() ? "meshes[" + std::to_string(index) + "]" : given;
        Pieces pieces;
        for (std::size_t i = 0; i < primitives.size(); ++i) {
            if (!m_reading.watch.goesOn(ReadingStep::read, m_share))
                return cannotReadModel(m_reading.path, "it was given up", "Open it again.");
            const std::string suffix = primitives.size() > 1 ? "-" + std::to_string(i) : "";
            Result<SourceMesh> piece = m_meshes.read(primitives[i], own + suffix, pose);
            if (!piece)
                return piece.error();
            if (!given.empty())
                piece.value().name = KM_wString::FromUtf8(given + suffix);
            pieces.push_back(m_result.meshes.size());
            m_result.meshes.push_back(std::move(piece.value()));
        }
        return pieces;
    }

    using Key = std::tuple<std::uint64_t, std::optional<std::uint64_t>,
                           std::optional<std::uint64_t>>; ///< mesh, skin, node with own weights

    const ModelReading& m_reading;
    const Json& m_json;
    SourceScene m_result;
    Buffers m_buffers;
    Accessors m_accessors;
    Materials m_materials;
    PrimitiveSource m_source;
    Meshes m_meshes;
    Nodes m_nodes;
    std::map<Key, Pieces> m_pieces;
    double m_share = 0.0; ///< of the nodes that are read
};

bool isOld(const Json& json) {
    const std::string version = text(member(member(json, "asset"), "version"));
    return version.starts_with("1") || (version.empty() && member(json, "meshes").is_object());
}

Result<SourceScene> readParts(const ModelReading& reading, const Container& parts) {
    const std::uint64_t memory = memoryOfJson(parts.text);
    if (const Result<void> taken = takeMemory(reading, memory, 1, "descriptions"); !taken)
        return taken.error();
    const Result<Json> json = parseJson(parts.text);
    if (!json)
        return damaged(reading, json.message());
    if (isOld(json.value()))
        return readWithLibrary(reading);
    if (!json.value().is_object())
        return damaged(reading, "its text is no description of a model");
    const std::string unknown = unknownExtension(json.value());
    if (!unknown.empty())
        return cannotReadModel(
            reading.path, "it needs the glTF extension '" + unknown + "', which is not known here",
            "Ask whoever passed it on for the model without that extension, or "
            "in another format.");
    Result<SourceScene> scene = SceneReader(reading, json.value(), parts.binary).read();
    reading.budget.giveBack(memory);
    return scene;
}

} // namespace

} // namespace gltf

Result<SourceScene> readGltf(const ModelReading& reading) {
    const Result<gltf::Container> parts = gltf::takeApart(reading);
    if (!parts)
        return gltf::damaged(reading, parts.message());
    return parts.value().is_old_glb ? readWithLibrary(reading)
                                    : gltf::readParts(reading, parts.value());
}

} // namespace quarn
