#pragma once
#include "zoetrix/paths/Path.h"
#include "zoetrix/ZoetrixGlobals.cpp"
