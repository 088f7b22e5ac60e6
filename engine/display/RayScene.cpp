#include "engine/display/RayScene.h"

#include "engine/display/BuildProgress.h"
#include "engine/display/OpacityFilter.h"
#include "engine/display/SurfaceLook.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numeric>
#include <set>
#include <string>
#include <utility>

namespace quarn {

namespace {

/// A mesh of this many triangles has a scene of its own; smaller ones share scenes.
constexpr std::size_t large_mesh_triangles = 8192;
/// Scenes of meshes beyond this are built compact: that takes half the time and, at five million
/// triangles, 300 MB less, for rays that take about a third longer.
constexpr std::size_t compact_mesh_triangles = 4'000'000;

/// How many triangles a shared scene has at most. Rays are quickest in few large scenes; but once
/// some of its meshes is hidden or shown again a scene is split into small ones, whose rebuild
/// takes about 2 ms.
constexpr std::size_t bundle_triangles = 262144;
constexpr std::size_t split_bundle_triangles = 8192;

/// The first three rows, column by column.
std::array<float, 12> columnsOf(const KM_Xform& x) {
    std::array<float, 12> columns{};
    for (std::size_t j = 0; j < 4; ++j)
        for (std::size_t i = 0; i < 3; ++i)
            columns[3 * j + i] = static_cast<float>(x.m_xform[i][j]);
    return columns;
}

SurfacePlace placeOf(const KM_Xform& x) {
    SurfacePlace place{};
    double cofactors[3][3];
    double largest = 0.0;
    for (int i = 0; i < 3; ++i)
        for (int j = 0; j < 3; ++j) {
            const auto at = [&](int row, int column) {
                return x.m_xform[(i + row) % 3][(j + column) % 3];
            };
            place.linear[i][j] = static_cast<float>(x.m_xform[i][j]);
            cofactors[i][j] = at(1, 1) * at(2, 2) - at(1, 2) * at(2, 1);
            largest = std::max(largest, std::abs(cofactors[i][j]));
        }
    const int exponent = std::ilogb(largest); // powers of two leave all digits as they are
    for (int i = 0; i < 3; ++i)
        for (int j = 0; j < 3; ++j)
            place.cofactors[i][j] = static_cast<float>(std::ldexp(cofactors[i][j], -exponent));
    place.area_scale = std::ldexp(1.0F, exponent);
    double volume = 0.0;
    for (int j = 0; j < 3; ++j)
        volume += x.m_xform[0][j] * cofactors[0][j];
    place.hand = volume < 0.0 ? -1.0F : 1.0F;
    return place;
}

/// Spreads 10 bits so that two free bits follow each.
std::uint32_t spread(std::uint32_t bits) {
    bits = (bits | (bits << 16)) & 0x030000FFU;
    bits = (bits | (bits << 8)) & 0x0300F00FU;
    bits = (bits | (bits << 4)) & 0x030C30C3U;
    return (bits | (bits << 2)) & 0x09249249U;
}

/// Place along a Z-shaped curve through the box: neighbours on the curve are near in space
/// (G. M. Morton, 1966).
std::uint32_t mortonCode(const KM_3dPoint& p, const KM_BoundingBox& box) {
    const KM_3dVector size = box.Diagonal();
    const KM_3dVector from_corner = p - box.m_min;
    const auto cell = [](double offset, double length) {
        return length > 0.0
                   ? static_cast<std::uint32_t>(1023.0 * std::clamp(offset / length, 0.0, 1.0))
                   : 0U;
    };
    return spread(cell(from_corner.x, size.x)) | (spread(cell(from_corner.y, size.y)) << 1) |
           (spread(cell(from_corner.z, size.z)) << 2);
}

void setEnabled(RTCGeometry geometry, bool enabled) {
    if (enabled)
        rtcEnableGeometry(geometry);
    else
        rtcDisableGeometry(geometry);
}

} // namespace

void RayScene::shareWith(const RayScene& earlier) {
    if (earlier.mustBeBuiltAgain())
        return;
    m_library = earlier.m_library;
    m_shared = earlier.soleGroups();
    std::erase_if(m_shared, [](const auto& shared) { return shared.second->changed; });
}

void RayScene::startLibrary() {
    if (mustBeBuiltAgain())
        abandonLibrary();
    if (!m_library)
        m_library = RayLibrary::start(m_start_error);
}

std::string RayScene::takeError() {
    std::string error = std::exchange(m_start_error, {});
    if (m_library && error.empty())
        error = m_library->takeError();
    if (!error.empty())
        abandonLibrary();
    return error;
}

void RayScene::abandonLibrary() {
    m_root = nullptr;
    m_shared.clear();
    m_instances.clear();
    m_top = RaySceneHandle();
    if (m_library)
        m_library->abandon();
    m_library.reset();
    m_members.clear();
    clearMembers();
}

/// All that is kept of the members, but themselves and their scenes.
void RayScene::clearMembers() {
    m_surfaces.clear();
    m_surface_members.clear();
    m_surface_places.clear();
    m_first_surfaces.clear();
    m_places.clear();
    m_placed_meshes.clear();
}

bool RayScene::standsAlone(const Member& member) const {
    return member.mesh->mesh().m_F.size() >= large_mesh_triangles ||
           m_placed_meshes.contains(member.mesh.get());
}

RayScene::GroupKey RayScene::keyOf(const Member& member) const {
    const RaySurface& surface = member.surface;
    if (!surface.has_cutout && !surface.see_through && surface.passing == 0.0F)
        return {member.mesh.get(), nullptr, 0.0F, 0.0F, false, 0.0F};
    return {member.mesh.get(), surface.texture,     surface.alpha_cutoff,
            surface.opacity,   surface.see_through, surface.passing};
}

RayScene::SoleGroups RayScene::soleGroups() const {
    SoleGroups groups;
    for (const Instance& instance : m_instances)
        if (const RayMesh* const mesh = instance.group->sole_mesh)
            groups.emplace(GroupKey{mesh, nullptr, 0.0F, 0.0F, false, 0.0F}, instance.group);
    return groups;
}

std::size_t RayScene::geometryCount() const {
    std::set<const Group*> groups;
    std::size_t count = 0;
    for (const Instance& instance : m_instances)
        if (groups.insert(instance.group.get()).second)
            count += instance.group->geometries.size();
    return count;
}

void RayScene::build(std::vector<Member> members, BuildProgress* progress) {
    startLibrary();
    if (!m_library)
        return;
    std::vector<bool> wanted;
    for (const Member& member : members)
        wanted.push_back(member.visible);
    bool is_due = !m_root;
    if (!hasMembers(members)) {
        is_due = true;
        SoleGroups groups = soleGroups();
        groups.merge(std::exchange(m_shared, {}));
        // The meshes of the taken-over groups must outlive the search for them.
        const std::vector<Member> earlier_members = std::exchange(m_members, std::move(members));
        addAll(std::move(groups));
    }
    for (std::size_t i = 0; i < m_members.size(); ++i) {
        is_due |= m_members[i].visible != wanted[i];
        setVisible(i, wanted[i]);
    }
    if (is_due)
        commit(progress);
}

/// Whether these are the members that there are, shown or hidden.
bool RayScene::hasMembers(std::span<const Member> members) const {
    return m_top && std::ranges::equal(members, m_members, [](const Member& a, const Member& b) {
               return a.mesh == b.mesh && a.surface == b.surface &&
                      a.frame_from_mesh == b.frame_from_mesh;
           });
}

/// Makes the scenes of all members, which are all shown then.
void RayScene::addAll(SoleGroups groups) {
    m_instances.clear();
    clearMembers();
    m_surfaces.reserve(m_members.size());       // geometries point into it
    m_surface_places.reserve(m_members.size()); // and these into that
    m_places.assign(m_members.size(), {});
    m_top = makeScene(false);
    for (Member& member : m_members) {
        if (!member.frame_from_mesh.IsIdentity())
            m_placed_meshes.insert(member.mesh.get());
        member.visible = true;
    }
    for (std::size_t i = 0; i < m_members.size(); ++i)
        if (standsAlone(m_members[i]))
            addSole(i, groups);
    const std::vector<std::size_t> small = smallMembersBySpace();
    const std::size_t first_surface = m_surfaces.size();
    for (const std::size_t member : small)
        addSurface(member);
    std::vector<RayGeometry> geometries;
    for (std::size_t i = 0; i < small.size(); ++i)
        geometries.push_back(makeSurface(small[i], m_surfaces[first_surface + i]));
    addBundles(small, geometries, bundle_triangles, first_surface, m_instances.size());
}

std::vector<std::size_t> RayScene::smallMembersBySpace() const {
    KM_BoundingBox box;
    std::vector<std::size_t> order;
    for (std::size_t i = 0; i < m_members.size(); ++i) {
        if (standsAlone(m_members[i]))
            continue;
        order.push_back(i);
        box.Union(m_members[i].mesh->box());
    }
    std::vector<std::uint32_t> codes(m_members.size());
    for (const std::size_t i : order)
        if (m_members[i].mesh->box().IsValid())
            codes[i] = mortonCode(m_members[i].mesh->box().Center(), box);
    std::stable_sort(order.begin(), order.end(),
                     [&](std::size_t a, std::size_t b) { return codes[a] < codes[b]; });
    return order;
}

/// Rays can gather all that they meet there.
RaySceneHandle RayScene::makeScene(bool is_compact) const {
    RaySceneHandle scene(rtcNewScene(m_library->device()));
    const unsigned compact = is_compact ? RTC_SCENE_FLAG_COMPACT : RTC_SCENE_FLAG_NONE;
    rtcSetSceneFlags(scene.get(),
                     static_cast<RTCSceneFlags>(RTC_SCENE_FLAG_CONTEXT_FILTER_FUNCTION | compact));
    return scene;
}

std::shared_ptr<RayScene::Group> RayScene::makeGroup(bool is_compact) const {
    auto group = std::make_shared<Group>();
    group->scene = makeScene(is_compact);
    group->changed = true;
    return group;
}

RayGeometry RayScene::makeTriangles(std::size_t member) const {
    const RayMesh& mesh = *m_members[member].mesh;
    RayGeometry geometry(rtcNewGeometry(m_library->device(), RTC_GEOMETRY_TYPE_TRIANGLE));
    rtcSetSharedGeometryBuffer(geometry.get(), RTC_BUFFER_TYPE_VERTEX, 0, RTC_FORMAT_FLOAT3,
                               mesh.paddedVertices(), 0, sizeof(KM_3fPoint),
                               mesh.mesh().m_V.size());
    rtcSetSharedGeometryBuffer(geometry.get(), RTC_BUFFER_TYPE_INDEX, 0, RTC_FORMAT_UINT3,
                               mesh.mesh().m_F.data(), 0, sizeof(KM_MeshTriangle),
                               mesh.mesh().m_F.size());
    return geometry;
}

/// The triangles of a small mesh, ready for a scene that it shares.
RayGeometry RayScene::makeSurface(std::size_t member, const RaySurface& surface) const {
    RayGeometry geometry = makeTriangles(member);
    setOpacityFilter(geometry.get(), surface);
    rtcCommitGeometry(geometry.get());
    return geometry;
}

void RayScene::addSurface(std::size_t member) {
    m_surfaces.push_back(m_members[member].surface);
    m_surface_members.push_back(static_cast<std::uint32_t>(member));
}

/// @param slot  of the instance: a new one, or one whose place in the scene is free
void RayScene::putInstance(std::size_t slot, std::shared_ptr<Group> group,
                           const KM_Xform& frame_from_mesh, std::size_t first_surface) {
    RayGeometry instance(rtcNewGeometry(m_library->device(), RTC_GEOMETRY_TYPE_INSTANCE));
    rtcSetGeometryInstancedScene(instance.get(), group->scene.get());
    rtcSetGeometryTransform(instance.get(), 0, RTC_FORMAT_FLOAT3X4_COLUMN_MAJOR,
                            columnsOf(frame_from_mesh).data());
    rtcCommitGeometry(instance.get());
    rtcAttachGeometryByID(m_top.get(), instance.get(), static_cast<unsigned>(slot));
    if (slot == m_instances.size()) {
        m_instances.emplace_back();
        m_first_surfaces.emplace_back();
    }
    m_first_surfaces[slot] = static_cast<std::uint32_t>(first_surface);
    m_instances[slot] = {std::move(group), std::move(instance), !frame_from_mesh.IsIdentity(), 0,
                         true};
}

void RayScene::addSole(std::size_t member, SoleGroups& groups) {
    const KM_Xform& frame_from_mesh = m_members[member].frame_from_mesh;
    std::shared_ptr<Group>& group = groups[keyOf(m_members[member])];
    const bool is_new = !group;
    if (is_new)
        group = makeGroup(m_members[member].mesh->mesh().m_F.size() > compact_mesh_triangles);
    m_places[member] = {m_instances.size(), 0};
    putInstance(m_instances.size(), group, frame_from_mesh, m_surfaces.size());
    m_instances.back().visible_members = 1;
    addSurface(member);
    if (m_instances.back().placed) {
        m_surface_places.push_back(placeOf(frame_from_mesh));
        m_surfaces.back().place = &m_surface_places.back();
    }
    if (!is_new)
        return;
    group->triangles = m_members[member].mesh->mesh().m_F.size();
    group->geometries.push_back(makeTriangles(member));
    RTCGeometry geometry = group->geometries.back().get();
    if (!setOpacityFilter(geometry, m_surfaces.back()))
        group->sole_mesh = m_members[member].mesh.get();
    rtcCommitGeometry(geometry);
    rtcAttachGeometryByID(group->scene.get(), geometry, 0);
}

/// Lets members, whose surfaces follow each other, share scenes.
/// @param geometries  of the members; they move into the scenes
/// @param slot        of the first scene's instance; further ones are new
void RayScene::addBundles(std::span<const std::size_t> members, std::span<RayGeometry> geometries,
                          std::size_t most_triangles, std::size_t first_surface, std::size_t slot) {
    std::size_t first = 0;
    while (first < members.size()) {
        std::size_t triangles = 0;
        std::size_t end = first;
        while (end < members.size() && (end == first || triangles < most_triangles))
            triangles += m_members[members[end++]].mesh->mesh().m_F.size();
        putInstance(slot, makeGroup(false), KM_Xform(), first_surface + first);
        fillBundle(slot, members.subspan(first, end - first),
                   geometries.subspan(first, end - first));
        m_instances[slot].group->triangles = triangles;
        m_instances[slot].group->is_split = triangles < 2 * split_bundle_triangles;
        first = end;
        slot = m_instances.size();
    }
}

void RayScene::fillBundle(std::size_t slot, std::span<const std::size_t> members,
                          std::span<RayGeometry> geometries) {
    Instance& instance = m_instances[slot];
    Group& group = *instance.group;
    for (std::size_t i = 0; i < members.size(); ++i) {
        const auto id = static_cast<unsigned>(i);
        m_places[members[i]] = {slot, id};
        group.geometries.push_back(std::move(geometries[i]));
        RTCGeometry geometry = group.geometries.back().get();
        rtcAttachGeometryByID(group.scene.get(), geometry, id);
        instance.visible_members += m_members[members[i]].visible ? 1 : 0;
        setEnabled(geometry, m_members[members[i]].visible);
    }
}

void RayScene::split(std::size_t slot) {
    const std::shared_ptr<Group> bundle = m_instances[slot].group;
    const std::size_t first_surface = m_first_surfaces[slot];
    const auto begin = m_surface_members.begin() + static_cast<std::ptrdiff_t>(first_surface);
    const std::vector<std::size_t> members(
        begin, begin + static_cast<std::ptrdiff_t>(bundle->geometries.size()));
    rtcDetachGeometry(m_top.get(), static_cast<unsigned>(slot));
    addBundles(members, bundle->geometries, split_bundle_triangles, first_surface, slot);
}

void RayScene::setVisible(std::size_t member, bool visible) {
    if (m_members[member].visible == visible)
        return;
    const Group& shared = *m_instances[m_places[member].instance].group;
    if (shared.geometries.size() > 1 && !shared.is_split)
        split(m_places[member].instance);
    m_members[member].visible = visible;
    Instance& instance = m_instances[m_places[member].instance];
    instance.visible_members += visible ? 1 : std::size_t(-1);
    if (instance.group->geometries.size() == 1) // then the instance is switched as a whole
        return;
    RTCGeometry geometry = instance.group->geometries[m_places[member].geometry].get();
    setEnabled(geometry, visible);
    instance.group->changed = true;
}

std::size_t RayScene::trianglesToBuild() const {
    std::set<const Group*> groups;
    std::size_t triangles = 0;
    for (const Instance& instance : m_instances)
        if (instance.group->changed && instance.visible_members > 0 &&
            groups.insert(instance.group.get()).second)
            triangles += instance.group->triangles;
    return triangles;
}

void RayScene::commit(BuildProgress* progress) {
    if (!m_library)
        return;
    WatchedCommits commits(progress, progress ? trianglesToBuild() : 0);
    m_root = nullptr;
    for (std::size_t i = 0; i < m_instances.size(); ++i) {
        Instance& instance = m_instances[i];
        const bool wanted = instance.visible_members > 0;
        if (instance.group->changed && wanted) {
            if (!commits.commit(instance.group->scene.get(), instance.group->triangles))
                return;
            ++m_build_count;
            rtcCommitGeometry(instance.geometry.get());
            instance.group->changed = false;
        }
        if (instance.enabled != wanted)
            setEnabled(instance.geometry.get(), wanted);
        instance.enabled = wanted;
    }
    m_has_see_through = false;
    m_has_looks = false;
    m_has_mirrors = false;
    m_has_one_sided = false;
    for (const Member& member : m_members) {
        if (!member.visible)
            continue;
        const RaySurface& surface = member.surface;
        m_has_see_through |= surface.see_through || surface.passing > 0.0F;
        m_has_looks |= surface.look != nullptr;
        m_has_mirrors |= surface.look && surface.look->mirrors;
        m_has_one_sided |= surface.one_sided;
    }
    chooseRoot();
}

/// One group that stands where its vertices say needs no instance above it: rays reach it
/// directly, which saves about an eighth of their time.
void RayScene::chooseRoot() {
    const auto shown = [](const Instance& instance) { return instance.enabled; };
    const auto count = std::count_if(m_instances.begin(), m_instances.end(), shown);
    const auto sole = std::find_if(m_instances.begin(), m_instances.end(), shown);
    m_root = nullptr;
    m_sole_first_surface = 0;
    if (count == 1 && !sole->placed) {
        m_root = sole->group->scene.get();
        m_sole_first_surface =
            m_first_surfaces[static_cast<std::size_t>(sole - m_instances.begin())];
    } else if (count > 0) {
        rtcCommitScene(m_top.get());
        ++m_build_count;
        m_root = m_top.get();
    }
}

RTCScene RayScene::root() const {
    return m_root;
}

} // namespace quarn
