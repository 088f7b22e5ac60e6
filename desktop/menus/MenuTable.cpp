#include "desktop/menus/MenuTable.h"

namespace quarn::desktop {

namespace {

using enum MenuPlace;

constexpr MenuTitle TITLES[] = {
    {file, L"&File", 45120},           {edit, L"&Edit", 45121},
    {view, L"&View", 45122},           {draw, L"&Curves", 45123},
    {display, L"&Render", 45124},      {sun, L"S&un", 45597},
    {animation, L"&Animation", 45125}, {share, L"&Share", 45440},
    {plug_ins, L"&Plug-ins", 45126},   {help, L"&Help", 45127},
};

constexpr MenuRow ROWS[] = {
    {file, L"New", L"&New", 45130, "Ctrl+N"},
    {file, L"Open", L"&Open…", 45131, "Ctrl+O"},
    {file, L"Import", L"&Import a model…", 45132, "Ctrl+I"},
    {file, L"Save", L"&Save", 45133, "Ctrl+S", true},
    {file, L"SaveAs", L"Save &as…", 45134, "Ctrl+Shift+S"},
    {file, L"SaveSelected", L"Save &the selection…", 45135},
    {file, L"Run", L"Open with another &program…", 45136, nullptr, true},
    {file, L"Exit", L"E&xit", 45137, "Ctrl+Q", true},

    {edit, L"Select", L"&Select…", 45138, "Ctrl+A"},
    {edit, L"Delete", L"&Delete", 45139, "Del"},
    {edit, L"Rename", L"&Rename…", 45140, "F2"},
    {edit, L"Hide", L"&Hide", 45141, "Ctrl+H", true},
    {edit, L"Show", L"Sh&ow what is hidden…", 45142, "Ctrl+Shift+H"},
    {edit, L"List", L"&List the contents", 45143, "Ctrl+L", true},

    {view, L"StandardView", L"&Look from…", 45144, "Ctrl+1"},
    {view, L"FitView", L"&Fit to the window", 45145, "Ctrl+0", false, L"_Enter"},
    {view, L"Camera", L"Place the &camera…", 45146},
    {view, L"AddView", L"&Add a view…", 45147, nullptr, true},
    {view, L"RemoveView", L"&Remove a view…", 45148},
    {view, L"ViewportSize", L"Size in &pixels…", 45149},

    {draw, L"Line", L"&Line…", 45150},
    {draw, L"Polyline", L"&Polyline…", 45151},
    {draw, L"Spline", L"&Spline by control points…", 45152},
    {draw, L"SplineThrough", L"Spline &through points…", 45153},
    {draw, L"Circle", L"&Circle…", 45154},
    {draw, L"Point", L"P&oint…", 45155},
    {draw, L"ImportCurve", L"&Read from a file…", 45156, nullptr, true},
    {draw, L"MovePoint", L"&Move a point…", 45157},
    {draw, L"EvenSpeed", L"&Even speed…", 45158},

    {display, L"DisplayMode", L"&Display mode…", 45159, "F3"},
    {display, L"DisplayEdges", L"&Edges…", 45160},
    {display, L"Render", L"&Render", 45162, "F11", true},
    {display, L"RenderPreview", L"Render a &preview", 45163, "F12"},
    {display, L"RenderSettings", L"Picture si&ze and quality…", 45164},
    {display, L"JpegQuality", L"Quality of &JPEG pictures…", 45444},
    {display, L"SaveRenderWindowAs", L"&Save the rendered picture…", 45165},
    {display, L"CloseRenderWindow", L"&Close the rendered picture", 45166},

    {sun, L"Sun", L"S&un…", 45161},
    {sun, L"SetOneDaySunAnimation", L"&One day of sun…", 45173},
    {sun, L"SetSeasonalSunAnimation", L"A &season of sun…", 45174},

    {animation, L"SetTurntableAnimation", L"&Turntable…", 45170},
    {animation, L"SetPathAnimation", L"&Along a path…", 45171},
    {animation, L"SetFlythroughAnimation", L"Flyt&hrough…", 45172},
    {animation, L"PlayAnimation", L"Pla&y", 45175, "F5", true},
    {animation, L"ViewFirstFrame", L"&First frame", 45176, "Ctrl+Home", true},
    {animation, L"ViewPreviousFrame", L"Pre&vious frame", 45177, "Ctrl+Left"},
    {animation, L"ViewNextFrame", L"&Next frame", 45178, "Ctrl+Right"},
    {animation, L"ViewLastFrame", L"&Last frame", 45179, "Ctrl+End"},
    {animation, L"ViewFrameNumber", L"&Go to frame…", 45180, "Ctrl+G"},
    {animation, L"AnimationName", L"Na&me…", 45181, nullptr, true},
    {animation, L"SaveFrame", L"Save one frame as a pict&ure…", 45182},
    {animation, L"RecordAnimation", L"&Record…", 45183, "F9"},

    {share, L"ViewerPage", L"&Page of recorded frames…", 45441},
    {share, L"Film", L"&Film of recorded frames…", 45442},
    {share, L"ExportCamera", L"&Camera for other programs…", 45443},

    {plug_ins, L"LoadPlugIn", L"&Load a plug-in…", 45185},

    {help, L"Help", L"&Commands", 45186, "F1"},
};

} // namespace

std::span<const MenuTitle> menuTitles() {
    return TITLES;
}

std::span<const MenuRow> menuRows() {
    return ROWS;
}

} // namespace quarn::desktop
