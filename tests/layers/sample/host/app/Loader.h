#pragma once
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "vexui/Form.h"
#include <embree3/rtcore.h>
