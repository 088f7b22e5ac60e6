#pragma once

#include "engine/render/Renderer.h"

namespace quarn {

class RenderLayers;

/// Takes the samples of a picture, of all pixels at first and then of the tiles that are not yet
/// good enough, as many blocks of pixels at a time as last for some hundredths
/// of a second.
class SampleTaking {
public:
    /// @param layers   the sums, all 0
    /// @param samples  the most that a pixel gets, see RenderRequest
    SampleTaking(const RenderSetup& setup, const RenderKernel& kernel, RenderLayers& layers,
                 int samples);

    /// Called between batches.
    /// @return false to end the work
    using Pause = std::function<bool(double share)>;

    /// @param grows_evenly  begins with few samples of each pixel, so that there is something to
    ///     see soon; the sums in the end are the same
    RenderEnd run(bool grows_evenly, const Pause& pause);

private:
    int passEnd(int first, bool grows_evenly) const;
    void renderBlocks(int begin, int end, int first_sample, int end_sample);
    template <class Work> void timed(const Work& work);

    const RenderSetup& m_setup;
    const RenderKernel& m_kernel;
    RenderLayers& m_layers;
    const int m_samples;
    const int m_columns;
    const int m_blocks;
    int m_batch = 4;
};

} // namespace quarn
