#include "quarn/console/HistoryFile.h"

#include "ground/AtomicFile.h"
#include "host/front_end/StateFolder.h"
#include "quarn/words/Words.h"

#include <fcntl.h>
#include <fstream>
#include <unistd.h>

namespace quarn::program {

namespace {

std::vector<std::string> readLines(const std::filesystem::path& file) {
    std::vector<std::string> lines;
    std::ifstream stream(file, std::ios::binary);
    for (std::string line; std::getline(stream, line);) {
        if (!line.empty())
            lines.push_back(line);
    }
    return lines;
}

/// Makes the file hold these lines alone.
void replaceLines(const std::filesystem::path& file, const std::vector<std::string>& lines) {
    std::string bytes;
    for (const std::string& line : lines)
        bytes += line + '\n';
    (void)writeFileAtomically(file, std::as_bytes(std::span(bytes)));
}

} // namespace

HistoryFile::HistoryFile(std::filesystem::path file) : m_file(std::move(file)) {}

std::vector<std::wstring> HistoryFile::load() const {
    std::vector<std::string> lines = readLines(m_file);
    if (lines.size() > LINES_KEPT) {
        lines.erase(lines.begin(), lines.end() - LINES_KEPT);
        replaceLines(m_file, lines);
    }
    std::vector<std::wstring> texts;
    texts.reserve(lines.size());
    for (const std::string& line : lines)
        texts.push_back(wideText(line));
    return texts;
}

void HistoryFile::append(std::wstring_view line) const {
    if (m_file.empty())
        return;
    makeStateFolder(m_file.parent_path());
    const int descriptor = open(m_file.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0600);
    if (descriptor < 0)
        return;
    const std::string bytes = utf8Text(line) + "\n";
    [[maybe_unused]] const ssize_t written = write(descriptor, bytes.data(), bytes.size());
    close(descriptor);
}

std::filesystem::path historyPath() {
    const std::filesystem::path folder = userStateFolder();
    return folder.empty() ? folder : folder / "history";
}

} // namespace quarn::program
