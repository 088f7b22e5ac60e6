#pragma once

#include "ground/Result.h"
#include "host/document/DocumentLight.h"
#include "host/document/RangeWarnings.h"
#include "host/document/SceneChanges.h"

#include <functional>
#include <memory>
#include <span>
#include <vector>

class KM_Viewport;

namespace quarn {

class Document;
class DocumentScene;
struct DisplayModeAttributes;
struct Image;
struct RenderRequest;
struct SceneMesh;
enum class RenderEnd;

/// How a document is drawn. The scene is built once for each revision of the objects and shared by
/// all views; nothing of the document changes. Objects that are out of range are told once, when
/// the scene with them is to be drawn.
class DocumentDrawing {
public:
    /// @param document  must outlive the drawing
    explicit DocumentDrawing(const Document& document);
    ~DocumentDrawing();
    DocumentDrawing(const DocumentDrawing&) = delete;
    DocumentDrawing& operator=(const DocumentDrawing&) = delete;

    /// Draws all that is visible, otherwise than it is where `changes` says so.
    /// @return an error, with the picture unchanged, when the scene cannot be built or drawn; when
    ///         memory lacks, the picture is empty
    Result<void> draw(const KM_Viewport& viewport, const DisplayModeAttributes& mode, int width_px,
                      int height_px, Image& picture, const SceneChanges& changes = {});
    /// Renders the same; as Renderer::render.
    Result<RenderEnd> render(const KM_Viewport& viewport, const RenderRequest& request,
                             const std::function<bool(double share)>& watch, Image& picture,
                             const SceneChanges& changes,
                             const std::function<void(const Image& so_far)>& shown = {});

    /// Whether the camera of the picture that was drawn or rendered last was in range, so that it
    /// shows more than the background.
    bool showedScene() const { return m_showed_scene; }

    /// The scene as it is drawn now, brought up to date. Valid until the next call.
    /// @return an error when it cannot be built
    Result<const DocumentScene*> scene();
    /// A scene of what the document will have once these meshes stand behind its objects. Whoever
    /// builds it may draw the document meanwhile.
    std::unique_ptr<DocumentScene> sceneWith(std::span<const SceneMesh> added) const;
    /// Takes over such a scene after it was built and the meshes were added: what it has is not
    /// built again.
    void takeScene(std::unique_ptr<DocumentScene> scene);
    /// Brings the scene up to date where it was built before.
    Result<void> regenerate();
    /// Frees the scene.
    void release();

    /// Tells which objects are out of range, of which no scene need be built.
    void tellObjectsOutOfRange();

    /// What the document is lit by.
    DocumentLight& light() { return m_light; }

private:
    Result<void> update(const SceneChanges& changes);
    Error memoryLacks(const char* how, int width_px, int height_px);

    const Document& m_document;
    std::unique_ptr<DocumentScene> m_scene; ///< null until something is drawn
    ObjectRangeWarning m_object_warning;
    DocumentLight m_light;
    bool m_showed_scene = true;
};

} // namespace quarn
