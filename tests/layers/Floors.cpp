#include "tests/layers/Floors.h"

namespace layers {
namespace {

using enum Room::Libraries;
using Places = std::vector<std::string_view>;

Places operator+(Places places, std::string_view more) {
    places.push_back(more);
    return places;
}

const Places INTERFACE = {"kelmar/", "sdk/"};
const Places BELOW_IMPORT = {"kelmar/", "ground/", "engine/scene/"};
const Places BELOW_DISPLAY = BELOW_IMPORT + "engine/images/";

// The host: each of its rooms sees all that stand above it here.
const Places BELOW_HOST = {
    "kelmar/",         "sdk/",           "ground/",          "engine/scene/", "engine/images/",
    "engine/display/", "engine/render/", "engine/sunhours/", "import/"};
const Places BELOW_FRONT_END = BELOW_HOST + "host/border/";
const Places BELOW_CITIES = BELOW_FRONT_END + "host/front_end/";
const Places BELOW_SUN = BELOW_CITIES + "host/cities/";
const Places BELOW_CLOCK = BELOW_SUN + "host/sun/";
const Places BELOW_ALMANAC = BELOW_CLOCK + "host/clock/";
const Places BELOW_CURVES = BELOW_ALMANAC + "host/almanac/";
const Places BELOW_DOCUMENT = BELOW_CURVES + "host/curves/";
const Places BELOW_APP =
    BELOW_DOCUMENT + "host/letters/" + "host/document/" + "host/reader/" + "host/recording/";
const Places BELOW_PROMPT = BELOW_APP + "host/app/";
const Places BELOW_DIALOGS = BELOW_PROMPT + "host/prompt/";
const Places BELOW_COMMANDS = BELOW_DIALOGS + "host/dialogs/" + "host/recovery/";
const Places BELOW_SHARE = BELOW_COMMANDS + "host/commands/";
const Places BELOW_SUN_HOURS = BELOW_SHARE + "host/share/";
const Places BELOW_SESSION = BELOW_SUN_HOURS + "host/sunhours/" + "host/sunpath/";

// What a program sees of the host: its door, what it implements itself, the cities of the world,
// their sun, their clocks, their almanac and the diagram of the sun's paths.
const Places PROGRAM = {"sdk/",      "host/session/", "host/front_end/", "host/cities/",
                        "host/sun/", "host/clock/",   "host/almanac/",   "host/sunpath/"};

const Places BELOW_SESSIONS = PROGRAM + "quarn/words/" + "quarn/terminal/";
const Places BELOW_RUNS = PROGRAM + "quarn/words/" + "quarn/session/" + "quarn/scripts/";

const Places BELOW_PORT = PROGRAM + "desktop/texts/";
const Places BELOW_STARTER = BELOW_PORT + "desktop/front_end/";
const Places BELOW_BARS = BELOW_STARTER + "desktop/command_line/";
const Places BELOW_WINDOW = BELOW_BARS + "desktop/dialogs/" + "desktop/render/" +
                            "desktop/documents/" + "desktop/recovery/" + "desktop/animation/" +
                            "desktop/menus/" + "desktop/views/" + "desktop/sun/";

constexpr std::string_view UTILITIES = "zoetrix/plugin/ZoetrixUtilities.h";

const Room FLOORS[] = {
    {0, "kelmar/", {}, {}, standard},

    {1, "sdk/cocoa/", INTERFACE, {}, standard_and_cocoa},
    {1, "sdk/", {"kelmar/"}, {}, standard},
    {1, "ground/", {"kelmar/"}},

    {2, "engine/scene/", {"kelmar/", "ground/"}},
    {2, "engine/images/", BELOW_IMPORT},
    {2, "engine/display/", BELOW_DISPLAY},
    {2, "engine/render/", BELOW_DISPLAY + "engine/display/"},
    {2, "engine/sunhours/", BELOW_DISPLAY + "engine/display/"},

    {3, "import/", BELOW_IMPORT},
    {4, "reader/", BELOW_IMPORT + "import/"},

    {4, "host/border/", BELOW_HOST},
    {4, "host/front_end/", BELOW_FRONT_END},
    {4, "host/cities/", BELOW_CITIES},
    {4, "host/sun/", BELOW_SUN},
    {4, "host/clock/", BELOW_CLOCK},
    {4, "host/almanac/", BELOW_ALMANAC},
    {4, "host/curves/", BELOW_CURVES},
    {5, "host/document/", BELOW_DOCUMENT},
    {5, "host/reader/", BELOW_DOCUMENT},
    {5, "host/recording/", BELOW_DOCUMENT},
    {5, "host/letters/", BELOW_DOCUMENT},
    {6, "host/sunpath/", BELOW_DOCUMENT + "host/letters/"},
    {6, "host/app/", BELOW_APP},
    {7, "host/recovery/", BELOW_PROMPT},
    {7, "host/prompt/", BELOW_PROMPT},
    {8, "host/dialogs/", BELOW_DIALOGS},
    {9, "host/commands/", BELOW_COMMANDS},
    {9, "host/share/", BELOW_SHARE},
    {9, "host/sunhours/", BELOW_SUN_HOURS},
    {10, "host/session/", BELOW_SESSION},
    {10, "host/cocoa/", INTERFACE + "ground/Result.h" + "host/front_end/", {}, any_and_cocoa},

    {11, "zoetrix/sun/VyrSun", {}, {}, standard},
    {11, "zoetrix/sun/", INTERFACE, {UTILITIES}, standard},
    {11,
     "zoetrix/ui/QXTurnTableDialogController",
     INTERFACE,
     {"zoetrix/ui/"},
     standard_and_cocoa,
     false},
    {11, "zoetrix/ui/", INTERFACE, {UTILITIES}, standard},
    {11, "zoetrix/plugin/", INTERFACE, {"zoetrix/paths/"}, standard},
    {11, "zoetrix/paths/", INTERFACE, {"zoetrix/plugin/"}, standard},
    {11,
     "zoetrix/commands/",
     INTERFACE + "zoetrix/plugin/" + "zoetrix/paths/" + "zoetrix/sun/" + "zoetrix/ui/",
     {},
     standard},
    {11,
     "zoetrix/ZoetrixGlobals.cpp",
     INTERFACE + "zoetrix/plugin/" + "zoetrix/commands/",
     {},
     standard},

    {11, "vexui/texts/", INTERFACE},
    {11, "vexui/forms/", INTERFACE + "vexui/texts/"},
    {11, "vexui/", INTERFACE + "vexui/texts/" + "vexui/forms/"},

    {11, "quarn/words/", {"sdk/"}},
    {11, "quarn/terminal/", {"quarn/words/"}},
    {11, "quarn/session/", BELOW_SESSIONS},
    {11, "quarn/scripts/", PROGRAM + "quarn/words/"},
    {11, "quarn/runs/", BELOW_RUNS + "quarn/terminal/"},
    {11, "quarn/reports/", BELOW_RUNS},
    {11, "quarn/console/",
     BELOW_SESSIONS + "quarn/session/" + "ground/AtomicFile.h" + "ground/Result.h"},
    {11, "quarn/farm/",
     BELOW_RUNS + "quarn/terminal/" + "quarn/runs/" + "ground/AtomicFile.h" + "ground/Result.h"},
    {11, "quarn/arguments/",
     BELOW_RUNS + "quarn/runs/" + "quarn/reports/" + "quarn/console/" + "quarn/farm/"},
    {11, "quarn/main.cpp", {"quarn/arguments/", "quarn/terminal/"}},

    {11, "desktop/texts/", PROGRAM},
    {11, "desktop/front_end/", BELOW_PORT},
    {11, "desktop/command_line/", BELOW_STARTER},
    {11, "desktop/dialogs/", BELOW_STARTER},
    {11, "desktop/render/", BELOW_STARTER},
    {11, "desktop/documents/", BELOW_BARS},
    {11, "desktop/sun/", BELOW_BARS + "desktop/dialogs/"},
    {11, "desktop/recovery/", BELOW_BARS + "desktop/dialogs/" + "desktop/documents/"},
    {11, "desktop/animation/", BELOW_BARS + "desktop/documents/"},
    {11, "desktop/menus/", BELOW_BARS + "desktop/animation/"},
    {11, "desktop/views/", BELOW_BARS + "desktop/documents/"},
    {11, "desktop/window/", BELOW_WINDOW},
    {11, "desktop/main.cpp", BELOW_WINDOW + "desktop/window/"},

    {11, "examples/", INTERFACE},
};

} // namespace

std::span<const Room> floors() {
    return FLOORS;
}

} // namespace layers
