#include "host/clock/ZoneDatabase.h"

#include "host/cities/CitySpelling.h"
#include "host/clock/FooterRule.h"
#include "host/clock/ZoneFile.h"

#include <date/tz.h>

#include <algorithm>
#include <exception>
#include <optional>

namespace quarn {
namespace {

using std::chrono::sys_seconds;

constexpr std::size_t MOST_PROPOSED = 3;

Error missing(const std::filesystem::path& folder, const std::string& why) {
    return {"The time zone database is missing (" + folder.native() +
            (why.empty() ? "" : ": " + why) +
            "). Install Debian's package tzdata, or give the zone as hours from UTC, such as "
            "+01:00."};
}

/// Changes as the library reads them from the zone's file, then the rule of the file's end, which
/// the library leaves unread.
class FileRules final : public ZoneRules {
public:
    FileRules(const date::time_zone& zone, sys_seconds last_change, std::optional<FooterRule> rule)
        : m_zone(zone), m_last_change(last_change), m_rule(std::move(rule)) {}

    ClockPeriod periodAt(sys_seconds utc) const override {
        if (m_rule && utc >= m_last_change)
            return m_rule->periodAt(utc);
        const date::sys_info info = m_zone.get_info(utc);
        return {info.begin, info.end, info.offset, info.abbrev,
                info.save != std::chrono::minutes(0)};
    }

private:
    const date::time_zone& m_zone; // of the library's list, which stays
    sys_seconds m_last_change;
    std::optional<FooterRule> m_rule;
};

/// A name as it is found: Etc/GMT+5 and Etc/GMT-5 stay two.
std::string folded(std::string_view name) {
    std::string text(name);
    for (char& letter : text) {
        if (letter >= 'A' && letter <= 'Z')
            letter = static_cast<char>(letter - 'A' + 'a');
        else if (letter == ' ')
            letter = '_';
    }
    return text;
}

/// Berlin of Europe/Berlin.
std::string_view placeOf(std::string_view name) {
    return name.substr(name.rfind('/') + 1);
}

std::string proposals(std::string_view typed, const std::vector<date::time_zone>& zones) {
    const std::string place = comparedName(placeOf(typed));
    const int most_apart = std::max(1, static_cast<int>(place.size()) / 3);
    std::vector<std::pair<int, std::string>> near;
    for (const date::time_zone& zone : zones) {
        const int apart = lettersApart(place, comparedName(placeOf(zone.name())));
        if (apart <= most_apart)
            near.emplace_back(apart, zone.name());
    }
    std::ranges::stable_sort(near, {}, &std::pair<int, std::string>::first);
    std::string text;
    for (std::size_t index = 0; index < std::min(near.size(), MOST_PROPOSED); ++index)
        text += (index == 0 ? " Did you mean " : " or ") + near[index].second;
    return text.empty() ? text : text + "?";
}

Error unknown(std::string_view typed, const std::vector<date::time_zone>& zones) {
    return {"\"" + std::string(typed) + "\" is no time zone." + proposals(typed, zones) +
            " Zones are names like Europe/Berlin, or hours from UTC like +05:30."};
}

Result<DatabaseZone> zoneIn(const date::tzdb& database, std::string_view name,
                            const std::filesystem::path& folder) {
    const auto& zones = database.zones;
    const auto zone = std::ranges::find_if(zones, [wanted = folded(name)](const auto& other) {
        return folded(other.name()) == wanted;
    });
    if (zone == zones.end())
        return unknown(name, zones);
    const auto end = readZoneFileEnd(folder / zone->name());
    if (!end)
        return end.error();
    return DatabaseZone{zone->name(),
                        std::make_shared<FileRules>(*zone, end.value().last_change,
                                                    FooterRule::read(end.value().rule))};
}

} // namespace

Result<DatabaseZone> databaseZone(std::string_view name, const std::filesystem::path& folder) {
    std::error_code failure;
    if (!std::filesystem::is_directory(folder, failure))
        return missing(folder, {});
    // The library reports by exceptions what is wrong with the folder or a file in it.
    try {
        return zoneIn(date::get_tzdb(), name, folder);
    } catch (const std::exception& exception) {
        return missing(folder, exception.what());
    }
}

} // namespace quarn
