#pragma once
#include "zoetrix/sun/VyrSun.h"
#include "host/app/Loader.h"
#include "ZoetrixApp.h"
