#include "tests/desktop_window/HouseDesk.h"
#include "tests/desktop_window/driver/FileDrag.h"

#include <gtest/gtest.h>

namespace quarn::test {

namespace {

class FileDropped : public testing::Test {
protected:
    bool drop(const char* name) {
        const SeenWidget view = desk.widget("view Perspective");
        desk.display().moveMouse(view.place.center());
        return dropFile(desk.display().name(), view.window_id, view.place.center(),
                        desk.documents() / name);
    }

    HouseDesk desk;
};

TEST_F(FileDropped, ModelThatAnotherProgramDropsIsOpened) {
    desk.start();
    EXPECT_TRUE(drop("house.obj"));
    desk.waitForOutput("house.obj: 2 objects with 24 triangles");
    desk.waitUntilIdle();
}

TEST_F(FileDropped, FileThatIsNoModelIsRefusedAndTheNextOneOpens) {
    writeFile(desk.documents() / "notes.txt", "no model");
    writeFile(desk.documents() / "noise.obj", std::string(100, '\xff'));
    desk.start();
    for (const char* const name : {"notes.txt", "noise.obj"}) {
        EXPECT_TRUE(drop(name));
        desk.waitForOutput(name);
        const Windows seen = desk.waitUntilIdle();
        EXPECT_FALSE(seen.widget("output")->text.contains("objects with")) << name;
    }
    EXPECT_TRUE(drop("house.obj"));
    desk.waitForOutput("house.obj: 2 objects with 24 triangles");
    desk.waitUntilIdle();
}

} // namespace

} // namespace quarn::test
