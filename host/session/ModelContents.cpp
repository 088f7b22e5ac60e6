#include "host/session/ModelContents.h"

#include "host/commands/AnimationText.h"
#include "host/document/Document.h"
#include "import/ImportedModel.h"

#include <map>
#include <set>

namespace quarn {

namespace {

std::string utf8(const KM_wString& text) {
    return text.ToUtf8();
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
            m_contents.materials.push_back({utf8(material->name), material->base_color,
                                            material->see_through,
                                            textureOf(material->base_color_texture)});
        return known->second;
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
