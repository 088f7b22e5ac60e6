#pragma once

namespace quarn {

class Checksum;
struct LightSettings;
struct SceneContent;

/// Adds all of a scene that may change pictures: coordinates, materials with all their qualities
/// and textures, also those that are not drawn yet, what is shown, curves, points and lights. The
/// ids of objects are left out, which a model read again gets anew.
void addScene(const SceneContent& content, Checksum& sum);

/// Adds all that a scene is lit by beside its lights, a picture of the surroundings by its pixels,
/// and what it stands before and on.
void addLight(const LightSettings& light, Checksum& sum);

} // namespace quarn
