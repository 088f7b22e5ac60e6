#pragma once

#include "engine/scene/LightSettings.h"
#include "host/document/SceneChanges.h"
#include "host/document/SurroundingsFile.h"
#include "kelmar/KM_BoundingBox.h"

#include <cstdint>
#include <optional>
#include <vector>

namespace quarn {

class Document;

/// What a document's scene is lit by.
///
/// Its sun belongs to the sky: in a studio and among the surroundings of a picture it does not
/// shine. Where nobody chose what lies around, it is the sky for buildings and the studio for
/// products (surroundingsOf), whereby the sun of the document counts only where somebody moved it;
/// a new one has it too. One that nobody moved makes way for the suns of a model: these shine
/// alone.
///
/// In a sun study the lights of the document rest and the sun of the study shines alone, under the
/// sky unless something else was chosen. A study is drawn where the changes have its sun, and while
/// a plug-in has one in the light table with the document's own sun off.
class DocumentLight {
public:
    /// @param document  must outlive this
    explicit DocumentLight(const Document& document) : m_document(document) {}

    /// The lights that are on: the sun of the document first, then those of its table.
    std::vector<KM_Light> shiningLights(const SceneChanges& changes = {});
    /// What lies around, which is never left open, and what the scene stands before and on. A
    /// picture of the surroundings is read where it was not yet; one that cannot be read is told
    /// once, and is taken for nothing chosen.
    LightSettings settings(const SceneChanges& changes = {});

    /// Reads the picture of surroundings that a document is to be given.
    /// @param file  absolute
    /// @return an error in a sentence where it cannot be read
    Result<void> readSurroundings(const std::filesystem::path& file) {
        return m_picture.read(file);
    }

private:
    std::optional<KM_Light> studySun(const SceneChanges& changes) const;
    /// The document's sun, where it is on and shines.
    std::optional<KM_Light> ownSun(const SceneChanges& changes) const;
    Surroundings openSurroundings(const LightSettings& settings, const SceneChanges& changes);
    const KM_BoundingBox& surfaceBox();

    const Document& m_document;
    SurroundingsPicture m_picture;
    KM_BoundingBox m_surface_box;                ///< of all surfaces, shown or hidden
    std::optional<std::uint64_t> m_box_revision; ///< of the objects that it is the box of
};

} // namespace quarn
