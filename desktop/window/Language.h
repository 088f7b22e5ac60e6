#pragma once

#include <QLocale>
#include <QString>
#include <QTranslator>

namespace quarn::desktop {

/// The language that texts are in: the given one, else that of LC_ALL, LC_MESSAGES or LANG, the
/// first that is set, as the host takes it. The C locale where that names no language.
QLocale textLocale(const QString& language);

/// What dates and times are written like: in the given language, in the country of the system where
/// it is the system's language too; else as the system has it.
QLocale formatLocale(const QString& language, const QLocale& system = QLocale::system());

/// Qt's own part of the window - calendars, file choosers, menus of text fields - in a language,
/// for as long as this lives. It needs the application object, and comes before the first widget.
///
/// A program without a window reads and writes numbers with a point whatever the country is; so
/// does one with this, also where a library asks the C library for its way of writing numbers.
class Language final {
public:
    /// @param language  such as "de", "zh" or "de_AT"; empty takes that of the environment
    explicit Language(const QString& language);
    ~Language();
    Language(const Language&) = delete;
    Language& operator=(const Language&) = delete;

    /// Whether Qt has texts in the language here; without them its part is in English.
    bool hasTexts() const { return m_has_texts; }

private:
    QLocale m_former_locale;
    QTranslator m_texts;
    bool m_has_texts;
};

} // namespace quarn::desktop
