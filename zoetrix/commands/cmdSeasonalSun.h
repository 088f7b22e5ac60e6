#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which the sun moves through a season. This version of the plug-in cannot
/// do it yet: the command says so and fails.
class CCommandSeasonalSun : public CQuarnCommand {
public:
    CCommandSeasonalSun();
    ~CCommandSeasonalSun() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
