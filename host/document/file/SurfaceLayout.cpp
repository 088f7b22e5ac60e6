#include "host/document/file/SurfaceLayout.h"

#include "engine/scene/MaterialCheck.h"
#include "engine/scene/MaterialFields.h"

#include <algorithm>

namespace quarn {

namespace {

constexpr int SURFACE_LAYOUT_MAJOR = 1;
constexpr int SURFACE_LAYOUT_MINOR = 0;

/// The qualities as numbers that can be compared; of textures only whether they are there.
class QualityNumbers {
public:
    explicit QualityNumbers(const Material& material) {
        qualityFields(
            [this](const char*, const auto& quality) {
                add(quality);
                return true;
            },
            material);
    }
    friend bool operator==(const QualityNumbers&, const QualityNumbers&) = default;

private:
    void add(float number) { m_numbers.push_back(number); }
    void add(bool flag) { m_numbers.push_back(flag ? 1.0F : 0.0F); }
    void add(const LinearRgb& color) {
        m_numbers.insert(m_numbers.end(), color.begin(), color.end());
    }
    void add(const TextureUse& use) { add(use.texture != nullptr); }

    std::vector<float> m_numbers;
};

class QualityWriter {
public:
    QualityWriter(KM_BinaryArchive& archive, const SharedPlaces& places)
        : m_archive(archive), m_places(places) {}

    bool operator()(const char*, const auto& quality) { return write(quality); }

private:
    bool write(float number) { return m_archive.WriteFloat(number); }
    bool write(bool flag) { return m_archive.WriteBool(flag); }
    bool write(const LinearRgb& numbers) {
        return std::ranges::all_of(numbers,
                                   [this](float number) { return m_archive.WriteFloat(number); });
    }
    bool write(const TextureUse& use) {
        if (!m_archive.WriteInt(m_places.of(use.texture.get())) || !use.texture)
            return !m_archive.HasFailed();
        return write(use.u) && write(use.v);
    }

    KM_BinaryArchive& m_archive;
    const SharedPlaces& m_places;
};

class QualityReader {
public:
    QualityReader(KM_BinaryArchive& archive, const SharedContent& shared)
        : m_archive(archive), m_shared(shared) {}

    bool operator()(const char*, auto& quality) { return read(quality); }

private:
    bool read(float& number) { return m_archive.ReadFloat(number); }
    bool read(bool& flag) { return m_archive.ReadBool(flag); }
    bool read(LinearRgb& numbers) {
        return std::ranges::all_of(numbers,
                                   [this](float& number) { return m_archive.ReadFloat(number); });
    }
    bool read(TextureUse& use) {
        if (!readShared(m_archive, m_shared.textures, true, use.texture) || !use.texture)
            return !m_archive.HasFailed();
        return read(use.u) && read(use.v);
    }

    KM_BinaryArchive& m_archive;
    const SharedContent& m_shared;
};

/// Of a newer minor layout, what follows is passed over.
bool endSurface(KM_BinaryArchive& archive, int minor) {
    std::span<const std::uint8_t> rest;
    return minor == SURFACE_LAYOUT_MINOR || archive.ViewBytes(archive.BytesLeft(), rest);
}

} // namespace

bool hasSurface(const Material& material) {
    return QualityNumbers(material) != QualityNumbers(Material());
}

bool losesSurfaces(const DocumentContent& content) {
    return content.version < FIRST_VERSION_WITH_SURFACES &&
           std::ranges::any_of(content.objects, [](const ObjectContent& object) {
               return object.placed.material && hasSurface(*object.placed.material);
           });
}

bool writeSurface(KM_BinaryArchive& archive, const Material& material, const SharedPlaces& places) {
    Material drawable = material;
    makeDrawable(drawable);
    return archive.Write3dmChunkVersion(SURFACE_LAYOUT_MAJOR, SURFACE_LAYOUT_MINOR) &&
           qualityFields(QualityWriter(archive, places), drawable);
}

bool readSurface(KM_BinaryArchive& archive, SharedContent& shared) {
    auto material = std::make_shared<Material>(*shared.materials.back());
    int major = 0;
    int minor = 0;
    if (!archive.Read3dmChunkVersion(major, minor) ||
        !qualityFields(QualityReader(archive, shared), *material) || !endSurface(archive, minor))
        return false;
    if (major != SURFACE_LAYOUT_MAJOR)
        return archive.Fail();
    makeDrawable(*material);
    shared.materials.back() = std::move(material);
    return true;
}

} // namespace quarn
