#include "tests/vexui/VexUiFixture.h"

using testing::HasSubstr;

namespace {

class CameraForms : public VexUiFixture {
protected:
    /// Opens both forms with the same person.
    void openBoth(const Person& person) {
        openTurntable(person);
        openPath(person);
    }
};

} // namespace

TEST_F(CameraForms, TheTurntableShowsTheListsAndTheRecord) {
    EXPECT_FALSE(openTurntable([](QDialog& form) {
        EXPECT_EQ("Turntable Animation", form.windowTitle().toStdString());
        EXPECT_EQ("36", textIn(form, "frames"));
        EXPECT_EQ("AntiClockwise", textIn(form, "direction"));
        EXPECT_EQ("png", textIn(form, "fileType"));
        EXPECT_EQ("Rendered", textIn(form, "captureMethod"));
        EXPECT_EQ("Perspective", textIn(form, "viewport"));
        EXPECT_EQ("Walk", textIn(form, "name"));
        EXPECT_EQ("36 frames; the camera turns by about 10° from each to the next.", lineOf(form));
        EXPECT_EQ("Which way the model seems to turn, seen from above",
                  field<QWidget>(form, "direction").toolTip().toStdString());
        form.reject();
    }));
}

TEST_F(CameraForms, TheTurnFromFrameToFrameHasNoMoreDigitsThanAllOfThemShare) {
    EXPECT_FALSE(openTurntable([](QDialog& form) {
        for (const auto& [count, degrees] : {std::pair("7", "51"), std::pair("100", "3.6"),
                                             std::pair("1000", "0.36"), std::pair("2", "180")}) {
            typeInto(form, "frames", count);
            EXPECT_NE(lineOf(form).find(std::string("by about ") + degrees + "°"),
                      std::string::npos)
                << lineOf(form);
        }
        form.reject();
    }));
}

TEST_F(CameraForms, ThePathHasNoDirection) {
    EXPECT_FALSE(openPath([](QDialog& form) {
        EXPECT_EQ("Path Animation", form.windowTitle().toStdString());
        EXPECT_EQ(nullptr, form.findChild<QWidget*>("direction"));
        EXPECT_EQ("36 frames along the path.", lineOf(form));
        form.reject();
    }));
}

TEST_F(CameraForms, WhatIsEnteredComesBack) {
    const Person person = [](QDialog& form) {
        typeInto(form, "frames", "12");
        choose(form, "fileType", 1);
        choose(form, "captureMethod", 2);
        choose(form, "viewport", 0);
        typeInto(form, "name", "Straße 3");
        press(form, Qt::Key_Return);
    };
    EXPECT_TRUE(openPath(person));
    EXPECT_EQ(12, record.FrameCount());
    EXPECT_EQ(L"Straße 3", record.HtmlFilename().View());
    EXPECT_EQ(1, lists.files.selection);
    EXPECT_EQ(2, lists.captures.selection);
    EXPECT_EQ(0, lists.viewports.selection);
    EXPECT_EQ(1, lists.directions.selection);

    EXPECT_TRUE(openTurntable([&](QDialog& form) {
        choose(form, "direction", 0);
        person(form);
    }));
    EXPECT_EQ(0, lists.directions.selection);
}

TEST_F(CameraForms, NothingElseOfTheRecordChanges) {
    record.SetFileExtension(L"gif");
    record.SetViewportName(L"Nowhere");
    record.SetCaptureMethod(L"Nothing");
    record.SetLatitude(12.0);
    record.SetStartYear(1999);
    record.SetCurrentFrame(7);
    record.CameraPoints().Append({1.0, 2.0, 3.0});
    EXPECT_TRUE(openTurntable([](QDialog& form) { click(form, "ok"); }));
    EXPECT_EQ(L"gif", record.FileExtension().View());
    EXPECT_EQ(L"Nowhere", record.ViewportName().View());
    EXPECT_EQ(L"Nothing", record.CaptureMethod().View());
    EXPECT_EQ(KM_3dmAnimationProperties::none, record.CaptureType());
    EXPECT_EQ(12.0, record.Latitude());
    EXPECT_EQ(1999, record.StartYear());
    EXPECT_EQ(7, record.CurrentFrame());
    EXPECT_EQ(1, record.CameraPoints().Count());
}

