#pragma once

#include "engine/display/DisplayMode.h"
#include "engine/display/Environment.h"
#include "engine/display/FreeSky.h"
#include "engine/display/LineDrawing.h"
#include "engine/display/MarkedPixels.h"
#include "engine/display/OpenGround.h"
#include "engine/images/Image.h"
#include "ground/Result.h"

#include <cstdint>
#include <vector>

class KM_Viewport;

namespace quarn {

class DisplayScene;
struct RayKernel;

/// Draws pictures of a scene. It keeps its buffers, so drawing many frames of one size asks for
/// memory once; after many pictures that are far smaller than an earlier one it lets the buffers of
/// that one go. One picture at a time; the threads it uses have ended their work when a call
/// returns. The same picture comes out for any number of threads.
class DisplayPipeline {
public:
    static constexpr int max_size_px = 16384;

    DisplayPipeline();
    /// Draws with the ray loops of a certain kind of processor.
    explicit DisplayPipeline(const RayKernel& kernel) : m_kernel(&kernel) {}

    /// Draws `scene` as `viewport` sees it. The camera's opening is fitted to the picture's aspect,
    /// the smaller half angle stays. A camera that is out of range sees the background alone, see
    /// DisplayScene::canBeSeenBy.
    ///
    /// @param width, height  pixels, 1 to max_size_px; the viewport's own screen size does not
    /// count
    /// @param image          takes the picture; its storage is used again
    /// @param depth          takes the depth of surfaces (lines have none); may be null
    /// @return an error, with `image` unchanged, for a size out of range or an invalid camera
    Result<void> draw(const DisplayScene& scene, const KM_Viewport& viewport,
                      const DisplayModeAttributes& mode, int width, int height, Image& image,
                      DepthImage* depth = nullptr);

    /// How many pixels of the last picture were smoothed.
    std::size_t smoothedPixelCount() const { return m_smoothed; }

    /// Pixels of the largest picture for which memory is held.
    std::int64_t heldPixels() const { return m_held_px; }

private:
    void makeRoom(int width, int height);
    void drawSurfaces(struct FrameSetup& frame, const DisplayModeAttributes& mode);

    const RayKernel* m_kernel;
    std::vector<std::uint32_t> m_objects;
    DepthImage m_depth;
    std::vector<float> m_layers;
    MarkedPixels m_marked;
    FreeSky m_free_sky;
    Environment m_environment;
    OpenGround m_open_ground;
    LineDrawing m_lines;
    std::size_t m_smoothed = 0;
    std::int64_t m_held_px = 0;
    int m_small_pictures = 0; ///< since the last that needed about as much as is held
};

} // namespace quarn
