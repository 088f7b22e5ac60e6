#include "host/curves/CurveFile.h"

#include "host/document/Document.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "tests/host/app/TestCommand.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <unistd.h>

namespace quarn::test {
namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::StartsWith;

std::unique_ptr<KM_Curve> curveOf(std::string_view text) {
    CurveResult curve = readCurveText(text);
    EXPECT_TRUE(curve) << curve.message();
    return curve ? std::move(curve.value()) : nullptr;
}

template <class Curve> Curve as(std::string_view text) {
    const auto curve = curveOf(text);
    const auto* wanted = dynamic_cast<const Curve*>(curve.get());
    EXPECT_NE(wanted, nullptr);
    return wanted ? *wanted : Curve();
}

void expectRefused(std::string_view text, const char* message) {
    const CurveResult curve = readCurveText(text);
    ASSERT_FALSE(curve) << text;
    EXPECT_THAT(curve.message(), HasSubstr(message)) << text;
}

KM_3dPoint cv(const KM_NurbsCurve& curve, int index) {
    KM_3dPoint point;
    curve.GetCV(index, point);
    return point;
}

// ---- Text

TEST(CurveFile, LinesOfThreeNumbersAreAPolyline) {
    const auto walk = as<KM_PolylineCurve>("# a walk\n0 0 1.7\n\n  3,4,1.7 # the gate\r\n"
                                           "3, 4 ,\t-1e1\n+5\t5 , .5");
    EXPECT_EQ(walk.Points(), (KM_3dPointArray{{0, 0, 1.7}, {3, 4, 1.7}, {3, 4, -10}, {5, 5, 0.5}}));
}

TEST(CurveFile, ADegreeMakesThePointsControlPoints) {
    const auto arch = as<KM_NurbsCurve>("degree 3\n0 0 0\n0 4 0\n4 4 0\n4 0 0\n");
    EXPECT_EQ(arch.Degree(), 3);
    EXPECT_FALSE(arch.IsRational());
    EXPECT_EQ(arch.PointAt(0.5), KM_3dPoint(2, 3, 0));
}

TEST(CurveFile, ClosedCurvesNeedNotRepeatTheirFirstPoint) {
    EXPECT_EQ(as<KM_PolylineCurve>("closed\n0 0 0\n1 0 0\n1 1 0\n").PointCount(), 4);
    EXPECT_EQ(as<KM_PolylineCurve>("closed\n0 0 0\n1 0 0\n1 1 0\n0 0 0\n").PointCount(), 4);
    for (const char* text : {"closed\ndegree\t2\n0 0 0\n4 0 0\n4 4 0\n0 4 0\n",
                             "degree  2 \nclosed\n0 0 0\n4 0 0\n4 4 0\n0 4 0\n0 0 0\n"}) {
        const auto loop = as<KM_NurbsCurve>(text);
        EXPECT_TRUE(loop.IsClosed());
        EXPECT_EQ(loop.Domain().Length(), 4.0);
    }
}

TEST(CurveFile, AByteOrderMarkIsNoNumber) {
    EXPECT_EQ(as<KM_PolylineCurve>("\xEF\xBB\xBF"
                                   "0 0 0\n1 0 0\n")
                  .PointCount(),
              2);
    EXPECT_EQ(as<KM_PolylineCurve>("\xEF\xBB\xBF {\"points\":[[0,0,0],[1,0,0]]}").PointCount(), 2);
}

TEST(CurveFile, BadLinesAreNamedByTheirNumber) {
    expectRefused("0 0 0\n\n# two\n1 2\n", "line 4: \"1 2\" is no point; write x y z or x,y,z");
    for (const char* bad : {"nan 0 0", "0 inf 0", "1 2 3 4", "1,,2,3", "1,2,3,", ",1,2,3", "1;2;3",
                            "0x10 0 0", "1e999 0 0", "1 2 3m", "+-1 2 3", "one two three", "1.2.3",
                            "1,2,", "--1 0 0", "-1.23432101234321e308 0 0"})
        expectRefused(std::string("0 0 0\n") + bad + "\n1 1 1\n", "line 2: ");
    expectRefused(std::string_view("0 0 0\n1 \0 1\n", 12), "line 2: \"1 ? 1\" is no point");
    expectRefused("0 0 0\n" + std::string(100000, '7') + "\n", "7...\" is no point");
}

TEST(CurveFile, BadDegreesAndMisplacedLinesAreRefused) {
    for (const char* bad : {"degree 0", "degree -1", "degree 16", "degree", "degree 2.0",
                            "degree three", "degree 99999999999", "degree 2 3"})
        expectRefused(std::string("# x\n") + bad + "\n0 0 0\n1 1 1\n", "line 2: ");
    expectRefused("0 0 0\n1 0 0\nclosed\n", "line 3: \"closed\" is no point; ");
    expectRefused("0 0 0\ndegree 2\n", "line 2: \"degree 2\" is no point; ");
    expectRefused("Degree 2\n0 0 0\n", "line 1: ");
}

TEST(CurveFile, PointsThatMakeNoCurveAreRefused) {
    expectRefused("", "there are no points in it");
    expectRefused("# nothing\nclosed\n", "there are no points in it");
    expectRefused("1 2 3\n", "A polyline takes 2 points or more; 1 was given.");
    expectRefused("closed\n0 0 0\n1 0 0\n0 0 0", "A closed polyline takes 3 points or more; 2");
    expectRefused("0 0 0\n1 0 0\n1 0 0\n", "follow each other are at the same place");
    expectRefused("degree 3\n0 0 0\n1 0 0\n1 1 0\n", "A curve of degree 3 takes 4 points");
    expectRefused("degree 2\n1 1 1\n1 1 1\n1 1 1\n", "All points are at the same place");
    expectRefused("-1e308 0 0\n1e308 0 0\n", "too far apart");
}

TEST(CurveFile, MoreThanAMillionPointsAreRefused) {
    std::string text;
    for (int i = 0; i <= 1'000'000; ++i)
        text += std::to_string(i) + " 0 0\n";
    expectRefused(text, "line 1000001: there are more than a million points");
    text.erase(text.rfind("1000000"));
    EXPECT_EQ(as<KM_PolylineCurve>(text).PointCount(), 1'000'000);
}

// ---- JSON

TEST(CurveFile, JsonGivesDegreePointsAndWeights) {
    const auto arc = as<KM_NurbsCurve>(R"({"degree": 2, "closed": false,
        "points": [[1, 0, 0], [1, 1, 0, 0.70710678118654752], [0, 1, 0, 1]]})");
    EXPECT_TRUE(arc.IsRational());
    EXPECT_EQ(cv(arc, 1), KM_3dPoint(1, 1, 0));
    // A quarter of the unit circle.
    EXPECT_NEAR(arc.PointAt(0.3).DistanceTo({0, 0, 0}), 1.0, 1e-14);
    EXPECT_EQ(as<KM_PolylineCurve>(R"({"points":[[0,0,0],[1,-2e0,3]]})").PointAtEnd(),
              KM_3dPoint(1, -2, 3));
    EXPECT_EQ(as<KM_NurbsCurve>(R"({"points":[[0,0,0],[1,1,1,2]]})").Degree(), 1);
}

