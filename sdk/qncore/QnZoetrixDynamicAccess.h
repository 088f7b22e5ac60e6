#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Viewport.h"
#include "sdk/qncore/QnExport.h"

class CQuarnDoc;

/// The id of the plug-in that sets up animations: 3AA81848-5635-41BB-ABDB-0EC069BC5519.
inline constexpr KM_UUID ZoetrixPlugInId = {
    0x3AA81848, 0x5635, 0x41BB, {0xAB, 0xDB, 0x0E, 0xC0, 0x69, 0xBC, 0x55, 0x19}};

/// Through this object the host, and whatever else is loaded, reaches the animation of a document:
/// its record, and the camera or the sun of any frame. The animation plug-in implements it and
/// registers one object; the order of the virtual operations is part of the interface.
class QNCORE_API IQnZoetrixDynamicAccess {
public:
    virtual ~IQnZoetrixDynamicAccess();

    /// The record of the document; valid until the record is replaced or the plug-in unloaded.
    virtual const KM_3dmAnimationProperties& AnimationProperties(const CQuarnDoc& doc) const = 0;
    /// Replaces the record of the document by a copy of this one.
    virtual void SetAnimationProperties(const CQuarnDoc& doc,
                                        const KM_3dmAnimationProperties& rec) = 0;
    /// The camera of a frame of a camera animation.
    /// @param frame  from 1
    /// @param out    set on success; on failure not to be used
    /// @return false when there is no such frame, no such view, or no camera in this animation
    virtual bool AnimatedViewAtFrame(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec,
                                     int frame, KM_Viewport& out) = 0;
    /// The sun light of a frame of a sun study: style, location and direction of `light` are set.
    /// @param frame  from 1
    /// @return false, with `light` untouched, when there is no such frame, no such view, or the
    ///         animation is no sun study
    virtual bool AnimatedSunAtFrame(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec, int frame,
                                    KM_Light& light) = 0;
};

/// Installs the object through which the host reaches the animation record, or, with null, removes
/// it. The caller keeps the object and removes it before deleting it. Throws nothing. On another
/// thread than the main one it is a breach of the interface and does nothing.
QNCORE_API void Zoetrix_SetQuarnDynamicAccess(IQnZoetrixDynamicAccess* access);

/// The installed object, or null, as after the breach of asking on another thread than the main
/// one. Not owned by the caller.
QNCORE_API IQnZoetrixDynamicAccess* Zoetrix_QuarnDynamicAccess();
