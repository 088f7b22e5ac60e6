#pragma once

#include "engine/scene/LightSettings.h"
#include "sdk/qncore/QnLocalize.h"

#include <cstddef>

namespace quarn {

/// What one may choose of, as prompts and forms call it.
struct LightWord {
    const wchar_t* name;
    int option_id;
    int text_id;

    CQuarnCommandOptionName option() const { return QnLocalizeCommandOptionName(name, option_id); }
    const wchar_t* text() const { return QnLocalizeString(name, text_id); }
};

inline constexpr LightWord AUTOMATIC_WORD = {L"Automatic", 42930, 42903};

/// In the order of Surroundings.
inline constexpr LightWord SURROUNDINGS_WORDS[] = {
    AUTOMATIC_WORD, {L"Studio", 42931, 42904}, {L"Sky", 42932, 42905}, {L"Picture", 42933, 42906}};

/// In the order of BackgroundKind.
inline constexpr LightWord BACKGROUND_WORDS[] = {
    AUTOMATIC_WORD, {L"Colour", 42934, 42912}, {L"Transparent", 42935, 42914}};

inline const LightWord& lightWord(Surroundings surroundings) {
    return SURROUNDINGS_WORDS[static_cast<std::size_t>(surroundings)];
}

inline const LightWord& lightWord(BackgroundKind background) {
    return BACKGROUND_WORDS[static_cast<std::size_t>(background)];
}

} // namespace quarn
