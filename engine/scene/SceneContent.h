#pragma once

#include "engine/scene/LightSettings.h"
#include "engine/scene/PlacedMesh.h"
#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Color.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Uuid.h"

#include <cstdint>
#include <vector>

namespace quarn {

/// A mesh object as the display pipeline sees it.
struct SceneMesh {
    PlacedMesh placed;
    KM_UUID id;
    bool visible = true;
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

/// All that a document shows. `revision` changes whenever anything but visibility and light does:
/// a scene is rebuilt only then.
struct SceneContent {
    std::uint64_t revision = 0;
    std::vector<SceneMesh> meshes;
    std::vector<SceneCurve> curves;
    std::vector<ScenePoint> points;
    std::vector<KM_Light> lights; ///< the lights that are on; directional ones cast sun shadows
    LightSettings light;          ///< the light beside them
};

} // namespace quarn
