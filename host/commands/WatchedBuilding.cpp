#include "host/commands/WatchedBuilding.h"

#include "engine/display/BuildProgress.h"
#include "host/commands/WatchedReading.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"

#include <algorithm>
#include <chrono>
#include <exception>
#include <future>
#include <set>

namespace quarn {

namespace {

/// How often the front end works on its events.
constexpr std::chrono::milliseconds BEAT{20};
/// Fewer are built in less than what a person notices.
constexpr std::size_t WORTH_WATCHING_TRIANGLES = 250'000;
/// Shown last: the whole share says that all is over.
constexpr double LAST_SHARE = 0.99;

/// Meshes that objects share are built once.
std::size_t trianglesOf(std::span<const SceneMesh> added) {
    std::set<const KM_Mesh*> meshes;
    std::size_t triangles = 0;
    for (const SceneMesh& object : added)
        if (object.visible && meshes.insert(object.placed.mesh.get()).second)
            triangles += object.placed.mesh->m_F.size();
    return triangles;
}

/// @return whether it was built
bool build(DocumentScene& scene, WatchedReading& watch) {
    BuildProgress progress;
    auto building = std::async(std::launch::async, [&] { return scene.build(progress).ok(); });
    while (building.wait_for(BEAT) != std::future_status::ready)
        if (!watch.buildingGoesOn(std::min(progress.share.load(), LAST_SHARE)))
            progress.is_given_up = true;
    return building.get() && !watch.isGivenUp();
}

} // namespace

std::unique_ptr<DocumentScene>
buildWatched(const Document* document, std::span<const SceneMesh> added, WatchedReading& watch) {
    if (trianglesOf(added) < WORTH_WATCHING_TRIANGLES)
        return nullptr;
    try {
        auto scene = document ? document->drawing().sceneWith(added)
                              : std::make_unique<DocumentScene>(ObjectTable(), added, nullptr);
        return build(*scene, watch) ? std::move(scene) : nullptr;
    } catch (const std::exception&) { // no memory, or no thread
        return nullptr;
    }
}

} // namespace quarn
