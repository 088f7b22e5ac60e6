#include "import/assembly/ModelAssembly.h"

#include "import/ModelTurn.h"
#include "import/assembly/CameraPlacing.h"
#include "import/assembly/MaterialPlacing.h"
#include "import/assembly/MeshPlacing.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

constexpr std::uint64_t MOST_TRIANGLES = 100'000'000;

KM_Xform movedTo(const KM_3dPoint& point) {
    return KM_Xform::Translation(point - KM_3dPoint::Origin);
}

bool isUsablePoint(const KM_3dPoint& p) {
    return isUsableCoordinate(p.x) && isUsableCoordinate(p.y) && isUsableCoordinate(p.z);
}

void addCorners(const KM_BoundingBox& box, const KM_Xform& world_from_box, KM_BoundingBox& all) {
    for (int corner = 0; corner < 8 && box.IsValid(); ++corner) {
        const KM_3dPoint point = world_from_box * box.Corner(corner);
        if (isUsablePoint(point))
            all.Set(point);
    }
}

class Assembly {
public:
    Assembly(SourceScene& scene, const ModelReading& reading)
        : m_scene(scene), m_reading(reading),
          m_file_name(KM_wString::FromUtf8(reading.path.stem().string())) {}

    Result<ImportedModel> make() {
        repairMaterials(m_scene);
        turnUp();
        for (SourcePlace& place : m_scene.places)
            place.world_from_mesh =
                place.world_from_mesh * movedTo(m_scene.meshes[place.mesh].origin);
        countUses();
        if (m_triangles > MOST_TRIANGLES)
            return Error{"its meshes have more than 100 million triangles in all"};
        m_origin = nearbyOrigin(box());
        for (std::size_t done = 0; done < m_scene.places.size(); ++done) {
            const double share =
                static_cast<double>(done) / static_cast<double>(m_scene.places.size());
            if (!m_reading.watch.goesOn(ReadingStep::made, share))
                return Error{"it was given up"};
            placePiece(m_scene.places[done]);
        }
        takeRest();
        return std::move(m_model);
    }

private:
    struct Use {
        std::size_t places = 0;
        bool is_complete = false;
    };

    void turnUp() {
        if (m_scene.up.axis != UpAxis::y)
            return;
        const KM_Xform turn = zUpFromYUp();
        for (SourcePlace& place : m_scene.places)
            place.world_from_mesh = turn * place.world_from_mesh;
        for (SourceCamera& camera : m_scene.cameras) {
            camera.location = turn * camera.location;
            camera.direction = turn * camera.direction;
            camera.up = turn * camera.up;
        }
        for (KM_Light& light : m_scene.lights) {
            light.SetLocation(turn * light.Location());
            light.SetDirection(turn * light.Direction());
        }
    }

    void countUses() {
        m_uses.resize(m_scene.meshes.size());
        for (const SourcePlace& place : m_scene.places) {
            const std::shared_ptr<KM_Mesh>& mesh = m_scene.meshes[place.mesh].mesh;
            const bool is_first = m_uses[place.mesh].places++ == 0;
            if (mesh && (is_first || isFlattening(place.world_from_mesh)))
                m_triangles += mesh->m_F.size();
        }
    }

    /// The box of the boxes of all meshes where they stand.
    KM_BoundingBox box() const {
        std::vector<KM_BoundingBox> boxes;
        for (const SourceMesh& mesh : m_scene.meshes)
            boxes.push_back(mesh.mesh ? mesh.mesh->BoundingBox() : KM_BoundingBox());
        KM_BoundingBox all;
        for (const SourcePlace& place : m_scene.places)
            addCorners(boxes[place.mesh], place.world_from_mesh, all);
        return all;
    }

    void placePiece(const SourcePlace& place) {
        SourceMesh& piece = m_scene.meshes[place.mesh];
        const KM_wString& own_name = place.name.IsEmpty() ? piece.name : place.name;
        const KM_wString& name = own_name.IsEmpty() ? m_file_name : own_name;
        if (piece.mesh && !piece.mesh->m_F.empty())
            addMesh(piece, place, name);
        for (const KM_3dPointArray& line : piece.lines)
            addLine(line, place.world_from_mesh, name);
        for (const KM_3dPoint& point : piece.points)
            addPoint(place.world_from_mesh * point);
    }

