#include "tests/farm/House.h"

#include "tests/quarn/ProgramRun.h"

#include <gtest/gtest.h>
#include <stdexcept>

namespace quarn::test {

namespace {

namespace fs = std::filesystem;

// With the sanitizers all is ten times as slow.
#ifdef __SANITIZE_ADDRESS__
const char* const SAMPLES = "2";
#else
const char* const SAMPLES = "16";
#endif

constexpr int MOST_MINUTES = 15;

struct Wish {
    std::string kind;
    int frames = 0;
    std::vector<std::string> options;
};

fs::path model() {
    static const fs::path folder = fs::path(FARM_CLUSTER) / "model";
    const fs::path file = folder / "pavilion.obj";
    if (!fs::exists(file)) {
        fs::create_directories(folder);
        Start start;
        start.program = MAKE_PAVILION;
        start.arguments = {folder.string()};
        EXPECT_EQ(run(start).exit_code, 0);
    }
    return file;
}

/// Each test is a program of its own: the first that needs a house makes it.
House made(const Wish& wish) {
    const fs::path place = fs::path(FARM_CLUSTER) / wish.kind;
    const House house = {wish.frames, place / "house.quarn", place / "frames"};
    if (fs::exists(place / "done"))
        return house;
    fs::create_directories(place);
    Start start;
    start.arguments = {"turntable", model().string(),
                       "--name",    "house",
                       "--frames",  std::to_string(wish.frames),
                       "--hide",    "Walk",
                       "--out",     house.folder.string(),
                       "--save",    house.document.string()};
    start.arguments.insert(start.arguments.end(), wish.options.begin(), wish.options.end());
    RunningProgram program(start);
    for (int minute = 0; minute < MOST_MINUTES && !fs::exists(house.folder / "house.html");
         ++minute)
        program.waitUntil([&] { return fs::exists(house.folder / "house.html"); });
    const Ended ended = program.wait();
    if (ended.exit_code != 0)
        throw std::runtime_error("no frames to compare with: " + ended.err);
    writeFile(place / "done", "");
    return house;
}

bool tellsHowItCameAbout(const std::string& name) {
    return name.ends_with(".journal") || name.ends_with(".recording") ||
           name.find(".farm") != std::string::npos;
}

Wish rendered(const std::string& kind, int frames) {
    return {kind, frames, {"--mode", "RenderFull", "--samples", SAMPLES, "--size", "320x180"}};
}

} // namespace

const House& renderedHouse() {
    static const House house = made(rendered("rendered", 18));
    return house;
}

const House& longHouse() {
    static const House house = made(rendered("long", 200));
    return house;
}

const House& quickHouse() {
    static const House house =
        made({"quick", 24, {"--mode", "Rendered", "--size", "160x90", "--elevation", "40"}});
    return house;
}

std::map<std::string, std::string> whatIsSeen(const fs::path& folder) {
    std::map<std::string, std::string> files;
    for (const fs::directory_entry& entry : fs::directory_iterator(folder)) {
        const std::string name = entry.path().filename();
        if (!tellsHowItCameAbout(name))
            files[name] = readFile(entry.path());
    }
    return files;
}

std::vector<std::string> differences(const fs::path& folder, const fs::path& other) {
    const std::map<std::string, std::string> there = whatIsSeen(other);
    std::vector<std::string> names;
    for (const auto& [name, bytes] : whatIsSeen(folder)) {
        const auto same = there.find(name);
        if (same == there.end())
            names.push_back(name + " is only in " + folder.string());
        else if (same->second != bytes)
            names.push_back(name + " differs: " + std::to_string(bytes.size()) + " bytes, and " +
                            std::to_string(same->second.size()));
    }
    return names;
}

std::vector<std::string> framesIn(const fs::path& folder) {
    std::vector<std::string> names;
    if (fs::exists(folder)) {
        for (const auto& [name, bytes] : whatIsSeen(folder)) {
            if (name.ends_with(".jpg"))
                names.push_back(name);
        }
    }
    return names;
}

} // namespace quarn::test
