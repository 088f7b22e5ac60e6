#pragma once
#include "import/Reader.h"
#include "host/front_end/FrontEnd.h"
#include "host/app/Loader.h"
