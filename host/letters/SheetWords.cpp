#include "host/letters/SheetWords.h"

#include "host/letters/Letters.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

constexpr SheetText MONTHS[] = {
    {L"Jan", 43400}, {L"Feb", 43401}, {L"Mar", 43402}, {L"Apr", 43403},
    {L"May", 43404}, {L"Jun", 43405}, {L"Jul", 43406}, {L"Aug", 43407},
    {L"Sep", 43408}, {L"Oct", 43409}, {L"Nov", 43410}, {L"Dec", 43411},
};
constexpr SheetText DAY_MONTH{L"%1 %2", 43412};
constexpr SheetText DAY_MONTH_YEAR{L"%1 %2 %3", 43413};

constexpr SheetText QUARTERS[] = {{L"N", 42728}, {L"E", 42729}, {L"S", 42730}, {L"W", 42731}};

std::string dayText(std::chrono::day day) {
    return std::to_string(static_cast<unsigned>(day));
}

/// The argument that a place in a text stands for; null where it is none.
const std::string* argumentAt(const std::string& text, std::size_t at,
                              std::initializer_list<std::string> arguments) {
    if (text[at] != '%' || at + 1 == text.size())
        return nullptr;
    const int number = text[at + 1] - '1';
    const bool is_one = number >= 0 && number < static_cast<int>(arguments.size());
    return is_one ? arguments.begin() + number : nullptr;
}

} // namespace

std::string SheetWords::operator()(const SheetText& text,
                                   std::initializer_list<std::string> arguments) const {
    std::string words = KM_wString(QnLocalizeString(text.english, text.id)).ToUtf8();
    if (m_letters && !m_letters->have(words))
        words = KM_wString(text.english).ToUtf8();
    std::string filled;
    for (std::size_t at = 0; at < words.size(); ++at) {
        const std::string* const argument = argumentAt(words, at, arguments);
        if (argument)
            filled += *argument;
        else
            filled += words[at];
        at += argument ? 1 : 0;
    }
    return filled;
}

std::string SheetWords::month(std::chrono::month month) const {
    return (*this)(MONTHS[static_cast<unsigned>(month) - 1]);
}

std::string SheetWords::date(const std::chrono::month_day& day) const {
    return (*this)(DAY_MONTH, {dayText(day.day()), month(day.month())});
}

std::string SheetWords::date(const std::chrono::year_month_day& day) const {
    return (*this)(DAY_MONTH_YEAR, {dayText(day.day()), month(day.month()),
                                    std::to_string(static_cast<int>(day.year()))});
}

std::string SheetWords::quarter(Quarter quarter) const {
    return (*this)(QUARTERS[quarter]);
}

} // namespace quarn
