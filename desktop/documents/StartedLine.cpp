#include "desktop/documents/StartedLine.h"

#include "desktop/texts/Texts.h"

namespace quarn::desktop {

namespace {

bool isPrefixOrBlank(QChar c) {
    return c == '_' || c == '-' || c == '!' || c.isSpace();
}

} // namespace

StartedLine readLine(const Session& session, const QString& line) {
    qsizetype begin = 0;
    while (begin < line.size() && isPrefixOrBlank(line[begin]))
        ++begin;
    qsizetype end = begin;
    while (end < line.size() && !line[end].isSpace())
        ++end;
    const QString name = line.mid(begin, end - begin);
    for (const CommandName& command : session.commandNames(true)) {
        const QString english = qtText(command.english);
        if (name.compare(english, Qt::CaseInsensitive) == 0 ||
            name.compare(qtText(command.local), Qt::CaseInsensitive) == 0)
            return {english, line.mid(end).trimmed()};
    }
    return {};
}

QString quotedPath(const std::filesystem::path& file) {
    const QString path = qtText(file);
    const bool can_be_quoted = !path.contains('"') && !path.contains('\n') && !path.contains('\r');
    return can_be_quoted ? '"' + path + '"' : QString();
}

} // namespace quarn::desktop
