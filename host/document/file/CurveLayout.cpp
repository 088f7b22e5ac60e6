#include "host/document/file/CurveLayout.h"

#include "ground/Fields.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"

#include <algorithm>

namespace quarn {

namespace {

enum class CurveType : std::int32_t { line = 1, polyline = 2, nurbs = 3 };

bool areValid(const KM_3dPointArray& points) {
    return std::all_of(points.begin(), points.end(),
                       [](const KM_3dPoint& point) { return point.IsValid(); });
}

// ---- Line

bool writeLine(KM_BinaryArchive& archive, const KM_LineCurve& line) {
    return line.m_line.from.IsValid() && line.m_line.to.IsValid() &&
           archive.WritePoint(line.m_line.from) && archive.WritePoint(line.m_line.to) &&
           archive.WriteDouble(line.Domain().Min()) && archive.WriteDouble(line.Domain().Max());
}

std::unique_ptr<KM_Curve> readLine(KM_BinaryArchive& archive) {
    KM_Line ends;
    double t0 = 0.0;
    double t1 = 0.0;
    if (!archive.ReadPoint(ends.from) || !archive.ReadPoint(ends.to) || !archive.ReadDouble(t0) ||
        !archive.ReadDouble(t1) || !ends.from.IsValid() || !ends.to.IsValid())
        return nullptr;
    auto line = std::make_unique<KM_LineCurve>(ends);
    return line->SetDomain(t0, t1) ? std::move(line) : nullptr;
}

// ---- Polyline

bool writePolyline(KM_BinaryArchive& archive, const KM_PolylineCurve& polyline) {
    return areValid(polyline.Points()) && archive.WriteArray(polyline.Points()) &&
           archive.WriteArray(std::span(polyline.Parameters()));
}

std::unique_ptr<KM_Curve> readPolyline(KM_BinaryArchive& archive) {
    KM_3dPointArray corners;
    std::vector<double> parameters;
    if (!archive.ReadArray(corners) || !archive.ReadArray(parameters) || !areValid(corners))
        return nullptr;
    auto polyline = std::make_unique<KM_PolylineCurve>();
    const std::span points(corners.Array(), static_cast<std::size_t>(corners.Count()));
    return polyline->Create(points, parameters) ? std::move(polyline) : nullptr;
}

// ---- NURBS curve

/// Its numbers, as they stand in the file.
struct NurbsNumbers {
    std::int32_t order = 0;
    bool rational = false;
    KM_3dPointArray points;
    std::vector<double> weights; ///< none unless it is rational
    std::vector<double> knots;
};

template <class Step, class AnyNumbers> bool fields(Step step, AnyNumbers& numbers) {
    return step(numbers.order) && step(numbers.rational) && step(numbers.points) &&
           step(numbers.weights) && step(numbers.knots);
}

NurbsNumbers numbersOf(const KM_NurbsCurve& curve) {
    NurbsNumbers numbers;
    numbers.order = curve.Order();
    numbers.rational = curve.IsRational();
    numbers.points.SetCount(curve.CVCount());
    for (int i = 0; i < curve.CVCount(); ++i) {
        curve.GetCV(i, numbers.points[i]);
        if (numbers.rational)
            numbers.weights.push_back(curve.Weight(i));
    }
    for (int i = 0; i < curve.KnotCount(); ++i)
        numbers.knots.push_back(curve.Knot(i));
    return numbers;
}

/// @return null for numbers that make no valid curve
std::unique_ptr<KM_Curve> assemble(const NurbsNumbers& numbers) {
    const int count = numbers.points.Count();
    const std::size_t weights = numbers.rational ? static_cast<std::size_t>(count) : 0;
    auto curve = std::make_unique<KM_NurbsCurve>();
    if (numbers.weights.size() != weights ||
        !curve->Create(3, numbers.rational, numbers.order, count) ||
        numbers.knots.size() != static_cast<std::size_t>(curve->KnotCount()))
        return nullptr;
    bool taken = true;
    for (int i = 0; i < count; ++i) {
        taken = taken && curve->SetCV(i, numbers.points[i]);
        if (numbers.rational)
            taken = taken && curve->SetWeight(i, numbers.weights[static_cast<std::size_t>(i)]);
    }
    for (int i = 0; i < curve->KnotCount(); ++i)
        taken = taken && curve->SetKnot(i, numbers.knots[static_cast<std::size_t>(i)]);
    return taken && curve->IsValid() ? std::move(curve) : nullptr;
}

bool writeNurbs(KM_BinaryArchive& archive, const KM_NurbsCurve& curve) {
    const NurbsNumbers numbers = numbersOf(curve);
    return curve.IsValid() && fields(FieldWriter(archive), numbers);
}

std::unique_ptr<KM_Curve> readNurbs(KM_BinaryArchive& archive) {
    NurbsNumbers numbers;
    return fields(FieldReader(archive), numbers) ? assemble(numbers) : nullptr;
}

// ---- Any curve

bool writeType(KM_BinaryArchive& archive, CurveType type) {
    return archive.WriteInt(static_cast<std::int32_t>(type));
}

std::unique_ptr<KM_Curve> readAny(KM_BinaryArchive& archive) {
    CurveType type = CurveType::line;
    if (!FieldReader(archive)(type, CurveType::line, CurveType::nurbs))
        return nullptr;
    switch (type) {
    case CurveType::line:
        return readLine(archive);
    case CurveType::polyline:
        return readPolyline(archive);
    case CurveType::nurbs:
        return readNurbs(archive);
    }
    return nullptr;
}

} // namespace

bool writeCurve(KM_BinaryArchive& archive, const KM_Curve& curve) {
    bool written = false;
    if (const auto* line = dynamic_cast<const KM_LineCurve*>(&curve))
        written = writeType(archive, CurveType::line) && writeLine(archive, *line);
    else if (const auto* polyline = dynamic_cast<const KM_PolylineCurve*>(&curve))
        written = writeType(archive, CurveType::polyline) && writePolyline(archive, *polyline);
    else if (const auto* nurbs = dynamic_cast<const KM_NurbsCurve*>(&curve))
        written = writeType(archive, CurveType::nurbs) && writeNurbs(archive, *nurbs);
    return written || archive.Fail();
}

std::unique_ptr<KM_Curve> readCurve(KM_BinaryArchive& archive) {
    std::unique_ptr<KM_Curve> curve = readAny(archive);
    if (!curve)
        archive.Fail();
    return curve;
}

} // namespace quarn
