#include "tests/engine/display/LookScenes.h"

#include "engine/images/ImageFile.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

namespace quarn {

std::size_t addLook(SceneContent& content, KM_Mesh mesh,
                    const std::function<void(Material&)>& change) {
    auto material = std::make_shared<Material>();
    change(*material);
    const std::size_t index = addMesh(content, std::move(mesh));
    content.meshes[index].placed.material = material;
    return index;
}

KM_Mesh wallMesh(float x0, float x1, float y, float height) {
    KM_Mesh mesh;
    mesh.m_V = {{x0, y, 0.0F}, {x1, y, 0.0F}, {x1, y, height}, {x0, y, height}};
    mesh.m_T = {{0.0F, 0.0F}, {1.0F, 0.0F}, {1.0F, 1.0F}, {0.0F, 1.0F}};
    mesh.m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
    return mesh;
}

std::shared_ptr<const Texture>
textureOf(int width, int height,
          const std::function<std::array<std::uint8_t, 4>(int, int)>& texel) {
    auto texture = std::make_shared<Texture>();
    texture->width = width;
    texture->height = height;
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x)
            for (const std::uint8_t value : texel(x, y))
                texture->rgba.push_back(value);
    return texture;
}

void show(const Image& image, const char* name) {
    const char* const folder = std::getenv("QUARN_PICTURES");
    if (!folder)
        return;
    const auto path = std::filesystem::path(folder) / (std::string(name) + ".png");
    EXPECT_TRUE(writeImageFile(path, image, {}).ok()) << path;
}

} // namespace quarn
