#pragma once

#include <gtest/gtest.h>

#include <string>

namespace quarn::test {

/// Every way in which the program makes frames, by the name that its options have for it.
inline auto everyWayOfCapture() {
    return testing::Values("Wireframe", "Shaded", "Rendered", "Translucent", "X-Ray", "Drawing",
                           "Clay", "RenderFull", "RenderPreview");
}

/// The name of the test with a way of capture as its parameter.
inline std::string nameOfWay(const testing::TestParamInfo<const char*>& way) {
    std::string name = way.param;
    std::erase(name, '-');
    return name;
}

} // namespace quarn::test
