#include "vexui/forms/StudyFrames.h"

#include "vexui/texts/LocalText.h"

#include <QLocale>

namespace vexui {

StudyFrames studyFrames(const QDateTime& start, const QDateTime& end, std::int64_t step_s) {
    const std::int64_t length_s = start.secsTo(end);
    if (length_s < 0)
        return {};
    if (step_s <= 0)
        return {1, start};
    const std::int64_t steps = length_s / step_s;
    return {steps + 1, start.addSecs(steps * step_s)};
}

QString manyFramesText(std::int64_t count) {
    return localText(L"%1 frames are very many: setting up and recording them takes long.", 44087)
        .arg(QLocale().toString(static_cast<qlonglong>(count)));
}

} // namespace vexui
