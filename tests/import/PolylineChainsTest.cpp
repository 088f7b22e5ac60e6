#include "import/assembly/PolylineChains.h"

#include <gtest/gtest.h>

namespace quarn::test {
namespace {

KM_3dPoint at(double x, double y = 0.0) {
    return {x, y, 0.0};
}

TEST(PolylineChains, SegmentsThatFollowEachOtherAreOnePolyline) {
    const LineSegment segments[] = {{at(0), at(1)}, {at(1), at(2)}, {at(2), at(5)}};
    const auto polylines = joinSegments(segments);
    ASSERT_EQ(polylines.size(), 1U);
    ASSERT_EQ(polylines[0].Count(), 4);
    EXPECT_EQ(polylines[0][3], at(5));
}

TEST(PolylineChains, ScatteredAndReversedSegmentsAreJoinedInTheDirectionOfTheFirst) {
    const LineSegment segments[] = {{at(1), at(2)}, {at(4), at(3)}, {at(0), at(1)}, {at(3), at(2)}};
    const auto polylines = joinSegments(segments);
    ASSERT_EQ(polylines.size(), 1U);
    ASSERT_EQ(polylines[0].Count(), 5);
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(polylines[0][i], at(i));
    }
}

TEST(PolylineChains, LoopIsClosed) {
    const LineSegment segments[] = {{at(0), at(1)}, {at(1), at(1, 1)}, {at(1, 1), at(0)}};
    const auto polylines = joinSegments(segments);
    ASSERT_EQ(polylines.size(), 1U);
    ASSERT_EQ(polylines[0].Count(), 4);
    EXPECT_EQ(polylines[0][0], polylines[0][3]);
}

TEST(PolylineChains, PolylinesEndAtABranching) {
    const LineSegment segments[] = {{at(0), at(1)}, {at(2), at(1)}, {at(1, 5), at(1)}};
    EXPECT_EQ(joinSegments(segments).size(), 3U);
}

TEST(PolylineChains, RunThatComesBackToItsStartIsClosedThere) {
    const LineSegment segments[] = {{at(0), at(1)},
                                    {at(1), at(1, 1)},
                                    {at(1, 1), at(0, 1)},
                                    {at(0, 1), at(0)},
                                    {at(0), at(-1)}};
    const auto polylines = joinSegments(segments);
    // The run closes at its start; what goes on from there is a polyline of its own.
    ASSERT_EQ(polylines.size(), 2U);
    EXPECT_EQ(polylines[0].Count(), 5);
    EXPECT_EQ(polylines[1].Count(), 2);
}

TEST(PolylineChains, SegmentsOfNoLengthAreLeftOut) {
    const LineSegment segments[] = {{at(0), at(0)}, {at(0), at(1)}, {at(1), at(1)}};
    const auto polylines = joinSegments(segments);
    ASSERT_EQ(polylines.size(), 1U);
    EXPECT_EQ(polylines[0].Count(), 2);
}

} // namespace
} // namespace quarn::test
