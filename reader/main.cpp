// Reads one model file for the host that started it, and ends. It asks for nothing but what the
// socket tells, and answers there; the model goes into the block. docs/model-reader.md has more.
#include "import/ModelFile.h"
#include "import/transfer/ModelTransfer.h"
#include "import/transfer/ReaderMessages.h"
#include "reader/Fence.h"
#include "reader/ReaderLimits.h"

#include <tbb/global_control.h>

#include <cerrno>
#include <chrono>
#include <cstdio>
#include <sys/socket.h>
#include <unistd.h>

namespace {

using namespace quarn;

constexpr std::chrono::milliseconds NEWS_EVERY{50};

bool send(const ReaderAnswer& answer, int flags) {
    const std::vector<std::uint8_t> bytes = encodeAnswer(answer);
    return ::send(READER_SOCKET, bytes.data(), bytes.size(), flags | MSG_NOSIGNAL) >= 0 ||
           errno == EAGAIN;
}

/// Tells the host how far the reading is. News that the host has no time for are dropped.
class TellingWatch final : public ReadingWatch {
public:
    bool goesOn(ReadingStep step, double share) override {
        const auto now = std::chrono::steady_clock::now();
        if (now < m_next)
            return true;
        m_next = now + NEWS_EVERY;
        const bool is_share = share >= 0.0 && share <= 1.0;
        return send({ReaderAnswer::Kind::progress, step, is_share ? share : 0.0, {}}, MSG_DONTWAIT);
    }

private:
    std::chrono::steady_clock::time_point m_next = std::chrono::steady_clock::now() + NEWS_EVERY;
};

ReaderAnswer refusal(std::string message) {
    return {ReaderAnswer::Kind::refused, ReadingStep::read, 0.0, std::move(message)};
}

ReaderAnswer read(const ReaderRequest& request) {
    std::optional<tbb::global_control> limit;
    if (request.most_threads > 0)
        limit.emplace(tbb::global_control::max_allowed_parallelism,
                      static_cast<std::size_t>(request.most_threads));
    TellingWatch watch;
    Result<ImportedModel> model = readModelFile(request.path, {.up = request.up,
                                                               .tolerance = request.tolerance,
                                                               .most_memory = request.most_memory,
                                                               .watch = &watch});
    if (!model)
        return refusal(model.message());
    SharedBlock block(READER_BLOCK);
    const Result<void> written = writeModel(std::move(model.value()), block);
    if (!written)
        return refusal("Cannot read '" + request.path.string() + "': " + written.message() +
                       ". Use a smaller model.");
    return {ReaderAnswer::Kind::done, ReadingStep::made, 1.0, {}};
}

/// Waits until there is a file to read; nothing when the host is gone.
std::optional<ReaderRequest> receiveRequest() {
    std::vector<std::uint8_t> bytes(MOST_MESSAGE_BYTES);
    const ssize_t count = recv(READER_SOCKET, bytes.data(), bytes.size(), 0);
    return count > 0 ? decodeRequest(std::span(bytes).first(static_cast<std::size_t>(count)))
                     : std::nullopt;
}

int serve() {
    tieToParent();
    const std::optional<ReaderRequest> request = receiveRequest();
    if (!request) {
        std::fputs("quarn-reader reads model files for the other programs of Quarn, which start "
                   "it. It takes no orders from a person.\n",
                   stderr);
        return 2;
    }
    limitMemory(request->most_memory);
    raiseFence(request->path);
    send(read(*request), 0);
    return 0;
}

} // namespace

int main() {
    // Without giving anything back first: the system takes it all at once.
    _exit(serve());
}
