#pragma once

#include "engine/scene/Material.h"
#include "import/ModelReading.h"

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <span>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

namespace quarn {

/// How a texture goes on outside its square, in both directions.
struct TextureWraps {
    TextureWrap u = TextureWrap::repeat;
    TextureWrap v = TextureWrap::repeat;

    friend auto operator<=>(const TextureWraps&, const TextureWraps&) = default;
};

/// The textures of one model file, each decoded once. A texture that cannot be had is left out, and
/// a sentence says so once.
class TextureStore {
public:
    /// @param reading   outlives this object
    /// @param warnings  receives the sentences; outlives this object
    TextureStore(const ModelReading& reading, std::vector<std::string>& warnings)
        : m_reading(reading), m_warnings(warnings) {}

    /// The picture file that the model names, in its folder or below.
    /// @return null where it was left out
    std::shared_ptr<const Texture> fromFile(const std::string& reference, TextureWraps wraps);
    /// A picture that the model file holds.
    /// @param name  names it to the person and tells it from the others of the file
    std::shared_ptr<const Texture>
    fromBytes(const std::string& name, std::span<const std::uint8_t> bytes, TextureWraps wraps);
    /// What is known of a picture: it was had already, or null where it was left out.
    std::optional<std::shared_ptr<const Texture>> known(const std::string& name,
                                                        TextureWraps wraps) const;
    /// Keeps a picture that needs no decoding; null stays null.
    std::shared_ptr<const Texture> keep(const std::string& name, std::shared_ptr<Texture> picture,
                                        TextureWraps wraps);
    /// See withOpacity; the same pair gives the same texture.
    /// @param colors  may be null
    std::shared_ptr<const Texture> combined(const std::shared_ptr<const Texture>& colors,
                                            const std::shared_ptr<const Texture>& opacity);
    /// See metalRoughPicture; the same pair gives the same texture. One picture for both holds them
    /// as they are needed already.
    /// @return null where both are, or it was left out
    std::shared_ptr<const Texture> metalRough(const std::shared_ptr<const Texture>& roughness,
                                              const std::shared_ptr<const Texture>& metalness);
    /// See roughnessOfGlossiness; the same picture and glossiness give the same texture.
    /// @return null where it was left out
    std::shared_ptr<const Texture> roughness(const std::shared_ptr<const Texture>& glossy,
                                             float glossiness);
    /// @param why  a part of a sentence
    void warnLeftOut(const std::string& name, const std::string& why);

private:
    using Key = std::tuple<std::string, TextureWraps>;
    using Pair = std::pair<std::shared_ptr<const Texture>, std::shared_ptr<const Texture>>;

    std::shared_ptr<Texture> load(const std::string& reference);
    bool hasRoomFor(const Texture& another);
    std::shared_ptr<Texture> decoded(const std::string& name, Result<Texture> texture);

    const ModelReading& m_reading;
    std::vector<std::string>& m_warnings;
    std::map<Key, std::shared_ptr<const Texture>> m_textures;
    std::map<Pair, std::shared_ptr<const Texture>> m_combined;
    std::map<Pair, std::shared_ptr<const Texture>> m_metal_rough;
    std::map<std::pair<std::shared_ptr<const Texture>, float>, std::shared_ptr<const Texture>>
        m_rough;
    std::set<std::string> m_told; ///< textures that were left out
};

} // namespace quarn
