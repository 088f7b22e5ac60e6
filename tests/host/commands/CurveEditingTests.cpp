#include "host/document/Document.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "tests/host/app/TestCommand.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

/// A document with a curve of each kind and a point.
class CurveEditingTest : public HostTest {
protected:
    CurveEditingTest() {
        for (const wchar_t* line :
             {L"_-Line _Name Edge 0,0,0 1,0,0", L"_-Polyline _Name Walk 0,0,0 5,0,0 5,5,0",
              L"_-Polyline _Name Yard 0,0,0 5,0,0 5,5,0 _Close",
              L"_-Spline _Name Way 0,0,0 0,9,0 9,9,0 9,0,0 5,5,5",
              L"_-Spline _Name Loop 0,0,0 9,0,0 9,9,0 0,9,0 _Close", L"_-Circle _Name Ring 0,0,0 5",
              L"_-Point _Name Mark 1,1,1"})
            EXPECT_EQ(run(line), CQuarnCommand::success);
        front_end.clearPrinted();
    }

    ObjectTable& objects() { return Document::of(session.document()).objects(); }
    const DocumentObject& object(const wchar_t* name) { return *objects().findByName(name); }
    template <class Curve> const Curve& curve(const wchar_t* name) {
        return dynamic_cast<const Curve&>(*object(name).curve);
    }

    void expectRefused(const wchar_t* line, CQuarnCommand::result result, const char* message) {
        front_end.clearPrinted();
        const std::uint64_t revision = objects().revision();
        EXPECT_EQ(run(line), result) << KM_wString(line).ToUtf8();
        EXPECT_EQ(objects().revision(), revision) << KM_wString(line).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr(message));
    }
};

// ---- MovePoint

TEST_F(CurveEditingTest, AMovedCornerLeavesTheOthersAndTheObject) {
    const KM_UUID id = object(L"Walk").id;
    const std::uint64_t revision = objects().revision();
    ASSERT_EQ(run(L"_-MovePoint Walk 1 5,0,3"), CQuarnCommand::success);
    const auto& walk = curve<KM_PolylineCurve>(L"Walk");
    EXPECT_EQ(walk.Points(), (KM_3dPointArray{{0, 0, 0}, {5, 0, 3}, {5, 5, 0}}));
    EXPECT_EQ(object(L"Walk").id, id);
    EXPECT_GT(objects().revision(), revision) << "nobody would draw it again";
    EXPECT_THAT(printed(), HasSubstr("Walk: polyline, length 11.6619.\n")); // twice the root of 34
}

