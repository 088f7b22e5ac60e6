#include "host/commands/LightPrompt.h"

#include "host/commands/ColorText.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/LightWords.h"
#include "host/document/DocumentDrawing.h"
#include "host/prompt/NumberText.h"
#include "sdk/qncore/QnGet.h"

#include <span>

namespace quarn {

namespace {

/// Asks for one of several words.
/// @param chosen  its place among them; the present one, and the answer
CQuarnCommand::result askWord(const wchar_t* prompt, std::span<const LightWord> words,
                              std::size_t& chosen) {
    CQuarnGetOption get;
    get.SetCommandPrompt(prompt);
    get.SetDefaultString(words[chosen].option().m_local);
    for (const LightWord& word : words)
        get.AddCommandOption(word.option());
    const CQuarnGet::result answer = get.GetOption();
    if (answer == CQuarnGet::string)
        return CQuarnCommand::failure;
    if (answer == CQuarnGet::option)
        chosen = static_cast<std::size_t>(get.Option()->m_option_index - 1);
    return get.CommandResult();
}

/// Asks for one of the values of an enumeration, in the order of the words.
template <class Value>
CQuarnCommand::result askValue(const wchar_t* prompt, std::span<const LightWord> words,
                               Value& value) {
    auto chosen = static_cast<std::size_t>(value);
    const CQuarnCommand::result asked = askWord(prompt, words, chosen);
    value = static_cast<Value>(chosen);
    return asked;
}

CQuarnCommand::result askPicture(const CQuarnCommandContext& context, DocumentDrawing& drawing,
                                 LightChoice& choice) {
    std::filesystem::path file;
    const CQuarnCommand::result asked = askFile(
        context, FileUse::surroundings, QnLocalizeString(L"Picture file (.hdr)", 42907), file);
    if (asked != CQuarnCommand::success)
        return asked;
    std::error_code error;
    file = std::filesystem::absolute(file, error);
    if (const Result<void> is_read = drawing.light().readSurroundings(file); !is_read)
        return fail(is_read.message());
    choice.picture = file;
    return CQuarnCommand::success;
}

CQuarnCommand::result askColor(KM_Color& color) {
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Background colour", 42913));
    get.SetDefaultString(colorText(color));
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    const auto read = colorFromText(get.String());
    if (!read)
        return fail(noColorText(get.String()));
    color = *read;
    return CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result askSurroundings(const CQuarnCommandContext& context, DocumentDrawing& drawing,
                                      LightChoice& choice) {
    LightChoice wish = choice;
    CQuarnCommand::result asked =
        askValue(QnLocalizeString(L"Light", 42902), SURROUNDINGS_WORDS, wish.surroundings);
    if (asked == CQuarnCommand::success && wish.surroundings == Surroundings::picture)
        asked = askPicture(context, drawing, wish);
    if (asked == CQuarnCommand::success)
        choice = wish;
    return asked;
}

CQuarnCommand::result askExposure(LightChoice& choice) {
    CQuarnGetNumber get;
    get.SetCommandPrompt(QnLocalizeString(L"Exposure in stops", 42909));
    get.SetLowerLimit(-LightChoice::most_stops);
    get.SetUpperLimit(LightChoice::most_stops);
    get.SetDefaultNumber(choice.exposure.value_or(0.0));
    get.AddCommandOption(AUTOMATIC_WORD.option());
    const CQuarnGet::result answer = get.GetNumber();
    if (answer == CQuarnGet::number)
        choice.exposure = get.Number();
    else if (answer == CQuarnGet::option)
        choice.exposure.reset();
    return get.CommandResult();
}

CQuarnCommand::result askBackground(LightChoice& choice) {
    LightChoice wish = choice;
    CQuarnCommand::result asked =
        askValue(QnLocalizeString(L"Background", 42911), BACKGROUND_WORDS, wish.background);
    if (asked == CQuarnCommand::success && wish.background == BackgroundKind::color)
        asked = askColor(wish.background_color);
    if (asked == CQuarnCommand::success)
        choice = wish;
    return asked;
}

std::filesystem::path chooseSurroundings(const CQuarnCommandContext& context,
                                         const std::filesystem::path& present) {
    const FileChoice choice = chooseFile(context, FileUse::surroundings, present);
    return choice.kind == FileChoice::Kind::chosen ? choice.file : std::filesystem::path();
}

} // namespace quarn
