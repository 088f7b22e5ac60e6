#pragma once
#include "engine/scene/PlacedMesh.h"
#include "engine/render/Renderer.h"
#include "host/document/Document.h"
