#pragma once

#include "engine/scene/LightSettings.h"
#include "sdk/qncore/QnLocalize.h"

#include <cstddef>

namespace quarn {

/// What one may choose of, as prompts and forms call it.
struct LightWord {
    const wchar_t* name;
    int id; ///< of the text, and of the option

    CQuarnCommandOptionName option() const { return QnLocalizeCommandOptionName(name, id); }
    const wchar_t* text() const { return QnLocalizeString(name, id); }
};

inline constexpr LightWord AUTOMATIC_WORD = {L"Automatic", 42903};

/// In the order of Surroundings.
inline constexpr LightWord SURROUNDINGS_WORDS[] = {
    AUTOMATIC_WORD, {L"Studio", 42904}, {L"Sky", 42905}, {L"Picture", 42906}};

/// In the order of BackgroundKind.
inline constexpr LightWord BACKGROUND_WORDS[] = {
    AUTOMATIC_WORD, {L"Colour", 42912}, {L"Transparent", 42914}};

inline const LightWord& lightWord(Surroundings surroundings) {
    return SURROUNDINGS_WORDS[static_cast<std::size_t>(surroundings)];
}

inline const LightWord& lightWord(BackgroundKind background) {
    return BACKGROUND_WORDS[static_cast<std::size_t>(background)];
}

} // namespace quarn
