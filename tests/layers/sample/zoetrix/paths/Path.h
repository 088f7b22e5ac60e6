#pragma once
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "zoetrix/commands/cmdTurntable.h"
