#include "tests/vexui/VexUiFixture.h"

#include <cmath>
#include <limits>

using testing::HasSubstr;

namespace {

class SunForms : public VexUiFixture {
protected:
    SunForms() {
        record.SetHtmlFilename(L"Sun");
        record.SetLatitude(51.5);
        record.SetLongitude(-0.12);
        record.SetNorthAngle(12.5);
        setStart(2026, 6, 21, 6, 0, 0);
        setEnd(2026, 12, 21, 18, 0, 59);
        record.SetMinutesBetweenFrames(60);
        record.SetDaysBetweenFrames(30);
    }
    void setStart(int year, int month, int day, int hour, int minute, int second) {
        record.SetStartYear(year);
        record.SetStartMonth(month);
        record.SetStartDay(day);
        record.SetStartHour(hour);
        record.SetStartMinutes(minute);
        record.SetStartSeconds(second);
    }
    void setEnd(int year, int month, int day, int hour, int minute, int second) {
        record.SetEndYear(year);
        record.SetEndMonth(month);
        record.SetEndDay(day);
        record.SetEndHour(hour);
        record.SetEndMinutes(minute);
        record.SetEndSeconds(second);
    }
    COleDateTime start() const {
        return {record.StartYear(), record.StartMonth(),   record.StartDay(),
                record.StartHour(), record.StartMinutes(), record.StartSeconds()};
    }
    COleDateTime end() const {
        return {record.EndYear(), record.EndMonth(),   record.EndDay(),
                record.EndHour(), record.EndMinutes(), record.EndSeconds()};
    }
    /// Opens both forms with the same person.
    void openBoth(const Person& person) {
        openDay(person);
        openSeason(person);
    }
};

} // namespace

TEST_F(SunForms, TheDayShowsTheListsAndTheRecord) {
    EXPECT_FALSE(openDay([](QDialog& form) {
        EXPECT_EQ("One-Day Sun Study", form.windowTitle().toStdString());
        EXPECT_EQ("51.5", textIn(form, "latitude"));
        EXPECT_EQ("-0.12", textIn(form, "longitude"));
        EXPECT_EQ("12.5", textIn(form, "northAngle"));
        EXPECT_EQ("2026-06-21", textIn(form, "date"));
        EXPECT_EQ("06:00", textIn(form, "startTime"));
        EXPECT_EQ("18:00", textIn(form, "endTime"));
        EXPECT_EQ("60", textIn(form, "minutes"));
        EXPECT_EQ("png", textIn(form, "fileType"));
        EXPECT_EQ("Rendered", textIn(form, "captureMethod"));
        EXPECT_EQ("Perspective", textIn(form, "viewport"));
        EXPECT_EQ("Sun", textIn(form, "name"));
        EXPECT_EQ("13 frames, the first at 06:00, the last at 18:00.", lineOf(form));
        form.reject();
    }));
}

TEST_F(SunForms, TheSeasonShowsTheListsAndTheRecord) {
    EXPECT_FALSE(openSeason([](QDialog& form) {
        EXPECT_EQ("Seasonal Sun Study", form.windowTitle().toStdString());
        EXPECT_EQ("2026-06-21", textIn(form, "startDate"));
        EXPECT_EQ("2026-12-21", textIn(form, "endDate"));
        EXPECT_EQ("06:00", textIn(form, "timeOfDay"));
        EXPECT_EQ("30", textIn(form, "days"));
        // 183 days lie between the solstices: six steps of 30.
        EXPECT_EQ("7 frames, the first on 2026-06-21, the last on 2026-12-18.", lineOf(form));
        form.reject();
    }));
}

TEST_F(SunForms, WhatIsEnteredForADayComesBack) {
    EXPECT_TRUE(openDay([](QDialog& form) {
        typeInto(form, "latitude", "-33.86");
        typeInto(form, "longitude", "151.21");
        typeInto(form, "northAngle", "-90");
        field<QDateEdit>(form, "date").setDate({2024, 2, 29});
        field<QTimeEdit>(form, "startTime").setTime({7, 15});
        field<QTimeEdit>(form, "endTime").setTime({19, 45});
        typeInto(form, "minutes", "15");
        choose(form, "fileType", 3);
        choose(form, "captureMethod", 0);
        choose(form, "viewport", 1);
        typeInto(form, "name", "Shadow");
        click(form, "ok");
    }));
    EXPECT_EQ(-33.86, record.Latitude());
    EXPECT_EQ(151.21, record.Longitude());
    EXPECT_EQ(-90.0, record.NorthAngle());
    EXPECT_EQ(COleDateTime(2024, 2, 29, 7, 15, 0), start());
    EXPECT_EQ(COleDateTime(2024, 2, 29, 19, 45, 0), end());
    EXPECT_EQ(15, record.MinutesBetweenFrames());
    EXPECT_EQ(30, record.DaysBetweenFrames());
    EXPECT_EQ(L"Shadow", record.HtmlFilename().View());
    EXPECT_EQ(3, lists.files.selection);
    EXPECT_EQ(0, lists.captures.selection);
    EXPECT_EQ(1, lists.viewports.selection);
    EXPECT_EQ(36, record.FrameCount());
}

