#include "zoetrix/commands/cmdFlyThru.h"
#include "zoetrix/commands/cmdOneDaySun.h"
#include "zoetrix/commands/cmdPath.h"
#include "zoetrix/commands/cmdSeasonalSun.h"
#include "zoetrix/commands/cmdTurntable.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixApp.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

// Every global object of the plug-in, in one source, so that the language itself guarantees their
// order: the application, the plug-in, the commands that show and record, the commands that set up.
// Constructing a command announces it to the host. They are destroyed in reverse when the plug-in
// file is unloaded.

CZoetrixApp theApp;
CZoetrixPlugIn thePlugIn;

CCommandPlayAnimation thePlayAnimationCommand;
CCommandViewFirstFrame theViewFirstFrameCommand;
CCommandViewLastFrame theViewLastFrameCommand;
CCommandViewPreviousFrame theViewPreviousFrameCommand;
CCommandViewNextFrame theViewNextFrameCommand;
CCommandViewFrameNumber theViewFrameNumberCommand;
CCommandRecordAnimation theRecordAnimationCommand;

CCommandFlythroughAnimation theFlythroughAnimationCommand;
CCommandOneDaySun theOneDaySunCommand;
CCommandPathAnimation thePathAnimationCommand;
CCommandSeasonalSun theSeasonalSunCommand;
CCommandTurntableAnimation theTurntableAnimationCommand;

CZoetrixPlugIn& ZoetrixPlugIn() {
    return thePlugIn;
}
