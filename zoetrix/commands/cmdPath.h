#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which camera and target each follow a curve or stay at a point. Enter
/// at the question for either takes the object of the last set-up, whose ids are kept in the
/// document's record. The rest is asked in a dialog when a person started the command, else at the
/// command line; a run that does not succeed leaves the document's record as it was.
class CCommandPathAnimation : public CQuarnCommand {
public:
    CCommandPathAnimation();
    ~CCommandPathAnimation() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
