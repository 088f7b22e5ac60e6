#pragma once

#include <algorithm>
#include <cmath>

namespace quarn {

/// Equations of a symmetric matrix without negative eigenvalues, for three right sides at once.
template <int size> struct SmallSystem {
    double matrix[size][size]; ///< what stands on the diagonal and below it counts
    double right[size][3];

    /// Puts the solutions in place of the right sides (Cholesky's method, G. Golub and C. Van Loan,
    /// "Matrix Computations", section 4.2). Spoils the matrix.
    void solve() {
        for (int i = 0; i < size; ++i) {
            factorRow(i);
            for (double& side : right[i]) {
                const auto c = &side - right[i];
                for (int k = 0; k < i; ++k)
                    side -= matrix[i][k] * right[k][c];
                side /= matrix[i][i];
            }
        }
        for (int i = size - 1; i >= 0; --i)
            for (double& side : right[i]) {
                const auto c = &side - right[i];
                for (int k = i + 1; k < size; ++k)
                    side -= matrix[k][i] * right[k][c];
                side /= matrix[i][i];
            }
    }

private:
    static constexpr double least_pivot = 1e-30;

    void factorRow(int i) {
        for (int j = 0; j < i; ++j) {
            for (int k = 0; k < j; ++k)
                matrix[i][j] -= matrix[i][k] * matrix[j][k];
            matrix[i][j] /= matrix[j][j];
            matrix[i][i] -= matrix[i][j] * matrix[i][j];
        }
        matrix[i][i] = std::sqrt(std::max(matrix[i][i], least_pivot));
    }
};

} // namespace quarn
