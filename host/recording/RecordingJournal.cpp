#include "host/recording/RecordingJournal.h"

#include "ground/PathText.h"
#include "host/recording/ManifestFrameJson.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <fstream>
#include <iterator>
#include <random>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace quarn {

namespace {

namespace fs = std::filesystem;
using json = ManifestJson;

constexpr const char* FORMAT_NAME = "quarn-journal";
constexpr int FORMAT_VERSION = 1;
constexpr std::string_view EXTENSION = ".journal";

std::string lineOf(const json& object) {
    return object.dump(-1, ' ', false, json::error_handler_t::replace) + "\n";
}

JournalHead headOf(const json& object) {
    if (object.at("format") != FORMAT_NAME ||
        integerOf<std::int64_t>(object.at("version")) > FORMAT_VERSION)
        throw std::out_of_range("format");
    const json& writer = object.at("writer");
    return {fileNameOf(object.at("name")),
            {writer.at("host"), intOf(writer.at("pid")),
             integerOf<std::uint64_t>(writer.at("started"))},
            {object.at("program"), object.at("document"), object.at("settings"),
             object.at("instructions")},
            finiteOf(object.at("loading_s"))};
}

void takeLine(const json& object, RecordingJournal& journal) {
    if (object.contains("ended")) {
        journal.has_ended = true;
        journal.trouble = object.at("trouble");
        return;
    }
    journal.frames.push_back({manifestFrameOf(object), finiteOf(object.at("seconds"))});
}

Error about(const fs::path& file, const wchar_t* text) {
    return {KM_wString::FormatToString(text, textFromPath(file).Array()).ToUtf8()};
}

Error isNoJournal(const fs::path& file) {
    return about(file, QnLocalizeString(L"%s is damaged, or no journal of a recording.", 42852));
}

Error notWritten(const fs::path& file, int error) {
    return {KM_wString::FormatToString(
                QnLocalizeString(L"The journal %s cannot be written: %s.", 42853),
                textFromPath(file).Array(),
                KM_wString::FromUtf8(std::generic_category().message(error)).Array())
                .ToUtf8()};
}

/// Programs on machines of one name, as containers are, may have one number too.
std::string nameOf(const JournalHead& head) {
    static std::random_device random;
    constexpr unsigned MOST = 0xFFFFFF;
    char number[8];
    std::snprintf(number, sizeof number, "%06x", random() & MOST);
    return head.animation + "." + head.writer.host + "-" + std::to_string(head.writer.pid) + "-" +
           number + std::string(EXTENSION);
}

} // namespace

std::string journalHeadLine(const JournalHead& head) {
    return lineOf(
        {{"format", FORMAT_NAME},
         {"version", FORMAT_VERSION},
         {"name", head.animation},
         {"writer",
          {{"host", head.writer.host}, {"pid", head.writer.pid}, {"started", head.writer.started}}},
         {"program", head.fingerprint.program},
         {"document", head.fingerprint.document},
         {"settings", head.fingerprint.settings},
         {"instructions", head.fingerprint.instructions},
         {"loading_s", head.loading_seconds}});
}

std::string journalFrameLine(const JournalFrame& frame) {
    json object = jsonOf(frame.frame);
    object["seconds"] = frame.seconds;
    return lineOf(object);
}

std::string journalEndLine(const std::string& trouble) {
    return lineOf({{"ended", true}, {"trouble", trouble}});
}

Result<void> JournalReader::take(std::string_view text) {
    try {
        for (std::size_t end = text.find('\n'); end != text.npos; end = text.find('\n')) {
            const json object = json::parse(text.substr(0, end));
            if (hasHead())
                takeLine(object, m_content);
            else
                m_content.head = headOf(object);
            text.remove_prefix(end + 1);
            m_read_bytes += end + 1;
        }
    } catch (const json::exception&) {
        return isNoJournal(m_file);
    } catch (const std::out_of_range&) {
        return isNoJournal(m_file);
    }
    return {};
}

Result<void> JournalReader::readOn() {
    std::ifstream stream(m_file, std::ios::binary);
    stream.seekg(static_cast<std::streamoff>(m_read_bytes));
    const std::string added{std::istreambuf_iterator<char>(stream), {}};
    if (stream.bad() || !stream.is_open())
        return isNoJournal(m_file);
    return take(added);
}

std::vector<fs::path> journalsIn(const fs::path& folder, const std::string& animation) {
    std::vector<fs::path> files;
    const std::string start = animation + ".";
    std::error_code error;
    for (fs::directory_iterator at(folder, error), end; !error && at != end; at.increment(error)) {
        const std::string name = at->path().filename().native();
        if (name.starts_with(start) && name.ends_with(EXTENSION))
            files.push_back(at->path());
    }
    std::ranges::sort(files);
    return files;
}

Result<JournalWriter> JournalWriter::create(const fs::path& folder, const JournalHead& head) {
    constexpr int most_tries = 100; // of names that are taken
    fs::path file;
    int descriptor = -1;
    for (int tries = 0; tries < most_tries && descriptor < 0; ++tries) {
        file = folder / nameOf(head);
        descriptor = open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_APPEND | O_CLOEXEC, 0666);
        if (descriptor < 0 && errno != EEXIST)
            break;
    }
    if (descriptor < 0)
        return notWritten(file, errno);
    JournalWriter writer(file, descriptor);
    if (auto written = writer.append(journalHeadLine(head)); !written) {
        writer.remove();
        return written.error();
    }
    return writer;
}

JournalWriter::JournalWriter(JournalWriter&& other) noexcept
    : m_file(std::move(other.m_file)), m_descriptor(std::exchange(other.m_descriptor, -1)) {}

JournalWriter& JournalWriter::operator=(JournalWriter&& other) noexcept {
    std::swap(m_file, other.m_file);
    std::swap(m_descriptor, other.m_descriptor);
    return *this;
}

JournalWriter::~JournalWriter() {
    if (m_descriptor >= 0)
        close(m_descriptor);
}

/// By one write, so that a line is whole or the last one.
Result<void> JournalWriter::append(const std::string& line) const {
    const off_t before = lseek(m_descriptor, 0, SEEK_END);
    const ssize_t written = write(m_descriptor, line.data(), line.size());
    if (written == static_cast<ssize_t>(line.size()))
        return {};
    const int error = written < 0 ? errno : ENOSPC;
    if (written > 0 && before >= 0)
        (void)ftruncate(m_descriptor, before); // a part of a line would spoil the next one
    return notWritten(m_file, error);
}

fs::file_time_type JournalWriter::renew() const {
    (void)futimens(m_descriptor, nullptr);
    std::error_code error;
    const auto now = fs::last_write_time(m_file, error);
    return error ? fs::file_time_type::clock::now() : now;
}

void JournalWriter::remove() const {
    std::error_code error;
    fs::remove(m_file, error);
}

bool isWriterAlive(const JournalReader& journal, fs::file_time_type now,
                   std::chrono::seconds lease) {
    const RecordingJournal& content = journal.content();
    const ProcessIdentity& writer = content.head.writer;
    if (content.has_ended ||
        (journal.hasHead() && (hasEnded(writer) || writer == currentProcess())))
        return false;
    std::error_code error;
    const auto renewed = fs::last_write_time(journal.file(), error);
    return !error && now - renewed < lease;
}

} // namespace quarn
