#pragma once

#include "sdk/qncore/QnCommand.h"

/// Sets up an animation in which the sun moves through one day: a frame for every so many minutes
/// from one time of day to another, both included, also at night. Place, date and times are asked
/// for in a dialog when a person started the command, else at the command line, where the answers
/// of the last sun study are offered; a run that does not succeed leaves the document's record as
/// it was. A day that its month does not have makes an animation without frames.
class CCommandOneDaySun : public CQuarnCommand {
public:
    CCommandOneDaySun();
    ~CCommandOneDaySun() override;
    KM_UUID CommandUUID() override;
    const wchar_t* EnglishCommandName() override;
    const wchar_t* CommandDescription() override;
    result RunCommand(const CQuarnCommandContext& context) override;
};
