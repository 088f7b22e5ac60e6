// Stands where the program that reads model files does, and behaves as badly as the name of the
// file asks for. Fences itself behind nothing: it is the host that is tried.
#include "import/transfer/ModelTransfer.h"
#include "import/transfer/ReaderMessages.h"

#include <array>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <map>
#include <sys/mman.h>
#include <sys/socket.h>
#include <thread>
#include <unistd.h>

namespace {

using namespace quarn;

void send(const std::vector<std::uint8_t>& bytes) {
    ::send(READER_SOCKET, bytes.data(), bytes.size(), MSG_NOSIGNAL);
}

void refuse(const std::string& message) {
    send(encodeAnswer({ReaderAnswer::Kind::refused, ReadingStep::read, 0.0, message}));
}

void claimToBeDone() {
    send(encodeAnswer({ReaderAnswer::Kind::done, ReadingStep::made, 1.0, {}}));
}

void hang() {
    send(encodeAnswer({ReaderAnswer::Kind::progress, ReadingStep::made, 0.25, {}}));
    for (;;)
        std::this_thread::sleep_for(std::chrono::hours(1));
}

void takeMemory() {
    constexpr std::size_t STEP_BYTES = std::size_t{16} << 20;
    for (;;) {
        auto* const bytes = static_cast<volatile char*>(std::malloc(STEP_BYTES));
        for (std::size_t i = 0; bytes && i < STEP_BYTES; i += 4096)
            bytes[i] = 1;
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
}

void fillBlock() {
    SharedBlock block(READER_BLOCK);
    const std::vector<std::uint8_t> zeros(std::size_t{16} << 20);
    while (block.append(zeros))
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
}

/// Reads on in a file that somebody makes shorter meanwhile.
void readMapped(const std::filesystem::path& path) {
    const int file = open(path.c_str(), O_RDONLY);
    const auto size = std::filesystem::file_size(path);
    const auto* const bytes =
        static_cast<const volatile char*>(mmap(nullptr, size, PROT_READ, MAP_SHARED, file, 0));
    for (;;) {
        [[maybe_unused]] const char last = bytes[size - 1];
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
}

void handOverNonsense() {
    SharedBlock block(READER_BLOCK);
    const std::vector<std::uint8_t> nonsense(1000, 0xAB);
    if (block.append(nonsense))
        claimToBeDone();
}

void talkNonsense() {
    for (;;)
        send(std::vector<std::uint8_t>(64, 0xFF));
}

void tellForEver() {
    for (;;)
        send(encodeAnswer({ReaderAnswer::Kind::progress, ReadingStep::read, 0.5, {}}));
}

/// Refuses with a list of what it has inherited.
void listDescriptors() {
    std::string list;
    for (int number = 0; number < 1024; ++number)
        if (fcntl(number, F_GETFD) >= 0)
            list += std::to_string(number) + " ";
    refuse(list);
}

void listEnvironment() {
    std::string list;
    for (char** variable = environ; *variable; ++variable)
        list += std::string(*variable) + " ";
    refuse(list);
}

void behave(const std::filesystem::path& path) {
    const std::map<std::string, void (*)()> behaviours = {
        {"hang", hang},
        {"crash", [] { std::raise(SIGSEGV); }},
        {"leave", [] {}},
        {"take_memory", takeMemory},
        {"fill_block", fillBlock},
        {"hand_over_nothing", claimToBeDone},
        {"hand_over_nonsense", handOverNonsense},
        {"talk_nonsense", talkNonsense},
        {"tell_for_ever", tellForEver},
        {"list_descriptors", listDescriptors},
        {"list_environment", listEnvironment},
        {"say_name", [] { refuse(program_invocation_name); }},
        {"say_nothing", [] { refuse(""); }},
    };
    if (path.stem() == "read_mapped")
        readMapped(path);
    const auto found = behaviours.find(path.stem().string());
    if (found != behaviours.end())
        found->second();
}

} // namespace

int main() {
    std::vector<std::uint8_t> bytes(MOST_MESSAGE_BYTES);
    const ssize_t count = recv(READER_SOCKET, bytes.data(), bytes.size(), 0);
    if (count <= 0)
        return 2;
    const auto request = decodeRequest(std::span(bytes).first(static_cast<std::size_t>(count)));
    if (request)
        behave(request->path);
    return 0;
}
