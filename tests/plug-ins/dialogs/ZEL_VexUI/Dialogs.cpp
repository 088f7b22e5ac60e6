#include "sdk/vexui/VexUi.h"
#include "tests/plug-ins/TestPlugIn.h"

#include <array>
#include <optional>
#include <sstream>

// Stands in for the dialog plug-in. The test says in the environment what the person does, and
// reads there what the person was shown:
//   QUARN_DIALOG_CONFIRM    "1" confirms the dialog; anything else closes it
//   QUARN_DIALOG_FRAMES     the frame count to enter
//   QUARN_DIALOG_NAME       the animation name to enter (UTF-8)
//   QUARN_DIALOG_FILE_TYPE, QUARN_DIALOG_CAPTURE, QUARN_DIALOG_VIEWPORT, QUARN_DIALOG_DIRECTION
//                           the index to choose
//   QUARN_DIALOG_PLACE      latitude, longitude and north angle to enter
//   QUARN_DIALOG_START, QUARN_DIALOG_END
//                           year, month, day, hour, minute and second to enter
//   QUARN_DIALOG_MINUTES, QUARN_DIALOG_DAYS
//                           what to enter as the time between frames
// What is not set stays as it was shown. Afterwards QUARN_DIALOG_KIND holds "turntable", "path",
// "day" or "season", and QUARN_DIALOG_SHOWN
//   frames=<n>;name=<name>;files=<a,b>@<selected>;captures=...;viewports=...;directions=...
// and, for the two of the sun, QUARN_DIALOG_SUN
//   place=<latitude,longitude,north>;start=<y-m-d h:m:s>;end=...;minutes=<n>;days=<n>

