#include "quarn/runs/FolderInstructions.h"

#include "host/session/InstructionSets.h"
#include "host/session/RecordingProgress.h"

#include <algorithm>

namespace quarn::program {

std::optional<std::string> whyInstructionsLack(const std::filesystem::path& folder,
                                               const std::string& wanted,
                                               const std::vector<std::string>& here) {
    if (wanted.empty() || std::ranges::find(here, wanted) != here.end())
        return std::nullopt;
    std::string names;
    for (const std::string& name : here)
        names += (names.empty() ? "" : ", ") + name;
    return "the recording in " + folder.native() + " is drawn with the instructions " + wanted +
           ", and this processor has " + names +
           ": pictures of it would differ in a few pixels. Record on a machine that has " + wanted +
           ", or begin anew with quarn record ... --overwrite.";
}

std::optional<Outcome> takeInstructionsOf(const std::filesystem::path& folder,
                                          CommonOptions& common) {
    if (!common.instructions.empty())
        return std::nullopt;
    const std::string wanted = recordingSettings(folder).progress.instructions;
    if (const auto lack = whyInstructionsLack(folder, wanted, instructionSets()))
        return Outcome::failure(*lack);
    common.instructions = wanted;
    return std::nullopt;
}

std::optional<int> jpegQualityOf(const std::filesystem::path& folder) {
    const int quality = recordingSettings(folder).progress.jpeg_quality;
    return quality > 0 ? std::optional(quality) : std::nullopt;
}

} // namespace quarn::program
