#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Viewport.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnObject.h"
#include "sdk/qncore/QnView.h"

#include <vector>

// What showing frames changes for a while. Each of these puts its part back at the end of its
// scope, however that is left.

/// The curves that camera and target follow. What is hidden stays so unless ShowAgainAtEnd was
/// called.
class HiddenPaths {
public:
    explicit HiddenPaths(CQuarnDoc& doc) : m_doc(doc) {}
    ~HiddenPaths();
    HiddenPaths(const HiddenPaths&) = delete;
    HiddenPaths& operator=(const HiddenPaths&) = delete;

    /// @param curves  ids of objects; those that are gone, or hidden already, are passed over
    void Hide(const KM_SimpleArray<KM_UUID>& curves);
    /// From here on the end of the scope shows what was hidden, and rebuilds the views.
    void ShowAgainAtEnd() { m_shows_again = true; }

private:
    CQuarnDoc& m_doc;
    std::vector<CQuarnObjRef> m_hidden; ///< by this object, not before
    bool m_shows_again = false;
};

/// A view's display mode.
class SavedDisplayMode {
public:
    /// @param restores  put the mode back at the end
    SavedDisplayMode(CQuarnView& view, bool restores);
    ~SavedDisplayMode();
    SavedDisplayMode(const SavedDisplayMode&) = delete;
    SavedDisplayMode& operator=(const SavedDisplayMode&) = delete;

private:
    CQuarnView& m_view;
    KM_UUID m_mode_id; ///< nil when the view had none
    bool m_restores;
};

/// A viewport's camera and projection.
class SavedCamera {
public:
    /// @param restores  put the camera back at the end
    SavedCamera(CQuarnViewport& viewport, bool restores);
    ~SavedCamera();
    SavedCamera(const SavedCamera&) = delete;
    SavedCamera& operator=(const SavedCamera&) = delete;

private:
    CQuarnViewport& m_viewport;
    KM_Viewport m_saved;
    bool m_restores;
};

/// The document's sun, switched off.
class SunSwitchedOff {
public:
    explicit SunSwitchedOff(CQuarnDoc& doc);
    ~SunSwitchedOff();
    SunSwitchedOff(const SunSwitchedOff&) = delete;
    SunSwitchedOff& operator=(const SunSwitchedOff&) = delete;

private:
    CQuarnSun& m_sun;
    bool m_was_on;
};

/// The light of a sun study, which is taken out of the document again at the end.
class StudyLight {
public:
    StudyLight(CQuarnDoc& doc, KM_3dmAnimationProperties& props) : m_doc(doc), m_props(props) {}
    ~StudyLight();
    StudyLight(const StudyLight&) = delete;
    StudyLight& operator=(const StudyLight&) = delete;

    /// Lights the document from one point toward another, instead of as before.
    void Shine(const KM_3dPoint& from, const KM_3dPoint& to);

private:
    CQuarnDoc& m_doc;
    KM_3dmAnimationProperties& m_props; ///< keeps the light's index
};
