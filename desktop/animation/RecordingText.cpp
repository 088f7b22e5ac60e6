#include "desktop/animation/RecordingText.h"

#include "desktop/texts/Texts.h"

#include <QStringList>

namespace quarn::desktop {

namespace {

QString countText(const RecordingReport& report) {
    const QString folder = qtText(report.folder);
    if (report.written < report.expected)
        return localized(L"Only %1 of %2 pictures were written to %3.", 45371)
            .arg(report.written)
            .arg(report.expected)
            .arg(folder);
    if (report.there < report.written)
        return localized(L"%1 pictures were written to %2, but only %3 are still there.", 45372)
            .arg(QString::number(report.written), folder, QString::number(report.there));
    return localized(L"%1 pictures were written to %2.", 45370).arg(report.there).arg(folder);
}

QString pageText(const RecordingReport& report) {
    const QString page = qtText(report.page.filename());
    if (!report.has_page || report.isComplete())
        return {};
    if (report.there == 0)
        return localized(L"The page %1 shows nothing.", 45373).arg(page);
    return report.there < report.written
               ? localized(L"The page %1 lists pictures that are not there.", 45374).arg(page)
               : QString();
}

QString leftOverText(const RecordingReport& report) {
    if (report.left_over == 0)
        return {};
    return localized(L"%1 pictures of an earlier recording are still there, the first is %2.",
                     45375)
        .arg(QString::number(report.left_over), qtText(report.first_left_over));
}

} // namespace

QString recordingText(const RecordingReport& report) {
    QStringList sentences = {countText(report), pageText(report), leftOverText(report)};
    sentences.removeAll({});
    return sentences.join(' ');
}

} // namespace quarn::desktop
