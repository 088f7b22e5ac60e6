#include "engine/render/EmitterList.h"

#include "engine/display/DisplayScene.h"
#include "engine/display/SurfaceLook.h"
#include "engine/images/ColorSpace.h"
#include "kelmar/KM_Mesh.h"

#include <cmath>

namespace quarn {

namespace {

constexpr float LEAST_BRIGHTNESS = 1e-3F;

float brightnessOfSurface(const RaySurface& surface) {
    if (!surface.look)
        return 0.0F;
    const float(&emission)[3] = surface.look->numbers.emission;
    return brightnessOf({emission[0], emission[1], emission[2]});
}

void set(float (&to)[3], const KM_3dVector& v) {
    to[0] = static_cast<float>(v.x);
    to[1] = static_cast<float>(v.y);
    to[2] = static_cast<float>(v.z);
}

/// @return its area
double makeEmitter(const KM_3dPoint (&corners)[3], Emitter& emitter) {
    const KM_3dVector a = corners[1] - corners[0];
    const KM_3dVector b = corners[2] - corners[0];
    KM_3dVector normal = KM_CrossProduct(a, b);
    const double area = 0.5 * normal.Length();
    if (!normal.Unitize())
        return 0.0;
    set(emitter.corner, corners[0] - KM_3dPoint::Origin);
    set(emitter.edges[0], a);
    set(emitter.edges[1], b);
    set(emitter.normal, normal);
    return area;
}

} // namespace

void EmitterList::addMesh(const DisplayScene& scene, std::size_t index) {
    const DisplayScene::MeshObject& object = scene.meshes()[scene.meshOfSurface(index)];
    const float bright = brightnessOfSurface(scene.rays().surfaces()[index]);
    const KM_Mesh& mesh = object.mesh->mesh();
    for (const KM_MeshTriangle& triangle : mesh.m_F) {
        KM_3dPoint corners[3];
        for (std::size_t i = 0; i < 3; ++i) {
            const KM_3fPoint& vertex = mesh.m_V[triangle.vi[i]];
            corners[i] = object.frame_from_mesh * KM_3dPoint(vertex.x, vertex.y, vertex.z);
        }
        Emitter emitter{};
        const auto power = static_cast<float>(makeEmitter(corners, emitter) * bright);
        if (!(power > 0.0F) || !std::isfinite(power))
            continue;
        emitter.density = bright;
        m_emitters.push_back(emitter);
        m_ends.push_back(power);
    }
}

void EmitterList::find(const DisplayScene& scene) {
    m_emitters.clear();
    m_ends.clear();
    m_density_of_brightness = 0.0F;
    for (std::size_t i = 0; i < scene.rays().surfaces().size(); ++i) {
        const DisplayScene::MeshObject& object = scene.meshes()[scene.meshOfSurface(i)];
        if (object.visible && brightnessOfSurface(scene.rays().surfaces()[i]) > LEAST_BRIGHTNESS)
            addMesh(scene, i);
        if (m_emitters.size() > most_triangles) {
            m_emitters.clear();
            return;
        }
    }
    double sum = 0.0;
    for (const float power : m_ends)
        sum += power;
    double so_far = 0.0;
    for (float& end : m_ends) {
        so_far += end;
        end = static_cast<float>(so_far / sum);
    }
    m_density_of_brightness = sum > 0.0 ? static_cast<float>(1.0 / sum) : 0.0F;
    for (Emitter& emitter : m_emitters)
        emitter.density *= m_density_of_brightness;
}

EmitterTable EmitterList::table() const {
    return {static_cast<int>(m_emitters.size()), m_emitters.data(), m_ends.data(),
            m_density_of_brightness};
}

} // namespace quarn
