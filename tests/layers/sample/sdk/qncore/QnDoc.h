#pragma once
#include "host/document/Document.h"
#include "kelmar/KM_Shape.h"
