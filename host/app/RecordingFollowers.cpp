#include "host/app/RecordingFollowers.h"

#include <utility>

namespace quarn {

void RecordingFollowers::add(std::unique_ptr<RecordingFollower> follower) {
    m_followers.push_back(std::move(follower));
}

void RecordingFollowers::addFirst(std::unique_ptr<RecordingFollower> follower) {
    m_followers.insert(m_followers.begin(), std::move(follower));
}

void RecordingFollowers::frameRecorded(int number, const std::filesystem::path& file,
                                       const Image& picture) {
    if (m_followers.empty() || !m_camera)
        return;
    const KM_Viewport camera = m_camera();
    for (const auto& follower : m_followers)
        follower->frameRecorded({number, file, camera, picture});
}

void RecordingFollowers::frameKept(int number, const std::filesystem::path& file) {
    for (const auto& follower : m_followers)
        follower->frameKept(number, file);
}

void RecordingFollowers::end(const RecordingReport& report) {
    for (const auto& follower : m_followers)
        follower->recordingEnded(report);
    clear();
}

void RecordingFollowers::clear() {
    m_followers.clear();
    m_camera = nullptr;
}

} // namespace quarn
