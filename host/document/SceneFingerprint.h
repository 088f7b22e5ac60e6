#pragma once

namespace quarn {

class Checksum;
struct SceneContent;

/// Adds all of a scene that changes pictures: coordinates, materials and textures, what is shown,
/// curves, points and lights. The ids of objects are left out, which a model read again gets anew.
void addScene(const SceneContent& content, Checksum& sum);

} // namespace quarn
