#include "ground/AtomicFile.h"
#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/FileNameQuestion.h"
#include "host/commands/WordsLeft.h"
#include "host/prompt/NumberText.h"
#include "host/share/ShareCommands.h"
#include "host/share/camera/CameraFile.h"
#include "host/share/camera/GltfFile.h"
#include "host/share/camera/TrackText.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

constexpr int HIGHEST_FRAME_RATE = 1000;

struct ExportWish {
    int frame_rate = 0;
    std::filesystem::path file;
};

CQuarnCommand::result askFrameRate(int& frame_rate) {
    CQuarnGetInteger get;
    get.SetCommandPrompt(QnLocalizeString(L"Frames a second", 42822));
    get.SetDefaultInteger(frame_rate);
    get.SetLowerLimit(1);
    get.SetUpperLimit(HIGHEST_FRAME_RATE);
    if (get.GetNumber() == CQuarnGet::number)
        frame_rate = get.Number();
    return get.CommandResult();
}

/// Asks for the file at the prompt, where the frame rate can be chosen too.
CQuarnCommand::result askAtPrompt(ExportWish& wish) {
    for (;;) {
        FileNameQuestion get;
        get.SetCommandPrompt(QnLocalizeString(L"Camera file", 42820));
        const KM_wString shown = numberText(wish.frame_rate);
        get.AddCommandOption(QnLocalizeCommandOptionName(L"FrameRate", 42820), {shown, shown});
        const CQuarnGet::result answer = get.GetString();
        if (answer == CQuarnGet::string) {
            wish.file = pathFromText(get.String());
            return tellWordsBehindFile() ? CQuarnCommand::failure : CQuarnCommand::success;
        }
        if (answer != CQuarnGet::option)
            return get.CommandResult() == CQuarnCommand::success ? CQuarnCommand::nothing
                                                                 : get.CommandResult();
        if (const auto asked = askFrameRate(wish.frame_rate); asked != CQuarnCommand::success)
            return asked;
    }
}

CQuarnCommand::result askWish(const CQuarnCommandContext& context, ExportWish& wish) {
    const FileChoice choice = chooseFile(context, FileUse::export_camera);
    if (choice.kind == FileChoice::Kind::nobody)
        return askAtPrompt(wish);
    wish.file = choice.file;
    return choice.kind == FileChoice::Kind::chosen ? CQuarnCommand::success : CQuarnCommand::cancel;
}

void tell(const KM_wString& message) {
    Application::current()->tell(message.ToUtf8());
}

/// What a person should know of a glTF file.
void tellNotes(const CameraTrack& track, const GltfFile& file) {
    if (track.units == UnitSystem::none)
        tell(QnLocalizeString(
            L"The document has no units: one unit counts as a metre in the camera file.", 42831));
    if (file.is_straightened)
        tell(QnLocalizeString(L"The view's camera looks askew, which glTF cannot tell: its picture "
                              L"is exported about the line of sight.",
                              42832));
    if (file.lost_m > 0.0)
        tell(KM_wString::FormatToString(
            QnLocalizeString(L"So far from the origin glTF keeps places to %.1g m only. Files that "
                             L"end in .json or .csv keep all digits.",
                             42833),
            file.lost_m));
}

Result<std::string> fileBytes(const CameraTrack& track, CameraForm form) {
    if (form == CameraForm::json)
        return trackJson(track);
    if (form == CameraForm::csv)
        return trackCsv(track);
    auto file = gltfFile(track, form == CameraForm::glb ? GltfForm::binary : GltfForm::text);
    if (!file)
        return file.error();
    tellNotes(track, file.value());
    return std::move(file.value().bytes);
}

void tellDone(const CameraTrack& track, const std::filesystem::path& file) {
    const wchar_t* const text =
        track.isSunStudy()
            ? QnLocalizeString(L"Wrote the camera and the sun of %d frames, %d a second, to %s.",
                               42835)
            : QnLocalizeString(L"Wrote the camera of %d frames, %d a second, to %s.", 42834);
    Application::current()->frontEnd().sharedFileEnded(
        {file, true,
         KM_wString::FormatToString(text, track.frameCount(), track.frame_rate,
                                    textFromPath(file).Array())});
}

CQuarnCommand::result writeTrack(const CameraTrack& track, const ExportWish& wish,
                                 CameraForm form) {
    const auto bytes = fileBytes(track, form);
    if (!bytes)
        return fail(bytes.message());
    const auto written = writeFileAtomically(wish.file, std::as_bytes(std::span(bytes.value())),
                                             Application::current()->protection());
    if (!written)
        return fail(written.message());
    tellDone(track, wish.file);
    return CQuarnCommand::success;
}

CQuarnCommand::result exportCamera(const StoredAnimation& animation, const ExportWish& wish) {
    const auto form = cameraFormOf(wish.file);
    if (!form)
        return fail(KM_wString::FormatToString(
            QnLocalizeString(L"The camera cannot be written to %s. Give a file that ends in .glb, "
                             L".gltf, .json or .csv.",
                             42828),
            textFromPath(wish.file).Array()));
    if (!Application::current()->options().overwrites && isOtherFile(wish.file))
        return fail(KM_wString::FormatToString(
            QnLocalizeString(L"%s is not replaced: it holds something else than a camera. Give "
                             L"another name, or start the program with --overwrite.",
                             42836),
            textFromPath(wish.file).Array()));
    const auto track = cameraTrack(animation, wish.frame_rate);
    if (!track)
        return fail(track.message());
    return track.value() ? writeTrack(*track.value(), wish, *form) : CQuarnCommand::cancel;
}

} // namespace

CQuarnCommand::result runExportCamera(const CQuarnCommandContext& context) {
    const auto animation = storedAnimation(Document::of(context.Document()));
    if (!animation)
        return fail(animation.message());
    ExportWish wish{standardFrameRate(animation.value().record->FrameCount()), {}};
    const CQuarnCommand::result asked = askWish(context, wish);
    return asked == CQuarnCommand::success ? exportCamera(animation.value(), wish) : asked;
}

} // namespace quarn
