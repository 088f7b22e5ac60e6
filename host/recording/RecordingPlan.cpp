#include "host/recording/RecordingPlan.h"

#include "ground/PathText.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

KM_wString wide(const std::string& text) {
    return KM_wString::FromUtf8(text);
}

/// "turntable, 72 frames, 1280x720, Rendered, jpg 90"
KM_wString settingsText(const RecordingSettings& settings) {
    return KM_wString::FormatToString(
        QnLocalizeString(L"%s, %d frames, %dx%d, %s, %s", 42854), wide(settings.kind).Array(),
        settings.frames, settings.width_px, settings.height_px, wide(settings.mode).Array(),
        wide(settings.extension +
             (settings.jpeg_quality > 0 ? " " + std::to_string(settings.jpeg_quality) : ""))
            .Array());
}

KM_wString whatDiffers(const RecordingFile& there, const RecordingFile& own) {
    if (there.fingerprint.program.empty())
        return QnLocalizeString(L"it does not tell from what", 42855);
    if (there.settings != own.settings)
        return KM_wString::FormatToString(QnLocalizeString(L"as %s, and this is %s", 42856),
                                          settingsText(there.settings).Array(),
                                          settingsText(own.settings).Array());
    if (there.fingerprint.document != own.fingerprint.document)
        return QnLocalizeString(L"from another state of the document", 42857);
    if (there.fingerprint.settings != own.fingerprint.settings)
        return QnLocalizeString(L"with another camera, path, sun, light or number of samples",
                                42858);
    return KM_wString::FormatToString(QnLocalizeString(L"by another program, %s", 42859),
                                      wide(there.fingerprint.program).Array());
}

std::string ofOtherInstructions(const std::filesystem::path& folder, const RecordingFile& there,
                                const RecordingFile& own) {
    return KM_wString::FormatToString(
               QnLocalizeString(
                   L"%s in %s is drawn with the instruction set %s, and this program draws with "
                   L"%s, whose pictures differ in a few pixels. Start it with --instructions "
                   L"%s on a processor that has it, or begin anew with --overwrite.",
                   42860),
               wide(own.animation).Array(), textFromPath(folder).Array(),
               wide(there.fingerprint.instructions).Array(),
               wide(own.fingerprint.instructions).Array(),
               wide(there.fingerprint.instructions).Array())
        .ToUtf8();
}

bool differInInstructionsAlone(const RecordingFile& there, const RecordingFile& own) {
    RecordingFingerprint adapted = own.fingerprint;
    adapted.instructions = there.fingerprint.instructions;
    return !adapted.document.empty() && there.settings == own.settings &&
           adapted == there.fingerprint;
}

} // namespace

RecordingFile recordingFileOf(const RecordingPlan& plan, const RecordingFingerprint& fingerprint) {
    RecordingFile file;
    file.animation = plan.animation;
    file.document = plan.document;
    file.is_running = true;
    file.is_shared = plan.choice.frames || plan.choice.begin == RecordingBegin::resume;
    file.writer = currentProcess();
    file.settings = plan.settings;
    file.fingerprint = fingerprint;
    file.owns_page = true;
    return file;
}

std::optional<std::string> whyAnotherRecording(const RecordingFile& there, const RecordingFile& own,
                                               const std::filesystem::path& folder) {
    if (differInInstructionsAlone(there, own))
        return there.fingerprint.instructions.empty() ||
                       there.fingerprint.instructions == own.fingerprint.instructions
                   ? std::nullopt
                   : std::optional(ofOtherInstructions(folder, there, own));
    return KM_wString::FormatToString(
               QnLocalizeString(L"%s in %s was recorded before %s. Its frames are kept: record "
                                L"into another folder or under another name, or begin anew with "
                                L"--overwrite.",
                                42861),
               wide(own.animation).Array(), textFromPath(folder).Array(),
               whatDiffers(there, own).Array())
        .ToUtf8();
}

} // namespace quarn
