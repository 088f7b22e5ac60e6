#include "import/gltf/GltfNodes.h"

#include "import/gltf/GltfContainer.h"

#include <cmath>

namespace quarn::gltf {

namespace {

KM_Xform matrixOf(const Json& list) {
    double numbers[16] = {1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1}; // columns
    readNumbers(list, numbers);
    KM_Xform xform;
    for (int row = 0; row < 3; ++row) // the last is that of an affine matrix, whatever it says
        for (int column = 0; column < 4; ++column)
            xform.m_xform[row][column] = numbers[4 * column + row];
    return xform;
}

KM_Xform placeOf(const Json& node) {
    const Json& matrix = member(node, "matrix");
    if (!matrix.is_null())
        return matrixOf(matrix);
    double move[3] = {0, 0, 0};
    double turn[4] = {0, 0, 0, 1};
    double scale[3] = {1, 1, 1};
    readNumbers(member(node, "translation"), move);
    readNumbers(member(node, "rotation"), turn);
    readNumbers(member(node, "scale"), scale);
    return KM_Xform::Translation(move[0], move[1], move[2]) * rotation(turn) *
           KM_Xform::Diagonal(scale[0], scale[1], scale[2]);
}

/// Where positions are far from the origin, files state them from a place of their own.
KM_Xform worldFromScene(const Json& json) {
    double center[3] = {0, 0, 0};
    readNumbers(member(extension(json, "CESIUM_RTC"), "center"), center);
    return KM_Xform::Translation(center[0], center[1], center[2]);
}

std::string timesMore(std::uint64_t count) {
    return count == 1 ? "once more" : std::to_string(count) + " times more";
}

class NodeWalk {
public:
    NodeWalk(const ModelReading& reading, const Json& json)
        : m_reading(reading), m_json(json), m_nodes(elements(member(json, "nodes"))),
          m_world_from_scene(worldFromScene(json)), m_is_reached(m_nodes.size(), false) {
        m_result.world_from_node.resize(m_nodes.size());
    }

    Result<Nodes> walk() {
        const std::vector<bool> has_parent = findParents();
        const Json* const scene = shownScene();
        if (scene != nullptr)
            for (const Json& root : elements(member(*scene, "nodes")))
                if (const Result<void> done = followFrom(wholeNumber(root), true); !done)
                    return done.error();
        // Those of no scene may be joints of it.
        for (std::uint64_t i = 0; i < m_nodes.size(); ++i)
            if (!has_parent[i] && !m_is_reached[i])
                if (const Result<void> done = followFrom(i, scene == nullptr); !done)
                    return done.error();
        return std::move(m_result);
    }

    std::uint64_t reachedAgain() const { return m_reached_again; }

private:
    struct Open {
        std::uint64_t node;
        KM_Xform world_from_parent;
    };

    std::vector<bool> findParents() const {
        std::vector<bool> has_parent(m_nodes.size(), false);
        for (const Json& node : m_nodes)
            for (const Json& child : elements(member(node, "children")))
                if (const auto index = wholeNumber(child); index && *index < m_nodes.size())
                    has_parent[*index] = true;
        return has_parent;
    }

    /// Null where the file has none.
    const Json* shownScene() const {
        const std::span<const Json> scenes = elements(member(m_json, "scenes"));
        const std::uint64_t named = wholeNumber(member(m_json, "scene")).value_or(0);
        if (scenes.empty())
            return nullptr;
        return named < scenes.size() ? &scenes[named] : &scenes.front();
    }

    Result<void> followFrom(std::optional<std::uint64_t> root, bool is_shown) {
        m_open.clear();
        if (const Result<void> pushed = push(root, m_world_from_scene); !pushed)
            return pushed;
        while (!m_open.empty()) {
            const Open open = m_open.back();
            m_open.pop_back();
            if (m_is_reached[open.node]) {
                ++m_reached_again;
                continue;
            }
            m_is_reached[open.node] = true;
            const KM_Xform world = open.world_from_parent * placeOf(m_nodes[open.node]);
            m_result.world_from_node[open.node] = world;
            if (is_shown)
                m_result.shown.push_back(open.node);
            const std::span<const Json> children = elements(member(m_nodes[open.node], "children"));
            for (std::size_t i = children.size(); i-- > 0;)
                if (const Result<void> pushed = push(wholeNumber(children[i]), world); !pushed)
                    return pushed;
        }
        return {};
    }

    Result<void> push(std::optional<std::uint64_t> node, const KM_Xform& world_from_parent) {
        if (!node || *node >= m_nodes.size())
            return damaged(m_reading, "its scene names node " +
                                          (node ? std::to_string(*node) : "without a number") +
                                          ", which is not there: there are " +
                                          std::to_string(m_nodes.size()) + " nodes");
        m_open.push_back({*node, world_from_parent});
        return {};
    }

    const ModelReading& m_reading;
    const Json& m_json;
    std::span<const Json> m_nodes;
    KM_Xform m_world_from_scene;
    std::vector<bool> m_is_reached;
    std::vector<Open> m_open;
    std::uint64_t m_reached_again = 0;
    Nodes m_result;
};

} // namespace

Result<Nodes> followNodes(const ModelReading& reading, const Json& json,
                          std::vector<std::string>& warnings) {
    NodeWalk walk(reading, json);
    Result<Nodes> nodes = walk.walk();
    if (walk.reachedAgain() > 0)
        warnings.push_back("Nodes of its scene that belong to several others, or to themselves, "
                           "are shown once: the file has them " +
                           timesMore(walk.reachedAgain()) + ".");
    return nodes;
}

KM_Xform rotation(const double (&xyzw)[4]) {
    const double length = std::hypot(std::hypot(xyzw[0], xyzw[1], xyzw[2]), xyzw[3]);
    if (!(length > 0.0) || !std::isfinite(length))
        return {};
    const double x = xyzw[0] / length;
    const double y = xyzw[1] / length;
    const double z = xyzw[2] / length;
    const double w = xyzw[3] / length;
    const double rows[3][3] = {
        {1.0 - 2.0 * (y * y + z * z), 2.0 * (x * y - z * w), 2.0 * (x * z + y * w)},
        {2.0 * (x * y + z * w), 1.0 - 2.0 * (x * x + z * z), 2.0 * (y * z - x * w)},
        {2.0 * (x * z - y * w), 2.0 * (y * z + x * w), 1.0 - 2.0 * (x * x + y * y)}};
    KM_Xform xform;
    for (int i = 0; i < 3; ++i)
        for (int j = 0; j < 3; ++j)
            xform.m_xform[i][j] = rows[i][j];
    return xform;
}

} // namespace quarn::gltf
