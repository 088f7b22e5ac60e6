#include "tests/engine/display/HostileNumbers.h"

#include "tests/engine/display/DisplayFixture.h"

#include <cmath>
#include <limits>

namespace quarn {

namespace {

std::shared_ptr<const Texture> texture() {
    auto pixels = std::make_shared<Texture>();
    pixels->width = pixels->height = 2;
    pixels->rgba = {255, 0, 0, 255, 0, 255, 0, 90, 0, 0, 255, 255, 255, 255, 255, 0};
    return pixels;
}

} // namespace

int HostileNumbers::choice(int count) {
    return std::uniform_int_distribution<int>(0, count - 1)(m_random);
}

double HostileNumbers::scale(bool may_be_infinite) {
    switch (choice(may_be_infinite ? 9 : 7)) {
    case 0:
        return 0.0;
    case 1:
        return std::pow(10.0, 10.0 + choice(9)); // about the limit
    case 2:
        return std::pow(10.0, 16.0 + choice(292));
    case 3:
        return std::pow(10.0, -30.0 + choice(30));
    case 4:
        return std::pow(10.0, -323.0 + choice(293));
    case 5:
        return std::numeric_limits<double>::max();
    case 7:
        return std::numeric_limits<double>::infinity();
    case 8:
        return std::numeric_limits<double>::quiet_NaN();
    default:
        return std::pow(10.0, choice(13));
    }
}

double HostileNumbers::any() {
    const double usual = std::uniform_real_distribution<double>(-1.0, 1.0)(m_random);
    return choice(6) > 0 ? usual : usual * scale(true);
}

double HostileNumbers::finite() {
    const double usual = std::uniform_real_distribution<double>(-1.0, 1.0)(m_random);
    return choice(6) > 0 ? usual : usual * scale(false);
}

KM_3dPoint HostileNumbers::point() {
    return {any(), any(), any()};
}

/// Usual ones, ones of one scale, and ones that are nothing but numbers.
KM_Xform HostileNumbers::place() {
    const KM_Xform turn = KM_Xform::Rotation(3.0 * any(), {any(), any(), 1.0}, KM_3dPoint::Origin);
    switch (choice(5)) {
    case 0:
        return {};
    case 1:
        return KM_Xform::Translation(any(), any(), any()) * turn;
    case 2:
        return KM_Xform::Scale(KM_3dPoint::Origin, scale(true)) * turn;
    case 3:
        return turn * KM_Xform::Diagonal(scale(true), scale(true), scale(true)) * turn;
    default:
        KM_Xform x;
        for (int row = 0; row < 3; ++row)
            for (double& number : x.m_xform[row])
                number = any();
        return x;
    }
}

SceneMesh HostileNumbers::mesh() {
    KM_Mesh mesh = choice(2) ? sphereMesh(KM_3dPoint::Origin, 0.7F, 6)
                             : boxMesh({-0.6, -0.5, -0.4}, {0.5, 0.4, 0.6});
    const double size = choice(3) ? 1.0 : scale(true);
    for (KM_3fPoint& v : mesh.m_V)
        v = KM_3fPoint(v.ToDouble() * size);
    if (choice(3) == 0)
        mesh.m_V[static_cast<std::size_t>(choice(mesh.VertexCount()))] = KM_3fPoint(point());
    if (choice(3) == 0)
        for (std::size_t i = 0; i < mesh.m_V.size(); ++i)
            mesh.m_T.emplace_back(static_cast<float>(any()), static_cast<float>(any()));
    if (choice(3) == 0) {
        mesh.m_N.clear();
        for (std::size_t i = 0; i < mesh.m_V.size(); ++i)
            mesh.m_N.emplace_back(KM_3dVector(any(), any(), any()));
    }
    auto material = std::make_shared<Material>();
    material->base_color = {200, 120, static_cast<std::uint8_t>(choice(256)), 200};
    material->base_color_texture = choice(2) ? texture() : nullptr;
    material->see_through = choice(3) == 0;
    material->alpha_cutout = choice(4) == 0;
    material->alpha_cutoff = static_cast<float>(any());
    return {{shared(std::move(mesh)), material, place()}, KM_CreateUuid()};
}

KM_Light HostileNumbers::light() {
    KM_Light light = sunLight({any(), any(), any()});
    if (choice(3) == 0)
        light.SetStyle(KM_LightStyle::camera_directional);
    light.SetIntensity(choice(2) ? 1.0 : any());
    light.SetShadowIntensity(choice(2) ? 1.0 : any());
    return light;
}

SceneContent HostileNumbers::scene() {
    SceneContent content;
    content.revision = 1;
    if (choice(4) > 0)
        addMesh(content, boxMesh({-0.5, -0.5, -0.5}, {0.5, 0.5, 0.5}));
    for (int i = choice(4); i > 0; --i)
        content.meshes.push_back(mesh());
    for (int i = choice(3); i > 0; --i) {
        SceneCurve curve{KM_CreateUuid(), {}};
        for (int corner = choice(5); corner > 0; --corner)
            curve.polyline.Append(point());
        content.curves.push_back(curve);
    }
    for (int i = choice(3); i > 0; --i)
        content.points.push_back({KM_CreateUuid(), point()});
    for (int i = choice(3); i > 0; --i)
        content.lights.push_back(light());
    return content;
}

KM_Viewport HostileNumbers::camera() {
    KM_Viewport camera = perspectiveView({2.0, -3.0, 2.0}, KM_3dPoint::Origin);
    if (choice(3) == 0)
        camera.SetProjection(KM_parallel_view);
    if (choice(2) == 0)
        camera.SetCameraLocation({4.0 * any(), 4.0 * any(), 4.0 * any()});
    if (choice(3) == 0)
        camera.SetCameraDirection({any(), any(), any()});
    if (choice(4) == 0)
        camera.SetCameraUp({any(), any(), any()});
    if (choice(3) == 0)
        camera.SetCamera35mmLensLength(scale(false));
    if (choice(3) == 0)
        camera.SetFrustumNearFar(scale(false), scale(false));
    if (choice(4) == 0)
        camera.SetFrustum(any(), any(), any(), any(), any(), any());
    return camera.IsValidCamera() ? camera : perspectiveView({2.0, -3.0, 2.0}, {});
}

} // namespace quarn
