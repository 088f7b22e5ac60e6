#include "tests/zoetrix/SunFixture.h"

#include "kelmar/KM_BinaryArchive.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <cstdio>

namespace {

using Words = std::vector<std::wstring>;

constexpr const wchar_t* day_command = L"SetOneDaySunAnimation";
constexpr const wchar_t* season_command = L"SetSeasonalSunAnimation";

Words wordsOf(const DayAnswers& a) {
    return {a.latitude,   a.longitude,    a.north_angle, a.day,        a.month,  a.year,
            a.start_hour, a.start_minute, a.end_hour,    a.end_minute, a.minutes};
}

Words wordsOf(const SeasonAnswers& a) {
    return {a.latitude, a.longitude, a.north_angle, a.start_day, a.start_month, a.start_year,
            a.end_day,  a.end_month, a.end_year,    a.hour,      a.minute,      a.days};
}

KM_wString lineWith(const wchar_t* command, const Words& answers) {
    KM_wString line = command;
    for (const std::wstring& answer : answers)
        line += L" " + KM_wString(answer.c_str());
    return line + L" _Enter _Enter _Enter _Enter";
}

int daysOf(int month, int year) {
    if (month == 2)
        return year % 4 == 0 && (year % 100 != 0 || year % 400 == 0) ? 29 : 28;
    return month == 4 || month == 6 || month == 9 || month == 11 ? 30 : 31;
}

} // namespace

SunFixture::SunFixture(const std::string& plug_ins) : PlugInFixture(plug_ins) {}

void SunFixture::SetUp() {
    KM_3dmAnimationProperties& props = record();
    props.SetHtmlFilename(L"Sun");
    props.SetFolderName(wide(folder.path() / "frames"));
    props.SetLatitude(40.0);
    props.SetLongitude(10.0);
    props.SetNorthAngle(5.0);
    props.SetEndDay(3);
    props.SetEndMonth(4);
    props.SetEndYear(2015);
    props.Dates().Append(L"before");
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 64 48"));
    front_end.clearPrinted();
    m_untouched = bytesOfRecord();
}

CQuarnCommand::result SunFixture::setUp(const DayAnswers& answers) {
    return run(lineWith(day_command, wordsOf(answers)));
}

CQuarnCommand::result SunFixture::setUp(const SeasonAnswers& answers) {
    return run(lineWith(season_command, wordsOf(answers)));
}

CQuarnCommand::result SunFixture::askedFor(const DayAnswers& answers, std::size_t given,
                                           std::initializer_list<std::wstring_view> then) {
    return asked(day_command, wordsOf(answers), given, then);
}

CQuarnCommand::result SunFixture::askedFor(const SeasonAnswers& answers, std::size_t given,
                                           std::initializer_list<std::wstring_view> then) {
    return asked(season_command, wordsOf(answers), given, then);
}

CQuarnCommand::result SunFixture::asked(const wchar_t* command, Words answers, std::size_t given,
                                        std::initializer_list<std::wstring_view> then) {
    for (std::size_t k = 0; k < given; ++k)
        answer({answers.at(k)});
    answer(then);
    return run(command);
}

CQuarnCommand::result SunFixture::dayInDialog(const Entered& entered) {
    enterIntoDialog(entered);
    return session->runCommand(day_command, true);
}

CQuarnCommand::result SunFixture::seasonInDialog(const Entered& entered) {
    enterIntoDialog(entered);
    return session->runCommand(season_command, true);
}

std::vector<std::wstring> SunFixture::dates() {
    std::vector<std::wstring> texts;
    for (const KM_wString& date : record().Dates())
        texts.emplace_back(date.View());
    return texts;
}

void SunFixture::expectFrames(const std::vector<Moment>& moments, double north_angle,
                              double latitude, double longitude) {
    const int count = static_cast<int>(moments.size());
    ASSERT_EQ(count, record().FrameCount());
    ASSERT_EQ(count, record().Dates().Count());
    ASSERT_EQ(count, record().CameraPoints().Count());
    ASSERT_EQ(count, record().TargetPoints().Count());
    for (int k = 0; k < count; ++k) {
        const Moment& at = moments[static_cast<std::size_t>(k)];
        EXPECT_EQ(textOf(at), record().Dates()[k].View());
        EXPECT_EQ(CZoetrixUtilities::GetSunPoint(at.hour, at.minute, at.year, at.month, at.day,
                                                 north_angle, latitude, longitude),
                  record().CameraPoints()[k])
            << KM_wString(textOf(at).c_str()).ToUtf8();
        EXPECT_NEAR((record().CameraPoints()[k] - KM_3dPoint::Origin).Length(), 1.0, 1e-15);
        EXPECT_EQ(KM_3dPoint::Origin, record().TargetPoints()[k]);
    }
}

void SunFixture::expectNoFrames(KM_3dmAnimationProperties::CaptureTypes type) {
    EXPECT_EQ(type, record().CaptureType());
    EXPECT_EQ(0, record().CurrentFrame());
    expectFrames({}, 0.0, 0.0, 0.0);
}

void SunFixture::expectRecordUntouched() {
    EXPECT_TRUE(m_untouched == bytesOfRecord());
}

std::string SunFixture::bytesOfRecord() {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    EXPECT_TRUE(record().Write(archive));
    const auto bytes = archive.TakeBytes();
    return {bytes.begin(), bytes.end()};
}

std::wstring textOf(const Moment& moment) {
    char text[64];
    std::snprintf(text, sizeof text, "%04d-%02d-%02d %02d:%02d:00", moment.year, moment.month,
                  moment.day, moment.hour, moment.minute);
    const std::string narrow = text;
    return {narrow.begin(), narrow.end()};
}

Moment daysAfter(Moment moment, int days) {
    moment.day += days;
    while (moment.day > daysOf(moment.month, moment.year)) {
        moment.day -= daysOf(moment.month, moment.year);
        if (++moment.month > 12) {
            moment.month = 1;
            ++moment.year;
        }
    }
    return moment;
}
