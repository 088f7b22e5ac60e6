#include "host/app/AnimationFingerprint.h"

#include "engine/display/InstructionSet.h"
#include "ground/Checksum.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "host/document/SceneFingerprint.h"
#include "host/recording/FramesManifest.h"

namespace quarn {

namespace {

void addPoints(const KM_3dPointArray& points, Checksum& sum) {
    sum.add(points.Count());
    for (int i = 0; i < points.Count(); ++i)
        for (const double coordinate : {points[i].x, points[i].y, points[i].z})
            sum.add(coordinate);
}

void addCamera(const FrameCamera& camera, Checksum& sum) {
    for (const KM_3dPoint& point : {camera.place, camera.target, KM_3dPoint(camera.up)})
        for (const double coordinate : {point.x, point.y, point.z})
            sum.add(coordinate);
    sum.add(camera.is_parallel);
    for (const double number : {camera.lens_mm, camera.width, camera.height})
        sum.add(number);
}

/// Empty where the scene cannot be built.
std::string documentMark(Document& document) {
    const auto scene = document.drawing().scene();
    if (!scene)
        return {};
    Checksum sum;
    addScene(scene.value()->content(), sum);
    return checksumText(sum.value());
}

std::string settingsMark(const KM_3dmAnimationProperties& record, const RecordingSettings& settings,
                         Document& document) {
    Checksum sum;
    sum.addText(settings.kind);
    sum.add(settings.frames);
    sum.add(settings.width_px);
    sum.add(settings.height_px);
    sum.addText(settings.mode);
    sum.addText(settings.extension);
    sum.add(settings.jpeg_quality);
    const RenderSettings& render = document.renderWindow().settings;
    sum.add(record.RenderFull() ? render.samples : 0);
    sum.add(record.RenderPreview() ? render.preview_samples : 0);
    addLight(document.drawing().light().settings(), sum);
    sum.add(document.edgesOf(record.DisplayMode()));
    addPoints(record.CameraPoints(), sum);
    addPoints(record.TargetPoints(), sum);
    KM_wString view_name = record.ViewportName();
    view_name.TrimLeftAndRight();
    if (const ViewState* const view = document.findView(view_name.View()))
        addCamera(frameCameraOf(view->viewport()), sum);
    return checksumText(sum.value());
}

} // namespace

RecordingFingerprint fingerprintOf(const KM_3dmAnimationProperties& record,
                                   const RecordingSettings& settings, Document& document) {
    return {"quarn " QUARN_VERSION, documentMark(document),
            settingsMark(record, settings, document), std::string(nameOf(instructionSetInForce()))};
}

} // namespace quarn
