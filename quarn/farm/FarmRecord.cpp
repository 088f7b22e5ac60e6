#include "quarn/farm/FarmRecord.h"

#include "ground/AtomicFile.h"

#include <fstream>
#include <iterator>
#include <nlohmann/json.hpp>
#include <span>

namespace quarn::program {

namespace {

using Json = nlohmann::ordered_json;
using Path = std::filesystem::path;

const std::string ENDING = ".farm.json";

Json jsonOf(const FarmRecord& record) {
    Json arrays = Json::array();
    for (const SubmittedArray& array : record.arrays)
        arrays.push_back({{"id", array.id}, {"first", array.first}, {"tasks", array.tasks}});
    return {{"name", record.name},
            {"document", record.document},
            {"submitted", record.submitted},
            {"frames", record.frames},
            {"frame_seconds", record.cost.frame_s},
            {"loading_seconds", record.cost.loading_s},
            {"chunks", record.chunks},
            {"arrays", arrays},
            {"finish", record.finish_id},
            {"command", record.command}};
}

/// Throws what the library throws for a text that is something else.
FarmRecord recordOf(const Json& json) {
    FarmRecord record;
    record.name = json.at("name").get<std::string>();
    record.document = json.at("document").get<std::string>();
    record.submitted = json.at("submitted").get<std::string>();
    record.frames = json.at("frames").get<int>();
    record.cost = {json.at("frame_seconds").get<double>(),
                   json.at("loading_seconds").get<double>()};
    record.chunks = json.at("chunks").get<std::vector<std::string>>();
    for (const Json& array : json.at("arrays"))
        record.arrays.push_back({array.at("id").get<std::string>(), array.at("first").get<int>(),
                                 array.at("tasks").get<int>()});
    record.finish_id = json.at("finish").get<std::string>();
    record.command = json.at("command").get<std::vector<std::string>>();
    return record;
}

std::vector<Path> recordsIn(const Path& folder) {
    std::vector<Path> found;
    std::error_code error;
    for (std::filesystem::directory_iterator entry(folder, error), end; !error && entry != end;
         entry.increment(error))
        if (entry->path().filename().native().ends_with(ENDING))
            found.push_back(entry->path());
    return found;
}

} // namespace

std::vector<std::string> FarmRecord::ids() const {
    std::vector<std::string> all;
    if (!finish_id.empty())
        all.push_back(finish_id);
    for (const SubmittedArray& array : arrays)
        all.push_back(array.id);
    return all;
}

FarmFiles::FarmFiles(const Path& folder, const std::string& name)
    : script(folder / (name + ".farm.sh")), record(folder / (name + ENDING)),
      logs(folder / (name + ".farm")) {}

Result<void> writeFarmRecord(const Path& file, const FarmRecord& record) {
    // A path need not be text; the file is for reading, and what is no text is shown as such.
    const std::string text =
        jsonOf(record).dump(1, ' ', false, Json::error_handler_t::replace) + "\n";
    return writeFileAtomically(file, std::as_bytes(std::span(text)));
}

Result<FarmRecord> readFarmRecord(const Path& folder) {
    const bool is_file = folder.filename().native().ends_with(ENDING);
    const auto files = is_file ? std::vector<Path>{folder} : recordsIn(folder);
    if (files.empty())
        return Error{"nothing was submitted for " + folder.native() +
                     ": it holds no NAME.farm.json, which quarn farm submit writes."};
    if (files.size() > 1)
        return Error{"several animations were submitted for " + folder.native() + ": give " +
                     files[0].native() + " or " + files[1].native() + "."};
    std::ifstream stream(files[0], std::ios::binary);
    const std::string text{std::istreambuf_iterator<char>(stream), {}};
    try {
        return recordOf(Json::parse(text));
    } catch (const Json::exception&) {
        return Error{files[0].native() + " cannot be read as what quarn farm submit writes; "
                                         "squeue lists the jobs, and scancel ends them."};
    }
}

Path farmFolder(const Path& folder) {
    if (!folder.filename().native().ends_with(ENDING))
        return folder;
    return folder.has_parent_path() ? folder.parent_path() : Path(".");
}

} // namespace quarn::program
