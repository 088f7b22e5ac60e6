#pragma once

#include <QString>

namespace vexui {

/// What becomes of characters in an animation's name that no file's name can have.
enum class BadCharacters {
    replaced, ///< the command replaces them, and tells so
    refused,  ///< the command would keep them, and the recording would fail
};

/// Why a name cannot be taken, in the user's language; empty when it can.
QString nameFault(const QString& name, BadCharacters bad_characters);

/// What a person should know about a name that can be taken; empty for nothing.
QString nameWarning(const QString& name);

} // namespace vexui
