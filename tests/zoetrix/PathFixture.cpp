#include "tests/zoetrix/PathFixture.h"

#include <algorithm>
#include <array>

namespace {

using Bytes = std::vector<std::uint8_t>;

// As docs/document-format.md has them.
constexpr std::uint64_t FILE_HEADER = 12;
constexpr std::uint32_t OBJECT = 0x544A424F; // "OBJT"
constexpr std::uint32_t VIEW = 0x57454956;   // "VIEW"
constexpr int CURVE_KIND = 2;
constexpr int POINT_KIND = 3;
constexpr int LINE_TYPE = 1;
constexpr int POLYLINE_TYPE = 2;
constexpr int NURBS_TYPE = 3;

constexpr double FAR_OUT = 1e308;

void writeLine(KM_BinaryArchive& archive, const KM_LineCurve& line) {
    archive.WriteInt(LINE_TYPE);
    archive.WritePoint(line.m_line.from);
    archive.WritePoint(line.m_line.to);
    archive.WriteDouble(line.Domain().Min());
    archive.WriteDouble(line.Domain().Max());
}

void writePolyline(KM_BinaryArchive& archive, const KM_PolylineCurve& polyline) {
    archive.WriteInt(POLYLINE_TYPE);
    archive.WriteArray(polyline.Points());
    archive.WriteArray(std::span(polyline.Parameters()));
}

void writeNurbs(KM_BinaryArchive& archive, const KM_NurbsCurve& curve) {
    KM_3dPointArray points;
    std::vector<double> weights;
    std::vector<double> knots;
    points.SetCount(curve.CVCount());
    for (int i = 0; i < curve.CVCount(); ++i) {
        curve.GetCV(i, points[i]);
        if (curve.IsRational())
            weights.push_back(curve.Weight(i));
    }
    for (int i = 0; i < curve.KnotCount(); ++i)
        knots.push_back(curve.Knot(i));
    archive.WriteInt(NURBS_TYPE);
    archive.WriteInt(curve.Order());
    archive.WriteBool(curve.IsRational());
    archive.WriteArray(points);
    archive.WriteArray(std::span<const double>(weights));
    archive.WriteArray(std::span<const double>(knots));
}

void writeCurve(KM_BinaryArchive& archive, const KM_Curve& curve) {
    archive.WriteInt(CURVE_KIND);
    if (const auto* line = dynamic_cast<const KM_LineCurve*>(&curve))
        writeLine(archive, *line);
    else if (const auto* polyline = dynamic_cast<const KM_PolylineCurve*>(&curve))
        writePolyline(archive, *polyline);
    else
        writeNurbs(archive, dynamic_cast<const KM_NurbsCurve&>(curve));
}

/// A copy of a document's file with one more object in it, before the views.
Bytes withObject(const Bytes& file, const std::function<void(KM_BinaryArchive&)>& write_object) {
    KM_BinaryArchive from = KM_BinaryArchive::ForReading(file);
    KM_BinaryArchive to = KM_BinaryArchive::ForWriting();
    std::span<const std::uint8_t> bytes;
    EXPECT_TRUE(from.ViewBytes(FILE_HEADER, bytes) && to.WriteBytes(bytes));
    bool is_in = false;
    while (from.BytesLeft() > 0) {
        std::uint32_t id = 0;
        std::uint64_t length = 0;
        EXPECT_TRUE(from.BeginReadChunk(id, length) && from.ViewBytes(length, bytes) &&
                    from.EndReadChunk());
        if (id == VIEW && !is_in) {
            to.BeginWriteChunk(OBJECT);
            write_object(to);
            to.EndWriteChunk();
            is_in = true;
        }
        EXPECT_TRUE(to.BeginWriteChunk(id) && to.WriteBytes(bytes) && to.EndWriteChunk());
    }
    EXPECT_TRUE(is_in);
    return to.TakeBytes();
}

} // namespace

PathFixture::PathFixture(const std::string& plug_ins) : PlugInFixture(plug_ins) {}

void PathFixture::SetUp() {
    const std::filesystem::path file = folder.path() / "empty.quarn";
    ASSERT_EQ(CQuarnCommand::success, run(L"_-SaveAs \"" + wide(file) + L"\""));
    const std::string content = readFile(file);
    m_empty_document.assign(content.begin(), content.end());

    importObj("v 0 0 0\nv 1 0 0\nv 0 1 0\no slab\nf 1 2 3\n");
    addCurve(L"rail", KM_LineCurve({0.0, 0.0, 1.0}, {10.0, 0.0, 1.0}));
    addCurve(L"gaze", KM_LineCurve({0.0, 0.0, 5.0}, {0.0, 4.0, 5.0}));
    addPoint(L"spot", {1.0, 2.0, 3.0});
    addPoint(L"nest", {-4.0, 0.0, 2.0});

    record() = KM_3dmAnimationProperties();
    record().SetHtmlFilename(L"Walk");
    record().SetCaptureMethod(L"Shaded");
    front_end.clearPrinted();
    forgetDialog();
}

void PathFixture::addObject(const wchar_t* name, const KM_UUID& id, const Geometry& geometry) {
    const Bytes file = withObject(m_empty_document, [&](KM_BinaryArchive& archive) {
        archive.WriteUuid(KM_UuidIsNil(id) ? KM_CreateUuid() : id);
        archive.WriteString(name);
        archive.WriteBool(true);
        geometry(archive);
    });
    const std::filesystem::path place = folder.path() / "object.quarn";
    writeFile(place, {reinterpret_cast<const char*>(file.data()), file.size()});
    ASSERT_EQ(CQuarnCommand::success, run(L"_-Import \"" + wide(place) + L"\""))
        << KM_wString(printed().c_str()).ToUtf8();
}