TEST_F(SunForms, WhatIsEnteredForASeasonComesBack) {
    EXPECT_TRUE(openSeason([](QDialog& form) {
        typeInto(form, "latitude", "90");
        typeInto(form, "longitude", "-180");
        typeInto(form, "northAngle", "360");
        field<QDateEdit>(form, "startDate").setDate({2026, 3, 21});
        field<QDateEdit>(form, "endDate").setDate({2027, 3, 21});
        field<QTimeEdit>(form, "timeOfDay").setTime({14, 30});
        typeInto(form, "days", "7");
        click(form, "ok");
    }));
    EXPECT_EQ(90.0, record.Latitude());
    EXPECT_EQ(-180.0, record.Longitude());
    EXPECT_EQ(360.0, record.NorthAngle());
    EXPECT_EQ(COleDateTime(2026, 3, 21, 14, 30, 0), start());
    EXPECT_EQ(COleDateTime(2027, 3, 21, 14, 30, 0), end());
    EXPECT_EQ(7, record.DaysBetweenFrames());
    EXPECT_EQ(60, record.MinutesBetweenFrames());
}

TEST_F(SunForms, DatesAndTimesCanBeTyped) {
    EXPECT_TRUE(openDay([](QDialog& form) {
        QDateEdit& date = field<QDateEdit>(form, "date");
        date.setFocus(Qt::TabFocusReason);
        QTest::keyClicks(&date, "20250228");
        QTimeEdit& time = field<QTimeEdit>(form, "startTime");
        time.setFocus(Qt::TabFocusReason);
        QTest::keyClicks(&time, "0905");
        press(time, Qt::Key_Return);
    }));
    EXPECT_EQ(COleDateTime(2025, 2, 28, 9, 5, 0), start());
}

TEST_F(SunForms, PlacesOutsideTheEarthAreRefused) {
    const auto refused = [&](const char* name, const char* text, const char* why) {
        openBoth([&](QDialog& form) {
            typeInto(form, name, text);
            EXPECT_TRUE(isMarked(form, name)) << text;
            EXPECT_THAT(lineOf(form), HasSubstr(why));
            click(form, "ok");
            EXPECT_TRUE(form.isVisible()) << text;
            EXPECT_TRUE(field<QLineEdit>(form, name).hasFocus()) << text;
            press(form, Qt::Key_Escape);
        });
    };
    for (const char* text :
         {"90.5", "-90.0001", "", "north", "1e1", "1,234.5", "nan", "inf", "--1"})
        refused("latitude", text, "Enter a latitude from -90 to 90 degrees.");
    for (const char* text : {"180.5", "-181", "+"})
        refused("longitude", text, "Enter a longitude from -180 to 180 degrees.");
    for (const char* text : {"360.1", "-361"})
        refused("northAngle", text, "Enter a north angle from -360 to 360 degrees.");
    EXPECT_EQ(51.5, record.Latitude());
}

TEST_F(SunForms, NumbersAreTakenWithPointAndComma) {
    const auto taken = [&](const char* text, double latitude) {
        openBoth([&](QDialog& form) {
            typeInto(form, "latitude", text);
            EXPECT_FALSE(isMarked(form, "latitude")) << text;
            click(form, "ok");
        });
        EXPECT_EQ(latitude, record.Latitude()) << text;
    };
    taken("48.25", 48.25);
    taken("48,25", 48.25);
    taken(" +48. ", 48.0);
    taken("-.5", -0.5);
    taken("\u221233,5", -33.5);
    taken("\uff13\uff15\uff0e\uff15", 35.5);
    taken("-90", -90.0);
    taken("90", 90.0);
}

TEST_F(SunForms, NumbersAreShownWithTheUsersDecimalSign) {
    const QLocale before;
    QLocale::setDefault(QLocale(QLocale::German, QLocale::Germany));
    record.SetLatitude(12.25);
    openBoth([](QDialog& form) {
        EXPECT_EQ("12,25", textIn(form, "latitude"));
        click(form, "ok");
    });
    QLocale::setDefault(before);
    EXPECT_EQ(12.25, record.Latitude());
}

