#include "host/share/frames/FramePicture.h"
#include "tests/host/share/film/DecodedFilm.h"
#include "tests/quarn/Studio.h"

#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;

std::string frameName(int number) {
    const std::string digits = std::to_string(number);
    return "house" + std::string(3 - std::min<std::size_t>(3, digits.size()), '0') + digits;
}

int pictureCount(const fs::path& folder) {
    int count = 0;
    for (const auto& entry : fs::directory_iterator(folder))
        count += entry.path().extension() == ".png" || entry.path().extension() == ".jpg";
    return count;
}

class FilmProgram : public testing::Test {
protected:
    Start record(int frames, std::vector<std::string> options) const {
        options.insert(options.end(), {"--format", "png"});
        return m_studio.turntable(frames, options);
    }
    Ended film(std::vector<std::string> arguments) const {
        Start start;
        start.folder = m_studio.path();
        start.arguments = {"video"};
        start.arguments.insert(start.arguments.end(), arguments.begin(), arguments.end());
        return run(start);
    }
    void expectSameFrames(const DecodedFilm& film, int frames) const {
        ASSERT_EQ(film.frames.size(), static_cast<std::size_t>(frames)) << film.trouble;
        for (int number = 0; number < frames; ++number) {
            const auto picture = readFramePicture(m_studio / "out" / (frameName(number) + ".png"));
            ASSERT_TRUE(picture) << picture.message();
            EXPECT_GT(psnr(film.frames[static_cast<std::size_t>(number)], picture.value()), 35.0)
                << number;
        }
    }

    Studio m_studio;
};

TEST_F(FilmProgram, MakesAFilmOfTheFramesThatARecordingDraws) {
    for (const char* const name : {"a.mp4", "a.gif"}) {
        const Ended ended = run(record(12, {"--size", "320x180", "--video", name}));
        ASSERT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(ended.out, HasSubstr(std::string(name) +
                                         ": 12 frames of 320 x 180 pixels, 10 a second, 1.2 s"));
        const DecodedFilm film = decodeFilm(m_studio / name);
        expectSameFrames(film, 12);
        EXPECT_NEAR(film.seconds, 1.2, 0.001);
    }
}

TEST_F(FilmProgram, LeavesFramesAndPageAsTheyAreWithoutAFilm) {
    ASSERT_EQ(run(record(3, {"--out", "plain"})).exit_code, 0);
    ASSERT_EQ(run(record(3, {"--video", "a.mp4"})).exit_code, 0);
    for (const char* const name : {"house000.png", "house002.png", "house.html"})
        EXPECT_EQ(readFile(m_studio / "plain" / name), readFile(m_studio / "out" / name)) << name;
}