    void addMesh(SourceMesh& piece, const SourcePlace& place, const KM_wString& name) {
        Use& use = m_uses[place.mesh];
        const bool is_shared = use.places > 1;
        if (is_shared && !isFlattening(place.world_from_mesh)) {
            if (!std::exchange(use.is_complete, true))
                completeMesh(*piece.mesh);
            addObject({piece.mesh, m_materials.ofShared(piece.material, place.world_from_mesh),
                       place.world_from_mesh},
                      name);
            return;
        }
        const std::shared_ptr<KM_Mesh> mesh =
            is_shared ? std::make_shared<KM_Mesh>(*piece.mesh) : std::move(piece.mesh);
        const KM_3dVector to_origin = KM_3dPoint::Origin - m_origin;
        m_dropped += placeMesh(*mesh, KM_Xform::Translation(to_origin) * place.world_from_mesh);
        if (mesh->m_F.empty())
            return;
        completeMesh(*mesh);
        addObject(
            {mesh, m_materials.ofMoved(piece.material, place.world_from_mesh), movedTo(m_origin)},
            name);
    }

    void addObject(PlacedMesh placed, const KM_wString& name) {
        m_without_area += hasArea(*placed.mesh) ? 0 : 1;
        m_model.meshes.push_back({name, std::move(placed)});
    }

    void addLine(const KM_3dPointArray& line, const KM_Xform& world_from_mesh,
                 const KM_wString& name) {
        KM_3dPointArray points;
        for (const KM_3dPoint& point : line)
            points.Append(world_from_mesh * point);
        if (std::all_of(points.begin(), points.end(), isUsablePoint))
            m_model.curves.push_back({name, std::move(points)});
        else
            ++m_lines_dropped;
    }

    void addPoint(const KM_3dPoint& point) {
        if (isUsablePoint(point))
            m_model.points.Append(point);
        else
            ++m_points_dropped;
    }

    void takeRest() {
        KM_BoundingBox bounds;
        for (const ImportedMesh& mesh : m_model.meshes)
            bounds.Union(mesh.placed.box());
        for (const SourceCamera& camera : m_scene.cameras)
            if (auto placed = placeCamera(camera, bounds))
                m_model.cameras.push_back(std::move(*placed));
        m_model.lights = std::move(m_scene.lights);
        m_model.units = m_scene.units;
        m_model.up = std::move(m_scene.up);
        m_model.place = m_scene.place;
        m_model.warnings = std::move(m_scene.warnings);
        warn(leftOutText(m_dropped, m_triangles, "triangles"));
        warn(leftOutText(m_lines_dropped, m_lines_dropped, "lines"));
        warn(leftOutText(m_points_dropped, m_points_dropped, "points"));
        if (m_without_area > 0)
            warn(std::to_string(m_without_area) +
                 " of its meshes cannot be seen: their triangles have no area.");
    }

    void warn(std::string sentence) {
        if (!sentence.empty())
            m_model.warnings.push_back(std::move(sentence));
    }

    SourceScene& m_scene;
    const ModelReading& m_reading;
    KM_wString m_file_name; ///< names what has no name of its own
    ImportedModel m_model;
    PlacedMaterials m_materials;
    std::vector<Use> m_uses; ///< by mesh of the scene
    KM_3dPoint m_origin;     ///< where the coordinates of meshes that stand once begin
    std::uint64_t m_triangles = 0;
    std::uint64_t m_dropped = 0;
    std::uint64_t m_lines_dropped = 0;
    std::uint64_t m_points_dropped = 0;
    std::uint64_t m_without_area = 0; ///< meshes of triangles that are all lines or points
};

} // namespace

std::string leftOutText(std::uint64_t dropped, std::uint64_t all, std::string_view what) {
    if (dropped == 0)
        return {};
    std::string count = std::to_string(dropped);
    if (all > dropped)
        count += " of " + std::to_string(all);
    return count + " " + std::string(what) +
           " were left out: an index is out of range or a coordinate is no usable number.";
}

Result<ImportedModel> assembleModel(SourceScene scene, const ModelReading& reading) {
    return Assembly(scene, reading).make();
}

} // namespace quarn