TEST_F(SunForms, NumbersThatNobodyTouchedComeBackToTheLastBit) {
    record.SetLatitude(1.0 / 3.0);
    record.SetNorthAngle(-0.1 - 0.2);
    openBoth([](QDialog& form) { click(form, "ok"); });
    EXPECT_EQ(1.0 / 3.0, record.Latitude());
    EXPECT_EQ(-0.1 - 0.2, record.NorthAngle());
}

TEST_F(SunForms, LongitudesCountedTo360AreShownAndTakenFromMinus180) {
    const auto shown = [&](double longitude, const char* text, double taken) {
        record.SetLongitude(longitude);
        openBoth([&](QDialog& form) {
            EXPECT_EQ(text, textIn(form, "longitude"));
            click(form, "ok");
        });
        EXPECT_EQ(taken, record.Longitude());
    };
    shown(294.5, "-65.5", -65.5);
    shown(360.0, "0", 0.0);
    shown(-190.0, "170", 170.0);
    shown(180.0, "180", 180.0);
    shown(-180.0, "-180", -180.0);
}

TEST_F(SunForms, TheZoneIsToldThatTheSunIsReckonedBy) {
    const auto told = [&](const char* longitude, const char* zone) {
        openBoth([&](QDialog& form) {
            typeInto(form, "longitude", longitude);
            EXPECT_EQ(zone, textIn(form, "zone"));
            form.reject();
        });
    };
    told("14.9", "Times are those of UTC, without daylight saving.");
    told("15", "Times are those of UTC+1, without daylight saving.");
    told("-65.43", "Times are those of UTC-4, without daylight saving.");
    told("180", "Times are those of UTC+12, without daylight saving.");
    told("999", "");
}

TEST_F(SunForms, WhatNoPlaceOrCalendarKnowsIsShownAsTheNearestThatIs) {
    record.SetLatitude(std::nan(""));
    record.SetLongitude(std::numeric_limits<double>::infinity());
    record.SetNorthAngle(-1e300);
    setStart(2026, 0, 0, 24, 60, 75);
    setEnd(-5, 13, 31, -1, -1, 99);
    record.SetMinutesBetweenFrames(-2147483647 - 1);
    record.SetDaysBetweenFrames(-7);
    EXPECT_FALSE(openDay([](QDialog& form) {
        EXPECT_EQ("0", textIn(form, "latitude"));
        EXPECT_EQ("0", textIn(form, "longitude"));
        EXPECT_EQ("-360", textIn(form, "northAngle"));
        EXPECT_EQ("2026-01-01", textIn(form, "date"));
        EXPECT_EQ("23:59", textIn(form, "startTime"));
        EXPECT_EQ("00:00", textIn(form, "endTime"));
        EXPECT_EQ("1440", textIn(form, "minutes"));
        for (const char* name : {"latitude", "longitude", "northAngle", "minutes", "name"})
            EXPECT_FALSE(isMarked(form, name)) << name;
        form.reject();
    }));
    setStart(2026, 4, 31, 12, 0, 0);
    EXPECT_TRUE(openSeason([](QDialog& form) {
        EXPECT_EQ("2026-04-30", textIn(form, "startDate"));
        EXPECT_EQ("0100-12-31", textIn(form, "endDate"));
        EXPECT_EQ("7", textIn(form, "days"));
        click(form, "ok");
    }));
    EXPECT_TRUE(start().IsValid());
    EXPECT_TRUE(end().IsValid());
}

TEST_F(SunForms, AnEndBeforeTheStartIsTakenWithAWarning) {
    const char* warning = "The end is before the start: there will be no frames.";
    EXPECT_TRUE(openDay([&](QDialog& form) {
        field<QTimeEdit>(form, "endTime").setTime({5, 59});
        EXPECT_EQ(warning, lineOf(form));
        click(form, "ok");
    }));
    EXPECT_EQ(5, record.EndHour());
    EXPECT_TRUE(openSeason([&](QDialog& form) {
        field<QDateEdit>(form, "endDate").setDate({2026, 6, 20});
        EXPECT_EQ(warning, lineOf(form));
        field<QDateEdit>(form, "endDate").setDate({2026, 6, 21});
        EXPECT_EQ("1 frame, on 2026-06-21.", lineOf(form));
        click(form, "ok");
    }));
}

