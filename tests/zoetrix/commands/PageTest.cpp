#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

namespace {

KM_3dmAnimationProperties turntableOfThree() {
    KM_3dmAnimationProperties props;
    props.SetCaptureType(KM_3dmAnimationProperties::turntable);
    props.SetHtmlFilename(L"Walk");
    for (const wchar_t* image : {L"Walk000.png", L"Walk001.png", L"Walk002.png"})
        props.Images().Append(image);
    return props;
}

std::wstring pageOf(KM_3dmAnimationProperties props) {
    return std::wstring(CZoetrixUtilities::GetHTMLtemplate(props).View());
}

class Page : public PlugInFixture {};
class GermanPage : public PlugInFixture {
protected:
    GermanPage() : PlugInFixture("", "de") {}
};

/// Everything before the script's functions, for three images of a turntable called Walk.
constexpr const wchar_t* expected_head =
    L"<HTML>\n <HEAD>\n  <TITLE>Walk</TITLE>\n </HEAD>\n <BODY onLoad=\"Load()\">\n"
    L" <FONT FACE=VERDANA SIZE=2><B>Walk</B><BR>\n"
    L"\t<IMG BORDER=1 STYLE=\"border-color:black\" ID=\"animated_image\"><BR>\n"
    L"<FONT FACE=COURIER SIZE=2>\n"
    L"<SPAN ID=\"frame_title\" STYLE=\"position:relative;left:0;top:-15;color:black;"
    L"background-color:white;padding:1px;border-width:1px;border-style:solid;"
    L"border-color:black;display:inline;\"></SPAN>\n"
    L"&nbsp;</FONT><BR>\n"
    L"  <BUTTON ID=\"btnToggle\" onClick=\"start_stop()\" onDblClick=\"start_stop()\">Stop"
    L"</BUTTON>&nbsp;\n"
    L"<BUTTON ID=\"btnFirst\" onClick=\"firstFrame()\" onDblClick=\"firstFrame()\" "
    L"STYLE=\"width:35\">&lt;&lt;</BUTTON>&nbsp;\n"
    L"  <BUTTON ID=\"btnPrev\" onClick=\"prevFrame()\" onDblClick=\"prevFrame()\" "
    L"STYLE=\"width:35\">&lt;</BUTTON>&nbsp;\n"
    L"  <BUTTON ID=\"btnNext\" onClick=\"nextFrame()\" onDblClick=\"nextFrame()\" "
    L"STYLE=\"width:35\">&gt;</BUTTON>&nbsp;\n"
    L"  <BUTTON ID=\"btnLast\" onClick=\"lastFrame()\" onDblClick=\"lastFrame()\" "
    L"STYLE=\"width:35\">&gt;&gt;</BUTTON>\n"
    L"  <FONT SIZE=1>\n"
    L"  <BR><BR>&nbsp;&nbsp;&nbsp;<INPUT ID=\"checkLoop\"\" TYPE=\"checkbox\" "
    L"style=\"width:13;height:13;\">Loop continuously\n"
    L"  <BR>&nbsp;&nbsp;&nbsp;<INPUT ID=\"checkCounter\" TYPE=\"checkbox\" CHECKED "
    L"onClick=\"showCounter(this.checked)\" style=\"width:13;height:13;\">Show frame counter\n"
    L"  </FONT>\n  <P>\n  <FONT COLOR=888888 SIZE=1>Animation created in "
    L"<A HREF=\"https://quarn.example/\" TARGET=_blank><FONT COLOR=7777ff SIZE=1>Quarn</FONT></A>"
    L".</FONT>\n </BODY>\n</HTML>\n\n"
    L"<STYLE>\n  button {width:75;height:25;font-family:mssansserif;font-size:8pt}\n</STYLE>\n"
    L"<SCRIPT LANGUAGE=\"JavaScript\">\n"
    L"  var FRAME_DELAY = 75;\n  var timeoutID;\n  var ImageCount = 3;\n"
    L"  var Images = new Array();\n  for( i=0; i < ImageCount; i++ )\n"
    L"  \tImages[i] = new Image();\n\n"
    L"  var currentImageIndex = 0;\n  bDisplayDate = 0;\n\n"
    L"  var Dates = new Array(0);\n"
    L"Images[0].src = \"Walk000.png\"\n"
    L"Images[1].src = \"Walk001.png\"\n"
    L"Images[2].src = \"Walk002.png\"\n";

} // namespace

TEST_F(Page, HasEveryPieceUpToTheFunctionsLetterByLetter) {
    EXPECT_THAT(pageOf(turntableOfThree()), StartsWith(expected_head));
}

TEST_F(Page, EndsWithTheScript) {
    const std::wstring page = pageOf(turntableOfThree());
    EXPECT_TRUE(page.ends_with(L"}\n</SCRIPT>\n"));
}