TEST_F(FilmProgram, MakesAFilmOfAFolder) {
    ASSERT_EQ(run(record(8, {"--size", "320x180"})).exit_code, 0);
    const Ended ended = film({"out", "a.webm", "--fps", "4"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, HasSubstr("a.webm: 8 frames"));
    const DecodedFilm made = decodeFilm(m_studio / "a.webm");
    expectSameFrames(made, 8);
    EXPECT_NEAR(made.seconds, 2.0, 0.001);
}

TEST_F(FilmProgram, RefusesAFilmBeforeItReadsTheModel) {
    writeFile(m_studio / "there.mp4", "somebody's");
    const std::pair<std::string, std::string> refused[] = {
        {"there.mp4", "--overwrite"},
        {"a.mov", ".mp4, .webm, .gif, .webp or .apng"},
        {"nowhere/a.mp4", "there is no folder nowhere"}};
    for (const auto& [name, why] : refused) {
        const Ended ended = run(m_studio.turntableOf("absent.obj", 3, {"--video", name}));
        EXPECT_EQ(ended.exit_code, 1);
        EXPECT_THAT(ended.err, HasSubstr(why));
        EXPECT_THAT(ended.err, Not(HasSubstr("absent.obj")));
    }
    EXPECT_EQ(readFile(m_studio / "there.mp4"), "somebody's");
    EXPECT_FALSE(fs::exists(m_studio / "out"));
}

TEST_F(FilmProgram, ReplacesAFilmWithOverwrite) {
    writeFile(m_studio / "a.mp4", "earlier");
    ASSERT_EQ(run(record(3, {"--video", "a.mp4", "--overwrite"})).exit_code, 0);
    EXPECT_EQ(decodeFilm(m_studio / "a.mp4").frames.size(), 3U);
    EXPECT_EQ(film({"out", "a.mp4"}).exit_code, 1);
    EXPECT_EQ(film({"out", "a.mp4", "--overwrite"}).exit_code, 0);
}

TEST_F(FilmProgram, PutsAFilmIntoTheFolderThatItMakes) {
    ASSERT_EQ(run(record(3, {"--video", "out/a.mp4"})).exit_code, 0);
    EXPECT_EQ(decodeFilm(m_studio / "out/a.mp4").frames.size(), 3U);
}

TEST_F(FilmProgram, TakesOptionsOfAFilmWithAFilmAlone) {
    const std::vector<std::string> alone[] = {
        {"--fps", "10"}, {"--video-quality", "50"}, {"--width", "32"}};
    for (const auto& options : alone) {
        const Ended ended = run(record(3, options));
        EXPECT_EQ(ended.exit_code, 2);
        EXPECT_THAT(ended.err, HasSubstr(options[0] + " is for a film"));
    }
    EXPECT_EQ(run(record(3, {"--video", "a.mp4", "--fps", "61"})).exit_code, 2);
    EXPECT_EQ(run(record(3, {"--video", "a.mp4", "--caption"})).exit_code, 2);
}

TEST_F(FilmProgram, ThatIsStoppedLeavesAFilmOfTheFramesUntilThen) {
    for (const char* const name : {"a.mp4", "a.gif"}) {
        RunningProgram running(record(3000, {"--video", name, "--overwrite"}));
        ASSERT_TRUE(running.waitUntil([&] { return fs::exists(m_studio / "out/house010.png"); }));
        running.sendSignal(SIGINT);
        const Ended ended = running.wait();
        EXPECT_EQ(ended.exit_code, 130);
        EXPECT_THAT(ended.err, HasSubstr(name));
        const DecodedFilm film = decodeFilm(m_studio / name);
        EXPECT_EQ(static_cast<int>(film.frames.size()), pictureCount(m_studio / "out"));
        fs::remove_all(m_studio / "out");
    }
}

TEST_F(FilmProgram, KeepsTheFramesOfARecordingWhoseFilmCannotBeWritten) {
    Start start = m_studio.turntable(60, {"--video", "a.apng"});
    start.largest_file = 20000;
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("a.apng is not written"));
    EXPECT_EQ(pictureCount(m_studio / "out"), 60);
    EXPECT_TRUE(fs::exists(m_studio / "out/house.html"));
    EXPECT_FALSE(fs::exists(m_studio / "a.apng"));
}

TEST_F(FilmProgram, ShowsAScriptThatMakesTheSameFilm) {
    const Ended shown = run(record(3, {"--video", "a.mp4", "--fps", "15", "--video-quality", "90",
                                       "--width", "32", "--show-script"}));
    EXPECT_THAT(shown.out,
                HasSubstr("_-Film _FrameRate 15 _Quality 90 _Width 32 _NextRecording \"a.mp4\"\n"
                          "_-NextRecording _IfSame _Enter\n_-RecordAnimation "));
    writeFile(m_studio / "steps.txt", shown.out);
    fs::create_directory(m_studio / "out");
    Start start;
    start.folder = m_studio.path();
    start.arguments = {"run", "steps.txt"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const DecodedFilm film = decodeFilm(m_studio / "a.mp4");
    ASSERT_EQ(film.frames.size(), 3U) << film.trouble;
    EXPECT_EQ(film.frames[0].width, 32);
    EXPECT_NEAR(film.seconds, 0.2, 0.001);
}

TEST_F(FilmProgram, BurnsTheTimesOfASunStudyInWhileItIsRecordedAndLater) {
    Start start;
    start.folder = m_studio.path();
    start.arguments = {"day",     "house.obj", "--place",  "Athens", "--date",   "2026-06-21",
                       "--from",  "11:00",     "--to",     "13:00",  "--every",  "60",
                       "--size",  "320x180",   "--out",    "out",    "--format", "png",
                       "--video", "a.apng",    "--caption"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    ASSERT_EQ(film({"out", "b.apng", "--caption"}).exit_code, 0);
    ASSERT_EQ(film({"out", "plain.apng"}).exit_code, 0);
    const DecodedFilm recorded = decodeFilm(m_studio / "a.apng");
    const DecodedFilm later = decodeFilm(m_studio / "b.apng");
    const DecodedFilm plain = decodeFilm(m_studio / "plain.apng");
    ASSERT_EQ(recorded.frames.size(), 3U);
    for (std::size_t i = 0; i < 3; ++i) {
        EXPECT_EQ(psnr(recorded.frames[i], later.frames.at(i)), 99.0);
        EXPECT_LT(psnr(recorded.frames[i], plain.frames.at(i)), 40.0);
    }
}

} // namespace
} // namespace quarn::test
