#pragma once
#include "host/front_end/FrontEnd.h"
#include "host/app/Loader.h"
#include "kelmar/KM_Shape.h"
#include <CLI/CLI.hpp>
