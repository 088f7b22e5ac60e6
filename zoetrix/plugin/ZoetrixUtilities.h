#pragma once

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Curve.h"
#include "kelmar/KM_wString.h"

class CQuarnDoc;
class CQuarnView;

/// What every part of the plug-in may use. Each operation is defined in the folder of its subject.
class CZoetrixUtilities {
public:
    CZoetrixUtilities() = delete;

    /// Gives the plug-in's own record its starting values: the capture method is the local name of
    /// the wireframe mode, the sequence name the local "Animation", and the folder a folder of that
    /// name in the user's documents folder; it stays empty when there is no such documents folder.
    /// Nothing else changes.
    static void InitializeAnimationProperties(KM_3dmAnimationProperties& props);

    /// Computes the frame points of a path or a flythrough anew from the curves in the document, so
    /// that a curve that was edited after the set-up is followed. The lists may come out shorter
    /// than the frame count where a curve cannot be evaluated.
    ///
    /// @return false, with the record unchanged, when the curve of a flythrough yields no points;
    ///         true otherwise, also where there was nothing to do: a deleted curve, or another kind
    ///         of animation
    static bool ResetAnimation(KM_3dmAnimationProperties& props);

    /// Divides a curve into one point per frame, at equal steps of the curve's parameter.
    ///
    /// An open curve is divided from end to end. A closed one gives its seam once, as the last
    /// point. For a flythrough the curve is divided into one step more: the camera gets all points
    /// but the last, the target all but the first, so that it runs one step ahead.
    ///
    /// @param curve       may be null
    /// @param count       frames wanted
    /// @param points      emptied, then filled; untouched when the curve is null. Parameters at
    ///                    which the curve cannot be evaluated are left out
    /// @param look_ahead  camera and target ride the same curve
    /// @param is_camera   the camera's points (not the target's); only looked at with `look_ahead`
    /// @return true when there is at least one point; false also when memory does not hold them
    static bool GetPathPoints(const KM_Curve* curve, int count, KM_3dPointArray& points,
                              bool look_ahead, bool is_camera);

    /// The page that plays the recorded images in a browser, with the record's sequence name as its
    /// title. Names and labels stand in it as they are stored.
    static KM_wString GetHTMLtemplate(KM_3dmAnimationProperties& props);

    /// The first view of the document whose main viewport has this name, or null. Owned by the
    /// document; valid until the view is closed, which never happens while a command runs.
    static CQuarnView* FindQuarnViewByName(CQuarnDoc& doc, const KM_wString& name,
                                           bool ignore_case);
};
