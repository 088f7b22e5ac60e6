#include "import/ModelTurn.h"

namespace quarn {

namespace {

/// To build the search structure of a mesh anew takes a tenth of a second for a million triangles;
/// rays that meet it where a transform puts it take an eighth longer ever after.
constexpr std::size_t QUICKLY_BUILT_TRIANGLES = 500'000;

PlacedMesh turned(const PlacedMesh& placed, const KM_Xform& turn) {
    if (placed.world_from_mesh.IsIdentity() && placed.mesh->m_F.size() <= QUICKLY_BUILT_TRIANGLES) {
        auto mesh = std::make_shared<KM_Mesh>(*placed.mesh);
        if (mesh->Transform(turn))
            return {std::move(mesh), placed.material, {}};
    }
    return {placed.mesh, placed.material, turn * placed.world_from_mesh};
}

} // namespace

KM_Xform zUpFromYUp() {
    KM_Xform xform;
    xform.m_xform[1][1] = 0.0;
    xform.m_xform[1][2] = -1.0;
    xform.m_xform[2][1] = 1.0;
    xform.m_xform[2][2] = 0.0;
    return xform;
}

ImportedModel turnedUp(const ImportedModel& model, UpAxis up) {
    KM_Xform turn = zUpFromYUp();
    if (up == UpAxis::z)
        turn.Transpose(); // which takes a turn back
    ImportedModel result = model;
    result.up = {up, TakenUpAxis::Reason::asked, {}};
    for (ImportedMesh& mesh : result.meshes)
        mesh.placed = turned(mesh.placed, turn);
    for (ImportedCurve& curve : result.curves)
        for (KM_3dPoint& point : curve.points)
            point = turn * point;
    for (KM_3dPoint& point : result.points)
        point = turn * point;
    return result;
}

} // namespace quarn
