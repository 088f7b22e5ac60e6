#include "host/document/DocumentLight.h"

#include "engine/display/LightChoice.h"
#include "engine/scene/UnitLength.h"
#include "host/document/Document.h"

#include <algorithm>

namespace quarn {

namespace {

/// Whether a sun shines that no plug-in put there last.
bool hasSunOfModel(const LightStore& lights) {
    const auto suns = std::ranges::count(lights.shiningLights(), KM_LightStyle::world_directional,
                                         &KM_Light::Style);
    const auto of_plug_in = lights.studySun();
    return suns > (of_plug_in && LightStore::canShine(*of_plug_in) ? 1 : 0);
}

} // namespace

std::optional<KM_Light> DocumentLight::studySun(const SceneChanges& changes) const {
    if (changes.sun)
        return changes.sun;
    return m_document.sun().isEnabled() ? std::nullopt : m_document.lights().studySun();
}

std::optional<KM_Light> DocumentLight::ownSun(const SceneChanges& changes) const {
    const DocumentSun& sun = m_document.sun();
    const bool makes_way = !sun.wasMoved() && hasSunOfModel(m_document.lights());
    return makes_way || studySun(changes) ? std::nullopt : sun.light();
}

std::vector<KM_Light> DocumentLight::shiningLights(const SceneChanges& changes) {
    if (const auto sun = studySun(changes))
        return LightStore::canShine(*sun) ? std::vector{*sun} : std::vector<KM_Light>();
    std::vector<KM_Light> lights = m_document.lights().shiningLights();
    if (const auto sun = ownSun(changes))
        lights.insert(lights.begin(), *sun);
    return lights;
}

LightSettings DocumentLight::settings(const SceneChanges& changes) {
    const LightChoice& choice = m_document.renderWindow().settings.light;
    LightSettings settings;
    settings.exposure = choice.exposure;
    settings.background = choice.background;
    settings.background_color = choice.background_color;
    settings.has_ground = choice.has_ground;
    settings.first_light_is_sun = ownSun(changes).has_value();
    if (const double metres = metresPerUnit(m_document.units()); metres > 0.0)
        settings.metres_per_unit = metres;
    settings.surroundings = choice.surroundings;
    if (choice.surroundings == Surroundings::picture)
        settings.picture = m_picture.pictureFor(m_document, choice.picture);
    if (choice.surroundings == Surroundings::automatic ||
        (choice.surroundings == Surroundings::picture && !settings.picture))
        settings.surroundings = openSurroundings(settings, changes);
    return settings;
}

Surroundings DocumentLight::openSurroundings(const LightSettings& settings,
                                             const SceneChanges& changes) {
    const DocumentSun& sun = m_document.sun();
    if (studySun(changes) || (sun.isEnabled() && sun.wasMoved()))
        return Surroundings::sky;
    LightSettings open = settings;
    open.surroundings = Surroundings::automatic;
    return surroundingsOf(open, m_document.lights().shiningLights(), surfaceBox());
}

const KM_BoundingBox& DocumentLight::surfaceBox() {
    const ObjectTable& objects = m_document.objects();
    if (m_box_revision == objects.revision())
        return m_surface_box;
    m_surface_box = KM_BoundingBox();
    for (const auto& object : objects.objects())
        if (object->placed.mesh && object->isInDrawableRange())
            m_surface_box.Union(object->boundingBox());
    m_box_revision = objects.revision();
    return m_surface_box;
}

} // namespace quarn
