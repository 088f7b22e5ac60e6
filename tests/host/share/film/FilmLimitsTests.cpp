#include "tests/host/share/film/FilmStudio.h"

#include <csignal>
#include <gmock/gmock.h>
#include <sys/resource.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

/// No file grows beyond this while it lives, as on a full disk.
class LargestFile {
public:
    explicit LargestFile(rlim_t bytes) : m_signal(std::signal(SIGXFSZ, SIG_IGN)) {
        getrlimit(RLIMIT_FSIZE, &m_before);
        const rlimit limit{bytes, m_before.rlim_max};
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~LargestFile() {
        setrlimit(RLIMIT_FSIZE, &m_before);
        std::signal(SIGXFSZ, m_signal);
    }
    LargestFile(const LargestFile&) = delete;
    LargestFile& operator=(const LargestFile&) = delete;

private:
    void (*m_signal)(int);
    rlimit m_before{};
};

class FilmOnAFullDisk : public testing::TestWithParam<std::string> {};

INSTANTIATE_TEST_SUITE_P(Films, FilmOnAFullDisk,
                         testing::Values(".mp4", ".webm", ".gif", ".webp", ".apng"),
                         [](const auto& kind) { return kind.param.substr(1); });

TEST_P(FilmOnAFullDisk, IsToldAndLeavesNothing) {
    FilmStudio studio;
    writeFile(studio / "before", "");
    const LargestFile full(1500);
    const auto made = studio.film("house" + GetParam(), 30);
    ASSERT_FALSE(made);
    EXPECT_THAT(made.message(), HasSubstr("house" + GetParam()));
    EXPECT_THAT(made.message(), HasSubstr("File too large"));
    EXPECT_EQ(studio.fileCount(), 1);
}

class FilmOfManyFrames : public testing::TestWithParam<std::string> {};

INSTANTIATE_TEST_SUITE_P(Films, FilmOfManyFrames, testing::Values(".mp4", ".gif"),
                         [](const auto& kind) { return kind.param.substr(1); });

/// 10,000 frames of 96 x 54 pixels are 207 MB.
TEST_P(FilmOfManyFrames, TakesNoMoreMemoryThanOneOfSome) {
    constexpr int FRAMES = 10000;
    constexpr long MOST_KB = 100 << 10;
    FilmStudio studio;
    ASSERT_TRUE(studio.film("some" + GetParam(), 50, 96, 54));
    const auto most_kb = [] {
        rusage usage{};
        getrusage(RUSAGE_SELF, &usage);
        return usage.ru_maxrss;
    };
    const long before_kb = most_kb();
    const auto made = studio.film("many" + GetParam(), FRAMES, 96, 54);
    ASSERT_TRUE(made) << made.message();
    EXPECT_LT(most_kb() - before_kb, MOST_KB);
    EXPECT_THAT(made.value().text.ToUtf8(), HasSubstr("10000 frames"));
    EXPECT_EQ(decodeFilm(studio / ("many" + GetParam())).frames.size(), FRAMES);
}

} // namespace
} // namespace quarn::test
