#include "desktop/views/ViewContext.h"

#include "desktop/command_line/CommandPane.h"
#include "desktop/command_line/CommandStarter.h"

namespace quarn::desktop {

bool ViewContext::areViewsFree() const {
    return !session.isCommandRunning() || pane.isAsking();
}

} // namespace quarn::desktop
