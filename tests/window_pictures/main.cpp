#include "tests/desktop_window/driver/Desk.h"

#include <QColor>

#include <csignal>
#include <cstdio>
#include <exception>
#include <thread>

namespace {

using namespace quarn::test;

constexpr int JPEG_QUALITY = 80;
/// The frame of that time, where the first is of six o'clock, and half an hour lies between them.
constexpr int HALF_PAST_EIGHT = 8;

/// Darkens what lies around a window, as the shadow that a window manager gives it.
/// @param before  what stands before it and stays as it is; may be empty
void addShadow(QImage& picture, const QRect& window, const QRect& before) {
    constexpr int WIDTH_PX = 14;
    for (int step = WIDTH_PX; step > 0; --step) {
        const QRect ring = window.adjusted(-step, -step, step, step);
        const double light = step == 1 ? 0.45 : 1.0 - 0.5 * (1.0 - double(step) / WIDTH_PX) / 2.0;
        for (int y = ring.top(); y <= ring.bottom(); ++y)
            for (int x = ring.left(); x <= ring.right(); ++x) {
                const bool is_edge =
                    x == ring.left() || x == ring.right() || y == ring.top() || y == ring.bottom();
                if (!is_edge || !picture.valid(x, y) || before.contains(x, y))
                    continue;
                const QColor lit = picture.pixelColor(x, y);
                picture.setPixelColor(x, y,
                                      QColor(int(lit.red() * light), int(lit.green() * light),
                                             int(lit.blue() * light)));
            }
    }
}

/// Takes the pictures of docs/window.md, in the order in which a person comes by.
class Tour {
public:
    Tour(std::filesystem::path model, QString folder)
        : m_model(std::move(model)), m_folder(std::move(folder)) {}

    void inEnglish() {
        Desk desk;
        open(desk, "en");
        take(desk, "window-model");
        desk.chooseInMenu("command_SetTurntableAnimation");
        desk.choose("captureMethod", "RenderedViewport");
        desk.stepTo("frames", 120);
        take(desk, "window-turntable");
        confirm(desk);
        play(desk);
        desk.click("record");
        desk.widget("promptOk");
        take(desk, "window-record");
        desk.click("promptOk");
        desk.widget("openPageButton");
        desk.waitUntilIdle();
        take(desk, "window-recorded");
        desk.chooseInMenu("command_SetOneDaySunAnimation");
        desk.choose("namedDay", "Longest day");
        desk.click("choosePlace");
        const QRect map = desk.widget("map").place;
        const double pixels_per_degree = map.width() / 360.0;
        desk.display().click(map.topLeft() + QPoint(qRound((23.73 + 180) * pixels_per_degree),
                                                    qRound((90 - 37.98) * pixels_per_degree)));
        desk.waitForText("latitude", "37.98");
        take(desk, "window-place");
        desk.click("ok");
        desk.waitUntilGone("map");
        take(desk, "window-sun");
        confirm(desk);
        play(desk);
        desk.click("firstFrame");
        desk.stepTo("frameNumber", HALF_PAST_EIGHT);
        desk.waitUntilIdle();
        take(desk, "window-sun-frame");
    }

    /// Two documents of programs that were killed.
    void recovery() {
        Desk desk;
        std::filesystem::copy(m_model.parent_path(), desk.documents());
        workAndKill(
            desk, "_-SaveAs \"Documents/riverside.quarn\"\n"
                  "_-DisplayMode _Rendered\n"
                  "_-SetTurntableAnimation 120 _Clockwise _jpg _RenderedViewport Perspective R\n");
        workAndKill(desk, "_-DisplayMode _Shaded\n_-Point 0,0,0\n");
        desk.begin({.arguments = {"--language", "en"}});
        desk.widget("recover");
        take(desk, "window-recovery");
    }

    void inJapanese() {
        Desk desk;
        open(desk, "ja");
        desk.chooseInMenu("command_SetTurntableAnimation");
        take(desk, "window-ja");
    }

    void inGerman() {
        Desk desk;
        open(desk, "de");
        desk.chooseInMenu("command_SetOneDaySunAnimation");
        take(desk, "window-de");
    }

private:
    void workAndKill(Desk& desk, const char* lines) {
        writeFile(desk.home() / "work.txt",
                  std::string("_-Open \"Documents/pavilion.obj\"\n") + lines);
        desk.start({.screen_px = {1300, 900},
                    .arguments = {"--recovery-every", "0.2", "--run-script", "work.txt"}});
        std::this_thread::sleep_for(std::chrono::seconds(2)); // some beats
        desk.sendSignal(SIGKILL);
        desk.waitForEnd();
    }

    void open(Desk& desk, const char* language) {
        std::filesystem::copy(m_model.parent_path(), desk.documents());
        desk.start({.screen_px = {1300, 900}, .arguments = {"--language", language}});
        desk.chooseInMenu("command_Open");
        const auto fileIn = [](const Windows& seen) -> const SeenItem* {
            const SeenWidget* const files = seen.widget("treeView");
            return files ? files->item("pavilion.obj") : nullptr;
        };
        const Windows chooser = desk.lookUntil(
            "the file", [&](const Windows& seen) { return fileIn(seen) != nullptr; });
        desk.display().doubleClick(fileIn(chooser)->place.center());
        desk.lookUntil("the model", [](const Windows& seen) {
            return seen.widget("output")->text.contains("pavilion.obj:");
        });
        desk.waitUntilIdle();
    }

    void confirm(Desk& desk) {
        desk.click("ok");
        desk.waitUntilIdle();
    }

    void play(Desk& desk) {
        desk.click("play");
        desk.lookUntil("it plays", [](const Windows& seen) { return seen.isCommandRunning(); });
        desk.waitUntilIdle();
    }

    void take(Desk& desk, const QString& name) {
        desk.display().moveMouse({640, 858});
        QImage picture = desk.stillPicture();
        const Windows seen = desk.look();
        QRect front;
        for (const SeenWidget* const window : seen.modalWindows())
            if (window->is_in_front)
                front = window->place;
        for (const SeenWidget* const window : seen.modalWindows())
            addShadow(picture, window->place, window->is_in_front ? QRect() : front);
        picture = picture.copy(seen.widget("mainWindow")->place);
        picture.save(m_folder + '/' + name + ".jpg", "jpg", JPEG_QUALITY);
    }

    std::filesystem::path m_model;
    QString m_folder;
};

} // namespace

/// Takes the pictures of the window that docs/ shows.
int main(int argument_count, char** arguments) {
    if (argument_count != 3) {
        std::fputs("usage: window_pictures MODEL.obj FOLDER\n", stderr);
        return 2;
    }
    try {
        Tour tour(std::filesystem::absolute(arguments[1]), QString::fromLocal8Bit(arguments[2]));
        tour.inEnglish();
        tour.recovery();
        tour.inJapanese();
        tour.inGerman();
    } catch (const std::exception& error) {
        std::fprintf(stderr, "window_pictures: %s\n", error.what());
        return 1;
    }
    return 0;
}