TEST_F(SunForms, StepsBelowZeroAreRefusedAndNoneMakesOneFrame) {
    const auto check = [](const char* name, const char* fault) {
        return [=](QDialog& form) {
            typeInto(form, name, "-1");
            EXPECT_TRUE(isMarked(form, name));
            EXPECT_EQ(fault, lineOf(form));
            typeInto(form, name, "");
            EXPECT_EQ(fault, lineOf(form));
            typeInto(form, name, "0");
            EXPECT_FALSE(isMarked(form, name));
            EXPECT_EQ("Without time between frames there is one frame, the first.", lineOf(form));
            click(form, "ok");
        };
    };
    EXPECT_TRUE(openDay(check("minutes", "Enter how many minutes are between frames, 0 or more.")));
    EXPECT_EQ(0, record.MinutesBetweenFrames());
    EXPECT_TRUE(openSeason(check("days", "Enter how many days are between frames, 0 or more.")));
    EXPECT_EQ(0, record.DaysBetweenFrames());
}

TEST_F(SunForms, VeryManyFramesAreTakenWithAWarning) {
    setStart(1000, 1, 1, 12, 0, 0);
    setEnd(2000, 1, 1, 12, 0, 0);
    record.SetDaysBetweenFrames(1);
    EXPECT_TRUE(openSeason([](QDialog& form) {
        EXPECT_THAT(lineOf(form), HasSubstr("very many"));
        click(form, "ok");
    }));
}

TEST_F(SunForms, NamesThatNobodyRepairsHereAreRefused) {
    openBoth([](QDialog& form) {
        for (const char* name : {"a/b", "a\\b", "a:b", "a\"b", ""}) {
            typeInto(form, "name", name);
            EXPECT_TRUE(isMarked(form, "name")) << name;
            click(form, "ok");
            EXPECT_TRUE(form.isVisible());
        }
        typeInto(form, "name", "a_b");
        EXPECT_FALSE(isMarked(form, "name"));
        click(form, "ok");
    });
    EXPECT_EQ(L"a_b", record.HtmlFilename().View());
}

TEST_F(SunForms, ThePlaceIsChosenInTheHostsPicker) {
    front_end.addLocationChoice(quarn::Place{12.34567, -65.43211});
    EXPECT_TRUE(openDay([](QDialog& form) {
        typeInto(form, "latitude", "45.5");
        click(form, "choosePlace");
        EXPECT_EQ("12.3457", textIn(form, "latitude"));
        EXPECT_EQ("-65.4321", textIn(form, "longitude"));
        EXPECT_EQ("Times are those of UTC-4, without daylight saving.", textIn(form, "zone"));
        click(form, "ok");
    }));
    EXPECT_EQ(12.3457, record.Latitude());
    EXPECT_EQ(-65.4321, record.Longitude());
    ASSERT_EQ(1u, front_end.locationQuestions().size());
    EXPECT_EQ(L"Set Animation Location", front_end.locationQuestions()[0].title);
    EXPECT_EQ(45.5, front_end.locationQuestions()[0].start.latitude_deg);
    EXPECT_EQ(-0.12, front_end.locationQuestions()[0].start.longitude_deg);
}

TEST_F(SunForms, APickerThatIsClosedChangesNothing) {
    front_end.addLocationChoice(std::nullopt);
    EXPECT_TRUE(openSeason([](QDialog& form) {
        QPushButton& button = field<QPushButton>(form, "choosePlace");
        button.setFocus();
        press(button, Qt::Key_Space);
        EXPECT_EQ("51.5", textIn(form, "latitude"));
        EXPECT_EQ("-0.12", textIn(form, "longitude"));
        press(button, Qt::Key_Return);
    }));
    EXPECT_EQ(1u, front_end.locationQuestions().size()) << "Enter confirms the form";
}

namespace {

/// Athens, in a document that nobody has set a sun study up in.
class FirstSunForms : public VexUiFixture {
protected:
    FirstSunForms() {
        record = KM_3dmAnimationProperties();
        record.SetHtmlFilename(L"Sun");
        record.SetLatitude(37.98);
        record.SetLongitude(23.73);
    }
};

} // namespace

