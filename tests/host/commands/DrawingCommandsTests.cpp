#include "host/document/Document.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "tests/host/app/TestCommand.h"

#include <gmock/gmock.h>

#include <cmath>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class DrawingCommandsTest : public HostTest {
protected:
    ObjectTable& objects() { return Document::of(session.document()).objects(); }
    const DocumentObject& object(const wchar_t* name) { return *objects().findByName(name); }

    /// The curve of the object, or one that is not valid.
    template <class Curve> const Curve& curve(const wchar_t* name) {
        static const Curve none;
        const DocumentObject* object = objects().findByName(name);
        const auto* found = object ? dynamic_cast<const Curve*>(object->curve.get()) : nullptr;
        EXPECT_NE(found, nullptr) << KM_wString(name).ToUtf8() << " is no such curve";
        return found ? *found : none;
    }

    /// A line that is refused: it draws nothing and tells why.
    void expectRefused(const wchar_t* line, CQuarnCommand::result result, const char* message) {
        front_end.clearPrinted();
        const std::size_t before = objects().objects().size();
        EXPECT_EQ(run(line), result) << KM_wString(line).ToUtf8();
        EXPECT_EQ(objects().objects().size(), before) << KM_wString(line).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr(message)) << KM_wString(line).ToUtf8();
    }
    void expectFailure(const wchar_t* line, const char* message) {
        expectRefused(line, CQuarnCommand::failure, message);
    }
    void expectCancel(const wchar_t* line, const char* message) {
        expectRefused(line, CQuarnCommand::cancel, message);
    }
};

// ---- Names

