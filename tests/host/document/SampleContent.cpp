#include "tests/host/document/SampleContent.h"

#include "engine/display/DisplayMode.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/QualityChanges.h"

namespace quarn::test {

namespace {

std::shared_ptr<const Material> checkeredMaterial() {
    auto texture = std::make_shared<Texture>();
    texture->width = 2;
    texture->height = 1;
    texture->rgba = {255, 255, 255, 255, 10, 20, 30, 128};
    texture->wrap_u = TextureWrap::mirror;
    texture->wrap_v = TextureWrap::clamp;
    auto material = std::make_shared<Material>();
    material->name = L"Kachel";
    material->base_color = {1, 2, 3, 200};
    material->base_color_texture = texture;
    material->alpha_cutout = true;
    material->alpha_cutoff = 0.25F;
    return material;
}

std::shared_ptr<const KM_Mesh> coloredBox() {
    auto mesh = boxMesh({-1.0, -2.0, 0.0}, {1.0, 2.0, 3.0});
    for (int i = 0; i < mesh->VertexCount(); ++i) {
        mesh->m_T.push_back({0.125F * static_cast<float>(i), 0.5F});
        mesh->m_C.push_back({static_cast<std::uint8_t>(i), 100, 200, 255});
    }
    return mesh;
}

std::shared_ptr<const KM_Curve> rationalCurve() {
    auto curve = std::make_shared<KM_NurbsCurve>();
    const std::vector<KM_3dPoint> points = {{0, 0, 0}, {1, 0, 1}, {1, 1, 0}, {0, 2, 1}};
    curve->CreateClampedUniformNurbs(points, 4);
    curve->SetWeight(1, 0.7);
    curve->SetDomain(-1.0, 3.0);
    return curve;
}

void addCurves(std::vector<ObjectContent>& objects) {
    const std::vector<KM_3dPoint> corners = {{0, 0, 0}, {1, 0, 0}, {1, 5, 0.1}};
    const std::vector<double> parameters = {0.0, 0.25, 7.0};
    auto polyline = std::make_shared<KM_PolylineCurve>();
    polyline->Create(corners, parameters);
    const KM_Line line(KM_3dPoint(0, 0, 0), KM_3dPoint(0, 0, 1.0 / 3.0));

    ObjectContent curve;
    curve.id = sampleId(11);
    curve.name = L"Weg";
    curve.curve = polyline;
    objects.push_back(curve);
    curve.id = sampleId(12);
    curve.name = L"Achse";
    curve.curve = std::make_shared<KM_LineCurve>(line, 2.0, 4.0);
    objects.push_back(curve);
    curve.id = sampleId(13);
    curve.name = L"";
    curve.curve = rationalCurve();
    objects.push_back(curve);
}

void addObjects(std::vector<ObjectContent>& objects) {
    ObjectContent box;
    box.id = sampleId(1);
    box.name = L"Kiste";
    box.placed.mesh = coloredBox();
    box.placed.material = checkeredMaterial();
    objects.push_back(box);
    ObjectContent same_box = box;
    same_box.id = sampleId(2);
    same_box.name = L"Kiste \u2211";
    same_box.visible = false;
    same_box.placed.material = nullptr;
    objects.push_back(same_box);
    addCurves(objects);
    ObjectContent point;
    point.id = sampleId(21);
    point.name = L"Blick";
    point.point = KM_3dPoint(0.1, 0.2, 0.3);
    objects.push_back(point);
    ObjectContent lacquered = box;
    lacquered.id = sampleId(22);
    lacquered.name = L"Schrank";
    lacquered.placed.material = std::make_shared<Material>(changedMaterial());
    objects.push_back(lacquered);
}

void addViews(DocumentContent& content) {
    ViewContent view;
    view.name = L"Perspective";
    view.display_mode = shaded_mode_id;
    view.viewport.SetCameraLocation({3.3, -4.4, 5.5});
    view.viewport.SetCameraDirection({-3.3, 4.4, -5.5});
    view.viewport.SetTargetPoint({0.0, 0.0, 0.1});
    view.width_px = 640;
    view.height_px = 360;
    view.viewport.SetScreenPort(640, 360);
    view.viewport.SetCameraUpLock(true);
    content.views.push_back(view);
    ViewContent plan;
    plan.name = L"Plan";
    plan.display_mode = wireframe_mode_id;
    plan.viewport.SetCameraDirection({0.0, 0.0, -1.0});
    plan.viewport.SetCameraUp({0.0, 1.0, 0.0});
    plan.viewport.SetProjection(KM_parallel_view);
    plan.width_px = 1000;
    plan.height_px = 10;
    plan.viewport.SetScreenPort(1000, 10);
    plan.active = true;
    content.views.push_back(plan);
    content.cameras.push_back({L"Kamera 1", view.viewport});
    content.edges.push_back({wireframe_mode_id, MeshEdgeChoice::all});
    content.studied_place = StudiedPlace{L"Zürich, Switzerland", L"Europe/Zurich", 47.37, 8.54};
    content.rendering = RenderSettings{640, 360, 128, 4};
    content.light = LightChoice{.surroundings = Surroundings::picture,
                                .picture = "/pictures/sky.hdr",
                                .exposure = 0.5,
                                .background = BackgroundKind::color,
                                .background_color = {1, 2, 3, 255},
                                .has_ground = false};
}

void addLights(std::vector<LightContent>& lights) {
    LightContent lamp;
    lamp.index = 1;
    lamp.light.SetStyle(KM_LightStyle::world_directional);
    lamp.light.SetLocation({1, 2, 3});
    lamp.light.SetDirection({-1, -2, -3});
    lamp.light.SetIntensity(0.75);
    lamp.light.SetShadowIntensity(0.5);
    lamp.light.SetDiffuse({9, 8, 7, 255});
    lamp.light.Enable(false);
    lamp.light.SetLightId(sampleId(31));
    lamp.light.SetLightName(L"Lampe");
    lights.push_back(lamp);
}

} // namespace

KM_UUID sampleId(std::uint32_t number) {
    return {number, 0x1234, 0x4567, {0x80, 1, 2, 3, 4, 5, 6, 7}};
}

DocumentContent sampleContent() {
    DocumentContent content;
    content.settings.units = UnitSystem::feet;
    content.settings.absolute_tolerance = 0.0125;
    content.settings.sun_enabled = false;
    content.settings.direction_to_sun = KM_3dVector(0.6, 0.0, 0.8);
    content.settings.light_slots = 5; // of which only that of index 1 holds a light
    addObjects(content.objects);
    addViews(content);
    addLights(content.lights);
    content.plug_ins.push_back({sampleId(41), {7, 0, 0, 0, 1, 0, 0, 0, 0xAB, 0xCD}});
    content.unknown.push_back({0x58595A41, {1, 2, 3, 4, 5}});
    return content;
}

} // namespace quarn::test
