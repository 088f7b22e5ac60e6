#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which the sun moves through one day. This version of the plug-in cannot
/// do it yet: the command says so and fails.
class CCommandOneDaySun : public CQuarnCommand {
public:
    CCommandOneDaySun();
    ~CCommandOneDaySun() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
