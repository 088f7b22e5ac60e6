#include "host/share/film/FilmWish.h"

#include "host/share/film/FilmCaption.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

/// A module whose libraries lack some encoder.
class PoorModule final : public FilmModule {
public:
    std::string missingEncoder(FilmKind kind) const override {
        return kind == FilmKind::mp4 ? "libx264" : "";
    }
    Result<std::unique_ptr<FilmWriter>> open(const FilmForm&,
                                             const std::filesystem::path&) const override {
        return Error{"not asked for"};
    }
};

class CheckedFilm : public testing::Test {
protected:
    FilmWish wish(const std::string& name) const {
        FilmWish wish;
        wish.file = m_folder / name;
        return wish;
    }
    static std::string refusal(const FilmWish& wish) {
        const auto checked = checkFilm(wish, filmModule());
        return checked ? "" : checked.message();
    }

    TempFolder m_folder;
};

TEST_F(CheckedFilm, MayBeOfEachKindInAnyCase) {
    for (const char* const name : {"a.mp4", "a.MP4", "a.webm", "a.gif", "a.WebP", "a.apng"})
        EXPECT_EQ(refusal(wish(name)), "") << name;
}

TEST_F(CheckedFilm, OfAnotherExtensionIsRefusedWithTheOnesThereAre) {
    for (const char* const name : {"a.mov", "a.png", "a", ".mp4"})
        EXPECT_THAT(refusal(wish(name)), HasSubstr(".mp4, .webm, .gif, .webp or .apng")) << name;
}

TEST_F(CheckedFilm, AsGifShowsAtMost50FramesASecond) {
    FilmWish quick = wish("a.gif");
    quick.frame_rate = 50;
    EXPECT_EQ(refusal(quick), "");
    quick.frame_rate = 51;
    EXPECT_THAT(refusal(quick), HasSubstr("at most 50"));
}

TEST_F(CheckedFilm, ThatLosesNothingHasNoQuality) {
    FilmWish exact = wish("a.apng");
    exact.quality = 50;
    EXPECT_THAT(refusal(exact), HasSubstr("keeps every pixel"));
}

TEST_F(CheckedFilm, ReplacesAFileOnlyWhereThatIsAllowed) {
    FilmWish film = wish("a.mp4");
    writeFile(film.file, "somebody's");
    EXPECT_THAT(refusal(film), HasSubstr("--overwrite"));
    film.may_replace = true;
    EXPECT_EQ(refusal(film), "");
}

TEST_F(CheckedFilm, NeverReplacesAFolder) {
    FilmWish film = wish("a.mp4");
    film.may_replace = true;
    std::filesystem::create_directory(film.file);
    EXPECT_THAT(refusal(film), HasSubstr("is not replaced"));
}

TEST_F(CheckedFilm, NeedsAFolderThatIsThereOrWillBe) {
    const FilmWish film = wish("to come/a.mp4");
    EXPECT_THAT(refusal(film), HasSubstr("to come. Make it first."));
    EXPECT_TRUE(checkFilm(film, filmModule(), m_folder / "to come"));
    EXPECT_TRUE(checkFilm(film, filmModule(), m_folder / "to come/"));
    EXPECT_FALSE(checkFilm(film, filmModule(), m_folder / "another"));
}

TEST_F(CheckedFilm, NeedsAFolderThatTakesFiles) {
    FilmWish film;
    film.file = "/proc/a.mp4";
    EXPECT_THAT(refusal(film), HasSubstr("Choose another one."));
}

TEST_F(CheckedFilm, WithoutItsEncoderNamesThePackageThatHasIt) {
    const PoorModule poor;
    const auto checked = checkFilm(wish("a.mp4"), &poor);
    ASSERT_FALSE(checked);
    EXPECT_THAT(checked.message(), HasSubstr("libx264"));
    EXPECT_THAT(checked.message(), HasSubstr("libavcodec59"));
    EXPECT_TRUE(checkFilm(wish("a.gif"), &poor));
}

TEST_F(CheckedFilm, WithoutItsModuleSaysWhatToInstall) {
    const auto checked = checkFilm(wish("a.mp4"), Error{"Install libavfilter8"});
    ASSERT_FALSE(checked);
    EXPECT_THAT(checked.message(), HasSubstr("a.mp4 is not written: Install libavfilter8."));
}

TEST_F(CheckedFilm, LeavesNothingInItsFolder) {
    EXPECT_EQ(refusal(wish("a.mp4")), "");
    EXPECT_TRUE(std::filesystem::is_empty(m_folder.path()));
}

TEST(FilmSize, KeepsTheProportionsOfTheFrames) {
    const FilmKindFacts& gif = *filmKindOf("a.gif");
    const FilmSize scaled = filmSize(gif, {1280, 720}, 0);
    EXPECT_EQ(scaled.width_px, 640);
    EXPECT_EQ(scaled.height_px, 360);
    EXPECT_EQ(filmSize(gif, {1280, 1}, 0).height_px, 1);
    EXPECT_EQ(filmSize(gif, {1000, 1000}, 333).height_px, 333);
}

TEST(FilmSize, OfVideosIsEven) {
    const FilmKindFacts& mp4 = *filmKindOf("a.mp4");
    EXPECT_EQ(filmSize(mp4, {1, 1}, 0).width_px, 2);
    EXPECT_EQ(filmSize(mp4, {1279, 719}, 0).height_px, 720);
    EXPECT_EQ(filmSize(mp4, {1280, 720}, 333).width_px, 334);
}

TEST(FilmCaption, TellsDateTimeAndZone) {
    const FrameSun afternoon{"2026-06-21T14:30:00", "UTC+1", 0.0, 0.0};
    EXPECT_EQ(captionOf(afternoon, "a.mp4").value(), "2026-06-21  14:30  UTC+1");
    const FrameSun odd{"2026-06-21T14:30:15", "UTC-3:30", 0.0, 0.0};
    EXPECT_EQ(captionOf(odd, "a.mp4").value(), "2026-06-21  14:30:15  UTC-3:30");
}

} // namespace
} // namespace quarn::test
