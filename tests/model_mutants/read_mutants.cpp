// Reads damaged copies of small models, one after the other, as a person's program would, and tells
// what became of them. Ends with 1 where one ended or hung this program's reading for longer than
// it may take, or ended a reader of our own; such a file is kept.
#include "ground/FileBytes.h"
#include "host/reader/ModelReader.h"
#include "host/reader/ReaderEnds.h"
#include "import/ModelFormats.h"
#include "import/files/ModelFileCheck.h"
#include "tests/model_mutants/Mutator.h"
#include "tests/model_mutants/SmallModels.h"
#include "tests/support/TempFolder.h"

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <map>
#include <string>

namespace quarn::test {

namespace {

namespace fs = std::filesystem;
using Clock = std::chrono::steady_clock;
using std::chrono::seconds;

constexpr std::uintmax_t MOST_MODEL_BYTES = 200'000;
constexpr seconds LONGEST_READING{5};
constexpr seconds LONGEST_WITH_ITS_END{8};
constexpr std::uint64_t MOST_MEMORY = 1ULL << 30;

std::string bytesOf(const fs::path& file) {
    const auto read = readFileBytes(file);
    if (!read)
        return {};
    const auto bytes = read.value().bytes();
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

/// What became of a damaged file.
enum class End { read, refused, stopped_reader, took_too_long, needed_too_much };

End endOf(const Result<ImportedModel>& model, const fs::path& file) {
    if (model)
        return End::read;
    if (model.message() == readerStopped(file, 0).message)
        return End::stopped_reader;
    if (model.message() == readingTookTooLong(file, LONGEST_READING).message)
        return End::took_too_long;
    return model.message() == readingNeedsMore(file, MOST_MEMORY).message ? End::needed_too_much
                                                                          : End::refused;
}

/// Whether a reader of our own has the whole file in its hands: a glTF that is not of version 2
/// goes to the library.
bool isOwnReaders(const fs::path& file) {
    const std::string format = modelFormat(file);
    const bool is_gltf = format == "gltf" || format == "glb";
    return hasOwnReader(format) && (!is_gltf || bytesOf(file).find("\"2.") != std::string::npos);
}

class MutantReading {
public:
    MutantReading(std::vector<fs::path> models, fs::path kept)
        : m_models(std::move(models)), m_kept(std::move(kept)) {}

    /// Reads the mutants with these numbers.
    void read(std::uint64_t first, std::uint64_t count) {
        // All mutants of a model follow each other, so that what stands beside it is copied once.
        std::map<std::size_t, std::vector<std::uint64_t>> by_model;
        for (std::uint64_t number = first; number < first + count; ++number)
            by_model[number % m_models.size()].push_back(number);
        for (const auto& [model, numbers] : by_model)
            readMutantsOf(model, numbers);
    }

    /// @return whether all went as it must
    bool report() const {
        std::printf("%llu read, %llu refused, %llu ended their reader, %llu took too long, "
                    "%llu needed too much memory\n",
                    count(End::read), count(End::refused), count(End::stopped_reader),
                    count(End::took_too_long), count(End::needed_too_much));
        for (const std::string& harm : m_harms)
            std::printf("%s\n", harm.c_str());
        return m_harms.empty() && count(End::read) > 0 && count(End::refused) > 0;
    }

private:
    void readMutantsOf(std::size_t model, const std::vector<std::uint64_t>& numbers) {
        const fs::path& source = m_models[model];
        const std::string bytes = bytesOf(source);
        // A neighbour is of the same format, mostly.
        const std::string other = bytesOf(m_models[(model + 1) % m_models.size()]);
        const TempFolder folder;
        copyCompanions(source, folder.path());
        for (const std::uint64_t number : numbers) {
            Mutator mutator(number);
            const fs::path file = folder / source.filename().string();
            const std::string mutant = mutator.damaged(bytes, other);
            std::ofstream(file, std::ios::binary) << mutant;
            readOne(file, number);
        }
    }

    void readOne(const fs::path& file, std::uint64_t number) {
        const Clock::time_point begin = Clock::now();
        const auto model =
            readModel(file, {.most_memory = MOST_MEMORY, .longest = LONGEST_READING});
        const End end = endOf(model, file);
        ++m_ends[end];
        if (Clock::now() - begin > LONGEST_WITH_ITS_END)
            keep(file, number, "held the program up");
        else if (end == End::stopped_reader && isOwnReaders(file))
            keep(file, number, "ended a reader of our own");
        else if (!model && model.message().empty())
            keep(file, number, "was refused without a word");
    }

    void keep(const fs::path& file, std::uint64_t number, const char* what) {
        const std::string name = std::to_string(number) + "-" + file.filename().string();
        m_harms.push_back(name + " " + what);
        if (m_kept.empty())
            return;
        fs::create_directories(m_kept);
        fs::copy_file(file, m_kept / name, fs::copy_options::overwrite_existing);
    }

    unsigned long long count(End end) const {
        const auto found = m_ends.find(end);
        return found == m_ends.end() ? 0 : found->second;
    }

    std::vector<fs::path> m_models;
    fs::path m_kept;
    std::map<End, unsigned long long> m_ends;
    std::vector<std::string> m_harms;
};

int run(int count, char** arguments) {
    if (count < 4) {
        std::fprintf(stderr, "usage: read_mutants FIRST COUNT KEPT FOLDER...\n"
                             "reads the mutants with the numbers from FIRST; those that do harm "
                             "are copied to the folder KEPT\n");
        return 2;
    }
    const std::vector<fs::path> folders(arguments + 4, arguments + count);
    std::vector<fs::path> models = smallModels(folders, MOST_MODEL_BYTES);
    if (models.empty()) {
        std::fprintf(stderr, "read_mutants: there are no models\n");
        return 2;
    }
    std::printf("%zu models\n", models.size());
    MutantReading reading(std::move(models), arguments[3]);
    reading.read(std::strtoull(arguments[1], nullptr, 10),
                 std::strtoull(arguments[2], nullptr, 10));
    return reading.report() ? 0 : 1;
}

} // namespace

} // namespace quarn::test

int main(int count, char** arguments) {
    return quarn::test::run(count, arguments);
}
