#include "host/reader/ReaderProcess.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <fstream>
#include <poll.h>
#include <spawn.h>
#include <string>
#include <string_view>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>
#include <utility>
#include <vector>

namespace quarn {

namespace {

/// Descriptors are moved up here first, so that none of them stands where another one belongs.
constexpr int ABOVE_READERS_OWN = 16;

/// Where libraries are, which words and characters they use, how a build that looks for faults is
/// told what to do. What else the environment holds is none of the reader's business.
constexpr std::string_view PASSED_ON[] = {"LD_", "LC_", "LANG", "ASAN_", "UBSAN_", "CSF_"};

/// The C library asks for large pages under all that the reader takes: its arrays, which it fills
/// once, then take less time to fill.
char large_pages[] = "GLIBC_TUNABLES=glibc.malloc.hugetlb=1";

std::vector<char*> readersEnvironment() {
    std::vector<char*> passed = {large_pages};
    for (char** variable = environ; *variable; ++variable)
        for (const std::string_view beginning : PASSED_ON)
            if (std::string_view(*variable).starts_with(beginning))
                passed.push_back(*variable);
    passed.push_back(nullptr);
    return passed;
}

/// A descriptor that is closed at the end of its life.
class Descriptor {
public:
    explicit Descriptor(int number) : m_number(number) {}
    ~Descriptor() {
        if (m_number >= 0)
            close(m_number);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;
    int number() const { return m_number; }
    int release() { return std::exchange(m_number, -1); }

private:
    int m_number;
};

/// What the program finds: nothing but its own descriptors, no signal blocked or passed over, no
/// terminal that could reach it.
class Beginning {
public:
    Beginning(int socket, int block) {
        posix_spawn_file_actions_init(&m_actions);
        posix_spawn_file_actions_addopen(&m_actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_addopen(&m_actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
        posix_spawn_file_actions_addopen(&m_actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
        posix_spawn_file_actions_adddup2(&m_actions, socket, READER_SOCKET);
        posix_spawn_file_actions_adddup2(&m_actions, block, READER_BLOCK);
        posix_spawn_file_actions_addclosefrom_np(&m_actions, READER_BLOCK + 1);
        posix_spawnattr_init(&m_attributes);
        sigset_t signals;
        sigemptyset(&signals);
        posix_spawnattr_setsigmask(&m_attributes, &signals);
        sigfillset(&signals);
        posix_spawnattr_setsigdefault(&m_attributes, &signals);
        posix_spawnattr_setpgroup(&m_attributes, 0);
        posix_spawnattr_setflags(&m_attributes, POSIX_SPAWN_SETSIGMASK | POSIX_SPAWN_SETSIGDEF |
                                                    POSIX_SPAWN_SETPGROUP);
    }
    ~Beginning() {
        posix_spawn_file_actions_destroy(&m_actions);
        posix_spawnattr_destroy(&m_attributes);
    }
    Beginning(const Beginning&) = delete;
    Beginning& operator=(const Beginning&) = delete;

    /// @return the process, or -1 with errno set
    pid_t start(const std::filesystem::path& program) const {
        // Whole: a program looks for what belongs to it from where its name says that it is.
        std::string name = program.string();
        std::array<char*, 2> arguments = {name.data(), nullptr};
        pid_t process = -1;
        errno = posix_spawn(&process, program.c_str(), &m_actions, &m_attributes, arguments.data(),
                            readersEnvironment().data());
        return errno == 0 ? process : -1;
    }

private:
    posix_spawn_file_actions_t m_actions{};
    posix_spawnattr_t m_attributes{};
};

Error lastError() {
    return {std::strerror(errno)};
}

} // namespace

Result<ReaderProcess> ReaderProcess::start(const std::filesystem::path& program) {
    Result<SharedBlock> block = SharedBlock::make();
    if (!block)
        return block.error();
    int sockets[2] = {-1, -1};
    if (socketpair(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0, sockets) != 0)
        return lastError();
    Descriptor own(sockets[0]);
    const Descriptor theirs(sockets[1]);
    const Descriptor their_socket(fcntl(theirs.number(), F_DUPFD_CLOEXEC, ABOVE_READERS_OWN));
    const Descriptor their_block(
        fcntl(block.value().descriptor(), F_DUPFD_CLOEXEC, ABOVE_READERS_OWN));
    if (their_socket.number() < 0 || their_block.number() < 0)
        return lastError();
    const pid_t process = Beginning(their_socket.number(), their_block.number()).start(program);
    if (process < 0)
        return lastError();
    return ReaderProcess(process, own.release(), std::move(block.value()));
}

ReaderProcess::ReaderProcess(ReaderProcess&& other) noexcept
    : m_program(std::exchange(other.m_program, -1)), m_socket(std::exchange(other.m_socket, -1)),
      m_block(std::move(other.m_block)) {}

ReaderProcess::~ReaderProcess() {
    end();
    if (m_socket >= 0)
        close(m_socket);
}

bool ReaderProcess::ask(const ReaderRequest& request) {
    const auto bytes = encodeRequest(request);
    return bytes && send(m_socket, bytes->data(), bytes->size(), MSG_NOSIGNAL) >= 0;
}

ReaderProcess::News ReaderProcess::wait(std::chrono::milliseconds longest) {
    pollfd waiting{m_socket, POLLIN, 0};
    if (poll(&waiting, 1, static_cast<int>(longest.count())) <= 0)
        return {};
    std::array<std::uint8_t, MOST_MESSAGE_BYTES> bytes;
    const ssize_t count = recv(m_socket, bytes.data(), bytes.size(), MSG_DONTWAIT);
    if (count < 0 && (errno == EAGAIN || errno == EINTR))
        return {};
    if (count > 0)
        if (auto answer = decodeAnswer(std::span(bytes).first(static_cast<std::size_t>(count))))
            return {News::Kind::answer, std::move(*answer)};
    return {News::Kind::ended, {}};
}

std::uint64_t ReaderProcess::memory() const {
    std::uint64_t pages = 0;
    std::uint64_t resident = 0;
    std::uint64_t of_files = 0;
    std::ifstream("/proc/" + std::to_string(m_program) + "/statm") >> pages >> resident >> of_files;
    const std::uint64_t own = resident > of_files ? resident - of_files : 0;
    return own * static_cast<std::uint64_t>(sysconf(_SC_PAGESIZE)) + m_block.memory();
}

void ReaderProcess::kill() {
    if (m_program > 0)
        ::kill(m_program, SIGKILL);
}

int ReaderProcess::end() {
    if (m_program <= 0)
        return 0;
    // One that has ended already keeps its own end until it is waited for.
    kill();
    int status = 0;
    while (waitpid(m_program, &status, 0) < 0 && errno == EINTR)
        ;
    m_program = -1;
    return WIFSIGNALED(status) ? WTERMSIG(status) : 0;
}

} // namespace quarn
