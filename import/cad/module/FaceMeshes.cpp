#include "import/cad/module/FaceMeshes.h"

#include "import/assembly/MeshPlacing.h"
#include "import/assembly/StoredColor.h"

#include <RWMesh_FaceIterator.hxx>

#include <map>
#include <optional>
#include <tuple>

namespace quarn {

namespace {

using ColorKey = std::optional<std::tuple<int, int, int, int>>;

KM_Color colorOf(const Quantity_ColorRGBA& color) {
    double r = 0.0;
    double g = 0.0;
    double b = 0.0;
    color.GetRGB().Values(r, g, b, Quantity_TOC_sRGB);
    return colorFromSrgb(static_cast<float>(r), static_cast<float>(g), static_cast<float>(b),
                         color.Alpha());
}

KM_3fVector normalAt(const RWMesh_FaceIterator& face, int node) {
    const gp_Dir normal = face.NormalTransformed(node);
    return {static_cast<float>(normal.X()), static_cast<float>(normal.Y()),
            static_cast<float>(normal.Z())};
}

bool isUsable(const gp_Pnt& point) {
    return isUsableCoordinate(point.X()) && isUsableCoordinate(point.Y()) &&
           isUsableCoordinate(point.Z());
}

/// Every face has vertices of its own, so that its borders stay sharp as far as its surface's
/// normals say so.
class Piece {
public:
    /// @return false where a vertex of the face is no usable number; then it is left out
    bool add(const RWMesh_FaceIterator& face) {
        for (int node = face.NodeLower(); node <= face.NodeUpper(); ++node)
            if (!isUsable(face.NodeTransformed(node)))
                return false;
        const auto first = static_cast<std::uint32_t>(mesh->m_V.size());
        for (int node = face.NodeLower(); node <= face.NodeUpper(); ++node) {
            const gp_Pnt point = face.NodeTransformed(node);
            mesh->m_V.emplace_back(static_cast<float>(point.X()), static_cast<float>(point.Y()),
                                   static_cast<float>(point.Z()));
            mesh->m_N.push_back(face.HasNormals() ? normalAt(face, node) : KM_3fVector());
        }
        for (int element = face.ElemLower(); element <= face.ElemUpper(); ++element) {
            const Poly_Triangle triangle = face.TriangleOriented(element);
            KM_MeshTriangle added;
            for (int k = 0; k < 3; ++k)
                added.vi[k] =
                    first + static_cast<std::uint32_t>(triangle.Value(k + 1) - face.NodeLower());
            mesh->m_F.push_back(added);
        }
        return true;
    }

    std::shared_ptr<KM_Mesh> mesh = std::make_shared<KM_Mesh>();
    std::shared_ptr<const Material> material; ///< null: no colour
};

/// Files state a colour alone; parts are shown with a satin finish.
constexpr float ROUGHNESS = 0.5F;

std::shared_ptr<const Material> materialOf(const KM_Color& color) {
    auto material = std::make_shared<Material>();
    material->base_color = color;
    material->see_through = color.a < 255;
    material->roughness = ROUGHNESS;
    return material;
}

std::uint64_t bytesOf(const RWMesh_FaceIterator& face) {
    const auto nodes = static_cast<std::uint64_t>(face.NbNodes());
    const auto triangles = static_cast<std::uint64_t>(face.NbTriangles());
    return nodes * (sizeof(KM_3fPoint) + sizeof(KM_3fVector)) + triangles * sizeof(KM_MeshTriangle);
}

} // namespace

Result<void> addFaceMeshes(const TDF_Label& part, const XCAFPrs_Style& style,
                           const KM_wString& name, ReadingBudget& budget, SourceScene& scene) {
    std::map<ColorKey, Piece> pieces;
    std::uint64_t faces = 0;
    std::uint64_t dropped = 0;
    for (RWMesh_FaceIterator face(part, TopLoc_Location(), true, style); face.More(); face.Next()) {
        if (face.IsEmptyMesh())
            continue;
        if (const Result<void> taken = budget.take(bytesOf(face), "triangles"); !taken)
            return taken;
        ColorKey key;
        const KM_Color color = face.HasFaceColor() ? colorOf(face.FaceColor()) : KM_Color();
        if (face.HasFaceColor())
            key.emplace(color.r, color.g, color.b, color.a);
        Piece& piece = pieces[key];
        if (key && !piece.material)
            piece.material = materialOf(color);
        ++faces;
        dropped += piece.add(face) ? 0 : 1;
    }
    for (auto& [key, piece] : pieces)
        scene.meshes.push_back({name, piece.mesh, {}, piece.material, {}, {}});
    if (const std::string text = leftOutText(dropped, faces, "faces"); !text.empty())
        scene.warnings.push_back(text);
    return {};
}

} // namespace quarn
