#include "import/cad/module/FreeCurves.h"

#include <BRepAdaptor_Curve.hxx>
#include <BRep_Tool.hxx>
#include <GCPnts_TangentialDeflection.hxx>
#include <TopExp.hxx>
#include <TopExp_Explorer.hxx>
#include <TopTools_IndexedMapOfShape.hxx>
#include <TopoDS.hxx>

namespace quarn {

namespace {

constexpr double ANGLE = 0.2; ///< radians between two pieces of a polyline, at most

KM_3dPoint pointOf(const gp_Pnt& point) {
    return {point.X(), point.Y(), point.Z()};
}

KM_3dPointArray polylineOf(const TopoDS_Edge& edge, double tolerance) {
    KM_3dPointArray points;
    const BRepAdaptor_Curve curve(edge);
    const GCPnts_TangentialDeflection places(curve, ANGLE, tolerance);
    for (int i = 1; i <= places.NbPoints(); ++i)
        points.Append(pointOf(places.Value(i)));
    return points;
}

/// Each once, however many wires hold it.
TopTools_IndexedMapOfShape freeOnes(const TopoDS_Shape& shape, TopAbs_ShapeEnum kind,
                                    TopAbs_ShapeEnum not_in) {
    TopTools_IndexedMapOfShape found;
    for (TopExp_Explorer free(shape, kind, not_in); free.More(); free.Next())
        found.Add(free.Current());
    return found;
}

} // namespace

void addFreeCurves(const TopoDS_Shape& shape, double tolerance, const KM_wString& name,
                   SourceScene& scene) {
    SourceMesh piece;
    piece.name = name;
    const TopTools_IndexedMapOfShape edges = freeOnes(shape, TopAbs_EDGE, TopAbs_FACE);
    for (int i = 1; i <= edges.Extent(); ++i) {
        const TopoDS_Edge& edge = TopoDS::Edge(edges(i));
        if (!BRep_Tool::Degenerated(edge) && BRep_Tool::IsGeometric(edge))
            piece.lines.push_back(polylineOf(edge, tolerance));
    }
    const TopTools_IndexedMapOfShape vertices = freeOnes(shape, TopAbs_VERTEX, TopAbs_EDGE);
    for (int i = 1; i <= vertices.Extent(); ++i)
        piece.points.Append(pointOf(BRep_Tool::Pnt(TopoDS::Vertex(vertices(i)))));
    std::erase_if(piece.lines, [](const KM_3dPointArray& line) { return line.Count() < 2; });
    if (!piece.lines.empty() || piece.points.Count() > 0)
        scene.meshes.push_back(std::move(piece));
}

} // namespace quarn
