// The cubic spline through given points, by its second derivatives m at them. With the parameter
// steps h[k] = u[k+1] - u[k] and the secants s[k] = (q[k+1] - q[k]) / h[k], the first derivative is
// continuous when
//   h[k-1] m[k-1] + 2 (h[k-1] + h[k]) m[k] + h[k] m[k+1] = 6 (s[k] - s[k-1])
// (C. de Boor, A Practical Guide to Splines, chapter IV). The system is diagonally dominant
// whatever the steps, so elimination needs no pivots. At its ends an open curve has m = 0; for a
// closed one the indices go round.

#include "kelmar/KM_NurbsCurve.h"

#include <utility>

namespace {

// The three diagonals of a system whose rows are dominated by their middles.
struct Tridiagonal {
    explicit Tridiagonal(std::size_t count) : below(count), middle(count), above(count) {}

    // Gauss elimination. below[0] and above[last] are not looked at.
    template <class Value> std::vector<Value> Solve(std::vector<Value> right) const {
        const std::size_t count = middle.size();
        std::vector<double> ratio(count);
        double pivot = middle[0];
        right[0] = right[0] / pivot;
        for (std::size_t i = 1; i < count; ++i) {
            ratio[i] = above[i - 1] / pivot;
            pivot = middle[i] - below[i] * ratio[i];
            right[i] = (right[i] - below[i] * right[i - 1]) / pivot;
        }
        for (std::size_t i = count - 1; i > 0; --i)
            right[i - 1] = right[i - 1] - ratio[i] * right[i];
        return right;
    }

    std::vector<double> below;
    std::vector<double> middle;
    std::vector<double> above;
};

// The points to pass, a parameter step apart; of a closed curve the first one stands last again.
struct PassedPoints {
    std::vector<KM_3dPoint> points;
    std::vector<double> steps;
    bool closed = false;

