#pragma once

#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_Array.h"
#include "kelmar/KM_Uuid.h"
#include "sdk/vexui/VexUi.h"
#include "zoetrix/ui/ZoetrixDataUI.h"

// What all set-up commands that ask in a dialog have in common: the choices for file type, capture
// method and viewport, and the dialog plug-in that shows them.

/// Which renderer "RenderPreview" stands for when it is chosen in a dialog.
enum class PreviewRenders {
    preview,
    full, ///< the full renderer, in paths and sun studies: their frames take as long as with
          ///< "RenderFull"
};

/// Finds the entry point of a dialog, once the dialog plug-in is loaded.
using FindDialog = QnZoetrixVexUiDialog (*)();

/// The ids of the display modes in the capture list, where they stand behind the render methods.
using DisplayModeIds = KM_SimpleArray<KM_UUID>;

/// Fills the lists of file types, capture methods and viewports, each with the record's present
/// choice selected.
///
/// @param sun_filter  leave out the display modes in which a sun study cannot be seen
/// @param lists       its direction list is left as it is
/// @param modes       emptied, then filled
void FillLists(KM_3dmAnimationProperties& props, bool sun_filter, CZoetrixDataUI& lists,
               DisplayModeIds& modes);

/// Loads the dialog plug-in, which a message box tells when it is impossible, and runs a dialog.
/// @param edited  shown first; receives what was entered, unchecked
/// @return success when it was confirmed; cancel when it was not; failure when there is none
int RunDialog(FindDialog find, CZoetrixDataUI& lists, KM_3dmAnimationProperties& edited);

/// Writes what is selected in the lists into the record: file extension, capture method with its
/// render flags and display mode, and viewport. A selection outside its list changes nothing.
void TakeSelections(const CZoetrixDataUI& lists, const DisplayModeIds& modes,
                    PreviewRenders preview_renders, KM_3dmAnimationProperties& props);
