#pragma once

#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gtest/gtest.h>
#include <map>
#include <sys/stat.h>

namespace quarn::test {

/// A folder with a document house.quarn, whose turntable is recorded.
class RecordedDocument {
public:
    /// @param frames  of the turntable
    /// @param size    of its pictures, "64 48"
    explicit RecordedDocument(int frames = 12, const std::string& size = "64 48") {
        save("house.quarn", frames, size);
    }

    /// Saves another document of the same name of animation.
    void save(const std::string& document, int frames, const std::string& size = "64 48",
              const std::string& before = "") const {
        writeFile(m_studio / "save.txt",
                  "_-ViewportSize " + size + "\n_-FitView _Turn=Yes _Enter\n" +
                      "_-AnimationName house\n" + before + "_-SetTurntableAnimation " +
                      std::to_string(frames) + " _Clockwise _jpg _Shaded _Enter _Enter\n_-SaveAs " +
                      document + "\n");
        const Ended ended = run({"run", "save.txt", "house.obj"});
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
    }

    Start start(std::vector<std::string> arguments) const {
        Start start;
        start.folder = m_studio.path();
        start.arguments = std::move(arguments);
        start.environment = {{"LANG", "C.UTF-8"}};
        return start;
    }
    Start record(const std::string& out, std::vector<std::string> options = {}) const {
        options.insert(options.begin(), {"record", "house.quarn", "--out", out});
        return start(std::move(options));
    }
    Ended run(std::vector<std::string> arguments) const {
        return test::run(start(std::move(arguments)));
    }

    /// The files of a finished recording by their names, but for NAME.recording: pictures, page and
    /// list of frames. What is in the folder besides fails the test.
    std::map<std::string, std::string> recorded(const std::string& folder) const {
        std::map<std::string, std::string> files;
        for (const std::string& name : filesIn(m_studio / folder)) {
            EXPECT_FALSE(name.ends_with(".journal") || name.ends_with(".claim")) << name;
            if (!name.ends_with(".recording"))
                files[name] = readFile(m_studio / folder / name);
        }
        return files;
    }

    /// Which file of the disk it is, and when it was written: changes when it is made again.
    std::pair<ino_t, long> markOf(const std::filesystem::path& file) const {
        struct stat found {};
        EXPECT_EQ(stat((m_studio / file).c_str(), &found), 0) << file;
        return {found.st_ino, found.st_mtim.tv_nsec + 1'000'000'000L * found.st_mtim.tv_sec};
    }

    int picturesIn(const std::string& folder) const {
        int count = 0;
        if (std::filesystem::exists(m_studio / folder))
            for (const std::string& name : filesIn(m_studio / folder))
                count += name.ends_with(".jpg") && !name.starts_with('.');
        return count;
    }

    std::filesystem::path operator/(const std::filesystem::path& name) const {
        return m_studio / name;
    }

private:
    Studio m_studio;
};

} // namespace quarn::test
