#pragma once

namespace quarn {

/// How a mesh that several objects share stands in the coordinates of the frame. Rows come first.
struct SurfacePlace {
    float linear[3][3];    ///< turns and stretches vectors of the mesh
    float cofactors[3][3]; ///< turns normals; the largest is about 1, so that squares are floats
    float area_scale;      ///< times this they stretch areas too
    float hand; ///< 1; -1 where it mirrors: then fronts of triangles are what else were their backs
};

/// The matrix times the vector.
inline void turn(const float (&matrix)[3][3], const float (&vector)[3], float (&turned)[3]) {
    for (int i = 0; i < 3; ++i)
        turned[i] = matrix[i][0] * vector[0] + matrix[i][1] * vector[1] + matrix[i][2] * vector[2];
}

} // namespace quarn