TEST_F(CurveEditingTest, EndsOfALineAndControlPointsMove) {
    ASSERT_EQ(run(L"_-MovePoint Edge 1 0,7,0"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_LineCurve>(L"Edge").m_line.to, KM_3dPoint(0, 7, 0));
    ASSERT_EQ(run(L"_-MovePoint Edge 0 0,6,0"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_LineCurve>(L"Edge").m_line.from, KM_3dPoint(0, 6, 0));
    ASSERT_EQ(run(L"_-MovePoint Way 4 1,2,3"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_NurbsCurve>(L"Way").PointAtEnd(), KM_3dPoint(1, 2, 3));
    EXPECT_EQ(curve<KM_NurbsCurve>(L"Way").PointAtStart(), KM_3dPoint(0, 0, 0));
}

TEST_F(CurveEditingTest, ClosedCurvesStayClosed) {
    ASSERT_EQ(run(L"_-MovePoint Yard 0 -1,-1,0"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-MovePoint Ring 0 7,0,0"), CQuarnCommand::success);
    for (const wchar_t* line :
         {L"_-MovePoint Loop 0 -5,-5,0", L"_-MovePoint Loop 2 9,9,3", L"_-MovePoint Loop 3 0,9,1"})
        ASSERT_EQ(run(line), CQuarnCommand::success);
    for (const wchar_t* name : {L"Yard", L"Ring", L"Loop"})
        EXPECT_TRUE(object(name).curve->IsClosed());
    const auto& loop = curve<KM_NurbsCurve>(L"Loop");
    const KM_Interval domain = loop.Domain();
    EXPECT_LT((loop.DerivativeAt(domain.Min()) - loop.DerivativeAt(domain.Max())).Length(), 1e-12);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Yard").PointAtEnd(), KM_3dPoint(-1, -1, 0));
    EXPECT_EQ(curve<KM_NurbsCurve>(L"Ring").PointAtEnd(), KM_3dPoint(7, 0, 0));
}

TEST_F(CurveEditingTest, PointsThatStandTwiceInAClosedCurveCountOnce) {
    // Each has one point less than the number that is refused.
    expectRefused(L"_-MovePoint Yard 3 1,1,1", CQuarnCommand::cancel, "a number from 0 to 2");
    expectRefused(L"_-MovePoint Loop 4 1,1,1", CQuarnCommand::cancel, "a number from 0 to 3");
    expectRefused(L"_-MovePoint Ring 8 1,1,1", CQuarnCommand::cancel, "a number from 0 to 7");
    expectRefused(L"_-MovePoint Walk 3 1,1,1", CQuarnCommand::cancel, "a number from 0 to 2");
    expectRefused(L"_-MovePoint Way 5 1,1,1", CQuarnCommand::cancel, "a number from 0 to 4");
    expectRefused(L"_-MovePoint Edge 2 1,1,1", CQuarnCommand::cancel, "a number from 0 to 1");
}

TEST_F(CurveEditingTest, APointObjectMovesWithoutANumber) {
    ASSERT_EQ(run(L"_-MovePoint Mark 4,5,6"), CQuarnCommand::success);
    EXPECT_EQ(*object(L"Mark").point, KM_3dPoint(4, 5, 6));
    EXPECT_EQ(printed(), "Mark: point at 4,5,6.\n");
}

TEST_F(CurveEditingTest, TheSelectedCurveIsTaken) {
    run(L"_-Select Walk");
    front_end.addAnswer(L"0");
    front_end.addAnswer(L"0,0,1");
    ASSERT_EQ(run(L"MovePoint"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Walk").PointAtStart(), KM_3dPoint(0, 0, 1));
}

TEST_F(CurveEditingTest, MovesThatMakeNoCurveAreRefused) {
    expectRefused(L"_-MovePoint Walk 1 0,0,0", CQuarnCommand::failure, "where its neighbour is");
    expectRefused(L"_-MovePoint Yard 0 5,5,0", CQuarnCommand::failure, "where its neighbour is");
    expectRefused(L"_-MovePoint Edge 0 1,0,0", CQuarnCommand::failure, "where its neighbour is");
    expectRefused(L"_-MovePoint Walk -1 0,0,1", CQuarnCommand::cancel, "from 0 to 2");
    expectRefused(L"_-MovePoint Walk one 0,0,1", CQuarnCommand::cancel, "Enter a whole number");
    expectRefused(L"_-MovePoint Walk 1 0,0", CQuarnCommand::failure, "\"0,0\" is no point");
    expectRefused(L"_-MovePoint Walk 1 0,0,nan", CQuarnCommand::failure, "is no point");
    expectRefused(L"_-MovePoint Walk 1", CQuarnCommand::cancel, "needs an answer to \"New place\"");
    expectRefused(L"_-MovePoint Walk", CQuarnCommand::cancel, "\"Number of the point, from 0\"");
    expectRefused(L"_-MovePoint Nothing 1 0,0,0", CQuarnCommand::cancel, "There is no object");
    expectRefused(L"_-MovePoint", CQuarnCommand::cancel, "\"Curve or point to change\"");
}

// ---- EvenSpeed

TEST_F(CurveEditingTest, EvenSpeedKeepsTheObjectAndMakesItsParameterItsLength) {
    const KM_UUID id = object(L"Ring").id;
    objects().select(id);
    objects().setVisible(object(L"Ring").id, false);
    const std::uint64_t revision = objects().revision();
    ASSERT_EQ(run(L"_-EvenSpeed Ring"), CQuarnCommand::success);
    const DocumentObject& ring = object(L"Ring");
    EXPECT_EQ(ring.id, id);
    EXPECT_FALSE(ring.visible);
    EXPECT_TRUE(ring.selected);
    EXPECT_GT(objects().revision(), revision);
    EXPECT_NEAR(ring.curve->Domain().Length(), 10.0 * KM_PI, 1e-6);
    // A sixth of the way round is at 60 degrees.
    const KM_3dPoint sixth = ring.curve->PointAt(ring.curve->Domain().ParameterAt(1.0 / 6.0));
    EXPECT_LT(sixth.DistanceTo({2.5, 4.330127018922193, 0}), 1e-3);
    EXPECT_EQ(printed(), "Ring: NURBS curve, closed, length 31.4159.\n");
}

TEST_F(CurveEditingTest, EvenSpeedStaysWithinAHundredThousandthOfTheCurve) {
    ASSERT_EQ(run(L"_-EvenSpeed Ring"), CQuarnCommand::success);
    const double allowed = 1e-5 * 10.0 * std::sqrt(2.0);
    for (int i = 0; i <= 1000; ++i) {
        const KM_Curve& ring = *object(L"Ring").curve;
        const KM_3dPoint point = ring.PointAt(ring.Domain().ParameterAt(i / 1000.0));
        EXPECT_NEAR(point.DistanceTo({0, 0, 0}), 5.0, allowed);
    }
}

TEST_F(CurveEditingTest, EvenSpeedTwiceIsEvenSpeed) {
    for (int i = 0; i < 2; ++i)
        ASSERT_EQ(run(L"_-EvenSpeed Way"), CQuarnCommand::success);
    double length = 0.0;
    object(L"Way").curve->GetLength(&length);
    EXPECT_NEAR(object(L"Way").curve->Domain().Length(), length, 1e-4 * length);
}

TEST_F(CurveEditingTest, EvenSpeedRefusesWhatIsNoCurve) {
    expectRefused(L"_-EvenSpeed Mark", CQuarnCommand::cancel, "Mark is a point; pick a curve");
    expectRefused(L"_-EvenSpeed Nothing", CQuarnCommand::cancel, "There is no object");
    expectRefused(L"_-EvenSpeed", CQuarnCommand::cancel, "needs an answer");
    objects().addCurve(L"Dot", std::make_unique<KM_LineCurve>());
    expectRefused(L"_-EvenSpeed Dot", CQuarnCommand::failure, "Dot: The curve has no extent");
}

} // namespace
} // namespace quarn::test
