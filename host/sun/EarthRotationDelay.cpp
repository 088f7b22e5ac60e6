#include "host/sun/EarthRotationDelay.h"

#include <algorithm>
#include <iterator>

namespace quarn {
namespace {

/// A polynomial in the years since `origin`, lowest power first.
struct Expression {
    double end_year;
    double origin;
    double coefficients[8];
};

constexpr Expression EXPRESSIONS[] = {
    {1860,
     1800,
     {13.72, -0.332447, 0.0068612, 0.0041116, -0.00037436, 0.0000121272, -0.0000001699,
      0.000000000875}},
    {1900, 1860, {7.62, 0.5737, -0.251754, 0.01680668, -0.0004473624, 1.0 / 233174}},
    {1920, 1900, {-2.79, 1.494119, -0.0598939, 0.0061966, -0.000197}},
    {1941, 1920, {21.20, 0.84493, -0.076100, 0.0020936}},
    {1961, 1950, {29.07, 0.407, -1.0 / 233, 1.0 / 2547}},
    {1986, 1975, {45.45, 1.067, -1.0 / 260, -1.0 / 718}},
    {2005, 2000, {63.86, 0.3345, -0.060374, 0.0017275, 0.000651814, 0.00002373599}},
    {2050, 2000, {62.92, 0.32217, 0.005589}},
};

double valueAt(const Expression& expression, double year) {
    const double years = year - expression.origin;
    double value = 0;
    for (auto power = std::rbegin(expression.coefficients);
         power != std::rend(expression.coefficients); ++power)
        value = value * years + *power;
    return value;
}

/// The long-term parabola, which the years up to 2150 approach step by step.
double predicted_s(double year) {
    const double centuries = (year - 1820) / 100;
    return -20 + 32 * centuries * centuries - 0.5628 * std::max(0.0, 2150 - year);
}

} // namespace

double earthRotationDelay_s(double year) {
    const auto expression = std::ranges::find_if(
        EXPRESSIONS, [&](const Expression& candidate) { return year < candidate.end_year; });
    return expression == std::end(EXPRESSIONS) ? predicted_s(year) : valueAt(*expression, year);
}

} // namespace quarn
