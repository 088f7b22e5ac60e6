#pragma once

#include "host/display/DenseTone.h"
#include "host/display/LineRaster.h"

#include <cstddef>
#include <vector>

namespace quarn {

class DisplayScene;
class MeshEdges;
class MeshLines;
struct CameraRays;
struct DisplayModeAttributes;

/// Draws a scene's lines over a picture: edges of meshes as the mode asks, curves and points
/// always.
class LineDrawing {
public:
    /// True when the scene has any line that this mode draws.
    static bool hasLines(const DisplayScene& scene, const DisplayModeAttributes& mode);

    void draw(const DisplayScene& scene, const CameraRays& rays, const DisplayModeAttributes& mode,
              const LineTarget& target);

private:
    enum class Source { flat, smooth, creases, feature_outlines, smooth_outlines, curve, point };
    /// A part of one object's lines, small enough for one task.
    struct Job {
        Source source;
        std::size_t object;
        std::size_t begin;
        std::size_t end;
        LineStyle style;
        float strength;
    };

    void listMeshes(const DisplayScene& scene, const CameraRays& rays,
                    const DisplayModeAttributes& mode);
    void layTone(const DisplayScene& scene, const CameraRays& rays,
                 const DisplayModeAttributes& mode, const ScreenProjection& projection,
                 const LineTarget& target);
    void listCurvesAndPoints(const DisplayScene& scene, const DisplayModeAttributes& mode);
    void list(Source source, std::size_t object, std::size_t count, const LineStyle& style,
              float strength = 1.0F);
    static void addMeshLines(const Job& job, const MeshLines& lines, const MeshEdges& edges,
                             LineBatch& batch);

    std::vector<Job> m_jobs;
    std::vector<LineBatch> m_batches;
    DenseTone m_tone;
};

} // namespace quarn
