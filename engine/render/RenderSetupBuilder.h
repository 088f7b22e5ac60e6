#pragma once

#include "engine/render/EmitterList.h"
#include "engine/render/EnvironmentChances.h"
#include "engine/render/kernel/RenderSetup.h"

class KM_Viewport;

namespace quarn {

class DisplayScene;
class SampleSequence;

/// The sun's apparent diameter in degrees, at its mean distance.
inline constexpr double sun_diameter_deg = 0.53;

/// What a setup points to.
struct RenderTables {
    EnvironmentChances environment;
    EmitterList emitters;
};

/// Collects what the render loops need for one picture: what Rendered mode draws, with the sky as
/// a light. A floor under the free sky gets as much light from it as in Rendered mode.
/// @param sequence, tables  must outlive the setup
RenderSetup makeRenderSetup(const DisplayScene& scene, const KM_Viewport& viewport, int width,
                            int height, const SampleSequence& sequence, const RenderKernel& kernel,
                            RenderTables& tables);

/// Makes the rest of a setup from its `frame`: the scale of the sky, where its light is looked for,
/// and the discs of the suns.
void completeRenderSetup(RenderSetup& setup, const RenderKernel& kernel, RenderTables& tables);

} // namespace quarn
