#include "import/transfer/ReaderMessages.h"

#include "ground/Fields.h"

#include <cmath>

namespace quarn {

namespace {

/// Told apart by what follows it whenever a message or the block changes.
constexpr std::int32_t LAYOUT = 3;
/// Of a message's text; the rest of the packet is room for its other fields.
constexpr std::size_t MOST_TEXT_BYTES = MOST_MESSAGE_BYTES - 1024;

using Bytes = std::vector<std::uint8_t>;

Bytes bytesOf(const std::string& text) {
    return {text.begin(), text.end()};
}

template <class Step, class AnyRequest, class AnyBytes>
bool requestFields(Step step, AnyRequest& request, AnyBytes& path) {
    return step(path) && step(request.up, UpAxis::by_format, UpAxis::z) &&
           step(request.tolerance) &&
           step.check(std::isfinite(request.tolerance) && request.tolerance >= 0.0) &&
           step(request.most_threads) && step.check(request.most_threads >= 0);
}

template <class Step, class AnyAnswer, class AnyBytes>
bool answerFields(Step step, AnyAnswer& answer, AnyBytes& message) {
    return step(answer.kind, ReaderAnswer::Kind::progress, ReaderAnswer::Kind::refused) &&
           step(answer.step, ReadingStep::read, ReadingStep::made) && step(answer.share) &&
           step.check(answer.share >= 0.0 && answer.share <= 1.0) && step(message);
}

} // namespace

std::optional<Bytes> encodeRequest(const ReaderRequest& request) {
    const Bytes path = bytesOf(request.path.native());
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    if (path.size() > MOST_TEXT_BYTES || !archive.WriteInt(LAYOUT) ||
        !requestFields(FieldWriter(archive), request, path) ||
        !archive.WriteInt64(static_cast<std::int64_t>(request.most_memory)))
        return std::nullopt;
    return archive.TakeBytes();
}

std::optional<ReaderRequest> decodeRequest(std::span<const std::uint8_t> bytes) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(bytes);
    ReaderRequest request;
    std::int32_t layout = 0;
    Bytes path;
    std::int64_t memory = 0;
    if (!archive.ReadInt(layout) || layout != LAYOUT ||
        !requestFields(FieldReader(archive), request, path) || !archive.ReadInt64(memory) ||
        memory < 0)
        return std::nullopt;
    request.path = std::string(path.begin(), path.end());
    request.most_memory = static_cast<std::uint64_t>(memory);
    return request;
}

Bytes encodeAnswer(const ReaderAnswer& answer) {
    const Bytes message = bytesOf(answer.message.substr(0, MOST_TEXT_BYTES));
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    answerFields(FieldWriter(archive), answer, message);
    return archive.TakeBytes();
}

std::optional<ReaderAnswer> decodeAnswer(std::span<const std::uint8_t> bytes) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(bytes);
    ReaderAnswer answer;
    Bytes message;
    if (!answerFields(FieldReader(archive), answer, message))
        return std::nullopt;
    answer.message = std::string(message.begin(), message.end());
    return answer;
}

} // namespace quarn
