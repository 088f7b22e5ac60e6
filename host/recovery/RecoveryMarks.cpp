#include "host/recovery/RecoveryMarks.h"

#include "ground/AtomicFile.h"
#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/front_end/StateFolder.h"

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <span>
#include <string>
#include <string_view>
#include <system_error>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr const char* EXTENSION = ".mark";

fs::path freeName(const fs::path& folder, const ProcessIdentity& writer) {
    const std::string stem = writer.host + "-" + std::to_string(writer.pid);
    std::error_code ignored;
    fs::path file = folder / (stem + EXTENSION);
    for (int number = 2; fs::exists(file, ignored); ++number)
        file = folder / (stem + "-" + std::to_string(number) + EXTENSION);
    return file;
}

/// Takes what stands before the next zero; paths hold every byte but that one.
std::string_view takeField(std::string_view& text) {
    const std::size_t end = text.find('\0');
    const std::string_view field = text.substr(0, end);
    text.remove_prefix(end == text.npos ? text.size() : end + 1);
    return field;
}

template <class Number> bool readNumber(std::string_view text, Number& number) {
    const char* const end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, number);
    return read.ec == std::errc() && read.ptr == end;
}

} // namespace

fs::path recoveryFolder(const fs::path& state_folder) {
    return state_folder / "recovery";
}

fs::path unfinishedRecovery(const fs::path& recovery) {
    return recovery.native() + ".new";
}

Result<fs::path> writeMark(const fs::path& folder, const RecoveryMark& mark) {
    if (!makeStateFolder(folder))
        return Error{"the folder '" + textFromPath(folder).ToUtf8() + "' cannot be made"};
    std::string text;
    for (const std::string& field :
         {mark.writer.host, std::to_string(mark.writer.pid), std::to_string(mark.writer.started),
          mark.recovery.native(), mark.document.native()})
        text += field + '\0';
    const fs::path file = freeName(folder, mark.writer);
    if (const auto written = writeFileAtomically(file, std::as_bytes(std::span(text))); !written)
        return written.error();
    return file;
}

std::optional<RecoveryMark> readMark(const fs::path& file) {
    const auto bytes = readFileBytes(file);
    if (!bytes)
        return std::nullopt;
    const auto read = bytes.value().bytes();
    std::string_view text(reinterpret_cast<const char*>(read.data()), read.size());
    constexpr std::ptrdiff_t fields = 5;
    if (!text.ends_with('\0') || std::ranges::count(text, '\0') != fields)
        return std::nullopt;
    RecoveryMark mark;
    mark.writer.host = takeField(text);
    const bool has_numbers = readNumber(takeField(text), mark.writer.pid) &&
                             readNumber(takeField(text), mark.writer.started);
    mark.recovery = takeField(text);
    mark.document = takeField(text);
    if (!has_numbers || !mark.recovery.is_absolute())
        return std::nullopt;
    return mark;
}

std::vector<fs::path> marksIn(const fs::path& folder) {
    std::vector<fs::path> marks;
    std::error_code error;
    for (fs::directory_iterator at(folder, error), end; !error && at != end; at.increment(error))
        if (at->path().extension() == EXTENSION)
            marks.push_back(at->path());
    return marks;
}

void removeRecovery(const fs::path& mark) {
    std::error_code ignored;
    if (const auto read = readMark(mark)) {
        fs::remove(unfinishedRecovery(read->recovery), ignored);
        fs::remove(read->recovery, ignored);
    }
    fs::remove(mark, ignored);
}

} // namespace quarn
