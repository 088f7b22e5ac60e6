#pragma once

#include "ground/Result.h"
#include "host/share/camera/CameraTrack.h"

#include <string>

namespace quarn {

enum class GltfForm {
    text,   ///< .gltf, with the numbers of the keys inside
    binary, ///< .glb
};

/// A camera file for other programs.
struct GltfFile {
    std::string bytes;
    bool is_straightened = false; ///< the view's camera looks askew, which glTF cannot tell
    /// How far from its place in the document the camera may lie, in metres, as glTF keeps places
    /// by seven digits; 0 where nobody could see that.
    double lost_m = 0.0;
};

/// The camera of an animation as glTF 2.0: a camera that moves; of a sun study one that stands
/// still, and the sun as a directional light that turns (KHR_lights_punctual).
/// @return an error, in a sentence of the user's language, where the camera stands farther away
///         than glTF can say
Result<GltfFile> gltfFile(const CameraTrack& track, GltfForm form);

} // namespace quarn
