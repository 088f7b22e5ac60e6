#pragma once

#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Viewport.h"

#include <memory>
#include <vector>

namespace quarn {

/// A mesh ready to be shared with a scene.
std::shared_ptr<const KM_Mesh> shared(KM_Mesh mesh);

/// The rectangle between two corners, two of whose coordinates x0 <= x1, y0 <= y1 lie at height z.
KM_Mesh floorMesh(float x0, float y0, float x1, float y1, float z);
/// A closed box of twelve triangles, without normals.
KM_Mesh boxMesh(const KM_3dPoint& min, const KM_3dPoint& max);
/// A sphere of 2 * rings segments and `rings` rings with smooth normals.
KM_Mesh sphereMesh(const KM_3dPoint& center, float radius, int rings);
/// Hills of 2 * cells * cells triangles over [-50, 50]^2, with smooth normals.
KM_Mesh hillMesh(int cells);

/// Adds a mesh object of the given colour; gives back its index.
std::size_t addMesh(SceneContent& content, KM_Mesh mesh, KM_Color color = {204, 204, 204, 255});
/// A sun that shines in this direction.
KM_Light sunLight(const KM_3dVector& shines_to);

/// A parallel view from above: x to the right, y upward; the picture shows [-half, half] in y.
KM_Viewport topView(double half);
/// A camera at `eye` that looks at `target`, up along z.
KM_Viewport perspectiveView(const KM_3dPoint& eye, const KM_3dPoint& target);

/// A standard mode by its English name, with a level of anti-aliasing.
DisplayModeAttributes modeNamed(const wchar_t* english_name, int antialiasing_level = 0);

/// A picture of the content, which must be drawable.
Image drawn(const SceneContent& content, const KM_Viewport& viewport,
            const DisplayModeAttributes& mode, int width, int height, DepthImage* depth = nullptr);

/// Mean of a pixel's three channels, 0 to 255.
double brightness(const Image& image, int x, int y);
/// Mean of the whole picture.
double meanBrightness(const Image& image);
/// True when the two pixels have the same bytes.
bool samePixel(const Image& a, int ax, int ay, const Image& b, int bx, int by);

} // namespace quarn