namespace {

class DialogPlugIn final : public TestPlugIn {
public:
    DialogPlugIn() : TestPlugIn("00000000-0000-0000-0000-000000000000") {}
    KM_UUID PlugInID() const override { return ZelVexUiPlugInId; }
};

TestApplication the_application;
DialogPlugIn the_plug_in;

std::optional<std::string> Wish(const std::string& name) {
    const char* value = std::getenv(("QUARN_DIALOG_" + name).c_str());
    return value ? std::optional<std::string>(value) : std::nullopt;
}

std::string Described(const KM_ClassArray<KM_wString>& list, int selection) {
    std::string text;
    for (const KM_wString& entry : list)
        text += (text.empty() ? "" : ",") + entry.ToUtf8();
    return text + "@" + std::to_string(selection);
}

void TellShown(const IZoetrixDataUI& lists, const KM_3dmAnimationProperties& record) {
    const std::string shown =
        "frames=" + std::to_string(record.FrameCount()) +
        ";name=" + record.HtmlFilename().ToUtf8() +
        ";files=" + Described(lists.FileList(), lists.FileListSelection()) +
        ";captures=" + Described(lists.CaptureList(), lists.CaptureListSelection()) +
        ";viewports=" + Described(lists.ViewportList(), lists.ViewportListSelection()) +
        ";directions=" + Described(lists.DirectionList(), lists.DirectionListSelection());
    setenv("QUARN_DIALOG_SHOWN", shown.c_str(), 1);
}

void TellSunShown(const KM_3dmAnimationProperties& record) {
    std::ostringstream shown;
    shown << "place=" << record.Latitude() << "," << record.Longitude() << ","
          << record.NorthAngle() << ";start=" << record.StartYear() << "-" << record.StartMonth()
          << "-" << record.StartDay() << " " << record.StartHour() << ":" << record.StartMinutes()
          << ":" << record.StartSeconds() << ";end=" << record.EndYear() << "-" << record.EndMonth()
          << "-" << record.EndDay() << " " << record.EndHour() << ":" << record.EndMinutes() << ":"
          << record.EndSeconds() << ";minutes=" << record.MinutesBetweenFrames()
          << ";days=" << record.DaysBetweenFrames();
    setenv("QUARN_DIALOG_SUN", shown.str().c_str(), 1);
}

/// The numbers of a wish, which stand there with blanks between them.
template <class Number, std::size_t count>
std::optional<std::array<Number, count>> WishedNumbers(const std::string& name) {
    const std::optional<std::string> text = Wish(name);
    if (!text)
        return std::nullopt;
    std::array<Number, count> numbers = {};
    std::istringstream words(*text);
    for (Number& number : numbers)
        words >> number;
    return numbers;
}

void EnterSun(KM_3dmAnimationProperties& record) {
    if (const auto place = WishedNumbers<double, 3>("PLACE")) {
        record.SetLatitude((*place)[0]);
        record.SetLongitude((*place)[1]);
        record.SetNorthAngle((*place)[2]);
    }
    if (const auto start = WishedNumbers<int, 6>("START")) {
        record.SetStartYear((*start)[0]);
        record.SetStartMonth((*start)[1]);
        record.SetStartDay((*start)[2]);
        record.SetStartHour((*start)[3]);
        record.SetStartMinutes((*start)[4]);
        record.SetStartSeconds((*start)[5]);
    }
    if (const auto end = WishedNumbers<int, 6>("END")) {
        record.SetEndYear((*end)[0]);
        record.SetEndMonth((*end)[1]);
        record.SetEndDay((*end)[2]);
        record.SetEndHour((*end)[3]);
        record.SetEndMinutes((*end)[4]);
        record.SetEndSeconds((*end)[5]);
    }
    if (const auto minutes = Wish("MINUTES"))
        record.SetMinutesBetweenFrames(std::atoi(minutes->c_str()));
    if (const auto days = Wish("DAYS"))
        record.SetDaysBetweenFrames(std::atoi(days->c_str()));
}

void EnterIntoRecord(KM_3dmAnimationProperties& record) {
    if (const auto frames = Wish("FRAMES"))
        record.SetFrameCount(std::atoi(frames->c_str()));
    if (const auto name = Wish("NAME"))
        record.SetHtmlFilename(KM_wString::FromUtf8(*name));
    // A command that takes more of the edited record than its dialog shows finds nonsense there.
    record.SetFileExtension(L"gif");
    record.SetViewportName(L"Nowhere");
    record.SetCaptureMethod(L"Nothing");
    record.SetCaptureType(KM_3dmAnimationProperties::seasonal_sun);
}

void Choose(IZoetrixDataUI& lists) {
    if (const auto index = Wish("FILE_TYPE"))
        lists.SetFileListSelection(std::atoi(index->c_str()));
    if (const auto index = Wish("CAPTURE"))
        lists.SetCaptureListSelection(std::atoi(index->c_str()));
    if (const auto index = Wish("VIEWPORT"))
        lists.SetViewportListSelection(std::atoi(index->c_str()));
    if (const auto index = Wish("DIRECTION"))
        lists.SetDirectionListSelection(std::atoi(index->c_str()));
}

bool RunDialog(const char* kind, IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    setenv("QUARN_DIALOG_KIND", kind, 1);
    TellShown(lists, record);
    EnterIntoRecord(record);
    Choose(lists);
    return Wish("CONFIRM") == "1";
}

bool RunSunDialog(const char* kind, IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    TellSunShown(record);
    EnterSun(record);
    return RunDialog(kind, lists, record);
}

} // namespace

QN_PLUGIN_ENTRY bool ZelVexUiTurnTable(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    return RunDialog("turntable", lists, record);
}

QN_PLUGIN_ENTRY bool ZelVexUiPathAnimation(IZoetrixDataUI& lists,
                                           KM_3dmAnimationProperties& record) {
    return RunDialog("path", lists, record);
}

QN_PLUGIN_ENTRY bool ZelVexUiDay(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    return RunSunDialog("day", lists, record);
}

QN_PLUGIN_ENTRY bool ZelVexUiSeason(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    return RunSunDialog("season", lists, record);
}

TEST_PLUGIN_EXPORTS
