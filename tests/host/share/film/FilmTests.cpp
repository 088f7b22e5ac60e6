#include "tests/host/share/film/FilmStudio.h"

#include <fstream>
#include <gmock/gmock.h>
#include <thread>
#include <unistd.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

/// What a thread may still do that has encoded its frame.
constexpr std::uint64_t FALLING_ASLEEP_NS = 500'000;

/// For how many nanoseconds all threads of this process but the calling one have run.
std::uint64_t workOfOtherThreads() {
    std::uint64_t sum_ns = 0;
    for (const auto& thread : std::filesystem::directory_iterator("/proc/self/task")) {
        std::uint64_t work_ns = 0;
        std::ifstream(thread.path() / "schedstat") >> work_ns;
        if (thread.path().filename() != std::to_string(gettid()))
            sum_ns += work_ns;
    }
    return sum_ns;
}

class EachKindOfFilm : public testing::TestWithParam<std::string> {
protected:
    std::string name() const { return "house" + GetParam(); }
    FilmStudio m_studio;
};

INSTANTIATE_TEST_SUITE_P(Films, EachKindOfFilm,
                         testing::Values(".mp4", ".webm", ".gif", ".webp", ".apng"),
                         [](const auto& kind) { return kind.param.substr(1); });

TEST_P(EachKindOfFilm, ShowsEveryFrameAsItWasForAsLongAsItShould) {
    constexpr int FRAMES = 30;
    const auto made = m_studio.film(name(), FRAMES);
    ASSERT_TRUE(made) << made.message();
    const DecodedFilm film = decodeFilm(m_studio / name());
    ASSERT_EQ(film.trouble, "");
    ASSERT_EQ(film.frames.size(), FRAMES);
    EXPECT_NEAR(film.seconds, 1.5, 0.001);
    for (int frame = 0; frame < FRAMES; ++frame)
        EXPECT_GT(psnr(film.frames[frame], pictureOf(320, 180, frame)), 35.0) << frame;
    EXPECT_EQ(m_studio.fileCount(), 1);
}

TEST_P(EachKindOfFilm, MayHaveOneFrame) {
    const auto made = m_studio.film(name(), 1);
    ASSERT_TRUE(made) << made.message();
    const DecodedFilm film = decodeFilm(m_studio / name());
    ASSERT_EQ(film.frames.size(), 1U) << film.trouble;
    EXPECT_GT(psnr(film.frames[0], pictureOf(320, 180, 0)), 35.0);
    if (GetParam() != ".webp" &&
        GetParam() != ".apng") { // which are pictures that stand still then
        EXPECT_NEAR(film.seconds, 1.0 / RATE, 0.001);
    }
}

TEST_P(EachKindOfFilm, OfOddSidesKeepsEveryPixel) {
    const auto made = m_studio.film(name(), 3, 161, 91);
    ASSERT_TRUE(made) << made.message();
    const DecodedFilm film = decodeFilm(m_studio / name());
    ASSERT_EQ(film.frames.size(), 3U) << film.trouble;
    const bool is_even = GetParam() == ".mp4" || GetParam() == ".webm";
    const Image& shown = film.frames[2];
    ASSERT_EQ(shown.width, is_even ? 162 : 161);
    ASSERT_EQ(shown.height, is_even ? 92 : 91);
    const Image whole = pictureOf(161, 91, 2);
    Image expected;
    expected.resize(shown.width, shown.height);
    for (int y = 0; y < expected.height; ++y)
        for (int x = 0; x < expected.width; ++x)
            std::ranges::copy(whole.pixel(std::min(x, 160), std::min(y, 90)),
                              expected.rgba.begin() +
                                  4 * (static_cast<std::ptrdiff_t>(y) * expected.width + x));
    EXPECT_GT(psnr(shown, expected), 35.0);
}

TEST_P(EachKindOfFilm, IsScaledToTheWidthThatIsAskedFor) {
    FilmWish wish = m_studio.wish(name());
    wish.width_px = 160;
    ASSERT_TRUE(m_studio.film(wish, 2, 320, 180));
    const DecodedFilm film = decodeFilm(wish.file);
    ASSERT_EQ(film.frames.size(), 2U) << film.trouble;
    EXPECT_GT(psnr(film.frames[1], pictureOf(160, 90, 1)), 25.0); // edges fall between pixels
}

