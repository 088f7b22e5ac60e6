#pragma once

#include <embree3/rtcore.h>

#include <utility>

namespace quarn {

/// Owns one reference to an object of the ray tracing library.
template <class T, void (*release)(T)> class RayHandle {
public:
    RayHandle() = default;
    explicit RayHandle(T object) : m_object(object) {}
    RayHandle(RayHandle&& other) noexcept : m_object(std::exchange(other.m_object, nullptr)) {}
    RayHandle& operator=(RayHandle&& other) noexcept {
        std::swap(m_object, other.m_object);
        return *this;
    }
    ~RayHandle() {
        if (m_object)
            release(m_object);
    }

    T get() const { return m_object; }
    explicit operator bool() const { return m_object != nullptr; }

private:
    T m_object = nullptr;
};

using RayDevice = RayHandle<RTCDevice, rtcReleaseDevice>;
using RaySceneHandle = RayHandle<RTCScene, rtcReleaseScene>;
using RayGeometry = RayHandle<RTCGeometry, rtcReleaseGeometry>;

} // namespace quarn