TEST_F(CameraForms, FrameCountsBelowOneAreRefusedWhileTheyAreTyped) {
    openBoth([](QDialog& form) {
        for (const char* count : {"0", "-5"}) {
            typeInto(form, "frames", count);
            EXPECT_TRUE(isMarked(form, "frames")) << count;
            EXPECT_EQ("An animation has at least 1 frame.", lineOf(form));
            press(form, Qt::Key_Return);
            EXPECT_TRUE(form.isVisible()) << count;
        }
        typeInto(form, "frames", "1");
        EXPECT_FALSE(isMarked(form, "frames"));
        press(form, Qt::Key_Return);
    });
    EXPECT_EQ(1, record.FrameCount());
}

TEST_F(CameraForms, AnEmptyFrameCountIsNotTheOneBefore) {
    openBoth([](QDialog& form) {
        typeInto(form, "frames", "");
        EXPECT_TRUE(isMarked(form, "frames"));
        EXPECT_EQ("Enter the number of frames.", lineOf(form));
        press(field<QSpinBox>(form, "frames"), Qt::Key_Return);
        EXPECT_TRUE(form.isVisible());
        EXPECT_EQ("", textIn(form, "frames"));
        press(form, Qt::Key_Escape);
    });
    EXPECT_EQ(36, record.FrameCount());
}

TEST_F(CameraForms, StoredFrameCountsOutsideWhatIsPossibleAreShownAsTheNearest) {
    for (const auto& [count, shown] :
         {std::pair(0, "1"), std::pair(-2147483647 - 1, "1"), std::pair(2147483647, "1000000")}) {
        record.SetFrameCount(count);
        openBoth([&](QDialog& form) {
            EXPECT_EQ(shown, textIn(form, "frames")) << count;
            EXPECT_FALSE(isMarked(form, "frames"));
            form.reject();
        });
        EXPECT_EQ(count, record.FrameCount()) << "the form was not confirmed";
    }
}

TEST_F(CameraForms, TheArrowsStopAtOneFrame) {
    record.SetFrameCount(2);
    EXPECT_TRUE(openTurntable([](QDialog& form) {
        QSpinBox& frames = field<QSpinBox>(form, "frames");
        for (int i = 0; i < 5; ++i)
            press(frames, Qt::Key_Down);
        EXPECT_EQ("1", textIn(form, "frames"));
        EXPECT_EQ("1 frame: the view as it is.", lineOf(form));
        press(frames, Qt::Key_Up);
        press(frames, Qt::Key_PageDown);
        press(frames, Qt::Key_Return);
    }));
    EXPECT_EQ(1, record.FrameCount());
}

TEST_F(CameraForms, VeryManyFramesAreTakenWithAWarning) {
    EXPECT_TRUE(openPath([](QDialog& form) {
        typeInto(form, "frames", "100000");
        EXPECT_THAT(lineOf(form), HasSubstr("along the path"));
        typeInto(form, "frames", "100001");
        EXPECT_THAT(lineOf(form), HasSubstr("very many"));
        click(form, "ok");
    }));
    EXPECT_EQ(100001, record.FrameCount());
}

TEST_F(CameraForms, NamesThatTheCommandRepairsAreLetThroughWithAWarning) {
    for (const char* name : {"a\\b", "a|b", "a/b", "a:b", "a*b", "a?b", "a\"b", "a<b", "a>b"}) {
        openBoth([&](QDialog& form) {
            typeInto(form, "name", name);
            EXPECT_FALSE(isMarked(form, "name")) << name;
            EXPECT_THAT(lineOf(form), HasSubstr("will replace")) << name;
            click(form, "ok");
        });
        EXPECT_EQ(name, record.HtmlFilename().ToUtf8());
    }
}

