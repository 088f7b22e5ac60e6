#include "import/transfer/ReaderMessages.h"

#include <gtest/gtest.h>

namespace quarn::test {

TEST(ReaderMessages, RequestsArriveAsTheyWereAlsoWithPathsThatAreNoText) {
    const ReaderRequest request{"folder/\xff\xfe.obj", UpAxis::y, 0.25, 123456789, 3};
    const auto bytes = encodeRequest(request);
    ASSERT_TRUE(bytes);
    const auto arrived = decodeRequest(*bytes);
    ASSERT_TRUE(arrived);
    EXPECT_EQ(arrived->path, request.path);
    EXPECT_EQ(arrived->up, request.up);
    EXPECT_EQ(arrived->tolerance, request.tolerance);
    EXPECT_EQ(arrived->most_memory, request.most_memory);
    EXPECT_EQ(arrived->most_threads, request.most_threads);
}

TEST(ReaderMessages, ARequestWithAPathThatNoPacketHoldsIsNotMade) {
    EXPECT_FALSE(encodeRequest({.path = std::string(MOST_MESSAGE_BYTES, 'a')}));
}

TEST(ReaderMessages, AnswersArriveAsTheyWere) {
    const ReaderAnswer answer{ReaderAnswer::Kind::refused, ReadingStep::made, 0.5, "No such file."};
    const auto arrived = decodeAnswer(encodeAnswer(answer));
    ASSERT_TRUE(arrived);
    EXPECT_EQ(arrived->kind, answer.kind);
    EXPECT_EQ(arrived->step, answer.step);
    EXPECT_EQ(arrived->share, answer.share);
    EXPECT_EQ(arrived->message, answer.message);
}

TEST(ReaderMessages, AnAnswerFitsAPacketHoweverMuchItHasToSay) {
    const auto bytes =
        encodeAnswer({ReaderAnswer::Kind::refused, {}, 0.0, std::string(1'000'000, 'a')});
    EXPECT_LE(bytes.size(), MOST_MESSAGE_BYTES);
    EXPECT_TRUE(decodeAnswer(bytes));
}

TEST(ReaderMessages, BytesThatSayNothingAreRefused) {
    const auto bytes = encodeAnswer({ReaderAnswer::Kind::done, {}, 1.0, "text"});
    for (std::size_t length = 0; length < bytes.size(); ++length)
        EXPECT_FALSE(decodeAnswer(std::span(bytes).first(length))) << length;
    auto kinds = bytes;
    kinds[0] = 3;
    EXPECT_FALSE(decodeAnswer(kinds));
    EXPECT_FALSE(decodeRequest(bytes));
}

} // namespace quarn::test
