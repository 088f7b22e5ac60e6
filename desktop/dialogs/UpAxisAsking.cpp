#include "desktop/dialogs/UpAxisAsking.h"

#include "desktop/dialogs/DialogOwner.h"
#include "desktop/dialogs/UpAxisDialog.h"
#include "desktop/texts/Texts.h"

#include <QApplication>
#include <QPointer>
#include <QSettings>

namespace quarn::desktop {

namespace {

constexpr const char* SETTING = "files/asks_which_way_is_up";
constexpr QSize PICTURE{260, 195};

std::filesystem::path wholePath(const std::filesystem::path& file) {
    std::error_code error;
    const std::filesystem::path whole = std::filesystem::weakly_canonical(file, error);
    return error ? file : whole;
}

ModelUp otherThan(ModelUp up) {
    return up == ModelUp::y ? ModelUp::z : ModelUp::y;
}

/// A picture as sharp as the screens are; null where the model cannot be drawn.
UpAxisDialog::Way drawn(const UpAxisQuestion& question, ModelUp up) {
    const qreal ratio = qApp->devicePixelRatio();
    const QSize size = (QSizeF(PICTURE) * ratio).toSize();
    const ShownPicture shown = question.draw(up, size.width(), size.height());
    if (shown.width_px <= 0)
        return {up, {}};
    QPixmap picture = QPixmap::fromImage(
        QImage(shown.rgba.data(), shown.width_px, shown.height_px, QImage::Format_RGBX8888));
    picture.setDevicePixelRatio(ratio);
    return {up, picture};
}

} // namespace

UpAxisAsking::UpAxisAsking(QObject* parent)
    : QObject(parent), m_switch(new QAction(localized(L"Ask which &way is up", 45439), this)) {
    m_switch->setObjectName("askUpAxis");
    m_switch->setCheckable(true);
    m_switch->setChecked(QSettings().value(SETTING, true).toBool());
    connect(m_switch, &QAction::toggled, this,
            [](bool asks) { QSettings().setValue(SETTING, asks); });
}

std::optional<ModelUp> UpAxisAsking::ask(QWidget* owner, const UpAxisQuestion& question) {
    const std::filesystem::path file = wholePath(question.file);
    if (const auto earlier = m_answers.find(file); earlier != m_answers.end())
        return earlier->second;
    if (!m_switch->isChecked())
        return std::nullopt;
    const std::optional<ModelUp> answer = askPerson(owner, question);
    if (answer)
        m_answers.emplace(file, *answer);
    return answer;
}

std::optional<ModelUp> UpAxisAsking::askPerson(QWidget* owner, const UpAxisQuestion& question) {
    const UpAxisDialog::Way other = drawn(question, otherThan(question.taken));
    const UpAxisDialog::Way taken = drawn(question, question.taken);
    if (taken.picture.isNull() || other.picture.isNull())
        return std::nullopt;
    const QPointer<UpAxisDialog> dialog =
        new UpAxisDialog(topmostOwner(owner), qtText(question.file.filename()), taken, other);
    dialog->exec();
    std::optional<ModelUp> answer;
    if (dialog) {
        answer = dialog->choice();
        m_switch->setChecked(dialog->wantsToBeAsked());
    }
    delete dialog.data();
    return answer;
}

} // namespace quarn::desktop
