#include "host/session/ModelContents.h"

#include "engine/scene/MaterialFields.h"
#include "host/commands/AnimationText.h"
#include "host/document/Document.h"
#include "import/ImportedModel.h"

#include <charconv>
#include <map>
#include <set>

namespace quarn {

namespace {

std::string utf8(const KM_wString& text) {
    return text.ToUtf8();
}

/// The double that has the fewest digits among those that are this float: 0.3, where the float is
/// 0.300000012.
double asRead(float number) {
    std::array<char, 32> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr;
    double read = number;
    std::from_chars(digits.data(), end, read);
    return read;
}

std::array<double, 3> asRead(const std::array<float, 3>& numbers) {
    return {asRead(numbers[0]), asRead(numbers[1]), asRead(numbers[2])};
}

class Telling {
public:
    explicit Telling(const Document& document) : m_document(document) {}

    ModelContents tell() {
        for (const auto& object : m_document.objects().objects())
            addObject(*object);
        for (const NamedView& view : m_document.namedViews())
            m_contents.cameras.push_back(utf8(view.name));
        m_contents.lights = m_document.lights().live().size();
        m_contents.units = utf8(unitName(m_document.units()));
        if (m_box.IsValid())
            m_contents.box = {m_box.m_min, m_box.m_max};
        if (const ReadingNotes* const notes = m_document.readingNotes()) {
            tellAxis(notes->up);
            m_contents.left_out = notes->warnings;
        }
        return std::move(m_contents);
    }

private:
    void tellAxis(const TakenUpAxis& up) {
        using Reason = TakenUpAxis::Reason;
        if (up.reason == Reason::file)
            return;
        m_contents.up_axis = up.axis == UpAxis::y ? 'y' : 'z';
        m_contents.up_reason = reasonOf(up);
        m_contents.up_is_guessed = up.reason == Reason::habit || up.reason == Reason::writer;
    }

    static std::string reasonOf(const TakenUpAxis& up) {
        switch (up.reason) {
        case TakenUpAxis::Reason::format:
            return "as its format has it";
        case TakenUpAxis::Reason::habit:
            return "as most such files have it";
        case TakenUpAxis::Reason::writer:
            return "as " + up.writer + " writes it";
        case TakenUpAxis::Reason::file:
        case TakenUpAxis::Reason::asked:
            break;
        }
        return "as was asked";
    }

    void addObject(const DocumentObject& object) {
        ObjectContents told;
        told.name = utf8(object.name);
        told.kind = utf8(object.kind());
        told.is_visible = object.visible;
        if (const auto& mesh = object.placed.mesh) {
            told.triangles = mesh->m_F.size();
            told.vertices = mesh->m_V.size();
            told.repeats = !m_meshes.insert(mesh.get()).second;
            told.material = materialOf(object.placed.material);
        }
        m_box.Union(object.boundingBox());
        m_contents.objects.push_back(std::move(told));
    }

    std::optional<std::size_t> materialOf(const std::shared_ptr<const Material>& material) {
        if (!material)
            return std::nullopt;
        const auto [known, is_new] =
            m_materials.try_emplace(material.get(), m_contents.materials.size());
        if (is_new)
            m_contents.materials.push_back(contentsOf(*material));
        return known->second;
    }

    MaterialContents contentsOf(const Material& material) {
        MaterialContents told;
        told.name = utf8(material.name);
        told.base_color = material.base_color;
        told.is_see_through = material.see_through;
        if (material.alpha_cutout)
            told.alpha_cutoff = asRead(material.alpha_cutoff);
        told.texture = textureOf(material.base_color_texture);
        const auto tell = [&](const char* name, const auto& quality) {
            told.qualities.emplace_back(name, qualityOf(quality));
            return true;
        };
        qualityFields(tell, material);
        tellShortly(material, told);
        return told;
    }

    static void tellShortly(const Material& material, MaterialContents& told) {
        constexpr LinearRgb BLACK{};
        told.is_metal = material.metalness >= 0.5F;
        told.has_normal_map = material.normals.texture != nullptr;
        told.has_clearcoat = material.clearcoat > 0.0F;
        told.shines = material.emission != BLACK;
        told.lets_light_through = material.transmission > 0.0F || material.see_through;
        told.is_unlit = material.is_unlit;
        told.has_sheen = material.sheen_color != BLACK;
    }

    static MaterialQuality qualityOf(bool flag) { return flag; }
    static MaterialQuality qualityOf(float number) { return asRead(number); }
    static MaterialQuality qualityOf(const LinearRgb& color) { return asRead(color); }
    MaterialQuality qualityOf(const TextureUse& use) {
        const auto texture = textureOf(use.texture);
        if (!texture)
            return std::monostate();
        return UsedTexture{*texture, asRead(use.u), asRead(use.v)};
    }

    std::optional<std::size_t> textureOf(const std::shared_ptr<const Texture>& texture) {
        if (!texture)
            return std::nullopt;
        const auto [known, is_new] =
            m_textures.try_emplace(texture.get(), m_contents.textures.size());
        if (is_new)
            m_contents.textures.push_back(
                {texture->width, texture->height, std::uint64_t{texture->rgba.size()}});
        return known->second;
    }

    const Document& m_document;
    ModelContents m_contents;
    KM_BoundingBox m_box;
    std::set<const KM_Mesh*> m_meshes;
    std::map<const Material*, std::size_t> m_materials;
    std::map<const Texture*, std::size_t> m_textures;
};

} // namespace

ModelContents contentsOf(CQuarnDoc& document) {
    ModelContents contents = Telling(Document::of(document)).tell();
    contents.animation = utf8(animationText(Document::of(document)));
    return contents;
}

} // namespace quarn
