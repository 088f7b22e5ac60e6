#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which the camera flies along a curve and looks ahead along it. This
/// version of the plug-in cannot do it yet: the command says so and fails.
class CCommandFlythroughAnimation : public CQuarnCommand {
public:
    CCommandFlythroughAnimation();
    ~CCommandFlythroughAnimation() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