void PathFixture::addCurve(const wchar_t* name, const KM_Curve& curve, const KM_UUID& id) {
    addObject(name, id, [&curve](KM_BinaryArchive& archive) { writeCurve(archive, curve); });
}

void PathFixture::addPoint(const wchar_t* name, const KM_3dPoint& point) {
    addObject(name, KM_nil_uuid, [&point](KM_BinaryArchive& archive) {
        archive.WriteInt(POINT_KIND);
        archive.WritePoint(point);
    });
}

void PathFixture::editCurve(const wchar_t* name, const KM_Curve& curve) {
    const KM_UUID id = objectId(name);
    remove(name);
    addCurve(name, curve, id);
    ASSERT_EQ(id, objectId(name));
}

void PathFixture::remove(const wchar_t* name) {
    ASSERT_EQ(CQuarnCommand::success, run(KM_wString(L"_-Delete \"") + name + L"\" _Enter"));
    ASSERT_EQ(nullptr, doc().FindObjectByName(name));
}

CQuarnCommand::result PathFixture::setUpPath(std::wstring_view camera, std::wstring_view target,
                                             std::wstring_view frames) {
    answer({camera, target, frames, L"_Enter", L"_Enter", L"_Enter", L"_Enter"});
    return run(L"SetPathAnimation");
}

CQuarnCommand::result PathFixture::setUpFlythrough(std::wstring_view path,
                                                   std::wstring_view frames) {
    answer({path, frames, L"_Enter", L"_Enter", L"_Enter", L"_Enter"});
    return run(L"SetFlythroughAnimation");
}

CQuarnCommand::result PathFixture::pathInDialog(std::wstring_view camera, std::wstring_view target,
                                                const Entered& entered) {
    enterIntoDialog(entered);
    answer({camera, target});
    return session->runCommand(L"SetPathAnimation", true);
}

CQuarnCommand::result PathFixture::flythroughInDialog(std::wstring_view path,
                                                      const Entered& entered) {
    enterIntoDialog(entered);
    answer({path});
    return session->runCommand(L"SetFlythroughAnimation", true);
}

void PathFixture::expectRecordUntouched() {
    EXPECT_EQ(KM_3dmAnimationProperties::none, record().CaptureType());
    EXPECT_EQ(100, record().FrameCount());
    EXPECT_EQ(1, record().CurrentFrame());
    EXPECT_EQ(L"jpg", record().FileExtension().View());
    EXPECT_EQ(L"Walk", record().HtmlFilename().View());
    EXPECT_TRUE(record().CameraPoints().IsEmpty());
    EXPECT_TRUE(record().TargetPoints().IsEmpty());
}

KM_NurbsCurve unevenCurve() {
    const std::array<KM_3dPoint, 4> points = {
        {{0.0, 0.0, 0.0}, {4.0, 0.0, 0.0}, {4.0, 12.0, 0.0}, {13.0, 12.0, 0.0}}};
    const std::array<double, 5> knots = {0.0, 0.0, 1.0, 4.0, 4.0};
    KM_NurbsCurve curve;
    EXPECT_TRUE(curve.Create(3, false, 3, static_cast<int>(points.size())));
    for (int i = 0; i < curve.CVCount(); ++i)
        curve.SetCV(i, points[static_cast<std::size_t>(i)]);
    for (int i = 0; i < curve.KnotCount(); ++i)
        curve.SetKnot(i, knots[static_cast<std::size_t>(i)]);
    EXPECT_TRUE(curve.IsValid());
    return curve;
}

KM_NurbsCurve curveWithHoleAt(int place) {
    // Four cubic pieces between triple knots; control point 3 k is the point at k / 4.
    KM_NurbsCurve curve;
    EXPECT_TRUE(curve.Create(3, false, 4, 13));
    for (int i = 0; i < curve.CVCount(); ++i)
        curve.SetCV(i, {10.0 * i / 3.0, 0.0, 0.0});
    for (int i = 0; i < curve.KnotCount(); ++i)
        curve.SetKnot(i, 0.25 * (i / 3));
    curve.SetCV(3 * place + 1, {FAR_OUT, 0.0, 0.0});
    curve.SetCV(3 * place + 2, {-FAR_OUT, 0.0, 0.0});
    EXPECT_TRUE(curve.IsValid());
    return curve;
}

KM_NurbsCurve curveWithoutPoints() {
    // One piece between single knots: no control point is a point of the curve.
    KM_NurbsCurve curve;
    EXPECT_TRUE(curve.Create(3, false, 3, 3));
    for (int i = 0; i < curve.CVCount(); ++i)
        curve.SetCV(i, {i == 1 ? -FAR_OUT : FAR_OUT, 1.0 * i, 0.0});
    for (int i = 0; i < curve.KnotCount(); ++i)
        curve.SetKnot(i, i);
    EXPECT_TRUE(curve.IsValid());
    return curve;
}

testing::AssertionResult near(const KM_3dPointArray& a, const KM_3dPointArray& b,
                              double tolerance) {
    if (a.Count() != b.Count())
        return testing::AssertionFailure() << a.Count() << " points are not " << b.Count();
    for (int i = 0; i < a.Count(); ++i)
        if (const testing::AssertionResult result = near(a[i], b[i], tolerance); !result)
            return testing::AssertionFailure() << "point " << i << ": " << result.message();
    return testing::AssertionSuccess();
}
