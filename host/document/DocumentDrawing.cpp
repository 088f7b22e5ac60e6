#include "host/document/DocumentDrawing.h"

#include "engine/render/Renderer.h"
#include "host/document/Document.h"
#include "host/document/DocumentScene.h"

#include <new>
#include <string>
#include <utility>

namespace quarn {

DocumentDrawing::DocumentDrawing(const Document& document)
    : m_document(document), m_light(document) {}

DocumentDrawing::~DocumentDrawing() = default;

void DocumentDrawing::release() {
    m_scene.reset();
}

Result<void> DocumentDrawing::update(const SceneChanges& changes) {
    if (!m_scene)
        m_scene = std::make_unique<DocumentScene>();
    const auto updated = m_scene->update(m_document.objects(), m_light.shiningLights(changes),
                                         m_light.settings(changes), changes.hidden);
    if (updated)
        m_object_warning.tell(m_document, m_scene->display().outOfRange());
    return updated;
}

void DocumentDrawing::tellObjectsOutOfRange() {
    std::vector<KM_UUID> ids;
    for (const auto& object : m_document.objects().objects())
        if (!object->isInDrawableRange())
            ids.push_back(object->id);
    m_object_warning.tell(m_document, ids);
}

/// Nothing that was half built is drawn the next time.
Error DocumentDrawing::memoryLacks(const char* how, int width_px, int height_px) {
    release();
    return Error{"A picture of " + std::to_string(width_px) + " by " + std::to_string(height_px) +
                 " pixels cannot be " + how +
                 ": there is too little memory. Close other programs, or choose a smaller size."};
}

Result<void> DocumentDrawing::draw(const KM_Viewport& viewport, const DisplayModeAttributes& mode,
                                   int width_px, int height_px, Image& picture,
                                   const SceneChanges& changes) {
    try {
        const auto updated = update(changes);
        if (!updated)
            return updated;
        m_showed_scene = m_scene->display().canBeSeenBy(viewport, width_px, height_px);
        return m_scene->draw(viewport, withEdges(mode, m_document.edgesOf(mode.id)), width_px,
                             height_px, picture);
    } catch (const std::bad_alloc&) {
        picture = Image();
        return memoryLacks("drawn", width_px, height_px);
    }
}

Result<RenderEnd> DocumentDrawing::render(const KM_Viewport& viewport, const RenderRequest& request,
                                          const std::function<bool(double share)>& watch,
                                          Image& picture, const SceneChanges& changes,
                                          const std::function<void(const Image& so_far)>& shown) {
    try {
        const auto updated = update(changes);
        if (!updated)
            return updated.error();
        m_showed_scene =
            m_scene->display().canBeSeenBy(viewport, request.width_px, request.height_px);
        return Renderer().render(m_scene->display(), viewport, request, watch, picture, shown);
    } catch (const std::bad_alloc&) {
        return memoryLacks("rendered", request.width_px, request.height_px);
    }
}

Result<const DocumentScene*> DocumentDrawing::scene() {
    try {
        const auto updated = update(SceneChanges());
        if (!updated)
            return updated.error();
        return m_scene.get();
    } catch (const std::bad_alloc&) {
        release();
        return Error{"There is too little memory for the scene. Close other programs."};
    }
}

std::unique_ptr<DocumentScene> DocumentDrawing::sceneWith(std::span<const SceneMesh> added) const {
    return std::make_unique<DocumentScene>(m_document.objects(), added, m_scene.get());
}

void DocumentDrawing::takeScene(std::unique_ptr<DocumentScene> scene) {
    m_scene = std::move(scene);
}

Result<void> DocumentDrawing::regenerate() {
    return m_scene ? update(SceneChanges()) : Result<void>();
}

} // namespace quarn
