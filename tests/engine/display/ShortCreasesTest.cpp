#include "engine/display/MeshEdges.h"
#include "kelmar/KM_Mesh.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

constexpr int cells = 20; // of 0.5 by 0.5: the sheet is 10 by 10, its diagonal 14.1
constexpr std::size_t border_edges = 4 * cells;

/// A flat sheet with a ridge along its middle, 0.14 high: its sides rise by 0.28, so they meet at
/// 31 degrees, a crease; what leads up to it and down at its ends turns by less than 22 degrees.
/// @param first, last  the rows of vertices that are raised
KM_Mesh ridgedSheet(int first, int last) {
    KM_Mesh mesh;
    for (int j = 0; j <= cells; ++j)
        for (int i = 0; i <= cells; ++i) {
            const bool raised = i == cells / 2 && j >= first && j <= last;
            mesh.m_V.emplace_back(0.5F * static_cast<float>(i), 0.5F * static_cast<float>(j),
                                  raised ? 0.14F : 0.0F);
        }
    const auto side = static_cast<std::uint32_t>(cells + 1);
    for (std::uint32_t j = 0; j + 1 < side; ++j)
        for (std::uint32_t i = 0; i + 1 < side; ++i) {
            const std::uint32_t a = j * side + i;
            mesh.m_F.push_back({{a, a + 1, a + side + 1}});
            mesh.m_F.push_back({{a, a + side + 1, a + side}});
        }
    return mesh;
}

// Raised rows 4 to 16 make a crease of 12 edges, 6 long: more than a quarter of the diagonal, 3.5.
TEST(ShortCreases, ALongRidgeIsDrawn) {
    EXPECT_EQ(MeshEdges(ridgedSheet(4, 16)).features().size(), border_edges + 12);
}

TEST(ShortCreases, AShortRidgeIsAnAccidentOfTheTriangles) {
    const MeshEdges edges(ridgedSheet(9, 11)); // 2 edges, 1 long
    EXPECT_EQ(edges.features().size(), border_edges);
}

TEST(ShortCreases, WhatIsDroppedStillShowsAsAnOutline) {
    const std::size_t without_ridge = MeshEdges(ridgedSheet(1, 0)).smooth().size();
    EXPECT_EQ(without_ridge, 0U);
    const MeshEdges edges(ridgedSheet(9, 11));
    const auto middle = static_cast<std::uint32_t>(cells / 2);
    std::size_t along_ridge = 0;
    for (const MeshEdges::Edge& edge : edges.smooth())
        along_ridge += edge.from % (cells + 1) == middle && edge.to % (cells + 1) == middle;
    EXPECT_EQ(along_ridge, 4U);
}

TEST(ShortCreases, AShortRidgeThatEndsAtABorderIsDrawn) {
    EXPECT_EQ(MeshEdges(ridgedSheet(0, 2)).features().size(), border_edges + 2);
}

} // namespace
} // namespace quarn
