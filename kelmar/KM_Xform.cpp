#include "kelmar/KM_Xform.h"

#include "kelmar/KM_Plane.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

namespace {

constexpr double epsilon = std::numeric_limits<double>::epsilon();

// Gauss-Jordan elimination with full pivoting on the upper left n by n part of `source`.
// A pivot that is only the rounding of its row means that there is no inverse.
class Inversion {
public:
    Inversion(const KM_Xform& source, int n) : m_n(n) {
        for (int row = 0; row < n; ++row) {
            std::copy_n(source.m_xform[row], n, m_left[row]);
            std::fill_n(m_right[row], n, 0.0);
            m_right[row][row] = 1.0;
            for (int column = 0; column < n; ++column)
                m_row_size[row] = std::max(m_row_size[row], std::abs(m_left[row][column]));
        }
    }

    bool Run() {
        for (int step = 0; step < m_n; ++step) {
            if (!bringPivot(step))
                return false;
            eliminate(step);
        }
        return true;
    }

    // Row `step` of the result belongs to the column that was eliminated in that step.
    double At(int row, int column) const {
        const int step = static_cast<int>(std::find(m_column, m_column + m_n, row) - m_column);
        return m_right[step][column];
    }

private:
    bool bringPivot(int step) {
        int best_row = -1;
        double largest = 0.0;
        for (int row = step; row < m_n; ++row) {
            for (int column = 0; column < m_n; ++column) {
                const double size = std::abs(m_left[row][column]);
                if (!m_used[column] && size > largest) {
                    largest = size;
                    best_row = row;
                    m_column[step] = column;
                }
            }
        }
        if (best_row < 0 || largest <= 16.0 * epsilon * m_row_size[best_row])
            return false;
        m_used[m_column[step]] = true;
        std::swap(m_left[step], m_left[best_row]);
        std::swap(m_right[step], m_right[best_row]);
        std::swap(m_row_size[step], m_row_size[best_row]);
        return true;
    }

    void eliminate(int step) {
        const double pivot = m_left[step][m_column[step]];
        for (int i = 0; i < m_n; ++i) {
            m_left[step][i] /= pivot;
            m_right[step][i] /= pivot;
        }
        for (int row = 0; row < m_n; ++row) {
            const double factor = m_left[row][m_column[step]];
            if (row == step || factor == 0.0)
                continue;
            for (int i = 0; i < m_n; ++i) {
                m_left[row][i] -= factor * m_left[step][i];
                m_right[row][i] -= factor * m_right[step][i];
            }
        }
    }

    int m_n;
    double m_left[4][4] = {};
    double m_right[4][4] = {};
    double m_row_size[4] = {};
    int m_column[4] = {-1, -1, -1, -1};
    bool m_used[4] = {};
};

// What an affine matrix adds so that `fixed` stays where it is: (1 - linear part) * fixed.
void keepFixed(KM_Xform& xform, const KM_3dPoint& fixed) {
    const double p[3] = {fixed.x, fixed.y, fixed.z};
    for (int row = 0; row < 3; ++row) {
        double shift = 0.0;
        for (int column = 0; column < 3; ++column)
            shift += ((row == column ? 1.0 : 0.0) - xform.m_xform[row][column]) * p[column];
        xform.m_xform[row][3] = shift;
    }
}

double minor3(const double m[4][4], int skipped_column) {
    int c[3] = {};
    for (int i = 0, column = 0; column < 4; ++column) {
        if (column != skipped_column)
            c[i++] = column;
    }
    return m[1][c[0]] * (m[2][c[1]] * m[3][c[2]] - m[2][c[2]] * m[3][c[1]]) -
           m[1][c[1]] * (m[2][c[0]] * m[3][c[2]] - m[2][c[2]] * m[3][c[0]]) +
           m[1][c[2]] * (m[2][c[0]] * m[3][c[1]] - m[2][c[1]] * m[3][c[0]]);
}

} // namespace

