#pragma once

#include "ground/Result.h"
#include "import/transfer/ReaderMessages.h"
#include "import/transfer/SharedBlock.h"

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <sys/types.h>

namespace quarn {

/// The program that reads one model file, as long as it runs. It inherits nothing but its socket,
/// its block and those variables of the environment that libraries need, and it ends with this
/// object, with this process, and by no key of the terminal.
class ReaderProcess {
public:
    /// What came from the program.
    struct News {
        enum class Kind { nothing, answer, ended };
        Kind kind = Kind::nothing;
        ReaderAnswer answer;
    };

    /// Starts the program, which then waits for its request.
    /// @return an error, part of a sentence
    static Result<ReaderProcess> start(const std::filesystem::path& program);
    ReaderProcess(ReaderProcess&& other) noexcept;
    ReaderProcess& operator=(ReaderProcess&& other) = delete;
    ~ReaderProcess();

    /// @return false when the request cannot be made
    bool ask(const ReaderRequest& request);
    /// Waits for news. An answer that is none counts as the end.
    News wait(std::chrono::milliseconds longest);
    /// Bytes of memory that the program and its block take now, without the pages of files.
    std::uint64_t memory() const;
    SharedBlock& block() { return m_block; }
    /// Ends the program, unless it has ended, and waits for that.
    /// @return the signal that ended it, SIGKILL where this did; 0 for none
    int end();
    /// Ends the program without waiting for that.
    void kill();

private:
    ReaderProcess(pid_t program, int socket, SharedBlock block)
        : m_program(program), m_socket(socket), m_block(std::move(block)) {}

    pid_t m_program; ///< -1: has ended
    int m_socket;
    SharedBlock m_block;
};

} // namespace quarn
