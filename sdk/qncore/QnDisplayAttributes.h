#pragma once

#include "kelmar/KM_Array.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

/// What a display mode looks like. A value: a copy may be changed and drawn with.
class QNCORE_API CDisplayPipelineAttributes {
public:
    /// What a mode draws of a surface.
    enum mode_kind : int { wireframe = 1, shaded = 2 };

    KM_UUID Id() const { return m_id; }
    const KM_wString& EnglishName() const { return m_english_name; }
    const KM_wString& LocalName() const { return m_local_name; }

    KM_UUID m_id = KM_nil_uuid;
    KM_wString m_english_name;
    KM_wString m_local_name;
    int m_mode_kind = wireframe;         ///< see mode_kind
    bool m_uses_document_lights = false; ///< lit by the document's lights and sun
    bool m_casts_shadows = false;        ///< directional lights cast shadows
    int m_antialiasing_level = 1;        ///< 0 off, 1 screen, 2 capture
};

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
