#include "tests/engine/display/LookScenes.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>

namespace quarn {
namespace {

constexpr int size = 64;

using Change = std::function<void(Material&)>;

/// One quality of a material, and the others that it needs to be seen.
struct Quality {
    const char* name;
    Change others;
    Change change;
};

/// For test output.
void PrintTo(const Quality& quality, std::ostream* out) {
    *out << quality.name;
}

/// A rectangle whose normals spread like those of a pillow, so that it mirrors many directions.
KM_Mesh pillow(float x0, float x1) {
    KM_Mesh mesh = wallMesh(x0, x1, 0, 8);
    for (const KM_2fPoint& t : mesh.m_T)
        mesh.m_N.emplace_back(KM_3dVector(t.x - 0.5, -1.0, t.y - 0.5 > 0.0 ? 0.6 : -0.4));
    return mesh;
}

/// On the left a pillow of the material, on the right a grey one, before a checkered wall.
Image pictureOf(const Quality& quality, bool is_changed) {
    SceneContent content;
    addLook(content, pillow(-6, 0), [&](Material& material) {
        material.base_color = {190, 120, 70, 255};
        quality.others(material);
        if (is_changed)
            quality.change(material);
    });
    addLook(content, pillow(0, 6), [](Material& material) {
        material.base_color = {128, 128, 128, 255};
    });
    addLook(content, wallMesh(-7, 7, 3, 9), [](Material& material) {
        material.base_color_texture = textureOf(32, 32, [](int x, int y) {
            const std::uint8_t value = (x + y) % 2 == 0 ? 220 : 30;
            return std::array<std::uint8_t, 4>{value, value, 200, 255};
        });
    });
    content.lights.push_back(sunLight({0.3, 1.0, -0.5}));
    KM_Viewport view = perspectiveView({0.0, -30.0, 4.0}, {0.0, 0.0, 4.0});
    view.SetProjection(KM_parallel_view);
    view.SetFrustum(-3.2, 3.2, -3.2, 3.2, 1.0, 100.0);
    return drawn(content, view, modeNamed(L"Rendered"), size, size);
}

/// How many pixels of the columns differ visibly, or at all.
int differing(const Image& a, const Image& b, int first_column, int end_column, int least) {
    int count = 0;
    for (int y = 0; y < size; ++y)
        for (int x = first_column; x < end_column; ++x) {
            int step = 0;
            for (std::size_t c = 0; c < 4; ++c)
                step = std::max(step, std::abs(a.pixel(x, y)[c] - b.pixel(x, y)[c]));
            count += step >= least ? 1 : 0;
        }
    return count;
}

TextureUse stripes(const std::array<std::uint8_t, 4>& even,
                   const std::array<std::uint8_t, 4>& odd) {
    TextureUse use;
    use.texture = textureOf(8, 1, [&](int x, int) { return x % 2 == 0 ? even : odd; });
    return use;
}

TextureUse greyStripes() {
    return stripes({255, 255, 255, 255}, {40, 40, 40, 40});
}

TextureUse tiltedNormals() {
    return stripes({190, 128, 238, 255}, {60, 128, 238, 255});
}

void nothing(Material&) {}

void plastic(Material& material) {
    material.roughness = 0.2F;
}

void metal(Material& material) {
    material.metalness = 1.0F;
    material.roughness = 0.3F;
}

void coated(Material& material) {
    material.clearcoat = 1.0F;
    material.clearcoat_roughness = 0.1F;
}

void glass(Material& material) {
    material.base_color = {255, 255, 255, 255};
    material.roughness = 0.0F;
    material.transmission = 1.0F;
}

void tintedGlass(Material& material) {
    glass(material);
    material.thickness = 1.0F;
    material.attenuation_distance = 1.0F;
    material.attenuation_color = {0.4F, 0.8F, 0.9F};
}

void halfClear(Material& material) {
    material.base_color.a = 120;
}

std::vector<Quality> drawnQualities() {
    return {
        {"base_color", nothing,
         [](Material& m) {
             m.base_color = {60, 120, 200, 255};
         }},
        {"base_color_texture", nothing,
         [](Material& m) { m.base_color_texture = greyStripes().texture; }},
        {"alpha_cutoff",
         [](Material& m) {
             halfClear(m);
             m.alpha_cutout = true;
             m.alpha_cutoff = 0.1F;
         },
         [](Material& m) { m.alpha_cutoff = 0.8F; }},
        {"see_through", halfClear, [](Material& m) { m.see_through = true; }},
        {"metalness", plastic, [](Material& m) { m.metalness = 1.0F; }},
        {"roughness", metal, [](Material& m) { m.roughness = 0.7F; }},
        {"metal_rough", metal, [](Material& m) { m.metal_rough = greyStripes(); }},
        {"normals", nothing, [](Material& m) { m.normals = tiltedNormals(); }},
        {"normals_transform", [](Material& m) { m.normals = tiltedNormals(); },
         [](Material& m) {
             m.normals.u = {2.0F, 0.0F, 0.0F};
         }},
        {"normal_scale", [](Material& m) { m.normals = tiltedNormals(); },
         [](Material& m) { m.normal_scale = 0.2F; }},
        {"occlusion", nothing, [](Material& m) { m.occlusion = greyStripes(); }},
        {"occlusion_strength", [](Material& m) { m.occlusion = greyStripes(); },
         [](Material& m) { m.occlusion_strength = 0.3F; }},
        {"emission", nothing,
         [](Material& m) {
             m.emission = {0.0F, 0.3F, 0.0F};
         }},
        {"emission_texture",
         [](Material& m) {
             m.emission = {0.0F, 0.3F, 0.0F};
         },
         [](Material& m) { m.emission_texture = greyStripes(); }},
        {"is_unlit", nothing, [](Material& m) { m.is_unlit = true; }},
        {"clearcoat", [](Material& m) { m.clearcoat_roughness = 0.1F; },
         [](Material& m) { m.clearcoat = 1.0F; }},
        {"clearcoat_roughness", coated, [](Material& m) { m.clearcoat_roughness = 0.8F; }},
        {"clearcoat_texture", coated, [](Material& m) { m.clearcoat_texture = greyStripes(); }},
        {"clearcoat_roughness_texture",
         [](Material& m) {
             coated(m);
             m.clearcoat_roughness = 0.9F;
         },
         [](Material& m) { m.clearcoat_roughness_texture = greyStripes(); }},
        {"clearcoat_normals", coated, [](Material& m) { m.clearcoat_normals = tiltedNormals(); }},
        {"transmission", plastic, [](Material& m) { m.transmission = 0.8F; }},
        {"transmission_texture", glass,
         [](Material& m) { m.transmission_texture = greyStripes(); }},
        {"index_of_refraction", plastic, [](Material& m) { m.index_of_refraction = 2.2F; }},
        {"index_of_refraction_of_glass", glass, [](Material& m) { m.index_of_refraction = 2.2F; }},
        {"thickness", tintedGlass, [](Material& m) { m.thickness = 4.0F; }},
        {"thickness_texture", tintedGlass,
         [](Material& m) { m.thickness_texture = greyStripes(); }},
        {"attenuation_distance", tintedGlass, [](Material& m) { m.attenuation_distance = 0.3F; }},
        {"attenuation_color", tintedGlass,
         [](Material& m) {
             m.attenuation_color = {0.9F, 0.2F, 0.3F};
         }},
        {"specular", plastic, [](Material& m) { m.specular = 0.0F; }},
        {"specular_color", plastic,
         [](Material& m) {
             m.specular_color = {0.0F, 1.0F, 3.0F};
         }},
        {"specular_texture", plastic, [](Material& m) { m.specular_texture = greyStripes(); }},
        {"specular_color_texture", plastic,
         [](Material& m) { m.specular_color_texture = greyStripes(); }},
    };
}

/// What is kept and not drawn, or does not count as the material is.
std::vector<Quality> qualitiesThatDoNotShow() {
    return {
        {"sheen_color", nothing,
         [](Material& m) {
             m.sheen_color = {1.0F, 0.5F, 0.2F};
         }},
        {"sheen_roughness", nothing, [](Material& m) { m.sheen_roughness = 0.5F; }},
        {"one_sided_from_its_front", nothing, [](Material& m) { m.is_one_sided = true; }},
        {"alpha_cutoff_of_opaque", nothing, [](Material& m) { m.alpha_cutoff = 0.9F; }},
        {"alpha_of_opaque", nothing, halfClear},
        {"normal_scale_without_map", plastic, [](Material& m) { m.normal_scale = 0.1F; }},
        {"occlusion_strength_without_texture", nothing,
         [](Material& m) { m.occlusion_strength = 0.1F; }},
        {"emission_texture_without_emission", nothing,
         [](Material& m) { m.emission_texture = greyStripes(); }},
        {"clearcoat_roughness_without_coat", plastic,
         [](Material& m) { m.clearcoat_roughness = 0.7F; }},
        {"clearcoat_normals_without_coat", plastic,
         [](Material& m) { m.clearcoat_normals = tiltedNormals(); }},
        {"thickness_of_opaque", plastic, [](Material& m) { m.thickness = 2.0F; }},
        {"attenuation_of_thin_glass", glass,
         [](Material& m) {
             m.attenuation_color = {0.1F, 0.1F, 0.1F};
             m.attenuation_distance = 0.1F;
         }},
        {"specular_of_metal", metal, [](Material& m) { m.specular = 0.0F; }},
        {"index_of_refraction_of_metal", metal, [](Material& m) { m.index_of_refraction = 2.0F; }},
        {"transmission_of_metal", metal, [](Material& m) { m.transmission = 1.0F; }},
        {"emission_of_unlit", [](Material& m) { m.is_unlit = true; },
         [](Material& m) {
             m.emission = {1.0F, 1.0F, 1.0F};
         }},
        {"metalness_of_unlit", [](Material& m) { m.is_unlit = true; }, metal},
    };
}

std::string nameOf(const testing::TestParamInfo<Quality>& info) {
    return info.param.name;
}

class DrawnQuality : public testing::TestWithParam<Quality> {};

TEST_P(DrawnQuality, ChangesThePictureOfItsSurfaceAndNothingElse) {
    const Image before = pictureOf(GetParam(), false);
    const Image after = pictureOf(GetParam(), true);
    EXPECT_GT(differing(before, after, 0, size / 2, 3), size * size / 16);
    EXPECT_EQ(differing(before, after, size / 2, size, 1), 0);
}

INSTANTIATE_TEST_SUITE_P(Material, DrawnQuality, testing::ValuesIn(drawnQualities()), nameOf);

class QualityThatDoesNotShow : public testing::TestWithParam<Quality> {};

TEST_P(QualityThatDoesNotShow, ChangesNothing) {
    EXPECT_EQ(pictureOf(GetParam(), false).rgba, pictureOf(GetParam(), true).rgba);
}

INSTANTIATE_TEST_SUITE_P(Material, QualityThatDoesNotShow,
                         testing::ValuesIn(qualitiesThatDoNotShow()), nameOf);

} // namespace
} // namespace quarn
