#pragma once

#include "ground/Result.h"

#include "quarn/farm/FrameChunks.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn::program {

/// An array that was submitted: its task K makes chunk `first` + K.
struct SubmittedArray {
    std::string id;
    int first = 0;
    int tasks = 0;
};

/// What was submitted for a folder, as NAME.farm.json in it tells.
struct FarmRecord {
    std::string name; ///< of the animation, UTF-8
    std::string document;
    std::string submitted; ///< when, in UTC
    int frames = 0;        ///< of the animation
    FrameCost cost{};
    std::vector<std::string> chunks{}; ///< their frames, as --frames takes them
    std::vector<SubmittedArray> arrays{};
    std::string finish_id{};            ///< empty: it was not submitted
    std::vector<std::string> command{}; ///< that submitted the first array

    /// Of all jobs, the last one first: what waits for others goes before them.
    std::vector<std::string> ids() const;
};

/// The files that stand beside the frames for the cluster.
struct FarmFiles {
    FarmFiles(const std::filesystem::path& folder, const std::string& name);

    std::filesystem::path script;
    std::filesystem::path record;
    std::filesystem::path logs; ///< a folder
};

/// @return an error where the file cannot be written; then one that was there is untouched
Result<void> writeFarmRecord(const std::filesystem::path& file, const FarmRecord& record);

/// @param folder  that frames are recorded into, or the file NAME.farm.json in it
/// @return an error that names the folder where nothing was submitted for it, or for more than one
///         animation
Result<FarmRecord> readFarmRecord(const std::filesystem::path& folder);

/// The folder itself, where its file NAME.farm.json was named.
std::filesystem::path farmFolder(const std::filesystem::path& folder);

} // namespace quarn::program