TEST_F(Page, FunctionsStandInTheirOrder) {
    const std::wstring page = pageOf(turntableOfThree());
    std::size_t place = 0;
    for (const wchar_t* function :
         {L"function Load()", L"function begin_animation()", L"function stop_animation()",
          L"function start_stop()", L"function run()", L"function firstFrame()",
          L"function prevFrame()", L"function nextFrame()", L"function lastFrame()",
          L"function DisplayCaption(nFrameNumber)", L"function EnableCtrls(sCtl)",
          L"function showCounter(bShow)"}) {
        const std::size_t found = page.find(function);
        ASSERT_NE(std::wstring::npos, found) << KM_wString(function).ToUtf8();
        EXPECT_GT(found, place) << KM_wString(function).ToUtf8();
        place = found;
    }
}

TEST_F(Page, ButtonsThatThePageHasNotAreNamedInCommentsOnly) {
    const std::wstring page = pageOf(turntableOfThree());
    for (const wchar_t* button : {L"btnStop", L"btnStart"}) {
        int comments = 0;
        for (std::size_t at = page.find(button); at != page.npos; at = page.find(button, at + 1)) {
            const std::size_t line = page.rfind(L'\n', at) + 1;
            EXPECT_EQ(L"//", page.substr(page.find_first_not_of(L' ', line), 2));
            ++comments;
        }
        EXPECT_EQ(2, comments) << KM_wString(button).ToUtf8();
    }
}

TEST_F(Page, SunStudyShowsItsDates) {
    for (const auto type :
         {KM_3dmAnimationProperties::one_day_sun, KM_3dmAnimationProperties::seasonal_sun}) {
        KM_3dmAnimationProperties props = turntableOfThree();
        props.SetCaptureType(type);
        for (const wchar_t* date : {L"1 June 06:00", L"1 June 06:30"})
            props.Dates().Append(date);
        const std::wstring page = pageOf(props);
        EXPECT_THAT(page, HasSubstr(L"  bDisplayDate = 1;\n\n  var Dates = new Array(2);\n"));
        EXPECT_THAT(page, HasSubstr(L"Images[2].src = \"Walk002.png\"\n"
                                    L"Dates[0] = \"1 June 06:00\"\nDates[1] = \"1 June 06:30\"\n"));
    }
}

TEST_F(Page, CameraAnimationsShowNoDates) {
    for (const auto type :
         {KM_3dmAnimationProperties::path, KM_3dmAnimationProperties::turntable,
          KM_3dmAnimationProperties::flythrough, KM_3dmAnimationProperties::none}) {
        KM_3dmAnimationProperties props = turntableOfThree();
        props.SetCaptureType(type);
        EXPECT_THAT(pageOf(props), HasSubstr(L"bDisplayDate = 0;"));
    }
}

TEST_F(Page, NamesStandInItAsTheyAreStored) {
    KM_3dmAnimationProperties props = turntableOfThree();
    props.SetHtmlFilename(L"%s & \"%d\"");
    props.Images().Empty();
    props.Images().Append(L"a\"b%s000.png");
    const std::wstring page = pageOf(props);
    EXPECT_THAT(page, HasSubstr(L"Images[0].src = \"a\"b%s000.png\"\n"));
    EXPECT_THAT(page, HasSubstr(L"<TITLE>%s & \"%d\"</TITLE>"));
}

TEST_F(GermanPage, HasItsTextsInTheUsersLanguage) {
    const std::wstring page = pageOf(turntableOfThree());
    EXPECT_THAT(page, HasSubstr(L">Endlos wiederholen\n"));
    EXPECT_THAT(page, HasSubstr(L">Bildzähler anzeigen\n"));
    EXPECT_THAT(page, HasSubstr(L"Animation erstellt mit <A HREF"));
    EXPECT_THAT(page, HasSubstr(L"onDblClick=\"start_stop()\">Anhalten</BUTTON>"));
    EXPECT_THAT(page, HasSubstr(L".textContent = \"Anhalten\";"));
    EXPECT_THAT(page, Not(HasSubstr(L"\"Stop\"")));
}

TEST_F(Page, IsWrittenAsUtf8WithAByteOrderMark) {
    KM_3dmAnimationProperties props = turntableOfThree();
    props.SetHtmlFilename(L"Grüße 日本");
    const std::filesystem::path file = folder.path() / "page.html";
    ASSERT_TRUE(WriteHTML(props, L"  " + wide(file) + L"\t "));
    const std::string bytes = readFile(file);
    EXPECT_TRUE(bytes.starts_with("\xEF\xBB\xBF<HTML>\n"));
    EXPECT_THAT(bytes, HasSubstr("<TITLE>Grüße 日本</TITLE>"));
    EXPECT_EQ(KM_wString(pageOf(props)).ToUtf8(), bytes.substr(3));
}

TEST_F(Page, BlankPathWritesNothing) {
    KM_3dmAnimationProperties props = turntableOfThree();
    EXPECT_FALSE(WriteHTML(props, L"   \t "));
    EXPECT_FALSE(WriteHTML(props, L""));
}

TEST_F(Page, FolderThatIsNotThereWritesNothing) {
    KM_3dmAnimationProperties props = turntableOfThree();
    EXPECT_FALSE(WriteHTML(props, wide(folder.path() / "no such folder" / "page.html")));
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}
