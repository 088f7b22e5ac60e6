#pragma once

#include "import/gltf/GltfPrimitive.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Xform.h"

#include <optional>
#include <vector>

namespace quarn::gltf {

/// How a mesh is bent where it stands.
struct Pose {
    std::vector<double> weights;  ///< of its morph targets; those that are missing are 0
    std::vector<KM_Xform> joints; ///< world from bind pose; none: it has no skin
};

/// Bends the vertices of a primitive. The accessors are read from several threads.
class Deformation {
public:
    /// @param primitive, pose  outlive this object
    Deformation(const Primitive& primitive, const Pose& pose);

    /// Why it cannot be done, a part of a sentence; empty where it can. Looks at every vertex.
    std::string whyBad() const;

    /// @param vertex  less than the count of the positions
    KM_3fPoint place(std::uint64_t vertex) const;
    /// A unit vector, or zero where the primitive's has no direction.
    KM_3fVector normal(std::uint64_t vertex) const;

private:
    struct Target {
        const MorphTarget* target;
        double weight;
    };

    KM_Xform blended(std::uint64_t vertex) const;

    const Primitive& m_primitive;
    const Pose& m_pose;
    std::vector<Target> m_targets; ///< those that count
    bool m_has_skin;
};

} // namespace quarn::gltf
