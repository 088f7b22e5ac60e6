#pragma once

#include <filesystem>
#include <map>
#include <string>
#include <vector>

namespace quarn::test {

/// A document with a turntable, and what a single process records of it.
struct House {
    int frames = 0;
    std::filesystem::path document;
    std::filesystem::path folder; ///< of the frames, page and list that one process made
};

/// The pavilion, rendered: a frame takes one processor about half a second. Made once, and kept for
/// all tests as long as the cluster stands.
const House& renderedHouse();

/// Small frames that are drawn at once, of the same name.
const House& quickHouse();

/// 200 frames, each as much work as one of renderedHouse().
const House& longHouse();

/// What stands in a folder of frames once a recording is done, by name, but for what tells how it
/// came about: journals, NAME.recording and what the farm keeps.
std::map<std::string, std::string> whatIsSeen(const std::filesystem::path& folder);

/// The files of a folder that this holds and the other has not, or has otherwise; for a message.
std::vector<std::string> differences(const std::filesystem::path& folder,
                                     const std::filesystem::path& other);

/// The names of the frames that are there, in order.
std::vector<std::string> framesIn(const std::filesystem::path& folder);

} // namespace quarn::test