TEST_F(DrawingCommandsTest, ObjectsWithoutANameGivenAreNumbered) {
    ASSERT_EQ(run(L"_-Line 0,0,0 1,0,0"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Polyline 0,0,0 1,0,0 1,1,0"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Point 1,2,3"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Point 1,2,4"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Curve: line, length 1.\n"
                         "Curve 2: polyline, length 2.\n"
                         "Point: point at 1,2,3.\n"
                         "Point 2: point at 1,2,4.\n");
}

TEST_F(DrawingCommandsTest, ANameCanBeGivenBeforeEveryPoint) {
    ASSERT_EQ(run(L"_-Line Name Walk 0,0,0 1,0,0"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Line 0,0,0 _Name \" Way back \" 1,0,0"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Polyline 0,0,0 1,0,0 _Name Yard"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Circle _Name Ring 0,0,0 2"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Point _Name Mark 0,0,0"), CQuarnCommand::success);
    for (const wchar_t* name : {L"Walk", L"Way back", L"Yard", L"Ring", L"Mark"})
        EXPECT_NE(objects().findByName(name), nullptr) << KM_wString(name).ToUtf8();
}

TEST_F(DrawingCommandsTest, BadNamesAreRefused) {
    run(L"_-Point _Name Mark 0,0,0");
    expectFailure(L"_-Line _Name mark 0,0,0 1,0,0", "Another object is called \"Mark\"");
    expectFailure(L"_-Line _Name \"  \" 0,0,0 1,0,0", "cannot be empty");
    expectFailure(L"_-Point _Name \"a\u0007\" 0,0,0", "control characters");
    expectFailure(L"_-Circle _Name 154FA333-917E-4961-8B52-1FFF3A62DF1B 0,0,0 1", "like an id");
    expectCancel(L"_-Line _Name", "needs an answer to \"Name of the new object\"");
}

// ---- Line

TEST_F(DrawingCommandsTest, LineRunsFromItsStartToItsEnd) {
    ASSERT_EQ(run(L"_-Line 1,2,3 \"1, 5, 7\""), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_LineCurve>(L"Curve").m_line.from, KM_3dPoint(1, 2, 3));
    EXPECT_EQ(curve<KM_LineCurve>(L"Curve").m_line.to, KM_3dPoint(1, 5, 7));
    EXPECT_EQ(printed(), "Curve: line, length 5.\n");
}

TEST_F(DrawingCommandsTest, LineRefusesWhatIsNoLine) {
    expectFailure(L"_-Line 1,2,3 1,2,3", "The line ends where it starts.");
    expectFailure(L"_-Line 1,2 1,2,3", "\"1,2\" is no point.");
    expectFailure(L"_-Line 1,2,nan 1,2,3", "is no point");
    expectFailure(L"_-Line 0,0,0 _Close", "\"_Close\" is no point");
    expectFailure(L"_-Line -1e308,0,0 1e308,0,0", "too far apart");
    expectCancel(L"_-Line", "Line needs an answer to \"Start of the line\" (Name)");
    expectCancel(L"_-Line 0,0,0", "Line needs an answer to \"End of the line\" (Name)");
    expectCancel(L"_-Line 0,0,0 _Enter", "\"_Enter\" does not answer \"End of the line\"");
    expectCancel(L"_-Line 0,0,0 _Cancel", "");
}

TEST_F(DrawingCommandsTest, ReplacedPointKeepsItsIdAndAFreeNameMakesANewPoint) {
    ASSERT_EQ(run(L"_-Point _Replace Mark 1,2,3"), CQuarnCommand::success);
    const KM_UUID id = objects().findByName(L"Mark")->id;
    ASSERT_EQ(run(L"_-Point _Replace mark 4,5,6"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Mark: point at 1,2,3.\nMark: point at 4,5,6.\n");
    EXPECT_EQ(objects().objects().size(), 1U);
    EXPECT_EQ(*objects().find(id)->point, KM_3dPoint(4, 5, 6));
}

TEST_F(DrawingCommandsTest, APointReplacesNoCurve) {
    run(L"_-Line _Name Way 0,0,0 1,0,0");
    expectFailure(L"_-Point _Replace Way 4,5,6", "Another object is called \"Way\"");
}

TEST_F(DrawingCommandsTest, OnlyQuestionsForPointsTakePoints) {
    front_end.addAnswer(L"Name");
    front_end.addAnswer(L"Mark");
    front_end.addAnswer(L"1,2,3");
    ASSERT_EQ(run(L"Point"), CQuarnCommand::success);
    ASSERT_EQ(front_end.questions().size(), 3U);
    EXPECT_TRUE(front_end.questions()[0].takes_points);
    EXPECT_FALSE(front_end.questions()[1].takes_points) << "it asks for a name";
    EXPECT_TRUE(front_end.questions()[2].takes_points);
}

TEST_F(DrawingCommandsTest, TheCameraAsksForPointsToo) {
    front_end.addAnswer(L"Location");
    front_end.addAnswer(L"1,2,3");
    front_end.addAnswer(L"_Enter");
    ASSERT_EQ(run(L"Camera"), CQuarnCommand::success);
    ASSERT_EQ(front_end.questions().size(), 3U);
    EXPECT_FALSE(front_end.questions()[0].takes_points) << "its text is nothing";
    EXPECT_TRUE(front_end.questions()[1].takes_points);
}

TEST_F(DrawingCommandsTest, APersonIsAskedAgainForABadPoint) {
    for (const wchar_t* answer : {L"here", L"0,0,0", L"0,0,0", L"0,0", L"0,3,0"})
        front_end.addAnswer(answer);
    ASSERT_EQ(run(L"Line"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_LineCurve>(L"Curve").m_line.to, KM_3dPoint(0, 3, 0));
    EXPECT_THAT(printed(), HasSubstr("The line ends where it starts."));
}

// ---- Polyline

TEST_F(DrawingCommandsTest, PolylineEndsAtEnterOrTheEndOfTheLine) {
    ASSERT_EQ(run(L"_-Polyline 0,0,0 3,0,0 3,4,0 _Enter"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Polyline 0,0,0 3,0,0 3,4,0"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Curve").PointCount(), 3);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Curve 2").Points(),
              curve<KM_PolylineCurve>(L"Curve").Points());
    EXPECT_FALSE(curve<KM_PolylineCurve>(L"Curve").IsClosed());
}

TEST_F(DrawingCommandsTest, PolylineClosesWithOrWithoutItsFirstPointRepeated) {
    ASSERT_EQ(run(L"_-Polyline 0,0,0 3,0,0 3,4,0 _Close"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Polyline 0,0,0 3,0,0 3,4,0 0,0,0 Close"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Polyline 0,0,0 3,0,0 3,4,0 0,0,0"), CQuarnCommand::success);
    for (const wchar_t* name : {L"Curve", L"Curve 2", L"Curve 3"}) {
        EXPECT_EQ(curve<KM_PolylineCurve>(name).PointCount(), 4);
        EXPECT_TRUE(curve<KM_PolylineCurve>(name).IsClosed());
    }
    EXPECT_THAT(printed(), HasSubstr("Curve: polyline, closed, length 12.\n"));
}

TEST_F(DrawingCommandsTest, UndoTakesTheLastPointBack) {
    ASSERT_EQ(run(L"_-Polyline 0,0,0 9,9,9 _Undo 3,0,0 8,8,8 _Undo _Enter"),
              CQuarnCommand::success);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Curve").PointCount(), 2);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Curve").PointAtEnd(), KM_3dPoint(3, 0, 0));
    expectFailure(L"_-Polyline 0,0,0 _Undo _Undo 1,1,1 2,2,2", "There is no point to undo.");
}

TEST_F(DrawingCommandsTest, PolylineRefusesWhatIsNoPolyline) {
    expectFailure(L"_-Polyline 0,0,0", "A polyline takes 2 points or more; 1 was given.");
    expectFailure(L"_-Polyline 0,0,0 _Enter", "1 was given.");
    expectFailure(L"_-Polyline _Enter", "0 were given.");
    expectFailure(L"_-Polyline 0,0,0 1,0,0 _Close", "A closed polyline takes 3 points");
    expectFailure(L"_-Polyline 0,0,0 0,0,0 1,0,0", "The point is where the last one is.");
    expectFailure(L"_-Polyline 0,0,0 1,0,0 here", "\"here\" is no point");
    expectFailure(L"_-Polyline 0,0,0 1,0,0 inf,0,0", "is no point");
    expectFailure(L"_-Polyline 0,0,0 1,0,0 _Degree 2", "\"_Degree\" is no point");
    expectCancel(L"_-Polyline", "needs an answer to \"First point\" (Name, Close, Undo)");
    expectCancel(L"_-Polyline 0,0,0 1,0,0 _Cancel", "");
}

TEST_F(DrawingCommandsTest, APersonMendsWhatIsNoPolylineYet) {
    for (const wchar_t* answer :
         {L"Undo", L"0,0,0", L"_Enter", L"Close", L"0,0,0", L"5,0,0", L"x", L"5,5,0", L"close"})
        front_end.addAnswer(answer);
    ASSERT_EQ(run(L"Polyline"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Curve").PointCount(), 4);
}

TEST_F(DrawingCommandsTest, ABadWordOfATypedLineIsAskedAgainAndThePointsBeforeItStay) {
    for (const wchar_t* answer : {L"3,0,0", L"3,4,0", L"_Enter"})
        front_end.addAnswer(answer);
    ASSERT_EQ(session.runTypedCommand(L"Polyline 0,0,0 here 9,9,9"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_PolylineCurve>(L"Curve").Points(),
              (KM_3dPointArray{{0, 0, 0}, {3, 0, 0}, {3, 4, 0}}));
    EXPECT_THAT(printed(), HasSubstr("\"here\" is no point"));
}

// ---- Spline

TEST_F(DrawingCommandsTest, SplineIsDrawnTowardItsControlPoints) {
    ASSERT_EQ(run(L"_-Spline 0,0,0 0,4,0 4,4,0 4,0,0"), CQuarnCommand::success);
    const auto& spline = curve<KM_NurbsCurve>(L"Curve");
    EXPECT_EQ(spline.Degree(), 3);
    EXPECT_EQ(spline.CVCount(), 4);
    // The middle of a cubic Bezier curve: (p0 + 3 p1 + 3 p2 + p3) / 8.
    EXPECT_EQ(spline.PointAt(0.5), KM_3dPoint(2, 3, 0));
}

TEST_F(DrawingCommandsTest, SplineTakesADegree) {
    ASSERT_EQ(run(L"_-Spline _Degree 2 0,0,0 2,4,0 4,0,0"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_NurbsCurve>(L"Curve").PointAt(0.5), KM_3dPoint(2, 2, 0));
    ASSERT_EQ(run(L"_-Spline 0,0,0 2,4,0 4,0,0 _Degree 1"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_NurbsCurve>(L"Curve 2").PointAt(1), KM_3dPoint(2, 4, 0));
}

TEST_F(DrawingCommandsTest, AClosedSplineIsSmoothAtItsSeam) {
    ASSERT_EQ(run(L"_-Spline 0,0,0 4,0,0 4,4,0 0,4,0 _Close"), CQuarnCommand::success);
    const auto& spline = curve<KM_NurbsCurve>(L"Curve");
    EXPECT_TRUE(spline.IsClosed());
    const KM_Interval domain = spline.Domain();
    EXPECT_LT((spline.TangentAt(domain.Min()) - spline.TangentAt(domain.Max())).Length(), 1e-12);
}

TEST_F(DrawingCommandsTest, SplineRefusesWhatIsNoSpline) {
    expectFailure(L"_-Spline 0,0,0 1,0,0 2,1,0",
                  "A curve of degree 3 takes 4 points or more; 3 were given.");
    expectFailure(L"_-Spline 0,0,0 1,0,0 _Close", "A closed curve of degree 3 takes 3 points");
    expectFailure(L"_-Spline _Degree 5 0,0,0 1,0,0 2,1,0 3,1,0 _Close", "takes 5 points");
    expectFailure(L"_-Spline 1,1,1 1,1,1 1,1,1 1,1,1", "All points are at the same place.");
    expectCancel(L"_-Spline _Degree 0 0,0,0 1,0,0", "Enter a number from 1 to 15");
    expectCancel(L"_-Spline _Degree 16 0,0,0 1,0,0", "Enter a number from 1 to 15");
    expectCancel(L"_-Spline _Degree 2.5 0,0,0 1,0,0", "Enter a whole number");
    expectCancel(L"_-Spline _Degree", "needs an answer to \"Degree\"");
}

TEST_F(DrawingCommandsTest, ControlPointsMayRepeat) {
    ASSERT_EQ(run(L"_-Spline 0,0,0 4,0,0 4,0,0 4,0,0 4,4,0"), CQuarnCommand::success);
    EXPECT_EQ(curve<KM_NurbsCurve>(L"Curve").CVCount(), 5);
}

// ---- SplineThrough

TEST_F(DrawingCommandsTest, SplineThroughPassesItsPointsAtTheLengthsOfTheChords) {
    ASSERT_EQ(run(L"_-SplineThrough 0,0,0 3,0,0 3,4,0"), CQuarnCommand::success);
    const auto& spline = curve<KM_NurbsCurve>(L"Curve");
    EXPECT_LT(spline.PointAt(3).DistanceTo({3, 0, 0}), 1e-12);
    EXPECT_LT(spline.PointAt(7).DistanceTo({3, 4, 0}), 1e-12);
    EXPECT_EQ(spline.Domain().Max(), 7.0);
}

TEST_F(DrawingCommandsTest, SplineThroughClosesSmoothly) {
    ASSERT_EQ(run(L"_-SplineThrough 0,0,0 3,0,0 3,4,0 _Close"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-SplineThrough 0,0,0 3,0,0 3,4,0 0,0,0 _Close"), CQuarnCommand::success);
    for (const wchar_t* name : {L"Curve", L"Curve 2"}) {
        const auto& spline = curve<KM_NurbsCurve>(name);
        EXPECT_TRUE(spline.IsClosed());
        EXPECT_EQ(spline.Domain().Max(), 12.0);
        EXPECT_LT((spline.DerivativeAt(0) - spline.DerivativeAt(12)).Length(), 1e-12);
    }
}

TEST_F(DrawingCommandsTest, SplineThroughRefusesWhatIsNoCurve) {
    expectFailure(L"_-SplineThrough 0,0,0", "A curve through points takes 2 points or more");
    expectFailure(L"_-SplineThrough 0,0,0 1,0,0 _Close", "takes 3 points or more; 2 were given.");
    expectFailure(L"_-SplineThrough 0,0,0 1,0,0 1,0,0 2,0,0", "The point is where the last one is");
    expectFailure(L"_-SplineThrough -1e308,0,0 1e308,0,0", "too far apart");
    expectFailure(L"_-SplineThrough 0,0,0 1,0,0 ,,", "is no point");
}

// ---- Circle

TEST_F(DrawingCommandsTest, CircleIsExactAndStandsAroundTheVertical) {
    ASSERT_EQ(run(L"_-Circle 1,2,3 5"), CQuarnCommand::success);
    const auto& circle = curve<KM_NurbsCurve>(L"Curve");
    EXPECT_TRUE(circle.IsRational());
    EXPECT_TRUE(circle.IsClosed());
    for (int i = 0; i <= 100; ++i) {
        const KM_3dPoint point = circle.PointAt(circle.Domain().ParameterAt(i / 100.0));
        EXPECT_NEAR(point.DistanceTo({1, 2, 3}), 5.0, 1e-14 * 50);
        EXPECT_EQ(point.z, 3.0);
    }
    EXPECT_EQ(circle.PointAtStart(), KM_3dPoint(6, 2, 3));
    EXPECT_EQ(printed(), "Curve: NURBS curve, closed, length 31.4159.\n");
}

TEST_F(DrawingCommandsTest, CircleTurnsAroundItsAxis) {
    ASSERT_EQ(run(L"_-Circle _Normal 0,-2,0 0,0,0 1"), CQuarnCommand::success);
    const auto& circle = curve<KM_NurbsCurve>(L"Curve");
    const KM_Interval domain = circle.Domain();
    const KM_3dVector start = circle.PointAtStart() - KM_3dPoint::Origin;
    const KM_3dVector quarter = circle.PointAt(domain.ParameterAt(0.25)) - KM_3dPoint::Origin;
    // Anticlockwise seen from the tip of the normal, -y: start x quarter = normal.
    EXPECT_NEAR(start.z * quarter.x - start.x * quarter.z, -1.0, 1e-12);
}

TEST_F(DrawingCommandsTest, CircleRefusesWhatIsNoCircle) {
    expectFailure(L"_-Circle 0,0,0 0", "The radius of a circle is above 0.");
    expectFailure(L"_-Circle 0,0,0 -2", "The radius of a circle is above 0.");
    expectCancel(L"_-Circle 0,0,0 nan", "Enter a number");
    expectCancel(L"_-Circle 0,0,0 wide", "Enter a number");
    expectFailure(L"_-Circle 1e300,0,0 1e-300", "too small");
    expectFailure(L"_-Circle 0,0,0 1e308", "too far apart");
    expectFailure(L"_-Circle _Normal 0,0,0 0,0,0 1", "needs a direction");
    expectFailure(L"_-Circle _Normal up 0,0,0 1", "\"up\" is no point");
    expectFailure(L"_-Circle middle 1", "\"middle\" is no point");
    expectCancel(L"_-Circle 0,0,0", "needs an answer to \"Radius\"");
    expectCancel(L"_-Circle _Normal", "needs an answer to \"Direction of the axis\"");
    expectCancel(L"_-Circle", "needs an answer to \"Centre of the circle\" (Name, Normal)");
}

// ---- Point

TEST_F(DrawingCommandsTest, PointStandsAtItsPlace) {
    ASSERT_EQ(run(L"_-Point 0.1,-2e3,+3"), CQuarnCommand::success);
    EXPECT_EQ(*object(L"Point").point, KM_3dPoint(0.1, -2000, 3));
    expectFailure(L"_-Point 1,2,3,4", "is no point");
    expectFailure(L"_-Point \"\"", "is no point");
    expectCancel(L"_-Point", "needs an answer to \"Place of the point\" (Name, Replace)");
}

} // namespace
} // namespace quarn::test
