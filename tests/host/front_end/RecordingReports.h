#pragma once

#include "host/front_end/RecordingReport.h"

namespace quarn::test {

/// A recording of out/house.html that wrote its page.
/// @param expected  how many pictures it was to write
/// @param written   how many it wrote
/// @param there     how many of those were there at its end
inline RecordingReport reportOf(int expected, int written, int there) {
    RecordingReport report;
    report.folder = "out";
    report.page = "out/house.html";
    report.expected = expected;
    report.written = written;
    report.there = there;
    report.has_page = true;
    return report;
}

} // namespace quarn::test
