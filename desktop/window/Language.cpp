#include "desktop/window/Language.h"

#include <QCoreApplication>
#include <QLibraryInfo>

#include <clocale>

namespace quarn::desktop {

namespace {

QString languageOfEnvironment() {
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"})
        if (!qEnvironmentVariableIsEmpty(variable))
            return qEnvironmentVariable(variable);
    return {};
}

bool isLanguage(const QLocale& locale) {
    return locale.language() != QLocale::C;
}

} // namespace

QLocale textLocale(const QString& language) {
    return QLocale(language.isEmpty() ? languageOfEnvironment() : language);
}

QLocale formatLocale(const QString& language, const QLocale& system) {
    const QLocale wanted(language);
    const bool is_systems = wanted.language() == system.language() && !language.contains('_');
    return isLanguage(wanted) && !is_systems ? wanted : system;
}

/// Qt takes over the system's locale, decimal commas included, when the application is made.
Language::Language(const QString& language) {
    std::setlocale(LC_NUMERIC, "C");
    QLocale::setDefault(formatLocale(language));
    const QString folder = QLibraryInfo::path(QLibraryInfo::TranslationsPath);
    m_has_texts = m_texts.load(textLocale(language), "qtbase", "_", folder);
    if (m_has_texts)
        QCoreApplication::installTranslator(&m_texts);
}

Language::~Language() {
    QCoreApplication::removeTranslator(&m_texts);
    QLocale::setDefault(m_former_locale);
}

} // namespace quarn::desktop
