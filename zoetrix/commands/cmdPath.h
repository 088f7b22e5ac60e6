#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which camera and target each follow a curve or stay at a point. This
/// version of the plug-in cannot do it yet: the command says so and fails.
class CCommandPathAnimation : public CQuarnCommand {
public:
    CCommandPathAnimation();
    ~CCommandPathAnimation() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
