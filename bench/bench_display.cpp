// Milliseconds a frame of the display pipeline beside a bare loop that shoots the same rays into a
// scene that holds the mesh alone and writes one number a pixel. Both use the same tiles and
// threads, take turns, and the best of many frames counts, so that the ratio holds on a busy
// machine too. The second ratio is that of the smoothed picture to the one without smoothing.

#include "host/display/CameraRays.h"
#include "host/display/DisplayPipeline.h"
#include "host/display/DisplayScene.h"
#include "host/display/FlushDenormals.h"
#include "host/display/RayHandle.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Viewport.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

constexpr int width = 1280;
constexpr int height = 720;
constexpr int rounds = 40;

double millisecondsSince(Clock::time_point start) {
    return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

/// Hills of 2 * cells * cells triangles over a square of 100 by 100.
std::shared_ptr<KM_Mesh> makeHills(int cells) {
    auto mesh = std::make_shared<KM_Mesh>();
    const auto side = static_cast<std::uint32_t>(cells + 1);
    mesh->m_V.reserve(std::size_t{side} * side + 1);
    for (int j = 0; j <= cells; ++j)
        for (int i = 0; i <= cells; ++i) {
            const float x = 100.0F * static_cast<float>(i) / static_cast<float>(cells) - 50.0F;
            const float y = 100.0F * static_cast<float>(j) / static_cast<float>(cells) - 50.0F;
            mesh->m_V.emplace_back(x, y,
                                   4.0F * std::sin(0.2F * x) * std::cos(0.17F * y) +
                                       std::sin(0.9F * x + 0.7F * y));
        }
    for (std::uint32_t j = 0; j + 1 < side; ++j)
        for (std::uint32_t i = 0; i + 1 < side; ++i) {
            const std::uint32_t a = j * side + i;
            mesh->m_F.push_back({{a, a + 1, a + side + 1}});
            mesh->m_F.push_back({{a, a + side + 1, a + side}});
        }
    mesh->ComputeVertexNormals();
    mesh->PadForRayTracing();
    return mesh;
}

KM_Viewport makeViewport() {
    KM_Viewport viewport;
    const KM_3dPoint eye(0.0, -62.0, 34.0);
    viewport.SetCameraLocation(eye);
    viewport.SetCameraDirection(KM_3dPoint(0.0, -8.0, 0.0) - eye);
    viewport.SetCameraUp(KM_3dVector::ZAxis);
    viewport.SetCamera35mmLensLength(40.0);
    return viewport;
}

KM_Light makeSun() {
    KM_Light sun;
    sun.SetStyle(KM_LightStyle::world_directional);
    sun.SetDirection({0.5, 0.6, -0.7});
    return sun;
}

/// The mesh alone in a scene of its own, and nothing but the rays.
class BareLoop {
public:
    BareLoop(const KM_Mesh& mesh, const KM_Viewport& viewport, const KM_Light& sun)
        : m_device(rtcNewDevice(nullptr)), m_scene(rtcNewScene(m_device.get())),
          m_rays(quarn::cameraRays(viewport, width, height, mesh.BoundingBox())),
          m_ground(static_cast<float>(mesh.BoundingBox().m_min.z)),
          m_output(std::size_t{width} * height) {
        KM_3dVector toward = -sun.Direction();
        toward.Unitize();
        m_sun[0] = static_cast<float>(toward.x);
        m_sun[1] = static_cast<float>(toward.y);
        m_sun[2] = static_cast<float>(toward.z);
        const quarn::RayGeometry geometry(
            rtcNewGeometry(m_device.get(), RTC_GEOMETRY_TYPE_TRIANGLE));
        rtcSetSharedGeometryBuffer(geometry.get(), RTC_BUFFER_TYPE_VERTEX, 0, RTC_FORMAT_FLOAT3,
                                   mesh.m_V.data(), 0, sizeof(KM_3fPoint), mesh.m_V.size());
        rtcSetSharedGeometryBuffer(geometry.get(), RTC_BUFFER_TYPE_INDEX, 0, RTC_FORMAT_UINT3,
                                   mesh.m_F.data(), 0, sizeof(KM_MeshTriangle), mesh.m_F.size());
        rtcCommitGeometry(geometry.get());
        rtcAttachGeometry(m_scene.get(), geometry.get());
        rtcCommitScene(m_scene.get());
    }

    void draw(bool with_shadows) {
        constexpr int columns = width / 64;
        constexpr int rows = (height + 31) / 32;
        tbb::parallel_for(0, columns * rows, [&](int index) {
            const quarn::FlushDenormals flush;
            const int x = index % columns * 64;
            const int y = index / columns * 32;
            drawBlock(x, y, std::min(height, y + 32), with_shadows);
        });
    }

private:
    void drawBlock(int left, int top, int bottom, bool with_shadows) {
        alignas(64) int valid[16];
        std::fill_n(valid, 16, -1);
        RTCRayHit16 rays;
        for (int i = 0; i < 16; ++i) {
            rays.ray.tnear[i] = 0.0F;
            rays.ray.time[i] = 0.0F;
            rays.ray.mask[i] = 0xFFFFFFFFU;
            rays.ray.flags[i] = 0;
        }
        for (int y = top; y < bottom; y += 4)
            for (int x = left; x < left + 64; x += 4) {
                aim(rays, x, y);
                RTCIntersectContext context;
                rtcInitIntersectContext(&context);
                context.flags = RTC_INTERSECT_CONTEXT_FLAG_COHERENT;
                rtcIntersect16(valid, m_scene.get(), &context, &rays);
                if (with_shadows)
                    lookAtSun(rays);
                for (int i = 0; i < 16; ++i)
                    m_output[static_cast<std::size_t>((y + i / 4) * width + x + i % 4)] =
                        rays.ray.tfar[i];
            }
    }

    void aim(RTCRayHit16& rays, int left, int top) const {
        for (int i = 0; i < 16; ++i) {
            const float x = static_cast<float>(left + i % 4) + 0.5F;
            const float y = static_cast<float>(top + i / 4) + 0.5F;
            rays.ray.org_x[i] = m_rays.origin[0];
            rays.ray.org_y[i] = m_rays.origin[1];
            rays.ray.org_z[i] = m_rays.origin[2];
            rays.ray.dir_x[i] =
                m_rays.direction[0] + x * m_rays.direction_dx[0] + y * m_rays.direction_dy[0];
            rays.ray.dir_y[i] =
                m_rays.direction[1] + x * m_rays.direction_dx[1] + y * m_rays.direction_dy[1];
            rays.ray.dir_z[i] =
                m_rays.direction[2] + x * m_rays.direction_dx[2] + y * m_rays.direction_dy[2];
            rays.ray.tfar[i] = 1e30F;
            rays.hit.geomID[i] = RTC_INVALID_GEOMETRY_ID;
            rays.hit.instID[0][i] = RTC_INVALID_GEOMETRY_ID;
        }
    }

    /// From each hit that faces the sun, and from the ground where it is seen, to the sun.
    void lookAtSun(RTCRayHit16& rays) const {
        alignas(64) int valid[16];
        RTCRay16 shadow;
        int wanted = 0;
        for (int i = 0; i < 16; ++i) {
            const bool hit = rays.hit.geomID[i] != RTC_INVALID_GEOMETRY_ID;
            float facing = rays.hit.Ng_x[i] * m_sun[0] + rays.hit.Ng_y[i] * m_sun[1] +
                           rays.hit.Ng_z[i] * m_sun[2];
            const float along = rays.hit.Ng_x[i] * rays.ray.dir_x[i] +
                                rays.hit.Ng_y[i] * rays.ray.dir_y[i] +
                                rays.hit.Ng_z[i] * rays.ray.dir_z[i];
            facing = along > 0.0F ? -facing : facing;
            float t = rays.ray.tfar[i];
            const bool ground = !hit && rays.ray.dir_z[i] < 0.0F;
            if (ground)
                t = (m_ground - rays.ray.org_z[i]) / rays.ray.dir_z[i];
            const bool look = (hit && facing > 0.0F) || ground;
            t = look ? t * 0.9999F : 0.0F;
            shadow.org_x[i] = rays.ray.org_x[i] + t * rays.ray.dir_x[i];
            shadow.org_y[i] = rays.ray.org_y[i] + t * rays.ray.dir_y[i];
            shadow.org_z[i] = rays.ray.org_z[i] + t * rays.ray.dir_z[i];
            shadow.dir_x[i] = m_sun[0];
            shadow.dir_y[i] = m_sun[1];
            shadow.dir_z[i] = m_sun[2];
            shadow.tnear[i] = 0.0F;
            shadow.tfar[i] = look ? 1e30F : -1.0F;
            shadow.time[i] = 0.0F;
            shadow.mask[i] = 0xFFFFFFFFU;
            shadow.flags[i] = 0;
            valid[i] = look ? -1 : 0;
            wanted |= valid[i];
        }
        if (wanted == 0)
            return;
        RTCIntersectContext context;
        rtcInitIntersectContext(&context);
        rtcOccluded16(valid, m_scene.get(), &context, &shadow);
        for (int i = 0; i < 16; ++i)
            rays.ray.tfar[i] = shadow.tfar[i];
    }

    quarn::RayDevice m_device;
    quarn::RaySceneHandle m_scene;
    quarn::CameraRays m_rays;
    float m_sun[3];
    float m_ground;
    std::vector<float> m_output;
};

template <class Function> void keepBest(double& best, const Function& function) {
    const auto start = Clock::now();
    function();
    best = std::min(best, millisecondsSince(start));
}

quarn::DisplayModeAttributes modeOf(const KM_UUID& id, int antialiasing_level) {
    quarn::DisplayModeAttributes mode = *quarn::findDisplayMode(id);
    mode.antialiasing_level = antialiasing_level;
    return mode;
}

void require(const quarn::Result<void>& result) {
    if (result)
        return;
    std::fprintf(stderr, "%s\n", result.message().c_str());
    std::exit(1);
}

struct Times {
    double bare = 1e9;
    double smoothing_off = 1e9;
    double smoothing_full = 1e9;
};

Times measure(const quarn::DisplayScene& scene, const KM_Viewport& viewport, BareLoop& bare,
              const KM_UUID& mode_id, bool with_shadows) {
    const auto off = modeOf(mode_id, 0);
    const auto full = modeOf(mode_id, 2);
    quarn::DisplayPipeline pipeline;
    quarn::Image image;
    Times times;
    for (int i = 0; i < rounds; ++i) {
        keepBest(times.bare, [&] { bare.draw(with_shadows); });
        keepBest(times.smoothing_off,
                 [&] { require(pipeline.draw(scene, viewport, off, width, height, image)); });
        keepBest(times.smoothing_full,
                 [&] { require(pipeline.draw(scene, viewport, full, width, height, image)); });
    }
    return times;
}

void measureMesh(int cells) {
    const auto mesh = makeHills(cells);
    const KM_Viewport viewport = makeViewport();
    quarn::SceneContent content;
    content.revision = 1;
    content.meshes.push_back({KM_CreateUuid(), mesh, nullptr, true});
    content.lights.push_back(makeSun());

    double build_ms = 1e9;
    for (int i = 0; i < 3; ++i) {
        quarn::DisplayScene fresh;
        keepBest(build_ms, [&] { require(fresh.update(content)); });
    }
    quarn::DisplayScene scene;
    require(scene.update(content));
    BareLoop bare(*mesh, viewport, content.lights.front());
    const auto print = [&](const char* name, const Times& t) {
        std::printf("%10d  %-9s %9.2f %9.2f %6.2f %11.2f %6.2f %11.1f\n", mesh->TriangleCount(),
                    name, t.bare, t.smoothing_off, t.smoothing_off / t.bare, t.smoothing_full,
                    t.smoothing_full / t.smoothing_off, build_ms);
    };
    print("Shaded", measure(scene, viewport, bare, quarn::shaded_mode_id, false));
    print("Rendered", measure(scene, viewport, bare, quarn::rendered_mode_id, true));
}

} // namespace

int main() {
    std::printf("%d x %d pixels, milliseconds\n", width, height);
    std::printf("%10s  %-9s %9s %9s %6s %11s %6s %11s\n", "triangles", "mode", "bare rays",
                "pipeline", "ratio", "smoothed", "ratio", "scene build");
    for (const int cells : {71, 224, 707})
        measureMesh(cells);
    return 0;
}