TEST_F(CameraForms, NamesThatNobodyRepairsAreRefused) {
    const auto refused = [&](const KM_wString& name, const char* why) {
        record.SetHtmlFilename(name);
        openBoth([&](QDialog& form) {
            EXPECT_TRUE(isMarked(form, "name"));
            EXPECT_THAT(lineOf(form), HasSubstr(why));
            click(form, "ok");
            EXPECT_TRUE(form.isVisible());
            EXPECT_TRUE(field<QLineEdit>(form, "name").hasFocus());
            click(form, "cancel");
        });
        EXPECT_EQ(name, record.HtmlFilename());
    };
    refused(L"", "Enter a name.");
    refused(L"   ", "Enter a name.");
    refused(std::wstring(256, L'x').c_str(), "256 characters; 255 are the most");
    refused(std::wstring(100'000, L'漢').c_str(), "100000 characters");
    refused(L"two\nlines", "line break");
    refused(L"tab\tbed", "invisible");
    refused(L"para\u2029graph", "line break");
}

TEST_F(CameraForms, TheLongestNamePossibleIsTaken) {
    const std::wstring longest(255, L'x');
    record.SetHtmlFilename(longest.c_str());
    EXPECT_TRUE(openPath([](QDialog& form) {
        EXPECT_FALSE(isMarked(form, "name"));
        click(form, "ok");
    }));
    EXPECT_EQ(longest, record.HtmlFilename().View());
}

TEST_F(CameraForms, SelectionsOutsideTheirListsShowTheFirstEntry) {
    for (const int selection : {-1, 4, 2147483647, -2147483647 - 1}) {
        lists.files.selection = lists.captures.selection = selection;
        lists.viewports.selection = lists.directions.selection = selection;
        EXPECT_FALSE(openTurntable([](QDialog& form) {
            EXPECT_EQ("jpg", textIn(form, "fileType"));
            EXPECT_EQ("RenderFull", textIn(form, "captureMethod"));
            EXPECT_EQ("Top", textIn(form, "viewport"));
            EXPECT_EQ("Clockwise", textIn(form, "direction"));
            form.reject();
        }));
        EXPECT_EQ(selection, lists.files.selection);
        EXPECT_TRUE(openTurntable([](QDialog& form) { form.accept(); }));
        EXPECT_EQ(0, lists.files.selection);
        EXPECT_EQ(0, lists.captures.selection);
        EXPECT_EQ(0, lists.viewports.selection);
        EXPECT_EQ(0, lists.directions.selection);
    }
}

TEST_F(CameraForms, FirstTimeInADocumentOffersTheActiveViewAsItIsDrawn) {
    lists.viewports.selection = 0;
    lists.captures = listOf({L"RenderFull", L"RenderPreview", L"Wireframe", L"Shaded", L"Rendered",
                             L"Translucent", L"X-Ray", L"Drawing", L"Clay"},
                            2);
    EXPECT_TRUE(openTurntable([](QDialog& form) {
        EXPECT_EQ("Perspective", textIn(form, "viewport"));
        EXPECT_EQ("Shaded", textIn(form, "captureMethod")) << "as a new Perspective is drawn";
        form.accept();
    }));
    EXPECT_EQ(3, lists.viewports.selection);
    EXPECT_EQ(3, lists.captures.selection);

    record.SetViewportName(L"Top");
    lists.viewports.selection = 0;
    lists.captures.selection = 2;
    EXPECT_FALSE(openTurntable([](QDialog& form) {
        EXPECT_EQ("Top", textIn(form, "viewport"));
        EXPECT_EQ("Wireframe", textIn(form, "captureMethod"));
        form.reject();
    }));
}

TEST_F(CameraForms, EmptyListsAreShownDisabledAndKeepTheirSelection) {
    lists.files = lists.captures = lists.viewports = lists.directions = listOf({}, 5);
    EXPECT_TRUE(openTurntable([](QDialog& form) {
        for (const char* name : {"fileType", "captureMethod", "viewport", "direction"})
            EXPECT_FALSE(field<QComboBox>(form, name).isEnabled()) << name;
        form.accept();
    }));
    EXPECT_EQ(5, lists.files.selection);
    EXPECT_EQ(5, lists.captures.selection);
    EXPECT_EQ(5, lists.viewports.selection);
    EXPECT_EQ(5, lists.directions.selection);
}

TEST_F(CameraForms, HostileEntriesNeitherWidenTheFormNorBecomeMarkup) {
    int usual_width = 0;
    EXPECT_FALSE(openTurntable([&](QDialog& form) {
        usual_width = form.width();
        form.reject();
    }));
    lists.viewports = listOf({L"<h1>&Big</h1>", std::wstring(5000, L'W').c_str()});
    EXPECT_TRUE(openTurntable([&](QDialog& form) {
        EXPECT_EQ(usual_width, form.width());
        EXPECT_EQ("<h1>&Big</h1>", textIn(form, "viewport"));
        choose(form, "viewport", 1);
        form.accept();
    }));
    EXPECT_EQ(1, lists.viewports.selection);
}
