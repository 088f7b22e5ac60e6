#include "host/sunhours/SunHoursPage.h"

#include "engine/images/ImageFile.h"
#include "host/clock/WallText.h"
#include "host/share/Base64Text.h"
#include "host/share/viewer/PageTemplate.h"
#include "host/sunhours/HourColors.h"
#include "host/sunhours/HoursSheet.h"

#include <nlohmann/json.hpp>

#include <cmath>
#include <cstdio>
#include <map>

namespace quarn {

namespace {

constexpr SheetText TIME_OF_DAY{L"Time of day", 42995};
constexpr SheetText MOVE{L"move to see shadows", 42996};
constexpr SheetText LANGUAGE{L"en", 42999}; // of these texts, as web pages name it

/// Numbers as the page's script reads them: seven bits a byte, the lowest first, the eighth set
/// where more follow.
class RunBytes {
public:
    /// Adds one more number of a row; those that are equal are kept as one.
    void add(std::int64_t number) {
        if (m_count > 0 && number == m_number) {
            ++m_count;
            return;
        }
        flush();
        m_step = number - m_number;
        m_number = number;
        m_count = 1;
    }
    std::string base64() {
        flush();
        m_count = 0;
        return base64Text(std::as_bytes(std::span(m_bytes)));
    }

private:
    /// A run: the change of the number, by turns up and down, and how long it stays.
    void flush() {
        if (m_count == 0)
            return;
        put(static_cast<std::uint64_t>(m_step < 0 ? -2 * m_step - 1 : 2 * m_step));
        put(m_count);
    }
    void put(std::uint64_t number) {
        for (; number >= 128; number >>= 7)
            m_bytes.push_back(static_cast<std::uint8_t>((number & 127U) | 128U));
        m_bytes.push_back(static_cast<std::uint8_t>(number));
    }

    std::vector<std::uint8_t> m_bytes;
    std::int64_t m_number = 0;
    std::int64_t m_step = 0;
    std::uint64_t m_count = 0;
};

template <class Number> std::string runsOf(const SunHoursMap& map, const Number& number) {
    RunBytes runs;
    for (int y = 0; y < map.height_px; ++y)
        for (int x = 0; x < map.width_px; ++x)
            runs.add(number(x, y));
    return runs.base64();
}

/// In hundredths of an hour; -1 where no surface is seen.
std::string hourRuns(const SunHoursMap& map) {
    return runsOf(map, [&](int x, int y) -> std::int64_t {
        return map.object(x, y) == 0 ? -1 : std::lround(100.0 * double{map.hours(x, y)});
    });
}

/// What changed since the step before: most of a picture stays as it was.
nlohmann::json litRuns(const SunHoursMap& map, std::size_t steps) {
    nlohmann::json all = nlohmann::json::array();
    for (std::size_t step = 0; step < steps; ++step)
        all.push_back(runsOf(map, [&](int x, int y) -> std::int64_t {
            const std::size_t point = map.tiles.indexOf(x, y);
            const bool before = step > 0 && map.light.isLit(step - 1, point);
            return map.light.isLit(step, point) != before;
        }));
    return all;
}

nlohmann::json timesOf(const SunHoursPage& page) {
    nlohmann::json times = nlohmann::json::array();
    for (const SunMoment& moment : page.moments.moments)
        times.push_back(timeWithZone(page.request.site.zone.at(moment.time)));
    return times;
}

nlohmann::json scaleOf() {
    constexpr int COLORS = 10;
    nlohmann::json colors = nlohmann::json::array();
    for (int i = 0; i <= COLORS; ++i) {
        const KM_Color color = viridis(static_cast<double>(i) / COLORS);
        char text[8];
        std::snprintf(text, sizeof text, "#%02x%02x%02x", unsigned{color.r}, unsigned{color.g},
                      unsigned{color.b});
        colors.push_back(text);
    }
    return colors;
}

std::string dataOf(const SunHoursPage& page) {
    const SunHoursMap& map = page.map;
    const bool has_day = page.moments.areShown();
    nlohmann::json data;
    data["width"] = map.width_px;
    data["height"] = map.height_px;
    data["end"] = endOfScale(page.moments.hours);
    data["scale"] = scaleOf();
    data["names"] = page.names;
    data["hour"] = SheetWords()(WHOLE_HOURS);
    data["move"] = SheetWords()(MOVE);
    data["hours"] = hourRuns(map);
    data["objects"] = runsOf(map, [&](int x, int y) -> std::int64_t { return map.object(x, y); });
    data["times"] = has_day ? timesOf(page) : nlohmann::json::array();
    data["lit"] = has_day ? litRuns(map, page.moments.moments.size()) : nlohmann::json::array();
    return data.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace);
}

} // namespace

Result<void> writeSunHoursPage(const std::filesystem::path& file, const SunHoursPage& page) {
    const auto picture = encodeImage(page.picture, ImageFormat::png);
    if (!picture)
        return picture.error();
    const SheetWords words;
    const std::string title = titleOf(page.request, words);
    char nonce[17];
    std::snprintf(nonce, sizeof nonce, "%016zx", std::hash<std::string>()(title));
    const auto text = [](std::string words) {
        return [words = std::move(words)](const ByteSink& sink) { put(sink, words); };
    };
    const PlaceFillers fillers = {
        {"nonce", text(nonce)},
        {"title", text(htmlText(title))},
        {"language", text(words(LANGUAGE))},
        {"subtitle", text(htmlText(subtitleOf(page.request, page.moments, words)))},
        {"time of day", text(htmlText(words(TIME_OF_DAY)))},
        {"legend", text(htmlText(legendOf(page.request, page.moments, words)))},
        {"data", text(jsonInHtml(dataOf(page)))},
        {"picture", text("data:image/png;base64," + base64Text(picture.value()))},
    };
    return writeFileInPieces(file, [&](const ByteSink& sink) {
        return fillTemplate(page.page_template, fillers, sink);
    });
}

} // namespace quarn
