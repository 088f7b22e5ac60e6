#pragma once

#include "tests/quarn/Models.h"
#include "tests/quarn/ProgramRun.h"

namespace quarn::test {

/// A folder with a model in it, to record turntables in.
class Studio {
public:
    Studio() { writeHouse(m_folder / "house.obj"); }

    /// `quarn turntable house.obj --size 64x48 --out out` with further options, in the folder.
    Start turntable(int frames, const std::vector<std::string>& options = {}) const {
        return turntableOf("house.obj", frames, options);
    }

    Start turntableOf(const std::string& model, int frames,
                      const std::vector<std::string>& options = {}) const {
        Start start;
        start.folder = m_folder.path();
        start.arguments = {"turntable", model, "--frames", std::to_string(frames)};
        addUnlessGiven("--out", "out", options, start.arguments);
        addUnlessGiven("--size", "64x48", options, start.arguments);
        start.arguments.insert(start.arguments.end(), options.begin(), options.end());
        return start;
    }

    std::filesystem::path operator/(const std::filesystem::path& name) const {
        return m_folder / name;
    }
    const std::filesystem::path& path() const { return m_folder.path(); }

private:
    static void addUnlessGiven(const std::string& option, const std::string& value,
                               const std::vector<std::string>& given,
                               std::vector<std::string>& arguments) {
        for (const std::string& word : given)
            if (word == option)
                return;
        arguments.insert(arguments.end(), {option, value});
    }

    TempFolder m_folder;
};

} // namespace quarn::test
