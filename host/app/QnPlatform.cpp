#include "sdk/qncore/QnPlatform.h"

#include "host/app/Application.h"

#include <chrono>
#include <limits>

short GetAsyncKeyState(int virtual_key) {
    quarn::Application* application = quarn::Application::forCall("GetAsyncKeyState");
    const bool down = application && application->frontEnd().isKeyDown(virtual_key);
    return down ? std::numeric_limits<short>::min() : short{0};
}

unsigned int GetTickCount() {
    const auto since_start = std::chrono::steady_clock::now().time_since_epoch();
    const auto now = static_cast<unsigned int>(
        std::chrono::duration_cast<std::chrono::milliseconds>(since_start).count());
    const quarn::Application* const application = quarn::Application::current();
    return application ? now + application->cutWaits() : now;
}
