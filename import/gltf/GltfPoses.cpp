#include "import/gltf/GltfPoses.h"

#include "import/gltf/GltfContainer.h"

#include <algorithm>
#include <array>
#include <optional>

namespace quarn::gltf {

namespace {

std::vector<double> weightsOf(const Json& node, const Json& mesh) {
    const Json& own = member(node, "weights");
    std::vector<double> weights;
    for (const Json& weight : elements(own.is_null() ? member(mesh, "weights") : own))
        weights.push_back(number(weight, 0.0));
    return weights;
}

KM_Xform matrixAt(const Accessor& accessor, std::uint64_t element) {
    std::array<float, 16> numbers{};
    accessor.read(element, numbers);
    KM_Xform xform;
    for (std::size_t row = 0; row < 3; ++row)
        for (std::size_t column = 0; column < 4; ++column)
            xform.m_xform[row][column] = static_cast<double>(numbers[4 * column + row]);
    return xform;
}

Result<std::vector<KM_Xform>> jointsOf(const PoseSource& source, const Json& skin) {
    const std::span<const Json> joints = elements(member(skin, "joints"));
    const Json& which = member(skin, "inverseBindMatrices");
    std::optional<Accessor> inverse;
    if (!which.is_null()) {
        Result<Accessor> read = source.accessors.at(which, 16);
        if (!read)
            return read.error();
        inverse = std::move(read.value());
    }
    if (inverse && inverse->count < joints.size())
        return damaged(source.reading, inverse->name + " has " + std::to_string(inverse->count) +
                                           " matrices for " + std::to_string(joints.size()) +
                                           " joints");
    std::vector<KM_Xform> world_from_bind;
    for (std::size_t i = 0; i < joints.size(); ++i) {
        const auto node = wholeNumber(joints[i]);
        if (!node || *node >= source.nodes.world_from_node.size())
            return damaged(source.reading,
                           "joint " + std::to_string(i) + " of a skin is a node that is not there");
        const KM_Xform world_from_joint = source.nodes.world_from_node[*node];
        world_from_bind.push_back(inverse ? world_from_joint * matrixAt(*inverse, i)
                                          : world_from_joint);
    }
    return world_from_bind;
}

/// One of the three lists that place copies.
class InstanceList {
public:
    Result<void> find(const PoseSource& source, const Json& which, unsigned components) {
        if (which.is_null())
            return {};
        Result<Accessor> read = source.accessors.at(which, components);
        if (!read)
            return read.error();
        m_accessor = std::move(read.value());
        return {};
    }

    std::uint64_t count() const { return m_accessor ? m_accessor->count : UINT64_MAX; }

    template <std::size_t N> void read(std::uint64_t i, double (&numbers)[N]) const {
        if (!m_accessor)
            return;
        std::array<float, N> single{};
        m_accessor->read(i, single);
        std::ranges::copy(single, numbers);
    }

private:
    std::optional<Accessor> m_accessor;
};

} // namespace

Result<Pose> poseAt(const PoseSource& source, const Json& node, const Json& mesh) {
    Pose pose;
    pose.weights = weightsOf(node, mesh);
    const auto index = wholeNumber(member(node, "skin"));
    if (!index)
        return pose;
    const Json& skin = element(member(source.json, "skins"), *index);
    if (skin.is_null())
        return damaged(source.reading, "there is no skin " + std::to_string(*index));
    Result<std::vector<KM_Xform>> joints = jointsOf(source, skin);
    if (!joints)
        return joints.error();
    pose.joints = std::move(joints.value());
    return pose;
}

Result<std::vector<KM_Xform>> instancesAt(const PoseSource& source, const Json& node,
                                          std::uint64_t most_memory_each) {
    const Json& attributes = member(extension(node, "EXT_mesh_gpu_instancing"), "attributes");
    InstanceList moves;
    InstanceList turns;
    InstanceList scales;
    for (const Result<void>& found : {moves.find(source, member(attributes, "TRANSLATION"), 3),
                                      turns.find(source, member(attributes, "ROTATION"), 4),
                                      scales.find(source, member(attributes, "SCALE"), 3)})
        if (!found)
            return found.error();
    const std::uint64_t stated = std::min({moves.count(), turns.count(), scales.count()});
    const std::uint64_t count = stated == UINT64_MAX && attributes.is_null() ? 1 : stated;
    if (const Result<void> taken =
            takeMemory(source.reading, count, most_memory_each, "repeated objects");
        !taken)
        return taken.error();
    std::vector<KM_Xform> places(count);
    for (std::uint64_t i = 0; i < count; ++i) {
        double move[3] = {0, 0, 0};
        double turn[4] = {0, 0, 0, 1};
        double scale[3] = {1, 1, 1};
        moves.read(i, move);
        turns.read(i, turn);
        scales.read(i, scale);
        places[i] = KM_Xform::Translation(move[0], move[1], move[2]) * rotation(turn) *
                    KM_Xform::Diagonal(scale[0], scale[1], scale[2]);
    }
    return places;
}

} // namespace quarn::gltf
