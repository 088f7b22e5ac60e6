#pragma once
#include "sdk/qncore/QnDoc.h"
#include <embree3/rtcore.h>
#include <vector>
