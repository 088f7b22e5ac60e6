#pragma once

#include "engine/scene/SceneContent.h"
#include "host/document/DocumentScene.h"

#include <memory>
#include <span>

namespace quarn {

class Document;
class WatchedReading;

/// Builds the scene of meshes that were read, on a thread of its own, before they are added to a
/// document.
/// @param document  that they will be added to; null for a new one
/// @param watch     shows how far it is and may give it up
/// @return the scene, for DocumentDrawing::takeScene; null where it was given up, where the meshes
///         are so few that nobody would wait for it, and where it could not be built: the first
///         picture tells why
std::unique_ptr<DocumentScene>
buildWatched(const Document* document, std::span<const SceneMesh> added, WatchedReading& watch);

} // namespace quarn
