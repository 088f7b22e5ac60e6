#include "quarn/arguments/Readings.h"

#include "host/session/InstructionSets.h"
#include "host/session/MemorySize.h"
#include "host/session/RecordingCheck.h"

#include <algorithm>

namespace quarn::program {

namespace {

/// A reading that knows one reason to refuse a word.
/// @param read  nothing for a word that is not as demanded
template <class Value>
Reading<Value> reading(const std::string& demand,
                       const std::function<std::optional<Value>(const std::string&)>& read) {
    return [=](const std::string& option, const std::string& word) {
        const std::optional<Value> value = read(word);
        return value ? std::variant<Value, Refusal>(*value) : mustBe(option, demand, word);
    };
}

std::string ofUnit(const std::string& unit) {
    return unit.empty() ? "" : " of " + unit;
}

/// "a, b or c"
std::string alternatives(const std::vector<std::string>& words) {
    std::string text;
    for (std::size_t i = 0; i < words.size(); ++i)
        text += (i == 0 ? "" : i + 1 == words.size() ? " or " : ", ") + words[i];
    return text;
}

/// The year that a word named; nothing: this one.
std::optional<int> yearOf(const WantedDay& day) {
    if (const auto* const date = std::get_if<std::chrono::year_month_day>(&day))
        return int(date->year());
    const auto* const season = std::get_if<SeasonDay>(&day);
    return season ? season->year : std::nullopt;
}

} // namespace

Refusal mustBe(const std::string& option, const std::string& demand, const std::string& word) {
    return {option + " must be " + demand + ", not \"" + word + "\"."};
}

Reading<int> wholeNumberFrom(int low, std::optional<int> high, const std::string& unit) {
    const std::string demand = "a whole number" + ofUnit(unit) + " from " + std::to_string(low) +
                               (high ? " to " + std::to_string(*high) : "");
    return reading<int>(demand, [=](const std::string& word) {
        const std::optional<int> number = wholeNumber(word);
        return number && *number >= low && (!high || *number <= *high) ? number : std::nullopt;
    });
}

Reading<int> minutesOfADay() {
    constexpr int MINUTES_OF_DAY = 1440;
    return wholeNumberFrom(1, MINUTES_OF_DAY, "minutes");
}

Reading<double> numberFrom(double low, double high, const std::string& unit) {
    const std::string demand =
        "a number" + ofUnit(unit) + " from " + numberText(low) + " to " + numberText(high);
    return reading<double>(demand, [=](const std::string& word) {
        const std::optional<double> number = realNumber(word);
        return number && *number >= low && *number <= high ? number : std::nullopt;
    });
}

Reading<Triple> point() {
    return reading<Triple>("three numbers X,Y,Z without blanks",
                           [](const std::string& word) { return triple(word); });
}

Reading<PixelSize> sizeOfPicture() {
    constexpr int LARGEST_SIDE_PX = 16384;
    const auto is_good = [](int side_px) { return side_px >= 1 && side_px <= LARGEST_SIDE_PX; };
    return reading<PixelSize>(
        "WIDTHxHEIGHT such as 1280x720, each from 1 to " + std::to_string(LARGEST_SIDE_PX),
        [=](const std::string& word) {
            const std::optional<PixelSize> size = pixelSize(word);
            return size && is_good(size->width_px) && is_good(size->height_px) ? size
                                                                               : std::nullopt;
        });
}

Reading<std::uint64_t> sizeOfMemory() {
    return reading<std::uint64_t>("a size such as 500M or 2G, from 1M", &memorySize);
}

Reading<int> threadCount() {
    constexpr int MOST_THREADS = 1024;
    return wholeNumberFrom(1, MOST_THREADS, "threads");
}

Reading<int> numberOfRetries() {
    constexpr int MOST_RETRIES = 100;
    return wholeNumberFrom(0, MOST_RETRIES);
}

Reading<std::string> instructionSet() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<std::string, Refusal> {
        const std::string name = lowerCase(word);
        if (const auto refusal = whyInstructionsAreRefused(name))
            return Refusal{option + ": " + *refusal};
        return name;
    };
}

Reading<std::string> oneOf(const std::vector<std::string>& words) {
    return reading<std::string>(
        alternatives(words), [=](const std::string& word) -> std::optional<std::string> {
            const auto found = std::ranges::find(words, lowerCase(word));
            return found == words.end() ? std::nullopt : std::optional(*found);
        });
}

Reading<std::string> scriptWord(const std::string& subject) {
    return [=](const std::string&, const std::string& word) -> std::variant<std::string, Refusal> {
        if (const auto refusal = whyPathIsRefused(subject, word))
            return Refusal{*refusal};
        return word;
    };
}

Reading<std::filesystem::path> savedDocument() {
    using Path = std::filesystem::path;
    return [](const std::string&, const std::string& word) -> std::variant<Path, Refusal> {
        if (const auto refusal = whyPathIsRefused("the document's path", word))
            return Refusal{*refusal};
        if (!isDocument(word))
            return Refusal{word + " is no document: give the .quarn file that --save wrote."};
        return Path(word);
    };
}

Reading<FrameRanges> frameRanges() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<FrameRanges, Refusal> {
        FrameRangesReading reading = readFrameRanges(option, word);
        if (!reading.refusal.empty())
            return Refusal{reading.refusal};
        if (const auto refusal = whyFramesAreRefused(word))
            return Refusal{option + ": " + *refusal};
        return std::move(reading.ranges);
    };
}

Reading<WantedDay> dayOfTheSun(int last_year) {
    return [=](const std::string& option,
               const std::string& word) -> std::variant<WantedDay, Refusal> {
        const std::optional<WantedDay> day = wantedDay(word);
        if (!day)
            return mustBe(option,
                          "a date such as 2026-06-21, today, or a day such as solstice-june or "
                          "equinox-march-2030",
                          word);
        const auto* const date = std::get_if<std::chrono::year_month_day>(&*day);
        if (date && (!date->ok() || date->year() == std::chrono::year(0)))
            return mustBe(option, "a day of the calendar", word);
        const std::optional<int> year = yearOf(*day);
        if (year && (*year < FIRST_SUN_YEAR || *year > last_year))
            return mustBe(option,
                          "in the years " + std::to_string(FIRST_SUN_YEAR) + " to " +
                              std::to_string(last_year),
                          word);
        return *day;
    };
}

Reading<WantedTime> timeOfTheSun() {
    return reading<WantedTime>(
        "a time from 00:00 to 23:59, or one such as sunrise+1h and sunset-30m", &wantedTime);
}

Reading<std::chrono::minutes> timeByTheClock() {
    return reading<std::chrono::minutes>("a time from 00:00 to 23:59", &timeOfDay);
}

} // namespace quarn::program
