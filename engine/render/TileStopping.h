#pragma once

#include "engine/render/RenderLayers.h"

#include <vector>

namespace quarn {

/// Finds the tiles of a picture that need no more samples, by what the sums tell: the halves of a
/// pixel's samples differ by about as much as all of them are wrong (compare F. Rousselle,
/// C. Knaus and M. Zwicker, "Adaptive Sampling and Reconstruction using Greedy Error
/// Minimization", ACM Transactions on Graphics 30(6), 2011). So which tiles stop follows from the
/// samples alone, whoever took them.
class TileStopping {
public:
    /// @param samples  the most that a pixel gets: the more, the smaller the error that may be left
    TileStopping(RenderLayers& layers, int samples);

    /// Stops every tile whose error, and that of the tiles around it, is small enough. All tiles
    /// that are not done have the same number of samples, at least two.
    /// @return whether a tile is left
    bool stopGoodTiles();

private:
    float errorOf(std::size_t tile) const;
    std::size_t tileAt(int column, int row) const;
    float errorAround(int column, int row) const;

    RenderLayers& m_layers;
    int m_columns;
    int m_rows;
    float m_tolerance; ///< squared steps of 255
    std::vector<float> m_errors;
};

} // namespace quarn
