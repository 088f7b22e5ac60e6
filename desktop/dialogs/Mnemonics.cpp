#include "desktop/dialogs/Mnemonics.h"

namespace quarn::desktop {
namespace {

bool isKey(QChar character) {
    return character.unicode() < 0x80 && character.isLetterOrNumber();
}

/// Where the letter stands that the label names itself; -1 when it names none.
qsizetype ownLetter(const QString& label) {
    for (qsizetype at = label.indexOf('&'); at >= 0; at = label.indexOf('&', at + 2)) {
        if (at + 1 < label.size() && label[at + 1].isLetterOrNumber())
            return at + 1;
    }
    return -1;
}

/// So that an ampersand that is one is shown.
QString withAmpersandsShown(const QString& label) {
    QString shown = label;
    for (qsizetype at = shown.indexOf('&'); at >= 0; at = shown.indexOf('&', at + 2)) {
        if (at + 1 == shown.size() || shown[at + 1].isSpace())
            shown.insert(at, '&');
    }
    return shown;
}

qsizetype freeLetter(const QString& label, const QString& taken, bool only_of_words) {
    for (qsizetype at = 0; at < label.size(); ++at) {
        const bool begins_a_word = at == 0 || label[at - 1].isSpace();
        if (isKey(label[at]) && (begins_a_word || !only_of_words) &&
            !taken.contains(label[at].toLower()))
            return at;
    }
    return -1;
}

} // namespace

QStringList withMnemonics(const QStringList& labels, QString taken) {
    QStringList result;
    for (const QString& label : labels) {
        result << withAmpersandsShown(label);
        if (const qsizetype own = ownLetter(result.last()); own >= 0)
            taken += result.last()[own].toLower();
    }
    for (QString& label : result) {
        if (ownLetter(label) >= 0)
            continue;
        qsizetype letter = freeLetter(label, taken, true);
        if (letter < 0)
            letter = freeLetter(label, taken, false);
        if (letter < 0)
            continue;
        taken += label[letter].toLower();
        label.insert(letter, '&');
    }
    return result;
}

QString withoutMnemonic(QString label) {
    for (qsizetype at = label.indexOf('&'); at >= 0; at = label.indexOf('&', at + 1)) {
        const bool marks = at + 1 < label.size() && !label[at + 1].isSpace();
        if (marks)
            label.remove(at, 1);
    }
    return label;
}

} // namespace quarn::desktop
