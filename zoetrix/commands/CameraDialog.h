#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "zoetrix/commands/DialogChoices.h"
#include "zoetrix/ui/ZoetrixDataUI.h"

/// A camera dialog of the dialog plug-in.
struct CameraDialog {
    FindDialog find;
    PreviewRenders preview_renders;
};

/// Asks for frame count, sequence name, file type, capture method and viewport in a dialog, and
/// writes the answers into the record; the frame count is for the caller to store. An invalid name
/// is repaired, which a message box tells. A selection outside its list changes nothing.
///
/// @param lists        the direction list, where the dialog has one, with its selection; the other
///                     lists are filled here. Receives what was selected
/// @param frame_count  shown first; receives what was entered, which may be below 1
/// @return success; cancel when the dialog was not confirmed and, after a message, for a name that
///         cannot be repaired; failure when there is no such dialog. Unless it is success the
///         record is as it was
int AskInDialog(const CameraDialog& dialog, CZoetrixDataUI& lists, KM_3dmAnimationProperties& props,
                int& frame_count);

/// The same in the path dialog, which has no directions, for all commands along curves.
int AskInPathDialog(KM_3dmAnimationProperties& props, int& frame_count);
