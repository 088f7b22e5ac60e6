#pragma once

#include "engine/display/DisplayPipeline.h"
#include "engine/display/DisplayScene.h"
#include "engine/scene/SceneContent.h"

#include <cstdint>
#include <span>

namespace quarn {

class ObjectTable;
struct BuildProgress;
struct ImportedModel;

/// A document's objects made ready for drawing, once for all its views.
class DocumentScene {
public:
    DocumentScene() = default;
    /// A scene that is to be built before its document has all that it shows.
    /// @param objects  of the document
    /// @param added    meshes that will stand behind them; the scene is the document's own once its
    ///                 objects have them
    /// @param earlier  the document's scene, whose large meshes need not be built again; may be
    ///                 null
    DocumentScene(const ObjectTable& objects, std::span<const SceneMesh> added,
                  const DocumentScene* earlier);

    /// Builds a scene of the other constructor, on any thread.
    /// @return an error when it cannot be built, or was given up
    Result<void> build(BuildProgress& progress);

    /// Takes over what changed since the last call: everything when an object was added, removed
    /// or changed, else the lights and what is shown or hidden.
    /// @param lights  that shine
    /// @param light   beside them
    /// @param hidden  objects that are not shown although they are visible
    /// @return an error when the scene cannot be built
    Result<void> update(const ObjectTable& objects, std::span<const KM_Light> lights,
                        const LightSettings& light = {}, std::span<const KM_UUID> hidden = {});

    /// What was built of large meshes of another scene need not be built again by the next update.
    void shareWith(const DocumentScene& other) { m_display.shareWith(other.m_display); }

    /// Takes over a model that is in no document, in place of all that was there.
    Result<void> update(const ImportedModel& model, std::span<const KM_Light> lights);

    /// Draws the scene as the last update left it; as DisplayPipeline::draw. A picture that does
    /// not fit into memory is refused before any work begins.
    Result<void> draw(const KM_Viewport& viewport, const DisplayModeAttributes& mode, int width_px,
                      int height_px, Image& picture);

    /// What the last update left.
    const DisplayScene& display() const { return m_display; }
    /// What it was made of; its meshes, curves and points are in the order of the display's.
    const SceneContent& content() const { return m_content; }

private:
    void takeObjects(const ObjectTable& objects);
    void takeVisibility(const ObjectTable& objects, std::span<const KM_UUID> hidden);

    SceneContent m_content;
    DisplayScene m_display;
    DisplayPipeline m_pipeline; ///< keeps its buffers from picture to picture
    std::uint64_t m_models = 0; ///< that were taken over
};

} // namespace quarn
