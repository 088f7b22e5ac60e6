#include "ground/Checksum.h"

#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

namespace quarn::test {
namespace {

std::uint64_t checksumOf(const std::string& text) {
    Checksum sum;
    sum.addBytes(std::as_bytes(std::span(text)));
    return sum.value();
}

// The published values of the algorithm's own description (xxHash fast digest algorithm, section
// "Test vectors" of its reference programs, seed 0).
TEST(ChecksumTest, IsThePublishedOne) {
    EXPECT_EQ(checksumOf(""), 0xEF46DB3751D8E999U);
    EXPECT_EQ(checksumOf("a"), 0xD24EC4F1A98C6E5BU);
    EXPECT_EQ(checksumOf("abc"), 0x44BC2CF5AD770999U);
}

TEST(ChecksumTest, TellsTextsThatFollowEachOtherFromOthers) {
    Checksum one;
    one.addText("ab");
    one.addText("c");
    Checksum other;
    other.addText("a");
    other.addText("bc");
    EXPECT_NE(one.value(), other.value());
}

TEST(ChecksumTest, OfAFileIsThatOfItsBytesWhateverItsLength) {
    const TempFolder folder;
    std::string bytes(700'001, '\0'); // more than two pieces
    for (std::size_t i = 0; i < bytes.size(); ++i)
        bytes[i] = static_cast<char>(i * 7 % 251);
    writeFile(folder / "long", bytes);
    const auto sum = checksumOfFile(folder / "long");
    ASSERT_TRUE(sum);
    EXPECT_EQ(sum.value().bytes, bytes.size());
    EXPECT_EQ(sum.value().xxh64, checksumOf(bytes));
}

TEST(ChecksumTest, OfAFileThatIsMissingIsAnError) {
    const TempFolder folder;
    const auto sum = checksumOfFile(folder / "none");
    ASSERT_FALSE(sum);
    EXPECT_EQ(sum.message(), "No such file or directory");
}

TEST(ChecksumTest, HasSixteenDigitsAsText) {
    EXPECT_EQ(checksumText(0xABC), "0000000000000abc");
    EXPECT_EQ(checksumText(0xEF46DB3751D8E999U), "ef46db3751d8e999");
}

} // namespace
} // namespace quarn::test
