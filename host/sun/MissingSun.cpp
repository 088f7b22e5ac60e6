#include "host/sun/MissingSun.h"

#include "host/sun/SunYears.h"
#include "sdk/qncore/QnLocalize.h"

#include <utility>

namespace quarn {

namespace {

thread_local std::optional<MissingSun> noted;

} // namespace

void noteMissingSun(const MissingSun& missing) {
    if (!noted)
        noted = missing;
}

std::optional<KM_wString> takeMissingSun() {
    const std::optional<MissingSun> missing = std::exchange(noted, std::nullopt);
    if (!missing)
        return std::nullopt;
    if (!isSunYear(missing->year))
        return KM_wString::FormatToString(
            QnLocalizeString(L"The sun has no position in the year %d: it is known for the years "
                             L"%d to %d\n",
                             42112),
            missing->year, FIRST_SUN_YEAR, LAST_SUN_YEAR);
    return KM_wString::FormatToString(
        QnLocalizeString(L"The sun has no position on %04d-%02d-%02d at latitude %g, longitude "
                         L"%g\n",
                         42113),
        missing->year, missing->month, missing->day, missing->latitude_deg, missing->longitude_deg);
}

} // namespace quarn
