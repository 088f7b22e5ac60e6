#include "tests/layers/IncludeRules.h"
#include "tests/layers/Floors.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <optional>

namespace {

using layers::breachesBelow;
using layers::floors;
using layers::Include;
using layers::includesOf;
using layers::isAllowed;
using layers::Room;

std::string listed(const std::vector<std::string>& lines) {
    std::string text;
    for (const std::string& line : lines) {
        text += line + "\n";
    }
    return text;
}

bool allowsQuoted(const std::string& file, const std::string& path) {
    return isAllowed(file, Include{1, true, path});
}

bool allowsAngled(const std::string& file, const std::string& path) {
    return isAllowed(file, Include{1, false, path});
}

TEST(Layers, NoSourceOfTheProjectIncludesWhatItMayNotKnow) {
    EXPECT_EQ(listed(breachesBelow(QUARN_SOURCE_DIR)), "");
}

TEST(Layers, EveryBreachOfTheSampleTreeIsReported) {
    EXPECT_EQ(listed(breachesBelow(QUARN_SOURCE_DIR "/tests/layers/sample")),
              "desktop/window/Window.h:2: may not include host/document/Document.h\n"
              "engine/display/Scene.h:3: may not include engine/render/Renderer.h\n"
              "engine/display/Scene.h:4: may not include host/document/Document.h\n"
              "host/app/Loader.h:2: may not include zoetrix/plugin/ZoetrixPlugIn.h\n"
              "host/app/Loader.h:3: may not include vexui/Form.h\n"
              "host/document/Document.h:4: may not include host/app/Loader.h\n"
              "import/Reader.h:3: may not include engine/display/Scene.h\n"
              "import/Reader.h:4: may not include sdk/qncore/QnDoc.h\n"
              "kelmar/KM_Shape.h:2: may not include sdk/qncore/QnDoc.h\n"
              "kelmar/KM_Shape.h:3: may not include embree3/rtcore.h\n"
              "quarn/session/Program.h:3: may not include host/app/Loader.h\n"
              "quarn/session/Program.h:4: may not include kelmar/KM_Shape.h\n"
              "sdk/qncore/QnDoc.h:2: may not include host/document/Document.h\n"
              "vexui/Form.h:4: may not include zoetrix/ui/TurnTableDialog.h\n"
              "zoetrix/commands/cmdTurntable.h:3: may not include host/app/Loader.h\n"
              "zoetrix/commands/cmdTurntable.h:4: may not include ZoetrixApp.h\n"
              "zoetrix/paths/Path.h:3: may not include zoetrix/commands/cmdTurntable.h\n"
              "zoetrix/plugin/ZoetrixPlugIn.h:3: may not include zoetrix/ZoetrixGlobals.cpp\n"
              "zoetrix/sun/VyrSun.h:3: may not include kelmar/KM_Shape.h\n");
}

/// The row that a place belongs to, or none.
std::optional<std::size_t> rowOf(std::string_view place) {
    const auto rows = floors();
    const auto row =
        std::ranges::find_if(rows, [&](const Room& room) { return place.starts_with(room.place); });
    if (row == rows.end())
        return std::nullopt;
    return static_cast<std::size_t>(row - rows.begin());
}

TEST(Layers, ARoomSeesRoomsThatStandAboveItInTheListAlone) {
    const auto rows = floors();
    for (std::size_t i = 0; i < rows.size(); ++i) {
        for (const std::string_view place : rows[i].sees) {
            if (rows[i].place.starts_with(place))
                continue; // the wider room that it is a part of
            const auto seen = rowOf(place);
            ASSERT_TRUE(seen) << rows[i].place << " sees " << place;
            EXPECT_LT(*seen, i) << rows[i].place << " sees " << place;
            EXPECT_LE(rows[*seen].floor, rows[i].floor) << rows[i].place << " sees " << place;
        }
        const int floor_before = i > 0 ? rows[i - 1].floor : 0;
        EXPECT_GE(rows[i].floor, floor_before) << rows[i].place;
    }
}

TEST(Layers, OnlyTheFoldersOfThePlugInHaveNeighbours) {
    for (const Room& room : floors())
        EXPECT_TRUE(room.neighbours.empty() || room.place.starts_with("zoetrix/")) << room.place;
}

TEST(Layers, TheLibrariesBelowTheHostKnowNoDocument) {
    for (const std::string room :
         {"ground", "engine/scene", "engine/images", "engine/display", "engine/render", "import"}) {
        EXPECT_FALSE(allowsQuoted(room + "/A.cpp", "host/document/Document.h")) << room;
        EXPECT_FALSE(allowsQuoted(room + "/A.cpp", "sdk/qncore/QnDoc.h")) << room;
        EXPECT_TRUE(allowsQuoted(room + "/A.cpp", "kelmar/KM_Point.h")) << room;
    }
}

TEST(Layers, ProgramsComeInByTheDoor) {
    for (const std::string program : {"quarn/session", "desktop/window"}) {
        EXPECT_TRUE(allowsQuoted(program + "/A.cpp", "host/session/Session.h"));
        EXPECT_TRUE(allowsQuoted(program + "/A.cpp", "host/front_end/FrontEnd.h"));
        EXPECT_TRUE(allowsQuoted(program + "/A.cpp", "host/cities/Cities.h"));
        EXPECT_FALSE(allowsQuoted(program + "/A.cpp", "host/commands/HostCommands.h"));
        EXPECT_FALSE(allowsQuoted(program + "/A.cpp", "engine/images/Image.h"));
        EXPECT_FALSE(allowsQuoted(program + "/A.cpp", "import/ModelFile.h"));
    }
}

TEST(Layers, CommentedOutIncludesDoNotCount) {
    const auto includes =
        includesOf("// #include <a>\n  #  include \"b/c.h\" // why\n#import <d>\n");
    ASSERT_EQ(includes.size(), 2u);
    EXPECT_EQ(includes[0].line, 2);
    EXPECT_TRUE(includes[0].quoted);
    EXPECT_EQ(includes[0].path, "b/c.h");
    EXPECT_EQ(includes[1].line, 3);
    EXPECT_FALSE(includes[1].quoted);
    EXPECT_EQ(includes[1].path, "d");
}

TEST(Layers, TheCalculatorOfTheSunKnowsTheStandardLibraryAlone) {
    EXPECT_TRUE(allowsAngled("zoetrix/sun/VyrSun.cpp", "cmath"));
    EXPECT_TRUE(allowsQuoted("zoetrix/sun/VyrSun.cpp", "zoetrix/sun/VyrSun.h"));
    EXPECT_FALSE(allowsQuoted("zoetrix/sun/VyrSun.cpp", "zoetrix/plugin/ZoetrixUtilities.h"));
    EXPECT_FALSE(allowsQuoted("zoetrix/sun/VyrSun.h", "sdk/qncore/QnSun.h"));
}

TEST(Layers, EveryOtherFolderOfThePlugInMayUseTheUtilities) {
    for (const std::string folder : {"sun", "paths", "commands", "ui", "plugin"}) {
        EXPECT_TRUE(
            allowsQuoted("zoetrix/" + folder + "/A.cpp", "zoetrix/plugin/ZoetrixUtilities.h"))
            << folder;
    }
    EXPECT_FALSE(allowsQuoted("zoetrix/sun/A.cpp", "zoetrix/plugin/ZoetrixPlugIn.h"));
    EXPECT_FALSE(allowsQuoted("zoetrix/ui/A.cpp", "zoetrix/commands/cmdZoetrix.h"));
}

TEST(Layers, OnlyTheGlobalObjectsStandAboveTheFoldersOfThePlugIn) {
    EXPECT_TRUE(allowsQuoted("zoetrix/ZoetrixGlobals.cpp", "zoetrix/commands/cmdTurntable.h"));
    EXPECT_TRUE(allowsQuoted("zoetrix/ZoetrixGlobals.cpp", "zoetrix/plugin/ZoetrixApp.h"));
    EXPECT_FALSE(allowsQuoted("zoetrix/ZoetrixGlobals.cpp", "host/app/Loader.h"));
    EXPECT_FALSE(allowsQuoted("zoetrix/commands/A.cpp", "zoetrix/ZoetrixGlobals.h"));
}

TEST(Layers, CocoaStaysInTheFilesOfObjectiveC) {
    const std::string controller = "zoetrix/ui/QXTurnTableDialogController.mm";
    EXPECT_TRUE(allowsAngled(controller, "AppKit/AppKit.h"));
    EXPECT_TRUE(allowsQuoted(controller, "sdk/cocoa/QXDialogController.h"));
    EXPECT_TRUE(allowsQuoted(controller, "zoetrix/ui/TurnTableDialog.h"));
    EXPECT_TRUE(allowsAngled("sdk/cocoa/QXText.h", "Foundation/Foundation.h"));
    EXPECT_TRUE(allowsQuoted("host/cocoa/QXText.mm", "sdk/cocoa/QXText.h"));
    EXPECT_TRUE(allowsQuoted("host/cocoa/Window.mm", "host/front_end/DialogWindow.h"));

    EXPECT_FALSE(allowsQuoted(controller, "host/cocoa/CocoaDialogs.h"));
    EXPECT_FALSE(allowsQuoted("host/cocoa/Window.mm", "host/document/Document.h"));
    EXPECT_FALSE(allowsAngled("zoetrix/ui/TurnTableDialog.cpp", "AppKit/AppKit.h"));
    EXPECT_FALSE(allowsAngled("host/app/Application.cpp", "Foundation/Foundation.h"));
    EXPECT_FALSE(allowsQuoted("host/app/Application.cpp", "host/cocoa/CocoaDialogs.h"));
    EXPECT_FALSE(allowsQuoted("sdk/qncore/qncore.h", "sdk/cocoa/QXText.h"));
    EXPECT_FALSE(
        allowsQuoted("zoetrix/ui/TurnTableDialog.h", "zoetrix/ui/QXTurnTableDialogController.h"));
}

TEST(Layers, AFolderWithoutARuleMayIncludeNothing) {
    EXPECT_FALSE(allowsQuoted("attic/A.cpp", "kelmar/KM_Point.h"));
}

} // namespace
