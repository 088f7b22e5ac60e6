#pragma once

#include "desktop/animation/RecordingPace.h"
#include "host/front_end/FrontEnd.h"

#include <QLabel>
#include <QProgressBar>
#include <QPushButton>

namespace quarn::desktop {

/// How far a recording, a rendered picture, a model being read or a file for others is, with a
/// button that ends it.
class ProgressRow final : public QWidget {
    Q_OBJECT
public:
    explicit ProgressRow(QWidget* parent = nullptr);

    /// A recording begins, or a command that may render a picture.
    void begin();
    void showFrame(int written, int total);
    /// @param share  of one picture, from 0 to 1
    void showPicture(double share);
    /// How far a model file is read.
    /// @param share  of the step, from 0 to 1
    void showModel(ModelStep step, double share);
    /// How much of a file for others is made.
    /// @param share  from 0 to 1
    void showSharedFile(const std::filesystem::path& file, double share);
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
