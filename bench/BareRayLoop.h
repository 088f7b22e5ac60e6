#pragma once

#include "engine/display/CameraRays.h"
#include "engine/display/FlushDenormals.h"
#include "engine/display/RayHandle.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Viewport.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cstddef>
#include <vector>

namespace bench {

/// What a picture costs at least: the mesh alone in a scene of its own, the rays of every pixel,
/// and one number written for each. The tiles and the threads are those of the display pipeline.
class BareRayLoop {
public:
    BareRayLoop(const KM_Mesh& mesh, const KM_Light& sun)
        : m_device(rtcNewDevice(nullptr)), m_scene(rtcNewScene(m_device.get())),
          m_box(mesh.BoundingBox()), m_ground(static_cast<float>(m_box.m_min.z)) {
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

    /// What the next pictures show.
    /// @param width, height  pixels; multiples of 64 and of 4
    void look(const KM_Viewport& viewport, int width, int height) {
        m_width = width;
        m_height = height;
        m_rays = quarn::cameraRays(viewport, width, height, m_box);
        m_output.resize(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
    }

    /// @param with_shadows  a second ray from each place that the sun may shine on
    void draw(bool with_shadows) {
        const int columns = m_width / 64;
        const int rows = (m_height + 31) / 32;
        tbb::parallel_for(0, columns * rows, [&](int index) {
            const quarn::FlushDenormals flush;
            const int x = index % columns * 64;
            const int y = index / columns * 32;
            drawBlock(x, y, std::min(m_height, y + 32), with_shadows);
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
                    m_output[static_cast<std::size_t>((y + i / 4) * m_width + x + i % 4)] =
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
    KM_BoundingBox m_box;
    float m_ground;
    float m_sun[3];
    int m_width = 0;
    int m_height = 0;
    quarn::CameraRays m_rays;
    std::vector<float> m_output;
};

} // namespace bench
