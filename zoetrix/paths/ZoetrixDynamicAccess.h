#pragma once

#include "sdk/qncore/QnZoetrixDynamicAccess.h"

class CQuarnViewport;

/// The object through which the host, and what else is loaded, reaches the animation. The plug-in
/// object makes it, registers it with the host, and removes it before deleting it. It keeps nothing
/// between calls.
class CZoetrixDynamicAccess : public IQnZoetrixDynamicAccess {
public:
    ~CZoetrixDynamicAccess() override;

    /// The record of the plug-in object; valid until the plug-in is unloaded.
    const KM_3dmAnimationProperties& AnimationProperties(const CQuarnDoc& doc) const override;
    /// Replaces the record of the plug-in object by a copy of `rec`.
    void SetAnimationProperties(const CQuarnDoc& doc,
                                const KM_3dmAnimationProperties& rec) override;

    /// The camera of a frame. A path with both curves, and a flythrough with its curve, is looked
    /// up anew from the curves as they are now. Changes nothing but `out`.
    ///
    /// @param frame  from 1; frame N is element N-1 of the record's points
    /// @param out    the animated view's viewport, moved to the frame; not to be used on failure
    /// @return false when there is no such frame, when the record names no view of the document,
    ///         for a sun study, and when the camera cannot be placed
    bool AnimatedViewAtFrame(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec, int frame,
                             KM_Viewport& out) override;

    /// The sun light of a frame: a directional light in world coordinates at the frame's camera
    /// point, shining as far as the frame's target point. The direction is not made a unit vector.
    ///
    /// @param frame  from 1
    /// @param light  style, location and direction are set
    /// @return false, with `light` untouched, when there is no such frame, when the record names no
    ///         view of the document, and for any animation but a sun study
    bool AnimatedSunAtFrame(CQuarnDoc& doc, const KM_3dmAnimationProperties& rec, int frame,
                            KM_Light& light) override;
};

/// Moves a copy of a live viewport's camera to a point and makes it look at another. A camera that
/// was rolled about its line of sight keeps that roll relative to the world's up; a camera whose up
/// is locked keeps its up, and its direction is laid into the plane perpendicular to it.
///
/// @param out  the moved copy
/// @return false, with `out` untouched, for points that are not valid or coincide (closer than
///         2^-32 in each coordinate), and when no up vector fits the new direction
bool SetTargetAndCameraLocation(const CQuarnViewport& view_vp, KM_3dPoint target, KM_3dPoint camera,
                                KM_Viewport& out);

/// Puts a light into the document in the place of the animation's last one, and stores its index in
/// the record. A record whose light index is negative has none yet; an index that names no live
/// light any more is passed over.
void ReplaceLight(CQuarnDoc& doc, KM_3dmAnimationProperties& rec, KM_Light& light);