/// The true length comes near 2, by way of the corner, as the weight of the corner grows.
TEST(CurveFile, WeightsMayDifferByAMillionAndNoMore) {
    const auto corner =
        as<KM_NurbsCurve>(R"({"degree": 2, "points": [[1, 0, 0], [1, 1, 0, 1e6], [0, 1, 0]]})");
    double length = 0.0;
    ASSERT_TRUE(corner.GetLength(&length));
    EXPECT_NEAR(length, 2.0, 1e-5);
    expectRefused(R"({"degree": 2, "points": [[1, 0, 0], [1, 1, 0, 1.1e6], [0, 1, 0]]})",
                  "by a factor of more than 1,000,000");
}

TEST(CurveFile, ClosedJsonCurvesRepeatTheirFirstWeightsToo) {
    const auto loop = as<KM_NurbsCurve>(
        R"({"closed":true,"degree":2,"points":[[0,0,0,5],[4,0,0,1],[4,4,0,2],[0,4,0,1]]})");
    ASSERT_EQ(loop.CVCount(), 6);
    EXPECT_EQ(loop.Weight(4), 5.0);
    EXPECT_EQ(loop.Weight(5), 1.0);
    EXPECT_TRUE(loop.IsClosed());
}

TEST(CurveFile, DamagedJsonIsRefusedWithItsLine) {
    const std::string whole = "{\n\"degree\": 1,\n\"points\": [\n[0, 0, 0],\n[1, 2, 3]\n]\n}";
    ASSERT_TRUE(readCurveText(whole));
    for (std::size_t size = 1; size < whole.size(); ++size)
        expectRefused(whole.substr(0, size), "line ");
    expectRefused(whole.substr(0, 36), "line 4: the JSON text is damaged or ends too early");
    expectRefused(whole + "}", "line 7: the JSON text is damaged");
    expectRefused("{\"points\": [[0,0,0],\n[1,NaN,0]]}", "line 2: the JSON text is damaged");
    expectRefused("{\"points\": [[0,0,0],\n[1,1e999,0]]}", "line 2: a number is too large");
}

