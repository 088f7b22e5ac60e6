#include "host/app/RecordingScope.h"

#include "engine/images/ImageFile.h"
#include "engine/scene/UnitLength.h"
#include "host/app/AnimationFingerprint.h"
#include "host/app/Application.h"
#include "host/app/FrameNoter.h"
#include "host/app/PictureOpacity.h"
#include "host/app/StudyMoments.h"
#include "host/border/Border.h"
#include "host/document/DisplayModeList.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

namespace {

/// The command RecordAnimation: FCE04371-0752-46BA-A4DA-0C6F62A24D61.
constexpr KM_UUID recording_command_id = {
    0xFCE04371, 0x0752, 0x46BA, {0xA4, 0xDA, 0x0C, 0x6F, 0x62, 0xA2, 0x4D, 0x61}};

const char* kindOf(KM_3dmAnimationProperties::CaptureTypes type) {
    switch (type) {
    case KM_3dmAnimationProperties::path:
        return "path";
    case KM_3dmAnimationProperties::turntable:
        return "turntable";
    case KM_3dmAnimationProperties::flythrough:
        return "flythrough";
    case KM_3dmAnimationProperties::one_day_sun:
        return "one_day_sun";
    case KM_3dmAnimationProperties::seasonal_sun:
        return "seasonal_sun";
    case KM_3dmAnimationProperties::none:
        break;
    }
    return "none";
}

std::string modeOf(const KM_3dmAnimationProperties& record) {
    if (record.RenderFull())
        return "RenderFull";
    if (record.RenderPreview())
        return "RenderPreview";
    const KM_UUID id = record.IsSunStudy()                  ? rendered_mode_id
                       : KM_UuidIsNil(record.DisplayMode()) ? wireframe_mode_id
                                                            : record.DisplayMode();
    const CDisplayPipelineAttributes* const mode = DisplayModeList::instance().find(id);
    return mode ? mode->EnglishName().ToUtf8() : "";
}

KM_wString recordedViewName(const KM_3dmAnimationProperties& record) {
    KM_wString name = record.ViewportName();
    name.TrimLeftAndRight();
    return name;
}

void takePictureSize(const KM_3dmAnimationProperties& record, Document& document,
                     RecordingSettings& settings) {
    const KM_wString name = recordedViewName(record);
    if (record.RenderFull() || record.RenderPreview()) {
        settings.width_px = document.renderWindow().settings.width_px;
        settings.height_px = document.renderWindow().settings.height_px;
    } else if (const ViewState* const view = document.findView(name.View())) {
        settings.width_px = view->frameWidth();
        settings.height_px = view->frameHeight();
    }
}

RecordingSettings settingsOf(const KM_3dmAnimationProperties& record, Document& document,
                             int jpeg_quality) {
    KM_wString extension = record.FileExtension();
    extension.Remove(L'.');
    RecordingSettings settings;
    settings.kind = kindOf(record.CaptureType());
    settings.frames = record.FrameCount();
    settings.mode = modeOf(record);
    settings.extension = extension.ToUtf8();
    if (imageFormatFor(settings.extension) == ImageFormat::jpeg)
        settings.jpeg_quality = jpeg_quality;
    takePictureSize(record, document, settings);
    return settings;
}

RecordingPlan planOf(const KM_3dmAnimationProperties& record, Document& document,
                     Application& application) {
    RecordingPlan plan;
    plan.animation = record.HtmlFilename().ToUtf8();
    plan.settings = settingsOf(record, document, application.jpegQuality());
    std::error_code error;
    if (!document.file().empty())
        plan.document = std::filesystem::absolute(document.file(), error);
    plan.metres_per_unit = metresPerUnit(document.units());
    const auto place = record.IsSunStudy() ? document.studiedPlace() : std::nullopt;
    plan.place = place ? place->city.ToUtf8() : "";
    plan.fingerprint = [record, settings = plan.settings, &document] {
        return fingerprintOf(record, settings, document);
    };
    plan.choice = application.takeNextRecording();
    plan.overwrites = application.options().overwrites;
    plan.refusal = whyNotSeeThrough(document, plan.settings.extension).value_or("");
    return plan;
}

/// The camera of the view that the record names.
/// Rendered pictures have another size than the view, and their camera has their aspect.
RecordingFollowers::Camera cameraOf(const KM_3dmAnimationProperties& record, Document& document,
                                    const RecordingSettings& settings) {
    return [&document, name = recordedViewName(record), width_px = settings.width_px,
            height_px = settings.height_px] {
        const ViewState* const view = document.findView(name.View());
        KM_Viewport camera = view ? view->viewport() : KM_Viewport();
        int view_width_px = 0;
        int view_height_px = 0;
        camera.GetScreenPort(&view_width_px, &view_height_px);
        if (view_width_px != width_px || view_height_px != height_px)
            camera.SetScreenPort(width_px, height_px);
        return camera;
    };
}

void beginRecording(Application& application, Document& document,
                    const KM_3dmAnimationProperties& record) {
    RecordingPlan plan = planOf(record, document, application);
    if (plan.animation.find('/') != std::string::npos)
        return; // nothing of this name is written
    RecordingFollowers& followers = application.recordingFollowers();
    followers.begin(cameraOf(record, document, plan.settings));
    auto recording = std::make_unique<RunningRecording>(
        std::move(plan), RunningRecording::Listener{
                             [&application](const std::string& text) { application.tell(text); },
                             [&application](const RecordingStart& start) {
                                 application.frontEnd().recordingBegun(start);
                             }});
    followers.addFirst(
        std::make_unique<FrameNoter>(record, studyZone(document, record), *recording));
    application.setRecording(std::move(recording));
}

} // namespace

RecordingScope::RecordingScope(Application& application, CQuarnCommand& command,
                               CQuarnDoc& document)
    : m_application(application), m_document(Document::of(document)),
      m_is_recording(!application.recording() && command.CommandUUID() == recording_command_id) {
    if (!m_is_recording)
        return;
    const IQnZoetrixDynamicAccess* const access = Zoetrix_QuarnDynamicAccess();
    if (!access)
        return;
    const KM_3dmAnimationProperties record = access->AnimationProperties(document);
    m_view_name = recordedViewName(record);
    if (const ViewState* const view = m_document.findView(m_view_name.View()))
        m_camera_before = view->viewport();
    beginRecording(application, m_document, record);
}

void RecordingScope::putCameraBack() {
    ViewState* const view = m_document.findView(m_view_name.View());
    if (view && m_camera_before)
        view->setViewport(*m_camera_before, true, true);
}

RecordingScope::~RecordingScope() {
    if (!m_is_recording)
        return;
    RecordingFollowers& followers = m_application.recordingFollowers();
    const auto ended = acrossBorder([&] {
        if (!m_application.recording())
            return;
        putCameraBack();
        if (const auto report = m_application.recording()->end()) {
            followers.end(*report);
            m_application.frontEnd().recordingEnded(*report);
        }
    });
    followers.clear();
    m_application.setRecording(nullptr);
    if (!ended)
        m_application.tell(ended.message());
}

} // namespace quarn
