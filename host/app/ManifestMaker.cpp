#include "host/app/ManifestMaker.h"

#include "ground/Checksum.h"
#include "host/app/StudyMoments.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "host/document/SceneFingerprint.h"

#include <algorithm>

namespace quarn {

namespace {

double metresPer(UnitSystem units) {
    switch (units) {
    case UnitSystem::none:
        break;
    case UnitSystem::millimeters:
        return 0.001;
    case UnitSystem::centimeters:
        return 0.01;
    case UnitSystem::meters:
        return 1.0;
    case UnitSystem::kilometers:
        return 1000.0;
    case UnitSystem::inches:
        return 0.0254;
    case UnitSystem::feet:
        return 0.3048;
    }
    return 0.0;
}

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

} // namespace

ManifestMaker::ManifestMaker(const KM_3dmAnimationProperties& record, const std::string& animation,
                             const RecordingSettings& settings, Document& document, Tell tell)
    : m_record(record), m_settings(settings), m_document(document), m_tell(std::move(tell)) {
    m_manifest.program = "quarn " QUARN_VERSION;
    m_manifest.name = animation;
    m_manifest.kind = settings.kind;
    m_manifest.frames = settings.frames;
    m_manifest.width_px = settings.width_px;
    m_manifest.height_px = settings.height_px;
    m_manifest.mode = settings.mode;
    m_manifest.extension = settings.extension;
    m_manifest.frame_rate = standardFrameRate(settings.frames);
    m_manifest.metres_per_unit = metresPer(document.units());
}

void ManifestMaker::frameRecorded(const RecordedFrame& frame) {
    ManifestFrame noted;
    noted.number = frame.number;
    noted.file = frame.file.filename().native();
    // What is read back is what stands on the disk; just written, it comes from memory.
    if (const auto sum = checksumOfFile(frame.file)) {
        noted.bytes = sum.value().bytes;
        noted.xxh64 = sum.value().xxh64;
    }
    noted.camera = frameCameraOf(frame.camera);
    noted.sun = sunOfFrame(m_record, frame.number);
    m_manifest.images.push_back(std::move(noted));
}

void ManifestMaker::recordingEnded(const RecordingReport& report) {
    std::erase_if(m_manifest.images, [&](const ManifestFrame& frame) {
        std::error_code error;
        return !std::filesystem::exists(report.folder / frame.file, error);
    });
    if (m_manifest.images.empty())
        return;
    m_manifest.document = documentFingerprint();
    m_manifest.settings = settingsFingerprint();
    const auto written =
        writeFramesManifest(report.folder / manifestName(m_manifest.name), m_manifest);
    if (!written && report.isComplete()) // else the reason was told with the frames
        m_tell(written.message());
}

/// Empty where the scene cannot be built any more.
std::string ManifestMaker::documentFingerprint() const {
    const auto scene = m_document.drawing().scene();
    if (!scene)
        return {};
    Checksum sum;
    addScene(scene.value()->content(), sum);
    return checksumText(sum.value());
}

std::string ManifestMaker::settingsFingerprint() const {
    Checksum sum;
    sum.addText(m_settings.kind);
    sum.add(m_settings.frames);
    sum.add(m_settings.width_px);
    sum.add(m_settings.height_px);
    sum.addText(m_settings.mode);
    sum.addText(m_settings.extension);
    const RenderSettings& render = m_document.renderWindow().settings;
    sum.add(m_record.RenderFull() ? render.samples : 0);
    sum.add(m_record.RenderPreview() ? render.preview_samples : 0);
    sum.add(m_document.edgesOf(m_record.DisplayMode()));
    addPoints(m_record.CameraPoints(), sum);
    addPoints(m_record.TargetPoints(), sum);
    KM_wString view_name = m_record.ViewportName();
    view_name.TrimLeftAndRight();
    // It is back where it was when the recording began.
    if (const ViewState* const view = m_document.findView(view_name.View()))
        addCamera(frameCameraOf(view->viewport()), sum);
    return checksumText(sum.value());
}

} // namespace quarn
