#include "engine/display/DenseTone.h"

#include "engine/display/CameraRays.h"
#include "engine/display/LineBlend.h"
#include "engine/display/MeshEdges.h"
#include "engine/display/RayMesh.h"
#include "engine/display/ScreenProjection.h"
#include "engine/display/VisibleParts.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <atomic>
#include <cmath>

namespace quarn {

namespace {

/// Edges that stand closer than the first, in pixels, cannot be told apart; from the second on all
/// can.
constexpr double dense_px = 2.5;
constexpr double sparse_px = 10.0;

constexpr std::size_t triangles_per_job = 16384;
/// Places of a surface that leave a mark, for each pixel that it covers.
constexpr double marks_per_pixel = 1.2;
constexpr int most_marks = 64;
/// So many marked pixels of nine make the full tone: gaps between marks are not seen.
constexpr float marks_for_full_tone = 4.0F;

/// A number from 0 to 1 that looks random and is the same in every frame.
float scattered(std::uint32_t seed) {
    seed ^= seed >> 16;
    seed *= 0x7FEB352DU;
    seed ^= seed >> 15;
    seed *= 0x846CA68BU;
    seed ^= seed >> 16;
    return static_cast<float>(seed >> 8) * 0x1p-24F;
}

float wrapped(float value) {
    return value - std::floor(value);
}

void raise(std::uint8_t& mark, std::uint8_t to) {
    const std::atomic_ref<std::uint8_t> shared(mark);
    std::uint8_t present = shared.load(std::memory_order_relaxed);
    while (present < to && !shared.compare_exchange_weak(present, to, std::memory_order_relaxed)) {
    }
}

} // namespace

EdgeSpacing::EdgeSpacing(const DisplayScene::MeshObject& object, const CameraRays& rays)
    : m_length(object.mesh->edges().meanInnerLength() *
               std::cbrt(std::abs(object.frame_from_mesh.Determinant()))),
      m_pixel_size(rays.pixel_size), m_parallel(rays.parallel) {}

double EdgeSpacing::pixelAt(float nearness) const {
    return m_parallel ? m_pixel_size : m_pixel_size / std::max(1e-30, double{nearness});
}

float EdgeSpacing::clearness(float nearness) const {
    const double spacing_px = m_length / std::max(pixelAt(nearness), 1e-300);
    return static_cast<float>(
        std::clamp((spacing_px - dense_px) / (sparse_px - dense_px), 0.0, 1.0));
}

void DenseTone::reset(int width, int height) {
    m_width = width;
    m_height = height;
    m_is_empty = true;
    m_marks.assign(static_cast<std::size_t>(width + 2) * static_cast<std::size_t>(height + 2), 0);
}

/// Marks the pixels that a mesh's triangles show, by places scattered over them.
class DenseTone::Sampler {
public:
    Sampler(const DisplayScene::MeshObject& object, const CameraRays& rays,
            const ScreenProjection& projection, const LineTarget& target, DenseTone& tone)
        : m_mesh(object.mesh->mesh()), m_spacing(object, rays), m_rays(rays),
          m_projection(projection), m_surfaces(target), m_tone(tone),
          m_hides(target.depth != nullptr) {
        for (int row = 0; row < 3; ++row)
            for (int column = 0; column < 4; ++column)
                m_frame_from_mesh[row][column] = object.frame_from_mesh.m_xform[row][column];
    }

    void addTriangle(std::uint32_t index) const {
        const std::uint32_t* const vertices = m_mesh.m_F[index].vi;
        const Triangle t{{inFrame(vertices[0]), inFrame(vertices[1]), inFrame(vertices[2])}};
        const float nearness = m_projection.nearness(t.corners[0].at);
        const float amount = toneOf(nearness);
        if (amount <= 0.0F)
            return;
        const double pixel = m_spacing.pixelAt(nearness);
        const double wanted = marks_per_pixel * areaSeen(t) / (pixel * pixel);
        const float chance = scattered(index);
        const int count = static_cast<int>(std::min(wanted, double{most_marks}) + chance);
        if (count == 1)
            markCorner(t, amount);
        else if (count > 1)
            markWithin(t, count, {chance, scattered(~index)}, amount);
    }

private:
    struct Point {
        double at[3];
    };
    struct Triangle {
        Point corners[3];

        Point within(float s, float t) const {
            Point p;
            for (int i = 0; i < 3; ++i)
                p.at[i] = corners[0].at[i] + s * (corners[1].at[i] - corners[0].at[i]) +
                          t * (corners[2].at[i] - corners[0].at[i]);
            return p;
        }
    };
    struct Shift {
        float s;
        float t;
    };

    Point inFrame(std::uint32_t vertex) const {
        const KM_3fPoint& p = m_mesh.m_V[vertex];
        Point result;
        for (int i = 0; i < 3; ++i) {
            const double(&row)[4] = m_frame_from_mesh[i];
            result.at[i] = row[0] * p.x + row[1] * p.y + row[2] * p.z + row[3];
        }
        return result;
    }

