#pragma once

namespace quarn {

class Checksum;
struct SceneContent;

/// Adds all of a scene that may change pictures: coordinates, materials with all their qualities
/// and textures, also those that are not drawn yet, what is shown, curves, points and lights. The
/// ids of objects are left out, which a model read again gets anew.
void addScene(const SceneContent& content, Checksum& sum);

} // namespace quarn
