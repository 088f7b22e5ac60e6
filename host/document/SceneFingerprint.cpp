#include "host/document/SceneFingerprint.h"

#include "engine/scene/MaterialFields.h"
#include "engine/scene/SceneContent.h"
#include "ground/Checksum.h"

#include <map>

namespace quarn {

namespace {

template <class Value> void addAll(const std::vector<Value>& values, Checksum& sum) {
    sum.add(std::uint64_t{values.size()});
    sum.addBytes(std::as_bytes(std::span(values)));
}

void add(const KM_Color& color, Checksum& sum) {
    sum.addBytes(std::as_bytes(std::span(&color, 1)));
}

void add(const KM_3dPoint& point, Checksum& sum) {
    for (const double coordinate : {point.x, point.y, point.z})
        sum.add(coordinate);
}

void add(const KM_Xform& xform, Checksum& sum) {
    for (const auto& row : xform.m_xform)
        for (const double number : row)
            sum.add(number);
}

void add(const KM_Mesh& mesh, Checksum& sum) {
    addAll(mesh.m_V, sum);
    addAll(mesh.m_N, sum);
    addAll(mesh.m_T, sum);
    addAll(mesh.m_C, sum);
    addAll(mesh.m_F, sum);
}

void add(const Texture& texture, Checksum& sum) {
    sum.add(texture.width);
    sum.add(texture.height);
    addAll(texture.rgba, sum);
    sum.add(texture.wrap_u);
    sum.add(texture.wrap_v);
}

/// Objects share meshes and textures: each is gone through once.
class SharedParts {
public:
    template <class Part> std::uint64_t fingerprintOf(const std::shared_ptr<const Part>& part) {
        if (!part)
            return 0;
        const auto [known, is_new] = m_known.try_emplace(part.get(), 0);
        if (is_new) {
            Checksum sum;
            add(*part, sum);
            known->second = sum.value();
        }
        return known->second;
    }

private:
    std::map<const void*, std::uint64_t> m_known;
};

/// Goes through the qualities of a material.
class QualitySum {
public:
    QualitySum(SharedParts& parts, Checksum& sum) : m_parts(parts), m_sum(sum) {}

    bool operator()(const char*, const auto& quality) {
        add(quality);
        return true;
    }

private:
    void add(float number) { m_sum.add(number); }
    void add(bool flag) { m_sum.add(flag); }
    void add(const LinearRgb& numbers) { m_sum.addBytes(std::as_bytes(std::span(numbers))); }
    void add(const TextureUse& use) {
        m_sum.add(m_parts.fingerprintOf(use.texture));
        add(use.u);
        add(use.v);
    }

    SharedParts& m_parts;
    Checksum& m_sum;
};

void add(const Material& material, SharedParts& parts, Checksum& sum) {
    add(material.base_color, sum);
    sum.add(parts.fingerprintOf(material.base_color_texture));
    sum.add(material.alpha_cutout);
    sum.add(material.alpha_cutoff);
    sum.add(material.see_through);
    qualityFields(QualitySum(parts, sum), material);
}

void add(const SceneMesh& mesh, SharedParts& parts, Checksum& sum) {
    sum.add(mesh.visible);
    sum.add(parts.fingerprintOf(mesh.placed.mesh));
    add(mesh.placed.material ? *mesh.placed.material : Material{}, parts, sum);
    add(mesh.placed.world_from_mesh, sum);
}

void add(const SceneCurve& curve, Checksum& sum) {
    sum.add(curve.visible);
    add(curve.color, sum);
    sum.add(curve.polyline.Count());
    for (int i = 0; i < curve.polyline.Count(); ++i)
        add(curve.polyline[i], sum);
}

void add(const ScenePoint& point, Checksum& sum) {
    sum.add(point.visible);
    add(point.color, sum);
    add(point.location, sum);
}

void add(const KM_Light& light, Checksum& sum) {
    sum.add(light.IsEnabled());
    sum.add(light.Style());
    add(light.Location(), sum);
    add(KM_3dPoint(light.Direction()), sum);
    sum.add(light.Intensity());
    sum.add(light.ShadowIntensity());
    add(light.Diffuse(), sum);
}

} // namespace

void addLight(const LightSettings& light, Checksum& sum) {
    sum.add(light.surroundings);
    if (light.picture) {
        sum.add(light.picture->width);
        sum.add(light.picture->height);
        addAll(light.picture->rgb, sum);
    }
    sum.add(light.exposure.has_value());
    sum.add(light.exposure.value_or(0.0));
    sum.add(light.background);
    add(light.background_color, sum);
    sum.add(light.has_ground);
    sum.add(light.metres_per_unit);
}

void addScene(const SceneContent& content, Checksum& sum) {
    SharedParts parts;
    sum.add(std::uint64_t{content.meshes.size()});
    for (const SceneMesh& mesh : content.meshes)
        add(mesh, parts, sum);
    sum.add(std::uint64_t{content.curves.size()});
    for (const SceneCurve& curve : content.curves)
        add(curve, sum);
    sum.add(std::uint64_t{content.points.size()});
    for (const ScenePoint& point : content.points)
        add(point, sum);
    sum.add(std::uint64_t{content.lights.size()});
    for (const KM_Light& light : content.lights)
        add(light, sum);
}

} // namespace quarn
