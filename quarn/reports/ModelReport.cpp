#include "quarn/reports/ModelReport.h"

#include "quarn/session/Interruption.h"
#include "quarn/words/Words.h"

#include <chrono>
#include <cmath>
#include <type_traits>

namespace quarn::program {

namespace {

/// A number of bytes in the unit that suits it: "812 bytes", "1.5 MB".
std::string byteCountText(std::uintmax_t bytes) {
    if (bytes < 1000)
        return std::to_string(bytes) + " bytes";
    constexpr const char* UNITS[] = {" kB", " MB", " GB", " TB"};
    double count = static_cast<double>(bytes) / 1000.0;
    int unit = 0;
    for (; count >= 999.95 && unit < 3; ++unit)
        count /= 1000.0;
    return numberText(std::round(count * 10.0) / 10.0) + UNITS[unit];
}

std::string formatName(const std::filesystem::path& model) {
    std::string extension = model.extension().native();
    if (extension.empty())
        return "unknown";
    extension.erase(0, 1);
    for (char& c : extension)
        c = c >= 'a' && c <= 'z' ? static_cast<char>(c - 32) : c;
    return extension;
}

std::string millisecondsText(std::chrono::steady_clock::duration time) {
    const double milliseconds = std::chrono::duration<double, std::milli>(time).count();
    return numberText(std::round(milliseconds)) + " ms";
}

/// What is known of the file without its contents.
std::string fileReport(const std::filesystem::path& model,
                       std::chrono::steady_clock::duration read_time) {
    std::error_code error;
    const std::uintmax_t size = std::filesystem::file_size(model, error);
    return "name: " + model.filename().native() + "\nformat: " + formatName(model) +
           "\nfile size: " + (error ? error.message() : byteCountText(size)) +
           "\nread in: " + millisecondsText(read_time) + "\n";
}

/// Which axis was taken as up, and why; empty for a document, which knows its axes.
std::string upReport(HostSession& host, const std::string& format) {
    const auto& up = host.session().lastUpAxis();
    if (!up)
        return {};
    using Reason = std::decay_t<decltype(up->reason)>;
    const bool is_y = up->axis == std::decay_t<decltype(up->axis)>::y;
    const std::string axis = is_y ? "y" : "z";
    const std::string other = std::string("; ") + (is_y ? "--up z" : "--up y") + " turns it";
    if (up->reason == Reason::habit)
        return "up: " + axis + ", as in most " + format + " files" + other + "\n";
    if (up->reason == Reason::writer)
        return "up: " + axis + ", as " + up->writer + " writes " + format + " files" + other + "\n";
    return "up: " + axis + "\n";
}

} // namespace

Outcome reportModel(const std::filesystem::path& model, const CommonOptions& common) {
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common);
    const auto start = std::chrono::steady_clock::now();
    if (const auto trouble = host.readModel(model))
        return *trouble;
    const auto read_time = std::chrono::steady_clock::now() - start;
    front_end.keepWords();
    if (const auto trouble = host.run("_-List _Objects"))
        return *trouble;
    return Outcome::success(fileReport(model, read_time) + upReport(host, formatName(model)) +
                            front_end.takeKeptWords());
}

} // namespace quarn::program
