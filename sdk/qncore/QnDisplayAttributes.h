#pragma once

#include "kelmar/KM_Array.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"
#include "sdk/qncore/QnLocalize.h"

/// What a display mode looks like. A value: a copy may be changed and drawn with.
class QNCORE_API CDisplayPipelineAttributes {
public:
    /// What a mode draws of a surface.
    enum mode_kind : int { wireframe = 1, shaded = 2 };

    KM_UUID Id() const { return m_id; }
    const KM_wString& EnglishName() const { return m_english_name; }
    const KM_wString& LocalName() const { return m_local_name; }

    /// Whether a sun study can be seen in this mode: it draws surfaces, and the document's lights
    /// or their shadows on them.
    bool ShowsSunStudies() const {
        return m_mode_kind == shaded && (m_uses_document_lights || m_casts_shadows);
    }

    KM_UUID m_id = KM_nil_uuid;
    KM_wString m_english_name;
    KM_wString m_local_name;
    int m_mode_kind = wireframe;         ///< see mode_kind
    bool m_uses_document_lights = false; ///< lit by the document's lights and sun
    bool m_casts_shadows = false;        ///< directional lights cast shadows
    int m_antialiasing_level = 1;        ///< 0 off, 1 screen, 2 capture
};

/// A mode's name as an option can hold it: without "_", " ", "-" and ",".
inline KM_wString QnCleanedModeName(KM_wString name) {
    for (const wchar_t character : {L'_', L' ', L'-', L','})
        name.Remove(character);
    return name;
}

/// The name by which the commands that set up animations offer a mode. The rendered and the x-ray
/// mode, known by their local names, are "RenderedViewport" and "XRay" in either language's form;
/// another mode has its English name as it stands, and its local name cleaned.
QNCORE_API CQuarnCommandOptionName QnCaptureOptionName(const CDisplayPipelineAttributes& mode);

/// The display modes of the host.
class QNCORE_API CQuarnDisplayAttrsMgr {
public:
    CQuarnDisplayAttrsMgr() = delete;

    /// Fills the list with every display mode in the host's order. The modes are the host's and
    /// live as long as the program.
    /// @return their number
    static int GetDisplayAttrsList(KM_SimpleArray<const CDisplayPipelineAttributes*>& list);

    /// The mode with this id, or null. Lives as long as the program.
    static const CDisplayPipelineAttributes* FindDisplayAttrs(const KM_UUID& id);

    static KM_UUID WireframeModeId();
    static KM_UUID RenderedModeId();
};
