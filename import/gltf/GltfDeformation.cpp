#include "import/gltf/GltfDeformation.h"

#include <tbb/parallel_for.h>

#include <array>
#include <atomic>
#include <cmath>

namespace quarn::gltf {

namespace {

constexpr unsigned JOINTS_A_SET = 4;

using Triple = std::array<float, 3>;

KM_3dVector tripleAt(const Accessor& accessor, std::uint64_t vertex) {
    Triple numbers{};
    accessor.read(vertex, numbers);
    return {static_cast<double>(numbers[0]), static_cast<double>(numbers[1]),
            static_cast<double>(numbers[2])};
}

KM_3fVector unitOrZero(const KM_3dVector& v) {
    const double length = std::hypot(v.x, v.y, v.z);
    if (!(length > 0.0) || !std::isfinite(length))
        return {};
    const double factor = 1.0 / length;
    return {static_cast<float>(v.x * factor + 0.0), static_cast<float>(v.y * factor + 0.0),
            static_cast<float>(v.z * factor + 0.0)};
}

/// Normals turn by the cofactors, which a flattening matrix has too.
KM_3dVector turnedNormal(const KM_Xform& xform, const KM_3dVector& n) {
    const auto column = [&](int j) {
        return KM_3dVector(xform.m_xform[0][j], xform.m_xform[1][j], xform.m_xform[2][j]);
    };
    const KM_3dVector x = KM_CrossProduct(column(1), column(2));
    const KM_3dVector turned = x * n.x + KM_CrossProduct(column(2), column(0)) * n.y +
                               KM_CrossProduct(column(0), column(1)) * n.z;
    return column(0) * x < 0.0 ? -turned : turned;
}

} // namespace

Deformation::Deformation(const Primitive& primitive, const Pose& pose)
    : m_primitive(primitive), m_pose(pose),
      m_has_skin(!pose.joints.empty() && !primitive.influences.empty()) {
    for (std::size_t i = 0; i < std::min(primitive.targets.size(), pose.weights.size()); ++i)
        if (pose.weights[i] != 0.0)
            m_targets.push_back({&primitive.targets[i], pose.weights[i]});
}

std::string Deformation::whyBad() const {
    constexpr std::size_t MOST_TARGETS = 1024;
    if (m_targets.size() > MOST_TARGETS)
        return "one of its meshes is a mixture of " + std::to_string(m_targets.size()) + " shapes";
    std::atomic<std::uint64_t> bad = UINT64_MAX;
    const std::uint64_t count = m_has_skin ? m_primitive.positions.count : 0;
    tbb::parallel_for(std::uint64_t{0}, count, [&](std::uint64_t v) {
        for (const Influences& set : m_primitive.influences) {
            std::array<float, JOINTS_A_SET> weights{};
            set.weights.read(v, weights);
            for (unsigned i = 0; i < JOINTS_A_SET; ++i)
                if (weights[i] != 0.0F && set.joints.integer(v, i) >= m_pose.joints.size())
                    bad = v;
        }
    });
    if (bad == UINT64_MAX)
        return {};
    return "vertex " + std::to_string(bad) + " of " + m_primitive.positions.name +
           " follows a joint that is out of range: its skin has " +
           std::to_string(m_pose.joints.size());
}

/// The sum of the joints' matrices, each as much as its weight; the weights become 1 together.
KM_Xform Deformation::blended(std::uint64_t vertex) const {
    KM_Xform sum;
    double total = 0.0;
    for (auto& row : sum.m_xform)
        for (double& number : row)
            number = 0.0;
    for (const Influences& set : m_primitive.influences) {
        std::array<float, JOINTS_A_SET> weights{};
        set.weights.read(vertex, weights);
        for (unsigned i = 0; i < JOINTS_A_SET; ++i) {
            const auto weight = static_cast<double>(weights[i]);
            if (!(weight > 0.0) || !std::isfinite(weight))
                continue;
            total += weight;
            const KM_Xform& joint = m_pose.joints[set.joints.integer(vertex, i)];
            for (int row = 0; row < 3; ++row)
                for (int column = 0; column < 4; ++column)
                    sum.m_xform[row][column] += weight * joint.m_xform[row][column];
        }
    }
    if (!(total > 0.0))
        return m_pose.joints.front();
    for (int row = 0; row < 3; ++row)
        for (double& number : sum.m_xform[row])
            number /= total;
    sum.m_xform[3][3] = 1.0;
    return sum;
}

KM_3fPoint Deformation::place(std::uint64_t vertex) const {
    if (m_targets.empty() && !m_has_skin) {
        Triple p{};
        m_primitive.positions.read(vertex, p);
        return {p[0] + 0.0F, p[1] + 0.0F, p[2] + 0.0F};
    }
    KM_3dVector place = tripleAt(m_primitive.positions, vertex);
    for (const Target& target : m_targets)
        if (target.target->positions)
            place = place + tripleAt(*target.target->positions, vertex) * target.weight;
    KM_3dPoint point(place);
    if (m_has_skin)
        point = blended(vertex) * point;
    return {static_cast<float>(point.x) + 0.0F, static_cast<float>(point.y) + 0.0F,
            static_cast<float>(point.z) + 0.0F};
}

KM_3fVector Deformation::normal(std::uint64_t vertex) const {
    KM_3dVector normal = tripleAt(*m_primitive.normals, vertex);
    for (const Target& target : m_targets)
        if (target.target->normals)
            normal = normal + tripleAt(*target.target->normals, vertex) * target.weight;
    return unitOrZero(m_has_skin ? turnedNormal(blended(vertex), normal) : normal);
}

} // namespace quarn::gltf
