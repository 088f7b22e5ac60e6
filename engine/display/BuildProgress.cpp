#include "engine/display/BuildProgress.h"

#include <algorithm>
#include <utility>

namespace quarn {

WatchedCommits::WatchedCommits(BuildProgress* progress, std::size_t all_triangles)
    : m_progress(progress), m_first_share(progress ? progress->share.load() : 0.0),
      m_share_of_triangle((1.0 - m_first_share) /
                          static_cast<double>(std::max<std::size_t>(all_triangles, 1))) {}

bool WatchedCommits::commit(RTCScene scene, std::size_t triangles) {
    if (!m_progress) {
        rtcCommitScene(scene);
        return true;
    }
    m_triangles = triangles;
    rtcSetSceneProgressMonitorFunction(scene, noteShare, this);
    rtcCommitScene(scene);
    rtcSetSceneProgressMonitorFunction(scene, nullptr, nullptr);
    if (m_progress->is_given_up)
        return false;
    m_triangles_built += std::exchange(m_triangles, 0);
    return noteShare(this, 0.0);
}

/// Called by any of the threads that build.
bool WatchedCommits::noteShare(void* commits, double share) {
    const auto& all = *static_cast<const WatchedCommits*>(commits);
    const double triangles = static_cast<double>(all.m_triangles_built) +
                             std::clamp(share, 0.0, 1.0) * static_cast<double>(all.m_triangles);
    all.m_progress->share = std::min(all.m_first_share + all.m_share_of_triangle * triangles, 1.0);
    return !all.m_progress->is_given_up;
}

} // namespace quarn
