#pragma once

#include "engine/scene/Material.h"
#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Color.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_Xform.h"

#include <cstdint>
#include <memory>
#include <vector>

namespace quarn {

/// A mesh object as the display pipeline sees it. The mesh is shared with the document, never
/// copied; it must not change while a scene holds it.
struct SceneMesh {
    KM_UUID id;
    std::shared_ptr<const KM_Mesh> mesh;
    std::shared_ptr<const Material> material; ///< null: the default material
    bool visible = true;
    KM_Xform world_from_mesh; ///< affine; objects may share a mesh
};

/// A curve object, already flattened to a polyline in world coordinates.
struct SceneCurve {
    KM_UUID id;
    KM_3dPointArray polyline;
    KM_Color color{0, 0, 0, 255};
    bool visible = true;
};

/// A point object in world coordinates.
struct ScenePoint {
    KM_UUID id;
    KM_3dPoint location;
    KM_Color color{0, 0, 0, 255};
    bool visible = true;
};

/// All that a document shows. `revision` changes whenever anything but visibility or lights does:
/// a scene is rebuilt only then.
struct SceneContent {
    std::uint64_t revision = 0;
    std::vector<SceneMesh> meshes;
    std::vector<SceneCurve> curves;
    std::vector<ScenePoint> points;
    std::vector<KM_Light> lights; ///< the lights that are on; directional ones cast sun shadows
};

} // namespace quarn