KM_Xform KM_Xform::Identity() {
    return {};
}

KM_Xform KM_Xform::Translation(const KM_3dVector& delta) {
    KM_Xform xform;
    xform.m_xform[0][3] = delta.x;
    xform.m_xform[1][3] = delta.y;
    xform.m_xform[2][3] = delta.z;
    return xform;
}

KM_Xform KM_Xform::Translation(double dx, double dy, double dz) {
    return Translation(KM_3dVector(dx, dy, dz));
}

KM_Xform KM_Xform::Scale(const KM_3dPoint& center, double factor) {
    KM_Xform xform = Diagonal(factor, factor, factor);
    keepFixed(xform, center);
    return xform;
}

KM_Xform KM_Xform::Diagonal(double x, double y, double z) {
    KM_Xform xform;
    xform.m_xform[0][0] = x;
    xform.m_xform[1][1] = y;
    xform.m_xform[2][2] = z;
    return xform;
}

KM_Xform KM_Xform::Rotation(double angle, const KM_3dVector& axis, const KM_3dPoint& center) {
    double sine = std::sin(angle);
    double cosine = std::cos(angle);
    // Pi is not a floating-point number: up to a whole turn its multiples miss by less than this.
    constexpr double miss = 2.5e-16;
    if (std::abs(sine) < miss) {
        sine = 0.0;
        cosine = cosine < 0.0 ? -1.0 : 1.0;
    } else if (std::abs(cosine) < miss) {
        sine = sine < 0.0 ? -1.0 : 1.0;
        cosine = 0.0;
    }
    return Rotation(sine, cosine, axis, center);
}

KM_Xform KM_Xform::Rotation(double sin_angle, double cos_angle, const KM_3dVector& axis,
                            const KM_3dPoint& center) {
    KM_3dVector k = axis;
    KM_3dVector pair(cos_angle, sin_angle, 0.0);
    if (!center.IsValid() || !k.Unitize() || !pair.IsValid() || pair.IsZero())
        return Identity();
    if (std::abs(pair.LengthSquared() - 1.0) > 4.0 * epsilon)
        pair.Unitize();
    const double c = pair.x;
    const double s = pair.y;
    const double v = 1.0 - c;

    KM_Xform xform;
    auto& m = xform.m_xform;
    // The diagonal is written so that a rotation about a world axis leaves that axis exactly alone.
    m[0][0] = 1.0 - v * (k.y * k.y + k.z * k.z);
    m[0][1] = v * k.x * k.y - s * k.z;
    m[0][2] = v * k.x * k.z + s * k.y;
    m[1][0] = v * k.x * k.y + s * k.z;
    m[1][1] = 1.0 - v * (k.x * k.x + k.z * k.z);
    m[1][2] = v * k.y * k.z - s * k.x;
    m[2][0] = v * k.x * k.z - s * k.y;
    m[2][1] = v * k.y * k.z + s * k.x;
    m[2][2] = 1.0 - v * (k.x * k.x + k.y * k.y);
    keepFixed(xform, center);
    return xform;
}

KM_Xform KM_Xform::Rotation(const KM_3dVector& start_direction, const KM_3dVector& end_direction,
                            const KM_3dPoint& center) {
    constexpr double same = 2e-15;
    KM_3dVector start = start_direction;
    KM_3dVector end = end_direction;
    if (!start.Unitize() || !end.Unitize() || (end - start).Length() <= same)
        return Identity();
    // Adding or subtracting the start does not change the cross product, but near a straight angle
    // or none it keeps the digits that the product of the full vectors would cancel.
    const double cosine = start * end;
    const KM_3dVector difference = cosine < 0.0 ? end + start : end - start;
    const KM_3dVector axis = KM_CrossProduct(start, difference);
    if (difference.Length() > same)
        return Rotation(axis.Length(), cosine, axis, center);

    KM_3dVector half_turn_axis;
    if (std::abs(start.z) <= same && std::abs(end.z) <= same)
        half_turn_axis = KM_3dVector::ZAxis;
    else
        half_turn_axis.PerpendicularTo(start);
    return Rotation(0.0, -1.0, half_turn_axis, center);
}