TEST_F(FirstSunForms, ADayGoesFromSunriseToSunsetAndTheClocksThereAreTold) {
    EXPECT_TRUE(openDay([](QDialog& form) {
        EXPECT_EQ(QDate::currentDate().year(), field<QDateEdit>(form, "date").date().year());
        EXPECT_EQ("Athens, Greece", textIn(form, "city"));
        EXPECT_EQ("Europe/Athens", textIn(form, "clocks"));
        typeInto(form, "minutes", "30");
        field<QDateEdit>(form, "date").setDate({2026, 6, 21});
        EXPECT_EQ("Longest day", field<QComboBox>(form, "namedDay").currentText().toStdString());
        // The sun rises at 06:03 and sets at 20:51 there, some minutes before and after its centre
        // is at the bare horizon.
        EXPECT_EQ("04:30", textIn(form, "startTime"));
        EXPECT_EQ("18:30", textIn(form, "endTime"));
        EXPECT_EQ("04:30 - 18:30 UTC+1 is 06:30 - 20:30 EEST by the clocks there.",
                  textIn(form, "localTimes"));
        click(form, "ok");
    }));
    EXPECT_EQ(4, record.StartHour());
    EXPECT_EQ(30, record.EndMinutes());
}

TEST_F(FirstSunForms, OfferedTimesFollowThePlaceUntilAPersonChoosesOne) {
    openDay([](QDialog& form) {
        field<QDateEdit>(form, "date").setDate({2026, 6, 21});
        typeInto(form, "latitude", "52.52");
        typeInto(form, "longitude", "13.40");
        // Berlin: 04:43 to 21:33 of UTC+2, and the study reckons in UTC.
        EXPECT_EQ("03:00", textIn(form, "startTime"));
        EXPECT_EQ("19:00", textIn(form, "endTime"));
        EXPECT_EQ("Europe/Berlin", textIn(form, "clocks"));
        field<QTimeEdit>(form, "startTime").setTime({9, 0});
        typeInto(form, "longitude", "-70");
        EXPECT_EQ("09:00", textIn(form, "startTime"));
        EXPECT_EQ("19:00", textIn(form, "endTime"));
        form.reject();
    });
}

TEST_F(FirstSunForms, ASeasonIsThisYearAtNoonByTheClocksThere) {
    const int year = QDate::currentDate().year();
    openSeason([&](QDialog& form) {
        EXPECT_EQ(QDate(year, 1, 1), field<QDateEdit>(form, "startDate").date());
        EXPECT_EQ(QDate(year, 12, 31), field<QDateEdit>(form, "endDate").date());
        EXPECT_EQ("11:00", textIn(form, "timeOfDay"));
        EXPECT_EQ("11:00 UTC+1 is 12:00 EET, 13:00 EEST by the clocks there.",
                  textIn(form, "localTimes"));
        form.reject();
    });
}

TEST_F(FirstSunForms, ClocksThatAPersonNamesAreKeptByTheDocument) {
    EXPECT_TRUE(openDay([](QDialog& form) {
        typeInto(form, "clocks", "Europe/Atlantis");
        EXPECT_TRUE(isMarked(form, "clocks"));
        click(form, "ok");
        EXPECT_TRUE(form.isVisible());
        typeInto(form, "clocks", "+05:30");
        EXPECT_FALSE(isMarked(form, "clocks"));
        click(form, "ok");
    }));
    session->document().Properties().SetAnimationProperties(record); // as the command does
    openSeason([](QDialog& form) {
        EXPECT_EQ("UTC+5:30", textIn(form, "clocks"));
        typeInto(form, "clocks", "");
        EXPECT_EQ("Europe/Athens",
                  field<QLineEdit>(form, "clocks").placeholderText().toStdString());
        EXPECT_FALSE(isMarked(form, "clocks"));
        form.reject();
    });
}

TEST_F(FirstSunForms, PolarNightOffersTheMiddleOfTheDay) {
    openDay([](QDialog& form) {
        field<QDateEdit>(form, "date").setDate({2026, 12, 21});
        typeInto(form, "latitude", "78.22");
        typeInto(form, "longitude", "15.65");
        EXPECT_EQ("09:00", textIn(form, "startTime"));
        EXPECT_EQ("15:00", textIn(form, "endTime"));
        form.reject();
    });
}

TEST_F(FirstSunForms, FitALowScreen) {
    for (const char* const language : {"C", "de", "es", "fr", "ja", "zh"}) {
        start(language);
        const auto fits = [&](QDialog& form) {
            EXPECT_LE(form.height(), 560) << language;
            EXPECT_LE(form.width(), 1000) << language;
            if (const QByteArray to = qgetenv("QUARN_FORM_PICTURES"); !to.isEmpty())
                form.grab().save(QString("%1/%2-%3.png").arg(to, form.objectName(), language));
            form.reject();
        };
        openDay(fits);
        openSeason(fits);
    }
}
