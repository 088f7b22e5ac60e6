#pragma once

#include "engine/render/kernel/RenderSetup.h"

#include <vector>

namespace quarn {

class DisplayScene;

/// The triangles of a scene that shine. Rays look for their light the more often the larger and
/// brighter they are.
class EmitterList {
public:
    /// Goes through the visible surfaces. What shines too dimly to be seen on others is left out,
    /// and so is all when there are more triangles than `most_triangles`: such light is found by
    /// chance alone.
    void find(const DisplayScene& scene);

    /// Valid as long as the object is and finds nothing else.
    EmitterTable table() const;

    static constexpr std::size_t most_triangles = 2000000;

private:
    void addMesh(const DisplayScene& scene, std::size_t surface);

    std::vector<Emitter> m_emitters;
    std::vector<float> m_ends;
    float m_density_of_brightness = 0.0F;
};

} // namespace quarn
