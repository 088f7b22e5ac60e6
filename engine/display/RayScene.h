#pragma once

#include "engine/display/RayHandle.h"
#include "engine/display/RayLibrary.h"
#include "engine/display/RayMesh.h"
#include "engine/display/RaySurface.h"
#include "engine/display/SurfacePlace.h"
#include "kelmar/KM_Xform.h"

#include <compare>
#include <cstdint>
#include <map>
#include <memory>
#include <span>
#include <unordered_set>
#include <vector>

namespace quarn {

struct BuildProgress;

/// The surfaces that rays meet. Meshes of many triangles, and those that a transform puts into
/// their place, get a scene of their own under an instance; the small others share a few. The first
/// time that one of these is hidden or shown its scene is split, so that from then on showing or
/// hiding an object rebuilds little: nothing for a large one, some thousand triangles for a small.
class RayScene {
public:
    /// One mesh object; `mesh` is drawable and `surface` describes it, without its place.
    struct Member {
        std::shared_ptr<const RayMesh> mesh;
        RaySurface surface;
        bool visible = true;
        KM_Xform frame_from_mesh; ///< affine; members that share a mesh share its search structure
    };

    /// Lets a scene that has nothing yet use those of large meshes that another one has built. Both
    /// may then be used by threads of their own.
    void shareWith(const RayScene& earlier);
    /// Replaces everything. Scenes of large meshes that were there before are taken over, and all
    /// of them where no member changed but in being shown or hidden. The first call starts the
    /// library; where it cannot start, the next one tries again.
    /// @param progress  may be null; where it is given up, the scene is empty
    void build(std::vector<Member> members, BuildProgress* progress = nullptr);
    /// Shows or hides one member, by its index in `build`. Takes effect with the next `commit`.
    void setVisible(std::size_t member, bool visible);
    /// Makes the changes of visibility good.
    /// @param progress  as of `build`
    void commit(BuildProgress* progress = nullptr);

    /// What rays are shot into; null when nothing is visible. The surface of a hit is
    /// firstSurfaces()[instID] + geomID, or soleFirstSurface() + geomID without instances.
    RTCScene root() const;
    bool hasInstances() const { return m_root && m_root == m_top.get(); }
    std::uint32_t soleFirstSurface() const { return m_sole_first_surface; }
    std::span<const std::uint32_t> firstSurfaces() const { return m_first_surfaces; }
    /// In the order of surface indices, which is not that of the members.
    std::span<const RaySurface> surfaces() const { return m_surfaces; }
    /// Of each surface the index of its member in `build`.
    std::span<const std::uint32_t> surfaceMembers() const { return m_surface_members; }

    /// Whether some visible surface lets some of what is behind it through.
    bool hasSeeThrough() const { return m_has_see_through; }
    /// Whether some visible surface looks like more than its base colour.
    bool hasLooks() const { return m_has_looks; }
    /// Whether some visible surface mirrors.
    bool hasMirrors() const { return m_has_mirrors; }
    /// Whether the back of some visible surface is not seen.
    bool hasOneSided() const { return m_has_one_sided; }

    /// How often a search structure, of a group or of all, was built.
    std::size_t buildCount() const { return m_build_count; }
    /// How many meshes have search structures, however often they are shown.
    std::size_t geometryCount() const;

    /// What the library could not do for this thread since the last call, in a sentence for the
    /// person; empty when it could do all. After an error the scene is empty, and the next `build`
    /// starts the library anew.
    std::string takeError();
    /// Whether a scene that shares with this one met an error: then all has to be built again.
    bool mustBeBuiltAgain() const { return m_library && m_library->isAbandoned(); }

private:
    struct Group {
        RaySceneHandle scene;
        std::vector<RayGeometry> geometries;
        const RayMesh* sole_mesh = nullptr; ///< of a mesh that stands alone: to find it again
        std::size_t triangles = 0;
        bool changed = false;
        bool is_split = false; ///< of several meshes: it is small
    };
    struct Instance {
        std::shared_ptr<Group> group;
        RayGeometry geometry;
        bool placed = false; ///< by a transform
        std::size_t visible_members = 0;
        bool enabled = true;
    };
    struct Place {
        std::size_t instance = 0;
        unsigned geometry = 0;
    };

    /// What meshes must have in common to share a scene of their own.
    struct GroupKey {
        const RayMesh* mesh;
        const MipTexture* texture; ///< whose opacity counts
        float cutoff;
        float opacity;
        bool see_through;
        float passing;
        auto operator<=>(const GroupKey&) const = default;
    };
    using SoleGroups = std::map<GroupKey, std::shared_ptr<Group>>;

    void startLibrary();
    void abandonLibrary();
    bool hasMembers(std::span<const Member> members) const;
    void clearMembers();
    bool standsAlone(const Member& member) const;
    GroupKey keyOf(const Member& member) const;
    void addSole(std::size_t member, SoleGroups& groups);
    void addAll(SoleGroups groups);
    void addBundles(std::span<const std::size_t> members, std::span<RayGeometry> geometries,
                    std::size_t most_triangles, std::size_t first_surface, std::size_t slot);
    void fillBundle(std::size_t slot, std::span<const std::size_t> members,
                    std::span<RayGeometry> geometries);
    void split(std::size_t slot);
    void addSurface(std::size_t member);
    void putInstance(std::size_t slot, std::shared_ptr<Group> group,
                     const KM_Xform& frame_from_mesh, std::size_t first_surface);
    RayGeometry makeTriangles(std::size_t member) const;
    RayGeometry makeSurface(std::size_t member, const RaySurface& surface) const;
    RaySceneHandle makeScene(bool is_compact) const;
    std::shared_ptr<Group> makeGroup(bool is_compact) const;
    SoleGroups soleGroups() const;
    std::vector<std::size_t> smallMembersBySpace() const;
    std::size_t trianglesToBuild() const;
    void chooseRoot();

    std::shared_ptr<RayLibrary> m_library; ///< null until something is built
    std::string m_start_error;             ///< why it could not start
    SoleGroups m_shared;                   ///< of another scene, until something is built
    RaySceneHandle m_top;
    RTCScene m_root = nullptr;
    std::uint32_t m_sole_first_surface = 0;
    std::vector<Member> m_members;
    std::vector<Place> m_places;                        ///< by member
    std::unordered_set<const RayMesh*> m_placed_meshes; ///< some member puts them elsewhere
    std::vector<Instance> m_instances;
    std::vector<std::uint32_t> m_first_surfaces;
    std::vector<RaySurface> m_surfaces;
    std::vector<SurfacePlace> m_surface_places;
    std::vector<std::uint32_t> m_surface_members;
    std::size_t m_build_count = 0;
    bool m_has_see_through = false;
    bool m_has_looks = false;
    bool m_has_mirrors = false;
    bool m_has_one_sided = false;
};

} // namespace quarn
