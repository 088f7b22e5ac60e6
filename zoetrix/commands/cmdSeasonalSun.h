#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation of the sun at one time of day through a season: a frame for every so many
/// days from one date to another, both included. The longitude is asked for from 0 to 360 degrees.
/// All else is as with the study of one day.
class CCommandSeasonalSun : public CQuarnCommand {
public:
    CCommandSeasonalSun();
    ~CCommandSeasonalSun() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
