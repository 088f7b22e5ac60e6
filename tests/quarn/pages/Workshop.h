#pragma once

#include "tests/quarn/ProgramRun.h"

namespace quarn::test {

/// A folder with every file that the commands of the pages and of the help texts name: small models
/// with curves, documents with an animation, curve files, a script, recorded
/// frames.
class Workshop {
public:
    Workshop();

    /// Runs the program in the folder.
    Ended run(const std::vector<std::string>& arguments, const std::string& input = "") const;

    std::filesystem::path operator/(const std::filesystem::path& name) const {
        return m_folder / name;
    }

private:
    void writeModels() const;
    void writeCurves() const;
    void writeDocuments() const;
    void writeCluster() const; ///< commands of one that takes jobs and runs none, and such jobs
    void writeFrames() const;  ///< two of a recording, in the folder frames

    TempFolder m_folder;
};

} // namespace quarn::test
