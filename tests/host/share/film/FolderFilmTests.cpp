#include "host/share/film/FolderFilm.h"

#include "host/letters/Letters.h"
#include "host/recording/FramesManifest.h"
#include "tests/host/share/film/FilmStudio.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

/// Asks the program to stop once so much of the film is done.
class ImpatientFrontEnd final : public ScriptedFrontEnd {
public:
    explicit ImpatientFrontEnd(double share) : m_share(share) {}
    void sharedFileProgress(const std::filesystem::path&, double share) override {
        if (share >= m_share)
            interrupt();
    }

private:
    double m_share;
};

class FilmOfAFolder : public testing::Test {
protected:
    FilmOfAFolder() { std::filesystem::create_directory(m_folder / "frames"); }

    std::filesystem::path fileOf(int number) const {
        return m_folder / "frames" /
               ("house" +
                std::string(number < 10    ? "00"
                            : number < 100 ? "0"
                                           : "") +
                std::to_string(number) + ".png");
    }
    void writeFrame(int number, int width = 96, int height = 54) const {
        ASSERT_TRUE(writeImageFile(fileOf(number), pictureOf(width, height, number % 100)));
    }
    void writeFrames(int count) const {
        for (int number = 0; number < count; ++number)
            writeFrame(number);
    }
    FilmWish wish(const std::string& name) const {
        FilmWish wish;
        wish.file = m_folder / name;
        return wish;
    }
    Result<SharedFileReport> make(const FilmWish& wish) {
        return makeFilmOfFolder(m_folder / "frames", wish, m_front_end);
    }
    /// Writes the list of frames, with the sun of each.
    void writeStudy(int count) const {
        FramesManifest manifest;
        manifest.name = "house";
        manifest.kind = "one_day_sun";
        manifest.frames = count;
        manifest.extension = "png";
        manifest.frame_rate = 12;
        for (int number = 0; number < count; ++number) {
            ManifestFrame frame;
            frame.number = number;
            frame.file = fileOf(number).filename().native();
            frame.bytes = std::filesystem::file_size(fileOf(number));
            frame.sun = FrameSun{"2026-06-21T1" + std::to_string(number) + ":30:00", "UTC+1", 1, 2};
            manifest.images.push_back(frame);
        }
        ASSERT_TRUE(writeFramesManifest(m_folder / "frames" / manifestName("house"), manifest));
    }

    TempFolder m_folder;
    ScriptedFrontEnd m_front_end;
};

TEST_F(FilmOfAFolder, ShowsFramesInTheOrderOfTheirNumbers) {
    for (const int number : {0, 3, 999, 1000})
        writeFrame(number);
    const auto made = make(wish("house.apng"));
    ASSERT_TRUE(made) << made.message();
    const DecodedFilm film = decodeFilm(m_folder / "house.apng");
    ASSERT_EQ(film.frames.size(), 4U);
    EXPECT_EQ(psnr(film.frames[1], pictureOf(96, 54, 3)), 99.0);
    EXPECT_EQ(psnr(film.frames[2], pictureOf(96, 54, 99)), 99.0);
    EXPECT_EQ(psnr(film.frames[3], pictureOf(96, 54, 0)), 99.0);
}

TEST_F(FilmOfAFolder, LastsFourSecondsWhereThereAreFramesEnough) {
    writeFrames(80);
    ASSERT_TRUE(make(wish("house.mp4")));
    EXPECT_NEAR(decodeFilm(m_folder / "house.mp4").seconds, 4.0, 0.001);
}

TEST_F(FilmOfAFolder, HasTheFrameRateThatIsAskedFor) {
    writeFrames(6);
    FilmWish film = wish("house.mp4");
    film.frame_rate = 3;
    ASSERT_TRUE(make(film));
    EXPECT_NEAR(decodeFilm(film.file).seconds, 2.0, 0.001);
}

TEST_F(FilmOfAFolder, WithACutFrameIsRefusedWithItsName) {
    writeFrames(3);
    std::filesystem::resize_file(fileOf(1), std::filesystem::file_size(fileOf(1)) / 2);
    const auto made = make(wish("house.mp4"));
    ASSERT_FALSE(made);
    EXPECT_THAT(made.message(), HasSubstr("house001.png"));
    EXPECT_FALSE(std::filesystem::exists(m_folder / "house.mp4"));
}

TEST_F(FilmOfAFolder, WithFramesOfSeveralSizesIsRefused) {
    writeFrames(2);
    writeFrame(2, 54, 96);
    const auto made = make(wish("house.gif"));
    ASSERT_FALSE(made);
    EXPECT_THAT(made.message(), HasSubstr("54 x 96"));
    EXPECT_FALSE(std::filesystem::exists(m_folder / "house.gif"));
}

TEST_F(FilmOfAFolder, WithoutFramesIsRefused) {
    const auto made = make(wish("house.mp4"));
    ASSERT_FALSE(made);
    EXPECT_THAT(made.message(), HasSubstr("frames"));
}

