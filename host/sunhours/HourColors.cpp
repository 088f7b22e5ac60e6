#include "host/sunhours/HourColors.h"

#include <algorithm>
#include <cmath>

namespace quarn {

KM_Color viridis(double share) {
    constexpr int LAST = 10;
    constexpr int COLORS[LAST + 1][3] = {{68, 1, 84},    {72, 36, 117},  {65, 68, 135},
                                         {53, 95, 141},  {42, 120, 142}, {33, 145, 140},
                                         {34, 168, 132}, {68, 191, 112}, {122, 209, 81},
                                         {189, 223, 38}, {253, 231, 37}};
    const double place = std::clamp(share, 0.0, 1.0) * LAST;
    const int low = std::min(static_cast<int>(place), LAST - 1);
    const auto channel = [&](int c) {
        const double mixed = COLORS[low][c] + (place - low) * (COLORS[low + 1][c] - COLORS[low][c]);
        return static_cast<unsigned char>(std::lround(mixed));
    };
    return {channel(0), channel(1), channel(2), 255};
}

double endOfScale(double hours) {
    return std::max(1.0, std::ceil(hours - 1e-6));
}

} // namespace quarn
