#pragma once

#include "engine/display/DisplayScene.h"
#include "engine/display/LineRaster.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace quarn {

class ScreenProjection;
struct CameraRays;

/// How clearly the inner edges of a mesh can be told apart, by how far they stand from each other
/// on the picture: 1 where each can be seen, 0 where they would be a grey spot.
class EdgeSpacing {
public:
    /// @param object  its edges are measured
    EdgeSpacing(const DisplayScene::MeshObject& object, const CameraRays& rays);

    /// @param nearness  of the edges, in the measure of DepthImage
    float clearness(float nearness) const;
    /// The side of a pixel there, in the frame's units.
    double pixelAt(float nearness) const;

private:
    double m_length; ///< mean of the edges, in the frame's units
    double m_pixel_size;
    bool m_parallel;
};

/// Lays an even tone over meshes whose edges are too dense to be told apart, as a fine screen of
/// lines looks from afar. It is steady: it depends on where surfaces are, not on how edges and
/// pixels happen to meet.
class DenseTone {
public:
    /// Starts anew for a picture of this size; keeps the storage.
    void reset(int width, int height);
    /// Adds a mesh, as far as its edges cannot be told apart and surfaces do not hide it.
    void add(const DisplayScene::MeshObject& object, const CameraRays& rays,
             const ScreenProjection& projection, const LineTarget& target);
    /// Lays the tone over the picture.
    /// @param strength  of the tone where nothing can be told apart, 0 to 1
    void blend(const LineTarget& target, const KM_Color& color, float strength) const;

private:
    class Sampler;

    void blendRow(const LineTarget& target, int row, const KM_Color& color, float strength) const;

    int m_width = 0;
    int m_height = 0;
    /// How much of the tone each pixel has, in steps of 255; with a border of one pixel.
    std::vector<std::uint8_t> m_marks;
    bool m_is_empty = true;
};

} // namespace quarn
