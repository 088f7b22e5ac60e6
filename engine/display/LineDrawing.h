#pragma once

#include "engine/display/DenseTone.h"
#include "engine/display/LineRaster.h"

#include <cstddef>
#include <vector>

namespace quarn {

class DisplayScene;
class VisibleParts;
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
    /// Some lines that follow each other in one object.
    struct Part {
        Source source;
        std::size_t object;
        std::size_t begin;
        std::size_t end;
        float strength;
    };
    /// Parts of one style, together small enough for one task.
    struct Job {
        LineStyle style;
        std::size_t first_part;
        std::size_t end_part;
        std::size_t line_count;
    };
    /// What the tasks of one picture share.
    struct Shared;

    void listMeshes(const DisplayScene& scene, const CameraRays& rays,
                    const DisplayModeAttributes& mode);
    void layTone(const DisplayScene& scene, const CameraRays& rays,
                 const DisplayModeAttributes& mode, const ScreenProjection& projection,
                 const LineTarget& target);
    void listCurvesAndPoints(const DisplayScene& scene, const DisplayModeAttributes& mode);
    void list(Source source, std::size_t object, std::size_t count, const LineStyle& style,
              float strength = 1.0F);
    void listPart(const Part& part, const LineStyle& style);
    void run(const Job& job, const Shared& shared, LineBatch& batch);
    static void addCurve(const Part& part, const Shared& shared, LineBatch& batch);
    static void addPoint(const Part& part, const Shared& shared, LineBatch& batch);
    static void addMeshLines(const Part& part, const Shared& shared, VisibleParts* visible_parts,
                             LineBatch& batch);

    std::vector<Part> m_parts;
    std::vector<Job> m_jobs;
    std::vector<LineBatch> m_batches;
    DenseTone m_tone;
};

} // namespace quarn
