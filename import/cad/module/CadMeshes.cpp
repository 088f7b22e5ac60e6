#include "import/cad/module/CadMeshes.h"

#include "import/cad/module/FaceMeshes.h"
#include "import/cad/module/FreeCurves.h"

#include <BRepBndLib.hxx>
#include <BRepMesh_IncrementalMesh.hxx>
#include <Bnd_Box.hxx>
#include <TDF_Tool.hxx>
#include <TDataStd_Name.hxx>
#include <XCAFDoc_DocumentTool.hxx>
#include <XCAFDoc_ShapeTool.hxx>
#include <XCAFPrs_DocumentExplorer.hxx>

#include <map>
#include <numbers>
#include <string>
#include <utility>

namespace quarn {

namespace {

constexpr double SHARE_OF_READING = 0.5;    ///< is done when the meshes begin
constexpr double TOLERANCE_OF_SIZE = 0.001; ///< of the model's diagonal
/// A circle has thirty sides at least, however small it is in the whole.
constexpr double ANGLE = 2.0 * std::numbers::pi / 30.0;
/// So that a small part of a large model is round as well.
constexpr double TOLERANCE_OF_PART = 0.01;
constexpr double SHORTEST_OF_TOLERANCE = 0.05;

double diagonalOf(const Bnd_Box& box) {
    return box.IsVoid() ? 0.0 : std::sqrt(box.SquareExtent());
}

/// @param tolerance  above 0
IMeshTools_Parameters finenessOf(const TopoDS_Shape& part, double tolerance) {
    Bnd_Box box;
    BRepBndLib::Add(part, box, false);
    const double size = diagonalOf(box);
    IMeshTools_Parameters fineness;
    const double farthest = size > 0.0 ? std::min(tolerance, TOLERANCE_OF_PART * size) : tolerance;
    fineness.Deflection = 0.5 * farthest; // inside a face the library keeps to twice that
    fineness.MinSize = SHORTEST_OF_TOLERANCE * fineness.Deflection;
    fineness.Angle = ANGLE;
    fineness.InParallel = true;
    return fineness;
}

KM_wString textOf(const TCollection_ExtendedString& text) {
    std::string utf8(static_cast<std::size_t>(text.LengthOfCString()) + 1, '\0');
    char* bytes = utf8.data();
    utf8.resize(static_cast<std::size_t>(text.ToUTF8CString(bytes)));
    return KM_wString::FromUtf8(utf8);
}

KM_wString nameAt(const TDF_Label& label) {
    Handle(TDataStd_Name) name;
    return label.FindAttribute(TDataStd_Name::GetID(), name) ? textOf(name->Get()) : KM_wString();
}

KM_Xform xformFrom(const gp_Trsf& from) {
    KM_Xform xform;
    for (int row = 0; row < 3; ++row)
        for (int column = 0; column < 4; ++column)
            xform.m_xform[row][column] = from.Value(row + 1, column + 1);
    return xform;
}

/// What tells one look of a part from another: the part, and the colour that its place gives it.
std::string keyOf(const XCAFPrs_DocumentNode& node) {
    TCollection_AsciiString entry;
    TDF_Tool::Entry(node.RefLabel, entry);
    const bool is_colored = node.Style.IsSetColorSurf();
    const auto color = is_colored ? node.Style.GetColorSurfRGBA() : Quantity_ColorRGBA();
    return std::string(entry.ToCString()) +
           (is_colored ? Quantity_ColorRGBA::ColorToHex(color).ToCString() : "");
}

class PartMeshes {
public:
    PartMeshes(const Handle(TDocStd_Document) & document, const ModelReading& reading)
        : m_document(document), m_reading(reading) {}

    Result<SourceScene> make() {
        countParts();
        m_tolerance = m_reading.tolerance > 0.0 ? m_reading.tolerance : toleranceBySize();
        for (Explorer part = parts(); part.More(); part.Next())
            if (const Result<void> made = place(part.Current()); !made)
                return made.error();
        return std::move(m_scene);
    }

private:
    using Explorer = XCAFPrs_DocumentExplorer;
    using Pieces = std::pair<std::size_t, std::size_t>; ///< the first, and one behind the last

    Explorer parts() const {
        TDF_LabelSequence roots;
        XCAFDoc_DocumentTool::ShapeTool(m_document->Main())->GetFreeShapes(roots);
        return Explorer(m_document, roots, XCAFPrs_DocumentExplorerFlags_OnlyLeafNodes);
    }

    void countParts() {
        for (Explorer part = parts(); part.More(); part.Next())
            ++m_parts;
    }

    double toleranceBySize() const {
        Bnd_Box box;
        TDF_LabelSequence roots;
        XCAFDoc_DocumentTool::ShapeTool(m_document->Main())->GetFreeShapes(roots);
        for (const TDF_Label& root : roots)
            BRepBndLib::Add(XCAFDoc_ShapeTool::GetShape(root), box, false);
        const double size = diagonalOf(box);
        return size > 0.0 ? TOLERANCE_OF_SIZE * size : 1.0;
    }

    Result<void> place(const XCAFPrs_DocumentNode& node) {
        const double share = static_cast<double>(m_placed++) / static_cast<double>(m_parts);
        if (!m_reading.watch.goesOn(ReadingStep::read,
                                    SHARE_OF_READING + (1.0 - SHARE_OF_READING) * share))
            return Error{"it was given up"};
        const Result<Pieces> pieces = piecesOf(node);
        if (!pieces)
            return pieces.error();
        for (std::size_t piece = pieces.value().first; piece < pieces.value().second; ++piece)
            m_scene.places.push_back({{}, piece, xformFrom(node.Location.Transformation())});
        return {};
    }

    Result<Pieces> piecesOf(const XCAFPrs_DocumentNode& node) {
        const auto [known, is_new] = m_pieces.try_emplace(keyOf(node));
        if (is_new) {
            const std::size_t first = m_scene.meshes.size();
            if (const Result<void> made = makePieces(node); !made)
                return made.error();
            known->second = {first, m_scene.meshes.size()};
        }
        return known->second;
    }

    Result<void> makePieces(const XCAFPrs_DocumentNode& node) {
        const TopoDS_Shape shape = XCAFDoc_ShapeTool::GetShape(node.RefLabel);
        if (shape.IsNull())
            return {};
        BRepMesh_IncrementalMesh mesh(shape, finenessOf(shape, m_tolerance));
        const KM_wString own_name = nameAt(node.RefLabel);
        const KM_wString name = own_name.IsEmpty() ? nameAt(node.Label) : own_name;
        if (const Result<void> added =
                addFaceMeshes(node.RefLabel, node.Style, name, m_reading.budget, m_scene);
            !added)
            return added;
        addFreeCurves(shape, m_tolerance, name, m_scene);
        return {};
    }

    Handle(TDocStd_Document) m_document;
    const ModelReading& m_reading;
    SourceScene m_scene;
    std::map<std::string, Pieces> m_pieces;
    double m_tolerance = 1.0;
    std::size_t m_parts = 0;
    std::size_t m_placed = 0;
};

} // namespace

Result<SourceScene> meshesOf(const Handle(TDocStd_Document) & document,
                             const ModelReading& reading) {
    return PartMeshes(document, reading).make();
}

} // namespace quarn