TEST(CurveFile, JsonThatIsNoCurveIsRefusedWithItsLine) {
    expectRefused("{}", "there are no points in it");
    expectRefused("{\n\"degree\": 0,\n\"points\": []}", "line 2: \"degree\" is a whole number");
    for (const char* bad : {"-1", "16", "2.5", "1e0", "\"3\"", "null", "true", "[3]", "{}",
                            "18446744073709551615", "-9223372036854775808"})
        expectRefused(std::string("{\"points\":[[0,0,0],[1,1,1]],\n\"degree\":") + bad + "}",
                      "line 2: \"degree\" is a whole number from 1 to 15");
    for (const char* bad : {"1", "\"yes\"", "null", "[]", "{}"})
        expectRefused(std::string("{\n\"closed\":") + bad + "}", "line 2: \"closed\" is true or");
    for (const char* bad :
         {"1", "null", "{}", "\"0 0 0\"", "[0,0,0]", "[[0,0]]", "[[]]", "[[0,0,0,1,1]]",
          "[[0,0,null]]", "[[0,0,[0]]]", "[[0,0,\"0\"]]", "[{\"x\":0}]", "[[[[[[[["})
        expectRefused(std::string("{\n\"points\":") + bad + "}", "line 2: \"points\" is a list");
    expectRefused("{\"points\":[[0,0,0],\n[1,1,1,0]]}", "line 2: the weight of a point");
    expectRefused("{\"points\":[[0,0,0],\n[1,1,1,-1]]}", "line 2: the weight of a point");
    expectRefused("{\"points\":[[0,0,0]],\n\"knots\":[0,1]}", "line 2: a curve has \"degree\"");
    expectRefused("{\"degree\":1,\n\"degree\":2}", "line 2: \"degree\" is there twice");
}