    /// Of its shadow on a plane across the line of sight.
    double areaSeen(const Triangle& triangle) const {
        double u[3];
        double v[3];
        double toward[3];
        for (int i = 0; i < 3; ++i) {
            u[i] = triangle.corners[1].at[i] - triangle.corners[0].at[i];
            v[i] = triangle.corners[2].at[i] - triangle.corners[0].at[i];
            toward[i] = m_rays.eye[i] - triangle.corners[0].at[i];
        }
        const auto volume = [&](const auto& w) {
            return 0.5 * std::fabs(w[0] * (u[1] * v[2] - u[2] * v[1]) +
                                   w[1] * (u[2] * v[0] - u[0] * v[2]) +
                                   w[2] * (u[0] * v[1] - u[1] * v[0]));
        };
        if (m_rays.parallel)
            return volume(m_rays.camera_z);
        return volume(toward) / (toward[0] * m_rays.camera_z[0] + toward[1] * m_rays.camera_z[1] +
                                 toward[2] * m_rays.camera_z[2]);
    }

    /// A little of it is left out, so that meshes that are nearly clear cost nothing.
    float toneOf(float nearness) const {
        constexpr float least = 0.1F;
        return nearness > 0.0F
                   ? (1.0F - m_spacing.clearness(nearness) - least) * (1.0F / (1.0F - least))
                   : 0.0F;
    }

    void markCorner(const Triangle& t, float amount) const {
        ScreenPoint place;
        if (m_projection.project(t.corners[0].at, place))
            mark(place, amount);
    }

    /// By the additive recurrence of M. Roberts, "The Unreasonable Effectiveness of Quasirandom
    /// Sequences", 2018.
    void markWithin(const Triangle& triangle, int count, Shift shift, float amount) const {
        for (int i = 0; i < count; ++i) {
            const float s = wrapped(shift.s + 0.754877666F * static_cast<float>(i));
            const float t = wrapped(shift.t + 0.569840296F * static_cast<float>(i));
            const bool is_inside = s + t <= 1.0F;
            const Point p = triangle.within(is_inside ? s : 1.0F - s, is_inside ? t : 1.0F - t);
            ScreenPoint place;
            if (m_projection.project(p.at, place))
                mark(place, amount);
        }
    }

    void mark(const ScreenPoint& place, float amount) const {
        const auto x = static_cast<int>(place.x);
        const auto y = static_cast<int>(place.y);
        std::uint8_t& present = m_tone.m_marks[static_cast<std::size_t>(y + 1) *
                                                   static_cast<std::size_t>(m_tone.m_width + 2) +
                                               static_cast<std::size_t>(x + 1)];
        const auto to = static_cast<std::uint8_t>(255.0F * amount + 0.5F);
        if (!m_hides || !m_surfaces.hides(x, y, place.nearness))
            raise(present, to);
    }

    const KM_Mesh& m_mesh;
    double m_frame_from_mesh[3][4];
    EdgeSpacing m_spacing;
    const CameraRays& m_rays;
    const ScreenProjection& m_projection;
    SurfaceView m_surfaces;
    DenseTone& m_tone;
    bool m_hides;
};

void DenseTone::add(const DisplayScene::MeshObject& object, const CameraRays& rays,
                    const ScreenProjection& projection, const LineTarget& target) {
    m_is_empty = false;
    const Sampler sampler(object, rays, projection, target, *this);
    const std::size_t count = object.mesh->mesh().m_F.size();
    const std::size_t jobs = (count + triangles_per_job - 1) / triangles_per_job;
    tbb::parallel_for(std::size_t{0}, jobs, [&](std::size_t job) {
        const std::size_t end = std::min(count, (job + 1) * triangles_per_job);
        for (std::size_t i = job * triangles_per_job; i < end; ++i)
            sampler.addTriangle(static_cast<std::uint32_t>(i));
    });
}

void DenseTone::blend(const LineTarget& target, const KM_Color& color, float strength) const {
    if (m_is_empty)
        return;
    tbb::parallel_for(0, m_height, [&](int row) { blendRow(target, row, color, strength); });
}

void DenseTone::blendRow(const LineTarget& target, int row, const KM_Color& color,
                         float strength) const {
    const auto stride = static_cast<std::size_t>(m_width) + 2;
    const std::uint8_t* const above = m_marks.data() + static_cast<std::size_t>(row) * stride;
    const auto columnSum = [&](int x) {
        return int{above[x]} + int{above[stride + static_cast<std::size_t>(x)]} +
               int{above[2 * stride + static_cast<std::size_t>(x)]};
    };
    std::uint32_t* const pixels =
        target.pixels + static_cast<std::size_t>(row) * static_cast<std::size_t>(m_width);
    int left = columnSum(0);
    int here = columnSum(1);
    for (int x = 0; x < m_width; ++x) {
        const int right = columnSum(x + 2);
        const int sum = left + here + right;
        left = here;
        here = right;
        if (sum == 0)
            continue;
        const float part = std::min(1.0F, static_cast<float>(sum) / (255.0F * marks_for_full_tone));
        pixels[x] = blendedOver(pixels[x], color, strength * part);
    }
}

} // namespace quarn
