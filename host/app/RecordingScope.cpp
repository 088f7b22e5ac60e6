#include "host/app/RecordingScope.h"

#include "host/app/Application.h"
#include "host/app/ManifestMaker.h"
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

RunningRecording::Plan planOf(const KM_3dmAnimationProperties& record, Document& document,
                              bool overwrites) {
    KM_wString extension = record.FileExtension();
    extension.Remove(L'.');
    RunningRecording::Plan plan;
    plan.animation = record.HtmlFilename().ToUtf8();
    plan.settings.kind = kindOf(record.CaptureType());
    plan.settings.frames = record.FrameCount();
    plan.settings.mode = modeOf(record);
    plan.settings.extension = extension.ToUtf8();
    takePictureSize(record, document, plan.settings);
    plan.overwrites = overwrites;
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
    RunningRecording::Plan plan = planOf(record, document, application.options().overwrites);
    if (plan.animation.find('/') != std::string::npos)
        return; // nothing of this name is written
    const auto tell = [&application](const std::string& text) { application.tell(text); };
    RecordingFollowers& followers = application.recordingFollowers();
    followers.begin(cameraOf(record, document, plan.settings));
    followers.addFirst(
        std::make_unique<ManifestMaker>(record, plan.animation, plan.settings, document, tell));
    application.setRecording(std::make_unique<RunningRecording>(std::move(plan), tell));
}

} // namespace

RecordingScope::RecordingScope(Application& application, CQuarnCommand& command,
                               CQuarnDoc& document)
    : m_application(application),
      m_is_recording(!application.recording() && command.CommandUUID() == recording_command_id) {
    if (!m_is_recording)
        return;
    if (const IQnZoetrixDynamicAccess* const access = Zoetrix_QuarnDynamicAccess())
        beginRecording(application, Document::of(document), access->AnimationProperties(document));
}

RecordingScope::~RecordingScope() {
    if (!m_is_recording)
        return;
    RecordingFollowers& followers = m_application.recordingFollowers();
    const auto ended = acrossBorder([&] {
        if (!m_application.recording())
            return;
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
