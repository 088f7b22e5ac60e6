#include "quarn/scripts/ViewerScript.h"

#include "quarn/words/Words.h"

namespace quarn::program {

std::string viewerLine(const std::filesystem::path& recorded, const ViewerRequest& request) {
    std::string line = "_-ViewerPage " + quotedPath(recorded);
    if (request.is_one_file)
        line += " _OneFile=Yes";
    if (!request.title.empty())
        line += " _Title \"" + request.title + "\"";
    return line + " _Enter";
}

} // namespace quarn::program
