#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which the camera flies along a curve and looks ahead along it. Enter at
/// the question for the curve takes the one of the last set-up, whose id is kept in the document's
/// record. The rest is asked in a dialog when a person started the command, else at the command
/// line; a run that does not succeed leaves the document's record as it was.
class CCommandFlythroughAnimation : public CQuarnCommand {
public:
    CCommandFlythroughAnimation();
    ~CCommandFlythroughAnimation() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
