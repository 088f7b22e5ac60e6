#include "desktop/command_line/LineHistory.h"

#include <QSettings>

namespace quarn::desktop {

namespace {

constexpr const char* SETTING = "command_line/history";

} // namespace

LineHistory::LineHistory() : m_lines(QSettings().value(SETTING).toStringList()), m_place(0) {
    m_place = m_lines.size();
}

void LineHistory::add(const QString& line) {
    if (!line.isEmpty() && (m_lines.isEmpty() || m_lines.last() != line)) {
        m_lines.append(line);
        m_lines.remove(0, std::max<qsizetype>(0, m_lines.size() - LINES_KEPT));
        QSettings().setValue(SETTING, m_lines);
    }
    m_place = m_lines.size();
    m_unfinished.clear();
}

QString LineHistory::older(const QString& typed) {
    if (m_lines.isEmpty())
        return typed;
    if (m_place == m_lines.size())
        m_unfinished = typed;
    m_place = std::max<qsizetype>(0, m_place - 1);
    return m_lines[m_place];
}

QString LineHistory::newer(const QString& typed) {
    if (m_place == m_lines.size())
        return typed;
    ++m_place;
    return m_place == m_lines.size() ? m_unfinished : m_lines[m_place];
}

} // namespace quarn::desktop
