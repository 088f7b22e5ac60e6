#include "host/share/viewer/PageTexts.h"

#include "ground/FileBytes.h"
#include "host/app/StringTables.h"
#include "kelmar/KM_wString.h"

#include <nlohmann/json.hpp>

namespace quarn {

namespace {

using Json = nlohmann::ordered_json;

/// What the script calls a text, its English, and its number in the string tables.
struct PageText {
    const char* key;
    const wchar_t* english;
    int id;
};

constexpr PageText PAGE_TEXTS[] = {
    {"play", L"Play", 42700},
    {"pause", L"Pause", 42701},
    {"turn", L"Turn the model", 42702},
    {"position", L"Position", 42703},
    {"time", L"Date and time", 42704},
    {"rate", L"Speed", 42705},
    {"frames_per_second", L"%1 fps", 42706},
    {"loop", L"Repeat", 42707},
    {"full_screen", L"Full screen", 42708},
    {"leave_full_screen", L"Leave full screen", 42709},
    {"fit", L"Fit the picture", 42710},
    {"zoom", L"Zoom", 42711},
    {"embed", L"Embed this view", 42712},
    {"embed_help", L"Put this line into your web page, with this file beside it.", 42713},
    {"copy", L"Copy", 42714},
    {"copied", L"Copied", 42715},
    {"close", L"Close", 42716},
    {"drag_to_turn", L"Drag to turn", 42717},
    {"frame", L"Picture %1 of %2", 42718},
    {"degrees", L"%1 degrees", 42719},
    {"loading", L"Loading pictures", 42720},
    {"controls", L"Controls", 42721},
    {"none_loaded",
     L"The pictures could not be loaded. Keep this page in the folder of its pictures.", 42722},
    {"some_not_loaded", L"%1 of %2 pictures could not be loaded.", 42723},
    {"keys", L"Keys", 42724},
    {"key_step", L"One picture back or on", 42725},
    {"key_ends", L"First or last picture", 42726},
    {"key_space", L"Space", 42727},
    {"north", L"N", 42728},
    {"east", L"E", 42729},
    {"south", L"S", 42730},
    {"west", L"W", 42731},
    {"sun", L"Sun", 42732},
    {"azimuth", L"Azimuth %1°", 42733},
    {"above_horizon", L"%1° above the horizon", 42734},
    {"below_horizon", L"%1° below the horizon", 42735},
};

Json englishTexts() {
    Json texts;
    for (const PageText& text : PAGE_TEXTS)
        texts[text.key] = KM_wString(text.english).ToUtf8();
    return texts;
}

/// A table that cannot be read tells so where the program starts; here it has no texts.
Json textsIn(const std::filesystem::path& file) {
    Json texts = Json::object();
    const Result<FileBytes> bytes = readFileBytes(file);
    if (!bytes)
        return texts;
    const auto json = bytes.value().bytes();
    const auto table = readTextTable({reinterpret_cast<const char*>(json.data()), json.size()});
    if (!table)
        return texts;
    const auto& strings = table.value()[static_cast<std::size_t>(TextSpace::strings)];
    for (const PageText& text : PAGE_TEXTS)
        if (const auto found = strings.find(text.id); found != strings.end())
            texts[text.key] = KM_wString(found->second.c_str()).ToUtf8();
    return texts;
}

} // namespace

std::string pageTextsJson(const std::vector<std::filesystem::path>& folders) {
    nlohmann::json languages; // sorted, so that the same recording gives the same page
    languages["en"] = englishTexts();
    for (const std::filesystem::path& folder : folders) {
        std::error_code error;
        std::filesystem::directory_iterator at(folder, error);
        for (; !error && at != std::filesystem::directory_iterator(); at.increment(error)) {
            const std::string language = at->path().stem().string();
            if (at->path().extension() != ".json" || languages.contains(language))
                continue;
            if (Json texts = textsIn(at->path()); !texts.empty())
                languages[language] = std::move(texts);
        }
    }
    return languages.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

} // namespace quarn
