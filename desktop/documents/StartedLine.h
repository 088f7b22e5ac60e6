#pragma once

#include "host/session/Session.h"

#include <QString>

namespace quarn::desktop {

/// A command line, looked at before it is started.
struct StartedLine {
    QString english_name; ///< of the command; empty when there is none of that name
    QString words;        ///< what follows the name, without blanks around it
};

/// @param line  with the name in either language and whatever prefixes
StartedLine readLine(const Session& session, const QString& line);

/// A path as one word of a command line; nothing for a path that no command line can hold.
QString quotedPath(const std::filesystem::path& file);

} // namespace quarn::desktop
