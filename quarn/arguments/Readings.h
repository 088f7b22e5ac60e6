#pragma once

#include "host/almanac/DayTimes.h"
#include "host/almanac/WantedDay.h"
#include "host/sun/SunYears.h"
#include "quarn/arguments/OptionAdder.h"
#include "quarn/words/FrameRanges.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// "--frames must be a whole number from 1, not "x"."
Refusal mustBe(const std::string& option, const std::string& demand, const std::string& word);

/// @param high  nothing: as large as a number can be
/// @param unit  what is counted; empty: nothing
Reading<int> wholeNumberFrom(int low, std::optional<int> high = {}, const std::string& unit = "");
/// A step of a day.
Reading<int> minutesOfADay();
Reading<double> numberFrom(double low, double high, const std::string& unit = "");
Reading<Triple> point();
Reading<PixelSize> sizeOfPicture();
/// How often a frame that fails is tried again.
Reading<int> numberOfRetries();
/// In bytes.
Reading<std::uint64_t> sizeOfMemory();

/// By how many threads work is done.
Reading<int> threadCount();
/// A set of instructions that this processor has, in lower case.
Reading<std::string> instructionSet();

/// One of these words in any case; the value is in lower case, as they are.
Reading<std::string> oneOf(const std::vector<std::string>& words);

/// A name or a path that a script can hold.
/// @param subject  what it is, for the message: "the name of --hide"
Reading<std::string> scriptWord(const std::string& subject);

/// A document file to open.
Reading<std::filesystem::path> savedDocument();

/// Frames of an animation: "0-9,20-30:2".
Reading<FrameRanges> frameRanges();

/// What help says of the days that dayOfTheSun reads.
inline constexpr const char* DAY_HELP =
    "The day, such as 2026-06-21, or solstice-june, solstice-december, equinox-march or "
    "equinox-september of this year; solstice-june-2030 is of another one (default: today)";

/// A date, or a day that the sun's course names.
/// @param last_year  the first is that of the sun
Reading<WantedDay> dayOfTheSun(int last_year = LAST_SUN_YEAR);

/// A time by the clock, or one that is told from sunrise or sunset.
Reading<WantedTime> timeOfTheSun();

/// A time by the clock, since midnight.
Reading<std::chrono::minutes> timeByTheClock();

} // namespace quarn::program
