#include "tests/desktop_window/HouseDesk.h"

#include "tests/quarn/Models.h"

namespace quarn::test {

HouseDesk::HouseDesk() {
    writeHouse(documents() / "house.obj");
}

void HouseDesk::startWithHouse(DeskStart start) {
    start.arguments.prepend(QString::fromStdString(documents() / "house.obj"));
    Desk::start(start);
    waitForOutput("house.obj");
    waitUntilIdle();
}

void HouseDesk::openHouse() {
    chooseInMenu("command_Open");
    clickItem("treeView", "house.obj");
    clickButton("Open");
    waitForOutput("house.obj: 2 objects with 24 triangles");
    waitUntilIdle();
}

void HouseDesk::setUpTurntable() {
    chooseInMenu("command_SetTurntableAnimation");
    click("ok");
    waitUntilGone("turntableForm");
    widget("play");
}

void HouseDesk::waitForOutput(const QString& text) {
    lookUntil("output " + text.toStdString(), [&](const Windows& seen) {
        const SeenWidget* const output = seen.widget("output");
        return output && output->text.contains(text);
    });
}

} // namespace quarn::test