    std::size_t Before(std::size_t k) const { return k > 0 ? k - 1 : steps.size() - 1; }
    KM_3dVector Secant(std::size_t k) const { return (points[k + 1] - points[k]) / steps[k]; }
    // Steps beside a point; beyond the ends of an open curve there are none.
    double StepAfter(std::size_t k) const { return k < steps.size() ? steps[k] : 0.0; }
    double StepBefore(std::size_t k) const { return k > 0 || closed ? steps[Before(k)] : 0.0; }
};

// Steps are the distances of the points: the chord length parameters of L. Piegl and W. Tiller, The
// NURBS Book (2nd edition), equations 9.4 and 9.5, without dividing by the whole length.
// Returns false when neighbours coincide.
bool takeChordSteps(PassedPoints& passed) {
    for (std::size_t k = 0; k + 1 < passed.points.size(); ++k) {
        const double chord = passed.points[k].DistanceTo(passed.points[k + 1]);
        if (!KM_IsValid(chord) || !(chord > 0.0))
            return false;
        passed.steps.push_back(chord);
    }
    return true;
}

KM_3dVector bend(const PassedPoints& passed, std::size_t k) {
    return 6.0 * (passed.Secant(k) - passed.Secant(passed.Before(k)));
}

std::vector<KM_3dVector> openSecondDerivatives(const PassedPoints& passed) {
    const std::size_t count = passed.points.size();
    Tridiagonal system(count);
    std::vector<KM_3dVector> right(count, KM_3dVector::ZeroVector);
    system.middle.front() = 1.0;
    system.middle.back() = 1.0;
    for (std::size_t k = 1; k + 1 < count; ++k) {
        system.below[k] = passed.steps[k - 1];
        system.middle[k] = 2.0 * (passed.steps[k - 1] + passed.steps[k]);
        system.above[k] = passed.steps[k];
        right[k] = bend(passed, k);
    }
    return system.Solve(std::move(right));
}

// The two entries in the corners of the cyclic system are taken out of it and put back by the
// formula of Sherman and Morrison (G. H. Golub and C. F. Van Loan, Matrix Computations).
std::vector<KM_3dVector> closedSecondDerivatives(const PassedPoints& passed) {
    const std::size_t count = passed.steps.size();
    Tridiagonal system(count);
    std::vector<KM_3dVector> right(count);
    for (std::size_t k = 0; k < count; ++k) {
        system.below[k] = passed.StepBefore(k);
        system.middle[k] = 2.0 * (passed.StepBefore(k) + passed.steps[k]);
        system.above[k] = passed.steps[k];
        right[k] = bend(passed, k);
    }
    const double corner = passed.steps.back();
    const double shift = system.middle.front();
    system.middle.front() += shift;
    system.middle.back() += corner * corner / shift;
    std::vector<double> column(count, 0.0);
    column.front() = -shift;
    column.back() = corner;
    std::vector<KM_3dVector> second = system.Solve(std::move(right));
    const std::vector<double> change = system.Solve(std::move(column));
    const double ratio = -corner / shift;
    const KM_3dVector factor =
        (second.front() + ratio * second.back()) / (1.0 + change.front() + ratio * change.back());
    for (std::size_t k = 0; k < count; ++k)
        second[k] = second[k] - change[k] * factor;
    second.push_back(second.front());
    return second;
}

// The control point that belongs to a passed point: the blossom of the cubic piece beside it at the
// three knots around it (L. Ramshaw, Blossoms are polar forms, CAGD 6 (1989)).
KM_3dPoint controlPoint(const PassedPoints& passed, const std::vector<KM_3dVector>& second,
                        std::size_t k) {
    const double before = passed.StepBefore(k);
    const double after = passed.StepAfter(k);
    const std::size_t piece = k < passed.steps.size() ? k : k - 1;
    const double step = passed.steps[piece];
    const KM_3dVector first =
        k == piece ? passed.Secant(piece) - step / 6.0 * (2.0 * second[k] + second[k + 1])
                   : passed.Secant(piece) + step / 6.0 * (2.0 * second[k] + second[k - 1]);
    return passed.points[k] + (after - before) / 3.0 * first - before * after / 6.0 * second[k];
}

// The parameters of the passed points, with two more knots at either end: those of the neighbouring
// turn when the curve is closed, else the end again.
std::vector<double> knotsOf(const PassedPoints& passed) {
    const std::size_t pieces = passed.steps.size();
    std::vector<double> knots(pieces + 5, 0.0);
    for (std::size_t k = 0; k < pieces; ++k)
        knots[k + 3] = knots[k + 2] + passed.steps[k];
    const double length = knots[pieces + 2];
    for (std::size_t i = 0; i < 2; ++i) {
        knots[i] = passed.closed ? knots[pieces + i] - length : 0.0;
        knots[pieces + 3 + i] = passed.closed ? knots[3 + i] + length : length;
    }
    return knots;
}

} // namespace

bool KM_NurbsCurve::CreateCubicThroughPoints(std::span<const KM_3dPoint> points, bool closed) {
    if (points.size() < (closed ? 3U : 2U))
        return false;
    PassedPoints passed{{points.begin(), points.end()}, {}, closed};
    if (closed)
        passed.points.push_back(points.front());
    if (!takeChordSteps(passed))
        return false;
    const std::vector<KM_3dVector> second =
        closed ? closedSecondDerivatives(passed) : openSecondDerivatives(passed);

    const std::size_t pieces = passed.steps.size();
    KM_NurbsCurve curve;
    if (!curve.Create(3, false, 4, static_cast<int>(pieces) + 3))
        return false;
    // Control point i belongs to the passed point i - 1.
    for (std::size_t i = 0; i < pieces + 3; ++i) {
        const bool is_end = i == 0 || i == pieces + 2;
        const std::size_t k = closed ? (i + pieces - 1) % pieces : i - 1;
        curve.m_points[i] = !closed && is_end ? (i == 0 ? points.front() : points.back())
                                              : controlPoint(passed, second, k);
    }
    curve.m_knots = knotsOf(passed);
    if (!curve.IsValid())
        return false;
    *this = curve;
    return true;
}
