#include "host/clock/FooterRule.h"
#include "host/clock/ZoneDatabase.h"
#include "host/clock/ZoneFile.h"
#include "tests/host/clock/CLibraryClock.h"

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>

namespace {

using namespace quarn;
using namespace std::chrono;

// The C library takes such rules as the name of a zone. The last two days of both years count
// leap days in their own way.
TEST(FooterRule, ChangesTheClocksWhenTheCLibraryDoes) {
    const char* const RULES[] = {"CET-1CEST,M3.5.0,M10.5.0/3",
                                 "IST-1GMT0,M10.5.0,M3.5.0/1",
                                 "<-02>2<-01>,M3.5.0/-1,M10.5.0/0",
                                 "EET-2EEST,M3.4.4/50,M10.4.4/50",
                                 "<+1030>-10:30<+11>-11,M10.1.0,M4.1.0",
                                 "EST5EDT,M3.2.0,M11.1.0",
                                 "AAA3BBB,J60/0,J300/2:30:15",
                                 "AAA-3BBB-5:15,59/0,300",
                                 "UTC0"};
    for (const char* const text : RULES) {
        const auto rule = FooterRule::read(text);
        ASSERT_TRUE(rule) << text;
        const CLibraryClock c_library(text);
        for (sys_seconds moment = sys_days(2039y / 12 / 25); moment < sys_days(2042y / 1 / 5);
             moment += 15min) {
            const std::tm shown = c_library.at(moment);
            const ClockPeriod period = rule->periodAt(moment);
            ASSERT_EQ(period.offset.count(), shown.tm_gmtoff)
                << text << " " << moment.time_since_epoch().count();
            ASSERT_EQ(period.abbreviation, shown.tm_zone) << text;
            ASSERT_LE(period.begin, moment) << text;
            ASSERT_GT(period.end, moment) << text;
        }
    }
}

TEST(FooterRule, IsNotMadeOfTextThatIsNone) {
    for (const char* const text :
         {"", "C", "CET", "CET-", "CET-1CEST", "CET-1CEST,", "CET-1CEST,M3.5.0",
          "CET-1CEST,M13.5.0,M1.1.1", "CET-1CEST,M3.6.0,M10.5.0", "CET-1CEST,M3.5.7,M10.5.0",
          "CET-1CEST,M3.5.0,M10.5.0/168", "CET-1CEST,J0,J1", "CET-1CEST,366,1", "<CET-1",
          "CET-1CEST,M3.5.0,M10.5.0/3x", "CET-1:60"})
        EXPECT_FALSE(FooterRule::read(text)) << text;
}

class ZoneFiles : public testing::Test {
protected:
    void SetUp() override {
        std::ifstream stream(ZONE_FOLDER / "Europe/Berlin", std::ios::binary);
        m_berlin.assign(std::istreambuf_iterator<char>(stream), {});
        ASSERT_GT(m_berlin.size(), 100U);
    }
    void TearDown() override { std::filesystem::remove(m_file); }

    Result<ZoneFileEnd> readCopy(const std::string& bytes) {
        std::ofstream(m_file, std::ios::binary) << bytes;
        return readZoneFileEnd(m_file);
    }

    std::string m_berlin;
    std::filesystem::path m_file =
        std::filesystem::path(testing::TempDir()) / "quarn_zone_file_test";
};

TEST_F(ZoneFiles, EndWithTheRuleOfLaterTimes) {
    const auto end = readCopy(m_berlin);
    ASSERT_TRUE(end.ok()) << end.message();
    EXPECT_EQ(end.value().rule, "CET-1CEST,M3.5.0,M10.5.0/3");
    // No change of the clocks is listed that the rule would not give: the last came after 1995.
    EXPECT_GT(end.value().last_change, sys_days(1995y / 1 / 1));
}

TEST_F(ZoneFiles, ThatAreCutOffOrOverwrittenAreRefusedOrRead) {
    for (std::size_t size = 0; size + 1 < m_berlin.size(); size += 3) {
        const auto end = readCopy(m_berlin.substr(0, size));
        ASSERT_FALSE(end.ok()) << size;
        EXPECT_NE(end.message().find("tzdata"), std::string::npos);
    }
    for (std::size_t at = 0; at < m_berlin.size(); at += 5) {
        std::string damaged = m_berlin;
        damaged[at] = '\xff';
        (void)readCopy(damaged); // whatever it is: the sanitizers see a step too far
    }
    EXPECT_FALSE(readCopy("TZif1" + m_berlin.substr(5)).ok());
}

} // namespace
