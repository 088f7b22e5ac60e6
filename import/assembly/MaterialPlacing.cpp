#include "import/assembly/MaterialPlacing.h"

#include "engine/scene/MaterialCheck.h"

#include <cmath>
#include <cstddef>
#include <string>

namespace quarn {

namespace {

using Shared = std::shared_ptr<const Material>;

class Repair {
public:
    Shared of(const Shared& material) {
        const auto [found, is_new] = m_drawable.try_emplace(material, material);
        if (is_new)
            found->second = repaired(material);
        return found->second;
    }

    /// Empty where nothing was changed.
    std::string sentence() const {
        if (m_changed == 0)
            return {};
        const std::string count = std::to_string(m_changed);
        return count + (m_changed > 1 ? " materials have" : " material has") +
               " numbers or textures that cannot be; what is usual stands for them: " + m_first +
               (m_changed > 1 ? " and others." : ".");
    }

private:
    Shared repaired(const Shared& material) {
        auto drawable = std::make_shared<Material>(*material);
        const std::string changed = makeDrawable(*drawable);
        if (changed.empty())
            return material;
        if (m_changed++ == 0)
            m_first = "'" + material->name.ToUtf8() + "' (" + changed + ")";
        return drawable;
    }

    std::map<Shared, Shared> m_drawable;
    std::size_t m_changed = 0;
    std::string m_first;
};

/// How much longer lengths become, whatever their direction.
float growthOf(const KM_Xform& xform) {
    const auto& m = xform.m_xform;
    const double determinant = m[0][0] * (m[1][1] * m[2][2] - m[1][2] * m[2][1]) -
                               m[0][1] * (m[1][0] * m[2][2] - m[1][2] * m[2][0]) +
                               m[0][2] * (m[1][0] * m[2][1] - m[1][1] * m[2][0]);
    return static_cast<float>(std::cbrt(std::abs(determinant)));
}

bool isGrowth(float growth) {
    constexpr float ROUNDING = 1e-5F;
    return std::isnormal(growth) && std::abs(growth - 1.0F) > ROUNDING;
}

} // namespace

void repairMaterials(SourceScene& scene) {
    Repair repair;
    for (SourceMesh& mesh : scene.meshes)
        if (mesh.material)
            mesh.material = repair.of(mesh.material);
    if (std::string sentence = repair.sentence(); !sentence.empty())
        scene.warnings.push_back(std::move(sentence));
}

Shared PlacedMaterials::ofShared(const Shared& material, const KM_Xform& world_from_mesh) {
    const float growth = growthOf(world_from_mesh);
    return isGrowth(growth) ? grown(material, {1.0F, 1.0F / growth}) : material;
}

Shared PlacedMaterials::ofMoved(const Shared& material, const KM_Xform& world_from_mesh) {
    const float growth = growthOf(world_from_mesh);
    return isGrowth(growth) ? grown(material, {growth, 1.0F}) : material;
}

Shared PlacedMaterials::grown(const Shared& material, Growth growth) {
    const bool has_inside = material && material->transmission > 0.0F && material->thickness > 0.0F;
    if (!has_inside)
        return material;
    Shared& placed = m_grown[{material, growth}];
    if (!placed) {
        Material larger = *material;
        larger.thickness *= growth.thickness;
        larger.attenuation_distance *= growth.distance;
        makeDrawable(larger); // lengths may have left what can be told
        placed = std::make_shared<const Material>(std::move(larger));
    }
    return placed;
}

} // namespace quarn
