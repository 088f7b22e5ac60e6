// Gives a fuzz target its seeds and every hostile file without a fuzzer. A target ends the program
// when a promise is broken, so a test passes by coming back.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size);

namespace {

using Bytes = std::vector<std::uint8_t>;

std::vector<std::filesystem::path> filesBelow(const std::filesystem::path& folder) {
    std::vector<std::filesystem::path> files;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder)) {
        if (entry.is_regular_file())
            files.push_back(entry.path());
    }
    std::ranges::sort(files);
    return files;
}

Bytes contentOf(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    EXPECT_TRUE(file) << path;
    return {std::istreambuf_iterator<char>(file), {}};
}

void replay(const Bytes& bytes) {
    EXPECT_EQ(LLVMFuzzerTestOneInput(bytes.data(), bytes.size()), 0);
}

void replayAllBelow(const std::filesystem::path& folder) {
    const auto files = filesBelow(folder);
    ASSERT_FALSE(files.empty()) << folder;
    for (const auto& file : files) {
        SCOPED_TRACE(file);
        replay(contentOf(file));
    }
}

} // namespace

TEST(Replay, SeedsAreSurvived) {
    replayAllBelow(QUARN_CORPUS);
}

TEST(Replay, HostileFilesAreSurvived) {
    replayAllBelow(QUARN_SOURCE_DIR "/tests/data/hostile");
}

// Long files are cut and flipped at places spread over them, so that each takes a moment at most.
TEST(Replay, SeedsCutAndFlippedAnywhereAreSurvived) {
    constexpr std::size_t places = 500;
    for (const auto& file : filesBelow(QUARN_CORPUS)) {
        SCOPED_TRACE(file);
        const Bytes seed = contentOf(file);
        for (std::size_t at = 0; at < seed.size(); at += seed.size() / places + 1) {
            Bytes flipped = seed;
            flipped[at] = static_cast<std::uint8_t>(~flipped[at]);
            replay(flipped);
            replay({seed.begin(), seed.begin() + static_cast<std::ptrdiff_t>(at)});
        }
    }
}
