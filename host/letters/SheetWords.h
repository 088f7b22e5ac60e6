#pragma once

#include <chrono>
#include <initializer_list>
#include <string>

namespace quarn {

class Letters;

/// A text of sheets and their pages: its English, where %1, %2, ... stand for arguments, and its
/// number in the string tables.
struct SheetText {
    const wchar_t* english;
    int id;
};

/// Of the compass, clockwise.
enum Quarter { NORTH, EAST, SOUTH, WEST };

/// The words on a sheet, UTF-8. To be used on the main thread.
class SheetWords {
public:
    /// In the user's language.
    SheetWords() = default;
    /// In the user's language as far as these letters can write it, and else in English.
    explicit SheetWords(const Letters& letters) : m_letters(&letters) {}

    std::string operator()(const SheetText& text,
                           std::initializer_list<std::string> arguments = {}) const;

    /// "Mar"
    std::string month(std::chrono::month month) const;
    /// "21 Mar"
    std::string date(const std::chrono::month_day& day) const;
    /// "21 Mar 2026"
    std::string date(const std::chrono::year_month_day& day) const;
    /// The letter of north, east, south or west.
    std::string quarter(Quarter quarter) const;

private:
    const Letters* m_letters = nullptr;
};

} // namespace quarn
