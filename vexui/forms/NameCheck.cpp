#include "vexui/forms/NameCheck.h"

#include "sdk/qncore/QnAnimationName.h"
#include "vexui/texts/LocalText.h"

#include <algorithm>

namespace vexui {

namespace {

bool isBad(QChar character) {
    return QnIsForbiddenInNames(character.unicode());
}

/// Line breaks and all else that shows nothing and that no file's name should hold.
bool isControl(QChar character) {
    return character.category() == QChar::Other_Control || character == QChar::LineSeparator ||
           character == QChar::ParagraphSeparator;
}

} // namespace

QString nameFault(const QString& name, BadCharacters bad_characters) {
    if (name.trimmed().isEmpty())
        return localText(L"Enter a name.", 44075);
    const auto length = static_cast<int>(name.toStdWString().size());
    if (length > QnLongestAnimationName)
        return localText(L"The name has %1 characters; %2 are the most.", 44076)
            .arg(QString::number(length), QString::number(QnLongestAnimationName));
    if (std::any_of(name.begin(), name.end(), isControl))
        return localText(L"The name holds a line break or another invisible character.", 44077);
    const bool is_refused = bad_characters == BadCharacters::refused;
    if (is_refused && std::any_of(name.begin(), name.end(), isBad))
        return localText(L"These characters cannot be used in the name: \\ / : * ? \" < > |",
                         44078);
    return {};
}

QString nameWarning(const QString& name) {
    if (std::none_of(name.begin(), name.end(), isBad))
        return {};
    return localText(
        L"In the name \"_\" will replace the characters that a file cannot have: \\ / : * ? \" < "
        L"> |",
        44085);
}

} // namespace vexui
