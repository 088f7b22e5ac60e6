#include "host/share/film/FilmCaption.h"

#include "ground/PathText.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

Result<std::string> captionOf(const std::optional<FrameSun>& sun,
                              const std::filesystem::path& film) {
    if (!sun)
        return Error{KM_wString::FormatToString(
                         QnLocalizeString(L"%s is not written: its frames tell no date and time, "
                                          L"so none can be drawn into it. Make it without them.",
                                          42784),
                         textFromPath(film).Array())
                         .ToUtf8()};
    std::string time = sun->time;
    if (time.ends_with(":00"))
        time.resize(time.size() - 3);
    if (const auto between = time.find('T'); between != time.npos)
        time.replace(between, 1, "  ");
    return time + "  " + sun->zone;
}

} // namespace quarn
