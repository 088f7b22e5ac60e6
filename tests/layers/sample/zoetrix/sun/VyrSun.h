#pragma once
#include <cmath>
#include "kelmar/KM_Shape.h"
