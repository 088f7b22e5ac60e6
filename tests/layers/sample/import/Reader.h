#pragma once
#include "engine/scene/PlacedMesh.h"
#include "engine/display/Scene.h"
#include "sdk/qncore/QnDoc.h"