TEST_F(FilmOfAFolder, WhoseListIsDamagedGoesByTheNamesOfTheFramesAndSaysSo) {
    writeFrames(2);
    writeFile(m_folder / "frames" / manifestName("house"), "{\"images\": [");
    const auto made = make(wish("house.mp4"));
    ASSERT_TRUE(made) << made.message();
    EXPECT_EQ(decodeFilm(m_folder / "house.mp4").frames.size(), 2U);
    EXPECT_FALSE(m_front_end.printed().empty());
}

TEST_F(FilmOfAFolder, ThatIsStoppedPlaysWhatThereIsByThen) {
    writeFrames(20);
    for (const char* const name : {"house.mp4", "house.gif"}) {
        ImpatientFrontEnd impatient(0.5 * 7 / 20);
        const auto made = makeFilmOfFolder(m_folder / "frames", wish(name), impatient);
        ASSERT_TRUE(made) << made.message();
        EXPECT_EQ(decodeFilm(m_folder / name).frames.size(), 7U) << name;
    }
}

TEST_F(FilmOfAFolder, AsGifMayBeStoppedWhileItsColoursAreChosen) {
    const FilmForm form{FilmKind::gif, 96, 54, 10, 80, 1, {}};
    writeFile(m_folder / "house.gif", "");
    const auto film = filmModule().value()->open(form, m_folder / "house.gif");
    ASSERT_TRUE(film) << film.message();
    for (int frame = 0; frame < 5; ++frame)
        ASSERT_TRUE(film.value()->add(pictureOf(96, 54, frame), ""));
    film.value()->endSoon();
    ASSERT_TRUE(film.value()->finish());
    EXPECT_EQ(decodeFilm(m_folder / "house.gif").frames.size(), 1U);
}

/// Where the plate of a caption lies, and where there is none.
struct Corner {
    int white = 0;
    int changed = 0;
};

Corner lowerLeftOf(const Image& shown, const Image& plain, int from_y) {
    Corner corner;
    for (int y = from_y; y < shown.height; ++y)
        for (int x = 0; x < shown.width; ++x) {
            const auto pixel = shown.pixel(x, y);
            corner.white += pixel[0] > 240 && pixel[1] > 240 && pixel[2] > 240;
            corner.changed += !std::ranges::equal(pixel, plain.pixel(x, y));
        }
    return corner;
}

TEST_F(FilmOfAFolder, HasItsTimesInWhiteOnADarkPlateInTheLowerLeftCorner) {
    for (int number = 0; number < 3; ++number)
        writeFrame(number, 640, 360);
    writeStudy(3);
    FilmWish film = wish("house.apng");
    film.has_caption = true;
    const auto made = make(film);
    ASSERT_TRUE(made) << made.message();
    const DecodedFilm shown = decodeFilm(film.file);
    ASSERT_EQ(shown.frames.size(), 3U);
    for (int number = 0; number < 3; ++number) {
        const Image plain = pictureOf(640, 360, number);
        const Corner all = lowerLeftOf(shown.frames[number], plain, 0);
        const Corner low = lowerLeftOf(shown.frames[number], plain, 310);
        EXPECT_EQ(all.changed, low.changed); // the rest is as it was
        EXPECT_GT(low.white, 200);
        EXPECT_GT(low.changed, 5000);
        EXPECT_LT(low.changed, 10000);
    }
    const auto plate = [&](int number) {
        return std::vector(shown.frames[number].rgba.end() - 4 * 640 * 40,
                           shown.frames[number].rgba.end());
    };
    EXPECT_NE(plate(0), plate(1)); // another hour
    EXPECT_NEAR(shown.seconds, 3.0 / 12, 0.001);
}

TEST_F(FilmOfAFolder, ThatTellsNoTimesHasNone) {
    writeFrames(2);
    FilmWish film = wish("house.mp4");
    film.has_caption = true;
    const auto made = make(film);
    ASSERT_FALSE(made);
    EXPECT_THAT(made.message(), HasSubstr("tell no date and time"));
}

TEST_F(FilmOfAFolder, HasItsTimesWhereverTheFontIsInstalled) {
    const auto odd = m_folder / "it's: [a], \\folder;";
    std::filesystem::create_directory(odd);
    std::filesystem::copy_file(programFont(), odd / "font.ttf");
    writeFile(m_folder / "house.apng", "");
    const FilmForm form{FilmKind::apng, 640, 360, 10, 80, 1, odd / "font.ttf"};
    const auto film = filmModule().value()->open(form, m_folder / "house.apng");
    ASSERT_TRUE(film) << film.message();
    ASSERT_TRUE(film.value()->add(pictureOf(640, 360, 0), "%{pts}: it's 50% \\o/"));
    ASSERT_TRUE(film.value()->finish());
    const Image shown = decodeFilm(m_folder / "house.apng").frames.at(0);
    EXPECT_GT(lowerLeftOf(shown, pictureOf(640, 360, 0), 310).white, 100);
}

} // namespace
} // namespace quarn::test
