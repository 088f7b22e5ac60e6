#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnExport.h"

/// The name of a command-line option: English for scripts that run anywhere, local for a person.
/// At a prompt either is understood, ignoring case, with or without a leading underscore.
struct CQuarnCommandOptionName {
    KM_wString m_english;
    KM_wString m_local;
};

/// A value that a command-line option shows, in English and in the user's language.
struct CQuarnCommandOptionValue {
    KM_wString m_english;
    KM_wString m_local;
};

/// The text in the user's language.
///
/// @param english  the English text, which is also the fallback; not null
/// @param id       the text's fixed number in the string tables; 0 is never looked up
/// @return a text that stays valid until the program ends; for id 0, or an id that no table holds,
///         `english` itself, and so on another thread than the main one, which is a breach of the
///         interface, and where the table's text takes other arguments of KM_wString::Format than
///         `english` does. Strings, option names and option values are separate tables.
QNCORE_API const wchar_t* QnLocalizeString(const wchar_t* english, int id);

/// An option name with its local form; as QnLocalizeString otherwise.
QNCORE_API CQuarnCommandOptionName QnLocalizeCommandOptionName(const wchar_t* english, int id);

/// An option value with its local form; as QnLocalizeString otherwise.
QNCORE_API CQuarnCommandOptionValue QnLocalizeCommandOptionValue(const wchar_t* english, int id);
