#pragma once

#include "tests/zoetrix/DialogEntries.h"
#include "tests/zoetrix/PlugInFixture.h"

#include <string>
#include <vector>

/// The answers to the questions of SetOneDaySunAnimation, in their order.
struct DayAnswers {
    std::wstring latitude = L"51.5";
    std::wstring longitude = L"-0.12";
    std::wstring north_angle = L"0";
    std::wstring day = L"21";
    std::wstring month = L"6";
    std::wstring year = L"2026";
    std::wstring start_hour = L"6";
    std::wstring start_minute = L"0";
    std::wstring end_hour = L"18";
    std::wstring end_minute = L"0";
    std::wstring minutes = L"60";
};

/// The answers to the questions of SetSeasonalSunAnimation, in their order.
struct SeasonAnswers {
    std::wstring latitude = L"51.5";
    std::wstring longitude = L"0.12";
    std::wstring north_angle = L"0";
    std::wstring start_day = L"21";
    std::wstring start_month = L"3";
    std::wstring start_year = L"2026";
    std::wstring end_day = L"21";
    std::wstring end_month = L"12";
    std::wstring end_year = L"2026";
    std::wstring hour = L"14";
    std::wstring minute = L"30";
    std::wstring days = L"7";
};

/// A date and a local time.
struct Moment {
    int year;
    int month;
    int day;
    int hour = 0;
    int minute = 0;
};

/// A running host with the plug-in, whose sun studies are answered at the command line or in the
/// test's dialogs.
class SunFixture : public PlugInFixture {
protected:
    explicit SunFixture(const std::string& plug_ins = "dialogs");

    void SetUp() override;

    /// Runs the command in a script with these answers and Enter to the questions for output.
    CQuarnCommand::result setUp(const DayAnswers& answers);
    CQuarnCommand::result setUp(const SeasonAnswers& answers);
    /// Runs the command at a command line, where a person gives the first answers of so many and
    /// then another one.
    CQuarnCommand::result askedFor(const DayAnswers& answers, std::size_t given,
                                   std::initializer_list<std::wstring_view> then);
    CQuarnCommand::result askedFor(const SeasonAnswers& answers, std::size_t given,
                                   std::initializer_list<std::wstring_view> then);
    /// Runs the command as a person does who enters this into its dialog.
    CQuarnCommand::result dayInDialog(const Entered& entered);
    CQuarnCommand::result seasonInDialog(const Entered& entered);

    /// Texts of the record's frames, in their order.
    std::vector<std::wstring> dates();
    /// That the record holds a frame for each of these moments and no other: its text, the sun
    /// there as it is computed here for each by itself, and a target at the origin.
    void expectFrames(const std::vector<Moment>& moments, double north_angle, double latitude,
                      double longitude);
    /// That the record holds a study of this kind without any frame.
    void expectNoFrames(KM_3dmAnimationProperties::CaptureTypes type);
    /// That the record still is as SetUp left it.
    void expectRecordUntouched();

private:
    CQuarnCommand::result asked(const wchar_t* command, std::vector<std::wstring> answers,
                                std::size_t given, std::initializer_list<std::wstring_view> then);
    std::string bytesOfRecord();

    std::string m_untouched; ///< the record as bytes
};

/// `2026-06-21 14:30:00`.
std::wstring textOf(const Moment& moment);

/// The date so many days after another, by the rule of the Gregorian calendar.
Moment daysAfter(Moment moment, int days);
