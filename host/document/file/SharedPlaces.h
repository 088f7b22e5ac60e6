#pragma once

#include "host/document/file/DocumentContent.h"

#include <cstdint>
#include <map>
#include <memory>
#include <vector>

namespace quarn {

/// What objects share, as it was read. In the file each is named by its place among those of its
/// kind.
struct SharedContent {
    std::vector<std::shared_ptr<const Texture>> textures;
    std::vector<std::shared_ptr<const Material>> materials;
    std::vector<std::shared_ptr<const KM_Mesh>> meshes;
};

/// What objects share and others keep, to be written.
struct SharedThings {
    std::vector<const Texture*> textures;
    std::vector<const Material*> materials;
    std::vector<const KM_Mesh*> meshes;
};

/// The place that stands for no texture and no material.
inline constexpr std::int32_t NO_PLACE = -1;

/// Reads the place of a thing.
/// @param thing  receives it; untouched by NO_PLACE, where that is allowed
/// @return false, with the archive failed, when there is nothing at the place
template <class T>
bool readShared(KM_BinaryArchive& archive, const std::vector<std::shared_ptr<const T>>& things,
                bool may_be_none, std::shared_ptr<const T>& thing) {
    std::int32_t place = NO_PLACE;
    if (!archive.ReadInt(place))
        return false;
    if (place == NO_PLACE && may_be_none)
        return true;
    if (place < 0 || static_cast<std::size_t>(place) >= things.size())
        return archive.Fail();
    thing = things[static_cast<std::size_t>(place)];
    return true;
}

/// The places of the textures, materials and meshes of a file, each kind counted from 0.
class SharedPlaces {
public:
    /// Gives places to all that the objects of a content share, as far as files of its version hold
    /// it, and that has none yet.
    /// @return what got a place, in the order of the places; lives as long as the content
    SharedThings add(const DocumentContent& content);
    /// Keeps the place of a thing that is gone from one that takes its memory; it is given to
    /// nothing else either.
    void forget(const void* gone);

    /// The place of a thing that was added; NO_PLACE for none.
    std::int32_t of(const Texture* texture) const { return m_textures.of(texture); }
    std::int32_t of(const Material* material) const { return m_materials.of(material); }
    std::int32_t of(const KM_Mesh* mesh) const { return m_meshes.of(mesh); }

private:
    template <class T> class Kind {
    public:
        /// Adds a thing that is new to the end of `added`.
        void add(const T* thing, std::vector<const T*>& added) {
            if (!thing || !m_places.try_emplace(thing, m_count).second)
                return;
            ++m_count;
            added.push_back(thing);
        }
        void forget(const void* gone) { m_places.erase(static_cast<const T*>(gone)); }
        std::int32_t of(const T* thing) const {
            const auto found = m_places.find(thing);
            return found == m_places.end() ? NO_PLACE : found->second;
        }

    private:
        std::map<const T*, std::int32_t> m_places;
        std::int32_t m_count = 0;
    };

    Kind<Texture> m_textures;
    Kind<Material> m_materials;
    Kind<KM_Mesh> m_meshes;
};

} // namespace quarn
