#pragma once

#include "desktop/animation/RecordingPace.h"

#include <QLabel>
#include <QProgressBar>
#include <QPushButton>

namespace quarn::desktop {

/// How far a recording or a rendered picture is, with a button that ends it.
class ProgressRow final : public QWidget {
    Q_OBJECT
public:
    explicit ProgressRow(QWidget* parent = nullptr);

    /// A recording begins, or a command that may render a picture.
    void begin();
    void showFrame(int written, int total);
    /// @param share  of one picture, from 0 to 1
    void showPicture(double share);
    int framesWritten() const { return m_frames_written; }

signals:
    void cancelled();

private:
    void show(double share, const QString& text);

    QLabel* m_text;
    QProgressBar* m_bar;
    RecordingPace m_pace;
    int m_frames_written = 0;
};

} // namespace quarn::desktop