KM_Xform KM_Xform::PlanarProjection(const KM_Plane& plane) {
    const KM_3dVector& normal = plane.zaxis;
    const double n[3] = {normal.x, normal.y, normal.z};
    const double height = normal * KM_3dVector(plane.origin);
    KM_Xform xform;
    for (int row = 0; row < 3; ++row) {
        for (int column = 0; column < 3; ++column)
            xform.m_xform[row][column] = (row == column ? 1.0 : 0.0) - n[row] * n[column];
        xform.m_xform[row][3] = n[row] * height;
    }
    return xform;
}

KM_Xform KM_Xform::operator*(const KM_Xform& right) const {
    KM_Xform product;
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < 4; ++column) {
            double sum = 0.0;
            for (int i = 0; i < 4; ++i)
                sum += m_xform[row][i] * right.m_xform[i][column];
            product.m_xform[row][column] = sum;
        }
    }
    return product;
}

KM_3dPoint KM_Xform::operator*(const KM_3dPoint& p) const {
    if (!p.IsValid())
        return KM_3dPoint::UnsetPoint;
    const auto row = [&](int i) {
        return m_xform[i][0] * p.x + m_xform[i][1] * p.y + m_xform[i][2] * p.z + m_xform[i][3];
    };
    const KM_3dPoint moved(row(0), row(1), row(2));
    const double w = row(3);
    if (w == 1.0)
        return moved;
    return w == 0.0 ? KM_3dPoint::UnsetPoint : moved / w;
}

KM_3dVector KM_Xform::operator*(const KM_3dVector& v) const {
    if (!v.IsValid())
        return KM_3dVector::UnsetVector;
    const auto row = [&](int i) {
        return m_xform[i][0] * v.x + m_xform[i][1] * v.y + m_xform[i][2] * v.z;
    };
    return {row(0), row(1), row(2)};
}

bool KM_Xform::IsValid() const {
    return std::all_of(&m_xform[0][0], &m_xform[0][0] + 16, KM_IsValid);
}

bool KM_Xform::IsAffine() const {
    return m_xform[3][0] == 0.0 && m_xform[3][1] == 0.0 && m_xform[3][2] == 0.0 &&
           m_xform[3][3] == 1.0;
}

bool KM_Xform::IsIdentity(double tolerance) const {
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < 4; ++column) {
            const double wanted = row == column ? 1.0 : 0.0;
            if (!(std::abs(m_xform[row][column] - wanted) <= tolerance))
                return false;
        }
    }
    return true;
}

double KM_Xform::Determinant() const {
    double sum = 0.0;
    for (int column = 0; column < 4; ++column) {
        const double term = m_xform[0][column] * minor3(m_xform, column);
        sum += column % 2 == 0 ? term : -term;
    }
    return sum;
}

bool KM_Xform::Invert() {
    if (!IsValid())
        return false;
    // An affine matrix is inverted by its linear part, so that a far translation costs no digits.
    const bool affine = IsAffine();
    const int n = affine ? 3 : 4;
    Inversion inversion(*this, n);
    if (!inversion.Run())
        return false;
    KM_Xform inverse;
    for (int row = 0; row < n; ++row) {
        for (int column = 0; column < n; ++column)
            inverse.m_xform[row][column] = inversion.At(row, column);
    }
    if (affine) {
        const KM_3dVector shift =
            inverse * -KM_3dVector(m_xform[0][3], m_xform[1][3], m_xform[2][3]);
        inverse = Translation(shift) * inverse;
    }
    if (!inverse.IsValid())
        return false;
    *this = inverse;
    return true;
}

void KM_Xform::Transpose() {
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < row; ++column)
            std::swap(m_xform[row][column], m_xform[column][row]);
    }
}
