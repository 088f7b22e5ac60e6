#include "vexui/forms/CameraAnimationForm.h"

#include "vexui/forms/CountField.h"
#include "vexui/forms/StudyFrames.h"
#include "vexui/texts/LocalText.h"

#include <QComboBox>
#include <QFormLayout>
#include <QLocale>

#include <algorithm>

namespace vexui {

namespace {

constexpr int most_frames = 1'000'000;

const char* nameOf(CameraAnimationForm::Kind kind) {
    return kind == CameraAnimationForm::Kind::turntable ? "turntableForm" : "pathForm";
}

QString titleOf(CameraAnimationForm::Kind kind) {
    return kind == CameraAnimationForm::Kind::turntable ? localText(L"Turntable Animation", 44001)
                                                        : localText(L"Path Animation", 44002);
}

/// The steps are even in the circle's parameter, so that their angles differ by some percent: more
/// digits than these would be those of no step.
QString meanStepText(double degrees) {
    return degrees < 1.0 ? QLocale().toString(degrees, 'g', 2)
                         : QLocale().toString(degrees, 'f', degrees < 10.0 ? 1 : 0);
}

} // namespace

CameraAnimationForm::CameraAnimationForm(Kind kind, const IZoetrixDataUI& lists,
                                         const KM_3dmAnimationProperties& record, QWidget* owner)
    : Form(nameOf(kind), titleOf(kind), owner), m_kind(kind) {
    addMotion(lists, record);
    m_recording = addRecording(lists, record, BadCharacters::replaced);
    finish([this] { return outcome(); });
}

void CameraAnimationForm::addMotion(const IZoetrixDataUI& lists,
                                    const KM_3dmAnimationProperties& record) {
    QFormLayout& section = addSection(localText(L"Camera", 44007));
    m_frames = new CountField(1, most_frames, this);
    m_frames->setValue(std::max(record.FrameCount(), 1));
    addCount(section,
             {"frames", localText(L"&Frames:", 44020),
              localText(L"How many pictures the animation has", 44040)},
             *m_frames);
    check(*m_frames, [this] { return frameFault(); });
    if (m_kind == Kind::turntable)
        m_directions =
            &addList(section,
                     {"direction", localText(L"&Direction:", 44021),
                      localText(L"Which way the model seems to turn, seen from above", 44041)},
                     lists.DirectionList(), lists.DirectionListSelection());
}

QString CameraAnimationForm::frameFault() const {
    const std::optional<int> count = m_frames->count();
    if (!count)
        return localText(L"Enter the number of frames.", 44070);
    return *count < 1 ? localText(L"An animation has at least 1 frame.", 44071) : QString();
}

Outcome CameraAnimationForm::outcome() const {
    const int count = m_frames->count().value_or(1);
    if (const QString warning = nameWarning(m_recording.nameText()); !warning.isEmpty())
        return {warning, true};
    if (count > many_frames)
        return {manyFramesText(count), true};
    return {framesText(count)};
}

QString CameraAnimationForm::framesText(int count) const {
    const QString number = QLocale().toString(count);
    if (m_kind == Kind::path)
        return count == 1 ? localText(L"1 frame.", 44100)
                          : localText(L"%1 frames along the path.", 44101).arg(number);
    if (count == 1)
        return localText(L"1 frame: the view as it is.", 44102);
    return localText(L"%1 frames; the camera turns by about %2° from each to the next.", 44103)
        .arg(number, meanStepText(360.0 / count));
}

void CameraAnimationForm::takeInto(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) const {
    m_recording.takeInto(lists, record);
    record.SetFrameCount(m_frames->count().value_or(1));
    if (m_directions && m_directions->count() > 0)
        lists.SetDirectionListSelection(m_directions->currentIndex());
}

} // namespace vexui
