#include "tests/model_mutants/SmallModels.h"

#include "import/ModelFormats.h"
#include "import/files/ModelFileCheck.h"

#include <algorithm>
#include <string>

namespace quarn::test {

namespace fs = std::filesystem;

std::vector<fs::path> smallModels(const std::vector<fs::path>& folders, std::uintmax_t most_bytes) {
    const std::vector<std::string> known = modelFileExtensions();
    std::vector<fs::path> found;
    for (const fs::path& folder : folders)
        for (const fs::directory_entry& entry : fs::recursive_directory_iterator(folder))
            if (entry.is_regular_file() && entry.file_size() <= most_bytes &&
                std::ranges::find(known, modelFormat(entry.path())) != known.end())
                found.push_back(entry.path());
    std::ranges::sort(found);
    return found;
}

void copyCompanions(const fs::path& model, const fs::path& to) {
    constexpr std::uintmax_t MOST_BYTES = 300'000;
    constexpr std::uintmax_t MOST_IN_ALL = 3'000'000;
    constexpr int DEEPEST = 2;
    std::uintmax_t copied = 0;
    for (auto entry = fs::recursive_directory_iterator(model.parent_path());
         entry != fs::recursive_directory_iterator(); ++entry) {
        if (entry.depth() >= DEEPEST)
            entry.disable_recursion_pending();
        if (!entry->is_regular_file() || entry->file_size() > MOST_BYTES)
            continue;
        copied += entry->file_size();
        if (copied > MOST_IN_ALL)
            return;
        const fs::path copy = to / entry->path().lexically_relative(model.parent_path());
        fs::create_directories(copy.parent_path());
        fs::copy_file(entry->path(), copy, fs::copy_options::overwrite_existing);
    }
}

} // namespace quarn::test
