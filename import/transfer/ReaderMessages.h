#pragma once

#include "import/ImportedModel.h"
#include "import/ReadingWatch.h"

#include <cstdint>
#include <filesystem>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace quarn {

// What the host and the program that reads a model file for it say to each other, each message a
// packet of its own. Both belong to one installation; a program of another one refuses the request.

/// The descriptors that the reading program finds open when it starts.
inline constexpr int READER_SOCKET = 3; ///< of packets; its end ends the program
inline constexpr int READER_BLOCK = 4;  ///< an empty SharedBlock

/// The longest packet. What cannot be said in as many bytes is cut.
inline constexpr std::size_t MOST_MESSAGE_BYTES = 16 << 10;

/// What is to be read, and how: as ReadingOptions has it.
struct ReaderRequest {
    std::filesystem::path path;
    UpAxis up = UpAxis::by_format;
    double tolerance = 0.0;
    std::uint64_t most_memory = 0; ///< bytes, below 2^63
    std::int32_t most_threads = 0; ///< that read; 0: as many as the machine has processors
};

/// What the program answers: any number of times how far it is, then how it ended.
struct ReaderAnswer {
    enum class Kind : std::int32_t {
        progress,
        done,    ///< the model is in the block
        refused, ///< the file cannot be read: `message` says why
    };
    Kind kind = Kind::progress;
    ReadingStep step = ReadingStep::read;
    double share = 0.0;
    std::string message;
};

/// @return nothing for a path that is too long
std::optional<std::vector<std::uint8_t>> encodeRequest(const ReaderRequest& request);
/// @return nothing for bytes that are no request of this installation
std::optional<ReaderRequest> decodeRequest(std::span<const std::uint8_t> bytes);

std::vector<std::uint8_t> encodeAnswer(const ReaderAnswer& answer);
/// @return nothing for bytes that are no answer
std::optional<ReaderAnswer> decodeAnswer(std::span<const std::uint8_t> bytes);

} // namespace quarn
