#pragma once

#include "host/document/file/DocumentContent.h"

#include <cstdint>
#include <map>
#include <memory>
#include <vector>

namespace quarn {

/// What objects share. In the file each is named by its place among those of its kind.
struct SharedContent {
    std::vector<std::shared_ptr<const Texture>> textures;
    std::vector<std::shared_ptr<const Material>> materials;
    std::vector<std::shared_ptr<const KM_Mesh>> meshes;
};

/// The place that stands for no texture and no material.
inline constexpr std::int32_t NO_PLACE = -1;

/// The places of the textures, materials and meshes of a file, each kind counted from 0. Things are
/// not kept alive; one that takes the memory of one that is gone has a place of its own.
class SharedPlaces {
public:
    /// Gives places to all that the objects of a content share and that has none yet.
    /// @return what got a place, in the order of the places
    SharedContent add(const DocumentContent& content);

    /// The place of a thing that was added; NO_PLACE for none.
    std::int32_t of(const std::shared_ptr<const Texture>& texture) const {
        return m_textures.of(texture);
    }
    std::int32_t of(const std::shared_ptr<const Material>& material) const {
        return m_materials.of(material);
    }
    std::int32_t of(const std::shared_ptr<const KM_Mesh>& mesh) const { return m_meshes.of(mesh); }

private:
    template <class T> class Kind {
    public:
        /// Adds a thing that is new to the end of `added`.
        void add(const std::shared_ptr<const T>& thing,
                 std::vector<std::shared_ptr<const T>>& added) {
            if (!thing)
                return;
            const auto [known, is_new] = m_places.try_emplace(thing.get());
            if (!is_new && !known->second.thing.expired())
                return;
            known->second = {thing, m_count++};
            added.push_back(thing);
        }
        std::int32_t of(const std::shared_ptr<const T>& thing) const {
            const auto found = m_places.find(thing.get());
            return thing && found != m_places.end() ? found->second.place : NO_PLACE;
        }

    private:
        struct Known {
            std::weak_ptr<const T> thing;
            std::int32_t place = NO_PLACE;
        };
        std::map<const T*, Known> m_places;
        std::int32_t m_count = 0;
    };

    Kind<Texture> m_textures;
    Kind<Material> m_materials;
    Kind<KM_Mesh> m_meshes;
};

} // namespace quarn