TEST(CurveFile, NestingAsDeepAsTheFileIsRefusedAtItsThirdLevel) {
    expectRefused("{\"points\":" + std::string(5'000'000, '['), "line 1: \"points\" is a list");
    std::string objects;
    for (int i = 0; i < 100'000; ++i)
        objects += "{\"points\":";
    expectRefused(objects, "line 1: \"points\" is a list");
}

// ---- The page about curve files

/// What stands between the fences of the page's block that begins with `start`.
std::string blockOfPage(const std::string& start) {
    const std::string page =
        readFile(std::filesystem::path(QUARN_SOURCE_DIR) / "docs/curve-files.md");
    const std::size_t begin = page.find(start);
    return begin == page.npos ? "" : page.substr(begin, page.find("```", begin) - begin);
}

TEST(CurveFile, BothExamplesOfThePageAreTheSameCurve) {
    const auto text = as<KM_NurbsCurve>(blockOfPage("# past the columns"));
    const auto json = as<KM_NurbsCurve>(blockOfPage("{\n    \"degree\""));
    ASSERT_EQ(text.CVCount(), 4);
    ASSERT_EQ(json.CVCount(), 4);
    EXPECT_EQ(text.Degree(), 3);
    EXPECT_EQ(json.Degree(), 3);
    for (int i = 0; i < 4; ++i)
        EXPECT_EQ(cv(text, i), cv(json, i)) << i;
}

// ---- The command

class ImportCurveTest : public HostTest {
protected:
    ObjectTable& objects() { return Document::of(session.document()).objects(); }
    CQuarnCommand::result import(const std::string& name, const wchar_t* before = L"") {
        const std::wstring line =
            std::wstring(L"_-ImportCurve ") + before + L" \"" + (folder / name).wstring() + L"\"";
        return run(line.c_str());
    }

    TempFolder folder;
};

TEST_F(ImportCurveTest, TheObjectIsCalledLikeTheFile) {
    writeFile(folder / "morning walk.txt", "0 0 0\n3 4 0\n");
    ASSERT_EQ(import("morning walk.txt"), CQuarnCommand::success);
    ASSERT_EQ(import("morning walk.txt"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "morning walk: polyline, length 5.\n"
                         "morning walk 2: polyline, length 5.\n");
    EXPECT_NE(objects().findByName(L"morning walk"), nullptr);
}

TEST_F(ImportCurveTest, AnotherNameCanBeGiven) {
    writeFile(folder / "walk.json", R"({"points":[[0,0,0],[3,4,0]]})");
    ASSERT_EQ(import("walk.json", L"[Name] \"To the gate\""), CQuarnCommand::success);
    EXPECT_NE(objects().findByName(L"To the gate"), nullptr);
    EXPECT_EQ(import("walk.json", L"[Name] \"to the gate\""), CQuarnCommand::failure);
    EXPECT_EQ(objects().objects().size(), 1U);
}

TEST_F(ImportCurveTest, ReplacedCurveKeepsItsIdAndAFreeNameMakesANewObject) {
    writeFile(folder / "a.txt", "0 0 0\n3 4 0\n");
    writeFile(folder / "b.txt", "0 0 0\n6 8 0\n");
    ASSERT_EQ(import("a.txt", L"[Replace] \"Way in\""), CQuarnCommand::success);
    const KM_UUID id = objects().findByName(L"Way in")->id;
    ASSERT_EQ(import("b.txt", L"[Replace] \"way in\""), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Way in: polyline, length 5.\nWay in: polyline, length 10.\n");
    ASSERT_EQ(objects().objects().size(), 1U);
    EXPECT_EQ(objects().find(id)->curve->PointAtEnd(), KM_3dPoint(6, 8, 0));
}

TEST_F(ImportCurveTest, OnlyCurvesAreReplaced) {
    writeFile(folder / "a.txt", "0 0 0\n3 4 0\n");
    objects().addPoint(L"Gate", {1, 2, 3});
    EXPECT_EQ(import("a.txt", L"[Replace] Gate"), CQuarnCommand::failure);
    EXPECT_EQ(printed(), "Another object is called \"Gate\"; give a free name.\n");
    EXPECT_EQ(objects().objects().size(), 1U);
}

TEST_F(ImportCurveTest, AFileNameThatNoObjectCanHaveIsNotTaken) {
    writeFile(folder / "154FA333-917E-4961-8B52-1FFF3A62DF1B.txt", "0 0 0\n3 4 0\n");
    ASSERT_EQ(import("154FA333-917E-4961-8B52-1FFF3A62DF1B.txt"), CQuarnCommand::success);
    EXPECT_NE(objects().findByName(L"Curve"), nullptr);
}

TEST_F(ImportCurveTest, WhatCannotBeReadAddsNothingAndIsToldWithFileAndLine) {
    writeFile(folder / "bad.txt", "0 0 0\n1 nan 0\n");
    writeFile(folder / "empty.txt", "");
    EXPECT_EQ(import("bad.txt"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), StartsWith("Cannot read a curve from '"));
    EXPECT_THAT(printed(), EndsWith("bad.txt': line 2: \"1 nan 0\" is no point; write x y z or "
                                    "x,y,z.\n"));
    EXPECT_EQ(import("empty.txt"), CQuarnCommand::failure);
    EXPECT_EQ(import("nowhere.txt"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("nowhere.txt': there is no such file."));
    EXPECT_EQ(import("."), CQuarnCommand::failure);
    EXPECT_EQ(run(L"_-ImportCurve"), CQuarnCommand::cancel);
    EXPECT_THAT(printed(), HasSubstr("needs an answer to \"Curve file\" (Name, Replace)"));
    EXPECT_TRUE(objects().empty());
}

TEST_F(ImportCurveTest, AHugeFileIsRefusedUnread) {
    const auto file = folder / "huge.txt";
    writeFile(file, "0 0 0\n");
    ASSERT_EQ(truncate(file.c_str(), (64LL << 20) + 1), 0);
    EXPECT_EQ(import("huge.txt"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("it is larger than 64 MB."));
}

} // namespace
} // namespace quarn::test
