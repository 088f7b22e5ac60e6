#include "desktop/animation/ProgressRow.h"

#include "desktop/texts/Texts.h"

#include <QHBoxLayout>

#include <cmath>

namespace quarn::desktop {

namespace {

constexpr int STEPS = 1000;
constexpr int NAME_LETTERS = 40;

} // namespace

ProgressRow::ProgressRow(QWidget* parent)
    : QWidget(parent), m_text(new QLabel(this)), m_bar(new QProgressBar(this)) {
    m_text->setObjectName("progressText");
    m_text->setTextFormat(Qt::PlainText); // names of files may look like HTML
    m_bar->setObjectName("progressBar");
    m_bar->setAccessibleName(localized(L"Progress", 45236));
    m_bar->setRange(0, STEPS);
    m_bar->setTextVisible(false);
    auto* const cancel = new QPushButton(localized(L"Cancel", 45105), this);
    cancel->setObjectName("progressCancel");
    cancel->setToolTip(localized(L"Ends it here; pictures that are written stay", 45237));

    auto* const row = new QHBoxLayout(this);
    row->setContentsMargins(0, 0, 0, 0);
    row->addWidget(m_bar, 1);
    row->addWidget(m_text);
    row->addWidget(cancel);
    connect(cancel, &QPushButton::clicked, this, &ProgressRow::cancelled);
}

void ProgressRow::begin() {
    m_frames_written = 0;
    m_pace.begin(RecordingPace::Clock::now());
}

void ProgressRow::showFrame(int written, int total) {
    m_frames_written = written;
    m_pace.noteFrame(written, total, RecordingPace::Clock::now());
    show(m_pace.share(), m_pace.text());
}

/// Before the first frame nobody knows whether it is one picture or the first of many.
void ProgressRow::showPicture(double share) {
    m_pace.noteShare(share, RecordingPace::Clock::now());
    if (m_frames_written > 0) {
        show(m_pace.share(), m_pace.text());
        return;
    }
    const int percent = static_cast<int>(std::floor(share * 100.0));
    show(share, localized(L"Rendering: %1 %", 45238).arg(percent));
}

void ProgressRow::showModel(ModelStep step, double share) {
    const QString text = step == ModelStep::read   ? localized(L"Reading: %1 %", 45430)
                         : step == ModelStep::made ? localized(L"Making the meshes: %1 %", 45431)
                                                   : localized(L"Building the scene: %1 %", 45446);
    show(share, text.arg(static_cast<int>(std::floor(share * 100.0))));
}

/// A long name may not push the button out of the window.
void ProgressRow::showSharedFile(const std::filesystem::path& file, double share) {
    const QString name = fontMetrics().elidedText(qtText(file.filename()), Qt::ElideMiddle,
                                                  fontMetrics().averageCharWidth() * NAME_LETTERS);
    show(share, localized(L"Making %1: %2 %", 45445)
                    .arg(name, QString::number(static_cast<int>(std::floor(share * 100.0)))));
}

void ProgressRow::show(double share, const QString& text) {
    m_bar->setValue(static_cast<int>(std::lround(share * STEPS)));
    m_text->setText(text);
    setVisible(true);
}

} // namespace quarn::desktop