TEST_P(EachKindOfFilm, IsNeverWiderThanItsFrames) {
    FilmWish wish = m_studio.wish(name());
    wish.width_px = 4000;
    ASSERT_TRUE(m_studio.film(wish, 2, 64, 36));
    const DecodedFilm film = decodeFilm(wish.file);
    ASSERT_EQ(film.frames.size(), 2U) << film.trouble;
    EXPECT_EQ(film.frames[0].width, 64);
}

TEST_P(EachKindOfFilm, LeavesNothingBehindWhereNotAllOfItIsMade) {
    {
        FilmMaking making({m_studio.wish(name()), 20, RATE, 1}, m_studio.frontEnd());
        for (int frame = 0; frame < 5; ++frame)
            ASSERT_TRUE(making.add(pictureOf(320, 180, frame), ""));
        EXPECT_EQ(m_studio.fileCount(), 1); // under another name
    }
    EXPECT_EQ(m_studio.fileCount(), 0);
}

TEST_P(EachKindOfFilm, IsEncodedBetweenItsFramesWhereNoThreadMayWorkBesideThem) {
    FilmMaking making({m_studio.wish(name()), 20, RATE, 0}, m_studio.frontEnd());
    for (int frame = 0; frame < 3; ++frame) {
        ASSERT_TRUE(making.add(pictureOf(640, 360, frame), ""));
        const std::uint64_t work_ns = workOfOtherThreads();
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        EXPECT_LT(workOfOtherThreads() - work_ns, FALLING_ASLEEP_NS) << frame;
    }
    ASSERT_TRUE(making.finish());
    EXPECT_EQ(decodeFilm(m_studio / name()).frames.size(), 3U);
}

TEST_P(EachKindOfFilm, OfFramesOfSeveralSizesIsRefused) {
    FilmMaking making({m_studio.wish(name()), 20, RATE, 1}, m_studio.frontEnd());
    ASSERT_TRUE(making.add(pictureOf(320, 180, 0), ""));
    const auto added = making.add(pictureOf(320, 200, 1), "");
    ASSERT_FALSE(added);
    EXPECT_THAT(added.message(), HasSubstr("320 x 200"));
    EXPECT_THAT(added.message(), HasSubstr("320 x 180"));
}

TEST_P(EachKindOfFilm, MayHaveAnyNameThatAFileMayHave) {
    const std::string odd = "pipe:1 'a',[b];%d\\\xC3\xBC" + GetParam();
    const auto made = m_studio.film(odd, 3);
    ASSERT_TRUE(made) << made.message();
    EXPECT_EQ(decodeFilm(m_studio / odd).frames.size(), 3U);
}

TEST_P(EachKindOfFilm, TellsWhatItHolds) {
    const auto made = m_studio.film(name(), 30);
    ASSERT_TRUE(made) << made.message();
    const std::string text = made.value().text.ToUtf8();
    EXPECT_THAT(text, HasSubstr((m_studio / name()).native()));
    EXPECT_THAT(text, HasSubstr("30 frames of 320 x 180 pixels, 20 a second, 1.5 s long"));
}

TEST(Film, AsMp4BeginsWithItsIndexAndPlaysEverywhere) {
    FilmStudio studio;
    ASSERT_TRUE(studio.film("house.mp4", 40));
    const DecodedFilm film = decodeFilm(studio / "house.mp4");
    EXPECT_EQ(film.encoding, "h264");
    EXPECT_EQ(film.pixels, "yuv420p");
    EXPECT_TRUE(film.has_video_colours);
    const std::string bytes = readFile(studio / "house.mp4");
    ASSERT_NE(bytes.find("moov"), bytes.npos);
    EXPECT_LT(bytes.find("moov"), bytes.find("mdat"));
}

/// With another matrix, or read in another range, strong colours are off by 10 and more.
TEST(Film, AsVideoHasTheColoursOfItsFrames) {
    constexpr std::uint8_t COLOURS[][3] = {{200, 30, 30}, {30, 160, 60}, {40, 60, 210}, {9, 9, 9}};
    Image frame;
    frame.resize(256, 64);
    for (std::size_t i = 0; i < frame.rgba.size(); ++i)
        frame.rgba[i] = i % 4 == 3 ? 255 : COLOURS[i / 4 % 256 / 64][i % 4];
    FilmStudio studio;
    for (const char* const name : {"a.mp4", "a.webm"}) {
        FilmMaking making({studio.wish(name), 1, RATE, 1}, studio.frontEnd());
        ASSERT_TRUE(making.add(frame, ""));
        ASSERT_TRUE(making.finish());
        const Image shown = decodeFilm(studio / name).frames.at(0);
        for (int block = 0; block < 4; ++block)
            for (std::size_t part = 0; part < 3; ++part)
                EXPECT_NEAR(shown.pixel(64 * block + 32, 32)[part], COLOURS[block][part], 4)
                    << name << ", block " << block;
    }
}

