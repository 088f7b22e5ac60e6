#pragma once

#include "host/curves/CurveMaking.h"

#include <string_view>
#include <vector>

namespace quarn {

/// What a curve file tells about its curve.
struct CurveDescription {
    static constexpr std::size_t MOST_POINTS = 1'000'000;

    int degree = 1;
    bool closed = false;
    std::vector<KM_3dPoint> points;
    std::vector<double> weights; ///< as many as points
};

/// "line 3: why"
Error errorInLine(std::size_t line, std::string_view why);

/// Reads lines of three numbers, after lines that set the degree or close the curve.
Result<CurveDescription> readCurveLines(std::string_view text);

/// Reads an object with "degree", "closed" and "points".
Result<CurveDescription> readCurveJson(std::string_view text);

} // namespace quarn
