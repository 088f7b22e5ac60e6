#pragma once

#include <embree3/rtcore.h>

#include <atomic>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <thread>

namespace quarn {

/// The ray tracing library, started. Scenes that share search structures share it, also where
/// different threads build them.
class RayLibrary {
public:
    /// @param why  receives a sentence for the person where it cannot start
    /// @return null then
    static std::shared_ptr<RayLibrary> start(std::string& why);
    explicit RayLibrary(RTCDevice device);
    ~RayLibrary();
    RayLibrary(const RayLibrary&) = delete;
    RayLibrary& operator=(const RayLibrary&) = delete;

    RTCDevice device() const { return m_device; }

    /// What it could not do for the calling thread since the last call, in a sentence for the
    /// person; empty when it could do all. To have given up is no such thing.
    std::string takeError();

    /// Nobody uses the library from now on, and it is never released: where its memory ran out one
    /// of its locks may stay closed, and releasing it would wait for that without end.
    void abandon() { m_is_abandoned = true; }
    bool isAbandoned() const { return m_is_abandoned; }

private:
    static void noteError(void* library, RTCError error, const char* message);

    RTCDevice m_device;
    std::atomic<bool> m_is_abandoned{false};
    std::mutex m_mutex;
    std::map<std::thread::id, std::string> m_errors; ///< the first of each thread
};

} // namespace quarn
