#include "engine/display/RayLibrary.h"

#include "engine/display/InstructionSet.h"

#include <utility>

namespace quarn {

namespace {

/// What the library could not do, in words for the person and with what may help.
std::string sentenceFor(RTCError error, const char* message) {
    if (error == RTC_ERROR_UNSUPPORTED_CPU)
        return "The scene cannot be drawn: the ray tracing library does not run on this processor.";
    if (error == RTC_ERROR_OUT_OF_MEMORY || !message)
        return "The scene cannot be drawn: there is too little memory. Close other programs or "
               "hide "
               "objects.";
    return "The scene cannot be drawn: " + std::string(message) +
           ". Close other programs or hide objects.";
}

/// How the library is set up for a set of instructions. Left alone it goes by the model of the
/// processor in how wide its trees are, and what has the same instructions would draw differently.
const char* settingsFor(InstructionSet set) {
    switch (set) {
    case InstructionSet::avx512:
        return "isa=avx512,frequency_level=simd256";
    case InstructionSet::avx2:
        return "isa=avx2,frequency_level=simd256";
    case InstructionSet::sse2:
        break;
    }
    return "isa=sse2,frequency_level=simd128";
}

} // namespace

/// A processor that the library runs on lacks nothing but memory, or threads, which take some.
std::shared_ptr<RayLibrary> RayLibrary::start(std::string& why) {
    if (const RTCDevice device = rtcNewDevice(settingsFor(instructionSetInForce())))
        return std::make_shared<RayLibrary>(device);
    const RTCError error = rtcGetDeviceError(nullptr);
    why =
        sentenceFor(error == RTC_ERROR_UNSUPPORTED_CPU ? error : RTC_ERROR_OUT_OF_MEMORY, nullptr);
    return nullptr;
}

RayLibrary::RayLibrary(RTCDevice device) : m_device(device) {
    rtcSetDeviceErrorFunction(m_device, noteError, this);
}

RayLibrary::~RayLibrary() {
    if (!m_is_abandoned)
        rtcReleaseDevice(m_device);
}

std::string RayLibrary::takeError() {
    const std::lock_guard lock(m_mutex);
    const auto found = m_errors.find(std::this_thread::get_id());
    if (found == m_errors.end())
        return {};
    std::string error = std::move(found->second);
    m_errors.erase(found);
    return error;
}

/// The library calls it on the thread that asked it for what it could not do.
void RayLibrary::noteError(void* library, RTCError error, const char* message) {
    if (error == RTC_ERROR_CANCELLED)
        return;
    auto& noting = *static_cast<RayLibrary*>(library);
    const std::lock_guard lock(noting.m_mutex);
    noting.m_errors.try_emplace(std::this_thread::get_id(), sentenceFor(error, message));
}

} // namespace quarn
