#include "host/commands/CommandEnd.h"
#include "host/share/ShareCommands.h"

namespace quarn {

CQuarnCommand::result runExportCamera(const CQuarnCommandContext&) {
    return fail("Not there yet.");
}

} // namespace quarn
