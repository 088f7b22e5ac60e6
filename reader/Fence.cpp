#include "reader/Fence.h"

#include "reader/CallFilter.h"
#include "reader/FileRules.h"

#include <sys/prctl.h>

namespace quarn {

Fence raiseFence(const std::filesystem::path& model) {
    Fence fence;
    if (prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0) != 0)
        return fence;
    fence.has_file_rules = restrictFiles(model);
    fence.has_call_filter = filterCalls(); // last: it also forbids to make rules
    return fence;
}

} // namespace quarn
