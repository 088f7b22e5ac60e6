#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which the camera of the active view travels once around a horizontal
/// circle at its own height, about the vertical through the view's target, and looks at that target
/// in every frame. The last frame is where the camera stands now. It asks in a dialog when a person
/// started it, else at the command line; a run that does not succeed leaves the document's record
/// as it was.
///
/// The direction is remembered until the plug-in is unloaded, for all documents. At the command
/// line it can only be changed to anticlockwise; the dialog changes it both ways.
class CCommandTurntableAnimation : public CQuarnCommand {
public:
    CCommandTurntableAnimation();
    ~CCommandTurntableAnimation() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