TEST(Film, AsWebmIsVp9) {
    FilmStudio studio;
    ASSERT_TRUE(studio.film("house.webm", 10));
    const DecodedFilm film = decodeFilm(studio / "house.webm");
    EXPECT_EQ(film.encoding, "vp9");
    EXPECT_EQ(film.pixels, "yuv420p");
}

TEST(Film, AsGifIsAtMost640WideUnlessAskedFor) {
    FilmStudio studio;
    ASSERT_TRUE(studio.film("small.gif", 2, 1280, 720));
    EXPECT_EQ(decodeFilm(studio / "small.gif").frames.at(0).width, 640);
    EXPECT_EQ(decodeFilm(studio / "small.gif").frames.at(0).height, 360);
    FilmWish wish = studio.wish("large.gif");
    wish.width_px = 1280;
    ASSERT_TRUE(studio.film(wish, 2, 1280, 720));
    EXPECT_EQ(decodeFilm(wish.file).frames.at(0).width, 1280);
}

/// Frames of a GIF say with a bit whether they have a palette of their own.
TEST(Film, AsGifHasOnePaletteForAllFramesAndRunsForEver) {
    FilmStudio studio;
    ASSERT_TRUE(studio.film("house.gif", 12));
    const std::string bytes = readFile(studio / "house.gif");
    ASSERT_EQ(bytes.substr(0, 6), "GIF89a");
    EXPECT_EQ(static_cast<unsigned char>(bytes[10]) & 0x87, 0x87); // 256 colours for all
    EXPECT_NE(bytes.find("NETSCAPE2.0"), bytes.npos);
    int frames = 0;
    for (std::size_t at = bytes.find("\x21\xF9\x04"); at != bytes.npos;
         at = bytes.find("\x21\xF9\x04", at + 1)) {
        const std::size_t descriptor = at + 8;
        ASSERT_EQ(bytes.at(descriptor), 0x2C);
        if (frames > 0) { // the encoder writes the first one's colours with it too
            EXPECT_EQ(bytes.at(descriptor + 9) & 0x80, 0) << frames;
        }
        ++frames;
    }
    EXPECT_EQ(frames, 12);
}

TEST(Film, IsSmallerWithLessQualityAndBetterWithMore) {
    FilmStudio studio;
    for (const char* const kind : {".mp4", ".webm", ".gif", ".webp"}) {
        FilmWish low = studio.wish(std::string("low") + kind);
        low.quality = 5;
        FilmWish high = studio.wish(std::string("high") + kind);
        high.quality = 95;
        ASSERT_TRUE(studio.film(low, 6) && studio.film(high, 6)) << kind;
        EXPECT_LT(std::filesystem::file_size(low.file), std::filesystem::file_size(high.file))
            << kind;
        EXPECT_LT(psnr(decodeFilm(low.file).frames.at(3), pictureOf(320, 180, 3)) + 1.0,
                  psnr(decodeFilm(high.file).frames.at(3), pictureOf(320, 180, 3)))
            << kind;
    }
}

TEST(Film, ReplacesAFileOnlyOnceItIsWhole) {
    FilmStudio studio;
    writeFile(studio / "house.mp4", "earlier");
    {
        FilmMaking making({studio.wish("house.mp4"), 2, RATE, 1}, studio.frontEnd());
        ASSERT_TRUE(making.add(pictureOf(320, 180, 0), ""));
        EXPECT_EQ(readFile(studio / "house.mp4"), "earlier");
        ASSERT_TRUE(making.finish());
    }
    EXPECT_EQ(decodeFilm(studio / "house.mp4").frames.size(), 1U);
}

TEST(Film, OfNoFrameIsNotWritten) {
    FilmStudio studio;
    const auto made = studio.film("house.mp4", 0);
    ASSERT_FALSE(made);
    EXPECT_THAT(made.message(), HasSubstr("there is no frame"));
    EXPECT_EQ(studio.fileCount(), 0);
}

} // namespace
} // namespace quarn::test
