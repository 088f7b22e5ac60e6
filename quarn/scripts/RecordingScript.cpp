#include "quarn/scripts/RecordingScript.h"

namespace quarn::program {

namespace {

/// Each render method has its own number of samples.
std::string samplesAnswer(const RecordingRequest& request) {
    if (request.samples == 0)
        return "";
    const bool is_preview = request.mode.option == "_RenderPreview";
    return (is_preview ? " _PreviewSamples " : " _Samples ") + std::to_string(request.samples);
}

} // namespace

RecordingScript composeRecording(const RecordingRequest& request, const AnimationLines& lines) {
    RecordingScript script;
    script.notes = lines.notes;
    script.reading = readingLine(request.model, request.up_axis, request.tolerance);
    std::vector<std::string>& set_up = script.set_up;
    for (const std::string& name : request.hidden)
        set_up.push_back("_-Hide \"" + name + "\"");
    const std::string size =
        std::to_string(request.size.width_px) + " " + std::to_string(request.size.height_px);
    set_up.push_back("_-ViewportSize " + size);
    set_up.insert(set_up.end(), lines.preparing.begin(), lines.preparing.end());
    set_up.push_back("_-AnimationName \"" + request.name + "\"");
    set_up.insert(set_up.end(), lines.setting_up.begin(), lines.setting_up.end());
    const std::string pictures =
        request.mode.is_rendered ? " _Size " + size + samplesAnswer(request) : "";
    if (const std::string settings = pictures + lightAnswers(request.light); !settings.empty())
        set_up.push_back(renderSettingsLine(settings));
    if (request.quality)
        set_up.push_back("_-JpegQuality " + std::to_string(*request.quality));
    if (!request.document.empty())
        script.saving = "_-SaveAs " + quotedPath(request.document);
    if (!request.film.file.empty())
        script.following.push_back(nextFilmLine(request.film));
    script.beginning =
        beginningLine(request.goes_on ? RecordingStartKind::resume : RecordingStartKind::if_same);
    script.recording = recordingLine(request.folder);
    if (request.viewer.is_wanted)
        script.sharing.push_back(viewerLine(framesPath(request), request.viewer));
    return script;
}

std::string sharedAnswers(const RecordingRequest& request) {
    return "_" + request.format + " " + request.mode.option + " _Enter _Enter";
}

std::string beginningLine(RecordingStartKind start, const std::string& frames) {
    const char* const word = start == RecordingStartKind::anew      ? "_Anew"
                             : start == RecordingStartKind::if_same ? "_IfSame"
                                                                    : "_Resume";
    return "_-NextRecording " + std::string(word) + (frames.empty() ? "" : " " + frames) +
           " _Enter";
}

std::string recordingLine(const std::filesystem::path& folder) {
    return "_-RecordAnimation _TargetFolder " + quotedPath(folder) + " _Enter";
}

std::string scriptText(const RecordingScript& script) {
    std::string text;
    for (const std::string& note : script.notes)
        text += "# " + note + "\n";
    text += script.reading + "\n";
    for (const std::string& line : script.set_up)
        text += line + "\n";
    text += "# The folder must be there before the recording starts.\n";
    if (script.saving)
        text += *script.saving + "\n";
    for (const std::string& line : script.following)
        text += line + "\n";
    text += script.beginning + "\n" + script.recording;
    for (const std::string& line : script.sharing)
        text += "\n" + line;
    return text;
}

} // namespace quarn::program
