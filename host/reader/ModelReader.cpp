#include "host/reader/ModelReader.h"

#include "ground/FreeMemory.h"
#include "host/reader/ReaderEnds.h"
#include "host/reader/ReaderProcess.h"
#include "host/reader/ReaderProgram.h"
#include "import/ModelFile.h"
#include "import/transfer/ModelTransfer.h"

#include <algorithm>
#include <optional>
#include <system_error>

namespace quarn {

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;
using std::chrono::milliseconds;

/// How often the reader's memory, the time and the person are looked at.
constexpr milliseconds BEAT{20};
constexpr milliseconds SHORTEST_LIMIT{60'000};
constexpr std::uint64_t BYTES_A_MILLISECOND = 10'000'000 / 30'000;
/// Where the system does not tell how much memory is free.
constexpr std::uint64_t MOST_MEMORY = std::uint64_t{1} << 62;
/// What a small model needs is tried also where hardly any memory is free.
constexpr std::uint64_t LEAST_MEMORY = std::uint64_t{64} << 20;

std::uint64_t memoryOf(const ModelReaderOptions& options) {
    if (options.most_memory > 0)
        return std::min(options.most_memory, MOST_MEMORY);
    return std::clamp(freeMemory() / 2, LEAST_MEMORY, MOST_MEMORY);
}

milliseconds timeOf(const ModelReaderOptions& options, const fs::path& path) {
    if (options.longest > milliseconds(0))
        return options.longest;
    std::error_code unknown;
    const std::uintmax_t bytes = fs::file_size(path, unknown);
    return longestReading(unknown ? 0 : bytes);
}

/// One file being read by a program that was started for it.
class Reading {
public:
    Reading(ReaderProcess& reader, const fs::path& path, const ModelReaderOptions& options)
        : m_reader(reader), m_path(path), m_options(options), m_most_memory(memoryOf(options)),
          m_longest(timeOf(options, path)) {}

    Result<ImportedModel> model() {
        const ReaderRequest request{m_path, m_options.up, m_options.tolerance, m_most_memory,
                                    m_options.most_threads};
        if (!m_reader.ask(request))
            return ended();
        for (;;) {
            const ReaderProcess::News news = m_reader.wait(BEAT);
            if (news.kind == ReaderProcess::News::Kind::ended)
                return ended();
            if (news.kind == ReaderProcess::News::Kind::answer &&
                news.answer.kind != ReaderAnswer::Kind::progress)
                return result(news.answer);
            if (news.kind == ReaderProcess::News::Kind::answer)
                m_progress = news.answer;
            if (const auto why = whyNoLonger())
                return *why;
        }
    }

private:
    Error ended() { return readerStopped(m_path, m_reader.end()); }

    Result<ImportedModel> result(const ReaderAnswer& answer) {
        m_reader.kill(); // it has nothing more to do, and shall do nothing more
        if (answer.kind == ReaderAnswer::Kind::refused)
            return answer.message.empty() ? readerStopped(m_path, 0) : Error{answer.message};
        if (m_reader.block().memory() > m_most_memory)
            return readingNeedsMore(m_path, m_most_memory);
        Result<ImportedModel> model = takeModel(m_reader.block());
        return model ? std::move(model) : cannotTakeModel(m_path, model.message());
    }

    /// Looks at what is spent, on the beat.
    std::optional<Error> whyNoLonger() {
        const Clock::time_point now = Clock::now();
        if (now < m_next_beat)
            return std::nullopt;
        m_next_beat = now + BEAT;
        if (m_reader.memory() > m_most_memory)
            return readingNeedsMore(m_path, m_most_memory);
        if (now - m_begin > m_longest)
            return readingTookTooLong(m_path, m_longest);
        if (m_options.watch && !m_options.watch->goesOn(m_progress.step, m_progress.share))
            return readingGivenUp(m_path);
        return std::nullopt;
    }

    ReaderProcess& m_reader;
    const fs::path& m_path;
    const ModelReaderOptions& m_options;
    std::uint64_t m_most_memory;
    milliseconds m_longest;
    Clock::time_point m_begin = Clock::now();
    Clock::time_point m_next_beat = m_begin + BEAT;
    ReaderAnswer m_progress;
};

} // namespace

milliseconds longestReading(std::uint64_t file_bytes) {
    return SHORTEST_LIMIT +
           milliseconds(static_cast<milliseconds::rep>(file_bytes / BYTES_A_MILLISECOND));
}

Result<ImportedModel> readModel(const fs::path& path, const ModelReaderOptions& options) {
    if (readsInside())
        return readModelFile(path, {.up = options.up,
                                    .tolerance = options.tolerance,
                                    .most_memory = memoryOf(options),
                                    .watch = options.watch});
    const Result<fs::path> program = readerProgram();
    if (!program)
        return program.error();
    Result<ReaderProcess> reader = ReaderProcess::start(program.value());
    if (!reader)
        return cannotStartReader(path, reader.message());
    return Reading(reader.value(), path, options).model();
}

} // namespace quarn
