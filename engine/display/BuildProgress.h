#pragma once

#include <embree3/rtcore.h>

#include <atomic>
#include <cstddef>

namespace quarn {

/// How far the building of a scene is, and whether it goes on. One thread builds while another one
/// looks.
struct BuildProgress {
    std::atomic<double> share{0.0};       ///< that is done, 0 to 1
    std::atomic<bool> is_given_up{false}; ///< the building ends soon, with an error
};

/// Builds several search structures and says how far all of them are.
class WatchedCommits {
public:
    /// @param progress       may be null: nobody looks
    /// @param all_triangles  of all structures that will be built
    WatchedCommits(BuildProgress* progress, std::size_t all_triangles);

    /// @return false when it was given up; the scene is not built then
    bool commit(RTCScene scene, std::size_t triangles);

private:
    static bool noteShare(void* commits, double share);

    BuildProgress* m_progress;
    double m_first_share;
    double m_share_of_triangle;
    std::size_t m_triangles = 0;       ///< of the structure that is built
    std::size_t m_triangles_built = 0; ///< of those before
};

} // namespace quarn
