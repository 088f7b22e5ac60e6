#pragma once

#include <QString>
#include <QStringList>

namespace quarn::desktop {

/// The command lines that were typed, the oldest first, in this run and in earlier ones. They are
/// kept in the settings of the user (QSettings).
class LineHistory {
public:
    /// How many lines are kept.
    static constexpr int LINES_KEPT = 500;

    LineHistory();

    /// Adds a line, unless it is the last one again, and starts walking at the end.
    void add(const QString& line);
    /// One line further back; at the oldest one it stays there.
    /// @param typed  what stands in the line now; kept when the walk begins, and what newer() ends
    /// at
    /// @return the line to show
    QString older(const QString& typed);
    /// One line nearer; past the newest one what was typed before the walk.
    QString newer(const QString& typed);

    const QStringList& lines() const { return m_lines; }

private:
    QStringList m_lines;
    qsizetype m_place;    ///< the line that is shown; the count of lines: none of them
    QString m_unfinished; ///< what was typed before the walk
};

} // namespace quarn::desktop
